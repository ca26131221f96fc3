#pragma once

#include <algorithm>
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

    explicit operator bool();

    /// Turns to an input.
    void begin(const BlurInput& input);

    /// Rows that are asked for at once; the last ones may be fewer.
    int64_t bandRows();

    /// `count` rows of results from row y of the source on, first column that of the window. Bands are
    /// asked for in order, from the window's top on. The rows may be changed, and stay until the next
    /// call.
    BlurredRows rows(int64_t y, int64_t count);

  private:
    template <class Action>
    auto withBlur(Action action);

    std::optional<NarrowBlur> mNarrow;
    std::optional<DotBlur> mDots;
    std::optional<DifferenceBlur> mDifferences;
    int64_t mNextRow = 0;
};

/// Blurs an input and calls paint(part, rows) for all bands of its window, `part` being a band's box.
template <class Paint>
void forBands(BlurPlan& plan, const BlurInput& input, Paint paint) {
    plan.begin(input);
    const Box& window = input.window;
    for (int64_t y = window.top; y < window.bottom; y += plan.bandRows()) {
        const int64_t count = std::min(plan.bandRows(), window.bottom - y);
        paint(Box{window.left, y, window.right, y + count}, plan.rows(y, count));
    }
}

/// Blurs an input in windows that take `workingBytes` at most, and calls paint(part, rows) for the bands
/// of all; for none when memory ran out.
template <class Paint>
void blurInWindows(CpuLevel level, const BlurInput& input, int64_t workingBytes, Paint paint) {
    const auto memoryBytes = [&](const Windows& cut) {
        return BlurPlan::memoryBytes(level, input.largestOf(cut));
    };
    const Windows windows = windowsWithin(workingBytes, input.window, input.weights.radius, memoryBytes);
    BlurPlan plan(level, input.largestOf(windows), windows.memoryBytes);
    if (!plan) return;
    windows.forEach([&](const Box& window) { forBands(plan, input.of(window), paint); });
}

}  // namespace VFontEffect::internal
