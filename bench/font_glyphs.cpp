#include <cstddef>
#include <utility>

#include "font_face.h"
#include "glyphs.h"

namespace vorel_bench {
namespace {

/// Renders a character with the pen at `penX` on the baseline 0 and moves the pen.
Glyph rendered(FT_Face face, char character, int& penX) {
    const auto code = static_cast<FT_ULong>(static_cast<unsigned char>(character));
    if (FT_Load_Char(face, code, kLoadFlags | FT_LOAD_RENDER) != 0) return {};
    const FT_GlyphSlot slot = face->glyph;
    const FT_Bitmap& bitmap = slot->bitmap;
    Glyph glyph = {penX + slot->bitmap_left,
                   -slot->bitmap_top,
                   static_cast<int>(bitmap.width),
                   static_cast<int>(bitmap.rows),
                   {}};
    for (int y = 0; y < glyph.height; ++y) {
        const unsigned char* const row = bitmap.buffer + std::ptrdiff_t{y} * bitmap.pitch;
        glyph.coverage.insert(glyph.coverage.end(), row, row + glyph.width);
    }
    penX += static_cast<int>((slot->advance.x + 32) >> 6);
    return glyph;
}

}  // namespace

std::vector<Glyph> glyphsOf(const Workload& workload) {
    std::vector<Glyph> glyphs;
    const FontFace face(workload.font, workload.sizePx);
    int penX = 0;
    for (const char character : workload.text) {
        Glyph glyph = rendered(face.face(), character, penX);
        if (!glyph.coverage.empty()) glyphs.push_back(std::move(glyph));
    }
    return glyphs;
}

}  // namespace vorel_bench
