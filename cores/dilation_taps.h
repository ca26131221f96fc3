#pragma once

#include <cstdint>

#include "cores/dilation_rows.h"

/// Dilation by small discs: every cell of the disc is looked at, but for stretches of the result that
/// are empty or full beforehand.
///
/// A vector of results is the maximum over taps: loads at fixed distances from the vector's own place. A
/// run of full cells takes few taps where rows of windowed maxima stand beside the rows of coverage. The
/// cells of the rim come in groups of equal weight, each group with one subtraction.
///
/// Cost: 17 taps for a disc of radius 2, 45 for 4, 111 for 8, for each vector near an outline.
namespace VFontEffect::internal::VOREL_LEVEL {

constexpr int kLongestTappedReach = 8;

/// The window of the second plane of rows, and the reach from which on a disc has runs that long.
constexpr int64_t kTapWindow = 4;
constexpr int kShortestWindowedReach = 3;

/// Taps that add their maximum to the result, less 255 - weight.
struct TapGroup {
    uint8_t deficit;
    int16_t end;  ///< in the list of taps; the group starts where its predecessor ends
};

struct Taps {
    // 17 rows of at most 5 taps for the full cells; at most 4 * 32 cells in the rim.
    static constexpr int kMost = 17 * 5 + 4 * 4 * kLongestTappedReach;

    int64_t offsets[kMost];
    TapGroup groups[2 + 4 * kLongestTappedReach];
    int count;
    int groupCount;

    void add(int64_t offset) { offsets[count++] = offset; }
    void endGroup(uint8_t deficit) { groups[groupCount++] = {deficit, static_cast<int16_t>(count)}; }
};

/// Where the method's working memory is.
struct TapPlanes {
    Taps* taps;
    int64_t* busyUntil;  ///< by tile: the first row that no source pixel seen so far reaches
    int64_t tiles;
    PaddedRows rows;
    int64_t rowCount;
    bool windowed;
    int64_t toWindows;  ///< from a pixel to the maximum of the window that starts there
    size_t bytes;
};

inline TapPlanes tapPlanes(const Dilation& dilation) {
    TapPlanes planes = {};
    const int64_t reach = dilation.disc->reach;
    planes.tiles = (dilation.right - dilation.left + kBytes - 1) / kBytes;
    planes.rowCount = kBandRows + 2 * reach;
    planes.rows = paddedRowsOf(dilation);
    planes.windowed = reach >= kShortestWindowedReach;
    planes.toWindows = planes.rowCount * planes.rows.stride;

    const auto tapBytes = static_cast<int64_t>(sizeof(Taps));
    const int64_t headBytes = tapBytes + planes.tiles * int64_t{sizeof(int64_t)};
    const int64_t rowPlanes = planes.windowed ? 2 : 1;
    planes.bytes = static_cast<size_t>(headBytes + rowPlanes * planes.toWindows);
    if (dilation.memory == nullptr) return planes;
    planes.taps = reinterpret_cast<Taps*>(dilation.memory);
    planes.busyUntil = reinterpret_cast<int64_t*>(dilation.memory + tapBytes);
    planes.rows.start = dilation.memory + headBytes;
    return planes;
}

/// The run of full cells in a row of the disc.
inline void addFlatTaps(const TapPlanes& planes, int64_t dy, int64_t reach) {
    const int64_t row = dy * planes.rows.stride;
    const bool windowed = planes.windowed && 2 * reach + 1 >= kTapWindow;
    const int64_t step = windowed ? kTapWindow : 1;
    const int64_t plane = windowed ? planes.toWindows : 0;
    const int64_t last = reach + 1 - step;
    for (int64_t dx = -reach; dx < last; dx += step)
        planes.taps->add(plane + row + dx);
    planes.taps->add(plane + row + last);
}

/// A cell of the rim and its mirror images.
inline void addRimTaps(const TapPlanes& planes, int64_t dx, int64_t dy) {
    const int64_t row = dy * planes.rows.stride;
    planes.taps->add(row + dx);
    if (dx != 0) planes.taps->add(row - dx);
    if (dy != 0) planes.taps->add(-row + dx);
    if (dx != 0 && dy != 0) planes.taps->add(-row - dx);
}

inline void addRimGroup(const TapPlanes& planes, const DiscShape& disc, uint8_t deficit) {
    for (int64_t dy = 0; dy <= disc.reach; ++dy) {
        const uint8_t* deficits = disc.rimDeficit + disc.rimStart[dy];
        for (int64_t dx = disc.flatReach[dy] + 1; dx <= disc.outerReach[dy]; ++dx) {
            if (*deficits++ == deficit) addRimTaps(planes, dx, dy);
        }
    }
    planes.taps->endGroup(deficit);
}

inline bool hasGroup(const Taps& taps, uint8_t deficit) {
    for (int i = 0; i < taps.groupCount; ++i) {
        if (taps.groups[i].deficit == deficit) return true;
    }
    return false;
}

inline void listTaps(const Dilation& dilation) {
    const TapPlanes planes = tapPlanes(dilation);
    const DiscShape& disc = *dilation.disc;
    Taps& taps = *planes.taps;
    taps.count = taps.groupCount = 0;
    // The middle row comes alone: often it tells that there can be no more.
    if (disc.flatReach[0] >= 0) addFlatTaps(planes, 0, disc.flatReach[0]);
    taps.endGroup(0);
    for (int64_t dy = 1; dy <= disc.reach && disc.flatReach[dy] >= 0; ++dy) {
        addFlatTaps(planes, dy, disc.flatReach[dy]);
        addFlatTaps(planes, -dy, disc.flatReach[dy]);
    }
    taps.endGroup(0);
    const int rimCells =
        disc.rimStart[disc.reach] + disc.outerReach[disc.reach] - disc.flatReach[disc.reach];
    for (int i = 0; i < rimCells; ++i) {
        if (!hasGroup(taps, disc.rimDeficit[i])) addRimGroup(planes, disc, disc.rimDeficit[i]);
    }
}

VOREL_INLINE Bytes dilatedVector(const Taps& taps, const uint8_t* source) {
    Bytes result = {};
    const int64_t* tap = taps.offsets;
    for (int i = 0; i < taps.groupCount; ++i) {
        const TapGroup group = taps.groups[i];
        const int64_t* const end = taps.offsets + group.end;
        Bytes largest = {};
        for (; tap < end; ++tap)
            largest = larger(largest, load<Bytes>(source + *tap));
        result = larger(result, subSaturated(largest, spread<Bytes>(group.deficit)));
        if (i < 2 && allZero(~result)) break;
    }
    return result;
}

/// Notes how far down the ink of a source row reaches.
inline void markInk(const Dilation& dilation, const TapPlanes& planes, int64_t y, int64_t row) {
    const int64_t reach = dilation.disc->reach;
    const int64_t spreadTiles = (reach + kBytes - 1) / kBytes;
    const uint8_t* const source = planes.rows.at(row) + dilation.left;
    for (int64_t tile = 0; tile < planes.tiles; ++tile) {
        if (allZero(load<Bytes>(source + tile * kBytes))) continue;
        const int64_t first = larger<int64_t>(tile - spreadTiles, 0);
        const int64_t end = smaller(tile + spreadTiles + 1, planes.tiles);
        for (int64_t i = first; i < end; ++i)
            planes.busyUntil[i] = y + reach + 1;
    }
}

inline void dilateRowsByTaps(const Dilation& dilation, int64_t y, int64_t count, uint8_t* results) {
    const TapPlanes planes = tapPlanes(dilation);
    const int64_t reach = dilation.disc->reach;
    for (int64_t row = 0; row < count + 2 * reach; ++row) {
        fillRow(dilation, y - reach + row, planes.rows, row);
        uint8_t* const whole = planes.rows.wholeRow(row);
        if (planes.windowed) widenWindows(whole, whole + planes.toWindows, 1, planes.rows.stride);
    }
    for (int64_t tile = 0; tile < planes.tiles; ++tile)
        planes.busyUntil[tile] = y;
    for (int64_t row = 0; row < 2 * reach; ++row)
        markInk(dilation, planes, y - reach + row, row);
    for (int64_t i = 0; i < count; ++i, results += dilatedStride(dilation)) {
        markInk(dilation, planes, y + i + reach, i + 2 * reach);
        const uint8_t* const source = planes.rows.at(i + reach) + dilation.left;
        for (int64_t tile = 0; tile < planes.tiles; ++tile) {
            const bool busy = planes.busyUntil[tile] > y + i;
            store(results + tile * kBytes,
                  busy ? dilatedVector(*planes.taps, source + tile * kBytes) : Bytes{});
        }
    }
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
