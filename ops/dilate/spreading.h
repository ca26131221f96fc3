#pragma once

#include <cstdint>
#include <cstring>

#include "ops/dilate/padded_rows.h"
#include "simd/tuning.h"

/// Dilation by discs that are not large: each row of the source is spread over the rows of results that
/// its discs reach.
///
/// What a vector of the source gives to the rows d above and below it is one vector: the maximum over
/// row d of the disc. The full cells of the disc's rows are runs around the middle, one within the other
/// from the disc's end to its middle row, so a running maximum of pairs of loads, k columns to the left
/// and to the right, serves them all; the cells of the rim take the same pairs less what they lack.
///
/// Vectors without anything covered in reach are left out, and so is the inside of glyphs: a full vector
/// fills as many rows as the disc has full cells in its middle column, all but the lowest of which the
/// full vector above it has filled.
///
/// Cost: for a reach of r, 2 r + 2 loads, up to 3 r cells of the rim and 2 r + 1 maxima with rows of
/// results, for each vector of the source along the outline.
namespace VFontEffect::internal::VOREL_LEVEL {

struct SpreadLayout {
    PaddedRows row;     ///< one of the source's
    uint8_t* deficits;  ///< vectors of 255 - weight: of the rim, from the disc's end to its middle row,
                        ///< from the inside outwards
    uint8_t* wasFull;   ///< for each vector of a row whether the row before was full there
    uint8_t* rows;      ///< of results: 2 * reach before a band, the band, and 2 * reach behind it
    int64_t stride;

    static SpreadLayout of(const Dilation& dilation, Arena& arena) {
        const int64_t reach = dilation.disc->reach;
        SpreadLayout layout;
        // The first column that is wanted begins a line of the cache.
        layout.row = takeRows(dilation, wantedColumns(dilation), 1, roundedUp(reach, kArenaAlignment),
                              reach + kBytes, arena);
        layout.deficits = arena.take<uint8_t>(4 * (kLongestSpreadReach + 1) * kBytes);
        layout.stride = dilatedStride(dilation);
        layout.wasFull = arena.take<uint8_t>(layout.stride / kBytes);
        layout.rows = arena.take<uint8_t>((dilation.bandRows + 4 * reach) * layout.stride);
        return layout;
    }
};

inline void beginSpreading(const Dilation& dilation, uint8_t* memory) {
    const DiscShape& disc = *dilation.disc;
    VOREL_ASSERT(disc.reach <= kLongestSpreadReach);
    uint8_t* deficits = layOut<SpreadLayout>(dilation, memory).deficits;
    for (int64_t d = disc.reach; d >= 0; --d) {
        for (int i = 0; i < disc.outerReach[d] - disc.flatReach[d]; ++i, deficits += kBytes)
            setBytes(deficits, disc.rimDeficit[disc.rimStart[d] + i], kBytes);
    }
}

/// Whether anything is covered within reach of a vector.
VOREL_INLINE bool reachesCoverage(const uint8_t* source, int64_t reach) {
    U8s all = load<U8s>(source + reach);
    for (int64_t k = -reach; k < reach; k += kBytes)
        all |= load<U8s>(source + k);
    return !allZero(all);
}

VOREL_INLINE void raise(uint8_t* target, U8s value) {
    store(target, max(load<U8s>(target), value));
}

/// Spreads a vector of the source; `target` is its own place among the results.
inline void spreadVector(const DiscShape& disc, const SpreadLayout& planes, const uint8_t* source,
                         uint8_t* target) {
    U8s pairs[kLongestSpreadReach + 1];
    for (int64_t k = 0; k <= disc.reach; ++k)
        pairs[k] = max(load<U8s>(source - k), load<U8s>(source + k));
    const uint8_t* deficits = planes.deficits;
    U8s flat = {};
    int64_t k = 0;
    for (int64_t d = disc.reach; d >= 0; --d) {
        for (; k <= disc.flatReach[d]; ++k)
            flat = max(flat, pairs[k]);
        U8s value = flat;
        for (int64_t rim = disc.flatReach[d] + 1; rim <= disc.outerReach[d]; ++rim) {
            value = max(value, subSaturated(pairs[rim], load<U8s>(deficits)));
            deficits += kBytes;
        }
        raise(target - d * planes.stride, value);
        if (d != 0) raise(target + d * planes.stride, value);
    }
}

/// Spreads a row of the source; `targets` is its own row of results.
inline void spreadRow(const Dilation& dilation, const SpreadLayout& planes, uint8_t* targets) {
    const DiscShape& disc = *dilation.disc;
    const uint8_t* const source = planes.row.at(0) + dilation.left;
    // A disc that ends with rows of the rim alone reaches farther than it fills.
    const bool fillsItsReach = disc.flatReach[disc.reach] >= 0;
    for (int64_t x = 0; x < dilation.right - dilation.left; x += kBytes) {
        uint8_t& wasFull = planes.wasFull[x / kBytes];
        const bool isFull = fillsItsReach && allZero(~load<U8s>(source + x));
        if (isFull && wasFull != 0) {
            store(targets + x + disc.reach * planes.stride, ~U8s{});
        } else if (reachesCoverage(source + x, disc.reach)) {
            spreadVector(disc, planes, source + x, targets + x);
        }
        wasFull = isFull;
    }
}

/// Makes room for the rows of results of the band that begins with row y: some of them have been begun.
inline void nextBand(const Dilation& dilation, const SpreadLayout& planes, bool isFirst) {
    const int64_t reach = dilation.disc->reach;
    const int64_t begun = isFirst ? 0 : 2 * reach;
    uint8_t* const band = planes.rows + 2 * reach * planes.stride;
    std::memmove(band, band + dilation.bandRows * planes.stride,
                 static_cast<size_t>(begun * planes.stride));
    const int64_t rest = dilation.bandRows + 2 * reach - begun;
    setBytes(band + begun * planes.stride, 0, rest * planes.stride);
    if (isFirst) setBytes(planes.wasFull, 0, planes.stride / kBytes);
}

/// The band before has spread the rows in its reach.
inline uint8_t* rowsBySpreading(const Dilation& dilation, uint8_t* memory, int64_t y, int64_t count) {
    const auto planes = layoutIn<SpreadLayout>(memory);
    const int64_t reach = dilation.disc->reach;
    const bool isFirst = y == dilation.top;
    nextBand(dilation, planes, isFirst);
    uint8_t* const band = planes.rows + 2 * reach * planes.stride;
    const int64_t end = min(y + count + reach, dilation.height);
    for (int64_t row = max<int64_t>(isFirst ? y - reach : y + reach, 0); row < end; ++row) {
        fillRow(dilation, row, planes.row, 0);
        spreadRow(dilation, planes, band + (row - y) * planes.stride);
    }
    return band;
}

constexpr DilationStrategy kSpreading = {layoutBytes<SpreadLayout>, beginSpreading, rowsBySpreading};

}  // namespace VFontEffect::internal::VOREL_LEVEL
