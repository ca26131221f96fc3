#include "spread_colours.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <string>

namespace vorelpaint {
namespace {

using voreltext::Image;

/// A picture whose letters are opaque pixels of that value in each channel; '.' is a clear black one.
Image drawn(const std::string& letters, int width) {
    Image image = voreltext::transparentImage(width, static_cast<int>(letters.size()) / width);
    for (size_t i = 0; i < letters.size(); ++i) {
        if (letters[i] == '.') continue;
        for (size_t c = 0; c < 4; ++c)
            image.pixels[4 * i + c] = static_cast<uint8_t>(letters[i]);
    }
    return image;
}

/// The letters that the pixels have their colours from.
std::string coloursOf(const Image& image) {
    std::string letters;
    for (size_t i = 0; i < image.pixels.size(); i += 4)
        letters += image.pixels[i] == 0 ? '.' : static_cast<char>(image.pixels[i]);
    return letters;
}

TEST(SpreadColours, ClearPixels_TakeThoseThatAreNearest) {
    Image image = drawn(
        "........."
        "..a...b.."
        "........."
        ".........",
        9);
    spreadColours(image, 2);
    EXPECT_EQ(coloursOf(image),
              ".aaa.bbb."
              "aaaaabbbb"
              ".aaa.bbb."
              "..a...b..");
}

TEST(SpreadColours, Alphas_StayWhatTheyAre) {
    Image image = drawn("a..b", 4);
    image.pixels[3] = 1;
    spreadColours(image, 4);
    EXPECT_EQ(coloursOf(image), "aabb");
    EXPECT_EQ(image.pixels[3], 1);
    EXPECT_EQ(image.pixels[7], 0);
    EXPECT_EQ(image.pixels[11], 0);
    EXPECT_EQ(image.pixels[15], 'b');
}

TEST(SpreadColours, APictureWithoutAnything_StaysSo) {
    Image image = drawn("......", 3);
    spreadColours(image, 254);
    EXPECT_EQ(coloursOf(image), "......");
}

}  // namespace
}  // namespace vorelpaint
