#pragma once

#include <cstdint>

#include "text/font.h"
#include "text/glyph_mask.h"

/// From a glyph of a font to its pixels.
namespace voreltext {

/// FreeType's flags for every outline: as its designer drew it, which lands on any fraction of a pixel.
extern const int32_t kOutlineFlags;

/// A glyph and its origin in 64ths of a pixel, y upwards.
struct GlyphOrigin {
    unsigned int index;
    int64_t x;
    int64_t y;
};

struct GlyphInk {
    Box box;         ///< holds all that is rasterised; empty without ink
    bool isPicture;  ///< it has colours of its own
};

/// Where the ink of a glyph lies. Throws TextError.
GlyphInk inkOf(const Font& font, const GlyphOrigin& glyph);

/// A glyph with ink. What a colour glyph leaves to the colour of the text is black in it, unless all of
/// it is: then it is no picture. Throws TextError.
GlyphMask rasterised(const Font& font, const GlyphOrigin& glyph);

}  // namespace voreltext
