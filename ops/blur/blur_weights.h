#pragma once

#include <cstdint>

#include "core/size_limit.h"
#include "ops/blur/narrow_loops.h"

/// The weights of the separable integer Gaussian blur.
///
/// A tap at distance k weighs byDistance[|k|]. The weight falls as exp(-k^2 / d), where d = R^2 / ln 100
/// makes the weight at the radius one hundredth of the centre's. Each pass divides its sum by the
/// total of all weights, truncating, so the order of the passes shows in single units and is fixed.
namespace VFontEffect::internal {

struct BlurWeights {
    static constexpr int kLongestRadius = static_cast<int>(kLargestSizePx);

    uint32_t byDistance[kLongestRadius + 1];  // 0 to radius
    int radius;
    uint32_t total;
};

/// Weights on a scale of 100, rounded in single precision, of a radius up to kLongestRadius.
BlurWeights gaussianOf100(int radius);

/// Weights on a scale of 128, rounded in double precision, likewise.
BlurWeights gaussianOf128(int radius);

/// The smallest float that is not below 1 / total. With it the product in single precision of any sum up
/// to 256 * total - 1, truncated, is the whole quotient, while total is at most kLargestTotal: a sum of
/// n * total gives n or more, and one less gives n - 1 / total plus at most 2^-15, which is more than
/// half a step of single precision below n.
float inverseAbove(uint32_t total);
constexpr uint32_t kLargestTotal = 26000;

/// No total of weights on that scale is above this. As exp(-x^2 / d) falls, the sum over the distances 1
/// to R is below its integral from 0 on, R / 2 * sqrt(pi / ln 100) = 0.41297 R: 826 thousandths for both
/// sides. The centre adds the scale, and rounding at most half a unit to each of the other 2 R weights.
constexpr uint32_t totalBound(uint32_t scale, uint32_t radius) {
    return scale + (scale * radius / 1000 + 1) * 826 + radius;
}

/// For sums up to 256 * divisor - 1, a divisor of 128 to 255.
NarrowDivision narrowDivision(uint32_t divisor);

}  // namespace VFontEffect::internal
