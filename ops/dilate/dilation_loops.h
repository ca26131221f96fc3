#pragma once

#include <cstdint>

#include "core/coverage_rows.h"
#include "core/inline.h"
#include "core/numeric.h"
#include "ops/dilate/disc_shape.h"
#include "simd/cpu_level.h"

/// The inner loops of a dilation, compiled once per level of the instruction set.
namespace VFontEffect::internal {

/// The source is the box with a border of so many empty pixels.
constexpr int64_t kDilationBorder = 1;

/// Grey-scale dilation of a box of coverage by a disc, for a window of results. All coordinates are
/// those of the part of the source that the disc reaches from there, its corner being (0, 0).
///
/// The result at p is the largest c - (255 - weight) over all source pixels of coverage c, with the
/// weight that the disc around p has there; 0 where nothing is above 0.
struct Dilation {
    CoverageRows box;  ///< what is in reach without the border, which is full where the box is inverted
    int64_t boxLeft;   ///< where it begins: behind the border, if that is in reach
    int64_t boxTop;
    const DiscShape* disc;
    int64_t width;   ///< of what is in reach, border included
    int64_t height;  ///< likewise
    int64_t left;    ///< the columns of the window: nothing in reach is farther from them than the reach
    int64_t right;
    int64_t top;       ///< the first row of the window
    int64_t bandRows;  ///< rows that are asked for at once; the last ones may be fewer
};

/// Rows of results are so far apart: an odd number of the cache's lines, for rows that are a power of
/// two apart share few of its places, and spreading takes 1.6 times as long.
VOREL_INLINE int64_t dilatedStride(const Dilation& dilation) {
    return roundedUp(dilation.right - dilation.left, 64) | 64;
}

/// One way to dilate. Its layout stands at the beginning of its memory.
struct DilationStrategy {
    int64_t (*memoryBytes)(const Dilation& dilation);
    /// Lays the memory out and prepares it: as many bytes as above, from a line of the cache on, of any
    /// values.
    void (*begin)(const Dilation& dilation, uint8_t* memory);
    /// `count` rows of results from row y on, first column `left`: from row `top` on a band after the
    /// other, all of bandRows rows but the last. They may be changed, and stay until the next call. Null
    /// when the strategy gives the window up, as it takes too long there.
    uint8_t* (*rows)(const Dilation& dilation, uint8_t* memory, int64_t y, int64_t count);
};

/// Up to this reach of the disc each of its cells is looked at by itself.
constexpr int kLongestCellReach = 2;

struct DilationLoops {
    DilationStrategy cells[kLongestCellReach + 1];  ///< by reach
    DilationStrategy spreading;
    DilationStrategy tiles;    ///< may give up
    DilationStrategy squares;  ///< for what tiles give up
    /// Up to this reach spreading takes less time than tiles.
    int64_t longestSpreadReach;
    /// first = min(first, second), whole rows of results
    void (*keepMin)(uint8_t* first, const uint8_t* second, int64_t count);
};

/// The loops of a level.
const DilationLoops& dilationLoops(CpuLevel level);

}  // namespace VFontEffect::internal
