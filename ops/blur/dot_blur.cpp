#include "ops/blur/dot_blur.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <utility>

#include "core/assert.h"
#include "core/numeric.h"

namespace VFontEffect::internal {
namespace {

/// Bytes of a row that whole vectors are written to.
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
void fillTotals(const BlurWeights& weights, uint32_t* totals) {
    uint32_t total = 0;
    for (int64_t i = 0; i < cellsOf(weights.radius); ++i) {
        totals[i] = total;
        const int64_t distance = std::abs(i - kCellsBefore - weights.radius);
        if (distance <= weights.radius) total += weights.byDistance.data()[distance];
    }
}

}  // namespace

// --- Weights --------------------------------------------------------------------------------------

PackedWeights::PackedWeights(const DotLoops& loops, const BlurWeights& weights)
    : mMemory(PixelBuffer<uint8_t>::uninitialised(cellsOf(weights.radius),
                                                  loops.cellBytes + int64_t{sizeof(uint32_t)})),
      mBlur{} {
    mBlur.radius = weights.radius;
    mBlur.total = weights.total;
    if (!mMemory) return;
    loops.fillCells(weights.byDistance.data(), weights.radius, mMemory.data());
    auto* const totals =
        reinterpret_cast<uint32_t*>(mMemory.data() + cellsOf(weights.radius) * loops.cellBytes);
    fillTotals(weights, totals);
    mBlur.cells = mMemory.data() + kCellsBefore * loops.cellBytes;
    mBlur.totals = totals + kCellsBefore;
    mBlur.inverse = inverseAbove(weights.total);
    mBlur.isNarrow = loops.hasNarrow && weights.radius <= kLargestNarrowRadius && weights.total <= 0xFF;
    if (!mBlur.isNarrow) return;
    const uint32_t scale = weights.total < 128 ? 2 : 1;
    for (int k = 0; k <= weights.radius; ++k)
        mBlur.weights[k] = static_cast<uint16_t>(weights.byDistance.data()[k] * scale);
    mBlur.narrowTotal = static_cast<uint16_t>(weights.total * scale);
    mBlur.division = narrowDivision(mBlur.narrowTotal);
}

// --- Working memory -------------------------------------------------------------------------------

// A narrow blur reads all the groups around its results. A wide one leaves out groups without coverage,
// and so there is no need to store those that lie wholly above or below the rows.
GroupRange GroupRange::needed(const PackedWeights& weights, int64_t height, int64_t firstRow,
                              int64_t quads) {
    const int64_t end = quads - 1 + tapSteps(weights->radius);
    if (weights->isNarrow) return {0, end};
    const int64_t first = std::min(end, std::max<int64_t>(0, -firstRow) / kQuad);
    return {first, std::clamp(quadsOf(std::max<int64_t>(0, height - firstRow)), first, end)};
}

TapGroups::TapGroups(const DotLoops& loops, const PackedWeights& weights, int64_t width, int64_t height,
                     int64_t firstRow, int64_t quads)
    : mSteps(tapSteps(weights->radius)),
      mMissing(GroupRange::needed(weights, height, firstRow, quads)),
      mCapacity(std::min(mSteps - 1 + kSpareGroups, mMissing.end - mMissing.first)),
      mStrips(roundedUp(width, loops.vectorBytes) / loops.vectorBytes),
      mGroupBytes(kQuad * loops.vectorBytes * weights.pixelBytes()),
      mMemory(mGroupBytes * mCapacity, mStrips),
      mCovered(PixelBuffer<int32_t>::zeroed(mStrips, 2)) {
    if (!*this) return;
    mColumns = {mMemory.data(), mGroupBytes * mCapacity, mMissing.first,
                width,          mCovered.data(),         mCovered.data() + mStrips};
    std::fill_n(mColumns.lastCovered, mStrips, -1);
}

/// Makes room behind the groups from `group` on.
void TapGroups::forgetBefore(int64_t group) {
    VOREL_ASSERT(group > mColumns.firstGroup && group <= mMissing.first);
    const int64_t skipped = (group - mColumns.firstGroup) * mGroupBytes;
    const int64_t kept = (mMissing.first - group) * mGroupBytes;
    for (int64_t strip = 0; strip < mStrips; ++strip) {
        uint8_t* const groups = mColumns.groups + strip * mColumns.stripStride;
        std::memmove(groups, groups + skipped, static_cast<size_t>(kept));
    }
    mColumns.firstGroup = group;
}

IntermediateBuffer::IntermediateBuffer(const DotLoops& loops, const PackedWeights& weights,
                                       int64_t coveredColumn, int64_t columns, const FullColumns& full)
    : mStrideBytes((strideFor(columns) + 2 * kIntermediateMargin) * weights.pixelBytes()),
      mPixels(mStrideBytes, kQuad),
      mCovered(PixelBuffer<uint8_t>::zeroed(strideFor(columns) / loops.vectorBytes)) {
    if (!*this || !weights) return;
    VOREL_ASSERT(coveredColumn % kWidestVector == 0);
    uint8_t* const start = mPixels.data() + kIntermediateMargin * weights.pixelBytes();
    mRows = {start, mStrideBytes, columns, coveredColumn, full.before, full.from, mCovered.data()};
    loops.clear(*weights, mRows);
}

// --- Passes -----------------------------------------------------------------------------------------

DotBlur::DotBlur(const DotLoops& loops, const BlurInput& input)
    : mLoops(loops),
      mWindow(input.window),
      mFirst(input.first),
      mSecond(input.second),
      mWeights(loops, input.weights),
      mSource(ReachedSource::of(input)),
      mFirstRow(mWindow.top - input.weights.radius - mSource.top),
      mStride(strideFor(mWindow.width())),
      mAcross(input.order == BlurInput::Order::acrossThenDown
                  ? std::optional<LineBuffer>(std::in_place, mStride, kQuad)
                  : std::nullopt),
      mTaps(loops, mWeights, mAcross ? mWindow.width() : mSource.part.width, mSource.part.height,
            mFirstRow, quadsOf(mWindow.height())),
      mIntermediateLeft(mSource.left),
      mIntermediate(intermediateFor(input.full)),
      mOut(mStride, kQuad) {}

/// The rows that are blurred across have the source's columns, and when some of the full ones are in
/// reach all that are.
IntermediateBuffer DotBlur::intermediateFor(const FullColumns& full) {
    const Box reach = expanded(mWindow, mWeights->radius);
    const int64_t width = mSource.part.width;
    if (full.before <= reach.left && full.from >= reach.right)
        return {mLoops, mWeights, 0, width, {0, width}};
    const int64_t coveredColumn =
        roundedUp(std::max<int64_t>(0, mIntermediateLeft - reach.left), kWidestVector);
    mIntermediateLeft -= coveredColumn;
    return {mLoops,
            mWeights,
            coveredColumn,
            reach.right - mIntermediateLeft,
            {full.before - mIntermediateLeft, full.from - mIntermediateLeft}};
}

void DotBlur::blurAcross(const PassEnding& ending, uint8_t* out) {
    VOREL_ASSERT(roundedUp(mWindow.width(), mLoops.vectorBytes) <= mStride);
    mLoops.across(*mWeights, mIntermediate.rows(), mWindow.left - mIntermediateLeft,
                  mWindow.right - mIntermediateLeft, {out, mStride, ending});
}

void DotBlur::feed(int64_t group) {
    const int64_t row = mFirstRow + kQuad * group;
    if (!mAcross) return mLoops.feed(*mWeights, mSource.part, row, mTaps.columns(), group);
    mLoops.copy(*mWeights, mSource.part, row, mIntermediate.rows());
    blurAcross(mFirst, mAcross->data());
    const CoverageRows across = {mAcross->data(), mStride, mWindow.width(), kQuad, kAsIs};
    mLoops.feed(*mWeights, across, 0, mTaps.columns(), group);
}

BlurredRows DotBlur::rows(int64_t y) {
    VOREL_ASSERT((y - mWindow.top) % kQuad == 0);
    const int64_t quad = (y - mWindow.top) / kQuad;
    mTaps.complete(quad, [&](int64_t group) { feed(group); });
    if (mAcross) {
        mLoops.downToBytes(*mWeights, mTaps.columns(), quad, {mOut.data(), mStride, mSecond});
    } else {
        mLoops.down(*mWeights, mTaps.columns(), quad, mIntermediate.rows());
        blurAcross(mSecond, mOut.data());
    }
    return {mOut.data(), mStride};
}

}  // namespace VFontEffect::internal
