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
/// Up to a radius of 3 sums fit in 16 bits. Where no instruction makes a dot product of bytes, taps are
/// widened to 16 bits there, those at +k and -k are added before the product, and the division is one by
/// multiplication in 16 bits.
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

/// So many columns as the vectors have that hold `columns` of them.
VOREL_INLINE int64_t wholeVectors(int64_t columns) {
    return roundedUp(columns, kBytes);
}

// --- Loading --------------------------------------------------------------------------------------

/// Four rows of a strip.
struct Group {
    U8s rows[kQuad];

    /// Not inline: up to four loops take groups, and calls are a twentieth of a small blur at most.
    static __attribute__((noinline)) Group of(const SourceStrip& strip, int64_t y) {
        if (!strip.has(y) || !strip.has(y + kQuad - 1)) return atEdge(strip, y);
        Group group;
        unrolled<kQuad>([&](auto i) VOREL_INLINE_LAMBDA {
            const int64_t row = y + i.value;
            group.rows[i.value] = strip.row(row);
        });
        return group;
    }
    static __attribute__((noinline)) Group atEdge(const SourceStrip& strip, int64_t y) {
        Group group;
        for (int64_t i = 0; i < kQuad; ++i)
            group.rows[i] = strip.has(y + i) ? strip.row(y + i) : U8s{};
        return group;
    }
    VOREL_INLINE bool isCovered() const { return !allZero(rows[0] | rows[1] | rows[2] | rows[3]); }
};

// --- The two methods: how groups are stored, summed and divided ---------------------------------------

/// Sums of 32 bits by dot products.
struct DotMethod {
    static constexpr int64_t kPixelBytes = 1;
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

    using Row = U8s;
    static VOREL_INLINE Row rowOf(U8s row) { return row; }
    static VOREL_INLINE U8s bytesOf(Row row) { return row; }
    static VOREL_INLINE void storeIntermediate(Row row, uint8_t* to) { store(to, row ^ kTapBias); }
    static void fillIntermediate(uint8_t* to, int64_t count, uint8_t value) {
        if (count > 0) std::memset(to, value ^ kTapBias, static_cast<size_t>(count));
    }
};

/// Sums of 16 bits.
struct NarrowMethod {
    static constexpr int64_t kPixelBytes = kNarrowPixelBytes;
    static constexpr int64_t kRowBytes = kPixelBytes * kBytes;
    static constexpr int64_t kGroupBytes = kQuad * kRowBytes;

    int radius;
    U16s weights[kLargestNarrowRadius + 1];
    U16s start;
    U16s multiplier;

    static NarrowMethod of(const PackedBlur& blur, bool roundsUp) {
        NarrowMethod method;
        method.radius = blur.radius;
        for (int k = 0; k <= blur.radius; ++k)
            method.weights[k] = splat<U16s>(blur.weights[k]);
        const uint32_t rounding = roundsUp ? blur.narrowTotal - 1 : 0;
        method.start = splat<U16s>(static_cast<uint16_t>(blur.division.start + rounding));
        method.multiplier = splat<U16s>(blur.division.multiplier);
        return method;
    }

    struct Row {
        U16s left;
        U16s right;
    };
    static VOREL_INLINE Row rowOf(U8s row) { return {widenLow(row), widenHigh(row)}; }
    static VOREL_INLINE U8s bytesOf(const Row& row) { return narrow(row.left, row.right); }
    static VOREL_INLINE Row loadRow(const uint8_t* from) {
        return {load<U16s>(from), load<U16s>(from + kBytes)};
    }
    static VOREL_INLINE void storeIntermediate(const Row& row, uint8_t* to) {
        store(to, row.left);
        store(to + kBytes, row.right);
    }
    static void fillIntermediate(uint8_t* to, int64_t count, uint16_t value) {
        for (int64_t i = 0; i < count; ++i)
            std::memcpy(to + i * kPixelBytes, &value, sizeof value);
    }

    static VOREL_INLINE void storeGroup(const Group& group, uint8_t* to) {
        unrolled<kQuad>([&](auto i) VOREL_INLINE_LAMBDA {
            storeIntermediate(rowOf(group.rows[i.value]), to + i.value * kRowBytes);
        });
    }

    /// The mean of the taps around `centre`, `step` bytes apart.
    VOREL_INLINE Row mean(const uint8_t* centre, int64_t step) const {
        const Row middle = loadRow(centre);
        Row sums = {middle.left * weights[0] + start, middle.right * weights[0] + start};
        unrolled<kLargestNarrowRadius>([&](auto i) VOREL_INLINE_LAMBDA {
            constexpr int k = i.value + 1;
            if (k > radius) return;
            const Row before = loadRow(centre - k * step);
            const Row after = loadRow(centre + k * step);
            sums.left += (before.left + after.left) * weights[k];
            sums.right += (before.right + after.right) * weights[k];
        });
        return {multiplyHigh(sums.left, multiplier) >> kNarrowShift,
                multiplyHigh(sums.right, multiplier) >> kNarrowShift};
    }

    template <class GroupAt, class Store>
    VOREL_INLINE void quadDown(const Range&, GroupAt groupAt, Store store) const {
        const uint8_t* const centre = groupAt(0) + radius * kRowBytes;
        for (int j = 0; j < kQuad; ++j)
            store(j, mean(centre + j * kRowBytes, kRowBytes));
    }
    template <class Store>
    VOREL_INLINE void quadAcross(const Range&, const uint8_t* rows, int64_t stride, int64_t tapColumn,
                                 Store store) const {
        const uint8_t* const centre = rows + (tapColumn + radius) * kPixelBytes;
        for (int j = 0; j < kQuad; ++j)
            store(j, bytesOf(mean(centre + j * stride, kPixelBytes)));
    }
};

// --- Down ---------------------------------------------------------------------------------------------

template <class Method>
VOREL_INLINE uint8_t* groupAt(const TapColumns& columns, int64_t strip, int64_t group) {
    return columns.groups + strip * columns.stripStride +
           (group - columns.firstGroup) * Method::kGroupBytes;
}

template <class Method>
void feed(const PackedBlur&, const CoverageRows& source, int64_t row, const TapColumns& columns,
          int64_t index) {
    for (int64_t strip = 0; strip * kBytes < columns.width; ++strip) {
        const Group group = Group::of(SourceStrip::of(source, strip * kBytes), row);
        Method::storeGroup(group, groupAt<Method>(columns, strip, index));
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
template <class Method, class Store>
VOREL_INLINE void quadDown(const Method& method, const TapColumns& columns, int64_t quad, int radius,
                           Store store) {
    for (int64_t strip = 0; strip * kBytes < columns.width; ++strip) {
        const auto storeRow = [&](int j, const typename Method::Row& row)
                                  VOREL_INLINE_LAMBDA { store(strip, j, row); };
        const Range steps = coveredSteps(columns, strip, quad, radius);
        if (steps.empty()) {
            for (int j = 0; j < kQuad; ++j)
                storeRow(j, typename Method::Row{});
        } else {
            method.quadDown(
                steps,
                [&](int64_t step)
                    VOREL_INLINE_LAMBDA { return groupAt<Method>(columns, strip, quad + step); },
                storeRow);
        }
    }
}

template <class Method>
VOREL_INLINE uint8_t* intermediateAt(const IntermediateRows& intermediate, int64_t x, int64_t y) {
    return intermediate.start + y * intermediate.strideBytes + x * Method::kPixelBytes;
}

template <class Method>
VOREL_INLINE void fillIntermediate(const IntermediateRows& intermediate, int64_t from, int64_t end,
                                   uint8_t value) {
    for (int64_t y = 0; y < kQuad && from < end; ++y)
        Method::fillIntermediate(intermediateAt<Method>(intermediate, from, y), end - from, value);
}

template <class Method>
void clear(const PackedBlur&, const IntermediateRows& intermediate) {
    fillIntermediate<Method>(intermediate, -kIntermediateMargin,
                             wholeVectors(intermediate.columns) + kIntermediateMargin, 0);
}

template <class Method>
void fillFullColumns(const IntermediateRows& intermediate) {
    fillIntermediate<Method>(intermediate, 0,
                             min<int64_t>(intermediate.fullBefore, intermediate.columns), 0xFF);
    fillIntermediate<Method>(intermediate, max<int64_t>(intermediate.fullFrom, 0), intermediate.columns,
                             0xFF);
    for (int64_t x = 0; x < intermediate.columns; x += kBytes) {
        if (x < intermediate.fullBefore || x + kBytes > intermediate.fullFrom)
            intermediate.covered[x / kBytes] = 1;
    }
}

template <class Method>
void down(const PackedBlur& blur, const TapColumns& columns, int64_t quad,
          const IntermediateRows& intermediate) {
    const int64_t strips = wholeVectors(intermediate.columns) / kBytes;
    std::memset(intermediate.covered, 0, static_cast<size_t>(strips));
    const int64_t firstStrip = intermediate.coveredColumn / kBytes;
    for (int64_t strip = 0; strip * kBytes < columns.width; ++strip) {
        const Range steps = coveredSteps(columns, strip, quad, blur.radius);
        intermediate.covered[firstStrip + strip] = !steps.empty();
    }
    uint8_t* const start = intermediateAt<Method>(intermediate, firstStrip * kBytes, 0);
    const int64_t stride = intermediate.strideBytes;
    quadDown(Method::of(blur, false), columns, quad, blur.radius,
             [=](int64_t strip, int j, const typename Method::Row& row) VOREL_INLINE_LAMBDA {
                 Method::storeIntermediate(row,
                                           start + j * stride + strip * kBytes * Method::kPixelBytes);
             });
    if (intermediate.fullBefore > 0 || intermediate.fullFrom < intermediate.columns)
        fillFullColumns<Method>(intermediate);
}

template <class Method>
void downToBytes(const PackedBlur& blur, const TapColumns& columns, int64_t quad, const BlurRows& out) {
    uint8_t* const start = out.start;
    const int64_t stride = out.stride;
    const U8s invertMask = splat<U8s>(out.ending.invertMask);
    quadDown(Method::of(blur, out.ending.roundsUp), columns, quad, blur.radius,
             [=](int64_t strip, int j, const typename Method::Row& row) VOREL_INLINE_LAMBDA {
                 store(start + j * stride + strip * kBytes, Method::bytesOf(row) ^ invertMask);
             });
}

template <class Method>
void copy(const PackedBlur&, const CoverageRows& source, int64_t row,
          const IntermediateRows& intermediate) {
    for (int64_t x = 0; x < source.width; x += kBytes) {
        const Group group = Group::of(SourceStrip::of(source, x), row);
        intermediate.covered[x / kBytes] = group.isCovered();
        for (int j = 0; j < kQuad; ++j) {
            uint8_t* const to = intermediateAt<Method>(intermediate, x, j);
            Method::storeIntermediate(Method::rowOf(group.rows[j]), to);
        }
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

template <class Method>
void across(const PackedBlur& blur, const IntermediateRows& intermediate, int64_t left, int64_t right,
            const BlurRows& out) {
    const Method method = Method::of(blur, out.ending.roundsUp);
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
            method.quadAcross(steps, intermediateAt<Method>(intermediate, 0, 0),
                              intermediate.strideBytes, x - blur.radius, storeRow);
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

/// The form of a loop that suits the blur; where it sums in 32 bits always there is one only.
template <auto kNarrow, auto kWide, class... Arguments>
void chosen(const PackedBlur& blur, Arguments... arguments) {
    if constexpr (!kHasDotProducts) {
        if (blur.isNarrow) return kNarrow(blur, arguments...);
    }
    kWide(blur, arguments...);
}

}  // namespace

extern const DotLoops kDotLoops = {
    kBytes,
    kLargestDotRadius,
    !kHasDotProducts,
    sizeof(WeightCell),
    fillCells,
    chosen<clear<NarrowMethod>, clear<DotMethod>>,
    chosen<feed<NarrowMethod>, feed<DotMethod>>,
    chosen<down<NarrowMethod>, down<DotMethod>>,
    chosen<downToBytes<NarrowMethod>, downToBytes<DotMethod>>,
    chosen<copy<NarrowMethod>, copy<DotMethod>>,
    chosen<across<NarrowMethod>, across<DotMethod>>,
};

}  // namespace VFontEffect::internal::VOREL_LEVEL
