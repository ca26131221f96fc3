#include "style/message.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace vorelstyle {
namespace {

TEST(Message, Printable_HasNoControlCharacters) {
    EXPECT_EQ(printable("a\nb\x1B[2J\x7F\xC3\xA9"), "a b [2J \xC3\xA9");
}

TEST(Message, Printable_SpellsWhatWouldTakeTheLineApart) {
    EXPECT_EQ(printable("\xC2\x80\xC2\x9B[2J\xC2\x9F\xC2\xA0"), "<U+0080><U+009B>[2J<U+009F>\xC2\xA0");
    EXPECT_EQ(printable("a\xE2\x80\xA8z\xE2\x80\xA9"), "a<U+2028>z<U+2029>") << "separators";
    EXPECT_EQ(printable("\xD8\x9C\xE2\x80\x8E\xE2\x80\x8F"), "<U+061C><U+200E><U+200F>") << "marks";
    EXPECT_EQ(printable("\xE2\x80\xAA\xE2\x80\xAB\xE2\x80\xAC\xE2\x80\xAD\xE2\x80\xAEgpj"),
              "<U+202A><U+202B><U+202C><U+202D><U+202E>gpj");
    EXPECT_EQ(printable("\xE2\x81\xA6\xE2\x81\xA7\xE2\x81\xA8\xE2\x81\xA9"),
              "<U+2066><U+2067><U+2068><U+2069>");
}

TEST(Message, Printable_LeavesAllOtherTextAsItIs) {
    const std::string text =
        "\xD7\x90\xD8\xA8 caf\xC3\xA9 "
        "\xE2\x80\x8B\xE2\x80\x8C\xE2\x80\x8D\xE2\x80\xA7\xE2\x80\xAF\xE2\x81\xA5"
        "\xE2\x81\xAA\xD8\x9B \xF0\x9F\x98\x80\xF4\x8F\xBF\xBF";
    EXPECT_EQ(printable(text), text);
}

TEST(Message, Printable_SpellsBytesThatAreNotUtf8) {
    EXPECT_EQ(printable("a\xFFz\x80\xC3"), "a<FF>z<80><C3>");
    EXPECT_EQ(printable("\xC0\xAF\xE0\x9F\xBF"), "<C0><AF><E0><9F><BF>") << "longer than needed";
    EXPECT_EQ(printable("\xED\xA0\x80"), "<ED><A0><80>") << "a surrogate";
    EXPECT_EQ(printable("\xC3\x1B[2J"), "<C3> [2J") << "the escape is no part of the sequence";
}

TEST(Message, Names_AreListed) {
    EXPECT_EQ(joined(std::vector<std::string>{}), "");
    EXPECT_EQ(joined(std::vector<std::string>{"left"}), "left");
    EXPECT_EQ(joined(std::vector<std::string>{"left", "center", "right"}), "left, center, right");
}

TEST(Message, FaultPrefix_IsEmptyWithoutAName) {
    EXPECT_EQ(faultPrefix("a.json"), "style 'a.json': ");
    EXPECT_EQ(faultPrefix(""), "");
}

}  // namespace
}  // namespace vorelstyle
