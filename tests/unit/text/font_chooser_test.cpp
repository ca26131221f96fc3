#include "text/font_chooser.h"

#include <gtest/gtest.h>

#include "unit/text/made_font.h"
#include "unit/text/test_font.h"

namespace voreltext {
namespace {

using vorel_test::letters;
using vorel_test::MadeFont;
using vorel_test::MadeGlyph;
using vorel_test::openMade;
using vorel_test::Rectangle;

/// A font of these characters, with colours or without.
Font fontOf(const std::string& characters, bool isColour = false) {
    MadeFont made;
    for (const uint32_t code : decodeUtf8(characters))
        made.glyphs.push_back({code, 640, Rectangle{64, 0, 576, 512}});
    if (isColour) {
        made.colours = {0xFF0000FF};
        made.glyphs[0].layers = {{1, 0}};
    }
    return openMade(made);
}

class FontChooserTest : public ::testing::Test {
  protected:
    /// For each character the font that is chosen.
    std::vector<size_t> chosen(const std::string& text) {
        return mChooser.choose(splitParagraphs(decodeUtf8(text)).front()).fonts;
    }

    Fonts mFonts{fontOf("abc ")};
    Shaper mShaper{mFonts, {}};
    FontChooser mChooser{mFonts, mShaper};
};

using Indices = std::vector<size_t>;

TEST_F(FontChooserTest, MainFont_HasAllThatItHas) {
    mFonts.add(fontOf("abc"));
    EXPECT_EQ(chosen("a cab"), Indices(5, 0));
    EXPECT_TRUE(mChooser.missing().empty());
}

TEST_F(FontChooserTest, MissingCluster_GoesToTheFirstFontThatHasIt) {
    mFonts.add(fontOf("de"));
    mFonts.add(fontOf("def"));
    EXPECT_EQ(chosen("adbfe"), (Indices{0, 1, 0, 2, 1}));
    EXPECT_TRUE(mChooser.missing().empty());
}

TEST_F(FontChooserTest, ClusterOfSeveralCharacters_GoesAsAWhole) {
    mFonts.add(fontOf("d"));
    mFonts.add(fontOf("d\u0326"));
    EXPECT_EQ(chosen("d\u0326d"), (Indices{2, 2, 1}));
}

TEST_F(FontChooserTest, GivenFonts_ComeBeforeTheFallback) {
    mFonts.add(fontOf("d"));
    std::vector<Cluster> asked;
    mFonts.setFallback([&](const Cluster& cluster) {
        asked.push_back(cluster);
        return FontFile{VOREL_TEST_FONT};
    });
    EXPECT_EQ(chosen("ad1212"), (Indices{0, 1, 2, 2, 2, 2}));
    EXPECT_EQ(asked, (std::vector<Cluster>{{'1'}, {'2'}})) << "once for each";
}

TEST_F(FontChooserTest, WhatNobodyHas_StaysWithTheMainFont) {
    mFonts.add(fontOf("d"));
    EXPECT_EQ(chosen("xdy"), (Indices{0, 1, 0}));
    mChooser.choose(splitParagraphs(decodeUtf8("0123456789\nayx"))[1]);
    ASSERT_EQ(mChooser.missing().size(), 2U);
    const MissingCharacter x = mChooser.missing()[0];
    const MissingCharacter y = mChooser.missing()[1];
    EXPECT_EQ(x.code, uint32_t{'x'});
    EXPECT_EQ(x.count, 2U);
    EXPECT_EQ(x.first, 0U);
    EXPECT_EQ(y.code, uint32_t{'y'});
    EXPECT_EQ(y.count, 2U);
    EXPECT_EQ(y.first, 2U);
}

TEST_F(FontChooserTest, MarksThatShowNothing_AreNotMissing) {
    EXPECT_EQ(chosen("a\u00ADb\u200D"), Indices(4, 0));
    EXPECT_TRUE(mChooser.missing().empty());
}

TEST_F(FontChooserTest, MissingCharacter_OfAClusterIsNamedAlone) {
    chosen("a\u0326");
    ASSERT_EQ(mChooser.missing().size(), 1U);
    EXPECT_EQ(mChooser.missing()[0].code, 0x326U);
    chosen("x\u200D");
    ASSERT_EQ(mChooser.missing().size(), 2U) << "not what joins";
    EXPECT_EQ(mChooser.missing()[1].code, uint32_t{'x'});
    EXPECT_EQ(mChooser.missing()[0].first, 1U);
}

TEST_F(FontChooserTest, AskedForColours_AFontWithColoursIsPreferred) {
    Fonts fonts{fontOf("a❤👍🏽")};
    fonts.add(fontOf("❤"));
    fonts.add(fontOf("❤👍🏽", true));
    Shaper shaper(fonts, {});
    FontChooser chooser(fonts, shaper);
    const auto chosen = [&](const char* text) {
        return chooser.choose(splitParagraphs(decodeUtf8(text)).front()).fonts;
    };
    EXPECT_EQ(chosen("❤"), Indices{0});
    EXPECT_EQ(chosen("❤\uFE0F"), (Indices{2, 2}));
    EXPECT_EQ(chosen("❤\uFE0E"), (Indices{0, 0}));
    EXPECT_EQ(chosen("👍"), Indices{0});
    EXPECT_EQ(chosen("👍🏽a"), (Indices{2, 2, 0}));
}

TEST_F(FontChooserTest, AskedForNoColours_AFontWithoutIsPreferred) {
    Fonts fonts{fontOf("a❤", true)};
    fonts.add(fontOf("❤"));
    Shaper shaper(fonts, {});
    FontChooser chooser(fonts, shaper);
    EXPECT_EQ(chooser.choose(splitParagraphs(decodeUtf8("❤❤\uFE0E")).front()).fonts, (Indices{0, 1, 1}));
}

TEST_F(FontChooserTest, FallbackWithoutColours_IsNotPreferred) {
    Fonts fonts{fontOf("❤")};
    fonts.setFallback([](const Cluster&) { return FontFile{VOREL_TEST_FONT}; });
    Shaper shaper(fonts, {});
    FontChooser chooser(fonts, shaper);
    EXPECT_EQ(chooser.choose(splitParagraphs(decodeUtf8("❤\uFE0F")).front()).fonts, (Indices{0, 0}));
}

TEST_F(FontChooserTest, ManyFonts_CostAsManyPassesAtMost) {
    std::string text;
    for (char letter = 'd'; letter <= 'z'; ++letter) {
        mFonts.add(fontOf(std::string(1, letter)));
        text += letter;
    }
    Indices expected;
    for (size_t i = 1; i <= text.size(); ++i)
        expected.push_back(i);
    EXPECT_EQ(chosen(text), expected);
}

}  // namespace
}  // namespace voreltext
