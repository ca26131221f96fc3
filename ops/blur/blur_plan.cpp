#include "ops/blur/blur_plan.h"

#include <algorithm>

#include "core/assert.h"

namespace VFontEffect::internal {
namespace {

/// Differences keep up to 256 bytes for each row or column of a strip: no longer ones than this.
constexpr int64_t kLongestDifferenceSide = 1 << 16;

enum class Strategy { narrow, dots, differences };

Strategy strategyFor(const DotLoops& dots, const BlurInput& input) {
    if (dots.leavesNarrow && NarrowBlur::suits(input.weights)) return Strategy::narrow;
    const int64_t longest = std::max(std::max(input.source.width, input.source.height),
                                     std::max(input.window.width(), input.window.height()));
    return input.weights.radius > dots.largestDotRadius && longest <= kLongestDifferenceSide
               ? Strategy::differences
               : Strategy::dots;
}

}  // namespace

int64_t BlurPlan::memoryBytes(CpuLevel level, const BlurInput& input) {
    const DotLoops& dots = dotLoops(level);
    switch (strategyFor(dots, input)) {
        case Strategy::narrow:
            return NarrowBlur::memoryBytes(narrowLoops(level), input);
        case Strategy::dots:
            return DotBlur::memoryBytes(dots, input);
        case Strategy::differences:
            return DifferenceBlur::memoryBytes(differenceLoops(level), input);
    }
    return 0;
}

BlurPlan::BlurPlan(CpuLevel level, const BlurInput& largest, int64_t memoryBytes) {
    VOREL_ASSERT(!largest.window.empty());
    VOREL_ASSERT(largest.weights.total <= kLargestTotal);
    const DotLoops& dots = dotLoops(level);
    switch (strategyFor(dots, largest)) {
        case Strategy::narrow:
            mNarrow.emplace(narrowLoops(level), largest, memoryBytes);
            break;
        case Strategy::dots:
            mDots.emplace(dots, largest, memoryBytes);
            break;
        case Strategy::differences:
            mDifferences.emplace(differenceLoops(level), largest, memoryBytes);
            break;
    }
}

BlurPlan::~BlurPlan() = default;

/// What `action` gives for the one blur that there is.
template <class Plan, class Action>
auto BlurPlan::withBlur(Plan& plan, Action action) {
    if (plan.mNarrow) return action(*plan.mNarrow);
    if (plan.mDots) return action(*plan.mDots);
    return action(*plan.mDifferences);
}

void BlurPlan::begin(const BlurInput& input) {
    VOREL_ASSERT(*this && !input.window.empty());
    withBlur(*this, [&](auto& blur) { blur.begin(input); });
    mNextRow = input.window.top;
}

BlurPlan::operator bool() const {
    return withBlur(*this, [](auto& blur) { return static_cast<bool>(blur); });
}

int64_t BlurPlan::bandRows() const {
    return withBlur(*this, [](auto& blur) { return blur.bandRows(); });
}

BlurredRows BlurPlan::rows(int64_t y, int64_t count) {
    VOREL_ASSERT(*this && y == mNextRow && count > 0 && count <= bandRows());
    mNextRow += count;
    return withBlur(*this, [&](auto& blur) { return blur.rows(y); });
}

}  // namespace VFontEffect::internal
