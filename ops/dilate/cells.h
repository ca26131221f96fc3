#pragma once

#include <cstdint>

#include "ops/dilate/padded_rows.h"

/// Dilation by the smallest discs, of a reach of up to 2: each cell is a load of its own, and the cells
/// at one distance, which weigh the same, share a subtraction.
///
/// Cost: 9 loads a vector for a reach of 1, 25 for one of 2. Telling empty stretches would cost as much.
namespace VFontEffect::internal::VOREL_LEVEL {

struct CellLayout {
    PaddedRows rows;
    uint8_t* results;  ///< of a band

    static CellLayout of(const Dilation& dilation, Arena& arena) {
        const int64_t reach = dilation.disc->reach;
        return {takeRows(dilation, dilation.bandRows + 2 * reach, reach, reach + kBytes, arena),
                arena.take<uint8_t>(dilation.bandRows * dilatedStride(dilation))};
    }
};

/// 255 - weight of the cells that lie that far aside.
VOREL_INLINE U8s cellDeficit(const DiscShape& disc, int dx, int dy) {
    uint8_t deficit = 255;
    if (dx <= disc.flatReach[dy]) {
        deficit = 0;
    } else if (dx <= disc.outerReach[dy]) {
        deficit = disc.rimDeficit[disc.rimStart[dy] + dx - disc.flatReach[dy] - 1];
    }
    return splat<U8s>(deficit);
}

/// The largest of the four pixels that lie dx columns and dy rows aside.
VOREL_INLINE U8s mirrored(const uint8_t* source, int64_t dx, int64_t dy) {
    const U8s right = max(load<U8s>(source + dx + dy), load<U8s>(source + dx - dy));
    const U8s left = max(load<U8s>(source - dx + dy), load<U8s>(source - dx - dy));
    return max(right, left);
}

/// A disc of one cell.
struct CentreCell {
    static constexpr int kReach = 0;
    U8s centre;

    explicit CentreCell(const DiscShape& disc) : centre(cellDeficit(disc, 0, 0)) {}
    VOREL_INLINE U8s dilated(const uint8_t* source, int64_t /*stride*/) const {
        return subSaturated(load<U8s>(source), centre);
    }
};

/// With the eight cells around it.
struct NearCells {
    static constexpr int kReach = 1;
    CentreCell inner;
    U8s side, corner;

    explicit NearCells(const DiscShape& disc)
        : inner(disc), side(cellDeficit(disc, 1, 0)), corner(cellDeficit(disc, 1, 1)) {}
    VOREL_INLINE U8s dilated(const uint8_t* source, int64_t stride) const {
        const U8s sides = max(max(load<U8s>(source - 1), load<U8s>(source + 1)),
                              max(load<U8s>(source - stride), load<U8s>(source + stride)));
        const U8s corners = mirrored(source, 1, stride);
        const U8s result = max(subSaturated(sides, side), subSaturated(corners, corner));
        return max(result, inner.dilated(source, stride));
    }
};

/// With the sixteen cells around those.
struct FarCells {
    static constexpr int kReach = 2;
    NearCells inner;
    U8s side, between, corner;

    explicit FarCells(const DiscShape& disc)
        : inner(disc),
          side(cellDeficit(disc, 2, 0)),
          between(cellDeficit(disc, 2, 1)),
          corner(cellDeficit(disc, 2, 2)) {}
    VOREL_INLINE U8s dilated(const uint8_t* source, int64_t stride) const {
        const U8s sides = max(max(load<U8s>(source - 2), load<U8s>(source + 2)),
                              max(load<U8s>(source - 2 * stride), load<U8s>(source + 2 * stride)));
        const U8s betweens = max(mirrored(source, 2, stride), mirrored(source, 1, 2 * stride));
        const U8s corners = mirrored(source, 2, 2 * stride);
        const U8s straight = max(subSaturated(sides, side), subSaturated(betweens, between));
        const U8s result = max(straight, subSaturated(corners, corner));
        return max(result, inner.dilated(source, stride));
    }
};

inline void beginCells(const Dilation& dilation, uint8_t* memory) {
    layOut<CellLayout>(dilation, memory);
}

template <class Cells>
uint8_t* rowsByCells(const Dilation& dilation, uint8_t* memory, int64_t y, int64_t count) {
    const auto planes = layoutIn<CellLayout>(memory);
    for (int64_t row = 0; row < count + 2 * Cells::kReach; ++row)
        fillRow(dilation, y + row - Cells::kReach, planes.rows, row);
    const Cells cells(*dilation.disc);
    const int64_t width = dilation.right - dilation.left;
    uint8_t* results = planes.results;
    for (int64_t row = 0; row < count; ++row, results += dilatedStride(dilation)) {
        const uint8_t* const source = planes.rows.at(row + Cells::kReach) + dilation.left;
        for (int64_t x = 0; x < width; x += kBytes)
            store(results + x, cells.dilated(source + x, planes.rows.stride));
    }
    return planes.results;
}

template <class Cells>
constexpr DilationStrategy kCellStrategy = {layoutBytes<CellLayout>, beginCells, rowsByCells<Cells>};

}  // namespace VFontEffect::internal::VOREL_LEVEL
