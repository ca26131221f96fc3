#pragma once

#include <cstdint>

#include "cores/dilation_rows.h"

/// Dilation by small discs: every cell of the disc is looked at.
///
/// A vector of results is the maximum of loads at fixed distances from the vector's own place, its taps.
/// A run of full cells takes few taps where rows of windowed maxima stand beside the rows of coverage.
/// Taps come in fours of equal weight, which share one subtraction: a cell of the rim has its mirror
/// images, and a tap too many is one that was there already, as that changes no maximum.
///
/// A vector that is full after the taps of the middle row, or after all full cells, is done. Columns of
/// vectors without any covered pixel near them are left out.
///
/// Cost: 12 taps for a disc of radius 1, 28 for 2, 48 for 4, 112 for 8, for each vector near an outline.
namespace VFontEffect::internal::VOREL_LEVEL {

constexpr int kLongestTappedReach = 8;

/// Four loads and what is taken off the largest of them.
struct TapQuad {
    int32_t taps[4];
    uint8_t deficit[kBytes];
};

/// All taps of a disc.
struct Taps {
    // 17 rows of at most 5 taps, and at most 4 * reach cells in a quarter of the rim.
    static constexpr int kMostQuads = 17 * 2 + 4 * kLongestTappedReach;

    TapQuad quads[kMostQuads];
    int middleEnd;  ///< the full cells of the middle row end here
    int flatEnd;    ///< and those of all rows here
    int end;
};

/// The way's working memory.
struct TapPlanes {
    Taps* taps;
    PaddedRows rows;
    int windows;  ///< planes of windows behind the plane of coverage, each as large
    int64_t planeBytes;
    size_t bytes;
};

/// The windows' lengths: the first has 4 pixels, the second is made of four of these.
constexpr int64_t kShortWindow = 4;
VOREL_INLINE int64_t secondStep(int64_t reach) {
    return reach < 6 ? 1 : 2;
}
VOREL_INLINE int64_t windowLength(int64_t reach, int i) {
    return i == 0 ? kShortWindow : kShortWindow + 3 * secondStep(reach);
}

inline TapPlanes tapPlanes(const Dilation& dilation) {
    const int64_t reach = dilation.disc->reach;
    const int64_t rowCount = kBandRows + 2 * reach;
    Arena arena = {dilation.memory};
    TapPlanes planes;
    planes.windows = reach < 3 ? 0 : reach < 4 ? 1 : 2;
    planes.taps = arena.take<Taps>(1);
    planes.rows = takeRows(dilation, (1 + planes.windows) * rowCount, arena);
    planes.planeBytes = rowCount * planes.rows.stride;
    planes.bytes = arena.used;
    return planes;
}

// --- The list of taps --------------------------------------------------------------------------------

/// Gathers taps of one weight in fours.
class QuadWriter {
  public:
    QuadWriter(Taps& taps, uint8_t deficit) : mTaps(taps), mDeficit(deficit), mCount(0) {}
    ~QuadWriter() {
        while (mCount % 4 != 0)
            add(mTaps.quads[mTaps.end - 1].taps[0]);
    }
    QuadWriter(const QuadWriter&) = delete;
    QuadWriter& operator=(const QuadWriter&) = delete;

    void add(int64_t tap) {
        if (mCount % 4 == 0) setBytes(mTaps.quads[mTaps.end++].deficit, mDeficit, kBytes);
        mTaps.quads[mTaps.end - 1].taps[mCount++ % 4] = static_cast<int32_t>(tap);
    }

  private:
    Taps& mTaps;
    uint8_t mDeficit;
    int mCount;
};

/// The run of full cells in a row of the disc, covered by the longest windows that are not too long.
inline void addFlatTaps(const TapPlanes& planes, int64_t discReach, int64_t dy, int64_t reach,
                        QuadWriter& writer) {
    const int64_t length = 2 * reach + 1;
    int64_t row = dy * planes.rows.stride;
    int64_t step = 1;
    for (int i = 0; i < planes.windows && length >= windowLength(discReach, i); ++i) {
        row += planes.planeBytes;
        step = windowLength(discReach, i);
    }
    const int64_t last = reach + 1 - step;
    for (int64_t dx = -reach; dx < last; dx += step)
        writer.add(row + dx);
    writer.add(row + last);
}

inline void listFlatTaps(const TapPlanes& planes, const DiscShape& disc) {
    Taps& taps = *planes.taps;
    if (disc.flatReach[0] >= 0) {
        QuadWriter writer(taps, 0);
        addFlatTaps(planes, disc.reach, 0, disc.flatReach[0], writer);
    }
    taps.middleEnd = taps.end;
    QuadWriter writer(taps, 0);
    for (int64_t dy = 1; dy <= disc.reach && disc.flatReach[dy] >= 0; ++dy) {
        addFlatTaps(planes, disc.reach, dy, disc.flatReach[dy], writer);
        addFlatTaps(planes, disc.reach, -dy, disc.flatReach[dy], writer);
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
    Taps& taps = *planes.taps;
    taps.end = 0;
    listFlatTaps(planes, disc);
    taps.flatEnd = taps.end;
    for (int64_t dy = 0; dy <= disc.reach; ++dy) {
        const uint8_t* deficit = disc.rimDeficit + disc.rimStart[dy];
        for (int64_t dx = disc.flatReach[dy] + 1; dx <= disc.outerReach[dy]; ++dx)
            addRimTaps(planes, dx, dy, *deficit++);
    }
}

// --- Evaluation --------------------------------------------------------------------------------------

VOREL_INLINE Bytes raised(Bytes result, const TapQuad* quad, const TapQuad* end, const uint8_t* source) {
    for (; quad < end; ++quad) {
        const int32_t* const taps = quad->taps;
        const Bytes left = larger(load<Bytes>(source + taps[0]), load<Bytes>(source + taps[1]));
        const Bytes right = larger(load<Bytes>(source + taps[2]), load<Bytes>(source + taps[3]));
        result = larger(result, subSaturated(larger(left, right), load<Bytes>(quad->deficit)));
    }
    return result;
}

VOREL_INLINE Bytes dilatedVector(const Taps& taps, const uint8_t* source) {
    const TapQuad* const quads = taps.quads;
    Bytes result = raised(Bytes{}, quads, quads + taps.middleEnd, source);
    if (allZero(~result)) return result;
    result = raised(result, quads + taps.middleEnd, quads + taps.flatEnd, source);
    if (allZero(~result)) return result;
    return raised(result, quads + taps.flatEnd, quads + taps.end, source);
}

/// Whether anything is covered in a column of vectors, or as near to it as the disc reaches.
inline bool isBusy(const PaddedRows& rows, int64_t count, int64_t x, int64_t reach) {
    Bytes ink = {};
    for (int64_t dx = -reach;; dx = smaller(dx + kBytes, reach)) {
        for (int64_t row = 0; row < count; ++row)
            ink |= load<Bytes>(rows.at(row) + x + dx);
        if (dx == reach) return !allZero(ink);
    }
}

inline void dilateRowsByTaps(const Dilation& dilation, int64_t y, int64_t count, uint8_t* results) {
    const TapPlanes planes = tapPlanes(dilation);
    const int64_t reach = dilation.disc->reach;
    const int64_t rowCount = count + 2 * reach;
    for (int64_t row = 0; row < rowCount; ++row) {
        fillRow(dilation, y - reach + row, planes.rows, row);
        uint8_t* const pixels = planes.rows.at(row);
        uint8_t* const windows = pixels + planes.planeBytes;
        if (planes.windows > 0) widenWindows(planes.rows, pixels, windows, 1);
        if (planes.windows > 1)
            widenWindows(planes.rows, windows, windows + planes.planeBytes, secondStep(reach));
    }
    const int64_t stride = dilatedStride(dilation);
    for (int64_t x = dilation.left; x < dilation.right; x += kBytes) {
        uint8_t* result = results + (x - dilation.left);
        const uint8_t* source = planes.rows.at(reach) + x;
        const bool busy = isBusy(planes.rows, rowCount, x, reach);
        for (int64_t i = 0; i < count; ++i, result += stride, source += planes.rows.stride)
            store(result, busy ? dilatedVector(*planes.taps, source) : Bytes{});
    }
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
