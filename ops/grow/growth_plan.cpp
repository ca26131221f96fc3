#include "ops/grow/growth_plan.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

#include "core/box.h"
#include "core/numeric.h"
#include "ops/grow/growth_loops.h"

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
int64_t firstInked(const uint8_t* row, int64_t x, int64_t end) {
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
int64_t inkedEnd(const uint8_t* row, int64_t x, int64_t end) {
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
Box inkedPart(const Picture& picture) {
    Box inked = {picture.width, picture.height, 0, 0};
    for (int64_t y = 0; y < picture.height; ++y) {
        const uint8_t* const row = picture.at(0, y);
        const int64_t first = firstInked(row, 0, picture.width);
        if (first == picture.width) continue;
        inked = {std::min(inked.left, first), std::min(inked.top, y),
                 std::max(inked.right, inkedEnd(row, first, picture.width)), y + 1};
    }
    return inked;
}

void copyIn(const Picture& picture, const Box& part, Growth& growth) {
    for (int64_t y = -1; y <= part.height(); ++y) {
        std::memcpy(growth.row(y) - 1, picture.at(part.left - 1, part.top + y),
                    static_cast<size_t>(part.width() + 2));
    }
}

void copyOut(Growth& growth, const Box& part, const Picture& picture) {
    for (int64_t y = 0; y < part.height(); ++y) {
        std::memcpy(picture.at(part.left, part.top + y), growth.row(y),
                    static_cast<size_t>(part.width()));
    }
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

Growth::Growth(int64_t width, int64_t height)
    : mWidth(width),
      mHeight(height),
      mStride(strideFor(width)),
      mPlanes{planeFor(width, height), planeFor(width, height)},
      mTiles(PixelBuffer<uint8_t>::uninitialised(growthTileBytes(width, height))) {}

uint8_t* Growth::rowOf(int plane, int64_t y) {
    return mPlanes[plane].data() + kGrowthMargin + (y + 1) * mStride;
}

/// The other plane's frame: as it is in this one above and below, `beside` at the sides.
void Growth::frameOther(uint8_t beside) {
    const int other = 1 - mCurrent;
    for (const int64_t y : {int64_t{-1}, mHeight})
        std::memcpy(rowOf(other, y) - 1, row(y) - 1, static_cast<size_t>(mWidth + 2));
    for (int64_t y = 0; y < mHeight; ++y)
        rowOf(other, y)[-1] = rowOf(other, y)[mWidth] = beside;
}

void Growth::grow(int passes, uint8_t beside) {
    frameOther(beside);
    growthLoops().grow({{rowOf(mCurrent, 0), rowOf(1 - mCurrent, 0)},
                        mStride,
                        mWidth,
                        mHeight,
                        beside,
                        passes,
                        mTiles.data()});
    if (passes % 2 != 0) mCurrent = 1 - mCurrent;
}

void Growth::finish() {
    mPlanes[1 - mCurrent].release();
    mTiles.release();
}

// What is not 0 spreads by a pixel a pass: the part that changes lies within `passes` pixels of it.
void growByBoxFilter(unsigned char* mask, int passes, int width, int height) {
    if (mask == nullptr || passes < 1 || width < 1 || height <= 2) return;
    const Picture picture = {mask, width, height};
    const Box inner = {1, 1, int64_t{width} - 1, int64_t{height} - 1};
    const Box part = intersection(expanded(inkedPart(picture), passes), inner);
    if (part.empty()) return clearEndColumns(picture);
    Growth growth(part.width(), part.height());
    if (!growth) return;
    copyIn(picture, part, growth);
    growth.grow(1, 0);
    growth.grow(passes - 1, 0);
    copyOut(growth, part, picture);
    clearEndColumns(picture);
}

}  // namespace VFontEffect::internal
