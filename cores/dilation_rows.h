#pragma once

#include <cstdint>
#include <cstring>

#include "blend/lanes.h"
#include "cores/dilation.h"

/// Rows of source pixels as both ways of dilation read them, and windowed maxima of them.
namespace VFontEffect::internal::VOREL_LEVEL {

/// Columns to the right of what a disc can reach, for the ends of vectors and windows.
constexpr int64_t kSlack = 256;

/// Rows with so many zeros to both sides that the disc around any pixel of the result lies in them.
struct PaddedRows {
    uint8_t* start;
    int64_t stride;
    int64_t lead;  ///< columns before column 0

    /// Column 0 of a row.
    VOREL_INLINE uint8_t* at(int64_t row) const { return start + row * stride + lead; }
    VOREL_INLINE uint8_t* wholeRow(int64_t row) const { return start + row * stride; }
};

/// Their measures, with no memory yet.
VOREL_INLINE PaddedRows paddedRowsOf(const Dilation& dilation) {
    const int64_t reach = dilation.disc->reach;
    const int64_t lead = reach - dilation.left;
    return {nullptr, lead + dilation.right + reach + kSlack, lead};
}

VOREL_INLINE void setBytes(uint8_t* to, uint8_t value, int64_t count) {
    std::memset(to, value, static_cast<size_t>(count));
}

/// Copies row y of the source, which may lie outside of it, with zeros around.
inline void fillRow(const Dilation& dilation, int64_t y, const PaddedRows& rows, int64_t row) {
    if (y < 0 || y >= dilation.height) return setBytes(rows.wholeRow(row), 0, rows.stride);
    uint8_t* const to = rows.at(row);
    const int64_t width = dilation.width;
    setBytes(to - rows.lead, 0, rows.lead);
    setBytes(to + width, 0, rows.stride - rows.lead - width);
    if (y == 0 || y == dilation.height - 1) return setBytes(to, dilation.flip, width);
    const uint8_t* const from = dilation.box + (y - 1) * dilation.boxStride;
    to[0] = to[width - 1] = dilation.flip;
    if (dilation.flip == 0) {
        std::memcpy(to + 1, from, static_cast<size_t>(width - 2));
    } else {
        for (int64_t x = 0; x < width - 2; ++x)
            to[x + 1] = static_cast<uint8_t>(~from[x]);
    }
}

/// The largest of four pixels that stand `step` apart, the first of them at the result's place. From
/// windows of `step` pixels this makes windows of four times as many; `to` may be `from`.
inline void widenWindows(const uint8_t* from, uint8_t* to, int64_t step, int64_t count) {
    int64_t x = 0;
    for (; x + 3 * step + kBytes <= count; x += kBytes) {
        const uint8_t* const p = from + x;
        const Bytes left = larger(load<Bytes>(p), load<Bytes>(p + step));
        const Bytes right = larger(load<Bytes>(p + 2 * step), load<Bytes>(p + 3 * step));
        store(to + x, larger(left, right));
    }
    // The slack, in which there is nothing.
    setBytes(to + x, 0, count - x);
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
