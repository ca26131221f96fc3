#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "tests/support/blurs.h"
#include "tests/support/core_compare.h"
#include "tests/support/mask_gallery.h"

/// The blur by running sums against the one by dot products, whichever of the two a level chooses, and
/// the terms that it adds up against the kernel's differences.
namespace {

using namespace vorel_test;
using literal::Mask;
using VFontEffect::internal::BlurSource;
using VFontEffect::internal::BlurWeights;
using VFontEffect::internal::Box;
using VFontEffect::internal::FullColumns;
using VFontEffect::internal::glowWeights;
using VFontEffect::internal::kNoFullColumns;
using VFontEffect::internal::shadowWeights;

// The largest glow has a radius of 231.
constexpr int kLargestShadow = 256;
constexpr int kLargestGlow = 231;

// --- Terms ------------------------------------------------------------------------------------------

/// What the taps from distance -radius - order on weigh in a difference of the order: the binomials of
/// 1 - z, times the weights.
std::vector<int64_t> definedDifference(const BlurWeights& kernel, int order) {
    const std::vector<int64_t> binomials =
        order == 2 ? std::vector<int64_t>{1, -2, 1} : std::vector<int64_t>{1, -3, 3, -1};
    std::vector<int64_t> difference;
    for (int k = -kernel.radius - order; k <= kernel.radius; ++k) {
        int64_t sum = 0;
        for (size_t i = 0; i < binomials.size(); ++i) {
            const int distance = std::abs(k + static_cast<int>(i));
            if (distance <= kernel.radius) sum += binomials[i] * kernel.weights.data()[distance];
        }
        difference.push_back(sum);
    }
    return difference;
}

void expectTermsOf(const BlurWeights& kernel) {
    SCOPED_TRACE(kernel.radius);
    const TermsOfKernel split = termsOf(kernel);
    ASSERT_TRUE(split.order == 2 || split.order == 3);
    std::vector<int64_t> sum(static_cast<size_t>(2 * kernel.radius + 1 + split.order), 0);
    for (const Term& term : split.terms) {
        const auto cell = static_cast<size_t>(term.row + kernel.radius + split.order);
        sum.at(cell) += term.sign;
        if (!term.isPair) continue;
        sum.at(cell + static_cast<size_t>(split.pairDistance)) +=
            split.pairsAreDifferences ? -term.sign : term.sign;
    }
    EXPECT_EQ(sum, definedDifference(kernel, split.order));
    for (size_t i = 1; i < split.terms.size(); ++i) {
        if (split.terms[i].sign != split.terms[i - 1].sign) continue;
        EXPECT_LE(split.terms[i - 1].row, split.terms[i].row);
    }
}

TEST(RunningBlur, TermsOfEveryKernel_AscendAndAddUpToItsDifference) {
    for (int radius = 0; radius <= kLargestShadow; ++radius)
        expectTermsOf(shadowWeights(radius));
    for (int radius = 0; radius <= kLargestGlow; ++radius)
        expectTermsOf(glowWeights(radius));
}

TEST(RunningBlur, TermsOfWideKernels_AreFarFewerThanTheTaps) {
    for (int radius = 13; radius <= 100; ++radius) {
        const size_t most = radius <= 40 ? 40 : 66;
        EXPECT_LE(termsOf(shadowWeights(radius)).terms.size(), most) << radius;
        EXPECT_LE(termsOf(glowWeights(radius)).terms.size(), most) << radius;
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

/// What a case says when it fails.
std::string describe(const BlurCase& blur) {
    std::ostringstream text;
    text << blur.source.width << " x " << blur.source.height << ", radius " << blur.kernel.radius
         << ", window " << blur.window.left << " " << blur.window.top << " " << blur.window.right << " "
         << blur.window.bottom << ", full before " << blur.full.before << " and from " << blur.full.from
         << ", centre " << blur.kernel.weights.data()[0] << ", flip " << int{blur.source.invertMask}
         << ", inverted " << blur.inverted;
    return text.str();
}

void expectBothMethodsTheSame(const BlurCase& blur) {
    const std::vector<uint8_t> expected = blurredByDots(blur);
    ASSERT_FALSE(expected.empty());
    ASSERT_EQ(blurredByRunningSums(blur), expected) << describe(blur);
    const std::vector<uint8_t> inverse = inverseBlurredByDots(blur);
    ASSERT_FALSE(inverse.empty());
    ASSERT_EQ(inverseBlurredByRunningSums(blur), inverse) << describe(blur);
}

/// Near one of two columns, or anywhere between them.
int64_t nearEither(Random& random, int64_t a, int64_t b) {
    if (random.chance(40)) return random.between(static_cast<int>(a), static_cast<int>(b));
    return (random.chance(50) ? a : b) + random.between(-2, 2);
}

void expectBothMethodsTheSame(Random& random, int radius) {
    const bool glow = radius <= kLargestGlow && random.chance(50);
    const BlurWeights kernel = glow ? glowWeights(radius) : shadowWeights(radius);
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
    const auto flip = static_cast<uint8_t>(random.chance(50) ? 0 : 0xFF);
    expectBothMethodsTheSame({kernel,
                              {mask.bytes.data(), stride, width, height, flip},
                              {left, top, right, bottom},
                              full,
                              random.chance(50)});
}

TEST(RunningBlur, OfEveryRadius_IsTheOneByDotProducts) {
    for (int radius = 0; radius <= kLargestShadow; ++radius) {
        forSeeds(static_cast<uint64_t>(radius) * 100, radius <= 100 ? 10 : 4,
                 [&](Random& random) { expectBothMethodsTheSame(random, radius); });
        if (HasFatalFailure()) return;
    }
}

TEST(RunningBlur, OfSidesLongerThanTheKernel_ReachesTheLargestDifferences) {
    for (const int radius : {13, 100, 150, 256}) {
        const BlurWeights kernel = shadowWeights(radius);
        const BlurWeights glow = glowWeights(std::min(radius, kLargestGlow));
        const int length = 2 * radius + 60;
        for (const bool wide : {true, false}) {
            const int width = wide ? length : 5;
            const int height = wide ? 5 : length;
            const Mask mask = filledMask(width, height, 255);
            const Box window = {-radius, -radius, width + radius, height + radius};
            const BlurSource source = {mask.bytes.data(), width, width, height, 0};
            expectBothMethodsTheSame({kernel, source, window, kNoFullColumns, false});
            expectBothMethodsTheSame({glow, source, window, kNoFullColumns, true});
            if (HasFatalFailure()) return;
        }
    }
}

}  // namespace
