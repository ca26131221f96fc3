#include "text/colour_layers.h"

#include <gtest/gtest.h>

namespace voreltext {
namespace {

GlyphMask emptyPicture(const Box& box) {
    GlyphMask picture;
    picture.box = box;
    const auto area = static_cast<size_t>(box.width() * box.height());
    picture.coverage.resize(area);
    picture.pixels.resize(area * 4);
    return picture;
}

TEST(ColourLayers, FirstLayer_IsItsColourByItsCoverage) {
    GlyphMask picture = emptyPicture({0, 0, 2, 1});
    layOn(picture, {{0, 0, 2, 1}, {255, 51}}, {200, 100, 0, 255});
    // A fifth of 200 and of 100.
    EXPECT_EQ(picture.pixels, (std::vector<uint8_t>{200, 100, 0, 255, 40, 20, 0, 51}));
    EXPECT_EQ(picture.coverage, (std::vector<uint8_t>{255, 51}));
}

TEST(ColourLayers, NextLayer_LiesOnTop) {
    GlyphMask picture = emptyPicture({0, 0, 3, 1});
    layOn(picture, {{0, 0, 3, 1}, {255, 255, 102}}, {255, 0, 0, 255});
    layOn(picture, {{0, 0, 3, 1}, {255, 51, 0}}, {0, 0, 255, 255});
    EXPECT_EQ(picture.pixels, (std::vector<uint8_t>{0, 0, 255, 255, 204, 0, 51, 255, 102, 0, 0, 102}));
}

TEST(ColourLayers, AlphaOfTheColour_ThinsTheCoverage) {
    GlyphMask picture = emptyPicture({0, 0, 1, 1});
    layOn(picture, {{0, 0, 1, 1}, {255}}, {255, 255, 255, 51});
    EXPECT_EQ(picture.pixels, (std::vector<uint8_t>{51, 51, 51, 51}));
    layOn(picture, {{0, 0, 1, 1}, {51}}, {0, 0, 0, 51});
    // A twenty-fifth of black, 10.2, over 24 of 25 of the 51.
    EXPECT_EQ(picture.pixels, (std::vector<uint8_t>{49, 49, 49, 59}));
}

TEST(ColourLayers, SmallerLayer_StandsAtItsPlace) {
    GlyphMask picture = emptyPicture({-2, -3, 0, 0});
    layOn(picture, {{-1, -2, 0, -1}, {255}}, {9, 9, 9, 255});
    EXPECT_EQ(picture.coverage, (std::vector<uint8_t>{0, 0, 0, 255, 0, 0}));
    EXPECT_EQ(picture.pixels[3 * 4], 9);
}

TEST(ColourLayers, AnyLayers_StayPremultiplied) {
    for (unsigned int one = 0; one < 256; ++one) {
        for (unsigned int other = 0; other < 256; ++other) {
            GlyphMask picture = emptyPicture({0, 0, 1, 1});
            layOn(picture, {{0, 0, 1, 1}, {static_cast<uint8_t>(one)}}, {255, 254, 1, 255});
            layOn(picture, {{0, 0, 1, 1}, {static_cast<uint8_t>(other)}}, {255, 0, 128, 255});
            ASSERT_EQ(picture.pixels[0], picture.pixels[3]) << "full red stays full";
            ASSERT_LE(picture.pixels[1], picture.pixels[3]);
            ASSERT_LE(picture.pixels[2], picture.pixels[3]);
        }
    }
}

}  // namespace
}  // namespace voreltext
