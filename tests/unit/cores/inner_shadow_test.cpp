#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/literal_cores.h"
#include "tests/support/mask_gallery.h"

namespace {

using namespace vorel_test;
using VFontEffect::VFInnerShadow;
using VFontEffect::VFInnerShadowProperty;

/// The literal form with the angle as the record reduces it.
void paintLiteral(literal::Picture& dst, const literal::Mask& mask, literal::Box text, float angle,
                  float distance, float size, uint32_t color) {
    const VFInnerShadowProperty record(angle, distance, size, color, 1.0F);
    literal::paintInnerShadow(dst, mask, text, record.mAngle, distance, size, color);
}

const Shadow kShadow{coreOf<VFInnerShadow, VFInnerShadowProperty>, paintLiteral};

// --- The core as an object ------------------------------------------------------------------------

TEST(InnerShadow, NewCore_HasItsTypeAndNoRecord) {
    expectFreshCore<VFInnerShadow>(2);
}

TEST(InnerShadow, Record_IsOwnedByTheCore) {
    expectOwnsItsRecord<VFInnerShadow>(VFInnerShadowProperty(30.0F, 4.0F, 2.0F, 0xFF102030, 0.5F),
                                       VFInnerShadowProperty(200.0F, 6.0F, 1.0F, 0x80402010, 1.0F),
                                       sceneOf(discMask(30, 30, 15.0F, 14.0F, 9.0F, true)));
}

TEST(InnerShadow, Record_ReducesTheAngle) {
    VFInnerShadow core;
    VFInnerShadowProperty record(-30.7F, 4.5F, 2.25F, 0x12345678, 0.5F);
    record.mAngle = 725.9F;  // as if the caller had changed it: the core's copy is reduced again
    core.setProperty(&record);
    const auto* stored = static_cast<VFInnerShadowProperty*>(core.getProperty());
    EXPECT_EQ(5.0F, stored->mAngle);
    EXPECT_EQ(4.5F, stored->mDistance);
    EXPECT_EQ(2.25F, stored->mSize);
    EXPECT_EQ(0x12345678U, stored->mColor);
    EXPECT_EQ(0.5F, stored->mOpacity);
}

TEST(InnerShadow, FractionOfTheAngle_IsCut) {
    const Scene scene = sceneOf(discMask(30, 30, 15.0F, 14.0F, 9.0F, true));
    EXPECT_TRUE(samePaint(kShadow.painted(scene, -30.0F, 9.0F, 1.0F),
                          kShadow.painted(scene, -30.9F, 9.0F, 1.0F)));
    EXPECT_FALSE(samePaint(kShadow.painted(scene, -30.0F, 9.0F, 1.0F),
                           kShadow.painted(scene, -40.0F, 9.0F, 1.0F)));
}

TEST(InnerShadow, Offsets_StayZero) {
    expectNoReach(*kShadow.core(45.0F, 20.0F, 10.0F));
}

// --- By hand: white over nothing shows the shadow plane --------------------------------------------

TEST(InnerShadow, NoMoveAndNoSize_InvertsTheGlyph) {
    Scene scene = sceneOf(filledMask(4, 3, 77), {1, 0, 4, 2});
    scene.mask.bytes = {77, 0, 10, 255, 77, 254, 128, 1, 77, 77, 77, 77};
    EXPECT_EQ((std::vector<int>{0, 255, 245, 0, 0, 1, 127, 254, 0, 0, 0, 0}),
              alphaOf(kShadow.painted(scene, 0.0F, 0.0F, 0.0F).dst));
}

TEST(InnerShadow, LightFromTheRight_ShadesTheRightEdges) {
    const Scene scene = sceneOf(filledMask(3, 2, 255));
    EXPECT_EQ((std::vector<int>{0, 0, 255, 0, 0, 255}),
              alphaOf(kShadow.painted(scene, 0.0F, 1.0F, 0.0F).dst));
    EXPECT_EQ((std::vector<int>{255, 0, 0, 255, 0, 0}),
              alphaOf(kShadow.painted(scene, 180.0F, 1.0F, 0.0F).dst));
    EXPECT_EQ((std::vector<int>{255, 255, 255, 0, 0, 0}),
              alphaOf(kShadow.painted(scene, 90.0F, 1.0F, 0.0F).dst));
    EXPECT_EQ((std::vector<int>{0, 0, 0, 255, 255, 255}),
              alphaOf(kShadow.painted(scene, 270.0F, 1.0F, 0.0F).dst));
}

TEST(InnerShadow, DeepInsideAThickStroke_ThereIsNoShadow) {
    const Scene scene = sceneOf(filledMask(15, 15, 255));
    const std::vector<int> alpha = alphaOf(kShadow.painted(scene, 0.0F, 0.0F, 3.0F).dst);
    EXPECT_EQ(0, alpha[7 * 15 + 7]);
    EXPECT_EQ(0, alpha[3 * 15 + 3]);
    EXPECT_LT(0, alpha[2 * 15 + 7]);
    EXPECT_LT(0, alpha[7 * 15 + 12]);
}

TEST(InnerShadow, RadiusOne_BlursTheInverseHorizontallyFirst) {
    const Scene scene = sceneOf(filledMask(3, 3, 255));
    // Weights 100 and 1 of 102. Along a row, with two taps of three inside: 255 - 255 * 101 / 102 gives
    // (26010 - 25755) / 102 = 2 at both ends and 0 between. Down a column of ends: 2 inside, with one
    // tap outside (2 * 101 + 255) / 102 = 4; of middles 0 inside, and 255 / 102 = 2.
    EXPECT_EQ((std::vector<int>{4, 2, 4, 2, 0, 2, 4, 2, 4}),
              alphaOf(kShadow.painted(scene, 0.0F, 0.0F, 1.0F).dst));
}

TEST(InnerShadow, FarAwayGlyph_IsShadedWhole) {
    Scene scene = sceneOf(filledMask(4, 1, 0));
    scene.mask.bytes = {0, 90, 255, 1};
    for (int angle = 0; angle < 360; angle += 45) {
        EXPECT_EQ((std::vector<int>{0, 90, 255, 1}),
                  alphaOf(kShadow.painted(scene, static_cast<float>(angle), 100.0F, 2.0F).dst));
    }
}

TEST(InnerShadow, ReachThatEndsOnTheLeftOrTopEdge_StillOverlaps) {
    const Scene scene = sceneOf(filledMask(4, 4, 77));
    const std::vector<int> full(16, 255);
    const std::vector<int> glyph(16, 77);
    // R = 3 and a box of 4: moved by 7 to the left or up the reach ends exactly on the edge.
    EXPECT_EQ(full, alphaOf(kShadow.painted(scene, 0.0F, 7.0F, 3.0F).dst));
    EXPECT_EQ(full, alphaOf(kShadow.painted(scene, 270.0F, 7.0F, 3.0F).dst));
    EXPECT_EQ(glyph, alphaOf(kShadow.painted(scene, 0.0F, 8.0F, 3.0F).dst));
    EXPECT_EQ(glyph, alphaOf(kShadow.painted(scene, 270.0F, 8.0F, 3.0F).dst));
}

TEST(InnerShadow, ReachThatStartsOnTheRightOrBottomEdge_DoesNotOverlap) {
    const Scene scene = sceneOf(filledMask(4, 4, 77));
    const std::vector<int> glyph(16, 77);
    EXPECT_EQ(glyph, alphaOf(kShadow.painted(scene, 180.0F, 7.0F, 3.0F).dst));
    EXPECT_EQ(glyph, alphaOf(kShadow.painted(scene, 90.0F, 7.0F, 3.0F).dst));
    EXPECT_NE(glyph, alphaOf(kShadow.painted(scene, 180.0F, 6.0F, 3.0F).dst));
    EXPECT_NE(glyph, alphaOf(kShadow.painted(scene, 90.0F, 6.0F, 3.0F).dst));
}

TEST(InnerShadow, LastColumnOfOverlap_IsBlurred) {
    const Scene scene = sceneOf(filledMask(4, 4, 255));
    // Weights 100, 60, 13, 1 of 248. Only the last column sees the outermost tap of the moved glyph:
    // (255 * 248 - 255) / 248 = 253, and down the column values of 253 and 255 mix to 253.
    EXPECT_EQ((std::vector<int>{255, 255, 255, 253, 255, 255, 255, 253,  //
                                255, 255, 255, 253, 255, 255, 255, 253}),
              alphaOf(kShadow.painted(scene, 180.0F, 6.0F, 3.0F).dst));
}

TEST(InnerShadow, OnlyTheBox_IsPainted) {
    const Scene scene = sceneOf(filledMask(7, 6, 0), {2, 1, 5, 4});
    const std::vector<int> alpha = alphaOf(kShadow.painted(scene, 30.0F, 2.0F, 3.0F).dst);
    for (int y = 0; y < 6; ++y) {
        for (int x = 0; x < 7; ++x) {
            const bool inside = x >= 2 && x < 5 && y >= 1 && y < 4;
            EXPECT_EQ(inside ? 255 : 0, alpha[static_cast<size_t>(y * 7 + x)]);
        }
    }
}

TEST(InnerShadow, OpaqueDestination_IsUntouched) {
    const Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    expectOpaqueDestinationUntouched(*kShadow.core(30.0F, 3.0F, 2.0F), scene);
    expectOpaqueDestinationUntouched(*kShadow.core(30.0F, 300.0F, 2.0F), scene);
}

TEST(InnerShadow, LayeredModeAndSecondDestination_AreNotRead) {
    expectLayersNotRead(*kShadow.core(30.0F, 3.0F, 2.0F));
}

// --- Hostile input ----------------------------------------------------------------------------------

TEST(InnerShadow, BrokenInput_PaintsNothing) {
    for (float distance : {1.0F, 500.0F})
        expectNothingFromBrokenInput(*kShadow.core(0.0F, distance, 1.0F));
}

TEST(InnerShadow, SizesOutOfProportion_PaintNothing) {
    const Scene scene = sceneOf(filledMask(10, 10, 255));
    for (float size : {256.5F, 5000.0F, 1e9F, 3e38F, std::numeric_limits<float>::infinity()}) {
        EXPECT_TRUE(samePaint(scene, kShadow.painted(scene, 0.0F, 0.0F, size))) << size;
        EXPECT_TRUE(samePaint(scene, kShadow.painted(scene, 0.0F, 1e6F, size))) << size;
    }
}

TEST(InnerShadow, LargestSize_MatchesTheLiteralForm) {
    const Scene scene = sceneOf(discMask(9, 8, 4.0F, 4.0F, 3.0F, true), {1, 1, 6, 7});
    EXPECT_TRUE(kShadow.matchesLiteral(scene, 60.0F, 3.0F, 256.0F));
    EXPECT_TRUE(kShadow.matchesLiteral(scene, 60.0F, 900.0F, 256.0F));
}

TEST(InnerShadow, DistancesOutOfProportion_ShadeTheWholeGlyph) {
    const Scene scene = sceneOf(discMask(14, 14, 7.0F, 7.0F, 4.0F, true));
    const float infinity = std::numeric_limits<float>::infinity();
    const std::vector<int> glyph(scene.mask.bytes.begin(), scene.mask.bytes.end());
    for (float distance : {1e5F, 2147483648.0F, 1e10F, 3e38F, infinity, -1e5F, -1e10F, -infinity}) {
        for (float angle : {0.0F, 45.0F, 180.0F, 200.0F}) {
            EXPECT_EQ(glyph, alphaOf(kShadow.painted(scene, angle, distance, 3.0F).dst))
                << distance << " " << angle;
        }
    }
}

TEST(InnerShadow, NotANumber_CountsAsZero) {
    const Scene scene = sceneOf(discMask(14, 14, 7.0F, 7.0F, 4.0F, true));
    const float nan = std::nanf("");
    EXPECT_TRUE(
        samePaint(kShadow.painted(scene, 0.0F, 3.0F, 1.0F), kShadow.painted(scene, nan, 3.0F, 1.0F)));
    EXPECT_TRUE(
        samePaint(kShadow.painted(scene, 0.0F, 0.0F, 1.0F), kShadow.painted(scene, 10.0F, nan, 1.0F)));
    EXPECT_TRUE(
        samePaint(kShadow.painted(scene, 0.0F, 2.0F, 0.0F), kShadow.painted(scene, 0.0F, 2.0F, nan)));
}

// --- Against the literal form -----------------------------------------------------------------------

TEST(InnerShadow, EveryWholeAngle_MatchesTheLiteralForm) {
    const Scene scene = sceneOf(discMask(24, 22, 11.0F, 12.0F, 8.0F, true), {3, 4, 19, 20});
    for (int angle = -359; angle < 360; ++angle) {
        ASSERT_TRUE(kShadow.matchesLiteral(scene, static_cast<float>(angle), 5.5F, 2.0F, 0xC0604020));
    }
}

TEST(InnerShadow, DistancesAroundTheEdges_MatchTheLiteralForm) {
    kShadow.expectLiteralFormAroundTheEdges(200, 45, 24);
}

TEST(InnerShadow, SmallScenes_MatchTheLiteralForm) {
    kShadow.expectLiteralFormOfSmallScenes(4000, 14.0F);
}

TEST(InnerShadow, LargeSizes_MatchTheLiteralForm) {
    kShadow.expectLiteralFormOfLargeSizes(120, 140.0F);
}

TEST(InnerShadow, EveryMaskOfTheGallery_MatchesTheLiteralForm) {
    kShadow.expectLiteralFormOfTheGallery();
}

TEST(InnerShadow, DestinationOfAnotherSize_IsClipped) {
    kShadow.expectClippingToTheDestination();
}

}  // namespace
