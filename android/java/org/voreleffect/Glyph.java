package org.voreleffect;

import androidx.annotation.CheckResult;
import androidx.annotation.NonNull;
import java.nio.ByteBuffer;
import java.util.List;

/**
 * The coverage of one glyph, or of a whole line, and where it stands. Immutable but for the coverage,
 * which is not copied: it is read by the calls that the glyph is handed to, and by nothing else.
 *
 * <p>One of no width or no height is skipped.
 */
public final class Glyph {
    private static final int LARGEST = 0xFFFF;
    /** The numbers of one glyph for the native side. */
    private static final int NUMBERS = 7;

    private final int x;
    private final int y;
    private final int width;
    private final int height;
    private final int stride;
    private final Memory coverage;

    private Glyph(int x, int y, int width, int height, int stride, Memory coverage) {
        this.x = x;
        this.y = y;
        this.width = width;
        this.height = height;
        this.stride = stride;
        this.coverage = coverage;
    }

    /**
     * From packed rows.
     *
     * @param x left edge, from the origin of the text
     * @param y top edge
     * @param coverage a byte for each pixel, 0 outside to 255 inside, top row first
     * @param width pixels of a row, 0 to 65535
     * @param height rows, 0 to 65535
     */
    public Glyph(int x, int y, @NonNull byte[] coverage, int width, int height) {
        this(x, y, coverage, width, height, width);
    }

    /**
     * From rows that may lie apart.
     *
     * @param x left edge, from the origin of the text
     * @param y top edge
     * @param coverage a byte for each pixel, 0 outside to 255 inside, top row first
     * @param width pixels of a row, 0 to 65535
     * @param height rows, 0 to 65535
     * @param stride bytes from row to row, at least the width
     */
    public Glyph(int x, int y, @NonNull byte[] coverage, int width, int height, int stride) {
        this(x, y, width, height, stride,
                Memory.of("coverage", coverage, bytesOf(width, height, stride)));
    }

    /**
     * From packed rows in a buffer, direct or with an array, from its position on. The position is read
     * here and not moved.
     *
     * @param x left edge, from the origin of the text
     * @param y top edge
     * @param coverage a byte for each pixel, 0 outside to 255 inside, top row first
     * @param width pixels of a row, 0 to 65535
     * @param height rows, 0 to 65535
     */
    public Glyph(int x, int y, @NonNull ByteBuffer coverage, int width, int height) {
        this(x, y, coverage, width, height, width);
    }

    /**
     * From rows that may lie apart, in a buffer, direct or with an array, from its position on. The
     * position is read here and not moved.
     *
     * @param x left edge, from the origin of the text
     * @param y top edge
     * @param coverage a byte for each pixel, 0 outside to 255 inside, top row first
     * @param width pixels of a row, 0 to 65535
     * @param height rows, 0 to 65535
     * @param stride bytes from row to row, at least the width
     */
    public Glyph(int x, int y, @NonNull ByteBuffer coverage, int width, int height, int stride) {
        this(x, y, width, height, stride,
                Memory.of("coverage", coverage, bytesOf(width, height, stride)));
    }

    /**
     * The same glyph elsewhere: glyphs of a cache are placed so.
     *
     * @param x left edge, from the origin of the text
     * @param y top edge
     * @return one that reads the same coverage
     */
    @CheckResult
    @NonNull
    public Glyph at(int x, int y) {
        return new Glyph(x, y, width, height, stride, coverage);
    }

    /**
     * Its left edge, from the origin of the text.
     *
     * @return in pixels
     */
    public int x() {
        return x;
    }

    /**
     * Its top edge, from the origin of the text.
     *
     * @return in pixels
     */
    public int y() {
        return y;
    }

    /**
     * Pixels of a row.
     *
     * @return 0 to 65535
     */
    public int width() {
        return width;
    }

    /**
     * Rows.
     *
     * @return 0 to 65535
     */
    public int height() {
        return height;
    }

    private static long bytesOf(int width, int height, int stride) {
        if (width < 0 || width > LARGEST || height < 0 || height > LARGEST) {
            throw new IllegalArgumentException("size of a glyph: " + width + " x " + height);
        }
        if (stride < width) throw new IllegalArgumentException("stride of a glyph: " + stride);
        return width == 0 || height == 0 ? 0 : (long) stride * (height - 1) + width;
    }

    /** Glyphs as the native side takes them: their numbers, and where their coverage is. */
    static final class Run {
        @NonNull final int[] numbers;
        @NonNull final Object[] coverage;

        Run(@NonNull List<Glyph> glyphs) {
            if (glyphs == null) throw new IllegalArgumentException("glyphs: null");
            Glyph[] list = glyphs.toArray(new Glyph[0]);
            if (list.length > Integer.MAX_VALUE / NUMBERS) throw new OutOfMemoryError("glyphs");
            numbers = new int[list.length * NUMBERS];
            coverage = new Object[list.length];
            for (int i = 0; i < list.length; ++i) take(list[i], i);
        }

        private void take(Glyph glyph, int index) {
            if (glyph == null) throw new IllegalArgumentException("glyphs: one is null");
            Memory memory = glyph.coverage;
            if (glyph.width > 0 && glyph.height > 0) memory.touch();
            int at = index * NUMBERS;
            numbers[at] = glyph.x;
            numbers[at + 1] = glyph.y;
            numbers[at + 2] = glyph.width;
            numbers[at + 3] = glyph.height;
            numbers[at + 4] = glyph.stride;
            numbers[at + 5] = memory.kind;
            numbers[at + 6] = memory.offset;
            coverage[index] = memory.object;
        }
    }
}
