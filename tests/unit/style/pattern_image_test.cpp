#include "style/pattern_image.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace vorelstyle {
namespace {

PatternImage pictureOfWidth(int width) {
    return {width, 1, std::vector<uint8_t>(static_cast<size_t>(width) * 4)};
}

Pattern patternOfWidth(float width) {
    Pattern pattern{"a.png", 1, 1, {}};
    pattern.width = Length{width};
    return pattern;
}

/// The notes of a pattern of this width over so many columns.
std::vector<std::string> notesOf(float width, int columns) {
    std::vector<std::string> notes;
    patternScale(patternOfWidth(width), pictureOfWidth(columns),
                 [&](const std::string& line) { notes.push_back(line); });
    return notes;
}

float scaleOf(float width, int columns) {
    return patternScale(patternOfWidth(width), pictureOfWidth(columns), [](const std::string&) {});
}

TEST(PatternImage, Pixels_AreTurnedToAlphaFirst) {
    const auto load = [](const std::string&) { return PatternImage{1, 1, {10, 20, 30, 40}}; };
    EXPECT_EQ(patternImage({"a.png", 1, 1, {}}, load).pixels, (std::vector<uint8_t>{40, 10, 20, 30}));
}

TEST(PatternImage, ScaleOfAPatternWithoutWidth_IsItsOwn) {
    EXPECT_EQ(patternScale({"a.png", 0.75F, 1, {}}, pictureOfWidth(3), nullptr), 0.75F);
}

TEST(PatternImage, Width_IsThatOfATile) {
    EXPECT_EQ(scaleOf(32, 16), 2.0F);
    EXPECT_EQ(scaleOf(4, 16), 0.25F);
    // The library's tile is the product of scale and columns, cut to whole pixels.
    for (int columns = 1; columns <= 400; ++columns) {
        for (int width = (columns + 9) / 10; width <= 10 * columns; ++width) {
            const float product =
                scaleOf(static_cast<float>(width), columns) * static_cast<float>(columns);
            ASSERT_EQ(static_cast<int>(product), width) << columns;
            ASSERT_LT(product, static_cast<float>(width) + 0.01F) << columns;
        }
    }
}

TEST(PatternImage, WidthsBeyondTheLibrarysScales_AreCutAndNoted) {
    EXPECT_EQ(scaleOf(161, 16), 10.0F);
    EXPECT_EQ(scaleOf(1, 16), 0.1F);
    EXPECT_EQ(notesOf(200, 16), std::vector<std::string>{
                                    "pattern.width: 200 pixels of a picture of 16 are a scale of 12.5, "
                                    "which is more than the library's 10; painted with 10"});
    EXPECT_EQ(notesOf(1, 16), std::vector<std::string>{
                                  "pattern.width: 1 pixels of a picture of 16 are a scale of 0.0625, "
                                  "which is less than the library's 0.1; painted with 0.1"});
    EXPECT_TRUE(notesOf(160, 16).empty());
    EXPECT_TRUE(notesOf(2, 20).empty());
}

TEST(PatternImage, PictureWithoutPixels_HasAScaleAllTheSame) {
    EXPECT_EQ(scaleOf(5, 0), 1.0F);
    EXPECT_TRUE(notesOf(5, 0).empty());
}

}  // namespace
}  // namespace vorelstyle
