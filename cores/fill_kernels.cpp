#include "cores/fill_kernels.h"

#include <cstdint>

#include "blend/rows.h"
#include "blend/rules.h"

/// Fills of the covered pixels. A ramp's place is computed for a vector of pixels in the same single
/// precision steps as for one: multiply, add, root, each rounded by itself. Stretches without coverage
/// are left at once. Cost: some ten instructions, a table look-up a pixel and a destination-over.
namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

constexpr int32_t kLastEntry = 255;
constexpr int32_t kMiddleEntry = 128;

/// 0, 1, 2, ... as whole numbers.
VOREL_INLINE Integers ascending() {
    Integers lanes{};
    for (int i = 0; i < kWords; ++i)
        lanes[i] = i;
    return lanes;
}

/// x - centre for the columns x, x + 1, ...
VOREL_INLINE Floats columnsFrom(int64_t x, float centre) {
    return __builtin_convertvector(ascending() + static_cast<int32_t>(x), Floats) - centre;
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

    /// Entries of kWords pixels from column x on. Saturation on both sides of the ramp first: adding the
    /// middle afterwards cannot overflow.
    VOREL_INLINE Integers entries(int64_t x) const {
        const Integers place = toInt(rowTerm + stepX * columnsFrom(x, centreX));
        const Integers below = smaller(place, spread<Integers>(kLastEntry - kMiddleEntry));
        return larger(below, spread<Integers>(-kMiddleEntry)) + kMiddleEntry;
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

    VOREL_INLINE Integers entries(int64_t x) const {
        const Floats across = columnsFrom(x, centreX);
        const Integers place = toInt(step * squareRoot(rowTerm + across * across));
        return larger(smaller(place, spread<Integers>(kLastEntry)), Integers{});
    }
};

template <class RampRow>
struct RampPainter {
    static constexpr bool kReadsImage = false;
    static constexpr bool kReadsMask = true;
    static constexpr Empty kEmpty = DstOverWhereCovered::kEmpty;
    RampRow row;
    int64_t left;

    VOREL_INLINE bool isEmpty(const Place& place) const { return hasEmptyMask(place); }
    VOREL_INLINE Pixels paint(const Place& place) const {
        uint8_t colours[4 * kPixels];
        for (int i = 0; i < kPixels; i += kWords)
            store(colours + 4 * i, gathered(row.pixels, row.entries(left + place.x + i)));
        return DstOverWhereCovered::apply(loadPixels(place.destination()), loadPixels(colours),
                                          loadAmounts(place.mask()));
    }
};

template <class RampRow, class Ramp>
void fillRamp(const FillJob& job, const Ramp& ramp) {
    const BlendJob& blend = job.blend;
    for (int64_t y = 0; y < blend.height; ++y) {
        const RampPainter<RampRow> painter = {RampRow::of(ramp, job.top + y), job.left};
        paintRow(painter,
                 {blend.destination + y * blend.destinationStride, nullptr,
                  blend.mask + y * blend.maskStride},
                 blend.width);
    }
}

void mixRows(const uint8_t* near, const uint8_t* far, const Tap& weights, int64_t bytes, MixedRow out) {
    const auto nearWeight = static_cast<uint16_t>(weights.nearWeight);
    const auto farWeight = static_cast<uint16_t>(weights.farWeight);
    for (int64_t i = 0; i < bytes; ++i)
        out[i] = static_cast<uint16_t>(near[i] * nearWeight + far[i] * farWeight);
}

/// The four channels of one pixel.
using Channels = uint32_t __attribute__((vector_size(16)));
using PixelBytes = uint8_t __attribute__((vector_size(4)));

VOREL_INLINE Channels channelsAt(const uint16_t* mixed, uint32_t column) {
    using Eight = uint16_t __attribute__((vector_size(16)));
    using Two = uint64_t __attribute__((vector_size(16)));
    const auto four = as<Eight>(Two{load<uint64_t>(mixed + 4 * size_t{column}), 0});
    return as<Channels>(__builtin_shufflevector(four, Eight{}, 0, 8, 1, 9, 2, 10, 3, 11));
}

// Deliberate: weights of 255 and a shift by 16 sample an opaque pattern as 253. Pattern pixels stand in
// memory as A, R, G, B, unlike the destination's.
void sampleRow(const uint16_t* mixed, const Tap* taps, int64_t count, const uint8_t* alphas,
               uint32_t* out) {
    for (int64_t i = 0; i < count; ++i) {
        const Tap& tap = taps[i];
        const Channels sum =
            channelsAt(mixed, tap.near) * tap.nearWeight + channelsAt(mixed, tap.far) * tap.farWeight;
        const Channels straight = sum >> 16;
        const uint32_t alpha = alphas[straight[0]];
        const Channels colours = product(straight, spread<Channels>(alpha));
        const Channels ordered = {colours[1], colours[2], colours[3], alpha};
        store(out + i, __builtin_convertvector(ordered, PixelBytes));
    }
}

}  // namespace

extern const FillKernels kFillKernels = {
    fillRamp<LinearRow, LinearRamp>,
    fillRamp<RadialRow, RadialRamp>,
    mixRows,
    sampleRow,
};

}  // namespace VFontEffect::internal::VOREL_LEVEL
