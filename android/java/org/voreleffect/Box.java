package org.voreleffect;

import androidx.annotation.NonNull;
import androidx.annotation.Nullable;

/** A rectangle of whole pixels, half-open. */
public final class Box {
    /** First column. */
    public final int left;

    /** First row. */
    public final int top;

    /** One past the last column. */
    public final int right;

    /** One past the last row. */
    public final int bottom;

    /**
     * From its four sides; without a pixel where the right is not beyond the left, or the bottom not
     * beyond the top.
     *
     * @param left first column
     * @param top first row
     * @param right one past the last column
     * @param bottom one past the last row
     */
    public Box(int left, int top, int right, int bottom) {
        this.left = left;
        this.top = top;
        this.right = right;
        this.bottom = bottom;
    }

    Box(@NonNull int[] sides) {
        this(sides[0], sides[1], sides[2], sides[3]);
    }

    /**
     * Whether there is no pixel in it.
     *
     * @return true for one of no width or no height
     */
    public boolean isEmpty() {
        return right <= left || bottom <= top;
    }

    @Override
    public boolean equals(@Nullable Object other) {
        if (!(other instanceof Box)) return false;
        Box same = (Box) other;
        return left == same.left && top == same.top && right == same.right && bottom == same.bottom;
    }

    @Override
    public int hashCode() {
        return ((left * 31 + top) * 31 + right) * 31 + bottom;
    }

    @Override
    @NonNull
    public String toString() {
        return "Box(" + left + ", " + top + ", " + right + ", " + bottom + ")";
    }
}
