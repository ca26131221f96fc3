#include "style/colour.h"

#include <gtest/gtest.h>

namespace vorelstyle {
namespace {

TEST(Colour, SixDigitsOfEitherCase_AreRead) {
    EXPECT_EQ(parseColour("#000000"), 0x000000U);
    EXPECT_EQ(parseColour("#09aFfA"), 0x09AFFAU);
    EXPECT_EQ(parseColour("#FFFFFF"), 0xFFFFFFU);
}

TEST(Colour, OtherSpellings_AreRefused) {
    for (const char* text : {"", "#", "#FFF", "FFFFFF", "0xFFFFFF", "#FFFFFFF", "#FFFFFG", "#-FFFFF",
                             "#0x1234", "# FFFFF", "#FFFFF ", "red"}) {
        EXPECT_FALSE(parseColour(text)) << text;
    }
}

}  // namespace
}  // namespace vorelstyle
