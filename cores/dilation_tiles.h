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

/// Farther than any disc reaches.
constexpr int32_t kFar = 1 << 20;

/// The covered pixels of a tile of the source, and the nearest ones beside it.
struct TileInk {
    uint64_t lanes;  ///< kLaneBits ones for each covered pixel
    int32_t before;  ///< columns of the nearest covered pixels to both sides
    int32_t after;
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
    Tile* rimDeficits;  ///< those of the disc, in all lanes
    TileInk* ink;
    TileInk* fullInk;
    size_t bytes;
};

/// The lengths of the windows, for rows of full cells that are as long at least.
VOREL_INLINE int64_t windowLength(const DiscShape& disc, int plane) {
    const int64_t shorter = disc.reach < 24 ? 4 : 16;
    return plane == 0 ? shorter : 4 * shorter;
}

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

    const int64_t inkBytes = planes.tiles * int64_t{sizeof(TileInk)};
    planes.ink = reinterpret_cast<TileInk*>(take(inkBytes));
    planes.fullInk = reinterpret_cast<TileInk*>(take(inkBytes));
    const int64_t reachBytes = height * planes.reachStride * int64_t{sizeof(Reach)};
    planes.full = reinterpret_cast<Reach*>(take(reachBytes));
    planes.touched = reinterpret_cast<Reach*>(take(reachBytes));
    planes.touching = take(planes.tiles * planes.touchingStride);
    planes.rimDeficits = reinterpret_cast<Tile*>(take(DiscShape::kMostRimCells * int64_t{sizeof(Tile)}));
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

constexpr uint64_t kTileLanes = ~uint64_t{0} >> (64 - kTile * kLaneBits);

/// Splits the lanes of a vector into those of its tiles.
VOREL_INLINE void setLanes(TileInk* ink, uint64_t lanes, int64_t count) {
    for (int i = 0; i < kBytes / kTile && i < count; ++i)
        ink[i].lanes = lanes >> (i * kTile * kLaneBits % 64) & kTileLanes;
}

/// Finds the nearest covered pixels beside each tile.
inline void findNeighbours(TileInk* ink, int64_t tiles) {
    int32_t nearest = -kFar;
    for (int64_t i = 0; i < tiles; ++i) {
        ink[i].before = nearest;
        if (ink[i].lanes != 0) nearest = static_cast<int32_t>(i) * kTile + lastLane(ink[i].lanes);
    }
    nearest = kFar;
    for (int64_t i = tiles; i-- > 0;) {
        ink[i].after = nearest;
        if (ink[i].lanes != 0) nearest = static_cast<int32_t>(i) * kTile + firstLane(ink[i].lanes);
    }
}

/// Distance of a covered pixel from the nearest pixel of the tile.
VOREL_INLINE int32_t smallestDistance(const TileInk& ink, int32_t start) {
    const int32_t beside = smaller(start - ink.before, ink.after - (start + kTile - 1));
    return ink.lanes != 0 ? 0 : beside;
}

/// Not less than the distance of the nearest covered pixel from any pixel of the tile. Between two
/// covered pixels the distance rises to half of theirs; holes among the tile's own are taken as one.
VOREL_INLINE int32_t largestDistance(const TileInk& ink, int32_t start) {
    const int32_t end = start + kTile - 1;
    if (ink.lanes == 0) {
        return smaller(smaller(end - ink.before, ink.after - start), (ink.after - ink.before) / 2);
    }
    const int32_t first = firstLane(ink.lanes);
    const int32_t last = lastLane(ink.lanes);
    const int32_t left = smaller(first, (start + first - ink.before) / 2);
    const int32_t right = smaller(kTile - 1 - last, (ink.after - start - last) / 2);
    const uint64_t solid = ink.lanes >> (first * kLaneBits);
    const int32_t between = (solid & (solid + 1)) == 0 ? 0 : (last - first) / 2;
    return larger(larger(left, right), between);
}

inline void findInk(const Dilation& dilation, const TilePlanes& planes, int64_t y) {
    const uint8_t* const source = planes.rows.at(y) + dilation.left;
    const Bytes most = spread<Bytes>(dilation.largest);
    for (int64_t tile = 0; tile < planes.tiles; tile += kBytes / kTile) {
        const Bytes coverage = load<Bytes>(source + tile * kTile);
        const Bytes isMost = as<Bytes>(coverage == most) & coverage;
        setLanes(planes.ink + tile, nonZeroLanes(coverage), planes.tiles - tile);
        setLanes(planes.fullInk + tile, nonZeroLanes(isMost), planes.tiles - tile);
    }
    findNeighbours(planes.ink, planes.tiles);
    findNeighbours(planes.fullInk, planes.tiles);
}

inline void noteReaches(const Dilation& dilation, const TilePlanes& planes, const Reached& reached,
                        int64_t y) {
    const int32_t beyond = dilation.disc->reach + 1;
    Reach* const full = planes.full + y * planes.reachStride;
    Reach* const touched = planes.touched + y * planes.reachStride;
    for (int64_t tile = 0; tile < planes.tiles; ++tile) {
        const int32_t start = static_cast<int32_t>(tile) * kTile;
        full[tile] = reached.full[smaller(largestDistance(planes.fullInk[tile], start), beyond)];
        touched[tile] = reached.touched[smaller(smallestDistance(planes.ink[tile], start), beyond)];
        planes.touching[tile * planes.touchingStride + y] =
            static_cast<uint8_t>(smaller<int>(touched[tile] + 1, 255));
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

inline void listRimDeficits(const DiscShape& disc, Tile* deficits) {
    const int cells =
        disc.rimStart[disc.reach] + disc.outerReach[disc.reach] - disc.flatReach[disc.reach];
    for (int i = 0; i < cells; ++i)
        deficits[i] = spread<Tile>(disc.rimDeficit[i]);
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
    listRimDeficits(*dilation.disc, planes.rimDeficits);

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

/// The largest coverage under the full cells of a row of the disc, which reach that far to both sides.
VOREL_INLINE Tile flatMaximum(const TilePlanes& planes, const DiscShape& disc, int64_t y, int64_t x,
                              int64_t reach) {
    const int64_t length = 2 * reach + 1;
    const uint8_t* source = planes.rows.at(y) + x;
    int64_t step = 1;
    for (int plane = 0; plane < 2 && length >= windowLength(disc, plane); ++plane) {
        source = planes.windows[plane].at(y) + x;
        step = windowLength(disc, plane);
    }
    const int64_t last = reach + 1 - step;
    Tile largest = load<Tile>(source + last);
    for (int64_t dx = -reach; dx < last; dx += step)
        largest = larger(largest, load<Tile>(source + dx));
    return largest;
}

/// What a source row, dy rows away, adds to the tile at column x.
VOREL_INLINE Tile dilatedRow(const TilePlanes& planes, const DiscShape& disc, int64_t y, int64_t dy,
                             int64_t x) {
    const int64_t flat = disc.flatReach[dy];
    Tile result = {};
    if (flat >= 0) result = flatMaximum(planes, disc, y, x, flat);
    const uint8_t* const source = planes.rows.at(y) + x;
    const Tile* deficit = planes.rimDeficits + disc.rimStart[dy];
    for (int64_t dx = flat + 1; dx <= disc.outerReach[dy]; ++dx, ++deficit) {
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
            result = larger(result, dilatedRow(planes, disc, row, row < y ? y - row : row - y, x));
            touch &= ~(((uint64_t{1} << kLaneBits) - 1) << lane * kLaneBits);
        }
    }
    return result;
}

inline void dilateRowByTiles(const Dilation& dilation, const TilePlanes& planes, int64_t y,
                             uint8_t* results) {
    const int64_t nearest = smaller(larger<int64_t>(y, 0), dilation.height - 1);
    const int64_t away = y < nearest ? nearest - y : y - nearest;
    const Reach* const full = planes.full + nearest * planes.reachStride;
    const Reach* const touched = planes.touched + nearest * planes.reachStride;
    const Tile most = spread<Tile>(dilation.largest);
    for (int64_t tile = 0; tile < planes.tiles; ++tile, results += kTile) {
        if (full[tile] >= away) {
            store(results, most);
        } else if (touched[tile] < away) {
            store(results, Tile{});
        } else {
            store(results, dilatedTile(dilation, planes, y, tile));
        }
    }
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
