#include <gtest/gtest.h>

#include <cstdint>
#include <string>
#include <vector>

#include "painting.h"

/// What docs/captions.md says of settings together.
namespace vorelpaint {
namespace {

using voreltext::Image;
using voreltext::Line;

Options optionsOf(const std::string& text, const std::string& style = "{}") {
    Options options;
    options.text = text;
    options.inlineStyle = vorelstyle::parseStyle(style);
    return options;
}

Composition checked(const Options& options) {
    Composition composition = composed(options);
    composition.notes().giveTo([](const std::string& note) { ADD_FAILURE() << note; });
    return composition;
}

std::vector<uint8_t> alphasOf(const Image& image) {
    std::vector<uint8_t> alphas;
    for (size_t i = 3; i < image.pixels.size(); i += 4)
        alphas.push_back(image.pixels[i]);
    return alphas;
}

/// Whether the picture has a pixel whose red, or whose blue, is the larger one.
struct Colours {
    bool red = false;
    bool blue = false;

    explicit Colours(const Image& image) {
        for (size_t i = 0; i < image.pixels.size(); i += 4) {
            red = red || image.pixels[i] > image.pixels[i + 2];
            blue = blue || image.pixels[i + 2] > image.pixels[i];
        }
    }
};

constexpr const char* kEdgeInPercent =
    R"({"version": 2, "stroke": {"size": "10%", "color": "#000", "position": "outside"}})";

TEST(Captions, Shrink_TakesLengthsInPercentAlong) {
    Options options = optionsOf("Smaller", kEdgeInPercent);
    options.size = 200;
    EXPECT_EQ(composed(options).margins().left, 20);
    options.canvas.width = 400;
    options.canvas.margin = 30;
    options.fit = Fit::shrink;
    const Composition shrunk = checked(options);
    EXPECT_LT(shrunk.text().size(), 120);
    EXPECT_EQ(shrunk.margins().left, (shrunk.text().size() + 5) / 10);
}

TEST(Captions, Shrink_KeepsTheLinesOfTheText) {
    Options options = optionsOf("One\nand two");
    options.canvas.width = 100;
    options.fit = Fit::shrink;
    EXPECT_EQ(composed(options).text().layout().lines().size(), 2U);
}

TEST(Captions, WrappedBeyondTheHeight_IsCutOffWithANote) {
    Options options = optionsOf("a few words in many lines");
    options.canvas.width = 300;
    options.canvas.height = 120;
    options.fit = Fit::wrap;
    const Composition wrapped = composed(options);
    std::vector<std::string> notes;
    wrapped.notes().giveTo([&](const std::string& note) { notes.push_back(note); });
    EXPECT_GT(wrapped.text().layout().lines().size(), 2U);
    EXPECT_EQ(wrapped.canvas().height, 120);
    ASSERT_EQ(notes.size(), 1U);
    EXPECT_NE(notes.front().find("at the bottom"), std::string::npos) << notes.front();
}

TEST(Captions, Start_GoesByEachLine) {
    Options options = optionsOf("a long line of English\n\u05E9\u05DC\u05D5\u05DD\nshort");
    options.align = voreltext::Align::start;
    const Composition text = checked(options);
    const std::vector<Line>& lines = text.text().layout().lines();
    ASSERT_EQ(lines.size(), 3U);
    EXPECT_EQ(lines[1].box.right, lines[0].box.right);
    EXPECT_EQ(lines[2].box.left, lines[0].box.left);
    EXPECT_GT(lines[1].box.left, lines[0].box.left);
}

TEST(Captions, ColoursOfWords_LeaveTheShapeOfThePictureAsItIs) {
    const auto of = [](const std::string& text) {
        Options options = optionsOf(text, kEdgeInPercent);
        options.markup = true;
        return composed(options).paint();
    };
    const Image plain = of("Twinkle, twinkle");
    const Image coloured = of("Twinkle, <c #F80>twin</c>kle");
    EXPECT_EQ(coloured.width, plain.width);
    EXPECT_EQ(coloured.height, plain.height);
    EXPECT_EQ(alphasOf(coloured), alphasOf(plain));
    EXPECT_NE(coloured.pixels, plain.pixels);
}

TEST(Captions, Ligature_HasTheColourOfItsFirstLetter) {
    Options options = optionsOf("<c #F00>f</c><c #00F>i</c>");
    options.markup = true;
    const Colours joined(composed(options).paint());
    EXPECT_TRUE(joined.red);
    EXPECT_FALSE(joined.blue);
    options.features = {"liga=0"};
    const Colours apart(composed(options).paint());
    EXPECT_TRUE(apart.red);
    EXPECT_TRUE(apart.blue);
}

/// A thumb in colours.
Options thumb(const std::string& style) {
    Options options = optionsOf("\U0001F44D", style);
    options.fonts = {"DejaVu Sans:bold", "Noto Color Emoji"};
    return options;
}

TEST(Captions, PictureOfAColourFont_HidesTheFillAndWhatLiesOnIt) {
    const Image black = composed(thumb(R"({"color": "#000"})")).paint();
    const Image ramp = composed(thumb(R"({"innerShadow": {"angle": 90, "distance": 3, "size": 5,
        "color": "#00F"}, "linearGradient": {"angle": 0, "gradient": [{"color": "#0F0", "location": 0}]}})"))
                           .paint();
    const Image picture = composed(thumb(R"({"version": 2, "fill": false})")).paint();
    ASSERT_EQ(black.pixels.size(), picture.pixels.size());
    ASSERT_EQ(ramp.pixels.size(), picture.pixels.size());
    size_t opaque = 0;
    for (size_t i = 0; i < picture.pixels.size(); i += 4) {
        if (picture.pixels[i + 3] != 255) continue;
        ++opaque;
        for (size_t channel = i; channel < i + 3; ++channel) {
            ASSERT_EQ(black.pixels[channel], picture.pixels[channel]);
            ASSERT_EQ(ramp.pixels[channel], picture.pixels[channel]);
        }
    }
    EXPECT_GT(opaque, 1000U);
}

TEST(Captions, PictureOfAColourFont_HasTheStrokeAroundIt) {
    const Composition plain = checked(thumb("{}"));
    const Composition edged =
        composed(thumb(R"({"stroke": {"size": 6, "color": "#FFF", "position": "outside"}})"));
    EXPECT_EQ(edged.canvas().width, plain.canvas().width + 12);
    const Image image = edged.paint();
    const auto row = static_cast<size_t>(image.height / 2) * static_cast<size_t>(image.width);
    size_t x = 0;
    while (image.pixels[(row + x) * 4 + 3] < 255)
        ++x;
    EXPECT_EQ(image.pixels[(row + x) * 4 + 2], 255) << "white, where the thumb is yellow";
}

TEST(Captions, PictureOfAColourFont_FadesWithTheText) {
    Options options = thumb("{}");
    const Image whole = composed(options).paint();
    options.opacity = 0.5F;
    const Image faded = composed(options).paint();
    const size_t middle = (static_cast<size_t>(whole.height / 2) * static_cast<size_t>(whole.width) +
                           static_cast<size_t>(whole.width / 2)) *
                          4;
    EXPECT_EQ(whole.pixels[middle + 3], 255);
    EXPECT_LT(faded.pixels[middle + 3], 200);
}

}  // namespace
}  // namespace vorelpaint
