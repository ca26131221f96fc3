#include "core/fixed_point.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>

#include "tests/support/literal_blend.h"

namespace {

using VFontEffect::internal::product;
namespace literal = vorel_test::literal;

TEST(FixedPoint, Product_IsTheShiftedProductForAllPairs) {
    for (int x = 0; x < 256; ++x) {
        for (int y = 0; y < 256; ++y) {
            const int expected = literal::product(x, y);
            ASSERT_EQ(product(x, y), expected) << x << ", " << y;
            ASSERT_EQ(product(static_cast<uint32_t>(x), static_cast<uint32_t>(y)),
                      static_cast<uint32_t>(expected))
                << x << ", " << y;
        }
    }
}

TEST(FixedPoint, Product_StaysWithinOneOfTheQuotientForAllPairs) {
    for (int x = 0; x < 256; ++x) {
        for (int y = 0; y < 256; ++y) {
            const double quotient = x * y / 255.0;
            ASSERT_LT(std::abs(product(x, y) - quotient), 1.0) << x << ", " << y;
        }
    }
}

TEST(FixedPoint, Product_IntermediateFitsSixteenBitsAndResultEight) {
    for (int x = 0; x < 256; ++x) {
        for (int y = 0; y < 256; ++y) {
            const auto wide = static_cast<uint16_t>((x + 1) * y);
            ASSERT_EQ(product(x, y), wide >> 8) << x << ", " << y;
            ASSERT_LE(product(x, y), 255) << x << ", " << y;
        }
    }
}

TEST(FixedPoint, Product_FullKeepsTheOtherSideAndEmptyGivesNothing) {
    for (int v = 0; v < 256; ++v) {
        EXPECT_EQ(product(255, v), v);
        EXPECT_EQ(product(v, 255), v);
        EXPECT_EQ(product(v, 0), 0);
        EXPECT_EQ(product(0, v), 0);
    }
}

TEST(FixedPoint, Product_NeverFallsWhenAnArgumentGrows) {
    for (int x = 0; x < 255; ++x) {
        for (int y = 0; y < 255; ++y) {
            ASSERT_LE(product(x, y), product(x + 1, y)) << x << ", " << y;
            ASSERT_LE(product(x, y), product(x, y + 1)) << x << ", " << y;
        }
    }
}

TEST(FixedPoint, Product_ArgumentOrderMatters) {
    // 1 * 128 / 255 is a little more than a half: one order makes it 1, the other 0.
    EXPECT_EQ(product(1, 128), 1);
    EXPECT_EQ(product(128, 1), 0);
}

}  // namespace
