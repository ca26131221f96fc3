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
    } catch (const std::runtime_error& error) {
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
    EXPECT_EQ(options.canvas.padding, 0);
}

TEST(Options, FontsAreCollected_InTheirOrder) {
    EXPECT_EQ(optionsOf({"A"}).fonts, std::vector<std::string>{"DejaVu Sans"});
    EXPECT_EQ(optionsOf({"--font", "X", "A"}).fonts, std::vector<std::string>{"X"});
    EXPECT_EQ(optionsOf({"--font", "X", "A", "--font", "Y, Z"}).fonts,
              (std::vector<std::string>{"X", "Y, Z"}));
    EXPECT_EQ(optionsOf({"--font", "X", "A"}).text, "A") << "one value behind each";
}

TEST(Options, LettersAndLines_AreRead) {
    const Options options = optionsOf({"--letter-spacing", "-5%", "--line-height", "1.25", "--markup",
                                       "--font-features", "ss01,-kern", "A"});
    EXPECT_EQ(options.letterSpacing, (vorelstyle::Length{-5, vorelstyle::Length::Unit::percent}));
    EXPECT_EQ(options.lineHeight, 1.25F);
    EXPECT_TRUE(options.markup);
    EXPECT_EQ(options.features, (std::vector<std::string>{"ss01", "-kern"}));
    EXPECT_EQ(
        faultOf({"--letter-spacing", "201", "A"}),
        "--letter-spacing: '201' is no length from -200 to 200 in pixels or, with a %, in percent");
    EXPECT_EQ(
        faultOf({"--font-variations", "weight=700", "A"}),
        "--font-variations: 'weight=700' is no list of AXIS=VALUE; an axis has four letters, as in "
        "wght=700");
}

TEST(Options, Sizes_AreThoseOfASheet) {
    EXPECT_EQ(optionsOf({"--sheet", "--sizes", "24,48", "A"}).sheetSizes, (std::vector<int>{24, 48}));
    EXPECT_EQ(faultOf({"--sheet", "--sizes", "24,0", "A"}),
              "--sizes: '0' is no whole number from 1 to 1000");
    EXPECT_EQ(faultOf({"--sheet", "--sizes", "", "A"}), "--sizes: '' is no list of 1 to 16 sizes");
    std::vector<const char*> batch{"vorelpaint", "--batch", "a.jsonl", "--sizes", "24"};
    EXPECT_THROW(parseOptions(static_cast<int>(batch.size()), batch.data()), ToolError);
    EXPECT_EQ(faultOf({"--sizes", "24", "A"}),
              "--sizes are the columns of a --sheet; the size of one picture is --size");
}

TEST(Options, CanvasThatDoesNotGoTogether_IsRefused) {
    EXPECT_EQ(optionsOf({"--fit", "wrap", "--width", "9", "A"}).fit, Fit::wrap);
    EXPECT_EQ(faultOf({"--fit", "wrap", "A"}), "fit: wrap breaks lines at a width; none is given");
    EXPECT_EQ(faultOf({"--sheet", "--width", "9", "A"}),
              "a sheet has the size of its cells; no width or height can be given");
    EXPECT_EQ(
        faultOf({"--anchor", "middle", "A"}),
        "--anchor: 'middle' is none of top-left, top, top-right, left, center, right, bottom-left, "
        "bottom, bottom-right");
    EXPECT_EQ(faultOf({"--fit", "shrnk", "A"}),
              "--fit: 'shrnk' is none of none, shrink, wrap; did you mean shrink?");
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
