#include "line_reader.h"

#include <gtest/gtest.h>

#include "error.h"
#include "program.h"

namespace vorelpaint {
namespace {

using vorel_test::TempDir;

TEST(LineReader, Lines_AreNumberedFromOne) {
    const TempDir dir;
    LineReader lines(dir.write("a", "one\n\nthree"));
    EXPECT_EQ(lines.next(100), "one");
    EXPECT_EQ(lines.number(), 1U);
    EXPECT_EQ(lines.next(100), "");
    EXPECT_EQ(lines.next(100), "three");
    EXPECT_EQ(lines.number(), 3U);
    EXPECT_EQ(lines.next(100), std::nullopt);
}

TEST(LineReader, LineFeedAtTheEnd_BeginsNoLine) {
    const TempDir dir;
    LineReader lines(dir.write("a", "one\n"));
    EXPECT_EQ(lines.next(100), "one");
    EXPECT_EQ(lines.next(100), std::nullopt);
}

TEST(LineReader, LongLine_IsCutAndTheNextOneIsWhole) {
    const TempDir dir;
    LineReader lines(dir.write("a", "123456789\nnext\n"));
    EXPECT_EQ(lines.next(4), "12345");
    EXPECT_EQ(lines.next(4), "next");
}

TEST(LineReader, Rewind_BeginsAnew) {
    const TempDir dir;
    LineReader lines(dir.write("a", "one\n\ntwo"));
    ASSERT_TRUE(lines.canRewind());
    for (int pass = 0; pass < 2; ++pass) {
        EXPECT_EQ(lines.next(100), "one");
        EXPECT_EQ(lines.next(100), "");
        EXPECT_EQ(lines.next(100), "two");
        EXPECT_EQ(lines.number(), 3U);
        EXPECT_EQ(lines.next(100), std::nullopt);
        lines.rewind();
    }
    EXPECT_EQ(lines.next(100), "one");
    lines.rewind();
    EXPECT_EQ(lines.next(100), "one");
    EXPECT_EQ(lines.number(), 1U);
}

TEST(LineReader, WhatIsNoFile_CannotBeReadAnew) {
    EXPECT_FALSE(LineReader("/dev/null").canRewind());
}

TEST(LineReader, WhatCannotBeRead_IsRefused) {
    const TempDir dir;
    EXPECT_THROW(LineReader(dir.file("none")), ToolError);
    LineReader directory(dir.path().string());
    EXPECT_THROW(directory.next(10), ToolError);
    LineReader endless("/dev/zero");
    EXPECT_THROW(endless.next(10), ToolError);
}

}  // namespace
}  // namespace vorelpaint
