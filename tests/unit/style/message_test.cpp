#include "style/message.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace vorelstyle {
namespace {

TEST(Message, Printable_HasNoControlCharacters) {
    EXPECT_EQ(printable("a\nb\x1B[2J\x7F\xC3\xA9"), "a b [2J \xC3\xA9");
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
