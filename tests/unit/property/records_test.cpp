#include <gtest/gtest.h>
#include <voreleffect/VFECore.h>
#include <voreleffect/VFProperty.h>

#include <cmath>

#include "tests/support/engine.h"

using namespace VFontEffect;
using namespace vorel_test;

namespace {

const VFGradient kStops[] = {
    {0x11223344, 0.25F, 0.0F}, {0x55667788, 0.5F, 0.5F}, {0x99AABBCC, 1.5F, 1.0F}};

std::vector<VFGradient> threeStops() {
    return {std::begin(kStops), std::end(kStops)};
}

void expectThreeStops(const VFGradient* actual) {
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(actual[i].mColor, kStops[i].mColor);
        EXPECT_EQ(actual[i].mOpacity, kStops[i].mOpacity);
        EXPECT_EQ(actual[i].mLocation, kStops[i].mLocation);
    }
}

/// The angle that a constructor which cuts and reduces should keep: whole degrees, sign kept.
struct AngleCase {
    float given;
    float by360;
    float by90;
};

const AngleCase kAngles[] = {
    {0, 0, 0},
    {-30.7F, -30, -30},
    {725, 5, 5},
    {-725, -5, -5},
    {359.9F, 359, 89},
    {360, 0, 0},
    {-360, 0, 0},
    {100, 100, 10},
    {-100, -100, -10},
    {89.99F, 89, 89},
    {90, 90, 0},
    {-0.9F, 0, 0},
    {1e9F, 280, 10},
    {-1e9F, -280, -10},
    // Outside the range of an int the value saturates: 2147483647 and -2147483648.
    {kInfinity, 127, 37},
    {-kInfinity, -128, -38},
    {3e9F, 127, 37},
    {-1e30F, -128, -38},
    {kNan, 0, 0},
};

TEST(Records, Text_KeepsColourAndOpacity) {
    const VFTextProperty record(0x80804000, 0.5F);
    EXPECT_EQ(record.mColor, 0x80804000U);
    EXPECT_EQ(record.mOpacity, 0.5F);
}

TEST(Records, Opacity_IsNotClamped) {
    EXPECT_EQ(VFTextProperty(0, 7.5F).mOpacity, 7.5F);
    EXPECT_EQ(VFStrokeProperty(1, 0, -3, 0, 0).mOpacity, -3.0F);
    EXPECT_TRUE(std::isnan(VFLinearGradientProperty(0, 1, kNan, 0, nullptr).mOpacity));
}

TEST(Records, OuterShadow_KeepsTheAngleAsGiven) {
    for (const float angle : {-30.7F, 725.0F, -0.9F, kInfinity, 1e30F}) {
        EXPECT_EQ(VFOuterShadowProperty(angle, 2, 3, 4, 0.5F).mAngle, angle);
    }
    EXPECT_TRUE(std::isnan(VFOuterShadowProperty(kNan, 2, 3, 4, 0.5F).mAngle));
}

TEST(Records, InnerShadow_CutsTheAngleAndKeepsItsSign) {
    for (const AngleCase& angle : kAngles) {
        EXPECT_EQ(VFInnerShadowProperty(angle.given, 2, 3, 4, 0.5F).mAngle, angle.by360) << angle.given;
    }
}

template <class Record>
void expectShadowFields() {
    const Record record(30, -250.5F, 1000.25F, 0xDEADBEEF, 0.75F);
    EXPECT_EQ(record.mAngle, 30.0F);
    EXPECT_EQ(record.mDistance, -250.5F);
    EXPECT_EQ(record.mSize, 1000.25F);
    EXPECT_EQ(record.mColor, 0xDEADBEEFU);
    EXPECT_EQ(record.mOpacity, 0.75F);
}

TEST(Records, Shadows_KeepTheOtherArguments) {
    expectShadowFields<VFOuterShadowProperty>();
    expectShadowFields<VFInnerShadowProperty>();
}

TEST(Records, Stroke_KeepsItsArguments) {
    const VFStrokeProperty record(200.5F, 0x12345678, 0.25F, -9, 77);
    EXPECT_EQ(record.mSize, 200.5F);
    EXPECT_EQ(record.mColor, 0x12345678U);
    EXPECT_EQ(record.mOpacity, 0.25F);
    EXPECT_EQ(record.mStrokeStyle, -9);
    EXPECT_EQ(record.mPosition, 77);
}

template <class Record>
void expectGlowFields() {
    VFGradient stop = {1, 1, 1};
    for (const int count : {1, 0, -5, 1000}) {
        const Record record(200.5F, 0x12345678, 0.25F, count, &stop);
        EXPECT_EQ(record.mSize, 200.5F);
        EXPECT_EQ(record.mColor, 0x12345678U);
        EXPECT_EQ(record.mOpacity, 0.25F);
        EXPECT_EQ(record.mGradientCount, count);
        EXPECT_EQ(record.mGradient, &stop);
    }
}

TEST(Records, Glows_KeepTheirArgumentsAndTheArrayOfTheCaller) {
    expectGlowFields<VFOuterGlowProperty>();
    expectGlowFields<VFInnerGlowProperty>();
}

template <class Record>
void expectGradientFields() {
    VFGradient stop = {1, 1, 1};
    const Record record(45, 1.25F, 0.25F, 1000, &stop);
    EXPECT_EQ(record.mColor, 0U);
    EXPECT_EQ(record.mOpacity, 0.25F);
    EXPECT_EQ(record.mAngle, 45.0F);
    EXPECT_EQ(record.mScale, 1.25F);
    EXPECT_EQ(record.mGradientCount, 1000);
    EXPECT_EQ(record.mGradient, &stop);

    for (const AngleCase& angle : kAngles) {
        EXPECT_EQ(Record(angle.given, 1, 1, 0, nullptr).mAngle, angle.by360) << angle.given;
    }
    const std::pair<float, float> scales[] = {
        {3.5F, 2}, {-1, 0}, {2, 2}, {0, 0}, {-0.0F, 0}, {0.05F, 0.05F}, {kInfinity, 2}, {-kInfinity, 0}};
    for (const auto& [given, kept] : scales) {
        EXPECT_EQ(Record(0, given, 1, 0, nullptr).mScale, kept) << given;
    }
    EXPECT_TRUE(std::isnan(Record(0, kNan, 1, 0, nullptr).mScale));
}

TEST(Records, Gradients_ReduceTheAngleAndClampTheScale) {
    expectGradientFields<VFLinearGradientProperty>();
    expectGradientFields<VFRadialGradientProperty>();
}

TEST(Records, Pattern_ClampsTheScaleAndKeepsThePointer) {
    VFBitmap bitmap(1, 1, 4);
    const VFPatternProperty record(&bitmap, 12, 0.25F);
    EXPECT_EQ(record.mPattern, &bitmap);
    EXPECT_EQ(record.mScale, 10.0F);
    EXPECT_EQ(record.mOpacity, 0.25F);
    EXPECT_EQ(record.mColor, 0U);

    const std::pair<float, float> scales[] = {
        {-1, 0}, {10, 10}, {9.75F, 9.75F}, {kInfinity, 10}, {-kInfinity, 0}};
    for (const auto& [given, kept] : scales)
        EXPECT_EQ(VFPatternProperty(&bitmap, given, 1).mScale, kept);
    EXPECT_TRUE(std::isnan(VFPatternProperty(&bitmap, kNan, 1).mScale));
}

template <class Record>
void expectBevelFields() {
    const Record record(1, 250.5F, 12, -2, 3, 20, 0.25F, 725.5F, 100, 0x11223344, 1.5F, 0x55667788,
                        -0.5F);
    EXPECT_EQ(record.mColor, 0U);
    EXPECT_EQ(record.mOpacity, 0.25F);
    EXPECT_EQ(record.mStyle, 1);
    EXPECT_EQ(record.mSize, 250.5F);
    EXPECT_EQ(record.mDepth, 10.0F);
    EXPECT_EQ(record.mTechnique, -2);
    EXPECT_EQ(record.mDirection, 3);
    EXPECT_EQ(record.mSoften, 16);
    EXPECT_EQ(record.mAngle, 5.0F);
    EXPECT_EQ(record.mAltitude, 10.0F);
    EXPECT_EQ(record.mHighlightColor, 0x11223344U);
    EXPECT_EQ(record.mHighlightOpacity, 1.5F);
    EXPECT_EQ(record.mShadowColor, 0x55667788U);
    EXPECT_EQ(record.mShadowOpacity, -0.5F);

    const auto with = [](float depth, int soften, float angle, float altitude) {
        return Record(0, 0, depth, 0, 0, soften, 1, angle, altitude, 0, 1, 0, 1);
    };
    for (const AngleCase& angle : kAngles) {
        EXPECT_EQ(with(1, 0, angle.given, angle.given).mAngle, angle.by360) << angle.given;
        EXPECT_EQ(with(1, 0, angle.given, angle.given).mAltitude, angle.by90) << angle.given;
    }
    const std::pair<float, float> depths[] = {
        {-1, 0}, {0.5F, 0.5F}, {10, 10}, {kInfinity, 10}, {-kInfinity, 0}};
    for (const auto& [given, kept] : depths)
        EXPECT_EQ(with(given, 0, 0, 0).mDepth, kept) << given;
    const std::pair<int, int> softens[] = {{-3, 0},  {0, 0},         {16, 16},
                                           {17, 16}, {INT32_MIN, 0}, {INT32_MAX, 16}};
    for (const auto& [given, kept] : softens)
        EXPECT_EQ(with(1, given, 0, 0).mSoften, kept) << given;
}

TEST(Records, BevelAndEmboss_ClampAndReduce) {
    expectBevelFields<VFBevelProperty>();
    expectBevelFields<VFEmbossProperty>();
}

/// A virtual operation called by its slot alone, as code compiled against the fixed order calls it.
bool writeThroughSlot(VFProperty& record, int slot, char** cursor) {
    void** table = *reinterpret_cast<void***>(&record);
    return reinterpret_cast<bool (*)(VFProperty*, char**)>(table[slot])(&record, cursor);
}

TEST(Records, EncodingStandsInSlotsTwoAndThree) {
    class Probe : public VFProperty {
      public:
        Probe() : VFProperty(0, 1) {}
        int getSequentialCharLength() override { return called = 2; }
        bool toSequentialChar(char**) override {
            called = 3;
            return true;
        }
        int called = 0;
    };
    for (const int slot : {2, 3}) {
        Probe probe;
        char* cursor = nullptr;
        writeThroughSlot(probe, slot, &cursor);
        EXPECT_EQ(probe.called, slot);
    }
}

// --- The copy that a core makes ---------------------------------------------------------------

template <class Record>
const Record& copyIn(VFECore& core, Record& record) {
    core.setProperty(&record);
    EXPECT_NE(core.getProperty(), nullptr);
    EXPECT_NE(core.getProperty(), &record);
    return *static_cast<const Record*>(core.getProperty());
}

TEST(RecordCopies, Text_IsItsOwn) {
    VFText core;
    VFTextProperty record(0x11223344, 0.5F);
    const VFTextProperty& copy = copyIn(core, record);
    record.mColor = 0;
    EXPECT_EQ(copy.mColor, 0x11223344U);
    EXPECT_EQ(copy.mOpacity, 0.5F);
}

template <class Core, class Record>
void expectShadowCopy(float copiedAngle) {
    Core core;
    Record record(0, 2.5F, 3.5F, 0x11223344, 0.5F);
    record.mAngle = -400.7F;
    const Record& copy = copyIn(core, record);
    EXPECT_EQ(copy.mAngle, copiedAngle);
    EXPECT_EQ(copy.mDistance, 2.5F);
    EXPECT_EQ(copy.mSize, 3.5F);
    EXPECT_EQ(copy.mColor, 0x11223344U);
    EXPECT_EQ(copy.mOpacity, 0.5F);
}

TEST(RecordCopies, Shadows_RunTheirConstructorAgain) {
    expectShadowCopy<VFOuterShadow, VFOuterShadowProperty>(-400.7F);
    expectShadowCopy<VFInnerShadow, VFInnerShadowProperty>(-40);
}

TEST(RecordCopies, Stroke_TakesEveryField) {
    VFStroke core;
    VFStrokeProperty record(5.5F, 0x11223344, 0.5F, -9, 77);
    const VFStrokeProperty& copy = copyIn(core, record);
    EXPECT_EQ(copy.mSize, 5.5F);
    EXPECT_EQ(copy.mColor, 0x11223344U);
    EXPECT_EQ(copy.mOpacity, 0.5F);
    EXPECT_EQ(copy.mStrokeStyle, -9);
    EXPECT_EQ(copy.mPosition, 77);
}

template <class Core, class Record>
void expectGlowCopy() {
    Core core;
    auto stops = threeStops();
    Record record(5.5F, 0x11223344, 0.5F, 3, stops.data());
    const Record& copy = copyIn(core, record);
    EXPECT_NE(copy.mGradient, stops.data());
    stops.assign(3, VFGradient{0, 0, 0});
    ASSERT_EQ(copy.mGradientCount, 3);
    expectThreeStops(copy.mGradient);
    EXPECT_EQ(copy.mSize, 5.5F);
    EXPECT_EQ(copy.mColor, 0x11223344U);
    EXPECT_EQ(copy.mOpacity, 0.5F);
}

TEST(RecordCopies, Glows_CopyTheStops) {
    expectGlowCopy<VFOuterGlow, VFOuterGlowProperty>();
    expectGlowCopy<VFInnerGlow, VFInnerGlowProperty>();
}

template <class Core, class Record>
void expectGradientCopy() {
    Core core;
    auto stops = threeStops();
    Record record(0, 1, 0.5F, 3, stops.data());
    record.mAngle = -400.7F;
    record.mScale = 3.5F;
    const Record& copy = copyIn(core, record);
    EXPECT_NE(copy.mGradient, stops.data());
    stops.assign(3, VFGradient{0, 0, 0});
    ASSERT_EQ(copy.mGradientCount, 3);
    expectThreeStops(copy.mGradient);
    EXPECT_EQ(copy.mAngle, -40.0F);
    EXPECT_EQ(copy.mScale, 2.0F);
    EXPECT_EQ(copy.mOpacity, 0.5F);
}

TEST(RecordCopies, Gradients_CopyTheStopsAndRunTheirConstructorAgain) {
    expectGradientCopy<VFLinearGradient, VFLinearGradientProperty>();
    expectGradientCopy<VFRadialGradient, VFRadialGradientProperty>();
}

TEST(RecordCopies, Pattern_CopiesThePixelsAndClampsAgain) {
    VFPattern core;
    VFBitmap bitmap(2, 2, 4);
    fillBytes(bitmap, 9);
    VFPatternProperty record(&bitmap, 1, 0.5F);
    record.mScale = 12;
    const VFPatternProperty& copy = copyIn(core, record);
    EXPECT_NE(copy.mPattern, &bitmap);
    fillBytes(bitmap, 1);
    EXPECT_EQ(bytesOf(*copy.mPattern), std::vector<uint8_t>(16, 9));
    EXPECT_EQ(copy.mScale, 10.0F);
    EXPECT_EQ(copy.mOpacity, 0.5F);
}

TEST(RecordCopies, MissingArraysAndBitmaps_StayMissing) {
    VFOuterGlow glow;
    VFOuterGlowProperty glowRecord(1, 0, 1, 3, nullptr);
    EXPECT_EQ(copyIn(glow, glowRecord).mGradient, nullptr);

    VFLinearGradient gradient;
    VFLinearGradientProperty gradientRecord(0, 1, 1, 3, nullptr);
    EXPECT_EQ(copyIn(gradient, gradientRecord).mGradient, nullptr);

    VFPattern pattern;
    VFPatternProperty patternRecord(nullptr, 1, 1);
    EXPECT_EQ(copyIn(pattern, patternRecord).mPattern, nullptr);
}

TEST(RecordCopies, NegativeCountWithAnArray_Survives) {
    auto stops = threeStops();
    VFInnerGlow glow;
    VFInnerGlowProperty record(1, 0x00FF00FF, 1, -7, stops.data());
    EXPECT_EQ(copyIn(glow, record).mColor, 0x00FF00FFU);
}

/// A core with a first and a second record of its class, told apart by their opacity.
struct Replacement {
    VFECore& core;
    VFProperty& first;
    VFProperty& second;
};

void expectReplaced(const Replacement& with) {
    EXPECT_EQ(with.core.getProperty(), nullptr);
    with.core.setProperty(nullptr);
    EXPECT_EQ(with.core.getProperty(), nullptr);

    with.core.setProperty(&with.first);
    VFProperty* stored = with.core.getProperty();
    ASSERT_NE(stored, nullptr);
    EXPECT_EQ(stored->mOpacity, with.first.mOpacity);
    with.core.setProperty(nullptr);
    EXPECT_EQ(with.core.getProperty(), stored);
    EXPECT_EQ(stored->mOpacity, with.first.mOpacity);

    with.core.setProperty(&with.second);
    EXPECT_EQ(with.core.getProperty()->mOpacity, with.second.mOpacity);
    // A core may be given its own record back.
    with.core.setProperty(with.core.getProperty());
    EXPECT_EQ(with.core.getProperty()->mOpacity, with.second.mOpacity);
}

template <class Core, class Record, class... Arguments>
void expectRecordReplaced(Arguments... beforeOpacity) {
    Core core;
    Record first(beforeOpacity..., 0.25F);
    Record second(beforeOpacity..., 0.75F);
    expectReplaced({core, first, second});
}

TEST(RecordCopies, NullKeepsAndANewRecordReplacesTheStoredOne) {
    expectRecordReplaced<VFText, VFTextProperty>(1U);
    expectRecordReplaced<VFOuterShadow, VFOuterShadowProperty>(1.0F, 2.0F, 3.0F, 4U);
    expectRecordReplaced<VFInnerShadow, VFInnerShadowProperty>(1.0F, 2.0F, 3.0F, 4U);
    VFBitmap bitmap(2, 2, 4);
    expectRecordReplaced<VFPattern, VFPatternProperty>(&bitmap, 1.0F);

    VFStroke stroke;
    VFStrokeProperty thin(1, 2, 0.25F, 0, 0);
    VFStrokeProperty thick(9, 2, 0.75F, 0, 0);
    expectReplaced({stroke, thin, thick});
}

template <class Core, class Record, class... Arguments>
void expectStopsReplaced(Arguments... beforeOpacity) {
    Core core;
    auto stops = threeStops();
    Record first(beforeOpacity..., 0.25F, 3, stops.data());
    Record second(beforeOpacity..., 0.75F, 2, stops.data());
    expectReplaced({core, first, second});
    EXPECT_EQ(static_cast<Record*>(core.getProperty())->mGradientCount, 2);
}

TEST(RecordCopies, NullKeepsAndNewStopsReplaceTheStoredOnes) {
    expectStopsReplaced<VFOuterGlow, VFOuterGlowProperty>(1.0F, 2U);
    expectStopsReplaced<VFInnerGlow, VFInnerGlowProperty>(1.0F, 2U);
    expectStopsReplaced<VFLinearGradient, VFLinearGradientProperty>(1.0F, 2.0F);
    expectStopsReplaced<VFRadialGradient, VFRadialGradientProperty>(1.0F, 2.0F);
}

}  // namespace
