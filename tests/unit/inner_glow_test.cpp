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
using VFontEffect::VFInnerGlow;
using VFontEffect::VFInnerGlowProperty;

constexpr uint32_t kWhite = 0xFFFFFFFF;
constexpr uint32_t kRed = 0xFFFF0000;
constexpr uint32_t kGreen = 0xFF00FF00;
constexpr uint32_t kBlue = 0xFF0000FF;
constexpr uint32_t kClear = 0x00FFFFFF;

void giveRecord(VFInnerGlow& core, float size, uint32_t color, const std::vector<Stop>& stops) {
    std::vector<VFGradient> array = libraryStops(stops);
    VFInnerGlowProperty record(size, color, 1.0F, static_cast<int>(array.size()),
                               array.empty() ? nullptr : array.data());
    core.setProperty(&record);
}

Scene glowing(const Scene& scene, float size, uint32_t color, const std::vector<Stop>& stops = {}) {
    VFInnerGlow core;
    giveRecord(core, size, color, stops);
    return painted(core, scene);
}

::testing::AssertionResult matchesLiteral(const Scene& scene, float size, uint32_t color,
                                          const std::vector<Stop>& stops = {}) {
    VFInnerGlow core;
    giveRecord(core, size, color, stops);
    auto same = paintsLike(core, scene, [&](Scene& expected) {
        literal::paintInnerGlow(expected.dst, expected.mask, expected.text, size, color, stops);
    });
    if (!same) same << "; size " << size << ", stops " << stops.size();
    return same;
}

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
    const Scene scene = sceneOf(discMask(40, 40, 20.0F, 19.0F, 16.0F, true));
    auto stops = std::make_unique<VFGradient[]>(2);
    stops[0] = {kRed, 0.25F, 0.0F};
    stops[1] = {kBlue, 0.75F, 0.5F};
    VFInnerGlowProperty record(6.0F, 0x12345678, 0.5F, 2, stops.get());
    VFInnerGlow core;
    core.setProperty(&record);
    const Scene before = painted(core, scene);
    stops[0].mColor = kGreen;
    stops[1].mLocation = 0.1F;
    EXPECT_TRUE(samePaint(before, painted(core, scene)));
    stops.reset();
    EXPECT_TRUE(samePaint(before, painted(core, scene)));

    const auto* stored = static_cast<VFInnerGlowProperty*>(core.getProperty());
    EXPECT_EQ(6.0F, stored->mSize);
    EXPECT_EQ(0x12345678U, stored->mColor);
    EXPECT_EQ(0.5F, stored->mOpacity);
    ASSERT_EQ(2, stored->mGradientCount);
    EXPECT_EQ(kRed, stored->mGradient[0].mColor);
    EXPECT_EQ(0.75F, stored->mGradient[1].mOpacity);
    EXPECT_EQ(0.5F, stored->mGradient[1].mLocation);
}

// --- By hand ----------------------------------------------------------------------------------------

TEST(InnerGlow, SizeZero_PaintsNothing) {
    // The table is transparent and a radius of 0 leaves no border.
    const Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    EXPECT_TRUE(samePaint(scene, glowing(scene, 0.0F, kWhite)));
    EXPECT_TRUE(
        samePaint(scene, glowing(scene, 0.0F, kWhite, {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 1.0F}})));
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
    EXPECT_EQ(expected, alphaOf(glowing(scene, 0.5F, kWhite).dst));
}

TEST(InnerGlow, Strength_FallsFromTheCornersInwards) {
    // The same, with a ramp from red to blue that shows the table's entries: 255 is entry 1, the sides
    // of the first ring, three full neighbours, are 3 * 255 >> 2 = 191 and entry 65.
    const Scene scene = sceneOf(filledMask(9, 9, 255), {2, 2, 7, 7});
    const Scene result = glowing(scene, 0.5F, 0, {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 1.0F}});
    const std::vector<int> blue = channelOf(result.dst, 2);
    EXPECT_EQ(0, blue[2 * 9 + 2]);                        // entry 1: 255 >> 8
    EXPECT_EQ(64, blue[2 * 9 + 4]);                       // entry 65: 65 * 255 >> 8
    EXPECT_EQ(190, channelOf(result.dst, 0)[2 * 9 + 4]);  // 191 * 255 >> 8
}

TEST(InnerGlow, UnreachedBorder_IsOpaqueWhite) {
    // Padding 2, radius 1: the image starts 4 pixels before the box and its outermost ring is white,
    // even where the colour of the glow is transparent.
    const Scene scene = sceneOf(filledMask(20, 20, 255), {7, 6, 12, 13});
    const Scene result = glowing(scene, 1.0F, kClear);
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
    const std::vector<int> alpha = alphaOf(glowing(scene, 10.0F, kClear).dst);
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
    const std::vector<int> alpha = alphaOf(glowing(scene, 4.0F, kWhite).dst);
    EXPECT_EQ(0, alpha[20 * 41 + 20]);
    EXPECT_LT(200, alpha[20 * 41]);
    EXPECT_LT(200, alpha[20]);
}

TEST(InnerGlow, CoverageOutsideTheBox_IsNotRead) {
    Scene scene = sceneOf(filledMask(12, 12, 255), {4, 4, 8, 8});
    const Scene full = glowing(scene, 1.0F, kRed);
    for (size_t i = 0; i < 48; ++i)
        scene.mask.bytes[i] = 0;
    EXPECT_TRUE(samePicture(full.dst, glowing(scene, 1.0F, kRed).dst));
}

TEST(InnerGlow, OpaqueDestination_IsUntouched) {
    Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    scene.dst = filledPicture(20, 20, 0xFF112233);
    EXPECT_TRUE(samePaint(scene, glowing(scene, 5.0F, kWhite)));
}

TEST(InnerGlow, Opacity_IsNotRead) {
    const Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    VFInnerGlow core;
    VFInnerGlowProperty record(5.0F, kRed, 0.25F, 0, nullptr);
    core.setProperty(&record);
    EXPECT_TRUE(samePaint(glowing(scene, 5.0F, kRed), painted(core, scene)));
}

TEST(InnerGlow, LayeredModeAndSecondDestination_AreNotRead) {
    Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    const Scene plain = glowing(scene, 3.0F, kRed);
    scene.useOuterLayer = true;
    scene.sub = filledPicture(20, 20, 0);
    const Scene layered = glowing(scene, 3.0F, kRed);
    EXPECT_TRUE(samePicture(plain.dst, layered.dst));
    EXPECT_TRUE(samePicture(*scene.sub, *layered.sub));
}

// --- Hostile input ----------------------------------------------------------------------------------

TEST(InnerGlow, BrokenInput_PaintsNothing) {
    VFInnerGlow core;
    giveRecord(core, 3.0F, kWhite, {});
    expectNothingFromBrokenInput(core);
}

TEST(InnerGlow, SizesOutOfProportion_PaintNothing) {
    const Scene scene = sceneOf(filledMask(10, 10, 255));
    const float infinity = std::numeric_limits<float>::infinity();
    for (float size : {-1.0F, -1.9F, -2.0F, -50.0F, -1e9F, 256.5F, 1e9F, 3e38F, infinity, -infinity}) {
        EXPECT_TRUE(samePaint(scene, glowing(scene, size, kWhite))) << size;
    }
}

TEST(InnerGlow, SmallNegativeAndUnorderedSizes_MatchTheLiteralForm) {
    const Scene scene = sceneOf(discMask(14, 14, 7.0F, 7.0F, 4.0F, true));
    for (float size : {-0.0F, -0.5F, -0.99F, std::nanf("")}) {
        EXPECT_TRUE(matchesLiteral(scene, size, kRed));
    }
}

TEST(InnerGlow, CountWithoutStops_HasTheOneColour) {
    const Scene scene = sceneOf(discMask(20, 20, 10.0F, 10.0F, 6.0F, true));
    for (int count : {1, 2, 256, -4}) {
        VFInnerGlow core;
        VFInnerGlowProperty record(5.0F, kRed, 1.0F, count, nullptr);
        core.setProperty(&record);
        EXPECT_TRUE(samePaint(glowing(scene, 5.0F, kRed), painted(core, scene))) << count;
    }
}

// --- Against the literal form -----------------------------------------------------------------------

TEST(InnerGlow, SmallScenes_MatchTheLiteralForm) {
    forSeeds(1000, 2200, [](Random& random) {
        const Scene scene = randomScene(random, 26);
        const float size =
            random.chance(50) ? static_cast<float>(random.between(0, 9)) : random.real(0.0F, 12.0F);
        const int count = random.chance(30) ? 0 : random.between(1, 6);
        EXPECT_TRUE(matchesLiteral(scene, size, randomStraight(random), randomStops(random, count)));
    });
}

TEST(InnerGlow, EveryWholeSize_MatchesTheLiteralForm) {
    const std::vector<Stop> stops{{kGreen, 1.0F, 0.0F}, {0x80FF0000, 1.0F, 0.4F}, {kBlue, 1.0F, 1.0F}};
    Scene scene = sceneOf(discMask(15, 9, 7.0F, 4.0F, 4.0F, true), {2, 1, 13, 8});
    for (int size = 0; size <= 100; ++size) {
        ASSERT_TRUE(matchesLiteral(scene, static_cast<float>(size), 0, stops));
    }
}

TEST(InnerGlow, SizesWithinABroadGlyph_MatchTheLiteralForm) {
    const std::vector<Stop> stops{{kGreen, 1.0F, 0.0F}, {kRed, 1.0F, 0.4F}, {kBlue, 1.0F, 1.0F}};
    const Scene scene = sceneOf(discMask(121, 90, 60.0F, 45.0F, 58.0F, true));
    for (int size = 1; size <= 40; size += 3) {
        ASSERT_TRUE(matchesLiteral(scene, static_cast<float>(size), 0, stops));
    }
}

TEST(InnerGlow, EveryMaskOfTheGallery_MatchesTheLiteralForm) {
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

TEST(InnerGlow, DestinationOfAnotherSize_IsClipped) {
    forSeeds(3000, 200, [](Random& random) {
        Scene scene = randomScene(random, 16);
        scene.dst = randomPicture(random, random.between(1, 24), random.between(1, 24));
        EXPECT_TRUE(matchesLiteral(scene, random.real(0.0F, 6.0F), randomStraight(random)));
    });
}

}  // namespace
