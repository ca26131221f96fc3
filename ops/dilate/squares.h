#pragma once

#include <cstdint>
#include <cstring>

#include "ops/dilate/padded_rows.h"

/// Dilation by large discs of what has little empty and little full about it, as noise, ramps and
/// photographs: every vector of results is evaluated, at a cost that no mask raises far.
///
/// The full cells of a disc are a union of squares whose sides are powers of two. Let [-h, h]^2 be the
/// largest square of full cells, and (w, d) the corners of the outline's staircase, w > h >= d, with
/// their mirror images: [-w, w] x [-d, d] is full, and the largest square in its corner, whose side is a
/// power of two, is longer than d. The steps there are one column wide: (w - 1, d + 1) is no farther
/// from the centre than (w, d) is. So each column beyond h has a corner, whose square reaches from the
/// staircase to the middle row, and the rest is the middle square, four of the largest side. A plane for
/// each side holds the largest coverage of every square at its upper left corner, so a square is one
/// load.
///
/// What lies around the middle square is cut into 16 sectors, two of an octant: corners, and cells of
/// the rim. A few squares around a sector tell the largest coverage in it. Where that is no more than
/// what has been found the sector is left out, and its rim where it is no more than 1 above, as any cell
/// of the rim lacks at least 1 to 255. The largest coverage under a disc is rarely in many sectors.
///
/// Cost for a reach of r: 4 loads for each plane, of which there are about log2(1.4 r), and for each
/// vector of results some 60 loads, and per sector that is looked into up to r / 7 squares and r / 2
/// cells of the rim.
namespace VFontEffect::internal::VOREL_LEVEL {

/// Rows that planes have room for beside those in reach: a number of bands, after which rows are moved.
constexpr int64_t kRolledRows = 64;

/// Loads of one sector, as offsets from a result's place in the plane of single pixels. The squares of
/// each list are even in number, so that half of a loop's maxima need not wait for each other.
struct Sector {
    const int32_t* bounds;   ///< squares with all of it
    const int32_t* squares;  ///< of its corners
    const int32_t* rim;
    const U8s* deficits;  ///< 255 - weight of the rim's cells, in all lanes
    int32_t boundCount;
    int32_t squareCount;
    int32_t rimCount;
};
constexpr int64_t kSectors = 16;
constexpr int kImages = 8;  ///< of an octant

struct SquareLayout {
    int64_t planes;      ///< of the sides 1, 2, 4, ...
    PaddedRows rows;     ///< of the first plane; the others follow
    int64_t planeBytes;  ///< from one to the next
    int64_t firstRow;    ///< of the source: the planes' first
    int64_t filledRows;  ///< from there on
    Sector* sectors;
    int32_t* middle;  ///< the four squares of the middle
    int32_t* around;  ///< squares with all of the disc
    int64_t aroundCount;
    int32_t* offsets;  ///< all that the sectors point to
    U8s* deficits;
    uint8_t* results;  ///< of a band

    static SquareLayout of(const Dilation& dilation, Arena& arena);
};

/// The half side of the largest square of full cells.
VOREL_INLINE int64_t halfOfMiddle(const DiscShape& disc) {
    int64_t half = 0;
    while (half < disc.reach && disc.flatReach[half + 1] > half)
        ++half;
    return half;
}

/// The plane of the largest squares of at most that side.
VOREL_INLINE int64_t planeWithin(int64_t side) {
    return 63 - __builtin_clzll(static_cast<uint64_t>(side));
}
/// The plane of the smallest squares of at least that side.
VOREL_INLINE int64_t planeAround(int64_t side) {
    return side <= 1 ? 0 : planeWithin(side - 1) + 1;
}

inline SquareLayout SquareLayout::of(const Dilation& dilation, Arena& arena) {
    const DiscShape& disc = *dilation.disc;
    const int64_t reach = disc.reach;
    SquareLayout layout;
    layout.planes = planeWithin(2 * halfOfMiddle(disc) + 1) + 1;
    const int64_t rows = 2 * reach + max(kRolledRows, dilation.bandRows);
    layout.rows = takeRows(dilation, wantedColumns(dilation), layout.planes * rows + 1,
                           roundedUp(reach, kArenaAlignment), reach + kBytes, arena);
    layout.rows.count = rows;
    layout.planeBytes = rows * layout.rows.stride;
    layout.firstRow = layout.filledRows = 0;
    layout.sectors = arena.take<Sector>(kSectors);
    layout.middle = arena.take<int32_t>(4);
    layout.around = arena.take<int32_t>(10);
    layout.aroundCount = 0;
    // A quarter's staircase has at most a corner in each row, its rim four cells.
    constexpr int64_t kMostBounds = 8;
    layout.offsets = arena.take<int32_t>(kImages * (5 * (reach + 1) + 2 * kMostBounds) + 2 * kSectors);
    layout.deficits = arena.take<U8s>(4 * (reach + 1));
    layout.results = arena.take<uint8_t>(dilation.bandRows * dilatedStride(dilation));
    return layout;
}

// --- The disc ----------------------------------------------------------------------------------------

/// One of the eight images of what is described in the octant x >= y >= 0.
struct Image {
    bool left;
    bool up;
    bool transposed;
};

/// Appends loads to the lists of a layout.
class LoadLists {
  public:
    explicit LoadLists(const SquareLayout& layout) : mLayout(layout), mNext(layout.offsets) {}

    int32_t* next() const { return mNext; }

    /// Ends a list of squares that began there: an odd one repeats its last load.
    void end(const int32_t* begin) {
        if ((mNext - begin) % 2 == 0) return;
        mNext[0] = mNext[-1];
        ++mNext;
    }

    /// The square of a plane whose outer corner is that cell.
    void addSquare(const Image& image, int64_t plane, int64_t x, int64_t y) {
        const int64_t inwards = (int64_t{1} << plane) - 1;
        add(image, plane, image.left ? -x : x - inwards, image.up ? -y : y - inwards);
    }

    void addCell(const Image& image, int64_t x, int64_t y) {
        add(image, 0, image.left ? -x : x, image.up ? -y : y);
    }

  private:
    void add(const Image& image, int64_t plane, int64_t x, int64_t y) {
        VOREL_ASSERT(plane < mLayout.planes);
        const int64_t column = image.transposed ? y : x;
        const int64_t row = image.transposed ? x : y;
        *mNext++ = static_cast<int32_t>(plane * mLayout.planeBytes + row * mLayout.rows.stride + column);
    }

    const SquareLayout& mLayout;
    int32_t* mNext;
};

/// Rows of an octant, x >= y >= 0.
struct OctantRows {
    int64_t first;
    int64_t last;
};

/// Squares from the sector's outermost column inwards to the middle square, over all of its rows.
inline void addBounds(LoadLists& lists, const DiscShape& disc, const Image& image, OctantRows rows) {
    const int64_t outermost = disc.outerReach[rows.first];
    const int64_t plane = planeAround(outermost - halfOfMiddle(disc));
    for (int64_t row = rows.last; row >= rows.first; row -= int64_t{1} << plane)
        lists.addSquare(image, plane, outermost, row);
}

/// The sector's last row makes corners of its own, so that the squares reach inwards from there as well.
inline void addCorners(LoadLists& lists, const DiscShape& disc, const Image& image, OctantRows rows) {
    const int64_t half = halfOfMiddle(disc);
    const int64_t last = min(rows.last, half);
    for (int64_t row = rows.first; row <= last; ++row) {
        const int64_t column = disc.flatReach[row];
        const bool isCorner = row == last || disc.flatReach[row + 1] < column;
        if (isCorner && column > half) lists.addSquare(image, planeWithin(2 * row + 1), column, row);
    }
}

/// The deficits are the same for all images.
inline void addRim(LoadLists& lists, const DiscShape& disc, const Image& image, OctantRows rows,
                   U8s* deficits) {
    for (int64_t row = rows.first; row <= rows.last; ++row) {
        const int64_t flat = disc.flatReach[row];
        for (int64_t column = max(flat + 1, row); column <= disc.outerReach[row]; ++column) {
            lists.addCell(image, column, row);
            *deficits++ = splat<U8s>(disc.rimDeficit[disc.rimStart[row] + column - flat - 1]);
        }
    }
}

inline Sector listSector(LoadLists& lists, const DiscShape& disc, const Image& image, OctantRows rows,
                         U8s* deficits) {
    Sector sector;
    sector.bounds = lists.next();
    addBounds(lists, disc, image, rows);
    lists.end(sector.bounds);
    sector.squares = lists.next();
    addCorners(lists, disc, image, rows);
    lists.end(sector.squares);
    sector.rim = lists.next();
    addRim(lists, disc, image, rows, deficits);
    sector.deficits = deficits;
    sector.boundCount = static_cast<int32_t>(sector.squares - sector.bounds);
    sector.squareCount = static_cast<int32_t>(sector.rim - sector.squares);
    sector.rimCount = static_cast<int32_t>(lists.next() - sector.rim);
    return sector;
}

/// The two sectors of each octant: what is close to the axis, and what is close to the diagonal.
inline void listSectors(const SquareLayout& layout, const DiscShape& disc) {
    int64_t last = 0;  // of the octant's rows
    while (last < disc.reach && disc.outerReach[last + 1] > last)
        ++last;
    const int64_t cut = halfOfMiddle(disc) / 2;
    LoadLists lists(layout);
    Sector* sector = layout.sectors;
    for (int i = 0; i < kImages; ++i) {
        const Image image = {(i & 1) != 0, (i & 2) != 0, (i & 4) != 0};
        const Sector& near = *sector++ = listSector(lists, disc, image, {0, cut}, layout.deficits);
        *sector++ = listSector(lists, disc, image, {cut + 1, last}, layout.deficits + near.rimCount);
    }
}

/// Squares that cover [-half, half]^2, in rows of `perRow`.
inline void listSquares(const SquareLayout& layout, int64_t half, int64_t perRow, int32_t* offsets) {
    const int64_t plane = layout.planes - 1;
    const int64_t side = int64_t{1} << plane;
    VOREL_ASSERT(perRow * side > 2 * half);
    const auto place = [=](int64_t i) { return min(i * side - half, half + 1 - side); };
    for (int64_t i = 0; i < perRow * perRow; ++i) {
        *offsets++ = static_cast<int32_t>(plane * layout.planeBytes +
                                          place(i / perRow) * layout.rows.stride + place(i % perRow));
    }
}

inline void beginSquares(const Dilation& dilation, uint8_t* memory) {
    const DiscShape& disc = *dilation.disc;
    SquareLayout& layout = layOut<SquareLayout>(dilation, memory);
    VOREL_ASSERT(layout.planes * layout.planeBytes <= INT32_MAX);
    const int64_t side = int64_t{1} << (layout.planes - 1);
    const int64_t perRow = (2 * int64_t{disc.reach} + side) / side;
    VOREL_ASSERT(perRow <= 3);
    listSquares(layout, halfOfMiddle(disc), 2, layout.middle);
    listSquares(layout, disc.reach, perRow, layout.around);
    layout.aroundCount = perRow * perRow;
    if (layout.aroundCount % 2 != 0) layout.around[layout.aroundCount++] = layout.around[0];
    listSectors(layout, disc);
    layout.firstRow = dilation.top - disc.reach;
    layout.filledRows = 0;
}

// --- The planes --------------------------------------------------------------------------------------

/// Rows of a plane that are known when so many of the source are.
VOREL_INLINE int64_t rowsOfPlane(int64_t plane, int64_t filledRows) {
    return max<int64_t>(filledRows - (int64_t{1} << plane) + 1, 0);
}

/// Makes a row of a plane of the one before: four squares are one of twice the side.
inline void joinSquares(const SquareLayout& layout, int64_t plane, int64_t row) {
    const int64_t side = int64_t{1} << (plane - 1);
    const int64_t stride = layout.rows.stride;
    const uint8_t* const upper = layout.rows.start + (plane - 1) * layout.planeBytes + row * stride;
    const uint8_t* const lower = upper + side * stride;
    uint8_t* const to = layout.rows.start + plane * layout.planeBytes + row * stride;
    for (int64_t x = 0; x <= stride - 2 * side; x += kBytes) {
        const U8s left = max(load<U8s>(upper + x), load<U8s>(lower + x));
        const U8s right = max(load<U8s>(upper + x + side), load<U8s>(lower + x + side));
        store(to + x, max(left, right));
    }
}

/// Drops the rows before one of the source. All planes have rows from there on.
inline void dropRows(SquareLayout& layout, int64_t firstRow) {
    const int64_t dropped = firstRow - layout.firstRow;
    for (int64_t plane = 0; plane < layout.planes; ++plane) {
        uint8_t* const rows = layout.rows.start + plane * layout.planeBytes;
        const int64_t kept = rowsOfPlane(plane, layout.filledRows) - dropped;
        VOREL_ASSERT(dropped > 0 && kept >= 0);
        std::memmove(rows, rows + dropped * layout.rows.stride,
                     static_cast<size_t>(kept * layout.rows.stride));
    }
    layout.filledRows -= dropped;
    layout.firstRow = firstRow;
}

/// Fills the planes as far as that row of the source.
inline void fillPlanes(const Dilation& dilation, SquareLayout& layout, int64_t endRow) {
    const int64_t before = layout.filledRows;
    layout.filledRows = endRow - layout.firstRow;
    VOREL_ASSERT(layout.filledRows <= layout.rows.count);
    for (int64_t row = before; row < layout.filledRows; ++row)
        fillRow(dilation, layout.firstRow + row, layout.rows, row);
    for (int64_t plane = 1; plane < layout.planes; ++plane) {
        const int64_t end = rowsOfPlane(plane, layout.filledRows);
        for (int64_t row = rowsOfPlane(plane, before); row < end; ++row)
            joinSquares(layout, plane, row);
    }
}

// --- Evaluation --------------------------------------------------------------------------------------

VOREL_INLINE U8s largestOf(const uint8_t* place, const int32_t* offsets, int64_t count, U8s value) {
    for (const int32_t* const end = offsets + count; offsets < end; offsets += 2)
        value = max(value, largerOf<U8s>(place, offsets));
    return value;
}

VOREL_INLINE U8s withRim(const Sector& sector, const uint8_t* place, U8s value) {
    const U8s* deficits = sector.deficits;
    const int32_t* const end = sector.rim + sector.rimCount;
    for (const int32_t* rim = sector.rim; rim < end; ++rim, ++deficits)
        value = max(value, subSaturated(load<U8s>(place + *rim), *deficits));
    return value;
}

VOREL_INLINE bool isMore(U8s bound, U8s value) {
    return !allZero(subSaturated(bound, value));
}

inline U8s dilatedVector(const SquareLayout& layout, const uint8_t* place) {
    U8s value = largestOf(place, layout.middle, 4, U8s{});
    if (!isMore(largestOf(place, layout.around, layout.aroundCount, U8s{}), value)) return value;
    for (int64_t i = 0; i < kSectors; ++i) {
        const Sector& sector = layout.sectors[i];
        const U8s bound = largestOf(place, sector.bounds, sector.boundCount, U8s{});
        if (!isMore(bound, value)) continue;
        value = largestOf(place, sector.squares, sector.squareCount, value);
        if (isMore(subSaturated(bound, splat<U8s>(uint8_t{1})), value))
            value = withRim(sector, place, value);
    }
    return value;
}

inline uint8_t* rowsBySquares(const Dilation& dilation, uint8_t* memory, int64_t y, int64_t count) {
    SquareLayout& kept = keptIn<SquareLayout>(memory);
    const int64_t reach = dilation.disc->reach;
    const int64_t end = y + count + reach;
    if (end - kept.firstRow > kept.rows.count) dropRows(kept, y - reach);
    fillPlanes(dilation, kept, end);
    const auto layout = layoutIn<SquareLayout>(memory);
    for (int64_t i = 0; i < count; ++i) {
        const uint8_t* const source = layout.rows.at(y + i - layout.firstRow) + dilation.left;
        uint8_t* const results = layout.results + i * dilatedStride(dilation);
        for (int64_t x = 0; x < dilation.right - dilation.left; x += kBytes)
            store(results + x, dilatedVector(layout, source + x));
    }
    return layout.results;
}

constexpr DilationStrategy kSquares = {layoutBytes<SquareLayout>, beginSquares, rowsBySquares};

}  // namespace VFontEffect::internal::VOREL_LEVEL
