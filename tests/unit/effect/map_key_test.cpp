#include <gtest/gtest.h>
#include <voreleffect/VFEffect.h>

#include "tests/support/engine.h"

using namespace VFontEffect;
using namespace vorel_test;

namespace {

std::string keyWith(VFEffect& set, unsigned colour) {
    return takeKey(set.getMapKey(colour));
}

/// The letter and colour word of a text record.
std::string textFragment(unsigned colour) {
    std::string fragment = "T";
    for (int shift = 28; shift >= 0; shift -= 4)
        fragment += static_cast<char>(0x80U | (colour >> shift & 0xFU));
    return fragment;
}

void addStyle(VFEffect& set) {
    VFGradient stops[] = {{0x112233, 1, 0}, {0x445566, 0.5F, 1}};
    set.addOuterGlowText(4, 0x123456, 1, 2, stops);
    set.addStrokeText(2, 0xFFFFFF, 1, 0, 1);
    set.addLinearGradientText(45, 1, 1, 2, stops);
}

TEST(MapKey, EmptySet_IsEmpty) {
    VFEffect set;
    char* key = set.getMapKey();
    ASSERT_NE(key, nullptr);
    EXPECT_EQ(*key, 0);
    delete[] key;
}

TEST(MapKey, TextAlone_IsItsNineCharacters) {
    VFEffect set;
    set.addText(0x80FF8000, 0.5F);
    EXPECT_EQ(keyOf(set), "T\x88\x80\x88\x80\x84\x80\x80\x80");
    EXPECT_EQ(keyOf(set).size(), 9U);
}

TEST(MapKey, PatternAlone_IsEmpty) {
    VFEffect set;
    VFBitmap bitmap(2, 2, 4);
    set.addPatternText(&bitmap, 1, 1);
    EXPECT_EQ(keyOf(set), "");
}

TEST(MapKey, JoinsTheFragmentsInListOrder) {
    VFEffect set;
    set.addText(0xFF0000, 1);
    set.addStrokeText(7, 0x00FF00, 1, 3, 1);
    const std::string stroke = "K\x87\x8F\x8F\x80\x80\x8F\x8F\x80\x80\x83\x81";
    EXPECT_EQ(keyOf(set), textFragment(0xFFFF0000) + stroke);
    set.initEffect(4, 4);
    EXPECT_EQ(keyOf(set), textFragment(0xFFFF0000) + stroke);
    set.setTextOpacity(0.5F);
    set.initEffect(4, 4);
    EXPECT_EQ(keyOf(set), stroke + textFragment(0xFFFF0000));
}

TEST(MapKey, UnwrittenCharacters_LeaveNoGapAndNoTail) {
    VFEffect set;
    VFBitmap bitmap(2, 2, 4);
    VFGradient stops[] = {{0, 1, 0}, {0, 1, 0.5F}, {0, 1, 1}};
    set.addInnerGlowText(4, 0, 1, 3, stops);
    set.addPatternText(&bitmap, 1, 1);
    set.addText(0, 1);
    const std::string key = keyOf(set);
    EXPECT_EQ(key.size(), 37U + 9U);
    EXPECT_EQ(key.substr(37), textFragment(0xFF000000));
}

TEST(MapKey, Buffer_IsZeroToItsReservedEnd) {
    VFEffect set;
    VFBitmap bitmap(2, 2, 4);
    set.addText(0, 1);
    set.addPatternText(&bitmap, 1, 1);
    char* key = set.getMapKey();
    for (int i = 9; i <= 9 + 17; ++i)
        EXPECT_EQ(key[i], 0) << i;
    delete[] key;
}

TEST(MapKey, Buffers_AreTheCallers) {
    VFEffect set;
    set.addText(0x123456, 1);
    char* first = set.getMapKey();
    char* second = set.getMapKey();
    EXPECT_NE(first, second);
    set.addText(0, 1);
    EXPECT_EQ(takeKey(first), takeKey(second));
}

TEST(MapKey, WithColour_CreatesTheTextOnceAndKeepsTheKey) {
    VFEffect set;
    EXPECT_EQ(keyWith(set, 0xFF000000), textFragment(0xFF000000));
    ASSERT_NE(set.getEffect(kText), nullptr);
    EXPECT_EQ(set.getEffect(kText)->getId(), 0);
    EXPECT_EQ(keyWith(set, 0xFF000000), textFragment(0xFF000000));
    EXPECT_EQ(effectsOf(set).size(), 1U);
    EXPECT_EQ(textColorOf(set), 0xFF000000U);
    EXPECT_EQ(set.getNewEffectId(), 1);
}

TEST(MapKey, WithColour_UsesTheTextOpacityAndIgnoresTheCallersAlpha) {
    VFEffect set;
    EXPECT_EQ(keyWith(set, 0x12FF8000), textFragment(0xFFFF8000));
    EXPECT_EQ(textAlphaOf(set), 0x12);
    EXPECT_EQ(textColorOf(set), 0x12FF8000U);
    EXPECT_EQ(keyWith(set, 0xFEFF8000), textFragment(0xFFFF8000));
    set.setTextOpacity(0.5F);
    EXPECT_EQ(keyWith(set, 0x12FF8000), textFragment(0x80804000));
    EXPECT_EQ(set.getEffect(kText)->getProperty()->mOpacity, 0.5F);
    set.setTextOpacity(0);
    EXPECT_EQ(keyWith(set, 0x12FF8000), textFragment(0));
}

TEST(MapKey, TranslucentFills_ShareAKeyWhicheverOpacityMakesThem) {
    VFEffect knockedOut;
    knockedOut.setTextOpacity(0.5F);
    VFEffect letThrough;
    letThrough.addText(0xFF8000, 0.5F);
    EXPECT_EQ(keyWith(knockedOut, 0xFF8000), textFragment(0x80804000));
    EXPECT_EQ(keyOf(letThrough), textFragment(0x80804000));
}

TEST(MapKey, WithColour_ReArmsTheOrderAndWithoutItDoesNot) {
    VFEffect set;
    set.addOuterShadowText(0, 1, 1, 0, 1);
    set.addStrokeText(1, 0, 1, 0, 1);
    delete[] set.getMapKey(0);
    ASSERT_EQ(planAndOrder(set), "TKS");
    delete[] set.getMapKey();
    EXPECT_EQ(planAndOrder(set), "TKS");
    delete[] set.getMapKey(0);
    EXPECT_EQ(planAndOrder(set), "TSK");
}

TEST(MapKey, EqualCallsInEqualOrder_GiveEqualKeys) {
    VFEffect first;
    VFEffect second;
    addStyle(first);
    addStyle(second);
    EXPECT_EQ(keyWith(first, 0x3366CC), keyWith(second, 0x3366CC));
    first.initEffect(4, 4);
    second.initEffect(40, 40);
    EXPECT_EQ(keyOf(first), keyOf(second));
}

TEST(MapKey, Planning_ChangesTheKeyAndASecondPlanningRestoresIt) {
    VFEffect set;
    set.addOuterShadowText(0, 1, 1, 0, 1);
    set.addStrokeText(1, 0, 1, 0, 1);
    const std::string added = keyOf(set);
    set.initEffect(4, 4);
    EXPECT_NE(keyOf(set), added);
    set.addStrokeText(1, 0, 1, 0, 1);
    set.initEffect(4, 4);
    EXPECT_EQ(keyOf(set), added);
}

TEST(MapKey, DifferentNumbers_GiveDifferentKeys) {
    VFEffect base;
    addStyle(base);
    VFEffect size;
    addStyle(size);
    size.addStrokeText(3, 0xFFFFFF, 1, 0, 1);
    VFEffect style;
    addStyle(style);
    style.addStrokeText(2, 0xFFFFFF, 1, 1, 1);
    EXPECT_NE(keyOf(size), keyOf(base));
    EXPECT_NE(keyOf(style), keyOf(base));
    EXPECT_NE(keyOf(size), keyOf(style));
}

/// An add-call puts the opacities into the colours, which are in the key.
TEST(MapKey, OpacitiesOfAddCalls_AreInIt) {
    const auto keyOfRamp = [](float opacity, float ofStop) {
        VFEffect set;
        VFGradient stops[] = {{0xFF0000, ofStop, 0}, {0x0000FF, 1, 1}};
        set.addLinearGradientText(0, 1, opacity, 2, stops);
        return keyOf(set);
    };
    EXPECT_NE(keyOfRamp(1, 1), keyOfRamp(0.5F, 1));
    EXPECT_NE(keyOfRamp(1, 1), keyOfRamp(1, 0.5F));
}

/// Twice cut to hundredths: once by the add-call, once on the way into the key.
TEST(MapKey, TwoPlacesOfStops_AreToldAHundredthLess) {
    const auto keyOfStop = [](float place) {
        VFEffect set;
        VFGradient stop = {0xFF0000, 1, place};
        set.addLinearGradientText(0, 1, 1, 1, &stop);
        return keyOf(set);
    };
    for (int hundredth = 1; hundredth <= 100; ++hundredth) {
        // In the middle, where the first cut is of no doubt.
        const float place = (static_cast<float>(hundredth) + 0.5F) / 100;
        const bool isTheSame = hundredth == 53 || hundredth == 59;
        EXPECT_EQ(keyOfStop(place) == keyOfStop(place - 0.01F), isTheSame && hundredth < 100)
            << hundredth;
    }
}

TEST(MapKey, CoresWithoutRecords_LeaveNoTrace) {
    VFEffect set;
    for (const int type : kCoreTypes)
        set.addEffect(type, nullptr);
    EXPECT_EQ(keyOf(set), "");
    EXPECT_EQ(keyWith(set, 0), textFragment(0xFF000000));
}

TEST(MapKey, RecordsWithCountsThatHoldNoStops_Survive) {
    VFGradient stop = {0, 1, 0};
    VFOuterGlowProperty negative(1, 0, 1, -100, &stop);
    VFLinearGradientProperty missing(0, 1, 1, 100, nullptr);
    VFEffect set;
    set.addEffect(kOuterGlow, &negative);
    set.addEffect(kLinearGradient, &missing);
    set.addText(0, 1);
    EXPECT_EQ(orderOf(set), "GLT");
    EXPECT_EQ(keyOf(set).size(), 10U + 5U + 9U);
}

TEST(MapKey, CountsOutOfAllProportion_GiveNoKey) {
    VFOuterGlowProperty claim(1, 0, 1, INT32_MAX, nullptr);
    VFEffect set;
    set.addEffect(kOuterGlow, &claim);
    EXPECT_EQ(set.getMapKey(), nullptr);

    claim.mGradientCount = 1000;
    set.addEffect(kOuterGlow, &claim);
    EXPECT_EQ(keyOf(set).size(), 10U);

    // 10 bytes and 10 a stop: the last key below 2^28 bytes, and the first above.
    claim.mGradientCount = 26843544;
    set.addEffect(kOuterGlow, &claim);
    EXPECT_EQ(keyOf(set).size(), 10U);
    ++claim.mGradientCount;
    set.addEffect(kOuterGlow, &claim);
    EXPECT_EQ(set.getMapKey(), nullptr);
}

/// A record that claims any length and writes one character.
class LongRecord : public VFProperty {
  public:
    explicit LongRecord(int length) : VFProperty(0, 1), mLength(length) {}
    int getSequentialCharLength() override { return mLength; }
    bool toSequentialChar(char** cursor) override {
        *(*cursor)++ = 'X';
        return true;
    }

  private:
    int mLength;
};

TEST(MapKey, LengthsWhoseSumNeedsMoreThan32Bits_GiveNoKey) {
    LongRecord half(INT32_MAX);
    LongRecord rest(2 + 8);  // 2^32 + 8 in all
    VFEffect set;
    insertCore(set, kOuterGlow, &half);
    insertCore(set, kInnerGlow, &half);
    insertCore(set, kStroke, &rest);
    EXPECT_EQ(set.getMapKey(), nullptr);
}

TEST(MapKey, LongestKey_Has2To28Bytes) {
    constexpr int kLongest = 1 << 28;
    LongRecord within(kLongest - 9);
    LongRecord beyond(kLongest - 8);
    VFEffect set;
    set.addText(0, 1);
    insertCore(set, kOuterGlow, &within);
    EXPECT_EQ(keyOf(set).size(), 10U);
    insertCore(set, kInnerGlow, &beyond);
    EXPECT_EQ(set.getMapKey(), nullptr);
    VFEffect other;
    other.addText(0, 1);
    insertCore(other, kOuterGlow, &beyond);
    EXPECT_EQ(other.getMapKey(), nullptr);
}

}  // namespace
