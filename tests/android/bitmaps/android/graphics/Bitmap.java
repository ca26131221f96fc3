package android.graphics;

import java.nio.Buffer;
import java.nio.ByteBuffer;

/**
 * Stands in for Android's bitmap: its public functions that VorelBitmaps calls, and what jnigraphics.cpp
 * tells of it. The pixels of each row lie at its start; the bytes behind them are not to be touched.
 */
public final class Bitmap {
    public enum Config {
        ALPHA_8,
        RGB_565,
        ARGB_8888,
        HARDWARE
    }

    /** Of all bitmaps that are made by createBitmap: bytes between rows. */
    public static int gap = 0;

    public static final int FORMAT_RGBA_8888 = 1;
    public static final int FORMAT_A_8 = 8;

    /** The lowest two of the flags. */
    public static final int PREMULTIPLIED = 0;
    public static final int OPAQUE = 1;
    public static final int STRAIGHT = 2;

    /** What the native functions tell; the tests change it. */
    public int width;
    public int height;
    public int stride;
    public int format;
    public int flags;
    public int infoResult;
    public int lockResult;
    public boolean throwsInLock;
    public boolean isMutable = true;
    public boolean hasPixels = true;
    public int locks;
    public int unlocks;
    public ByteBuffer memory;

    private final Config config;

    public Bitmap(int width, int height, int stride, Config config) {
        this.width = width;
        this.height = height;
        this.stride = stride;
        this.config = config;
        format = config == Config.ALPHA_8 ? FORMAT_A_8 : FORMAT_RGBA_8888;
        memory = ByteBuffer.allocateDirect(stride * height);
    }

    public static Bitmap createBitmap(int width, int height, Config config) {
        return new Bitmap(width, height, width * (config == Config.ALPHA_8 ? 1 : 4) + gap, config);
    }

    public int getWidth() {
        return width;
    }

    public int getHeight() {
        return height;
    }

    public int getRowBytes() {
        return stride;
    }

    public Config getConfig() {
        return config;
    }

    public boolean isMutable() {
        return isMutable;
    }

    public boolean hasAlpha() {
        return alphaFlags() != OPAQUE;
    }

    public boolean isPremultiplied() {
        return alphaFlags() == PREMULTIPLIED;
    }

    private int alphaFlags() {
        return flags & 3;
    }

    public void copyPixelsToBuffer(Buffer buffer) {
        ((ByteBuffer) buffer).put(memory.duplicate().clear());
    }

    public void copyPixelsFromBuffer(Buffer buffer) {
        memory.duplicate().clear().put((ByteBuffer) buffer);
    }
}
