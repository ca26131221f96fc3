#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace voreltext {

/// A line of the source, without its end.
struct Paragraph {
    size_t number;                  ///< 1 for the first
    size_t begin;                   ///< where it stands in the text
    std::vector<uint32_t> codes;    ///< its characters, tabs as blanks
    std::vector<uint32_t> scripts;  ///< of each of them, as scriptsOf tells it
    std::vector<int8_t> levels;     ///< of each of them, odd from right to left (UAX #9)
    bool isRightToLeft;  ///< the direction of its first letter that has one (UAX #9, P2 and P3)
};

/// Cuts a text at its line ends, of which CR LF is one. Throws TextError where it has another control
/// character.
std::vector<Paragraph> splitParagraphs(const std::vector<uint32_t>& text);

}  // namespace voreltext
