#include "ops/blur/blur_plan.h"

#include <algorithm>

#include "core/assert.h"

namespace VFontEffect::internal {
namespace {

/// Differences keep up to 256 bytes for each row or column of a strip: no longer ones than this.
constexpr int64_t kLongestDifferenceSide = 1 << 16;

bool suitsDifferences(const DotLoops& dots, const BlurInput& input) {
    const int64_t longest = std::max(std::max(input.source.width, input.source.height),
                                     std::max(input.window.width(), input.window.height()));
    return input.weights.radius > dots.largestDotRadius && longest <= kLongestDifferenceSide;
}

}  // namespace

int64_t BlurPlan::memoryBytes(CpuLevel level, const BlurInput& input) {
    const DotLoops& dots = dotLoops(level);
    return suitsDifferences(dots, input) ? DifferenceBlur::memoryBytes(differenceLoops(level), input)
                                         : DotBlur::memoryBytes(dots, input);
}

BlurPlan::BlurPlan(CpuLevel level, const BlurInput& largest, int64_t memoryBytes) {
    VOREL_ASSERT(!largest.window.empty());
    VOREL_ASSERT(largest.weights.total <= kLargestTotal);
    const DotLoops& dots = dotLoops(level);
    if (suitsDifferences(dots, largest)) {
        mDifferences.emplace(differenceLoops(level), largest, memoryBytes);
    } else {
        mDots.emplace(dots, largest, memoryBytes);
    }
}

void BlurPlan::begin(const BlurInput& input) {
    VOREL_ASSERT(*this && !input.window.empty());
    if (mDots) {
        mDots->begin(input);
    } else {
        mDifferences->begin(input);
    }
    mNextRow = input.window.top;
}

BlurPlan::operator bool() const {
    return (mDots && *mDots) || (mDifferences && *mDifferences);
}

int64_t BlurPlan::bandRows() const {
    return mDots ? mDots->bandRows() : mDifferences->bandRows();
}

BlurredRows BlurPlan::rows(int64_t y, int64_t count) {
    VOREL_ASSERT(*this && y == mNextRow && count > 0 && count <= bandRows());
    mNextRow += count;
    return mDots ? mDots->rows(y) : mDifferences->rows(y);
}

}  // namespace VFontEffect::internal
