package org.voreleffect;

import androidx.annotation.NonNull;
import androidx.annotation.Nullable;

/**
 * One effect of a look; which of the numbers count depends on its kind. Not changed once it is in a
 * look.
 */
final class Effect {
    /** The numbers by which the native side knows the kinds. */
    static final int OUTER_SHADOW = 1;

    static final int INNER_SHADOW = 2;
    static final int OUTER_GLOW = 3;
    static final int INNER_GLOW = 4;
    static final int LINEAR_GRADIENT = 7;
    static final int RADIAL_GRADIENT = 8;
    static final int STROKE = 10;
    static final int PATTERN = 11;

    private static final int NUMBERS = 9;
    private static final int NUMBERS_OF_A_STOP = 3;

    final int kind;
    int color;
    float opacity = 1;
    float angle;
    float distance;
    float size;
    float scale = 1;
    @NonNull Position position = Position.OUTSIDE;
    @NonNull Stops stops = Stops.NONE;

    /** The pixels of a pattern behind their width and height; null for all other kinds. */
    @Nullable int[] tile;

    Effect(int kind) {
        this.kind = kind;
    }

    int length() {
        return NUMBERS + NUMBERS_OF_A_STOP * stops.size();
    }

    /** Writes its numbers; returns the index behind them. */
    int write(@NonNull int[] to, int at) {
        to[at++] = kind;
        to[at++] = color;
        to[at++] = Float.floatToRawIntBits(opacity);
        to[at++] = Float.floatToRawIntBits(angle);
        to[at++] = Float.floatToRawIntBits(distance);
        to[at++] = Float.floatToRawIntBits(size);
        to[at++] = Float.floatToRawIntBits(scale);
        to[at++] = position.ordinal();
        to[at++] = stops.size();
        for (int i = 0; i < stops.size(); ++i) {
            to[at++] = stops.colors()[i];
            to[at++] = Float.floatToRawIntBits(stops.opacities()[i]);
            to[at++] = Float.floatToRawIntBits(stops.places()[i]);
        }
        return at;
    }
}
