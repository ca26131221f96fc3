#include "plans.h"

#include <algorithm>
#include <cstddef>

#include "ops/blur/blur_plan.h"
#include "ops/dilate/dilation_plan.h"
#include "ops/ramp/ramp_loops.h"
#include "ops/tile/tile_plan.h"
#include "simd/level_table.h"
#include "tests/support/lanes_check.h"

namespace VFontEffect::internal {

VOREL_LEVEL_TABLE(VOREL_EACH_VECTOR_LEVEL, lanesCheck, LanesCheck, kLanesCheck)

}  // namespace VFontEffect::internal

namespace vorel_test {
namespace {

using namespace VFontEffect::internal;

/// Appends the rows' values as they are to be taken.
void append(const CoverageRows& rows, std::vector<uint8_t>& values) {
    for (int64_t y = 0; y < rows.height; ++y) {
        for (int64_t x = 0; x < rows.width; ++x) {
            const uint8_t value = rows.start[y * rows.stride + x];
            values.push_back(static_cast<uint8_t>(value ^ rows.invertMask));
        }
    }
}

template <class Blur>
std::vector<uint8_t> collected(Blur& blur, const Box& window, int64_t bandRows) {
    if (!blur) return {};
    std::vector<uint8_t> values;
    for (int64_t y = window.top; y < window.bottom; y += bandRows) {
        const BlurredRows band = blur.rows(y);
        const int64_t count = std::min(bandRows, window.bottom - y);
        append({band.values, band.stride, window.width(), count, kAsIs}, values);
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

std::vector<uint8_t> blurred(const BlurInput& input) {
    BlurPlan plan(chosenLevel(), input);
    if (!plan) return {};
    std::vector<uint8_t> values;
    forBands(plan, input.window, [&](const Box& band, const BlurredRows& rows) {
        append({rows.values, rows.stride, band.width(), band.height(), kAsIs}, values);
    });
    return values;
}

bool blursByDotsAlone() {
    constexpr int kLargestRadius = 256;
    return dotLoops(chosenLevel()).largestDotRadius >= kLargestRadius;
}

std::vector<uint8_t> dilated(const CoverageRows& source, const DiscShape& disc, const Box& part,
                             bool andInverse) {
    const Windows windows = Windows::oneOf(part);
    DilationPlan plan(chosenLevel(), {source, disc}, windows);
    CoverageRows inverse = source;
    inverse.invertMask ^= kInverse;
    DilationPlan other(chosenLevel(), {inverse, disc}, windows);
    if (!plan || !other) return {};
    plan.begin(part);
    other.begin(part);
    std::vector<uint8_t> values;
    for (int64_t y = part.top; y < part.bottom; y += plan.bandRows()) {
        const int64_t count = std::min(plan.bandRows(), part.bottom - y);
        append(andInverse ? plan.minRows(other, y, count) : plan.rows(y, count), values);
    }
    return values;
}

std::vector<uint8_t> grown(const GrowthInput& input) {
    GrowthPlan plan(chosenLevel(), input);
    if (!plan) return {};
    std::vector<uint8_t> values;
    append(plan.rows(-input.margin, input.source.height + 2 * input.margin), values);
    return values;
}

std::vector<uint32_t> tiled(const ColourView& pattern, float scale, float opacity, int64_t width,
                            int64_t height) {
    TilePlan plan(chosenLevel(), pattern, scale, opacity, width);
    if (!plan) return {};
    std::vector<uint32_t> pixels;
    for (int64_t y = 0; y < height; ++y) {
        const uint32_t* const row = plan.row(y);
        pixels.insert(pixels.end(), row, row + width);
    }
    return pixels;
}

std::vector<uint8_t> faded(std::vector<uint8_t> values, uint32_t alpha) {
    rampLoops(chosenLevel()).fade(values.data(), static_cast<int64_t>(values.size()), alpha);
    return values;
}

const char* wrongLanesOperation(uint64_t seed) {
    return lanesCheck(chosenLevel()).wrongOperation(seed);
}

void askForRowsOutOfOrder() {
    const uint8_t pixel = 255;
    const DiscShape disc(1.0F);
    const Box part = {0, 0, 1, 2};
    DilationPlan plan(chosenLevel(), {{&pixel, 1, 1, 1, kAsIs}, disc}, Windows::oneOf(part));
    plan.begin(part);
    plan.rows(1, 1);
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
