#pragma once

#include <cstdint>

#include "cores/dilation_rows.h"

/// Dilation by large discs: only the neighbourhood of an outline is looked at.
///
/// The result is cut into tiles, short pieces of a row. Let M be the largest coverage.
///  - A tile all of whose pixels have a pixel of coverage M under the full cells of their disc is M
///    throughout: nothing is larger.
///  - A tile none of whose pixels has any covered pixel under their disc is 0.
///  - The others are evaluated, a source row at a time: windowed maxima give the largest coverage under
///  a
///    row's full cells, each cell of the rim is looked at by itself. A row with no covered pixel under
///    the disc of any pixel of the tile is left out; mostly but a few rows near the outline stay.
/// The first two need only be recognised most of the time, as evaluating gives the same.
///
/// Both are dilations of what a single source row does to a column of tiles. In a row where a pixel at
/// the horizontal distance g of all of the tile's pixels has coverage M, the tile is full, and stays so
/// up to the disc's last row whose full cells reach g far: the row's reach. Passing down and up the
/// rows, a reach goes down by one each row; where it is not yet negative there is a full tile. Likewise
/// with the smallest distance of any covered pixel, and all cells of the disc, for the tiles that are
/// not empty.
///
/// Cost: some 40 instructions for each tile of the source and 6 for each of the result; then (on text)
/// 10 to 25 source rows of some 6 loads for each evaluated tile, of which there are about as many as the
/// outline is long in rows and tiles. It does not grow with the radius but by the outline.
namespace VFontEffect::internal::VOREL_LEVEL {

constexpr int kTile = kBytes < 16 ? kBytes : 16;
using Tile = uint8_t __attribute__((vector_size(kTile)));

using Reach = int16_t;  // rows; negative where nothing is reached
using Reaches = int16_t __attribute__((vector_size(kBytes)));
constexpr int64_t kReachLanes = kBytes / 2;

/// Columns; beyond what any disc reaches only that it is beyond is told.
using Distance = int16_t;
using Distances = int16_t __attribute__((vector_size(kBytes)));
constexpr int32_t kBeyond = 1024;

/// The covered pixels of the tiles in a row of the source, in one array for each number. A tile without
/// any has its first one and its last one far to the right and to the left.
struct InkRow {
    Distance* first;  ///< column of the tile's first covered pixel
    Distance* last;   ///< of its last one
    Distance*
        before;       ///< from the tile's first column back to the nearest covered pixel before the tile
    Distance* after;  ///< from the tile's last column on to the nearest one behind it
    Distance*
        holes;  ///< columns from the first to the last one if there are any not covered between, or 0
};

/// What a row of the disc looks at.
struct DiscRow {
    int32_t firstTap;  ///< among the taps for its full cells, which come in twos
    int32_t endTap;
    int32_t firstRim;  ///< distance of the first rim cell
    int32_t endRim;
    const Tile* deficits;  ///< 255 - weight of the rim's cells, in all lanes
};

/// Where the method's working memory is.
struct TilePlanes {
    // By row of the source.
    PaddedRows rows;
    PaddedRows windows[2];  ///< maxima of windows
    Reach* full;            ///< how far the row fills the tiles; later: all rows together, at this row
    Reach* touched;         ///< the same for tiles that are not empty
    int64_t reachStride;
    uint8_t* touching;  ///< by tile, then by source row: 1 + the rows that it touches the tile up to
    int64_t touchingStride;

    int64_t tiles;
    InkRow ink;
    InkRow most;  ///< of the pixels with the largest coverage
    Tile* rimDeficits;
    int32_t* taps;  ///< distances from a pixel's own place to what is loaded
    DiscRow* discRows;
    size_t bytes;
};

/// The lengths of the windows, for rows of full cells that are as long at least.
VOREL_INLINE int64_t windowLength(const DiscShape& disc, int plane) {
    const int64_t shorter = disc.reach < 24 ? 4 : 16;
    return plane == 0 ? shorter : 4 * shorter;
}

/// The longest rows take 9 windows of 64.
constexpr int64_t kMostTapsOfRow = 16;

inline TilePlanes tilePlanes(const Dilation& dilation) {
    TilePlanes planes;
    planes.bytes = 0;
    const auto take = [&](int64_t bytes) {
        const size_t taken = planes.bytes;
        planes.bytes += static_cast<size_t>((bytes + 63) / 64 * 64);
        return dilation.memory == nullptr ? nullptr : dilation.memory + taken;
    };
    const int64_t height = dilation.height;
    planes.tiles = (dilation.right - dilation.left + kTile - 1) / kTile;
    planes.reachStride = (planes.tiles + kReachLanes - 1) / kReachLanes * kReachLanes;
    planes.touchingStride = height + kBytes;

    const auto takeInk = [&] {
        const auto takeDistances = [&] {
            return reinterpret_cast<Distance*>(take(planes.reachStride * int64_t{sizeof(Distance)}));
        };
        return InkRow{takeDistances(), takeDistances(), takeDistances(), takeDistances(),
                      takeDistances()};
    };
    planes.ink = takeInk();
    planes.most = takeInk();
    const int64_t reachBytes = height * planes.reachStride * int64_t{sizeof(Reach)};
    planes.full = reinterpret_cast<Reach*>(take(reachBytes));
    planes.touched = reinterpret_cast<Reach*>(take(reachBytes));
    planes.touching = take(planes.tiles * planes.touchingStride);

    const int64_t discRows = dilation.disc->reach + 1;
    planes.rimDeficits = reinterpret_cast<Tile*>(take(DiscShape::kMostRimCells * int64_t{sizeof(Tile)}));
    planes.taps = reinterpret_cast<int32_t*>(take(discRows * kMostTapsOfRow * int64_t{sizeof(int32_t)}));
    planes.discRows = reinterpret_cast<DiscRow*>(take(discRows * int64_t{sizeof(DiscRow)}));
    const auto takeRows = [&] {
        PaddedRows rows = paddedRowsOf(dilation);
        rows.start = take(height * rows.stride);
        return rows;
    };
    planes.rows = takeRows();
    planes.windows[0] = takeRows();
    planes.windows[1] = takeRows();
    return planes;
}

// --- What the source rows do to the tiles
// ---------------------------------------------------------------

/// How far up and down a pixel reaches that lies the given number of columns aside: the last row of the
/// disc that is that wide.
struct Reached {
    Reach full[DiscShape::kLongestReach + 2];
    Reach touched[DiscShape::kLongestReach + 2];
};

inline void listReached(const DiscShape& disc, Reached& reached) {
    Reach full = static_cast<Reach>(disc.reach);
    Reach touched = full;
    for (int distance = 0; distance <= disc.reach + 1; ++distance) {
        while (full >= 0 && disc.flatReach[full] < distance)
            --full;
        while (touched >= 0 && disc.outerReach[touched] < distance)
            --touched;
        reached.full[distance] = full;
        reached.touched[distance] = touched;
    }
}

VOREL_INLINE int32_t firstLane(uint64_t lanes) {
    return __builtin_ctzll(lanes) / kLaneBits;
}
VOREL_INLINE int32_t lastLane(uint64_t lanes) {
    return (63 - __builtin_clzll(lanes)) / kLaneBits;
}

constexpr int kTileBits = kTile * kLaneBits;
constexpr uint64_t kTileLanes = ~uint64_t{0} >> (64 - kTileBits);

/// Notes the covered pixels of a tile.
VOREL_INLINE void noteInk(const InkRow& ink, int64_t tile, uint64_t lanes) {
    const uint64_t bits = lanes & kTileLanes;
    const int32_t first = bits != 0 ? firstLane(bits) : kBeyond;
    const int32_t last = bits != 0 ? lastLane(bits) : -kBeyond;
    // Adding one to solid ones carries through all of them.
    const uint64_t solid = bits >> (first * kLaneBits & 63);
    ink.first[tile] = static_cast<Distance>(first);
    ink.last[tile] = static_cast<Distance>(last);
    ink.holes[tile] = static_cast<Distance>((solid & (solid + 1)) == 0 ? 0 : last - first);
}

/// Finds the nearest covered pixels beside each tile.
inline void findNeighbours(const InkRow& ink, int64_t tiles) {
    int32_t distance = kBeyond;
    for (int64_t i = 0; i < tiles; ++i) {
        ink.before[i] = static_cast<Distance>(distance);
        distance = smaller(smaller(distance, kBeyond) + kTile, kTile - ink.last[i]);
    }
    distance = kBeyond;
    for (int64_t i = tiles; i-- > 0;) {
        ink.after[i] = static_cast<Distance>(distance);
        distance = smaller(smaller(distance, kBeyond) + kTile, 1 + ink.first[i]);
    }
}

inline void findInk(const Dilation& dilation, const TilePlanes& planes, int64_t y) {
    const uint8_t* const source = planes.rows.at(y) + dilation.left;
    const Bytes most = spread<Bytes>(dilation.largest);
    for (int64_t tile = 0; tile < planes.tiles; tile += kBytes / kTile) {
        const Bytes coverage = load<Bytes>(source + tile * kTile);
        const uint64_t ink = nonZeroLanes(coverage);
        const uint64_t isMost = nonZeroLanes(as<Bytes>(coverage == most) & coverage);
        for (int i = 0; i < kBytes / kTile; ++i) {
            noteInk(planes.ink, tile + i, ink >> (i * kTileBits % 64));
            noteInk(planes.most, tile + i, isMost >> (i * kTileBits % 64));
        }
    }
    findNeighbours(planes.ink, planes.tiles);
    findNeighbours(planes.most, planes.tiles);
}

/// Distance of a covered pixel from the nearest pixel of each tile.
VOREL_INLINE Distances smallestDistance(const InkRow& ink, int64_t tile) {
    const Distances beside =
        smaller(load<Distances>(ink.before + tile), load<Distances>(ink.after + tile));
    return load<Distances>(ink.last + tile) < 0 ? beside : Distances{};
}

/// Not less than the distance of the nearest covered pixel from any pixel of the tile: before its first
/// one, behind its last one, and between these. From one covered pixel to the next the distance rises to
/// half of theirs. Holes among the tile's own are taken as one.
VOREL_INLINE Distances largestDistance(const InkRow& ink, int64_t tile) {
    const Distances before = load<Distances>(ink.before + tile);
    const Distances after = load<Distances>(ink.after + tile);
    const Distances first = load<Distances>(ink.first + tile);
    const Distances last = load<Distances>(ink.last + tile);
    constexpr int16_t kEnd = kTile - 1;
    const Distances empty = smaller(smaller(before, after) + kEnd, (before + after + kEnd) >> 1);
    const Distances toFirst = smaller(first, (before + first) >> 1);
    const Distances fromLast = smaller(kEnd - last, (after + kEnd - last) >> 1);
    const Distances between = load<Distances>(ink.holes + tile) >> 1;
    return last < 0 ? empty : larger(larger(toFirst, fromLast), between);
}

inline void noteReaches(const Dilation& dilation, const TilePlanes& planes, const Reached& reached,
                        int64_t y) {
    const Distances beyond = spread<Distances>(static_cast<Distance>(dilation.disc->reach + 1));
    Reach* const full = planes.full + y * planes.reachStride;
    Reach* const touched = planes.touched + y * planes.reachStride;
    uint8_t* touching = planes.touching + y;
    for (int64_t tile = 0; tile < planes.tiles; tile += kReachLanes) {
        store(full + tile, smaller(largestDistance(planes.most, tile), beyond));
        store(touched + tile, smaller(smallestDistance(planes.ink, tile), beyond));
    }
    for (int64_t tile = 0; tile < planes.tiles; ++tile, touching += planes.touchingStride) {
        full[tile] = reached.full[full[tile]];
        touched[tile] = reached.touched[touched[tile]];
        *touching = static_cast<uint8_t>(smaller<int>(touched[tile] + 1, 255));
    }
    // The lanes behind the last tile agree with any other.
    for (int64_t tile = planes.tiles; tile < planes.reachStride; ++tile) {
        full[tile] = kBeyond;
        touched[tile] = -1;
    }
}

/// Lets each row reach its neighbours: down, then up.
inline void passReaches(Reach* reaches, int64_t stride, int64_t height) {
    const auto pass = [&](int64_t y, int64_t from) {
        for (int64_t x = 0; x < stride; x += kReachLanes) {
            Reach* const own = reaches + y * stride + x;
            const Reaches passed = load<Reaches>(reaches + from * stride + x) - 1;
            store(own, larger(load<Reaches>(own), passed));
        }
    };
    for (int64_t y = 1; y < height; ++y)
        pass(y, y - 1);
    for (int64_t y = height - 1; y-- > 0;)
        pass(y, y + 1);
}

inline uint8_t largestOf(const PaddedRows& rows, int64_t height) {
    Bytes largest = {};
    for (int64_t x = 0; x + kBytes <= height * rows.stride; x += kBytes)
        largest = larger(largest, load<Bytes>(rows.start + x));
    uint8_t result = 0;
    for (int i = 0; i < kBytes; ++i)
        result = larger<uint8_t>(result, largest[i]);
    return result;
}

// --- The disc
// -------------------------------------------------------------------------------------------

/// Covers the run of full cells in a row with windows, the last of which may lie over its predecessor.
inline int32_t* listFlatTaps(const TilePlanes& planes, const DiscShape& disc, int64_t reach,
                             int32_t* taps) {
    const int64_t length = 2 * reach + 1;
    const uint8_t* plane = planes.rows.start;
    int64_t step = 1;
    for (int i = 0; i < 2 && length >= windowLength(disc, i); ++i) {
        plane = planes.windows[i].start;
        step = windowLength(disc, i);
    }
    const int64_t last = reach + 1 - step;
    const int32_t* const start = taps;
    for (int64_t dx = -reach; dx < last; dx += step)
        *taps++ = static_cast<int32_t>(plane - planes.rows.start + dx);
    *taps++ = static_cast<int32_t>(plane - planes.rows.start + last);
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
        for (int32_t i = 0; i < row.endRim - row.firstRim; ++i)
            *deficit++ = spread<Tile>(disc.rimDeficit[disc.rimStart[dy] + i]);
    }
}

inline void beginTiles(Dilation& dilation) {
    const TilePlanes planes = tilePlanes(dilation);
    const int64_t shortWindow = windowLength(*dilation.disc, 0);
    for (int64_t y = 0; y < dilation.height; ++y) {
        fillRow(dilation, y, planes.rows, y);
        uint8_t* const windows = planes.windows[0].wholeRow(y);
        widenWindows(planes.rows.wholeRow(y), windows, 1, planes.rows.stride);
        if (shortWindow > 4) widenWindows(windows, windows, 4, planes.rows.stride);
        widenWindows(windows, planes.windows[1].wholeRow(y), shortWindow, planes.rows.stride);
    }
    dilation.largest = largestOf(planes.rows, dilation.height);
    listDiscRows(planes, *dilation.disc);

    Reached reached;
    listReached(*dilation.disc, reached);
    for (int64_t y = 0; y < dilation.height; ++y) {
        findInk(dilation, planes, y);
        noteReaches(dilation, planes, reached, y);
    }
    passReaches(planes.full, planes.reachStride, dilation.height);
    passReaches(planes.touched, planes.reachStride, dilation.height);
}

// --- Evaluation
// -----------------------------------------------------------------------------------------

/// |dy|, as large as the values it is compared with may tell.
struct RowDistances {
    static constexpr int64_t kMost = DiscShape::kLongestReach + 64;
    uint8_t values[2 * kMost + 1];

    constexpr RowDistances() : values() {
        for (int64_t dy = -kMost; dy <= kMost; ++dy) {
            const int64_t distance = dy < 0 ? -dy : dy;
            values[dy + kMost] = static_cast<uint8_t>(distance < 254 ? distance : 254);
        }
    }
    const uint8_t* at(int64_t dy) const { return values + kMost + dy; }
};
constexpr RowDistances kRowDistances;

/// What a source row adds to the tile whose place in it is `source`.
VOREL_INLINE Tile dilatedRow(const TilePlanes& planes, const DiscRow& row, const uint8_t* source) {
    Tile result = {};
    for (int32_t i = row.firstTap; i < row.endTap; i += 2) {
        const int32_t* const tap = planes.taps + i;
        result = larger(result, larger(load<Tile>(source + tap[0]), load<Tile>(source + tap[1])));
    }
    const Tile* deficit = row.deficits;
    for (int64_t dx = row.firstRim; dx < row.endRim; ++dx, ++deficit) {
        const Tile coverage = larger(load<Tile>(source - dx), load<Tile>(source + dx));
        result = larger(result, larger(coverage, *deficit) - *deficit);
    }
    return result;
}

inline Tile dilatedTile(const Dilation& dilation, const TilePlanes& planes, int64_t y, int64_t tile) {
    const DiscShape& disc = *dilation.disc;
    const uint8_t* const touching = planes.touching + tile * planes.touchingStride;
    const int64_t x = dilation.left + tile * kTile;
    const int64_t end = smaller(y + disc.reach + 1, dilation.height);
    Tile result = {};
    for (int64_t first = larger<int64_t>(y - disc.reach, 0); first < end; first += kBytes) {
        const Bytes distances = load<Bytes>(kRowDistances.at(first - y));
        uint64_t touch = nonZeroLanes(subSaturated(load<Bytes>(touching + first), distances));
        while (touch != 0) {
            const int lane = firstLane(touch);
            const int64_t row = first + lane;
            if (row >= end) break;
            const DiscRow& discRow = planes.discRows[row < y ? y - row : row - y];
            result = larger(result, dilatedRow(planes, discRow, planes.rows.at(row) + x));
            touch &= ~(((uint64_t{1} << kLaneBits) - 1) << lane * kLaneBits);
        }
    }
    return result;
}

inline void dilateRowByTiles(const Dilation& dilation, const TilePlanes& planes, int64_t y,
                             uint8_t* results) {
    const int64_t nearest = smaller(larger<int64_t>(y, 0), dilation.height - 1);
    const auto away = static_cast<Reach>(y < nearest ? nearest - y : y - nearest);
    const Reach* const full = planes.full + nearest * planes.reachStride;
    const Reach* const touched = planes.touched + nearest * planes.reachStride;
    const Tile most = spread<Tile>(dilation.largest);
    const auto fill = [&](int64_t tile, int64_t end, Tile value) {
        for (; tile < end; ++tile)
            store(results + tile * kTile, value);
    };
    for (int64_t tile = 0; tile < planes.tiles; tile += kReachLanes) {
        const int64_t end = smaller(tile + kReachLanes, planes.tiles);
        if (allZero(as<Bytes>(load<Reaches>(full + tile) < away))) {
            fill(tile, end, most);
        } else if (allZero(as<Bytes>(load<Reaches>(touched + tile) >= away))) {
            fill(tile, end, Tile{});
        } else {
            for (int64_t i = tile; i < end; ++i) {
                const bool isFull = full[i] >= away;
                const bool isKnown = isFull || touched[i] < away;
                store(results + i * kTile,
                      isKnown ? isFull ? most : Tile{} : dilatedTile(dilation, planes, y, i));
            }
        }
    }
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
