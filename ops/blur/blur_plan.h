#pragma once

#include <algorithm>
#include <cstdint>
#include <optional>

#include "ops/blur/blur_input.h"
#include "ops/blur/difference_blur.h"
#include "ops/blur/dot_blur.h"

namespace VFontEffect::internal {

/// A separable blur, planned once: the strategy, the weights in its form, and the working memory. It is
/// ready, or empty when memory ran out.
class BlurPlan {
  public:
    BlurPlan(CpuLevel level, const BlurInput& input);

    explicit operator bool() const;

    /// Rows that are asked for at once; the last ones may be fewer.
    int64_t bandRows() const;

    /// `count` rows of results from row y of the source on, first column that of the window. Bands are
    /// asked for in order, from the window's top on. The rows may be changed, and stay until the next
    /// call.
    BlurredRows rows(int64_t y, int64_t count);

  private:
    std::optional<DotBlur> mDots;
    std::optional<DifferenceBlur> mDifferences;
    int64_t mNextRow;
};

/// Calls paint(part, rows) for all bands of the window, `part` being a band's box.
template <class Paint>
void forBands(BlurPlan& plan, const Box& window, Paint paint) {
    for (int64_t y = window.top; y < window.bottom; y += plan.bandRows()) {
        const int64_t count = std::min(plan.bandRows(), window.bottom - y);
        paint(Box{window.left, y, window.right, y + count}, plan.rows(y, count));
    }
}

}  // namespace VFontEffect::internal
