#pragma once

#include <cstdint>

#include "cores/dilation_ink.h"
#include "cores/dilation_rows.h"

/// Dilation by discs that are not large: all cells of the disc are looked at.
///
/// A vector of results is the maximum of loads at fixed distances from the vector's own place, its taps.
/// A run of full cells takes few taps, as rows of windowed maxima stand beside the rows of coverage.
/// Taps come in fours of equal weight, which share one subtraction: a cell of the rim has its mirror
/// images, and where a tap is missing another one stands twice, which changes no maximum.
///
/// Vectors with nothing covered in the square around their discs are left out, and so are vectors that a
/// single row fills: all its windows there are full, and the disc's full cells hold a window in that
/// row.
///
/// Cost: 36 taps for a disc of radius 4, 104 for 8, for each vector along the outline; some 20
/// instructions for any other one.
namespace VFontEffect::internal::VOREL_LEVEL {

constexpr int kLongestTappedReach = 8;

/// A window reaches that far to both sides. It serves rows of full cells that are as long at least.
VOREL_INLINE int64_t windowHalf(const DiscShape& disc) {
    return disc.reach < 5 ? 2 : 3;
}

/// Four loads and what is taken off the largest of them.
struct TapQuad {
    int32_t taps[4];
    uint8_t deficit[kBytes];
};

/// All taps of a disc.
struct TapList {
    // At most 5 taps for each row of full cells, and 4 * reach cells in a quarter of the rim.
    static constexpr int kMostQuads =
        (5 * (2 * kLongestTappedReach + 1) + 3) / 4 + 4 * kLongestTappedReach;

    TapQuad quads[kMostQuads];
    int count;
};

/// The way's working memory.
struct TapPlanes {
    TapList* taps;
    PaddedRows rows;     ///< coverage
    PaddedRows windows;  ///< the largest coverage around each pixel
    int64_t vectors;     ///< in a row of the result
    int64_t margin;      ///< vectors before and behind these that the disc reaches
    // By row, then by vector, the margin first: 255 where the row's windows
    uint8_t* inked;   ///< are not all empty
    uint8_t* filled;  ///< are all full
    int64_t flagStride;
    // Flags of one row of results.
    uint8_t* near;
    uint8_t* full;
    size_t bytes;
};

inline TapPlanes tapPlanes(const Dilation& dilation) {
    const int64_t reach = dilation.disc->reach;
    const int64_t rowCount = dilation.bandRows + 2 * reach;
    Arena arena = {dilation.memory};
    TapPlanes planes;
    planes.vectors = (dilation.right - dilation.left + kBytes - 1) / kBytes;
    planes.margin = (reach + kBytes - 1) / kBytes;
    planes.taps = arena.take<TapList>(1);
    const int64_t beside = planes.margin * kBytes + reach;
    planes.rows = takeRows(dilation, rowCount, beside, beside + kBytes, arena);
    planes.windows = planes.rows;
    planes.windows.start = arena.take<uint8_t>(rowCount * planes.windows.stride);
    planes.flagStride = (planes.vectors + 2 * planes.margin + kBytes - 1) / kBytes * kBytes;
    planes.inked = arena.take<uint8_t>(rowCount * planes.flagStride);
    planes.filled = arena.take<uint8_t>(rowCount * planes.flagStride);
    planes.near = arena.take<uint8_t>(planes.flagStride + kBytes);
    planes.full = arena.take<uint8_t>(planes.flagStride + kBytes);
    planes.bytes = arena.used;
    return planes;
}

// --- The list of taps --------------------------------------------------------------------------------

/// Gathers taps of one weight in fours.
class QuadWriter {
  public:
    QuadWriter(TapList& taps, uint8_t deficit) : mTaps(taps), mDeficit(deficit), mCount(0) {}
    ~QuadWriter() {
        while (mCount % 4 != 0)
            add(mTaps.quads[mTaps.count - 1].taps[0]);
    }
    QuadWriter(const QuadWriter&) = delete;
    QuadWriter& operator=(const QuadWriter&) = delete;

    void add(int64_t tap) {
        if (mCount % 4 == 0) setBytes(mTaps.quads[mTaps.count++].deficit, mDeficit, kBytes);
        mTaps.quads[mTaps.count - 1].taps[mCount++ % 4] = static_cast<int32_t>(tap);
    }

  private:
    TapList& mTaps;
    uint8_t mDeficit;
    int mCount;
};

/// Covers a run of full cells with windows, or takes its pixels one by one.
inline void addFlatTaps(const TapPlanes& planes, const DiscShape& disc, int64_t dy, QuadWriter& writer) {
    const int64_t reach = disc.flatReach[dy < 0 ? -dy : dy];
    const bool windowed = reach >= windowHalf(disc);
    const int64_t half = windowed ? windowHalf(disc) : 0;
    const int64_t plane = windowed ? planes.windows.start - planes.rows.start : 0;
    const int64_t row = plane + dy * planes.rows.stride;
    for (int64_t dx = half - reach; dx < reach - half; dx += 2 * half + 1)
        writer.add(row + dx);
    writer.add(row + reach - half);
}

inline void listFlatTaps(const TapPlanes& planes, const DiscShape& disc) {
    QuadWriter writer(*planes.taps, 0);
    for (int64_t dy = -disc.reach; dy <= disc.reach; ++dy) {
        if (disc.flatReach[dy < 0 ? -dy : dy] >= 0) addFlatTaps(planes, disc, dy, writer);
    }
}

/// A cell of the rim and its mirror images.
inline void addRimTaps(const TapPlanes& planes, int64_t dx, int64_t dy, uint8_t deficit) {
    const int64_t row = dy * planes.rows.stride;
    QuadWriter writer(*planes.taps, deficit);
    writer.add(row + dx);
    writer.add(row - dx);
    writer.add(-row + dx);
    writer.add(-row - dx);
}

inline void listTaps(const Dilation& dilation) {
    const TapPlanes planes = tapPlanes(dilation);
    const DiscShape& disc = *dilation.disc;
    planes.taps->count = 0;
    listFlatTaps(planes, disc);
    for (int64_t dy = 0; dy <= disc.reach; ++dy) {
        const uint8_t* deficit = disc.rimDeficit + disc.rimStart[dy];
        for (int64_t dx = disc.flatReach[dy] + 1; dx <= disc.outerReach[dy]; ++dx)
            addRimTaps(planes, dx, dy, *deficit++);
    }
}

// --- Rows of the source ------------------------------------------------------------------------------

template <int kHalf>
VOREL_INLINE Bytes windowAround(const uint8_t* pixel) {
    Bytes largest = load<Bytes>(pixel);
    for (int64_t dx = 1; dx <= kHalf; ++dx)
        largest = larger(largest, larger(load<Bytes>(pixel - dx), load<Bytes>(pixel + dx)));
    return largest;
}

/// Makes the windows of a row and their flags.
template <int kHalf>
inline void makeWindows(const Dilation& dilation, const TapPlanes& planes, int64_t row) {
    const int64_t start = dilation.left - planes.margin * kBytes;
    const uint8_t* const source = planes.rows.at(row) + start;
    uint8_t* const windows = planes.windows.at(row) + start;
    uint8_t* const inked = planes.inked + row * planes.flagStride;
    uint8_t* const filled = planes.filled + row * planes.flagStride;
    for (int64_t i = 0; i < planes.vectors + 2 * planes.margin; ++i) {
        const Bytes window = windowAround<kHalf>(source + i * kBytes);
        store(windows + i * kBytes, window);
        inked[i] = allZero(window) ? 0 : 255;
        filled[i] = allZero(~window) ? 255 : 0;
    }
}

inline void fillBand(const Dilation& dilation, const TapPlanes& planes, int64_t y, int64_t rowCount) {
    const bool wide = windowHalf(*dilation.disc) == 3;
    for (int64_t row = 0; row < rowCount; ++row) {
        fillRow(dilation, y + row, planes.rows, row);
        if (y + row < 0 || y + row >= dilation.height) {
            clearRow(planes.windows, row);
            setBytes(planes.inked + row * planes.flagStride, 0, planes.flagStride);
            setBytes(planes.filled + row * planes.flagStride, 0, planes.flagStride);
        } else if (wide) {
            makeWindows<3>(dilation, planes, row);
        } else {
            makeWindows<2>(dilation, planes, row);
        }
    }
}

// --- Rows of results ---------------------------------------------------------------------------------

/// Gathers the flags of the rows around a row.
inline void gatherFlags(const TapPlanes& planes, const uint8_t* flags, int64_t row, int64_t reach,
                        uint8_t* gathered) {
    for (int64_t i = 0; i < planes.flagStride; i += kBytes) {
        Bytes all = {};
        for (int64_t r = row - reach; r <= row + reach; ++r)
            all |= load<Bytes>(flags + r * planes.flagStride + i);
        store(gathered + i, all);
    }
}

/// The last row of the disc whose full cells hold a window in the middle; -1 for none.
inline int64_t filledReach(const DiscShape& disc) {
    int64_t dy = disc.reach;
    while (dy >= 0 && disc.flatReach[dy] < windowHalf(disc))
        --dy;
    return dy;
}

VOREL_INLINE Bytes dilatedVector(const TapList& taps, const uint8_t* source) {
    Bytes result = {};
    for (const TapQuad* quad = taps.quads; quad < taps.quads + taps.count; ++quad) {
        const Bytes left =
            larger(load<Bytes>(source + quad->taps[0]), load<Bytes>(source + quad->taps[1]));
        const Bytes right =
            larger(load<Bytes>(source + quad->taps[2]), load<Bytes>(source + quad->taps[3]));
        result = larger(result, subSaturated(larger(left, right), load<Bytes>(quad->deficit)));
    }
    return result;
}

/// Dilates a row from `source`, its place in the rows of the source, by the flags that were gathered for
/// it.
inline void dilateRow(const TapPlanes& planes, const uint8_t* source, uint8_t* results) {
    const uint8_t* const full = planes.full + planes.margin;
    for (int64_t i = 0; i < planes.vectors; ++i)
        store(results + i * kBytes, spread<Bytes>(full[i]));
    for (int64_t first = 0; first < planes.vectors; first += kBytes) {
        Bytes near = {};
        for (int64_t i = 0; i <= 2 * planes.margin; ++i)
            near |= load<Bytes>(planes.near + first + i);
        uint64_t open = nonZeroLanes(near & ~load<Bytes>(full + first));
        for (; open != 0; open = withoutFirst(open)) {
            const int64_t at = (first + firstLane(open)) * kBytes;
            if (first + firstLane(open) >= planes.vectors) break;
            store(results + at, dilatedVector(*planes.taps, source + at));
        }
    }
}

inline void dilateRowsByTaps(const Dilation& dilation, int64_t y, int64_t count, uint8_t* results) {
    const TapPlanes planes = tapPlanes(dilation);
    const int64_t reach = dilation.disc->reach;
    const int64_t fillingReach = filledReach(*dilation.disc);
    fillBand(dilation, planes, y - reach, count + 2 * reach);
    for (int64_t row = reach; row < reach + count; ++row, results += dilatedStride(dilation)) {
        gatherFlags(planes, planes.inked, row, reach, planes.near);
        gatherFlags(planes, planes.filled, row, fillingReach, planes.full);
        dilateRow(planes, planes.rows.at(row) + dilation.left, results);
    }
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
