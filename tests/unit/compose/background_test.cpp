#include "compose/background.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cmath>

namespace vorelcompose {
namespace {

using Pixel = std::vector<uint8_t>;

Pixel laid(const Pixel& pixel, const char* background) {
    voreltext::Image image{1, 1, pixel};
    layOn(image, parseBackground(background).value());
    return image.pixels;
}

TEST(Background, Transparent_DividesTheAlphaOut) {
    EXPECT_EQ(laid({64, 128, 0, 128}, "transparent"), (Pixel{128, 255, 0, 128}));
    EXPECT_EQ(laid({10, 20, 30, 255}, "transparent"), (Pixel{10, 20, 30, 255}));
    EXPECT_EQ(laid({0, 0, 0, 0}, "transparent"), (Pixel{0, 0, 0, 0}));
}

TEST(Background, ChannelAboveItsAlpha_StaysWithinAByte) {
    EXPECT_EQ(laid({9, 0, 0, 8}, "transparent"), (Pixel{255, 0, 0, 8}));
}

TEST(Background, Colour_ShowsThroughByTheRest) {
    EXPECT_EQ(laid({0, 0, 0, 0}, "#102030"), (Pixel{0x10, 0x20, 0x30, 255}));
    EXPECT_EQ(laid({1, 2, 3, 255}, "#102030"), (Pixel{1, 2, 3, 255}));
    EXPECT_EQ(laid({51, 0, 0, 51}, "#FFFFFF"), (Pixel{255, 204, 204, 255}));
}

TEST(Background, Checkerboard_ChangesEveryEightPixels) {
    voreltext::Image image{9, 9, Pixel(9 * 9 * 4, 0)};
    layOn(image, parseBackground("checkerboard").value());
    const auto redAt = [&](int x, int y) { return image.pixels[static_cast<size_t>((y * 9 + x) * 4)]; };
    EXPECT_EQ(redAt(7, 7), redAt(0, 0));
    EXPECT_NE(redAt(8, 0), redAt(0, 0));
    EXPECT_NE(redAt(0, 8), redAt(0, 0));
    EXPECT_EQ(redAt(8, 8), redAt(0, 0));
}

/// All channels with all alphas, a row for each alpha.
voreltext::Image everyPair() {
    voreltext::Image image{256, 256, {}};
    for (int alpha = 0; alpha < 256; ++alpha) {
        for (int channel = 0; channel < 256; ++channel) {
            for (const int value : {channel, 255 - channel, channel ^ 85, alpha})
                image.pixels.push_back(static_cast<uint8_t>(value));
        }
    }
    return image;
}

uint8_t roundedByte(double value) {
    return static_cast<uint8_t>(std::min(255.0, std::floor(value + 0.5)));
}

TEST(Background, Transparent_EveryPairIsRoundedToNearest) {
    const voreltext::Image before = everyPair();
    voreltext::Image image = before;
    layOn(image, parseBackground("transparent").value());
    for (size_t i = 0; i < image.pixels.size(); ++i) {
        const uint8_t alpha = before.pixels[i | 3];
        const uint8_t straight = alpha == 0 ? uint8_t{0} : roundedByte(before.pixels[i] * 255.0 / alpha);
        ASSERT_EQ(image.pixels[i], i % 4 == 3 ? alpha : straight) << "byte " << i;
    }
}

TEST(Background, Colour_EveryPairIsRoundedToNearest) {
    const std::array<int, 3> colour{0x01, 0x7F, 0xFE};
    const voreltext::Image before = everyPair();
    voreltext::Image image = before;
    layOn(image, parseBackground("#017FFE").value());
    for (size_t i = 0; i < image.pixels.size(); ++i) {
        if (i % 4 == 3) {
            ASSERT_EQ(image.pixels[i], 255);
            continue;
        }
        const uint8_t beneath = roundedByte(colour[i % 4] * (255 - before.pixels[i | 3]) / 255.0);
        ASSERT_EQ(image.pixels[i], std::min(255, before.pixels[i] + beneath)) << "byte " << i;
    }
}

TEST(Background, Checkerboard_IsOfTwoColoursBeneath) {
    const voreltext::Image before = everyPair();
    voreltext::Image image = before;
    layOn(image, parseBackground("checkerboard").value());
    voreltext::Image light = before;
    layOn(light, parseBackground("#FFFFFF").value());
    voreltext::Image dark = before;
    layOn(dark, parseBackground("#CCCCCC").value());
    for (size_t pixel = 0; pixel < 256 * 256; ++pixel) {
        const bool isLight = (pixel % 256 / 8 + pixel / 256 / 8) % 2 == 0;
        const voreltext::Image& wanted = isLight ? light : dark;
        for (size_t i = 4 * pixel; i < 4 * pixel + 4; ++i)
            ASSERT_EQ(image.pixels[i], wanted.pixels[i]) << "pixel " << pixel;
    }
}

TEST(Background, ClearPixels_AreOfOneValue) {
    EXPECT_EQ(laid({9, 8, 7, 0}, "transparent"), (Pixel{0, 0, 0, 0}));
}

TEST(Background, Rows_AloneAreTouched) {
    voreltext::Image image{1, 4, Pixel(16, 0)};
    layOn(image, parseBackground("#102030").value(), 1, 3);
    EXPECT_EQ(image.pixels,
              (Pixel{0, 0, 0, 0, 0x10, 0x20, 0x30, 255, 0x10, 0x20, 0x30, 255, 0, 0, 0, 0}));
    voreltext::Image board{1, 9, Pixel(36, 0)};
    layOn(board, parseBackground("checkerboard").value(), 8, 9);
    EXPECT_EQ(board.pixels[8 * 4], 0xCC) << "squares are counted from the top of the picture";
}

TEST(Background, OtherWords_AreRefused) {
    for (const char* text : {"", "white", "#FF", "Transparent"}) {
        EXPECT_FALSE(parseBackground(text)) << text;
    }
}

}  // namespace
}  // namespace vorelcompose
