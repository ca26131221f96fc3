package org.voreleffect;

import androidx.annotation.NonNull;
import androidx.annotation.Nullable;

/** Pixels that a look needs around the glyphs; each 0 or more. */
public final class Margins {
    /** To the left. */
    public final int left;

    /** Above. */
    public final int top;

    /** To the right. */
    public final int right;

    /** Below. */
    public final int bottom;

    Margins(@NonNull int[] numbers) {
        left = numbers[0];
        top = numbers[1];
        right = numbers[2];
        bottom = numbers[3];
    }

    @Override
    public boolean equals(@Nullable Object other) {
        if (!(other instanceof Margins)) return false;
        Margins same = (Margins) other;
        return left == same.left && top == same.top && right == same.right && bottom == same.bottom;
    }

    @Override
    public int hashCode() {
        return ((left * 31 + top) * 31 + right) * 31 + bottom;
    }

    @Override
    @NonNull
    public String toString() {
        return "Margins(" + left + ", " + top + ", " + right + ", " + bottom + ")";
    }
}
