package org.voreleffect;

/** Where a stroke lies on the edge of the glyphs. */
public enum Position {
    /** Half of it on each side. */
    CENTRE,
    /** Around the glyphs. */
    OUTSIDE,
    /** Within the glyphs. */
    INSIDE
}
