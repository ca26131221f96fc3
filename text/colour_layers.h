#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "text/glyph_mask.h"

/// Glyphs that are outlines of one colour each, one upon the other.
namespace voreltext {

struct LayerColour {
    uint8_t red;
    uint8_t green;
    uint8_t blue;
    uint8_t alpha;
};

/// Lays a coverage in a colour on what is in `picture`, a mask with pixels whose box holds that of the
/// coverage.
void layOn(GlyphMask& picture, const GlyphMask& coverage, const LayerColour& colour);

}  // namespace voreltext
