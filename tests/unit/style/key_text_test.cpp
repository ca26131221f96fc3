#include "style/key_text.h"

#include <gtest/gtest.h>
#include <voreleffect/VFEffect.h>

#include <memory>
#include <string>

namespace vorelstyle {
namespace {

using VFontEffect::VFEffect;
using VFontEffect::VFGradient;

std::vector<KeyFragment> fragmentsOf(VFEffect& effects) {
    const std::unique_ptr<char[]> key(effects.getMapKey());
    return keyFragments(key.get());
}

std::string onlyMeaning(VFEffect& effects) {
    const std::vector<KeyFragment> fragments = fragmentsOf(effects);
    EXPECT_EQ(fragments.size(), 1U);
    return fragments.front().meaning;
}

TEST(KeyText, EmptyKey_HasNoFragment) {
    EXPECT_TRUE(keyFragments("").empty());
}

TEST(KeyText, Fill_IsItsColourWord) {
    const std::vector<KeyFragment> fragments = keyFragments("T\x88\x80\x88\x80\x84\x80\x80\x80");
    ASSERT_EQ(fragments.size(), 1U);
    EXPECT_EQ(fragments[0].type, 12);
    EXPECT_EQ(fragments[0].letter, 'T');
    EXPECT_EQ(fragments[0].meaning, "colour #80804000");
}

TEST(KeyText, Shadow_TellsItsFourNumbers) {
    VFEffect effects;
    effects.addOuterShadowText(-30.7F, 150, 7, 0xFF8000, 0.5F);
    EXPECT_EQ(onlyMeaning(effects), "angle 330, distance 100, size 7, colour #80804000");
}

TEST(KeyText, Stroke_TellsItsPosition) {
    for (const auto& [position, word] :
         {std::pair(0, "centred"), std::pair(1, "outside"), std::pair(2, "inside")}) {
        VFEffect effects;
        effects.addStrokeText(3, 0x102030, 1, 5, position);
        EXPECT_EQ(onlyMeaning(effects), std::string("size 3, colour #FF102030, style 5, ") + word);
    }
}

TEST(KeyText, Glow_TellsItsStopsInHundredths) {
    VFGradient stops[] = {{0x0000FF, 1, 0.25F}, {0x00FF00, 0.5F, 1}};
    VFEffect effects;
    effects.addOuterGlowText(9, 0xABCDEF, 1, 2, stops);
    EXPECT_EQ(onlyMeaning(effects), "size 9, colour #FFABCDEF, #FF0000FF at 25%, #8000FF00 at 100%");
}

TEST(KeyText, Gradient_TellsItsScaleInHundredths) {
    VFGradient stops[] = {{0x0000FF, 1, 0}};
    VFEffect effects;
    effects.addLinearGradientText(45, 0.5F, 1, 1, stops);
    EXPECT_EQ(onlyMeaning(effects), "angle 45, scale 50%, #FF0000FF at 0%");
}

TEST(KeyText, Fragments_StandInTheirOrderWithoutThePattern) {
    VFGradient stops[] = {{0x0000FF, 1, 0}};
    unsigned char pixel[] = {255, 1, 2, 3};
    VFontEffect::VFBitmap pattern(1, 1, pixel, 4);
    VFEffect effects;
    effects.addText(0, 1);
    effects.addRadialGradientText(1, 1, 1, stops);
    effects.addPatternText(&pattern, 1, 1);
    effects.addInnerGlowText(1, 0, 1, 0, nullptr);
    effects.addInnerShadowText(0, 0, 0, 0, 1);
    std::vector<int> types;
    for (const KeyFragment& fragment : fragmentsOf(effects))
        types.push_back(fragment.type);
    EXPECT_EQ(types, (std::vector<int>{12, 8, 4, 2}));
}

TEST(KeyText, Place_TellsOffsetsSpanAndFill) {
    const auto wordsOf = [](const Place& place) {
        const std::vector<KeyFragment> fragments = keyFragments(placeFragment(place));
        EXPECT_EQ(fragments.size(), 1U);
        EXPECT_EQ(fragments[0].type, 0);
        EXPECT_EQ(fragments[0].letter, 'P');
        EXPECT_EQ(fragments[0].name, "place");
        return fragments[0].meaning;
    };
    EXPECT_EQ(wordsOf({3, -2, Span::word, true}), "moved by 3, -2, by word");
    EXPECT_EQ(wordsOf({}), "not moved");
    EXPECT_EQ(wordsOf({0, 1, Span::block, true}), "moved by 0, 1");
    EXPECT_EQ(wordsOf({-1, 127, Span::line, false}), "moved by -1, 127, by line, not filled");
    EXPECT_EQ(wordsOf({32767, -32767, Span::glyph, true}), "moved by 32767, -32767, by glyph");
    EXPECT_EQ(wordsOf({128, -129, Span::block, false}), "moved by 128, -129, not filled");
}

TEST(KeyText, Place_IsOneLetterAndCharactersWithTheirTopBit) {
    // -2 of 2^20 is 2^20 - 2: 63, 127, 126 of seven bits each.
    EXPECT_EQ(placeFragment({1, -2, Span::word, false}), "P\xC0\x80\x81\xBF\xFF\xFE\x86");
    EXPECT_EQ(placeFragment({}), "P\xC0\x80\x80\xC0\x80\x80\x80");
}

TEST(KeyText, Places_AreEqualInAllOfTheirParts) {
    const Place place{1, 2, Span::line, true};
    EXPECT_EQ(place, (Place{1, 2, Span::line, true}));
    for (const Place& other : {Place{0, 2, Span::line, true}, Place{1, 0, Span::line, true},
                               Place{1, 2, Span::word, true}, Place{1, 2, Span::line, false}})
        EXPECT_NE(place, other);
}

TEST(KeyText, Names_AreThoseOfAStyleFile) {
    const std::vector<KeyFragment> fragments = keyFragments("K\x81T\x81?\x81P\x81");
    ASSERT_EQ(fragments.size(), 4U);
    EXPECT_EQ(fragments[0].name, "stroke");
    EXPECT_EQ(fragments[1].name, "text");
    EXPECT_EQ(fragments[2].name, "");
    EXPECT_EQ(fragments[3].name, "place") << "cut off";
}

TEST(KeyText, Hexadecimal_SpellsEveryByte) {
    EXPECT_EQ(hexadecimal(std::string_view("\x00\x0F\xF0Z", 4)), "000ff05a");
}

}  // namespace
}  // namespace vorelstyle
