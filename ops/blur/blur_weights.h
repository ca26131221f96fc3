#pragma once

#include <cstdint>

#include "core/pixel_buffer.h"
#include "ops/blur/dot_loops.h"

/// The separable integer Gaussian blur of shadows and glows.
///
/// A tap at distance k weighs weights[|k|]. The weight falls as exp(-k^2 / d), where d = R^2 / ln 100
/// makes the weight at the radius one hundredth of the centre's. Each pass divides its sum by the
/// total of all weights, truncating, so the order of the passes shows in single units and is fixed.
namespace VFontEffect::internal {

constexpr int kShadowScale = 100;
constexpr int kGlowScale = 128;

struct BlurWeights {
    PixelBuffer<uint32_t> weights;
    int radius;
    uint32_t total;

    explicit operator bool() const { return static_cast<bool>(weights); }
};

/// Weights on a scale of 100, rounded in single precision.
BlurWeights shadowWeights(int radius);

/// Weights on a scale of 128, rounded in double precision.
BlurWeights glowWeights(int radius);

/// The smallest float that is not below 1 / total. With it the product in single precision of any sum up
/// to 256 * total - 1, truncated, is the whole quotient, while total is at most 26,000: a sum of
/// n * total gives n or more, and one less gives n - 1 / total plus at most 2^-15, which is more than
/// half a step of single precision below n.
float inverseAbove(uint32_t total);

/// For sums up to 256 * divisor - 1, a divisor of 128 to 255.
NarrowDivision narrowDivision(uint32_t divisor);

}  // namespace VFontEffect::internal
