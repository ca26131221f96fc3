#include "ops/blur/intermediate_rows.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

#include "core/assert.h"
#include "core/numeric.h"
#include "ops/blur/blur_input.h"
#include "ops/blur/narrow_loops.h"
#include "simd/cpu_level.h"

namespace VFontEffect::internal {
namespace {

/// Pixels on both sides of the rows. A vector of results of which one alone has a tap among the columns
/// is computed as a whole, with the taps of all others.
constexpr int64_t kMargin = 2 * kWidestVector;
static_assert(kMargin >= kWidestVector - 1 + int64_t{2} * kLargestNarrowRadius,
              "narrow blurs, which load vectors at every other pixel, have room as well");

IntermediateRows takeRows(int64_t coveredColumn, int64_t columns, const FullColumns& full,
                          int64_t vectorBytes, Arena& arena) {
    VOREL_ASSERT(coveredColumn % kWidestVector == 0);
    const int64_t width = roundedUp(columns, kWidestVector);
    const int64_t stride = width + 2 * kMargin;
    uint8_t* const pixels = arena.take<uint8_t>(stride * kQuad);
    uint8_t* const covered = arena.take<uint8_t>(width / vectorBytes);
    uint8_t* const start = pixels == nullptr ? nullptr : pixels + kMargin;
    return {start, stride, columns, coveredColumn, full.before, full.from, covered};
}

void fill(const IntermediateRows& rows, int64_t from, int64_t end, uint8_t value) {
    for (int64_t y = 0; y < kQuad && from < end; ++y)
        std::memset(rows.start + y * rows.strideBytes + from, value, static_cast<size_t>(end - from));
}

}  // namespace

PlacedIntermediate PlacedIntermediate::of(const BlurInput& input, const ReachedSource& source,
                                          int64_t vectorBytes, Arena& arena) {
    const Box reach = expanded(input.window, input.weights.radius);
    const int64_t width = source.part.width;
    if (input.full.before <= reach.left && input.full.from >= reach.right)
        return {source.left, takeRows(0, width, {0, width}, vectorBytes, arena)};
    const int64_t coveredColumn =
        roundedUp(std::max<int64_t>(0, source.left - reach.left), kWidestVector);
    const int64_t left = source.left - coveredColumn;
    const FullColumns full = {input.full.before - left, input.full.from - left};
    return {left, takeRows(coveredColumn, reach.right - left, full, vectorBytes, arena)};
}

void clear(const IntermediateForm& form, const IntermediateRows& rows) {
    fill(rows, -kMargin, roundedUp(rows.columns, kWidestVector) + kMargin, form.tapBias);
}

void fillFullColumns(const IntermediateForm& form, const IntermediateRows& rows) {
    if (rows.fullBefore <= 0 && rows.fullFrom >= rows.columns) return;
    const auto full = static_cast<uint8_t>(0xFF ^ form.tapBias);
    fill(rows, 0, std::min(rows.fullBefore, rows.columns), full);
    fill(rows, std::max<int64_t>(rows.fullFrom, 0), rows.columns, full);
    for (int64_t x = 0; x < rows.columns; x += form.vectorBytes) {
        if (x < rows.fullBefore || x + form.vectorBytes > rows.fullFrom)
            rows.covered[x / form.vectorBytes] = 1;
    }
}

}  // namespace VFontEffect::internal
