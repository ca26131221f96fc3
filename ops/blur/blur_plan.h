#pragma once

#include <cstdint>
#include <optional>

#include "ops/blur/blur_input.h"
#include "ops/blur/difference_blur.h"
#include "ops/blur/dot_blur.h"
#include "ops/blur/narrow_blur.h"

namespace VFontEffect::internal {

/// A separable blur, planned once: the strategy, the weights in its form, and the working memory, which
/// serves one window after the other. It is ready, or empty when memory ran out.
class BlurPlan {
  public:
    /// What a plan for an input takes beside the weights.
    static int64_t memoryBytes(CpuLevel level, const BlurInput& input);

    /// For inputs that take no more memory than this one, which is `memoryBytes`, of the same weights,
    /// order and endings.
    BlurPlan(CpuLevel level, const BlurInput& largest, int64_t memoryBytes);
    ~BlurPlan();

    explicit operator bool() const;

    /// Turns to an input.
    void begin(const BlurInput& input);

    /// Rows that are asked for at once; the last ones may be fewer.
    int64_t bandRows() const;

    /// `count` rows of results from row y of the source on, first column that of the window. Bands are
    /// asked for in order, from the window's top on. The rows may be changed, and stay until the next
    /// call.
    BlurredRows rows(int64_t y, int64_t count);

  private:
    template <class Plan, class Action>
    static auto withBlur(Plan& plan, Action action);

    std::optional<NarrowBlur> mNarrow;
    std::optional<DotBlur> mDots;
    std::optional<DifferenceBlur> mDifferences;
    int64_t mNextRow = 0;
};

/// Windows of a blur that take `workingBytes` at most, if they can.
inline Windows blurWindows(CpuLevel level, const BlurInput& input, int64_t workingBytes) {
    return windowsWithin(workingBytes, input.window, input.weights.radius, [&](const Windows& cut) {
        return BlurPlan::memoryBytes(level, input.largestOf(cut));
    });
}

}  // namespace VFontEffect::internal
