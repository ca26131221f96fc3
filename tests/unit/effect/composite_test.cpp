#include <gtest/gtest.h>

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
#include "voreleffect/VFEffect.h"

namespace {

using namespace vorel_test;
using VFontEffect::VFBitmap;
using VFontEffect::VFEffect;
using VFontEffect::VFGlyph;

/// Draws a glyph of the layers' size.
void renderWhole(VFEffect& look, std::vector<uint8_t>& coverage, int width, int height) {
    VFGlyph glyph{coverage.data(), static_cast<unsigned short>(width),
                  static_cast<unsigned short>(height)};
    look.renderEffectLayer(0, 0, &glyph);
}

/// A layered run up to the composite: the outer layer holds `outer` in all four bytes of each pixel,
/// painted there by a white shadow without blur, and the mask then holds `mask`.
void prepareLayers(VFEffect& look, std::vector<uint8_t>& outer, const std::vector<uint8_t>& mask,
                   int width, int height) {
    look.addOuterShadowText(0, 0, 0, 0xFFFFFF, 1);
    look.setTextOpacity(0.5F);
    look.initEffect(width, height);
    renderWhole(look, outer, width, height);
    look.doEffectPostProcessing();
    memcpy(look.getSrcBitmap()->mData, mask.data(), mask.size());
}

std::vector<uint8_t> inAllFourBytes(const std::vector<uint8_t>& bytes) {
    std::vector<uint8_t> pixels;
    for (const uint8_t byte : bytes)
        pixels.insert(pixels.end(), 4, byte);
    return pixels;
}

std::vector<uint8_t> randomBytes(Random& random, size_t size) {
    std::vector<uint8_t> bytes(size);
    fillMask(random, bytes.data(), size);
    return bytes;
}

TEST(Composite, MixesByTheCoverage) {
    std::vector<uint8_t> outer = {200};
    VFEffect look;
    prepareLayers(look, outer, {128}, 1, 1);
    VFBitmap picture(1, 1, 4);
    memset(picture.mData, 100, 4);
    look.compositeLayers(&picture);
    EXPECT_EQ(bytesOf(picture), std::vector<uint8_t>(4, 149));  // (201 * 127 >> 8) + (101 * 128 >> 8)
}

TEST(Composite, InsideKeepsThePictureAndOutsideTakesTheOuterLayer) {
    for (int value = 0; value < 256; ++value) {
        std::vector<uint8_t> outer(2, static_cast<uint8_t>(255 - value));
        VFEffect look;
        prepareLayers(look, outer, {255, 0}, 2, 1);
        VFBitmap picture(2, 1, 4);
        memset(picture.mData, value, 8);
        look.compositeLayers(&picture);
        for (size_t i = 0; i < 4; ++i) {
            EXPECT_EQ(picture.mData[i], value);
            EXPECT_EQ(picture.mData[4 + i], 255 - value);
        }
    }
}

/// The outer layer changes along a row, the coverage from row to row; 64 runs of four bytes a pixel
/// carry all 256 values of the picture.
TEST(Composite, AllValuesMatchTheLiteralForm) {
    constexpr int kSide = 256;
    constexpr size_t kArea = kSide * kSide;
    std::vector<uint8_t> outer(kArea);
    std::vector<uint8_t> mask(kArea);
    for (size_t i = 0; i < kArea; ++i) {
        outer[i] = static_cast<uint8_t>(i % kSide);
        mask[i] = static_cast<uint8_t>(i / kSide);
    }
    const std::vector<uint8_t> outerPixels = inAllFourBytes(outer);
    for (int run = 0; run < 64; ++run) {
        VFEffect look;
        prepareLayers(look, outer, mask, kSide, kSide);
        GuardedBitmap picture(kSide, kSide, 4);
        for (size_t i = 0; i < kArea * 4; ++i)
            picture.pixels().data()[i] = static_cast<uint8_t>(run * 4 + static_cast<int>(i % 4));
        std::vector<uint8_t> expected = bytesOf(picture.pixels());
        literal::composite(expected.data(), outerPixels.data(), mask.data(), static_cast<int>(kArea));
        look.compositeLayers(picture.bitmap());
        ASSERT_TRUE(sameBytes(expected.data(), picture.pixels().data(), kSide, kSide, 4)) << run;
    }
}

TEST(Composite, AllSizesMatchTheLiteralForm) {
    for (int seed = 0; seed < thinned(1000); ++seed) {
        Random random(static_cast<uint64_t>(seed));
        const int width = 1 + seed % 67;
        const int height = random.between(1, 5);
        SCOPED_TRACE(testing::Message() << "seed " << seed << ", " << width << " x " << height);
        const auto pixels = static_cast<size_t>(width) * static_cast<size_t>(height);
        std::vector<uint8_t> outer = randomBytes(random, pixels);
        const std::vector<uint8_t> mask = randomBytes(random, pixels);
        VFEffect look;
        prepareLayers(look, outer, mask, width, height);
        GuardedBitmap picture(width, height, 4, randomEdge(random));
        fillColour(random, picture.pixels());
        std::vector<uint8_t> expected = bytesOf(picture.pixels());
        literal::composite(expected.data(), inAllFourBytes(outer).data(), mask.data(),
                           static_cast<int>(pixels));
        look.compositeLayers(picture.bitmap());
        ASSERT_TRUE(sameBytes(expected.data(), picture.pixels().data(), width, height, 4));
    }
}

TEST(Composite, WithoutPaintTheOuterLayerErasesOutsideTheGlyph) {
    VFEffect look;
    look.setTextOpacity(0.5F);
    look.initEffect(3, 1);
    std::vector<uint8_t> coverage = {0, 128, 255};
    renderWhole(look, coverage, 3, 1);
    VFBitmap picture(3, 1, 4);
    memset(picture.mData, 201, 12);
    look.compositeLayers(&picture);
    // 1 * 127 >> 8 is 0; 202 * 128 >> 8 is 101.
    const std::vector<uint8_t> expected = {0, 0, 0, 0, 101, 101, 101, 101, 201, 201, 201, 201};
    EXPECT_EQ(bytesOf(picture), expected);
}

TEST(Composite, OutsideLayeredModeThePictureIsUntouched) {
    VFEffect look;
    look.initEffect(3, 1);
    std::vector<uint8_t> coverage = {0, 128, 255};
    renderWhole(look, coverage, 3, 1);
    VFBitmap picture(3, 1, 4);
    memset(picture.mData, 201, 12);
    look.compositeLayers(&picture);
    EXPECT_EQ(bytesOf(picture), std::vector<uint8_t>(12, 201));
    EXPECT_EQ(look.getSrcBitmap(), nullptr);
}

TEST(Composite, EndsTheRunInEveryMode) {
    for (const float opacity : {0.5F, 1.0F}) {
        VFEffect look;
        look.setTextOpacity(opacity);
        look.initEffect(3, 1);
        VFBitmap picture(3, 1, 4);
        look.setDstBitmap(&picture);
        ASSERT_NE(look.getSrcBitmap(), nullptr);
        look.compositeLayers(&picture);
        EXPECT_EQ(look.getSrcBitmap(), nullptr) << opacity;
        EXPECT_EQ(look.getDstBitmap(), nullptr) << opacity;

        memset(picture.mData, 201, 12);
        look.compositeLayers(&picture);  // no run is open: nothing to merge
        EXPECT_EQ(bytesOf(picture), std::vector<uint8_t>(12, 201)) << opacity;
    }
}

TEST(Composite, RefusedPicturesStayAsTheyAreAndTheRunEnds) {
    const Numbers refused[] = {{2, 1, 4}, {4, 1, 4}, {3, 2, 4}, {1, 3, 4},        {0, 0, 4},
                               {3, 1, 1}, {3, 1, 3}, {3, 1, 5}, {65536, 65536, 4}};
    for (const Numbers& numbers : refused) {
        SCOPED_TRACE(testing::Message()
                     << numbers.width << " x " << numbers.height << " x " << numbers.bytesPerPixel);
        VFEffect look;
        look.setTextOpacity(0.5F);
        look.initEffect(3, 1);
        GuardedBitmap picture(5, 5, 5);
        memset(picture.pixels().data(), 201, picture.pixels().size());
        claim(picture.bitmap(), numbers);
        look.compositeLayers(picture.bitmap());
        EXPECT_EQ(bytesOf(picture.pixels()), std::vector<uint8_t>(125, 201));
        EXPECT_EQ(look.getSrcBitmap(), nullptr);
    }
    VFEffect look;
    look.setTextOpacity(0.5F);
    look.initEffect(3, 1);
    look.compositeLayers(nullptr);
    EXPECT_EQ(look.getSrcBitmap(), nullptr);
}

}  // namespace
