#include <gtest/gtest.h>

#include "cores/shadow_offset.h"
#include "ops/blur/blur_plan.h"
#include "tests/support/literal_cores.h"

/// Every integer that the library derives from a transcendental function, over its whole domain,
/// against the literal form, which asks the C library's double-precision functions.
namespace vorel_test {
namespace {

namespace internal = VFontEffect::internal;

constexpr int kLargestRadius = 256;

template <class Weights>
void expectWeights(const internal::BlurWeights& weights, const Weights& expected, int radius) {
    uint32_t total = 0;
    for (size_t i = 0; i < expected.size(); ++i) {
        ASSERT_EQ(weights.byDistance[i], static_cast<uint32_t>(expected[i])) << radius << " at " << i;
        total += static_cast<uint32_t>(expected[i]) * (i == 0 ? 1U : 2U);
    }
    EXPECT_EQ(weights.total, total);
}

TEST(Derivations, WeightsOfAllRadii_AreThoseOfTheCLibrary) {
    for (int radius = 0; radius <= kLargestRadius; ++radius) {
        expectWeights(internal::gaussianOf100(radius), literal::shadowWeights(radius), radius);
        expectWeights(internal::gaussianOf128(radius), literal::glowWeights(radius), radius);
    }
}

TEST(Derivations, OffsetsOfAllAnglesAndDistances_AreThoseOfTheCLibrary) {
    for (int degrees = -360; degrees <= 360; ++degrees) {
        for (int distance = 0; distance <= 100; ++distance) {
            const auto angle = static_cast<float>(degrees);
            const auto length = static_cast<float>(distance);
            const internal::ShadowOffset actual = internal::shadowOffset(angle, length);
            const literal::Offset expected = literal::shadowOffset(angle, length);
            ASSERT_EQ(actual.x, expected.x) << degrees << " " << distance;
            ASSERT_EQ(actual.y, expected.y) << degrees << " " << distance;
        }
    }
}

}  // namespace
}  // namespace vorel_test
