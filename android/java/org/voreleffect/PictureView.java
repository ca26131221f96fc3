package org.voreleffect;

import androidx.annotation.CheckResult;
import androidx.annotation.NonNull;
import java.nio.ByteBuffer;

/**
 * A picture to paint on: premultiplied pixels in an array or a buffer of the caller's. Immutable but for
 * the pixels, which are not copied.
 *
 * <pre>{@code
 * BufferedImage image = new BufferedImage(640, 360, BufferedImage.TYPE_INT_ARGB_PRE);
 * int[] pixels = ((DataBufferInt) image.getRaster().getDataBuffer()).getData();
 * PictureView page = PictureView.of(pixels, 640, 360);
 * }</pre>
 */
public final class PictureView {
    private static final int BYTES_PER_PIXEL = 4;
    private static final int LARGEST = (1 << 30) - 1;

    private final Memory memory;
    private final int width;
    private final int height;
    private final int stride;
    private final PixelOrder order;
    private final Box clip;

    private PictureView(Memory memory, int width, int height, int stride, PixelOrder order, Box clip) {
        this.memory = memory;
        this.width = width;
        this.height = height;
        this.stride = stride;
        this.order = order;
        this.clip = clip;
    }

    private PictureView(Memory memory, int width, int height, int stride) {
        this(memory, width, height, stride, PixelOrder.RGBA, new Box(0, 0, width, height));
    }

    /**
     * Of words 0xAARRGGBB, premultiplied, rows back to back: those of a
     * {@code BufferedImage.TYPE_INT_ARGB_PRE}. (What {@code android.graphics.Bitmap.getPixels} gives is
     * not premultiplied: {@link VorelBitmaps} paints on bitmaps.)
     *
     * @param pixels a word for each pixel, top row first
     * @param width pixels of a row, 0 and more
     * @param height rows, 0 and more
     * @return the view
     */
    @NonNull
    public static PictureView of(@NonNull int[] pixels, int width, int height) {
        return of(pixels, width, height, width);
    }

    /**
     * Of words 0xAARRGGBB, premultiplied, in rows that may lie apart.
     *
     * @param pixels a word for each pixel, top row first
     * @param width pixels of a row, 0 and more
     * @param height rows, 0 and more
     * @param stride words from row to row, at least the width
     * @return the view
     */
    @NonNull
    public static PictureView of(@NonNull int[] pixels, int width, int height, int stride) {
        long words = lengthOf(width, height, stride, 1);
        return new PictureView(Memory.of("pixels", pixels, words), width, height, stride);
    }

    /**
     * Of bytes R, G, B, A, premultiplied, rows back to back.
     *
     * @param pixels four bytes for each pixel, top row first
     * @param width pixels of a row, 0 and more
     * @param height rows, 0 and more
     * @return the view
     */
    @NonNull
    public static PictureView of(@NonNull byte[] pixels, int width, int height) {
        return of(pixels, width, height, packed(width));
    }

    /**
     * Of bytes R, G, B, A, premultiplied, in rows that may lie apart.
     *
     * @param pixels four bytes for each pixel, top row first
     * @param width pixels of a row, 0 and more
     * @param height rows, 0 and more
     * @param stride bytes from row to row, at least 4 * width
     * @return the view
     */
    @NonNull
    public static PictureView of(@NonNull byte[] pixels, int width, int height, int stride) {
        long bytes = lengthOf(width, height, stride, BYTES_PER_PIXEL);
        return new PictureView(Memory.of("pixels", pixels, bytes), width, height, stride);
    }

    /**
     * Of bytes R, G, B, A, premultiplied, rows back to back, in a buffer that can be written to, direct
     * or with an array, from its position on. The position is read here and not moved.
     *
     * @param pixels four bytes for each pixel, top row first
     * @param width pixels of a row, 0 and more
     * @param height rows, 0 and more
     * @return the view
     */
    @NonNull
    public static PictureView of(@NonNull ByteBuffer pixels, int width, int height) {
        return of(pixels, width, height, packed(width));
    }

    /**
     * Of bytes R, G, B, A, premultiplied, in rows that may lie apart, in a buffer that can be written
     * to, direct or with an array, from its position on. The position is read here and not moved.
     *
     * @param pixels four bytes for each pixel, top row first
     * @param width pixels of a row, 0 and more
     * @param height rows, 0 and more
     * @param stride bytes from row to row, at least 4 * width
     * @return the view
     */
    @NonNull
    public static PictureView of(@NonNull ByteBuffer pixels, int width, int height, int stride) {
        long bytes = lengthOf(width, height, stride, BYTES_PER_PIXEL);
        if (pixels != null && pixels.isReadOnly()) throw new IllegalArgumentException("pixels: read-only");
        return new PictureView(Memory.of("pixels", pixels, bytes), width, height, stride);
    }

    /**
     * The same pixels with another order of their bytes. Words have none.
     *
     * @param order of the bytes of a pixel
     * @return the view
     */
    @CheckResult
    @NonNull
    public PictureView order(@NonNull PixelOrder order) {
        if (order == null) throw new IllegalArgumentException("order: null");
        if (memory.kind == Memory.WORDS) throw new IllegalArgumentException("order: of words 0xAARRGGBB");
        return new PictureView(memory, width, height, stride, order, clip);
    }

    /**
     * The same picture, of which what lies outside the box is left alone. Its coordinates stay. A view
     * that is clipped already is clipped to both.
     *
     * @param box what may be painted on; without a pixel, nothing
     * @return the view
     */
    @CheckResult
    @NonNull
    public PictureView clip(@NonNull Box box) {
        if (box == null) throw new IllegalArgumentException("clip: null");
        int left = within(box.left, clip.left, clip.right);
        int top = within(box.top, clip.top, clip.bottom);
        Box both = new Box(
                left, top, within(box.right, left, clip.right), within(box.bottom, top, clip.bottom));
        return new PictureView(memory, width, height, stride, order, both);
    }

    /**
     * Pixels of a row.
     *
     * @return 0 and more
     */
    public int width() {
        return width;
    }

    /**
     * Rows.
     *
     * @return 0 and more
     */
    public int height() {
        return height;
    }

    /** Where the pixels are; fails where they were closed. */
    @NonNull
    Object memory() {
        if (!clip.isEmpty()) memory.touch();
        return memory.object;
    }

    /** As the native side takes them. */
    @NonNull
    int[] numbers() {
        return new int[] {
            memory.kind, memory.offset, stride, order.ordinal(),
            clip.left, clip.top, clip.right, clip.bottom
        };
    }

    private static int within(int value, int least, int most) {
        return Math.max(least, Math.min(value, most));
    }

    private static int packed(int width) {
        return (int) Math.min((long) width * BYTES_PER_PIXEL, Integer.MAX_VALUE);
    }

    /** Bytes, or words, from the first pixel to the last. */
    private static long lengthOf(int width, int height, int stride, int perPixel) {
        if (width < 0 || height < 0 || width > LARGEST || height > LARGEST) {
            throw new IllegalArgumentException("size of a picture: " + width + " x " + height);
        }
        long row = (long) width * perPixel;
        if (stride < row) throw new IllegalArgumentException("stride of a picture: " + stride);
        return width == 0 || height == 0 ? 0 : (long) stride * (height - 1) + row;
    }
}
