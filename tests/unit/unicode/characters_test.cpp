#include "unicode/characters.h"

#include <gtest/gtest.h>

namespace vorelunicode {
namespace {

TEST(Characters, Ranges_HoldTheirEnds) {
    constexpr CodeRange kRanges[]{{3, 5}, {9, 9}};
    for (const uint32_t code : {3U, 4U, 5U, 9U})
        EXPECT_TRUE(isIn(code, kRanges)) << code;
    for (const uint32_t code : {0U, 2U, 6U, 8U, 10U})
        EXPECT_FALSE(isIn(code, kRanges)) << code;
}

TEST(Characters, DefaultIgnorable_ShowsNothing) {
    for (const uint32_t code :
         {0xADU, 0x200BU, 0x200DU, 0x200FU, 0x2060U, 0xFE00U, 0xFE0FU, 0xFEFFU, 0xE007FU})
        EXPECT_TRUE(isDefaultIgnorable(code)) << code;
    for (const uint32_t code : {0x20U, 0xACU, 0xAEU, 0x2010U, 0x3164U, 0xFE10U, 0xFFFCU, 0x1F3FBU})
        EXPECT_FALSE(isDefaultIgnorable(code)) << code;
}

TEST(Characters, Blank_SeparatesWords) {
    for (const uint32_t code : {0x9U, 0x20U, 0x1680U, 0x2000U, 0x200AU, 0x205FU, 0x3000U})
        EXPECT_TRUE(isBlank(code)) << code;
    for (const uint32_t code : {0xA0U, 0x2007U, 0x202FU, 0x200BU, 0x41U, 0x0U})
        EXPECT_FALSE(isBlank(code)) << "no line may end at it, or it has no width: " << code;
}

TEST(Characters, Pictures_AreSymbols) {
    for (uint32_t code = 0; code <= 0x10FFFF; ++code) {
        // The watch and its kin stand among technical signs, which are symbols as well.
        if (isPictureByDefault(code) || isRegionalIndicator(code) || isSkinTone(code)) {
            EXPECT_TRUE(isSymbol(code)) << code;
        }
    }
    EXPECT_TRUE(isPictureByDefault(0x1F600));
    EXPECT_FALSE(isPictureByDefault(0x2764)) << "the heart is black by default";
    EXPECT_FALSE(isPictureByDefault('1'));
}

}  // namespace
}  // namespace vorelunicode
