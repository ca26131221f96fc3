#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/mask_gallery.h"
#include "tests/support/plans.h"

/// The blur by differences of the weights against the one by dot products, whichever of the two a level
/// chooses, and the terms that it adds up against those differences.
namespace {

using namespace vorel_test;
using literal::Mask;
using VFontEffect::internal::BlurInput;
using VFontEffect::internal::BlurWeights;
using VFontEffect::internal::Box;
using VFontEffect::internal::CoverageRows;
using VFontEffect::internal::FullColumns;
using VFontEffect::internal::gaussianOf100;
using VFontEffect::internal::gaussianOf128;
using VFontEffect::internal::kNoFullColumns;

// The largest glow has a radius of 231.
constexpr int kLargestShadow = 256;
constexpr int kLargestGlow = 231;

// --- Terms ------------------------------------------------------------------------------------------

/// What the taps from distance -radius - 2 on weigh in the second difference: (1 - z)^2 times the
/// weights.
std::vector<int64_t> secondDifference(const BlurWeights& weights) {
    const int64_t binomials[] = {1, -2, 1};
    std::vector<int64_t> difference;
    for (int k = -weights.radius - 2; k <= weights.radius; ++k) {
        int64_t sum = 0;
        for (int i = 0; i < 3; ++i) {
            const int distance = std::abs(k + i);
            if (distance <= weights.radius) sum += binomials[i] * weights.byDistance[distance];
        }
        difference.push_back(sum);
    }
    return difference;
}

void expectTermsOf(const BlurWeights& weights) {
    SCOPED_TRACE(weights.radius);
    const TermsOfWeights split = termsOf(weights);
    ASSERT_NE(split.pairDistance, 0);
    std::vector<int64_t> sum(static_cast<size_t>(2 * weights.radius + 3), 0);
    for (const Term& term : split.terms) {
        const auto cell = static_cast<size_t>(term.row + weights.radius + 2);
        sum.at(cell) += term.sign;
        if (!term.isPair) continue;
        sum.at(cell + static_cast<size_t>(split.pairDistance)) +=
            split.pairsAreDifferences ? -term.sign : term.sign;
    }
    EXPECT_EQ(sum, secondDifference(weights));
    for (size_t i = 1; i < split.terms.size(); ++i) {
        if (split.terms[i].sign != split.terms[i - 1].sign) continue;
        EXPECT_LE(split.terms[i - 1].row, split.terms[i].row);
    }
}

TEST(DifferenceBlur, TermsOfEveryRadius_AscendAndAddUpToTheSecondDifference) {
    for (int radius = 0; radius <= kLargestShadow; ++radius)
        expectTermsOf(gaussianOf100(radius));
    for (int radius = 0; radius <= kLargestGlow; ++radius)
        expectTermsOf(gaussianOf128(radius));
}

TEST(DifferenceBlur, TermsOfWideBlurs_AreFarFewerThanTheTaps) {
    for (int radius = 16; radius <= 100; ++radius) {
        const size_t most = radius <= 40 ? 40 : 66;
        EXPECT_LE(termsOf(gaussianOf100(radius)).terms.size(), most) << radius;
        EXPECT_LE(termsOf(gaussianOf128(radius)).terms.size(), most) << radius;
    }
}

// --- Blurs ------------------------------------------------------------------------------------------

/// Mostly from `first` to `end`, else from a place before that to one behind it.
std::pair<int, int> randomRange(Random& random, int first, int end) {
    if (random.chance(50)) return {first, end};
    const int from = random.between(first - 9, end - 1);
    return {from, random.between(from + 1, end + 9)};
}

Mask maskWithEmptyEdges(Random& random, int width, int height) {
    Mask mask = randomMask(random, width, height);
    const int top = random.between(0, height);
    const int bottom = random.between(0, height);
    for (int y = 0; y < height; ++y) {
        const auto row = mask.bytes.begin() + static_cast<ptrdiff_t>(y) * width;
        if (y < top || y >= bottom) std::fill_n(row, random.between(0, width), uint8_t{0});
    }
    return mask;
}

/// A blur in either order; `full` and `inverted` are for the first.
struct BlurCase {
    const BlurWeights& weights;
    CoverageRows source;
    Box window;
    FullColumns full;
    bool inverted;
    WindowSize windows;
};

/// What a case says when it fails.
std::string describe(const BlurCase& blur) {
    std::ostringstream text;
    text << blur.source.width << " x " << blur.source.height << ", radius " << blur.weights.radius
         << ", window " << blur.window.left << " " << blur.window.top << " " << blur.window.right << " "
         << blur.window.bottom << ", full before " << blur.full.before << " and from " << blur.full.from
         << ", centre " << blur.weights.byDistance[0] << ", mask " << int{blur.source.invertMask}
         << ", inverted " << blur.inverted << ", windows " << blur.windows.width << " x "
         << blur.windows.height;
    return text.str();
}

bool fitsIn16Bits(const BlurWeights& weights) {
    return weights.radius >= 1 && weights.radius <= 3 && weights.total <= 255;
}

void expectAllTheSame(const BlurCase& blur) {
    const auto expectSame = [&blur](const BlurInput& input) {
        const std::vector<uint8_t> expected = blurredByDots(input);
        ASSERT_FALSE(expected.empty());
        ASSERT_EQ(blurredByDots(input, blur.windows), expected) << describe(blur);
        ASSERT_EQ(blurredByDifferences(input, blur.windows), expected) << describe(blur);
        if (fitsIn16Bits(blur.weights)) {
            ASSERT_EQ(blurredIn16Bits(input, blur.windows), expected) << describe(blur);
        }
        ASSERT_EQ(blurred(input), expected) << describe(blur);
    };
    expectSame(BlurInput::down(blur.weights, blur.source, blur.window, blur.full, blur.inverted));
    expectSame(BlurInput::inverseAcross(blur.weights, blur.source, blur.window));
}

/// Near one of two columns, or anywhere between them if they are in order.
int64_t nearEither(Random& random, int64_t a, int64_t b) {
    if (random.chance(40) && a <= b) return random.between(static_cast<int>(a), static_cast<int>(b));
    return (random.chance(50) ? a : b) + random.between(-2, 2);
}

void expectAllTheSame(Random& random, int radius) {
    const bool glow = radius <= kLargestGlow && random.chance(50);
    const BlurWeights weights = glow ? gaussianOf128(radius) : gaussianOf100(radius);
    const int stride = random.between(1, 150);
    const int width = random.chance(50) ? stride : random.between(1, stride);
    const int height = random.between(1, 90);
    const Mask mask =
        random.chance(10) ? filledMask(stride, height, 255) : maskWithEmptyEdges(random, stride, height);
    const auto [left, right] = randomRange(random, -radius, width + radius);
    const auto [top, bottom] = randomRange(random, -radius, height + radius);
    // Columns at and around the ends of what the window's taps reach, and those of the mask.
    FullColumns full = kNoFullColumns;
    if (random.chance(30)) full.before = nearEither(random, left - radius, width);
    if (random.chance(30)) full.from = nearEither(random, 0, right + radius);
    const auto invertMask = static_cast<uint8_t>(random.chance(50) ? 0 : 0xFF);
    const WindowSize windows = {random.between(1, 150), random.between(1, 90)};
    expectAllTheSame({weights,
                      {mask.bytes.data(), stride, width, height, invertMask},
                      {left, top, right, bottom},
                      full,
                      random.chance(50),
                      random.chance(50) ? windows : WindowSize{}});
}

TEST(DifferenceBlur, OfEveryRadius_IsTheOneByDotProducts) {
    for (int radius = 0; radius <= kLargestShadow; radius += kThinned) {
        forSeeds(static_cast<uint64_t>(radius) * 100, radius <= 100 ? 6 : 1,
                 [&](Random& random) { expectAllTheSame(random, radius); });
        if (HasFatalFailure()) return;
    }
}

TEST(NarrowBlur, OfEveryRadius_IsTheOneByDotProducts) {
    for (int radius = 1; radius <= 3; ++radius) {
        forSeeds(static_cast<uint64_t>(radius) * 1000, 1000,
                 [&](Random& random) { expectAllTheSame(random, radius); });
        if (HasFatalFailure()) return;
    }
}

// The last of them reach full columns, but none of the source: they must not take more memory than
// others.
TEST(NarrowBlur, OfWindowsBesideTheSource_IsTheOneOfAll) {
    const Mask mask = filledMask(150, 5, 255);
    const CoverageRows source = {mask.bytes.data(), 150, 150, 5, 0};
    for (const int radius : {1, 2, 3, 8, 30}) {
        const BlurWeights weights = gaussianOf100(radius);
        expectAllTheSame({weights, source, {0, 0, 159, 5}, {kNoFullColumns.before, 155}, false, {1, 5}});
        if (HasFatalFailure()) return;
    }
}

TEST(DifferenceBlur, OfSidesLongerThanTheBlur_ReachesTheLargestDifferences) {
    for (const int radius : {13, 100, 150, 256}) {
        const BlurWeights shadow = gaussianOf100(radius);
        const BlurWeights glow = gaussianOf128(std::min(radius, kLargestGlow));
        const int length = 2 * radius + 60;
        for (const bool wide : {true, false}) {
            const int width = wide ? length : 5;
            const int height = wide ? 5 : length;
            const Mask mask = filledMask(width, height, 255);
            const Box window = {-radius, -radius, width + radius, height + radius};
            const CoverageRows source = {mask.bytes.data(), width, width, height, 0};
            expectAllTheSame({shadow, source, window, kNoFullColumns, false, {}});
            expectAllTheSame({glow, source, window, kNoFullColumns, true, {70, 70}});
            if (HasFatalFailure()) return;
        }
    }
}

}  // namespace
