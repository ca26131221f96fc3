#include "blurs.h"

#include <algorithm>
#include <cstddef>

#include "ops/blur/difference_blur.h"
#include "ops/blur/dot_blur.h"

namespace vorel_test {
namespace {

using namespace VFontEffect::internal;

/// Collects the rows that `run(blur, paint)` paints.
template <class Blur, class Run>
std::vector<uint8_t> collected(const BlurCase& which, Blur blur, Run run) {
    std::vector<uint8_t> values(static_cast<size_t>(which.window.width() * which.window.height()));
    if (!blur) return {};
    int64_t next = which.window.top;
    run(blur, [&](int64_t y, int64_t rows, const uint8_t* from, int64_t stride) {
        if (y != next) return;
        for (; next < y + rows; ++next) {
            const auto to = values.begin() + (next - which.window.top) * which.window.width();
            std::copy_n(from + (next - y) * stride, which.window.width(), to);
        }
    });
    return next == which.window.bottom ? values : std::vector<uint8_t>{};
}

template <class Blur>
std::vector<uint8_t> blurredBy(const BlurCase& which) {
    return collected(which, Blur(which.kernel, which.source, which.window, which.full),
                     [&](Blur& blur, auto paint) { blur.run(which.inverted, paint); });
}

template <class Blur>
std::vector<uint8_t> inverseBlurredBy(const BlurCase& which) {
    return collected(which, Blur(which.kernel, which.source, which.window),
                     [](Blur& blur, auto paint) { blur.run(paint); });
}

void append(const TermList& list, int sign, std::vector<Term>& terms) {
    const int64_t lineBytes = kDifferencePixelBytes * dotLoops().vectorBytes;
    const int64_t rowBytes = kLinesOfRow * lineBytes;
    for (int64_t i = 0; i < list.count; ++i) {
        const int64_t offset = list.offsets[i];
        const int64_t row = (offset < 0 ? offset - rowBytes + 1 : offset) / rowBytes;
        const int64_t line = offset - row * rowBytes;
        if (line != 0 && line != lineBytes) sign = 0;  // neither taps nor pairs: no term of any kernel
        terms.push_back({row, line != 0, sign});
    }
}

}  // namespace

std::vector<uint8_t> blurredByDots(const BlurCase& blur) {
    return blurredBy<DownThenAcross>(blur);
}

std::vector<uint8_t> blurredByRunningSums(const BlurCase& blur) {
    return blurredBy<DifferenceDownThenAcross>(blur);
}

std::vector<uint8_t> inverseBlurredByDots(const BlurCase& blur) {
    return inverseBlurredBy<AcrossThenDown>(blur);
}

std::vector<uint8_t> inverseBlurredByRunningSums(const BlurCase& blur) {
    return inverseBlurredBy<DifferenceAcrossThenDown>(blur);
}

TermsOfKernel termsOf(const BlurWeights& kernel) {
    const KernelTerms memory(kernel);
    if (!memory) return {};
    const DifferenceTerms& terms = *memory;
    TermsOfKernel result = {terms.order, terms.pairs.distance, terms.pairs.areDifferences, {}};
    append(terms.added, 1, result.terms);
    append(terms.takenAway, -1, result.terms);
    return result;
}

}  // namespace vorel_test
