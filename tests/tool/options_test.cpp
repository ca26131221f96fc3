#include "options.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "error.h"

namespace vorelpaint {
namespace {

Options optionsOf(std::vector<const char*> arguments) {
    arguments.insert(arguments.begin(), {"vorelpaint", "-o", "out.png"});
    return parseOptions(static_cast<int>(arguments.size()), arguments.data()).value();
}

std::string faultOf(const std::vector<const char*>& arguments) {
    try {
        optionsOf(arguments);
        return "";
    } catch (const ToolError& error) {
        return error.what();
    }
}

TEST(Options, TextAlone_LeavesTheRestToTheStyle) {
    const Options options = optionsOf({"A"});
    EXPECT_EQ(options.text, "A");
    EXPECT_EQ(options.output, "out.png");
    EXPECT_EQ(options.effectScale, 1.0F);
    EXPECT_FALSE(options.color);
    EXPECT_FALSE(options.opacity);
    EXPECT_FALSE(options.style);
    EXPECT_FALSE(options.preset);
}

TEST(Options, EachValue_IsRead) {
    const Options options =
        optionsOf({"--size", "12", "--align", "right", "--effect-scale", "2.5", "--color", "#010203",
                   "--opacity", "0.25", "--background", "checkerboard", "--padding", "0", "A"});
    EXPECT_EQ(options.size, 12);
    EXPECT_EQ(options.align, voreltext::Align::right);
    EXPECT_EQ(options.effectScale, 2.5F);
    EXPECT_EQ(options.color, 0x010203U);
    EXPECT_EQ(options.opacity, 0.25F);
    EXPECT_EQ(options.background.kind, Background::Kind::checkerboard);
    EXPECT_EQ(options.padding, 0);
}

TEST(Options, Colours_MayBeShort) {
    const Options options = optionsOf({"--color", "#f80", "--background", "#abc", "A"});
    EXPECT_EQ(options.color, 0xFF8800U);
    EXPECT_EQ(options.background.kind, Background::Kind::colour);
    EXPECT_EQ(options.background.colour, 0xAABBCCU);
    EXPECT_EQ(faultOf({"--color", "#ff", "A"}), "--color: '#ff' is no colour; write #RRGGBB or #RGB");
    EXPECT_EQ(faultOf({"--background", "#ff", "A"}),
              "--background: '#ff' is none of transparent, checkerboard, #RRGGBB, #RGB");
}

TEST(Options, MisspeltOption_IsAnsweredWithTheNearest) {
    EXPECT_EQ(faultOf({"--szie", "96", "A"}), "no option '--szie'; did you mean --size?");
    EXPECT_EQ(faultOf({"--szie=96", "A"}), "no option '--szie'; did you mean --size?");
    EXPECT_EQ(faultOf({"-size", "96", "A"}), "no option '-size'; did you mean --size?");
    EXPECT_EQ(faultOf({"A", "--colour", "#000"}), "no option '--colour'; did you mean --color?");
    EXPECT_EQ(faultOf({"A", "--print-margin"}),
              "no option '--print-margin'; did you mean --print-margins?");
    EXPECT_EQ(faultOf({"A", "--list"}), "no option '--list'; did you mean --list-presets?");
    EXPECT_EQ(faultOf({"A", "--Preset", "gold"}), "no option '--Preset'; did you mean --preset?");
}

TEST(Options, OptionLikeNone_IsNamed) {
    for (const char* option : {"--no-such-option", "-x", "---"}) {
        EXPECT_EQ(faultOf({"A", option}), "no option '" + std::string(option) + "'; --help lists them");
    }
}

TEST(Options, SecondText_IsNamed) {
    EXPECT_EQ(faultOf({"Once", "upon", "a time"}),
              "'upon' is one text too many; quotes keep the words of a text together");
}

TEST(Options, EmptySecondText_IsNamed) {
    EXPECT_EQ(faultOf({"A", ""}), "'' is one text too many; quotes keep the words of a text together");
    EXPECT_EQ(faultOf({"A", "", "--szie"}), "no option '--szie'; did you mean --size?");
}

TEST(Options, EmptyNames_AreGivenNames) {
    EXPECT_EQ(optionsOf({"--style", "", "A"}).style, "");
    EXPECT_EQ(optionsOf({"--preset", "", "A"}).preset, "");
    EXPECT_EQ(optionsOf({"--text-file", ""}).textFile, "");
}

TEST(Options, WholeNumbers_AreDecimalAndInRange) {
    for (const std::string text : {"12.5", "", "0x10", " 1", "1 ", "+1", "0", "1001", "99999999999"}) {
        EXPECT_EQ(faultOf({"--size", text.c_str(), "A"}),
                  "--size: '" + text + "' is no whole number from 1 to 1000");
    }
    EXPECT_EQ(optionsOf({"--size", "1", "A"}).size, 1);
    EXPECT_EQ(optionsOf({"--size", "1000", "A"}).size, 1000);
}

TEST(Options, Fractions_AreNumbersInRange) {
    for (const std::string text : {"", "nan", "inf", "0x1", "1.01", "-0.1", "0.5 "}) {
        EXPECT_EQ(faultOf({"--opacity", text.c_str(), "A"}),
                  "--opacity: '" + text + "' is no number from 0 to 1");
    }
    EXPECT_EQ(optionsOf({"--opacity", "1", "A"}).opacity, 1.0F);
    EXPECT_EQ(optionsOf({"--opacity", "5e-1", "A"}).opacity, 0.5F);
}

}  // namespace
}  // namespace vorelpaint
