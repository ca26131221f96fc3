#include "text/system_fonts.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "text/error.h"

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

TEST(SystemFonts, MisspeltStyle_IsRefused) {
    for (const std::string style :
         {"blod", "italics", "weight=blod", "wieght=200", "foo=bar", "=", "size"}) {
        EXPECT_EQ(faultOf("DejaVu Sans:" + style), "font 'DejaVu Sans:" + style + "': '" + style +
                                                       "' is no style and no property of fonts");
    }
    EXPECT_EQ(faultOf("DejaVu Sans:bold:blod"),
              "font 'DejaVu Sans:bold:blod': 'blod' is no style and no property of fonts");
    EXPECT_EQ(faultOf("No Such Family:blod"),
              "font 'No Such Family:blod': 'blod' is no style and no property of fonts");
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

}  // namespace
}  // namespace voreltext
