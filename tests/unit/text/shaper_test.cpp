#include "text/shaper.h"

#include <gtest/gtest.h>

#include <memory>

#include "unit/text/made_font.h"
#include "unit/text/test_font.h"

namespace voreltext {
namespace {

using vorel_test::letters;
using vorel_test::openMade;

/// Shapes in one of the fonts.
std::vector<ShapedGlyph> shaped(const Shaper& shaper, const std::string& text, size_t font = 0) {
    const std::vector<uint32_t> codes = decodeUtf8(text);
    const std::vector<size_t> fonts(codes.size(), font);
    return shaper.shape({codes.data(), fonts.data(), codes.size(), false});
}

TEST(Shaper, Glyphs_TellTheirClustersAndAdvances) {
    const Fonts fonts{openMade(letters())};
    const std::vector<ShapedGlyph> glyphs = shaped(Shaper(fonts, {}), "ab ");
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
    EXPECT_TRUE(shaped(Shaper(fonts, {}), "").empty());
}

TEST(Shaper, Ranges_AreShapedInTheirFonts) {
    Fonts fonts{openMade(letters())};
    fonts.add(openMade(letters(), 32));
    const std::vector<uint32_t> codes = decodeUtf8("abc");
    const std::vector<size_t> chosen{0, 1, 0};
    const std::vector<ShapedGlyph> glyphs =
        Shaper(fonts, {}).shape({codes.data(), chosen.data(), codes.size(), false});
    ASSERT_EQ(glyphs.size(), 3U);
    for (size_t i = 0; i < 3; ++i) {
        EXPECT_EQ(glyphs[i].font, chosen[i]);
        EXPECT_EQ(glyphs[i].advance, i == 1 ? 1280 : 640);
    }
}

TEST(Shaper, FontOfPictures_AdvancesInItsOwnSize) {
    vorel_test::MadeFont made = letters();
    made.pictures = vorel_test::Pictures::withoutOutlines;
    made.ppem = 64;
    const Fonts fonts{openMade(made, 20)};
    // 640 of 1024 units are 40 of the picture's 64 pixels, 12.5 of 20.
    EXPECT_EQ(shaped(Shaper(fonts, {}), "a").front().advance, 800);
}

TEST(Shaper, Direction_OrdersTheGlyphs) {
    const Fonts fonts{Font(FontFile{VOREL_TEST_FONT}, 20)};
    const std::vector<uint32_t> codes = decodeUtf8("a!");
    const std::vector<size_t> none(2);
    const Shaper shaper(fonts, {});
    EXPECT_EQ(shaper.shape({codes.data(), none.data(), 2, false})[0].cluster, 0U);
    EXPECT_EQ(shaper.shape({codes.data(), none.data(), 2, true})[0].cluster, 1U) << "!a";
}

TEST(Shaper, Features_AreSwitchedOnAndOff) {
    const Fonts fonts{Font(FontFile{VOREL_TEST_FONT}, 20)};
    EXPECT_EQ(shaped(Shaper(fonts, {}), "ffi").size(), 1U) << "a ligature";
    for (const char* off : {"liga=0", "-liga", "liga off"})
        EXPECT_EQ(shaped(Shaper(fonts, {off}), "ffi").size(), 3U) << off;
    EXPECT_EQ(shaped(Shaper(fonts, {"-liga", "liga"}), "ffi").size(), 1U) << "the last counts";
    const auto pairWidth = [&](const Shaper& shaper) { return shaped(shaper, "AV").front().advance; };
    EXPECT_LT(pairWidth(Shaper(fonts, {})), pairWidth(Shaper(fonts, {"kern=0"})));
    EXPECT_EQ(shaped(Shaper(fonts, {"ss01", "zzzz=3"}), "ffi").size(), 1U) << "unknown to the font";
}

TEST(Shaper, MisspeltFeature_IsRefusedByItsName) {
    const Fonts fonts{openMade(letters())};
    for (const std::string feature : {"", "ligatures", "liga=x", "=1", "liga=0 kern=0", "liga[2:3]=0"}) {
        EXPECT_EQ(vorel_test::faultOf([&] {
                      const Shaper shaper(fonts, {"kern", feature});
                  }),
                  "'" + feature + "' is no feature of a font for a whole text, as 'liga=0' is");
    }
}

}  // namespace
}  // namespace voreltext
