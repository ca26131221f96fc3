#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace voreltext {

/// A line, or a part of one, that is shaped by itself. The arrays are their owner's.
struct ShapingRun {
    const uint32_t* codes;
    const size_t* fonts;      ///< for each character the index of its font
    const uint32_t* scripts;  ///< see Paragraph, as are the levels
    const int8_t* levels;
    size_t length;
    bool isRightToLeft;  ///< the direction of the source line
};

/// Neighbours of one direction, script and font, which a shaper takes at once.
struct ShapingItem {
    size_t begin;
    size_t end;
    size_t font;
    uint32_t script;
    bool isRightToLeft;
};

/// The items of a line from left to right (UAX #9, L1 and L2).
std::vector<ShapingItem> itemsOf(const ShapingRun& run);

}  // namespace voreltext
