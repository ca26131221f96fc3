#pragma once

#include <cstdint>

#include "ops/dilate/padded_rows.h"
#include "ops/dilate/tile_extents.h"

/// Dilation by large discs: only the neighbourhood of an outline is looked at.
///
/// The result is cut into tiles. Let M be the largest coverage.
///  - A full tile has under the full cells of each pixel's disc a pixel of coverage M. It is M
///    throughout: nothing is larger.
///  - An untouched tile has no covered pixel under the disc of any of its pixels. It is 0.
///  - Any other is evaluated, a source row at a time: windowed maxima give the largest coverage under
///    the row's full cells, and each cell of the rim is looked at by itself. A row with no covered pixel
///    under the disc of any pixel that is not M yet adds nothing and is left out.
/// As evaluating gives the same in any tile, the first two need not all be recognised.
///
/// Which tiles are full follows from the source rows one by one. Where no pixel of a tile has more than
/// g columns to a pixel of coverage M in a row, the row fills the tile as far up and down as the disc
/// has rows whose full cells reach g columns. So each row gives each column of tiles a reach, in rows; a
/// pass down the rows and one up, in each of which a reach shrinks by one a row, tell what any row
/// reaches. Likewise for touched tiles, with the smallest distance, any covered pixel and all cells of
/// the disc.
///
/// Cost: some 60 instructions for each tile of the source, 3 for each tile of the result, and for each
/// tile along the outline, on text, some 10 rows of 40 each. It grows with the outline, not with the
/// radius.
namespace VFontEffect::internal::VOREL_LEVEL {

using Reach = int16_t;  // rows, as many up as down; negative where nothing is reached

/// What a row of the disc looks at in a source row: 4 taps or more for its full cells, 2 cells of the
/// rim or more. Almost all rows have just these, which leaves no branches to be guessed wrong.
struct DiscRow {
    const int32_t* taps;   ///< from a tile's first pixel to what is loaded; null without full cells
    int32_t tapCount;      ///< even
    int32_t rimCount;      ///< even
    int64_t firstRim;      ///< columns to the first cell of the rim
    const Tile* deficits;  ///< 255 - weight of the rim's cells, in all lanes
};
constexpr int64_t kFewestTaps = 4;
constexpr int64_t kFewestRimCells = 2;

/// Rows behind the disc's last one that a vector may hang over.
constexpr int64_t kOverhang = 64;

constexpr int64_t kLongestWindow = 64;

/// Columns for the windows and the vector that start last.
constexpr int64_t kWindowSlack = kLongestWindow + 2 * kBytes;

/// Rows as long as they may be take nine windows of 64 pixels, rows shorter than 16 up to 15 single
/// ones.
constexpr int64_t kMostTaps = 16;

/// A window is given up when its tiles have been evaluated by more rows of the source than so many at
/// first and so many for each tile of the results. Text takes 1 to 2 a tile, and up to 3500 more where
/// its letters begin.
constexpr int64_t kFirstAllowance = 4096;
constexpr int64_t kAllowancePerTile = 4;

VOREL_INLINE int64_t tilesOf(int64_t columns) {
    return (columns + kTile - 1) / kTile;
}

struct TileLayout {
    Columns columns;    ///< of all tiles: those of the window, and of the source in its reach
    int64_t tiles;      ///< in a row
    int64_t firstTile;  ///< of the window, its corner
    int64_t endTile;    ///< behind its last one
    uint8_t largest;    ///< of all coverage
    // By row of the source.
    PaddedRows rows;
    PaddedRows windows[2];
    int64_t lengths[2];  ///< of the windows
    Reach* full;         ///< first what each row reaches by itself, in the end what any row reaches
    Reach* touched;
    int64_t reachStride;
    // By tile, then by row of the source: distances, at most 255.
    uint8_t* toRight;
    uint8_t* toLeft;
    int64_t columnStride;

    TileExtents covered;  ///< covered pixels
    TileExtents most;     ///< pixels of the largest coverage

    // The disc.
    DiscRow* discRows;
    int32_t* taps;
    Tile* rimDeficits;
    uint8_t* outerReach;  ///< by dy, from -reach to reach, at most 255, then zeros
    uint8_t* results;     ///< of a band
    int64_t allowance;    ///< source rows that tiles may still be evaluated by

    static TileLayout of(const Dilation& dilation, Arena& arena) {
        const int64_t height = dilation.height;
        const int64_t reach = dilation.disc->reach;
        TileLayout layout;
        layout.firstTile = tilesOf(max<int64_t>(dilation.left, 0));
        layout.endTile = layout.firstTile + tilesOf(dilation.right - dilation.left);
        layout.columns = {dilation.left - layout.firstTile * kTile, max(dilation.right, dilation.width)};
        layout.tiles = tilesOf(layout.columns.right - layout.columns.left);
        layout.largest = 0;
        const auto take = [&] {
            return takeRows(dilation, layout.columns, height, reach + kFewestRimCells,
                            reach + kWindowSlack, arena);
        };
        layout.rows = take();
        layout.windows[0] = take();
        layout.windows[1] = take();
        layout.lengths[0] = reach < 24 ? 4 : 16;
        layout.lengths[1] = 4 * layout.lengths[0];
        // Vectors of the window's tiles begin with its first one.
        const int64_t fromFirst = roundedUp(layout.tiles - layout.firstTile, kDistances);
        layout.reachStride = roundedUp(layout.firstTile + fromFirst, kDistances);
        layout.full = arena.take<Reach>(height * layout.reachStride);
        layout.touched = arena.take<Reach>(height * layout.reachStride);
        layout.columnStride = height + kBytes;
        layout.toRight = arena.take<uint8_t>(layout.tiles * layout.columnStride);
        layout.toLeft = arena.take<uint8_t>(layout.tiles * layout.columnStride);
        layout.covered = takeExtents(layout.tiles, arena);
        layout.most = takeExtents(layout.tiles, arena);
        layout.discRows = arena.take<DiscRow>(reach + 1);
        layout.taps = arena.take<int32_t>((reach + 1) * kMostTaps);
        layout.rimDeficits = arena.take<Tile>(DiscShape::kMostRimCells + (reach + 1) * kFewestRimCells);
        layout.outerReach = arena.take<uint8_t>(2 * reach + 1 + kOverhang);
        layout.results = arena.take<uint8_t>(dilation.bandRows * dilatedStride(dilation));
        layout.allowance = kFirstAllowance;
        return layout;
    }
};

// --- The disc ----------------------------------------------------------------------------------------

VOREL_INLINE int64_t evenAtLeast(int64_t count, int64_t fewest) {
    return max((count + 1) / 2 * 2, fewest);
}

/// Covers a run of full cells with the longest windows that are not too long. They lie over each other
/// where there are more than it takes.
inline int32_t listFlatTaps(const TileLayout& planes, int64_t reach, int32_t* taps) {
    const int64_t length = 2 * reach + 1;
    int64_t plane = 0;
    int64_t step = 1;
    for (int i = 0; i < 2 && planes.lengths[i] <= length; ++i) {
        plane = planes.windows[i].start - planes.rows.start;
        step = planes.lengths[i];
    }
    const int64_t count = evenAtLeast((length + step - 1) / step, kFewestTaps);
    VOREL_ASSERT(count <= kMostTaps);
    for (int64_t i = 0; i < count; ++i)
        taps[i] = static_cast<int32_t>(plane + min(i * step - reach, reach + 1 - step));
    return static_cast<int32_t>(count);
}

inline void listDiscRows(const TileLayout& planes, const DiscShape& disc) {
    int32_t* taps = planes.taps;
    Tile* deficits = planes.rimDeficits;
    for (int64_t dy = 0; dy <= disc.reach; ++dy, taps += kMostTaps) {
        const int64_t flat = disc.flatReach[dy];
        const int64_t cells = disc.outerReach[dy] - flat;
        DiscRow& row = planes.discRows[dy];
        row.taps = flat >= 0 ? taps : nullptr;
        row.tapCount = flat >= 0 ? listFlatTaps(planes, flat, taps) : 0;
        row.rimCount = static_cast<int32_t>(evenAtLeast(cells, kFewestRimCells));
        row.firstRim = flat + 1;
        row.deficits = deficits;
        for (int64_t i = 0; i < row.rimCount; ++i) {
            const uint8_t deficit = i < cells ? disc.rimDeficit[disc.rimStart[dy] + i] : 255;
            *deficits++ = splat<Tile>(deficit);
        }
    }
}

inline void listOuterReach(const TileLayout& planes, const DiscShape& disc) {
    setBytes(planes.outerReach, 0, 2 * disc.reach + 1 + kOverhang);
    for (int64_t dy = -disc.reach; dy <= disc.reach; ++dy) {
        const int reach = disc.outerReach[dy < 0 ? -dy : dy];
        planes.outerReach[disc.reach + dy] = static_cast<uint8_t>(min(reach, 255));
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

/// The largest of four that stand `step` apart, the first of them at the result's own place. Out of
/// windows of `step` pixels, each at the place of its first one, this makes windows four times as long.
/// `to` may be `from`; both are column 0 of a row.
inline void widenWindows(const PaddedRows& rows, const uint8_t* from, uint8_t* to, int64_t step) {
    // Windows that start farther to the left, or behind the last column, are empty.
    int64_t x = max(-rows.lead, -4 * step);
    setBytes(to - rows.lead, 0, rows.lead + x);
    for (; x < rows.width; x += kBytes) {
        const uint8_t* const window = from + x;
        const U8s left = max(load<U8s>(window), load<U8s>(window + step));
        const U8s right = max(load<U8s>(window + 2 * step), load<U8s>(window + 3 * step));
        store(to + x, max(left, right));
    }
    setBytes(to + x, 0, rows.stride - rows.lead - x);
}

/// Fills the rows of coverage and of windows.
inline void fillRows(const Dilation& dilation, const TileLayout& planes) {
    for (int64_t y = 0; y < dilation.height; ++y) {
        fillRow(dilation, y, planes.rows, y);
        uint8_t* const windows = planes.windows[0].at(y);
        widenWindows(planes.rows, planes.rows.at(y), windows, 1);
        if (planes.lengths[0] > 4) widenWindows(planes.rows, windows, windows, 4);
        widenWindows(planes.rows, windows, planes.windows[1].at(y), planes.lengths[0]);
    }
}

inline uint8_t largestCoverage(const PaddedRows& rows, int64_t height) {
    U8s largest = {};
    // Two rows at a time: a maximum waits for the one before.
    for (int64_t y = 0; y < height; y += 2) {
        const uint8_t* const row = rows.at(y);
        const uint8_t* const next = rows.at(min(y + 1, height - 1));
        for (int64_t x = 0; x < rows.width; x += kBytes)
            largest = max(largest, max(load<U8s>(row + x), load<U8s>(next + x)));
    }
    uint8_t result = 0;
    for (int i = 0; i < kBytes; ++i)
        result = max<uint8_t>(result, largest[i]);
    return result;
}

/// Notes what is covered in a row of the source, which may lie behind its last one.
inline void findExtents(const Dilation& dilation, const TileLayout& planes, int64_t y) {
    const bool inside = y < dilation.height;
    const uint8_t* const source = planes.rows.at(inside ? y : 0) + planes.columns.left;
    const U8s most = splat<U8s>(planes.largest);
    for (int64_t tile = 0; tile < planes.tiles; tile += kTilesOfVector) {
        const U8s coverage = inside ? load<U8s>(source + tile * kTile) : U8s{};
        const uint64_t covered = nonZeroLanes(coverage);
        const uint64_t isMost = nonZeroLanes(bitCast<U8s>(coverage == most) & coverage);
        for (int64_t i = 0; i < kTilesOfVector; ++i) {
            const int64_t at = (tile + i) * kDistances + y % kDistances;
            noteTile(planes.covered, at, covered >> (i * kTileBits % 64));
            noteTile(planes.most, at, isMost >> (i * kTileBits % 64));
        }
    }
}

VOREL_INLINE void storeBytes(uint8_t* to, Distances distances) {
    using Narrow = uint8_t __attribute__((vector_size(kDistances)));
    const Distances most = splat<Distances>(Distance{255});
    store(to, __builtin_convertvector(min(distances, most), Narrow));
}

/// Looks up what kDistances rows from row y on reach of a tile.
inline void noteReaches(const Dilation& dilation, const TileLayout& planes, const DiscReaches& reaches,
                        int64_t y, int64_t tile) {
    const int64_t at = tile * kDistances;
    const Distances toRight = toTheRight(planes.covered, at);
    const Distances toLeft = toTheLeft(planes.covered, at);
    storeBytes(planes.toRight + tile * planes.columnStride + y, toRight);
    storeBytes(planes.toLeft + tile * planes.columnStride + y, toLeft);

    // Read back one by one, which compilers do badly with a vector.
    Distance nearest[kDistances];
    Distance farthest[kDistances];
    const Distances beyond = splat<Distances>(static_cast<Distance>(dilation.disc->reach + 1));
    store(nearest, min(smallestDistance(toRight, toLeft), beyond));
    store(farthest, min(largestDistance(planes.most, at), beyond));
    const int64_t count = min(kDistances, dilation.height - y);
    int64_t target = y * planes.reachStride + tile;
    for (int64_t i = 0; i < count; ++i, target += planes.reachStride) {
        planes.full[target] = reaches.full[farthest[i]];
        planes.touched[target] = reaches.touched[nearest[i]];
    }
}

/// What lies behind the last tile of a row, to the end of a vector, is both full and untouched.
inline void closeReaches(const TileLayout& planes, int64_t height) {
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
            store(own + x, max(load<Distances>(own + x), load<Distances>(passing + x) - 1));
    };
    for (int64_t y = 1; y < height; ++y)
        pass(y - 1, y);
    for (int64_t y = height - 1; y > 0; --y)
        pass(y, y - 1);
}

inline void beginTiles(const Dilation& dilation, uint8_t* memory) {
    TileLayout& planes = layOut<TileLayout>(dilation, memory);
    fillRows(dilation, planes);
    planes.largest = largestCoverage(planes.rows, dilation.height);
    listDiscRows(planes, *dilation.disc);
    listOuterReach(planes, *dilation.disc);

    DiscReaches reaches;
    listReaches(*dilation.disc, reaches);
    for (int64_t y = 0; y < dilation.height; y += kDistances) {
        for (int64_t i = 0; i < kDistances; ++i)
            findExtents(dilation, planes, y + i);
        findNeighbours(planes.covered, planes.tiles);
        findNeighbours(planes.most, planes.tiles);
        for (int64_t tile = 0; tile < planes.tiles; ++tile)
            noteReaches(dilation, planes, reaches, y, tile);
    }
    closeReaches(planes, dilation.height);
    passReaches(planes.full, planes.reachStride, dilation.height);
    passReaches(planes.touched, planes.reachStride, dilation.height);
}

// --- Evaluation --------------------------------------------------------------------------------------

/// A difference that stays at 0. Tiles may be shorter than the level's vectors.
template <class V>
VOREL_INLINE V lessDeficit(V v, V deficit) {
    if constexpr (sizeof(V) == kBytes) return subSaturated(v, deficit);
    return max(v, deficit) - deficit;
}

/// What two cells of the rim add, with their mirror images.
VOREL_INLINE Tile rimPair(const uint8_t* source, int64_t dx, const Tile* deficits) {
    const Tile inner = max(load<Tile>(source - dx), load<Tile>(source + dx));
    const Tile outer = max(load<Tile>(source - dx - 1), load<Tile>(source + dx + 1));
    return max(lessDeficit(inner, deficits[0]), lessDeficit(outer, deficits[1]));
}

/// What a source row adds to the tile whose place in it is `source`.
VOREL_INLINE Tile dilatedRow(const DiscRow& row, const uint8_t* source) {
    Tile result = rimPair(source, row.firstRim, row.deficits);
    for (int32_t i = kFewestRimCells; i < row.rimCount; i += 2)
        result = max(result, rimPair(source, row.firstRim + i, row.deficits + i));
    if (row.taps == nullptr) return result;
    const Tile flat = max(largerOf<Tile>(source, row.taps), largerOf<Tile>(source, row.taps + 2));
    result = max(result, flat);
    for (int32_t i = kFewestTaps; i < row.tapCount; i += 2)
        result = max(result, largerOf<Tile>(source, row.taps + i));
    return result;
}

/// A tile of the result on its way up from 0.
struct OpenTile {
    const TileLayout& planes;
    int64_t y;
    const uint8_t* source;   ///< the tile's place in the first row of the source
    const uint8_t* toRight;  ///< of the tile's column
    const uint8_t* toLeft;
    const uint8_t* outerReach;  ///< of the disc's middle row
    Tile result;

    VOREL_INLINE void add(int64_t row) {
        VOREL_ASSERT(row >= 0 && row < planes.rows.count);
        const DiscRow& discRow = planes.discRows[row < y ? y - row : row - y];
        const uint8_t* const place = source + row * planes.rows.stride;
        result = max(result, dilatedRow(discRow, place));
    }

    /// The rows, of kBytes up to the last one, that touch any of the lanes from `first` to `last`. A row
    /// whose nearest pixel lies between the tile's edge and these lanes counts among them.
    VOREL_INLINE uint64_t touching(int64_t row, int64_t lastRow, int first, int last) const {
        const auto right = splat<U8s>(static_cast<uint8_t>(last));
        const auto left = splat<U8s>(static_cast<uint8_t>(kTileEnd - first));
        const U8s distance = min(subSaturated(load<U8s>(toRight + row), right),
                                 subSaturated(load<U8s>(toLeft + row), left));
        const U8s reached = load<U8s>(outerReach + row - y);
        const uint64_t lanes = nonZeroLanes(bitCast<U8s>(distance <= reached));
        const int64_t behind = max<int64_t>(row + kBytes - 1 - lastRow, 0);
        return lanes & (~uint64_t{0} >> (64 - (kBytes - behind) * kLaneBits));
    }

    /// The lanes that are less than `most`.
    VOREL_INLINE uint64_t unsettled(uint8_t most) const {
        const Tile rest = result ^ most;
        U8s lanes = {};
        std::memcpy(&lanes, &rest, sizeof rest);
        return nonZeroLanes(lanes);
    }
};

struct RowRange {
    int64_t first;
    int64_t last;
};

/// Cuts the rows off that touch none of the tile's pixels. One does.
inline RowRange touchingRange(const OpenTile& tile, RowRange rows) {
    RowRange touching = {rows.last + 1, rows.first - 1};
    for (int64_t row = rows.first; row <= rows.last; row += kBytes) {
        const uint64_t lanes = tile.touching(row, rows.last, 0, kTileEnd);
        if (lanes == 0) continue;
        touching.first = min(touching.first, row + firstLane(lanes));
        touching.last = row + lastLane(lanes);
    }
    return touching;
}

/// Adds the rows that touch any of the given lanes; how many there are.
inline int64_t addTouching(OpenTile& tile, RowRange rows, int firstOpen, int lastOpen) {
    int64_t added = 0;
    for (int64_t row = rows.first; row <= rows.last; row += kBytes) {
        uint64_t lanes = tile.touching(row, rows.last, firstOpen, lastOpen);
        for (; lanes != 0; lanes = withoutFirst(lanes), ++added)
            tile.add(row + firstLane(lanes));
    }
    return added;
}

/// Takes the rows that it evaluates from the allowance.
inline Tile dilatedTile(const Dilation& dilation, const TileLayout& planes, int64_t y, int64_t tile,
                        int64_t& allowance) {
    const int64_t reach = dilation.disc->reach;
    OpenTile open = {planes,
                     y,
                     planes.rows.at(0) + planes.columns.left + tile * kTile,
                     planes.toRight + tile * planes.columnStride,
                     planes.toLeft + tile * planes.columnStride,
                     planes.outerReach + reach,
                     Tile{}};
    const RowRange inReach = {max<int64_t>(y - reach, 0), min(y + reach, dilation.height - 1)};
    const RowRange rows = touchingRange(open, inReach);
    // The nearest row and the one in the middle mostly settle the pixels that come out as M.
    open.add(min(max(y, rows.first), rows.last));
    open.add((rows.first + rows.last) / 2);
    const uint64_t unsettled = open.unsettled(planes.largest);
    if (unsettled != 0) allowance -= addTouching(open, rows, firstLane(unsettled), lastLane(unsettled));
    return open.result;
}

inline void dilateRowByTiles(const Dilation& dilation, const TileLayout& planes, int64_t y,
                             uint8_t* results, int64_t& allowance) {
    const int64_t nearest = min(max<int64_t>(y, 0), dilation.height - 1);
    const auto away = static_cast<Reach>(y < nearest ? nearest - y : y - nearest);
    const Reach* const full = planes.full + nearest * planes.reachStride;
    const Reach* const touched = planes.touched + nearest * planes.reachStride;
    const Tile most = splat<Tile>(planes.largest);
    for (int64_t tile = planes.firstTile; tile < planes.endTile; tile += kDistances) {
        const int64_t end = min(tile + kDistances, planes.endTile);
        const bool allFull = allZero(bitCast<U8s>(load<Distances>(full + tile) < away));
        const bool allUntouched = allZero(bitCast<U8s>(load<Distances>(touched + tile) >= away));
        if (allFull || allUntouched) {
            setBytes(results, allFull ? planes.largest : 0, (end - tile) * kTile);
            results += (end - tile) * kTile;
            continue;
        }
        for (int64_t i = tile; i < end; ++i, results += kTile) {
            const bool known = full[i] >= away || touched[i] < away;
            store(results, !known            ? dilatedTile(dilation, planes, y, i, allowance)
                           : full[i] >= away ? most
                                             : Tile{});
        }
    }
}

inline uint8_t* rowsByTiles(const Dilation& dilation, uint8_t* memory, int64_t y, int64_t count) {
    const auto planes = layoutIn<TileLayout>(memory);
    int64_t allowance = planes.allowance;
    for (int64_t i = 0; i < count && allowance >= 0; ++i) {
        uint8_t* const results = planes.results + i * dilatedStride(dilation);
        dilateRowByTiles(dilation, planes, y + i, results, allowance);
        allowance += kAllowancePerTile * (planes.endTile - planes.firstTile);
    }
    keptIn<TileLayout>(memory).allowance = allowance;
    return allowance >= 0 ? planes.results : nullptr;
}

constexpr DilationStrategy kTiles = {layoutBytes<TileLayout>, beginTiles, rowsByTiles};

}  // namespace VFontEffect::internal::VOREL_LEVEL
