#include <gtest/gtest.h>
#include <voreleffect/VFProperty.h>

#include "tests/support/engine.h"

using namespace VFontEffect;
using namespace vorel_test;

namespace {

using Bytes = std::vector<uint8_t>;

constexpr uint8_t kUntouched = 0x5A;

/// The fragment that the record writes. Checks what every record promises: true, a zero byte after
/// the fragment that the cursor points at, no other byte written, and top bits set after the letter.
Bytes fragmentOf(VFProperty& record) {
    const auto reserved = static_cast<size_t>(record.getSequentialCharLength());
    std::vector<char> buffer(reserved + 8, static_cast<char>(kUntouched));
    char* cursor = buffer.data();
    EXPECT_TRUE(record.toSequentialChar(&cursor));
    const auto written = static_cast<size_t>(cursor - buffer.data());
    EXPECT_LE(written, reserved);
    const Bytes fragment(buffer.data(), buffer.data() + written);
    Bytes behind(buffer.size() - written, kUntouched);
    if (written > 0) behind[0] = 0;
    EXPECT_EQ(Bytes(buffer.data() + written, buffer.data() + buffer.size()), behind);
    for (size_t i = 1; i < written; ++i)
        EXPECT_GE(fragment[i], 0x80) << i;
    return fragment;
}

void expectFragment(VFProperty&& record, int reserved, const Bytes& fragment) {
    EXPECT_EQ(record.getSequentialCharLength(), reserved);
    EXPECT_EQ(fragmentOf(record), fragment);
}

const VFGradient kStops[] = {
    {0x12345678, 0.1F, 0.0F}, {0xFFFFFFFF, 0.2F, 0.5F}, {0x00000000, 0.3F, 1.0F}};

std::vector<VFGradient> threeStops() {
    return {std::begin(kStops), std::end(kStops)};
}

/// The three stops: each a word and the position times 100, of which 7 bits are kept.
const Bytes kThreeStops = {0x81, 0x82, 0x83, 0x84, 0x85, 0x86, 0x87, 0x88, 0x80,       //
                           0x8F, 0x8F, 0x8F, 0x8F, 0x8F, 0x8F, 0x8F, 0x8F, 0x80 | 50,  //
                           0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0x80 | 100};

Bytes operator+(Bytes left, const Bytes& right) {
    left.insert(left.end(), right.begin(), right.end());
    return left;
}

TEST(Encoding, Text_IsALetterAndAWord) {
    expectFragment(VFTextProperty(0x80804000, 0.5F), 9,
                   {'T', 0x88, 0x80, 0x88, 0x80, 0x84, 0x80, 0x80, 0x80});
    expectFragment(VFTextProperty(0xFEDCBA98, 0.5F), 9,
                   {'T', 0x8F, 0x8E, 0x8D, 0x8C, 0x8B, 0x8A, 0x89, 0x88});
}

TEST(Encoding, Shadows_AreAngleDistanceSizeAndColour) {
    const auto with = [](char letter) {
        return Bytes{static_cast<uint8_t>(letter),
                     0x82,
                     0xCA,  // 330 = 2 * 128 + 74
                     0xE4,
                     0x85,  // 100 and 5
                     0x88,
                     0x80,
                     0x81,
                     0x82,
                     0x83,
                     0x84,
                     0x85,
                     0x86};
    };
    expectFragment(VFOuterShadowProperty(330, 100, 5, 0x80123456, 0.5F), 13, with('S'));
    expectFragment(VFInnerShadowProperty(330, 100, 5, 0x80123456, 0.5F), 13, with('I'));
}

TEST(Encoding, Angle_IsBroughtInto0To359) {
    const std::pair<float, Bytes> angles[] = {
        {-30, {0x82, 0xCA}},        {330, {0x82, 0xCA}},
        {-30.7F, {0x82, 0xCA}},     {-390, {0x82, 0xCA}},
        {0, {0x80, 0x80}},          {-0.9F, {0x80, 0x80}},
        {720, {0x80, 0x80}},        {359.9F, {0x82, 0xE7}},
        {127, {0x80, 0xFF}},        {128, {0x81, 0x80}},
        {kNan, {0x80, 0x80}},       {kInfinity, {0x80, 0xFF}},  // 2147483647 leaves 127
        {-kInfinity, {0x81, 0xE8}},  // -2147483648 leaves -128, 232 = 128 + 104
    };
    for (const auto& [angle, bytes] : angles) {
        VFOuterShadowProperty record(angle, 0, 0, 0, 1);
        const Bytes fragment = fragmentOf(record);
        EXPECT_EQ(Bytes(fragment.begin() + 1, fragment.begin() + 3), bytes) << angle;
    }
}

TEST(Encoding, SmallNumbers_KeepSevenBitsOfTheWholePart) {
    const std::pair<float, uint8_t> sizes[] = {
        {0, 0x80},          {0.99F, 0x80}, {100, 0xE4},   {127.9F, 0xFF},
        {128, 0x80},        {200, 0xC8},   {-1, 0xFF},    {-0.5F, 0x80},
        {-128, 0x80},       {kNan, 0x80},  {-0.0F, 0x80}, {kInfinity, 0xFF},  // 0x7FFFFFFF
        {-kInfinity, 0x80}, {1e30F, 0xFF}};
    for (const auto& [size, byte] : sizes) {
        VFStrokeProperty stroke(size, 0, 1, 0, 0);
        EXPECT_EQ(fragmentOf(stroke)[1], byte) << size;
        VFInnerShadowProperty shadow(0, size, size, 0, 1);
        EXPECT_EQ(fragmentOf(shadow)[3], byte) << size;
        EXPECT_EQ(fragmentOf(shadow)[4], byte) << size;
        VFInnerGlowProperty glow(size, 0, 1, 0, nullptr);
        EXPECT_EQ(fragmentOf(glow)[1], byte) << size;
    }
}

TEST(Encoding, Stroke_IsSizeColourStyleAndPosition) {
    expectFragment(VFStrokeProperty(7.9F, 0xFF102030, 0.5F, 3, 1), 12,
                   {'K', 0x87, 0x8F, 0x8F, 0x81, 0x80, 0x82, 0x80, 0x83, 0x80, 0x83, 0x81});
    expectFragment(VFStrokeProperty(0, 0, 0.5F, -1, 130), 12,
                   {'K', 0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0xFF, 0x82});
}

TEST(Encoding, Glows_AreSizeColourAndStops) {
    const Bytes sizeAndColour = {0x8C, 0x88, 0x80, 0x81, 0x82, 0x83, 0x84, 0x85, 0x86};
    auto stops = threeStops();
    expectFragment(VFOuterGlowProperty(12, 0x80123456, 1, 3, stops.data()), 40,
                   Bytes{'G'} + sizeAndColour + kThreeStops);
    expectFragment(VFInnerGlowProperty(12, 0x80123456, 1, 3, stops.data()), 40,
                   Bytes{'N'} + sizeAndColour + kThreeStops);
    expectFragment(VFOuterGlowProperty(12, 0x80123456, 1, 0, stops.data()), 10,
                   Bytes{'G'} + sizeAndColour);
    expectFragment(VFInnerGlowProperty(12, 0x80123456, 1, 0, nullptr), 10, Bytes{'N'} + sizeAndColour);
}

TEST(Encoding, GlowOfThreeStops_WritesThreeCharactersLessThanItReserves) {
    auto stops = threeStops();
    VFOuterGlowProperty record(12, 0, 1, 3, stops.data());
    EXPECT_EQ(record.getSequentialCharLength(), 40);
    EXPECT_EQ(fragmentOf(record).size(), 37U);
}

TEST(Encoding, Gradients_AreAngleScaleAndStops) {
    const Bytes angleAndScale = {0x80, 0xDA, 0x8C, 0x88};  // 90; 200 = 0xC8
    auto stops = threeStops();
    expectFragment(VFLinearGradientProperty(90, 2, 0.5F, 3, stops.data()), 35,
                   Bytes{'L'} + angleAndScale + kThreeStops);
    expectFragment(VFRadialGradientProperty(90, 2, 0.5F, 3, stops.data()), 35,
                   Bytes{'D'} + angleAndScale + kThreeStops);
    expectFragment(VFLinearGradientProperty(90, 2, 0.5F, 0, stops.data()), 5,
                   Bytes{'L'} + angleAndScale);
    expectFragment(VFRadialGradientProperty(90, 2, 0.5F, 0, nullptr), 5, Bytes{'D'} + angleAndScale);
}

TEST(Encoding, ProductsWithHundred_AreTakenInSinglePrecision) {
    // 0.29F is a little below 0.29: its product with 100 is 28.9999992, which single precision
    // rounds to 29 = 0x1D.
    VFGradient stop = {0, 1, 0.29F};
    VFLinearGradientProperty gradient(0, 0.29F, 1, 1, &stop);
    const Bytes fragment = fragmentOf(gradient);
    EXPECT_EQ(Bytes(fragment.begin() + 3, fragment.begin() + 5), (Bytes{0x81, 0x8D}));
    EXPECT_EQ(fragment.back(), 0x9D);

    VFBevelProperty bevel(0, 0, 0.29F, 0, 0, 0, 1, 0, 0, 0, 1, 0, 1);
    const Bytes bevelFragment = fragmentOf(bevel);
    EXPECT_EQ(Bytes(bevelFragment.begin() + 4, bevelFragment.begin() + 8),
              (Bytes{0x80, 0x80, 0x81, 0x8D}));
}

TEST(Encoding, StopPosition_KeepsSevenBits) {
    const std::pair<float, uint8_t> positions[] = {{0, 0x80},         {1, 0xE4},         {0.129F, 0x8C},
                                                   {1.28F, 0x80},     {-0.01F, 0xFF},    {kNan, 0x80},
                                                   {kInfinity, 0xFF}, {-kInfinity, 0x80}};
    for (const auto& [position, byte] : positions) {
        VFGradient stop = {0, 1, position};
        VFRadialGradientProperty record(0, 1, 1, 1, &stop);
        EXPECT_EQ(fragmentOf(record).back(), byte) << position;
    }
}

TEST(Encoding, BelowOneStop_WritesNoStops) {
    auto stops = threeStops();
    for (const int count : {-1, -5, INT32_MIN}) {
        VFOuterGlowProperty glow(12, 0, 1, count, stops.data());
        ASSERT_GE(glow.getSequentialCharLength(), 10);
        EXPECT_EQ(fragmentOf(glow).size(), 10U);
        VFRadialGradientProperty gradient(0, 1, 1, count, stops.data());
        ASSERT_GE(gradient.getSequentialCharLength(), 5);
        EXPECT_EQ(fragmentOf(gradient).size(), 5U);
    }
}

/// Of a count whose characters an int could not count, as many as it can.
TEST(Encoding, LengthOfAnyCount_IsANumberAbove0) {
    VFOuterGlowProperty glow(1, 0, 1, INT32_MAX, nullptr);
    VFLinearGradientProperty gradient(0, 1, 1, INT32_MAX, nullptr);
    for (VFProperty* const record : std::initializer_list<VFProperty*>{&glow, &gradient})
        EXPECT_GT(record->getSequentialCharLength(), 2000000000);
}

TEST(Encoding, MissingStops_WriteNothing) {
    VFOuterGlowProperty glow(12, 0, 1, 3, nullptr);
    EXPECT_EQ(fragmentOf(glow).size(), 10U);
    VFLinearGradientProperty gradient(0, 1, 1, 3, nullptr);
    EXPECT_EQ(fragmentOf(gradient).size(), 5U);
}

TEST(Encoding, BevelAndEmboss_AreTheirNumbersAndTwoColours) {
    const Bytes numbers = {0x81,                    // style 1
                           0x86, 0x84,              // size 100 = 0x64
                           0x80, 0x83, 0x8E, 0x88,  // depth 10: 1000 = 0x03E8
                           0x82, 0x83, 0x90,        // technique, direction, soften 16
                           0x82, 0xCA,              // angle 330
                           0x9E,                    // altitude 30
                           0x81, 0x82, 0x83, 0x84, 0x85, 0x86, 0x87, 0x88,   // highlight colour
                           0x88, 0x87, 0x86, 0x85, 0x84, 0x83, 0x82, 0x81};  // shadow colour
    expectFragment(
        VFBevelProperty(1, 100, 10, 2, 3, 16, 0.5F, 330, 30, 0x12345678, 0.5F, 0x87654321, 0.5F), 30,
        Bytes{'B'} + numbers);
    expectFragment(
        VFEmbossProperty(1, 100, 10, 2, 3, 16, 0.5F, 330, 30, 0x12345678, 0.5F, 0x87654321, 0.5F), 30,
        Bytes{'E'} + numbers);
}

TEST(Encoding, Bevel_WrapsWhatDoesNotFit) {
    VFBevelProperty record(-1, 300, 0.125F, 128, 255, 0, 1, -30, -10, 0, 1, 0, 1);
    const Bytes fragment = fragmentOf(record);
    const Bytes numbers = {'B',  0xFF, 0x82, 0x8C,               // -1; 300 = 0x12C keeps 0x2C
                           0x80, 0x80, 0x80, 0x8C,               // 12.5 is cut to 12
                           0x80, 0xFF, 0x80, 0x82, 0xCA, 0xF6};  // altitude -10 = ...0x76
    EXPECT_EQ(Bytes(fragment.begin(), fragment.begin() + 14), numbers);
}

TEST(Encoding, Pattern_ReservesButWritesNothing) {
    VFBitmap bitmap(1, 1, 4);
    expectFragment(VFPatternProperty(&bitmap, 2, 0.5F), 17, {});
    expectFragment(VFPatternProperty(nullptr, 2, 0.5F), 17, {});
}

TEST(Encoding, Pattern_LeavesTheCursorWhereItWas) {
    VFPatternProperty record(nullptr, 2, 0.5F);
    char buffer[18] = {};
    char* cursor = buffer + 3;
    EXPECT_TRUE(record.toSequentialChar(&cursor));
    EXPECT_EQ(cursor, buffer + 3);
}

TEST(Encoding, Opacities_AreNotEncoded) {
    VFTextProperty faint(0x11223344, 0.25F);
    VFTextProperty full(0x11223344, 1);
    EXPECT_EQ(fragmentOf(faint), fragmentOf(full));

    VFGradient faintStop = {7, 0.25F, 0.5F};
    VFGradient fullStop = {7, 1, 0.5F};
    VFLinearGradientProperty faintGradient(1, 1, 0.25F, 1, &faintStop);
    VFLinearGradientProperty fullGradient(1, 1, 1, 1, &fullStop);
    EXPECT_EQ(fragmentOf(faintGradient), fragmentOf(fullGradient));

    VFBevelProperty faintBevel(1, 2, 3, 4, 5, 6, 0.25F, 7, 8, 9, 0.25F, 10, 0.25F);
    VFBevelProperty fullBevel(1, 2, 3, 4, 5, 6, 1, 7, 8, 9, 1, 10, 1);
    EXPECT_EQ(fragmentOf(faintBevel), fragmentOf(fullBevel));
}

TEST(Encoding, Fragments_FollowEachOtherThroughTheCursor) {
    VFTextProperty text(0, 1);
    VFStrokeProperty stroke(1, 0, 1, 0, 0);
    char buffer[9 + 12 + 1];
    char* cursor = buffer;
    text.toSequentialChar(&cursor);
    stroke.toSequentialChar(&cursor);
    EXPECT_EQ(cursor, buffer + 21);
    EXPECT_EQ(buffer[0], 'T');
    EXPECT_EQ(buffer[9], 'K');
    EXPECT_EQ(std::strlen(buffer), 21U);
}

}  // namespace
