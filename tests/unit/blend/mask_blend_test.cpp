#include <gtest/gtest.h>

#include <climits>
#include <cstdint>
#include <cstring>
#include <vector>

#include "tests/support/compare.h"
#include "tests/support/guarded.h"
#include "tests/support/literal_blend.h"
#include "tests/support/pixel_cases.h"
#include "tests/support/random.h"
#include "tests/support/thinned.h"
#include "voreleffect/VFBitmap.h"
#include "voreleffect/VFBlender.h"

namespace {

using namespace vorel_test;
using VFontEffect::VFBitmap;
using VFontEffect::VFBlender;
using Pixel = std::vector<uint8_t>;

constexpr int kModes[] = {1, 2, 3, 7};
constexpr int kSrcOver = 1;
constexpr int kDstOver = 2;
constexpr int kGated = 3;
constexpr int kClipped = 7;
constexpr int kSweepCases = 4000;

/// One pixel `before` after drawing `color` through coverage `m` in `mode`.
Pixel blended(int mode, uint8_t m, uint32_t color, const Pixel& before) {
    VFBitmap dst(1, 1, 4);
    memcpy(dst.mData, before.data(), 4);
    VFBlender().drawBitmapBlend8(0, 0, &dst, &m, 1, 1, 1, color, mode);
    return Pixel(dst.mData, dst.mData + 4);
}

/// Draws with the operation of `mode` by its own name.
void drawByName(int mode, const Placement& p, const VFBitmap* dst, uint8_t* mask, int stride,
                uint32_t color) {
    VFBlender blender;
    if (mode == kSrcOver)
        blender.blendSrcOver8To32(p.x, p.y, dst, mask, p.width, p.height, stride, color);
    if (mode == kDstOver)
        blender.blendDstOver8To32(p.x, p.y, dst, mask, p.width, p.height, stride, color);
    if (mode == kGated)
        blender.blendDstOver8To32NSA(p.x, p.y, dst, mask, p.width, p.height, stride, color);
    if (mode == kClipped)
        blender.blendDstOverSA8To32(p.x, p.y, dst, mask, p.width, p.height, stride, color);
}

void drawByMode(int mode, const Placement& p, const VFBitmap* dst, uint8_t* mask, int stride,
                uint32_t color) {
    VFBlender().drawBitmapBlend8(p.x, p.y, dst, mask, p.width, p.height, stride, color, mode);
}

void drawLiteral(int mode, const Placement& p, uint8_t* dst, const uint8_t* mask, int stride,
                 uint32_t color) {
    literal::drawBitmapBlend8(p.x, p.y, dst, p.dstWidth, p.dstHeight, mask, p.width, p.height, stride,
                              color, mode);
}

using Draw = decltype(&drawByName);

/// Draws with `draw`, by name or by mode, and compares the destination with the literal form.
::testing::AssertionResult matchesLiteral(Draw draw, int mode, const Placement& p, GuardedBitmap& dst,
                                          uint8_t* mask, int stride, uint32_t color) {
    std::vector<uint8_t> expected = bytesOf(dst.pixels());
    drawLiteral(mode, p, expected.data(), mask, stride, color);
    draw(mode, p, dst.bitmap(), mask, stride, color);
    return sameBytes(expected.data(), dst.pixels().data(), p.dstWidth, p.dstHeight, 4);
}

/// Every operation, by both of its names, leaves `dst` as it is.
void expectNothingDrawn(GuardedBitmap& dst, const Placement& p, uint8_t* mask, int stride) {
    const std::vector<uint8_t> before = bytesOf(dst.pixels());
    for (const int mode : kModes) {
        drawByName(mode, p, dst.bitmap(), mask, stride, 0xFFFFFFFF);
        drawByMode(mode, p, dst.bitmap(), mask, stride, 0xFFFFFFFF);
        EXPECT_EQ(bytesOf(dst.pixels()), before)
            << "mode " << mode << ", stride " << stride << ", " << p;
    }
}

TEST(SrcOver8, OpaqueColourThroughFullMaskReplacesThePixel) {
    EXPECT_EQ(blended(kSrcOver, 255, 0xFF102030, {1, 2, 3, 4}), (Pixel{0x10, 0x20, 0x30, 0xFF}));
}

TEST(SrcOver8, NoAlphaLeavesThePixel) {
    EXPECT_EQ(blended(kSrcOver, 0, 0xFF102030, {1, 2, 3, 4}), (Pixel{1, 2, 3, 4}));
    EXPECT_EQ(blended(kSrcOver, 255, 0x00102030, {1, 2, 3, 4}), (Pixel{1, 2, 3, 4}));
    EXPECT_EQ(blended(kSrcOver, 1, 0x7F102030, {1, 2, 3, 4}), (Pixel{1, 2, 3, 4}));  // 128 >> 8
}

TEST(SrcOver8, HalfMaskMixes) {
    // Colour (64, 32, 16, 128) over 127 parts of the pixel: 99 + 64, 50 + 32, 25 + 16, 127 + 128.
    EXPECT_EQ(blended(kSrcOver, 128, 0xFF804020, {200, 100, 50, 255}), (Pixel{163, 82, 41, 255}));
}

TEST(SrcOver8, SumsAreSaturated) {
    EXPECT_EQ(blended(kSrcOver, 255, 0x80FFFFFF, {255, 255, 255, 255}), (Pixel{255, 255, 255, 255}));
}

TEST(DstOver8, OpaquePixelIsUntouched) {
    EXPECT_EQ(blended(kDstOver, 255, 0xFF102030, {1, 2, 3, 255}), (Pixel{1, 2, 3, 255}));
}

TEST(DstOver8, TransparentPixelTakesTheMaskedColour) {
    EXPECT_EQ(blended(kDstOver, 128, 0xFF804020, {9, 9, 9, 0}), (Pixel{64, 32, 16, 128}));
}

TEST(DstOver8, TranslucentPixelIsFilledFromBeneath) {
    // 200 parts of (64, 32, 16, 128): 50, 25, 13, 100.
    EXPECT_EQ(blended(kDstOver, 128, 0xFF804020, {10, 20, 30, 55}), (Pixel{60, 45, 43, 155}));
}

TEST(DstOverGated8, FaintestMaskPaintsTheFullColour) {
    EXPECT_EQ(blended(kGated, 1, 0xFF804020, {0, 0, 0, 0}), (Pixel{0x80, 0x40, 0x20, 0xFF}));
    // 200 parts of the full colour: 100, 50, 25, 200.
    EXPECT_EQ(blended(kGated, 1, 0xFF804020, {10, 20, 30, 55}), (Pixel{110, 70, 55, 255}));
}

TEST(DstOverGated8, OpaquePixelOrEmptyMaskIsUntouched) {
    EXPECT_EQ(blended(kGated, 255, 0xFF804020, {1, 2, 3, 255}), (Pixel{1, 2, 3, 255}));
    EXPECT_EQ(blended(kGated, 0, 0xFF804020, {1, 2, 3, 0}), (Pixel{1, 2, 3, 0}));
}

TEST(DstOverClipped8, EmptyMaskClearsThePixel) {
    EXPECT_EQ(blended(kClipped, 0, 0xFF804020, {200, 100, 50, 255}), (Pixel{0, 0, 0, 0}));
}

TEST(DstOverClipped8, FullMaskIsADestinationOver) {
    EXPECT_EQ(blended(kClipped, 255, 0xFF804020, {200, 100, 50, 255}), (Pixel{200, 100, 50, 255}));
    EXPECT_EQ(blended(kClipped, 255, 0xFF804020, {10, 20, 30, 55}), (Pixel{110, 70, 55, 255}));
}

TEST(DstOverClipped8, PartialMaskScalesTheMixedPixel) {
    EXPECT_EQ(blended(kClipped, 128, 0xFF804020, {9, 9, 9, 0}), (Pixel{64, 32, 16, 128}));
    EXPECT_EQ(blended(kClipped, 128, 0xFF804020, {200, 100, 50, 255}), (Pixel{100, 50, 25, 128}));
    // (10 + 50, 20 + 25, 30 + 13, 55 + 100) plus 1, halved.
    EXPECT_EQ(blended(kClipped, 128, 0xFF804020, {10, 20, 30, 55}), (Pixel{30, 23, 22, 78}));
}

TEST(DstOverClipped8, ErasesInsideTheRectangleOnly) {
    VFBitmap dst(4, 3, 4);
    memset(dst.mData, 77, 48);
    uint8_t mask[] = {0, 0};
    VFBlender().drawBitmapBlend8(1, 1, &dst, mask, 2, 1, 2, 0xFFFFFFFF, kClipped);
    std::vector<uint8_t> expected(48, 77);
    memset(expected.data() + (4 + 1) * 4, 0, 8);
    EXPECT_EQ(bytesOf(dst), expected);
}

TEST(MaskBlend, NegativePlacementReadsTheMaskFromItsColumn) {
    VFBitmap dst(2, 1, 4);
    uint8_t mask[] = {0, 0, 0, 0, 0, 50, 60};
    VFBlender().drawBitmapBlend8(-5, 0, &dst, mask, 7, 1, 7, 0xFFFFFFFF, kDstOver);
    EXPECT_EQ(bytesOf(dst), (std::vector<uint8_t>{50, 50, 50, 50, 60, 60, 60, 60}));
}

TEST(MaskBlend, RowsOfTheMaskAreAStrideApart) {
    VFBitmap dst(1, 2, 4);
    uint8_t mask[] = {10, 99, 99, 20};
    VFBlender().drawBitmapBlend8(0, 0, &dst, mask, 1, 2, 3, 0xFFFFFFFF, kDstOver);
    EXPECT_EQ(bytesOf(dst), (std::vector<uint8_t>{10, 10, 10, 10, 20, 20, 20, 20}));
}

TEST(MaskBlend, UnknownModesDrawNothing) {
    for (const int mode : {INT_MIN, -1, 0, 4, 5, 6, 8, 255, INT_MAX})
        EXPECT_EQ(blended(mode, 255, 0xFF102030, {1, 2, 3, 4}), (Pixel{1, 2, 3, 4})) << mode;
}

/// Coverage changes along a row and the alpha of the destination from row to row.
TEST(MaskBlendSweep, AllCoveragesOverAllAlphasMatchTheLiteralForm) {
    constexpr int kSide = 256;
    GuardedBuffer mask(kSide * kSide);
    for (size_t i = 0; i < mask.size(); ++i)
        mask.data()[i] = static_cast<uint8_t>(i % kSide);
    for (const int mode : kModes) {
        for (int seed = 0; seed < thinned(32); ++seed) {
            Random random(static_cast<uint64_t>(seed));
            const uint32_t color = randomColor(random);
            SCOPED_TRACE(testing::Message() << "seed " << seed << ", mode " << mode);
            GuardedBitmap dst(kSide, kSide, 4);
            fillColour(random, dst.pixels());
            for (size_t i = 0; i < mask.size(); ++i)
                dst.pixels().data()[i * 4 + 3] = static_cast<uint8_t>(i / kSide);
            const Placement whole{kSide, kSide, 0, 0, kSide, kSide};
            ASSERT_TRUE(matchesLiteral(drawByMode, mode, whole, dst, mask.data(), kSide, color));
        }
    }
}

TEST(MaskBlendSweep, MatchesTheLiteralForm) {
    for (const int mode : kModes) {
        for (int seed = 0; seed < thinned(kSweepCases); ++seed) {
            Random random(static_cast<uint64_t>(seed));
            const Placement p = randomPlacement(random);
            const int stride = p.width + oneOf(random, {0, 0, 1, 3, 16, 29});
            SCOPED_TRACE(testing::Message()
                         << "seed " << seed << ", mode " << mode << ", stride " << stride << ", " << p);

            GuardedBitmap dst(p.dstWidth, p.dstHeight, 4, randomEdge(random));
            fillColour(random, dst.pixels());
            GuardedBuffer mask(sourceBytes(p.height, stride, p.width), randomEdge(random));
            fillMask(random, mask.data(), mask.size());
            const uint32_t color = randomColor(random);

            const auto draw = random.chance(50) ? drawByName : drawByMode;
            ASSERT_TRUE(matchesLiteral(draw, mode, p, dst, mask.data(), stride, color));
        }
    }
}

TEST(MaskBlendLimits, PlacementsAtTheEndsOfAnIntMatchTheLiteralForm) {
    constexpr int kStride = 9;
    GuardedBuffer mask(kStride * 4);
    Random random(5);
    fillMask(random, mask.data(), mask.size());
    for (const int mode : kModes) {
        for (const Placement& p : extremePlacements({INT_MIN, -1, 0, 1, 8, INT_MAX})) {
            SCOPED_TRACE(testing::Message() << "mode " << mode << ", " << p);
            GuardedBitmap dst(p.dstWidth, p.dstHeight, 4);
            fillColour(random, dst.pixels());
            ASSERT_TRUE(matchesLiteral(drawByName, mode, p, dst, mask.data(), kStride, 0x80FF7F01));
        }
    }
}

TEST(MaskBlendLimits, StrideOfZeroRepeatsTheRowAndANegativeOneDrawsNothing) {
    GuardedBuffer mask(8);
    Random random(6);
    fillMask(random, mask.data(), mask.size());
    const Placement p{8, 3, 0, 0, 8, 3};
    for (const int mode : kModes) {
        GuardedBitmap dst(8, 3, 4);
        fillColour(random, dst.pixels());
        ASSERT_TRUE(matchesLiteral(drawByName, mode, p, dst, mask.data(), 0, 0xFF00FF7F)) << mode;
    }
    GuardedBitmap dst(8, 3, 4);
    for (const int stride : {-1, -8, INT_MIN})
        expectNothingDrawn(dst, p, mask.data(), stride);
}

TEST(MaskBlendLimits, NullArgumentsDrawNothing) {
    uint8_t mask[] = {255, 255, 255, 255};
    const Placement p{3, 3, 0, 0, 2, 2};
    VFBitmap withoutPixels;
    withoutPixels.mWidth = 3;
    withoutPixels.mHeight = 3;
    withoutPixels.mBytesPerPixel = 4;
    for (const int mode : kModes) {
        drawByName(mode, p, nullptr, mask, 2, 0xFFFFFFFF);
        drawByMode(mode, p, nullptr, mask, 2, 0xFFFFFFFF);
        drawByName(mode, p, &withoutPixels, mask, 2, 0xFFFFFFFF);
        drawByMode(mode, p, &withoutPixels, mask, 2, 0xFFFFFFFF);
    }
    EXPECT_EQ(withoutPixels.mData, nullptr);
    GuardedBitmap dst(3, 3, 4);
    expectNothingDrawn(dst, p, nullptr, 2);
}

TEST(MaskBlendLimits, OtherBytesPerPixelDrawNothing) {
    uint8_t mask[] = {255, 0, 255, 0};
    for (const unsigned bytesPerPixel : {0U, 1U, 2U, 3U, 5U, 0xFFFFFFFFU}) {
        GuardedBitmap dst(3, 3, 5);
        memset(dst.pixels().data(), 99, dst.pixels().size());
        dst.bitmap()->mBytesPerPixel = bytesPerPixel;
        expectNothingDrawn(dst, Placement{3, 3, 0, 0, 2, 2}, mask, 2);
    }
}

TEST(MaskBlendLimits, ByteCountsBeyondThirtyTwoBitsAreNotTouched) {
    std::vector<uint8_t> mask(64, 255);
    mask[1] = 0;
    for (const Numbers& numbers : wrappingNumbers(4)) {
        SCOPED_TRACE(testing::Message() << numbers.width << " x " << numbers.height);
        GuardedBitmap dst(4, 4, 4);
        memset(dst.pixels().data(), 99, dst.pixels().size());
        claim(dst.bitmap(), numbers);
        expectNothingDrawn(dst, Placement{4, 4, 0, 0, 32, 2}, mask.data(), 32);
        expectNothingDrawn(dst, Placement{4, 4, 60000, 30000, 32, 2}, mask.data(), 32);
    }
}

TEST(MaskBlendLimits, DestinationWithoutAreaIsNotTouched) {
    uint8_t mask[] = {255, 0, 255, 0};
    GuardedBitmap dst(4, 4, 4);
    for (const Numbers& numbers : {Numbers{0, 4, 4}, Numbers{4, 0, 4}, Numbers{0, 0, 4}}) {
        claim(dst.bitmap(), numbers);
        expectNothingDrawn(dst, Placement{4, 4, 0, 0, 2, 2}, mask, 2);
    }
}

}  // namespace
