#pragma once

#include <cstdint>
#include <vector>

#include "ops/blur/blur_input.h"
#include "voreleffect/VFExport.h"

/// The two strategies of the blur, each by itself: the library chooses one by the radius and the level.
namespace vorel_test {

/// The window's values, row after row; none when memory ran out.
VF_API std::vector<uint8_t> blurredByDots(const VFontEffect::internal::BlurInput& input);
VF_API std::vector<uint8_t> blurredByDifferences(const VFontEffect::internal::BlurInput& input);

/// A line of taps or pairs that is added or taken away for a result.
struct Term {
    int64_t row;  // from the result's own on
    bool isPair;
    int sign;
};

/// How the second difference of the weights is taken apart, each sign's terms as the library has them.
struct TermsOfWeights {
    int pairDistance;
    bool pairsAreDifferences;
    std::vector<Term> terms;
};
VF_API TermsOfWeights termsOf(const VFontEffect::internal::BlurWeights& weights);

}  // namespace vorel_test
