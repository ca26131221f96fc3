package org.voreleffect;

import androidx.annotation.NonNull;
import androidx.annotation.Nullable;
import java.util.Arrays;

/**
 * The colours of a ramp, each with an opacity and a place. Immutable; 1 to 256 stops, of more the first
 * 256 count.
 *
 * <pre>{@code
 * Stops dawn = Stops.of(0xFFD75E, 0xE8412C);
 * Stops glass = Stops.builder()
 *         .add(0xFFFFFF, 0.9f, 0)
 *         .add(0xFFFFFF, 0.2f, 0.5f)
 *         .add(0xA0C8FF, 1)
 *         .build();
 * }</pre>
 */
public final class Stops {
    private static final int MOST = 256;

    /** Those of a glow of one colour. */
    static final Stops NONE = new Stops(new int[0], new float[0], new float[0]);

    private final int[] colors;
    private final float[] opacities;
    private final float[] places;

    private Stops(int[] colors, float[] opacities, float[] places) {
        int count = Math.min(colors.length, MOST);
        this.colors = Arrays.copyOf(colors, count);
        this.opacities = Arrays.copyOf(opacities, count);
        this.places = Arrays.copyOf(places, count);
    }

    /**
     * Opaque colours at even distances, the first at 0 and the last at 1.
     *
     * @param colors 0xRRGGBB each, at least one
     * @return the stops
     */
    @NonNull
    public static Stops of(@NonNull int... colors) {
        if (colors == null) throw new IllegalArgumentException("stops: null");
        float[] opacities = new float[colors.length];
        float[] places = new float[colors.length];
        Arrays.fill(opacities, 1);
        for (int i = 1; i < colors.length; ++i) places[i] = (float) i / (colors.length - 1);
        return of(colors, opacities, places);
    }

    /**
     * What stands in three arrays of one length, which are copied.
     *
     * @param colors 0xRRGGBB each, at least one
     * @param opacities 0 to 1 each
     * @param places 0 to 1 each, ascending
     * @return the stops
     */
    @NonNull
    public static Stops of(@NonNull int[] colors, @NonNull float[] opacities, @NonNull float[] places) {
        check(colors, opacities, places);
        if (colors.length == 0) throw new IllegalArgumentException("stops: none");
        return new Stops(colors, opacities, places);
    }

    /**
     * Collects stops one by one.
     *
     * @return a builder without stops
     */
    @NonNull
    public static Builder builder() {
        return new Builder();
    }

    /**
     * How many there are.
     *
     * @return 1 to 256
     */
    public int size() {
        return colors.length;
    }

    static void check(int[] colors, float[] opacities, float[] places) {
        if (colors == null || opacities == null || places == null) {
            throw new IllegalArgumentException("stops: null");
        }
        if (colors.length != opacities.length || colors.length != places.length) {
            throw new IllegalArgumentException(
                    "stops: " + colors.length + " colours, " + opacities.length + " opacities, "
                            + places.length + " places");
        }
    }

    /** Our own arrays: not to be changed. */
    @NonNull
    int[] colors() {
        return colors;
    }

    /** Our own arrays: not to be changed. */
    @NonNull
    float[] opacities() {
        return opacities;
    }

    /** Our own arrays: not to be changed. */
    @NonNull
    float[] places() {
        return places;
    }

    @Override
    public boolean equals(@Nullable Object other) {
        if (!(other instanceof Stops)) return false;
        Stops same = (Stops) other;
        return Arrays.equals(colors, same.colors)
                && Arrays.equals(opacities, same.opacities)
                && Arrays.equals(places, same.places);
    }

    @Override
    public int hashCode() {
        return (Arrays.hashCode(colors) * 31 + Arrays.hashCode(opacities)) * 31 + Arrays.hashCode(places);
    }

    @Override
    @NonNull
    public String toString() {
        StringBuilder text = new StringBuilder("Stops(");
        for (int i = 0; i < colors.length; ++i) {
            text.append(i == 0 ? "" : ", ").append(String.format("0x%06X", colors[i] & 0xFFFFFF));
            text.append(' ').append(opacities[i]).append(" at ").append(places[i]);
        }
        return text.append(')').toString();
    }

    /** Collects stops one by one. */
    public static final class Builder {
        private int[] colors = new int[4];
        private float[] opacities = new float[4];
        private float[] places = new float[4];
        private int count;

        Builder() {}

        /**
         * Adds an opaque colour.
         *
         * @param color 0xRRGGBB
         * @param place 0 to 1, not before the last one
         * @return this builder
         */
        @NonNull
        public Builder add(int color, float place) {
            return add(color, 1, place);
        }

        /**
         * Adds a colour.
         *
         * @param color 0xRRGGBB
         * @param opacity 0 to 1
         * @param place 0 to 1, not before the last one
         * @return this builder
         */
        @NonNull
        public Builder add(int color, float opacity, float place) {
            if (count == colors.length) grow(2 * count);
            colors[count] = color;
            opacities[count] = opacity;
            places[count] = place;
            ++count;
            return this;
        }

        /**
         * The stops that were added, at least one. The builder may go on.
         *
         * @return the stops
         */
        @NonNull
        public Stops build() {
            return of(
                    Arrays.copyOf(colors, count),
                    Arrays.copyOf(opacities, count),
                    Arrays.copyOf(places, count));
        }

        private void grow(int capacity) {
            colors = Arrays.copyOf(colors, capacity);
            opacities = Arrays.copyOf(opacities, capacity);
            places = Arrays.copyOf(places, capacity);
        }
    }
}
