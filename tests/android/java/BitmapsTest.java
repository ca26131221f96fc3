import android.graphics.Bitmap;
import java.util.Arrays;
import java.util.List;
import org.voreleffect.Box;
import org.voreleffect.Glyph;
import org.voreleffect.Look;
import org.voreleffect.Painter;
import org.voreleffect.Picture;
import org.voreleffect.PictureView;
import org.voreleffect.VorelBitmaps;

/** Tests of the painting on bitmaps, with a stand-in for Android's (tests/android/bitmaps). */
public final class BitmapsTest extends Checks {
    private static final int WIDTH = 60;
    private static final int HEIGHT = 40;
    private static final int BAD_PARAMETER = -1;
    private static final int JNI_EXCEPTION = -2;
    private static final int ALLOCATION_FAILED = -3;

    private static final Look LOOK =
            new Look().fill(0x3366CC).outerShadow(135, 3, 2, 0x000000, 0.8f).stroke(2, 0xFFFFFF);
    private static final Glyph BLOCK = new Glyph(8, 7, block(12, 10), 12, 10);
    private static final List<Glyph> GLYPHS = Arrays.asList(BLOCK, BLOCK.at(30, 12));

    public static void main(String[] arguments) throws IllegalAccessException {
        new BitmapsTest().run();
    }

    void testBitmapGetsThePixelsOfAView() {
        for (int gap : new int[] {0, 4, 52}) {
            Bitmap bitmap = page(gap);
            byte[] expected = bytes(bitmap);
            PictureView view = PictureView.of(expected, WIDTH, HEIGHT, bitmap.stride);
            Box box = LOOK.paint(GLYPHS, view, 3, 2);
            check(!Arrays.equals(expected, bytes(bitmap)), "nothing was painted");
            check(VorelBitmaps.paint(LOOK, GLYPHS, bitmap, 3, 2).equals(box), "box");
            check(Arrays.equals(expected, bytes(bitmap)), "pixels, or the bytes between rows");
            unlocked(bitmap, 1);
        }
    }

    void testPainterPaintsTheSameOnEveryBitmap() {
        Painter painter = new Painter(LOOK, LOOK.fill(0xFFFFFF, 0.5f));
        Bitmap first = page(0);
        Bitmap second = page(0);
        VorelBitmaps.paint(painter, GLYPHS, first, 0, 0);
        VorelBitmaps.paint(painter, GLYPHS, second, 0, 0);
        check(Arrays.equals(bytes(first), bytes(second)), "pixels");
        Bitmap none = page(0);
        painter.close();
        misplaced(() -> VorelBitmaps.paint(painter, GLYPHS, none, 0, 0));
        unlocked(none, 0);
    }

    void testPainterThatTheListOfGlyphsClosesIsRefused() {
        Painter painter = new Painter(LOOK);
        Bitmap bitmap = page(0);
        misplaced(() -> VorelBitmaps.paint(painter, closing(painter, BLOCK), bitmap, 0, 0));
        unlocked(bitmap, 0);
    }

    void testPictureIsLaidOverABitmap() {
        Picture picture = LOOK.paint(BLOCK);
        Bitmap painted = page(8);
        Bitmap laid = page(8);
        VorelBitmaps.paint(LOOK, BLOCK, painted, -4, 25);
        VorelBitmaps.layOver(picture, laid, -4, 25);
        check(Arrays.equals(bytes(painted), bytes(laid)), "pixels");
        unlocked(laid, 1);
    }

    void testPictureBecomesABitmap() {
        Picture picture = LOOK.paint(BLOCK);
        for (int gap : new int[] {0, 12}) {
            Bitmap.gap = gap;
            Bitmap bitmap = VorelBitmaps.bitmapOf(picture);
            Bitmap.gap = 0;
            byte[] row = new byte[4 * picture.width()];
            byte[] expected = new byte[row.length];
            for (int y = 0; y < picture.height(); ++y) {
                bitmap.memory.position(y * bitmap.stride);
                bitmap.memory.get(row);
                picture.pixels().position(y * row.length).get(expected);
                check(Arrays.equals(row, expected), "row " + y);
            }
        }
        Bitmap far = VorelBitmaps.bitmapOf(LOOK.paint(BLOCK.at(Integer.MAX_VALUE, Integer.MIN_VALUE + 64)));
        check(Arrays.equals(bytes(far), bytes(VorelBitmaps.bitmapOf(picture))), "of far glyphs");
        refused(() -> VorelBitmaps.bitmapOf(LOOK.paint(Arrays.<Glyph>asList())));
    }

    void testMaskBecomesAGlyph() {
        Bitmap mask = new Bitmap(12, 10, 16, Bitmap.Config.ALPHA_8);
        for (int y = 0; y < 10; ++y) {
            mask.memory.position(16 * y);
            mask.memory.put(block(12, 10), 12 * y, 12);
        }
        mask.memory.clear();
        Glyph glyph = VorelBitmaps.glyphOf(mask, 8, 7);
        check(LOOK.paint(glyph).pixels().equals(LOOK.paint(BLOCK).pixels()), "pixels");
        refused(() -> VorelBitmaps.glyphOf(page(0), 0, 0));
        refused(() -> VorelBitmaps.glyphOf(null, 0, 0));
    }

    void testOpaqueBitmapIsPaintedOn() {
        Bitmap bitmap = page(0);
        bitmap.flags = Bitmap.OPAQUE; // its alpha is not looked at
        check(!VorelBitmaps.paint(LOOK, GLYPHS, bitmap, 0, 0).isEmpty(), "nothing was painted");
    }

    void testBitmapThatCannotBePaintedOnIsRefusedAndLeftAlone() {
        Bitmap otherFormat = page(0);
        otherFormat.format = 4; // RGB_565
        Bitmap straight = page(0);
        straight.flags = Bitmap.STRAIGHT;
        Bitmap immutable = page(0);
        immutable.isMutable = false;
        Bitmap hardware = page(0);
        hardware.flags = 0x80000000;
        Bitmap withoutInfo = page(0);
        withoutInfo.infoResult = BAD_PARAMETER;
        Bitmap narrow = page(0);
        narrow.stride = 4 * WIDTH - 1;
        Bitmap withoutStride = page(0);
        withoutStride.stride = 0;
        Bitmap huge = page(0);
        huge.width = 1 << 30;
        huge.stride = 0xFFFFFFFF;
        Bitmap negative = page(0);
        negative.height = -1;
        Bitmap locked = page(0);
        locked.lockResult = BAD_PARAMETER;
        Bitmap failing = page(0);
        failing.lockResult = JNI_EXCEPTION;
        for (Bitmap bitmap :
                Arrays.asList(otherFormat, straight, immutable, hardware, withoutInfo, narrow, withoutStride, huge,
                        negative, locked, failing)) {
            refused(() -> VorelBitmaps.paint(LOOK, GLYPHS, bitmap, 0, 0));
            refused(() -> VorelBitmaps.layOver(LOOK.paint(BLOCK), bitmap, 0, 0));
            check(Arrays.equals(bytes(bitmap), bytes(page(0))), "something was painted");
            unlocked(bitmap, 0);
        }
    }

    void testLockWithoutPixelsIsRefusedAndUndone() {
        Bitmap bitmap = page(0);
        bitmap.hasPixels = false;
        refused(() -> VorelBitmaps.paint(LOOK, GLYPHS, bitmap, 0, 0));
        unlocked(bitmap, 1);
    }

    void testWhatTheLockThrowsIsPassedOn() {
        Bitmap bitmap = page(0);
        bitmap.throwsInLock = true;
        bitmap.lockResult = JNI_EXCEPTION;
        misplaced(() -> VorelBitmaps.paint(LOOK, GLYPHS, bitmap, 0, 0));
        bitmap.throwsInLock = false;
        bitmap.lockResult = ALLOCATION_FAILED;
        expect(OutOfMemoryError.class, () -> VorelBitmaps.paint(LOOK, GLYPHS, bitmap, 0, 0));
        unlocked(bitmap, 0);
    }

    /** refusing_calloc.cpp refuses masks of 211 x 199 pixels. */
    void testBitmapIsUnlockedWhateverHappens() {
        Bitmap bitmap = page(0);
        Glyph large = new Glyph(0, 0, block(211, 199), 211, 199);
        Look plain = new Look();
        expect(OutOfMemoryError.class, () -> VorelBitmaps.paint(plain, large, bitmap, 0, 0));
        List<Glyph> apart =
                Arrays.asList(BLOCK.at(Integer.MIN_VALUE, 0), BLOCK.at(Integer.MAX_VALUE, 0));
        refused(() -> VorelBitmaps.paint(plain, apart, bitmap, 0, 0));
        unlocked(bitmap, 2);
        check(Arrays.equals(bytes(bitmap), bytes(page(0))), "something was painted");
    }

    void testNullIsRefused() {
        Bitmap bitmap = page(0);
        refused(() -> VorelBitmaps.paint((Painter) null, GLYPHS, bitmap, 0, 0));
        refused(() -> VorelBitmaps.paint((Look) null, GLYPHS, bitmap, 0, 0));
        refused(() -> VorelBitmaps.paint(LOOK, (List<Glyph>) null, bitmap, 0, 0));
        refused(() -> VorelBitmaps.paint(LOOK, (Glyph) null, bitmap, 0, 0));
        refused(() -> VorelBitmaps.paint(LOOK, GLYPHS, null, 0, 0));
        refused(() -> VorelBitmaps.paint(LOOK, GLYPHS, bitmap, Integer.MAX_VALUE, 0));
        refused(() -> VorelBitmaps.layOver(null, bitmap, 0, 0));
        refused(() -> VorelBitmaps.layOver(LOOK.paint(BLOCK), null, 0, 0));
        refused(() -> VorelBitmaps.bitmapOf(null));
    }

    private static void unlocked(Bitmap bitmap, int times) {
        check(bitmap.locks == times && bitmap.unlocks == times,
                bitmap.locks + " locks, " + bitmap.unlocks + " unlocks");
    }

    /** Opaque pixels of many colours, and as many bytes between rows. */
    private static Bitmap page(int gap) {
        Bitmap bitmap = new Bitmap(WIDTH, HEIGHT, 4 * WIDTH + gap, Bitmap.Config.ARGB_8888);
        for (int i = 0; i < bitmap.memory.capacity(); ++i) {
            bitmap.memory.put(i, (byte) (i % bitmap.stride % 4 == 3 ? 255 : i * 7));
        }
        return bitmap;
    }

    private static byte[] bytes(Bitmap bitmap) {
        byte[] bytes = new byte[bitmap.memory.capacity()];
        for (int i = 0; i < bytes.length; ++i) bytes[i] = bitmap.memory.get(i);
        return bytes;
    }

    private static byte[] block(int width, int height) {
        byte[] coverage = new byte[width * height];
        for (int i = 0; i < coverage.length; ++i) coverage[i] = (byte) (i % width == 0 ? 128 : 255);
        return coverage;
    }
}
