#pragma once

#include <cstdint>
#include <vector>

#include "ops/blur/blur_weights.h"
#include "ops/blur/reached_source.h"
#include "voreleffect/VFExport.h"

/// The two methods of the blur, each by itself: the library chooses one by the radius and the level.
namespace vorel_test {

struct BlurCase {
    const VFontEffect::internal::BlurWeights& kernel;
    VFontEffect::internal::BlurSource source;
    VFontEffect::internal::Box window;
    VFontEffect::internal::FullColumns full;
    bool inverted;
};

/// The window's values, row after row; none if rows come out of order or not at all.
VF_API std::vector<uint8_t> blurredByDots(const BlurCase& blur);
VF_API std::vector<uint8_t> blurredByRunningSums(const BlurCase& blur);

/// The same of the source's inverse across, then down; `full` and `inverted` are not for it.
VF_API std::vector<uint8_t> inverseBlurredByDots(const BlurCase& blur);
VF_API std::vector<uint8_t> inverseBlurredByRunningSums(const BlurCase& blur);

/// A line of taps or pairs that is added or taken away for a result.
struct Term {
    int64_t row;  // from the result's own on
    bool isPair;
    int sign;
};

/// How running sums take a difference of the kernel apart, each sign's terms as the library has them.
struct TermsOfKernel {
    int order;
    int pairDistance;
    bool pairsAreDifferences;
    std::vector<Term> terms;
};
VF_API TermsOfKernel termsOf(const VFontEffect::internal::BlurWeights& kernel);

}  // namespace vorel_test
