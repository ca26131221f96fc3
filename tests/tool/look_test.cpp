#include "look.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

namespace vorelpaint {
namespace {

Style styleOf(const std::string& json) {
    return parseStyle(json, VORELPAINT_PRESETS);
}

/// A cache key's 8-character spelling of a colour word: one character a nibble, top bit set.
std::string keyWord(uint32_t word) {
    std::string text;
    for (int shift = 28; shift >= 0; shift -= 4) {
        text += static_cast<char>(0x80U | ((word >> shift) & 15U));
    }
    return text;
}

TEST(Look, PlainText_HasTheKeyOfItsFill) {
    EXPECT_EQ(Look(styleOf("{}"), 0x123456, 1).key(), "T" + keyWord(0xFF123456));
}

TEST(Look, TextOpacity_EntersTheKeyPremultiplied) {
    // Half opacity is alpha 128, and (128 * (0xFF + 1)) >> 8 = 0x80.
    EXPECT_EQ(Look(styleOf("{}"), 0xFF0000, 0.5F).key(), "T" + keyWord(0x80800000));
}

TEST(Look, TextFillOfTheStyle_KeepsItsPlaceAndTakesTheChosenColour) {
    const Style style = styleOf(R"({"text": {"color": "#111111"},
                                    "stroke": {"size": 2, "color": "#0000FF", "position": "outside"}})");
    const std::string stroke = "K\x82" + keyWord(0xFF0000FF) + "\x80\x81";
    EXPECT_EQ(Look(style, 0x00FF00, 1).key(), "T" + keyWord(0xFF00FF00) + stroke);
}

TEST(Look, FillWithoutAPlace_ComesLast) {
    const Style style = styleOf(R"({"stroke": {"size": 2, "color": "#0000FF", "position": "outside"}})");
    EXPECT_EQ(Look(style, 0, 1).key().back(), '\x80');
    EXPECT_EQ(Look(style, 0, 1).key().find('T'), Look(style, 0, 1).key().size() - 9);
}

TEST(Look, Margins_AreTheReachOfTheEffects) {
    Look shadow(
        styleOf(R"({"outerShadow": {"angle": 0, "distance": 10, "size": 10, "color": "#000000"}})"), 0,
        1);
    EXPECT_EQ(shadow.margins().left, 20);
    EXPECT_EQ(shadow.margins().top, 10);
    EXPECT_EQ(shadow.margins().right, 0);
    EXPECT_EQ(shadow.margins().bottom, 10);
}

TEST(Look, EffectsWithoutACore_AreNamed) {
    const std::string relief =
        R"({"size": 1, "angle": 0, "altitude": 0, "highlightColor": "#000000", "shadowColor": "#000000"})";
    const Look look(styleOf(R"({"bevel": )" + relief + R"(, "emboss": )" + relief + "}"), 0, 1);
    EXPECT_EQ(look.unpainted(), (std::vector<std::string>{"bevel", "emboss"}));
}

TEST(Look, PatternFaults_NameTheStyleFile) {
    Style style = styleOf(R"({"pattern": {"image": "none.png"}})");
    style.file = "looks/a.json";
    try {
        const Look look(style, 0, 1);
        FAIL() << "painted without its pattern";
    } catch (const StyleError& error) {
        EXPECT_EQ(std::string(error.what()).rfind("style 'looks/a.json': pattern.image: ", 0), 0U);
    }
}

TEST(Look, PatternThatCannotBeRead_IsAStyleError) {
    EXPECT_THROW(Look(styleOf(R"({"pattern": {"image": "none.png"}})"), 0, 1), StyleError);
    EXPECT_THROW(Look(styleOf(R"({"pattern": {"image": "."}})"), 0, 1), StyleError);
    EXPECT_THROW(Look(styleOf(R"({"pattern": {"image": "gold.json"}})"), 0, 1), StyleError);
}

}  // namespace
}  // namespace vorelpaint
