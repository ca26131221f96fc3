#pragma once

#include <cstdint>

#include "core/coverage_rows.h"
#include "core/inline.h"
#include "ops/blur/intermediate_rows.h"
#include "simd/cpu_level.h"

/// The inner loops of the blur by dot products, compiled once per level of the instruction set: one pass
/// down the columns and one across the rows, and between them a plane in a form of the level's own.
namespace VFontEffect::internal {

/// Steps of four taps that together hold the taps of four neighbouring results.
VOREL_INLINE int64_t tapSteps(int radius) {
    return (2 * int64_t{radius} + kQuad + 3) / 4;
}

/// A blur in the form in which a level's loops read it.
struct PackedBlur {
    int radius;
    uint32_t total;
    float inverse;           // just above 1 / total
    const void* cells;       // the weights as the level wants them, from distance -radius on
    const uint32_t* totals;  // of the weights before each of them
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

/// Cells of zeros before and behind those of the weights.
constexpr int64_t kCellsBefore = 4;
constexpr int64_t kCellsBehind = 20;
/// A cell is made of the weight of its place and of so many behind it.
constexpr int64_t kWeightsBehindCell = 2;

struct DotLoops {
    IntermediateForm form;
    /// Up to this radius dot products take less time than differences of the weights.
    int largestDotRadius;
    /// Whether narrow blurs (narrow_loops.h) take less time where sums fit in 16 bits.
    bool leavesNarrow;
    /// Bytes of a weight's cell.
    int64_t cellBytes;
    /// Makes `count` cells of as many weights and kWeightsBehindCell more.
    void (*fillCells)(const uint8_t* weights, int64_t count, uint8_t* cells);

    /// Stores the source's rows from `row` on as a group.
    void (*feed)(const CoverageRows& source, int64_t row, const TapColumns& columns, int64_t group);
    /// The pass down, for the four results whose uppermost taps are in the group `quad`: rounded down,
    /// for the pass across, or as plain bytes.
    void (*down)(const PackedBlur& blur, const TapColumns& columns, int64_t quad,
                 const IntermediateRows& intermediate);
    void (*downToBytes)(const PackedBlur& blur, const TapColumns& columns, int64_t quad,
                        const BlurRows& out);

    /// The source's rows from `row` on as they are, for the pass across.
    void (*copy)(const CoverageRows& source, int64_t row, const IntermediateRows& intermediate);
    /// The pass across, for the columns `left` to `right` - 1.
    void (*across)(const PackedBlur& blur, const IntermediateRows& intermediate, int64_t left,
                   int64_t right, const BlurRows& out);
};

/// The loops of a level.
const DotLoops& dotLoops(CpuLevel level);

}  // namespace VFontEffect::internal
