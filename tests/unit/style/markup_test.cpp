#include "style/markup.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <iterator>
#include <random>
#include <string>
#include <string_view>
#include <vector>

#include "style/error.h"

namespace vorelstyle {
namespace {

std::vector<uint32_t> codes(std::string_view ascii) {
    return {ascii.begin(), ascii.end()};
}

std::string ascii(const std::vector<uint32_t>& text) {
    return {text.begin(), text.end()};
}

std::string faultOf(const std::vector<uint32_t>& text) {
    try {
        parseMarkup(text);
    } catch (const StyleError& error) {
        return error.what();
    }
    return "none";
}

std::string faultOf(std::string_view text) {
    return faultOf(codes(text));
}

/// "2-5 ff8800, 7-8 00ff00"
std::string spelled(const std::vector<ColourRange>& ranges) {
    std::string text;
    for (const ColourRange& range : ranges) {
        char each[64];
        std::snprintf(each, sizeof each, "%zu-%zu %06x", range.begin, range.end, range.colour);
        text += (text.empty() ? "" : ", ") + std::string(each);
    }
    return text;
}

TEST(Markup, TextWithoutTags_IsTheText) {
    const MarkedText marked = parseMarkup(codes("a > b\nc"));
    EXPECT_EQ(ascii(marked.text), "a > b\nc");
    EXPECT_TRUE(marked.colours.empty());
    EXPECT_TRUE(parseMarkup({}).text.empty());
}

TEST(Markup, Places_AreThoseOfTheWrittenText) {
    EXPECT_EQ(parseMarkup(codes("a<c #f80>b&lt;c</c>d")).places,
              (std::vector<size_t>{0, 9, 10, 14, 19}));
}

TEST(Markup, ControlCharacters_AreRefusedWhereTheyAreWritten) {
    EXPECT_EQ(faultOf("<c #f80>a</c>\r\n<c #f80>\tb\033</c>"),
              "markup, line 2, character 11: the control character U+001B");
    EXPECT_EQ(faultOf({'a', 0x85, '\t', 0x2028, '\n', 'b', 0x9F}),
              "markup, line 4, character 2: the control character U+009F");
}

TEST(Markup, Tag_ColoursWhatItEncloses) {
    const MarkedText marked = parseMarkup(codes("so <c #f80>hot</c> it <c #123456>is</c>"));
    EXPECT_EQ(ascii(marked.text), "so hot it is");
    EXPECT_EQ(spelled(marked.colours), "3-6 ff8800, 10-12 123456");
}

TEST(Markup, InnermostColourCounts) {
    const MarkedText marked = parseMarkup(codes("<c #111>a<c #222>b<c #333></c>c</c>d</c>"));
    EXPECT_EQ(ascii(marked.text), "abcd");
    EXPECT_EQ(spelled(marked.colours), "0-1 111111, 1-3 222222, 3-4 111111");
}

TEST(Markup, NeighboursOfOneColour_AreOneRange) {
    const MarkedText marked = parseMarkup(codes("<c #abc>a</c><c #aabbcc>b</c>"));
    EXPECT_EQ(spelled(marked.colours), "0-2 aabbcc");
}

TEST(Markup, RangesCountCodePoints) {
    const MarkedText marked =
        parseMarkup({0x1F600, '<', 'c', ' ', '#', 'f', '0', '0', '>', 0x3042, '<', '/', 'c', '>'});
    EXPECT_EQ(marked.text, (std::vector<uint32_t>{0x1F600, 0x3042}));
    EXPECT_EQ(spelled(marked.colours), "1-2 ff0000");
}

TEST(Markup, Entities_AreTheirCharacters) {
    EXPECT_EQ(ascii(parseMarkup(codes("&lt;c&gt; &amp;lt; R&amp;B")).text), "<c> &lt; R&B");
}

TEST(Markup, BlanksAroundTheColour_AreReadPast) {
    EXPECT_EQ(spelled(parseMarkup(codes("<c   #f80 >x</c>")).colours), "0-1 ff8800");
}

TEST(Markup, Fault_NamesItsPlace) {
    constexpr const char* kNoTag =
        ": < begins no tag; tags are <c #RRGGBB> and </c>, and < itself is written &lt;";
    constexpr const char* kNoColour = ": the tag has no colour; write <c #RRGGBB> or <c #RGB>";
    constexpr const char* kNoEntity =
        ": & begins neither &lt; nor &gt; nor &amp;; & itself is written &amp;";
    EXPECT_EQ(faultOf("a\nb <c #f80>c"),
              "markup, line 2, character 3: the tag does not close; </c> is missing");
    EXPECT_EQ(faultOf("a\r\n</c>"), "markup, line 2, character 1: </c> closes nothing");
    EXPECT_EQ(faultOf("1 < 2"), "markup, line 1, character 3" + std::string(kNoTag));
    EXPECT_EQ(faultOf("<C #f80>x</c>"), "markup, line 1, character 1" + std::string(kNoTag));
    EXPECT_EQ(faultOf("<c>x</c>"), "markup, line 1, character 1" + std::string(kNoTag));
    EXPECT_EQ(faultOf("\n\n<c red>x</c>"), "markup, line 3, character 1" + std::string(kNoColour));
    EXPECT_EQ(faultOf("<c >x</c>"), "markup, line 1, character 1" + std::string(kNoColour));
    EXPECT_EQ(faultOf("<c #f80"), "markup, line 1, character 1" + std::string(kNoColour));
    EXPECT_EQ(faultOf({'<', 'c', ' ', 0x3042, '>'}),
              "markup, line 1, character 1" + std::string(kNoColour));
    EXPECT_EQ(faultOf("AT&T"), "markup, line 1, character 3" + std::string(kNoEntity));
    EXPECT_EQ(faultOf("x &nbsp;"), "markup, line 1, character 3" + std::string(kNoEntity));
    EXPECT_EQ(faultOf("&"), "markup, line 1, character 1" + std::string(kNoEntity));
    EXPECT_EQ(faultOf("<"), "markup, line 1, character 1" + std::string(kNoTag));
}

/// Any text with its < and & written as entities, and tags put around random parts, is that text with
/// these colours.
TEST(Markup, WrittenText_IsReadBack) {
    std::mt19937 random(20261);
    for (int round = 0; round < 2000; ++round) {
        std::vector<uint32_t> text;
        std::vector<uint32_t> written;
        std::vector<size_t> places;
        std::vector<int> wanted;  // the colour of each character, -1 for none
        std::vector<int> open;
        const auto append = [&](const std::string& part) {
            written.insert(written.end(), part.begin(), part.end());
        };
        const size_t steps = random() % 24;
        for (size_t i = 0; i < steps; ++i) {
            if (random() % 4 == 0) {
                open.push_back(static_cast<int>(random() % 3) * 0x11);
                char tag[32];
                std::snprintf(tag, sizeof tag, "<c #%06x>", static_cast<unsigned int>(open.back()));
                append(tag);
            } else if (!open.empty() && random() % 3 == 0) {
                open.pop_back();
                append("</c>");
            } else {
                constexpr uint32_t kCharacters[]{'<', '>', '&', ';', 'c', '#', '\n', 0x5D0, 0x1F600};
                text.push_back(kCharacters[random() % std::size(kCharacters)]);
                places.push_back(written.size());
                wanted.push_back(open.empty() ? -1 : open.back());
                if (text.back() == '<') {
                    append("&lt;");
                } else if (text.back() == '&') {
                    append("&amp;");
                } else {
                    written.push_back(text.back());
                }
            }
        }
        for (; !open.empty(); open.pop_back())
            append("</c>");
        const MarkedText marked = parseMarkup(written);
        ASSERT_EQ(marked.text, text) << "round " << round;
        ASSERT_EQ(marked.places, places) << "round " << round;
        std::vector<int> colours(text.size(), -1);
        size_t before = 0;
        for (const ColourRange& range : marked.colours) {
            ASSERT_LT(range.begin, range.end);
            ASSERT_LE(before, range.begin);
            ASSERT_LE(range.end, text.size());
            std::fill(colours.begin() + static_cast<std::ptrdiff_t>(range.begin),
                      colours.begin() + static_cast<std::ptrdiff_t>(range.end),
                      static_cast<int>(range.colour));
            before = range.end;
        }
        ASSERT_EQ(colours, wanted) << "round " << round;
    }
}

}  // namespace
}  // namespace vorelstyle
