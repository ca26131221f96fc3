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

    /// Makes it hold the other box as well; an empty one has no place.
    void grow(const Box& other) {
        if (other.isEmpty()) return;
        *this = isEmpty() ? other
                          : Box{std::min(left, other.left), std::min(top, other.top),
                                std::max(right, other.right), std::max(bottom, other.bottom)};
    }
};

/// The coverage of one glyph and where it stands.
struct GlyphMask {
    Box box;
    std::vector<uint8_t> coverage;  ///< packed rows of the box, 0 to 255

    /// Packed rows of R, G, B, A bytes, premultiplied, the alpha being the coverage; empty unless the
    /// glyph is a picture.
    std::vector<uint8_t> pixels = {};
};

}  // namespace voreltext
