import java.io.IOException;
import java.lang.reflect.Method;
import java.lang.reflect.Modifier;
import java.nio.ByteBuffer;
import java.nio.ByteOrder;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.Paths;
import java.util.Arrays;
import java.util.Collections;
import java.util.HashMap;
import java.util.LinkedHashMap;
import java.util.List;
import java.util.Map;
import java.util.concurrent.atomic.AtomicReference;
import org.voreleffect.Box;
import org.voreleffect.Glyph;
import org.voreleffect.Look;
import org.voreleffect.Margins;
import org.voreleffect.Painter;
import org.voreleffect.Picture;
import org.voreleffect.PictureView;
import org.voreleffect.PixelOrder;
import org.voreleffect.Position;
import org.voreleffect.Stops;
import org.voreleffect.VorelEffect;

/**
 * Tests of looks, painters and pictures: the same keys, margins and pixels as look.h (look_runs.cpp wrote
 * them), and what is refused.
 */
public final class LookTest extends Checks {
    private static final int WIDTH = 67;
    private static final int HEIGHT = 49;
    private static final int STRIDE = 4 * WIDTH + 12;

    private static final Stops STOPS =
            Stops.of(
                    new int[] {0xFF0000, 0x00FF80, 0x0000FF},
                    new float[] {1, 0.75f, 0.5f},
                    new float[] {0, 0.4f, 1});
    private static final int[] PATTERN = {
        0xFFFF0000, 0x8000FF00, 0x400000FF, 0x12345678, 0xFFFFFFFF, 0xC0804020
    };

    private static final Glyph RING = new Glyph(8, 9, ring(), 31, 29);
    private static final Glyph BAR = new Glyph(33, 11, direct(bar()), 11, 25, 13);
    private static final List<Glyph> GLYPHS = Arrays.asList(RING, BAR, BAR.at(60, -3));
    private static final Look BLUE = new Look().fill(0x3366CC);
    private static final Look EVERYTHING =
            BLUE.outerShadow(45, 4, 6, 0x202020, 0.5f)
                    .outerGlow(5, 0xFFFF00, 0.5f)
                    .stroke(2, 0x000080)
                    .linearGradient(90, 1, 1, STOPS)
                    .innerGlow(3, 0xFFFFFF, 0.7f)
                    .innerShadow(270, 2, 2, 0x400040, 0.9f)
                    .pattern(PATTERN, 3, 2, 1, 0.2f);

    private final Path painted;

    private LookTest(Path painted) {
        this.painted = painted;
    }

    public static void main(String[] arguments) throws IllegalAccessException {
        new LookTest(Paths.get(arguments[0])).run();
    }

    // --- The same as C++ ------------------------------------------------------------------------

    private static Map<String, List<Look>> stacks() {
        Map<String, List<Look>> stacks = new LinkedHashMap<>();
        stacks.put("plain", Arrays.asList(new Look()));
        stacks.put("outer_shadow", Arrays.asList(BLUE.outerShadow(120.5f, 5, 4, 0x102030, 0.7f)));
        stacks.put("inner_shadow", Arrays.asList(BLUE.innerShadow(-30.7f, 3, 2, 0xFFEEDD, 0.6f)));
        stacks.put("outer_glow", Arrays.asList(BLUE.outerGlow(6, 0xFFD700, 0.8f)));
        stacks.put("outer_glow_stops", Arrays.asList(BLUE.outerGlow(7, 0.9f, STOPS)));
        stacks.put("inner_glow", Arrays.asList(BLUE.innerGlow(4, 0x00FFFF, 0.5f)));
        stacks.put("inner_glow_stops", Arrays.asList(BLUE.innerGlow(5, 1, STOPS)));
        stacks.put("linear", Arrays.asList(BLUE.linearGradient(60, 0.8f, 0.9f, STOPS)));
        stacks.put("radial", Arrays.asList(BLUE.radialGradient(1.2f, 0.8f, STOPS)));
        stacks.put("stroke_centre", Arrays.asList(BLUE.stroke(3, 0xFFFFFF, Position.CENTRE)));
        stacks.put("stroke_outside", Arrays.asList(BLUE.stroke(4, 0x00AA00)));
        stacks.put("stroke_inside", Arrays.asList(BLUE.stroke(2, 0xAA0000, 0.4f, Position.INSIDE)));
        stacks.put("pattern", Arrays.asList(BLUE.pattern(PATTERN, 3, 2, 1.5f, 0.9f)));
        stacks.put(
                "translucent_fill",
                Arrays.asList(new Look().fill(0x3366CC, 0.5f).outerShadow(135, 4, 4, 0x800000, 1)));
        stacks.put(
                "translucent_text",
                Arrays.asList(
                        BLUE.textOpacity(0.4f).outerShadow(135, 4, 4, 0x800000, 1).stroke(2, 0xFF8800)));
        stacks.put("no_fill", Arrays.asList(BLUE.noFill().outerGlow(4, 0x35C4FF, 1)));
        stacks.put(
                "order",
                Arrays.asList(BLUE.stroke(3, 1).outerShadow(135, 4, 4, 2, 1).stroke(5, 0xFFFF00)));
        stacks.put(
                "stack",
                Arrays.asList(
                        new Look().fill(0x1D2A44).stroke(7, 0x1D2A44, 0.7f, Position.OUTSIDE),
                        new Look().fill(0xFFE27A, 0.6f).stroke(3, 0xFFFFFF)));
        stacks.put("nothing", Collections.<Look>emptyList());
        return stacks;
    }

    void testEveryLookHasTheKeyMarginsAndPixelsOfCpp() throws IOException {
        Map<String, List<Look>> stacks = stacks();
        for (Map.Entry<String, List<Look>> entry : stacks.entrySet()) {
            byte[] expected = Files.readAllBytes(painted.resolve(entry.getKey()));
            byte[] actual = paint(entry.getValue());
            check(Arrays.equals(expected, actual), entry.getKey() + " differs from C++");
        }
        check(painted.toFile().list().length == stacks.size(), "C++ paints as many looks");
    }

    /** What look_runs writes of a stack. */
    private static byte[] paint(List<Look> looks) {
        ByteBuffer said = ByteBuffer.allocate(200_000).order(ByteOrder.LITTLE_ENDIAN);
        String key = looks.isEmpty() ? "" : looks.get(looks.size() - 1).key();
        said.putInt(key.length()).put(key.getBytes(StandardCharsets.ISO_8859_1));
        try (Painter painter = new Painter(looks)) {
            Margins margins = painter.margins();
            said.putInt(margins.left).putInt(margins.top).putInt(margins.right).putInt(margins.bottom);
            Picture picture = painter.paint(GLYPHS);
            said.putInt(picture.width()).putInt(picture.height());
            said.putInt(picture.left()).putInt(picture.top()).put(picture.pixels());
            for (PixelOrder order : PixelOrder.values()) {
                byte[] page = page();
                Box box = painter.paint(GLYPHS, view(page).order(order), 5, -3);
                said.putInt(box.left).putInt(box.top).putInt(box.right).putInt(box.bottom).put(page);
            }
        }
        return Arrays.copyOf(said.array(), said.position());
    }

    void testPaintingAgainGivesTheSamePicture() {
        for (List<Look> looks : stacks().values()) {
            try (Painter painter = new Painter(looks)) {
                byte[] first = onAPage(painter);
                looks.forEach(Look::key);
                check(Arrays.equals(first, onAPage(painter)), "the second time");
                check(Arrays.equals(first, onAPage(painter)), "the third time");
                try (Painter other = new Painter(looks)) {
                    check(Arrays.equals(first, onAPage(other)), "another painter");
                }
            }
        }
    }

    // --- Memory of each kind ---------------------------------------------------------------------

    void testEveryKindOfMemoryGetsTheSamePixels() {
        byte[] expected = page();
        EVERYTHING.paint(GLYPHS, view(expected), 5, -3);
        check(!Arrays.equals(expected, page()), "nothing was painted");

        ByteBuffer direct = direct(page());
        EVERYTHING.paint(GLYPHS, PictureView.of(direct, WIDTH, HEIGHT, STRIDE), 5, -3);
        check(direct.equals(ByteBuffer.wrap(expected)), "direct buffer");

        ByteBuffer wrapped = ByteBuffer.allocate(9 + expected.length);
        wrapped.position(4);
        wrapped = wrapped.slice();
        wrapped.position(5);
        wrapped.put(page()).position(5);
        EVERYTHING.paint(GLYPHS, PictureView.of(wrapped, WIDTH, HEIGHT, STRIDE), 5, -3);
        check(wrapped.position() == 5, "position");
        check(wrapped.equals(ByteBuffer.wrap(expected)), "buffer with an array");

        int[] words = words(page());
        EVERYTHING.paint(GLYPHS, PictureView.of(words, WIDTH, HEIGHT, STRIDE / 4), 5, -3);
        check(Arrays.equals(words, words(expected)), "words");
    }

    void testCoverageMayBeInMemoryOfEachKind() {
        byte[] expected = onAPage(EVERYTHING, Arrays.asList(RING));
        ByteBuffer moved = ByteBuffer.allocateDirect(3 + 31 * 29);
        moved.position(3);
        moved.put(ring()).position(3);
        ByteBuffer apart = ByteBuffer.allocate(2 + 40 * 29);
        for (int y = 0; y < 29; ++y) {
            apart.position(2 + 40 * y);
            apart.put(ring(), 31 * y, 31);
        }
        apart.position(2);
        for (Glyph glyph :
                Arrays.asList(
                        new Glyph(8, 9, moved, 31, 29),
                        new Glyph(8, 9, apart, 31, 29, 40),
                        new Glyph(0, 0, ByteBuffer.wrap(ring()), 31, 29).at(8, 9))) {
            check(Arrays.equals(expected, onAPage(EVERYTHING, Arrays.asList(glyph))), "pixels");
        }
    }

    void testPositionsAreReadOnceWhenABufferIsHandedOver() {
        ByteBuffer coverage = direct(ring());
        Glyph glyph = new Glyph(8, 9, coverage, 31, 29);
        ByteBuffer page = direct(page());
        PictureView view = PictureView.of(page, WIDTH, HEIGHT, STRIDE);
        coverage.position(100).limit(101);
        page.position(page.capacity()).limit(page.capacity());
        EVERYTHING.paint(glyph, view, 0, 0);
        page.clear();
        check(page.equals(ByteBuffer.wrap(onAPage(EVERYTHING, Arrays.asList(RING)))), "pixels");
    }

    void testWhatLiesOutsideTheClipIsLeftAlone() {
        byte[] whole = page();
        Box touched = EVERYTHING.paint(GLYPHS, view(whole), 5, -3);
        Box clip = new Box(10, 7, 30, 1000);
        for (int kind = 0; kind < 3; ++kind) {
            byte[] page = page();
            int[] words = words(page);
            ByteBuffer direct = direct(page);
            PictureView view =
                    kind == 0
                            ? view(page)
                            : kind == 1
                                    ? PictureView.of(words, WIDTH, HEIGHT, STRIDE / 4)
                                    : PictureView.of(direct, WIDTH, HEIGHT, STRIDE);
            Box box = EVERYTHING.paint(GLYPHS, view.clip(clip).clip(new Box(-5, 8, 1 << 30, 20)), 5, -3);
            check(box.equals(new Box(10, Math.max(8, touched.top), 30, 20)), "touched " + box);
            if (kind == 2) direct.get(page);
            int[] pixels = kind == 1 ? words : words(page);
            for (int i = 0; i < pixels.length; ++i) {
                int x = i % (STRIDE / 4);
                int y = i / (STRIDE / 4);
                boolean inside = x >= 10 && x < 30 && y >= 8 && y < 20;
                int expected = words(inside ? whole : page())[i];
                check(pixels[i] == expected, "kind " + kind + ", pixel " + x + ", " + y);
            }
        }
    }

    void testNothingIsTouchedOutsideOfThePicture() {
        byte[] page = page();
        check(EVERYTHING.paint(GLYPHS, view(page), 500, 0).isEmpty(), "to the right");
        check(EVERYTHING.paint(GLYPHS, view(page), -(1 << 30), 1 << 30).isEmpty(), "far");
        check(EVERYTHING.paint(GLYPHS, view(page).clip(new Box(9, 9, 9, 20)), 0, 0).isEmpty(), "clip");
        check(EVERYTHING.paint(GLYPHS, PictureView.of(new int[0], 0, 5), 0, 0).isEmpty(), "no width");
        check(EVERYTHING.paint(Collections.<Glyph>emptyList(), view(page), 0, 0).isEmpty(), "no glyph");
        check(EVERYTHING.paint(new Glyph(0, 0, new byte[0], 0, 7), view(page), 0, 0).isEmpty(), "empty");
        check(Arrays.equals(page, page()), "something was painted");
    }

    // --- Pictures -------------------------------------------------------------------------------

    void testPictureHasTheBoxOfTheGlyphsAndTheMargins() {
        Picture picture = EVERYTHING.paint(RING);
        Margins margins = EVERYTHING.margins();
        check(picture.left() == 8 - margins.left && picture.top() == 9 - margins.top, "place");
        check(picture.width() == 31 + margins.left + margins.right, "width");
        check(picture.height() == 29 + margins.top + margins.bottom, "height");
        check(picture.pixels().remaining() == 4 * picture.width() * picture.height(), "pixels");
        check(picture.pixels().isDirect() && picture.pixels().isReadOnly(), "kind of buffer");
    }

    void testPictureLaidOverAPageIsWhatOneLookPaintsThere() {
        byte[] expected = onAPage(EVERYTHING, GLYPHS);
        Picture picture = EVERYTHING.paint(GLYPHS);
        byte[] page = page();
        Box box = picture.layOver(view(page), 5, -3);
        check(Arrays.equals(expected, page), "array of bytes");
        int[] words = words(page());
        check(box.equals(picture.layOver(PictureView.of(words, WIDTH, HEIGHT, STRIDE / 4), 5, -3)), "box");
        check(Arrays.equals(words(expected), words), "array of words");
        ByteBuffer direct = direct(page());
        picture.layOver(PictureView.of(direct, WIDTH, HEIGHT, STRIDE), 5, -3);
        check(direct.equals(ByteBuffer.wrap(expected)), "direct buffer");
    }

    void testPictureCanBePaintedOn() {
        Picture under = new Look().stroke(8, 0x102030).paint(RING);
        Picture over = BLUE.paint(RING);
        Picture both = new Look().stroke(8, 0x102030).paint(RING);
        over.layOver(both.view(), -both.left(), -both.top());
        check(!both.pixels().equals(under.pixels()), "nothing was painted");
        int top = 4 * (both.width() * (9 + 3 - both.top()) + 8 + 15 - both.left()); // of the ring
        check((both.pixels().get(top + 2) & 255) > 0xC0, "blue of the fill");
    }

    void testEmptyPictureHasNoPixels() {
        Picture picture = EVERYTHING.paint(Collections.<Glyph>emptyList());
        check(picture.isEmpty() && picture.width() == 0 && picture.pixels().remaining() == 0, "empty");
        byte[] page = page();
        check(picture.layOver(view(page), 0, 0).isEmpty(), "touched");
        check(Arrays.equals(page, page()), "something was painted");
        check(BLUE.paint(RING, picture.view(), 0, 0).isEmpty(), "painted on");
    }

    // --- Looks as values --------------------------------------------------------------------------

    void testLooksAreEqualWhenTheSameWasAddedInTheSameOrder() {
        Look one = new Look().fill(0x3366CC).stroke(4, 0xFFFFFF).outerGlow(5, 0, 1);
        Look same = new Look().stroke(9, 1).outerGlow(5, 0, 1).stroke(4, 0xFFFFFF).fill(0xFF3366CC);
        Look other = new Look().fill(0x3366CC).outerGlow(5, 0, 1).stroke(4, 0xFFFFFF);
        check(one.equals(same) && one.hashCode() == same.hashCode(), "equal");
        check(one.key().equals(same.key()), "keys");
        check(!one.equals(other), "another order");
        check(!one.equals(null) && !one.equals("look"), "no look");
        Map<Look, String> cache = new HashMap<>();
        cache.put(one, "painted");
        check("painted".equals(cache.get(same)) && cache.get(other) == null, "map");
    }

    void testCallsLeaveTheLookAsItWas() {
        Look look = new Look();
        String key = look.key();
        Look changed = look.fill(1).stroke(1, 2).textOpacity(0.5f).noFill();
        check(look.key().equals(key), "changed");
        check(!changed.key().equals(key), "the changed one has not");
    }

    void testKeyTellsPatternsApartAndBeginsWithThatOfTheClass() {
        int[] other = PATTERN.clone();
        other[5] ^= 1;
        check(!BLUE.pattern(PATTERN, 3, 2, 1, 1).equals(BLUE.pattern(other, 3, 2, 1, 1)), "pixels");
        check(!BLUE.pattern(PATTERN, 3, 2, 1, 1).equals(BLUE.pattern(PATTERN, 2, 3, 1, 1)), "size");
        try (VorelEffect look = new VorelEffect()) {
            look.addStrokeText(4, 0xFFFFFF, 1, 0, VorelEffect.STROKE_OUTSIDE);
            look.addText(0x3366CC, 1);
            String key = new String(look.getMapKey(), StandardCharsets.ISO_8859_1);
            check(BLUE.stroke(4, 0xFFFFFF).key().startsWith(key), "key");
        }
    }

    void testAnotherPatternTakesThePlaceOfTheFirst() {
        Look one = BLUE.pattern(PATTERN, 2, 3, 1, 1).stroke(1, 2);
        Look replaced = BLUE.pattern(PATTERN, 3, 2, 9, 0.5f).stroke(1, 2).pattern(PATTERN, 2, 3, 1, 1);
        check(one.equals(replaced), "keys");
        check(one.paint(RING).pixels().equals(replaced.paint(RING).pixels()), "pixels");
    }

    void testPatternIsCopied() {
        int[] pixels = PATTERN.clone();
        Look look = BLUE.pattern(pixels, 3, 2, 1, 1);
        Arrays.fill(pixels, 0);
        check(look.equals(BLUE.pattern(PATTERN, 3, 2, 1, 1)), "key");
    }

    void testNumbersOutOfRangeAreTheNearestAndNoNumberIsTheLowest() {
        float nan = Float.NaN;
        check(BLUE.stroke(1e9f, 1).equals(BLUE.stroke(100, 1)), "large");
        check(BLUE.stroke(-3, 1).equals(BLUE.stroke(0, 1)), "negative");
        check(BLUE.outerShadow(nan, nan, nan, 1, nan).equals(BLUE.outerShadow(0, 0, 0, 1, 0)), "NaN");
        check(BLUE.fill(1, nan).equals(BLUE.fill(1, 0)), "fill");
        check(BLUE.textOpacity(nan).equals(BLUE.textOpacity(0)), "text opacity");
        float inf = Float.POSITIVE_INFINITY;
        check(BLUE.outerGlow(inf, 1, inf).equals(BLUE.outerGlow(100, 1, 1)), "infinite");
        Stops strange = Stops.of(new int[] {1}, new float[] {nan}, new float[] {-inf});
        check(!BLUE.linearGradient(nan, nan, nan, strange).paint(RING).isEmpty(), "painted");
    }

    // --- Stops ----------------------------------------------------------------------------------

    void testStopsOfColoursStandAtEvenDistances() {
        Stops built = Stops.builder().add(1, 0).add(2, 1, 0.5f).add(3, 1).build();
        check(Stops.of(1, 2, 3).equals(built) && Stops.of(1, 2, 3).hashCode() == built.hashCode(), "three");
        check(Stops.of(7).equals(Stops.builder().add(7, 0).build()), "one");
        check(!Stops.of(1, 2).equals(Stops.of(2, 1)), "another order");
        check(built.toString().equals("Stops(0x000001 1.0 at 0.0, 0x000002 1.0 at 0.5, 0x000003 1.0 at 1.0)"),
                built.toString());
    }

    void testStopsAreImmutable() {
        int[] colors = {1, 2};
        float[] numbers = {0, 1};
        Stops stops = Stops.of(colors, numbers, numbers);
        colors[0] = 9;
        numbers[0] = 9;
        check(stops.equals(Stops.of(new int[] {1, 2}, new float[] {0, 1}, new float[] {0, 1})), "arrays");
        Stops.Builder builder = Stops.builder().add(1, 0);
        Stops first = builder.build();
        for (int i = 0; i < 300; ++i) builder.add(i, 1);
        check(first.size() == 1 && builder.build().size() == 256, "builder");
    }

    void testStopsThatAreNoneAreRefused() {
        refused(() -> Stops.of());
        refused(() -> Stops.of((int[]) null));
        refused(() -> Stops.builder().build());
        refused(() -> Stops.of(new int[1], null, new float[1]));
        refused(() -> Stops.of(new int[1], new float[2], new float[1]));
        refused(() -> Stops.of(new int[1], new float[1], new float[0]));
    }

    // --- What is refused --------------------------------------------------------------------------

    void testNullIsRefusedEverywhere() throws Exception {
        PictureView view = view(page());
        try (Painter painter = new Painter(BLUE)) {
            Object[] objects = {BLUE, painter, BLUE.paint(RING), view};
            int calls = 0;
            for (Object object : objects) calls += callsWithNull(object);
            check(calls >= 20, "calls: " + calls);
            refused(() -> painter.paint(Arrays.asList(RING, null)));
        }
        refused(() -> new Painter((Look[]) null));
        refused(() -> new Painter((List<Look>) null));
        refused(() -> new Painter(BLUE, null));
        refused(() -> new Glyph(0, 0, (byte[]) null, 1, 1));
        refused(() -> new Glyph(0, 0, (ByteBuffer) null, 1, 1));
        refused(() -> PictureView.of((int[]) null, 1, 1));
        refused(() -> PictureView.of((byte[]) null, 1, 1));
        refused(() -> PictureView.of((ByteBuffer) null, 1, 1));
    }

    /** Calls every method with one null after the other, all else being right; returns how many calls. */
    private static int callsWithNull(Object object) throws Exception {
        int calls = 0;
        for (Method method : object.getClass().getDeclaredMethods()) {
            int modifiers = method.getModifiers();
            if (!Modifier.isPublic(modifiers) || Modifier.isStatic(modifiers)) continue;
            if (method.getName().equals("equals")) continue;
            Class<?>[] types = method.getParameterTypes();
            for (int i = 0; i < types.length; ++i) {
                if (types[i].isPrimitive()) continue;
                Object[] arguments = new Object[types.length];
                for (int j = 0; j < types.length; ++j) arguments[j] = j == i ? null : argument(types[j]);
                expect(IllegalArgumentException.class, () -> invoke(method, object, arguments));
                ++calls;
            }
        }
        return calls;
    }

    private static Object argument(Class<?> type) {
        if (type == int.class) return 1;
        if (type == float.class) return 1f;
        if (type == Glyph.class) return RING;
        if (type == List.class) return GLYPHS;
        return type == PictureView.class ? view(page()) : null;
    }

    private static void invoke(Method method, Object object, Object[] arguments) {
        try {
            method.invoke(object, arguments);
        } catch (java.lang.reflect.InvocationTargetException e) {
            throw (RuntimeException) e.getCause();
        } catch (IllegalAccessException e) {
            throw new AssertionError(e);
        }
    }

    void testGlyphsThatDoNotFitTheirMemoryAreRefused() {
        refused(() -> new Glyph(0, 0, new byte[99], 10, 10));
        refused(() -> new Glyph(0, 0, new byte[108], 10, 10, 11));
        new Glyph(0, 0, new byte[109], 10, 10, 11);
        refused(() -> new Glyph(0, 0, new byte[100], 10, 10, 9));
        refused(() -> new Glyph(0, 0, new byte[100], -1, 10));
        refused(() -> new Glyph(0, 0, new byte[100], 10, -1));
        refused(() -> new Glyph(0, 0, new byte[100], 1 << 16, 0));
        refused(() -> new Glyph(0, 0, new byte[100], 0, 1 << 16));
        refused(() -> new Glyph(0, 0, new byte[100], 0xFFFF, 0xFFFF, Integer.MAX_VALUE));
        refused(() -> new Glyph(0, 0, ByteBuffer.allocateDirect(99), 10, 10));
        ByteBuffer moved = ByteBuffer.allocateDirect(100);
        moved.position(1);
        refused(() -> new Glyph(0, 0, moved, 10, 10));
        refused(() -> new Glyph(0, 0, ByteBuffer.allocate(100).asReadOnlyBuffer(), 10, 10));
        new Glyph(0, 0, ByteBuffer.allocateDirect(100).asReadOnlyBuffer(), 10, 10);
    }

    void testViewsThatDoNotFitTheirMemoryAreRefused() {
        refused(() -> PictureView.of(new int[99], 10, 10));
        refused(() -> PictureView.of(new int[108], 10, 10, 11));
        PictureView.of(new int[109], 10, 10, 11);
        refused(() -> PictureView.of(new int[100], 10, 10, 9));
        refused(() -> PictureView.of(new byte[399], 10, 10));
        refused(() -> PictureView.of(new byte[400], 10, 10, 39));
        refused(() -> PictureView.of(new byte[400], -1, 10));
        refused(() -> PictureView.of(new byte[400], 10, -1));
        refused(() -> PictureView.of(new byte[400], 1 << 15, 1 << 15));
        refused(() -> PictureView.of(new byte[400], (1 << 29) + 1, 1));
        refused(() -> PictureView.of(new int[400], 1 << 30, 1));
        refused(() -> PictureView.of(new int[400], Integer.MAX_VALUE, Integer.MAX_VALUE));
        refused(() -> PictureView.of(ByteBuffer.allocateDirect(399), 10, 10));
        refused(() -> PictureView.of(ByteBuffer.allocateDirect(400).asReadOnlyBuffer(), 10, 10));
        refused(() -> PictureView.of(ByteBuffer.allocate(400).asReadOnlyBuffer(), 10, 10));
        refused(() -> PictureView.of(new int[100], 10, 10).order(PixelOrder.BGRA));
    }

    void testWhatIsTooLargeOrTooFarIsRefusedAndThePictureIsAsItWas() {
        byte[] page = page();
        List<Glyph> apart =
                Arrays.asList(RING.at(Integer.MIN_VALUE, 0), RING.at(Integer.MAX_VALUE, 0));
        try (Painter painter = new Painter(EVERYTHING)) {
            refused(() -> painter.paint(apart, view(page), 0, 0));
            refused(() -> painter.paint(apart));
            refused(() -> painter.paint(GLYPHS, view(page), (1 << 30) + 1, 0));
            refused(() -> painter.paint(GLYPHS, view(page), 0, Integer.MIN_VALUE));
            check(Arrays.equals(page, page()), "something was painted");
            check(Arrays.equals(onAPage(painter), onAPage(EVERYTHING, GLYPHS)), "the next time");
        }
        Picture picture = BLUE.paint(RING);
        refused(() -> picture.layOver(view(page), Integer.MAX_VALUE, 0));
    }

    /** refusing_calloc.cpp refuses masks of 211 x 199 pixels. */
    void testLayersThatGetNoMemoryAreReportedAndThePictureIsAsItWas() {
        byte[] coverage = new byte[211 * 199];
        Arrays.fill(coverage, (byte) 255);
        Glyph glyph = new Glyph(0, 0, coverage, 211, 199);
        byte[] page = page();
        try (Painter painter = new Painter(BLUE)) {
            expect(OutOfMemoryError.class, () -> painter.paint(glyph, view(page), 0, 0));
            expect(OutOfMemoryError.class, () -> painter.paint(glyph));
            check(Arrays.equals(page, page()), "something was painted");
            check(Arrays.equals(onAPage(painter), onAPage(BLUE, GLYPHS)), "the next time");
        }
    }

    // --- Closing --------------------------------------------------------------------------------

    void testClosedPainterRefusesEveryCall() throws Exception {
        Painter painter = new Painter(EVERYTHING);
        painter.close();
        int called = 0;
        for (Method method : Painter.class.getDeclaredMethods()) {
            int modifiers = method.getModifiers();
            if (!Modifier.isPublic(modifiers) || method.getName().equals("close")) continue;
            Class<?>[] types = method.getParameterTypes();
            Object[] arguments = new Object[types.length];
            for (int i = 0; i < types.length; ++i) arguments[i] = argument(types[i]);
            misplaced(() -> invoke(method, painter, arguments));
            ++called;
        }
        check(called == 5, "methods called: " + called);
        painter.close();
    }

    void testPainterThatTheListOfGlyphsClosesIsRefused() {
        for (boolean isOnAPage : new boolean[] {true, false}) {
            Painter painter = new Painter(EVERYTHING);
            List<Glyph> closing = closing(painter, RING);
            PictureView page = PictureView.of(new int[WIDTH * HEIGHT], WIDTH, HEIGHT);
            misplaced(() -> {
                if (isOnAPage) painter.paint(closing, page, 0, 0);
                else painter.paint(closing);
            });
        }
    }

    void testClosingFromOtherThreadsEndsInARefusal() throws InterruptedException {
        for (int round = 0; round < 30; ++round) {
            Painter painter = new Painter(EVERYTHING);
            AtomicReference<Throwable> thrown = new AtomicReference<>();
            Thread painting =
                    new Thread(
                            () -> {
                                try {
                                    while (true) onAPage(painter);
                                } catch (Throwable e) {
                                    thrown.set(e);
                                }
                            });
            Thread closing = new Thread(painter::close);
            painting.start();
            Thread.sleep(round % 5);
            closing.start();
            painter.close();
            painting.join();
            closing.join();
            check(thrown.get() instanceof IllegalStateException, "thrown: " + thrown.get());
        }
    }

    void testPaintersThatWereNeverClosedAreFreed() throws Exception {
        Look look = BLUE.pattern(new int[128 * 64], 128, 64, 1, 1);
        long before = residentKb();
        long most = 0;
        for (int i = 1; i <= 4_000; ++i) {
            new Painter(look);
            if (i % 500 == 0) {
                collect();
                most = Math.max(most, residentKb() - before);
            }
        }
        check(most < 160_000, "4,000 painters of 64 kB that were never closed hold " + most + " kB");
    }

    void testSeveralThreadsPaintInOneLook() throws InterruptedException {
        Look look = BLUE.outerGlow(5, 0xFFFF00, 0.5f).linearGradient(0, 1, 1, STOPS);
        byte[] expected = onAPage(look, GLYPHS);
        AtomicReference<Throwable> thrown = new AtomicReference<>();
        Thread[] threads = new Thread[4];
        for (int i = 0; i < threads.length; ++i) {
            threads[i] =
                    new Thread(
                            () -> {
                                try {
                                    for (int run = 0; run < 20; ++run) {
                                        check(Arrays.equals(expected, onAPage(look, GLYPHS)), "pixels");
                                        check(look.key().equals(look.fill(0x3366CC).key()), "key");
                                    }
                                } catch (Throwable e) {
                                    thrown.set(e);
                                }
                            });
            threads[i].start();
        }
        for (Thread thread : threads) thread.join();
        check(thrown.get() == null, "thrown: " + thrown.get());
    }

    // --- The desktop ------------------------------------------------------------------------------

    void testNoClassOfAndroidIsThere() {
        try {
            Class.forName("android.graphics.Bitmap");
        } catch (ClassNotFoundException e) {
            return;
        }
        throw new AssertionError("the classes are not those of a desktop");
    }

    // --- Support --------------------------------------------------------------------------------

    private static byte[] ring() {
        byte[] coverage = new byte[31 * 29];
        for (int y = 0; y < 29; ++y) {
            for (int x = 0; x < 31; ++x) {
                int fromCentre = (x - 15) * (x - 15) + (y - 14) * (y - 14);
                coverage[31 * y + x] = (byte) Math.max(255 - Math.abs(fromCentre - 120) * 3, 0);
            }
        }
        return coverage;
    }

    /** Rows of 11 pixels that lie 13 bytes apart. */
    private static byte[] bar() {
        byte[] coverage = new byte[13 * 25];
        for (int i = 0; i < coverage.length; ++i) {
            coverage[i] = (byte) (i % 13 == 0 || i % 13 == 10 ? 128 : 255);
        }
        return coverage;
    }

    private static byte[] page() {
        byte[] page = new byte[STRIDE * HEIGHT];
        for (int i = 0; i < page.length; ++i) page[i] = (byte) (i % 4 == 3 ? 255 : i * 7);
        return page;
    }

    private static PictureView view(byte[] page) {
        return PictureView.of(page, WIDTH, HEIGHT, STRIDE);
    }

    private static byte[] onAPage(Painter painter) {
        byte[] page = page();
        painter.paint(GLYPHS, view(page), 5, -3);
        return page;
    }

    private static byte[] onAPage(Look look, List<Glyph> glyphs) {
        byte[] page = page();
        look.paint(glyphs, view(page), glyphs == GLYPHS ? 5 : 0, glyphs == GLYPHS ? -3 : 0);
        return page;
    }

    private static ByteBuffer direct(byte[] bytes) {
        ByteBuffer buffer = ByteBuffer.allocateDirect(bytes.length);
        buffer.put(bytes).clear();
        return buffer;
    }

    /** R, G, B, A as 0xAARRGGBB. */
    private static int[] words(byte[] bytes) {
        int[] words = new int[bytes.length / 4];
        for (int i = 0; i < words.length; ++i) {
            words[i] =
                    (bytes[4 * i + 3] & 255) << 24
                            | (bytes[4 * i] & 255) << 16
                            | (bytes[4 * i + 1] & 255) << 8
                            | bytes[4 * i + 2] & 255;
        }
        return words;
    }
}
