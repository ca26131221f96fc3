#pragma once

#include <ft2build.h>
#include <hb-ft.h>
#include <voreleffect/look.h>

#include <algorithm>
#include <cstddef>
#include <memory>
#include <string>
#include <utility>
#include <vector>
#include FT_FREETYPE_H

/// A line of text: its glyphs from the start of the baseline, and the coverage that they point to.
struct Line {
    std::vector<VFontEffect::Glyph> glyphs;
    std::vector<std::unique_ptr<unsigned char[]>> coverage;
    int width = 0;  ///< pixels from the first pen to the last
};

/// A font file at one size: HarfBuzz places the glyphs, FreeType draws their coverage.
class Font {
  public:
    Font(const char* file, int pixels) {
        if (FT_Init_FreeType(&mLibrary) != 0 || FT_New_Face(mLibrary, file, 0, &mFace) != 0) return;
        mIsReady = FT_Set_Pixel_Sizes(mFace, 0, static_cast<FT_UInt>(pixels)) == 0;
        mShaped = hb_ft_font_create_referenced(mFace);
        hb_ft_font_set_load_flags(mShaped, kOutlines);
    }
    Font(const Font&) = delete;
    Font& operator=(const Font&) = delete;
    ~Font() {
        hb_font_destroy(mShaped);
        FT_Done_Face(mFace);
        FT_Done_FreeType(mLibrary);
    }

    bool isReady() const { return mIsReady; }  ///< whether the file could be read
    int ascent() const { return wholePixels(mFace->size->metrics.ascender); }
    int lineHeight() const { return wholePixels(mFace->size->metrics.height); }

    /// Shapes text of one script, UTF-8, with `spacing` pixels more behind each glyph.
    Line line(const std::string& text, int spacing = 0) const {
        hb_buffer_t* buffer = hb_buffer_create();
        hb_buffer_add_utf8(buffer, text.data(), static_cast<int>(text.size()), 0, -1);
        hb_buffer_guess_segment_properties(buffer);
        hb_shape(mShaped, buffer, nullptr, 0);
        unsigned count = 0;
        const hb_glyph_info_t* infos = hb_buffer_get_glyph_infos(buffer, &count);
        const hb_glyph_position_t* positions = hb_buffer_get_glyph_positions(buffer, &count);
        Line line;
        long pen = 0;
        for (unsigned i = 0; i < count; ++i) {
            draw(line, infos[i].codepoint, pen + positions[i].x_offset, positions[i].y_offset);
            pen += positions[i].x_advance + 64L * spacing;
        }
        hb_buffer_destroy(buffer);
        line.width = wholePixels(pen);
        return line;
    }

  private:
    /// Bitmaps, which some fonts have for small sizes, have one bit a pixel.
    static constexpr FT_Int32 kOutlines = FT_LOAD_NO_HINTING | FT_LOAD_NO_BITMAP;

    /// HarfBuzz and FreeType count in 64ths of a pixel.
    static int wholePixels(long sixtyFourths) { return static_cast<int>((sixtyFourths + 32) >> 6); }

    /// Draws a glyph whose pen is at (x, y), y upwards.
    void draw(Line& line, unsigned index, long x, long y) const {
        if (FT_Load_Glyph(mFace, index, FT_LOAD_RENDER | kOutlines) != 0) return;
        const FT_GlyphSlot slot = mFace->glyph;
        const FT_Bitmap& bitmap = slot->bitmap;
        const std::size_t bytes = static_cast<std::size_t>(bitmap.pitch) * bitmap.rows;
        auto coverage = std::make_unique<unsigned char[]>(bytes);
        std::copy_n(bitmap.buffer, bytes, coverage.get());
        line.glyphs.push_back({wholePixels(x) + slot->bitmap_left, wholePixels(-y) - slot->bitmap_top,
                               coverage.get(), static_cast<int>(bitmap.width),
                               static_cast<int>(bitmap.rows), bitmap.pitch});
        line.coverage.push_back(std::move(coverage));
    }

    FT_Library mLibrary = nullptr;
    FT_Face mFace = nullptr;
    hb_font_t* mShaped = nullptr;
    bool mIsReady = false;
};
