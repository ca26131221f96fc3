#pragma once

#include <cstdint>

#include "core/arena.h"

/// What the two passes of a blur four rows at a time hand on.
namespace VFontEffect::internal {

/// Rows are read and blurred four at a time.
constexpr int64_t kQuad = 4;

/// What a pass makes of the mean of the taps: rounded down or up, and then byte ^ invertMask.
struct PassEnding {
    bool roundsUp;
    uint8_t invertMask;
};

/// Plain rows of results. They are written in whole vectors: up to kWidestVector - 1 bytes too many.
struct BlurRows {
    uint8_t* start;
    int64_t stride;
    PassEnding ending;
};

/// Four rows between the passes, `columns` wide; what lies beyond counts as 0. The columns from
/// `coveredColumn` on are those of the pass before, the others are 0, or 255 before column `fullBefore`
/// and from `fullFrom` on. For every vector of columns `covered` tells whether there is anything but 0.
struct IntermediateRows {
    uint8_t* start;  // of row 0, column 0
    int64_t strideBytes;
    int64_t columns;
    int64_t coveredColumn;  // a multiple of kWidestVector
    int64_t fullBefore;
    int64_t fullFrom;
    uint8_t* covered;
};

struct BlurInput;
struct ReachedSource;

/// Rows between the passes, and their place.
struct PlacedIntermediate {
    int64_t left;  // the source's column that is their column 0
    IntermediateRows rows;

    /// What is blurred across has the source's columns, and when some of the full ones are in reach all
    /// that are.
    static PlacedIntermediate of(const BlurInput& input, const ReachedSource& source,
                                 int64_t vectorBytes, Arena& arena);
};

/// How a level's loops keep rows between the passes: as pixel ^ tapBias, in vectors.
struct IntermediateForm {
    int64_t vectorBytes;
    uint8_t tapBias;
};

/// Fills rows between the passes, with their margins, with 0: once, before the first quad.
void clear(const IntermediateForm& form, const IntermediateRows& rows);
/// Fills the full columns, which the pass down may have written over, and marks their vectors as
/// covered.
void fillFullColumns(const IntermediateForm& form, const IntermediateRows& rows);

}  // namespace VFontEffect::internal
