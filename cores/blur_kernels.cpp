#include "cores/blur_kernels.h"

#include <cstdint>
#include <cstring>

#include "blend/lanes.h"
#include "blend/unrolled.h"

/// The two passes of the blur.
///
/// Dot products: four neighbouring taps stand in the four bytes of a word, so that one instruction adds
/// four taps times their weights to each word of a vector. Down the columns the rows are interleaved by
/// fours for that; across a row the bytes stand so already. The same four taps then serve four results,
/// whose distances to them differ by one: the string of weights is read at four places one byte apart.
/// Down, the four results are four rows; across, they are the four bytes of a word. So every vector of
/// taps that is loaded feeds four sums, and every four weights feed several vectors.
///
/// Up to a radius of 3 sums fit in 16 bits: there taps are widened to halves, those at +k and -k are
/// added before the product, and the division is one by multiplication in 16 bits.
///
/// Exactness: sums are whole numbers and wrap nowhere: 255 times the total stays below 2^23. As floats
/// they are exact; with an inverse just above 1 / total the rounded product reaches n exactly when the
/// sum reaches n * total, as long as the total is below 26,000 (blur.h).
///
/// Cost: (2R + 1) / (taps in a vector) instructions a pixel and pass, over the rows and columns only
/// that hold ink; what lies beyond them is neither read nor stored.
namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

#if defined(__AVX512BW__) || defined(__aarch64__)
constexpr int kGridVectors = 4;  // of 32 registers half are sums
#else
constexpr int kGridVectors = 2;
#endif

// --- Steps: which groups of four taps a stretch of results needs --------------------------------------

/// Steps of four taps that together hold the taps of four neighbouring results.
VOREL_INLINE int64_t stepsOf(int radius) {
    return (2 * int64_t{radius} + kQuad + 3) / 4;
}

struct Range {
    int64_t first;
    int64_t end;

    bool empty() const { return first >= end; }
};

VOREL_INLINE int64_t smallerOf(int64_t a, int64_t b) {
    return a < b ? a : b;
}
VOREL_INLINE int64_t largerOf(int64_t a, int64_t b) {
    return a > b ? a : b;
}

/// So many columns as the vectors have that hold `columns` of them.
VOREL_INLINE int64_t wholeVectors(int64_t columns) {
    return (columns + kBytes - 1) / kBytes * kBytes;
}

// --- Loading --------------------------------------------------------------------------------------

/// The first `count` bytes of a vector, zeros after them.
VOREL_INLINE Bytes loadPart(const uint8_t* from, int64_t count) {
    if (count >= kBytes) return load<Bytes>(from);
    uint8_t bytes[kBytes] = {};
    std::memcpy(bytes, from, static_cast<size_t>(count));
    return load<Bytes>(bytes);
}

/// A strip of the source: `count` columns from `x` on, as many as a vector holds at most.
struct SourceStrip {
    const uint8_t* start;
    int64_t stride;
    int64_t height;
    int64_t count;
    Bytes flip;

    static SourceStrip of(const BlurSource& source, int64_t x) {
        const int64_t left = source.width - x;
        const int64_t count = left < kBytes ? left : int64_t{kBytes};
        uint8_t flip[kBytes] = {};
        std::memset(flip, source.flip, static_cast<size_t>(count));
        return {source.start + x, source.stride, source.height, count, load<Bytes>(flip)};
    }

    VOREL_INLINE Bytes row(int64_t y) const {
        if (y < 0 || y >= height) return Bytes{};
        return loadPart(start + y * stride, count) ^ flip;
    }
};

/// Four rows of a strip.
struct Group {
    Bytes rows[kQuad];

    static VOREL_INLINE Group of(const SourceStrip& strip, int64_t y) {
        return {{strip.row(y), strip.row(y + 1), strip.row(y + 2), strip.row(y + 3)}};
    }
    VOREL_INLINE bool isInked() const { return !allZero(rows[0] | rows[1] | rows[2] | rows[3]); }
};

// --- The two methods: how groups are stored, summed and divided
// ------------------------------------------

/// Sums of 32 bits by dot products.
struct DotMethod {
    static constexpr int64_t kMiddleBytes = 1;
    static constexpr int64_t kGroupBytes = kQuad * kBytes;

    const WeightCell* cells;
    const uint32_t* totals;
    uint32_t rounding;
    Floats inverse;

    static DotMethod of(const PreparedBlur& blur, bool roundsUp) {
        return {static_cast<const WeightCell*>(blur.cells), blur.totals, roundsUp ? blur.total - 1 : 0,
                spread<Floats>(blur.inverse)};
    }

    /// Words of four taps: the columns 0-3 of each 16, then 4-7, 8-11 and 12-15.
    static VOREL_INLINE void storeGroup(const Group& group, uint8_t* to) {
        const Halves low01 = as<Halves>(interleavedLow(group.rows[0], group.rows[1]));
        const Halves high01 = as<Halves>(interleavedHigh(group.rows[0], group.rows[1]));
        const Halves low23 = as<Halves>(interleavedLow(group.rows[2], group.rows[3]));
        const Halves high23 = as<Halves>(interleavedHigh(group.rows[2], group.rows[3]));
        storeTaps(interleavedLow(low01, low23), to);
        storeTaps(interleavedHigh(low01, low23), to + kBytes);
        storeTaps(interleavedLow(high01, high23), to + 2 * kBytes);
        storeTaps(interleavedHigh(high01, high23), to + 3 * kBytes);
    }
    static VOREL_INLINE void storeTaps(Halves taps, uint8_t* to) {
        store(to, as<Bytes>(taps) ^ kTapBias);
    }

    /// kGridVectors vectors of taps for four results each; `step` bytes on are the next four taps.
    struct Grid {
        Words sums[kGridVectors][kQuad];
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
        unrolled<kSteps>([&](auto s) {
            unrolled<kGridVectors>([&](auto v) {
                const Taps taps =
                    tapsOf(load<Bytes>(from.start + s.value * from.step + v.value * from.vectorStride));
                unrolled<kQuad>([&](auto j) {
                    Words& sum = grid.sums[v.value][j.value];
                    sum = addDots<s.value>(sum, taps, strings[j.value]);
                });
            });
        });
    }

    /// What a sum begins with: what rounds up, and what the bias of the taps takes away.
    VOREL_INLINE Words start(const Range& steps, int result) const {
        const uint32_t weights = totals[4 * steps.end - result] - totals[4 * steps.first - result];
        return spread<Words>(rounding + kTapBias * weights);
    }

    /// The sums over `steps` of the taps, the first of which are at `from`.
    VOREL_INLINE Grid sums(TapSource from, const Range& steps) const {
        Grid grid;
        unrolled<kQuad>([&](auto j) {
            const Words begin = start(steps, j.value);
            unrolled<kGridVectors>([&](auto v) { grid.sums[v.value][j.value] = begin; });
        });
        int64_t step = steps.first;
        for (; step + 4 <= steps.end; step += 4) {
            addSteps<4>(grid, from, cells + 4 * step);
            from.start += 4 * from.step;
        }
        for (; step < steps.end; ++step) {
            addSteps<1>(grid, from, cells + 4 * step);
            from.start += from.step;
        }
        return grid;
    }

    VOREL_INLINE Words quotient(Words sum) const {
        const Floats mean = __builtin_convertvector(as<Integers>(sum), Floats) * inverse;
        return as<Words>(__builtin_convertvector(mean, Integers));
    }

    /// Four rows of results; `group(step)` is where the taps of a step are.
    template <class GroupAt, class Store>
    VOREL_INLINE void quadDown(const Range& steps, GroupAt groupAt, Store store) const {
        Halves halves[2][kQuad];
        unrolled<4 / kGridVectors>([&](auto part) {
            constexpr int kVector = part.value * kGridVectors;
            const uint8_t* const from = groupAt(steps.first) + kVector * kBytes;
            const Grid grid = sums({from, kBytes, kGroupBytes}, steps);
            unrolled<kGridVectors / 2>([&](auto pair) {
                constexpr int kPair = pair.value * 2;
                unrolled<kQuad>([&](auto j) {
                    halves[(kVector + kPair) / 2][j.value] = packed(
                        quotient(grid.sums[kPair][j.value]), quotient(grid.sums[kPair + 1][j.value]));
                });
            });
        });
        unrolled<kQuad>([&](auto j) { store(j.value, packed(halves[0][j.value], halves[1][j.value])); });
    }

    /// A vector of results in each of four rows; the taps of step 0 are at column `tapColumn`.
    template <class Store>
    VOREL_INLINE void quadAcross(const Range& steps, const uint8_t* rows, int64_t stride,
                                 int64_t tapColumn, Store store) const {
        unrolled<4 / kGridVectors>([&](auto part) {
            constexpr int kRow = part.value * kGridVectors;
            const uint8_t* const from = rows + kRow * stride + (tapColumn + 4 * steps.first);
            const Grid grid = sums({from, stride, 4}, steps);
            unrolled<kGridVectors>([&](auto v) {
                const Words* const four = grid.sums[v.value];
                store(kRow + v.value, as<Bytes>(quotient(four[0]) | quotient(four[1]) << 8 |
                                                quotient(four[2]) << 16 | quotient(four[3]) << 24));
            });
        });
    }

    using Row = Bytes;
    static VOREL_INLINE Row rowOf(Bytes row) { return row; }
    static VOREL_INLINE Bytes bytesOf(Row row) { return row; }
    static VOREL_INLINE void storeMiddle(Row row, uint8_t* to) { store(to, row ^ kTapBias); }
    static void fillMiddle(uint8_t* to, int64_t count, uint8_t value) {
        if (count > 0) std::memset(to, value ^ kTapBias, static_cast<size_t>(count));
    }
};

/// Sums of 16 bits.
struct NarrowMethod {
    static constexpr int64_t kMiddleBytes = kNarrowMiddleBytes;
    static constexpr int64_t kRowBytes = kMiddleBytes * kBytes;
    static constexpr int64_t kGroupBytes = kQuad * kRowBytes;

    int radius;
    Halves weights[kLargestNarrowRadius + 1];
    Halves start;
    Halves multiplier;
    uint16_t shift;

    static NarrowMethod of(const PreparedBlur& blur, bool roundsUp) {
        NarrowMethod method;
        method.radius = blur.radius;
        for (int k = 0; k <= blur.radius; ++k)
            method.weights[k] = spread<Halves>(blur.weights[k]);
        const uint32_t rounding = roundsUp ? blur.total - 1 : 0;
        method.start = spread<Halves>(static_cast<uint16_t>(blur.division.start + rounding));
        method.multiplier = spread<Halves>(blur.division.multiplier);
        method.shift = blur.division.shift;
        return method;
    }

    struct Row {
        Halves left;
        Halves right;
    };
    static VOREL_INLINE Row rowOf(Bytes row) {
        uint8_t bytes[kBytes];
        store(bytes, row);
        return {widened(bytes), widened(bytes + kBytes / 2)};
    }
    static VOREL_INLINE Bytes bytesOf(const Row& row) { return narrowed(row.left, row.right); }
    static VOREL_INLINE Row loadRow(const uint8_t* from) {
        return {load<Halves>(from), load<Halves>(from + kBytes)};
    }
    static VOREL_INLINE void storeMiddle(const Row& row, uint8_t* to) {
        store(to, row.left);
        store(to + kBytes, row.right);
    }
    static void fillMiddle(uint8_t* to, int64_t count, uint16_t value) {
        for (int64_t i = 0; i < count; ++i)
            std::memcpy(to + i * kMiddleBytes, &value, sizeof value);
    }

    static VOREL_INLINE void storeGroup(const Group& group, uint8_t* to) {
        for (int i = 0; i < kQuad; ++i)
            storeMiddle(rowOf(group.rows[i]), to + i * kRowBytes);
    }

    /// The mean of the taps around `centre`, `step` bytes apart.
    VOREL_INLINE Row mean(const uint8_t* centre, int64_t step) const {
        const Row middle = loadRow(centre);
        Row sums = {middle.left * weights[0] + start, middle.right * weights[0] + start};
        for (int k = 1; k <= radius; ++k) {
            const Row before = loadRow(centre - k * step);
            const Row after = loadRow(centre + k * step);
            sums.left += (before.left + after.left) * weights[k];
            sums.right += (before.right + after.right) * weights[k];
        }
        return {multiplyHigh(sums.left, multiplier) >> shift,
                multiplyHigh(sums.right, multiplier) >> shift};
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
        const uint8_t* const centre = rows + (tapColumn + radius) * kMiddleBytes;
        for (int j = 0; j < kQuad; ++j)
            store(j, bytesOf(mean(centre + j * stride, kMiddleBytes)));
    }
};

// --- Down ---------------------------------------------------------------------------------------------

/// The rows of a strip that the pass needs, as groups, with as many empty groups on both sides as a
/// short blur may touch.
template <class Method>
class Strip {
  public:
    explicit Strip(const DownPass& pass)
        : mSteps(stepsOf(pass.blur->radius)),
          mFirstRow(pass.top - pass.blur->radius),
          mSkipped(mFirstRow < 0 ? -mFirstRow / kQuad : 0) {
        const int64_t rowEnd =
            smallerOf(pass.source.height, mFirstRow + kQuad * (pass.quads - 1 + mSteps));
        mCount = largerOf(0, (rowEnd - mFirstRow + kQuad - 1) / kQuad - mSkipped);
        mGroups = pass.strip + kSpareGroups * Method::kGroupBytes;
        mNextInked = reinterpret_cast<int32_t*>(mGroups + (mCount + kSpareGroups) * Method::kGroupBytes);
        std::memset(pass.strip, 0, kSpareGroups * Method::kGroupBytes);
        std::memset(group(mSkipped + mCount), 0, kSpareGroups * Method::kGroupBytes);
    }

    /// Reads the source's columns from `x` on.
    void fill(const BlurSource& source, int64_t x) {
        const SourceStrip strip = SourceStrip::of(source, x);
        auto next = static_cast<int32_t>(mCount);
        for (int64_t i = mCount - 1; i >= 0; --i) {
            const Group rows = Group::of(strip, mFirstRow + kQuad * (mSkipped + i));
            if (rows.isInked()) next = static_cast<int32_t>(i);
            mNextInked[i] = next;
            Method::storeGroup(rows, group(mSkipped + i));
        }
    }

    /// The steps of a quad of results from its first inked group on, to the last group that exists.
    Range steps(int64_t quad) const {
        const int64_t shift = quad - mSkipped;
        const int64_t first = largerOf(shift, 0);
        const int64_t end = smallerOf(shift + mSteps, mCount);
        if (first >= end) return {0, 0};
        return {mNextInked[first] - shift, end - shift};
    }

    /// Groups are counted from that of step 0 of quad 0 on.
    uint8_t* group(int64_t index) const { return mGroups + (index - mSkipped) * Method::kGroupBytes; }

  private:
    int64_t mSteps;
    int64_t mFirstRow;  // of the step 0 of quad 0
    int64_t mSkipped;   // groups from there on that lie above the source
    int64_t mCount;
    uint8_t* mGroups;
    int32_t* mNextInked;
};

/// Calls storeRow(x, y, row) for each row of each strip, y from 0 on, and inked(x, quad, whether).
template <class Method, class StoreRow, class NoteInk>
VOREL_INLINE void passDown(const DownPass& pass, const Method& method, StoreRow storeRow,
                           NoteInk noteInk) {
    Strip<Method> strip(pass);
    for (int64_t x = 0; x < pass.source.width; x += kBytes) {
        strip.fill(pass.source, x);
        for (int64_t quad = 0; quad < pass.quads; ++quad) {
            const Range steps = strip.steps(quad);
            noteInk(x, quad, !steps.empty());
            if (steps.empty()) {
                for (int64_t j = 0; j < kQuad; ++j)
                    storeRow(x, kQuad * quad + j, typename Method::Row{});
            } else {
                method.quadDown(
                    steps, [&](int64_t step) { return strip.group(quad + step); },
                    [&](int j, const typename Method::Row& row) { storeRow(x, kQuad * quad + j, row); });
            }
        }
    }
}

template <class Method>
VOREL_INLINE uint8_t* middleAt(const MiddlePlane& middle, int64_t x, int64_t y) {
    return middle.start + y * middle.strideBytes + x * Method::kMiddleBytes;
}

/// Completes a row around `width` columns of ink.
template <class Method>
void fillAround(const MiddlePlane& middle, int64_t width, int64_t y) {
    const auto fill = [&](int64_t from, int64_t end, uint8_t value) {
        if (from < end) Method::fillMiddle(middleAt<Method>(middle, from, y), end - from, value);
    };
    fill(-kWidestVector, middle.inkColumn, 0);
    fill(middle.inkColumn + wholeVectors(width), wholeVectors(middle.columns) + kWidestVector, 0);
    fill(0, smallerOf(middle.fullBefore, middle.columns), 0xFF);
    fill(largerOf(middle.fullFrom, 0), middle.columns, 0xFF);
}

/// Notes the vectors with full columns.
void noteFullColumns(const MiddlePlane& middle, uint8_t* inked) {
    for (int64_t x = 0; x < middle.columns; x += kBytes) {
        if (x < middle.fullBefore || x + kBytes > middle.fullFrom) inked[x / kBytes] = 1;
    }
}

template <class Method>
void down(const DownPass& pass, const MiddlePlane& middle) {
    std::memset(middle.inked, 0, static_cast<size_t>(pass.quads * middle.inkedStride));
    passDown(
        pass, Method::of(*pass.blur, false),
        [&](int64_t x, int64_t y, const typename Method::Row& row) {
            Method::storeMiddle(row, middleAt<Method>(middle, middle.inkColumn + x, y));
        },
        [&](int64_t x, int64_t quad, bool inked) {
            middle.inked[quad * middle.inkedStride + (middle.inkColumn + x) / kBytes] = inked;
        });
    for (int64_t y = 0; y < kQuad * pass.quads; ++y)
        fillAround<Method>(middle, pass.source.width, y);
    for (int64_t quad = 0; quad < pass.quads; ++quad)
        noteFullColumns(middle, middle.inked + quad * middle.inkedStride);
}

template <class Method>
void downToBytes(const DownPass& pass, const BlurEnding& ending, uint8_t* out, int64_t outStride) {
    passDown(
        pass, Method::of(*pass.blur, ending.roundsUp),
        [&](int64_t x, int64_t y, const typename Method::Row& row) {
            store(out + y * outStride + x, Method::bytesOf(row) ^ ending.flip);
        },
        [](int64_t, int64_t, bool) {});
}

template <class Method>
void copyQuad(const DownPass& pass, const MiddlePlane& middle) {
    for (int64_t y = 0; y < kQuad; ++y)
        fillAround<Method>(middle, pass.source.width, y);
    for (int64_t x = 0; x < pass.source.width; x += kBytes) {
        const Group group = Group::of(SourceStrip::of(pass.source, x), pass.top);
        middle.inked[x / kBytes] = group.isInked();
        for (int i = 0; i < kQuad; ++i)
            Method::storeMiddle(Method::rowOf(group.rows[i]), middleAt<Method>(middle, x, i));
    }
}

// --- Across -------------------------------------------------------------------------------------------

/// The steps of four taps, for a vector of results from column x on, that reach an inked vector.
VOREL_INLINE Range inkedSteps(const MiddlePlane& middle, const uint8_t* inked, int64_t x, int radius) {
    const int64_t firstTap = x - radius;
    int64_t first = largerOf(firstTap, 0) / kBytes;
    int64_t last = smallerOf(firstTap + 2 * radius + kBytes - 1, middle.columns - 1);
    if (last < 0) return {0, 0};
    last /= kBytes;
    while (first <= last && inked[first] == 0)
        ++first;
    while (last >= first && inked[last] == 0)
        --last;
    if (first > last) return {0, 0};
    // Step s reads a vector from firstTap + 4 s on.
    const int64_t reach = first * kBytes - kBytes - firstTap;
    return {reach < 0 ? 0 : reach / 4 + 1,
            smallerOf(stepsOf(radius), ((last + 1) * kBytes - 1 - firstTap) / 4 + 1)};
}

template <class Method>
void across(const AcrossPass& pass) {
    const Method method = Method::of(*pass.blur, pass.ending.roundsUp);
    const MiddlePlane& middle = pass.middle;
    const int radius = pass.blur->radius;
    const uint8_t* const inked = middle.inked + pass.quad * middle.inkedStride;
    for (int64_t x = pass.left; x < pass.right; x += kBytes) {
        uint8_t* const out = pass.out + (x - pass.left);
        const auto storeRow = [&](int j, Bytes row) {
            store(out + j * pass.outStride, row ^ pass.ending.flip);
        };
        const Range steps = inkedSteps(middle, inked, x, radius);
        if (steps.empty()) {
            for (int j = 0; j < kQuad; ++j)
                storeRow(j, Bytes{});
        } else {
            method.quadAcross(steps, middleAt<Method>(middle, 0, kQuad * pass.quad), middle.strideBytes,
                              x - radius, storeRow);
        }
    }
}

// --- The choice of the method
// -----------------------------------------------------------------------------

void blurDown(const DownPass& pass, const MiddlePlane& middle) {
    return pass.blur->isNarrow ? down<NarrowMethod>(pass, middle) : down<DotMethod>(pass, middle);
}
void blurDownToBytes(const DownPass& pass, const BlurEnding& ending, uint8_t* out, int64_t outStride) {
    return pass.blur->isNarrow ? downToBytes<NarrowMethod>(pass, ending, out, outStride)
                               : downToBytes<DotMethod>(pass, ending, out, outStride);
}
void copyQuadToMiddle(const DownPass& pass, const MiddlePlane& middle) {
    return pass.blur->isNarrow ? copyQuad<NarrowMethod>(pass, middle)
                               : copyQuad<DotMethod>(pass, middle);
}
void blurAcross(const AcrossPass& pass) {
    return pass.blur->isNarrow ? across<NarrowMethod>(pass) : across<DotMethod>(pass);
}

void fillCells(const uint32_t* weights, int radius, uint8_t* cells) {
    const auto weightAt = [&](int64_t distance) {
        const int64_t k = distance < 0 ? -distance : distance;
        return static_cast<uint8_t>(k <= radius ? weights[k] : 0);
    };
    for (int64_t k = -radius - kCellsBefore; k <= radius + kCellsBehind; ++k) {
        const uint8_t three[] = {weightAt(k), weightAt(k + 1), weightAt(k + 2)};
        const WeightCell cell = cellOf(three);
        std::memcpy(cells, &cell, sizeof cell);
        cells += sizeof cell;
    }
}

}  // namespace

extern const BlurKernels kBlurKernels = {
    kBytes, sizeof(WeightCell), fillCells, blurDown, blurDownToBytes, copyQuadToMiddle, blurAcross,
};

}  // namespace VFontEffect::internal::VOREL_LEVEL
