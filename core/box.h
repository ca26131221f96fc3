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
    bool operator==(const Box& other) const {
        return left == other.left && top == other.top && right == other.right && bottom == other.bottom;
    }
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

}  // namespace VFontEffect::internal
