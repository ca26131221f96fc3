#include "text/text_settings.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "unit/text/test_font.h"

namespace voreltext {
namespace {

std::string faultOf(const TextSettings& settings) {
    return vorel_test::faultOf([&] { checkSettings(settings); });
}

TextSettings withLineHeight(float lineHeight) {
    TextSettings settings;
    settings.lineHeight = lineHeight;
    return settings;
}

TEST(TextSettings, Presets_AreAllowed) {
    EXPECT_EQ(faultOf({}), "");
}

TEST(TextSettings, LineHeight_HasARange) {
    EXPECT_EQ(faultOf(withLineHeight(0)), "");
    EXPECT_EQ(faultOf(withLineHeight(100)), "");
    EXPECT_EQ(faultOf(withLineHeight(100.5F)), "the line height is 100.5; it may be 0 to 100");
    EXPECT_EQ(faultOf(withLineHeight(-0.25F)), "the line height is -0.25; it may be 0 to 100");
    EXPECT_NE(faultOf(withLineHeight(std::nanf(""))), "");
    EXPECT_NE(faultOf(withLineHeight(std::numeric_limits<float>::infinity())), "");
}

TEST(TextSettings, LetterSpacing_HasARange) {
    TextSettings settings;
    for (const int64_t most : {-1048576, 1048576}) {
        settings.letterSpacing = most;
        EXPECT_EQ(faultOf(settings), "") << "16384 pixels";
        settings.letterSpacing = most + most / 1048576;
        EXPECT_EQ(faultOf(settings), "the letter spacing is " + std::to_string(settings.letterSpacing) +
                                         "; it may be -1048576 to 1048576 64ths of a pixel");
    }
    settings.letterSpacing = std::numeric_limits<int64_t>::min();
    EXPECT_NE(faultOf(settings), "");
}

TEST(TextSettings, WidthOfLines_IsNotNegative) {
    TextSettings settings;
    settings.wrapWidth = std::numeric_limits<int>::max();
    EXPECT_EQ(faultOf(settings), "");
    settings.wrapWidth = -1;
    EXPECT_EQ(faultOf(settings), "the width of lines is -1; it may be 0, for any, or more pixels");
}

}  // namespace
}  // namespace voreltext
