#include "ops/blur/dot_blur.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <cstring>

#include "core/numeric.h"

namespace VFontEffect::internal {
namespace {

/// U8s of a row that whole vectors are written to.
int64_t strideFor(int64_t width) {
    return roundedUp(width, kWidestVector);
}

int64_t quadsOf(int64_t rows) {
    return roundedUp(rows, kQuad) / kQuad;
}

/// In multiples of four, so that what follows cells of a byte is aligned.
int64_t cellsOf(int radius) {
    return roundedUp(kCellsBefore + 2 * int64_t{radius} + 1 + kCellsBehind, 4);
}

/// The total of the weights before each cell.
void fillTotals(const BlurWeights& kernel, uint32_t* totals) {
    uint32_t total = 0;
    for (int64_t i = 0; i < cellsOf(kernel.radius); ++i) {
        totals[i] = total;
        const int64_t distance = std::abs(i - kCellsBefore - kernel.radius);
        if (distance <= kernel.radius) total += kernel.weights.data()[distance];
    }
}

}  // namespace

// --- Weights --------------------------------------------------------------------------------------

PackedWeights::PackedWeights(const BlurWeights& kernel)
    : mMemory(PixelBuffer<uint8_t>::uninitialised(kernel ? cellsOf(kernel.radius) : -1,
                                                  dotLoops().cellBytes + int64_t{sizeof(uint32_t)})),
      mBlur{} {
    mBlur.radius = kernel.radius;
    mBlur.total = kernel.total;
    if (!mMemory) return;
    const DotLoops& loops = dotLoops();
    loops.fillCells(kernel.weights.data(), kernel.radius, mMemory.data());
    auto* const totals =
        reinterpret_cast<uint32_t*>(mMemory.data() + cellsOf(kernel.radius) * loops.cellBytes);
    fillTotals(kernel, totals);
    mBlur.cells = mMemory.data() + kCellsBefore * loops.cellBytes;
    mBlur.totals = totals + kCellsBefore;
    mBlur.inverse = inverseAbove(kernel.total);
    mBlur.isNarrow = loops.hasNarrow && kernel.radius <= kLargestNarrowRadius && kernel.total <= 0xFF;
    if (!mBlur.isNarrow) return;
    const uint32_t scale = kernel.total < 128 ? 2 : 1;
    for (int k = 0; k <= kernel.radius; ++k)
        mBlur.weights[k] = static_cast<uint16_t>(kernel.weights.data()[k] * scale);
    mBlur.narrowTotal = static_cast<uint16_t>(kernel.total * scale);
    mBlur.division = narrowDivision(mBlur.narrowTotal);
}

// --- Working memory -------------------------------------------------------------------------------

// A narrow blur reads all the groups around its results. A wide one leaves out groups without ink, and
// so there is no need to store those that lie wholly above or below the rows.
GroupRange GroupRange::needed(const PackedWeights& weights, int64_t height, int64_t firstRow,
                              int64_t quads) {
    const int64_t end = quads - 1 + tapSteps(weights->radius);
    if (weights->isNarrow) return {0, end};
    const int64_t first = std::min(end, std::max<int64_t>(0, -firstRow) / kQuad);
    return {first, std::clamp(quadsOf(height - firstRow), first, end)};
}

TapGroups::TapGroups(const PackedWeights& weights, int64_t width, int64_t height, int64_t firstRow,
                     int64_t quads)
    : mSteps(tapSteps(weights->radius)),
      mMissing(GroupRange::needed(weights, height, firstRow, quads)),
      mCapacity(std::min(mSteps - 1 + kSpareGroups, mMissing.end - mMissing.first)),
      mStrips(roundedUp(width, dotLoops().vectorBytes) / dotLoops().vectorBytes),
      mGroupBytes(kQuad * dotLoops().vectorBytes * weights.pixelBytes()),
      mMemory(mGroupBytes * mCapacity, mStrips),
      mInked(PixelBuffer<int32_t>::zeroed(mStrips, 2)) {
    if (!*this) return;
    mColumns = {mMemory.data(), mGroupBytes * mCapacity, mMissing.first,
                width,          mInked.data(),           mInked.data() + mStrips};
    std::fill_n(mColumns.lastInked, mStrips, -1);
}

/// Makes room behind the groups from `group` on.
void TapGroups::forgetBefore(int64_t group) {
    const int64_t skipped = (group - mColumns.firstGroup) * mGroupBytes;
    const int64_t kept = (mMissing.first - group) * mGroupBytes;
    for (int64_t strip = 0; strip < mStrips; ++strip) {
        uint8_t* const groups = mColumns.groups + strip * mColumns.stripStride;
        std::memmove(groups, groups + skipped, static_cast<size_t>(kept));
    }
    mColumns.firstGroup = group;
}

IntermediateBuffer::IntermediateBuffer(const PackedWeights& weights, int64_t inkColumn, int64_t columns,
                                       const FullColumns& full)
    : mStrideBytes((strideFor(columns) + 2 * kIntermediateMargin) * weights.pixelBytes()),
      mPixels(mStrideBytes, kQuad),
      mInked(PixelBuffer<uint8_t>::zeroed(strideFor(columns) / dotLoops().vectorBytes)) {
    if (!*this || !weights) return;
    uint8_t* const start = mPixels.data() + kIntermediateMargin * weights.pixelBytes();
    mRows = {start, mStrideBytes, columns, inkColumn, full.before, full.from, mInked.data()};
    dotLoops().clear(*weights, mRows);
}

// --- Down, then across ------------------------------------------------------------------------------

DownThenAcross::DownThenAcross(const BlurWeights& kernel, const BlurSource& source, const Box& window,
                               const FullColumns& full)
    : mWindow(window),
      mWeights(kernel),
      mSource(ReachedSource::of(source, kernel.radius, window)),
      mFirstRow(window.top - kernel.radius - mSource.top),
      mTaps(mWeights, mSource.part.width, mSource.part.height, mFirstRow, quadsOf(window.height())),
      mIntermediateLeft(mSource.left),
      mIntermediate(intermediateFor(full)),
      mOutStride(strideFor(window.width())),
      mOut(mOutStride, kQuad) {}

/// The rows between the passes have the source's columns, and when some of the full ones are in reach
/// all that are.
IntermediateBuffer DownThenAcross::intermediateFor(const FullColumns& full) {
    const Box reach = expanded(mWindow, mWeights->radius);
    const int64_t width = mSource.part.width;
    if (full.before <= reach.left && full.from >= reach.right) return {mWeights, 0, width, {0, width}};
    const int64_t inkColumn =
        roundedUp(std::max<int64_t>(0, mIntermediateLeft - reach.left), kWidestVector);
    mIntermediateLeft -= inkColumn;
    return {mWeights,
            inkColumn,
            reach.right - mIntermediateLeft,
            {full.before - mIntermediateLeft, full.from - mIntermediateLeft}};
}

void DownThenAcross::blurQuad(int64_t quad, bool inverted) {
    const DotLoops& loops = dotLoops();
    mTaps.complete(quad, [&](int64_t group) {
        loops.feed(*mWeights, mSource.part, mFirstRow + kQuad * group, mTaps.columns(), group);
    });
    loops.down(*mWeights, mTaps.columns(), quad, mIntermediate.rows());
    loops.across(*mWeights, mIntermediate.rows(), mWindow.left - mIntermediateLeft,
                 mWindow.right - mIntermediateLeft, {mOut.data(), mOutStride, BlurEnding::of(inverted)});
}

// --- Across, then down ------------------------------------------------------------------------------

// 255 minus a mean that is rounded down is the mean of the inverse rounded up. So both passes work on
// what is missing from 255, which is 0 around the source, round up, and the second gives 255 minus its
// result.

AcrossThenDown::AcrossThenDown(const BlurWeights& kernel, const BlurSource& source, const Box& window)
    : mWindow(window),
      mWeights(kernel),
      mSource(ReachedSource::of(source, kernel.radius, window)),
      mFirstRow(window.top - kernel.radius - mSource.top),
      mIntermediate(mWeights, 0, mSource.part.width, {0, mSource.part.width}),
      mStride(strideFor(window.width())),
      mAcross(mStride, kQuad),
      mTaps(mWeights, window.width(), mSource.part.height, mFirstRow, quadsOf(window.height())),
      mOut(mStride, kQuad) {}

void AcrossThenDown::blurQuad(int64_t quad) {
    const DotLoops& loops = dotLoops();
    const BlurSource across = {mAcross.data(), mStride, mWindow.width(), kQuad, 0};
    mTaps.complete(quad, [&](int64_t group) {
        loops.copy(*mWeights, mSource.part, mFirstRow + kQuad * group, mIntermediate.rows());
        loops.across(*mWeights, mIntermediate.rows(), mWindow.left - mSource.left,
                     mWindow.right - mSource.left, {mAcross.data(), mStride, {true, 0}});
        loops.feed(*mWeights, across, 0, mTaps.columns(), group);
    });
    loops.downToBytes(*mWeights, mTaps.columns(), quad, {mOut.data(), mStride, {true, 0xFF}});
}

}  // namespace VFontEffect::internal
