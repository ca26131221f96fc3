#include "text/decimal.h"

#include <gtest/gtest.h>

namespace voreltext {
namespace {

TEST(Decimal, Numbers_AreShort) {
    EXPECT_EQ(decimal(0), "0");
    EXPECT_EQ(decimal(900), "900");
    EXPECT_EQ(decimal(-0.5), "-0.5");
    EXPECT_EQ(decimal(12345.678), "12345.7");
}

}  // namespace
}  // namespace voreltext
