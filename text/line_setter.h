#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "text/font_chooser.h"
#include "text/fonts.h"
#include "text/paragraphs.h"
#include "text/shaper.h"
#include "text/text_settings.h"

namespace voreltext {

/// A line whose glyphs stand from its left end at 0.
struct SetLine {
    std::vector<ShapedGlyph> glyphs;  ///< from left to right; clusters are indices into the text
    int64_t width = 0;                ///< its advance in 64ths of a pixel
    size_t begin = 0;                 ///< its part of the text
    size_t end = 0;
    bool isRightToLeft = false;
};

/// Sets source lines in lines for the eye.
class LineSetter {
  public:
    /// The fonts must outlive it. Throws TextError for a setting that is out of its range.
    LineSetter(Fonts& fonts, const TextSettings& settings);

    /// At least one line. Throws TextError.
    std::vector<SetLine> set(const Paragraph& paragraph);

    /// Of the lines so far.
    const std::vector<MissingCharacter>& missing() const { return mChooser.missing(); }

  private:
    const TextSettings& mSettings;
    Shaper mShaper;
    FontChooser mChooser;
};

}  // namespace voreltext
