#include "compose/system/file_bytes.h"

#include <gtest/gtest.h>

#include "compose/error.h"
#include "tests/tool/temp_dir.h"

namespace vorelcompose {
namespace {

TEST(FileBytes, File_IsReadUpToALength) {
    const vorel_test::TempDir dir;
    const std::string path = dir.write("a", "12345");
    EXPECT_EQ(readFile(path, 5), "12345");
    EXPECT_THROW(readFile(path, 4), ComposeError);
}

TEST(FileBytes, WhatCannotBeRead_IsNamedWithTheReason) {
    try {
        readFile("/no/such", 5);
        FAIL() << "read";
    } catch (const ComposeError& error) {
        EXPECT_STREQ(error.what(), "cannot read '/no/such': No such file or directory");
    }
}

}  // namespace
}  // namespace vorelcompose
