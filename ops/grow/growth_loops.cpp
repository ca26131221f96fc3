#include "ops/grow/growth_loops.h"

#include <cstdint>
#include <cstring>

#include "simd/pieces.h"

/// Growth: each pass makes a pixel a quarter of its 3 x 3 sum, at most 255.
///
/// The sum is separable: three neighbours of a row, then three rows. Of a row the sums of even and of
/// odd columns come from the bytes where they stand: the sum of a pair of bytes, which both share, and
/// one byte more from the vector that begins a byte earlier or later. They are kept while the rows go
/// by, so that each is made once.
///
/// Glyphs grow at their edges only: inside, nine times 255 stay 255, outside nine times 0 stay 0. A tile
/// that did not change in the last pass, nor the pixels beside it, cannot change in this one. It is
/// skipped: the other plane holds it already, as it has not changed since it was last written.
///
/// Cost: some 20 instructions a vector and pass in the tiles along the edges.
namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

constexpr int64_t kTileColumns = kBytes;
constexpr int64_t kTileRows = kGrowthTileRows;
static_assert(kTileColumns >= kNarrowestGrowthTile);

/// Adds to each 16-bit lane the lower, or the upper, of the two bytes that stand there.
VOREL_INLINE U16s plusLowBytes(U16s sums, U8s v) {
    return sums + (bitCast<U16s>(v) & 0x00FF);
}
VOREL_INLINE U16s plusHighBytes(U16s sums, U8s v) {
    return sums + (bitCast<U16s>(v) >> 8);
}

/// Sums of neighbours, those around even columns and those around odd ones.
struct Sums {
    U16s even;
    U16s odd;

    static VOREL_INLINE Sums ofRow(const uint8_t* row) {
        const U16s pairs = pairSums(load<U8s>(row));
        return {plusLowBytes(pairs, load<U8s>(row - 1)), plusHighBytes(pairs, load<U8s>(row + 1))};
    }
};

VOREL_INLINE Sums operator+(const Sums& a, const Sums& b) {
    return {a.even + b.even, a.odd + b.odd};
}

/// A column of vectors, from one plane to the other. The last one of the rows ends behind them.
template <bool kLast>
struct Column {
    const uint8_t* from;
    uint8_t* to;
    int64_t stride;
    U8s inside;  // of the last column, all ones where there are pixels
    U8s behind;  // and what to write elsewhere
    U8s changes = {};

    VOREL_INLINE void put(const Sums& sums) {
        U8s grown = quarters(sums.even, sums.odd);
        if (kLast) grown = (grown & inside) | behind;
        const U8s changed = grown ^ load<U8s>(from);
        changes |= kLast ? changed & inside : changed;
        store(to, grown);
        from += stride;
        to += stride;
    }

    /// Returns what changed. Rows are made by twos: both share the sum of the two rows.
    VOREL_INLINE U8s grow(int64_t rows) {
        Sums above = Sums::ofRow(from - stride);
        Sums here = Sums::ofRow(from);
        for (; rows >= 2; rows -= 2) {
            const Sums below = Sums::ofRow(from + stride);
            const Sums farther = Sums::ofRow(from + 2 * stride);
            const Sums both = here + below;
            put(above + both);
            put(both + farther);
            above = below;
            here = farther;
        }
        if (rows != 0) put(above + here + Sums::ofRow(from + stride));
        return changes;
    }
};

/// Whether the outermost pixels of a tile changed, on each of its sides.
struct ChangedSides {
    bool left;
    bool top;
    bool right;
    bool bottom;
};

/// Which tiles are to do in this pass and in the next one, with a tile more on all sides.
class Tiles {
  public:
    Tiles(const GrowthJob& job, uint8_t* tiles)
        : mStride((job.width + kTileColumns - 1) / kTileColumns + 2),
          mBytes(mStride * ((job.height + kTileRows - 1) / kTileRows + 2)),
          mNow(tiles),
          mNext(tiles + mBytes) {
        std::memset(mNow, 1, static_cast<size_t>(mBytes));
        std::memset(mNext, 0, static_cast<size_t>(mBytes));
    }

    bool isToDo(int64_t column, int64_t row) const { return *at(mNow, column, row) != 0; }

    /// Those that a change can reach in the next pass: the tile itself, and on each side where its
    /// outermost pixels changed the one beside it.
    void noteChange(const ChangedSides& sides, int64_t column, int64_t row) {
        for (int64_t y = row - sides.top; y <= row + sides.bottom; ++y) {
            for (int64_t x = column - sides.left; x <= column + sides.right; ++x)
                *at(mNext, x, y) = 1;
        }
    }

    void endPass() {
        uint8_t* const done = mNow;
        mNow = mNext;
        mNext = done;
        std::memset(mNext, 0, static_cast<size_t>(mBytes));
    }

  private:
    uint8_t* at(uint8_t* tiles, int64_t column, int64_t row) const {
        return tiles + (row + 1) * mStride + column + 1;
    }

    int64_t mStride;
    int64_t mBytes;
    uint8_t* mNow;
    uint8_t* mNext;
};

/// Grows a tile by one pass and tells what changed.
U8s growTile(const GrowthJob& job, int from, int64_t x, int64_t y, int64_t rows) {
    const int64_t at = y * job.stride + x;
    const uint8_t* const source = job.planes[from] + at;
    uint8_t* const target = job.planes[1 - from] + at;
    if (x + kBytes <= job.width) return Column<false>{source, target, job.stride, {}, {}}.grow(rows);
    const U8s inside = firstBytes(job.width - x);
    const U8s behind = splat<U8s>(job.behind) & ~inside;
    return Column<true>{source, target, job.stride, inside, behind}.grow(rows);
}

/// At least the sides in which something changed. One plane holds what was there, the other what is
/// there now; behind the rows they may differ in the first pass, which makes a tile to do too many.
ChangedSides changedSides(const GrowthJob& job, U8s changes, int64_t x, int64_t y, int64_t rows) {
    const auto hasChanged = [&](int64_t row) {
        const int64_t at = row * job.stride + x;
        return !allZero(load<U8s>(job.planes[0] + at) ^ load<U8s>(job.planes[1] + at));
    };
    const uint64_t lanes = nonZeroLanes(changes);
    return {(lanes & 1) != 0, hasChanged(y), (lanes >> (kBytes * kLaneBits - 1) & 1) != 0,
            hasChanged(y + rows - 1)};
}

/// Whether anything changed.
bool growPass(const GrowthJob& job, int from, Tiles& tiles) {
    bool changed = false;
    for (int64_t row = 0; row * kTileRows < job.height; ++row) {
        const int64_t y = row * kTileRows;
        const int64_t rows = job.height - y < kTileRows ? job.height - y : kTileRows;
        for (int64_t column = 0; column * kTileColumns < job.width; ++column) {
            if (!tiles.isToDo(column, row)) continue;
            const int64_t x = column * kTileColumns;
            const U8s changes = growTile(job, from, x, y, rows);
            if (allZero(changes)) continue;
            tiles.noteChange(changedSides(job, changes, x, y, rows), column, row);
            changed = true;
        }
    }
    tiles.endPass();
    return changed;
}

/// When nothing changes any more both planes are the same.
void grow(const GrowthJob& job, uint8_t* memory) {
    Tiles tiles(job, memory);
    for (int pass = 0; pass < job.passes; ++pass) {
        if (!growPass(job, pass % 2, tiles)) return;
    }
}

}  // namespace

extern const GrowthLoops kGrowthLoops = {copyInverted, grow};

}  // namespace VFontEffect::internal::VOREL_LEVEL
