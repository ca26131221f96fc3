#include "text/line_breaks.h"

#include <gtest/gtest.h>

#include <string>

#include "text/utf8.h"

namespace voreltext {
namespace {

/// The text with a bar wherever a line may end; not at its end.
std::string barred(const std::string& text) {
    std::string result;
    const std::vector<uint32_t> codes = decodeUtf8(text);
    const std::vector<bool> breaks = lineBreaks(codes);
    EXPECT_EQ(breaks.size(), codes.size());
    size_t at = 0;
    for (size_t i = 0; i < codes.size(); ++i) {
        const size_t length = codes[i] < 0x80 ? 1 : codes[i] < 0x800 ? 2 : codes[i] < 0x10000 ? 3 : 4;
        result += text.substr(at, length);
        at += length;
        if (i + 1 < codes.size() && breaks[i]) result += '|';
    }
    return result;
}

TEST(LineBreaks, Blanks_AllowOneBehindThem) {
    EXPECT_EQ(barred("one two  three"), "one |two  |three");
    EXPECT_EQ(barred(""), "");
    EXPECT_TRUE(lineBreaks(decodeUtf8("a")).back()) << "the end of the text";
}

TEST(LineBreaks, Punctuation_StaysWithItsWord) {
    EXPECT_EQ(barred("(one) two, three!"), "(one) |two, |three!");
    EXPECT_EQ(barred("well-known 1-2"), "well-|known |1-2") << "UAX #14, LB 21 and 25";
    EXPECT_EQ(barred("$ 12,345.67 %"), "$ |12,345.67 |%");
    EXPECT_EQ(barred("a/b «one»"), "a/|b |«one»");
    EXPECT_EQ(barred("one—two"), "one|—|two") << "LB 17";
}

TEST(LineBreaks, GlueAndWordJoiner_ForbidOne) {
    EXPECT_EQ(barred("10\xC2\xA0km"), "10\xC2\xA0km");
    EXPECT_EQ(barred("a-\u2060z"), "a-\u2060z");
}

TEST(LineBreaks, SoftHyphenAndZeroWidthSpace_AllowOne) {
    EXPECT_EQ(barred("ex\u00ADtra"), "ex\u00AD|tra");
    EXPECT_EQ(barred("สวัส\u200Bดี"), "สวัส\u200B|ดี") << "Thai breaks nowhere else";
}

TEST(LineBreaks, Ideographs_AllowOneBetweenThem) {
    EXPECT_EQ(barred("日本語。"), "日|本|語。") << "a stop begins no line";
    EXPECT_EQ(barred("「日本」"), "「日|本」");
    EXPECT_EQ(barred("한국어"), "한|국|어");
    EXPECT_EQ(barred("テスト"), "テ|ス|ト");
}

TEST(LineBreaks, Pictographs_BreakBetweenEachOther) {
    EXPECT_EQ(barred("😀😀"), "😀|😀");
    EXPECT_EQ(barred("😀🫠"), "😀|🫠") << "one of Unicode 14";
    EXPECT_EQ(barred("👍🏽👍"), "👍🏽|👍") << "its tone stays with it";
    EXPECT_EQ(barred("👩\u200D👧"), "👩\u200D👧") << "what is joined stays together";
    EXPECT_EQ(barred("❤\uFE0F a"), "❤\uFE0F |a");
}

TEST(LineBreaks, AnyCharacter_IsTaken) {
    for (uint32_t code = 0x20; code <= 0x110000; ++code) {
        if (code > 0x20000 && code % 0x1001 != 0 && code < 0x10FFFF) continue;
        const std::vector<bool> breaks = lineBreaks({code, 'a', code, code});
        ASSERT_TRUE(breaks.back()) << code;
    }
}

}  // namespace
}  // namespace voreltext
