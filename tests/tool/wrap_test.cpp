#include "wrap.h"

#include <gtest/gtest.h>

namespace vorelpaint {
namespace {

TEST(Wrap, Lines_StayWithinTheWidth) {
    EXPECT_EQ(wrapped("aa bb cc dd", 5, 0), "aa bb\ncc dd");
    EXPECT_EQ(wrapped("aa bb cc dd", 7, 2), "  aa bb\n  cc dd");
}

TEST(Wrap, LongWord_HasItsOwnLine) {
    EXPECT_EQ(wrapped("a longword b", 4, 0), "a\nlongword\nb");
}

TEST(Wrap, NoWords_AreNoLines) {
    EXPECT_EQ(wrapped("", 10, 2), "");
    EXPECT_EQ(wrapped("   ", 10, 2), "");
}

}  // namespace
}  // namespace vorelpaint
