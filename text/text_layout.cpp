#include "text/text_layout.h"

#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_OUTLINE_H
#include <raqm.h>

#include <algorithm>
#include <cstdlib>
#include <memory>
#include <string>

#include "text/error.h"
#include "unicode/utf8.h"

namespace voreltext {
namespace {

/// How every glyph is loaded: as its designer's outline, which lands on any fraction of a pixel.
constexpr FT_Int32 kLoadFlags = FT_LOAD_NO_HINTING | FT_LOAD_NO_BITMAP;

constexpr int64_t kUnit = 64;  ///< FreeType's and raqm's units per pixel

struct DestroyRaqm {
    void operator()(raqm_t* shaper) const { raqm_destroy(shaper); }
};
using Shaper = std::unique_ptr<raqm_t, DestroyRaqm>;

int floorToPixel(int64_t units) {
    return static_cast<int>(units >> 6);
}
int ceilToPixel(int64_t units) {
    return floorToPixel(units + kUnit - 1);
}

/// A font may step backwards as well as forwards.
void checkSide(int64_t units) {
    if (std::abs(units) <= TextLayout::kMaxSide * kUnit) return;
    throw TextError("the text would be more than " + std::to_string(TextLayout::kMaxSide) +
                    " pixels wide or high");
}

/// Next line, line separator and paragraph separator.
bool endsLine(uint32_t code) {
    return code == '\n' || code == '\r' || code == 0x85 || code == 0x2028 || code == 0x2029;
}

[[noreturn]] void refuseControl(uint32_t code, size_t line, size_t character) {
    throw TextError("the text has the control character " + vorelunicode::nameOf(code) + " in line " +
                    std::to_string(line) + ", character " + std::to_string(character));
}

/// Cuts at line ends, of which CR LF is one; tabs become blanks.
std::vector<std::vector<uint32_t>> splitLines(const std::vector<uint32_t>& text) {
    std::vector<std::vector<uint32_t>> lines(1);
    uint32_t before = 0;
    for (const uint32_t code : text) {
        std::vector<uint32_t>& line = lines.back();
        if (endsLine(code)) {
            if (code != '\n' || before != '\r') lines.emplace_back();
        } else if (vorelunicode::isControl(code) && code != '\t') {
            refuseControl(code, lines.size(), line.size() + 1);
        } else {
            line.push_back(code == '\t' ? ' ' : code);
        }
        before = code;
    }
    return lines;
}

/// The part of a line's slack that stands on its left.
int64_t leftShare(Align align, int64_t slack) {
    switch (align) {
        case Align::center:
            return slack / 2;
        case Align::right:
            return slack;
        default:
            return 0;
    }
}

}  // namespace

TextLayout::TextLayout(const Font& font, const std::vector<uint32_t>& text, Align align) : mFont(font) {
    std::vector<Line> lines;
    int64_t width = 0;
    for (const std::vector<uint32_t>& line : splitLines(text)) {
        lines.push_back(shapeLine(line.data(), line.size()));
        width = std::max(width, lines.back().width);
        checkSide(static_cast<int64_t>(lines.size()) * mFont.lineHeight());
    }
    int64_t baseline = 0;
    for (Line& line : lines) {
        placeLine(line, leftShare(align, width - line.width), baseline);
        baseline -= mFont.lineHeight();
    }
}

TextLayout::Line TextLayout::shapeLine(const uint32_t* text, size_t length) const {
    Line line;
    if (length == 0) return line;
    const Shaper shaper(raqm_create());
    const bool shaped = shaper != nullptr && raqm_set_text(shaper.get(), text, length) &&
                        raqm_set_freetype_face(shaper.get(), mFont.face()) &&
                        raqm_set_freetype_load_flags(shaper.get(), kLoadFlags) &&
                        raqm_set_par_direction(shaper.get(), RAQM_DIRECTION_DEFAULT) &&
                        raqm_layout(shaper.get());
    if (!shaped) throw TextError("the text cannot be shaped");

    size_t count = 0;
    const raqm_glyph_t* glyphs = raqm_get_glyphs(shaper.get(), &count);
    line.glyphs.reserve(count);
    for (size_t i = 0; i < count; ++i) {
        line.glyphs.push_back(
            {glyphs[i].index, line.width + glyphs[i].x_offset, glyphs[i].y_offset, {}});
        line.width += glyphs[i].x_advance;
        checkSide(line.width);
    }
    return line;
}

void TextLayout::placeLine(Line& line, int64_t shift, int64_t baseline) {
    for (Glyph& glyph : line.glyphs) {
        glyph.x += shift;
        glyph.y += baseline;
        checkSide(glyph.x);
        checkSide(glyph.y);
        if (glyph.index == 0) ++mMissingGlyphs;
        loadOutline(glyph);
        FT_BBox outline;
        FT_Outline_Get_CBox(&mFont.face()->glyph->outline, &outline);
        const int x = floorToPixel(glyph.x);
        const int y = floorToPixel(glyph.y);
        glyph.box = {x + floorToPixel(outline.xMin), -y - ceilToPixel(outline.yMax),
                     x + ceilToPixel(outline.xMax), -y - floorToPixel(outline.yMin)};
        if (glyph.box.width() <= 0 || glyph.box.height() <= 0) continue;
        growInkBox(glyph.box);
        mGlyphs.push_back(glyph);
    }
}

/// Leaves the outline in the face's slot, moved by the fraction of a pixel of its origin.
void TextLayout::loadOutline(const Glyph& glyph) const {
    const FT_Face face = mFont.face();
    if (FT_Load_Glyph(face, glyph.index, kLoadFlags) != 0 ||
        face->glyph->format != FT_GLYPH_FORMAT_OUTLINE) {
        throw TextError("the font has no outline for glyph " + std::to_string(glyph.index));
    }
    FT_Outline_Translate(&face->glyph->outline, glyph.x & (kUnit - 1), glyph.y & (kUnit - 1));
}

void TextLayout::growInkBox(const Box& box) {
    if (mGlyphs.empty()) {
        mInkBox = box;
        return;
    }
    mInkBox = {std::min(mInkBox.left, box.left), std::min(mInkBox.top, box.top),
               std::max(mInkBox.right, box.right), std::max(mInkBox.bottom, box.bottom)};
}

GlyphMask TextLayout::rasterise(size_t index) const {
    const Glyph& glyph = mGlyphs[index];
    loadOutline(glyph);
    FT_GlyphSlot slot = mFont.face()->glyph;
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
