#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/literal_cores.h"
#include "tests/support/mask_gallery.h"

namespace {

using namespace vorel_test;
using literal::Stop;
using VFontEffect::VFGradient;
using VFontEffect::VFRadialGradient;
using VFontEffect::VFRadialGradientProperty;

const Gradient kGradient{coreOf<VFRadialGradient, VFRadialGradientProperty>};
const std::vector<Stop>& kRamp = Gradient::ramp();

int greyOf(int entry) {
    return Gradient::greyOf(entry);
}

Scene filled(const Scene& scene, float scale, const std::vector<Stop>& stops) {
    return kGradient.painted(scene, 0.0F, scale, stops);
}

::testing::AssertionResult matchesLiteral(const Scene& scene, float scale,
                                          const std::vector<Stop>& stops) {
    const auto core = kGradient.core(0.0F, scale, stops);
    const auto* record = static_cast<VFRadialGradientProperty*>(core->getProperty());
    auto same = paintsLike(*core, scene, [&](Scene& expected) {
        literal::paintRadialGradient(expected.dst, expected.mask, expected.text, record->mScale, stops);
    });
    if (!same) same << "; scale " << scale << ", stops " << stops.size();
    return same;
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
    VFRadialGradient core;
    expectCopiesItsStops(core, sceneOf(filledMask(20, 20, 255)), [](VFGradient* stops) {
        return VFRadialGradientProperty(-30.5F, 3.5F, 0.5F, 2, stops);
    });
    const auto* stored = static_cast<VFRadialGradientProperty*>(core.getProperty());
    EXPECT_EQ(-30.0F, stored->mAngle);
    EXPECT_EQ(2.0F, stored->mScale);
    EXPECT_EQ(0.5F, stored->mOpacity);
    EXPECT_EQ(0U, stored->mColor);
}

TEST(RadialGradient, Offsets_StayZero) {
    expectNoReach(*kGradient.core(0.0F, 2.0F, kRamp));
}

TEST(RadialGradient, Angle_IsNotRead) {
    const Scene scene = sceneOf(filledMask(20, 11, 255));
    EXPECT_TRUE(
        samePaint(filled(scene, 1.0F, kRamp), painted(*kGradient.core(77.0F, 1.0F, kRamp), scene)));
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

TEST(RadialGradient, Steps_AreRingsHalfAsWideAsTheStripesOfALine) {
    // The radius of 1024 columns shows the 256 colours that one of 256 has a column each for.
    const std::vector<uint32_t> table =
        rowOf(filled(sceneOf(filledMask(512, 2, 255)), 1.0F, kRamp).dst, 1);
    const std::vector<uint32_t> row =
        rowOf(filled(sceneOf(filledMask(2048, 2, 255)), 1.0F, kRamp).dst, 1);
    for (int x = 1024; x < 2048; ++x) {
        const int entry = (x - 1024) / 4;
        EXPECT_EQ(table[static_cast<size_t>(256 + entry)], row[static_cast<size_t>(x)]) << x;
    }
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
    expectCoverageGates(*kGradient.core(0.0F, 1.0F, {{0xFF203040, 1.0F, 0.0F}}),
                        {0x20, 0x30, 0x40, 0xFF});
}

TEST(RadialGradient, StraightColours_ArePremultiplied) {
    const Scene result = filled(sceneOf(filledMask(1, 1, 255)), 1.0F, {{0x80FF4020, 1.0F, 0.0F}});
    EXPECT_EQ((std::vector<uint8_t>{128, 32, 16, 128}), result.dst.bytes);
}

TEST(RadialGradient, OpaqueDestination_IsUntouched) {
    expectOpaqueDestinationUntouched(*kGradient.core(0.0F, 1.0F, kRamp), sceneOf(filledMask(8, 8, 255)));
}

TEST(RadialGradient, OpacitiesOfRecordAndStops_AreNotRead) {
    kGradient.expectOpacitiesNotRead(0.0F);
}

// --- The colour table, seen along the centre line --------------------------------------------------

TEST(RadialGradient, Table_OfTwoStopsIsALinearRamp) {
    Gradient::expectLinearRampOfTwoStops(tableOf);
}

TEST(RadialGradient, Table_OfOneStopIsFlat) {
    EXPECT_EQ(std::vector<uint32_t>(256, kGreen), tableOf({{kGreen, 1.0F, 0.4F}}));
}

TEST(RadialGradient, Table_BeforeTheFirstStopHasItsColour) {
    Gradient::expectFirstColourBeforeTheFirstStop(tableOf);
}

TEST(RadialGradient, Table_KeepsTheLastSegmentWhenStopsEndEarly) {
    Gradient::expectLastSegmentWhenStopsEndEarly(tableOf);
}

TEST(RadialGradient, Table_PassesOneStopPerEntry) {
    Gradient::expectOneStopPassedPerEntry(tableOf);
}

// --- Hostile input ----------------------------------------------------------------------------------

TEST(RadialGradient, BrokenInput_PaintsNothing) {
    expectNothingFromBrokenInput(*kGradient.core(0.0F, 1.0F, kRamp));
}

TEST(RadialGradient, NoStops_PaintNothing) {
    kGradient.expectNothingWithoutStops();
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
    forGallery([](Random& random, const literal::Mask& mask) {
        for (int i = 0; i < 12; ++i) {
            const Scene scene = randomScene(random, mask);
            ASSERT_TRUE(matchesLiteral(scene, random.real(0.1F, 2.0F), randomStops(random, 4)));
        }
    });
}

TEST(RadialGradient, DestinationOfAnotherSize_IsClipped) {
    forOtherDestinations(300, 16, 24, [](Random& random, const Scene& scene) {
        EXPECT_TRUE(matchesLiteral(scene, 1.0F, randomStops(random, 3)));
    });
}

}  // namespace
