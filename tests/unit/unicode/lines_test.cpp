#include "unicode/lines.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <string>
#include <vector>

namespace vorelunicode {
namespace {

TEST(Lines, Places_CountFromOne) {
    const std::vector<uint32_t> text{'a', 'b', '\n', 0x1F600, 'c'};
    EXPECT_EQ(placeName(text, 0), "line 1, character 1");
    EXPECT_EQ(placeName(text, 2), "line 1, character 3");
    EXPECT_EQ(placeName(text, 3), "line 2, character 1");
    EXPECT_EQ(placeName(text, 4), "line 2, character 2") << "code points, not bytes";
    EXPECT_EQ(placeName(text, 5), "line 2, character 3") << "behind the end";
}

TEST(Lines, EveryLineEnd_BeginsAnotherLine) {
    for (const uint32_t end : {uint32_t{'\n'}, uint32_t{'\r'}, 0x85U, 0x2028U, 0x2029U})
        EXPECT_EQ(placeName({'a', end, 'b'}, 2), "line 2, character 1") << end;
    EXPECT_EQ(placeName({'a', '\v', 'b'}, 2), "line 1, character 3");
}

TEST(Lines, CarriageReturnAndLineFeed_EndOneLine) {
    EXPECT_EQ(placeName({'a', '\r', '\n', 'b'}, 3), "line 2, character 1");
    EXPECT_EQ(placeName({'a', '\n', '\r', 'b'}, 3), "line 3, character 1");
    EXPECT_EQ(placeName({'\n', '\n', 'b'}, 2), "line 3, character 1");
    EXPECT_EQ(placeName({'\n', 'b'}, 1), "line 2, character 1");
}

}  // namespace
}  // namespace vorelunicode
