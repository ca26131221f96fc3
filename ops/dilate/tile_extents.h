#pragma once

#include <cstdint>

#include "ops/dilate/padded_rows.h"

/// Where the covered pixels of a row are, seen from tiles: pieces of a row of one short vector.
namespace VFontEffect::internal::VOREL_LEVEL {

constexpr int kTile = kBytes < 16 ? kBytes : 16;
using Tile = uint8_t __attribute__((vector_size(kTile)));

/// Columns. Beyond what any disc reaches they need not be exact.
using Distance = int16_t;
using Distances = int16_t __attribute__((vector_size(kBytes)));
constexpr int64_t kDistances = kBytes / 2;
constexpr Distance kBeyond = 1024;
constexpr Distance kTileEnd = kTile - 1;

/// The covered pixels of kDistances rows: for each number an array, by tile and then by row, so that
/// vectors hold rows. A tile without any has its first and its last one far to the right and to the
/// left.
struct TileExtents {
    Distance* first;  ///< from the tile's first column to its first covered pixel
    Distance* last;   ///< from the tile's first column to its last one
    Distance* holes;  ///< from the first to the last one if any between is not covered, else 0
    Distance*
        before;       ///< from the tile's first column back to the nearest covered pixel before the tile
    Distance* after;  ///< from the tile's last column on to the nearest one behind it
};

/// Tiles that are noted at once, those of a vector.
constexpr int64_t kTilesOfVector = kBytes / kTile;

inline TileExtents takeExtents(int64_t tiles, Arena& arena) {
    const int64_t noted = roundedUp(tiles, kTilesOfVector);
    const auto take = [&] { return arena.take<Distance>(noted * kDistances); };
    return {take(), take(), take(), take(), take()};
}

VOREL_INLINE int firstLane(uint64_t lanes) {
    return __builtin_ctzll(lanes) / kLaneBits;
}
VOREL_INLINE int lastLane(uint64_t lanes) {
    return (63 - __builtin_clzll(lanes)) / kLaneBits;
}

VOREL_INLINE uint64_t withoutFirst(uint64_t lanes) {
    constexpr uint64_t kLane = ~uint64_t{0} >> (64 - kLaneBits);
    return kLaneBits == 1 ? lanes & (lanes - 1) : lanes & ~(kLane << firstLane(lanes) * kLaneBits);
}

constexpr int kTileBits = kTile * kLaneBits;
constexpr uint64_t kTileLanes = ~uint64_t{0} >> (64 - kTileBits);

/// Notes the covered pixels of a tile, given as lanes.
VOREL_INLINE void noteTile(const TileExtents& extents, int64_t at, uint64_t lanes) {
    const uint64_t bits = lanes & kTileLanes;
    const int first = bits != 0 ? firstLane(bits) : kBeyond;
    const int last = bits != 0 ? lastLane(bits) : -kBeyond;
    // Adding its lowest bit to a single run of ones carries out of it, and leaves nothing there.
    const bool solid = ((bits + (bits & (0 - bits))) & bits) == 0;
    extents.first[at] = static_cast<Distance>(first);
    extents.last[at] = static_cast<Distance>(last);
    extents.holes[at] = static_cast<Distance>(solid ? 0 : last - first);
}

/// Finds the nearest covered pixels beside each tile. An empty tile's first and last one are kBeyond
/// away: no distance grows by more than a tile beyond that.
inline void findNeighbours(const TileExtents& extents, int64_t tiles) {
    const Distances beyond = splat<Distances>(kBeyond);
    const Distance* const firsts = extents.first;
    const Distance* const lasts = extents.last;
    Distance* const before = extents.before;
    Distance* const after = extents.after;
    Distances distance = beyond;
    for (int64_t at = 0; at < tiles * kDistances; at += kDistances) {
        store(before + at, distance);
        distance = min(distance + kTile, kTile - load<Distances>(lasts + at));
    }
    distance = beyond;
    for (int64_t at = (tiles - 1) * kDistances; at >= 0; at -= kDistances) {
        store(after + at, distance);
        distance = min(distance + kTile, 1 + load<Distances>(firsts + at));
    }
}

/// From a tile's first column to the nearest covered pixel that is not to the left of it.
VOREL_INLINE Distances toTheRight(const TileExtents& extents, int64_t at) {
    return min(load<Distances>(extents.first + at), load<Distances>(extents.after + at) + kTileEnd);
}

/// From a tile's last column to the nearest covered pixel that is not to the right of it.
VOREL_INLINE Distances toTheLeft(const TileExtents& extents, int64_t at) {
    return min(kTileEnd - load<Distances>(extents.last + at),
               load<Distances>(extents.before + at) + kTileEnd);
}

/// Of the tile's pixels the one next to a covered one has it that far away.
VOREL_INLINE Distances smallestDistance(Distances toRight, Distances toLeft) {
    return max(min(toRight, toLeft) - kTileEnd, Distances{});
}

/// None of the tile's pixels is farther from a covered one. Between neighbouring covered columns p < q
/// the distance of x is min(x - p, q - x), at most (q - p) / 2, rounded down. With E = kTileEnd, b =
/// before and a = after, in columns 0 to E of the tile:
///  - of an empty tile p = -b and q = E + a: min(x + b, E + a - x) is at most (b + a + E) / 2, and as
///    x is 0 to E also at most min(b, a) + E;
///  - before the first one, f, p = -b and q = f: at most (b + f) / 2, and at most f as x >= 0;
///  - behind the last one, l, likewise: at most (a + E - l) / 2, and at most E - l;
///  - between these any gap has q - p <= l - f: at most (l - f) / 2.
/// The last one alone may be more than what occurs. More only leaves a tile to be evaluated.
VOREL_INLINE Distances largestDistance(const TileExtents& extents, int64_t at) {
    const Distances before = load<Distances>(extents.before + at);
    const Distances after = load<Distances>(extents.after + at);
    const Distances first = load<Distances>(extents.first + at);
    const Distances last = load<Distances>(extents.last + at);
    const Distances ofEmpty = min(min(before, after) + kTileEnd, (before + after + kTileEnd) >> 1);
    const Distances toFirst = min(first, (before + first) >> 1);
    const Distances fromLast = min(kTileEnd - last, (after + kTileEnd - last) >> 1);
    const Distances between = load<Distances>(extents.holes + at) >> 1;
    return last < 0 ? ofEmpty : max(max(toFirst, fromLast), between);
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
