#include "ops/grow/growth_plan.h"

#include <cstring>

#include "core/assert.h"
#include "core/numeric.h"

namespace VFontEffect::internal {
namespace {

int64_t strideFor(int64_t width) {
    return kGrowthMargin + roundedUp(width, kGrowthMargin);
}

/// Rows, frame and margins.
LineBuffer planeFor(int64_t width, int64_t height) {
    return LineBuffer(strideFor(width) * (height + 2) + 2 * kGrowthMargin);
}

}  // namespace

GrowthPlan::GrowthPlan(CpuLevel level, const GrowthInput& input)
    : mLoops(growthLoops(level)),
      mMargin(input.margin),
      mWidth(input.source.width + 2 * mMargin),
      mHeight(input.source.height + 2 * mMargin),
      mInvertMask(input.source.invertMask),
      mStride(strideFor(mWidth)),
      mPlanes{planeFor(mWidth, mHeight), planeFor(mWidth, mHeight)},
      mTiles(PixelBuffer<uint8_t>::uninitialised(growthTileBytes(mWidth, mHeight))) {
    VOREL_ASSERT(mMargin >= -1 && mWidth > 0 && mHeight > 0 && input.passes > 0);
    const bool ready = mPlanes[0] && mPlanes[1] && mTiles;
    if (ready) {
        copyIn(input);
        // What stood beside the rows in the source counts in the first pass only.
        const int first = mMargin < 0 ? 1 : input.passes;
        grow(first);
        if (input.passes > first) grow(input.passes - first);
    }
    mPlanes[1 - mCurrent].release();
    if (!ready) mPlanes[mCurrent].release();
    mTiles.release();
}

CoverageRows GrowthPlan::rows(int64_t y, int64_t count) {
    VOREL_ASSERT(*this && y >= -mMargin && count >= 0 && y + count <= mHeight - mMargin);
    return {rowOf(mCurrent, y + mMargin), mStride, mWidth, count, mInvertMask};
}

/// Row 0 to mHeight - 1 of what grows, between the frame's pixels at -1 and mWidth; row -1 and row
/// mHeight are the frame's.
uint8_t* GrowthPlan::rowOf(int plane, int64_t y) {
    return mPlanes[plane].data() + kGrowthMargin + (y + 1) * mStride;
}

void GrowthPlan::copyIn(const GrowthInput& input) {
    const CoverageRows& source = input.source;
    const auto side = static_cast<size_t>(mMargin + 1);
    for (int64_t y = -1 - mMargin; y <= source.height + mMargin; ++y) {
        uint8_t* const row = rowOf(0, y + mMargin) - 1;
        if (y < 0 || y >= source.height) {
            std::memset(row, mInvertMask, 2 * side + static_cast<size_t>(source.width));
            continue;
        }
        std::memset(row, mInvertMask, side);
        mLoops.copyInverted(source.start + y * source.stride, source.width, mInvertMask, row + side);
        std::memset(row + side + source.width, mInvertMask, side);
    }
}

/// The frame of the other plane: as it is in this one above and below.
void GrowthPlan::setFrame(int other) {
    for (const int64_t y : {int64_t{-1}, mHeight})
        std::memcpy(rowOf(other, y) - 1, rowOf(mCurrent, y) - 1, static_cast<size_t>(mWidth + 2));
    for (int64_t y = 0; y < mHeight; ++y)
        rowOf(other, y)[-1] = rowOf(other, y)[mWidth] = mInvertMask;
}

void GrowthPlan::grow(int passes) {
    const int other = 1 - mCurrent;
    setFrame(other);
    mLoops.grow({{rowOf(mCurrent, 0), rowOf(other, 0)}, mStride, mWidth, mHeight, mInvertMask, passes},
                mTiles.data());
    if (passes % 2 != 0) mCurrent = other;
}

}  // namespace VFontEffect::internal
