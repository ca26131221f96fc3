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
/// that did not change in the last pass, nor any of the eight around it, cannot change in this one. It
/// is skipped: the other plane holds it already, as it has not changed since it was last written.
///
/// Cost: some 20 instructions a vector and pass in the tiles along the edges.
namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

constexpr int64_t kTileColumns = kBytes > kGrowthTile ? kBytes : kGrowthTile;
constexpr int64_t kTileRows = kGrowthTile;

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

    /// Rows are made by twos: both share the sum of the two rows.
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

    void noteChange(int64_t column, int64_t row) {
        for (int64_t y = row - 1; y <= row + 1; ++y)
            std::memset(at(mNext, column - 1, y), 1, 3);
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

/// Grows a tile by one pass and tells whether it changed.
bool growTile(const GrowthJob& job, int from, int64_t left, int64_t top) {
    const int64_t right = left + kTileColumns < job.width ? left + kTileColumns : job.width;
    const int64_t rows = job.height - top < kTileRows ? job.height - top : kTileRows;
    const uint8_t* const source = job.planes[from] + top * job.stride;
    uint8_t* const target = job.planes[1 - from] + top * job.stride;
    U8s changes = {};
    int64_t x = left;
    for (; x + kBytes <= right; x += kBytes)
        changes |= Column<false>{source + x, target + x, job.stride, {}, {}}.grow(rows);
    if (x < right) {
        const U8s inside = firstBytes(right - x);
        const U8s behind = splat<U8s>(job.behind) & ~inside;
        changes |= Column<true>{source + x, target + x, job.stride, inside, behind}.grow(rows);
    }
    return !allZero(changes);
}

/// Whether anything changed.
bool growPass(const GrowthJob& job, int from, Tiles& tiles) {
    bool changed = false;
    for (int64_t row = 0; row * kTileRows < job.height; ++row) {
        for (int64_t column = 0; column * kTileColumns < job.width; ++column) {
            if (!tiles.isToDo(column, row)) continue;
            if (!growTile(job, from, column * kTileColumns, row * kTileRows)) continue;
            tiles.noteChange(column, row);
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
