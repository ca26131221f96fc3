#include "style/colour.h"

#include <gtest/gtest.h>

namespace vorelstyle {
namespace {

TEST(Colour, SixDigitsOfEitherCase_AreRead) {
    EXPECT_EQ(parseColour("#000000"), 0x000000U);
    EXPECT_EQ(parseColour("#09aFfA"), 0x09AFFAU);
    EXPECT_EQ(parseColour("#FFFFFF"), 0xFFFFFFU);
}

TEST(Colour, ThreeDigits_AreEachTakenTwice) {
    EXPECT_EQ(parseColour("#000"), 0x000000U);
    EXPECT_EQ(parseColour("#fFf"), 0xFFFFFFU);
    EXPECT_EQ(parseColour("#F80"), 0xFF8800U);
    EXPECT_EQ(parseColour("#1a9"), 0x11AA99U);
}

TEST(Colour, OtherSpellings_AreRefused) {
    for (const char* text :
         {"",         "#",       "#F",      "#FF",     "#FFFF",   "#FFFFF",  "FFF",
          "#FFG",     "#-FF",    "#0x1",    "# FF",    "#FF ",    "FFFFFF",  "0xFFFFFF",
          "#FFFFFFF", "#FFFFFG", "#-FFFFF", "#0x1234", "# FFFFF", "#FFFFF ", "red"}) {
        EXPECT_FALSE(parseColour(text)) << text;
    }
}

}  // namespace
}  // namespace vorelstyle
