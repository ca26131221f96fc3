#pragma once

#include <cstdint>

#include "text/font.h"
#include "text/glyph_mask.h"

/// From a glyph of a font to its pixels.
namespace voreltext {

/// How every glyph is loaded: as its designer's outline, which lands on any fraction of a pixel.
extern const int32_t kLoadFlags;

/// A glyph and its origin in 64ths of a pixel, y upwards.
struct GlyphOrigin {
    unsigned int index;
    int64_t x;
    int64_t y;
};

/// Where the ink of a glyph lies; empty for one without. Throws TextError.
Box inkOf(const Font& font, const GlyphOrigin& glyph);

/// Throws TextError.
GlyphMask rasterised(const Font& font, const GlyphOrigin& glyph);

}  // namespace voreltext
