#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelcompose {

/// What happens to a text that is larger than its canvas leaves room for.
enum class Fit {
    none,    ///< it is cut off
    shrink,  ///< the font becomes smaller
    wrap,    ///< lines are broken
};

/// What of a text is placed on its canvas, and has the padding around it.
enum class TextBox {
    ink,   ///< the smallest box around the glyphs
    line,  ///< the line boxes: one height for every text of a font, one width for what is written
};

/// What is asked of a picture beside its text and its style, within the limits of limits.h.
struct Request {
    std::vector<std::string> fonts{"DejaVu Sans"};  ///< in the order in which they are asked
    std::vector<std::string> features;
    std::vector<voreltext::FontVariation> variations;  ///< of the first font
    int size = 96;
    voreltext::Align align = voreltext::Align::left;
    float lineHeight = 1;
    vorelstyle::Length letterSpacing;

    std::optional<uint32_t> color;
    std::optional<float> opacity;
    float effectScale = 1;

    voreltext::CanvasRequest canvas{std::nullopt, std::nullopt, voreltext::Anchor::center, 0, 8};
    Fit fit = Fit::none;
    TextBox box = TextBox::ink;
    bool strict = false;  ///< the first note is an error
};

/// Refuses what is asked of a canvas that has no such side. Throws ComposeError.
void checkCanvas(const Request& request);

/// A word and what it stands for.
template <typename Value>
using Word = std::pair<const char*, Value>;

constexpr std::array<Word<voreltext::Align>, 5> kAligns{{{"left", voreltext::Align::left},
                                                         {"center", voreltext::Align::center},
                                                         {"right", voreltext::Align::right},
                                                         {"start", voreltext::Align::start},
                                                         {"end", voreltext::Align::end}}};
constexpr std::array<Word<voreltext::Anchor>, 9> kAnchors{
    {{"top-left", voreltext::Anchor::topLeft},
     {"top", voreltext::Anchor::top},
     {"top-right", voreltext::Anchor::topRight},
     {"left", voreltext::Anchor::left},
     {"center", voreltext::Anchor::center},
     {"right", voreltext::Anchor::right},
     {"bottom-left", voreltext::Anchor::bottomLeft},
     {"bottom", voreltext::Anchor::bottom},
     {"bottom-right", voreltext::Anchor::bottomRight}}};
constexpr std::array<Word<Fit>, 3> kFits{
    {{"none", Fit::none}, {"shrink", Fit::shrink}, {"wrap", Fit::wrap}}};
constexpr std::array<Word<TextBox>, 2> kBoxes{{{"ink", TextBox::ink}, {"line", TextBox::line}}};

}  // namespace vorelcompose
