#pragma once

#include <algorithm>
#include <cstdint>
#include <vector>

namespace voreltext {

/// Half-open, in whole pixels, y downwards.
struct Box {
    int left = 0;
    int top = 0;
    int right = 0;
    int bottom = 0;

    int width() const { return right - left; }
    int height() const { return bottom - top; }
    bool isEmpty() const { return width() <= 0 || height() <= 0; }
};

/// The smallest box around both; an empty one has no place.
inline Box unionOf(const Box& one, const Box& other) {
    if (one.isEmpty()) return other;
    if (other.isEmpty()) return one;
    return {std::min(one.left, other.left), std::min(one.top, other.top),
            std::max(one.right, other.right), std::max(one.bottom, other.bottom)};
}

/// The coverage of one glyph and where it stands.
struct GlyphMask {
    Box box;
    std::vector<uint8_t> coverage;  ///< packed rows of the box, 0 to 255

    /// Packed rows of R, G, B, A bytes, premultiplied, the alpha being the coverage; empty unless the
    /// glyph is a picture.
    std::vector<uint8_t> pixels = {};
};

}  // namespace voreltext
