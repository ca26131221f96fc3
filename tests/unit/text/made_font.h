#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "text/font.h"

namespace vorel_test {

/// A rectangle of a glyph in units of the font, y upwards.
struct Rectangle {
    int left;
    int bottom;
    int right;
    int top;
};

/// One colour of another glyph's outline, as an index into the font's colours.
struct MadeLayer {
    uint16_t glyph;
    uint16_t colour;
};

/// A picture of R, G, B, A bytes, not premultiplied, with its corner from the glyph's origin.
struct MadePicture {
    int width;
    int height;
    int left;  ///< in its pixels
    int top;   ///< from the baseline upwards
    std::vector<uint8_t> pixels;
};

struct MadeGlyph {
    uint32_t code;
    int advance;
    std::optional<Rectangle> outline;
    std::vector<MadeLayer> layers = {};
    std::optional<MadePicture> picture = {};
};

/// Where a font keeps its pictures: Google's tables without outlines, or Apple's beside them.
enum class Pictures { none, withoutOutlines, besideOutlines };

/// A TrueType font put together for a test. The numbers of the glyphs are their indices behind the sign
/// for what is missing, which is glyph 0, a full square that is half an em wide.
struct MadeFont {
    int unitsPerEm = 1024;
    int ascender = 768;
    int descender = -256;
    int lineGap = 0;
    std::vector<MadeGlyph> glyphs;
    std::vector<uint32_t> colours;  ///< 0xRRGGBBAA
    Pictures pictures = Pictures::none;
    std::vector<int> ppems;  ///< of the pictures, which are the same in each

    std::string bytes() const;
};

/// At this size a unit of a made font is a 64th of a pixel.
constexpr int kMadeSize = 16;

/// A made font whose bytes live on to the end of the program.
voreltext::Font openMade(const MadeFont& font, int sizePx = kMadeSize);

/// Letters a to z and A to Z, 10 pixels wide with 8 pixels of ink, a hyphen of 5 and a blank of 5
/// pixels.
MadeFont letters();

}  // namespace vorel_test
