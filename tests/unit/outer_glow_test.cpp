#include <gtest/gtest.h>

#include <algorithm>
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
using VFontEffect::VFOuterGlow;
using VFontEffect::VFOuterGlowProperty;

constexpr uint32_t kWhite = 0xFFFFFFFF;
constexpr uint32_t kRed = 0xFFFF0000;
constexpr uint32_t kGreen = 0xFF00FF00;
constexpr uint32_t kBlue = 0xFF0000FF;

void giveRecord(VFOuterGlow& core, float size, uint32_t color, const std::vector<Stop>& stops) {
    std::vector<VFGradient> array = libraryStops(stops);
    VFOuterGlowProperty record(size, color, 1.0F, static_cast<int>(array.size()),
                               array.empty() ? nullptr : array.data());
    core.setProperty(&record);
}

Scene glowing(const Scene& scene, float size, uint32_t color, const std::vector<Stop>& stops = {}) {
    VFOuterGlow core;
    giveRecord(core, size, color, stops);
    return painted(core, scene);
}

::testing::AssertionResult matchesLiteral(const Scene& scene, float size, uint32_t color,
                                          const std::vector<Stop>& stops = {}) {
    VFOuterGlow core;
    giveRecord(core, size, color, stops);
    auto same = paintsLike(core, scene, [&](Scene& expected) {
        literal::paintOuterGlow(expected.dst, expected.mask, expected.text, size, color, stops);
    });
    if (!same) same << "; size " << size << ", stops " << stops.size();
    return same;
}

/// A covered pixel in the middle of a picture.
Scene lonePixel(int side) {
    const int middle = side / 2;
    Scene scene = sceneOf(filledMask(side, side, 0), {middle, middle, middle + 1, middle + 1});
    scene.mask.bytes[static_cast<size_t>(middle * side + middle)] = 255;
    return scene;
}

// --- The core as an object ------------------------------------------------------------------------

TEST(OuterGlow, NewCore_HasItsTypeAndNoRecord) {
    expectFreshCore<VFOuterGlow>(3);
}

TEST(OuterGlow, Record_IsOwnedByTheCore) {
    VFGradient stops[] = {{kRed, 1.0F, 0.0F}, {kBlue, 0.5F, 1.0F}};
    VFGradient others[] = {{kGreen, 1.0F, 0.0F}, {kRed, 1.0F, 0.2F}, {kBlue, 1.0F, 0.9F}};
    expectOwnsItsRecord<VFOuterGlow>(VFOuterGlowProperty(6.0F, kWhite, 0.5F, 2, stops),
                                     VFOuterGlowProperty(4.0F, 0x80402010, 1.0F, 3, others),
                                     sceneOf(discMask(50, 50, 25.0F, 24.0F, 6.0F, true)));
}

TEST(OuterGlow, Stops_AreCopied) {
    const Scene scene = sceneOf(discMask(40, 40, 20.0F, 19.0F, 6.0F, true));
    auto stops = std::make_unique<VFGradient[]>(2);
    stops[0] = {kRed, 0.25F, 0.0F};
    stops[1] = {kBlue, 0.75F, 0.5F};
    VFOuterGlowProperty record(6.0F, 0x12345678, 0.5F, 2, stops.get());
    VFOuterGlow core;
    core.setProperty(&record);
    const Scene before = painted(core, scene);
    stops[0].mColor = kGreen;
    stops[1].mLocation = 0.1F;
    EXPECT_TRUE(samePaint(before, painted(core, scene)));
    stops.reset();
    EXPECT_TRUE(samePaint(before, painted(core, scene)));

    const auto* stored = static_cast<VFOuterGlowProperty*>(core.getProperty());
    EXPECT_EQ(6.0F, stored->mSize);
    EXPECT_EQ(0x12345678U, stored->mColor);
    EXPECT_EQ(0.5F, stored->mOpacity);
    ASSERT_EQ(2, stored->mGradientCount);
    EXPECT_EQ(kRed, stored->mGradient[0].mColor);
    EXPECT_EQ(0.25F, stored->mGradient[0].mOpacity);
    EXPECT_EQ(0.0F, stored->mGradient[0].mLocation);
    EXPECT_EQ(kBlue, stored->mGradient[1].mColor);
    EXPECT_EQ(0.75F, stored->mGradient[1].mOpacity);
    EXPECT_EQ(0.5F, stored->mGradient[1].mLocation);
}

// --- By hand ----------------------------------------------------------------------------------------

TEST(OuterGlow, SizeZero_PaintsNothing) {
    const Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    EXPECT_TRUE(samePaint(scene, glowing(scene, 0.0F, kWhite)));
    EXPECT_TRUE(
        samePaint(scene, glowing(scene, 0.0F, kWhite, {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 1.0F}})));
}

TEST(OuterGlow, SizeBelowOne_GrowsByOnePixelWithoutABlur) {
    // Padding 1, one pass: the 3 x 3 around the pixel is 63. Radius trunc(0.9) = 0 blurs nothing.
    // Entry 256 - 63 = 193: m = 256 * 63 / 180 = 89, alpha 255 * 89 >> 8 = 88, channels the same.
    const Scene result = glowing(lonePixel(7), 0.5F, kWhite);
    const std::vector<int> expected{0, 0, 0,  0,  0,  0, 0,  //
                                    0, 0, 0,  0,  0,  0, 0,  //
                                    0, 0, 88, 88, 88, 0, 0,  //
                                    0, 0, 88, 88, 88, 0, 0,  //
                                    0, 0, 88, 88, 88, 0, 0,  //
                                    0, 0, 0,  0,  0,  0, 0,  //
                                    0, 0, 0,  0,  0,  0, 0};
    EXPECT_EQ(expected, alphaOf(result.dst));
    EXPECT_EQ(expected, channelOf(result.dst, 0));
}

TEST(OuterGlow, SizeOne_BlursByOnePixel) {
    // Padding 2, one pass, radius 1: weights 128 and 1 of 130. The 3 x 3 of 63 becomes 61 in the
    // corners (62 * 129 / 130), 62 at the sides (63 * 129 / 130) and 63 in the middle, nothing outside.
    // m = 256 * v / 180 is 86, 88 and 89; alpha 255 * m >> 8 is 85, 87 and 88.
    const Scene result = glowing(lonePixel(7), 1.0F, kWhite);
    const std::vector<int> expected{0, 0, 0,  0,  0,  0, 0,  //
                                    0, 0, 0,  0,  0,  0, 0,  //
                                    0, 0, 85, 87, 85, 0, 0,  //
                                    0, 0, 87, 88, 87, 0, 0,  //
                                    0, 0, 85, 87, 85, 0, 0,  //
                                    0, 0, 0,  0,  0,  0, 0,  //
                                    0, 0, 0,  0,  0,  0, 0};
    EXPECT_EQ(expected, alphaOf(result.dst));
}

TEST(OuterGlow, ColoursAreStraight_AndPremultipliedIntoThePixel) {
    // Entry 193 as above, of the colour 0x80FF4020: alpha 128 * 89 >> 8 = 44; 256 * 44 >> 8 = 44,
    // 65 * 44 >> 8 = 11, 33 * 44 >> 8 = 5.
    const Scene result = glowing(lonePixel(7), 0.5F, 0x80FF4020);
    const size_t middle = (3 * 7 + 3) * 4;
    EXPECT_EQ(
        (std::vector<uint8_t>{44, 11, 5, 44}),
        std::vector<uint8_t>(result.dst.bytes.begin() + middle, result.dst.bytes.begin() + middle + 4));
}

TEST(OuterGlow, FullStrength_TakesEntryOneNeverEntryZero) {
    const Scene scene = sceneOf(filledMask(30, 30, 255));
    // Entry 1 is 1 of 256 from green to red: green 255 * 255 >> 8 = 254. Entry 0 would be 255.
    const Scene result = glowing(scene, 2.0F, 0, {{kGreen, 1.0F, 0.0F}, {kRed, 1.0F, 1.0F}});
    const size_t middle = (15 * 30 + 15) * 4;
    EXPECT_EQ(
        (std::vector<uint8_t>{0, 254, 0, 255}),
        std::vector<uint8_t>(result.dst.bytes.begin() + middle, result.dst.bytes.begin() + middle + 4));
}

TEST(OuterGlow, SizeTen_StaysInsideItsImageAndItsBorder) {
    // Padding 11: the image reaches 22 pixels beyond the box, its outermost 9 stay transparent.
    Scene scene = sceneOf(filledMask(80, 80, 255), {35, 33, 47, 45});
    const std::vector<int> alpha = alphaOf(glowing(scene, 10.0F, kWhite).dst);
    int left = 80, top = 80, right = 0, bottom = 0;
    for (int y = 0; y < 80; ++y) {
        for (int x = 0; x < 80; ++x) {
            if (alpha[static_cast<size_t>(y * 80 + x)] == 0) continue;
            left = std::min(left, x);
            top = std::min(top, y);
            right = std::max(right, x + 1);
            bottom = std::max(bottom, y + 1);
        }
    }
    EXPECT_LE(35 - 13, left);
    EXPECT_LE(33 - 13, top);
    EXPECT_GE(47 + 13, right);
    EXPECT_GE(45 + 13, bottom);
    // Five passes grow the box by five pixels at least; the glow is the same on all sides.
    EXPECT_GE(35 - 5, left);
    EXPECT_EQ(35 - left, 33 - top);
    EXPECT_EQ(35 - left, right - 47);
    EXPECT_EQ(35 - left, bottom - 45);
}

TEST(OuterGlow, CoverageOutsideTheBox_IsNotRead) {
    Scene scene = lonePixel(9);
    const Scene alone = glowing(scene, 1.0F, kWhite);
    scene.mask.bytes.assign(81, 255);
    EXPECT_TRUE(samePicture(alone.dst, glowing(scene, 1.0F, kWhite).dst));
}

TEST(OuterGlow, OpaqueDestination_IsUntouched) {
    Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    scene.dst = filledPicture(20, 20, 0xFF112233);
    EXPECT_TRUE(samePaint(scene, glowing(scene, 5.0F, kWhite)));
}

TEST(OuterGlow, Opacity_IsNotRead) {
    const Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    VFOuterGlow core;
    VFOuterGlowProperty record(5.0F, kRed, 0.25F, 0, nullptr);
    core.setProperty(&record);
    EXPECT_TRUE(samePaint(glowing(scene, 5.0F, kRed), painted(core, scene)));
}

TEST(OuterGlow, LayeredModeAndSecondDestination_AreNotRead) {
    Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    const Scene plain = glowing(scene, 3.0F, kRed);
    scene.useOuterLayer = true;
    scene.sub = filledPicture(20, 20, 0);
    const Scene layered = glowing(scene, 3.0F, kRed);
    EXPECT_TRUE(samePicture(plain.dst, layered.dst));
    EXPECT_TRUE(samePicture(*scene.sub, *layered.sub));
}

// --- Hostile input ----------------------------------------------------------------------------------

TEST(OuterGlow, BrokenInput_PaintsNothing) {
    VFOuterGlow core;
    giveRecord(core, 3.0F, kWhite, {});
    expectNothingFromBrokenInput(core);
}

TEST(OuterGlow, SizesOutOfProportion_PaintNothing) {
    const Scene scene = sceneOf(filledMask(10, 10, 255));
    const float infinity = std::numeric_limits<float>::infinity();
    for (float size : {-1.0F, -1.9F, -2.0F, -50.0F, -1e9F, 256.5F, 1e9F, 3e38F, infinity, -infinity}) {
        EXPECT_TRUE(samePaint(scene, glowing(scene, size, kWhite))) << size;
    }
}

TEST(OuterGlow, SmallNegativeAndUnorderedSizes_MatchTheLiteralForm) {
    const Scene scene = sceneOf(discMask(14, 14, 7.0F, 7.0F, 4.0F, true));
    for (float size : {-0.0F, -0.5F, -0.99F, std::nanf("")}) {
        EXPECT_TRUE(matchesLiteral(scene, size, kRed));
    }
}

TEST(OuterGlow, CountWithoutStops_HasTheOneColour) {
    const Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    for (int count : {1, 2, 256, -4}) {
        VFOuterGlow core;
        VFOuterGlowProperty record(5.0F, kRed, 1.0F, count, nullptr);
        core.setProperty(&record);
        EXPECT_TRUE(samePaint(glowing(scene, 5.0F, kRed), painted(core, scene))) << count;
    }
}

// --- Against the literal form -----------------------------------------------------------------------

TEST(OuterGlow, SmallScenes_MatchTheLiteralForm) {
    forSeeds(1000, 2200, [](Random& random) {
        const Scene scene = randomScene(random, 26);
        const float size =
            random.chance(50) ? static_cast<float>(random.between(0, 9)) : random.real(0.0F, 12.0F);
        const int count = random.chance(30) ? 0 : random.between(1, 6);
        EXPECT_TRUE(matchesLiteral(scene, size, randomStraight(random), randomStops(random, count)));
    });
}

TEST(OuterGlow, EveryWholeSize_MatchesTheLiteralForm) {
    const std::vector<Stop> stops{{kGreen, 1.0F, 0.0F}, {0x80FF0000, 1.0F, 0.4F}, {kBlue, 1.0F, 1.0F}};
    Scene scene = sceneOf(discMask(15, 9, 7.0F, 4.0F, 4.0F, true), {2, 1, 13, 8});
    for (int size = 0; size <= 100; ++size) {
        ASSERT_TRUE(matchesLiteral(scene, static_cast<float>(size), 0, stops));
    }
}

TEST(OuterGlow, EveryMaskOfTheGallery_MatchesTheLiteralForm) {
    for (const NamedMask& named : maskGallery()) {
        SCOPED_TRACE(named.name);
        Random random(99);
        for (float size : {1.0F, 4.0F, 13.0F}) {
            const Scene scene = randomScene(random, named.mask);
            ASSERT_TRUE(matchesLiteral(scene, size, randomStraight(random), randomStops(random, 3)));
            ASSERT_TRUE(matchesLiteral(sceneOf(named.mask), size, kWhite));
        }
    }
}

TEST(OuterGlow, DestinationOfAnotherSize_IsClipped) {
    forSeeds(3000, 200, [](Random& random) {
        Scene scene = randomScene(random, 16);
        scene.dst = randomPicture(random, random.between(1, 24), random.between(1, 24));
        EXPECT_TRUE(matchesLiteral(scene, random.real(0.0F, 6.0F), randomStraight(random)));
    });
}

}  // namespace
