#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "compose/font_shelf.h"
#include "compose/note.h"
#include "compose/request.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelcompose {

/// The text that is asked for.
class SourceText {
  public:
    /// `utf8` with markup (parseMarkup) or without. Throws TextError or StyleError.
    SourceText(const std::string& utf8, bool hasMarkup);

    const std::vector<uint32_t>& text() const { return mMarked.text; }  ///< without markup
    const std::vector<vorelstyle::ColourRange>& colours() const { return mMarked.colours; }

    /// "line 2, character 5": where a character of the text stands in what was given.
    std::string placeName(size_t at) const;

  private:
    std::vector<uint32_t> mGiven;
    vorelstyle::MarkedText mMarked;
};

/// A text set in its fonts at one size.
class SetText {
  public:
    /// Lines are broken at `wrapWidth` pixels, at 0 never. Its fonts come from
    /// `shelf`. Throws ComposeError or TextError.
    SetText(const Request& request, FontShelf& shelf, const std::vector<uint32_t>& text, int size,
            int wrapWidth = 0);

    int size() const { return mSize; }  ///< of the font, in pixels
    const voreltext::TextLayout& layout() const { return *mLayout; }
    const voreltext::Box& box() const { return mBox; }  ///< the kind of box that is asked for

  private:
    int mSize;
    std::shared_ptr<OpenFonts> mFonts;
    std::unique_ptr<voreltext::TextLayout> mLayout;
    voreltext::Box mBox;
};

/// Sets the text so that it fits its canvas as is asked for: in broken lines, or in a smaller font.
/// Throws InvisibleText when nothing of it is visible, and ComposeError when the canvas is too small for
/// one of its glyphs.
SetText setToFit(const Request& request, FontShelf& shelf, const SourceText& source);

/// Notes the characters that no font has.
void noteMissing(const voreltext::TextLayout& layout, const SourceText& source, const Note& note);

}  // namespace vorelcompose
