#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>
#include <vector>

#include "../support/core_compare.h"
#include "../support/literal_cores.h"
#include "../support/mask_gallery.h"

namespace {

using namespace vorel_test;
using literal::Stop;
using VFontEffect::VFGradient;
using VFontEffect::VFRadialGradient;
using VFontEffect::VFRadialGradientProperty;

constexpr uint32_t kBlack = 0xFF000000;
constexpr uint32_t kWhite = 0xFFFFFFFF;
constexpr uint32_t kRed = 0xFFFF0000;
constexpr uint32_t kGreen = 0xFF00FF00;
constexpr uint32_t kBlue = 0xFF0000FF;

/// Black to white: entry i of the table is the grey i * 255 >> 8.
const std::vector<Stop> kRamp{{kBlack, 1.0F, 0.0F}, {kWhite, 1.0F, 1.0F}};

int greyOf(int entry) {
    return entry * 255 >> 8;
}

/// The core with a record of these numbers; the record clamps and reduces them.
std::unique_ptr<VFRadialGradient> coreWith(float scale, const std::vector<Stop>& stops,
                                           float angle = 0.0F) {
    std::vector<VFGradient> array = libraryStops(stops);
    VFRadialGradientProperty record(angle, scale, 1.0F, static_cast<int>(array.size()), array.data());
    auto core = std::make_unique<VFRadialGradient>();
    core->setProperty(&record);
    return core;
}

Scene filled(const Scene& scene, float scale, const std::vector<Stop>& stops) {
    return painted(*coreWith(scale, stops), scene);
}

::testing::AssertionResult matchesLiteral(const Scene& scene, float scale,
                                          const std::vector<Stop>& stops) {
    const auto core = coreWith(scale, stops);
    const auto* record = static_cast<VFRadialGradientProperty*>(core->getProperty());
    auto same = paintsLike(*core, scene, [&](Scene& expected) {
        literal::paintRadialGradient(expected.dst, expected.mask, expected.text, record->mScale, stops);
    });
    if (!same) same << "; scale " << scale << ", stops " << stops.size();
    return same;
}

/// The colour words of one row.
std::vector<uint32_t> rowOf(const literal::Picture& picture, int y) {
    std::vector<uint32_t> row;
    const size_t stride = static_cast<size_t>(picture.width) * 4;
    for (size_t i = static_cast<size_t>(y) * stride; i < static_cast<size_t>(y + 1) * stride; i += 4) {
        row.push_back(uint32_t{picture.bytes[i + 3]} << 24 | uint32_t{picture.bytes[i]} << 16 |
                      uint32_t{picture.bytes[i + 1]} << 8 | picture.bytes[i + 2]);
    }
    return row;
}

/// In a box of 512 x 2 the lower row lies on the centre line and a pixel is one entry wide: column
/// 256 + i shows entry i.
std::vector<uint32_t> tableOf(const std::vector<Stop>& stops) {
    const std::vector<uint32_t> row =
        rowOf(filled(sceneOf(filledMask(512, 2, 255)), 1.0F, stops).dst, 1);
    return {row.begin() + 256, row.end()};
}

// --- The core as an object ------------------------------------------------------------------------

TEST(RadialGradient, NewCore_HasItsTypeAndNoRecord) {
    expectFreshCore<VFRadialGradient>(8);
}

TEST(RadialGradient, Record_IsOwnedByTheCore) {
    VFGradient stops[] = {{kRed, 1.0F, 0.0F}, {kBlue, 0.5F, 1.0F}};
    VFGradient others[] = {{kGreen, 1.0F, 0.0F}, {kRed, 1.0F, 0.2F}, {kBlue, 1.0F, 0.9F}};
    expectOwnsItsRecord<VFRadialGradient>(VFRadialGradientProperty(30.0F, 1.0F, 0.5F, 2, stops),
                                          VFRadialGradientProperty(70.0F, 0.5F, 1.0F, 3, others),
                                          sceneOf(discMask(30, 30, 15.0F, 14.0F, 9.0F, true)));
}

TEST(RadialGradient, Stops_AreCopied) {
    const Scene scene = sceneOf(filledMask(20, 20, 255));
    auto stops = std::make_unique<VFGradient[]>(2);
    stops[0] = {kRed, 0.25F, 0.0F};
    stops[1] = {kBlue, 0.75F, 0.5F};
    VFRadialGradientProperty record(-30.5F, 3.5F, 0.5F, 2, stops.get());
    VFRadialGradient core;
    core.setProperty(&record);
    const Scene before = painted(core, scene);
    stops[0].mColor = kGreen;
    stops[1].mLocation = 0.1F;
    EXPECT_TRUE(samePaint(before, painted(core, scene)));
    stops.reset();
    EXPECT_TRUE(samePaint(before, painted(core, scene)));

    const auto* stored = static_cast<VFRadialGradientProperty*>(core.getProperty());
    EXPECT_EQ(-30.0F, stored->mAngle);
    EXPECT_EQ(2.0F, stored->mScale);
    EXPECT_EQ(0.5F, stored->mOpacity);
    EXPECT_EQ(0U, stored->mColor);
    ASSERT_EQ(2, stored->mGradientCount);
    EXPECT_EQ(kRed, stored->mGradient[0].mColor);
    EXPECT_EQ(0.75F, stored->mGradient[1].mOpacity);
    EXPECT_EQ(0.5F, stored->mGradient[1].mLocation);
}

TEST(RadialGradient, Offsets_StayZero) {
    const auto core = coreWith(2.0F, kRamp);
    EXPECT_EQ(0, core->getOffset());
    EXPECT_EQ(0, core->getLeftOffset());
    EXPECT_EQ(0, core->getRightOffset());
    EXPECT_EQ(0, core->getTopOffset());
    EXPECT_EQ(0, core->getBottomOffset());
}

TEST(RadialGradient, Angle_IsNotRead) {
    const Scene scene = sceneOf(filledMask(20, 11, 255));
    EXPECT_TRUE(samePaint(filled(scene, 1.0F, kRamp), painted(*coreWith(1.0F, kRamp, 77.0F), scene)));
}

// --- Distance by hand ---------------------------------------------------------------------------------

TEST(RadialGradient, Centre_HasTheFirstEntryAndTheSidesTheLast) {
    const std::vector<uint32_t> row =
        rowOf(filled(sceneOf(filledMask(512, 2, 255)), 1.0F, kRamp).dst, 1);
    EXPECT_EQ(kBlack, row[256]);
    EXPECT_EQ(0xFFFEFEFE, row[511]);  // entry 255: 255 * 255 >> 8
    EXPECT_EQ(0xFFFEFEFE, row[0]);    // distance 256, clamped to entry 255
    EXPECT_EQ(row[256 + 100], row[256 - 100]);
}

TEST(RadialGradient, ScaleTwo_ReachesTheMiddleOfTheTableAtTheSides) {
    const std::vector<uint32_t> row =
        rowOf(filled(sceneOf(filledMask(512, 2, 255)), 2.0F, kRamp).dst, 1);
    EXPECT_EQ(0xFF7F7F7F, row[0]);    // entry 128
    EXPECT_EQ(0xFF7E7E7E, row[511]);  // entry 127
}

TEST(RadialGradient, SmallBox_IsMeasuredFromItsCentre) {
    // 4 x 2 with the centre at (2, 1): 128 entries a pixel. Distances 2, 1, 0, 1 in the lower row and
    // the roots of 5, 2, 1, 2 in the upper.
    const Scene result = filled(sceneOf(filledMask(4, 2, 255)), 1.0F, kRamp);
    EXPECT_EQ((std::vector<int>{greyOf(255), greyOf(181), greyOf(128), greyOf(181),  //
                                greyOf(255), greyOf(128), greyOf(0), greyOf(128)}),
              channelOf(result.dst, 0));
}

TEST(RadialGradient, Radius_IsMeasuredByTheWidthAlone) {
    // 4 wide, 64 high: the ramp ends two pixels above and below the centre.
    const std::vector<int> red = channelOf(filled(sceneOf(filledMask(4, 64, 255)), 1.0F, kRamp).dst, 0);
    const auto column = [&](int y) { return red[static_cast<size_t>(y * 4 + 2)]; };
    EXPECT_EQ(greyOf(0), column(32));
    EXPECT_EQ(greyOf(128), column(33));
    EXPECT_EQ(greyOf(255), column(34));
    EXPECT_EQ(greyOf(255), column(63));
    EXPECT_EQ(greyOf(128), column(31));
    EXPECT_EQ(greyOf(255), column(0));
}

TEST(RadialGradient, ScaleBelowATenth_PaintsNothing) {
    const Scene scene = sceneOf(filledMask(8, 8, 255));
    for (float scale : {0.09F, 0.0999F, 0.0F, -1.0F, -std::numeric_limits<float>::infinity()}) {
        EXPECT_TRUE(samePaint(scene, filled(scene, scale, kRamp))) << scale;
    }
    EXPECT_FALSE(samePaint(scene, filled(scene, 0.1F, kRamp)));
}

TEST(RadialGradient, ScaleThatIsNotANumber_PaintsTheFirstEntry) {
    const Scene result =
        filled(sceneOf(filledMask(6, 2, 255)), std::nanf(""), {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 1.0F}});
    EXPECT_TRUE(samePicture(filledPicture(6, 2, kRed), result.dst));
}

TEST(RadialGradient, Box_IsTheFrameOfTheRamp) {
    const Scene part = sceneOf(filledMask(12, 9, 255), {3, 2, 9, 7});
    const Scene whole = sceneOf(filledMask(6, 5, 255));
    const Scene partPaint = filled(part, 1.0F, kRamp);
    const std::vector<uint32_t> expected = rowOf(filled(whole, 1.0F, kRamp).dst, 1);
    const std::vector<uint32_t> actual = rowOf(partPaint.dst, 3);
    EXPECT_EQ(expected, std::vector<uint32_t>(actual.begin() + 3, actual.begin() + 9));
    EXPECT_EQ(0U, actual[2]);
    EXPECT_EQ(0U, actual[9]);
    EXPECT_EQ(std::vector<uint32_t>(12, 0), rowOf(partPaint.dst, 1));
    EXPECT_EQ(std::vector<uint32_t>(12, 0), rowOf(partPaint.dst, 7));
}

// --- Pixels -------------------------------------------------------------------------------------------

TEST(RadialGradient, Coverage_GatesButDoesNotScale) {
    Scene scene = sceneOf(filledMask(3, 1, 0));
    scene.mask.bytes = {1, 0, 255};
    const Scene result = filled(scene, 1.0F, {{0xFF203040, 1.0F, 0.0F}});
    EXPECT_EQ((std::vector<uint8_t>{0x20, 0x30, 0x40, 0xFF, 0, 0, 0, 0, 0x20, 0x30, 0x40, 0xFF}),
              result.dst.bytes);
}

TEST(RadialGradient, StraightColours_ArePremultiplied) {
    const Scene result = filled(sceneOf(filledMask(1, 1, 255)), 1.0F, {{0x80FF4020, 1.0F, 0.0F}});
    EXPECT_EQ((std::vector<uint8_t>{128, 32, 16, 128}), result.dst.bytes);
}

TEST(RadialGradient, OpaqueDestination_IsUntouched) {
    Scene scene = sceneOf(filledMask(8, 8, 255));
    scene.dst = filledPicture(8, 8, 0xFF112233);
    EXPECT_TRUE(samePaint(scene, filled(scene, 1.0F, kRamp)));
}

TEST(RadialGradient, OpacitiesOfRecordAndStops_AreNotRead) {
    const Scene scene = sceneOf(filledMask(20, 20, 255));
    VFGradient stops[] = {{kBlack, 0.1F, 0.0F}, {kWhite, 0.2F, 1.0F}};
    VFRadialGradientProperty record(0.0F, 1.0F, 0.3F, 2, stops);
    VFRadialGradient core;
    core.setProperty(&record);
    EXPECT_TRUE(samePaint(filled(scene, 1.0F, kRamp), painted(core, scene)));
}

// --- The colour table, seen along the centre line
// ---------------------------------------------------------

TEST(RadialGradient, Table_OfTwoStopsIsALinearRamp) {
    const std::vector<uint32_t> table = tableOf(kRamp);
    for (uint32_t i = 0; i < 256; ++i) {
        const uint32_t grey = i * 255 >> 8;
        ASSERT_EQ(0xFF000000 | grey << 16 | grey << 8 | grey, table[i]) << i;
    }
}

TEST(RadialGradient, Table_OfOneStopIsFlat) {
    EXPECT_EQ(std::vector<uint32_t>(256, kGreen), tableOf({{kGreen, 1.0F, 0.4F}}));
}

TEST(RadialGradient, Table_BeforeTheFirstStopHasItsColour) {
    const std::vector<uint32_t> table = tableOf({{kBlack, 1.0F, 0.5F}, {kWhite, 1.0F, 1.0F}});
    for (size_t i = 0; i <= 128; ++i)
        ASSERT_EQ(kBlack, table[i]) << i;
    EXPECT_EQ(0xFF7F7F7F, table[192]);
}

TEST(RadialGradient, Table_KeepsTheLastSegmentWhenStopsEndEarly) {
    const std::vector<uint32_t> table =
        tableOf({{kBlack, 1.0F, 0.0F}, {kRed, 1.0F, 0.125F}, {kBlue, 1.0F, 0.25F}});
    EXPECT_EQ(0xFF7F007F, table[48]);
    for (size_t i = 64; i <= 255; ++i)
        ASSERT_EQ(kBlue, table[i]) << i;
}

TEST(RadialGradient, Table_PassesOneStopPerEntry) {
    const std::vector<uint32_t> table = tableOf({{kBlack, 1.0F, 0.0F},
                                                 {kRed, 1.0F, 0.1F},
                                                 {kGreen, 1.0F, 0.1001F},
                                                 {kBlue, 1.0F, 0.1002F},
                                                 {kBlack, 1.0F, 1.0F}});
    EXPECT_EQ(kGreen, table[26]);
    EXPECT_EQ(kBlue, table[27]);
    EXPECT_EQ(0xFF0000FDU, table[28]);
}

// --- Hostile input ----------------------------------------------------------------------------------

TEST(RadialGradient, BrokenInput_PaintsNothing) {
    const auto core = coreWith(1.0F, kRamp);
    expectNothingFromBrokenInput(*core);
}

TEST(RadialGradient, NoStops_PaintNothing) {
    const Scene scene = sceneOf(filledMask(8, 8, 255));
    VFGradient stops[] = {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 1.0F}};
    for (int count : {0, -1, -2147483647 - 1}) {
        VFRadialGradientProperty record(0.0F, 1.0F, 1.0F, count, stops);
        VFRadialGradient core;
        core.setProperty(&record);
        EXPECT_TRUE(paintsNothing(core, scene)) << count;
    }
    for (int count : {0, 1, 2, 256, -5}) {
        VFRadialGradientProperty record(0.0F, 1.0F, 1.0F, count, nullptr);
        VFRadialGradient core;
        core.setProperty(&record);
        EXPECT_TRUE(paintsNothing(core, scene)) << count;
    }
}

// --- Against the literal form -----------------------------------------------------------------------

TEST(RadialGradient, RandomScenes_MatchTheLiteralForm) {
    forSeeds(1000, 5000, [](Random& random) {
        const Scene scene = randomScene(random, 50);
        const int count = random.chance(3) ? 256 : random.between(1, 8);
        const float scale = random.chance(3) ? std::nanf("") : random.real(0.08F, 2.2F);
        EXPECT_TRUE(matchesLiteral(scene, scale, randomStops(random, count)));
    });
}

TEST(RadialGradient, EveryMaskOfTheGallery_MatchesTheLiteralForm) {
    for (const NamedMask& named : maskGallery()) {
        SCOPED_TRACE(named.name);
        Random random(99);
        for (int i = 0; i < 12; ++i) {
            const Scene scene = randomScene(random, named.mask);
            ASSERT_TRUE(matchesLiteral(scene, random.real(0.1F, 2.0F), randomStops(random, 4)));
        }
    }
}

TEST(RadialGradient, DestinationOfAnotherSize_IsClipped) {
    forSeeds(3000, 300, [](Random& random) {
        Scene scene = randomScene(random, 16);
        scene.dst = randomPicture(random, random.between(1, 24), random.between(1, 24));
        EXPECT_TRUE(matchesLiteral(scene, 1.0F, randomStops(random, 3)));
    });
}

}  // namespace
