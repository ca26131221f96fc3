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

/// Walks along the disc's rim, from the middle row outwards: how far the full and the weighted cells of
/// each row reach. As both only shrink, the walk looks at few cells but those of the rim.
class RimWalk {
  public:
    RimWalk(int64_t reach, float radius)
        : flatReach(reach), outerReach(reach), mRow(0), mReach(reach), mRadius(radius) {
        shrink();
    }

    /// The last cell of the row with weight 255, and with any weight; -1 when there is none.
    int64_t flatReach;
    int64_t outerReach;

    int64_t row() const { return mRow; }
    uint8_t weight(int64_t dx) const { return discWeight(dx, mRow, mRadius); }
    bool done() const { return mRow > mReach; }
    void nextRow() {
        ++mRow;
        shrink();
    }

  private:
    void shrink() {
        while (outerReach >= 0 && weight(outerReach) == 0)
            --outerReach;
        if (flatReach > outerReach) flatReach = outerReach;
        while (flatReach >= 0 && weight(flatReach) < 255)
            --flatReach;
    }

    int64_t mRow;
    int64_t mReach;
    float mRadius;
};

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
