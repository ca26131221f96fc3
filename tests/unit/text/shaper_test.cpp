#include "text/shaper.h"

#include <ft2build.h>
#include FT_FREETYPE_H
#include <gtest/gtest.h>

#include <clocale>
#include <cstdlib>
#include <memory>

#include "text/paragraphs.h"
#include "unit/text/made_font.h"
#include "unit/text/test_font.h"

namespace voreltext {
namespace {

using vorel_test::letters;
using vorel_test::openMade;

using Indices = std::vector<size_t>;

/// Shapes a line, each character in its font.
std::vector<ShapedGlyph> shapedIn(Shaper& shaper, const std::string& text, const Indices& fonts) {
    const Paragraph line = splitParagraphs(decodeUtf8(text)).front();
    return shaper.shape({line.codes.data(), fonts.data(), line.scripts.data(), line.levels.data(),
                         line.codes.size(), line.isRightToLeft});
}

/// Shapes a line in the main font.
std::vector<ShapedGlyph> shaped(const Fonts& fonts, const std::string& text,
                                const std::vector<std::string>& features = {}) {
    Shaper shaper(fonts, features);
    return shapedIn(shaper, text, Indices(text.size()));
}

TEST(Shaper, Glyphs_TellTheirClustersAndAdvances) {
    const Fonts fonts{openMade(letters())};
    const std::vector<ShapedGlyph> glyphs = shaped(fonts, "ab ");
    ASSERT_EQ(glyphs.size(), 3U);
    for (size_t i = 0; i < 3; ++i) {
        EXPECT_EQ(glyphs[i].cluster, i);
        EXPECT_EQ(glyphs[i].font, 0U);
        EXPECT_EQ(glyphs[i].advance, i < 2 ? 640 : 320);
    }
    EXPECT_EQ(glyphs[0].index, 1U);
    EXPECT_EQ(glyphs[1].index, 2U);
}

TEST(Shaper, EmptyText_HasNoGlyphs) {
    const Fonts fonts{openMade(letters())};
    EXPECT_TRUE(shaped(fonts, "").empty());
}

TEST(Shaper, Ranges_AreShapedInTheirFonts) {
    Fonts fonts{openMade(letters())};
    fonts.add(openMade(letters(), 32));
    const Indices chosen{0, 1, 0};
    Shaper shaper(fonts, {});
    const std::vector<ShapedGlyph> glyphs = shapedIn(shaper, "abc", chosen);
    ASSERT_EQ(glyphs.size(), 3U);
    for (size_t i = 0; i < 3; ++i) {
        EXPECT_EQ(glyphs[i].font, chosen[i]);
        EXPECT_EQ(glyphs[i].advance, i == 1 ? 1280 : 640);
    }
}

TEST(Shaper, FontOfPictures_AdvancesInItsOwnSize) {
    vorel_test::MadeFont made = letters();
    made.pictures = vorel_test::Pictures::withoutOutlines;
    made.ppems = {64};
    const Fonts fonts{openMade(made, 20)};
    // 640 of 1024 units are 40 of the picture's 64 pixels, 12.5 of 20.
    EXPECT_EQ(shaped(fonts, "a").front().advance, 800);
}

TEST(Shaper, Direction_OrdersTheGlyphs) {
    const Fonts fonts{Font(FontFile{VOREL_TEST_FONT}, 20)};
    const auto order = [&](const char* text) {
        Indices clusters;
        for (const ShapedGlyph& glyph : shaped(fonts, text))
            clusters.push_back(glyph.cluster);
        return clusters;
    };
    EXPECT_EQ(order("ab!"), (Indices{0, 1, 2}));
    EXPECT_EQ(order("אב!"), (Indices{2, 1, 0}));
    EXPECT_EQ(order("א12 ab!"), (Indices{6, 4, 5, 3, 1, 2, 0}));
}

TEST(Shaper, Features_AreSwitchedOnAndOff) {
    const Fonts fonts{Font(FontFile{VOREL_TEST_FONT}, 20)};
    EXPECT_EQ(shaped(fonts, "ffi").size(), 1U) << "a ligature";
    for (const char* off : {"liga=0", "-liga", "liga off"})
        EXPECT_EQ(shaped(fonts, "ffi", {off}).size(), 3U) << off;
    EXPECT_EQ(shaped(fonts, "ffi", {"-liga", "liga"}).size(), 1U) << "the last counts";
    EXPECT_LT(shaped(fonts, "AV")[0].advance, shaped(fonts, "AV", {"kern=0"})[0].advance);
    EXPECT_EQ(shaped(fonts, "ffi", {"ss01", "zzzz=3"}).size(), 1U) << "unknown to the font";
}

/// Whether a digit that has a form of its own in Urdu is shaped without it where the program is Urdu.
[[noreturn]] void shapeInUrdu() {
    std::setlocale(LC_ALL, "ur_PK.UTF-8");
    const Fonts fonts{Font(FontFile{vorel_test::kArabicFont}, 20)};
    const std::vector<ShapedGlyph> four = shaped(fonts, "۴");
    const bool isPlain = four.front().index == FT_Get_Char_Index(fonts.main().face(), 0x6F4);
    std::_Exit(isPlain ? 0 : 1);
}

TEST(ShaperDeathTest, LocaleOfTheProgram_ChangesNoGlyph) {
    if (std::getenv("LOCPATH") == nullptr) GTEST_SKIP() << "LOCPATH names no folder of locales";
    // In a program of its own: HarfBuzz looks at the locale once.
    ::testing::FLAGS_gtest_death_test_style = "threadsafe";
    EXPECT_EXIT(shapeInUrdu(), ::testing::ExitedWithCode(0), "");
}

TEST(Shaper, MisspeltFeature_IsRefusedByItsName) {
    const Fonts fonts{openMade(letters())};
    for (const std::string feature :
         {"", "ligatures", "liga=x", "=1", "liga=0 kern=0", "liga[2:3]=0", "liga[:2]=0"}) {
        EXPECT_EQ(vorel_test::faultOf([&] {
                      const Shaper shaper(fonts, {"kern", feature});
                  }),
                  "'" + feature + "' is no feature of a font for a whole text, as 'liga=0' is");
    }
}

}  // namespace
}  // namespace voreltext
