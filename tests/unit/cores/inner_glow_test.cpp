#include <gtest/gtest.h>

#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/literal_cores.h"
#include "tests/support/mask_gallery.h"

namespace {

using namespace vorel_test;
using literal::Stop;
using VFontEffect::VFGradient;
using VFontEffect::VFInnerGlow;
using VFontEffect::VFInnerGlowProperty;

constexpr uint32_t kClear = 0x00FFFFFF;

const Glow kGlow{coreOf<VFInnerGlow, VFInnerGlowProperty>, literal::paintInnerGlow};

// --- The core as an object ------------------------------------------------------------------------

TEST(InnerGlow, NewCore_HasItsTypeAndNoRecord) {
    expectFreshCore<VFInnerGlow>(4);
}

TEST(InnerGlow, Record_IsOwnedByTheCore) {
    VFGradient stops[] = {{kRed, 1.0F, 0.0F}, {kBlue, 0.5F, 1.0F}};
    VFGradient others[] = {{kGreen, 1.0F, 0.0F}, {kRed, 1.0F, 0.2F}, {kBlue, 1.0F, 0.9F}};
    expectOwnsItsRecord<VFInnerGlow>(VFInnerGlowProperty(6.0F, kWhite, 0.5F, 2, stops),
                                     VFInnerGlowProperty(4.0F, 0x80402010, 1.0F, 3, others),
                                     sceneOf(discMask(50, 50, 25.0F, 24.0F, 16.0F, true)));
}

TEST(InnerGlow, Stops_AreCopied) {
    VFInnerGlow core;
    expectCopiesItsStops(
        core, sceneOf(discMask(40, 40, 20.0F, 19.0F, 16.0F, true)),
        [](VFGradient* stops) { return VFInnerGlowProperty(6.0F, 0x12345678, 0.5F, 2, stops); });
    const auto* stored = static_cast<VFInnerGlowProperty*>(core.getProperty());
    EXPECT_EQ(6.0F, stored->mSize);
    EXPECT_EQ(0x12345678U, stored->mColor);
    EXPECT_EQ(0.5F, stored->mOpacity);
}

// --- By hand ----------------------------------------------------------------------------------------

TEST(InnerGlow, SizeZero_PaintsNothing) {
    // The table is transparent and a radius of 0 leaves no border.
    kGlow.expectNothingOfSizeZero();
}

TEST(InnerGlow, SizeBelowOne_GrowsTheOutsideByOnePixel) {
    // Padding 1: two pixels around the box of 5 x 5 are outside. One pass brings the outside over the
    // first ring of the glyph and clears the first and last column between the first and last row.
    const Scene scene = sceneOf(filledMask(9, 9, 255), {2, 2, 7, 7});
    const std::vector<int> expected{255, 255, 255, 255, 255, 255, 255, 255, 255,  //
                                    0,   255, 255, 255, 255, 255, 255, 255, 0,    //
                                    0,   255, 255, 255, 255, 255, 255, 255, 0,    //
                                    0,   255, 255, 0,   0,   0,   255, 255, 0,    //
                                    0,   255, 255, 0,   0,   0,   255, 255, 0,    //
                                    0,   255, 255, 0,   0,   0,   255, 255, 0,    //
                                    0,   255, 255, 255, 255, 255, 255, 255, 0,    //
                                    0,   255, 255, 255, 255, 255, 255, 255, 0,    //
                                    255, 255, 255, 255, 255, 255, 255, 255, 255};
    EXPECT_EQ(expected, alphaOf(kGlow.painted(scene, 0.5F, kWhite).dst));
}

TEST(InnerGlow, Strength_FallsFromTheCornersInwards) {
    // The same, with a ramp from red to blue that shows the table's entries: 255 is entry 1, the sides
    // of the first ring, three full neighbours, are 3 * 255 >> 2 = 191 and entry 65.
    const Scene scene = sceneOf(filledMask(9, 9, 255), {2, 2, 7, 7});
    const Scene result = kGlow.painted(scene, 0.5F, 0, {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 1.0F}});
    const std::vector<int> blue = channelOf(result.dst, 2);
    EXPECT_EQ(0, blue[2 * 9 + 2]);                        // entry 1: 255 >> 8
    EXPECT_EQ(64, blue[2 * 9 + 4]);                       // entry 65: 65 * 255 >> 8
    EXPECT_EQ(190, channelOf(result.dst, 0)[2 * 9 + 4]);  // 191 * 255 >> 8
}

TEST(InnerGlow, HardStops_AreNotSmoothed) {
    kGlow.expectHardStopsNotSmoothed(sceneOf(discMask(90, 90, 45.0F, 44.0F, 30.0F, true)));
}

TEST(InnerGlow, UnreachedBorder_IsOpaqueWhite) {
    // Padding 2, radius 1: the image starts 4 pixels before the box and its outermost ring is white,
    // even where the colour of the glow is transparent.
    const Scene scene = sceneOf(filledMask(20, 20, 255), {7, 6, 12, 13});
    const Scene result = kGlow.painted(scene, 1.0F, kClear);
    for (int channel = 0; channel < 4; ++channel) {
        const std::vector<int> values = channelOf(result.dst, channel);
        for (int y = 0; y < 20; ++y) {
            for (int x = 0; x < 20; ++x) {
                const bool image = x >= 3 && x < 16 && y >= 2 && y < 17;
                const bool inner = x >= 4 && x < 15 && y >= 3 && y < 16;
                EXPECT_EQ(image && !inner ? 255 : 0, values[static_cast<size_t>(y * 20 + x)])
                    << x << " " << y;
            }
        }
    }
}

TEST(InnerGlow, Image_HasThePlaceAndBorderOfTheOuterGlow) {
    // Size 10: 22 pixels beyond the box, of which the outermost 9 are the border.
    const Scene scene = sceneOf(filledMask(80, 80, 255), {35, 33, 47, 45});
    const std::vector<int> alpha = alphaOf(kGlow.painted(scene, 10.0F, kClear).dst);
    for (int y = 0; y < 80; ++y) {
        for (int x = 0; x < 80; ++x) {
            const bool image = x >= 35 - 22 && x < 47 + 22 && y >= 33 - 22 && y < 45 + 22;
            const bool inner = x >= 35 - 13 && x < 47 + 13 && y >= 33 - 13 && y < 45 + 13;
            ASSERT_EQ(image && !inner ? 255 : 0, alpha[static_cast<size_t>(y * 80 + x)])
                << x << " " << y;
        }
    }
}

TEST(InnerGlow, DeepInsideTheGlyph_ThereIsNoGlow) {
    const Scene scene = sceneOf(filledMask(41, 41, 255));
    const std::vector<int> alpha = alphaOf(kGlow.painted(scene, 4.0F, kWhite).dst);
    EXPECT_EQ(0, alpha[20 * 41 + 20]);
    EXPECT_LT(200, alpha[20 * 41]);
    EXPECT_LT(200, alpha[20]);
}

TEST(InnerGlow, CoverageOutsideTheBox_IsNotRead) {
    Scene scene = sceneOf(filledMask(12, 12, 255), {4, 4, 8, 8});
    const Scene full = kGlow.painted(scene, 1.0F, kRed);
    for (size_t i = 0; i < 48; ++i)
        scene.mask.bytes[i] = 0;
    EXPECT_TRUE(samePicture(full.dst, kGlow.painted(scene, 1.0F, kRed).dst));
}

TEST(InnerGlow, OpaqueDestination_IsUntouched) {
    expectOpaqueDestinationUntouched(*kGlow.core(5.0F, kWhite),
                                     sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true)));
}

TEST(InnerGlow, Opacity_IsNotRead) {
    kGlow.expectOpacityNotRead();
}

TEST(InnerGlow, LayeredModeAndSecondDestination_AreNotRead) {
    expectLayersNotRead(*kGlow.core(3.0F, kRed));
}

// --- Hostile input ----------------------------------------------------------------------------------

TEST(InnerGlow, BrokenInput_PaintsNothing) {
    expectNothingFromBrokenInput(*kGlow.core(3.0F, kWhite));
}

TEST(InnerGlow, SizesOutOfProportion_PaintNothing) {
    kGlow.expectNothingOfSizesOutOfProportion();
}

TEST(InnerGlow, SmallNegativeAndUnorderedSizes_MatchTheLiteralForm) {
    kGlow.expectLiteralFormOfSmallNegativeAndUnorderedSizes();
}

TEST(InnerGlow, CountWithoutStops_HasTheOneColour) {
    kGlow.expectOneColourWithoutStops();
}

// --- Against the literal form -----------------------------------------------------------------------

TEST(InnerGlow, SmallScenes_MatchTheLiteralForm) {
    kGlow.expectLiteralFormOfSmallScenes();
}

TEST(InnerGlow, EveryWholeSize_MatchesTheLiteralForm) {
    kGlow.expectLiteralFormOfEveryWholeSize();
}

TEST(InnerGlow, SizesWithinABroadGlyph_MatchTheLiteralForm) {
    const std::vector<Stop> stops{{kGreen, 1.0F, 0.0F}, {kRed, 1.0F, 0.4F}, {kBlue, 1.0F, 1.0F}};
    const Scene scene = sceneOf(discMask(121, 90, 60.0F, 45.0F, 58.0F, true));
    for (int size = 1; size <= 40; size += 3) {
        ASSERT_TRUE(kGlow.matchesLiteral(scene, static_cast<float>(size), 0, stops));
    }
}

TEST(InnerGlow, EveryMaskOfTheGallery_MatchesTheLiteralForm) {
    kGlow.expectLiteralFormOfTheGallery();
}

TEST(InnerGlow, DestinationOfAnotherSize_IsClipped) {
    kGlow.expectClippingToTheDestination();
}

}  // namespace
