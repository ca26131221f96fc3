#pragma once

#include <cstdint>

#include "cores/dilation_ink.h"
#include "cores/dilation_rows.h"

/// Dilation by large discs: only the neighbourhood of an outline is looked at.
///
/// The result is cut into tiles. Let M be the largest coverage.
///  - A full tile has under the full cells of each pixel's disc a pixel of coverage M. It is M
///  throughout:
///    nothing is larger.
///  - An untouched tile has no covered pixel under the disc of any of its pixels. It is 0.
///  - Any other is evaluated, a source row at a time: windowed maxima give the largest coverage under
///  the
///    row's full cells, each cell of the rim is looked at by itself. A row with no covered pixel under
///    the disc of any pixel that is not M yet adds nothing and is left out; a few rows stay.
/// As evaluating gives the same in any tile, the first two need not all be recognised.
///
/// Which tiles are full follows from the source rows one by one. Where the pixels of coverage M in a row
/// are no farther than g columns from any pixel of a tile, the row fills the tile as far up and down as
/// the disc has rows whose full cells reach g columns. So each row gives each column of tiles a reach,
/// in rows; a pass down the rows and one up, in each of which a reach shrinks by one a row, tell what
/// any row reaches. Likewise for touched tiles, with the smallest distance, any covered pixel and all
/// cells of the disc.
///
/// Cost: some 60 instructions for each tile of the source, 3 for each tile of the result, and for each
/// tile along the outline, on text, 6 to 8 rows of some 40. It grows with the outline, not with the
/// radius.
namespace VFontEffect::internal::VOREL_LEVEL {

using Reach = int16_t;  // rows, as many up as down; negative where nothing is reached

/// What a row of the disc looks at in a source row.
struct DiscRow {
    int32_t firstTap;  ///< in the list of taps for the full cells, which come in twos
    int32_t endTap;
    int32_t firstRim;  ///< columns to the first cell of the rim
    int32_t endRim;
    const Tile* deficits;  ///< 255 - weight of the rim's cells, in all lanes
};

/// Rows before and behind the disc's that a vector may hang over.
constexpr int64_t kOverhang = 64;

/// The longest row of full cells takes nine windows of 64 pixels.
constexpr int64_t kMostTapsOfRow = 10;

/// The way's working memory.
struct TilePlanes {
    int64_t tiles;
    // By row of the source.
    PaddedRows rows;
    PaddedRows windows[2];
    Reach* full;  ///< first what each row reaches by itself, in the end what any row reaches
    Reach* touched;
    int64_t reachStride;
    // By tile, then by row of the source: distances, at most 255.
    uint8_t* toRight;
    uint8_t* toLeft;
    int64_t columnStride;

    Ink ink;   ///< covered pixels
    Ink most;  ///< pixels of the largest coverage

    // The disc.
    DiscRow* discRows;
    int32_t* taps;  ///< from a tile's first pixel in `rows` to what is loaded
    Tile* rimDeficits;
    uint8_t* outerReach;  ///< by dy, from the middle to both sides, at most 255
    size_t bytes;
};

/// The windows' lengths. They serve rows of full cells that are as long at least.
VOREL_INLINE int64_t windowLength(const DiscShape& disc, int i) {
    const int64_t shorter = disc.reach < 24 ? 4 : 16;
    return i == 0 ? shorter : 4 * shorter;
}

inline TilePlanes tilePlanes(const Dilation& dilation) {
    const int64_t height = dilation.height;
    const int64_t discRows = dilation.disc->reach + 1;
    Arena arena = {dilation.memory};
    TilePlanes planes;
    planes.tiles = (dilation.right - dilation.left + kTile - 1) / kTile;
    planes.rows = takeRows(dilation, height, arena);
    planes.windows[0] = takeRows(dilation, height, arena);
    planes.windows[1] = takeRows(dilation, height, arena);
    planes.reachStride = (planes.tiles + kDistances - 1) / kDistances * kDistances;
    planes.full = arena.take<Reach>(height * planes.reachStride);
    planes.touched = arena.take<Reach>(height * planes.reachStride);
    planes.columnStride = height + kBytes;
    planes.toRight = arena.take<uint8_t>(planes.tiles * planes.columnStride);
    planes.toLeft = arena.take<uint8_t>(planes.tiles * planes.columnStride);
    planes.ink = takeInk(planes.tiles, arena);
    planes.most = takeInk(planes.tiles, arena);
    planes.discRows = arena.take<DiscRow>(discRows);
    planes.taps = arena.take<int32_t>(discRows * kMostTapsOfRow);
    planes.rimDeficits = arena.take<Tile>(DiscShape::kMostRimCells);
    planes.outerReach = arena.take<uint8_t>(2 * (discRows + kOverhang));
    planes.bytes = arena.used;
    return planes;
}

// --- The disc ----------------------------------------------------------------------------------------

/// Covers a run of full cells with windows, the last of which may lie over its predecessor.
inline int32_t* listFlatTaps(const TilePlanes& planes, const DiscShape& disc, int64_t reach,
                             int32_t* taps) {
    const int64_t length = 2 * reach + 1;
    int64_t plane = 0;
    int64_t step = 1;
    for (int i = 0; i < 2 && length >= windowLength(disc, i); ++i) {
        plane = planes.windows[i].start - planes.rows.start;
        step = windowLength(disc, i);
    }
    const int64_t last = reach + 1 - step;
    const int32_t* const start = taps;
    for (int64_t dx = -reach; dx < last; dx += step)
        *taps++ = static_cast<int32_t>(plane + dx);
    *taps++ = static_cast<int32_t>(plane + last);
    if ((taps - start) % 2 != 0) {
        *taps = taps[-1];
        ++taps;
    }
    return taps;
}

inline void listDiscRows(const TilePlanes& planes, const DiscShape& disc) {
    int32_t* tap = planes.taps;
    Tile* deficit = planes.rimDeficits;
    for (int64_t dy = 0; dy <= disc.reach; ++dy) {
        DiscRow& row = planes.discRows[dy];
        row.firstTap = static_cast<int32_t>(tap - planes.taps);
        if (disc.flatReach[dy] >= 0) tap = listFlatTaps(planes, disc, disc.flatReach[dy], tap);
        row.endTap = static_cast<int32_t>(tap - planes.taps);
        row.firstRim = disc.flatReach[dy] + 1;
        row.endRim = disc.outerReach[dy] + 1;
        row.deficits = deficit;
        for (int64_t i = 0; i < row.endRim - row.firstRim; ++i)
            *deficit++ = spread<Tile>(disc.rimDeficit[disc.rimStart[dy] + i]);
    }
}

inline void listOuterReach(const TilePlanes& planes, const DiscShape& disc) {
    setBytes(planes.outerReach, 0, 2 * (disc.reach + 1 + kOverhang));
    for (int64_t dy = -disc.reach; dy <= disc.reach; ++dy) {
        const int reach = disc.outerReach[dy < 0 ? -dy : dy];
        planes.outerReach[disc.reach + dy] = static_cast<uint8_t>(smaller(reach, 255));
    }
}

// --- What the source rows reach ----------------------------------------------------------------------

/// The last row of the disc whose full cells, or cells of any weight, reach a number of columns.
struct DiscReaches {
    Reach full[DiscShape::kLongestReach + 2];
    Reach touched[DiscShape::kLongestReach + 2];
};

inline void listReaches(const DiscShape& disc, DiscReaches& reaches) {
    Reach full = static_cast<Reach>(disc.reach);
    Reach touched = full;
    for (int columns = 0; columns <= disc.reach + 1; ++columns) {
        while (full >= 0 && disc.flatReach[full] < columns)
            --full;
        while (touched >= 0 && disc.outerReach[touched] < columns)
            --touched;
        reaches.full[columns] = full;
        reaches.touched[columns] = touched;
    }
}

/// Fills the rows of coverage and of windows.
inline void fillRows(const Dilation& dilation, const TilePlanes& planes) {
    const int64_t length = windowLength(*dilation.disc, 0);
    for (int64_t y = 0; y < dilation.height; ++y) {
        fillRow(dilation, y, planes.rows, y);
        uint8_t* const windows = planes.windows[0].at(y);
        widenWindows(planes.rows, planes.rows.at(y), windows, 1);
        if (length > 4) widenWindows(planes.rows, windows, windows, 4);
        widenWindows(planes.rows, windows, planes.windows[1].at(y), length);
    }
}

inline uint8_t largestCoverage(const PaddedRows& rows, int64_t height) {
    Bytes largest = {};
    for (int64_t y = 0; y < height; ++y) {
        const uint8_t* const row = rows.at(y);
        for (int64_t x = 0; x < rows.width; x += kBytes)
            largest = larger(largest, load<Bytes>(row + x));
    }
    uint8_t result = 0;
    for (int i = 0; i < kBytes; ++i)
        result = larger<uint8_t>(result, largest[i]);
    return result;
}

/// Notes what is covered in a row of the source, which may lie behind its last one.
inline void findInk(const Dilation& dilation, const TilePlanes& planes, int64_t y) {
    const bool inside = y < dilation.height;
    const uint8_t* const source = planes.rows.at(inside ? y : 0) + dilation.left;
    const Bytes most = spread<Bytes>(dilation.largest);
    for (int64_t tile = 0; tile < planes.tiles; tile += kBytes / kTile) {
        const Bytes coverage = inside ? load<Bytes>(source + tile * kTile) : Bytes{};
        const uint64_t ink = nonZeroLanes(coverage);
        const uint64_t isMost = nonZeroLanes(as<Bytes>(coverage == most) & coverage);
        for (int i = 0; i < kBytes / kTile && tile + i < planes.tiles; ++i) {
            const int64_t at = (tile + i) * kDistances + y % kDistances;
            noteTile(planes.ink, at, ink >> (i * kTileBits % 64));
            noteTile(planes.most, at, isMost >> (i * kTileBits % 64));
        }
    }
}

VOREL_INLINE void storeBytes(uint8_t* to, Distances distances) {
    using Narrow = uint8_t __attribute__((vector_size(kDistances)));
    const Distances most = spread<Distances>(Distance{255});
    store(to, __builtin_convertvector(smaller(distances, most), Narrow));
}

/// Looks up what kDistances rows from row y on reach of a tile.
inline void noteReaches(const Dilation& dilation, const TilePlanes& planes, const DiscReaches& reaches,
                        int64_t y, int64_t tile) {
    const int64_t at = tile * kDistances;
    const Distances toRight = toTheRight(planes.ink, at);
    const Distances toLeft = toTheLeft(planes.ink, at);
    storeBytes(planes.toRight + tile * planes.columnStride + y, toRight);
    storeBytes(planes.toLeft + tile * planes.columnStride + y, toLeft);

    const Distances beyond = spread<Distances>(static_cast<Distance>(dilation.disc->reach + 1));
    const Distances nearest = smaller(smallestDistance(toRight, toLeft), beyond);
    const Distances farthest = smaller(largestDistance(planes.most, at), beyond);
    const int64_t count = smaller(kDistances, dilation.height - y);
    int64_t target = y * planes.reachStride + tile;
    for (int64_t i = 0; i < count; ++i, target += planes.reachStride) {
        planes.full[target] = reaches.full[farthest[i]];
        planes.touched[target] = reaches.touched[nearest[i]];
    }
}

/// What lies behind the last tile of a row, to the end of a vector, is both full and untouched.
inline void closeReaches(const TilePlanes& planes, int64_t height) {
    for (int64_t y = 0; y < height; ++y) {
        for (int64_t tile = planes.tiles; tile < planes.reachStride; ++tile) {
            planes.full[y * planes.reachStride + tile] = kBeyond;
            planes.touched[y * planes.reachStride + tile] = -1;
        }
    }
}

/// Lets each row's reaches pass over its neighbours: down, then up.
inline void passReaches(Reach* reaches, int64_t stride, int64_t height) {
    const auto pass = [=](int64_t from, int64_t to) {
        const Reach* const passing = reaches + from * stride;
        Reach* const own = reaches + to * stride;
        for (int64_t x = 0; x < stride; x += kDistances)
            store(own + x, larger(load<Distances>(own + x), load<Distances>(passing + x) - 1));
    };
    for (int64_t y = 1; y < height; ++y)
        pass(y - 1, y);
    for (int64_t y = height - 1; y > 0; --y)
        pass(y, y - 1);
}

inline void beginTiles(Dilation& dilation) {
    const TilePlanes planes = tilePlanes(dilation);
    fillRows(dilation, planes);
    dilation.largest = largestCoverage(planes.rows, dilation.height);
    listDiscRows(planes, *dilation.disc);
    listOuterReach(planes, *dilation.disc);

    DiscReaches reaches;
    listReaches(*dilation.disc, reaches);
    for (int64_t y = 0; y < dilation.height; y += kDistances) {
        for (int64_t i = 0; i < kDistances; ++i)
            findInk(dilation, planes, y + i);
        findNeighbours(planes.ink, planes.tiles);
        findNeighbours(planes.most, planes.tiles);
        for (int64_t tile = 0; tile < planes.tiles; ++tile)
            noteReaches(dilation, planes, reaches, y, tile);
    }
    closeReaches(planes, dilation.height);
    passReaches(planes.full, planes.reachStride, dilation.height);
    passReaches(planes.touched, planes.reachStride, dilation.height);
}

// --- Evaluation --------------------------------------------------------------------------------------

/// What a source row adds to the tile whose place in it is `source`.
VOREL_INLINE Tile dilatedRow(const int32_t* taps, const DiscRow& row, const uint8_t* source) {
    Tile result = {};
    for (int32_t i = row.firstTap; i < row.endTap; i += 2) {
        const Tile coverage = larger(load<Tile>(source + taps[i]), load<Tile>(source + taps[i + 1]));
        result = larger(result, coverage);
    }
    const Tile* deficit = row.deficits;
    for (int64_t dx = row.firstRim; dx < row.endRim; ++dx, ++deficit) {
        const Tile coverage = larger(load<Tile>(source - dx), load<Tile>(source + dx));
        // A difference that stays at 0.
        result = larger(result, larger(coverage, *deficit) - *deficit);
    }
    return result;
}

/// A tile of the result on its way up from 0.
struct OpenTile {
    const TilePlanes& planes;
    int64_t y;
    const uint8_t* source;   ///< the tile's place in the first row of the source
    const uint8_t* toRight;  ///< of the tile's column
    const uint8_t* toLeft;
    const uint8_t* outerReach;  ///< of the disc around the tile, from the first row of the source on
    Tile result;

    VOREL_INLINE void add(int64_t row) {
        const DiscRow& discRow = planes.discRows[row < y ? y - row : row - y];
        const uint8_t* const place = source + row * planes.rows.stride;
        result = larger(result, dilatedRow(planes.taps, discRow, place));
    }

    /// The rows, among kBytes, that touch any of the lanes from `first` to `last`. A row whose nearest
    /// pixel lies between the tile's edge and these lanes counts among them.
    VOREL_INLINE uint64_t touching(int64_t row, int first, int last) const {
        const auto right = spread<Bytes>(static_cast<uint8_t>(last));
        const auto left = spread<Bytes>(static_cast<uint8_t>(kTileEnd - first));
        const Bytes distance = smaller(subSaturated(load<Bytes>(toRight + row), right),
                                       subSaturated(load<Bytes>(toLeft + row), left));
        return nonZeroLanes(as<Bytes>(distance <= load<Bytes>(outerReach + row)));
    }

    /// The lanes that are less than `most`.
    VOREL_INLINE uint64_t unsettled(uint8_t most) const {
        const Tile rest = result ^ most;
        Bytes lanes = {};
        std::memcpy(&lanes, &rest, sizeof rest);
        return nonZeroLanes(lanes);
    }
};

struct RowRange {
    int64_t first;
    int64_t last;
};

/// Cuts the rows off that touch none of the tile's pixels. Nothing may be left.
inline RowRange touchingRange(const OpenTile& tile, RowRange rows) {
    RowRange touching = {rows.last + 1, rows.first - 1};
    for (int64_t row = rows.first; row <= rows.last; row += kBytes) {
        const uint64_t lanes = tile.touching(row, 0, kTileEnd);
        if (lanes == 0) continue;
        touching.first = smaller(touching.first, row + firstLane(lanes));
        touching.last = smaller(row + lastLane(lanes), rows.last);
    }
    return touching;
}

/// Adds the rows that touch any of the given lanes.
inline void addTouching(OpenTile& tile, RowRange rows, int firstOpen, int lastOpen) {
    for (int64_t row = rows.first; row <= rows.last; row += kBytes) {
        uint64_t lanes = tile.touching(row, firstOpen, lastOpen);
        while (lanes != 0) {
            const int lane = firstLane(lanes);
            if (row + lane > rows.last) return;
            tile.add(row + lane);
            lanes &= ~(((uint64_t{1} << kLaneBits) - 1) << lane * kLaneBits);
        }
    }
}

inline Tile dilatedTile(const Dilation& dilation, const TilePlanes& planes, int64_t y, int64_t tile) {
    const int64_t reach = dilation.disc->reach;
    OpenTile open = {planes,
                     y,
                     planes.rows.at(0) + dilation.left + tile * kTile,
                     planes.toRight + tile * planes.columnStride,
                     planes.toLeft + tile * planes.columnStride,
                     planes.outerReach + reach - y,
                     Tile{}};
    const RowRange inReach = {larger<int64_t>(y - reach, 0), smaller(y + reach, dilation.height - 1)};
    const RowRange rows = touchingRange(open, inReach);
    // Mostly the row in the middle settles all pixels that come out as M.
    open.add((rows.first + rows.last) / 2);
    const uint64_t unsettled = open.unsettled(dilation.largest);
    if (unsettled != 0) addTouching(open, rows, firstLane(unsettled), lastLane(unsettled));
    return open.result;
}

inline void dilateRowByTiles(const Dilation& dilation, const TilePlanes& planes, int64_t y,
                             uint8_t* results) {
    const int64_t nearest = smaller(larger<int64_t>(y, 0), dilation.height - 1);
    const auto away = static_cast<Reach>(y < nearest ? nearest - y : y - nearest);
    const Reach* const full = planes.full + nearest * planes.reachStride;
    const Reach* const touched = planes.touched + nearest * planes.reachStride;
    const Tile most = spread<Tile>(dilation.largest);
    for (int64_t tile = 0; tile < planes.tiles; tile += kDistances) {
        const int64_t end = smaller(tile + kDistances, planes.tiles);
        const bool allFull = allZero(as<Bytes>(load<Distances>(full + tile) < away));
        const bool allUntouched = allZero(as<Bytes>(load<Distances>(touched + tile) >= away));
        if (allFull || allUntouched) {
            setBytes(results + tile * kTile, allFull ? dilation.largest : 0, (end - tile) * kTile);
            continue;
        }
        for (int64_t i = tile; i < end; ++i) {
            const bool known = full[i] >= away || touched[i] < away;
            store(results + i * kTile, !known            ? dilatedTile(dilation, planes, y, i)
                                       : full[i] >= away ? most
                                                         : Tile{});
        }
    }
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
