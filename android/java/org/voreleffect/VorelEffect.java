package org.voreleffect;

import androidx.annotation.CheckResult;
import androidx.annotation.NonNull;
import java.nio.ByteBuffer;

/**
 * A styled-text look and the painter of its runs, call by call as the C++ class {@code VFEffect} has
 * them. {@link Look} and {@link Painter} are the plainer way: they paint the same picture each time,
 * keep track of margins by themselves, and lay what they paint over what is there.
 *
 * <p>Describe the look once with add-calls, then paint any number of runs (a line, a block, a glyph):
 *
 * <pre>{@code
 * try (VorelEffect look = new VorelEffect()) {
 *     look.addOuterShadowText(135, 6, 8, 0x000000, 0.6f);
 *     look.addStrokeText(4, 0xFFFFFF, 1, 0, VorelEffect.STROKE_OUTSIDE);
 *     byte[] key = look.getMapKey(0x3366CC); // the fill; a key for a cache of painted runs
 *
 *     int width = textWidth + look.getLeftOffset() + look.getRightOffset();
 *     int height = textHeight + look.getTopOffset() + look.getBottomOffset();
 *     ByteBuffer pixels = ByteBuffer.allocateDirect(width * height * 4);
 *     look.begin(width, height, pixels);
 *     look.glyph(look.getLeftOffset(), look.getTopOffset(), coverage, textWidth, textHeight);
 *     look.finish();
 * }
 * }</pre>
 *
 * <p>The pixels are those of an {@code android.graphics.Bitmap} of the configuration ARGB_8888: four
 * bytes R, G, B, A, premultiplied, rows back to back. {@code Bitmap.copyPixelsFromBuffer} takes them.
 *
 * <p>Colours are 0xRRGGBB; a byte above them is ignored, the opacity beside them, 0 to 1, takes its
 * place. The numbers of an effect are never refused: each is clamped to the range named here, a NaN
 * to its lower end. Angles are cut to whole degrees and brought into 0 to 359, sizes and distances to
 * whole pixels. Each add-call puts its effect into the look, or updates the one of its kind that is
 * there, and returns the id of the effect. Two looks made by the same calls in the same order paint
 * the same bytes on every device.
 *
 * <p><b>Which effect lies on top.</b> Effects lie in three groups, from the top: those inside the glyphs
 * (inner shadow, inner glow, gradients, pattern, inside stroke), then the text fill, then those beneath
 * the text (outer shadow, outer glow, outside stroke). Within a group the one that was added last lies
 * on top. The text fill keeps its place wherever it is added. A centred stroke belongs to both sides; it
 * lies over what was added before it.
 *
 * <p><b>The second run.</b> {@link #begin} puts the effects into the order of painting by reversing the
 * list as it stands, and does so whenever an add-call or a new text opacity came since the last time;
 * {@link #getMapKey(int)} is an add-call. A look that is painted, gets an add-call and is painted again
 * shows its groups in the opposite order. So take the key once, before the first run; to change
 * something between runs, keep a look that is never run and run {@linkplain #copy copies} of it.
 *
 * <p>What would touch memory that is not there is refused: a null array or buffer, a buffer that is
 * not direct, one with too few bytes remaining, a size out of range give an
 * {@link IllegalArgumentException}, and nothing changes. A closed object, a buffer over memory that its
 * owner has closed, and a call that does not fit a run that is or is not open, give an
 * {@link IllegalStateException}, and nothing changes either. A layer that cannot be made gives an
 * {@link OutOfMemoryError}; no run is open then.
 *
 * <p>The methods exclude each other, so that an object may be handed from thread to thread and closed
 * from any of them; separate objects paint at the same time. A buffer's position and limit are read
 * once, when the buffer is handed over: another thread that moves them makes no call touch other memory.
 * Its bytes are the caller's to keep: memory that is closed or unmapped <em>during</em> a call, or that
 * was freed behind the virtual machine's back (the pixels under a buffer that native code has made),
 * cannot be told from memory that is there, and touching it ends the process.
 *
 * <p>Close an object when it is done. One that was never closed is freed when a later one is made, after
 * the collector has found it unreachable, and until then holds the memory of its effects and of a run
 * that is open.
 */
public final class VorelEffect implements AutoCloseable {
    /** Position of a stroke: half of it on each side of the edge. Selects layered mode. */
    public static final int STROKE_CENTRE = 0;

    /** Position of a stroke: around the glyphs. */
    public static final int STROKE_OUTSIDE = 1;

    /** Position of a stroke: within the glyphs. */
    public static final int STROKE_INSIDE = 2;

    /** The id that an add-call returns for a kind of effect that nothing paints. */
    public static final int NO_EFFECT = -1;

    private static final int BYTES_PER_PIXEL = 4;
    private static final int LARGEST_GLYPH = 0xFFFF;
    /** In pixels: their bytes are counted in 32 bits. */
    private static final int LARGEST_PATTERN = 0x3FFFFFFF;

    static {
        Library.load();
    }

    private final NativeSide painter;

    /**
     * The destination of the open run, as a buffer of our own, whose position and limit nobody moves.
     * Null between runs.
     */
    private ByteBuffer destination;

    /** Where the picture starts in the destination. */
    private int destinationStart;

    /** A look without effects, at full text opacity. Frees those that were never closed and are gone. */
    public VorelEffect() {
        painter = new Side(this);
        painter.hold(nativeCreate());
    }

    private VorelEffect(VorelEffect original) {
        painter = new Side(this);
        painter.hold(original.nativeCopy(original.painter.address()));
    }

    /**
     * An independent copy: its effects, their ids and the text opacity, but no run. The first run of a
     * copy reverses the list of effects as it stands, so copy a look that was never run: each of its
     * copies then paints the picture that the look itself would paint first.
     *
     * @return a new object, to be closed as well
     */
    @CheckResult
    @NonNull
    public synchronized VorelEffect copy() {
        return new VorelEffect(this);
    }

    /**
     * Frees the look; a run that is open is dropped. Closing twice does nothing. A call of another
     * thread that is under way is waited for; what it calls next is refused.
     */
    @Override
    public synchronized void close() {
        painter.free();
        destination = null;
    }

    private static final class Side extends NativeSide {
        Side(VorelEffect owner) {
            super(owner);
        }

        @Override
        void destroy(long made) {
            nativeDestroy(made);
        }
    }

    // --- The look: between runs only ------------------------------------------------------------

    /**
     * Adds a shadow behind the text: beneath it, over what was added there before.
     *
     * @param angle where the light comes from: 0 from the right, 90 from above
     * @param distance how far the shadow is moved, 0 to 100 pixels
     * @param size blur radius, 0 to 100 pixels
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @return the id of the effect
     */
    public synchronized int addOuterShadowText(
            float angle, float distance, float size, int color, float opacity) {
        return nativeAddOuterShadow(look(), angle, distance, size, color, opacity);
    }

    /**
     * Adds a shadow that falls into the text: inside the glyphs, over what was added there before it.
     *
     * @param angle where the light comes from: 0 from the right, 90 from above
     * @param distance how far the shadow is moved, 0 to 100 pixels
     * @param size blur radius, 0 to 100 pixels
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @return the id of the effect
     */
    public synchronized int addInnerShadowText(
            float angle, float distance, float size, int color, float opacity) {
        return nativeAddInnerShadow(look(), angle, distance, size, color, opacity);
    }

    /**
     * Adds a halo of one colour around the text: beneath it, over what was added there before.
     *
     * @param size reach of the halo, 0 to 100 pixels
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @return the id of the effect
     */
    public synchronized int addOuterGlowText(float size, int color, float opacity) {
        return nativeAddOuterGlow(look(), size, color, opacity, NO_COLORS, NO_NUMBERS, NO_NUMBERS);
    }

    /**
     * Adds a halo around the text that runs through colour stops from the text outwards: beneath the
     * text, over what was added there before it. The three arrays are copied and have one length; stops
     * after the 256th are left out, and without stops the halo has the one colour {@code color}.
     *
     * @param size reach of the halo, 0 to 100 pixels
     * @param color 0xRRGGBB, of a halo without stops
     * @param opacity 0 to 1, multiplies the opacity of each stop
     * @param stopColors 0xRRGGBB of each stop
     * @param stopOpacities 0 to 1 of each stop
     * @param stopLocations 0 to 1, ascending, cut to hundredths
     * @return the id of the effect
     */
    public synchronized int addOuterGlowText(
            float size,
            int color,
            float opacity,
            @NonNull int[] stopColors,
            @NonNull float[] stopOpacities,
            @NonNull float[] stopLocations) {
        long look = look();
        Stops.check(stopColors, stopOpacities, stopLocations);
        return nativeAddOuterGlow(
                look, size, color, opacity, stopColors, stopOpacities, stopLocations);
    }

    /**
     * Adds a halo around the text that runs through colour stops from the text outwards: beneath the
     * text, over what was added there before it.
     *
     * @param size reach of it, 0 to 100 pixels
     * @param opacity 0 to 1, multiplies the opacity of each stop
     * @param stops its colours
     * @return the id of the effect
     */
    public synchronized int addOuterGlowText(float size, float opacity, @NonNull Stops stops) {
        long look = look();
        checkGiven(stops);
        return nativeAddOuterGlow(
                look, size, 0, opacity, stops.colors(), stops.opacities(), stops.places());
    }

    /**
     * Adds a glow of one colour from the edges of the text inwards: inside the glyphs, over what was
     * added there before it.
     *
     * @param size reach of the glow, 0 to 100 pixels
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @return the id of the effect
     */
    public synchronized int addInnerGlowText(float size, int color, float opacity) {
        return nativeAddInnerGlow(look(), size, color, opacity, NO_COLORS, NO_NUMBERS, NO_NUMBERS);
    }

    /**
     * Adds a glow that runs through colour stops from the edges of the text inwards: inside the glyphs,
     * over what was added there before it. The three arrays are copied and have one length; stops after
     * the 256th are left out, and without stops the glow has the one colour {@code color}.
     *
     * @param size reach of the glow, 0 to 100 pixels
     * @param color 0xRRGGBB, of a glow without stops
     * @param opacity 0 to 1, multiplies the opacity of each stop
     * @param stopColors 0xRRGGBB of each stop
     * @param stopOpacities 0 to 1 of each stop
     * @param stopLocations 0 to 1, ascending, cut to hundredths
     * @return the id of the effect
     */
    public synchronized int addInnerGlowText(
            float size,
            int color,
            float opacity,
            @NonNull int[] stopColors,
            @NonNull float[] stopOpacities,
            @NonNull float[] stopLocations) {
        long look = look();
        Stops.check(stopColors, stopOpacities, stopLocations);
        return nativeAddInnerGlow(
                look, size, color, opacity, stopColors, stopOpacities, stopLocations);
    }

    /**
     * Adds a glow that runs through colour stops from the edges of the text inwards: inside the glyphs,
     * over what was added there before it.
     *
     * @param size reach of it, 0 to 100 pixels
     * @param opacity 0 to 1, multiplies the opacity of each stop
     * @param stops its colours
     * @return the id of the effect
     */
    public synchronized int addInnerGlowText(float size, float opacity, @NonNull Stops stops) {
        long look = look();
        checkGiven(stops);
        return nativeAddInnerGlow(
                look, size, 0, opacity, stops.colors(), stops.opacities(), stops.places());
    }

    /**
     * Leaves the effects as they are.
     *
     * @param style any number
     * @param size pixels
     * @param depth 0 to 10
     * @param technique any number
     * @param direction any number
     * @param soften 0 to 16 pixels
     * @param opacity 0 to 1
     * @param angle of the light, in degrees
     * @param altitude of the light, in degrees
     * @param highlightColor 0xRRGGBB
     * @param highlightOpacity 0 to 1
     * @param shadowColor 0xRRGGBB
     * @param shadowOpacity 0 to 1
     * @return {@link #NO_EFFECT}
     * @deprecated the library has the numbers of a bevel but no core that paints one, so the call adds
     *     nothing. What comes near it is a light edge and a dark one: an inner glow or an inside stroke in
     *     the colour of the light, and an inner shadow from the other side.
     */
    @Deprecated
    public synchronized int addBevelText(
            int style,
            float size,
            float depth,
            int technique,
            int direction,
            int soften,
            float opacity,
            float angle,
            float altitude,
            int highlightColor,
            float highlightOpacity,
            int shadowColor,
            float shadowOpacity) {
        return nativeAddBevel(
                look(),
                style,
                size,
                depth,
                technique,
                direction,
                soften,
                opacity,
                angle,
                altitude,
                highlightColor,
                highlightOpacity,
                shadowColor,
                shadowOpacity);
    }

    /**
     * Leaves the effects as they are.
     *
     * @param style any number
     * @param size pixels
     * @param depth 0 to 10
     * @param technique any number
     * @param direction any number
     * @param soften 0 to 16 pixels
     * @param opacity 0 to 1
     * @param angle of the light, in degrees
     * @param altitude of the light, in degrees
     * @param highlightColor 0xRRGGBB
     * @param highlightOpacity 0 to 1
     * @param shadowColor 0xRRGGBB
     * @param shadowOpacity 0 to 1
     * @return {@link #NO_EFFECT}
     * @deprecated the library has the numbers of an emboss but no core that paints one, so the call adds
     *     nothing. What comes near it is a light edge and a dark one: an inner glow or an inside stroke in
     *     the colour of the light, and an inner shadow from the other side.
     */
    @Deprecated
    public synchronized int addEmbossText(
            int style,
            float size,
            float depth,
            int technique,
            int direction,
            int soften,
            float opacity,
            float angle,
            float altitude,
            int highlightColor,
            float highlightOpacity,
            int shadowColor,
            float shadowOpacity) {
        return nativeAddEmboss(
                look(),
                style,
                size,
                depth,
                technique,
                direction,
                soften,
                opacity,
                angle,
                altitude,
                highlightColor,
                highlightOpacity,
                shadowColor,
                shadowOpacity);
    }

    /**
     * Adds a ramp across the box of the text: inside the glyphs, over what was added there before it.
     * The three arrays are copied and have one length, at least 1; stops after the 256th are left out.
     *
     * @param angle 0 runs to the right, 90 upwards
     * @param scale length of the ramp in lengths of the box, 0 to 2; below 0.1 nothing is drawn
     * @param opacity 0 to 1, multiplies the opacity of each stop
     * @param stopColors 0xRRGGBB of each stop
     * @param stopOpacities 0 to 1 of each stop
     * @param stopLocations 0 to 1, ascending, cut to hundredths
     * @return the id of the effect
     */
    public synchronized int addLinearGradientText(
            float angle,
            float scale,
            float opacity,
            @NonNull int[] stopColors,
            @NonNull float[] stopOpacities,
            @NonNull float[] stopLocations) {
        long look = look();
        checkRamp(stopColors, stopOpacities, stopLocations);
        return nativeAddLinearGradient(
                look, angle, scale, opacity, stopColors, stopOpacities, stopLocations);
    }

    /**
     * Adds a ramp across the box of the text: inside the glyphs, over what was added there before it.
     *
     * @param angle 0 runs to the right, 90 upwards
     * @param scale length of the ramp in lengths of the box, 0 to 2; below 0.1 nothing is drawn
     * @param opacity 0 to 1, multiplies the opacity of each stop
     * @param stops its colours
     * @return the id of the effect
     */
    public synchronized int addLinearGradientText(
            float angle, float scale, float opacity, @NonNull Stops stops) {
        long look = look();
        checkGiven(stops);
        return nativeAddLinearGradient(
                look, angle, scale, opacity, stops.colors(), stops.opacities(), stops.places());
    }

    /**
     * Adds a ramp from the centre of the box of the text: inside the glyphs, over what was added there
     * before it. The three arrays are copied and have one length, at least 1; stops after the 256th are left out.
     *
     * @param scale radius in half widths of the box, 0 to 2; below 0.1 nothing is drawn
     * @param opacity 0 to 1, multiplies the opacity of each stop
     * @param stopColors 0xRRGGBB of each stop
     * @param stopOpacities 0 to 1 of each stop
     * @param stopLocations 0 to 1, ascending, cut to hundredths
     * @return the id of the effect
     */
    public synchronized int addRadialGradientText(
            float scale,
            float opacity,
            @NonNull int[] stopColors,
            @NonNull float[] stopOpacities,
            @NonNull float[] stopLocations) {
        long look = look();
        checkRamp(stopColors, stopOpacities, stopLocations);
        return nativeAddRadialGradient(
                look, scale, opacity, stopColors, stopOpacities, stopLocations);
    }

    /**
     * Adds a ramp from the centre of the box of the text: inside the glyphs, over what was added there
     * before it.
     *
     * @param scale radius in half widths of the box, 0 to 2; below 0.1 nothing is drawn
     * @param opacity 0 to 1, multiplies the opacity of each stop
     * @param stops its colours
     * @return the id of the effect
     */
    public synchronized int addRadialGradientText(float scale, float opacity, @NonNull Stops stops) {
        long look = look();
        checkGiven(stops);
        return nativeAddRadialGradient(
                look, scale, opacity, stops.colors(), stops.opacities(), stops.places());
    }

    /**
     * Adds an outline: one outside lies beneath the text, one inside in the glyphs, a centred one over
     * what was added before it on both sides.
     *
     * @param size width of the outline, 0 to 100 pixels
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @param strokeStyle any number; only part of the key
     * @param position {@link #STROKE_CENTRE}, {@link #STROKE_OUTSIDE} or {@link #STROKE_INSIDE}
     * @return the id of the effect
     */
    public synchronized int addStrokeText(
            float size, int color, float opacity, int strokeStyle, int position) {
        return nativeAddStroke(look(), size, color, opacity, strokeStyle, position);
    }

    /**
     * Adds an image tiled over the text from the top left corner of its box: inside the glyphs, over
     * what was added there before it. The pixels are copied. The key does not tell one image from
     * another.
     *
     * @param pixels 0xAARRGGBB, straight, rows back to back, as {@code Bitmap.getPixels} gives them
     * @param width pixels per row, at least 1
     * @param height rows, at least 1; fewer than 2^30 pixels in all
     * @param scale pixels painted per pixel of the image, 0 to 10; below 0.1 nothing is drawn
     * @param opacity 0 to 1
     * @return the id of the effect
     */
    public synchronized int addPatternText(
            @NonNull int[] pixels, int width, int height, float scale, float opacity) {
        long look = look();
        checkSize(width, height);
        if (pixels == null) throw new IllegalArgumentException("pixels: null");
        if ((long) width * height > LARGEST_PATTERN) {
            throw new IllegalArgumentException("size of a pattern: " + width + " x " + height);
        }
        if (pixels.length < width * height) {
            throw new IllegalArgumentException(
                    "pixels: " + pixels.length + ", fewer than " + width + " x " + height);
        }
        return nativeAddPattern(look, pixels, width, height, scale, opacity);
    }

    /**
     * Adds the plain fill of the text: between the effects inside the glyphs and those beneath the text,
     * wherever it is added.
     *
     * @param color 0xRRGGBB
     * @param opacity 0 to 1
     * @return the id of the effect
     */
    public synchronized int addText(int color, float opacity) {
        return nativeAddText(look(), color, opacity);
    }

    /**
     * Takes an effect out of the look.
     *
     * @param id what the add-call returned
     * @return false if there is no effect of that id
     */
    public synchronized boolean removeEffect(int id) {
        return nativeRemoveEffect(look(), id);
    }

    /** Takes every effect out of the look and starts ids at 0 again; the text opacity stays. */
    public synchronized void cleanAllEffect() {
        nativeCleanAllEffect(look());
    }

    /**
     * Sets the opacity of the text. Below 1 what lies beneath the text does not shine through it.
     *
     * @param opacity 0 to 1
     */
    public synchronized void setTextOpacity(float opacity) {
        nativeSetTextOpacity(look(), opacity);
    }

    /**
     * The opacity of the text.
     *
     * @return 0 to 1; 1 until it is set
     */
    public synchronized float getTextOpacity() {
        return nativeGetTextOpacity(painter());
    }

    /**
     * The pixels that the effects need to the left of the glyphs: leave them in the destination.
     *
     * @return pixels, at least 0
     */
    public synchronized int getLeftOffset() {
        return nativeGetLeftOffset(painter());
    }

    /**
     * The pixels that the effects need to the right of the glyphs.
     *
     * @return pixels, at least 0
     */
    public synchronized int getRightOffset() {
        return nativeGetRightOffset(painter());
    }

    /**
     * The pixels that the effects need above the glyphs.
     *
     * @return pixels, at least 0
     */
    public synchronized int getTopOffset() {
        return nativeGetTopOffset(painter());
    }

    /**
     * The pixels that the effects need below the glyphs.
     *
     * @return pixels, at least 0
     */
    public synchronized int getBottomOffset() {
        return nativeGetBottomOffset(painter());
    }

    /**
     * The look as bytes, for a cache of painted runs: equal for two looks made by the same calls in
     * the same order. {@link #begin} changes the order in which the effects stand in the key, so
     * compare keys taken at the same point, best before it. A pattern leaves no trace in the key.
     *
     * @return a new array, empty for a look without effects; it holds no zero byte
     */
    @NonNull
    public synchronized byte[] getMapKey() {
        return nativeGetMapKey(painter());
    }

    /**
     * Adds the fill of the text in this colour at the text opacity, then gives the key. Like every
     * add-call it comes before {@link #begin}.
     *
     * @param color 0xRRGGBB
     * @return the key, as {@link #getMapKey()}
     */
    @NonNull
    public synchronized byte[] getMapKey(int color) {
        return nativeGetMapKeyOfColor(look(), color);
    }

    // --- One run --------------------------------------------------------------------------------

    /**
     * Opens a run. Its pixels are written when {@link #finish} is called. Give it a destination of
     * zeros: a text fill erases whatever lies around the glyphs. A run that is still open is dropped;
     * nothing of it is painted.
     *
     * @param width pixels per row of the destination, at least 1
     * @param height rows of the destination, at least 1
     * @param destination direct and writable, with width * height * 4 bytes remaining; the run uses
     *     those from its position on and does not move the position. Kept until the run ends, its memory
     *     untouched until {@link #finish}.
     */
    public synchronized void begin(int width, int height, @NonNull ByteBuffer destination) {
        long open = painter();
        checkSize(width, height);
        int start = startOf("destination", destination, (long) width * height, BYTES_PER_PIXEL);
        if (destination.isReadOnly()) {
            throw new IllegalArgumentException("destination: read-only");
        }
        ByteBuffer ours = destination.duplicate();
        ours.clear();
        this.destination = null;
        nativeBegin(open, width, height);
        this.destination = ours;
        destinationStart = start;
    }

    /**
     * Puts a glyph into the open run. What lies outside the destination is left out; where glyphs
     * overlap the larger coverage counts.
     *
     * @param x left edge of the glyph in the destination
     * @param y top edge of the glyph in the destination
     * @param coverage direct, one byte for each pixel, 0 outside to 255 inside, rows of
     *     {@code width} bytes back to back; those from its position on are read, the position is not
     *     moved. Only read during the call.
     * @param width pixels per row, 0 to 65535
     * @param height rows, 0 to 65535
     */
    public synchronized void glyph(
            int x, int y, @NonNull ByteBuffer coverage, int width, int height) {
        long run = run();
        if (width < 0 || width > LARGEST_GLYPH || height < 0 || height > LARGEST_GLYPH) {
            throw new IllegalArgumentException("size of a glyph: " + width + " x " + height);
        }
        int start = startOf("coverage", coverage, (long) width * height, 1);
        nativeGlyph(run, x, y, coverage, start, width, height);
    }

    /**
     * Paints every effect of the open run into its destination and ends the run. Where the memory of the
     * destination has been closed the run stays open: begin another one.
     */
    public synchronized void finish() {
        long run = run();
        destination.get(destinationStart);
        nativeFinish(run, destination, destinationStart);
        destination = null;
    }

    // --- Checks ---------------------------------------------------------------------------------

    private static final int[] NO_COLORS = {};
    private static final float[] NO_NUMBERS = {};

    private long painter() {
        return painter.address();
    }

    /** The painter while its look may change: an effect added within a run would miss its order. */
    private long look() {
        long open = painter();
        if (destination != null) throw new IllegalStateException("a run is open: finish it first");
        return open;
    }

    private long run() {
        long open = painter();
        if (destination == null) throw new IllegalStateException("no run is open: begin one first");
        return open;
    }

    private static void checkSize(int width, int height) {
        if (width < 1 || height < 1) {
            throw new IllegalArgumentException("size: " + width + " x " + height);
        }
    }

    /**
     * The position of a buffer that has enough bytes from there on. Another thread may move position and
     * limit meanwhile: each is read once, and what is used lies between the two that were read.
     */
    private static int startOf(String name, ByteBuffer buffer, long pixels, int bytesPerPixel) {
        if (buffer == null) throw new IllegalArgumentException(name + ": null");
        if (!buffer.isDirect()) throw new IllegalArgumentException(name + ": not direct");
        int start = buffer.position();
        int remaining = buffer.limit() - start;
        // Compared in pixels: the byte count of the largest sizes does not fit in a long.
        if (remaining / bytesPerPixel < pixels) {
            throw new IllegalArgumentException(
                    name + ": " + remaining + " bytes remaining, too few for " + pixels
                            + " pixels of " + bytesPerPixel);
        }
        if (pixels > 0) touch(name, buffer, start);
        return start;
    }

    /** Reads a byte: where the memory was closed that fails here, and not on the native side. */
    private static void touch(String name, ByteBuffer buffer, int index) {
        try {
            buffer.get(index);
        } catch (IndexOutOfBoundsException e) {
            throw new IllegalArgumentException(name + ": its limit was moved during the call");
        }
    }

    private static void checkGiven(Stops stops) {
        if (stops == null) throw new IllegalArgumentException("stops: null");
    }

    private static void checkRamp(int[] colors, float[] opacities, float[] locations) {
        Stops.check(colors, opacities, locations);
        if (colors.length == 0) throw new IllegalArgumentException("stops: none");
    }

    // --- Native side: every argument has been checked ---------------------------------------------

    // Those of an object are not static: as an argument of the call it stays reachable until that returns.

    private static native long nativeCreate();

    private native long nativeCopy(long painter);

    private static native void nativeDestroy(long painter);

    private native int nativeAddOuterShadow(
            long painter, float angle, float distance, float size, int color, float opacity);

    private native int nativeAddInnerShadow(
            long painter, float angle, float distance, float size, int color, float opacity);

    private native int nativeAddOuterGlow(
            long painter,
            float size,
            int color,
            float opacity,
            int[] colors,
            float[] opacities,
            float[] locations);

    private native int nativeAddInnerGlow(
            long painter,
            float size,
            int color,
            float opacity,
            int[] colors,
            float[] opacities,
            float[] locations);

    private native int nativeAddBevel(
            long painter,
            int style,
            float size,
            float depth,
            int technique,
            int direction,
            int soften,
            float opacity,
            float angle,
            float altitude,
            int highlightColor,
            float highlightOpacity,
            int shadowColor,
            float shadowOpacity);

    private native int nativeAddEmboss(
            long painter,
            int style,
            float size,
            float depth,
            int technique,
            int direction,
            int soften,
            float opacity,
            float angle,
            float altitude,
            int highlightColor,
            float highlightOpacity,
            int shadowColor,
            float shadowOpacity);

    private native int nativeAddLinearGradient(
            long painter,
            float angle,
            float scale,
            float opacity,
            int[] colors,
            float[] opacities,
            float[] locations);

    private native int nativeAddRadialGradient(
            long painter,
            float scale,
            float opacity,
            int[] colors,
            float[] opacities,
            float[] locations);

    private native int nativeAddStroke(
            long painter, float size, int color, float opacity, int strokeStyle, int position);

    private native int nativeAddPattern(
            long painter, int[] pixels, int width, int height, float scale, float opacity);

    private native int nativeAddText(long painter, int color, float opacity);

    private native boolean nativeRemoveEffect(long painter, int id);

    private native void nativeCleanAllEffect(long painter);

    private native void nativeSetTextOpacity(long painter, float opacity);

    private native float nativeGetTextOpacity(long painter);

    private native int nativeGetLeftOffset(long painter);

    private native int nativeGetRightOffset(long painter);

    private native int nativeGetTopOffset(long painter);

    private native int nativeGetBottomOffset(long painter);

    private native byte[] nativeGetMapKey(long painter);

    private native byte[] nativeGetMapKeyOfColor(long painter, int color);

    private native void nativeBegin(long painter, int width, int height);

    private native void nativeGlyph(
            long painter, int x, int y, ByteBuffer coverage, int offset, int width, int height);

    private native void nativeFinish(long painter, ByteBuffer destination, int offset);
}
