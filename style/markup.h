#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace vorelstyle {

/// A part of a text, in code points, half-open, with a colour of its own, 0xRRGGBB.
struct ColourRange {
    size_t begin;
    size_t end;
    uint32_t colour;
};

/// A text without its markup, and the colours that the markup told.
struct MarkedText {
    std::vector<uint32_t> text;
    std::vector<ColourRange> colours;  ///< none empty, in the order of the text, none over another
    std::vector<size_t> places;        ///< of each character where it stands in the text with its markup
};

/// Reads a text in which "<c #RRGGBB>" or "<c #RGB>" gives what follows a colour, up to its "</c>". Tags
/// may stand within each other: the innermost colour counts. "&lt;", "&gt;" and "&amp;" are written for
/// the characters <, > and &; of these, > may stand for itself. Throws StyleError with the line and the
/// character of what is neither, of a tag that does not close or closes nothing, and of a control
/// character other than tabs and line ends.
MarkedText parseMarkup(const std::vector<uint32_t>& text);

}  // namespace vorelstyle
