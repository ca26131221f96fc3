#include "text/shaping_items.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

#include "text/paragraphs.h"
#include "text/utf8.h"

namespace voreltext {
namespace {

/// The items of a line from left to right, or of its first `length` characters: "0-3 < 1" is from 0 to
/// 3, to the left, in font 1.
std::vector<std::string> items(const std::string& text, std::vector<size_t> fonts = {},
                               size_t length = std::string::npos) {
    const Paragraph line = splitParagraphs(decodeUtf8(text)).front();
    fonts.resize(line.codes.size());
    length = std::min(length, line.codes.size());
    std::vector<std::string> result;
    for (const ShapingItem& item : itemsOf({line.codes.data(), fonts.data(), line.scripts.data(),
                                            line.levels.data(), length, line.isRightToLeft})) {
        result.push_back(std::to_string(item.begin) + "-" + std::to_string(item.end) +
                         (item.isRightToLeft ? " < " : " > ") + std::to_string(item.font));
    }
    return result;
}

using Items = std::vector<std::string>;

TEST(ShapingItems, OneScript_IsOne) {
    EXPECT_EQ(items(""), Items{});
    EXPECT_EQ(items("ab 12"), Items{"0-5 > 0"});
    EXPECT_EQ(items("אב"), Items{"0-2 < 0"});
}

TEST(ShapingItems, ScriptsAndFonts_PartThem) {
    EXPECT_EQ(items("aγ"), (Items{"0-1 > 0", "1-2 > 0"}));
    EXPECT_EQ(items("abc", {0, 1, 1}), (Items{"0-1 > 0", "1-3 > 1"}));
}

TEST(ShapingItems, RightToLeft_StandTheOtherWayRound) {
    EXPECT_EQ(items("אבג", {0, 1, 2}), (Items{"2-3 < 2", "1-2 < 1", "0-1 < 0"}));
    EXPECT_EQ(items("aאב", {0, 0, 1}), (Items{"0-1 > 0", "2-3 < 1", "1-2 < 0"}));
    EXPECT_EQ(items("א12ב"), (Items{"3-4 < 0", "1-3 > 0", "0-1 < 0"})) << "numbers go to the right";
    EXPECT_EQ(items("אabγδב"), (Items{"5-6 < 0", "1-3 > 0", "3-5 > 0", "0-1 < 0"}));
}

TEST(ShapingItems, BlanksAtTheEnd_HaveTheLinesDirection) {
    // The blanks behind the Hebrew word stand at the right, the end of a line of English.
    EXPECT_EQ(items("aא  "), (Items{"0-1 > 0", "1-2 < 0", "2-4 > 0"}));
    EXPECT_EQ(items("aא ב"), (Items{"0-1 > 0", "1-4 < 0"}));
    EXPECT_EQ(items("aא ב", {}, 3), (Items{"0-1 > 0", "1-2 < 0", "2-3 > 0"})) << "of a part, too";
}

}  // namespace
}  // namespace voreltext
