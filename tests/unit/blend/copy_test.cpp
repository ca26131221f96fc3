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

constexpr int kSweepCases = 6000;
constexpr int kByteSizes[] = {1, 4};

std::vector<uint8_t> ramp(int size) {
    std::vector<uint8_t> bytes(static_cast<size_t>(size));
    for (int i = 0; i < size; ++i)
        bytes[static_cast<size_t>(i)] = static_cast<uint8_t>(10 + i);
    return bytes;
}

/// The literal form of drawBitmap for a destination of 1 or 4 bytes per pixel.
void drawLiteral(const Placement& p, int bytesPerPixel, uint8_t* dst, const uint8_t* mask,
                 uint32_t color) {
    if (bytesPerPixel == 4) {
        literal::drawBitmap8To32(p.x, p.y, dst, p.dstWidth, p.dstHeight, mask, p.width, p.height, color);
    } else {
        literal::drawBitmap8To8(p.x, p.y, dst, p.dstWidth, p.dstHeight, mask, p.width, p.height);
    }
}

TEST(MaskCopy, NegativeXSkipsMaskColumns) {
    VFBitmap dst(12, 1, 1);
    std::vector<uint8_t> mask = ramp(10);
    VFBlender().drawBitmap8To8(-3, 0, &dst, mask.data(), 10, 1);
    const std::vector<uint8_t> expected = {13, 14, 15, 16, 17, 18, 19, 0, 0, 0, 0, 0};
    EXPECT_EQ(bytesOf(dst), expected);
}

TEST(MaskCopy, KeepsTheLargerCoverage) {
    VFBitmap dst(4, 1, 1);
    const uint8_t before[] = {0, 100, 200, 255};
    memcpy(dst.mData, before, sizeof before);
    uint8_t mask[] = {1, 100, 150, 0};
    VFBlender().drawBitmap8To8(0, 0, &dst, mask, 4, 1);
    const std::vector<uint8_t> expected = {1, 100, 200, 255};
    EXPECT_EQ(bytesOf(dst), expected);
}

TEST(MaskCopy, WhollyOutsideWritesNothing) {
    for (const int bytesPerPixel : kByteSizes) {
        GuardedBitmap dst(8, 4, bytesPerPixel);
        std::vector<uint8_t> mask(6, 255);
        const std::vector<uint8_t> before = bytesOf(dst.pixels());
        VFBlender blender;
        blender.drawBitmap(8, 0, dst.bitmap(), mask.data(), 3, 2, 0xFFFFFFFF);
        blender.drawBitmap(0, 4, dst.bitmap(), mask.data(), 3, 2, 0xFFFFFFFF);
        blender.drawBitmap(-3, 0, dst.bitmap(), mask.data(), 3, 2, 0xFFFFFFFF);
        blender.drawBitmap(0, -2, dst.bitmap(), mask.data(), 3, 2, 0xFFFFFFFF);
        EXPECT_EQ(bytesOf(dst.pixels()), before);
    }
}

TEST(MaskCopy, MaskOverItselfChangesNothing) {
    Random random(1);
    for (int width = 1; width <= 67; ++width) {
        GuardedBitmap mask(width, 3, 1);
        fillMask(random, mask.pixels().data(), mask.pixels().size());
        const std::vector<uint8_t> before = bytesOf(mask.pixels());
        VFBlender().drawBitmap8To8(0, 0, mask.bitmap(), mask.pixels().data(), width, 3);
        EXPECT_EQ(bytesOf(mask.pixels()), before) << width;
    }
}

TEST(ColourCopy, FirstRunFromTheOriginHoldsChannelsThenCoverage) {
    VFBitmap dst(3, 1, 4);
    uint8_t mask[] = {0, 128, 255};
    VFBlender().drawBitmap8To32(0, 0, &dst, mask, 3, 1, 0xFF102030);
    const std::vector<uint8_t> expected = {0x10, 0x20, 0x30, 0,    0x10, 0x20,
                                           0x30, 128,  0x10, 0x20, 0x30, 255};
    EXPECT_EQ(bytesOf(dst), expected);
}

TEST(ColourCopy, AlphaOfTheColourScalesTheCoverage) {
    VFBitmap dst(3, 1, 4);
    uint8_t mask[] = {1, 200, 255};
    VFBlender().drawBitmap8To32(0, 0, &dst, mask, 3, 1, 0x00FFFFFF);
    EXPECT_EQ(dst.mData[3], 0);
    EXPECT_EQ(dst.mData[7], 0);
    EXPECT_EQ(dst.mData[11], 0);
    VFBlender().drawBitmap8To32(0, 0, &dst, mask, 3, 1, 0x80FFFFFF);
    EXPECT_EQ(dst.mData[3], 0);     // 1 * 129 / 256
    EXPECT_EQ(dst.mData[7], 100);   // 200 * 129 / 256
    EXPECT_EQ(dst.mData[11], 128);  // 255 * 129 / 256
}

TEST(ColourCopy, RunStartsAtAByteOffsetNotAPixelOffset) {
    VFBitmap dst(4, 3, 4);
    uint8_t mask[] = {7, 9};
    VFBlender().drawBitmap8To32(1, 2, &dst, mask, 2, 1, 0xFFAABBCC);
    std::vector<uint8_t> expected(48, 0);
    const uint8_t run[] = {0xAA, 0xBB, 0xCC, 7, 0xAA, 0xBB, 0xCC, 9};
    memcpy(expected.data() + 4 * 2 + 1, run, sizeof run);
    EXPECT_EQ(bytesOf(dst), expected);
}

TEST(ColourCopy, LaterRowsOverlapEarlierOnes) {
    VFBitmap dst(2, 2, 4);
    uint8_t mask[] = {1, 2, 3, 4};
    VFBlender().drawBitmap8To32(0, 0, &dst, mask, 2, 2, 0xFFAABBCC);
    const std::vector<uint8_t> expected = {0xAA, 0xBB, 0xAA, 0xBB, 0xCC, 3, 0xAA, 0xBB,
                                           0xCC, 4,    0,    0,    0,    0, 0,    0};
    EXPECT_EQ(bytesOf(dst), expected);
}

TEST(ColourCopy, LastRowStaysInsideTheBuffer) {
    GuardedBitmap dst(5, 1, 4);
    std::vector<uint8_t> mask(5, 255);
    VFBlender().drawBitmap8To32(0, 0, dst.bitmap(), mask.data(), 5, 1, 0xFF000000);
    for (size_t i = 0; i < 5; ++i)
        EXPECT_EQ(dst.pixels().data()[i * 4 + 3], 255) << i;
}

TEST(DrawBitmap, ChoosesTheKernelByBytesPerPixel) {
    for (const int bytesPerPixel : kByteSizes) {
        GuardedBitmap viaDraw(9, 3, bytesPerPixel);
        GuardedBitmap direct(9, 3, bytesPerPixel);
        std::vector<uint8_t> mask = ramp(12);
        VFBlender blender;
        blender.drawBitmap(2, 0, viaDraw.bitmap(), mask.data(), 6, 2, 0x80FF7F01);
        if (bytesPerPixel == 4)
            blender.drawBitmap8To32(2, 0, direct.bitmap(), mask.data(), 6, 2, 0x80FF7F01);
        else
            blender.drawBitmap8To8(2, 0, direct.bitmap(), mask.data(), 6, 2);
        EXPECT_EQ(bytesOf(viaDraw.pixels()), bytesOf(direct.pixels()));
        EXPECT_NE(bytesOf(viaDraw.pixels()), std::vector<uint8_t>(viaDraw.pixels().size(), 0));
    }
}

TEST(DrawBitmap, BitmapSourceGivesItsPixelsAndSize) {
    Random random(3);
    for (const int bytesPerPixel : kByteSizes) {
        GuardedBitmap dst(9, 3, bytesPerPixel);
        GuardedBitmap source(6, 2, 1);
        fillMask(random, source.pixels().data(), source.pixels().size());
        std::vector<uint8_t> expected = bytesOf(dst.pixels());
        drawLiteral(Placement{9, 3, -1, 1, 6, 2}, bytesPerPixel, expected.data(), source.pixels().data(),
                    0x80FF7F01);
        VFBlender().drawBitmap(-1, 1, dst.bitmap(), source.bitmap(), 0x80FF7F01);
        EXPECT_TRUE(sameBytes(expected.data(), dst.pixels().data(), 9, 3, bytesPerPixel));
    }
}

TEST(CopySweep, MatchesTheLiteralForm) {
    for (const int bytesPerPixel : kByteSizes) {
        for (int seed = 0; seed < thinned(kSweepCases); ++seed) {
            Random random(static_cast<uint64_t>(seed));
            const Placement p = randomPlacement(random);
            SCOPED_TRACE(testing::Message()
                         << "seed " << seed << ", " << bytesPerPixel << " bytes per pixel, " << p);

            GuardedBitmap dst(p.dstWidth, p.dstHeight, bytesPerPixel, randomEdge(random));
            fillMask(random, dst.pixels().data(), dst.pixels().size());
            GuardedBuffer mask(sourceBytes(p.height, p.width, p.width), randomEdge(random));
            fillMask(random, mask.data(), mask.size());
            const uint32_t color = randomColor(random);

            std::vector<uint8_t> expected = bytesOf(dst.pixels());
            drawLiteral(p, bytesPerPixel, expected.data(), mask.data(), color);
            VFBlender().drawBitmap(p.x, p.y, dst.bitmap(), mask.data(), p.width, p.height, color);
            ASSERT_TRUE(
                sameBytes(expected.data(), dst.pixels().data(), p.dstWidth, p.dstHeight, bytesPerPixel));
        }
    }
}

TEST(CopyLimits, PlacementsAtTheEndsOfAnIntMatchTheLiteralForm) {
    std::vector<Placement> placements = extremePlacements({INT_MIN, -1, 0, 1, 8});
    for (const int x : {INT_MIN, -1, 0, 1, INT_MAX})
        for (const int y : {-1, 0, 1})
            placements.push_back(Placement{8, 3, x, y, INT_MAX, 1});
    GuardedBuffer mask(9 * 4);
    Random random(4);
    fillMask(random, mask.data(), mask.size());
    for (const int bytesPerPixel : kByteSizes) {
        for (const Placement& p : placements) {
            SCOPED_TRACE(testing::Message() << bytesPerPixel << " bytes per pixel, " << p);
            GuardedBitmap dst(p.dstWidth, p.dstHeight, bytesPerPixel);
            std::vector<uint8_t> expected = bytesOf(dst.pixels());
            drawLiteral(p, bytesPerPixel, expected.data(), mask.data(), 0xFF00FF7F);
            VFBlender().drawBitmap(p.x, p.y, dst.bitmap(), mask.data(), p.width, p.height, 0xFF00FF7F);
            ASSERT_TRUE(
                sameBytes(expected.data(), dst.pixels().data(), p.dstWidth, p.dstHeight, bytesPerPixel));
        }
    }
}

TEST(CopyLimits, NullArgumentsDrawNothing) {
    VFBlender blender;
    uint8_t mask[] = {255, 255, 255, 255};
    blender.drawBitmap(0, 0, nullptr, mask, 2, 2, 0xFFFFFFFF);
    blender.drawBitmap8To8(0, 0, nullptr, mask, 2, 2);
    blender.drawBitmap8To32(0, 0, nullptr, mask, 2, 2, 0xFFFFFFFF);
    VFBitmap source(2, 2, mask, 1);
    blender.drawBitmap(0, 0, nullptr, &source, 0xFFFFFFFF);

    for (const int bytesPerPixel : kByteSizes) {
        GuardedBitmap dst(3, 3, bytesPerPixel);
        const std::vector<uint8_t> before = bytesOf(dst.pixels());
        VFBitmap withoutPixels;
        VFBitmap* const noBitmap = nullptr;
        unsigned char* const noMask = nullptr;
        blender.drawBitmap(0, 0, dst.bitmap(), noBitmap, 0xFFFFFFFF);
        blender.drawBitmap(0, 0, dst.bitmap(), &withoutPixels, 0xFFFFFFFF);
        blender.drawBitmap(0, 0, dst.bitmap(), noMask, 2, 2, 0xFFFFFFFF);
        blender.drawBitmap8To8(0, 0, dst.bitmap(), noMask, 2, 2);
        blender.drawBitmap8To32(0, 0, dst.bitmap(), noMask, 2, 2, 0xFFFFFFFF);
        EXPECT_EQ(bytesOf(dst.pixels()), before);

        withoutPixels.mWidth = 2;
        withoutPixels.mHeight = 2;
        withoutPixels.mBytesPerPixel = static_cast<unsigned>(bytesPerPixel);
        blender.drawBitmap(0, 0, &withoutPixels, mask, 2, 2, 0xFFFFFFFF);
        blender.drawBitmap(0, 0, dst.bitmap(), &withoutPixels, 0xFFFFFFFF);
        EXPECT_EQ(bytesOf(dst.pixels()), before);
        EXPECT_EQ(withoutPixels.mData, nullptr);
    }
}

TEST(CopyLimits, OtherBytesPerPixelAreNotColour) {
    uint8_t mask[] = {255, 255, 255, 255};
    for (const unsigned bytesPerPixel : {0U, 1U, 2U, 3U, 5U, 0xFFFFFFFFU}) {
        GuardedBitmap dst(4, 4, 5);
        dst.bitmap()->mBytesPerPixel = bytesPerPixel;
        const std::vector<uint8_t> before = bytesOf(dst.pixels());
        VFBlender().drawBitmap8To32(0, 0, dst.bitmap(), mask, 2, 2, 0xFFFFFFFF);
        EXPECT_EQ(bytesOf(dst.pixels()), before) << bytesPerPixel;
    }
}

TEST(CopyLimits, AllButFourBytesPerPixelTakeCoverage) {
    uint8_t mask[] = {10, 20, 30, 40};
    for (const int bytesPerPixel : {1, 2, 3, 5}) {
        GuardedBitmap dst(4, 2, bytesPerPixel);
        std::fill(dst.pixels().begin(), dst.pixels().end(), uint8_t{15});
        // Rows of the destination are as many bytes apart as it has columns.
        std::vector<uint8_t> expected = bytesOf(dst.pixels());
        expected[1] = 20;
        expected[4] = 30;
        expected[5] = 40;
        VFBlender().drawBitmap(0, 0, dst.bitmap(), mask, 2, 2, 0xFFFFFFFF);
        EXPECT_EQ(bytesOf(dst.pixels()), expected) << bytesPerPixel;
    }
}

TEST(CopyLimits, CoverageIsMergedIntoColourTooWhenAskedFor) {
    uint8_t mask[] = {10, 20, 30, 40};
    GuardedBitmap dst(2, 2, 4);
    std::fill(dst.pixels().begin(), dst.pixels().end(), uint8_t{15});
    VFBlender().drawBitmap8To8(0, 0, dst.bitmap(), mask, 2, 2);
    std::vector<uint8_t> expected(16, 15);
    std::copy_n(std::begin({15, 20, 30, 40}), 4, expected.begin());
    EXPECT_EQ(bytesOf(dst.pixels()), expected);
}

TEST(CopyLimits, MaskOfWidePixelsGivesItsFirstBytes) {
    uint8_t bytes[] = {1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12};
    VFBitmap source(2, 2, bytes, 3);
    GuardedBitmap dst(2, 2, 1);
    VFBlender().drawBitmap(0, 0, dst.bitmap(), &source, 0);
    EXPECT_EQ(bytesOf(dst.pixels()), (std::vector<uint8_t>{1, 2, 3, 4}));
}

TEST(CopyLimits, PixelsOfNoBytesOrTooManyAreNotTouched) {
    uint8_t mask[] = {255, 255, 255, 255};
    for (const unsigned bytesPerPixel : {0U, 0x10000000U, 0xFFFFFFFFU}) {
        GuardedBitmap dst(4, 4, 1);
        const std::vector<uint8_t> before = bytesOf(dst.pixels());
        dst.bitmap()->mBytesPerPixel = bytesPerPixel;
        VFBlender().drawBitmap(0, 0, dst.bitmap(), mask, 2, 2, 0xFFFFFFFF);
        VFBlender().drawBitmap8To8(0, 0, dst.bitmap(), mask, 2, 2);
        EXPECT_EQ(bytesOf(dst.pixels()), before) << bytesPerPixel;
    }
}

TEST(CopyLimits, ByteCountsBeyondThirtyTwoBitsAreNotTouched) {
    VFBlender blender;
    std::vector<uint8_t> mask(64, 255);
    for (const int bytesPerPixel : kByteSizes) {
        for (const Numbers& numbers : wrappingNumbers(static_cast<unsigned>(bytesPerPixel))) {
            SCOPED_TRACE(testing::Message()
                         << numbers.width << " x " << numbers.height << " x " << numbers.bytesPerPixel);
            GuardedBitmap dst(4, 4, bytesPerPixel);
            const std::vector<uint8_t> before = bytesOf(dst.pixels());
            claim(dst.bitmap(), numbers);
            blender.drawBitmap(0, 0, dst.bitmap(), mask.data(), 32, 2, 0xFFFFFFFF);
            blender.drawBitmap(1000, 1000, dst.bitmap(), mask.data(), 32, 2, 0xFFFFFFFF);
            EXPECT_EQ(bytesOf(dst.pixels()), before);
        }
    }
    VFBitmap wrapped(65536, 65536, 1);  // really allocates no bytes at all
    blender.drawBitmap(0, 0, &wrapped, mask.data(), 32, 2, 0xFFFFFFFF);
    blender.drawBitmap(65535, 65535, &wrapped, mask.data(), 32, 2, 0xFFFFFFFF);
    EXPECT_EQ(wrapped.mWidth, 65536U);
}

TEST(CopyLimits, SourceWithAByteCountBeyondThirtyTwoBitsIsNotRead) {
    for (const int bytesPerPixel : kByteSizes) {
        for (const Numbers& numbers : wrappingNumbers(1)) {
            GuardedBitmap dst(6, 4, bytesPerPixel);
            GuardedBitmap source(4, 4, 1);
            memset(source.pixels().data(), 255, source.pixels().size());
            claim(source.bitmap(), numbers);
            const std::vector<uint8_t> before = bytesOf(dst.pixels());
            VFBlender().drawBitmap(0, 0, dst.bitmap(), source.bitmap(), 0xFFFFFFFF);
            EXPECT_EQ(bytesOf(dst.pixels()), before) << numbers.width << " x " << numbers.height;
        }
    }
}

TEST(CopyLimits, DestinationWithoutAreaIsNotTouched) {
    uint8_t mask[] = {255, 255, 255, 255};
    for (const int bytesPerPixel : kByteSizes) {
        GuardedBitmap dst(4, 4, bytesPerPixel);
        const std::vector<uint8_t> before = bytesOf(dst.pixels());
        const auto bytes = static_cast<unsigned>(bytesPerPixel);
        for (const Numbers& numbers :
             {Numbers{0, 4, bytes}, Numbers{4, 0, bytes}, Numbers{0, 0, bytes}}) {
            claim(dst.bitmap(), numbers);
            VFBlender().drawBitmap(0, 0, dst.bitmap(), mask, 2, 2, 0xFFFFFFFF);
            EXPECT_EQ(bytesOf(dst.pixels()), before);
        }
    }
}

}  // namespace
