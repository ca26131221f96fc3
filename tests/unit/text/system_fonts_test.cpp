#include "text/system_fonts.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <string>
#include <utility>
#include <vector>

#include "text/error.h"
#include "text/text_layout.h"
#include "text/utf8.h"

namespace voreltext {
namespace {

TEST(SystemFonts, Family_IsFoundWithItsStyle) {
    const SystemFonts fonts;
    EXPECT_EQ(std::filesystem::path(fonts.find("DejaVu Sans").path).filename(), "DejaVuSans.ttf");
    EXPECT_EQ(std::filesystem::path(fonts.find("dejavu sans:bold").path).filename(),
              "DejaVuSans-Bold.ttf");
}

std::string fileOf(const std::string& request) {
    return std::filesystem::path(SystemFonts().find(request).path).filename();
}

std::string faultOf(const std::string& request) {
    try {
        return "found " + SystemFonts().find(request).path;
    } catch (const TextError& error) {
        return error.what();
    }
}

TEST(SystemFonts, Properties_ChooseTheFace) {
    EXPECT_EQ(fileOf("DejaVu Sans:weight=200"), "DejaVuSans-Bold.ttf");
    EXPECT_EQ(fileOf("DejaVu Sans:style=Bold"), "DejaVuSans-Bold.ttf");
    EXPECT_EQ(fileOf("DejaVu Sans:Bold:oblique"), "DejaVuSans-BoldOblique.ttf");
    EXPECT_EQ(fileOf("DejaVu Sans:italic"), "DejaVuSans-Oblique.ttf") << "oblique stands for it";
    EXPECT_EQ(fileOf("DejaVu Serif:oblique"), "DejaVuSerif-Italic.ttf") << "italic stands for it";
    EXPECT_EQ(fileOf("DejaVu Sans Condensed"), "DejaVuSansCondensed.ttf");
    EXPECT_EQ(fileOf("DejaVu Sans:lang=de"), "DejaVuSans.ttf");
    EXPECT_EQ(fileOf("DejaVu Sans:"), "DejaVuSans.ttf");
    EXPECT_EQ(fileOf("Deja\\Vu Sans"), "DejaVuSans.ttf") << "an escaped letter is that letter";
}

TEST(SystemFonts, WordsOfAFacesOwnStyle_ChooseIt) {
    // By the numbers of its tables the first is regular, the others are semi-condensed.
    EXPECT_EQ(fileOf("DejaVu Sans:book"), "DejaVuSans.ttf");
    EXPECT_EQ(fileOf("DejaVu Sans:condensed"), "DejaVuSansCondensed.ttf");
    EXPECT_EQ(fileOf("DejaVu Sans:Bold:Condensed:italic"), "DejaVuSansCondensed-BoldOblique.ttf");
    EXPECT_EQ(fileOf("monospace:book"), fileOf("monospace"));
    for (const std::string style :
         {"light", "demibold", "ultracondensed", "book:bold", "condensed:black", "bold:weight=80"})
        EXPECT_NE(faultOf("DejaVu Sans:" + style).find("no face of it is as asked for"),
                  std::string::npos)
            << style;
}

TEST(SystemFonts, MisspeltStyle_IsRefusedWithTheNearest) {
    const std::string none = "' is no style and no property of fonts";
    const std::vector<std::pair<std::string, std::string>> meant{{"blod", "bold"},
                                                                 {"Itallic", "italic"},
                                                                 {"semi-condensed", "semicondensed"},
                                                                 {"weight=blod", "weight=bold"},
                                                                 {"wieght=200", "weight=200"},
                                                                 {"slnat=itlaic", "slant=italic"}};
    for (const auto& [style, nearest] : meant) {
        EXPECT_EQ(faultOf("DejaVu Sans:" + style), "font 'DejaVu Sans:" + style + "': '" + style + none +
                                                       "; did you mean '" + nearest + "'?");
    }
    for (const std::string style : {"foo=bar", "=", "size", "weight=xyz"})
        EXPECT_EQ(faultOf("DejaVu Sans:" + style), "font 'DejaVu Sans:" + style + "': '" + style + none);
    EXPECT_EQ(faultOf("DejaVu Sans:bold:blod"),
              "font 'DejaVu Sans:bold:blod': 'blod" + none + "; did you mean 'bold'?");
    EXPECT_EQ(faultOf("No Such Family:blod"),
              "font 'No Such Family:blod': 'blod" + none + "; did you mean 'bold'?");
}

TEST(SystemFonts, EveryStyleThatIsMeant_IsKnown) {
    // Each is refused for its face, if at all, and not for its name.
    for (const std::string style :
         {"thin",          "extralight",     "ultralight",     "demilight",     "semilight",
          "light",         "book",           "regular",        "medium",        "demibold",
          "semibold",      "bold",           "extrabold",      "ultrabold",     "black",
          "heavy",         "roman",          "italic",         "oblique",       "condensed",
          "expanded",      "ultracondensed", "extracondensed", "semicondensed", "semiexpanded",
          "extraexpanded", "ultraexpanded"}) {
        EXPECT_EQ(faultOf("DejaVu Sans:" + style).find("is no style"), std::string::npos) << style;
    }
}

TEST(SystemFonts, StyleThatTheFamilyHasNot_IsNotReplacedByTheNearest) {
    for (const std::string request :
         {"DejaVu Sans:black", "DejaVu Sans:style=Blod", "DejaVu Sans:weight=", "DejaVu Sans:weight=81",
          "DejaVu Math TeX Gyre:bold", "DejaVu Math TeX Gyre:italic", "DejaVu Sans:size=12"}) {
        EXPECT_EQ(faultOf(request),
                  "font '" + request + "': the family is there, but no face of it is as asked for");
    }
}

TEST(SystemFonts, WhatStandsBehindADash_IsRefused) {
    for (const std::string request :
         {"DejaVu Sans-Bold", "DejaVu Sans-12:bold", "DejaVuSans-Bold.ttf"}) {
        EXPECT_EQ(faultOf(request),
                  "no font file or family '" + request +
                      "'; a style stands behind a colon, as in 'DejaVu Sans:bold', and "
                      "a name's own dash behind a backslash");
    }
    EXPECT_EQ(faultOf("No\\-Family"), "no font file or family 'No\\-Family'");
}

TEST(SystemFonts, GenericFamily_IsWhateverTheSystemPrefers) {
    EXPECT_TRUE(std::filesystem::is_regular_file(SystemFonts().find("sans-serif").path));
    EXPECT_TRUE(std::filesystem::is_regular_file(SystemFonts().find("monospace:bold").path));
    EXPECT_EQ(fileOf("Sans"), fileOf("sans"));
    EXPECT_EQ(fileOf("Monospace:bold"), fileOf("monospace:bold"));
}

TEST(SystemFonts, FamilyThatIsNotInstalled_IsNotReplacedByTheNearest) {
    try {
        SystemFonts().find("No Such Family:bold");
        FAIL() << "found";
    } catch (const TextError& error) {
        EXPECT_STREQ(error.what(), "no font file or family 'No Such Family:bold'");
    }
}

TEST(SystemFonts, MisspeltFamily_IsRefusedWithTheNearest) {
    EXPECT_EQ(faultOf("DejaVu Snas"),
              "no font file or family 'DejaVu Snas'; did you mean 'DejaVu Sans'?");
    EXPECT_EQ(faultOf("dejavu serfi:bold"),
              "no font file or family 'dejavu serfi:bold'; did you mean 'DejaVu Serif'?");
    EXPECT_EQ(faultOf(""), "no font file or family ''");
}

class SystemFontsFor : public ::testing::Test {
  protected:
    /// The file of the font for a cluster of a text in `request`.
    std::string fileFor(const Cluster& cluster, const std::string& request = "DejaVu Sans") {
        const auto found = mFonts.findFor(cluster, mFonts.find(request));
        return found ? std::filesystem::path(found->path).filename().string() : "";
    }

    SystemFonts mFonts;
};

TEST_F(SystemFontsFor, Scripts_AreFoundInTheFontsThatHaveThem) {
    for (const uint32_t code : {0x905U, 0xE01U, 0x65E5U, 0xD55CU, 0x5D0U}) {
        const auto found = mFonts.findFor({code}, mFonts.find("DejaVu Serif"));
        ASSERT_TRUE(found) << code;
        EXPECT_TRUE(Font(*found, 20).has(code)) << found->path;
    }
}

TEST_F(SystemFontsFor, WhatNoFontHas_IsNotFound) {
    EXPECT_EQ(fileFor({0x10FFFD}), "");
    EXPECT_EQ(fileFor({'a', 0x10FFFD}), "");
}

TEST_F(SystemFontsFor, StyleOfTheMainFont_IsPreferred) {
    EXPECT_EQ(fileFor({'a'}, "DejaVu Sans:bold"), "DejaVuSans-Bold.ttf");
    EXPECT_EQ(fileFor({'a'}, "DejaVu Serif:italic"), "DejaVuSerif-Italic.ttf");
    EXPECT_EQ(fileFor({0xE01}, "DejaVu Sans:bold"), "Loma-Bold.ttf");
    EXPECT_EQ(fileFor({0xE01}), "Loma.ttf");
}

TEST_F(SystemFontsFor, Emoji_AreFoundInColours) {
    const std::string emoji = "NotoColorEmoji.ttf";
    EXPECT_EQ(fileFor({0x1F600}), emoji) << "though DejaVu Sans has it";
    EXPECT_EQ(fileFor({0x2764, 0xFE0F}), emoji);
    EXPECT_EQ(fileFor({0x1F468, 0x200D, 0x1F469}), emoji);
    EXPECT_EQ(fileFor({0x1F600, 0xFE0E}), "DejaVuSans.ttf") << "it asks for none";
    EXPECT_EQ(fileFor({0x2764}), "DejaVuSans.ttf") << "a black heart";
    EXPECT_EQ(fileFor({'1'}), "DejaVuSans.ttf");
}

TEST_F(SystemFontsFor, FontThatIsNotInstalled_HasAFallbackToo) {
    const auto found = mFonts.findFor({'a'}, {"no/such.ttf"});
    ASSERT_TRUE(found);
    EXPECT_TRUE(Font(*found, 20).has('a'));
}

/// Ends the program with 0 when fonts are chosen as in English where the language is another one.
[[noreturn]] void chooseIn(const char* language) {
    setenv("FC_LANG", language, 1);
    const SystemFonts fonts;
    const auto hebrew = fonts.findFor({0x5D0}, fonts.find("DejaVu Serif"));
    const bool areAlike = fileOf("serif") == "DejaVuSerif.ttf" &&
                          fileOf("monospace:bold") == "DejaVuSansMono-Bold.ttf" && hebrew &&
                          std::filesystem::path(hebrew->path).filename() == "FrankRuehlCLM-Medium.ttf";
    std::_Exit(areAlike ? 0 : 1);
}

TEST(SystemFontsDeathTest, LanguageOfTheEnvironment_ChangesNoChoice) {
    ::testing::FLAGS_gtest_death_test_style = "threadsafe";  // fontconfig asks for it once
    for (const char* language : {"en", "ja", "ko", "ar", "he", "hi", "th", "zh-tw"})
        EXPECT_EXIT(chooseIn(language), ::testing::ExitedWithCode(0), "") << language;
}

TEST_F(SystemFontsFor, ManyClusters_AreQuick) {
    const FontFile like = mFonts.find("DejaVu Sans");
    size_t found = 0;
    for (uint32_t code = 0x4E00; code < 0x4E00 + 10000; ++code)
        found += mFonts.findFor({code}, like) ? 1 : 0;  // each its own search: hours, were it
    EXPECT_GT(found, 3000U);
}

TEST_F(SystemFontsFor, AsAFallback_EveryScriptIsSet) {
    const FontFile main = mFonts.find("DejaVu Sans");
    Fonts fonts{Font(main, 32)};
    fonts.setFallback([&](const Cluster& cluster) { return mFonts.findFor(cluster, main); });
    const TextLayout text(
        fonts, decodeUtf8("abc नमस्ते สวัสดี 日本語 한국어 👍🏽"));
    EXPECT_TRUE(text.missing().empty());
    EXPECT_EQ(text.fontsUsed().front(), "DejaVu Sans Book");
    EXPECT_GE(text.fontsUsed().size(), 6U);
}

}  // namespace
}  // namespace voreltext
