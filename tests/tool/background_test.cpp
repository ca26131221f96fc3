#include "background.h"

#include <gtest/gtest.h>

namespace vorelpaint {
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
}  // namespace vorelpaint
