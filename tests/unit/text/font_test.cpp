#include "text/font.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <utility>

#include "text/error.h"
#include "text/text_layout.h"
#include "text/utf8.h"
#include "unit/text/made_font.h"
#include "unit/text/test_font.h"

namespace voreltext {
namespace {

using vorel_test::letters;
using vorel_test::MadeFont;
using vorel_test::openMade;
using vorel_test::Pictures;

FontBytes viewOf(const std::string& bytes) {
    return {reinterpret_cast<const uint8_t*>(bytes.data()), bytes.size()};
}

template <typename Source>
std::string faultOf(const Source& source, const std::vector<FontVariation>& variations = {}) {
    return vorel_test::faultOf([&] { const Font font(source, 32, variations); });
}

TEST(Font, Bytes_GiveTheGlyphsOfTheFile) {
    const std::string bytes = vorel_test::testFontBytes();
    Fonts ofFile{Font(FontFile{VOREL_TEST_FONT}, 48)};
    Fonts ofBytes{Font(viewOf(bytes), 48)};
    EXPECT_EQ(ofBytes.main().lineHeight(), ofFile.main().lineHeight());
    const std::vector<uint32_t> words = decodeUtf8("Quick\nfox AV");
    const TextLayout expected(ofFile, words, {Align::center});
    const TextLayout text(ofBytes, words, {Align::center});
    ASSERT_EQ(expected.glyphCount(), 10U);
    ASSERT_EQ(text.glyphCount(), expected.glyphCount());
    for (size_t i = 0; i < text.glyphCount(); ++i) {
        const GlyphMask glyph = text.rasterise(i);
        const GlyphMask same = expected.rasterise(i);
        EXPECT_EQ(glyph.box.left, same.box.left) << i;
        EXPECT_EQ(glyph.box.top, same.box.top) << i;
        EXPECT_EQ(glyph.coverage, same.coverage) << i;
    }
}

TEST(Font, WhatIsNoFont_IsRefused) {
    EXPECT_EQ(faultOf(FontFile{"no/such.ttf"}), "'no/such.ttf' is no font that can be read");
    EXPECT_EQ(faultOf(viewOf("no font")), "the bytes are no font that can be read");
    EXPECT_EQ(faultOf(FontBytes{nullptr, 0}), "the bytes are no font that can be read");
}

TEST(Font, SizeOutOfItsRange_IsRefused) {
    // Of pictures, FreeType knows nothing of the size that they are brought to.
    for (const char* file : {VOREL_TEST_FONT, vorel_test::kEmojiFont}) {
        for (const int size : {0, -1, 16385, 1 << 30}) {
            EXPECT_EQ(vorel_test::faultOf([&] { Font(FontFile{file}, size); }),
                      "the size of a font is " + std::to_string(size) + "; it may be 1 to 16384 pixels");
        }
        EXPECT_EQ(Font(FontFile{file}, 16384).sizePx(), 16384);
    }
}

TEST(Font, CutBytes_AreRefused) {
    const std::string bytes = vorel_test::testFontBytes().substr(0, 100);
    EXPECT_NE(faultOf(viewOf(bytes)), "");
}

TEST(Font, FaceIndexBeyondTheLast_IsRefused) {
    EXPECT_EQ(faultOf(FontFile{VOREL_TEST_FONT, 1}),
              "'" VOREL_TEST_FONT "' is no font that can be read");
}

TEST(Font, Metrics_AreWholePixelsOfItsSize) {
    MadeFont made = letters();
    made.ascender = 700;    // 10.9 pixels of 64 units
    made.descender = -150;  // 2.3
    made.lineGap = 40;      // together 13.9
    const Font font = openMade(made);
    EXPECT_EQ(font.sizePx(), 16);
    EXPECT_EQ(font.ascender(), 11 * 64);
    EXPECT_EQ(font.descender(), -3 * 64);
    EXPECT_EQ(font.lineHeight(), 14 * 64);
    EXPECT_EQ(openMade(made, 32).lineHeight(), 28 * 64);
}

TEST(Font, WithoutVerticalMetrics_IsRefused) {
    MadeFont flat = letters();
    flat.ascender = flat.descender = 0;
    const std::string fault = "the bytes are a font without vertical metrics";
    EXPECT_EQ(faultOf(viewOf(flat.bytes())), fault);
    MadeFont upsideDown = letters();
    std::swap(upsideDown.ascender, upsideDown.descender);
    EXPECT_EQ(faultOf(viewOf(upsideDown.bytes())), fault);
}

TEST(Font, WithoutOutlinesOrPictures_IsRefused) {
    MadeFont made = letters();
    made.pictures = Pictures::withoutOutlines;
    made.ppems = {8};
    EXPECT_EQ(faultOf(viewOf(made.bytes())), "");
    std::string plain = made.bytes();
    // Bitmaps without colours are kept in tables of other names.
    plain.replace(plain.find("CBDT"), 4, "EBDT");
    plain.replace(plain.find("CBLC"), 4, "EBLC");
    EXPECT_EQ(faultOf(viewOf(plain)), "the bytes are a font without outlines");
}

TEST(Font, Name_IsFamilyAndStyle) {
    EXPECT_EQ(openMade(letters()).name(), "Made Plain");
    EXPECT_EQ(Font(FontFile{vorel_test::kEmojiFont}, 20).name(), "Noto Color Emoji Regular");
}

TEST(Font, Characters_AreThoseOfItsTable) {
    const Font font = openMade(letters());
    EXPECT_TRUE(font.has('a'));
    EXPECT_FALSE(font.has('1'));
    EXPECT_FALSE(font.has(0x1F600));
    EXPECT_FALSE(font.has(0x110000));
}

TEST(Font, Colours_AreThoseOfPicturesAndOfLayers) {
    EXPECT_FALSE(openMade(letters()).isColour());
    MadeFont layered = letters();
    layered.colours = {0xFF0000FF};
    layered.glyphs[0].layers = {{2, 0}};
    EXPECT_TRUE(openMade(layered).isColour());
    EXPECT_TRUE(openMade(layered).hasOutlines());
    const Font emoji(FontFile{vorel_test::kEmojiFont}, 20);
    EXPECT_TRUE(emoji.isColour());
    EXPECT_FALSE(emoji.hasOutlines());
}

TEST(Font, OfPictures_HasTheMetricsOfItsSize) {
    MadeFont made = letters();
    made.pictures = Pictures::withoutOutlines;
    made.ppems = {64};
    // 48 pixels up and 16 down at 64 pixels to the em: at 20 it is 15 and 5, at 18 13.5 and 4.5.
    const Font font = openMade(made, 20);
    EXPECT_EQ(font.picturePpem(), 64);
    EXPECT_EQ(font.ascender(), 15 * 64);
    EXPECT_EQ(font.descender(), -5 * 64);
    EXPECT_EQ(font.lineHeight(), 20 * 64);
    EXPECT_EQ(font.scaled(64 * 64), 20 * 64);
    EXPECT_EQ(font.scaled(-64), -20);
    EXPECT_EQ(openMade(made, 18).ascender(), 14 * 64);
    EXPECT_EQ(openMade(made, 18).descender(), -5 * 64);
}

TEST(Font, SeveralSizesOfPictures_TheNextLargerIsTaken) {
    MadeFont made = letters();
    made.pictures = Pictures::withoutOutlines;
    made.ppems = {20, 64, 10, 32};
    const auto taken = [&](int sizePx) { return openMade(made, sizePx).picturePpem(); };
    EXPECT_EQ(taken(1), 10);
    EXPECT_EQ(taken(10), 10);
    EXPECT_EQ(taken(11), 20);
    EXPECT_EQ(taken(32), 32);
    EXPECT_EQ(taken(33), 64);
    EXPECT_EQ(taken(100), 64) << "the largest where none is large enough";
}

TEST(Font, Moved_IsTheSameFont) {
    Font font = openMade(letters());
    Font moved(std::move(font));
    EXPECT_TRUE(moved.has('a'));
    Font other(FontFile{VOREL_TEST_FONT}, 20);
    other = std::move(moved);
    EXPECT_EQ(other.name(), "Made Plain");
    EXPECT_EQ(other.sizePx(), 16);
}

TEST(Font, Variation_ChangesTheWidth) {
    const auto widthAt = [](float weight) {
        Fonts fonts{Font(FontFile{vorel_test::kVariableFont}, 64, {{"wght", weight}})};
        return TextLayout(fonts, decodeUtf8("Hamburg")).lines().front().box.width();
    };
    EXPECT_LT(widthAt(100), widthAt(400));
    EXPECT_LT(widthAt(400), widthAt(900));
    Fonts regular{Font(FontFile{vorel_test::kVariableFont}, 64)};
    EXPECT_EQ(widthAt(400), TextLayout(regular, decodeUtf8("Hamburg")).lines().front().box.width());
}

TEST(Font, VariationTwice_TheLastCounts) {
    Fonts fonts{Font(FontFile{vorel_test::kVariableFont}, 64, {{"wght", 900}, {"wght", 100}})};
    Fonts thin{Font(FontFile{vorel_test::kVariableFont}, 64, {{"wght", 100}})};
    const std::vector<uint32_t> word = decodeUtf8("Hamburg");
    EXPECT_EQ(TextLayout(fonts, word).lines().front().box.width(),
              TextLayout(thin, word).lines().front().box.width());
}

TEST(Font, VariationThatIsNotThere_IsRefusedWithThoseThatAre) {
    const std::string file = vorel_test::kVariableFont;
    const FontFile font{file};
    EXPECT_EQ(faultOf(font, {{"wdth", 100}}),
              "'" + file + "' is a font without the axis 'wdth'; it has wght 100 to 900");
    EXPECT_EQ(faultOf(font, {{"", 100}}),
              "'" + file + "' is a font without the axis ''; it has wght 100 to 900");
    EXPECT_EQ(faultOf(font, {{"wght", 950.5F}}),
              "'" + file + "' is a font without 'wght' of 950.5; it has wght 100 to 900");
    for (const float value : {99.9F, -1e30F, 1e30F, std::nanf("")})
        EXPECT_NE(faultOf(font, {{"wght", value}}), "") << value;
    EXPECT_EQ(faultOf(font, {{"wght", 900}, {"wght", 100}}), "");
    EXPECT_EQ(faultOf(FontFile{VOREL_TEST_FONT}, {{"wght", 400}}),
              "'" VOREL_TEST_FONT "' is no variable font: it has no axis 'wght'");
}

}  // namespace
}  // namespace voreltext
