#include "ops/blur/narrow_loops.h"

#include <cstdint>

#include "ops/blur/source_strip.h"
#include "simd/lanes.h"
#include "simd/unrolled.h"

/// The two passes of narrow blurs, in 16-bit lanes.
///
/// The pass down takes four rows of results at a time from the rows of the source as they lie there: all
/// taps of a vector of columns are in registers at once. The pass across loads a row at every other
/// pixel: the bytes of a 16-bit lane are then two neighbouring taps of a result at an even place, and of
/// one at the odd place behind it, whose distances differ by one.
///
/// Where an instruction multiplies bytes and adds neighbouring products, the taps of a lane are
/// multiplied at once, down the columns after two rows have been interleaved. Elsewhere they are parted,
/// and those at +k and -k are added before the product.
///
/// Exactness: a sum is below 2^16, and what wraps before it is complete does not matter. The sum of a
/// pair's products, which saturates, has neighbouring weights of 255 at most together: it is between
/// -255 * 128 and 255 * 127. The division is one by multiplication (narrowDivision in blur_weights.h).
///
/// Cost: (R + 1) products of pairs, or R + 1 of single taps, for a vector of 16-bit lanes and pass.
/// Vectors of columns without coverage are left out.
namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

/// The mean of the taps, of their sum.
struct Mean {
    U16s start;
    U16s multiplier;

    static Mean of(const NarrowWeights& weights, bool roundsUp, uint32_t bias) {
        const uint32_t rounding = roundsUp ? weights.total - 1U : 0U;
        const uint32_t start = weights.division.start + rounding + bias * weights.total;
        return {splat<U16s>(static_cast<uint16_t>(start)), splat<U16s>(weights.division.multiplier)};
    }
    VOREL_INLINE U16s operator()(U16s sum) const {
        return multiplyHigh(sum + start, multiplier) >> kNarrowShift;
    }
};

/// Bytes at even and at odd places.
VOREL_INLINE U8s joined(U16s even, U16s odd) {
    return bitCast<U8s>(even | odd << 8);
}

#if defined(VOREL_PAIR_PRODUCTS)

/// Sums of products of pairs of taps, which are biased to be signed.
template <int kRadius>
struct NarrowSums {
    static constexpr uint8_t kBias = 0x80;
    static constexpr int kPairs = kRadius + 1;

    U8s even[kPairs];  // of the pairs from the first tap on
    U8s odd[kPairs];   // from the one before it on
    Mean mean;

    static NarrowSums of(const NarrowWeights& weights, bool roundsUp) {
        NarrowSums sums;
        sums.mean = Mean::of(weights, roundsUp, kBias);
        const auto pair = [&](int distance) {
            const auto weight = [&](int d) { return uint32_t{weights.byDistance[d < 0 ? -d : d]}; };
            return bitCast<U8s>(
                splat<U16s>(static_cast<uint16_t>(weight(distance) | weight(distance + 1) << 8)));
        };
        for (int i = 0; i < kPairs; ++i) {
            sums.even[i] = pair(2 * i - kRadius);
            sums.odd[i] = pair(2 * i - kRadius - 1);
        }
        return sums;
    }

    VOREL_INLINE U16s meanOf(const U8s* pairs, const U8s* weights) const {
        U16s sum = pairProducts(weights[0], pairs[0]);
        unrolled<kRadius>([&](auto i) VOREL_INLINE_LAMBDA {
            sum += pairProducts(weights[i.value + 1], pairs[i.value + 1]);
        });
        return mean(sum);
    }

    /// Calls store(j, row) for four rows of results.
    template <class Store>
    VOREL_INLINE void down(const U8s* rows, Store store) const {
        U8s low[kPairs + 1];
        U8s high[kPairs + 1];
        unrolled<kPairs + 1>([&](auto i) VOREL_INLINE_LAMBDA {
            const U8s upper = rows[2 * i.value] ^ kBias;
            const U8s lower = rows[2 * i.value + 1] ^ kBias;
            low[i.value] = interleaveLow(upper, lower);
            high[i.value] = interleaveHigh(upper, lower);
        });
        unrolled<kQuad>([&](auto j) VOREL_INLINE_LAMBDA {
            constexpr int kFirst = j.value / 2;
            const U8s* const weights = j.value % 2 == 0 ? even : odd;
            store(j.value, pack(meanOf(low + kFirst, weights), meanOf(high + kFirst, weights)));
        });
    }

    /// A vector of results, the first of whose taps is at `taps`.
    VOREL_INLINE U8s across(const uint8_t* taps) const {
        U8s pairs[kPairs];
        unrolled<kPairs>([&](auto i)
                             VOREL_INLINE_LAMBDA { pairs[i.value] = load<U8s>(taps + 2 * i.value); });
        return joined(meanOf(pairs, even), meanOf(pairs, odd));
    }
};

#else

/// Sums of products of sums of two taps.
template <int kRadius>
struct NarrowSums {
    static constexpr uint8_t kBias = 0;

    U16s weights[kRadius + 1];
    Mean mean;

    static NarrowSums of(const NarrowWeights& weights, bool roundsUp) {
        NarrowSums sums;
        sums.mean = Mean::of(weights, roundsUp, kBias);
        for (int k = 0; k <= kRadius; ++k)
            sums.weights[k] = splat<U16s>(uint16_t{weights.byDistance[k]});
        return sums;
    }

    VOREL_INLINE U16s meanOf(const U16s* taps) const {
        U16s sum = taps[kRadius] * weights[0];
        unrolled<kRadius>([&](auto i) VOREL_INLINE_LAMBDA {
            constexpr int k = i.value + 1;
            sum += (taps[kRadius - k] + taps[kRadius + k]) * weights[k];
        });
        return mean(sum);
    }

    /// Calls store(j, row) for four rows of results.
    template <class Store>
    VOREL_INLINE void down(const U8s* rows, Store store) const {
        constexpr int kRows = int{kQuad} + 2 * kRadius;
        U16s even[kRows];
        U16s odd[kRows];
        unrolled<kRows>([&](auto i) VOREL_INLINE_LAMBDA {
            even[i.value] = bitCast<U16s>(rows[i.value]) & 0x00FF;
            odd[i.value] = bitCast<U16s>(rows[i.value]) >> 8;
        });
        unrolled<kQuad>([&](auto j) VOREL_INLINE_LAMBDA {
            store(j.value, joined(meanOf(even + j.value), meanOf(odd + j.value)));
        });
    }

    /// A vector of results, the first of whose taps is at `taps`.
    VOREL_INLINE U8s across(const uint8_t* taps) const {
        U16s parted[2 * kRadius + 2];
        unrolled<kRadius + 1>([&](auto i) VOREL_INLINE_LAMBDA {
            const U16s two = load<U16s>(taps + 2 * i.value);
            parted[2 * i.value] = two & 0x00FF;
            parted[2 * i.value + 1] = two >> 8;
        });
        return joined(meanOf(parted), meanOf(parted + 1));
    }
};

#endif

// --- Passes -------------------------------------------------------------------------------------------

void copy(const CoverageRows& source, int64_t row, uint8_t bias, const IntermediateRows& to) {
    for (int64_t x = 0; x < source.width; x += kBytes) {
        const SourceStrip strip = SourceStrip::of(source, x);
        U8s any = {};
        for (int64_t j = 0; j < kQuad; ++j) {
            const U8s pixels = strip.has(row + j) ? strip.row(row + j) : U8s{};
            any |= pixels;
            store(to.start + j * to.strideBytes + x, pixels ^ bias);
        }
        to.covered[x / kBytes] = !allZero(any);
    }
}

/// Four rows of results from a column on. What is written may be anything, as far as compilers know:
/// they are held by value.
struct Results {
    uint8_t* start;
    int64_t stride;
    U8s invertMask;

    static Results of(const BlurRows& out) {
        return {out.start, out.stride, splat<U8s>(out.ending.invertMask)};
    }
    VOREL_INLINE void storeRow(int64_t x, int64_t j, U8s row) const {
        store(start + j * stride + x, row ^ invertMask);
    }
    VOREL_INLINE void storeZeros(int64_t x) const {
        for (int64_t j = 0; j < kQuad; ++j)
            storeRow(x, j, U8s{});
    }
};

template <int kRadius>
void down(const NarrowWeights& weights, const TapRows& taps, const BlurRows& out, uint8_t* covered) {
    constexpr int kRows = int{kQuad} + 2 * kRadius;
    const auto sums = NarrowSums<kRadius>::of(weights, out.ending.roundsUp);
    const Results results = Results::of(out);
    // The last vector ends with the row, and may overlap the one before.
    for (int64_t next = 0; next < taps.width; next += kBytes) {
        const int64_t x = min<int64_t>(next, taps.width - kBytes);
        U8s rows[kRows];
        U8s any = {};
        unrolled<kRows>([&](auto i) VOREL_INLINE_LAMBDA {
            rows[i.value] = load<U8s>(taps.rows[i.value] + x);
            any |= rows[i.value];
        });
        if (allZero(any)) {
            results.storeZeros(x);
        } else {
            covered[x / kBytes] = covered[(x + kBytes - 1) / kBytes] = 1;
            sums.down(rows, [&](int j, U8s row) VOREL_INLINE_LAMBDA { results.storeRow(x, j, row); });
        }
    }
}

/// Whether the taps of a vector of results from column x on are among covered ones.
VOREL_INLINE bool isReached(const IntermediateRows& intermediate, int64_t x, int64_t radius) {
    const int64_t first = max<int64_t>(0, x - radius);
    const int64_t last = min<int64_t>(x + kBytes - 1 + radius, intermediate.columns - 1);
    if (first > last) return false;
    for (int64_t strip = first / kBytes; strip <= last / kBytes; ++strip) {
        if (intermediate.covered[strip] != 0) return true;
    }
    return false;
}

template <int kRadius>
void across(const NarrowWeights& weights, const IntermediateRows& intermediate, int64_t left,
            int64_t right, const BlurRows& out) {
    const auto sums = NarrowSums<kRadius>::of(weights, out.ending.roundsUp);
    const Results results = Results::of(out);
    const IntermediateRows rows = intermediate;
    for (int64_t x = left; x < right; x += kBytes) {
        if (!isReached(rows, x, kRadius)) {
            results.storeZeros(x - left);
            continue;
        }
        const uint8_t* const taps = rows.start + x - kRadius;
        for (int64_t j = 0; j < kQuad; ++j)
            results.storeRow(x - left, j, sums.across(taps + j * rows.strideBytes));
    }
}

}  // namespace

extern const NarrowLoops kNarrowLoops = {
    {kBytes, NarrowSums<1>::kBias},
    copy,
    {{down<1>, across<1>}, {down<2>, across<2>}, {down<3>, across<3>}},
};

}  // namespace VFontEffect::internal::VOREL_LEVEL
