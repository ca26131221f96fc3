#include "ops/blur/difference_blur.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <cstring>

#include "core/numeric.h"

namespace VFontEffect::internal {
namespace {

// What has the fewest terms, or few more, was counted for all radii from 10 to 100. While the radius is
// small the curve of the kernel makes the terms, later the rounding of its weights does, which is pairs
// of opposite neighbours.
constexpr int kLeastRadiusOfSecondDifferences = 18;
constexpr int kLeastRadiusOfNoise = 41;

int orderFor(int radius) {
    return radius < kLeastRadiusOfSecondDifferences ? 3 : 2;
}
TapPairs pairsFor(int radius) {
    return radius < kLeastRadiusOfNoise ? TapPairs{2, false} : TapPairs{1, true};
}

/// Of one sign. The weights rise and fall once, by 128 at most: the first difference adds up to 128
/// above and to as much below zero, and each further one to twice as much at most. A term has a unit of
/// its sign in it.
constexpr int64_t kMostTerms = 512;

/// Of the taps or pairs of a row.
int32_t lineBytes() {
    return static_cast<int32_t>(kDifferencePixelBytes * dotLoops().vectorBytes);
}

int64_t cellsOf(int radius) {
    return 2 * int64_t{radius} + 1 + orderFor(radius);
}

/// The difference as it applies to the taps from distance -radius - order on: what a running sum changes
/// by, changes by.
void fillDifference(const BlurWeights& kernel, int order, int32_t* cells) {
    const int64_t count = cellsOf(kernel.radius);
    for (int64_t i = 0; i < count; ++i) {
        const int64_t distance = std::abs(i - order - kernel.radius);
        cells[i] = distance > kernel.radius ? 0 : static_cast<int32_t>(kernel.weights.data()[distance]);
    }
    // A result takes the tap at distance k with the weight there, the one before with that at k + 1.
    for (int n = 0; n < order; ++n) {
        for (int64_t i = 0; i + 1 < count; ++i)
            cells[i] -= cells[i + 1];
    }
}

/// Takes the cells apart into single taps and pairs, the lowest first. There is room for kMostTerms of
/// either sign in `memory`.
void splitTerms(int radius, int32_t* cells, int32_t* memory, DifferenceTerms& terms) {
    const TapPairs& pairs = terms.pairs;
    int32_t* added = memory;
    int32_t* takenAway = memory + kMostTerms;
    terms.added.offsets = added;
    terms.takenAway.offsets = takenAway;
    const int64_t count = cellsOf(radius);
    for (int64_t i = 0; i < count; ++i) {
        const auto line = static_cast<int32_t>((i - terms.order - radius) * kLinesOfRow);
        while (cells[i] != 0) {
            const int32_t sign = cells[i] > 0 ? 1 : -1;
            const int32_t other = pairs.areDifferences ? -sign : sign;
            const int64_t partner = i + pairs.distance;
            const bool isPair = partner < count && cells[partner] * other > 0;
            cells[i] -= sign;
            if (isPair) cells[partner] -= other;
            int32_t*& end = sign > 0 ? added : takenAway;
            *end++ = (line + static_cast<int32_t>(isPair)) * lineBytes();
        }
    }
    terms.added.count = added - terms.added.offsets;
    terms.takenAway.count = takenAway - terms.takenAway.offsets;
}

}  // namespace

// --- Terms ------------------------------------------------------------------------------------------

KernelTerms::KernelTerms(const BlurWeights& kernel)
    : mMemory(
          PixelBuffer<int32_t>::uninitialised(kernel ? 2 * kMostTerms + cellsOf(kernel.radius) : -1)),
      mTerms{orderFor(kernel.radius), pairsFor(kernel.radius), {}, {}} {
    if (!mMemory) return;
    int32_t* const cells = mMemory.data() + 2 * kMostTerms;
    fillDifference(kernel, mTerms.order, cells);
    splitTerms(kernel.radius, cells, mMemory.data(), mTerms);
}

// --- Passes -----------------------------------------------------------------------------------------

DifferencePasses::DifferencePasses(const BlurWeights& kernel, const BlurSource& source,
                                   const Box& window)
    : mWindow(window),
      mSource(ReachedSource::of(source, kernel.radius, window)),
      mSide(dotLoops().vectorBytes),
      mRadius(kernel.radius),
      mTotal(kernel.total),
      mInverse(inverseAbove(kernel.total)),
      mTerms(kernel) {}

LineBuffer DifferencePasses::linesFor(int64_t rows) const {
    return LineBuffer(kLinesOfRow * kDifferencePixelBytes * mSide, rows + kDifferenceRowsAround);
}

void DifferencePasses::blurStrip(const BlurEnding& ending, const BlurSource& source, int64_t x,
                                 LineBuffer& lines, int64_t first, int64_t count,
                                 const SquareRows& out) const {
    const DifferenceSum sum = {*mTerms, mRadius, mTotal, mInverse, ending};
    differenceLoops().blurStrip(sum, source, x, lines.data(), first, count, out);
}

// --- Down, then across ------------------------------------------------------------------------------

DifferenceDownThenAcross::IntermediateColumns DifferenceDownThenAcross::IntermediateColumns::of(
    const DifferencePasses& passes, const FullColumns& full) {
    const ReachedSource& source = passes.source();
    const Box reach = expanded(passes.window(), passes.radius());
    const int64_t inked = passes.inSquares(source.part.width);
    if (full.before <= reach.left && full.from >= reach.right)
        return {source.left, source.part.width, inked};
    const int64_t before = inked > 0 ? source.left - reach.left : 0;
    return {reach.left, reach.width(), std::max(reach.width(), before + inked)};
}

DifferenceDownThenAcross::DifferenceDownThenAcross(const BlurWeights& kernel, const BlurSource& source,
                                                   const Box& window, const FullColumns& full)
    : mPasses(kernel, source, window),
      mFull(full),
      mColumns(IntermediateColumns::of(mPasses, full)),
      mLines(mPasses.linesFor(std::max(mPasses.source().part.height, mColumns.count))),
      mIntermediate(mColumns.allocated, mPasses.inSquares(window.height())),
      mOutStride(mPasses.inSquares(window.width())),
      mOut(mOutStride, mPasses.side()) {}

void DifferenceDownThenAcross::blurDown() {
    const int64_t side = mPasses.side();
    const ReachedSource& source = mPasses.source();
    const int64_t height = mPasses.window().height();
    uint8_t* const inked = mIntermediate.data() + (source.left - mColumns.left) * side;
    for (int64_t x = 0; x < source.part.width; x += side) {
        mPasses.blurStrip({false, 0}, source.part, x, mLines, mPasses.window().top - source.top, height,
                          {inked + x * side, mColumns.allocated * side, side, true});
    }
    for (int64_t y = 0; y < height; y += side)
        fillAround(bandAt(y));
}

void DifferenceDownThenAcross::fillAround(uint8_t* band) {
    const auto fill = [&](int64_t first, int64_t end, int value) {
        first = std::max<int64_t>(first, 0);
        const int64_t count = std::min(end, mColumns.count) - first;
        if (count <= 0) return;
        std::memset(band + first * mPasses.side(), value, static_cast<size_t>(count * mPasses.side()));
    };
    const int64_t inked = mPasses.source().left - mColumns.left;
    fill(0, inked, 0);
    fill(inked + mPasses.source().part.width, mColumns.count, 0);
    fill(0, mFull.before - mColumns.left, 0xFF);
    fill(mFull.from - mColumns.left, mColumns.count, 0xFF);
}

void DifferenceDownThenAcross::blurAcross(int64_t y, bool inverted) {
    const int64_t side = mPasses.side();
    const Box& window = mPasses.window();
    mPasses.blurStrip(BlurEnding::of(inverted), {bandAt(y), side, side, mColumns.count, 0}, 0, mLines,
                      window.left - mColumns.left, window.width(),
                      {mOut.data(), side, mOutStride, true});
}

// --- Across, then down ------------------------------------------------------------------------------

// Both passes work on what is missing from 255 and round up, as those by dot products do (dot_blur.cpp).

DifferenceAcrossThenDown::DifferenceAcrossThenDown(const BlurWeights& kernel, const BlurSource& source,
                                                   const Box& window)
    : mPasses(kernel, source, window),
      mLines(mPasses.linesFor(std::max(mPasses.source().part.height, mPasses.source().part.width))),
      mTransposed(mPasses.inSquares(mPasses.source().part.width), mPasses.side()),
      mStripBytes(mPasses.inSquares(mPasses.source().part.height) * mPasses.side()),
      mIntermediate(mStripBytes, mPasses.inSquares(window.width()) / mPasses.side()),
      mOutStride(mPasses.inSquares(window.width())),
      mOut(mOutStride, mPasses.inSquares(window.height())) {}

void DifferenceAcrossThenDown::blurAcross() {
    const int64_t side = mPasses.side();
    const ReachedSource& source = mPasses.source();
    const Box& window = mPasses.window();
    const BlurSource transposed = {mTransposed.data(), side, side, source.part.width, 0};
    for (int64_t y = 0; y < source.part.height; y += side) {
        differenceLoops().transpose(source.part, y, mTransposed.data());
        mPasses.blurStrip({true, 0}, transposed, 0, mLines, window.left - source.left, window.width(),
                          {mIntermediate.data() + y * side, mStripBytes, side, true});
    }
}

void DifferenceAcrossThenDown::blurDown() {
    const int64_t side = mPasses.side();
    const ReachedSource& source = mPasses.source();
    const Box& window = mPasses.window();
    for (int64_t x = 0; x < window.width(); x += side) {
        const BlurSource strip = {mIntermediate.data() + x / side * mStripBytes, side, side,
                                  source.part.height, 0};
        mPasses.blurStrip({true, 0xFF}, strip, 0, mLines, window.top - source.top, window.height(),
                          {mOut.data() + x, side * mOutStride, mOutStride, false});
    }
}

}  // namespace VFontEffect::internal
