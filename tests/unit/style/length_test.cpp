#include "style/length.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cstdlib>
#include <string>

namespace vorelstyle {
namespace {

constexpr auto kPixels = Length::Unit::pixels;
constexpr auto kPercent = Length::Unit::percent;

TEST(Length, BothUnits_AreRead) {
    EXPECT_EQ(parseLength("4px"), (Length{4, kPixels}));
    EXPECT_EQ(parseLength("4%"), (Length{4, kPercent}));
    EXPECT_EQ(parseLength("0%"), (Length{0, kPercent}));
    EXPECT_EQ(parseLength("1000px"), (Length{1000, kPixels}));
}

TEST(Length, FractionsAndSigns_AreRead) {
    EXPECT_EQ(parseLength("0.125px"), (Length{0.125F, kPixels}));
    EXPECT_EQ(parseLength("12.5%"), (Length{12.5F, kPercent}));
    EXPECT_EQ(parseLength("-0.3%"), (Length{-0.3F, kPercent}));
    EXPECT_EQ(parseLength("100.000px"), (Length{100, kPixels}));
}

TEST(Length, NumbersPastEveryRange_AreReadAsTheyAre) {
    EXPECT_EQ(parseLength("99999999px"), (Length{1e8F, kPixels}));
    EXPECT_FALSE(parseLength(std::string(60, '9') + "px")) << "more than a float holds";
}

TEST(Length, OtherSpellings_AreRefused) {
    for (const char* text :
         {"",     "4",     "px",   "%",     "-px",  "4em",     "4pt",  "4p",    "4PX",
          "4 px", " 4px",  "4px ", "4px\n", "+4px", "--4px",   "04px", "00%",   "-01px",
          ".5px", "4.px",  "-.5%", "4.%",   "4,5%", "4.1234%", "1e9%", "1e1px", "0x4px",
          "inf%", "nanpx", "4%%",  "4px%",  "%4",   "4.5.5%"}) {
        EXPECT_FALSE(parseLength(text)) << text;
    }
}

TEST(Length, EveryLocale_ReadsThePoint) {
    if (std::getenv("LOCPATH") == nullptr) GTEST_SKIP() << "LOCPATH names no folder of locales";
    ASSERT_NE(std::setlocale(LC_ALL, "de_DE.UTF-8"), nullptr);
    const auto point = parseLength("2.5%");
    const auto comma = parseLength("2,5%");
    std::setlocale(LC_ALL, "C");
    EXPECT_EQ(point, (Length{2.5F, kPercent}));
    EXPECT_FALSE(comma);
}

}  // namespace
}  // namespace vorelstyle
