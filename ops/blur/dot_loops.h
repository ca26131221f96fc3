#pragma once

#include <cstdint>

#include "core/coverage_rows.h"
#include "core/inline.h"
#include "simd/cpu_level.h"

/// The inner loops of the blur by dot products, compiled once per level of the instruction set: one pass
/// down the columns and one across the rows, and between them a plane in a form of the level's own.
namespace VFontEffect::internal {

/// Rows are read and blurred four at a time.
constexpr int64_t kQuad = 4;
/// Steps of four taps that together hold the taps of four neighbouring results.
VOREL_INLINE int64_t tapSteps(int radius) {
    return (2 * int64_t{radius} + kQuad + 3) / 4;
}

/// Up to this radius, and a total that fits in a byte, sums fit in 16 bits.
constexpr int64_t kLargestNarrowRadius = 3;

/// Pixels on both sides of the rows between the passes. A vector of results of which one alone has a tap
/// among the columns is computed as a whole, with the taps of all others.
constexpr int64_t kIntermediateMargin = 2 * kWidestVector;
static_assert(kIntermediateMargin >= kWidestVector - 1 + 2 * kLargestNarrowRadius,
              "the farthest tap of a vector that meets the columns lies in the margin");

/// Division by a number of 128 to 255 as (x + start) * multiplier >> 16 >> kNarrowShift, for sums up to
/// 256 times the number.
struct NarrowDivision {
    uint16_t start;
    uint16_t multiplier;
};
constexpr int kNarrowShift = 7;

/// A blur in the form in which a level's loops read it.
struct PackedBlur {
    int radius;
    uint32_t total;
    float inverse;           // just above 1 / total
    const void* cells;       // the weights as the level wants them, from distance -radius on
    const uint32_t* totals;  // of the weights before each of them
    bool isNarrow;  // whether sums fit in 16 bits, and then, all times 2 if the total is below 128:
    uint16_t weights[kLargestNarrowRadius + 1];
    uint16_t narrowTotal;
    NarrowDivision division;
};

/// What a pass makes of the mean of the taps: rounded down or up, and then byte ^ invertMask.
struct PassEnding {
    bool roundsUp;
    uint8_t invertMask;
};

/// What the pass down reads: groups of four rows in a form of the level's own, strip by strip, each
/// strip as wide as a vector. Groups are counted from that of the uppermost taps of the first results
/// on.
struct TapColumns {
    uint8_t* groups;      // of strip 0, from group `firstGroup` on
    int64_t stripStride;  // bytes
    int64_t firstGroup;
    int64_t width;
    int32_t* firstCovered;  // for each strip the first and the last group that has anything but 0
    int32_t* lastCovered;
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

/// Bytes of a pixel in the taps of a narrow blur and between its passes; others have 1.
constexpr int64_t kNarrowPixelBytes = 2;

/// Plain rows of results. They are written in whole vectors: up to kWidestVector - 1 bytes too many.
struct BlurRows {
    uint8_t* start;
    int64_t stride;
    PassEnding ending;
};

/// Cells of zeros before and behind those of the weights.
constexpr int64_t kCellsBefore = 4;
constexpr int64_t kCellsBehind = 20;
/// A cell is made of the weight of its place and of so many behind it.
constexpr int64_t kWeightsBehindCell = 2;

struct DotLoops {
    int64_t vectorBytes;
    /// Up to this radius dot products take less time than differences of the weights.
    int largestDotRadius;
    /// Whether the level sums in 16 bits where that suffices.
    bool hasNarrow;
    /// Bytes of a weight's cell.
    int64_t cellBytes;
    /// Makes `count` cells of as many weights and kWeightsBehindCell more.
    void (*fillCells)(const uint8_t* weights, int64_t count, uint8_t* cells);

    /// Fills rows between the passes, with their margins, with 0: once, before the first quad.
    void (*clear)(const PackedBlur& blur, const IntermediateRows& intermediate);

    /// Stores the source's rows from `row` on as a group.
    void (*feed)(const PackedBlur& blur, const CoverageRows& source, int64_t row,
                 const TapColumns& columns, int64_t group);
    /// The pass down, for the four results whose uppermost taps are in the group `quad`: rounded down,
    /// for the pass across, or as plain bytes.
    void (*down)(const PackedBlur& blur, const TapColumns& columns, int64_t quad,
                 const IntermediateRows& intermediate);
    void (*downToBytes)(const PackedBlur& blur, const TapColumns& columns, int64_t quad,
                        const BlurRows& out);

    /// The source's rows from `row` on as they are, for the pass across.
    void (*copy)(const PackedBlur& blur, const CoverageRows& source, int64_t row,
                 const IntermediateRows& intermediate);
    /// The pass across, for the columns `left` to `right` - 1.
    void (*across)(const PackedBlur& blur, const IntermediateRows& intermediate, int64_t left,
                   int64_t right, const BlurRows& out);
};

/// The loops of a level.
const DotLoops& dotLoops(CpuLevel level);

}  // namespace VFontEffect::internal
