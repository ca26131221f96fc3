#pragma once

#include <cstdint>

#include "cores/dilation_rows.h"

/// Dilation by discs that are not large: all cells of the disc are looked at.
///
/// A vector of results is the maximum of loads at fixed distances from the vector's own place, its taps.
/// A run of full cells takes few taps where rows of windowed maxima stand beside the rows of coverage.
/// Taps come in fours of equal weight, which share one subtraction: a cell of the rim has its mirror
/// images, and a tap too many is one that was there already, as that changes no maximum.
///
/// Vectors with nothing covered in the square around their discs are left out. So are those that a
/// single row fills: one whose windows of the longer kind are all full, and not too far away for these
/// windows.
///
/// Cost: 36 taps for a disc of radius 4, 100 for 8, for each vector along the outline; 20 instructions
/// for any other one.
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
    int count;
};

/// The windows' lengths: the first has 4 pixels, the second is made of four of these.
constexpr int64_t kShortWindow = 4;
VOREL_INLINE int64_t secondStep(int64_t reach) {
    return reach < 6 ? 1 : 2;
}
VOREL_INLINE int64_t windowLength(int64_t reach, int i) {
    return i == 0 ? kShortWindow : kShortWindow + 3 * secondStep(reach);
}

/// The way's working memory.
struct TapPlanes {
    Taps* taps;
    PaddedRows rows;
    int windows;  ///< planes of windows behind the plane of coverage, each as large
    int64_t planeBytes;
    // By row, then by vector of the result: 255 where the row
    uint8_t* inked;   ///< holds covered pixels
    uint8_t* filled;  ///< has only full windows of the longer kind in the middle of the disc
    uint8_t* near;    ///< of one row of results: where any row in reach is inked
    uint8_t* full;    ///< and where any row that is near enough is filled
    int64_t vectors;
    int64_t flagStride;
    size_t bytes;
};

inline TapPlanes tapPlanes(const Dilation& dilation) {
    const int64_t reach = dilation.disc->reach;
    const int64_t rowCount = kBandRows + 2 * reach;
    Arena arena = {dilation.memory};
    TapPlanes planes;
    planes.taps = arena.take<Taps>(1);
    planes.windows = reach < 4 ? 1 : 2;
    planes.rows = takeRows(dilation, (1 + planes.windows) * rowCount, reach - dilation.left,
                           dilation.right + reach - dilation.width, arena);
    planes.planeBytes = rowCount * planes.rows.stride;
    planes.vectors = (dilation.right - dilation.left + kBytes - 1) / kBytes;
    planes.flagStride = (planes.vectors + kBytes - 1) / kBytes * kBytes;
    planes.inked = arena.take<uint8_t>(rowCount * planes.flagStride);
    planes.filled = arena.take<uint8_t>(rowCount * planes.flagStride);
    planes.near = arena.take<uint8_t>(planes.flagStride);
    planes.full = arena.take<uint8_t>(planes.flagStride);
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
            add(mTaps.quads[mTaps.count - 1].taps[0]);
    }
    QuadWriter(const QuadWriter&) = delete;
    QuadWriter& operator=(const QuadWriter&) = delete;

    void add(int64_t tap) {
        if (mCount % 4 == 0) setBytes(mTaps.quads[mTaps.count++].deficit, mDeficit, kBytes);
        mTaps.quads[mTaps.count - 1].taps[mCount++ % 4] = static_cast<int32_t>(tap);
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
    QuadWriter writer(*planes.taps, 0);
    for (int64_t dy = 0; dy <= disc.reach && disc.flatReach[dy] >= 0; ++dy) {
        addFlatTaps(planes, disc.reach, dy, disc.flatReach[dy], writer);
        if (dy != 0) addFlatTaps(planes, disc.reach, -dy, disc.flatReach[dy], writer);
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

// --- Vectors that need no evaluation -----------------------------------------------------------------

/// Notes in which vectors a row is inked and filled.
inline void noteFlags(const Dilation& dilation, const TapPlanes& planes, int64_t row) {
    const uint8_t* const source = planes.rows.at(row) + dilation.left;
    const int64_t length = windowLength(dilation.disc->reach, planes.windows - 1);
    const uint8_t* const windows = source + planes.windows * planes.planeBytes - (length - 1) / 2;
    uint8_t* const inked = planes.inked + row * planes.flagStride;
    uint8_t* const filled = planes.filled + row * planes.flagStride;
    for (int64_t i = 0; i < planes.vectors; ++i) {
        inked[i] = allZero(load<Bytes>(source + i * kBytes)) ? 0 : 255;
        filled[i] = allZero(~load<Bytes>(windows + i * kBytes)) ? 255 : 0;
    }
}

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

/// The last row of the disc whose full cells hold the windows of the longer kind in the middle; -1 for
/// none.
inline int64_t filledReach(const TapPlanes& planes, const DiscShape& disc) {
    const int64_t half = windowLength(disc.reach, planes.windows - 1) / 2;
    int64_t dy = disc.reach;
    while (dy >= 0 && disc.flatReach[dy] < half)
        --dy;
    return dy;
}

// --- Evaluation --------------------------------------------------------------------------------------

VOREL_INLINE Bytes dilatedVector(const Taps& taps, const uint8_t* source) {
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

/// Whether a vector, or one as near to it as the disc reaches, has an inked row.
VOREL_INLINE bool isNear(const TapPlanes& planes, int64_t vector, int64_t reach) {
    const int64_t spread = (reach + kBytes - 1) / kBytes;
    const int64_t end = smaller(vector + spread + 1, planes.vectors);
    for (int64_t i = larger<int64_t>(vector - spread, 0); i < end; ++i) {
        if (planes.near[i] != 0) return true;
    }
    return false;
}

inline void fillBand(const Dilation& dilation, const TapPlanes& planes, int64_t y, int64_t rowCount) {
    const int64_t reach = dilation.disc->reach;
    for (int64_t row = 0; row < rowCount; ++row) {
        fillRow(dilation, y + row, planes.rows, row);
        uint8_t* const pixels = planes.rows.at(row);
        uint8_t* const windows = pixels + planes.planeBytes;
        widenWindows(planes.rows, pixels, windows, 1);
        if (planes.windows > 1)
            widenWindows(planes.rows, windows, windows + planes.planeBytes, secondStep(reach));
        noteFlags(dilation, planes, row);
    }
}

inline void dilateRowsByTaps(const Dilation& dilation, int64_t y, int64_t count, uint8_t* results) {
    const TapPlanes planes = tapPlanes(dilation);
    const int64_t reach = dilation.disc->reach;
    fillBand(dilation, planes, y - reach, count + 2 * reach);
    const int64_t fillingReach = filledReach(planes, *dilation.disc);
    for (int64_t row = reach; row < reach + count; ++row, results += dilatedStride(dilation)) {
        gatherFlags(planes, planes.inked, row, reach, planes.near);
        gatherFlags(planes, planes.filled, row, fillingReach, planes.full);
        const uint8_t* const source = planes.rows.at(row) + dilation.left;
        for (int64_t i = 0; i < planes.vectors; ++i) {
            Bytes result = spread<Bytes>(planes.full[i]);
            if (planes.full[i] == 0 && isNear(planes, i, reach))
                result = dilatedVector(*planes.taps, source + i * kBytes);
            store(results + i * kBytes, result);
        }
    }
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
