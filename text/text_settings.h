#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace voreltext {

/// Where short lines stand. `start` and `end` go by the direction of each source line's first letter
/// that has one: `start` is left in English, right in Hebrew.
enum class Align { left, center, right, start, end };

/// How a text is set.
struct TextSettings {
    Align align = Align::left;

    /// From baseline to baseline in the main font's own line height, 0 to kMostLineHeight; rounded to
    /// whole pixels, of which it is one at least.
    float lineHeight = 1;

    /// What is added between clusters, the characters that are one for the reader, in 64ths of a pixel;
    /// at most TextLayout::kMaxSide pixels, and as many less than none. It switches the features liga
    /// and clig off unless `features` ask for them. Letters that are joined in writing (Arabic, Syriac,
    /// Mongolian, N'Ko and others) stay as they are.
    int64_t letterSpacing = 0;

    /// Source lines that are wider, in pixels, are broken by the Unicode line breaking algorithm (UAX
    /// #14); 0: none is. Blanks at the end of a line do not count and are not aligned. A word that is
    /// wider is broken between clusters; for a cluster that is wider, TextLayout throws. A soft hyphen
    /// (U+00AD) is seen as a hyphen where a line ends with it. Thai, Lao, Khmer and Burmese break at
    /// zero width spaces (U+200B) alone. Letters are shaped line by line and have the direction that
    /// they have in the source line.
    int wrapWidth = 0;

    /// Features of the fonts as HarfBuzz writes them, for the whole text: "liga=0", "ss01", "-kern".
    std::vector<std::string> features = {};

    static constexpr float kMostLineHeight = 100;
};

/// Throws TextError, which tells the range, for a setting that is out of it.
void checkSettings(const TextSettings& settings);

}  // namespace voreltext
