#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "text/fonts.h"
#include "text/shaping_items.h"

struct hb_buffer_t;
struct hb_font_t;

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

/// Shapes lines in one set of fonts with the same features.
class Shaper {
  public:
    /// The fonts must outlive the shaper. Throws TextError for a feature that is misspelt.
    Shaper(const Fonts& fonts, const std::vector<std::string>& features);
    ~Shaper();
    Shaper(const Shaper&) = delete;
    Shaper& operator=(const Shaper&) = delete;

    /// The glyphs from left to right; those of one cluster stand beside each other. Throws TextError.
    std::vector<ShapedGlyph> shape(const ShapingRun& run);

  private:
    struct HarfBuzz;

    hb_font_t* fontFor(size_t index);
    void shapeItem(const ShapingRun& run, const ShapingItem& item);

    const Fonts& mFonts;
    std::unique_ptr<HarfBuzz> mHarfBuzz;
};

}  // namespace voreltext
