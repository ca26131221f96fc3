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

constexpr int32_t kLastEntry = 255;
constexpr int32_t kMiddleEntry = 128;

VOREL_INLINE I32s clamped(I32s value, int32_t low, int32_t high) {
    return max(min(value, splat<I32s>(high)), splat<I32s>(low));
}

/// x - centre for the columns x, x + 1, ...
VOREL_INLINE F32s columnsFrom(int64_t x, float centre) {
    return __builtin_convertvector(iota<I32s>() + static_cast<int32_t>(x), F32s) - centre;
}

struct LinearRow {
    RampPixels pixels;
    float rowTerm;
    float stepX;
    float centreX;

    static LinearRow of(const LinearRamp& ramp, int64_t y) {
        return {ramp.pixels, ramp.stepY * (static_cast<float>(y) - ramp.centreY), ramp.stepX,
                ramp.centreX};
    }

    /// Entries of kU32Lanes pixels from column x on. Saturation on both sides of the ramp first: adding
    /// the middle afterwards cannot overflow.
    VOREL_INLINE I32s entries(int64_t x) const {
        const I32s place = toInt(rowTerm + stepX * columnsFrom(x, centreX));
        return clamped(place, -kMiddleEntry, kLastEntry - kMiddleEntry) + kMiddleEntry;
    }
};

struct RadialRow {
    RampPixels pixels;
    float rowTerm;
    float step;
    float centreX;

    static RadialRow of(const RadialRamp& ramp, int64_t y) {
        const float down = static_cast<float>(y) - ramp.centreY;
        return {ramp.pixels, down * down, ramp.step, ramp.centreX};
    }

    VOREL_INLINE I32s entries(int64_t x) const {
        const F32s across = columnsFrom(x, centreX);
        return clamped(toInt(step * squareRoot(rowTerm + across * across)), 0, kLastEntry);
    }
};

template <class RampRow>
struct RampPainter {
    static constexpr bool kReadsImage = false;
    static constexpr bool kReadsMask = true;
    static constexpr bool kIsSparse = true;
    static constexpr Empty kEmpty = DstOverWhereCovered::kEmpty;
    RampRow row;

    template <int64_t kCount>
    VOREL_INLINE bool isEmpty(const Place& place) const {
        return hasEmptyMask<kCount>(place);
    }
    VOREL_INLINE bool paintWhole(const Place&) const { return false; }
    VOREL_INLINE Pixels paint(const Place& place) const {
        const Pixels destination = loadPixels(place.destination());
        const Pixels colours = madeOfWords(
            [&](int64_t i) { return gatherNear(row.pixels, kLastEntry + 1, row.entries(place.x + i)); });
        return DstOverWhereCovered::apply(destination, colours, loadAmounts(place.mask()));
    }
};

template <class RampRow, class Ramp>
void fillRamp(const BlendJob& job, const Ramp& ramp) {
    for (int64_t y = 0; y < job.height; ++y) {
        const RampPainter<RampRow> painter = {RampRow::of(ramp, y)};
        const Row row = {job.destination + y * job.destinationStride, nullptr,
                         job.mask + y * job.maskStride};
        paintRow(painter, row, job.width);
    }
}

constexpr uint32_t kEvenBytes = 0x00FF00FFU;

/// Weights of 256ths: the colours keep all four bytes alike, two of them at a time. Positions beyond a
/// segment have the colour of its end.
void mixStops(const RampSegment& segment, const float* positions, int64_t count, uint32_t* colours) {
    const auto lowerEven = splat<U32s>(segment.lower & kEvenBytes);
    const auto lowerOdd = splat<U32s>(segment.lower >> 8 & kEvenBytes);
    const auto upperEven = splat<U32s>(segment.upper & kEvenBytes);
    const auto upperOdd = splat<U32s>(segment.upper >> 8 & kEvenBytes);
    for (int64_t i = 0; i < count; i += kU32Lanes) {
        const F32s place = (load<F32s>(positions + i) - segment.start) / segment.span * 256.0F;
        const auto weight = bitCast<U32s>(clamped(toInt(place), 0, 256));
        const U32s rest = 256 - weight;
        const U32s even = (weight * upperEven + rest * lowerEven) >> 8 & kEvenBytes;
        const U32s odd = (weight * upperOdd + rest * lowerOdd) & ~kEvenBytes;
        const U32s mixed = even | odd;
        std::memcpy(colours + i, &mixed, static_cast<size_t>(4 * min(kU32Lanes, count - i)));
    }
}

void premultiplied(const uint32_t* colours, int64_t count, uint32_t* pixels) {
    for (int64_t i = 0; i < count; i += kPixels) {
        const Pixels straight = loadWords(reinterpret_cast<const uint8_t*>(colours + i));
        storePixels(reinterpret_cast<uint8_t*>(pixels + i),
                    withAlphaOf(scaled(straight, alphaOf(straight)), straight));
    }
}

/// Two bytes of each word times the weight in both of its halves: 255 * 255 fits in 16 bits.
VOREL_INLINE U16s weighted(U32s bytes, U32s weight) {
    return bitCast<U16s>(bytes) * bitCast<U16s>(weight);
}

// Deliberate: pattern pixels stand in memory as A, R, G, B, unlike the destination's.
void mixColumns(const uint32_t* patternRow, const ColumnTaps& taps, int64_t count, const MixedRow& out) {
    const auto pixelsAt = [patternRow](const int32_t* columns) {
        const U32s argb = gather(patternRow, load<I32s>(columns));
        return argb >> 8 | argb << 24;
    };
    for (int64_t x = 0; x < count; x += kU32Lanes) {
        const U32s near = pixelsAt(taps.near + x);
        const U32s far = pixelsAt(taps.far + x);
        const auto nearWeight = load<U32s>(taps.nearWeights + x);
        const auto farWeight = load<U32s>(taps.farWeights + x);
        store(out.redBlue + x,
              weighted(near & kEvenBytes, nearWeight) + weighted(far & kEvenBytes, farWeight));
        store(out.greenAlpha + x,
              weighted(near >> 8 & kEvenBytes, nearWeight) + weighted(far >> 8 & kEvenBytes, farWeight));
    }
}

/// (near * nearWeight + far * farWeight) >> 16: the upper halves of both products, and the carry of the
/// lower ones.
VOREL_INLINE U16s mixed(const uint32_t* near, const uint32_t* far, U16s nearWeight, U16s farWeight) {
    const auto n = load<U16s>(near);
    const auto f = load<U16s>(far);
    const U16s low = n * nearWeight;
    const U16s carry = bitCast<U16s>(low + f * farWeight < low);
    return multiplyHigh(n, nearWeight) + multiplyHigh(f, farWeight) - carry;
}

// Deliberate: weights of 255 and a shift by 16 sample an opaque pattern as 253.
void mixRows(const MixedRow& near, const MixedRow& far, uint32_t nearWeight, uint32_t farWeight,
             float opacity, int64_t count, uint32_t* out) {
    const auto n = splat<U16s>(static_cast<uint16_t>(nearWeight));
    const auto f = splat<U16s>(static_cast<uint16_t>(farWeight));
    for (int64_t x = 0; x < count; x += kU32Lanes) {
        const U16s redBlue = mixed(near.redBlue + x, far.redBlue + x, n, f);
        const U16s greenAlpha = mixed(near.greenAlpha + x, far.greenAlpha + x, n, f);
        const auto straightAlpha = bitCast<I32s>(bitCast<U32s>(greenAlpha) >> 16);
        const I32s seenAlpha = toInt(__builtin_convertvector(straightAlpha, F32s) * opacity);
        const auto alpha = bitCast<U32s>(clamped(seenAlpha, 0, 255));
        const auto factor = bitCast<U16s>(alpha | alpha << 16);
        const auto green = bitCast<U32s>(product(greenAlpha, factor)) & 0xFFFFU;
        store(out + x, bitCast<U32s>(product(redBlue, factor)) | green << 8 | alpha << 24);
    }
}

}  // namespace

extern const RampLoops kRampLoops = {
    fillRamp<LinearRow, LinearRamp>,
    fillRamp<RadialRow, RadialRamp>,
    mixStops,
    premultiplied,
    mixColumns,
    mixRows,
};

}  // namespace VFontEffect::internal::VOREL_LEVEL
