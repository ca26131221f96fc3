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

    /// From baseline to baseline in the main font's own line height, 0 to 100; rounded to whole pixels.
    float lineHeight = 1;

    /// What is added between clusters, the characters that are one for the reader, in 64ths of a pixel;
    /// may be negative. It switches the features liga and clig off unless `features` ask for them.
    /// Letters that are joined in writing, such as Arabic ones, keep together.
    int64_t letterSpacing = 0;

    /// Lines are broken where they would be wider, in pixels; 0: never.
    int wrapWidth = 0;

    /// Features of the fonts as HarfBuzz writes them, for the whole text: "liga=0", "ss01", "-kern".
    std::vector<std::string> features = {};
};

}  // namespace voreltext
