#include "ops/blur/dot_loops.h"

#include <cstdint>
#include <cstring>

#include "ops/blur/source_strip.h"
#include "simd/lanes.h"
#include "simd/tuning.h"
#include "simd/unrolled.h"

/// The two passes of the blur by dot products.
///
/// Four neighbouring taps stand in the four bytes of a word, so that one instruction adds four taps
/// times their weights to each word of a vector. Down the columns the rows are interleaved by fours for
/// that; across a row the bytes stand so already. The same four taps then serve four results, whose
/// distances to them differ by one: the string of weights is read at four places one byte apart. Down,
/// the four results are four rows; across, they are the four bytes of a word. So every vector of taps
/// that is loaded feeds four sums, and every four weights feed several vectors.
///
/// Exactness: sums are whole numbers and wrap nowhere: 255 times the total stays below 2^23. Their
/// quotients are whole (inverseAbove in blur_weights.h).
///
/// Cost: (2R + 1) / (taps in a vector) instructions a pixel and pass, over the rows and columns only
/// that hold coverage; what lies beyond them is neither read nor stored.
namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

// --- Steps: which groups of four taps a stretch of results needs --------------------------------------

struct Range {
    int64_t first;
    int64_t end;

    bool empty() const { return first >= end; }
};

// --- Loading --------------------------------------------------------------------------------------

/// Four rows of a strip.
struct Group {
    U8s rows[kQuad];

    static VOREL_INLINE Group of(const SourceStrip& strip, int64_t y) {
        if (!strip.has(y) || !strip.has(y + kQuad - 1)) return atEdge(strip, y);
        Group group;
        unrolled<kQuad>([&](auto i) VOREL_INLINE_LAMBDA {
            const int64_t row = y + i.value;
            group.rows[i.value] = strip.row(row);
        });
        return group;
    }
    /// Not inline: most groups are elsewhere.
    static __attribute__((noinline)) Group atEdge(const SourceStrip& strip, int64_t y) {
        Group group;
        for (int64_t i = 0; i < kQuad; ++i)
            group.rows[i] = strip.has(y + i) ? strip.row(y + i) : U8s{};
        return group;
    }
    VOREL_INLINE bool isCovered() const { return !allZero(rows[0] | rows[1] | rows[2] | rows[3]); }
};

// --- How groups are stored, summed and divided --------------------------------------------------------

/// Sums of 32 bits by dot products.
struct DotMethod {
    static constexpr int64_t kGroupBytes = kQuad * kBytes;

    const WeightCell* cells;
    const uint32_t* totals;
    uint32_t rounding;
    F32s inverse;

    static DotMethod of(const PackedBlur& blur, bool roundsUp) {
        return {static_cast<const WeightCell*>(blur.cells), blur.totals, roundsUp ? blur.total - 1 : 0,
                splat<F32s>(blur.inverse)};
    }

    /// Words of four taps: the columns 0-3 of each 16, then 4-7, 8-11 and 12-15.
    static VOREL_INLINE void storeGroup(const Group& group, uint8_t* to) {
        const U16s low01 = bitCast<U16s>(interleaveLow(group.rows[0], group.rows[1]));
        const U16s high01 = bitCast<U16s>(interleaveHigh(group.rows[0], group.rows[1]));
        const U16s low23 = bitCast<U16s>(interleaveLow(group.rows[2], group.rows[3]));
        const U16s high23 = bitCast<U16s>(interleaveHigh(group.rows[2], group.rows[3]));
        storeTaps(interleaveLow(low01, low23), to);
        storeTaps(interleaveHigh(low01, low23), to + kBytes);
        storeTaps(interleaveLow(high01, high23), to + 2 * kBytes);
        storeTaps(interleaveHigh(high01, high23), to + 3 * kBytes);
    }
    static VOREL_INLINE void storeTaps(U16s taps, uint8_t* to) {
        store(to, bitCast<U8s>(taps) ^ kTapBias);
    }

    /// kGridVectors vectors of taps for four results each; `step` bytes on are the next four taps.
    struct Grid {
        U32s sums[kGridVectors][kQuad];
    };
    struct TapSource {
        const uint8_t* start;
        int64_t vectorStride;
        int64_t step;
    };

    /// Adds the next 4 * kSteps taps, whose weights begin at `weights`.
    template <int kSteps>
    static VOREL_INLINE void addSteps(Grid& grid, const TapSource& from, const WeightCell* weights) {
        const Weights strings[kQuad] = {weightsAt(weights), weightsAt(weights - 1),
                                        weightsAt(weights - 2), weightsAt(weights - 3)};
        unrolled<kSteps>([&](auto s) VOREL_INLINE_LAMBDA {
            unrolled<kGridVectors>([&](auto v) VOREL_INLINE_LAMBDA {
                const Taps taps =
                    tapsOf(load<U8s>(from.start + s.value * from.step + v.value * from.vectorStride));
                unrolled<kQuad>([&](auto j) VOREL_INLINE_LAMBDA {
                    U32s& sum = grid.sums[v.value][j.value];
                    sum = addDots<s.value>(sum, taps, strings[j.value]);
                });
            });
        });
    }

    /// What a sum begins with: what rounds up, and what the bias of the taps takes away.
    VOREL_INLINE U32s start(const Range& steps, int result) const {
        const uint32_t weights = totals[4 * steps.end - result] - totals[4 * steps.first - result];
        return splat<U32s>(kNumberBias + rounding + kTapBias * weights);
    }

    /// The sums over `steps` of the taps, the first of which are at `from`.
    VOREL_INLINE Grid sums(TapSource from, const Range& steps) const {
        Grid grid;
        unrolled<kQuad>([&](auto j) VOREL_INLINE_LAMBDA {
            const U32s begin = start(steps, j.value);
            unrolled<kGridVectors>([&](auto v)
                                       VOREL_INLINE_LAMBDA { grid.sums[v.value][j.value] = begin; });
        });
        int64_t step = steps.first;
        for (; step + kStepsAtOnce <= steps.end; step += kStepsAtOnce) {
            addSteps<kStepsAtOnce>(grid, from, cells + 4 * step);
            from.start += kStepsAtOnce * from.step;
        }
        if (kStepsAtOnce == 1) return grid;
        for (; step < steps.end; ++step) {
            addSteps<1>(grid, from, cells + 4 * step);
            from.start += from.step;
        }
        return grid;
    }

    /// Four rows of results; `groupAt(step)` is where the taps of a step are.
    template <class GroupAt, class Store>
    VOREL_INLINE void quadDown(const Range& steps, GroupAt groupAt, Store store) const {
        U16s results[2][kQuad];
        unrolled<4 / kGridVectors>([&](auto part) VOREL_INLINE_LAMBDA {
            constexpr int kVector = part.value * kGridVectors;
            const uint8_t* const from = groupAt(steps.first) + kVector * kBytes;
            const Grid grid = sums({from, kBytes, kGroupBytes}, steps);
            unrolled<kGridVectors / 2>([&](auto pair) VOREL_INLINE_LAMBDA {
                constexpr int kPair = pair.value * 2;
                unrolled<kQuad>([&](auto j) VOREL_INLINE_LAMBDA {
                    results[(kVector + kPair) / 2][j.value] =
                        pack(quotient(grid.sums[kPair][j.value], inverse),
                             quotient(grid.sums[kPair + 1][j.value], inverse));
                });
            });
        });
        unrolled<kQuad>([&](auto j) VOREL_INLINE_LAMBDA {
            store(j.value, pack(results[0][j.value], results[1][j.value]));
        });
    }

    /// A vector of results in each of four rows; the taps of step 0 are at column `tapColumn`.
    template <class Store>
    VOREL_INLINE void quadAcross(const Range& steps, const uint8_t* rows, int64_t stride,
                                 int64_t tapColumn, Store store) const {
        unrolled<4 / kGridVectors>([&](auto part) VOREL_INLINE_LAMBDA {
            constexpr int kRow = part.value * kGridVectors;
            const uint8_t* const from = rows + kRow * stride + (tapColumn + 4 * steps.first);
            const Grid grid = sums({from, stride, 4}, steps);
            unrolled<kGridVectors>([&](auto v) VOREL_INLINE_LAMBDA {
                const U32s* const four = grid.sums[v.value];
                store(kRow + v.value,
                      joinedBytes(quotient(four[0], inverse), quotient(four[1], inverse),
                                  quotient(four[2], inverse), quotient(four[3], inverse)));
            });
        });
    }
};

// --- Down ---------------------------------------------------------------------------------------------

VOREL_INLINE uint8_t* groupAt(const TapColumns& columns, int64_t strip, int64_t group) {
    return columns.groups + strip * columns.stripStride +
           (group - columns.firstGroup) * DotMethod::kGroupBytes;
}

void feed(const CoverageRows& source, int64_t row, const TapColumns& columns, int64_t index) {
    for (int64_t strip = 0; strip * kBytes < columns.width; ++strip) {
        const Group group = Group::of(SourceStrip::of(source, strip * kBytes), row);
        DotMethod::storeGroup(group, groupAt(columns, strip, index));
        if (!group.isCovered()) continue;
        const auto number = static_cast<int32_t>(index);
        if (columns.lastCovered[strip] < columns.firstCovered[strip])
            columns.firstCovered[strip] = number;
        columns.lastCovered[strip] = number;
    }
}

/// The steps of a quad of results that reach covered groups of a strip.
VOREL_INLINE Range coveredSteps(const TapColumns& columns, int64_t strip, int64_t quad, int radius) {
    return {max<int64_t>(0, columns.firstCovered[strip] - quad),
            min<int64_t>(tapSteps(radius), columns.lastCovered[strip] + 1 - quad)};
}

/// Calls store(strip, j, row) for each of the four rows of each strip.
template <class Store>
VOREL_INLINE void quadDown(const DotMethod& method, const TapColumns& columns, int64_t quad, int radius,
                           Store store) {
    for (int64_t strip = 0; strip * kBytes < columns.width; ++strip) {
        const auto storeRow = [&](int j, U8s row) VOREL_INLINE_LAMBDA { store(strip, j, row); };
        const Range steps = coveredSteps(columns, strip, quad, radius);
        if (steps.empty()) {
            for (int j = 0; j < kQuad; ++j)
                storeRow(j, U8s{});
        } else {
            method.quadDown(
                steps,
                [&](int64_t step) VOREL_INLINE_LAMBDA { return groupAt(columns, strip, quad + step); },
                storeRow);
        }
    }
}

VOREL_INLINE uint8_t* intermediateAt(const IntermediateRows& intermediate, int64_t x, int64_t y) {
    return intermediate.start + y * intermediate.strideBytes + x;
}

void down(const PackedBlur& blur, const TapColumns& columns, int64_t quad,
          const IntermediateRows& intermediate) {
    const int64_t strips = roundedUp(intermediate.columns, kBytes) / kBytes;
    std::memset(intermediate.covered, 0, static_cast<size_t>(strips));
    const int64_t firstStrip = intermediate.coveredColumn / kBytes;
    for (int64_t strip = 0; strip * kBytes < columns.width; ++strip) {
        const Range steps = coveredSteps(columns, strip, quad, blur.radius);
        intermediate.covered[firstStrip + strip] = !steps.empty();
    }
    uint8_t* const start = intermediateAt(intermediate, firstStrip * kBytes, 0);
    const int64_t stride = intermediate.strideBytes;
    quadDown(DotMethod::of(blur, false), columns, quad, blur.radius,
             [=](int64_t strip, int j, U8s row)
                 VOREL_INLINE_LAMBDA { store(start + j * stride + strip * kBytes, row ^ kTapBias); });
}

void downToBytes(const PackedBlur& blur, const TapColumns& columns, int64_t quad, const BlurRows& out) {
    uint8_t* const start = out.start;
    const int64_t stride = out.stride;
    const U8s invertMask = splat<U8s>(out.ending.invertMask);
    quadDown(DotMethod::of(blur, out.ending.roundsUp), columns, quad, blur.radius,
             [=](int64_t strip, int j, U8s row)
                 VOREL_INLINE_LAMBDA { store(start + j * stride + strip * kBytes, row ^ invertMask); });
}

void copy(const CoverageRows& source, int64_t row, const IntermediateRows& intermediate) {
    for (int64_t x = 0; x < source.width; x += kBytes) {
        const Group group = Group::of(SourceStrip::of(source, x), row);
        intermediate.covered[x / kBytes] = group.isCovered();
        for (int j = 0; j < kQuad; ++j)
            store(intermediateAt(intermediate, x, j), group.rows[j] ^ kTapBias);
    }
}

// --- Across -------------------------------------------------------------------------------------------

/// The steps of four taps, for a vector of results from column x on, that reach a covered vector.
VOREL_INLINE Range coveredSteps(const IntermediateRows& intermediate, int64_t x, int radius) {
    const int64_t firstTap = x - radius;
    const int64_t lastTap = min<int64_t>(x + kBytes - 1 + radius, intermediate.columns - 1);
    if (lastTap < 0) return {0, 0};
    int64_t first = max<int64_t>(firstTap, 0) / kBytes;
    int64_t last = lastTap / kBytes;
    while (first <= last && intermediate.covered[first] == 0)
        ++first;
    while (last >= first && intermediate.covered[last] == 0)
        --last;
    if (first > last) return {0, 0};
    // Step s reads a vector from firstTap + 4 s on.
    const int64_t before = (first - 1) * kBytes - firstTap;
    return {before < 0 ? 0 : before / 4 + 1,
            min<int64_t>(tapSteps(radius), ((last + 1) * kBytes - 1 - firstTap) / 4 + 1)};
}

void across(const PackedBlur& blur, const IntermediateRows& intermediate, int64_t left, int64_t right,
            const BlurRows& out) {
    const DotMethod method = DotMethod::of(blur, out.ending.roundsUp);
    uint8_t* const start = out.start;
    const int64_t stride = out.stride;
    const U8s invertMask = splat<U8s>(out.ending.invertMask);
    for (int64_t x = left; x < right; x += kBytes) {
        const auto storeRow = [=](int j, U8s row) VOREL_INLINE_LAMBDA {
            store(start + j * stride + (x - left), row ^ invertMask);
        };
        const Range steps = coveredSteps(intermediate, x, blur.radius);
        if (steps.empty()) {
            for (int j = 0; j < kQuad; ++j)
                storeRow(j, U8s{});
        } else {
            method.quadAcross(steps, intermediateAt(intermediate, 0, 0), intermediate.strideBytes,
                              x - blur.radius, storeRow);
        }
    }
}

// --- The table ----------------------------------------------------------------------------------------

void fillCells(const uint8_t* weights, int64_t count, uint8_t* cells) {
    for (int64_t i = 0; i < count; ++i) {
        const WeightCell cell = cellOf(weights + i);
        std::memcpy(cells + i * static_cast<int64_t>(sizeof cell), &cell, sizeof cell);
    }
}

}  // namespace

extern const DotLoops kDotLoops = {
    {kBytes, kTapBias},
    kLargestDotRadius,
    kLeavesNarrow,
    sizeof(WeightCell),
    fillCells,
    feed,
    down,
    downToBytes,
    copy,
    across,
};

}  // namespace VFontEffect::internal::VOREL_LEVEL
