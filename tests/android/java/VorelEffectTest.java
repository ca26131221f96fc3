import java.io.IOException;
import java.lang.ref.WeakReference;
import java.lang.reflect.Field;
import java.lang.reflect.InvocationTargetException;
import java.lang.reflect.Method;
import java.lang.reflect.Modifier;
import java.nio.ByteBuffer;
import java.nio.ByteOrder;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.Paths;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.LinkedHashMap;
import java.util.List;
import java.util.Map;
import java.util.concurrent.atomic.AtomicBoolean;
import java.util.concurrent.atomic.AtomicReference;
import java.util.function.Consumer;
import org.voreleffect.Stops;
import org.voreleffect.VorelEffect;

/**
 * Tests of the Java facade: the same margins, keys and pixels as C++ (paint_runs.cpp wrote them), and
 * what is refused.
 */
public final class VorelEffectTest extends Checks {
    private static final int WIDTH = 67;
    private static final int HEIGHT = 49;
    private static final int TEXT_COLOR = 0x3366CC;

    private static final int[] COLORS = {0xFF0000, 0x00FF80, 0x0000FF};
    private static final float[] OPACITIES = {1, 0.75f, 0.5f};
    private static final float[] LOCATIONS = {0, 0.4f, 1};
    private static final int[] PATTERN = {
        0xFFFF0000, 0x8000FF00, 0x400000FF, 0x12345678, 0xFFFFFFFF, 0xC0804020
    };

    private static final ByteBuffer RING = ring(31, 29);
    private static final ByteBuffer BAR = bar(11, 25);

    private final Path painted;

    private VorelEffectTest(Path painted) {
        this.painted = painted;
    }

    public static void main(String[] arguments) throws IllegalAccessException {
        new VorelEffectTest(Paths.get(arguments[0])).run();
    }

    // --- The same as C++ ------------------------------------------------------------------------

    private static Map<String, Consumer<VorelEffect>> looks() {
        Map<String, Consumer<VorelEffect>> looks = new LinkedHashMap<>();
        looks.put("plain", look -> {});
        looks.put("outer_shadow", look -> look.addOuterShadowText(120.5f, 5, 4, 0x102030, 0.7f));
        looks.put("inner_shadow", look -> look.addInnerShadowText(-30.7f, 3, 2, 0xFFEEDD, 0.6f));
        looks.put("outer_glow", look -> look.addOuterGlowText(6, 0xFFD700, 0.8f));
        looks.put(
                "outer_glow_stops",
                look -> look.addOuterGlowText(7, 0x123456, 0.9f, COLORS, OPACITIES, LOCATIONS));
        looks.put("inner_glow", look -> look.addInnerGlowText(4, 0x00FFFF, 0.5f));
        looks.put(
                "inner_glow_stops",
                look -> look.addInnerGlowText(5, 0x654321, 1, COLORS, OPACITIES, LOCATIONS));
        looks.put(
                "linear",
                look -> look.addLinearGradientText(60, 0.8f, 0.9f, COLORS, OPACITIES, LOCATIONS));
        looks.put(
                "radial",
                look ->
                        look.addRadialGradientText(
                                1.2f,
                                0.8f,
                                Arrays.copyOf(COLORS, 2),
                                Arrays.copyOf(OPACITIES, 2),
                                Arrays.copyOf(LOCATIONS, 2)));
        looks.put(
                "stroke_centre",
                look -> look.addStrokeText(3, 0xFFFFFF, 1, 7, VorelEffect.STROKE_CENTRE));
        looks.put(
                "stroke_outside",
                look -> look.addStrokeText(4, 0x00AA00, 0.9f, 0, VorelEffect.STROKE_OUTSIDE));
        looks.put(
                "stroke_inside",
                look -> look.addStrokeText(2, 0xAA0000, 0.4f, 0, VorelEffect.STROKE_INSIDE));
        looks.put("pattern", look -> look.addPatternText(PATTERN, 3, 2, 1.5f, 0.9f));
        looks.put("translucent", VorelEffectTest::describeTranslucent);
        looks.put("everything", VorelEffectTest::describeEverything);
        return looks;
    }

    private static void describeTranslucent(VorelEffect look) {
        look.setTextOpacity(0.4f);
        look.addOuterShadowText(315, 6, 3, 0x000000, 0.8f);
        look.addStrokeText(2, 0xFF8800, 1, 0, VorelEffect.STROKE_OUTSIDE);
    }

    private static void describeEverything(VorelEffect look) {
        look.addOuterShadowText(45, 4, 6, 0x202020, 0.5f);
        look.addOuterGlowText(5, 0xFFFF00, 0.5f);
        look.addStrokeText(2, 0x000080, 1, 0, VorelEffect.STROKE_OUTSIDE);
        look.addLinearGradientText(90, 1, 1, COLORS, OPACITIES, LOCATIONS);
        look.addInnerGlowText(3, 0xFFFFFF, 0.7f);
        look.addInnerShadowText(270, 2, 2, 0x400040, 0.9f);
    }

    void testEveryLookHasTheMarginsKeyAndPixelsOfCpp() throws IOException {
        Map<String, Consumer<VorelEffect>> looks = looks();
        for (Map.Entry<String, Consumer<VorelEffect>> entry : looks.entrySet()) {
            byte[] expected = Files.readAllBytes(painted.resolve(entry.getKey()));
            byte[] actual = paint(entry.getValue());
            check(Arrays.equals(expected, actual), entry.getKey() + " differs from C++");
        }
        check(painted.toFile().list().length == looks.size(), "C++ paints as many looks");
    }

    /** What paint_runs writes of a look. */
    private static byte[] paint(Consumer<VorelEffect> describe) {
        try (VorelEffect look = new VorelEffect()) {
            describe.accept(look);
            byte[] key = look.getMapKey(TEXT_COLOR);
            int bytes = WIDTH * HEIGHT * 4;
            ByteBuffer said = ByteBuffer.allocate(5 * 4 + key.length + 2 * bytes);
            said.order(ByteOrder.LITTLE_ENDIAN);
            said.putInt(look.getLeftOffset()).putInt(look.getTopOffset());
            said.putInt(look.getRightOffset()).putInt(look.getBottomOffset());
            said.putInt(key.length).put(key);
            ByteBuffer picture = picture();
            for (int run = 0; run < 2; ++run) {
                paintRun(look, picture);
                said.put(picture.duplicate());
            }
            return said.array();
        }
    }

    // --- Buffers --------------------------------------------------------------------------------

    void testRunUsesTheBytesFromThePositionsOnAndMovesNoPosition() {
        ByteBuffer wide = ByteBuffer.allocateDirect(5 + WIDTH * HEIGHT * 4 + 7);
        for (int i = 0; i < wide.capacity(); ++i) wide.put(i, (byte) (i < 5 ? 0x55 : 0));
        for (int i = wide.capacity() - 7; i < wide.capacity(); ++i) wide.put(i, (byte) 0x55);
        wide.position(5).limit(wide.capacity() - 7);

        ByteBuffer atlas = ByteBuffer.allocateDirect(3 + RING.capacity() + BAR.capacity());
        atlas.position(3);
        atlas.put(RING.duplicate()).put(BAR.duplicate());
        ByteBuffer ring = atlas.duplicate();
        ring.position(3).limit(3 + RING.capacity());
        ring = ring.slice();
        ByteBuffer bar = atlas.duplicate();
        bar.position(3 + RING.capacity());

        try (VorelEffect look = everything()) {
            look.begin(WIDTH, HEIGHT, wide);
            look.glyph(8, 9, ring, 31, 29);
            look.glyph(33, 11, bar, 11, 25);
            look.glyph(60, -3, bar, 11, 25);
            look.finish();
        }
        check(wide.position() == 5, "position of the destination");
        check(bar.position() == 3 + RING.capacity(), "position of the coverage");
        check(wide.slice().equals(everythingPainted()), "pixels");
        for (int i = 0; i < 5; ++i) check(wide.get(i) == 0x55, "byte before the destination");
        wide.clear();
        for (int i = wide.capacity() - 7; i < wide.capacity(); ++i) {
            check(wide.get(i) == 0x55, "byte after the destination");
        }
    }

    void testDestinationStaysReachableWhileTheRunIsOpen() {
        try (VorelEffect look = new VorelEffect()) {
            WeakReference<ByteBuffer> destination = beginAndForget(look);
            for (int i = 0; i < 3; ++i) System.gc();
            check(destination.get() != null, "collected within the run");
            look.finish();
            for (int i = 0; i < 100 && destination.get() != null; ++i) System.gc();
            check(destination.get() == null, "kept after the run");
        }
    }

    private static WeakReference<ByteBuffer> beginAndForget(VorelEffect look) {
        ByteBuffer destination = picture();
        look.begin(WIDTH, HEIGHT, destination);
        return new WeakReference<>(destination);
    }

    void testEmptyGlyphsNeedNoBytes() {
        try (VorelEffect look = new VorelEffect()) {
            look.begin(WIDTH, HEIGHT, picture());
            look.glyph(0, 0, ByteBuffer.allocateDirect(0), 0, 0);
            look.glyph(0, 0, ByteBuffer.allocateDirect(0), 0xFFFF, 0);
            look.finish();
        }
    }

    void testDestinationThatDoesNotFitIsRefused() {
        try (VorelEffect look = everything()) {
            int bytes = WIDTH * HEIGHT * 4;
            refused(() -> look.begin(WIDTH, HEIGHT, null));
            refused(() -> look.begin(WIDTH, HEIGHT, ByteBuffer.allocate(bytes)));
            refused(() -> look.begin(WIDTH, HEIGHT, ByteBuffer.allocateDirect(bytes - 1)));
            ByteBuffer moved = picture();
            moved.position(1);
            refused(() -> look.begin(WIDTH, HEIGHT, moved));
            ByteBuffer limited = picture();
            limited.limit(bytes - 1);
            refused(() -> look.begin(WIDTH, HEIGHT, limited));
            refused(() -> look.begin(WIDTH, HEIGHT, picture().asReadOnlyBuffer()));
            refused(() -> look.begin(0, HEIGHT, picture()));
            refused(() -> look.begin(WIDTH, 0, picture()));
            refused(() -> look.begin(-WIDTH, -HEIGHT, picture()));
            refused(() -> look.begin(1 << 16, 1 << 16, picture()));
            refused(() -> look.begin(1 << 30, 1 << 30, picture()));
            refused(() -> look.begin(Integer.MAX_VALUE, Integer.MAX_VALUE, picture()));
            misplaced(look::finish);
        }
    }

    void testGlyphThatDoesNotFitIsRefusedAndTheRunGoesOn() {
        ByteBuffer picture = picture();
        try (VorelEffect look = everything()) {
            look.begin(WIDTH, HEIGHT, picture);
            refused(() -> look.glyph(0, 0, null, 1, 1));
            refused(() -> look.glyph(0, 0, ByteBuffer.allocate(100), 10, 10));
            refused(() -> look.glyph(0, 0, ByteBuffer.allocateDirect(99), 10, 10));
            ByteBuffer moved = ByteBuffer.allocateDirect(100);
            moved.position(1);
            refused(() -> look.glyph(0, 0, moved, 10, 10));
            refused(() -> look.glyph(0, 0, RING, -1, 1));
            refused(() -> look.glyph(0, 0, RING, 1, -1));
            refused(() -> look.glyph(0, 0, RING, 1 << 16, 0));
            refused(() -> look.glyph(0, 0, RING, 0, 1 << 16));
            refused(() -> look.glyph(0, 0, RING, 0xFFFF, 0xFFFF));
            glyphs(look);
            look.finish();
        }
        check(picture.equals(everythingPainted()), "pixels");
    }

    /**
     * Calls for a while, as another thread moves the position and the limit of the buffer: a call may refuse
     * it, and must go through now and then.
     */
    private static void callWhileMoved(ByteBuffer buffer, Runnable call) throws InterruptedException {
        AtomicBoolean ended = new AtomicBoolean();
        Thread mover =
                new Thread(
                        () -> {
                            while (!ended.get()) {
                                buffer.position(buffer.capacity() - 1);
                                buffer.limit(buffer.capacity() - 1);
                                buffer.clear();
                            }
                        });
        mover.start();
        int done = 0;
        int refused = 0;
        long start = System.nanoTime();
        long spent = 0;
        // A machine under load lets the other thread run late.
        while (spent < 700_000_000 || (done == 0 || refused == 0) && spent < 30_000_000_000L) {
            try {
                call.run();
                ++done;
            } catch (IllegalArgumentException e) {
                ++refused;
            }
            spent = System.nanoTime() - start;
        }
        ended.set(true);
        mover.join();
        check(done > 0 && refused > 0, done + " calls went through, " + refused + " were refused");
    }

    void testDestinationWhosePositionAnotherThreadMovesIsPaintedInsideAlone()
            throws InterruptedException {
        int bytes = WIDTH * HEIGHT * 4;
        ByteBuffer whole = ByteBuffer.allocateDirect(2 * bytes);
        whole.limit(bytes);
        ByteBuffer destination = whole.slice();
        whole.clear();
        ByteBuffer picture = picture();
        try (VorelEffect look = everything()) {
            callWhileMoved(destination, () -> paintRun(look, destination));
            paintRun(look, picture);
        }
        for (int i = bytes; i < whole.capacity(); ++i) {
            check(whole.get(i) == 0, "byte " + (i - bytes) + " after the destination");
        }
        check(picture.equals(everythingPainted()), "the next run");
    }

    void testCoverageWhosePositionAnotherThreadMovesIsReadInsideAlone() throws InterruptedException {
        int bytes = 31 * 29;
        ByteBuffer whole = ByteBuffer.allocateDirect(2 * bytes);
        for (int i = bytes; i < whole.capacity(); ++i) whole.put(i, (byte) 255);
        whole.limit(bytes);
        ByteBuffer nothing = whole.slice();
        ByteBuffer picture = picture();
        try (VorelEffect look = everything()) {
            look.begin(WIDTH, HEIGHT, picture);
            callWhileMoved(nothing, () -> look.glyph(8, 9, nothing, 31, 29));
            look.finish();
        }
        check(picture.equals(picture()), "the bytes after the coverage were read");
    }

    void testPositionMovedWithinTheRunMovesNothing() {
        ByteBuffer picture = picture();
        try (VorelEffect look = everything()) {
            look.begin(WIDTH, HEIGHT, picture);
            picture.position(picture.capacity()).limit(picture.capacity());
            glyphs(look);
            look.finish();
        }
        check(picture.clear().equals(everythingPainted()), "pixels");
    }

    /** What the checks of the Java side let through by a mistake must end on the native side. */
    void testNativeSideRefusesWhatLiesOutsideTheCapacity() {
        ByteBuffer picture = picture();
        try (VorelEffect look = everything()) {
            look.begin(WIDTH, HEIGHT, picture);
            for (int start : new int[] {1, RING.capacity(), Integer.MAX_VALUE, -1}) {
                refused(() -> call(look, "nativeGlyph", 0, 0, RING, start, 31, 29));
                refused(() -> call(look, "nativeFinish", picture, start));
            }
            refused(() -> call(look, "nativeGlyph", 0, 0, RING, 0, 0xFFFF, 0xFFFF));
            refused(() -> call(look, "nativeGlyph", 0, 0, ByteBuffer.allocate(900), 0, 31, 29));
            refused(() -> call(look, "nativeFinish", ByteBuffer.allocateDirect(99), 0));
            check(picture.equals(picture()), "something was painted");
            glyphs(look);
            look.finish();
        }
        check(picture.equals(everythingPainted()), "pixels");
    }

    // --- Objects that are never closed ----------------------------------------------------------

    void testObjectsThatWereNeverClosedAreFreed() throws Exception {
        int[] pixels = new int[128 * 64];
        Arrays.fill(pixels, 0x80402010);
        long before = residentKb();
        long most = 0;
        for (int i = 1; i <= 10_000; ++i) {
            new VorelEffect().addPatternText(pixels, 128, 64, 1, 1);
            if (i % 500 == 0) {
                collect();
                most = Math.max(most, residentKb() - before);
            }
        }
        check(most < 160_000, "10,000 looks of 32 kB that were never closed hold " + most + " kB");
    }

    void testObjectIsNotFreedWhileItsLastCallRuns() throws InterruptedException {
        ByteBuffer expected = everythingPainted();
        byte[] key = everything().getMapKey();
        AtomicBoolean ended = new AtomicBoolean();
        Thread collector =
                new Thread(
                        () -> {
                            while (!ended.get()) {
                                System.gc();
                                new VorelEffect().close(); // frees what the collector found
                                Thread.yield();
                            }
                        });
        collector.start();
        try {
            for (long end = System.nanoTime() + 700_000_000; System.nanoTime() < end; ) {
                ByteBuffer picture = picture();
                paintRun(everything(), picture);
                check(picture.equals(expected), "pixels");
                check(Arrays.equals(everything().getMapKey(), key), "key");
            }
        } finally {
            ended.set(true);
            collector.join();
        }
    }

    // --- Memory that is refused -------------------------------------------------------------------

    /** refusing_calloc.cpp refuses the mask of a layer of the first size, the outer layer of the second. */
    void testLayersThatGetNoMemoryAreReportedAndNothingIsPainted() {
        for (int[] size : new int[][] {{211, 199}, {197, 223}}) {
            ByteBuffer picture = ByteBuffer.allocateDirect(size[0] * size[1] * 4);
            try (VorelEffect look = new VorelEffect()) {
                describeTranslucent(look);
                look.getMapKey(TEXT_COLOR);
                expect(OutOfMemoryError.class, () -> look.begin(size[0], size[1], picture));
                misplaced(look::finish);
                check(picture.equals(ByteBuffer.allocateDirect(picture.capacity())), "painted");
                // The order of effects is that of a second run, as after a run that was given up.
                ByteBuffer next = picture();
                paintRun(look, next);
                ByteBuffer again = picture();
                try (VorelEffect other = new VorelEffect()) {
                    describeTranslucent(other);
                    other.getMapKey(TEXT_COLOR);
                    paintRun(other, again);
                }
                check(next.equals(again), "the next run");
            }
        }
    }

    /** refusing_calloc.cpp refuses the next list of effects after a pattern of 1009 pixels. */
    void testListOfEffectsThatCannotBeMadeIsReported() {
        for (boolean withKey : new boolean[] {false, true}) {
            try (VorelEffect other = everything();
                    VorelEffect look = new VorelEffect()) {
                byte[] key = look.getMapKey();
                other.addPatternText(new int[1009], 1009, 1, 1, 1);
                expect(
                        OutOfMemoryError.class,
                        () -> {
                            if (withKey) look.getMapKey(TEXT_COLOR);
                            else look.addText(TEXT_COLOR, 1);
                        });
                check(Arrays.equals(key, look.getMapKey()), "the key has changed");
                check(look.addText(TEXT_COLOR, 1) >= 0, "not added the second time");
            }
        }
    }

    void testRunWithoutAnOuterLayerNeedsNoMemoryForIt() {
        ByteBuffer picture = ByteBuffer.allocateDirect(197 * 223 * 4);
        try (VorelEffect look = everything()) {
            look.begin(197, 223, picture);
            glyphs(look);
            look.finish();
        }
        check(!picture.equals(ByteBuffer.allocateDirect(picture.capacity())), "nothing painted");
    }

    // --- Arrays ---------------------------------------------------------------------------------

    void testStopsThatDoNotFitAreRefused() {
        float[] two = {0, 1};
        try (VorelEffect look = new VorelEffect()) {
            refused(() -> look.addOuterGlowText(1, 0, 1, null, OPACITIES, LOCATIONS));
            refused(() -> look.addOuterGlowText(1, 0, 1, COLORS, two, LOCATIONS));
            refused(() -> look.addInnerGlowText(1, 0, 1, COLORS, null, LOCATIONS));
            refused(() -> look.addInnerGlowText(1, 0, 1, COLORS, OPACITIES, two));
            refused(() -> look.addLinearGradientText(0, 1, 1, COLORS, OPACITIES, null));
            refused(() -> look.addLinearGradientText(0, 1, 1, COLORS, OPACITIES, two));
            refused(
                    () ->
                            look.addLinearGradientText(
                                    0, 1, 1, new int[0], new float[0], new float[0]));
            refused(() -> look.addRadialGradientText(1, 1, COLORS, two, LOCATIONS));
            refused(
                    () -> look.addRadialGradientText(1, 1, new int[0], new float[0], new float[0]));
            check(look.getMapKey().length == 0, "an effect was added");
        }
    }

    void testStopsAfterThe256thAreLeftOut() {
        int[] colors = new int[300];
        float[] opacities = new float[300];
        float[] locations = new float[300];
        for (int i = 0; i < 300; ++i) {
            colors[i] = i * 0x010305;
            opacities[i] = 1;
            locations[i] = i / 300f;
        }
        try (VorelEffect all = new VorelEffect();
                VorelEffect first = new VorelEffect()) {
            all.addLinearGradientText(0, 1, 1, colors, opacities, locations);
            first.addLinearGradientText(
                    0,
                    1,
                    1,
                    Arrays.copyOf(colors, 256),
                    Arrays.copyOf(opacities, 256),
                    Arrays.copyOf(locations, 256));
            check(Arrays.equals(all.getMapKey(), first.getMapKey()), "keys");
        }
    }

    void testStopsGiveWhatTheirThreeArraysGive() {
        Stops stops = Stops.of(COLORS, OPACITIES, LOCATIONS);
        try (VorelEffect one = new VorelEffect();
                VorelEffect three = new VorelEffect()) {
            one.addOuterGlowText(5, 0.5f, stops);
            three.addOuterGlowText(5, 0, 0.5f, COLORS, OPACITIES, LOCATIONS);
            one.addInnerGlowText(4, 1, stops);
            three.addInnerGlowText(4, 0, 1, COLORS, OPACITIES, LOCATIONS);
            one.addLinearGradientText(30, 1, 0.7f, stops);
            three.addLinearGradientText(30, 1, 0.7f, COLORS, OPACITIES, LOCATIONS);
            one.addRadialGradientText(0.5f, 0.9f, stops);
            three.addRadialGradientText(0.5f, 0.9f, COLORS, OPACITIES, LOCATIONS);
            check(Arrays.equals(one.getMapKey(), three.getMapKey()), "keys");
            refused(() -> one.addOuterGlowText(5, 0.5f, null));
            refused(() -> one.addInnerGlowText(5, 0.5f, null));
            refused(() -> one.addLinearGradientText(5, 0.5f, 1, null));
            refused(() -> one.addRadialGradientText(5, 0.5f, null));
        }
    }

    // --- Copies ---------------------------------------------------------------------------------

    void testCopiesOfALookThatWasNeverRunPaintWhatItWouldPaint() {
        ByteBuffer expected = everythingPainted();
        try (VorelEffect original = everything()) {
            for (int run = 0; run < 3; ++run) {
                try (VorelEffect copy = original.copy()) {
                    copy.getMapKey(TEXT_COLOR); // an add-call, which would turn a second run around
                    ByteBuffer picture = picture();
                    paintRun(copy, picture);
                    check(picture.equals(expected), "run " + run);
                }
            }
        }
    }

    void testCopyIsIndependent() {
        VorelEffect original = everything();
        byte[] key = original.getMapKey();
        original.setTextOpacity(0.5f);
        try (VorelEffect copy = original.copy()) {
            check(Arrays.equals(key, copy.getMapKey()), "key");
            check(copy.getTextOpacity() == 0.5f, "text opacity");
            copy.addStrokeText(9, 0x123456, 1, 0, VorelEffect.STROKE_OUTSIDE);
            copy.setTextOpacity(0.25f);
            check(Arrays.equals(key, original.getMapKey()), "the original has changed");
            check(original.getTextOpacity() == 0.5f, "the original's text opacity has changed");
            original.close();
            check(copy.getRightOffset() == 9, "margin of the copy, the original closed");
        }
    }

    void testCopyHasNoRun() {
        try (VorelEffect original = everything()) {
            original.begin(WIDTH, HEIGHT, picture());
            try (VorelEffect copy = original.copy()) {
                misplaced(copy::finish);
            }
            glyphs(original);
            original.finish();
        }
    }

    void testGlowWithoutStopsIsThatOfOneColor() {
        try (VorelEffect empty = new VorelEffect();
                VorelEffect plain = new VorelEffect()) {
            empty.addOuterGlowText(5, 0x808080, 1, new int[0], new float[0], new float[0]);
            plain.addOuterGlowText(5, 0x808080, 1);
            check(Arrays.equals(empty.getMapKey(), plain.getMapKey()), "keys");
        }
    }

    void testPatternThatDoesNotFitIsRefused() {
        try (VorelEffect look = new VorelEffect()) {
            refused(() -> look.addPatternText(null, 1, 1, 1, 1));
            refused(() -> look.addPatternText(PATTERN, 7, 1, 1, 1));
            refused(() -> look.addPatternText(PATTERN, 0, 1, 1, 1));
            refused(() -> look.addPatternText(PATTERN, 1, 0, 1, 1));
            refused(() -> look.addPatternText(PATTERN, -3, -2, 1, 1));
            refused(() -> look.addPatternText(PATTERN, 1 << 15, 1 << 15, 1, 1));
            refused(() -> look.addPatternText(PATTERN, 1 << 16, 1 << 16, 1, 1));
            check(look.addText(0, 1) == 0, "an effect was added");
        }
    }

    // --- Order of calls -------------------------------------------------------------------------

    void testClosedObjectRefusesEveryCall() throws IllegalAccessException {
        VorelEffect look = new VorelEffect();
        look.begin(WIDTH, HEIGHT, picture());
        look.close();
        int called = 0;
        for (Method method : calls()) {
            check(thrownBy(look, method) instanceof IllegalStateException, method + " on a closed");
            ++called;
        }
        check(called >= 25, "methods called: " + called);
        look.close();
    }

    void testLookDoesNotChangeWithinARun() throws IllegalAccessException {
        try (VorelEffect look = everything()) {
            ByteBuffer picture = picture();
            look.begin(WIDTH, HEIGHT, picture);
            int called = 0;
            for (Method method : calls()) {
                String name = method.getName();
                boolean takesColor = method.getParameterCount() == 1;
                if (name.startsWith("add")
                        || name.equals("removeEffect")
                        || name.equals("cleanAllEffect")
                        || name.equals("setTextOpacity")
                        || name.equals("getMapKey") && takesColor) {
                    check(thrownBy(look, method) instanceof IllegalStateException, name);
                    ++called;
                }
            }
            check(called == 21, "methods called: " + called);
            glyphs(look);
            look.finish();
            check(picture.equals(everythingPainted()), "pixels");
        }
    }

    void testGlyphAndFinishNeedAnOpenRun() {
        try (VorelEffect look = new VorelEffect()) {
            misplaced(() -> look.glyph(0, 0, BAR, 11, 25));
            misplaced(look::finish);
            look.begin(WIDTH, HEIGHT, picture());
            look.finish();
            misplaced(() -> look.glyph(0, 0, BAR, 11, 25));
            misplaced(look::finish);
        }
    }

    void testRunThatIsBegunAnewForgetsTheFormerOne() {
        ByteBuffer dropped = picture();
        ByteBuffer picture = picture();
        try (VorelEffect look = everything()) {
            look.begin(WIDTH, HEIGHT, dropped);
            look.glyph(0, 40, RING, 31, 29); // would stretch the gradient
            look.begin(WIDTH, HEIGHT, picture);
            glyphs(look);
            look.finish();
        }
        check(dropped.equals(picture()), "the dropped run was painted");
        check(picture.equals(everythingPainted()), "the dropped run left a trace");
    }

    void testClosingFromAnotherThreadEndsInARefusal() throws InterruptedException {
        for (int round = 0; round < 50; ++round) {
            VorelEffect look = everything();
            AtomicReference<Throwable> thrown = new AtomicReference<>();
            Thread painter =
                    new Thread(
                            () -> {
                                try {
                                    while (true) paintRun(look, picture());
                                } catch (Throwable e) {
                                    thrown.set(e);
                                }
                            });
            painter.start();
            Thread.sleep(round % 5);
            look.close();
            painter.join();
            check(thrown.get() instanceof IllegalStateException, "thrown: " + thrown.get());
        }
    }

    // --- The registry ---------------------------------------------------------------------------

    void testIdsCountUpAndEffectsGo() {
        try (VorelEffect look = new VorelEffect()) {
            check(look.addStrokeText(4, 0, 1, 0, VorelEffect.STROKE_OUTSIDE) == 0, "first id");
            check(look.addText(0, 1) == 1, "second id");
            check(look.addStrokeText(8, 0, 1, 0, VorelEffect.STROKE_OUTSIDE) == 0, "updated id");
            check(look.getLeftOffset() > 0, "margin of the stroke");
            check(look.removeEffect(0), "removed");
            check(!look.removeEffect(0), "removed twice");
            check(look.getLeftOffset() == 0, "margin without the stroke");
            look.cleanAllEffect();
            check(look.getMapKey().length == 0, "key of no effects");
            check(look.addText(0, 1) == 0, "ids start anew");
        }
    }

    @SuppressWarnings("deprecation")
    void testBevelAndEmbossAddNothing() {
        try (VorelEffect look = new VorelEffect()) {
            int bevel = look.addBevelText(0, 5, 1, 0, 0, 2, 1, 120, 30, 0xFFFFFF, 1, 0, 1);
            int emboss = look.addEmbossText(0, 5, 1, 0, 0, 2, 1, 120, 30, 0xFFFFFF, 1, 0, 1);
            check(bevel == VorelEffect.NO_EFFECT && emboss == VorelEffect.NO_EFFECT, "ids");
            check(look.getMapKey().length == 0, "key");
        }
    }

    void testTextOpacityIsClamped() {
        try (VorelEffect look = new VorelEffect()) {
            check(look.getTextOpacity() == 1, "at the start");
            look.setTextOpacity(0.25f);
            check(look.getTextOpacity() == 0.25f, "set");
            look.setTextOpacity(7);
            check(look.getTextOpacity() == 1, "above");
            look.setTextOpacity(Float.NaN);
            check(look.getTextOpacity() == 0, "NaN");
        }
    }

    void testKeyTellsLooksApartAndHoldsNoZeroByte() {
        try (VorelEffect look = everything();
                VorelEffect same = everything();
                VorelEffect other = everything()) {
            other.addStrokeText(3, 0x000080, 1, 0, VorelEffect.STROKE_OUTSIDE);
            byte[] key = look.getMapKey();
            check(Arrays.equals(key, same.getMapKey()), "equal looks");
            check(!Arrays.equals(key, other.getMapKey()), "different looks");
            for (byte b : key) check(b != 0, "zero byte");
        }
    }

    // --- Support --------------------------------------------------------------------------------

    private static ByteBuffer ring(int width, int height) {
        ByteBuffer coverage = ByteBuffer.allocateDirect(width * height);
        for (int y = 0; y < height; ++y) {
            for (int x = 0; x < width; ++x) {
                int fromCentre = (x - 15) * (x - 15) + (y - 14) * (y - 14);
                coverage.put((byte) Math.max(255 - Math.abs(fromCentre - 120) * 3, 0));
            }
        }
        coverage.rewind();
        return coverage;
    }

    private static ByteBuffer bar(int width, int height) {
        ByteBuffer coverage = ByteBuffer.allocateDirect(width * height);
        for (int i = 0; i < width * height; ++i) {
            coverage.put((byte) (i % width == 0 || i % width == width - 1 ? 128 : 255));
        }
        coverage.rewind();
        return coverage;
    }

    private static ByteBuffer picture() {
        return ByteBuffer.allocateDirect(WIDTH * HEIGHT * 4);
    }

    private static void glyphs(VorelEffect look) {
        look.glyph(8, 9, RING, 31, 29);
        look.glyph(33, 11, BAR, 11, 25);
        look.glyph(60, -3, BAR, 11, 25);
    }

    private static void paintRun(VorelEffect look, ByteBuffer picture) {
        look.begin(WIDTH, HEIGHT, picture);
        glyphs(look);
        look.finish();
    }

    private static VorelEffect everything() {
        VorelEffect look = new VorelEffect();
        describeEverything(look);
        look.getMapKey(TEXT_COLOR);
        return look;
    }

    /** The pixels of the run that C++ painted as well. */
    private static ByteBuffer everythingPainted() {
        ByteBuffer picture = picture();
        try (VorelEffect look = everything()) {
            paintRun(look, picture);
        }
        return picture;
    }

    /** Every public method of an object but close. */
    private static List<Method> calls() {
        List<Method> calls = new ArrayList<>();
        for (Method method : VorelEffect.class.getDeclaredMethods()) {
            int modifiers = method.getModifiers();
            boolean call = Modifier.isPublic(modifiers) && !Modifier.isStatic(modifiers);
            if (call && !method.getName().equals("close")) calls.add(method);
        }
        return calls;
    }

    /** What a call with zeros and nulls throws; null if nothing. */
    private static Throwable thrownBy(VorelEffect look, Method method) throws IllegalAccessException {
        Object[] arguments = new Object[method.getParameterCount()];
        for (int i = 0; i < arguments.length; ++i) {
            Class<?> type = method.getParameterTypes()[i];
            if (type == int.class) arguments[i] = 0;
            if (type == float.class) arguments[i] = 0f;
        }
        try {
            method.invoke(look, arguments);
            return null;
        } catch (InvocationTargetException e) {
            return e.getCause();
        }
    }

    /** Calls a private native method of the object, past the checks of the Java side. */
    private static void call(VorelEffect look, String name, Object... arguments) {
        try {
            Field painter = VorelEffect.class.getDeclaredField("painter");
            painter.setAccessible(true);
            Field address = painter.getType().getDeclaredField("address");
            address.setAccessible(true);
            List<Object> all = new ArrayList<>(Arrays.asList(arguments));
            all.add(0, address.get(painter.get(look)));
            for (Method method : VorelEffect.class.getDeclaredMethods()) {
                if (!method.getName().equals(name)) continue;
                method.setAccessible(true);
                method.invoke(look, all.toArray());
            }
        } catch (InvocationTargetException e) {
            throw (RuntimeException) e.getCause();
        } catch (ReflectiveOperationException e) {
            throw new AssertionError(e);
        }
    }
}
