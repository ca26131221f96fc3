#include "unicode/decimal.h"

#include <gtest/gtest.h>

namespace vorelunicode {
namespace {

TEST(Decimal, Numbers_AreShort) {
    EXPECT_EQ(decimal(0), "0");
    EXPECT_EQ(decimal(900), "900");
    EXPECT_EQ(decimal(-0.5), "-0.5");
    EXPECT_EQ(decimal(12345.678), "12345.7");
    EXPECT_EQ(decimal(double{0.05F}), "0.05");
    EXPECT_EQ(decimal(2e7), "2e+07");
}

}  // namespace
}  // namespace vorelunicode
