#include "compose/layer_set.h"

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdio>
#include <string>

#include "memory_meter.h"
#include "painting.h"

namespace vorelpaint {
namespace {

Options optionsOf(const std::string& style, const std::string& text) {
    Options options;
    options.size = 24;
    options.inlineStyle = vorelstyle::parseStyle(style);
    options.markup = true;
    options.text = text;
    return options;
}

/// The most memory that painting takes at one time.
size_t mostMemoryOf(const Options& options) {
    const Composition composition = composed(options);
    const MemoryMeter meter;
    composition.paint();
    return meter.peak();
}

/// A letter in each of so many colours.
std::string colourful(int colours) {
    std::string text;
    for (int i = 0; i < 60; ++i) {
        char tag[32];
        std::snprintf(tag, sizeof tag, "<c #%06X>m</c>", i % colours);
        text += tag;
    }
    return text;
}

TEST(LayerSet, ManyColours_TakeNoMoreMemoryThanOne) {
    if (!MemoryMeter::works()) GTEST_SKIP() << "an allocator of its own";
    const char* style = R"({"outerShadow": {"angle": 0, "distance": 2, "size": 9, "color": "#F00"}})";
    const size_t one = mostMemoryOf(optionsOf(style, colourful(1)));
    EXPECT_LT(mostMemoryOf(optionsOf(style, colourful(60))), one + one / 10);
}

TEST(LayerSet, Colours_HaveTheOpacityOfTheFill) {
    const Options options = optionsOf(
        R"({"version": 2, "looks": [{"text": {"color": "#000", "opacity": 0.5}, "textOpacity": 0.5}]})",
        "a");
    const LayerSet looks(options, *options.inlineStyle, {}, 24, {{0, 1, 0xFF8800}},
                         [](const std::string&) {});
    ASSERT_EQ(looks.layers().size(), 1U);
    EXPECT_EQ(looks.layers()[0].fillOpacity, 0.25F);
    ASSERT_EQ(looks.layers()[0].colours.size(), 1U);
    EXPECT_EQ(looks.layers()[0].colours[0].colour, 0xFF8800U);
}

}  // namespace
}  // namespace vorelpaint
