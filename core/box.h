#pragma once

#include <algorithm>
#include <cstdint>

namespace VFontEffect::internal {

/// The part of a placed source that falls on the destination, half-open, in destination coordinates.
struct Box {
    int64_t left;
    int64_t top;
    int64_t right;
    int64_t bottom;

    bool empty() const { return left >= right || top >= bottom; }
    int64_t width() const { return right - left; }
    int64_t height() const { return bottom - top; }
};

inline Box intersection(const Box& a, const Box& b) {
    return {std::max(a.left, b.left), std::max(a.top, b.top), std::min(a.right, b.right),
            std::min(a.bottom, b.bottom)};
}
/// The smallest that has both in it. Empty ones count for nothing.
inline Box boundingBox(const Box& a, const Box& b) {
    if (a.empty() || b.empty()) return a.empty() ? b : a;
    return {std::min(a.left, b.left), std::min(a.top, b.top), std::max(a.right, b.right),
            std::max(a.bottom, b.bottom)};
}
inline Box expanded(const Box& clip, int64_t pixels) {
    return {clip.left - pixels, clip.top - pixels, clip.right + pixels, clip.bottom + pixels};
}
inline Box translated(const Box& clip, int64_t dx, int64_t dy) {
    return {clip.left + dx, clip.top + dy, clip.right + dx, clip.bottom + dy};
}

inline Box clipPlacement(int x, int y, int64_t width, int64_t height, int64_t targetWidth,
                         int64_t targetHeight) {
    return {std::max<int64_t>(x, 0), std::max<int64_t>(y, 0), std::min(x + width, targetWidth),
            std::min(y + height, targetHeight)};
}

}  // namespace VFontEffect::internal
