#include "unicode/nearest.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace vorelunicode {
namespace {

const std::vector<std::string> kNames{"size", "style", "sheet", "opacity", "outerShadow", "innerShadow"};

TEST(Nearest, Distance_CountsEdits) {
    EXPECT_EQ(editDistance("", ""), 0U);
    EXPECT_EQ(editDistance("size", "size"), 0U);
    EXPECT_EQ(editDistance("", "size"), 4U);
    EXPECT_EQ(editDistance("size", ""), 4U);
    EXPECT_EQ(editDistance("colour", "color"), 1U) << "left out";
    EXPECT_EQ(editDistance("opcity", "opacity"), 1U) << "put in";
    EXPECT_EQ(editDistance("sine", "size"), 1U) << "replaced";
    EXPECT_EQ(editDistance("szie", "size"), 1U) << "swapped";
    EXPECT_EQ(editDistance("SIZE", "size"), 0U) << "the case is nothing";
    EXPECT_EQ(editDistance("kitten", "sitting"), 3U);
    EXPECT_EQ(editDistance("ca", "abc"), 3U) << "nothing is edited twice";
}

TEST(Nearest, SameWord_IsOfEitherCase) {
    EXPECT_TRUE(isSameWord("", ""));
    EXPECT_TRUE(isSameWord("JPeg", "jpEG"));
    EXPECT_FALSE(isSameWord("jpe", "jpeg"));
    EXPECT_FALSE(isSameWord("jpeg", "jpe"));
    EXPECT_FALSE(isSameWord("@[`{", "`{@["));
}

TEST(Nearest, MisspeltName_IsFound) {
    EXPECT_EQ(nearest("szie", kNames), "size");
    EXPECT_EQ(nearest("opacty", kNames), "opacity");
    EXPECT_EQ(nearest("innershadow", kNames), "innerShadow");
    EXPECT_EQ(nearest("inner-shadow", kNames), "innerShadow");
    EXPECT_EQ(nearest("outer", kNames), "outerShadow") << "its beginning";
    EXPECT_EQ(nearest("styl", kNames), "style");
}

TEST(Nearest, OtherWords_FindNone) {
    for (const std::string word : {"", "x", "ab", "colour", "xyze", "--", "ou", "Shadow"})
        EXPECT_EQ(nearest(word, kNames), "") << word;
    EXPECT_EQ(nearest(std::string(100000, 's'), kNames), "");
    EXPECT_EQ(nearest("size", std::vector<std::string>{}), "");
}

}  // namespace
}  // namespace vorelunicode
