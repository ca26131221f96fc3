#pragma once

namespace VFontEffect::internal {

/// Sizes beyond this many pixels are no text effect, and would take gigabytes or minutes.
constexpr float kLargestSizePx = 256.0F;

inline bool exceedsSizeLimit(float sizePx) {
    return sizePx > kLargestSizePx;
}

}  // namespace VFontEffect::internal
