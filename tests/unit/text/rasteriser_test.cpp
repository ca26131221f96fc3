#include "text/rasteriser.h"

#include <gtest/gtest.h>

#include <string>

#include "unit/text/made_font.h"
#include "unit/text/test_font.h"

namespace voreltext {
namespace {

using vorel_test::edges;
using vorel_test::letters;
using vorel_test::MadeFont;
using vorel_test::MadeGlyph;
using vorel_test::openMade;
using vorel_test::Pictures;
using vorel_test::Rectangle;

/// Its glyph 1 is a red square of 2 pixels under a smaller one of the text's colour, glyph 2 that of the
/// text's colour alone, glyph 3 a letter without layers; glyphs 4 and 5 are the squares.
MadeFont layered() {
    MadeFont font;
    font.colours = {0xFF0000FF, 0x00FF0080};
    font.glyphs = {{'a', 640, {}, {{4, 0}, {5, 0xFFFF}}}, {'b', 640, {}, {{5, 0xFFFF}}},
                   {'c', 640, Rectangle{0, 0, 64, 64}},   {0, 640, Rectangle{0, 0, 128, 128}},
                   {0, 640, Rectangle{64, 0, 128, 64}},   {'d', 640, {}, {{4, 1}}}};
    return font;
}

/// Glyph 1 has a picture of 2 x 1 pixels at 8 pixels to the em, glyph 2 an outline alone.
MadeFont pictured(Pictures kind) {
    MadeFont font;
    font.pictures = kind;
    font.ppems = {8};
    const std::vector<uint8_t> pixels{255, 0, 0, 255, 0, 0, 200, 51};
    font.glyphs = {{'a', 640, Rectangle{0, 0, 64, 64}, {}, {{2, 1, 1, 3, pixels}}},
                   {'b', 640, Rectangle{0, 0, 64, 64}}};
    return font;
}

TEST(Rasteriser, Outline_StandsAtItsOrigin) {
    const Font font = openMade(letters());
    const GlyphOrigin origin{1, 3 * 64, -5 * 64};
    const GlyphInk ink = inkOf(font, origin);
    EXPECT_EQ(edges(ink.box), (std::vector<int>{4, -3, 12, 5}));
    EXPECT_FALSE(ink.isPicture);
    const GlyphMask mask = rasterised(font, origin);
    EXPECT_EQ(edges(mask.box), edges(ink.box));
    EXPECT_EQ(mask.coverage, std::vector<uint8_t>(64, 255));
    EXPECT_TRUE(mask.pixels.empty());
}

TEST(Rasteriser, FractionOfAPixel_MovesTheOutline) {
    const Font font = openMade(letters());
    const GlyphMask mask = rasterised(font, {1, 32, 0});
    EXPECT_EQ(mask.box.width(), 9);
    EXPECT_EQ(mask.coverage[0], 128) << "half a pixel at the left";
    EXPECT_EQ(mask.coverage[1], 255);
}

TEST(Rasteriser, Blank_HasNoInk) {
    const Font font = openMade(letters());
    EXPECT_TRUE(inkOf(font, {54, 0, 0}).box.isEmpty());
}

TEST(Rasteriser, Layers_AreLaidOneUponTheOther) {
    const Font font = openMade(layered());
    const GlyphInk ink = inkOf(font, {1, 64, 0});
    EXPECT_TRUE(ink.isPicture);
    EXPECT_EQ(edges(ink.box), (std::vector<int>{1, -2, 3, 0}));
    const GlyphMask mask = rasterised(font, {1, 64, 0});
    EXPECT_EQ(mask.coverage, std::vector<uint8_t>(4, 255));
    EXPECT_EQ(mask.pixels, (std::vector<uint8_t>{255, 0, 0, 255, 255, 0, 0, 255,  //
                                                 255, 0, 0, 255, 0, 0, 0, 255}))
        << "what is of the text's colour is black";
}

TEST(Rasteriser, LayersOfTheTextsColour_AreNoPicture) {
    const Font font = openMade(layered());
    EXPECT_FALSE(inkOf(font, {2, 0, 0}).isPicture);
    const GlyphMask mask = rasterised(font, {2, 0, 0});
    EXPECT_TRUE(mask.pixels.empty());
    EXPECT_EQ(mask.coverage, std::vector<uint8_t>(1, 255));
}

TEST(Rasteriser, ColourThatIsSeenThrough_Covers) {
    const Font font = openMade(layered());
    const GlyphMask mask = rasterised(font, {6, 0, 0});
    EXPECT_EQ(mask.coverage, std::vector<uint8_t>(4, 128));
    EXPECT_EQ(mask.pixels[1], 128);
}

TEST(Rasteriser, GlyphWithoutLayers_IsItsOutline) {
    const Font font = openMade(layered());
    EXPECT_FALSE(inkOf(font, {3, 0, 0}).isPicture);
    EXPECT_EQ(rasterised(font, {3, 0, 0}).coverage, std::vector<uint8_t>(1, 255));
}

TEST(Rasteriser, Picture_IsBroughtToTheSizeOfTheFont) {
    for (const Pictures kind : {Pictures::withoutOutlines, Pictures::besideOutlines}) {
        // At twice its size it is 4 x 2 pixels, 2 to the right of the origin and up from 4 to 6.
        const Font font = openMade(pictured(kind));
        const GlyphOrigin origin{1, 64, 0};
        const GlyphInk ink = inkOf(font, origin);
        EXPECT_TRUE(ink.isPicture);
        EXPECT_EQ(edges(ink.box), (std::vector<int>{3, -6, 7, -4}));
        const GlyphMask mask = rasterised(font, origin);
        EXPECT_EQ(edges(mask.box), edges(ink.box));
        EXPECT_EQ(mask.coverage, (std::vector<uint8_t>{255, 255, 51, 51, 255, 255, 51, 51}));
        const std::vector<uint8_t> first(mask.pixels.begin(), mask.pixels.begin() + 4);
        const std::vector<uint8_t> last(mask.pixels.end() - 4, mask.pixels.end());
        EXPECT_EQ(first, (std::vector<uint8_t>{255, 0, 0, 255}));
        EXPECT_EQ(last, (std::vector<uint8_t>{0, 0, 40, 51})) << "premultiplied";
    }
}

TEST(Rasteriser, BesidePictures_OutlinesAreTheirsStill) {
    const Font font = openMade(pictured(Pictures::besideOutlines));
    EXPECT_FALSE(inkOf(font, {2, 0, 0}).isPicture);
    EXPECT_EQ(edges(rasterised(font, {2, 0, 0}).box), (std::vector<int>{0, -1, 1, 0}));
    rasterised(font, {1, 0, 0});
    EXPECT_EQ(edges(rasterised(font, {2, 0, 0}).box), (std::vector<int>{0, -1, 1, 0}))
        << "the face has its size back";
}

TEST(Rasteriser, AmongPictures_GlyphWithoutOneHasNoInk) {
    const Font font = openMade(pictured(Pictures::withoutOutlines));
    EXPECT_TRUE(inkOf(font, {2, 0, 0}).box.isEmpty());
}

TEST(Rasteriser, PictureThatIsNoPng_IsRefused) {
    std::string bytes = pictured(Pictures::withoutOutlines).bytes();
    bytes.replace(bytes.find("IDAT"), 4, "IDAX");
    const Font font(FontBytes{reinterpret_cast<const uint8_t*>(bytes.data()), bytes.size()}, 16);
    EXPECT_EQ(vorel_test::faultOf([&] { rasterised(font, {1, 0, 0}); }), "glyph 1 cannot be rasterised");
}

TEST(Rasteriser, InstalledColourFonts_HavePictures) {
    const Font emoji(FontFile{vorel_test::kEmojiFont}, 32);
    Fonts fonts{Font(FontFile{vorel_test::kEmojiFont}, 32)};
    const TextLayout text(fonts, decodeUtf8("😀"));
    ASSERT_EQ(text.glyphCount(), 1U);
    EXPECT_TRUE(text.glyph(0).isPicture);
    const GlyphMask face = text.rasterise(0);
    const size_t centre =
        static_cast<size_t>(face.box.height() / 2 * face.box.width() + face.box.width() / 2);
    EXPECT_EQ(face.coverage[centre], 255);
    EXPECT_GT(face.pixels[centre * 4], face.pixels[centre * 4 + 2]) << "yellow, not blue";
}

}  // namespace
}  // namespace voreltext
