#include "ops/blur/blur_weights.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "core/numeric.h"
#include "core/portable_math.h"

namespace VFontEffect::internal {
namespace {

constexpr float kLn100 = 4.60517F;

/// `round` turns the exponential of a tap into its whole weight.
template <class Round>
BlurWeights makeWeights(int radius, uint32_t centre, Round round) {
    BlurWeights weights;
    weights.radius = radius;
    weights.total = weights.byDistance[0] = centre;
    const float spread = static_cast<float>(radius) * static_cast<float>(radius) / kLn100;
    for (int i = 1; i <= radius; ++i) {
        const auto weight =
            static_cast<uint32_t>(round(portableExp(static_cast<float>(-(i * i)) / spread)));
        weights.byDistance[i] = weight;
        weights.total += 2 * weight;
    }
    return weights;
}

}  // namespace

BlurWeights gaussianOf100(int radius) {
    return makeWeights(radius, 100, [](float tap) { return toInt(tap * 100.0F + 0.5F); });
}

BlurWeights gaussianOf128(int radius) {
    return makeWeights(radius, 128,
                       [](float tap) { return toInt(static_cast<double>(tap * 128.0F) + 0.5); });
}

float inverseAbove(uint32_t total) {
    const float nearest = 1.0F / static_cast<float>(total);
    // A float times a whole number of 16 bits is exact in double precision.
    return static_cast<double>(nearest) * total >= 1.0 ? nearest : std::nextafter(nearest, 1.0F);
}

// Of the two whole numbers next to 2^23 / d one is close enough. The larger one, m, if it is too large
// by at most 2^7 / d: x * m / 2^23 then exceeds x / d by less than 1 / d, as x is below 2^16. Else the
// smaller one, and x + 1 makes up for it.
NarrowDivision narrowDivision(uint32_t divisor) {
    constexpr uint32_t kScale = 0x10000U << kNarrowShift;
    const uint32_t smaller = kScale / divisor;
    const uint32_t larger = smaller + 1;
    if (larger <= 0xFFFF && larger * divisor - kScale <= 1U << kNarrowShift)
        return {0, static_cast<uint16_t>(larger)};
    return {1, static_cast<uint16_t>(std::min(smaller, 0xFFFFU))};
}

}  // namespace VFontEffect::internal
