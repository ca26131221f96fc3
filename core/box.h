#pragma once

#include <algorithm>
#include <cstdint>

namespace VFontEffect::internal {

/// A rectangle of whole pixels, half-open: the right and bottom edges do not belong to it.
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
/// The smallest box that contains both. An empty one is left out.
inline Box boundingBox(const Box& a, const Box& b) {
    if (a.empty() || b.empty()) return a.empty() ? b : a;
    return {std::min(a.left, b.left), std::min(a.top, b.top), std::max(a.right, b.right),
            std::max(a.bottom, b.bottom)};
}
inline Box expanded(const Box& box, int64_t pixels) {
    return {box.left - pixels, box.top - pixels, box.right + pixels, box.bottom + pixels};
}
inline Box translated(const Box& box, int64_t dx, int64_t dy) {
    return {box.left + dx, box.top + dy, box.right + dx, box.bottom + dy};
}
/// The part of a source placed at (x, y) that falls on the target, in the target's coordinates.
inline Box clipPlacement(int x, int y, int64_t width, int64_t height, int64_t targetWidth,
                         int64_t targetHeight) {
    return {std::max<int64_t>(x, 0), std::max<int64_t>(y, 0), std::min(x + width, targetWidth),
            std::min(y + height, targetHeight)};
}

}  // namespace VFontEffect::internal
