#pragma once

#include <cstdint>

#include "ops/dilate/padded_rows.h"
#include "simd/unrolled.h"

/// Dilation by the smallest discs, of a reach of up to 2: each cell is a load of its own, and the cells
/// that weigh the same, those a disc maps to one another when it is turned or mirrored, share a
/// subtraction.
///
/// Cost: 9 loads a vector for a reach of 1, 25 for one of 2. Telling empty stretches would cost as much.
namespace VFontEffect::internal::VOREL_LEVEL {

struct CellLayout {
    PaddedRows rows;
    uint8_t* results;  ///< of a band

    static CellLayout of(const Dilation& dilation, Arena& arena) {
        const int64_t reach = dilation.disc->reach;
        return {takeRows(dilation, wantedColumns(dilation), dilation.bandRows + 2 * reach, reach,
                         reach + kBytes, arena),
                arena.take<uint8_t>(dilation.bandRows * dilatedStride(dilation))};
    }
};

/// 255 - weight of the cells that lie that far aside.
inline uint8_t cellDeficit(const DiscShape& disc, int dx, int dy) {
    if (dx <= disc.flatReach[dy]) return 0;
    if (dx > disc.outerReach[dy]) return 255;
    return disc.rimDeficit[disc.rimStart[dy] + dx - disc.flatReach[dy] - 1];
}

/// The largest of the pixels that lie dx columns and dy rows aside, on all sides.
template <int kDx, int kDy>
VOREL_INLINE U8s mirrored(const uint8_t* source, int64_t stride) {
    const uint8_t* const below = source + kDy * stride;
    if constexpr (kDy == 0) return max(load<U8s>(source - kDx), load<U8s>(source + kDx));
    const uint8_t* const above = source - kDy * stride;
    if constexpr (kDx == 0) return max(load<U8s>(above), load<U8s>(below));
    return max(max(load<U8s>(above - kDx), load<U8s>(above + kDx)),
               max(load<U8s>(below - kDx), load<U8s>(below + kDx)));
}

/// A disc of that reach, by its cells (dx, dy) of an eighth: 0 <= dy <= dx.
template <int kReach>
struct Cells {
    U8s deficits[kReach + 1][kReach + 1];

    /// Here, so that they stay in registers.
    VOREL_INLINE explicit Cells(const DiscShape& disc) {
        unrolled<kReach + 1>([&](auto x) VOREL_INLINE_LAMBDA {
            unrolled<x.value + 1>([&](auto y) VOREL_INLINE_LAMBDA {
                deficits[x.value][y.value] = splat<U8s>(cellDeficit(disc, x.value, y.value));
            });
        });
    }
    VOREL_INLINE U8s dilated(const uint8_t* source, int64_t stride) const {
        U8s result = subSaturated(load<U8s>(source), deficits[0][0]);
        unrolled<kReach + 1, 1>([&](auto x) VOREL_INLINE_LAMBDA {
            constexpr int kDx = x.value;
            unrolled<kDx + 1>([&](auto y) VOREL_INLINE_LAMBDA {
                constexpr int kDy = y.value;
                U8s cells = mirrored<kDx, kDy>(source, stride);
                if constexpr (kDx != kDy) cells = max(cells, mirrored<kDy, kDx>(source, stride));
                result = max(result, subSaturated(cells, deficits[kDx][kDy]));
            });
        });
        return result;
    }
};

inline void beginCells(const Dilation& dilation, uint8_t* memory) {
    layOut<CellLayout>(dilation, memory);
}

template <int64_t kReach>
uint8_t* rowsByCells(const Dilation& dilation, uint8_t* memory, int64_t y, int64_t count) {
    const auto planes = layoutIn<CellLayout>(memory);
    for (int64_t row = 0; row < count + 2 * kReach; ++row)
        fillRow(dilation, y + row - kReach, planes.rows, row);
    const Cells<kReach> cells(*dilation.disc);
    const int64_t width = dilation.right - dilation.left;
    uint8_t* results = planes.results;
    for (int64_t row = 0; row < count; ++row, results += dilatedStride(dilation)) {
        const uint8_t* const source = planes.rows.at(row + kReach) + dilation.left;
        for (int64_t x = 0; x < width; x += kBytes)
            store(results + x, cells.dilated(source + x, planes.rows.stride));
    }
    return planes.results;
}

template <int64_t kReach>
constexpr DilationStrategy kCells = {layoutBytes<CellLayout>, beginCells, rowsByCells<kReach>};

}  // namespace VFontEffect::internal::VOREL_LEVEL
