#include "text/text_layout.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <string>

#include "text/error.h"
#include "text/utf8.h"
#include "unit/text/made_font.h"
#include "unit/text/test_font.h"

namespace voreltext {
namespace {

using vorel_test::edges;
using vorel_test::letters;
using vorel_test::MadeFont;
using vorel_test::openMade;

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

/// A layout in the made letters, which are 10 pixels wide, their blanks and hyphens 5, lines 16 high.
class MadeLayoutTest : public ::testing::Test {
  protected:
    TextLayout layOut(const std::string& text, const TextSettings& settings = {}) {
        return {mFonts, decodeUtf8(text), settings};
    }

    /// The lines of a text as it is wrapped, as the parts of the text that they have.
    std::vector<std::string> wrapped(const std::string& text, int width, int64_t spacing = 0) {
        TextSettings settings;
        settings.wrapWidth = width;
        settings.letterSpacing = spacing;
        const TextLayout layout = layOut(text, settings);
        std::vector<std::string> lines;
        for (const Line& line : layout.lines())
            lines.push_back(text.substr(line.begin, line.end - line.begin));
        return lines;
    }

    std::string faultOf(const std::string& text, const TextSettings& settings) {
        return vorel_test::faultOf([&] { layOut(text, settings); });
    }

    Fonts mFonts{openMade(letters())};
};

using Lines = std::vector<std::string>;

TextSettings spacedBy(int64_t units) {
    TextSettings settings;
    settings.letterSpacing = units;
    return settings;
}

TextSettings wrappedAt(int width) {
    TextSettings settings;
    settings.wrapWidth = width;
    return settings;
}

TEST_F(MadeLayoutTest, Glyphs_TellWhereTheyStandAndWhatTheyAre) {
    const TextLayout text = layOut("ab cd\nB");
    ASSERT_EQ(text.glyphCount(), 5U);
    const Glyph& d = text.glyph(3);
    EXPECT_EQ(edges(d.box), (std::vector<int>{36, -8, 44, 0}));
    EXPECT_EQ(d.line, 0U);
    EXPECT_EQ(d.word, 1U);
    EXPECT_EQ(d.cluster, 4U);
    EXPECT_EQ(d.font, 0U);
    EXPECT_FALSE(d.isPicture);
    const Glyph& last = text.glyph(4);
    EXPECT_EQ(edges(last.box), (std::vector<int>{1, 4, 9, 16})) << "16 lower, 12 high";
    EXPECT_EQ(last.line, 1U);
    EXPECT_EQ(last.word, 2U);
    EXPECT_EQ(last.cluster, 6U);
    for (size_t i = 0; i < text.glyphCount(); ++i)
        EXPECT_EQ(edges(text.glyph(i).box), edges(text.rasterise(i).box));
}

TEST_F(MadeLayoutTest, Lines_TellTheirBoxesAndTheirText) {
    const TextLayout text = layOut("ab\r\n\nAb c");
    ASSERT_EQ(text.lines().size(), 3U);
    const Line& first = text.lines()[0];
    EXPECT_EQ(first.baseline, 0);
    EXPECT_EQ(edges(first.box), (std::vector<int>{0, -12, 20, 4}));
    EXPECT_EQ(edges(first.ink), (std::vector<int>{1, -8, 19, 0}));
    const Line& empty = text.lines()[1];
    EXPECT_EQ(empty.baseline, 16);
    EXPECT_EQ(edges(empty.box), (std::vector<int>{0, 4, 0, 20}));
    EXPECT_TRUE(empty.ink.isEmpty());
    const Line& last = text.lines()[2];
    EXPECT_EQ(edges(last.ink), (std::vector<int>{1, 20, 34, 32}));
    EXPECT_EQ(edges(text.lineBox()), (std::vector<int>{0, -12, 35, 36}));
    EXPECT_EQ(edges(text.inkBox()), (std::vector<int>{1, -8, 34, 32}));
    const std::vector<size_t> parts{first.begin, first.end,  empty.begin,
                                    empty.end,   last.begin, last.end};
    EXPECT_EQ(parts, (std::vector<size_t>{0, 2, 4, 4, 5, 9}));
}

TEST_F(MadeLayoutTest, EmptyText_HasOneLine) {
    const TextLayout text = layOut("");
    ASSERT_EQ(text.lines().size(), 1U);
    EXPECT_EQ(edges(text.lineBox()), (std::vector<int>{0, -12, 0, 4}));
    EXPECT_TRUE(text.inkBox().isEmpty());
}

TEST_F(MadeLayoutTest, LineHeight_StandsHalfAboveAndHalfBelow) {
    TextSettings settings;
    settings.lineHeight = 1.5F;
    const TextLayout wide = layOut("a\na", settings);
    EXPECT_EQ(wide.lines()[1].baseline, 24);
    EXPECT_EQ(edges(wide.lines()[0].box), (std::vector<int>{0, -16, 10, 8}));
    EXPECT_EQ(edges(wide.lines()[1].box), (std::vector<int>{0, 8, 10, 32})) << "without a gap";
    settings.lineHeight = 0.53F;  // 8.48 pixels
    const TextLayout narrow = layOut("a\na", settings);
    EXPECT_EQ(narrow.lines()[1].baseline, 8);
    EXPECT_EQ(edges(narrow.lines()[0].box), (std::vector<int>{0, -8, 10, 0}));
    settings.lineHeight = 0;
    EXPECT_EQ(layOut("a\na", settings).lines()[1].baseline, 1) << "one pixel at least";
}

TEST_F(MadeLayoutTest, LineHeightWithAnOddRest_IsOneMoreBelow) {
    TextSettings settings;
    settings.lineHeight = 1.1875F;  // 19 pixels, 3 more than the letters have
    EXPECT_EQ(edges(layOut("a", settings).lines()[0].box), (std::vector<int>{0, -13, 10, 6}));
}

TEST_F(MadeLayoutTest, LetterSpacing_IsAddedBetweenLetters) {
    const TextLayout text = layOut("aaa", spacedBy(2 * 64));
    EXPECT_EQ(edges(text.glyph(0).box), (std::vector<int>{1, -8, 9, 0}));
    EXPECT_EQ(edges(text.glyph(1).box), (std::vector<int>{13, -8, 21, 0}));
    EXPECT_EQ(edges(text.glyph(2).box), (std::vector<int>{25, -8, 33, 0}));
    EXPECT_EQ(text.lines()[0].box.width(), 34) << "three letters, two gaps";
    EXPECT_EQ(layOut("aaa", spacedBy(-4 * 64)).lines()[0].box.width(), 22);
    EXPECT_EQ(layOut("a", spacedBy(2 * 64)).lines()[0].box.width(), 10);
    EXPECT_EQ(layOut("a a", spacedBy(2 * 64)).lines()[0].box.width(), 29);
}

TEST_F(MadeLayoutTest, SpacingBackBeyondTheLetters_LeavesNoWidth) {
    const TextLayout text = layOut("aaa", spacedBy(-20 * 64));
    EXPECT_EQ(text.glyph(2).box.left, -19);
    EXPECT_EQ(edges(text.lines()[0].box), (std::vector<int>{0, -12, 0, 4}));
}

TEST_F(MadeLayoutTest, SpacingBeyondTheLimit_IsRefused) {
    EXPECT_NE(faultOf("aaa", spacedBy(16384 * 64)), "");
    EXPECT_NE(faultOf("aaa", spacedBy(16384 * 64 + 1)), "");
}

TEST_F(MadeLayoutTest, Align_MovesLinesWithinTheWidest) {
    const auto leftOf = [&](Align align) { return layOut("aaaa\na", {align}).lines()[1].box.left; };
    EXPECT_EQ(leftOf(Align::left), 0);
    EXPECT_EQ(leftOf(Align::center), 15);
    EXPECT_EQ(leftOf(Align::right), 30);
    EXPECT_EQ(leftOf(Align::start), 0);
    EXPECT_EQ(leftOf(Align::end), 30);
}

TEST_F(TextLayoutTest, StartAndEnd_GoByTheDirectionOfTheSourceLine) {
    for (const Align align : {Align::start, Align::end}) {
        const TextLayout text = layOut("abc defghi jkl\nab\nשם 12\n12", align);
        const std::vector<Line>& lines = text.lines();
        EXPECT_FALSE(lines[1].isRightToLeft);
        EXPECT_TRUE(lines[2].isRightToLeft);
        EXPECT_FALSE(lines[3].isRightToLeft);
        const int width = lines[0].box.right;
        EXPECT_EQ(lines[1].box.left == 0, align == Align::start);
        EXPECT_EQ(lines[1].box.right == width, align == Align::end);
        EXPECT_EQ(lines[2].box.left == 0, align == Align::end);
        EXPECT_EQ(lines[2].box.right == width, align == Align::start);
    }
}

TEST_F(TextLayoutTest, LineBoxes_AreTheSameForEveryText) {
    const Box expected = layOut("ace").lineBox();
    for (const char* text : {"Apg", "-", "", " ", "ש", "Ế"}) {
        const Box box = layOut(text).lineBox();
        EXPECT_EQ(box.top, expected.top) << text;
        EXPECT_EQ(box.bottom, expected.bottom) << text;
    }
    EXPECT_EQ(expected.height() * 64, mFonts.main().lineHeight());
}

TEST_F(MadeLayoutTest, LineBoxes_AreThoseOfTheMainFontAlone) {
    MadeFont tall = letters();
    tall.ascender = 2000;
    tall.glyphs.push_back({'1', 640, vorel_test::Rectangle{0, 0, 640, 1900}});
    mFonts.add(openMade(tall));
    const TextLayout text = layOut("a1");
    EXPECT_EQ(text.glyph(1).font, 1U);
    EXPECT_EQ(text.glyph(1).box.bottom, 0) << "the same baseline";
    EXPECT_EQ(edges(text.lines()[0].box), (std::vector<int>{0, -12, 20, 4}));
}

TEST_F(MadeLayoutTest, Wrapping_EndsLinesBehindBlanks) {
    EXPECT_EQ(wrapped("ab cd ef", 45), (Lines{"ab cd ", "ef"})) << "20 + 5 + 20 pixels";
    EXPECT_EQ(wrapped("ab cd ef", 44), (Lines{"ab ", "cd ", "ef"}));
    EXPECT_EQ(wrapped("ab cd ef", 1000), Lines{"ab cd ef"});
    EXPECT_EQ(wrapped("ab   cd", 20), (Lines{"ab   ", "cd"})) << "blanks at the end do not count";
    EXPECT_EQ(wrapped("ab  ", 20), Lines{"ab  "});
}

TEST_F(MadeLayoutTest, WrappedLines_AreAsWideAsTheirWords) {
    TextSettings settings = wrappedAt(60);
    settings.align = Align::right;
    const TextLayout text = layOut("ab cd  ef\ngh  ", settings);
    ASSERT_EQ(text.lines().size(), 3U);
    EXPECT_EQ(edges(text.lines()[0].box), (std::vector<int>{0, -12, 45, 4}));
    EXPECT_EQ(edges(text.lines()[1].box), (std::vector<int>{25, 4, 45, 20}));
    EXPECT_EQ(edges(text.lines()[2].box), (std::vector<int>{25, 20, 45, 36}));
    EXPECT_EQ(text.glyph(4).cluster, 7U);
    EXPECT_EQ(text.glyph(4).word, 2U);
    EXPECT_EQ(text.glyph(4).line, 1U);
}

TEST_F(MadeLayoutTest, BlanksBeforeAWord_AreKept) {
    EXPECT_EQ(wrapped("  ab cd", 30), (Lines{"  ab ", "cd"}));
    EXPECT_EQ(layOut("  ab", wrappedAt(30)).glyph(0).box.left, 11);
}

TEST_F(MadeLayoutTest, SourceLines_AreWrappedEachByItself) {
    EXPECT_EQ(wrapped("ab cd\n\nef gh", 25), (Lines{"ab ", "cd", "", "ef ", "gh"}));
}

TEST_F(MadeLayoutTest, WordThatIsTooWide_IsBrokenBetweenClusters) {
    EXPECT_EQ(wrapped("a bcdefgh i", 30), (Lines{"a ", "bcd", "efg", "h i"}));
    EXPECT_EQ(wrapped("abc", 10), (Lines{"a", "b", "c"}));
}

TEST_F(MadeLayoutTest, ClusterThatIsTooWide_IsRefused) {
    EXPECT_EQ(faultOf("a\nb c", wrappedAt(9)),
              "U+0061 in line 1, character 1 of the text is wider than 9 pixels");
    MadeFont wide;
    wide.glyphs = {{'1', 1280, {}}};
    mFonts.add(openMade(wide));
    EXPECT_EQ(faultOf("a\nb1", wrappedAt(19)),
              "U+0031 in line 2, character 2 of the text is wider than 19 pixels");
    EXPECT_EQ(faultOf("a\nb1", wrappedAt(20)), "");
}

TEST_F(MadeLayoutTest, LetterSpacing_CountsForTheWidth) {
    EXPECT_EQ(wrapped("abc de", 34, 2 * 64), (Lines{"abc ", "de"}));
    EXPECT_EQ(wrapped("abc de", 33, 2 * 64), (Lines{"ab", "c ", "de"}));
    EXPECT_EQ(wrapped("ab cd ef", 53, 2 * 64), (Lines{"ab cd ", "ef"})) << "no gap at the end";
    EXPECT_EQ(wrapped("abc de", 40, -4 * 64), Lines{"abc de"}) << "50 + 5 - 5 * 4 is 35";
}

TEST_F(MadeLayoutTest, SoftHyphen_IsSeenWhereALineEndsWithIt) {
    const std::string word = "ab\u00ADcd";
    EXPECT_EQ(layOut(word).glyphCount(), 4U);
    EXPECT_EQ(layOut(word).lines()[0].box.width(), 40) << "elsewhere it is nothing";
    const TextLayout broken = layOut(word, wrappedAt(25));
    ASSERT_EQ(broken.lines().size(), 2U);
    EXPECT_EQ(broken.glyphCount(), 5U);
    EXPECT_EQ(edges(broken.glyph(2).box), (std::vector<int>{21, -4, 24, -3})) << "the hyphen";
    EXPECT_EQ(broken.glyph(2).cluster, 2U);
    EXPECT_EQ(broken.lines()[0].end, 3U);
    const TextLayout narrow = layOut(word, wrappedAt(24));
    EXPECT_EQ(narrow.lines()[0].end, 2U);
    EXPECT_EQ(narrow.glyphCount(), 4U) << "without room for a hyphen, the word is broken like any";
    const TextLayout last = layOut("ab\u00AD", wrappedAt(25));
    EXPECT_EQ(last.glyphCount(), 2U) << "none at the end of the text";
}

TEST_F(MadeLayoutTest, WithoutAHyphen_TheSoftOneStaysUnseen) {
    MadeFont made = letters();
    made.glyphs.erase(made.glyphs.end() - 2);
    mFonts = Fonts{openMade(made)};
    const TextLayout broken = layOut("ab\u00ADcd", wrappedAt(20));
    EXPECT_EQ(broken.lines().size(), 2U);
    EXPECT_EQ(broken.glyphCount(), 4U);
    EXPECT_TRUE(broken.missing().empty());
}

TEST_F(MadeLayoutTest, ZeroWidthSpace_AllowsABreak) {
    EXPECT_EQ(layOut("abc\u200Bdef", wrappedAt(45)).lines()[0].end, 4U);
    EXPECT_EQ(layOut("abcdef", wrappedAt(45)).lines()[0].end, 4U) << "else between any";
}

TEST_F(MadeLayoutTest, LongWord_IsNotShapedAnewForEachOfItsLines) {
    // 16 letters a line, of which the picture has room for 1024: hours, were it.
    const TextSettings narrow = wrappedAt(160);
    EXPECT_EQ(faultOf(std::string(1000000, 'a'), narrow),
              "the text would be more than 16384 pixels wide or high");
    EXPECT_EQ(layOut(std::string(16000, 'a'), narrow).lines().size(), 1000U);
}

TEST_F(MadeLayoutTest, Hyphen_IsOfTheFontOfItsWord) {
    MadeFont digits;
    for (uint32_t code = '0'; code <= '9'; ++code)
        digits.glyphs.push_back({code, 640, vorel_test::Rectangle{64, 0, 576, 512}});
    digits.glyphs.push_back({'-', 320, vorel_test::Rectangle{0, 0, 64, 64}});
    mFonts.add(openMade(digits));
    const TextLayout text = layOut("12\u00AD34", wrappedAt(25));
    ASSERT_EQ(text.glyphCount(), 5U);
    EXPECT_EQ(text.glyph(2).cluster, 2U);
    EXPECT_EQ(text.glyph(2).font, 1U);
}

TEST(LargePicture, BeyondTheLimit_IsRefused) {
    MadeFont made;
    made.pictures = vorel_test::Pictures::withoutOutlines;
    made.ppems = {1};
    made.glyphs = {{'a', 64, {}, {}, {{3, 1, 0, 1, std::vector<uint8_t>(12, 255)}}}};
    Fonts fonts{openMade(made, 5000)};
    EXPECT_EQ(TextLayout(fonts, {'a'}).glyph(0).box.width(), 15000);
    Fonts larger{openMade(made, 6000)};
    EXPECT_EQ(vorel_test::faultOf([&] { TextLayout(larger, {'a'}); }),
              "the text would be more than 16384 pixels wide or high");
}

TEST_F(MadeLayoutTest, ManySoftHyphens_AreNotTriedOneByOne) {
    // Each try shapes all of them: minutes, were they.
    std::string hyphens;
    for (int i = 0; i < 50000; ++i)
        hyphens += "\u00AD";
    const TextLayout text = layOut("ab" + hyphens + "cd", wrappedAt(20));
    ASSERT_EQ(text.lines().size(), 2U);
    EXPECT_EQ(text.lines()[0].end, 2U) << "without room for a hyphen";
}

TEST_F(TextLayoutTest, WrappedMixedDirections_AreOrderedLineByLine) {
    // Each line keeps the direction of the source line: the Hebrew words stand right of the Latin ones.
    TextSettings settings;
    settings.wrapWidth = layOut("שלום abc").lines()[0].box.width();
    const TextLayout text(mFonts, decodeUtf8("שלום abc עולם def"), settings);
    ASSERT_EQ(text.lines().size(), 2U);
    for (size_t line = 0; line < 2; ++line) {
        EXPECT_TRUE(text.lines()[line].isRightToLeft);
        EXPECT_EQ(text.lines()[line].end - text.lines()[line].begin, line == 0 ? 9U : 8U);
    }
    std::vector<size_t> clusters;
    for (size_t i = 0; i < text.glyphCount(); ++i)
        clusters.push_back(text.glyph(i).cluster);
    EXPECT_EQ(clusters, (std::vector<size_t>{5, 6, 7, 3, 2, 1, 0, 14, 15, 16, 12, 11, 10, 9}));
}

TEST_F(TextLayoutTest, LatinAmongHebrew_IsBrokenAtItsEnd) {
    // The end of the sentence is the left of its last line, also of English words.
    TextSettings settings;
    settings.wrapWidth = layOut("שלום abc").lines()[0].box.width();
    const TextLayout text(mFonts, decodeUtf8("שלום abc def"), settings);
    ASSERT_EQ(text.lines().size(), 2U);
    EXPECT_EQ(text.lines()[0].begin, 0U);
    EXPECT_EQ(text.lines()[0].end, 9U) << "abc is in the first line, though def stands left of it";
}

TEST_F(TextLayoutTest, HyphenOfALatinWord_StandsAtItsRight) {
    TextSettings settings;
    settings.wrapWidth = layOut("אב abc-").lines()[0].box.width();
    const TextLayout text(mFonts, decodeUtf8("אב abc\u00ADdef"), settings);
    ASSERT_EQ(text.lines().size(), 2U);
    std::vector<size_t> clusters;
    for (size_t i = 0; i < 6; ++i)
        clusters.push_back(text.glyph(i).cluster);
    EXPECT_EQ(clusters, (std::vector<size_t>{3, 4, 5, 6, 1, 0})) << "abc- and then the Hebrew word";
}

TEST_F(TextLayoutTest, OverriddenDirection_GoesOnInTheNextLine) {
    TextSettings settings;
    settings.wrapWidth = layOut("abc").lines()[0].box.width();
    const TextLayout text(mFonts, decodeUtf8("\u202Eabc def\u202C"), settings);
    ASSERT_EQ(text.lines().size(), 2U);
    std::vector<size_t> clusters;
    for (size_t i = 0; i < text.glyphCount(); ++i)
        clusters.push_back(text.glyph(i).cluster);
    EXPECT_EQ(clusters, (std::vector<size_t>{3, 2, 1, 7, 6, 5}));
}

TEST_F(TextLayoutTest, LetterSpacing_PartsLigatures) {
    TextSettings spaced = spacedBy(64);
    EXPECT_EQ(layOut("ffi").glyphCount(), 1U);
    EXPECT_EQ(TextLayout(mFonts, decodeUtf8("ffi"), spaced).glyphCount(), 3U);
    spaced.features = {"liga"};
    EXPECT_EQ(TextLayout(mFonts, decodeUtf8("ffi"), spaced).glyphCount(), 1U) << "asked for";
}

TEST_F(TextLayoutTest, LetterSpacing_KeepsArabicTogether) {
    const std::string word = "بسم";
    EXPECT_EQ(TextLayout(mFonts, decodeUtf8(word), spacedBy(640)).inkBox().width(),
              layOut(word).inkBox().width());
    const TextLayout hebrew(mFonts, decodeUtf8("שלום"), spacedBy(640));
    EXPECT_EQ(hebrew.lines()[0].box.width(), layOut("שלום").lines()[0].box.width() + 30);
}

TEST_F(TextLayoutTest, Features_AreThoseOfTheSettings) {
    TextSettings settings;
    settings.features = {"liga=0"};
    EXPECT_EQ(TextLayout(mFonts, decodeUtf8("ffi"), settings).glyphCount(), 3U);
    settings.features = {"nonsense"};
    EXPECT_NE(vorel_test::faultOf([&] { TextLayout(mFonts, decodeUtf8(""), settings); }), "");
}

TEST_F(TextLayoutTest, Words_AreWhatBlanksAndLineEndsSeparate) {
    const TextLayout text = layOut(" a-b  c\td\n\n\xC2\xA0\x65 \xD7\x90\xD7\x91 f");
    std::vector<size_t> words(text.glyphCount());
    for (size_t i = 0; i < text.glyphCount(); ++i)
        words[i] = text.glyph(i).word;
    // Of the last line the Hebrew word is two glyphs, from left to right.
    EXPECT_EQ(words, (std::vector<size_t>{0, 0, 0, 1, 2, 3, 4, 4, 5}));
}

TEST_F(TextLayoutTest, FontsUsed_AreNamedInTheOrderOfTheirUse) {
    mFonts.add(openMade(letters()));
    mFonts.add(Font(FontFile{vorel_test::kEmojiFont}, 64));
    EXPECT_EQ(layOut("👍🏽 a").fontsUsed(),
              (std::vector<std::string>{"Noto Color Emoji Regular", "DejaVu Sans Book"}));
    EXPECT_TRUE(layOut(" ").fontsUsed().empty());
}

TEST_F(TextLayoutTest, Pictures_StandOnTheBaselineOfTheText) {
    mFonts.add(Font(FontFile{vorel_test::kEmojiFont}, 64));
    const TextLayout text = layOut("a👍🏽");
    ASSERT_EQ(text.glyphCount(), 2U);
    EXPECT_TRUE(text.glyph(1).isPicture);
    EXPECT_EQ(text.glyph(1).font, 1U);
    const GlyphMask thumb = text.rasterise(1);
    EXPECT_EQ(edges(thumb.box), edges(text.glyph(1).box));
    EXPECT_EQ(thumb.pixels.size(), thumb.coverage.size() * 4);
    for (size_t i = 0; i < thumb.coverage.size(); ++i)
        ASSERT_EQ(thumb.pixels[i * 4 + 3], thumb.coverage[i]);
    EXPECT_TRUE(text.rasterise(0).pixels.empty());
    // The file's picture is 136 x 128 pixels at 109 to the em, 101 above the baseline: 64 / 109 of that.
    EXPECT_NEAR(thumb.box.height(), 75.2, 1.5);
    EXPECT_NEAR(-thumb.box.top, 59.3, 1.0);
}

TEST_F(TextLayoutTest, MissingCharacters_AreListedByTheirFirstAppearance) {
    const TextLayout text = layOut("A\xF0\x93\x80\x81\n\xF0\x93\x80\x80\xF0\x93\x80\x81");
    ASSERT_EQ(text.missing().size(), 2U);
    EXPECT_EQ(text.missing()[0].code, 0x13001U);
    EXPECT_EQ(text.missing()[0].count, 2U);
    EXPECT_EQ(text.missing()[0].first, 1U);
    EXPECT_EQ(text.missing()[1].code, 0x13000U);
    EXPECT_EQ(text.missing()[1].first, 3U);
}

}  // namespace
}  // namespace voreltext
