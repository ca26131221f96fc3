#include "file_io.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdio>
#include <filesystem>
#include <string>
#include <vector>

#include "compose/error.h"
#include "error.h"
#include "program.h"

namespace vorelpaint {
namespace {

using vorel_test::readBytes;
using vorel_test::TempDir;

void writeNew(std::FILE* file) {
    std::fputs("new", file);
}

void writeHalfAndFail(std::FILE* file) {
    std::fputs("ne", file);
    throw ToolError("the pen broke");
}

TEST(FileIo, WriteFile_ReplacesTheOldFile) {
    const TempDir dir;
    const std::string path = dir.write("a", "something older");
    writeFile(path, writeNew);
    EXPECT_EQ(readBytes(path), "new");
    EXPECT_EQ(dir.list(), std::vector<std::string>{"a"});
}

TEST(FileIo, WriteFile_FailureLeavesTheOldFileAndNothingElse) {
    const TempDir dir;
    const std::string path = dir.write("a", "old");
    EXPECT_THROW(writeFile(path, writeHalfAndFail), ToolError);
    EXPECT_THROW(writeFile(dir.file("b"), writeHalfAndFail), ToolError);
    EXPECT_EQ(readBytes(path), "old");
    EXPECT_EQ(dir.list(), std::vector<std::string>{"a"});
}

TEST(FileIo, WriteFile_ThroughALinkReplacesItsTarget) {
    const TempDir dir;
    const std::string target = dir.write("target", "old");
    std::filesystem::create_symlink(target, dir.file("link"));
    writeFile(dir.file("link"), writeNew);
    EXPECT_EQ(readBytes(target), "new");
    EXPECT_TRUE(std::filesystem::is_symlink(dir.file("link")));
}

TEST(FileIo, WriteFile_ThroughADanglingLinkMakesItsTarget) {
    const TempDir dir;
    std::filesystem::create_directory(dir.file("below"));
    std::filesystem::create_symlink("below/second", dir.file("first"));
    std::filesystem::create_symlink("target", dir.file("below/second"));
    writeFile(dir.file("first"), writeNew);
    EXPECT_EQ(readBytes(dir.file("below/target")), "new");
    EXPECT_TRUE(std::filesystem::is_symlink(dir.file("first")));
    EXPECT_TRUE(std::filesystem::is_symlink(dir.file("below/second")));
}

TEST(FileIo, WriteFile_ThroughALinkIntoNoDirectoryIsRefused) {
    const TempDir dir;
    std::filesystem::create_symlink("none/target", dir.file("link"));
    EXPECT_THROW(writeFile(dir.file("link"), writeNew), ToolError);
    EXPECT_TRUE(std::filesystem::is_symlink(dir.file("link")));
    EXPECT_EQ(dir.list(), std::vector<std::string>{"link"});
}

TEST(FileIo, WriteFile_ThroughLinksInACircleIsRefused) {
    const TempDir dir;
    std::filesystem::create_symlink("b", dir.file("a"));
    std::filesystem::create_symlink("a", dir.file("b"));
    EXPECT_THROW(writeFile(dir.file("a"), writeNew), ToolError);
    EXPECT_EQ(dir.list(), (std::vector<std::string>{"a", "b"}));
}

TEST(FileIo, WriteFile_KeepsThePermissionsOfTheOldFile) {
    using std::filesystem::perms;
    const TempDir dir;
    const std::string path = dir.write("private", "old");
    std::filesystem::permissions(path, perms::owner_read | perms::owner_write);
    writeFile(path, writeNew);
    EXPECT_EQ(std::filesystem::status(path).permissions(), perms::owner_read | perms::owner_write);
}

TEST(FileIo, WriteFile_NewFileHasThePermissionsOfAnyOther) {
    const TempDir dir;
    writeFile(dir.file("written"), writeNew);
    const std::string other = dir.write("other", "");
    EXPECT_EQ(std::filesystem::status(dir.file("written")).permissions(),
              std::filesystem::status(other).permissions());
}

TEST(FileIo, WriteFile_NameMayBeAsLongAsTheSystemAllows) {
    const TempDir dir;
    const std::string name(250, 'n');
    writeFile(dir.file(name), writeNew);
    EXPECT_EQ(dir.list(), std::vector<std::string>{name});
}

TEST(FileIo, WriteFile_DeviceWithoutSpaceIsReported) {
    try {
        writeFile("/dev/full", writeNew);
        FAIL() << "written";
    } catch (const ToolError& error) {
        EXPECT_STREQ(error.what(), "cannot write '/dev/full': No space left on device");
    }
}

TEST(FileIo, WriteFile_NameOfAnOpenFileGoesOnInIt) {
    const TempDir dir;
    const std::string path = dir.file("open");
    std::FILE* open = std::fopen(path.c_str(), "wb");
    ASSERT_NE(open, nullptr);
    std::fputs("begun, ", open);
    std::fflush(open);
    const std::string number = std::to_string(::fileno(open));
    writeFile("/dev/fd/" + number, writeNew);
    std::filesystem::create_symlink("/proc/self/fd/" + number, dir.file("link"));
    writeFile(dir.file("link"), writeNew);
    EXPECT_EQ(readBytes(path), "begun, newnew");
    std::filesystem::remove(path);
    writeFile("/dev/fd/" + number, writeNew);
    EXPECT_EQ(::lseek(::fileno(open), 0, SEEK_CUR), 7 + 3 * 3) << "it has no name any more";
    std::fclose(open);
    EXPECT_EQ(dir.list(), std::vector<std::string>{"link"});
    EXPECT_THROW(writeFile("/dev/fd/" + number, writeNew), ToolError) << "it is closed";
}

TEST(FileIo, StandardOutput_HasMoreNamesThanOne) {
    const TempDir dir;
    std::filesystem::create_symlink("/dev/stdout", dir.file("link"));
    for (const std::string& name :
         {std::string("-"), std::string("/dev/stdout"), std::string("/dev/fd/1"), dir.file("link")})
        EXPECT_TRUE(isStandardOutput(name)) << name;
    for (const char* name :
         {"", "a", "1", "/dev/fd/2", "/dev/fd/1x", "/dev/fd", "/dev/null", "/dev/fd/"})
        EXPECT_FALSE(isStandardOutput(name)) << name;
}

TEST(FileIo, ReadFile_StopsAtTheLimit) {
    const TempDir dir;
    const std::string path = dir.write("a", "12345");
    EXPECT_EQ(readFileOrInput(path, 5), "12345");
    EXPECT_THROW(readFileOrInput(path, 4), vorelcompose::ComposeError);
    EXPECT_THROW(readFileOrInput("/dev/zero", 1000), vorelcompose::ComposeError);
}

TEST(FileIo, ReadFile_RefusesWhatIsNoFile) {
    const TempDir dir;
    EXPECT_THROW(readFileOrInput(dir.path().string(), 10), vorelcompose::ComposeError);
    EXPECT_THROW(readFileOrInput(dir.file("none"), 10), vorelcompose::ComposeError);
}

}  // namespace
}  // namespace vorelpaint
