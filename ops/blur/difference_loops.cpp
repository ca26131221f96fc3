#include "ops/blur/difference_loops.h"

#include <cstdint>
#include <cstring>

#include "core/assert.h"
#include "ops/blur/source_strip.h"
#include "simd/lanes.h"
#include "simd/unrolled.h"

/// Wide blurs by differences of the weights.
///
/// Let t(y) be the taps of a column and w(k) the weights, 0 beyond the radius. The result at y is the
/// sum
///
///     S(y) = sum over k of w(k) t(y + k),
///
/// and what it changes by from one result to the next, and what that changes by, are sums over the same
/// taps with the differences of the weights:
///
///     D1(y) = S(y) - S(y - 1)   = sum of (w(k) - w(k + 1)) t(y + k)
///     D2(y) = D1(y) - D1(y - 1) = sum of (w(k) - 2 w(k + 1) + w(k + 2)) t(y + k)
///
/// so that  D1(y) = D1(y - 1) + D2(y)  and  S(y) = S(y - 1) + D1(y).
///
/// The weights are whole numbers that rise to 100 or 128 and fall again, whatever the radius: their
/// second difference is hardly anything but -1, 0 and 1, and its absolute values add up to a fraction of
/// the taps. D2 takes as many additions of 16 bits, D1 and S one each. Where two taps at a fixed
/// distance have one sign, or opposite ones, a line of their sums, or differences, made once for all
/// results, counts for both.
///
/// Exactness: all of these are whole numbers. |D1| is at most 255 * 128 and fits in 16 bits with its
/// sign, however D2 wraps; S has 32 bits.
///
/// Cost: 20 to 40 additions a pixel and pass up to a radius of 40, 60 at 100. Lanes are columns. The
/// results are transposed in squares, so that lanes are rows then, and the pass across is this one
/// again.
namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

constexpr int64_t kLineBytes = kLinePixelBytes * kBytes;
constexpr int64_t kRowBytes = kLinesOfRow * kLineBytes;

/// A line: the lower and the upper half of a vector's pixels.
struct Line {
    U16s left;
    U16s right;

    static VOREL_INLINE Line at(const uint8_t* line) {
        return {loadAligned<U16s>(line), loadAligned<U16s>(line + kBytes)};
    }
    VOREL_INLINE void storeAt(uint8_t* line) const {
        store(line, left);
        store(line + kBytes, right);
    }
    VOREL_INLINE void add(const Line& other) {
        left += other.left;
        right += other.right;
    }
    VOREL_INLINE void subtract(const Line& other) {
        left -= other.left;
        right -= other.right;
    }
};

// --- Lines ------------------------------------------------------------------------------------------

/// The rows of the strip that hold anything but 0, from `first` to `end` - 1.
struct RowExtent {
    int64_t first;
    int64_t end;

    static RowExtent of(const SourceStrip& strip) {
        RowExtent covered = {0, strip.height};
        while (covered.first < covered.end && allZero(strip.row(covered.first)))
            ++covered.first;
        while (covered.end > covered.first && allZero(strip.row(covered.end - 1)))
            --covered.end;
        return covered;
    }
};

/// The rows of taps and pairs from row `top` of the source on.
struct Rows {
    uint8_t* lines;
    int64_t top;

    VOREL_INLINE uint8_t* at(int64_t y) const { return lines + (y - top) * kRowBytes; }
    void clear(int64_t first, int64_t end) const {
        std::memset(at(first), 0, static_cast<size_t>((end - first) * kRowBytes));
    }
};

/// Stores the covered rows' taps, and the pairs from `distance` rows before them on; around them zeros,
/// as far as four results at a time reach.
Rows filledRows(const SourceStrip& strip, const RowExtent& covered, const TapPairs& pairs,
                uint8_t* lines) {
    const Rows rows = {lines, covered.first - (pairs.distance + kDifferenceRows - 1)};
    rows.clear(rows.top, covered.first);
    rows.clear(covered.end, covered.end + kDifferenceRows - 1);
    for (int64_t y = covered.first; y < covered.end; ++y) {
        const U8s row = strip.row(y);
        const Line taps = {bitCast<U16s>(interleaveLow(row, U8s{})),
                           bitCast<U16s>(interleaveHigh(row, U8s{}))};
        taps.storeAt(rows.at(y));
        uint8_t* const earlier = rows.at(y - pairs.distance);
        Line pair = Line::at(earlier);
        if (pairs.areDifferences) {
            pair.subtract(taps);
        } else {
            pair.add(taps);
        }
        pair.storeAt(earlier + kLineBytes);
    }
    // The last taps have no partners.
    for (int64_t y = covered.end - pairs.distance; y < covered.end; ++y)
        Line::at(rows.at(y)).storeAt(rows.at(y) + kLineBytes);
    return rows;
}

// --- Sums -------------------------------------------------------------------------------------------

/// The terms of one sign that meet covered rows: as the results go by, the ones further and further up.
class TermRange {
  public:
    explicit TermRange(const TermList& terms)
        : mBegin(terms.offsets), mFirst(mBegin + terms.count), mEnd(mFirst) {}

    /// Takes those at `lowest` to `end` - 1, both the starts of rows and not above the ones before.
    VOREL_INLINE void moveTo(int64_t lowest, int64_t end) {
        while (mEnd > mBegin && mEnd[-1] >= end)
            --mEnd;
        while (mFirst > mBegin && mFirst[-1] >= lowest)
            --mFirst;
    }
    VOREL_INLINE const int32_t* begin() const { return mFirst; }
    VOREL_INLINE const int32_t* end() const { return mEnd; }

  private:
    const int32_t* mBegin;
    const int32_t* mFirst;
    const int32_t* mEnd;
};

/// Four rows of differences.
struct FourLines {
    Line lines[kDifferenceRows];

    template <class Change>
    VOREL_INLINE void apply(const TermRange& terms, const uint8_t* memory, int64_t row, Change change) {
        for (const int32_t* term = terms.begin(); term < terms.end(); ++term) {
            const uint8_t* const from = memory + (row + *term);
            unrolled<kDifferenceRows>([&](auto i) VOREL_INLINE_LAMBDA {
                change(lines[i.value], Line::at(from + i.value * kRowBytes));
            });
        }
    }
    /// Makes first differences of the second ones; `last` is that of the row before.
    VOREL_INLINE void addUp(Line& last) {
        unrolled<kDifferenceRows>([&](auto i) VOREL_INLINE_LAMBDA {
            last.add(lines[i.value]);
            lines[i.value] = last;
        });
    }
};

class StripSum {
  public:
    StripSum(const DifferencePass& pass, const Rows& rows, int64_t coveredEnd)
        : mRows(rows),
          mCoveredEnd(coveredEnd),
          mAdded(pass.terms.added),
          mTakenAway(pass.terms.takenAway),
          mFirst{},
          mInverse(splat<F32s>(pass.inverse)),
          mInvertMask(splat<U8s>(pass.ending.invertMask)) {
        const uint32_t rounding = pass.ending.roundsUp ? pass.total - 1 : 0;
        for (U32s& sum : mSums)
            sum = splat<U32s>(kNumberBias + rounding);
    }

    /// The next four rows of results, from row y on.
    __attribute__((noinline)) void next(int64_t y, U8s* rows) {
        const int64_t row = (y - mRows.top) * kRowBytes;
        const int64_t end = (mCoveredEnd - y) * kRowBytes;
        mAdded.moveTo(-row, end);
        mTakenAway.moveTo(-row, end);
        FourLines four = {};
        four.apply(mAdded, mRows.lines, row,
                   [](Line& line, const Line& tap) VOREL_INLINE_LAMBDA { line.add(tap); });
        four.apply(mTakenAway, mRows.lines, row,
                   [](Line& line, const Line& tap) VOREL_INLINE_LAMBDA { line.subtract(tap); });
        four.addUp(mFirst);
        unrolled<kDifferenceRows>([&](auto i) VOREL_INLINE_LAMBDA {
            rows[i.value] = quotients(four.lines[i.value]) ^ mInvertMask;
        });
    }

  private:
    VOREL_INLINE U8s quotients(const Line& line) {
        return pack(quotients<0>(line.left), quotients<2>(line.right));
    }
    template <int kFirst>
    VOREL_INLINE U16s quotients(U16s change) {
        mSums[kFirst] += extended(interleaveLow(change, change));
        mSums[kFirst + 1] += extended(interleaveHigh(change, change));
        return pack(quotient(mSums[kFirst], mInverse), quotient(mSums[kFirst + 1], mInverse));
    }
    /// 16-bit lanes that stand twice in each word, as words with their signs.
    static VOREL_INLINE U32s extended(U16s twice) { return bitCast<U32s>(bitCast<I32s>(twice) >> 16); }

    Rows mRows;
    int64_t mCoveredEnd;
    TermRange mAdded;
    TermRange mTakenAway;
    Line mFirst;  // the first difference of the row before
    U32s mSums[4];
    F32s mInverse;
    U8s mInvertMask;
};

// --- Squares ------------------------------------------------------------------------------------------

constexpr int64_t kLaneBytes = kBytes < 16 ? kBytes : 16;

/// Two of the steps that transpose kLaneBytes rows of as many lanes, of each 128 bits by themselves. A
/// step interleaves the upper half of the rows with the lower one and so moves the highest bit of a
/// byte's row number to the end of its column number; as many steps as bits exchange the two.
VOREL_INLINE void transposeTwoBits(const U8s* from, U8s* to) {
    constexpr int64_t kQuarter = kLaneBytes / 4;
    for (int64_t i = 0; i < kQuarter; ++i) {
        const U8s low02 = interleaveLow(from[i], from[i + 2 * kQuarter]);
        const U8s high02 = interleaveHigh(from[i], from[i + 2 * kQuarter]);
        const U8s low13 = interleaveLow(from[i + kQuarter], from[i + 3 * kQuarter]);
        const U8s high13 = interleaveHigh(from[i + kQuarter], from[i + 3 * kQuarter]);
        to[4 * i] = interleaveLow(low02, low13);
        to[4 * i + 1] = interleaveHigh(low02, low13);
        to[4 * i + 2] = interleaveLow(high02, high13);
        to[4 * i + 3] = interleaveHigh(high02, high13);
    }
}
VOREL_INLINE void transposeRows(U8s* rows) {
    U8s half[kLaneBytes];
    transposeTwoBits(rows, half);
    if (kLaneBytes == 4) {
        std::memcpy(rows, half, sizeof half);
    } else {
        transposeTwoBits(half, rows);
    }
}

void storeTransposed(U8s* rows, uint8_t* to, int64_t rowStride) {
    for (int64_t group = 0; group < kBytes; group += kLaneBytes) {
        transposeRows(rows + group);
        for (int64_t i = 0; i < kLaneBytes; ++i) {
            uint8_t bytes[kBytes];
            store(bytes, rows[group + i]);
            for (int64_t lane = 0; lane < kBytes; lane += kLaneBytes)
                std::memcpy(to + (lane + i) * rowStride + group, bytes + lane, kLaneBytes);
        }
    }
}

void storePlain(const U8s* rows, uint8_t* to, int64_t rowStride) {
    for (int64_t i = 0; i < kBytes; ++i)
        store(to + i * rowStride, rows[i]);
}

void transpose(const CoverageRows& source, int64_t row, uint8_t* lines) {
    for (int64_t x = 0; x < source.width; x += kBytes) {
        const SourceStrip strip = SourceStrip::of(source, x);
        U8s rows[kBytes];
        for (int64_t i = 0; i < kBytes; ++i)
            rows[i] = strip.has(row + i) ? strip.row(row + i) : U8s{};
        storeTransposed(rows, lines + x * kBytes, kBytes);
    }
}

void fillSquare(uint8_t value, uint8_t* to, int64_t rowStride) {
    for (int64_t i = 0; i < kBytes; ++i)
        std::memset(to + i * rowStride, value, static_cast<size_t>(kBytes));
}

void blurStrip(const DifferencePass& pass, const CoverageRows& source, int64_t x, uint8_t* lines,
               int64_t first, int64_t count, const SquareRows& out) {
    const SourceStrip strip = SourceStrip::of(source, x);
    VOREL_ASSERT(reinterpret_cast<uintptr_t>(lines) % kBytes == 0);
    const RowExtent covered = RowExtent::of(strip);
    const bool isEmpty = covered.first >= covered.end;
    StripSum sums(pass, isEmpty ? Rows{} : filledRows(strip, covered, pass.terms.pairs, lines),
                  covered.end);
    const int64_t begin = covered.first - pass.radius;
    const int64_t end = covered.end + pass.radius;
    U8s rows[kBytes];
    int64_t y = first;
    // Results that nobody wants, but that the following ones build on.
    if (begin < first && !isEmpty) {
        for (y -= roundedUp(first - begin, kDifferenceRows); y < first; y += kDifferenceRows)
            sums.next(y, rows);
    }
    for (uint8_t* square = out.start; y < first + count; square += out.squareStride) {
        if (isEmpty || y + kBytes <= begin || y >= end) {
            fillSquare(pass.ending.invertMask, square, out.rowStride);
            y += kBytes;
            continue;
        }
        for (int64_t i = 0; i < kBytes; i += kDifferenceRows, y += kDifferenceRows)
            sums.next(y, rows + i);
        if (out.areTransposed) {
            storeTransposed(rows, square, out.rowStride);
        } else {
            storePlain(rows, square, out.rowStride);
        }
    }
}

}  // namespace

extern const DifferenceLoops kDifferenceLoops = {kBytes, transpose, blurStrip};

}  // namespace VFontEffect::internal::VOREL_LEVEL
