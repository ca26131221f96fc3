#include <gtest/gtest.h>

#include <algorithm>
#include <sstream>
#include <string>
#include <vector>

#include "compose/system/png_reader.h"
#include "program.h"
#include "style_file.h"

namespace vorelpaint {
namespace {

using vorel_test::Outcome;
using vorel_test::readBytes;
using vorel_test::runVorelpaint;
using vorel_test::runVorelpaintOnTerminal;
using vorel_test::TempDir;
using vorelcompose::readPng;
using voreltext::Image;
using Words = std::vector<std::string>;

std::string printed(const Words& arguments) {
    const Outcome outcome = runVorelpaint(arguments);
    EXPECT_EQ(outcome.exitCode, 0) << outcome.err;
    EXPECT_EQ(outcome.err, "");
    return outcome.out;
}

void expectRefused(const Words& arguments, const std::string& fault) {
    const Outcome outcome = runVorelpaint(arguments);
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(outcome.out, "");
    EXPECT_NE(outcome.err.find(fault), std::string::npos) << outcome.err;
    EXPECT_EQ(std::count(outcome.err.begin(), outcome.err.end(), '\n'), 1) << outcome.err;
}

bool contains(const std::string& text, const std::string& part) {
    return text.find(part) != std::string::npos;
}

/// The lines of the table of an explanation: from its headings to the blank line behind it.
Words tableOf(const std::string& explanation) {
    std::istringstream lines(explanation.substr(explanation.find("topmost effect first:\n\n")));
    std::string line;
    std::getline(lines, line);
    std::getline(lines, line);
    Words table;
    while (std::getline(lines, line) && !line.empty())
        table.push_back(line);
    return table;
}

/// Effects of every place, in pixels.
constexpr const char* kMetal = R"({
  "outerShadow": { "angle": 100, "distance": 6, "size": 8, "color": "#201000", "opacity": 0.6 },
  "linearGradient": { "angle": 90, "gradient": [ { "color": "#7A4A08", "location": 0 } ] },
  "innerShadow": { "angle": 270, "distance": 2, "size": 2, "color": "#6B3B00", "opacity": 0.7 },
  "stroke": { "size": 1, "color": "#FFF3C0", "opacity": 0.8, "position": "inside" } })";

/// A stroke across the edge, for which a run has two layers.
constexpr const char* kSoundWord = R"({
  "description": "A sound word",
  "outerShadow": { "angle": 135, "distance": 13, "size": 0, "color": "#2962C8" },
  "linearGradient": {
    "angle": 90,
    "gradient": [
      { "color": "#FF3D00", "location": 0 },
      { "color": "#FFC400", "location": 0.5 },
      { "color": "#FFF59D", "location": 1 } ] },
  "stroke": { "size": 5, "color": "#101010", "position": "center" } })";

TEST(Explain, Preset_IsNamedAndDescribed) {
    EXPECT_TRUE(
        contains(printed({"--preset", "gold", "--explain"}), "style       preset gold: Polished metal"));
}

TEST(Explain, Text_IsMeasuredStepByStep) {
    const TempDir dir;
    const std::string style = dir.write("metal.json", kMetal);
    const std::string text = printed({"--style", style, "--size", "40", "--explain", "Ag"});
    EXPECT_TRUE(contains(text, "style       file '" + style + "'\n"));
    EXPECT_TRUE(contains(text, "margins     left 7, top 2, right 9, bottom 14 pixels\n"));
    EXPECT_TRUE(contains(text, "layers      one: the text is opaque, and no stroke is centred\n"));
    EXPECT_TRUE(contains(text, "text        2 glyphs of 40 pixels in 1 line\n"));
    const Words table = tableOf(text);
    const Words steps{"  step ", "  glyphs ",      "  stroke ", "  innerShadow ", "  linearGradient ",
                      "  text ", "  outerShadow ", "  merge ",  "  whole run "};
    ASSERT_EQ(table.size(), steps.size()) << text;
    for (size_t i = 0; i < steps.size(); ++i) {
        EXPECT_EQ(table[i].rfind(steps[i], 0), 0U) << table[i];
        EXPECT_EQ(table[i].size(), table[0].size()) << "columns are aligned";
        EXPECT_EQ(contains(table[i], " ms "), i > 0) << table[i];
    }
    EXPECT_TRUE(contains(table[6], "beneath the text"));
    EXPECT_TRUE(contains(text, "\n  stroke          size 1, colour #CC"));
}

TEST(Explain, Picture_IsAsLargeAsItIsPainted) {
    const TempDir dir;
    const std::string path = dir.file("a.png");
    const std::string text = printed({"--preset", "comic", "--explain", "-o", path, "Ag"});
    const Image image = readPng(path);
    EXPECT_TRUE(contains(text, "picture     " + std::to_string(image.width) + " x " +
                                   std::to_string(image.height) + " pixels\n"))
        << text;
    const std::string alone = dir.file("b.png");
    printed({"--preset", "comic", "-o", alone, "Ag"});
    EXPECT_EQ(readBytes(path), readBytes(alone)) << "explaining changes no pixel";
}

TEST(Explain, WithoutText_TellsTheOrderAlone) {
    const TempDir dir;
    const std::string text = printed({"--style", dir.write("sound word.json", kSoundWord), "--explain"});
    EXPECT_EQ(tableOf(text),
              (Words{"  effect          place", "  stroke          across the edge",
                     "  linearGradient  on the text", "  outerShadow     outside the text",
                     "  text            the text"}));
    EXPECT_TRUE(contains(text, "layers      two: a stroke is centred on the edge"));
    EXPECT_FALSE(contains(text, " ms"));
}

TEST(Explain, TranslucentText_HasTwoLayers) {
    EXPECT_TRUE(contains(printed({"--opacity", "0.5", "--explain"}), "two: the text is translucent"));
}

TEST(Explain, Pattern_IsSaidToLeaveNoTrace) {
    EXPECT_TRUE(
        contains(printed({"--preset", "tiles", "--explain"}), "\n  pattern         leaves no trace: "));
    EXPECT_FALSE(contains(printed({"--preset", "gold", "--explain"}), "leaves no trace"));
}

TEST(Explain, EveryPreset_IsExplained) {
    for (const std::string& name : presetNames()) {
        const std::string text = printed({"--preset", name, "--size", "20", "--explain", "Ag"});
        EXPECT_TRUE(contains(text, "\n  whole run ")) << name;
        EXPECT_TRUE(contains(text, "\nCache key of ")) << name;
    }
}

TEST(Explain, TextWithoutInk_IsRefused) {
    expectRefused({"--explain", " "}, "no visible character");
}

TEST(Sheet, EveryPreset_IsOnIt) {
    const TempDir dir;
    const std::string path = dir.file("sheet.png");
    EXPECT_EQ(printed({"--sheet", "--size", "24", "-o", path, "Ag"}), "");
    const Image sheet = readPng(path);
    const size_t presets = presetNames().size();
    // Whatever the grid, its cells are large enough for the text and their number is that of the
    // presets.
    printed({"--size", "24", "-o", dir.file("one.png"), "Ag"});
    const Image one = readPng(dir.file("one.png"));
    EXPECT_GE(static_cast<size_t>(sheet.width) * static_cast<size_t>(sheet.height),
              presets * static_cast<size_t>(one.width) * static_cast<size_t>(one.height));
    EXPECT_GE(sheet.width, sheet.height);
}

TEST(Sheet, Cell_HoldsThePresetsOwnPicture) {
    const TempDir dir;
    const Words common{"--size", "24", "--background", "#102030", "--padding", "0", "Ag"};
    const auto paint = [&](Words arguments) {
        arguments.insert(arguments.end(), common.begin(), common.end());
        arguments.insert(arguments.end(), {"-o", dir.file("a.png")});
        printed(arguments);
        return readPng(dir.file("a.png"));
    };
    const Image sheet = paint({"--sheet"});
    for (const std::string& name : presetNames()) {
        const Image picture = paint({"--preset", name});
        bool found = false;
        for (int y = 0; y + picture.height <= sheet.height && !found; ++y) {
            for (int x = 0; x + picture.width <= sheet.width && !found; ++x) {
                found = true;
                for (int row = 0; row < picture.height && found; ++row) {
                    const auto at = [](const Image& image, int column, int line) {
                        return image.pixels.begin() + (line * image.width + column) * 4;
                    };
                    found = std::equal(at(picture, 0, row), at(picture, 0, row) + picture.width * 4,
                                       at(sheet, x, y + row));
                }
            }
        }
        EXPECT_TRUE(found) << name;
    }
}

TEST(Sheet, Terminal_ShowsABarThatGoesInTheEnd) {
    const TempDir dir;
    const Outcome outcome =
        runVorelpaintOnTerminal({"--sheet", "--size", "24", "-o", dir.file("a.png"), "Ag"}, 80);
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_TRUE(contains(outcome.err, "] 0 of " + std::to_string(presetNames().size()) + " pictures"));
    const std::string erased = "\r\x1B[K";
    EXPECT_EQ(outcome.err.substr(outcome.err.size() - erased.size()), erased);
}

TEST(Sheet, WhatItCannotPaint_IsRefused) {
    expectRefused({"--sheet", "Ag"}, "nowhere to paint");
    expectRefused({"--sheet", "-o", "/dev/null"}, "give TEXT");
    expectRefused({"--sheet", "--preset", "gold", "-o", "/dev/null", "A"}, "--sheet");
    const TempDir dir;
    expectRefused({"--sheet", "--size", "1000", "-o", dir.file("a.png"), "MMMM"},
                  "the picture would be");
    EXPECT_TRUE(dir.list().empty());
}

TEST(WriteCpp, Calls_HaveTheStylesNumbers) {
    const TempDir dir;
    EXPECT_EQ(printed({"--style", dir.write("sound word.json", kSoundWord), "--write-cpp"}),
              R"(#include <voreleffect/voreleffect.h>

/// A sound word.
/// For an empty set; VFEffect.h shows how a set paints a run.
void addSoundWord(VFontEffect::VFEffect& look) {
    look.setTextOpacity(1);
    look.addOuterShadowText(135, 13, 0, 0x2962C8, 1);
    VFontEffect::VFGradient linearStops[] = {
        {0xFF3D00, 1, 0},
        {0xFFC400, 1, 0.5F},
        {0xFFF59D, 1, 1},
    };
    look.addLinearGradientText(90, 1, 1, 3, linearStops);
    look.addStrokeText(5, 0x101010, 1, 0, 0);
    look.addText(0x000000, 1);
}
)");
}

TEST(WriteCpp, CommandLine_EntersTheCalls) {
    const TempDir dir;
    const std::string text =
        printed({"--style", dir.write("sound word.json", kSoundWord), "--effect-scale", "2", "--color",
                 "#ABCDEF", "--opacity", "0.3", "--write-cpp"});
    EXPECT_TRUE(contains(text, "look.setTextOpacity(0.3F);"));
    EXPECT_TRUE(contains(text, "look.addStrokeText(10, 0x101010, 1, 0, 0);"));
    EXPECT_TRUE(contains(text, "look.addText(0xABCDEF, 0.3F);"));
}

TEST(WriteCpp, StyleFile_NamesTheFunction) {
    const TempDir dir;
    const std::string style = dir.write("my look-2.json", "{}");
    EXPECT_TRUE(contains(printed({"--style", style, "--write-cpp"}), "void addMyLook2("));
    EXPECT_TRUE(contains(printed({"--write-cpp"}), "void addLook("));
}

TEST(WriteCpp, WhatItCannotBePrintedWith_IsRefused) {
    expectRefused({"--write-cpp", "--explain"}, "--write-cpp");
    expectRefused({"--write-cpp", "--print-key"}, "--write-cpp");
}

TEST(Manual, Program_PrintsIt) {
    EXPECT_EQ(printed({"--man"}).rfind(".TH VORELPAINT 1 ", 0), 0U);
}

TEST(Completion, Program_PrintsEachShells) {
    EXPECT_TRUE(contains(printed({"--completion", "bash"}), "complete -F _vorelpaint vorelpaint\n"));
    EXPECT_EQ(printed({"--completion", "zsh"}).rfind("#compdef vorelpaint\n", 0), 0U);
    EXPECT_TRUE(contains(printed({"--completion", "fish"}), "complete -c vorelpaint -f\n"));
    expectRefused({"--completion", "tcsh"}, "'tcsh' is none of bash, zsh, fish");
}

}  // namespace
}  // namespace vorelpaint
