#pragma once

#include <cstdint>
#include <cstring>

#include "core/arena.h"
#include "core/assert.h"
#include "ops/dilate/dilation_loops.h"
#include "simd/pieces.h"

/// Working memory of the strategies, and rows of source pixels as all of them read them.
namespace VFontEffect::internal::VOREL_LEVEL {

/// Bytes of memory for a strategy's `Layout`, which `Layout::of(dilation, arena)` takes, and which
/// stands at their beginning itself.
template <class Layout>
int64_t layoutBytes(const Dilation& dilation) {
    Arena arena = {nullptr};
    arena.take<Layout>(1);
    Layout::of(dilation, arena);
    return arena.used;
}

template <class Layout>
Layout& layOut(const Dilation& dilation, uint8_t* memory) {
    VOREL_ASSERT(reinterpret_cast<uintptr_t>(memory) % kArenaAlignment == 0);
    Arena arena = {memory};
    Layout& layout = *arena.take<Layout>(1);
    layout = Layout::of(dilation, arena);
    VOREL_ASSERT(arena.used == layoutBytes<Layout>(dilation));
    return layout;
}

/// Where numbers stand that change from band to band.
template <class Layout>
VOREL_INLINE Layout& keptIn(uint8_t* memory) {
    return *reinterpret_cast<Layout*>(memory);
}

/// By value: stores of bytes could change what stands in memory, for all that a compiler knows.
template <class Layout>
VOREL_INLINE Layout layoutIn(const uint8_t* memory) {
    return *reinterpret_cast<const Layout*>(memory);
}

/// Rows of the source with zeros to both sides, as far as any load goes.
struct PaddedRows {
    uint8_t* start;
    int64_t count;
    int64_t stride;
    int64_t lead;   ///< columns before column 0
    int64_t width;  ///< of the source

    /// Column 0 of a row.
    VOREL_INLINE uint8_t* at(int64_t row) const {
        VOREL_ASSERT(row >= 0 && row < count);
        return start + row * stride + lead;
    }
};

/// Columns of results.
struct Columns {
    int64_t left;
    int64_t right;
};

VOREL_INLINE Columns wantedColumns(const Dilation& dilation) {
    return {dilation.left, dilation.right};
}

/// Rows in which there are so many columns before and behind those of the results, the reach or more. No
/// more of the source lies there.
VOREL_INLINE PaddedRows takeRows(const Dilation& dilation, const Columns& results, int64_t count,
                                 int64_t before, int64_t behind, Arena& arena) {
    const int64_t lead = before - results.left;
    const int64_t stride = lead + results.right + behind;
    VOREL_ASSERT(lead >= 0 && lead + dilation.width <= stride);
    return {arena.take<uint8_t>(count * stride), count, stride, lead, dilation.width};
}

VOREL_INLINE void setBytes(uint8_t* to, uint8_t value, int64_t count) {
    std::memset(to, value, static_cast<size_t>(count));
}

VOREL_INLINE void clearRow(const PaddedRows& rows, int64_t row) {
    setBytes(rows.at(row) - rows.lead, 0, rows.stride);
}

/// Copies row y of the source, with zeros around. Rows outside of the source are empty.
inline void fillRow(const Dilation& dilation, int64_t y, const PaddedRows& rows, int64_t row) {
    if (y < 0 || y >= dilation.height) return clearRow(rows, row);
    uint8_t* const to = rows.at(row);
    setBytes(to - rows.lead, 0, rows.lead);
    setBytes(to + rows.width, 0, rows.stride - rows.lead - rows.width);
    const CoverageRows& box = dilation.box;
    const int64_t boxRow = y - dilation.boxTop;
    if (boxRow < 0 || boxRow >= box.height) return setBytes(to, box.invertMask, rows.width);
    // The border's columns, or the box's over them.
    to[0] = to[rows.width - 1] = box.invertMask;
    copyInverted(box.start + boxRow * box.stride, box.width, box.invertMask, to + dilation.boxLeft);
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
