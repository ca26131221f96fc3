#pragma once

#include <algorithm>
#include <cstdint>

#include "cores/dot_blur.h"
#include "cores/running_blur.h"

/// The blur by the method that takes less.
namespace VFontEffect::internal {

/// Running sums keep up to 256 bytes for each row or column of a strip: no longer ones than this.
constexpr int64_t kLongestRunningSide = 1 << 16;

inline bool suitsRunningSums(const BlurKernel& kernel, const BlurSource& source, const Window& window) {
    const int64_t longest =
        std::max(std::max(source.width, source.height), std::max(window.width(), window.height()));
    return kernel.radius > blurKernels().largestDotRadius && longest <= kLongestRunningSide;
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
bool blurDownThenAcross(const BlurKernel& kernel, const BlurSource& source, const Window& window,
                        const FullColumns& full, bool inverted, Paint paint) {
    const auto run = [&](auto& blur) { blur.run(inverted, paint); };
    if (suitsRunningSums(kernel, source, window))
        return runIfThere(RunningDownThenAcross(kernel, source, window, full), run);
    return runIfThere(DownThenAcross(kernel, source, window, full), run);
}

/// Blurs the rows of the source's inverse first and then its columns, each pass rounding down, and
/// paints as above. What lies around the source is 255 in its inverse.
template <class Paint>
bool blurAcrossThenDown(const BlurKernel& kernel, const BlurSource& source, const Window& window,
                        Paint paint) {
    const auto run = [&](auto& blur) { blur.run(paint); };
    if (suitsRunningSums(kernel, source, window))
        return runIfThere(RunningAcrossThenDown(kernel, source, window), run);
    return runIfThere(AcrossThenDown(kernel, source, window), run);
}

}  // namespace VFontEffect::internal
