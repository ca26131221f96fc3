#include "ops/grow/growth_plan.h"

#include <algorithm>
#include <cstring>

#include "core/assert.h"
#include "core/numeric.h"

namespace VFontEffect::internal {

GrowthPlan::Layout GrowthPlan::Layout::of(int64_t width, int64_t height, Arena& arena) {
    Layout layout = {};
    layout.width = width;
    layout.height = height;
    layout.stride = kGrowthMargin + roundedUp(width, kGrowthMargin);
    // Rows, frame and margins.
    for (uint8_t*& plane : layout.planes)
        plane = arena.take<uint8_t>(layout.stride * (height + 2) + 2 * kGrowthMargin);
    layout.tiles = arena.take<uint8_t>(growthTileBytes(width, height));
    return layout;
}

uint8_t* GrowthPlan::Layout::row(int plane, int64_t y) const {
    return planes[plane] + kGrowthMargin + (y + 1) * stride;
}

int64_t GrowthPlan::memoryBytes(const GrowthInput& input, int64_t width, int64_t height) {
    const Box whole = input.whole();
    const int64_t around = 2 * (int64_t{input.passes} - 1);
    Arena arena = {nullptr};
    static_cast<void>(Layout::of(std::min(width + around, whole.width()),
                                 std::min(height + around, whole.height()), arena));
    return arena.used;
}

GrowthPlan::GrowthPlan(CpuLevel level, const GrowthInput& input, int64_t width, int64_t height)
    : mLoops(growthLoops(level)),
      mInput(input),
      mMemoryBytes(memoryBytes(input, width, height)),
      mMemory(mMemoryBytes) {
    VOREL_ASSERT(input.margin >= -1 && !input.whole().empty() && input.passes > 0);
}

CoverageRows GrowthPlan::grown(const Box& part) {
    const Box worked = intersection(expanded(part, int64_t{mInput.passes} - 1), mInput.whole());
    VOREL_ASSERT(*this && !part.empty() && intersection(part, worked) == part);
    Arena arena = {mMemory.data()};
    mLayout = Layout::of(worked.width(), worked.height(), arena);
    VOREL_ASSERT(arena.used <= mMemoryBytes);
    mCurrent = 0;
    copyIn(worked);
    // What stood beside the rows in the source counts in the first pass only.
    const int first = mInput.margin < 0 ? 1 : mInput.passes;
    grow(first);
    if (mInput.passes > first) grow(mInput.passes - first);
    return {mLayout.row(mCurrent, part.top - worked.top) + (part.left - worked.left), mLayout.stride,
            part.width(), part.height(), mInput.source.invertMask};
}

/// Fills plane 0 with the source and what is around it, the frame included.
void GrowthPlan::copyIn(const Box& worked) {
    const CoverageRows& source = mInput.source;
    const Box framed = expanded(worked, 1);
    const Box inside = intersection(framed, wholeOf(source));
    uint8_t* at = mLayout.row(0, -1) - 1;
    uint8_t* const end = at + framed.height() * mLayout.stride;
    const auto fillTo = [&](const uint8_t* next) {
        std::memset(at, source.invertMask, static_cast<size_t>(next - at));
    };
    for (int64_t y = inside.top; !inside.empty() && y < inside.bottom; ++y) {
        uint8_t* const row = mLayout.row(0, y - worked.top) + inside.left - worked.left;
        fillTo(row);
        mLoops.copyInverted(source.start + y * source.stride + inside.left, inside.width(),
                            source.invertMask, row);
        at = row + inside.width();
    }
    fillTo(end);
}

/// The frame of the other plane: as it is in this one above and below.
void GrowthPlan::setFrame() {
    const int other = 1 - mCurrent;
    const int64_t width = mLayout.width;
    for (const int64_t y : {int64_t{-1}, mLayout.height}) {
        std::memcpy(mLayout.row(other, y) - 1, mLayout.row(mCurrent, y) - 1,
                    static_cast<size_t>(width + 2));
    }
    const uint8_t around = mInput.source.invertMask;
    uint8_t* row = mLayout.row(other, 0);
    const int64_t stride = mLayout.stride;
    for (int64_t rows = mLayout.height; rows > 0; --rows, row += stride)
        row[-1] = row[width] = around;
}

void GrowthPlan::grow(int passes) {
    const int other = 1 - mCurrent;
    setFrame();
    mLoops.grow({{mLayout.row(mCurrent, 0), mLayout.row(other, 0)},
                 mLayout.stride,
                 mLayout.width,
                 mLayout.height,
                 mInput.source.invertMask,
                 passes},
                mLayout.tiles);
    if (passes % 2 != 0) mCurrent = other;
}

}  // namespace VFontEffect::internal
