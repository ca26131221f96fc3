#pragma once

#include <algorithm>
#include <cstdint>

namespace VFontEffect::internal {

/// The part of a placed source that falls on the destination, half-open, in destination coordinates.
struct Clip {
    int64_t left;
    int64_t top;
    int64_t right;
    int64_t bottom;

    bool empty() const { return left >= right || top >= bottom; }
    int64_t width() const { return right - left; }
    int64_t height() const { return bottom - top; }
};

inline Clip clipPlacement(int x, int y, int64_t width, int64_t height, int64_t targetWidth,
                          int64_t targetHeight) {
    return {std::max<int64_t>(x, 0), std::max<int64_t>(y, 0), std::min(x + width, targetWidth),
            std::min(y + height, targetHeight)};
}

}  // namespace VFontEffect::internal
