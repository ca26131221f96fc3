package org.voreleffect;

import androidx.annotation.CheckResult;
import androidx.annotation.NonNull;
import java.nio.ByteBuffer;
import java.util.Arrays;
import java.util.Collections;
import java.util.List;

/**
 * Paints in a look, or in a stack of looks, again and again: every time the same picture for the same
 * glyphs. It keeps its layers for the next time, as large as the largest so far.
 *
 * <pre>{@code
 * try (Painter painter = new Painter(border, face)) { // the face lies on top
 *     Box touched = painter.paint(glyphs, page, 40, 300);
 * }
 * }</pre>
 *
 * <p>Gradients, patterns and what lies inside follow the box around all glyphs of a call: paint a line
 * in one call, and a page line by line.
 *
 * <p>The methods exclude each other, so that a painter may be handed from thread to thread and closed
 * from any of them; separate painters paint at the same time. Close a painter when it is done: a call
 * after that gives an {@link IllegalStateException}. One that was never closed is freed when a later
 * object is made, after the collector has found it unreachable.
 *
 * <p>Null gives an {@link IllegalArgumentException}, memory that its owner has closed an
 * {@link IllegalStateException}, memory that runs out an {@link OutOfMemoryError}: the picture is as it
 * was then. An effect that memory runs out for while it paints is missing, the others are there. Glyphs
 * and views are looked at only during the call that they are handed to; memory under a direct buffer
 * that is unmapped or freed <em>during</em> a call cannot be told from memory that is there, and ends
 * the process.
 */
public final class Painter implements AutoCloseable {
    /** Of x and y, so that they can be moved by the width of a picture. */
    private static final int FARTHEST = 1 << 30;

    static {
        Library.load();
    }

    private final NativeSide side;

    /**
     * Of a look, or of a stack of looks.
     *
     * @param looks the last on top; none paint nothing
     */
    public Painter(@NonNull Look... looks) {
        this(looks == null ? null : Arrays.asList(looks));
    }

    /**
     * Of a stack of looks.
     *
     * @param looks the last on top; none paint nothing
     */
    public Painter(@NonNull List<Look> looks) {
        if (looks == null) throw new IllegalArgumentException("looks: null");
        Look[] stack = looks.toArray(new Look[0]);
        int[][] numbers = new int[stack.length][];
        int[][] tiles = new int[stack.length][];
        for (int i = 0; i < stack.length; ++i) {
            if (stack[i] == null) throw new IllegalArgumentException("looks: one is null");
            numbers[i] = stack[i].numbers();
            tiles[i] = stack[i].tile();
        }
        side = new Side(this);
        side.hold(nativeNew(numbers, tiles));
    }

    /**
     * Frees its memory. Closing twice does nothing. A call of another thread that is under way is waited
     * for; what it calls next is refused.
     */
    @Override
    public synchronized void close() {
        side.free();
    }

    /**
     * How far the looks paint beyond the glyphs, all of them together.
     *
     * @return pixels on each side
     */
    @NonNull
    public synchronized Margins margins() {
        return new Margins(nativeMargins(side.address()));
    }

    /**
     * Lays the painted glyphs over the view, clipped, so that the origin of the text stands at (x, y).
     * The looks are painted one after the other, each laid over what is there: each channel becomes over
     * + under * (255 - alpha) / 255, rounded to nearest, at most 255.
     *
     * @param glyphs in any order; where they overlap the larger coverage counts
     * @param view what they are laid over
     * @param x -2^30 to 2^30
     * @param y -2^30 to 2^30
     * @return the box that holds all that was touched; an empty one when there is nothing to paint, or
     *     none of it lies within the view
     */
    @NonNull
    public synchronized Box paint(
            @NonNull List<Glyph> glyphs, @NonNull PictureView view, int x, int y) {
        Glyph.Run run = new Glyph.Run(glyphs);
        long painter = side.address(); // the list, a caller's, may have closed this
        if (view == null) throw new IllegalArgumentException("view: null");
        checkOrigin(x, y);
        int[] touched = new int[4];
        nativePaint(painter, run.numbers, run.coverage, view.memory(), view.numbers(), x, y, touched);
        return new Box(touched);
    }

    /**
     * Lays one painted glyph over the view; see {@link #paint(List, PictureView, int, int)}.
     *
     * @param glyph one, or a whole line
     * @param view what it is laid over
     * @param x -2^30 to 2^30
     * @param y -2^30 to 2^30
     * @return the box that was touched
     */
    @NonNull
    public Box paint(@NonNull Glyph glyph, @NonNull PictureView view, int x, int y) {
        return paint(Collections.singletonList(glyph), view, x, y);
    }

    /**
     * Paints a picture of its own, just large enough for the box of the glyphs and the margins.
     *
     * @param glyphs in any order; where they overlap the larger coverage counts
     * @return the picture; an empty one when there is nothing to paint
     */
    @CheckResult
    @NonNull
    public synchronized Picture paint(@NonNull List<Glyph> glyphs) {
        Glyph.Run run = new Glyph.Run(glyphs);
        long painter = side.address(); // the list, a caller's, may have closed this
        int[] place = new int[4];
        nativePicture(painter, run.numbers, run.coverage, place);
        ByteBuffer pixels = null;
        try {
            pixels = ByteBuffer.allocateDirect(4 * place[0] * place[1]);
        } finally {
            nativeTakePicture(painter, pixels);
        }
        return new Picture(place, pixels);
    }

    /**
     * Paints a picture of one glyph; see {@link #paint(List)}.
     *
     * @param glyph one, or a whole line
     * @return the picture
     */
    @CheckResult
    @NonNull
    public Picture paint(@NonNull Glyph glyph) {
        return paint(Collections.singletonList(glyph));
    }

    /** The address, for a call of the package that holds this object's lock. */
    long address() {
        return side.address();
    }

    static void checkOrigin(int x, int y) {
        if (Math.max(x, y) > FARTHEST || Math.min(x, y) < -FARTHEST) {
            throw new IllegalArgumentException("origin: " + x + ", " + y);
        }
    }

    private static final class Side extends NativeSide {
        Side(Painter owner) {
            super(owner);
        }

        @Override
        void destroy(long made) {
            nativeFree(made);
        }
    }

    // Those of an object are not static: as an argument of the call it stays reachable until that returns.

    private static native long nativeNew(int[][] numbers, int[][] tiles);

    private static native void nativeFree(long painter);

    private native int[] nativeMargins(long painter);

    private native void nativePaint(
            long painter,
            int[] glyphs,
            Object[] coverage,
            Object target,
            int[] view,
            int x,
            int y,
            int[] touched);

    /** Paints a picture, whose width, height, left and top it tells, and keeps it. */
    private native void nativePicture(long painter, int[] glyphs, Object[] coverage, int[] place);

    /** Moves the kept picture into the buffer, or drops it where that is null. */
    private native void nativeTakePicture(long painter, ByteBuffer pixels);
}
