#include "ops/dilate/dilation_plan.h"

#include <algorithm>

#include "core/assert.h"

namespace VFontEffect::internal {
namespace {

/// Rows that are dilated at once: few enough to stay in the cache with what is blended with them.
constexpr int64_t kBandRows = 32;

Dilation inputOf(const CoverageRows& box, const DiscShape& disc, const Box& wanted) {
    VOREL_ASSERT(!wanted.empty());
    const Box part = translated(wanted, kDilationBorder, kDilationBorder);
    Dilation input = {};
    input.box = box;
    input.disc = &disc;
    input.width = box.width + 2 * kDilationBorder;
    input.height = box.height + 2 * kDilationBorder;
    input.left = std::min<int64_t>(part.left, 0);
    input.right = std::max(part.right, input.width);
    input.top = part.top;
    input.bandRows = std::min(kBandRows, part.height());
    return input;
}

const DilationStrategy& strategyFor(const DilationLoops& loops, int reach) {
    VOREL_ASSERT(reach >= 0);
    if (reach <= kLongestCellReach) return loops.cells[reach];
    return reach <= loops.longestSpreadReach ? loops.spreading : loops.tiles;
}

}  // namespace

DilationPlan::DilationPlan(CpuLevel level, const CoverageRows& source, const DiscShape& disc,
                           const Box& part)
    : mInput(inputOf(source, disc, part)),
      mLoops(dilationLoops(level)),
      mStrategy(strategyFor(mLoops, disc.reach)),
      mMemory(mStrategy.memoryBytes(mInput)),
      mNextRow(part.top) {
    if (mMemory) mStrategy.begin(mInput, mMemory.data());
}

CoverageRows DilationPlan::rows(int64_t y, int64_t count) {
    return asRows(nextRows(y, count), count);
}

CoverageRows DilationPlan::minRows(DilationPlan& other, int64_t y, int64_t count) {
    VOREL_ASSERT(left() == other.left() && mInput.right == other.mInput.right);
    uint8_t* const values = nextRows(y, count);
    mLoops.keepMin(values, other.nextRows(y, count), dilatedStride(mInput) * count);
    return asRows(values, count);
}

uint8_t* DilationPlan::nextRows(int64_t y, int64_t count) {
    VOREL_ASSERT(*this && y == mNextRow && count > 0 && count <= bandRows());
    mNextRow += count;
    return mStrategy.rows(mInput, mMemory.data(), y + kDilationBorder, count);
}

CoverageRows DilationPlan::asRows(const uint8_t* values, int64_t count) const {
    return {values, dilatedStride(mInput), mInput.right - mInput.left, count, kAsIs};
}

}  // namespace VFontEffect::internal
