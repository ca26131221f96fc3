#include <cstdint>

#include "core/numeric.h"
#include "core/portable_math.h"
#include "cores/blur.h"

namespace VFontEffect::internal {
namespace {

constexpr float kLn100 = 4.60517F;

/// `round` turns the exponential of a tap into its whole weight.
template <class Round>
BlurKernel makeKernel(int radius, uint32_t centre, Round round) {
    BlurKernel kernel = {PixelBuffer<uint32_t>::uninitialised(int64_t{radius} + 1), radius, centre};
    if (!kernel) return kernel;
    kernel.weights[0] = centre;
    const float spread = static_cast<float>(radius) * static_cast<float>(radius) / kLn100;
    for (int i = 1; i <= radius; ++i) {
        const auto weight =
            static_cast<uint32_t>(round(portableExp(static_cast<float>(-(i * i)) / spread)));
        kernel.weights[static_cast<size_t>(i)] = weight;
        kernel.total += 2 * weight;
    }
    return kernel;
}

}  // namespace

BlurKernel shadowKernel(int radius) {
    return makeKernel(radius, kShadowScale,
                      [](float tap) { return toInt(tap * static_cast<float>(kShadowScale) + 0.5F); });
}

BlurKernel glowKernel(int radius) {
    return makeKernel(radius, kGlowScale, [](float tap) {
        return toInt(static_cast<double>(tap * static_cast<float>(kGlowScale)) + 0.5);
    });
}

}  // namespace VFontEffect::internal
