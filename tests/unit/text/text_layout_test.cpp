#include "text/text_layout.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <string>

#include "text/error.h"
#include "text/utf8.h"
#include "unit/text/test_font.h"

namespace voreltext {
namespace {

class TextLayoutTest : public ::testing::Test {
  protected:
    TextLayout layOut(const std::string& text, Align align = Align::left) {
        return {mFonts, decodeUtf8(text), {align}};
    }

    Fonts mFonts{Font(FontFile{VOREL_TEST_FONT}, 64)};
};

Box rasterisedBox(const TextLayout& text, size_t glyph) {
    return text.rasterise(glyph).box;
}

size_t leftmostGlyph(const TextLayout& text) {
    size_t leftmost = 0;
    for (size_t i = 1; i < text.glyphCount(); ++i) {
        if (rasterisedBox(text, i).left < rasterisedBox(text, leftmost).left) leftmost = i;
    }
    return leftmost;
}

TEST_F(TextLayoutTest, Blanks_LeaveNoInk) {
    for (const char* text : {"", " ", "\n\n", " \t \r\n"}) {
        EXPECT_EQ(layOut(text).glyphCount(), 0U);
        EXPECT_EQ(layOut(text).inkBox().width(), 0);
    }
}

TEST_F(TextLayoutTest, InkBox_HoldsEveryGlyphExactly) {
    const TextLayout text = layOut("Quick\nfox");
    ASSERT_EQ(text.glyphCount(), 8U);
    Box box = rasterisedBox(text, 0);
    for (size_t i = 1; i < text.glyphCount(); ++i) {
        const Box glyph = rasterisedBox(text, i);
        box = {std::min(box.left, glyph.left), std::min(box.top, glyph.top),
               std::max(box.right, glyph.right), std::max(box.bottom, glyph.bottom)};
    }
    EXPECT_EQ(text.inkBox().left, box.left);
    EXPECT_EQ(text.inkBox().top, box.top);
    EXPECT_EQ(text.inkBox().right, box.right);
    EXPECT_EQ(text.inkBox().bottom, box.bottom);
}

TEST_F(TextLayoutTest, Rasterise_CoversTheInsideOfAStemFully) {
    const GlyphMask mask = layOut("I").rasterise(0);
    ASSERT_EQ(mask.coverage.size(), static_cast<size_t>(mask.box.width() * mask.box.height()));
    const auto centre =
        static_cast<size_t>(mask.box.height() / 2 * mask.box.width() + mask.box.width() / 2);
    EXPECT_EQ(mask.coverage[centre], 255);
}

TEST_F(TextLayoutTest, Lines_StandOneLineHeightApart) {
    const TextLayout text = layOut("I\nI");
    const int distance = rasterisedBox(text, 1).top - rasterisedBox(text, 0).top;
    EXPECT_NEAR(distance, static_cast<double>(mFonts.main().lineHeight()) / 64, 1.0);
}

TEST_F(TextLayoutTest, EmptyLine_KeepsItsHeight) {
    EXPECT_NEAR(layOut("I\n\nI").inkBox().height() - layOut("I\nI").inkBox().height(),
                static_cast<double>(mFonts.main().lineHeight()) / 64, 1.0);
}

TEST_F(TextLayoutTest, EveryLineEnd_StartsALine) {
    const Box expected = layOut("I\nII\n\nI").inkBox();
    for (const std::string end : {"\r", "\r\n", "\xC2\x85", "\xE2\x80\xA8", "\xE2\x80\xA9"}) {
        const TextLayout text = layOut("I" + end + "II" + end + end + "I");
        EXPECT_EQ(text.glyphCount(), 4U);
        EXPECT_EQ(text.missing().size(), 0U);
        EXPECT_EQ(text.inkBox().width(), expected.width());
        EXPECT_EQ(text.inkBox().height(), expected.height());
    }
    EXPECT_EQ(layOut("I\n\rI").inkBox().height(), layOut("I\n\nI").inkBox().height());
}

TEST_F(TextLayoutTest, OtherControlCharacters_AreRefusedWithTheirPlace) {
    const auto faultOf = [&](const std::string& text) -> std::string {
        try {
            layOut(text);
            return "";
        } catch (const TextError& error) {
            return error.what();
        }
    };
    const std::string fault = "the text has the control character ";
    EXPECT_EQ(faultOf("A\x1B[31mB"), fault + "U+001B in line 1, character 2");
    EXPECT_EQ(faultOf(std::string("A\0", 2)), fault + "U+0000 in line 1, character 2");
    EXPECT_EQ(faultOf("A\r\n\xC3\xA9\xC3\xA9\xC2\x9B"), fault + "U+009B in line 2, character 3");
    EXPECT_EQ(faultOf("\n\r\x7F"), fault + "U+007F in line 3, character 1");
    for (int code = 0; code < 0xA0; ++code) {
        if (code == 0x20) code = 0x7F;
        const bool allowed = code == '\t' || code == '\n' || code == '\r' || code == 0x85;
        const auto low = static_cast<char>(code);
        const std::string text = code < 0x80 ? "A" + std::string(1, low) : std::string("A\xC2") + low;
        EXPECT_EQ(faultOf(text).empty(), allowed) << code;
    }
}

TEST_F(TextLayoutTest, Align_MovesTheShortLine) {
    const auto shortLine = [&](Align align) { return rasterisedBox(layOut("MMMM\nM", align), 4); };
    const int left = shortLine(Align::left).left;
    const int center = shortLine(Align::center).left;
    const int right = shortLine(Align::right).left;
    EXPECT_EQ(left, rasterisedBox(layOut("M"), 0).left);
    EXPECT_EQ(right, rasterisedBox(layOut("MMMM"), 3).left) << "below the last letter of the long line";
    EXPECT_NEAR(center, (left + right) / 2.0, 1.0);
}

TEST_F(TextLayoutTest, RightToLeft_FirstLetterStandsRight) {
    const std::string alef = "\xD7\x90";
    const std::string bet = "\xD7\x91";
    const TextLayout word = layOut(alef + bet);
    ASSERT_EQ(word.glyphCount(), 2U);
    const size_t left = leftmostGlyph(word);
    EXPECT_EQ(word.rasterise(left).coverage, layOut(bet).rasterise(0).coverage);
}

TEST_F(TextLayoutTest, Arabic_LettersJoin) {
    const std::string beh = "\xD8\xA8";
    const TextLayout word = layOut(beh + beh + beh);
    const TextLayout letter = layOut(beh);
    EXPECT_EQ(word.missing().size(), 0U);
    EXPECT_LT(word.inkBox().width(), 3 * letter.inkBox().width());
    EXPECT_NE(word.rasterise(leftmostGlyph(word)).coverage, letter.rasterise(0).coverage)
        << "the final form differs from the isolated one";
}

TEST_F(TextLayoutTest, MissingCharacters_AreCounted) {
    EXPECT_EQ(layOut("A\xF0\x93\x80\x80\xF0\x93\x80\x81").missing().size(), 2U);
    EXPECT_EQ(layOut("A\tB").missing().size(), 0U) << "a tab is a blank";
}

TEST_F(TextLayoutTest, TextBeyondTheLimit_IsRefused) {
    EXPECT_THROW(layOut(std::string(2000, 'M')), TextError);
    EXPECT_THROW(layOut(std::string(2000, '\n') + "M"), TextError);
}

size_t bigEndian(const std::string& bytes, size_t at, size_t size) {
    size_t number = 0;
    for (size_t i = 0; i < size; ++i)
        number = number << 8 | static_cast<uint8_t>(bytes.at(at + i));
    return number;
}

/// The font with every kerning pair drawn together by 16 em. Without its GPOS table, that is what
/// shapes it.
std::string kernedBackwards(std::string font) {
    constexpr size_t kOffsetInRecord = 8;
    constexpr size_t kPairCount = 10;
    constexpr size_t kFirstPair = 18;
    constexpr size_t kPairSize = 6;
    constexpr size_t kValueInPair = 4;
    font.replace(font.find("GPOS"), 4, "GPOR");
    const size_t table = bigEndian(font, font.find("kern") + kOffsetInRecord, 4);
    const size_t pairs = bigEndian(font, table + kPairCount, 2);
    for (size_t i = 0; i < pairs; ++i) {
        font.replace(table + kFirstPair + i * kPairSize + kValueInPair, 2, std::string("\x80\0", 2));
    }
    return font;
}

TEST_F(TextLayoutTest, FontThatStepsBackwards_IsHeldToTheLimitToo) {
    const std::string bytes = kernedBackwards(vorel_test::testFontBytes());
    Fonts fonts{Font(FontBytes{reinterpret_cast<const uint8_t*>(bytes.data()), bytes.size()}, 64)};
    const auto layOutPairs = [&](int count) {
        std::string text;
        for (int i = 0; i < count; ++i)
            text += "AV";
        return TextLayout(fonts, decodeUtf8(text));
    };
    EXPECT_LT(layOutPairs(1).inkBox().left, -900) << "the second letter stands 1024 pixels back";
    EXPECT_THROW(layOutPairs(20), TextError);
}

}  // namespace
}  // namespace voreltext
