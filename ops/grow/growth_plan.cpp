#include "ops/grow/growth_plan.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

#include "core/assert.h"
#include "core/box.h"
#include "core/numeric.h"

namespace VFontEffect::internal {
namespace {

/// A packed plane of bytes.
struct Picture {
    uint8_t* bytes;
    int64_t width;
    int64_t height;

    uint8_t* at(int64_t x, int64_t y) const { return bytes + y * width + x; }
};

/// The first place from `x` to `end` - 1 that is not 0, or end.
int64_t firstCovered(const uint8_t* row, int64_t x, int64_t end) {
    uint64_t eight = 0;
    for (; x + 8 <= end; x += 8) {
        std::memcpy(&eight, row + x, sizeof eight);
        if (eight != 0) break;
    }
    while (x < end && row[x] == 0)
        ++x;
    return x;
}

/// One place behind the last from `x` to `end` - 1 that is not 0, or x.
int64_t coveredEnd(const uint8_t* row, int64_t x, int64_t end) {
    uint64_t eight = 0;
    for (; x + 8 <= end; end -= 8) {
        std::memcpy(&eight, row + end - 8, sizeof eight);
        if (eight != 0) break;
    }
    while (end > x && row[end - 1] == 0)
        --end;
    return end;
}

/// The smallest box around what is not 0.
Box coveredPart(const Picture& picture) {
    Box covered = {picture.width, picture.height, 0, 0};
    for (int64_t y = 0; y < picture.height; ++y) {
        const uint8_t* const row = picture.at(0, y);
        const int64_t first = firstCovered(row, 0, picture.width);
        if (first == picture.width) continue;
        covered = {std::min(covered.left, first), std::min(covered.top, y),
                   std::max(covered.right, coveredEnd(row, first, picture.width)), y + 1};
    }
    return covered;
}

/// Deliberate: the first and the last column count as 0 after a pass, but for their ends.
void clearEndColumns(const Picture& picture) {
    for (int64_t y = 1; y < picture.height - 1; ++y)
        *picture.at(0, y) = *picture.at(picture.width - 1, y) = 0;
}

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
    if (mPlanes[0] && mPlanes[1] && mTiles) {
        copyIn(input);
        // What stood beside the rows in the source counts in the first pass only.
        const int first = mMargin < 0 ? 1 : input.passes;
        grow(first);
        if (input.passes > first) grow(input.passes - first);
    } else {
        mPlanes[mCurrent].release();
    }
    mPlanes[1 - mCurrent].release();
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
void GrowthPlan::setFrame(int plane, int other) {
    for (const int64_t y : {int64_t{-1}, mHeight})
        std::memcpy(rowOf(other, y) - 1, rowOf(plane, y) - 1, static_cast<size_t>(mWidth + 2));
    for (int64_t y = 0; y < mHeight; ++y)
        rowOf(other, y)[-1] = rowOf(other, y)[mWidth] = mInvertMask;
}

void GrowthPlan::grow(int passes) {
    const int other = 1 - mCurrent;
    setFrame(mCurrent, other);
    mLoops.grow({{rowOf(mCurrent, 0), rowOf(other, 0)},
                 mStride,
                 mWidth,
                 mHeight,
                 mInvertMask,
                 passes,
                 mTiles.data()});
    if (passes % 2 != 0) mCurrent = other;
}

// What is not 0 spreads by a pixel a pass: the part that changes lies within `passes` pixels of it.
void growByBoxFilter(CpuLevel level, unsigned char* mask, int passes, int width, int height) {
    if (mask == nullptr || passes < 1 || width < 1 || height <= 2) return;
    const Picture picture = {mask, width, height};
    const Box inner = {1, 1, int64_t{width} - 1, int64_t{height} - 1};
    const Box part = intersection(expanded(coveredPart(picture), passes), inner);
    if (part.empty()) return clearEndColumns(picture);
    const CoverageRows framed = {picture.at(part.left - 1, part.top - 1), width, part.width() + 2,
                                 part.height() + 2, kAsIs};
    GrowthPlan plan(level, {framed, -1, passes});
    if (!plan) return;
    const CoverageRows grown = plan.rows(1, part.height());
    for (int64_t y = 0; y < grown.height; ++y) {
        std::memcpy(picture.at(part.left, part.top + y), grown.start + y * grown.stride,
                    static_cast<size_t>(grown.width));
    }
    clearEndColumns(picture);
}

}  // namespace VFontEffect::internal
