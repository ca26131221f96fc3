#include "text/paragraphs.h"

#include <gtest/gtest.h>

#include "unit/text/test_font.h"

namespace voreltext {
namespace {

bool goesLeft(const char* text) {
    return splitParagraphs(decodeUtf8(text)).front().isRightToLeft;
}

TEST(Paragraphs, Text_IsCutAtItsLineEnds) {
    const std::vector<Paragraph> cut = splitParagraphs(decodeUtf8("ab\r\n\rc\td\n"));
    ASSERT_EQ(cut.size(), 4U);
    EXPECT_EQ(cut[0].codes, decodeUtf8("ab"));
    EXPECT_EQ(cut[1].codes, decodeUtf8(""));
    EXPECT_EQ(cut[2].codes, decodeUtf8("c d")) << "a tab is a blank";
    EXPECT_EQ(cut[3].codes, decodeUtf8(""));
    const std::vector<size_t> begins{cut[0].begin, cut[1].begin, cut[2].begin, cut[3].begin};
    EXPECT_EQ(begins, (std::vector<size_t>{0, 4, 5, 9}));
    EXPECT_EQ(cut[3].number, 4U);
}

TEST(Paragraphs, EmptyText_IsOneOfThem) {
    const std::vector<Paragraph> cut = splitParagraphs({});
    ASSERT_EQ(cut.size(), 1U);
    EXPECT_EQ(cut[0].number, 1U);
    EXPECT_EQ(cut[0].begin, 0U);
}

TEST(Paragraphs, ControlCharacter_IsRefusedWithItsPlace) {
    EXPECT_EQ(vorel_test::faultOf([] { splitParagraphs(decodeUtf8("a\nbc\x07")); }),
              "the text has the control character U+0007 in line 2, character 3");
}

TEST(Paragraphs, FirstLetterWithADirection_Decides) {
    EXPECT_FALSE(goesLeft(""));
    EXPECT_FALSE(goesLeft("123 !"));
    EXPECT_FALSE(goesLeft("abc שלום"));
    EXPECT_TRUE(goesLeft("שלום abc"));
    EXPECT_TRUE(goesLeft("123 (بسم abc"));
    EXPECT_TRUE(goesLeft("\u200F!")) << "a mark without a glyph";
    EXPECT_FALSE(goesLeft("\u2067שלום\u2069 abc")) << "what is isolated does not count";
}

}  // namespace
}  // namespace voreltext
