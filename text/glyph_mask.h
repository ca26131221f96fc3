#pragma once

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
