#include <gtest/gtest.h>
#include <voreleffect/VFEffect.h>

#include <climits>

#include "tests/support/engine.h"

using namespace VFontEffect;
using namespace vorel_test;

namespace {

/// What an add-call stored, each reached through the one number in question.
float opacityOfText(float opacity) {
    VFEffect set;
    set.addText(0, opacity);
    return set.getEffect(kText)->getProperty()->mOpacity;
}

unsigned colourOfText(unsigned colour, float opacity) {
    VFEffect set;
    set.addText(colour, opacity);
    return set.getEffect(kText)->getProperty()->mColor;
}

/// The stop that a linear gradient keeps of the given one.
VFGradient keptStop(VFGradient stop, float opacity) {
    VFEffect set;
    set.addLinearGradientText(0, 1, opacity, 1, &stop);
    return recordOf<VFLinearGradientProperty>(set, kLinearGradient).mGradient[0];
}

const std::pair<float, float> kOpacities[] = {
    {0, 0},  {1, 1},         {0.25F, 0.25F},  {1.0001F, 1},     {-0.0F, 0}, {-0.5F, 0},
    {50, 1}, {kInfinity, 1}, {-kInfinity, 0}, {1e-30F, 1e-30F}, {kNan, 0}};

const std::pair<float, float> kAngles[] = {
    {0, 0},
    {-30.7F, 330},
    {720, 0},
    {-0.9F, 0},
    {359.9F, 359},
    {360, 0},
    {-360, 0},
    {-361, 359},
    {-1, 359},
    {-0.0F, 0},
    {90.99F, 90},
    {1e9F, 280},
    {-1e9F, 80},
    // Saturated to 2147483647 and -2147483648, which leave 127 and -128.
    {kInfinity, 127},
    {1e30F, 127},
    {-kInfinity, 232},
    {-1e30F, 232},
    {kNan, 0}};

const std::pair<float, float> kPixels[] = {
    {0, 0},     {3.99F, 3}, {100, 100},   {99.9F, 99}, {100.5F, 100},    {150, 100},      {-4, 0},
    {-0.5F, 0}, {-0.0F, 0}, {1e30F, 100}, {-1e30F, 0}, {kInfinity, 100}, {-kInfinity, 0}, {kNan, 0}};

// --- Shared rules -----------------------------------------------------------------------------

TEST(AddCalls, Opacity_IsClampedTo0And1) {
    for (const auto& [given, kept] : kOpacities)
        EXPECT_EQ(opacityOfText(given), kept) << given;
}

TEST(AddCalls, AlphaByte_RoundsTheOpacity) {
    for (unsigned alpha = 0; alpha <= 255; ++alpha) {
        EXPECT_EQ(colourOfText(0, static_cast<float>(alpha) / 255.0F) >> 24, alpha);
    }
    EXPECT_EQ(colourOfText(0, 0.5F) >> 24, 128U);     // 127.5 + 0.5
    EXPECT_EQ(colourOfText(0, 0.0019F) >> 24, 0U);    // 0.4845 + 0.5
    EXPECT_EQ(colourOfText(0, 0.0020F) >> 24, 1U);    // 0.51 + 0.5
    EXPECT_EQ(colourOfText(0, 0.998F) >> 24, 254U);   // 254.49 + 0.5
    EXPECT_EQ(colourOfText(0, 0.9981F) >> 24, 255U);  // 254.5155 + 0.5
}

TEST(AddCalls, FullOpacity_KeepsEveryChannel) {
    for (unsigned c = 0; c <= 255; ++c) {
        const unsigned colour = c << 16 | (255 - c) << 8 | (c ^ 0x55U);
        EXPECT_EQ(colourOfText(colour, 1), 0xFF000000U | colour);
    }
}

TEST(AddCalls, ZeroOpacity_GivesColourZero) {
    EXPECT_EQ(colourOfText(0xFFFFFFFF, 0), 0U);
    EXPECT_EQ(colourOfText(0xFFFFFFFF, kNan), 0U);
}

TEST(AddCalls, PremultipliedColour_IsAlphaTimesChannelPlusOneOver256) {
    EXPECT_EQ(colourOfText(0x00FF8000, 0.5F), 0x80804000U);
    EXPECT_EQ(colourOfText(0xFFFF8000, 0.5F), 0x80804000U);
    for (unsigned alpha = 0; alpha <= 255; ++alpha) {
        for (unsigned c = 0; c <= 255; ++c) {
            const unsigned channel = alpha * (c + 1) / 256;
            ASSERT_EQ(colourOfText(c << 16 | c << 8 | c, static_cast<float>(alpha) / 255.0F),
                      alpha << 24 | channel << 16 | channel << 8 | channel)
                << alpha << " " << c;
        }
    }
}

// --- Shadows and stroke -----------------------------------------------------------------------

TEST(AddCalls, OuterShadow_WorkedExample) {
    VFEffect set;
    EXPECT_EQ(set.addOuterShadowText(-30.7F, 150, -4, 0x00FF8000, 0.5F), 0U);
    const auto& record = recordOf<VFOuterShadowProperty>(set, kOuterShadow);
    EXPECT_EQ(record.mAngle, 330.0F);
    EXPECT_EQ(record.mDistance, 100.0F);
    EXPECT_EQ(record.mSize, 0.0F);
    EXPECT_EQ(record.mColor, 0x80804000U);
    EXPECT_EQ(record.mOpacity, 0.5F);
}

template <class Record, class Call>
void expectShadowRules(int type, Call call) {
    VFEffect set;
    for (const auto& [given, kept] : kAngles) {
        EXPECT_EQ((set.*call)(given, 0, 0, 0, 1), 0U);
        EXPECT_EQ(recordOf<Record>(set, type).mAngle, kept) << given;
    }
    for (const auto& [given, kept] : kPixels) {
        (set.*call)(0, given, 7, 0, 1);
        EXPECT_EQ(recordOf<Record>(set, type).mDistance, kept) << given;
        EXPECT_EQ(recordOf<Record>(set, type).mSize, 7.0F);
        (set.*call)(0, 7, given, 0, 1);
        EXPECT_EQ(recordOf<Record>(set, type).mDistance, 7.0F);
        EXPECT_EQ(recordOf<Record>(set, type).mSize, kept) << given;
    }
    for (const auto& [given, kept] : kOpacities) {
        (set.*call)(0, 0, 0, 0x12345678, given);
        EXPECT_EQ(recordOf<Record>(set, type).mOpacity, kept) << given;
    }
    (set.*call)(0, 0, 0, 0x12FF8000, 0.5F);
    EXPECT_EQ(recordOf<Record>(set, type).mColor, 0x80804000U);
}

TEST(AddCalls, Shadows_CutAndClampTheirNumbers) {
    expectShadowRules<VFOuterShadowProperty>(kOuterShadow, &VFEffect::addOuterShadowText);
    expectShadowRules<VFInnerShadowProperty>(kInnerShadow, &VFEffect::addInnerShadowText);
}

TEST(AddCalls, Stroke_CutsTheSizeAndPassesStyleAndPositionOn) {
    VFEffect set;
    for (const auto& [given, kept] : kPixels) {
        EXPECT_EQ(set.addStrokeText(given, 0x12FF8000, 0.5F, 0, 0), 0U);
        EXPECT_EQ(recordOf<VFStrokeProperty>(set, kStroke).mSize, kept) << given;
    }
    EXPECT_EQ(recordOf<VFStrokeProperty>(set, kStroke).mColor, 0x80804000U);
    for (const auto& [given, kept] : kOpacities) {
        set.addStrokeText(1, 0, given, 0, 0);
        EXPECT_EQ(recordOf<VFStrokeProperty>(set, kStroke).mOpacity, kept) << given;
    }
    for (const int number : {INT_MIN, -1, 0, 1, 2, 3, INT_MAX}) {
        set.addStrokeText(1, 0, 1, number, 17);
        EXPECT_EQ(recordOf<VFStrokeProperty>(set, kStroke).mStrokeStyle, number);
        EXPECT_EQ(recordOf<VFStrokeProperty>(set, kStroke).mPosition, 17);
        set.addStrokeText(1, 0, 1, 17, number);
        EXPECT_EQ(recordOf<VFStrokeProperty>(set, kStroke).mStrokeStyle, 17);
        EXPECT_EQ(recordOf<VFStrokeProperty>(set, kStroke).mPosition, number);
    }
}

// --- Glows ------------------------------------------------------------------------------------

const std::pair<int, int> kCounts[] = {{0, 0},     {1, 1},         {3, 3},  {256, 256},  {257, 256},
                                       {300, 256}, {INT_MAX, 256}, {-5, 0}, {INT_MIN, 0}};

/// More stops than an add-call takes, each of its own colour.
std::vector<VFGradient> manyStops() {
    std::vector<VFGradient> stops(300);
    for (size_t i = 0; i < stops.size(); ++i)
        stops[i] = {static_cast<unsigned>(i), 1, 0.5F};
    return stops;
}

template <class Record>
void expectStops(VFEffect& set, int type, int count) {
    const auto& record = recordOf<Record>(set, type);
    ASSERT_EQ(record.mGradientCount, count);
    for (int i = 0; i < count; ++i) {
        EXPECT_EQ(record.mGradient[i].mColor, 0xFF000000U | static_cast<unsigned>(i));
    }
}

template <class Record, class Call>
void expectGlowRules(int type, Call call) {
    VFEffect set;
    for (const auto& [given, kept] : kPixels) {
        EXPECT_EQ((set.*call)(given, 0x12345678, 0.5F, 0, nullptr), 0U);
        EXPECT_EQ(recordOf<Record>(set, type).mSize, kept) << given;
    }
    EXPECT_EQ(recordOf<Record>(set, type).mColor, 0x80345678U);
    for (const auto& [given, kept] : kOpacities) {
        (set.*call)(1, 0, given, 0, nullptr);
        EXPECT_EQ(recordOf<Record>(set, type).mOpacity, kept) << given;
    }
    auto stops = manyStops();
    for (const auto& [given, kept] : kCounts) {
        (set.*call)(1, 0, 1, given, stops.data());
        expectStops<Record>(set, type, kept);
        (set.*call)(1, 0, 1, given, nullptr);
        expectStops<Record>(set, type, 0);
    }
}

TEST(AddCalls, Glows_KeepAStraightColourAndUpTo256Stops) {
    expectGlowRules<VFOuterGlowProperty>(kOuterGlow, &VFEffect::addOuterGlowText);
    expectGlowRules<VFInnerGlowProperty>(kInnerGlow, &VFEffect::addInnerGlowText);
}

TEST(AddCalls, WithoutStops_TheArrayIsNotRead) {
    VFEffect set;
    auto* nowhere = reinterpret_cast<VFGradient*>(uintptr_t{16});
    for (const int count : {0, -5}) {
        set.addOuterGlowText(1, 0, 1, count, nowhere);
        set.addInnerGlowText(1, 0, 1, count, nowhere);
        set.addLinearGradientText(0, 1, 1, count, nowhere);
        set.addRadialGradientText(1, 1, count, nowhere);
        EXPECT_EQ(recordOf<VFOuterGlowProperty>(set, kOuterGlow).mGradientCount, 0);
        EXPECT_EQ(recordOf<VFRadialGradientProperty>(set, kRadialGradient).mGradientCount, 0);
    }
}

// --- Stops ------------------------------------------------------------------------------------

TEST(AddCalls, Stops_BelongToTheSet) {
    VFEffect set;
    VFGradient stops[] = {{0x112233, 1, 0}, {0x445566, 1, 1}};
    set.addInnerGlowText(1, 0, 1, 2, stops);
    stops[0] = stops[1] = {0, 0, 0};
    const auto& record = recordOf<VFInnerGlowProperty>(set, kInnerGlow);
    EXPECT_NE(record.mGradient, stops);
    EXPECT_EQ(record.mGradient[0].mColor, 0xFF112233U);
    EXPECT_EQ(record.mGradient[1].mColor, 0xFF445566U);
    EXPECT_EQ(record.mGradient[1].mLocation, 1.0F);
}

TEST(AddCalls, StopColour_TakesTheProductOfTheOpacitiesAsItsAlpha) {
    struct Case {
        float effect, stop;
        unsigned alpha;
    };
    const Case cases[] = {
        {1, 1, 255},       {0.5F, 1, 128}, {1, 0.5F, 128},         {0.5F, 0.5F, 64},  // 63.75 + 0.5
        {0.5F, 1.7F, 217},                                                            // 216.75 + 0.5
        {0.5F, 3, 255},    {1, -0.5F, 0},  {1, -0.0F, 0},          {0, 1, 0},
        {2, 0.5F, 128},  // the effect opacity counts as 1
        {kNan, 1, 0},      {1, kNan, 0},   {0.5F, kInfinity, 255}, {0.5F, -kInfinity, 0},
        {0, kInfinity, 0}};
    for (const auto& [effect, stop, alpha] : cases) {
        EXPECT_EQ(keptStop({0x99123456, stop, 0}, effect).mColor, alpha << 24 | 0x123456U)
            << effect << " " << stop;
    }
}

TEST(AddCalls, StopOpacity_IsClampedTo0And1) {
    EXPECT_EQ(keptStop({0, 1.7F, 0}, 0.5F).mOpacity, 1.0F);
    for (const auto& [given, kept] : kOpacities)
        EXPECT_EQ(keptStop({0, given, 0}, 1).mOpacity, kept) << given;
}

TEST(AddCalls, StopPosition_IsCutToHundredthsAndClamped) {
    const std::pair<float, float> positions[] = {
        {0.129F, 0.12F}, {1.5F, 1},       {-0.2F, 0},   {0, 0},        {1, 1},
        {0.5F, 0.5F},    {0.009F, 0},     {-0.009F, 0}, {1e30F, 1},    {-1e30F, 0},
        {kInfinity, 1},  {-kInfinity, 0}, {kNan, 0},    {0.29F, 0.29F}};  // in single precision 0.29F *
                                                                          // 100 is 29
    for (const auto& [given, kept] : positions) {
        EXPECT_EQ(keptStop({0, 1, given}, 1).mLocation, kept) << given;
    }
}

// --- Gradients --------------------------------------------------------------------------------

const std::pair<float, float> kScalesTo2[] = {{0, 0},         {2, 2},          {3.5F, 2},
                                              {-1, 0},        {0.05F, 0.05F},  {-0.0F, 0},
                                              {kInfinity, 2}, {-kInfinity, 0}, {kNan, 0}};

TEST(AddCalls, LinearGradient_CutsTheAngleAndClampsTheScale) {
    VFEffect set;
    for (const auto& [given, kept] : kAngles) {
        EXPECT_EQ(set.addLinearGradientText(given, 1, 1, 0, nullptr), 0U);
        EXPECT_EQ(recordOf<VFLinearGradientProperty>(set, kLinearGradient).mAngle, kept) << given;
    }
    for (const auto& [given, kept] : kScalesTo2) {
        set.addLinearGradientText(0, given, 1, 0, nullptr);
        EXPECT_EQ(recordOf<VFLinearGradientProperty>(set, kLinearGradient).mScale, kept) << given;
    }
    for (const auto& [given, kept] : kOpacities) {
        set.addLinearGradientText(0, 1, given, 0, nullptr);
        EXPECT_EQ(recordOf<VFLinearGradientProperty>(set, kLinearGradient).mOpacity, kept) << given;
    }
    auto stops = manyStops();
    for (const auto& [given, kept] : kCounts) {
        set.addLinearGradientText(0, 1, 1, given, stops.data());
        expectStops<VFLinearGradientProperty>(set, kLinearGradient, kept);
    }
    set.addLinearGradientText(0, 1, 1, 5, nullptr);
    expectStops<VFLinearGradientProperty>(set, kLinearGradient, 0);
    EXPECT_EQ(recordOf<VFLinearGradientProperty>(set, kLinearGradient).mColor, 0U);
}

TEST(AddCalls, RadialGradient_ClampsTheScaleAndHasAngleZero) {
    VFEffect set;
    for (const auto& [given, kept] : kScalesTo2) {
        EXPECT_EQ(set.addRadialGradientText(given, 1, 0, nullptr), 0U);
        EXPECT_EQ(recordOf<VFRadialGradientProperty>(set, kRadialGradient).mScale, kept) << given;
    }
    for (const auto& [given, kept] : kOpacities) {
        set.addRadialGradientText(1, given, 0, nullptr);
        EXPECT_EQ(recordOf<VFRadialGradientProperty>(set, kRadialGradient).mOpacity, kept) << given;
    }
    auto stops = manyStops();
    for (const auto& [given, kept] : kCounts) {
        set.addRadialGradientText(1, 1, given, stops.data());
        expectStops<VFRadialGradientProperty>(set, kRadialGradient, kept);
    }
    set.addRadialGradientText(1, 1, 5, nullptr);
    expectStops<VFRadialGradientProperty>(set, kRadialGradient, 0);
    EXPECT_EQ(recordOf<VFRadialGradientProperty>(set, kRadialGradient).mAngle, 0.0F);
    EXPECT_EQ(recordOf<VFRadialGradientProperty>(set, kRadialGradient).mColor, 0U);
}

// --- Pattern, text, bevel, emboss -------------------------------------------------------------

TEST(AddCalls, Pattern_ClampsTheScaleAndCopiesTheBitmap) {
    VFEffect set;
    VFBitmap bitmap(2, 2, 4);
    fillBytes(bitmap, 9);
    const std::pair<float, float> scales[] = {{0, 0},     {10, 10},        {12, 10},        {-1, 0},
                                              {-0.0F, 0}, {kInfinity, 10}, {-kInfinity, 0}, {kNan, 0}};
    for (const auto& [given, kept] : scales) {
        EXPECT_EQ(set.addPatternText(&bitmap, given, 1), 0U);
        EXPECT_EQ(recordOf<VFPatternProperty>(set, kPattern).mScale, kept) << given;
    }
    for (const auto& [given, kept] : kOpacities) {
        set.addPatternText(&bitmap, 1, given);
        EXPECT_EQ(recordOf<VFPatternProperty>(set, kPattern).mOpacity, kept) << given;
    }
    fillBytes(bitmap, 1);
    EXPECT_EQ(bytesOf(*recordOf<VFPatternProperty>(set, kPattern).mPattern),
              std::vector<uint8_t>(16, 9));
    EXPECT_EQ(recordOf<VFPatternProperty>(set, kPattern).mColor, 0U);
}

TEST(AddCalls, NullPattern_GetsAnIdAndHasNoBitmap) {
    VFEffect set;
    EXPECT_EQ(set.addPatternText(nullptr, 1, 1), 0U);
    EXPECT_EQ(recordOf<VFPatternProperty>(set, kPattern).mPattern, nullptr);
}

TEST(AddCalls, Text_KeepsTheCallersAlphaAsideAndIgnoresItInTheColour) {
    VFEffect set;
    EXPECT_EQ(set.addText(0x40FFFFFF, 1), 0U);
    EXPECT_EQ(textAlphaOf(set), 0x40);
    EXPECT_EQ(set.getEffect(kText)->getProperty()->mColor, 0xFFFFFFFFU);
    set.addText(0xFE000000, 0);
    EXPECT_EQ(textAlphaOf(set), 0xFE);
}

TEST(AddCalls, BevelAndEmboss_ReturnNoEffectAndLeaveTheList) {
    VFEffect set;
    set.addText(0, 1);
    EXPECT_EQ(set.addBevelText(1, 5, 1, 0, 0, 3, 1, 30, 30, 0xFFFFFF, 1, 0, 1), kNoEffect);
    EXPECT_EQ(set.addEmbossText(1, 5, 1, 0, 0, 3, 1, 30, 30, 0xFFFFFF, 1, 0, 1), kNoEffect);
    for (const float odd : {kNan, kInfinity, -kInfinity, 1e30F, -1e30F}) {
        EXPECT_EQ(set.addBevelText(INT_MIN, odd, odd, INT_MAX, INT_MIN, INT_MAX, odd, odd, odd, 0, odd,
                                   0, odd),
                  kNoEffect);
        EXPECT_EQ(set.addEmbossText(INT_MIN, odd, odd, INT_MAX, INT_MIN, INT_MAX, odd, odd, odd, 0, odd,
                                    0, odd),
                  kNoEffect);
    }
    EXPECT_EQ(orderOf(set), "T");
    EXPECT_EQ(set.getEffect(kBevel), nullptr);
    EXPECT_EQ(set.getEffect(kEmboss), nullptr);
    EXPECT_EQ(set.getNewEffectId(), 1);
}

/// A core of the caller's own that copies the record it is given.
template <class Record>
class ReliefCore : public FakeCore {
  public:
    explicit ReliefCore(int style) : FakeCore(style) {}
    void setProperty(VFProperty* property) override { record = *static_cast<Record*>(property); }

    Record record{0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0};
};

template <class Record, class Add>
void expectReliefRecord(int style, Add add) {
    VFEffect set;
    auto* const core = new ReliefCore<Record>(style);
    effectsOf(set).push_back(core);
    (set.*add)(3, 5.5F, 11, 1, 2, 17, 0.5F, -30.9F, 100, 0x99112233, 0.5F, 0x88445566, 0.8F);
    const Record& record = core->record;
    EXPECT_EQ(record.mStyle, 3);
    EXPECT_EQ(record.mSize, 5.5F);
    EXPECT_EQ(record.mDepth, 10.0F);
    EXPECT_EQ(record.mTechnique, 1);
    EXPECT_EQ(record.mDirection, 2);
    EXPECT_EQ(record.mSoften, 16);
    EXPECT_EQ(record.mOpacity, 0.5F);
    EXPECT_EQ(record.mAngle, 330.0F);
    EXPECT_EQ(record.mAltitude, 10.0F);
    // Both opacities multiplied: 0.25 * 255 and 0.4 * 255, rounded.
    EXPECT_EQ(record.mHighlightColor, 0x40112233U);
    EXPECT_EQ(record.mHighlightOpacity, 0.5F);
    EXPECT_EQ(record.mShadowColor, 0x66445566U);
    EXPECT_EQ(record.mShadowOpacity, 0.8F);
}

TEST(AddCalls, BevelAndEmboss_GiveTheirRecordToACallersOwnCore) {
    expectReliefRecord<VFBevelProperty>(kBevel, &VFEffect::addBevelText);
    expectReliefRecord<VFEmbossProperty>(kEmboss, &VFEffect::addEmbossText);
}

TEST(AddCalls, BevelAndEmboss_ReArmTheOrder) {
    VFEffect set;
    set.addOuterShadowText(0, 1, 1, 0, 1);
    set.addStrokeText(1, 0, 1, 0, 1);
    ASSERT_EQ(planAndOrder(set), "KS");
    set.addBevelText(1, 5, 1, 0, 0, 3, 1, 30, 30, 0, 1, 0, 1);
    EXPECT_EQ(planAndOrder(set), "SK");
    set.addEmbossText(1, 5, 1, 0, 0, 3, 1, 30, 30, 0, 1, 0, 1);
    EXPECT_EQ(planAndOrder(set), "KS");
    EXPECT_EQ(planAndOrder(set), "KS");
}

TEST(AddCalls, EachKind_HasItsOwnCoreAndId) {
    VFEffect set;
    VFBitmap bitmap(1, 1, 4);
    EXPECT_EQ(set.addOuterShadowText(0, 0, 0, 0, 1), 0U);
    EXPECT_EQ(set.addInnerShadowText(0, 0, 0, 0, 1), 1U);
    EXPECT_EQ(set.addOuterGlowText(0, 0, 1, 0, nullptr), 2U);
    EXPECT_EQ(set.addInnerGlowText(0, 0, 1, 0, nullptr), 3U);
    EXPECT_EQ(set.addLinearGradientText(0, 1, 1, 0, nullptr), 4U);
    EXPECT_EQ(set.addRadialGradientText(1, 1, 0, nullptr), 5U);
    EXPECT_EQ(set.addStrokeText(0, 0, 1, 0, 0), 6U);
    EXPECT_EQ(set.addPatternText(&bitmap, 1, 1), 7U);
    EXPECT_EQ(set.addText(0, 1), 8U);
    int id = 0;
    for (const int type : kCoreTypes)
        EXPECT_EQ(set.getEffect(type)->getId(), id++);
}

}  // namespace
