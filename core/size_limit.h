#pragma once

namespace VFontEffect::internal {

/// Nothing is painted for an effect size above this: it would take gigabytes or minutes.
constexpr float kLargestSizePx = 256.0F;

inline bool exceedsSizeLimit(float sizePx) {
    return sizePx > kLargestSizePx;
}

}  // namespace VFontEffect::internal
