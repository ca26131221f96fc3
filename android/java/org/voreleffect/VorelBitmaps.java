package org.voreleffect;

import android.graphics.Bitmap;
import androidx.annotation.CheckResult;
import androidx.annotation.NonNull;
import java.nio.ByteBuffer;
import java.util.Collections;
import java.util.List;

/**
 * Painting on bitmaps of Android, for Android alone: no other class here knows of them, so that the
 * others run on every virtual machine.
 *
 * <p>A bitmap that is painted on is mutable, premultiplied or opaque, has the configuration ARGB_8888,
 * and is not recycled; another one gives an {@link IllegalArgumentException} and is left alone. It is
 * locked for the call and unlocked again whatever happens. Do not recycle it on another thread meanwhile.
 */
public final class VorelBitmaps {
    static {
        Library.load();
    }

    private VorelBitmaps() {}

    /**
     * Lays the painted glyphs over a bitmap, as {@link Painter#paint(List, PictureView, int, int)} does
     * over a view, without a copy of its pixels.
     *
     * @param painter of a look, or of a stack of looks
     * @param glyphs in any order
     * @param bitmap what they are laid over
     * @param x where the origin of the text stands, -2^30 to 2^30
     * @param y where the origin of the text stands, -2^30 to 2^30
     * @return the box that was touched; an empty one when none of it lies within the bitmap
     */
    @NonNull
    public static Box paint(
            @NonNull Painter painter, @NonNull List<Glyph> glyphs, @NonNull Bitmap bitmap, int x, int y) {
        if (painter == null) throw new IllegalArgumentException("painter: null");
        int[] touched = new int[4];
        synchronized (painter) {
            Glyph.Run run = new Glyph.Run(glyphs);
            long address = painter.address(); // the list, a caller's, may have closed it
            checkTarget(bitmap, x, y);
            nativePaint(painter, address, run.numbers, run.coverage, bitmap, x, y, touched);
        }
        return new Box(touched);
    }

    /**
     * Lays glyphs over a bitmap once.
     *
     * @param look what they look like
     * @param glyphs in any order
     * @param bitmap what they are laid over
     * @param x where the origin of the text stands, -2^30 to 2^30
     * @param y where the origin of the text stands, -2^30 to 2^30
     * @return the box that was touched
     */
    @NonNull
    public static Box paint(
            @NonNull Look look, @NonNull List<Glyph> glyphs, @NonNull Bitmap bitmap, int x, int y) {
        try (Painter painter = new Painter(look)) {
            return paint(painter, glyphs, bitmap, x, y);
        }
    }

    /**
     * Lays one glyph over a bitmap once.
     *
     * @param look what it looks like
     * @param glyph one, or a whole line
     * @param bitmap what it is laid over
     * @param x where the origin of the text stands, -2^30 to 2^30
     * @param y where the origin of the text stands, -2^30 to 2^30
     * @return the box that was touched
     */
    @NonNull
    public static Box paint(
            @NonNull Look look, @NonNull Glyph glyph, @NonNull Bitmap bitmap, int x, int y) {
        return paint(look, Collections.singletonList(glyph), bitmap, x, y);
    }

    /**
     * Lays a picture over a bitmap, as {@link Picture#layOver} does over a view.
     *
     * @param picture what was painted
     * @param bitmap what it is laid over
     * @param x where the origin of the text stands, -2^30 to 2^30
     * @param y where the origin of the text stands, -2^30 to 2^30
     * @return the box that was touched
     */
    @NonNull
    public static Box layOver(@NonNull Picture picture, @NonNull Bitmap bitmap, int x, int y) {
        if (picture == null) throw new IllegalArgumentException("picture: null");
        checkTarget(bitmap, x, y);
        int[] touched = new int[4];
        nativeLayOver(picture.buffer(), picture.place(), bitmap, x, y, touched);
        return new Box(touched);
    }

    /**
     * The coverage that was drawn into a bitmap of the configuration ALPHA_8, copied.
     *
     * @param mask drawn with an opaque, anti-aliased paint
     * @param x its left edge, from the origin of the text
     * @param y its top edge
     * @return a glyph
     */
    @CheckResult
    @NonNull
    public static Glyph glyphOf(@NonNull Bitmap mask, int x, int y) {
        if (mask == null) throw new IllegalArgumentException("mask: null");
        if (mask.getConfig() != Bitmap.Config.ALPHA_8) {
            throw new IllegalArgumentException("mask: of the configuration " + mask.getConfig());
        }
        int stride = mask.getRowBytes();
        long bytes = (long) stride * mask.getHeight();
        if (bytes > Integer.MAX_VALUE) throw new IllegalArgumentException("mask: " + bytes + " bytes");
        ByteBuffer rows = ByteBuffer.allocate((int) bytes);
        mask.copyPixelsToBuffer(rows);
        return new Glyph(x, y, rows.array(), mask.getWidth(), mask.getHeight(), stride);
    }

    /**
     * A picture as a bitmap of its size and of the configuration ARGB_8888.
     *
     * @param picture one that is not empty
     * @return a new bitmap
     */
    @CheckResult
    @NonNull
    public static Bitmap bitmapOf(@NonNull Picture picture) {
        if (picture == null || picture.isEmpty()) {
            throw new IllegalArgumentException("picture: " + (picture == null ? "null" : "empty"));
        }
        Bitmap bitmap =
                Bitmap.createBitmap(picture.width(), picture.height(), Bitmap.Config.ARGB_8888);
        int[] corner = {picture.width(), picture.height(), 0, 0};
        nativeLayOver(picture.buffer(), corner, bitmap, 0, 0, new int[4]);
        return bitmap;
    }

    private static void checkTarget(Bitmap bitmap, int x, int y) {
        if (bitmap == null) throw new IllegalArgumentException("bitmap: null");
        if (!bitmap.isMutable()) throw new IllegalArgumentException("bitmap: not mutable");
        if (bitmap.hasAlpha() && !bitmap.isPremultiplied()) {
            throw new IllegalArgumentException("bitmap: not premultiplied");
        }
        Painter.checkOrigin(x, y);
    }

    private static native void nativePaint(
            Painter reachable,
            long painter,
            int[] glyphs,
            Object[] coverage,
            Bitmap bitmap,
            int x,
            int y,
            int[] touched);

    private static native void nativeLayOver(
            ByteBuffer pixels, int[] place, Bitmap bitmap, int x, int y, int[] touched);
}
