#pragma once

#include <algorithm>
#include <cstdint>

#include "ops/blur/difference_blur.h"
#include "ops/blur/dot_blur.h"

/// The blur by the method that takes less.
namespace VFontEffect::internal {

/// Running sums keep up to 256 bytes for each row or column of a strip: no longer ones than this.
constexpr int64_t kLongestDifferenceSide = 1 << 16;

inline bool suitsDifferences(const BlurWeights& kernel, const BlurSource& source, const Box& window) {
    const int64_t longest =
        std::max(std::max(source.width, source.height), std::max(window.width(), window.height()));
    return kernel.radius > dotLoops().largestDotRadius && longest <= kLongestDifferenceSide;
}

/// Runs a blur, if there is memory for it.
template <class Blur, class Run>
bool runIfThere(Blur blur, Run run) {
    if (!blur) return false;
    run(blur);
    return true;
}

/// Blurs the columns of the source first and then its rows, each pass rounding down, and calls paint(y,
/// rows, values, stride) for some rows of the window at a time. What lies around the source is 0, but
/// for the full columns. `inverted` gives 255 minus the mean of the second pass, rounded down as a
/// whole. Returns false, with nothing painted, when memory ran out.
template <class Paint>
bool blurDownThenAcross(const BlurWeights& kernel, const BlurSource& source, const Box& window,
                        const FullColumns& full, bool inverted, Paint paint) {
    const auto run = [&](auto& blur) { blur.run(inverted, paint); };
    if (suitsDifferences(kernel, source, window))
        return runIfThere(DifferenceDownThenAcross(kernel, source, window, full), run);
    return runIfThere(DownThenAcross(kernel, source, window, full), run);
}

/// Blurs the rows of the source's inverse first and then its columns, each pass rounding down, and
/// paints as above. What lies around the source is 255 in its inverse.
template <class Paint>
bool blurAcrossThenDown(const BlurWeights& kernel, const BlurSource& source, const Box& window,
                        Paint paint) {
    const auto run = [&](auto& blur) { blur.run(paint); };
    if (suitsDifferences(kernel, source, window))
        return runIfThere(DifferenceAcrossThenDown(kernel, source, window), run);
    return runIfThere(AcrossThenDown(kernel, source, window), run);
}

}  // namespace VFontEffect::internal
