#pragma once

#include <cstdint>

#include "core/size_limit.h"

namespace VFontEffect::internal {

/// The square of cells that a disc of that radius lies in reaches that far from its centre; negative for
/// a radius without a cell.
int64_t discReach(float radius);

/// Weight of the disc's cell at that distance from the centre: 255 inside the radius, falling to 0 over
/// the pixel outside of it. The farther, the smaller.
uint8_t discWeight(int64_t dx, int64_t dy, float radius);

/// Walks along the disc's rim, from the middle row outwards. Calls cell(x, y, weight) for the cells of a
/// row between no weight and full weight, from the outside inwards, and row(y, flatReach, outerReach)
/// behind them: the last cell of weight 255, and of any weight, each -1 when there is none. As both only
/// shrink, it looks at few cells but those of the rim.
template <class Cell, class Row>
void walkRim(int64_t reach, float radius, Cell cell, Row row) {
    int64_t outer = reach;
    for (int64_t y = 0; y <= reach; ++y) {
        uint8_t weight = 0;
        while (outer >= 0 && (weight = discWeight(outer, y, radius)) == 0)
            --outer;
        int64_t flat = outer;
        while (flat >= 0 && weight < 255) {
            cell(flat, y, weight);
            if (--flat >= 0) weight = discWeight(flat, y, radius);
        }
        row(y, flat, outer);
    }
}

/// A disc row by row: full cells in the middle, then cells of falling weight.
struct DiscShape {
    static constexpr int kLongestReach = static_cast<int>(kLargestSizePx);
    /// Of a quarter of the disc. The rim is one pixel wide: where it is flatter than the diagonal it has
    /// at most two cells in a column, elsewhere at most two in a row.
    static constexpr int kMostRimCells = 4 * kLongestReach;

    explicit DiscShape(float radius);

    /// Whether there is a disc, of up to kLongestReach.
    explicit operator bool() const { return reach >= 0; }

    int reach;
    int16_t flatReach[kLongestReach + 1];   ///< by row: the last full cell, -1 when there is none
    int16_t outerReach[kLongestReach + 1];  ///< by row: the last cell of any weight, -1 likewise
    int16_t rimStart[kLongestReach + 1];    ///< by row: where its cells beyond the full ones start
    uint8_t rimDeficit[kMostRimCells];      ///< 255 - weight of these cells, from the inside outwards
};

}  // namespace VFontEffect::internal
