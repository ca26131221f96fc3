#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/literal_cores.h"
#include "tests/support/mask_gallery.h"

namespace {

using namespace vorel_test;
using VFontEffect::VFBitmap;
using VFontEffect::VFECore;
using VFontEffect::VFPattern;
using VFontEffect::VFPatternProperty;

/// A pattern's pixels: four bytes A, R, G, B each, packed rows.
struct Tile {
    int width;
    int height;
    std::vector<uint8_t> bytes;
};

/// Opaque; the red channel numbers the columns, the green one the rows.
Tile numberedTile(int width, int height, int columnStep, int rowStep) {
    Tile tile{width, height, {}};
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            for (int value : {255, x * columnStep, y * rowStep, 7}) {
                tile.bytes.push_back(static_cast<uint8_t>(value));
            }
        }
    }
    return tile;
}

Tile randomTile(Random& random, int longestSide) {
    Tile tile{random.between(1, longestSide), random.between(1, longestSide), {}};
    const bool opaque = random.chance(30);
    for (int i = 0; i < tile.width * tile.height * 4; ++i) {
        tile.bytes.push_back(opaque && i % 4 == 0 ? uint8_t{255} : random.byte());
    }
    return tile;
}

VFBitmap bitmapOf(const Tile& tile) {
    Tile copy = tile;
    return VFBitmap(static_cast<unsigned>(tile.width), static_cast<unsigned>(tile.height),
                    copy.bytes.data(), 4);
}

/// The core with a record of these numbers; the record clamps the scale.
std::unique_ptr<VFECore> coreWith(const Tile& tile, float scale, float opacity) {
    VFBitmap bitmap = bitmapOf(tile);
    return coreOf<VFPattern, VFPatternProperty>(&bitmap, scale, opacity);
}

Scene filled(const Scene& scene, const Tile& tile, float scale, float opacity = 1.0F) {
    return painted(*coreWith(tile, scale, opacity), scene);
}

::testing::AssertionResult matchesLiteral(const Scene& scene, const Tile& tile, float scale,
                                          float opacity) {
    const auto core = coreWith(tile, scale, opacity);
    const auto* record = static_cast<VFPatternProperty*>(core->getProperty());
    auto same = paintsLike(*core, scene, [&](Scene& expected) {
        literal::paintPattern(expected.dst, expected.mask, expected.text, opacity, record->mScale,
                              tile.width, tile.height, tile.bytes);
    });
    if (!same) {
        same << "; scale " << scale << ", opacity " << opacity << ", pattern " << tile.width << " x "
             << tile.height;
    }
    return same;
}

/// What an opaque pattern's channel becomes without interpolation: the weights add up to 255 * 255 of
/// 65536, and the sampled alpha of 253 is multiplied in.
int sampled(int value) {
    return value * 65025 >> 16;
}
int opaqueChannel(int value) {
    return 253 * (sampled(value) + 1) >> 8;
}

/// The red channel of one row.
std::vector<int> redRow(const literal::Picture& picture, int y) {
    const std::vector<int> red = channelOf(picture, 0);
    return {red.begin() + y * picture.width, red.begin() + (y + 1) * picture.width};
}

// --- The core as an object ------------------------------------------------------------------------

TEST(Pattern, NewCore_HasItsTypeAndNoRecord) {
    expectFreshCore<VFPattern>(11);
}

TEST(Pattern, Record_IsOwnedByTheCore) {
    VFBitmap first = bitmapOf(numberedTile(4, 3, 60, 80));
    VFBitmap second = bitmapOf(numberedTile(5, 5, 30, 10));
    expectOwnsItsRecord<VFPattern>(VFPatternProperty(&first, 1.5F, 0.5F),
                                   VFPatternProperty(&second, 1.0F, 1.0F),
                                   sceneOf(discMask(30, 30, 15.0F, 14.0F, 9.0F, true)));
}

TEST(Pattern, Bitmap_IsCopied) {
    const Scene scene = sceneOf(filledMask(20, 20, 255));
    auto bitmap = std::make_unique<VFBitmap>(bitmapOf(numberedTile(4, 3, 60, 80)));
    VFPatternProperty record(bitmap.get(), 12.0F, 0.5F);
    VFPattern core;
    core.setProperty(&record);
    const Scene before = painted(core, scene);
    for (int i = 0; i < 48; ++i)
        bitmap->mData[i] = 99;
    EXPECT_TRUE(samePaint(before, painted(core, scene)));
    bitmap.reset();
    EXPECT_TRUE(samePaint(before, painted(core, scene)));

    const auto* stored = static_cast<VFPatternProperty*>(core.getProperty());
    EXPECT_EQ(10.0F, stored->mScale);
    EXPECT_EQ(0.5F, stored->mOpacity);
    EXPECT_EQ(0U, stored->mColor);
    ASSERT_NE(nullptr, stored->mPattern);
    EXPECT_EQ(4U, stored->mPattern->mWidth);
    EXPECT_EQ(3U, stored->mPattern->mHeight);
    EXPECT_EQ(4U, stored->mPattern->mBytesPerPixel);
    EXPECT_EQ(60, stored->mPattern->mData[5]);
}

TEST(Pattern, Offsets_StayZero) {
    expectNoReach(*coreWith(numberedTile(4, 4, 60, 60), 2.0F, 1.0F));
}

// --- By hand ----------------------------------------------------------------------------------------

TEST(Pattern, ScaleOne_RepeatsThePatternPixelForPixel) {
    const Tile tile = numberedTile(4, 4, 60, 80);
    const Scene result = filled(sceneOf(filledMask(10, 9, 255)), tile, 1.0F);
    for (int y = 0; y < 9; ++y) {
        for (int x = 0; x < 10; ++x) {
            const size_t at = static_cast<size_t>(y * 10 + x) * 4;
            EXPECT_EQ(opaqueChannel(x % 4 * 60), result.dst.bytes[at]);
            EXPECT_EQ(opaqueChannel(y % 4 * 80), result.dst.bytes[at + 1]);
            EXPECT_EQ(opaqueChannel(7), result.dst.bytes[at + 2]);
            EXPECT_EQ(253, result.dst.bytes[at + 3]);
        }
    }
}

TEST(Pattern, OpaqueWhite_SamplesAs253) {
    const Tile white{1, 1, {255, 255, 255, 255}};
    // 255 * 65025 >> 16 = 253; premultiplied 253 * 254 >> 8 = 251.
    EXPECT_EQ((std::vector<uint8_t>{251, 251, 251, 253}),
              filled(sceneOf(filledMask(1, 1, 255)), white, 1.0F).dst.bytes);
}

TEST(Pattern, Bytes_AreAlphaRedGreenBlue) {
    const Tile tile{1, 1, {128, 200, 100, 50}};
    // Sampled 127, 198, 99, 49; premultiplied 127 * 199 >> 8 = 98, 127 * 100 >> 8 = 49, 127 * 50 >> 8.
    EXPECT_EQ((std::vector<uint8_t>{98, 49, 24, 127}),
              filled(sceneOf(filledMask(1, 1, 255)), tile, 1.0F).dst.bytes);
}

TEST(Pattern, Opacity_ScalesTheSampledAlpha) {
    const Tile white{1, 1, {255, 255, 255, 255}};
    // 253 * 0.5 = 126.5; 126 * 254 >> 8 = 125.
    EXPECT_EQ((std::vector<uint8_t>{125, 125, 125, 126}),
              filled(sceneOf(filledMask(1, 1, 255)), white, 1.0F, 0.5F).dst.bytes);
    const Scene scene = sceneOf(filledMask(3, 3, 255));
    EXPECT_TRUE(samePaint(scene, filled(scene, white, 1.0F, 0.0F)));
}

TEST(Pattern, OpacityBeyondItsRange_NeverWrapsTheAlpha) {
    const Tile white{1, 1, {255, 255, 255, 255}};
    const Scene scene = sceneOf(filledMask(3, 3, 255));
    const float infinity = std::numeric_limits<float>::infinity();
    for (float opacity : {1.5F, 2.0F, 100.0F, 1e30F, infinity}) {
        EXPECT_LE(253, alphaOf(filled(scene, white, 1.0F, opacity).dst)[4]) << opacity;
    }
    for (float opacity : {-0.5F, -1.0F, -300.0F, -1e30F, -infinity, std::nanf("")}) {
        EXPECT_TRUE(samePaint(scene, filled(scene, white, 1.0F, opacity))) << opacity;
    }
}

TEST(Pattern, OpacityAboveOne_RaisesTheSampledAlpha) {
    const Tile tile{1, 1, {200, 200, 200, 200}};
    const Scene result = filled(sceneOf(filledMask(1, 1, 255)), tile, 1.0F, 1.2F);
    // Sampled: 200 * 255 * 255 >> 16 = 198. Alpha: 198 * 1.2 = 237.6. Colours: 199 * 237 >> 8 = 184.
    EXPECT_EQ((std::vector<uint8_t>{184, 184, 184, 237}), result.dst.bytes);
}

TEST(Pattern, ScaleTwo_InterpolatesBetweenColumnsAndWraps) {
    const Scene result = filled(sceneOf(filledMask(16, 1, 255)), numberedTile(4, 4, 80, 0), 2.0F);
    // Odd columns lie half way: weights 128 and 127, times 255. Column 7 mixes the last with the first.
    const auto mixed = [](int first, int second) {
        return 253 * (((first * 128 + second * 127) * 255 >> 16) + 1) >> 8;
    };
    const std::vector<int> tile{opaqueChannel(0),   mixed(0, 80),    opaqueChannel(80),  mixed(80, 160),
                                opaqueChannel(160), mixed(160, 240), opaqueChannel(240), mixed(240, 0)};
    std::vector<int> expected = tile;
    expected.insert(expected.end(), tile.begin(), tile.end());
    EXPECT_EQ(expected, redRow(result.dst, 0));
}

TEST(Pattern, ScaleTwo_InterpolatesBetweenRowsAndWraps) {
    const Scene result = filled(sceneOf(filledMask(1, 8, 255)), numberedTile(4, 4, 0, 80), 2.0F);
    const std::vector<int> green = channelOf(result.dst, 1);
    EXPECT_EQ(opaqueChannel(80), green[2]);
    EXPECT_EQ(253 * (((80 * 128 + 160 * 127) * 255 >> 16) + 1) >> 8, green[3]);
    EXPECT_EQ(253 * ((240 * 128 * 255 >> 16) + 1) >> 8, green[7]);
}

TEST(Pattern, FractionalScale_CutsTheTile) {
    // 4 * 1.3 = 5.2: the tile is 5 pixels, column 5 starts anew.
    const std::vector<int> row =
        redRow(filled(sceneOf(filledMask(10, 1, 255)), numberedTile(4, 1, 80, 0), 1.3F).dst, 0);
    EXPECT_EQ(std::vector<int>(row.begin(), row.begin() + 5),
              std::vector<int>(row.begin() + 5, row.end()));
    EXPECT_EQ(opaqueChannel(0), row[0]);
}

TEST(Pattern, Tiling_StartsAtTheBox) {
    const Tile tile = numberedTile(3, 3, 60, 80);
    const Scene result = filled(sceneOf(filledMask(8, 6, 255), {2, 1, 7, 5}), tile, 1.0F);
    EXPECT_EQ((std::vector<int>{0, 0, opaqueChannel(0), opaqueChannel(60), opaqueChannel(120),
                                opaqueChannel(0), opaqueChannel(60), 0}),
              redRow(result.dst, 1));
    const std::vector<int> green = channelOf(result.dst, 1);
    EXPECT_EQ(opaqueChannel(0), green[1 * 8 + 2]);
    EXPECT_EQ(opaqueChannel(80), green[2 * 8 + 2]);
    EXPECT_EQ(std::vector<int>(8, 0), redRow(result.dst, 0));
    EXPECT_EQ(std::vector<int>(8, 0), redRow(result.dst, 5));
}

TEST(Pattern, Coverage_GatesButDoesNotScale) {
    const Tile white{1, 1, {255, 255, 255, 255}};
    expectCoverageGates(*coreWith(white, 1.0F, 1.0F), {251, 251, 251, 253});
}

TEST(Pattern, BoxLargerThanTheMask_IsCutToIt) {
    const Tile tile = numberedTile(3, 3, 60, 80);
    Scene scene = sceneOf(discMask(9, 7, 4.0F, 3.0F, 3.0F, true));
    const Scene whole = filled(scene, tile, 1.0F);
    constexpr int kMost = std::numeric_limits<int>::max();
    for (const literal::Box& box : {literal::Box{0, 0, 10, 7}, literal::Box{0, 0, 9, 200},
                                    literal::Box{0, 0, 4000, 3000}, literal::Box{0, 0, kMost, kMost}}) {
        scene.text = box;
        EXPECT_TRUE(samePicture(whole.dst, filled(scene, tile, 1.0F).dst)) << describe(scene);
    }
}

TEST(Pattern, ScaleBelowATenth_PaintsNothing) {
    const Scene scene = sceneOf(filledMask(8, 8, 255));
    const Tile tile = numberedTile(3, 3, 60, 80);
    for (float scale : {0.05F, 0.0999F, 0.0F, -1.0F, -std::numeric_limits<float>::infinity()}) {
        EXPECT_TRUE(samePaint(scene, filled(scene, tile, scale))) << scale;
    }
    EXPECT_FALSE(samePaint(scene, filled(scene, tile, 0.1F)));
}

TEST(Pattern, TileBelowOnePixel_CountsAsOne) {
    // 3 * 0.2 = 0.6: every pixel is the first of the pattern.
    const Tile tile = numberedTile(3, 3, 60, 80);
    EXPECT_EQ(std::vector<int>(6, opaqueChannel(0)),
              redRow(filled(sceneOf(filledMask(6, 6, 255)), tile, 0.2F).dst, 4));
    EXPECT_EQ(253, alphaOf(filled(sceneOf(filledMask(6, 6, 255)), tile, 0.2F).dst)[35]);
}

TEST(Pattern, ScaleThatIsNotANumber_PaintsTheFirstPixel) {
    Tile tile = numberedTile(3, 3, 60, 80);
    tile.bytes[1] = 200;
    EXPECT_EQ(std::vector<int>(4, opaqueChannel(200)),
              redRow(filled(sceneOf(filledMask(4, 4, 255)), tile, std::nanf("")).dst, 2));
}

TEST(Pattern, OpaqueDestination_IsUntouched) {
    expectOpaqueDestinationUntouched(*coreWith(numberedTile(3, 3, 60, 80), 1.0F, 1.0F),
                                     sceneOf(filledMask(8, 8, 255)));
}

// --- Hostile input ----------------------------------------------------------------------------------

TEST(Pattern, BrokenInput_PaintsNothing) {
    expectNothingFromBrokenInput(*coreWith(numberedTile(3, 3, 60, 80), 1.0F, 1.0F));
}

TEST(Pattern, BitmapsWithoutColourPixels_PaintNothing) {
    const Scene scene = sceneOf(filledMask(8, 8, 255));
    VFBitmap mask(4, 4, 1);
    VFBitmap threeBytes(4, 4, 3);
    VFBitmap none;
    VFBitmap noWidth(0, 4, 4);
    VFBitmap noHeight(4, 0, 4);
    VFBitmap noPixels(4, 4, nullptr, 4);
    for (VFBitmap* bitmap : {&mask, &threeBytes}) {
        for (int i = 0; i < 16; ++i)
            bitmap->mData[i] = 255;
    }
    for (VFBitmap* bitmap : {&mask, &threeBytes, &none, &noWidth, &noHeight, &noPixels}) {
        const auto core = coreOf<VFPattern, VFPatternProperty>(bitmap, 1.0F, 1.0F);
        EXPECT_TRUE(paintsNothing(*core, scene));
    }
    const auto core = coreOf<VFPattern, VFPatternProperty>(nullptr, 1.0F, 1.0F);
    EXPECT_TRUE(paintsNothing(*core, scene));
}

TEST(Pattern, RecordWithoutABitmap_ReplacesOneWithABitmap) {
    const Scene scene = sceneOf(filledMask(8, 8, 255));
    const auto core = coreWith(numberedTile(3, 3, 60, 80), 1.0F, 1.0F);
    ASSERT_FALSE(paintsNothing(*core, scene));
    VFPatternProperty record(nullptr, 1.0F, 1.0F);
    core->setProperty(&record);
    EXPECT_TRUE(paintsNothing(*core, scene));
}

// --- Against the literal form -----------------------------------------------------------------------

TEST(Pattern, EveryTenthOfAScale_MatchesTheLiteralForm) {
    Random random(5);
    const Tile tile = randomTile(random, 9);
    const Scene scene = sceneOf(filledMask(61, 23, 255));
    for (int tenth = 1; tenth <= 105; ++tenth) {
        ASSERT_TRUE(matchesLiteral(scene, tile, static_cast<float>(tenth) * 0.1F, 1.0F));
        ASSERT_TRUE(
            matchesLiteral(scene, numberedTile(7, 5, 30, 40), static_cast<float>(tenth) / 10.0F, 0.7F));
    }
}

TEST(Pattern, RandomScenes_MatchTheLiteralForm) {
    forSeeds(1000, 5000, [](Random& random) {
        const Scene scene = randomScene(random, 45);
        const Tile tile = randomTile(random, random.chance(50) ? 3 : 24);
        const float scale =
            random.chance(3) ? std::nanf("") : random.real(0.08F, random.chance(50) ? 2.0F : 10.5F);
        EXPECT_TRUE(
            matchesLiteral(scene, tile, scale, random.chance(30) ? 1.0F : random.real(0.0F, 1.0F)));
    });
}

TEST(Pattern, EveryMaskOfTheGallery_MatchesTheLiteralForm) {
    forGallery([](Random& random, const literal::Mask& mask) {
        for (int i = 0; i < 12; ++i) {
            const Scene scene = randomScene(random, mask);
            ASSERT_TRUE(matchesLiteral(scene, randomTile(random, 40), random.real(0.1F, 4.0F), 1.0F));
        }
    });
}

TEST(Pattern, BoxesLargerThanTheMask_MatchTheLiteralForm) {
    forSeeds(4000, 400, [](Random& random) {
        Scene scene = randomScene(random, 16);
        scene.text = {random.between(-1, 1), random.between(-1, 1), random.between(1, 40),
                      random.between(1, 40)};
        EXPECT_TRUE(matchesLiteral(scene, randomTile(random, 6), random.real(0.1F, 3.0F), 1.0F));
    });
}

TEST(Pattern, DestinationOfAnotherSize_IsClipped) {
    forOtherDestinations(300, 16, 24, [](Random& random, const Scene& scene) {
        EXPECT_TRUE(matchesLiteral(scene, randomTile(random, 6), random.real(0.1F, 3.0F), 1.0F));
    });
}

}  // namespace
