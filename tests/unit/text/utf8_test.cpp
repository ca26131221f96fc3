#include "text/utf8.h"

#include <gtest/gtest.h>

#include <string>

#include "text/error.h"

namespace voreltext {
namespace {

std::string faultOf(const std::string& text) {
    try {
        decodeUtf8(text);
        return "";
    } catch (const TextError& error) {
        return error.what();
    }
}

TEST(Utf8, EveryLength_IsDecoded) {
    const std::vector<uint32_t> expected{0x41, 0xE9, 0x20AC, 0x1F600};
    EXPECT_EQ(decodeUtf8("A\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80"), expected);
}

TEST(Utf8, LimitsOfEachLength_AreDecoded) {
    const std::vector<uint32_t> expected{0x7F, 0x80, 0x7FF, 0x800, 0xFFFF, 0x10000, 0x10FFFF};
    EXPECT_EQ(decodeUtf8("\x7F\xC2\x80\xDF\xBF\xE0\xA0\x80\xEF\xBF\xBF\xF0\x90\x80\x80\xF4\x8F\xBF\xBF"),
              expected);
}

TEST(Utf8, Faults_NameTheByte) {
    const std::string at3 = "the text is not valid UTF-8 at byte 3";
    EXPECT_EQ(faultOf("ab\xFF"), at3);
    EXPECT_EQ(faultOf("ab\x80"), at3) << "a continuation alone";
    EXPECT_EQ(faultOf("ab\xE2\x82"), at3) << "cut short";
    EXPECT_EQ(faultOf("ab\xC3z"), at3) << "no continuation";
    EXPECT_EQ(faultOf("ab\xC1\xBF"), at3) << "longer than needed";
    EXPECT_EQ(faultOf("ab\xE0\x9F\xBF"), at3) << "longer than needed";
    EXPECT_EQ(faultOf("ab\xED\xA0\x80"), at3) << "a surrogate";
    EXPECT_EQ(faultOf("ab\xF4\x90\x80\x80"), at3) << "beyond the last code point";
}

}  // namespace
}  // namespace voreltext
