#pragma once

#include <cstdint>

#include "core/pixel_buffer.h"
#include "cores/padded_mask.h"

/// The separable integer Gaussian blur of shadows and glows.
///
/// A tap at distance k weighs weights[|k|]. The weight falls as exp(-k^2 / d), where d = R^2 / ln 100
/// makes the weight at the radius one hundredth of the centre's. Each pass divides its sum by the
/// total of all weights, truncating, so the order of the passes shows in single units and is fixed.
/// Cost: 2R + 1 taps a pixel and pass, taps at +k and -k added before the product.
namespace VFontEffect::internal {

constexpr int kShadowScale = 100;
constexpr int kGlowScale = 128;

struct BlurKernel {
    PixelBuffer<uint32_t> weights;
    int radius;
    uint32_t total;

    explicit operator bool() const { return static_cast<bool>(weights); }
};

/// Weights on a scale of 100, rounded in single precision.
BlurKernel shadowKernel(int radius);

/// Weights on a scale of 128, rounded in double precision.
BlurKernel glowKernel(int radius);

/// One pass over `count` neighbouring pixels: `step` is 1 along a row and the stride along columns.
/// All taps must lie inside the source. Sense::inverted gives 255 minus the mean of the taps.
inline void blurLine(const uint8_t* source, int64_t step, int64_t count, const BlurKernel& kernel,
                     Sense sense, uint8_t* out) {
    const uint32_t* const weights = kernel.weights.data();
    for (int64_t x = 0; x < count; ++x) {
        const uint8_t* const centre = source + x;
        uint32_t sum = centre[0] * weights[0];
        for (int64_t k = 1; k <= kernel.radius; ++k) {
            sum += (uint32_t{centre[-k * step]} + centre[k * step]) * weights[k];
        }
        if (sense == Sense::inverted) sum = 255 * kernel.total - sum;
        out[x] = static_cast<uint8_t>(sum / kernel.total);
    }
}

/// Blurs the inner part of a plane, R pixels in from every edge, row by row: the vertical pass into
/// one row buffer whose R outermost bytes on each side hold the value of the border (0, or 255
/// inverted), then the horizontal pass. `paint(y, values)` gets the width - 2R finished values of row
/// y, which belong to columns R and up. Returns false, with nothing painted, when memory ran out.
template <class Paint>
bool blurPlane(const Plane& source, const BlurKernel& kernel, Sense sense, Paint paint) {
    const int64_t radius = kernel.radius;
    const int64_t count = source.width - 2 * radius;
    Plane between = Plane::filled(source.width, 1, sense == Sense::inverted ? 0xFF : 0);
    auto finished = PixelBuffer<uint8_t>::uninitialised(source.width);
    if (!between || !finished) return false;
    for (int64_t y = radius; y < source.height - radius; ++y) {
        blurLine(source.row(y) + radius, source.width, count, kernel, sense, between.row(0) + radius);
        blurLine(between.row(0) + radius, 1, count, kernel, sense, finished.data());
        paint(y, finished.data());
    }
    return true;
}

}  // namespace VFontEffect::internal
