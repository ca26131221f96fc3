#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdlib>
#include <limits>
#include <set>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/literal_cores.h"
#include "tests/support/mask_gallery.h"

namespace {

using namespace vorel_test;
using literal::Stop;
using VFontEffect::VFGradient;
using VFontEffect::VFLinearGradient;
using VFontEffect::VFLinearGradientProperty;

const Gradient kGradient{coreOf<VFLinearGradient, VFLinearGradientProperty>};
const std::vector<Stop>& kRamp = Gradient::ramp();

int greyOf(int entry) {
    return Gradient::greyOf(entry);
}

::testing::AssertionResult matchesLiteral(const Scene& scene, float angle, float scale,
                                          const std::vector<Stop>& stops) {
    const auto core = kGradient.core(angle, scale, stops);
    const auto* record = static_cast<VFLinearGradientProperty*>(core->getProperty());
    auto same = paintsLike(*core, scene, [&](Scene& expected) {
        literal::paintLinearGradient(expected.dst, expected.mask, expected.text, record->mAngle,
                                     record->mScale, stops);
    });
    if (!same) same << "; angle " << angle << ", scale " << scale << ", stops " << stops.size();
    return same;
}

/// At angle 0 and scale 1 column x of a box 256 wide shows entry x of the table.
std::vector<uint32_t> tableOf(const std::vector<Stop>& stops) {
    return rowOf(kGradient.painted(sceneOf(filledMask(256, 1, 255)), 0.0F, 1.0F, stops).dst, 0);
}

std::vector<int> greys(std::initializer_list<int> entries) {
    std::vector<int> result;
    for (int entry : entries)
        result.push_back(greyOf(entry));
    return result;
}

// --- The core as an object ------------------------------------------------------------------------

TEST(LinearGradient, NewCore_HasItsTypeAndNoRecord) {
    expectFreshCore<VFLinearGradient>(7);
}

TEST(LinearGradient, Record_IsOwnedByTheCore) {
    VFGradient stops[] = {{kRed, 1.0F, 0.0F}, {kBlue, 0.5F, 1.0F}};
    VFGradient others[] = {{kGreen, 1.0F, 0.0F}, {kRed, 1.0F, 0.2F}, {kBlue, 1.0F, 0.9F}};
    expectOwnsItsRecord<VFLinearGradient>(VFLinearGradientProperty(30.0F, 1.0F, 0.5F, 2, stops),
                                          VFLinearGradientProperty(70.0F, 0.5F, 1.0F, 3, others),
                                          sceneOf(discMask(30, 30, 15.0F, 14.0F, 9.0F, true)));
}

TEST(LinearGradient, Stops_AreCopied) {
    VFLinearGradient core;
    expectCopiesItsStops(core, sceneOf(filledMask(20, 20, 255)), [](VFGradient* stops) {
        return VFLinearGradientProperty(725.5F, 3.5F, 0.5F, 2, stops);
    });
    const auto* stored = static_cast<VFLinearGradientProperty*>(core.getProperty());
    EXPECT_EQ(5.0F, stored->mAngle);
    EXPECT_EQ(2.0F, stored->mScale);
    EXPECT_EQ(0.5F, stored->mOpacity);
    EXPECT_EQ(0U, stored->mColor);
}

TEST(LinearGradient, Offsets_StayZero) {
    expectNoReach(*kGradient.core(30.0F, 2.0F, kRamp));
}

// --- Direction and length by hand ---------------------------------------------------------------------

TEST(LinearGradient, AngleZero_RunsFromLeftToRight) {
    // (x - 2) * 64 + 128.
    EXPECT_EQ(greys({0, 64, 128, 192}),
              channelOf(kGradient.painted(sceneOf(filledMask(4, 1, 255)), 0.0F, 1.0F, kRamp).dst, 0));
    // (x - 2.5) * 51.2, truncated towards zero, + 128: -128, -76.8, -25.6, 25.6, 76.8.
    EXPECT_EQ(greys({0, 52, 103, 153, 204}),
              channelOf(kGradient.painted(sceneOf(filledMask(5, 1, 255)), 0.0F, 1.0F, kRamp).dst, 0));
}

TEST(LinearGradient, Angle90_RunsFromBottomToTop) {
    // The cosine of a hair less than a right angle adds -0.00004 half a pixel left of the centre: the
    // sums 127.99996, 63.99996, -0.00004 and -64.00004 are cut towards zero.
    EXPECT_EQ(greys({255, 191, 128, 64}),
              channelOf(kGradient.painted(sceneOf(filledMask(1, 4, 255)), 90.0F, 1.0F, kRamp).dst, 0));
}

TEST(LinearGradient, Angle180_RunsFromRightToLeft) {
    const std::vector<int> red =
        channelOf(kGradient.painted(sceneOf(filledMask(64, 1, 255)), 180.0F, 1.0F, kRamp).dst, 0);
    for (size_t x = 1; x < red.size(); ++x)
        ASSERT_LT(red[x], red[x - 1]) << x;
}

TEST(LinearGradient, PositiveAngle_TurnsCounterClockwise) {
    const std::vector<int> red =
        channelOf(kGradient.painted(sceneOf(filledMask(20, 20, 255)), 45.0F, 1.0F, kRamp).dst, 0);
    const int topRight = red[19];
    const int bottomLeft = red[19 * 20];
    EXPECT_GT(topRight, 230);
    EXPECT_LT(bottomLeft, 15);
    EXPECT_NEAR(red[0], 128, 8);
    EXPECT_NEAR(red[19 * 20 + 19], 128, 8);
}

TEST(LinearGradient, Length_FollowsTheSideThatTheLineLeavesBy) {
    // At 45 degrees in a box 40 x 10 the line leaves by the top: length 10 / sin 45 = 14.14. One pixel
    // to the right moves by cos 45 * 256 / 14.14 = 12.8 entries.
    const std::vector<int> red =
        channelOf(kGradient.painted(sceneOf(filledMask(40, 10, 255)), 45.0F, 1.0F, kRamp).dst, 0);
    EXPECT_EQ(greyOf(128), red[5 * 40 + 20]);
    EXPECT_EQ(greyOf(128 + 12), red[5 * 40 + 21]);
    EXPECT_EQ(greyOf(128 + 25), red[5 * 40 + 22]);
    EXPECT_EQ(greyOf(128 - 12), red[5 * 40 + 19]);
    // In a box 10 x 40 it leaves by the side: the same length.
    const std::vector<int> tall =
        channelOf(kGradient.painted(sceneOf(filledMask(10, 40, 255)), 45.0F, 1.0F, kRamp).dst, 0);
    EXPECT_EQ(greyOf(128 + 12), tall[20 * 10 + 6]);
    EXPECT_EQ(greyOf(128 + 25), tall[20 * 10 + 7]);
}

TEST(LinearGradient, Steps_AreStripesInABoxWiderThan256) {
    // 2048 columns show the 256 colours of a box of 256: each for 8 columns, and the middle one, to
    // which both sides are cut, for 15.
    const std::vector<uint32_t> table = tableOf(kRamp);
    const std::vector<uint32_t> row =
        rowOf(kGradient.painted(sceneOf(filledMask(2048, 1, 255)), 0.0F, 1.0F, kRamp).dst, 0);
    for (int x = 0; x < 2048; ++x)
        EXPECT_EQ(table[static_cast<size_t>(128 + (x - 1024) / 8)], row[static_cast<size_t>(x)]) << x;
    EXPECT_EQ(row[1024 - 7], row[1024 + 7]);
    EXPECT_NE(row[1024], row[1024 + 8]);
}

TEST(LinearGradient, Steps_AreAsWideAsTheBoxTimesTheScaleBy256) {
    // A quarter of 1024 columns shows the ramp, an entry a column, as a box of 256 at a scale of 1 does.
    const std::vector<uint32_t> table = tableOf(kRamp);
    const std::vector<uint32_t> row =
        rowOf(kGradient.painted(sceneOf(filledMask(1024, 1, 255)), 0.0F, 0.25F, kRamp).dst, 0);
    for (int x = 0; x < 256; ++x)
        EXPECT_EQ(table[static_cast<size_t>(x)], row[static_cast<size_t>(384 + x)]) << x;
    EXPECT_EQ(table[0], row[0]);
    EXPECT_EQ(table[255], row[1023]);
}

/// The largest change of a channel from an entry to the next.
int largestStep(const std::vector<uint32_t>& table) {
    int largest = 0;
    for (size_t i = 1; i < table.size(); ++i)
        for (const int shift : {0, 8, 16})
            largest = std::max(largest, std::abs(static_cast<int>(table[i] >> shift & 255) -
                                                 static_cast<int>(table[i - 1] >> shift & 255)));
    return largest;
}

TEST(LinearGradient, Steps_BetweenTwoStopsOverTheWholeRampAreOneValueAtMost) {
    // 255 values at most on 256 entries. From black to white each grey from 0 to 254 is there.
    const std::vector<uint32_t> greys = tableOf(kRamp);
    EXPECT_EQ(1, largestStep(greys));
    EXPECT_EQ(255U, std::set<uint32_t>(greys.begin(), greys.end()).size());
    EXPECT_EQ(1, largestStep(tableOf({{0xFF5B2A86, 1.0F, 0.0F}, {0xFFFFB03A, 1.0F, 1.0F}})));
}

TEST(LinearGradient, Steps_BetweenStopsATenthApartAreTenValues) {
    // 255 values on 25.6 entries: 26 steps of 9.96, off by the rounding of both ends.
    const std::vector<uint32_t> greys = tableOf({{kBlack, 1.0F, 0.4F}, {kWhite, 1.0F, 0.5F}});
    EXPECT_EQ(27U, std::set<uint32_t>(greys.begin(), greys.end()).size());
    EXPECT_NEAR(10, largestStep(greys), 1);
}

/// A colour in CIE L*a*b* under the white of sRGB.
std::array<double, 3> labOf(uint32_t rgb) {
    const auto linear = [rgb](int shift) {
        const double value = (rgb >> shift & 255) / 255.0;
        return value <= 0.04045 ? value / 12.92 : std::pow((value + 0.055) / 1.055, 2.4);
    };
    const auto root = [](double t) {
        return t > 216.0 / 24389 ? std::cbrt(t) : (t * 24389 / 27 + 16) / 116;
    };
    const double red = linear(16);
    const double green = linear(8);
    const double blue = linear(0);
    const double x = root((0.4124 * red + 0.3576 * green + 0.1805 * blue) / 0.9505);
    const double y = root(0.2126 * red + 0.7152 * green + 0.0722 * blue);
    const double z = root((0.0193 * red + 0.1192 * green + 0.9505 * blue) / 1.089);
    return {116 * y - 16, 500 * (x - y), 200 * (y - z)};
}

/// Mean and largest distance from an entry to the next one of another colour, in tenths.
std::array<long, 2> distancesOf(const std::vector<uint32_t>& table) {
    double sum = 0;
    double largest = 0;
    int count = 0;
    for (size_t i = 1; i < table.size(); ++i) {
        if (table[i] == table[i - 1]) continue;
        ++count;
        const auto a = labOf(table[i - 1]);
        const auto b = labOf(table[i]);
        const double distance = std::hypot(a[0] - b[0], a[1] - b[1], a[2] - b[2]);
        sum += distance;
        largest = std::max(largest, distance);
    }
    return {std::lround(sum / count * 10), std::lround(largest * 10)};
}

TEST(LinearGradient, Steps_AreAsFarApartForTheEyeAsItsPageSays) {
    EXPECT_EQ((std::array<long, 2>{7, 12}),
              distancesOf(tableOf({{0xFF5B2A86, 1, 0}, {0xFFFFB03A, 1, 1}})));
    EXPECT_EQ((std::array<long, 2>{25, 49}), distancesOf(tableOf({{0xFFFF0000, 1, 0},
                                                                  {0xFFFFFF00, 1, 0.17F},
                                                                  {0xFF00FF00, 1, 0.33F},
                                                                  {0xFF00FFFF, 1, 0.5F},
                                                                  {0xFF0000FF, 1, 0.67F},
                                                                  {0xFFFF00FF, 1, 0.83F},
                                                                  {0xFFFF0000, 1, 1}})));
}

TEST(LinearGradient, Scale_StretchesOrCompressesTheRamp) {
    const Scene line = sceneOf(filledMask(4, 1, 255));
    EXPECT_EQ(greys({64, 96, 128, 160}), channelOf(kGradient.painted(line, 0.0F, 2.0F, kRamp).dst, 0));
    // Half the length: (x - 2) * 128 + 128, clamped to the table.
    EXPECT_EQ(greys({0, 0, 128, 255}), channelOf(kGradient.painted(line, 0.0F, 0.5F, kRamp).dst, 0));
    EXPECT_EQ(greys({64, 96, 128, 160}), channelOf(kGradient.painted(line, 0.0F, 9.0F, kRamp).dst, 0));
}

TEST(LinearGradient, ScaleBelowATenth_PaintsNothing) {
    const Scene scene = sceneOf(filledMask(8, 8, 255));
    for (float scale : {0.05F, 0.0999F, 0.0F, -1.0F, -std::numeric_limits<float>::infinity()}) {
        EXPECT_TRUE(samePaint(scene, kGradient.painted(scene, 0.0F, scale, kRamp))) << scale;
    }
    EXPECT_FALSE(samePaint(scene, kGradient.painted(scene, 0.0F, 0.1F, kRamp)));
}

TEST(LinearGradient, ScaleThatIsNotANumber_PaintsTheMiddleEntry) {
    const std::vector<int> red =
        channelOf(kGradient.painted(sceneOf(filledMask(6, 2, 255)), 0.0F, std::nanf(""), kRamp).dst, 0);
    EXPECT_EQ(std::vector<int>(12, greyOf(128)), red);
}

TEST(LinearGradient, Box_IsTheFrameOfTheRamp) {
    Scene scene = sceneOf(filledMask(9, 3, 255), {3, 1, 7, 2});
    const std::vector<int> red = channelOf(kGradient.painted(scene, 0.0F, 1.0F, kRamp).dst, 0);
    EXPECT_EQ(greys({0, 0, 0, 0, 64, 128, 192, 0, 0}),
              std::vector<int>(red.begin() + 9, red.begin() + 18));
    const std::vector<int> alpha = alphaOf(kGradient.painted(scene, 0.0F, 1.0F, kRamp).dst);
    EXPECT_EQ((std::vector<int>{0, 0, 0, 255, 255, 255, 255, 0, 0}),
              std::vector<int>(alpha.begin() + 9, alpha.begin() + 18));
    EXPECT_EQ(0, alpha[4]);
    EXPECT_EQ(0, alpha[22]);
}

// --- Pixels -------------------------------------------------------------------------------------------

TEST(LinearGradient, Coverage_GatesButDoesNotScale) {
    expectCoverageGates(*kGradient.core(0.0F, 1.0F, {{0xFF203040, 1.0F, 0.0F}}),
                        {0x20, 0x30, 0x40, 0xFF});
}

TEST(LinearGradient, SingleStop_FillsFlat) {
    const Scene result =
        kGradient.painted(sceneOf(filledMask(7, 5, 255)), 33.0F, 1.3F, {{0xFF203040, 1.0F, 0.6F}});
    EXPECT_TRUE(samePicture(filledPicture(7, 5, 0xFF203040), result.dst));
}

TEST(LinearGradient, StraightColours_ArePremultiplied) {
    const Scene result =
        kGradient.painted(sceneOf(filledMask(1, 1, 255)), 0.0F, 1.0F, {{0x80FF4020, 1.0F, 0.0F}});
    // 256 * 128 >> 8, 65 * 128 >> 8, 33 * 128 >> 8.
    EXPECT_EQ((std::vector<uint8_t>{128, 32, 16, 128}), result.dst.bytes);
}

TEST(LinearGradient, OpaqueDestination_IsUntouched) {
    expectOpaqueDestinationUntouched(*kGradient.core(0.0F, 1.0F, kRamp), sceneOf(filledMask(8, 8, 255)));
}

TEST(LinearGradient, OpacitiesOfRecordAndStops_AreNotRead) {
    kGradient.expectOpacitiesNotRead(30.0F);
}

// --- The colour table, seen through a box of 256 columns -------------------------------------------

TEST(LinearGradient, Table_OfTwoStopsIsALinearRamp) {
    Gradient::expectLinearRampOfTwoStops(tableOf);
}

TEST(LinearGradient, Table_BeforeTheFirstStopHasItsColour) {
    Gradient::expectFirstColourBeforeTheFirstStop(tableOf);
}

TEST(LinearGradient, Table_KeepsTheLastSegmentWhenStopsEndEarly) {
    Gradient::expectLastSegmentWhenStopsEndEarly(tableOf);
}

TEST(LinearGradient, Table_PassesOneStopPerEntry) {
    Gradient::expectOneStopPassedPerEntry(tableOf);
}

TEST(LinearGradient, Table_PassesAStopOnlyBeyondIt) {
    // Entry 64 lies on the second stop and passes none; entry 65 passes it and stays at the third,
    // entry 66 is (0.2578 - 0.2501) / 0.7499 * 256 = 2.6, so 2 of 256 towards black.
    const std::vector<uint32_t> table = tableOf(
        {{kBlack, 1.0F, 0.0F}, {kRed, 1.0F, 0.25F}, {kWhite, 1.0F, 0.2501F}, {kBlack, 1.0F, 1.0F}});
    EXPECT_EQ(kRed, table[64]);
    EXPECT_EQ(kWhite, table[65]);
    EXPECT_EQ(0xFFFDFDFD, table[66]);
}

TEST(LinearGradient, Table_OfSegmentsWithoutLengthJumps) {
    const std::vector<uint32_t> early = tableOf({{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 0.0F}});
    EXPECT_EQ(kRed, early[0]);
    for (size_t i = 1; i < 256; ++i)
        ASSERT_EQ(kBlue, early[i]);
    // 0.5 - 0.5 over nothing is not a number: entry 128 keeps the lower colour.
    const std::vector<uint32_t> middle = tableOf({{kRed, 1.0F, 0.5F}, {kBlue, 1.0F, 0.5F}});
    EXPECT_EQ(kRed, middle[127]);
    EXPECT_EQ(kRed, middle[128]);
    EXPECT_EQ(kBlue, middle[129]);
    const std::vector<uint32_t> unknown = tableOf({{kRed, 1.0F, std::nanf("")}, {kBlue, 1.0F, 1.0F}});
    for (size_t i = 0; i < 256; ++i)
        ASSERT_EQ(kRed, unknown[i]);
}

TEST(LinearGradient, Table_OfUnsortedStopsMatchesTheLiteralForm) {
    const std::vector<Stop> stops{{kRed, 1.0F, 0.9F}, {kBlue, 1.0F, 0.2F}, {kGreen, 1.0F, 0.6F}};
    const std::vector<uint32_t> expected = literal::gradientColours(stops);
    EXPECT_EQ(std::vector<uint32_t>(expected.begin(), expected.begin() + 256), tableOf(stops));
    // Entry 0 is the first stop's; at entry 25 (0.0977 - 0.9) / -0.7 = 1.15 saturates to the second.
    EXPECT_EQ(kRed, tableOf(stops)[0]);
    EXPECT_EQ(kBlue, tableOf(stops)[25]);
}

// --- Hostile input ----------------------------------------------------------------------------------

TEST(LinearGradient, BrokenInput_PaintsNothing) {
    expectNothingFromBrokenInput(*kGradient.core(30.0F, 1.0F, kRamp));
}

TEST(LinearGradient, NoStops_PaintNothing) {
    kGradient.expectNothingWithoutStops();
}

// --- Against the literal form -----------------------------------------------------------------------

TEST(LinearGradient, EveryWholeAngle_MatchesTheLiteralForm) {
    const std::vector<Stop> stops{{kGreen, 1.0F, 0.0F}, {0x80FF0000, 1.0F, 0.4F}, {kBlue, 1.0F, 1.0F}};
    const Scene wide = sceneOf(filledMask(37, 12, 255), {2, 1, 36, 12});
    const Scene tall = sceneOf(filledMask(9, 31, 255));
    const Scene square = sceneOf(filledMask(16, 16, 255));
    for (int angle = -359; angle < 360; ++angle) {
        for (const Scene* scene : {&wide, &tall, &square}) {
            ASSERT_TRUE(matchesLiteral(*scene, static_cast<float>(angle), 1.0F, stops));
        }
    }
}

TEST(LinearGradient, RandomScenes_MatchTheLiteralForm) {
    forSeeds(1000, 5000, [](Random& random) {
        const Scene scene = randomScene(random, 50);
        const int count = random.chance(3) ? 256 : random.between(1, 8);
        const float scale = random.chance(3) ? std::nanf("") : random.real(0.08F, 2.2F);
        EXPECT_TRUE(
            matchesLiteral(scene, random.real(-720.0F, 720.0F), scale, randomStops(random, count)));
    });
}

TEST(LinearGradient, EveryMaskOfTheGallery_MatchesTheLiteralForm) {
    forGallery([](Random& random, const literal::Mask& mask) {
        for (int i = 0; i < 12; ++i) {
            const Scene scene = randomScene(random, mask);
            ASSERT_TRUE(matchesLiteral(scene, random.real(0.0F, 360.0F), random.real(0.1F, 2.0F),
                                       randomStops(random, 4)));
        }
    });
}

TEST(LinearGradient, DestinationOfAnotherSize_IsClipped) {
    forOtherDestinations(300, 16, 24, [](Random& random, const Scene& scene) {
        EXPECT_TRUE(matchesLiteral(scene, random.real(0.0F, 360.0F), 1.0F, randomStops(random, 3)));
    });
}

}  // namespace
