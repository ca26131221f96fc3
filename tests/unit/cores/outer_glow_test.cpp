#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/literal_cores.h"
#include "tests/support/mask_gallery.h"

namespace {

using namespace vorel_test;
using literal::Stop;
using VFontEffect::VFGradient;
using VFontEffect::VFOuterGlow;
using VFontEffect::VFOuterGlowProperty;

const Glow kGlow{coreOf<VFOuterGlow, VFOuterGlowProperty>, literal::paintOuterGlow};

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
    VFOuterGlow core;
    expectCopiesItsStops(
        core, sceneOf(discMask(40, 40, 20.0F, 19.0F, 6.0F, true)),
        [](VFGradient* stops) { return VFOuterGlowProperty(6.0F, 0x12345678, 0.5F, 2, stops); });
    const auto* stored = static_cast<VFOuterGlowProperty*>(core.getProperty());
    EXPECT_EQ(6.0F, stored->mSize);
    EXPECT_EQ(0x12345678U, stored->mColor);
    EXPECT_EQ(0.5F, stored->mOpacity);
}

// --- By hand ----------------------------------------------------------------------------------------

TEST(OuterGlow, SizeZero_PaintsNothing) {
    kGlow.expectNothingOfSizeZero();
}

TEST(OuterGlow, SizeBelowOne_GrowsByOnePixelWithoutABlur) {
    // Padding 1, one pass: the 3 x 3 around the pixel is 63. Radius trunc(0.9) = 0 blurs nothing.
    // Entry 256 - 63 = 193: m = 256 * 63 / 180 = 89, alpha 255 * 89 >> 8 = 88, channels the same.
    const Scene result = kGlow.painted(lonePixel(7), 0.5F, kWhite);
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
    const Scene result = kGlow.painted(lonePixel(7), 1.0F, kWhite);
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
    const Scene result = kGlow.painted(lonePixel(7), 0.5F, 0x80FF4020);
    const size_t middle = (3 * 7 + 3) * 4;
    EXPECT_EQ(
        (std::vector<uint8_t>{44, 11, 5, 44}),
        std::vector<uint8_t>(result.dst.bytes.begin() + middle, result.dst.bytes.begin() + middle + 4));
}

TEST(OuterGlow, FullStrength_TakesEntryOneNeverEntryZero) {
    const Scene scene = sceneOf(filledMask(30, 30, 255));
    // Entry 1 is 1 of 256 from green to red: green 255 * 255 >> 8 = 254. Entry 0 would be 255.
    const Scene result = kGlow.painted(scene, 2.0F, 0, {{kGreen, 1.0F, 0.0F}, {kRed, 1.0F, 1.0F}});
    const size_t middle = (15 * 30 + 15) * 4;
    EXPECT_EQ(
        (std::vector<uint8_t>{0, 254, 0, 255}),
        std::vector<uint8_t>(result.dst.bytes.begin() + middle, result.dst.bytes.begin() + middle + 4));
}

TEST(OuterGlow, HardStops_AreNotSmoothed) {
    kGlow.expectHardStopsNotSmoothed(sceneOf(discMask(90, 90, 45.0F, 44.0F, 14.0F, true)));
}

TEST(OuterGlow, SizeTen_StaysInsideItsImageAndItsBorder) {
    // Padding 11: the image reaches 22 pixels beyond the box, its outermost 9 stay transparent.
    Scene scene = sceneOf(filledMask(80, 80, 255), {35, 33, 47, 45});
    const std::vector<int> alpha = alphaOf(kGlow.painted(scene, 10.0F, kWhite).dst);
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
    const Scene alone = kGlow.painted(scene, 1.0F, kWhite);
    scene.mask.bytes.assign(81, 255);
    EXPECT_TRUE(samePicture(alone.dst, kGlow.painted(scene, 1.0F, kWhite).dst));
}

TEST(OuterGlow, OpaqueDestination_IsUntouched) {
    expectOpaqueDestinationUntouched(*kGlow.core(5.0F, kWhite),
                                     sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true)));
}

TEST(OuterGlow, Opacity_IsNotRead) {
    kGlow.expectOpacityNotRead();
}

TEST(OuterGlow, LayeredModeAndSecondDestination_AreNotRead) {
    expectLayersNotRead(*kGlow.core(3.0F, kRed));
}

// --- Hostile input ----------------------------------------------------------------------------------

TEST(OuterGlow, BrokenInput_PaintsNothing) {
    expectNothingFromBrokenInput(*kGlow.core(3.0F, kWhite));
}

TEST(OuterGlow, SizesOutOfProportion_PaintNothing) {
    kGlow.expectNothingOfSizesOutOfProportion();
}

TEST(OuterGlow, SmallNegativeAndUnorderedSizes_MatchTheLiteralForm) {
    kGlow.expectLiteralFormOfSmallNegativeAndUnorderedSizes();
}

TEST(OuterGlow, CountWithoutStops_HasTheOneColour) {
    kGlow.expectOneColourWithoutStops();
}

// --- Against the literal form -----------------------------------------------------------------------

TEST(OuterGlow, SmallScenes_MatchTheLiteralForm) {
    kGlow.expectLiteralFormOfSmallScenes();
}

TEST(OuterGlow, EveryWholeSize_MatchesTheLiteralForm) {
    kGlow.expectLiteralFormOfEveryWholeSize();
}

TEST(OuterGlow, EveryAlphaOfOneColour_MatchesTheLiteralForm) {
    // Grown by one pass and not blurred, noise that grows stronger from row to row has all values.
    Random random(300);
    literal::Mask mask = noiseMask(random, 60, 40, 0);
    for (int i = 0; i < 60 * 40; ++i) {
        uint8_t& coverage = mask.bytes[static_cast<size_t>(i)];
        coverage = static_cast<uint8_t>(coverage * (i / 60) / 40);
    }
    const Scene scene = sceneOf(mask);
    for (uint32_t alpha = 0; alpha < 256; ++alpha)
        ASSERT_TRUE(kGlow.matchesLiteral(scene, 0.5F, alpha << 24 | 0x30FF81)) << alpha;
}

TEST(OuterGlow, EveryMaskOfTheGallery_MatchesTheLiteralForm) {
    kGlow.expectLiteralFormOfTheGallery();
}

TEST(OuterGlow, DestinationOfAnotherSize_IsClipped) {
    kGlow.expectClippingToTheDestination();
}

}  // namespace
