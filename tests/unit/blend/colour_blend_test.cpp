#include <gtest/gtest.h>

#include <climits>
#include <cstdint>
#include <cstring>
#include <utility>
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

constexpr int kSrcOver = 1;
constexpr int kDstOver = 2;
constexpr int kModes[] = {kSrcOver, kDstOver};
constexpr int kAlphaFirst = 0;
constexpr int kAlphaLast = 1;
constexpr int kOrders[] = {kAlphaFirst, kAlphaLast};
constexpr int kSweepCases = 6000;

uint32_t* wordsOf(const GuardedBuffer& buffer) {
    return reinterpret_cast<uint32_t*>(buffer.data());
}

/// One pixel `before` after drawing the word `source` in `mode`.
Pixel blended(int mode, uint32_t source, const Pixel& before) {
    VFBitmap dst(1, 1, 4);
    memcpy(dst.mData, before.data(), 4);
    VFBlender().drawBitmapBlend32(0, 0, &dst, &source, 1, 1, 1, mode);
    return Pixel(dst.mData, dst.mData + 4);
}

/// One pixel `before` after drawing the four bytes `source` in `order`.
Pixel blendedBytes(int order, Pixel source, const Pixel& before) {
    VFBitmap dst(1, 1, 4);
    memcpy(dst.mData, before.data(), 4);
    VFBlender().drawBitmapBlend32(0, 0, &dst, source.data(), 1, 1, 4, order);
    return Pixel(dst.mData, dst.mData + 4);
}

/// Draws words with the operation of `mode` by its own name.
void drawByName(int mode, const Placement& p, const VFBitmap* dst, uint32_t* src, int stride) {
    VFBlender blender;
    if (mode == kSrcOver) blender.blendSrcOver32To32(p.x, p.y, dst, src, p.width, p.height, stride);
    if (mode == kDstOver) blender.blendDstOver32To32(p.x, p.y, dst, src, p.width, p.height, stride);
}

/// Draws words with the operation of `mode` by the mode's number.
void drawByMode(int mode, const Placement& p, const VFBitmap* dst, uint32_t* src, int stride) {
    VFBlender().drawBitmapBlend32(p.x, p.y, dst, src, p.width, p.height, stride, mode);
}

/// Draws bytes with the operation that takes them, by its own name.
void drawBytesByName(int order, const Placement& p, const VFBitmap* dst, uint8_t* src, int stride) {
    VFBlender().blendDstOver32To32(p.x, p.y, dst, src, p.width, p.height, stride, order);
}

void drawBytesByOrder(int order, const Placement& p, const VFBitmap* dst, uint8_t* src, int stride) {
    VFBlender().drawBitmapBlend32(p.x, p.y, dst, src, p.width, p.height, stride, order);
}

/// Draws with `draw` and compares the destination with the literal form: words in a mode or bytes in
/// an order.
template <class Unit>
::testing::AssertionResult matchesLiteral(void (*draw)(int, const Placement&, const VFBitmap*, Unit*,
                                                       int),
                                          int modeOrOrder, const Placement& p, GuardedBitmap& dst,
                                          Unit* src, int stride) {
    std::vector<uint8_t> expected = bytesOf(dst.pixels());
    const Unit* const source = src;
    literal::drawBitmapBlend32(p.x, p.y, expected.data(), p.dstWidth, p.dstHeight, source, p.width,
                               p.height, stride, modeOrOrder);
    draw(modeOrOrder, p, dst.bitmap(), src, stride);
    return sameBytes(expected.data(), dst.pixels().data(), p.dstWidth, p.dstHeight, 4);
}

/// Every operation, by both of its names and from words and bytes, leaves `dst` as it is.
void expectNothingDrawn(GuardedBitmap& dst, const Placement& p, uint32_t* words, int stride) {
    const std::vector<uint8_t> before = bytesOf(dst.pixels());
    for (const int mode : kModes) {
        drawByName(mode, p, dst.bitmap(), words, stride);
        drawByMode(mode, p, dst.bitmap(), words, stride);
    }
    auto* const bytes = reinterpret_cast<uint8_t*>(words);
    for (const int order : kOrders) {
        drawBytesByOrder(order, p, dst.bitmap(), bytes, stride);
        drawBytesByName(order, p, dst.bitmap(), bytes, stride);
    }
    EXPECT_EQ(bytesOf(dst.pixels()), before) << "stride " << stride << ", " << p;
}

TEST(SrcOver32, OpaqueSourceReplacesThePixel) {
    EXPECT_EQ(blended(kSrcOver, 0xFF102030, {1, 2, 3, 4}), (Pixel{0x10, 0x20, 0x30, 0xFF}));
}

TEST(SrcOver32, TranslucentSourceMixes) {
    // 127 parts of the pixel: 99, 50, 25, 127.
    EXPECT_EQ(blended(kSrcOver, 0x80402010, {200, 100, 50, 255}), (Pixel{163, 82, 41, 255}));
}

TEST(SrcOver32, TransparentSourceLeavesEveryValue) {
    for (int v = 0; v < 256; ++v) {
        const auto byte = static_cast<uint8_t>(v);
        const Pixel before = {byte, byte, byte, byte};
        EXPECT_EQ(blended(kSrcOver, 0, before), before);
    }
}

TEST(SrcOver32, TransparentSourceWithColourIsNotSkipped) {
    EXPECT_EQ(blended(kSrcOver, 0x00102030, {1, 2, 3, 4}), (Pixel{0x11, 0x22, 0x33, 4}));
}

TEST(SrcOver32, SumsAreSaturated) {
    EXPECT_EQ(blended(kSrcOver, 0x80FFFFFF, {255, 255, 255, 255}), (Pixel{255, 255, 255, 255}));
}

TEST(DstOver32, OpaquePixelIsUntouched) {
    EXPECT_EQ(blended(kDstOver, 0xFF102030, {1, 2, 3, 255}), (Pixel{1, 2, 3, 255}));
    for (const int order : kOrders)
        EXPECT_EQ(blendedBytes(order, {255, 9, 9, 255}, {1, 2, 3, 255}), (Pixel{1, 2, 3, 255}));
}

TEST(DstOver32, TransparentPixelTakesTheSource) {
    EXPECT_EQ(blended(kDstOver, 0x80402010, {9, 9, 9, 0}), (Pixel{0x40, 0x20, 0x10, 0x80}));
}

TEST(DstOver32, TransparentSourceLeavesThePixelWhateverItsColour) {
    EXPECT_EQ(blended(kDstOver, 0x00FFFFFF, {9, 9, 9, 0}), (Pixel{9, 9, 9, 0}));
    EXPECT_EQ(blended(kDstOver, 0x00FFFFFF, {9, 9, 9, 100}), (Pixel{9, 9, 9, 100}));
    EXPECT_EQ(blendedBytes(kAlphaFirst, {0, 255, 255, 255}, {9, 9, 9, 0}), (Pixel{9, 9, 9, 0}));
    EXPECT_EQ(blendedBytes(kAlphaLast, {255, 255, 255, 0}, {9, 9, 9, 0}), (Pixel{9, 9, 9, 0}));
}

TEST(DstOver32, TranslucentPixelIsFilledFromBeneath) {
    // 200 parts of (64, 32, 16, 128), each plus 1: 50, 25, 13, 100.
    EXPECT_EQ(blended(kDstOver, 0x80402010, {10, 20, 30, 55}), (Pixel{60, 45, 43, 155}));
}

TEST(DstOver32, ByteOrderNamesThePlaceOfTheAlpha) {
    const Pixel expected = {60, 45, 43, 155};
    EXPECT_EQ(blendedBytes(kAlphaFirst, {128, 64, 32, 16}, {10, 20, 30, 55}), expected);
    EXPECT_EQ(blendedBytes(kAlphaLast, {64, 32, 16, 128}, {10, 20, 30, 55}), expected);
}

TEST(DstOver32, NegativePlacementOfWordsSkipsWholePixels) {
    VFBitmap dst(2, 1, 4);
    uint32_t words[] = {0xFF000001, 0xFF000002, 0xFF000003};
    VFBlender().drawBitmapBlend32(-1, 0, &dst, words, 3, 1, 3, kDstOver);
    EXPECT_EQ(bytesOf(dst), (Pixel{0, 0, 2, 255, 0, 0, 3, 255}));
}

TEST(DstOver32, NegativePlacementOfBytesSkipsAsManyBytes) {
    VFBitmap dst(2, 1, 4);
    Pixel source = {1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12};
    VFBlender().drawBitmapBlend32(-1, 0, &dst, source.data(), 3, 1, 12, kAlphaLast);
    EXPECT_EQ(bytesOf(dst), (Pixel{2, 3, 4, 5, 6, 7, 8, 9}));
}

TEST(ColourBlend, UnknownModesAndOrdersDrawNothing) {
    const Pixel before = {1, 2, 3, 4};
    for (const int mode : {INT_MIN, -1, 0, 3, 4, 7, 255, INT_MAX})
        EXPECT_EQ(blended(mode, 0xFF102030, before), before) << mode;
    for (const int order : {INT_MIN, -1, 2, 3, 255, INT_MAX})
        EXPECT_EQ(blendedBytes(order, {255, 255, 255, 255}, before), before) << order;
}

/// The alpha of the source changes along a row and that of the destination from row to row.
TEST(ColourBlendSweep, AllPairsOfAlphasMatchTheLiteralForm) {
    constexpr int kSide = 256;
    const Placement whole{kSide, kSide, 0, 0, kSide, kSide};
    for (const int mode : kModes) {
        for (int seed = 0; seed < thinned(32); ++seed) {
            SCOPED_TRACE(testing::Message() << "seed " << seed << ", mode " << mode);
            Random random(static_cast<uint64_t>(seed));
            GuardedBitmap dst(kSide, kSide, 4);
            GuardedBuffer source(kSide * kSide * 4);
            fillColour(random, dst.pixels());
            for (uint32_t i = 0; i < kSide * kSide; ++i) {
                dst.pixels().data()[i * 4 + 3] = static_cast<uint8_t>(i / kSide);
                wordsOf(source)[i] = i % kSide << 24 | (randomColor(random) & 0x00FFFFFF);
            }
            ASSERT_TRUE(matchesLiteral(drawByName, mode, whole, dst, wordsOf(source), kSide));
        }
    }
}

TEST(ColourBlendSweep, WordsMatchTheLiteralForm) {
    for (const int mode : kModes) {
        for (int seed = 0; seed < thinned(kSweepCases); ++seed) {
            Random random(static_cast<uint64_t>(seed));
            const Placement p = randomPlacement(random);
            const int stride = p.width + oneOf(random, {0, 0, 1, 3, 16, 29});
            SCOPED_TRACE(testing::Message()
                         << "seed " << seed << ", mode " << mode << ", stride " << stride << ", " << p);

            GuardedBitmap dst(p.dstWidth, p.dstHeight, 4, randomEdge(random));
            fillColour(random, dst.pixels());
            GuardedBuffer source(sourceBytes(p.height, stride * 4, p.width * 4), randomEdge(random));
            fillColour(random, source);

            const auto draw = random.chance(50) ? drawByName : drawByMode;
            ASSERT_TRUE(matchesLiteral(draw, mode, p, dst, wordsOf(source), stride));
        }
    }
}

TEST(ColourBlendSweep, BytesMatchTheLiteralForm) {
    for (const int order : kOrders) {
        for (int seed = 0; seed < thinned(kSweepCases); ++seed) {
            Random random(static_cast<uint64_t>(seed));
            const Placement p = randomPlacement(random);
            const int stride = p.width * 4 + oneOf(random, {0, 0, 1, 2, 3, 4, 29});
            SCOPED_TRACE(testing::Message() << "seed " << seed << ", order " << order << ", stride "
                                            << stride << ", " << p);

            GuardedBitmap dst(p.dstWidth, p.dstHeight, 4, randomEdge(random));
            fillColour(random, dst.pixels());
            GuardedBuffer source(sourceBytes(p.height, stride, p.width * 4), randomEdge(random));
            fillMask(random, source.data(), source.size());
            for (int row = 0; row < p.height; ++row)
                fillColour(random, source.data() + row * stride, static_cast<size_t>(p.width),
                           order == kAlphaFirst ? 0 : 3);

            const auto draw = random.chance(50) ? drawBytesByName : drawBytesByOrder;
            ASSERT_TRUE(matchesLiteral(draw, order, p, dst, source.data(), stride));
        }
    }
}

TEST(ColourBlendLimits, PlacementsAtTheEndsOfAnIntMatchTheLiteralForm) {
    constexpr int kStride = 9;
    GuardedBuffer source(kStride * 4 * 4);
    Random random(7);
    fillColour(random, source);
    for (const Placement& p : extremePlacements({INT_MIN, -1, 0, 1, 8, INT_MAX})) {
        for (const int mode : kModes) {
            SCOPED_TRACE(testing::Message() << "mode " << mode << ", " << p);
            GuardedBitmap dst(p.dstWidth, p.dstHeight, 4);
            fillColour(random, dst.pixels());
            ASSERT_TRUE(matchesLiteral(drawByName, mode, p, dst, wordsOf(source), kStride));
        }
        for (const int order : kOrders) {
            SCOPED_TRACE(testing::Message() << "order " << order << ", " << p);
            GuardedBitmap dst(p.dstWidth, p.dstHeight, 4);
            fillColour(random, dst.pixels());
            ASSERT_TRUE(matchesLiteral(drawBytesByName, order, p, dst, source.data(), kStride * 4));
        }
    }
}

TEST(ColourBlendLimits, NullArgumentsDrawNothing) {
    uint32_t words[] = {0xFFFFFFFF, 0xFFFFFFFF, 0xFFFFFFFF, 0xFFFFFFFF};
    auto* const bytes = reinterpret_cast<uint8_t*>(words);
    const Placement p{3, 3, 0, 0, 2, 2};
    VFBitmap withoutPixels;
    withoutPixels.mWidth = 3;
    withoutPixels.mHeight = 3;
    withoutPixels.mBytesPerPixel = 4;
    for (const VFBitmap* dst : {static_cast<const VFBitmap*>(nullptr), &std::as_const(withoutPixels)}) {
        for (const int mode : kModes) {
            drawByName(mode, p, dst, words, 2);
            drawByMode(mode, p, dst, words, 2);
        }
        for (const int order : kOrders) {
            drawBytesByName(order, p, dst, bytes, 8);
            drawBytesByOrder(order, p, dst, bytes, 8);
        }
    }
    EXPECT_EQ(withoutPixels.mData, nullptr);
    GuardedBitmap dst(3, 3, 4);
    expectNothingDrawn(dst, p, nullptr, 8);
}

TEST(ColourBlendLimits, OtherBytesPerPixelDrawNothing) {
    std::vector<uint32_t> words(16, 0x80FFFFFF);
    for (const unsigned bytesPerPixel : {0U, 1U, 2U, 3U, 5U, 0xFFFFFFFFU}) {
        GuardedBitmap dst(3, 3, 5);
        memset(dst.pixels().data(), 99, dst.pixels().size());
        dst.bitmap()->mBytesPerPixel = bytesPerPixel;
        expectNothingDrawn(dst, Placement{3, 3, 0, 0, 2, 2}, words.data(), 8);
    }
}

TEST(ColourBlendLimits, ByteCountsBeyondThirtyTwoBitsAreNotTouched) {
    std::vector<uint32_t> words(256, 0x80FFFFFF);
    for (const Numbers& numbers : wrappingNumbers(4)) {
        SCOPED_TRACE(testing::Message() << numbers.width << " x " << numbers.height);
        GuardedBitmap dst(4, 4, 4);
        memset(dst.pixels().data(), 99, dst.pixels().size());
        claim(dst.bitmap(), numbers);
        expectNothingDrawn(dst, Placement{4, 4, 0, 0, 32, 2}, words.data(), 128);
        expectNothingDrawn(dst, Placement{4, 4, 60000, 30000, 32, 2}, words.data(), 128);
    }
}

TEST(ColourBlendLimits, StrideOfZeroRepeatsTheRow) {
    GuardedBuffer source(8 * 4);
    Random random(6);
    fillColour(random, source);
    const Placement p{8, 3, 0, 0, 8, 3};
    for (const int mode : kModes) {
        GuardedBitmap dst(8, 3, 4);
        fillColour(random, dst.pixels());
        ASSERT_TRUE(matchesLiteral(drawByName, mode, p, dst, wordsOf(source), 0)) << mode;
    }
    for (const int order : kOrders) {
        GuardedBitmap dst(8, 3, 4);
        fillColour(random, dst.pixels());
        ASSERT_TRUE(matchesLiteral(drawBytesByName, order, p, dst, source.data(), 0)) << order;
    }
}

TEST(ColourBlendLimits, EmptySourceOrDestinationOrNegativeStrideDrawsNothing) {
    std::vector<uint32_t> words(16, 0x80FFFFFF);
    GuardedBitmap dst(4, 4, 4);
    memset(dst.pixels().data(), 99, dst.pixels().size());
    for (const int length : {0, -1, INT_MIN}) {
        expectNothingDrawn(dst, Placement{4, 4, 0, 0, length, 2}, words.data(), 8);
        expectNothingDrawn(dst, Placement{4, 4, 0, 0, 2, length}, words.data(), 8);
    }
    for (const int stride : {-1, -8, INT_MIN})
        expectNothingDrawn(dst, Placement{4, 4, 0, 0, 2, 2}, words.data() + 8, stride);
    for (const Numbers& numbers : {Numbers{0, 4, 4}, Numbers{4, 0, 4}, Numbers{0, 0, 4}}) {
        claim(dst.bitmap(), numbers);
        expectNothingDrawn(dst, Placement{4, 4, 0, 0, 2, 2}, words.data(), 8);
    }
}

}  // namespace
