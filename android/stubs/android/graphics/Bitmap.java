package android.graphics;

import java.nio.Buffer;

/** What VorelBitmaps.java calls of Android's class, to be compiled against; no class is shipped. */
public final class Bitmap {
    private Bitmap() {}

    /** The layouts of pixels that are asked for here. */
    public enum Config {
        /** One byte of coverage. */
        ALPHA_8,
        /** Four bytes R, G, B, A. */
        ARGB_8888
    }

    /** @return a clear one */
    public static Bitmap createBitmap(int width, int height, Config config) {
        throw new UnsupportedOperationException();
    }

    /** @return pixels of a row */
    public int getWidth() {
        throw new UnsupportedOperationException();
    }

    /** @return rows */
    public int getHeight() {
        throw new UnsupportedOperationException();
    }

    /** @return bytes from row to row */
    public int getRowBytes() {
        throw new UnsupportedOperationException();
    }

    /** @return the layout of its pixels; null for one that has no name */
    public Config getConfig() {
        throw new UnsupportedOperationException();
    }

    /** @return whether its pixels may be changed */
    public boolean isMutable() {
        throw new UnsupportedOperationException();
    }

    /** @return whether its alpha counts */
    public boolean hasAlpha() {
        throw new UnsupportedOperationException();
    }

    /** @return whether its pixels have an alpha that they were multiplied with */
    public boolean isPremultiplied() {
        throw new UnsupportedOperationException();
    }

    /** Copies its bytes, with the gaps between rows. */
    public void copyPixelsToBuffer(Buffer buffer) {
        throw new UnsupportedOperationException();
    }

    /** Takes bytes, with the gaps between rows. */
    public void copyPixelsFromBuffer(Buffer buffer) {
        throw new UnsupportedOperationException();
    }
}
