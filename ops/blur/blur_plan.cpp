#include "ops/blur/blur_plan.h"

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

BlurPlan::BlurPlan(CpuLevel level, const BlurInput& input) : mNextRow(input.window.top) {
    if (!input.weights) return;
    VOREL_ASSERT(!input.window.empty());
    VOREL_ASSERT(input.weights.total <= kLargestTotal);
    const DotLoops& dots = dotLoops(level);
    if (suitsDifferences(dots, input)) {
        mDifferences.emplace(differenceLoops(level), input);
    } else {
        mDots.emplace(dots, input);
    }
}

BlurPlan::operator bool() const {
    return (mDots && *mDots) || (mDifferences && *mDifferences);
}

int64_t BlurPlan::bandRows() const {
    return mDots ? kQuad : mDifferences->bandRows();
}

BlurredRows BlurPlan::rows(int64_t y, int64_t count) {
    VOREL_ASSERT(*this && y == mNextRow && count > 0 && count <= bandRows());
    mNextRow += count;
    return mDots ? mDots->rows(y) : mDifferences->rows(y);
}

}  // namespace VFontEffect::internal
