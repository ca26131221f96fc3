#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/literal_cores.h"
#include "tests/support/mask_gallery.h"

namespace {

using namespace vorel_test;
using VFontEffect::VFOuterShadow;
using VFontEffect::VFOuterShadowProperty;

const Shadow kShadow{coreOf<VFOuterShadow, VFOuterShadowProperty>, literal::paintOuterShadow};

/// Left, top, right and bottom offset.
std::vector<int> marginsOf(float angle, float distance, float size) {
    const auto core = kShadow.core(angle, distance, size);
    return {core->getLeftOffset(), core->getTopOffset(), core->getRightOffset(),
            core->getBottomOffset()};
}

/// A shadow of size 0 moves the mask; returns where a single pixel goes.
literal::Offset moveOf(float angle, float distance) {
    constexpr int kSide = 61;
    Scene scene = sceneOf(filledMask(kSide, kSide, 0), {30, 30, 31, 31});
    scene.mask.bytes[30 * kSide + 30] = 255;
    const std::vector<int> alpha = alphaOf(kShadow.painted(scene, angle, distance, 0.0F).dst);
    for (int y = 0; y < kSide; ++y) {
        for (int x = 0; x < kSide; ++x) {
            if (alpha[static_cast<size_t>(y * kSide + x)] == 255) return {x - 30, y - 30};
        }
    }
    return {1000, 1000};
}

void expectMove(int x, int y, float angle, float distance) {
    const literal::Offset move = moveOf(angle, distance);
    EXPECT_EQ(x, move.x) << "angle " << angle << ", distance " << distance;
    EXPECT_EQ(y, move.y) << "angle " << angle << ", distance " << distance;
}

/// The blur of a full column, from its centre outwards: 255 * weight / sum, truncated.
std::vector<int> columnResponse(float size, int reach) {
    constexpr int kSide = 41;
    Scene scene = sceneOf(filledMask(kSide, kSide, 0));
    for (size_t y = 0; y < kSide; ++y)
        scene.mask.bytes[y * kSide + 20] = 255;
    const std::vector<int> alpha = alphaOf(kShadow.painted(scene, 0.0F, 0.0F, size).dst);
    std::vector<int> response;
    for (int k = 0; k <= reach; ++k) {
        const auto right = static_cast<size_t>(20 * kSide + 20 + k);
        const auto left = static_cast<size_t>(20 * kSide + 20 - k);
        EXPECT_EQ(alpha[left], alpha[right]);
        response.push_back(alpha[right]);
    }
    return response;
}

// --- The core as an object ------------------------------------------------------------------------

TEST(OuterShadow, NewCore_HasItsTypeAndNoRecord) {
    expectFreshCore<VFOuterShadow>(1);
}

TEST(OuterShadow, Record_IsOwnedByTheCore) {
    expectOwnsItsRecord<VFOuterShadow>(VFOuterShadowProperty(30.0F, 4.0F, 2.0F, 0xFF102030, 0.5F),
                                       VFOuterShadowProperty(200.0F, 6.0F, 1.0F, 0x80402010, 1.0F),
                                       sceneOf(discMask(30, 30, 15.0F, 14.0F, 6.0F, true)));
}

TEST(OuterShadow, Record_KeepsTheAngleAsGiven) {
    VFOuterShadow core;
    VFOuterShadowProperty record(-30.75F, 4.5F, 2.25F, 0x12345678, 0.5F);
    core.setProperty(&record);
    const auto* stored = static_cast<VFOuterShadowProperty*>(core.getProperty());
    EXPECT_EQ(-30.75F, stored->mAngle);
    EXPECT_EQ(4.5F, stored->mDistance);
    EXPECT_EQ(2.25F, stored->mSize);
    EXPECT_EQ(0x12345678U, stored->mColor);
    EXPECT_EQ(0.5F, stored->mOpacity);
}

TEST(OuterShadow, NewRecord_MovesTheOffsets) {
    VFOuterShadow core;
    VFOuterShadowProperty left(0.0F, 10.0F, 0.0F, kWhite, 1.0F);
    VFOuterShadowProperty right(180.0F, 7.0F, 0.0F, kWhite, 1.0F);
    core.setProperty(&left);
    EXPECT_EQ(10, core.getLeftOffset());
    EXPECT_EQ(0, core.getRightOffset());
    core.setProperty(&right);
    EXPECT_EQ(0, core.getLeftOffset());
    EXPECT_EQ(7, core.getRightOffset());
}

TEST(OuterShadow, BaseOffset_StaysZero) {
    EXPECT_EQ(0, kShadow.core(0.0F, 10.0F, 10.0F)->getOffset());
}

// --- Offsets --------------------------------------------------------------------------------------

TEST(OuterShadow, Move_FallsOnTheFarSideOfTheLight) {
    expectMove(-10, 0, 0.0F, 10.0F);
    expectMove(0, 10, 90.0F, 10.0F);
    expectMove(10, 0, 180.0F, 10.0F);
    expectMove(0, -10, 270.0F, 10.0F);
    expectMove(-7, 7, 45.0F, 10.0F);     // 7.07
    expectMove(-9, 5, 30.0F, 10.0F);     // 8.66 and 4.99999 + 0.5
    expectMove(7, -7, 225.0F, 10.0F);    // -7.07
    expectMove(-10, 0, -360.0F, 10.0F);  // the angle is not reduced; 360 degrees are nearly a full turn
}

TEST(OuterShadow, Move_RoundsHalvesAwayFromZero) {
    expectMove(-3, 0, 0.0F, 2.5F);
    expectMove(-1, 0, 0.0F, 0.5F);
    expectMove(3, 0, 180.0F, 2.5F);
    expectMove(0, 3, 90.0F, 2.5F);
    expectMove(-2, 0, 0.0F, 2.49F);
    expectMove(3, 0, 0.0F, -2.5F);
}

TEST(OuterShadow, DistanceZero_NeverMoves) {
    for (int angle = 0; angle < 360; ++angle) {
        ASSERT_EQ((std::vector<int>{0, 0, 0, 0}), marginsOf(static_cast<float>(angle), 0.0F, 0.0F))
            << angle;
    }
}

TEST(OuterShadow, Margins_AreReachAndMoveTogether) {
    EXPECT_EQ((std::vector<int>{20, 10, 0, 10}), marginsOf(0.0F, 10.0F, 10.0F));
    EXPECT_EQ((std::vector<int>{4, 0, 4, 14}), marginsOf(90.0F, 10.0F, 4.0F));
    EXPECT_EQ((std::vector<int>{0, 0, 10, 0}), marginsOf(180.0F, 10.0F, 0.4F));
    EXPECT_EQ((std::vector<int>{1, 1, 1, 1}), marginsOf(0.0F, 0.0F, 0.5F));
}

TEST(OuterShadow, Margins_OfEveryWholeAngleMatchTheLiteralForm) {
    for (int angle = -360; angle <= 720; ++angle) {
        for (float distance : {0.5F, 1.0F, 3.5F, 10.0F, 99.5F, 100.0F}) {
            const auto degrees = static_cast<float>(angle);
            const literal::Margins expected = literal::outerShadowMargins(degrees, distance, 7.5F);
            ASSERT_EQ((std::vector<int>{expected.left, expected.top, expected.right, expected.bottom}),
                      marginsOf(degrees, distance, 7.5F))
                << angle << " " << distance;
        }
    }
}

// --- The blur by hand: white over nothing shows the blurred mask --------------------------------------

TEST(OuterShadow, SizeZero_MovesTheMaskUnchanged) {
    Scene scene = sceneOf(filledMask(6, 3, 0), {2, 0, 5, 3});
    scene.mask.bytes = {9, 9, 10, 20, 30, 9,  //
                        9, 9, 40, 50, 60, 9,  //
                        9, 9, 70, 80, 90, 9};
    // Two to the left; then one row down, where the last row leaves the picture.
    Scene moved = kShadow.painted(scene, 0.0F, 2.0F, 0.0F);
    EXPECT_EQ((std::vector<int>{10, 20, 30, 0, 0, 0, 40, 50, 60, 0, 0, 0, 70, 80, 90, 0, 0, 0}),
              alphaOf(moved.dst));
    moved = kShadow.painted(scene, 90.0F, 1.0F, 0.0F);
    EXPECT_EQ((std::vector<int>{0, 0, 0, 0, 0, 0, 0, 0, 10, 20, 30, 0, 0, 0, 40, 50, 60, 0}),
              alphaOf(moved.dst));
}

TEST(OuterShadow, RadiusOne_BlursVerticallyFirst) {
    Scene scene = sceneOf(filledMask(5, 5, 0), {2, 2, 3, 3});
    scene.mask.bytes[12] = 255;
    // Weights 100 and 1 of 102. Down the column: 255 * 100 / 102 = 250 and 255 / 102 = 2. Along the
    // rows: 250 * 100 / 102 = 245 with 250 / 102 = 2 beside it, and 2 * 100 / 102 = 1 with 0 beside it.
    const std::vector<int> expected{0, 0, 0,   0, 0,  //
                                    0, 0, 1,   0, 0,  //
                                    0, 2, 245, 2, 0,  //
                                    0, 0, 1,   0, 0,  //
                                    0, 0, 0,   0, 0};
    EXPECT_EQ(expected, alphaOf(kShadow.painted(scene, 0.0F, 0.0F, 0.5F).dst));
}

TEST(OuterShadow, Size_RoundsToTheRadius) {
    EXPECT_EQ((std::vector<int>{255, 0}), columnResponse(0.4F, 1));
    EXPECT_EQ((std::vector<int>{250, 2}), columnResponse(0.5F, 1));
    EXPECT_EQ((std::vector<int>{250, 2, 0}), columnResponse(1.49F, 2));
    EXPECT_EQ((std::vector<int>{255, 0}), columnResponse(-5.0F, 1));
}

TEST(OuterShadow, Weights_FallToOneHundredthAtTheRadius) {
    // (100, 32, 1) of 166, (100, 60, 13, 1) of 248, (100, 83, 48, 19, 5, 1) of 412.
    EXPECT_EQ((std::vector<int>{153, 49, 1, 0}), columnResponse(2.0F, 3));
    EXPECT_EQ((std::vector<int>{102, 61, 13, 1, 0}), columnResponse(3.0F, 4));
    EXPECT_EQ((std::vector<int>{61, 51, 29, 11, 3, 0, 0}), columnResponse(5.0F, 6));
}

TEST(OuterShadow, LiteralKernel_HoldsTheWorkedWeights) {
    EXPECT_EQ((std::vector<uint32_t>{100}), literal::shadowWeights(0));
    EXPECT_EQ((std::vector<uint32_t>{100, 1}), literal::shadowWeights(1));
    EXPECT_EQ((std::vector<uint32_t>{100, 32, 1}), literal::shadowWeights(2));
    EXPECT_EQ((std::vector<uint32_t>{100, 60, 13, 1}), literal::shadowWeights(3));
    EXPECT_EQ((std::vector<uint32_t>{100, 83, 48, 19, 5, 1}), literal::shadowWeights(5));
}

TEST(OuterShadow, CoverageOutsideTheBox_IsNotRead) {
    Scene scene = sceneOf(filledMask(9, 9, 255), {4, 4, 5, 5});
    const std::vector<int> alpha = alphaOf(kShadow.painted(scene, 0.0F, 0.0F, 0.5F).dst);
    EXPECT_EQ(245, alpha[4 * 9 + 4]);
    EXPECT_EQ(0, alpha[0]);
}

TEST(OuterShadow, OpaqueDestination_IsUntouched) {
    const Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    expectOpaqueDestinationUntouched(*kShadow.core(30.0F, 3.0F, 2.0F), scene);
}

TEST(OuterShadow, LayeredModeAndSecondDestination_AreNotRead) {
    expectLayersNotRead(*kShadow.core(30.0F, 3.0F, 2.0F));
}

// --- Shadows that leave the destination ------------------------------------------------------------

TEST(OuterShadow, ShadowOutsideTheDestination_PaintsNothing) {
    const Scene scene = sceneOf(filledMask(10, 10, 255));
    for (float size : {0.0F, 3.0F}) {
        for (int angle = 0; angle < 360; angle += 90) {
            EXPECT_TRUE(samePaint(
                scene, kShadow.painted(scene, static_cast<float>(angle), 10.0F + 2.0F * size, size)));
            EXPECT_TRUE(
                samePaint(scene, kShadow.painted(scene, static_cast<float>(angle), 1000.0F, size)));
        }
    }
}

TEST(OuterShadow, LastColumnInside_IsStillPainted) {
    const Scene scene = sceneOf(filledMask(10, 1, 255));
    std::vector<int> expected(10, 0);
    expected[0] = 255;
    EXPECT_EQ(expected, alphaOf(kShadow.painted(scene, 0.0F, 9.0F, 0.0F).dst));
    expected = std::vector<int>(10, 0);
    expected[9] = 255;
    EXPECT_EQ(expected, alphaOf(kShadow.painted(scene, 180.0F, 9.0F, 0.0F).dst));
}

TEST(OuterShadow, DistancesAroundTheEdges_MatchTheLiteralForm) {
    kShadow.expectLiteralFormAroundTheEdges(255, 90, 32);
}

// --- Hostile input ----------------------------------------------------------------------------------

TEST(OuterShadow, BrokenInput_PaintsNothing) {
    expectNothingFromBrokenInput(*kShadow.core(0.0F, 1.0F, 1.0F));
}

TEST(OuterShadow, SizesOutOfProportion_PaintNothing) {
    const Scene scene = sceneOf(filledMask(10, 10, 255));
    for (float size : {256.5F, 5000.0F, 1e9F, 3e38F, std::numeric_limits<float>::infinity()}) {
        EXPECT_TRUE(samePaint(scene, kShadow.painted(scene, 0.0F, 0.0F, size))) << size;
    }
}

TEST(OuterShadow, LargestSize_MatchesTheLiteralForm) {
    const Scene scene = sceneOf(discMask(9, 8, 4.0F, 4.0F, 3.0F, true), {1, 1, 6, 7});
    EXPECT_TRUE(kShadow.matchesLiteral(scene, 60.0F, 3.0F, 256.0F));
}

TEST(OuterShadow, DistancesOutOfProportion_PaintNothing) {
    const Scene scene = sceneOf(filledMask(10, 10, 255));
    const float infinity = std::numeric_limits<float>::infinity();
    for (float distance : {1e5F, 2147483648.0F, 1e10F, 3e38F, infinity, -1e5F, -1e10F, -infinity}) {
        for (float angle : {0.0F, 45.0F, 180.0F, 200.0F}) {
            for (float size : {0.0F, 5.0F}) {
                EXPECT_TRUE(samePaint(scene, kShadow.painted(scene, angle, distance, size)))
                    << distance << " " << angle;
            }
        }
    }
}

TEST(OuterShadow, NotANumber_CountsAsZero) {
    const Scene scene = sceneOf(discMask(14, 14, 7.0F, 7.0F, 4.0F, true));
    const float nan = std::nanf("");
    const Scene unmoved = kShadow.painted(scene, 0.0F, 0.0F, 1.0F);
    EXPECT_TRUE(samePaint(unmoved, kShadow.painted(scene, nan, 3.0F, 1.0F)));
    EXPECT_TRUE(samePaint(unmoved, kShadow.painted(scene, 10.0F, nan, 1.0F)));
    EXPECT_TRUE(
        samePaint(kShadow.painted(scene, 0.0F, 2.0F, 0.0F), kShadow.painted(scene, 0.0F, 2.0F, nan)));
    EXPECT_EQ((std::vector<int>{0, 0, 0, 0}), marginsOf(nan, nan, nan));
}

// --- Against the literal form -----------------------------------------------------------------------

TEST(OuterShadow, EveryWholeAngle_MatchesTheLiteralForm) {
    const Scene scene = sceneOf(discMask(24, 22, 11.0F, 12.0F, 6.0F, true), {3, 4, 19, 20});
    for (int angle = 0; angle < 360; ++angle) {
        ASSERT_TRUE(kShadow.matchesLiteral(scene, static_cast<float>(angle), 5.5F, 2.0F, 0xC0604020));
    }
}

TEST(OuterShadow, SmallScenes_MatchTheLiteralForm) {
    kShadow.expectLiteralFormOfSmallScenes(3000, 12.0F);
}

TEST(OuterShadow, LargeSizes_MatchTheLiteralForm) {
    kShadow.expectLiteralFormOfLargeSizes(60, 100.0F);
}

TEST(OuterShadow, EveryMaskOfTheGallery_MatchesTheLiteralForm) {
    kShadow.expectLiteralFormOfTheGallery();
}

TEST(OuterShadow, DestinationOfAnotherSize_IsClipped) {
    kShadow.expectClippingToTheDestination();
}

}  // namespace
