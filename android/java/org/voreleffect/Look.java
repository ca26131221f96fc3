package org.voreleffect;

import androidx.annotation.CheckResult;
import androidx.annotation.NonNull;
import androidx.annotation.Nullable;
import java.nio.charset.Charset;
import java.util.Arrays;
import java.util.Collections;
import java.util.List;

/**
 * What text looks like: a fill and effects. At the start the fill is black and there are no effects.
 *
 * <pre>{@code
 * Look sale = new Look()
 *         .fill(0x3366CC)
 *         .outerShadow(135, 6, 8, 0x000000, 0.6f) // light from the upper left
 *         .stroke(4, 0xFFFFFF);
 * Picture picture = sale.paint(glyph);
 * }</pre>
 *
 * <p>A look is immutable: its calls return a changed one and leave it as it was. It holds no native
 * memory, needs no closing, may be used by several threads at once, and is a key of maps: looks are
 * equal when their {@linkplain #key keys} are.
 *
 * <p><b>Which effect lies on top.</b> Effects lie in three groups, from the top: those inside the glyphs
 * (inner shadow, inner glow, gradients, pattern, inside stroke), then the fill, then those beneath the
 * text (outer shadow, outer glow, outside stroke). Within a group the one that was added last lies on
 * top. The fill keeps its place wherever it is told. A centred stroke belongs to both sides; it lies
 * over what was added before it. A look has one effect of a kind: another one of that kind takes its
 * place in the order. For more of them paint several looks, one over the other, by a {@link Painter}.
 *
 * <p>Colours are 0xRRGGBB; what lies above is ignored. Numbers out of range become the nearest in range,
 * a NaN the lower end; null, and pixels that are too few, give an {@link IllegalArgumentException}.
 * Angles are cut to whole degrees, sizes and distances to whole pixels. A look paints the same bytes as
 * one of C++ to which the same was added in the same order, and has the same key.
 */
public final class Look {
    private static final Charset KEY_BYTES = Charset.forName("ISO-8859-1");
    private static final int NUMBERS = 5;
    /** In pixels: their bytes are counted in 32 bits. */
    private static final int LARGEST_PATTERN = Integer.MAX_VALUE / 4;

    static {
        Library.load();
    }

    private final int fillColor;
    private final float fillOpacity;
    private final float textOpacity;
    private final boolean isFilled;
    private final Effect[] effects;

    /** Made when they are asked for; a thread that does not see another's makes its own. */
    private String key;

    private Margins margins;

    /** A look that is filled in black. */
    public Look() {
        this(0, 1, 1, true, new Effect[0]);
    }

    private Look(
            int fillColor, float fillOpacity, float textOpacity, boolean isFilled, Effect[] effects) {
        this.fillColor = fillColor;
        this.fillOpacity = fillOpacity;
        this.textOpacity = textOpacity;
        this.isFilled = isFilled;
        this.effects = effects;
    }

    /**
     * Fills the glyphs.
     *
     * @param color 0xRRGGBB
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look fill(int color) {
        return fill(color, 1);
    }

    /**
     * Fills the glyphs. Through a fill whose own opacity is below 1 what lies beneath the text is seen.
     *
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look fill(int color, float opacity) {
        return new Look(color, opacity, textOpacity, true, effects);
    }

    /**
     * Leaves out the fill. What lies beneath the text is cut out of the glyphs; what lies inside them is
     * painted.
     *
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look noFill() {
        return new Look(fillColor, fillOpacity, textOpacity, false, effects);
    }

    /**
     * The opacity of the text, which the fill's is multiplied with. Below 1 what lies beneath the text
     * is cut out of the glyphs, and so is not seen through them. It may be told before or after the
     * fill.
     *
     * @param opacity 0 to 1
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look textOpacity(float opacity) {
        return new Look(fillColor, fillOpacity, opacity, isFilled, effects);
    }

    /**
     * Adds a shadow behind the glyphs: beneath the text, over what was added there before it.
     *
     * @param angle where the light comes from, in degrees: 0 the right, 90 above
     * @param distance how far it is moved, away from the light: 0 to 100 pixels
     * @param size radius of the blur: 0 to 100 pixels
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look outerShadow(float angle, float distance, float size, int color, float opacity) {
        return with(shadow(Effect.OUTER_SHADOW, angle, distance, size, color, opacity));
    }

    /**
     * Adds a shadow that falls into the glyphs: inside them, over what was added there before it.
     *
     * @param angle where the light comes from, in degrees: 0 the right, 90 above
     * @param distance how far it is moved, away from the light: 0 to 100 pixels
     * @param size radius of the blur: 0 to 100 pixels
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look innerShadow(float angle, float distance, float size, int color, float opacity) {
        return with(shadow(Effect.INNER_SHADOW, angle, distance, size, color, opacity));
    }

    /**
     * Adds a halo of one colour around the glyphs: beneath the text, over what was added there before
     * it.
     *
     * @param size 0 to 100 pixels wide
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look outerGlow(float size, int color, float opacity) {
        return with(glow(Effect.OUTER_GLOW, size, color, opacity, Stops.NONE));
    }

    /**
     * Adds a halo around the glyphs that runs through the colours of the stops, from the edge of the
     * glyphs outwards: beneath the text, over what was added there before it.
     *
     * @param size 0 to 100 pixels wide
     * @param opacity 0 to 1, multiplied with that of each stop
     * @param stops its colours
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look outerGlow(float size, float opacity, @NonNull Stops stops) {
        return with(glow(Effect.OUTER_GLOW, size, 0, opacity, given(stops)));
    }

    /**
     * Adds a glow of one colour from the edges of the glyphs inwards: inside them, over what was added
     * there before it.
     *
     * @param size 0 to 100 pixels wide
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look innerGlow(float size, int color, float opacity) {
        return with(glow(Effect.INNER_GLOW, size, color, opacity, Stops.NONE));
    }

    /**
     * Adds a glow that runs through the colours of the stops, from the edges of the glyphs inwards:
     * inside them, over what was added there before it.
     *
     * @param size 0 to 100 pixels wide
     * @param opacity 0 to 1, multiplied with that of each stop
     * @param stops its colours
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look innerGlow(float size, float opacity, @NonNull Stops stops) {
        return with(glow(Effect.INNER_GLOW, size, 0, opacity, given(stops)));
    }

    /**
     * Adds a ramp across the box of the glyphs: inside them, over what was added there before it.
     *
     * @param angle in degrees: 0 runs to the right, 90 upwards
     * @param scale the length of the ramp in lengths of the box, 0.1 to 2; less paints nothing
     * @param opacity 0 to 1, multiplied with that of each stop
     * @param stops its colours
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look linearGradient(float angle, float scale, float opacity, @NonNull Stops stops) {
        return with(gradient(Effect.LINEAR_GRADIENT, angle, scale, opacity, given(stops)));
    }

    /**
     * Adds a ramp from the centre of the box of the glyphs: inside them, over what was added there
     * before it.
     *
     * @param scale the length of the ramp in half widths of the box, 0.1 to 2; less paints nothing
     * @param opacity 0 to 1, multiplied with that of each stop
     * @param stops its colours
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look radialGradient(float scale, float opacity, @NonNull Stops stops) {
        return with(gradient(Effect.RADIAL_GRADIENT, 0, scale, opacity, given(stops)));
    }

    /**
     * Adds an opaque outline around the glyphs: beneath the text, over what was added there before it.
     *
     * @param size 0 to 100 pixels wide
     * @param color 0xRRGGBB
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look stroke(float size, int color) {
        return stroke(size, color, 1, Position.OUTSIDE);
    }

    /**
     * Adds an opaque outline: one outside lies beneath the text, one inside in the glyphs, a centred one
     * over what was added before it on both sides.
     *
     * @param size 0 to 100 pixels wide
     * @param color 0xRRGGBB
     * @param position where it lies on the edge of the glyphs
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look stroke(float size, int color, @NonNull Position position) {
        return stroke(size, color, 1, position);
    }

    /**
     * Adds an outline: one outside lies beneath the text, one inside in the glyphs, a centred one over
     * what was added before it on both sides.
     *
     * @param size 0 to 100 pixels wide
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @param position where it lies on the edge of the glyphs
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look stroke(float size, int color, float opacity, @NonNull Position position) {
        if (position == null) throw new IllegalArgumentException("position: null");
        Effect stroke = new Effect(Effect.STROKE);
        stroke.size = size;
        stroke.color = color;
        stroke.opacity = opacity;
        stroke.position = position;
        return with(stroke);
    }

    /**
     * Adds a picture tiled over the glyphs from the top left corner of their box: inside them, over what
     * was added there before it. The pixels are copied.
     *
     * @param pixels 0xAARRGGBB, straight, rows back to back, as {@code Bitmap.getPixels} and
     *     {@code BufferedImage.getRGB} give them
     * @param width pixels of a row, at least 1
     * @param height rows, at least 1; fewer than 2^29 pixels in all
     * @param scale pixels painted for one of the picture's, 0.1 to 10; less paints nothing
     * @param opacity 0 to 1
     * @return the changed look
     */
    @CheckResult
    @NonNull
    public Look pattern(@NonNull int[] pixels, int width, int height, float scale, float opacity) {
        if (pixels == null) throw new IllegalArgumentException("pixels: null");
        if (width < 1 || height < 1 || (long) width * height > LARGEST_PATTERN) {
            throw new IllegalArgumentException("size of a pattern: " + width + " x " + height);
        }
        if (pixels.length < width * height) {
            throw new IllegalArgumentException(
                    "pixels: " + pixels.length + ", fewer than " + width + " x " + height);
        }
        Effect pattern = new Effect(Effect.PATTERN);
        pattern.scale = scale;
        pattern.opacity = opacity;
        pattern.tile = new int[width * height + 2];
        pattern.tile[0] = width;
        pattern.tile[1] = height;
        System.arraycopy(pixels, 0, pattern.tile, 2, width * height);
        return with(pattern);
    }

    /**
     * How far the look paints beyond the glyphs; nothing is cut off.
     *
     * @return pixels on each side
     */
    @NonNull
    public Margins margins() {
        Margins known = margins;
        if (known == null) {
            known = new Margins(nativeMargins(numbers(), tile()));
            margins = known;
        }
        return known;
    }

    /**
     * The look as a string for a cache: always the same for looks to which the same was added in the
     * same order, at any time and in every process. Looks of the same key paint the same pictures,
     * patterns included. What the look does not know (font, size, text) you add.
     *
     * <p>Its characters are U+0001 to U+00FF, not all of them printable: in ISO-8859-1 they are the
     * bytes of the key in C and C++.
     *
     * @return the key
     */
    @NonNull
    public String key() {
        String known = key;
        if (known == null) {
            known = new String(nativeKey(numbers(), tile()), KEY_BYTES);
            key = known;
        }
        return known;
    }

    /**
     * Paints glyphs once, on a picture; see {@link Painter#paint(List, PictureView, int, int)}.
     *
     * @param glyphs in any order
     * @param view what they are laid over
     * @param x where the origin of the text stands
     * @param y where the origin of the text stands
     * @return the box that was touched
     */
    @NonNull
    public Box paint(@NonNull List<Glyph> glyphs, @NonNull PictureView view, int x, int y) {
        try (Painter painter = new Painter(this)) {
            return painter.paint(glyphs, view, x, y);
        }
    }

    /**
     * Paints one glyph once, on a picture; see {@link Painter#paint(List, PictureView, int, int)}.
     *
     * @param glyph one, or a whole line
     * @param view what it is laid over
     * @param x where the origin of the text stands
     * @param y where the origin of the text stands
     * @return the box that was touched
     */
    @NonNull
    public Box paint(@NonNull Glyph glyph, @NonNull PictureView view, int x, int y) {
        return paint(Collections.singletonList(glyph), view, x, y);
    }

    /**
     * Paints a picture of its own once; see {@link Painter#paint(List)}.
     *
     * @param glyphs in any order
     * @return the picture
     */
    @CheckResult
    @NonNull
    public Picture paint(@NonNull List<Glyph> glyphs) {
        try (Painter painter = new Painter(this)) {
            return painter.paint(glyphs);
        }
    }

    /**
     * Paints a picture of one glyph once; see {@link Painter#paint(List)}.
     *
     * @param glyph one, or a whole line
     * @return the picture
     */
    @CheckResult
    @NonNull
    public Picture paint(@NonNull Glyph glyph) {
        return paint(Collections.singletonList(glyph));
    }

    @Override
    public boolean equals(@Nullable Object other) {
        return this == other || other instanceof Look && key().equals(((Look) other).key());
    }

    @Override
    public int hashCode() {
        return key().hashCode();
    }

    /** As the native side takes it: the numbers of the fill, then those of each effect. */
    @NonNull
    int[] numbers() {
        int length = NUMBERS;
        for (Effect effect : effects) length += effect.length();
        int[] numbers = new int[length];
        numbers[0] = fillColor;
        numbers[1] = Float.floatToRawIntBits(fillOpacity);
        numbers[2] = Float.floatToRawIntBits(textOpacity);
        numbers[3] = isFilled ? 1 : 0;
        numbers[4] = effects.length;
        int at = NUMBERS;
        for (Effect effect : effects) at = effect.write(numbers, at);
        return numbers;
    }

    /** The pixels of the pattern behind their width and height; null without one. */
    @Nullable
    int[] tile() {
        for (Effect effect : effects) {
            if (effect.kind == Effect.PATTERN) return effect.tile;
        }
        return null;
    }

    /** With one more effect; one of its kind is replaced, at its place in the order. */
    private Look with(Effect added) {
        int at = 0;
        while (at < effects.length && effects[at].kind != added.kind) ++at;
        Effect[] changed = Arrays.copyOf(effects, Math.max(effects.length, at + 1));
        changed[at] = added;
        return new Look(fillColor, fillOpacity, textOpacity, isFilled, changed);
    }

    private static Effect shadow(
            int kind, float angle, float distance, float size, int color, float opacity) {
        Effect shadow = new Effect(kind);
        shadow.angle = angle;
        shadow.distance = distance;
        shadow.size = size;
        shadow.color = color;
        shadow.opacity = opacity;
        return shadow;
    }

    private static Effect glow(int kind, float size, int color, float opacity, Stops stops) {
        Effect glow = new Effect(kind);
        glow.size = size;
        glow.color = color;
        glow.opacity = opacity;
        glow.stops = stops;
        return glow;
    }

    private static Effect gradient(int kind, float angle, float scale, float opacity, Stops stops) {
        Effect gradient = new Effect(kind);
        gradient.angle = angle;
        gradient.scale = scale;
        gradient.opacity = opacity;
        gradient.stops = stops;
        return gradient;
    }

    private static Stops given(Stops stops) {
        if (stops == null) throw new IllegalArgumentException("stops: null");
        return stops;
    }

    private static native int[] nativeMargins(int[] numbers, int[] tile);

    private static native byte[] nativeKey(int[] numbers, int[] tile);
}
