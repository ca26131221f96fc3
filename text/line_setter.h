#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <vector>

#include "text/font_chooser.h"
#include "text/fonts.h"
#include "text/paragraphs.h"
#include "text/shaper.h"
#include "text/text_settings.h"
#include "text/wrapping.h"

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
///
/// To be wrapped, a source line is shaped whole first, which tells how wide each cluster is about; then
/// each line is shaped by itself and, where it turns out wider than it may be or another word would fit,
/// once more.
class LineSetter {
  public:
    /// Takes the lines one by one; may throw.
    using Take = std::function<void(SetLine line)>;

    /// The fonts must outlive it. Throws TextError for a feature that is misspelt.
    LineSetter(Fonts& fonts, const TextSettings& settings);

    /// At least one line. Throws TextError.
    void set(const Paragraph& paragraph, const Take& take);

    /// Of the lines so far.
    const std::vector<MissingCharacter>& missing() const { return mChooser.missing(); }

  private:
    struct Source;

    SetLine nextLine(const Source& source, size_t begin);
    std::optional<SetLine> longestLine(const Source& source, Wrapping::Ends ends, size_t begin);
    SetLine part(const Source& source, size_t begin, size_t end);
    static SetLine placed(std::vector<ShapedGlyph> glyphs, const Paragraph& paragraph, size_t begin,
                          size_t end);

    const Fonts& mFonts;
    int64_t mSpacing;
    int mWidth;
    Shaper mShaper;
    FontChooser mChooser;
};

}  // namespace voreltext
