#include "text/overlay.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <random>
#include <vector>

#include "text/error.h"

namespace voreltext {
namespace {

Image randomImage(std::mt19937& random, int width, int height) {
    Image image{width, height, {}};
    for (int i = 0; i < width * height; ++i) {
        const auto alpha = static_cast<unsigned int>(random() % 256);
        for (int c = 0; c < 3; ++c)
            image.pixels.push_back(static_cast<uint8_t>(random() % (alpha + 1)));
        image.pixels.push_back(static_cast<uint8_t>(alpha));
    }
    return image;
}

uint8_t over(uint8_t source, uint8_t destination, uint8_t alpha) {
    return static_cast<uint8_t>(
        std::min(255L, source + std::lround(destination * (255 - alpha) / 255.0)));
}

/// Pixel by pixel, in real numbers.
void layOverLiterally(Image& destination, const Image& source, int x, int y) {
    for (int row = 0; row < destination.height; ++row) {
        for (int column = 0; column < destination.width; ++column) {
            const int fromX = column - x;
            const int fromY = row - y;
            if (fromX < 0 || fromY < 0 || fromX >= source.width || fromY >= source.height) continue;
            uint8_t* to =
                &destination.pixels[static_cast<size_t>((row * destination.width + column) * 4)];
            const uint8_t* from =
                &source.pixels[static_cast<size_t>((fromY * source.width + fromX) * 4)];
            for (int c = 0; c < 4; ++c)
                to[c] = over(from[c], to[c], from[3]);
        }
    }
}

TEST(LayOver, EveryPairOfAlphaAndChannel_IsRoundedToNearest) {
    for (int alpha = 0; alpha < 256; ++alpha) {
        for (int below = 0; below < 256; ++below) {
            const auto channel = static_cast<uint8_t>(below);
            Image image{1, 1, {channel, 0, 255, channel}};
            layOver(image, {1, 1, {0, 0, 0, static_cast<uint8_t>(alpha)}}, 0, 0);
            ASSERT_EQ(image.pixels[0], over(0, channel, static_cast<uint8_t>(alpha)));
            ASSERT_EQ(image.pixels[2], 255 - alpha);
        }
    }
}

TEST(LayOver, ChannelsBeyondTheirAlpha_StayWithinAByte) {
    Image image{1, 1, {200, 200, 200, 200}};
    layOver(image, {1, 1, {255, 100, 0, 10}}, 0, 0);
    EXPECT_EQ(image.pixels[0], 255);
    EXPECT_EQ(image.pixels[2], 192);  // 200 * 245 / 255 = 192.2
}

TEST(LayOver, AnyPlace_IsTheLiteralForm) {
    std::mt19937 random(20262);
    for (int round = 0; round < 3000; ++round) {
        const auto side = [&] { return static_cast<int>(random() % 12); };
        Image image = randomImage(random, side(), side());
        const Image source = randomImage(random, side(), side());
        const int x = static_cast<int>(random() % 30) - 15;
        const int y = static_cast<int>(random() % 30) - 15;
        Image wanted = image;
        layOverLiterally(wanted, source, x, y);
        layOver(image, source, x, y);
        ASSERT_EQ(image.pixels, wanted.pixels) << "round " << round;
    }
}

TEST(TransparentImage, OfAnySizeButTooLarge_IsMade) {
    EXPECT_EQ(transparentImage(3, 2).pixels, std::vector<uint8_t>(24));
    EXPECT_TRUE(transparentImage(0, 5).pixels.empty());
    EXPECT_THROW(transparentImage(-1, 1), TextError);
    EXPECT_THROW(transparentImage(1, 16385), TextError);
    EXPECT_THROW(transparentImage(16384, 2049), TextError);
}

TEST(LayOver, FarAway_ChangesNothing) {
    constexpr int kMost = std::numeric_limits<int>::max();
    constexpr int kLeast = std::numeric_limits<int>::min();
    std::mt19937 random(1);
    const Image source = randomImage(random, 5, 5);
    const Image before = randomImage(random, 7, 7);
    for (const int x : {kLeast, -5, 7, kMost}) {
        for (const int y : {kLeast, -5, 0, 7, kMost}) {
            Image image = before;
            layOver(image, source, x, y);
            layOver(image, source, y, x);
            EXPECT_EQ(image.pixels, before.pixels) << x << ' ' << y;
        }
    }
}

TEST(Fade, MultipliesEveryChannel) {
    Image image{1, 1, {255, 101, 1, 200}};
    fade(image, 0.5F);  // of 255ths: 128
    EXPECT_EQ(image.pixels, (std::vector<uint8_t>{128, 51, 1, 100}));
    fade(image, 1);
    EXPECT_EQ(image.pixels, (std::vector<uint8_t>{128, 51, 1, 100}));
    fade(image, std::numeric_limits<float>::quiet_NaN());
    EXPECT_EQ(image.pixels, std::vector<uint8_t>(4));
}

}  // namespace
}  // namespace voreltext
