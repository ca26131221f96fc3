#include <gtest/gtest.h>

#include "compose/system/mark_of.h"
#include "tests/tool/temp_dir.h"

namespace vorelcompose {
namespace {

TEST(FileMark, FileThatHasJustChanged_IsNotTheSameAsItself) {
    const vorel_test::TempDir dir;
    const std::string path = dir.write("a", "1");
    EXPECT_FALSE(markOf(path) == markOf(path));
}

TEST(FileMark, OldFile_IsTheSameAsItselfAlone) {
    EXPECT_TRUE(markOf(VOREL_TEST_FONT) == markOf(VOREL_TEST_FONT));
    EXPECT_FALSE(markOf(VOREL_TEST_FONT) == markOf("/"));
    EXPECT_FALSE(markOf(VOREL_TEST_FONT) == markOf("/no/such/file"));
}

}  // namespace
}  // namespace vorelcompose
