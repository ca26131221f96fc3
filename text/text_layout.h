#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "text/font.h"

namespace voreltext {

enum class Align { left, center, right };

/// Half-open, in whole pixels, y downwards.
struct Box {
    int left = 0;
    int top = 0;
    int right = 0;
    int bottom = 0;

    int width() const { return right - left; }
    int height() const { return bottom - top; }
};

/// The coverage of one glyph and where it stands.
struct GlyphMask {
    Box box;
    std::vector<uint8_t> coverage;  ///< packed rows of the box, 0 to 255
};

/// Text set in lines: shaped, ordered from left to right for the eye and placed.
class TextLayout {
  public:
    /// The font must outlive the layout. A line ends with LF, CR, CR LF, NEL (U+0085), U+2028 or U+2029,
    /// and a tab is a blank. Throws TextError when the text has any other control character, cannot be
    /// shaped or grows beyond kMaxSide in width or height.
    TextLayout(const Font& font, const std::vector<uint32_t>& text, Align align);

    static constexpr int kMaxSide = 16384;

    /// Only glyphs with ink; blanks leave nothing.
    size_t glyphCount() const { return mGlyphs.size(); }
    GlyphMask rasterise(size_t index) const;

    const Box& inkBox() const { return mInkBox; }            ///< empty without glyphs
    size_t missingGlyphs() const { return mMissingGlyphs; }  ///< characters the font does not have

  private:
    /// A glyph and its origin in 64ths of a pixel, y upwards.
    struct Glyph {
        unsigned int index;
        int64_t x;
        int64_t y;
        Box box;
    };

    struct Line {
        std::vector<Glyph> glyphs;
        int64_t width = 0;  ///< in 64ths of a pixel
    };

    Line shapeLine(const uint32_t* text, size_t length) const;
    void placeLine(Line& line, int64_t shift, int64_t baseline);
    void loadOutline(const Glyph& glyph) const;
    void growInkBox(const Box& box);

    const Font& mFont;
    std::vector<Glyph> mGlyphs;
    Box mInkBox;
    size_t mMissingGlyphs = 0;
};

}  // namespace voreltext
