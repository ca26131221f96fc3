package org.voreleffect;

/** How the four bytes of a premultiplied pixel stand in memory. */
public enum PixelOrder {
    /** Red first, as in an {@code android.graphics.Bitmap}. */
    RGBA,
    /** Blue first, as on most screens. */
    BGRA
}
