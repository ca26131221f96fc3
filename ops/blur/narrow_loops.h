#pragma once

#include <cstdint>

#include "core/coverage_rows.h"
#include "ops/blur/intermediate_rows.h"
#include "simd/cpu_level.h"

/// The inner loops of narrow blurs, whose sums fit in 16 bits, compiled once per level of the
/// instruction set and written out for each radius.
namespace VFontEffect::internal {

/// Up to this radius, and a total that fits in a byte, sums fit in 16 bits.
constexpr int kLargestNarrowRadius = 3;
/// Rows with taps of four rows of results.
constexpr int kMostTapRows = int{kQuad} + 2 * kLargestNarrowRadius;

/// Division by a number of 128 to 255 as (x + start) * multiplier >> 16 >> kNarrowShift, for sums up to
/// 256 times the number.
struct NarrowDivision {
    uint16_t start;
    uint16_t multiplier;
};
constexpr int kNarrowShift = 7;

/// All times 2 if the total is below 128.
struct NarrowWeights {
    uint8_t byDistance[kLargestNarrowRadius + 2];  // 0 behind the radius
    uint16_t total;
    NarrowDivision division;
};

/// The rows with the taps of four rows of results, from the uppermost on.
struct TapRows {
    const uint8_t* rows[kMostTapRows];
    int64_t width;  // a vector or more
};

/// The passes of one radius.
struct NarrowPasses {
    /// The pass down, for `taps.width` columns. Marks vectors of columns with anything but 0 as covered,
    /// and at the end perhaps their neighbour.
    void (*down)(const NarrowWeights& weights, const TapRows& taps, const BlurRows& out,
                 uint8_t* covered);
    /// The pass across, for the columns `left` to `right` - 1.
    void (*across)(const NarrowWeights& weights, const IntermediateRows& intermediate, int64_t left,
                   int64_t right, const BlurRows& out);
};

struct NarrowLoops {
    IntermediateForm form;
    /// The source's rows from `row` on, each byte ^ bias, and which vectors of them are covered.
    void (*copy)(const CoverageRows& source, int64_t row, uint8_t bias, const IntermediateRows& to);
    NarrowPasses ofRadius[kLargestNarrowRadius];  // from 1 on
};

/// The loops of a level.
const NarrowLoops& narrowLoops(CpuLevel level);

}  // namespace VFontEffect::internal
