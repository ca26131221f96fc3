#include "ops/blur/difference_blur.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <cstring>

#include "core/assert.h"

namespace VFontEffect::internal {
namespace {

/// From this radius on the rounding of the weights makes most of the terms, which is pairs of opposite
/// neighbours; below it the curve does. Counted for all radii from 10 to 100.
constexpr int kLeastRadiusOfNoise = 41;

TapPairs pairsFor(int radius) {
    return radius < kLeastRadiusOfNoise ? TapPairs{2, false} : TapPairs{1, true};
}

constexpr int kOrder = 2;

/// Of one sign. The weights rise and fall once, by 128 at most: the first difference adds up to 128
/// above and to as much below zero, and the second to twice as much at most. A term has a unit of its
/// sign in it.
constexpr int64_t kMostTerms = 256;

int64_t cellsOf(int radius) {
    return 2 * int64_t{radius} + 1 + kOrder;
}

/// The difference as it applies to the taps from distance -radius - kOrder on: what a sum
/// changes by from result to result, changes by.
void fillDifference(const BlurWeights& weights, int32_t* cells) {
    const int64_t count = cellsOf(weights.radius);
    for (int64_t i = 0; i < count; ++i) {
        const int64_t distance = std::abs(i - kOrder - weights.radius);
        cells[i] = distance > weights.radius ? 0 : static_cast<int32_t>(weights.byDistance[distance]);
    }
    // A result takes the tap at distance k with the weight there, the one before with that at k + 1.
    for (int n = 0; n < kOrder; ++n) {
        for (int64_t i = 0; i + 1 < count; ++i)
            cells[i] -= cells[i + 1];
    }
}

/// Takes the cells apart into single taps and pairs, the lowest first. There is room for kMostTerms of
/// either sign in `memory`.
void splitTerms(int radius, int64_t lineBytes, int32_t* cells, int32_t* memory, DifferenceTerms& terms) {
    const TapPairs& pairs = terms.pairs;
    int32_t* added = memory;
    int32_t* takenAway = memory + kMostTerms;
    terms.added.offsets = added;
    terms.takenAway.offsets = takenAway;
    const int64_t count = cellsOf(radius);
    for (int64_t i = 0; i < count; ++i) {
        const int64_t line = (i - kOrder - radius) * kLinesOfRow;
        while (cells[i] != 0) {
            const int32_t sign = cells[i] > 0 ? 1 : -1;
            const int32_t other = pairs.areDifferences ? -sign : sign;
            const int64_t partner = i + pairs.distance;
            const bool isPair = partner < count && cells[partner] * other > 0;
            cells[i] -= sign;
            if (isPair) cells[partner] -= other;
            int32_t*& end = sign > 0 ? added : takenAway;
            VOREL_ASSERT(end - (sign > 0 ? terms.added : terms.takenAway).offsets < kMostTerms);
            *end++ = static_cast<int32_t>((line + (isPair ? 1 : 0)) * lineBytes);
        }
    }
    terms.added.count = added - terms.added.offsets;
    terms.takenAway.count = takenAway - terms.takenAway.offsets;
}

}  // namespace

int64_t termBytes(int radius) {
    return (2 * kMostTerms + cellsOf(radius)) * int64_t{sizeof(int32_t)};
}

DifferenceTerms differenceTerms(const DifferenceLoops& loops, const BlurWeights& weights,
                                uint8_t* memory) {
    auto* const lines = reinterpret_cast<int32_t*>(memory);
    int32_t* const cells = lines + 2 * kMostTerms;
    DifferenceTerms terms = {pairsFor(weights.radius), {}, {}};
    fillDifference(weights, cells);
    splitTerms(weights.radius, kLinePixelBytes * loops.vectorBytes, cells, lines, terms);
    return terms;
}

// --- Layout -----------------------------------------------------------------------------------------

/// The lanes of the second pass, which lie along the first one's strips.
void DifferenceBlur::Layout::placeLanes(const BlurInput& input, int64_t side) {
    const int64_t sourceLanes = roundedUp(second.length, side);
    const Box reach = expanded(window, input.weights.radius);
    if (input.full.before <= reach.left && input.full.from >= reach.right) {
        allocatedLanes = sourceLanes;
        fullFrom = second.length;
        return;
    }
    // All columns that are in reach, of which the source's are some.
    sourceLane = sourceLanes > 0 ? source.left - reach.left : 0;
    allocatedLanes = std::max(reach.width(), sourceLane + sourceLanes);
    fullBefore = input.full.before - reach.left;
    fullFrom = input.full.from - reach.left;
    second = {window.left - reach.left, window.width(), reach.width()};
}

DifferenceBlur::Layout DifferenceBlur::Layout::of(const DifferenceLoops& loops, const BlurInput& input,
                                                  Arena& arena) {
    const int64_t side = loops.vectorBytes;
    const Box& window = input.window;
    Layout layout = {};
    layout.window = window;
    layout.source = ReachedSource::of(input);
    const CoverageRows& part = layout.source.part;
    const Axis down = {window.top - layout.source.top, window.height(), part.height};
    const Axis across = {window.left - layout.source.left, window.width(), part.width};
    const bool downFirst = input.order == BlurInput::Order::downThenAcross;
    layout.first = downFirst ? down : across;
    layout.second = downFirst ? across : down;
    layout.bandRows = downFirst ? side : window.height();
    layout.placeLanes(input, side);

    const int64_t longest = std::max(layout.first.length, layout.second.length);
    layout.lines =
        arena.take<uint8_t>(kLinesOfRow * kLinePixelBytes * side * (longest + kDifferenceRowsAround));
    layout.intermediate =
        arena.take<uint8_t>(layout.allocatedLanes * roundedUp(layout.first.count, side));
    layout.stride = roundedUp(window.width(), side);
    layout.out = arena.take<uint8_t>(layout.stride * roundedUp(layout.bandRows, side));
    if (!downFirst) layout.transposed = arena.take<uint8_t>(roundedUp(part.width, side) * side);
    return layout;
}

int64_t DifferenceBlur::memoryBytes(const DifferenceLoops& loops, const BlurInput& input) {
    Arena arena = {nullptr};
    static_cast<void>(Layout::of(loops, input, arena));
    return arena.used;
}

DifferenceBlur::DifferenceBlur(const DifferenceLoops& loops, const BlurInput& largest,
                               int64_t memoryBytes)
    : mLoops(loops),
      mDownFirst(largest.order == BlurInput::Order::downThenAcross),
      mFirst(largest.first),
      mSecond(largest.second),
      mRadius(largest.weights.radius),
      mTotal(largest.weights.total),
      mInverse(inverseAbove(mTotal)),
      mSide(loops.vectorBytes),
      mMemoryBytes(memoryBytes),
      mMemory(mMemoryBytes + termBytes(mRadius)) {
    if (mMemory) mTerms = differenceTerms(loops, largest.weights, mMemory.data() + mMemoryBytes);
}

void DifferenceBlur::begin(const BlurInput& input) {
    Arena arena = {mMemory.data()};
    mLayout = Layout::of(mLoops, input, arena);
    VOREL_ASSERT(arena.used <= mMemoryBytes);
}

// --- Passes -----------------------------------------------------------------------------------------

void DifferenceBlur::blurStrip(const PassEnding& ending, const CoverageRows& source, int64_t x,
                               const Axis& axis, const SquareRows& out) {
    const DifferencePass pass = {mTerms, mRadius, mTotal, mInverse, ending};
    mLoops.blurStrip(pass, source, x, mLayout.lines, axis.first, axis.count, out);
}

void DifferenceBlur::firstPass() {
    const CoverageRows& part = mLayout.source.part;
    const int64_t lanes = mDownFirst ? part.width : part.height;
    VOREL_ASSERT(mLayout.sourceLane + inSquares(lanes) <= mLayout.allocatedLanes);
    for (int64_t lane = 0; lane < lanes; lane += mSide) {
        const SquareRows out = {mLayout.intermediate + (mLayout.sourceLane + lane) * mSide,
                                mLayout.allocatedLanes * mSide, mSide, true};
        if (mDownFirst) {
            blurStrip(mFirst, part, lane, mLayout.first, out);
        } else {
            mLoops.transpose(part, lane, mLayout.transposed);
            const CoverageRows rows = {mLayout.transposed, mSide, mSide, part.width, kAsIs};
            blurStrip(mFirst, rows, 0, mLayout.first, out);
        }
    }
    for (int64_t result = 0; result < mLayout.first.count; result += mSide)
        fillAround(strip(result), lanes);
}

/// The lanes of a strip that the first pass has not filled, and the full ones.
void DifferenceBlur::fillAround(uint8_t* strip, int64_t lanes) {
    const auto fill = [&](int64_t first, int64_t end, int value) {
        first = std::max<int64_t>(first, 0);
        const int64_t count = std::min(end, mLayout.second.length) - first;
        if (count > 0) std::memset(strip + first * mSide, value, static_cast<size_t>(count * mSide));
    };
    fill(0, mLayout.sourceLane, 0);
    fill(mLayout.sourceLane + lanes, mLayout.second.length, 0);
    fill(0, mLayout.fullBefore, 0xFF);
    fill(mLayout.fullFrom, mLayout.second.length, 0xFF);
}

void DifferenceBlur::secondPass(int64_t result, const SquareRows& out) {
    const CoverageRows rows = {strip(result), mSide, mSide, mLayout.second.length, kAsIs};
    blurStrip(mSecond, rows, 0, mLayout.second, out);
}

BlurredRows DifferenceBlur::rows(int64_t y) {
    VOREL_ASSERT((y - mLayout.window.top) % (mDownFirst ? mSide : mLayout.window.height()) == 0);
    if (y == mLayout.window.top) firstPass();
    if (mDownFirst) {
        secondPass(y - mLayout.window.top, {mLayout.out, mSide, mLayout.stride, true});
    } else {
        for (int64_t x = 0; x < mLayout.window.width(); x += mSide)
            secondPass(x, {mLayout.out + x, mSide * mLayout.stride, mLayout.stride, false});
    }
    return {mLayout.out, mLayout.stride};
}

}  // namespace VFontEffect::internal
