#pragma once

#include <algorithm>
#include <cstdint>

#include "core/fixed_point.h"
#include "core/numeric.h"
#include "voreleffect/VFBitmap.h"

/// How the add-calls bring a caller's numbers into the form that the cores expect.
namespace VFontEffect::internal {

constexpr int kLargestPixelSize = 100;
constexpr int kMostStops = 256;

inline float clampedOpacity(float opacity) {
    return clampOrLow(opacity, 0.0F, 1.0F);
}

/// An opacity as an alpha byte, rounded half up.
inline uint32_t alphaByte(float opacity) {
    return static_cast<uint32_t>(std::clamp(toInt(opacity * 255.0F + 0.5F), 0, 255));
}

/// The colour with its alpha byte replaced by the opacity.
inline uint32_t straightColour(uint32_t color, float opacity) {
    return (color & 0x00FFFFFFU) | alphaByte(opacity) << 24;
}

/// The colour with its alpha byte replaced by the opacity and its channels multiplied by it.
inline uint32_t premultipliedColour(uint32_t color, float opacity) {
    return premultiply(straightColour(color, opacity));
}

/// Whole pixels in 0..100.
inline float wholePixels(float pixels) {
    return static_cast<float>(std::clamp(toInt(pixels), 0, kLargestPixelSize));
}

/// The stop with both opacities multiplied into its alpha byte and its position cut to hundredths.
inline VFGradient normalisedStop(const VFGradient& stop, float effectOpacity) {
    const float opacity = clampedOpacity(effectOpacity * stop.mOpacity);
    const float location = static_cast<float>(toInt(stop.mLocation * 100.0F)) / 100.0F;
    return {straightColour(stop.mColor, opacity), clampedOpacity(stop.mOpacity),
            clampOrLow(location, 0.0F, 1.0F)};
}

/// The normalised copy of a caller's stops. A null array counts as no stops.
class NormalisedStops {
  public:
    void fill(const VFGradient* gradient, int count, float effectOpacity) {
        mCount = gradient == nullptr ? 0 : std::clamp(count, 0, kMostStops);
        for (int i = 0; i < mCount; ++i)
            mStops[i] = normalisedStop(gradient[i], effectOpacity);
    }

    int count() const { return mCount; }
    VFGradient* data() { return mStops; }

  private:
    int mCount = 0;
    VFGradient mStops[kMostStops];
};

}  // namespace VFontEffect::internal
