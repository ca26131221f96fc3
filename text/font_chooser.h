#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <vector>

#include "text/fonts.h"
#include "text/paragraphs.h"
#include "text/shaper.h"

namespace voreltext {

/// A character that no font has.
struct MissingCharacter {
    uint32_t code;
    size_t count;
    size_t first;  ///< index into the text
};

/// A source line with its fonts, on one line.
struct FontedParagraph {
    std::vector<size_t> fonts;  ///< for each character the index of its font
    std::vector<ShapedGlyph> glyphs;
};

/// Chooses the fonts of the clusters of source lines.
///
/// A line is shaped in the main font. The clusters that lack a glyph then go to the next font that has
/// their characters, and the line is shaped again; so every font costs a pass at most, however many
/// clusters there are.
class FontChooser {
  public:
    /// Both must outlive it.
    FontChooser(Fonts& fonts, Shaper& shaper) : mFonts(fonts), mShaper(shaper) {}

    /// Throws TextError.
    FontedParagraph choose(const Paragraph& paragraph);

    /// In the order of their first appearance in the lines so far.
    const std::vector<MissingCharacter>& missing() const { return mMissing; }

  private:
    /// A cluster of the line that is being chosen for.
    struct Span {
        size_t begin;
        size_t end;
        bool isMissing;
    };
    struct Line;

    static std::vector<Span> spansOf(const Line& line);
    static Cluster clusterOf(const Line& line, const Span& span);
    void shape(Line& line);
    bool preferPresentations(Line& line);
    std::optional<size_t> fontFor(const Cluster& cluster, bool isColour);
    bool replaceMissing(Line& line);
    size_t nextFont(const Cluster& cluster, size_t& tried);
    std::optional<size_t> fallbackFor(const Cluster& cluster);
    void noteMissing(const Line& line);
    void noteMissing(uint32_t code, size_t place);

    Fonts& mFonts;
    Shaper& mShaper;
    std::map<Cluster, std::optional<size_t>> mFallbacks;
    std::vector<MissingCharacter> mMissing;
    std::map<uint32_t, size_t> mPlaces;  ///< of characters in mMissing
};

}  // namespace voreltext
