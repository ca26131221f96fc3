#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "text/fonts.h"

namespace voreltext {

/// A glyph as it follows on the one at its left. Lengths are in 64ths of a pixel, y upwards.
struct ShapedGlyph {
    unsigned int index;  ///< in its font; 0 is the sign for a missing character
    size_t font;         ///< index into the fonts
    size_t cluster;      ///< index into the characters of the first that it stands for
    int64_t advance;
    int64_t x;  ///< from its origin to where it is drawn
    int64_t y;
};

/// What is shaped at once.
struct ShapingRun {
    const uint32_t* codes;
    const size_t* fonts;  ///< for each character the index of its font
    size_t length;
    bool isRightToLeft;
};

/// Shapes lines in one set of fonts with the same features.
class Shaper {
  public:
    /// The fonts must outlive the shaper. Throws TextError for a feature that is misspelt.
    Shaper(const Fonts& fonts, std::vector<std::string> features);

    /// The glyphs from left to right; those of one cluster stand beside each other. Throws TextError.
    std::vector<ShapedGlyph> shape(const ShapingRun& run) const;

  private:
    size_t fontOf(const FT_FaceRec_* face, size_t likely) const;

    const Fonts& mFonts;
    std::vector<std::string> mFeatures;
};

}  // namespace voreltext
