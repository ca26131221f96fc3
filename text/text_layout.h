#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "text/font_chooser.h"
#include "text/fonts.h"
#include "text/glyph_mask.h"
#include "text/text_settings.h"

namespace voreltext {

/// A glyph with ink and what it belongs to.
struct Glyph {
    Box box;
    size_t line;     ///< index of its line
    size_t word;     ///< which of the text's words, from 0; blanks and line ends separate them
    size_t cluster;  ///< index into the text of the first character that it stands for
    size_t font;     ///< index into the fonts
    bool isPicture;  ///< it has colours of its own
};

/// A line as it stands in the picture.
struct Line {
    int baseline;  ///< y of the baseline; that of the first line is 0
    Box box;       ///< the advance width; as high as every line of its font and settings, see TextLayout
    Box ink;       ///< around its glyphs, empty without
    size_t begin;  ///< its part of the text, without the end of a source line
    size_t end;
    bool isRightToLeft;  ///< the direction of its source line
};

struct SetLine;

/// Text set in lines: shaped, ordered from left to right for the eye and placed.
class TextLayout {
  public:
    /// The fonts must outlive the layout; those that a fallback names are added to them. A source line
    /// ends with LF, CR, CR LF, NEL (U+0085), U+2028 or U+2029, and a tab is a blank. Throws TextError
    /// when the text has any other control character, cannot be shaped or grows beyond kMaxSide in width
    /// or height, and when a setting is out of its range.
    TextLayout(Fonts& fonts, const std::vector<uint32_t>& text, const TextSettings& settings = {});

    static constexpr int kMaxSide = 16384;

    /// Only glyphs with ink; blanks leave nothing. They stand line by line, each from left to right.
    size_t glyphCount() const { return mGlyphs.size(); }
    const Glyph& glyph(size_t index) const { return mGlyphs[index]; }
    GlyphMask rasterise(size_t index) const;

    /// From top to bottom, at least one. Their boxes are without gaps from the ascender of the main font
    /// to its descender, with half of what the line height has beyond that above and below.
    const std::vector<Line>& lines() const { return mLines; }

    const Box& inkBox() const { return mInkBox; }  ///< around all glyphs, empty without
    Box lineBox() const;                           ///< around the boxes of all lines

    /// In the order of their first appearance.
    const std::vector<MissingCharacter>& missing() const { return mMissing; }

    /// The names of the fonts that have a glyph with ink, in the order of their first use.
    std::vector<std::string> fontsUsed() const;

  private:
    /// A glyph and its origin in 64ths of a pixel, y upwards.
    struct PlacedGlyph : Glyph {
        unsigned int index;
        int64_t x;
        int64_t y;
    };

    void placeLine(const SetLine& set, int64_t shift, int64_t baseline,
                   const std::vector<size_t>& words);

    const Fonts& mFonts;
    std::vector<PlacedGlyph> mGlyphs;
    std::vector<Line> mLines;
    Box mInkBox;
    std::vector<MissingCharacter> mMissing;
};

}  // namespace voreltext
