#include "blurs.h"

#include <algorithm>
#include <cstddef>

#include "ops/blur/difference_blur.h"
#include "ops/blur/dot_blur.h"

namespace vorel_test {
namespace {

using namespace VFontEffect::internal;

template <class Blur>
std::vector<uint8_t> collected(Blur& blur, const Box& window, int64_t bandRows) {
    if (!blur) return {};
    std::vector<uint8_t> values;
    for (int64_t y = window.top; y < window.bottom; y += bandRows) {
        const BlurredRows band = blur.rows(y);
        for (int64_t row = 0; row < std::min(bandRows, window.bottom - y); ++row) {
            const uint8_t* const from = band.values + row * band.stride;
            values.insert(values.end(), from, from + window.width());
        }
    }
    return values;
}

void append(const TermList& list, int sign, std::vector<Term>& terms) {
    const int64_t lineBytes = kLinePixelBytes * differenceLoops(chosenLevel()).vectorBytes;
    const int64_t rowBytes = kLinesOfRow * lineBytes;
    for (int64_t i = 0; i < list.count; ++i) {
        const int64_t offset = list.offsets[i];
        const int64_t row = (offset < 0 ? offset - rowBytes + 1 : offset) / rowBytes;
        const int64_t line = offset - row * rowBytes;
        if (line != 0 && line != lineBytes) sign = 0;  // neither taps nor pairs: no term of any weights
        terms.push_back({row, line != 0, sign});
    }
}

}  // namespace

std::vector<uint8_t> blurredByDots(const BlurInput& input) {
    DotBlur blur(dotLoops(chosenLevel()), input);
    return collected(blur, input.window, kQuad);
}

std::vector<uint8_t> blurredByDifferences(const BlurInput& input) {
    DifferenceBlur blur(differenceLoops(chosenLevel()), input);
    return collected(blur, input.window, blur.bandRows());
}

TermsOfWeights termsOf(const BlurWeights& weights) {
    const WeightTerms memory(differenceLoops(chosenLevel()), weights);
    if (!memory) return {};
    const DifferenceTerms& terms = *memory;
    TermsOfWeights result = {terms.pairs.distance, terms.pairs.areDifferences, {}};
    append(terms.added, 1, result.terms);
    append(terms.takenAway, -1, result.terms);
    return result;
}

}  // namespace vorel_test
