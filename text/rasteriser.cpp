#include "text/rasteriser.h"

#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_OUTLINE_H

#include <string>

#include "text/error.h"
#include "text/units.h"

namespace voreltext {

const int32_t kLoadFlags = FT_LOAD_NO_HINTING | FT_LOAD_NO_BITMAP;

namespace {

/// Leaves the outline in the face's slot, moved by the fraction of a pixel of its origin.
FT_GlyphSlot loadOutline(const Font& font, const GlyphOrigin& glyph) {
    const FT_Face face = font.face();
    if (FT_Load_Glyph(face, glyph.index, kLoadFlags) != 0 ||
        face->glyph->format != FT_GLYPH_FORMAT_OUTLINE) {
        throw TextError("the font has no outline for glyph " + std::to_string(glyph.index));
    }
    FT_Outline_Translate(&face->glyph->outline, glyph.x & (kUnit - 1), glyph.y & (kUnit - 1));
    return face->glyph;
}

}  // namespace

Box inkOf(const Font& font, const GlyphOrigin& glyph) {
    FT_BBox outline;
    FT_Outline_Get_CBox(&loadOutline(font, glyph)->outline, &outline);
    const int x = floorToPixel(glyph.x);
    const int y = floorToPixel(glyph.y);
    return {x + floorToPixel(outline.xMin), -y - ceilToPixel(outline.yMax),
            x + ceilToPixel(outline.xMax), -y - floorToPixel(outline.yMin)};
}

GlyphMask rasterised(const Font& font, const GlyphOrigin& glyph) {
    const FT_GlyphSlot slot = loadOutline(font, glyph);
    if (FT_Render_Glyph(slot, FT_RENDER_MODE_NORMAL) != 0) {
        throw TextError("glyph " + std::to_string(glyph.index) + " cannot be rasterised");
    }
    const FT_Bitmap& bitmap = slot->bitmap;
    const int left = floorToPixel(glyph.x) + slot->bitmap_left;
    const int top = -floorToPixel(glyph.y) - slot->bitmap_top;
    GlyphMask mask;
    mask.box = {left, top, left + static_cast<int>(bitmap.width), top + static_cast<int>(bitmap.rows)};
    mask.coverage.reserve(size_t{bitmap.width} * bitmap.rows);
    for (unsigned int row = 0; row < bitmap.rows; ++row) {
        const uint8_t* pixels = bitmap.buffer + static_cast<ptrdiff_t>(row) * bitmap.pitch;
        mask.coverage.insert(mask.coverage.end(), pixels, pixels + bitmap.width);
    }
    return mask;
}

}  // namespace voreltext
