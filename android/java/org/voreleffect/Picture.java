package org.voreleffect;

import androidx.annotation.NonNull;
import java.nio.ByteBuffer;

/**
 * A picture that owns its pixels: premultiplied bytes R, G, B, A in packed rows. The pixels are in the
 * memory of the virtual machine, which frees them: there is nothing to close. Several threads may read
 * one.
 */
public final class Picture {
    static {
        Library.load();
    }

    private final int width;
    private final int height;
    private final int left;
    private final int top;
    private final ByteBuffer pixels;

    Picture(@NonNull int[] place, @NonNull ByteBuffer pixels) {
        width = place[0];
        height = place[1];
        left = place[2];
        top = place[3];
        this.pixels = pixels;
    }

    /**
     * Pixels of a row.
     *
     * @return 0 for an empty one
     */
    public int width() {
        return width;
    }

    /**
     * Rows.
     *
     * @return 0 for an empty one
     */
    public int height() {
        return height;
    }

    /**
     * Its left column, from the origin of the text.
     *
     * @return in pixels
     */
    public int left() {
        return left;
    }

    /**
     * Its top row, from the origin of the text.
     *
     * @return in pixels
     */
    public int top() {
        return top;
    }

    /**
     * Whether it has no pixels.
     *
     * @return true when there was nothing to paint
     */
    public boolean isEmpty() {
        return width == 0 || height == 0;
    }

    /**
     * The pixels to read, as {@code Bitmap.copyPixelsFromBuffer} takes them for a bitmap of this size.
     *
     * @return a direct buffer of 4 * width * height bytes, read-only, with a position of its own
     */
    @NonNull
    public ByteBuffer pixels() {
        return pixels.asReadOnlyBuffer();
    }

    /**
     * Its own pixels to paint on, with (0, 0) as their upper left corner.
     *
     * @return a view
     */
    @NonNull
    public PictureView view() {
        return PictureView.of(pixels.duplicate(), width, height);
    }

    /**
     * Lays it over the view, clipped, so that the origin of the text stands at (x, y): each channel
     * becomes over + under * (255 - alpha) / 255, rounded to nearest, at most 255. The view must not show
     * this picture's own pixels: they would be changed while they are read.
     *
     * @param view what it is laid over
     * @param x -2^30 to 2^30
     * @param y -2^30 to 2^30
     * @return the box that was touched; an empty one when none of it lies within the view
     */
    @NonNull
    public Box layOver(@NonNull PictureView view, int x, int y) {
        if (view == null) throw new IllegalArgumentException("view: null");
        Painter.checkOrigin(x, y);
        int[] touched = new int[4];
        nativeLayOver(pixels, place(), view.memory(), view.numbers(), x, y, touched);
        return new Box(touched);
    }

    /** As the native side takes it. */
    @NonNull
    int[] place() {
        return new int[] {width, height, left, top};
    }

    /** The buffer itself: its position is 0 and not to be moved. */
    @NonNull
    ByteBuffer buffer() {
        return pixels;
    }

    private static native void nativeLayOver(
            ByteBuffer pixels, int[] place, Object target, int[] view, int x, int y, int[] touched);
}
