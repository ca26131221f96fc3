#include "ops/ramp/ramp_loops.h"

#include <cstdint>
#include <cstring>

#include "blend/rows.h"
#include "blend/rules.h"

/// Fills of the covered pixels. A ramp's place is computed for a vector of pixels in the same single
/// precision steps as for one: multiply, add, root, each rounded by itself. Stretches without coverage
/// are left at once. Cost: some ten instructions, a table look-up a pixel and a destination-over.
namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

/// x - centre for the columns x, x + 1, ...
VOREL_INLINE F32s columnsFrom(int64_t x, float centre) {
    return __builtin_convertvector(iota<I32s>() + static_cast<int32_t>(x), F32s) - centre;
}

/// A row of a ramp that begins at place kFirst, and the places of kU32Lanes pixels from column x on.
struct LinearRow {
    static constexpr int32_t kFirst = -128;

    RampPixels pixels;
    float rowTerm;
    float stepX;
    float centreX;

    static LinearRow of(const LinearRamp& ramp, int64_t y) {
        return {ramp.pixels, ramp.stepY * (static_cast<float>(y) - ramp.centreY), ramp.stepX,
                ramp.centreX};
    }

    VOREL_INLINE I32s places(int64_t x) const {
        return toInt(rowTerm + stepX * columnsFrom(x, centreX));
    }
};

struct RadialRow {
    static constexpr int32_t kFirst = 0;

    RampPixels pixels;
    float rowTerm;
    float step;
    float centreX;

    static RadialRow of(const RadialRamp& ramp, int64_t y) {
        const float down = static_cast<float>(y) - ramp.centreY;
        return {ramp.pixels, down * down, ramp.step, ramp.centreX};
    }

    VOREL_INLINE I32s places(int64_t x) const {
        const F32s across = columnsFrom(x, centreX);
        return toInt(step * squareRoot(rowTerm + across * across));
    }
};

/// Destination-over: what is premultiplied has no colour where it is transparent.
VOREL_INLINE Pixels underPremultiplied(const Pixels& d, const Pixels& source) {
    return under(d, source, ~isTransparent(source));
}

template <class RampRow>
struct RampPainter : MaskReader<Empty::keeps, true> {
    RampRow row;

    VOREL_INLINE Pixels paint(const Place& place) const {
        const Pixels destination = loadPixels(place.destination());
        const Where covered = ~isZero(loadAmounts(place.mask()));
        const Pixels colours = rampEntries<RampRow::kFirst>(
            row.pixels, [&](int64_t i) VOREL_INLINE_LAMBDA { return row.places(place.x + i); });
        return underPremultiplied(destination, kept(covered, colours));
    }
};

template <class RampRow, class Ramp>
void fillRamp(const BlendJob& job, int64_t firstRow, const Ramp& ramp) {
    for (int64_t y = 0; y < job.height; ++y) {
        const RampPainter<RampRow> painter = {{}, RampRow::of(ramp, firstRow + y)};
        const Row row = {job.destination + y * job.destinationStride, nullptr,
                         job.mask + y * job.maskStride};
        paintRow(painter, row, job.width);
    }
}

/// Weights of 256ths: the colours keep all four bytes alike, two of them at a time. Positions beyond a
/// segment have the colour of its end.
void mixStops(const RampSegment& segment, const float* positions, int64_t count, uint32_t* colours) {
    const auto lowerEven = splat<U32s>(segment.lower & kEvenBytes);
    const auto lowerOdd = splat<U32s>(segment.lower >> 8 & kEvenBytes);
    const auto upperEven = splat<U32s>(segment.upper & kEvenBytes);
    const auto upperOdd = splat<U32s>(segment.upper >> 8 & kEvenBytes);
    const float start = segment.start;
    const float span = segment.span;
    const auto mixedAt = [=](int64_t i) VOREL_INLINE_LAMBDA {
        const F32s place = (load<F32s>(positions + i) - start) / span * 256.0F;
        const U32s weight = toIntUpTo<256>(place);
        const U32s rest = 256 - weight;
        const U32s even = (weight * upperEven + rest * lowerEven) >> 8 & kEvenBytes;
        const U32s odd = (weight * upperOdd + rest * lowerOdd) & ~kEvenBytes;
        return even | odd;
    };
    int64_t i = 0;
    for (const int64_t last = count - kU32Lanes; i <= last; i += kU32Lanes)
        store(colours + i, mixedAt(i));
    if (i >= count) return;
    const U32s rest = mixedAt(i);
    std::memcpy(colours + i, &rest, static_cast<size_t>(4 * (count - i)));
}

void premultiplied(const uint32_t* colours, int64_t count, uint32_t* pixels) {
    VOREL_ASSERT(count % kRampSlack == 0);
    for (int64_t i = 0; i < count; i += kPixels) {
        const Pixels straight = loadWords(reinterpret_cast<const uint8_t*>(colours + i));
        storePixels(reinterpret_cast<uint8_t*>(pixels + i),
                    withAlphaOf(scaled(straight, alphaOf(straight)), straight));
    }
}

/// alpha * min(256 * value / 180, 256). The quotient is the upper half of a product of twice the value
/// with 2^23 / 180, rounded up. The rounding adds less than 0.005 for values of a byte, and as 256 / 180
/// = 64 / 45, fractions are multiples of 1 / 45: none of them reaches the next whole number.
VOREL_INLINE U16s fadedLanes(U16s values, U16s alpha) {
    constexpr uint16_t kMultiplier = ((1U << 23) + kFadedValues - 1) / kFadedValues;
    const U16s quotient = multiplyHigh(values + values, splat<U16s>(kMultiplier));
    return alpha * bitCast<U16s>(min(bitCast<I16s>(quotient), splat<I16s>(int16_t{256})));
}

void fade(uint8_t* values, int64_t count, uint32_t alpha) {
    VOREL_ASSERT(alpha <= 255);
    const auto alphas = splat<U16s>(static_cast<uint16_t>(alpha));
    const auto faded = [alphas](U8s v) VOREL_INLINE_LAMBDA {
        return upperBytes(fadedLanes(widenLow(v), alphas), fadedLanes(widenHigh(v), alphas));
    };
    int64_t x = 0;
    for (const int64_t last = count - kBytes; x <= last; x += kBytes)
        store(values + x, faded(load<U8s>(values + x)));
    if (x == count) return;
    const U8s rest = faded(loadFirst(values + x, count - x));
    std::memcpy(values + x, &rest, static_cast<size_t>(count - x));
}

/// The mask is values, each painted in its colour.
struct ValuePainter : MaskReader<> {
    RampPixels pixels;

    VOREL_INLINE Pixels paint(const Place& place) const {
        const Pixels colours = rampEntries(pixels, place.mask());
        return underPremultiplied(loadPixels(place.destination()), colours);
    }
};

void byValue(const BlendJob& job, RampPixels pixels) {
    VOREL_ASSERT(pixels[0] >> 24 == 0);
    paintRows(ValuePainter{{}, pixels}, job);
}

}  // namespace

extern const RampLoops kRampLoops = {
    fillRamp<LinearRow, LinearRamp>,
    fillRamp<RadialRow, RadialRamp>,
    mixStops,
    premultiplied,
    byValue,
    fade,
};

}  // namespace VFontEffect::internal::VOREL_LEVEL
