#include "style/look.h"

#include <gtest/gtest.h>

#include <string>

#include "style/error.h"

namespace vorelstyle {
namespace {

LookStyle lookOf(const std::string& json) {
    return parseStyle(json).looks.front();
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
    EXPECT_EQ(Look(lookOf("{}"), 0x123456, 1).key(), "T" + keyWord(0xFF123456));
}

TEST(Look, TextOpacity_EntersTheKeyPremultiplied) {
    // Half opacity is alpha 128, and (128 * (0xFF + 1)) >> 8 = 0x80.
    EXPECT_EQ(Look(lookOf("{}"), 0xFF0000, 0.5F).key(), "T" + keyWord(0x80800000));
}

TEST(Look, TextFillOfTheStyle_KeepsItsPlaceAndTakesTheChosenColour) {
    const LookStyle style = lookOf(R"({"text": {"color": "#111111"},
                                    "stroke": {"size": 2, "color": "#0000FF", "position": "outside"}})");
    const std::string stroke = "K\x82" + keyWord(0xFF0000FF) + "\x80\x81";
    EXPECT_EQ(Look(style, 0x00FF00, 1).key(), "T" + keyWord(0xFF00FF00) + stroke);
}

TEST(Look, OpacityOfTheFill_IsThatOfTheTextAndOfItsEffect) {
    EXPECT_EQ(Look(lookOf("{}"), 0, 0.5F).fillOpacity(), 0.5F);
    const LookStyle style = lookOf(R"({"text": {"color": "#000000", "opacity": 0.5}})");
    EXPECT_EQ(Look(style, 0, 1).fillOpacity(), 0.5F);
    EXPECT_EQ(Look(style, 0, 0.5F).fillOpacity(), 0.25F);
}

TEST(Look, FillWithoutAPlace_ComesLast) {
    const LookStyle style =
        lookOf(R"({"stroke": {"size": 2, "color": "#0000FF", "position": "outside"}})");
    EXPECT_EQ(Look(style, 0, 1).key().back(), '\x80');
    EXPECT_EQ(Look(style, 0, 1).key().find('T'), Look(style, 0, 1).key().size() - 9);
}

TEST(Look, EffectsWithoutACore_AreNamed) {
    const std::string relief =
        R"({"size": 1, "angle": 0, "altitude": 0, "highlightColor": "#000000", "shadowColor": "#000000"})";
    const Look look(lookOf(R"({"bevel": )" + relief + R"(, "emboss": )" + relief + "}"), 0, 1);
    EXPECT_EQ(look.unpainted(), (std::vector<std::string>{"bevel", "emboss"}));
}

/// The message with which a look with a pattern is refused whose pictures come from `load`.
std::string faultWith(const LoadImage& load) {
    try {
        const Look look(lookOf(R"({"pattern": {"image": "a.png"}})"), 0, 1, load);
        return "";
    } catch (const StyleError& error) {
        return error.what();
    }
}

TEST(Look, PatternFaults_NameTheKey) {
    const std::string where = "pattern.image: ";
    EXPECT_EQ(faultWith([](const std::string& image) -> PatternImage {
                  throw StyleError(image + " is torn");
              }),
              where + "a.png is torn");
    EXPECT_EQ(faultWith(nullptr), where + "there is nothing to load 'a.png' with");
}

TEST(Look, Lengths_AreThePixelsOfItsEffects) {
    const LookStyle look = lookOf(
        R"({"outerShadow": {"angle": 90, "distance": 6, "size": 7, "color": "#000000"},
            "innerGlow": {"size": 5, "color": "#FF0000"}})");
    const std::string angle = "\x80\xDA";  // 90 in two characters
    EXPECT_EQ(Look(look, 0, 1).key(), "S" + angle + "\x86\x87" + keyWord(0xFF000000) + "N\x85" +
                                          keyWord(0xFFFF0000) + "T" + keyWord(0xFF000000));
}

TEST(Look, LengthsThatAreNotResolved_AreRefused) {
    const LookStyle look = lookOf(R"({"version": 2, "outerGlow": {"size": "4%", "color": "#000000"}})");
    EXPECT_THROW(Look(look, 0, 1), StyleError);
}

TEST(Look, WidthOfATile_BecomesTheScaleOfItsPicture) {
    const LookStyle look = lookOf(R"({"version": 2, "pattern": {"image": "a.png", "width": 45}})");
    const auto load = [](const std::string&) { return PatternImage{4, 1, std::vector<uint8_t>(16)}; };
    const Look painted(look, 0, 1, load);
    VFontEffect::VFEffect effects(painted.effects());
    const auto* pattern = effects.getEffect(kPatternType);
    ASSERT_NE(pattern, nullptr);
    EXPECT_EQ(painted.notes(), std::vector<std::string>{
                                   "pattern.width: 45 pixels of a picture of 4 are a scale of 11.25, "
                                   "which is more than the library's 10; painted with 10"});
}

TEST(Look, PatternPictureOfAnotherSizeThanItsPixels_IsRefused) {
    const auto withPixels = [](int width, int height, size_t bytes) {
        return faultWith([=](const std::string&) {
            return PatternImage{width, height, std::vector<uint8_t>(bytes)};
        });
    };
    EXPECT_EQ(withPixels(2, 3, 24), "");
    for (const size_t bytes : {size_t{0}, size_t{20}, size_t{23}, size_t{25}, size_t{28}})
        EXPECT_NE(withPixels(2, 3, bytes), "") << bytes;
    EXPECT_NE(withPixels(-2, -3, 24), "");
}

}  // namespace
}  // namespace vorelstyle
