#include "output_name.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdio>
#include <filesystem>
#include <string>

#include "program.h"

namespace vorelpaint {
namespace {

using vorel_test::TempDir;

TEST(OutputName, OtherKinds_AreToldByTheirEnding) {
    for (const char* path : {"a.jpg", "a.JPEG", "dir/a.Gif", "a.png.webp", "a.svg", "a.pdf", "look.json",
                             ".txt", "font.ttc", "talk.srt", "film.mov"})
        EXPECT_TRUE(namesOtherKind(path)) << path;
}

TEST(OutputName, PngAndEndingsThatSayNothing_AreTaken) {
    for (const char* path : {"a.png", "a.PNG", "a", "-", "", ".", "a.", "/dev/stdout", "/tmp/tmp.aB3dE6",
                             "v1.2", "a.png.tmp", "a.jpg/picture", "jpg", "a.jpgx", "dir.jpg/../b"})
        EXPECT_FALSE(namesOtherKind(path)) << path;
}

class Claims : public ::testing::Test {
  protected:
    std::optional<size_t> claim(const std::string& path, size_t line) {
        return mNames.claim(path, line);
    }

    TempDir mDir;
    OutputNames mNames;
};

TEST_F(Claims, OtherFiles_AreFree) {
    EXPECT_FALSE(claim(mDir.file("a.png"), 1));
    EXPECT_FALSE(claim(mDir.file("b.png"), 2));
    EXPECT_FALSE(claim(mDir.file("A.png"), 3));
    EXPECT_FALSE(claim(mDir.file("none/a.png"), 4));
    EXPECT_FALSE(claim("a.png", 5)) << "in the working directory";
}

TEST_F(Claims, EverySpellingOfAPath_IsItsFile) {
    std::filesystem::create_directory(mDir.file("below"));
    EXPECT_FALSE(claim(mDir.file("a.png"), 3));
    EXPECT_EQ(claim(mDir.file("a.png"), 5), 3U);
    EXPECT_EQ(claim(mDir.file("./a.png"), 6), 3U);
    EXPECT_EQ(claim(mDir.file("below/../a.png"), 7), 3U);
    EXPECT_EQ(claim(mDir.path().string() + "//a.png", 8), 3U);
    EXPECT_FALSE(claim("a.png", 9));
    EXPECT_EQ(claim("./a.png", 10), 9U);
    EXPECT_EQ(claim((std::filesystem::current_path() / "a.png").string(), 11), 9U);
    EXPECT_FALSE(claim("no/such/a.png", 12));
    EXPECT_EQ(claim("no/./such//a.png", 13), 12U);
}

TEST_F(Claims, Links_LeadToTheirFile) {
    std::filesystem::create_directory(mDir.file("real"));
    std::filesystem::create_directory_symlink("real", mDir.file("linked"));
    std::filesystem::create_symlink("real/a.png", mDir.file("picture.png"));
    EXPECT_FALSE(claim(mDir.file("real/a.png"), 1));
    EXPECT_EQ(claim(mDir.file("linked/a.png"), 2), 1U);
    EXPECT_EQ(claim(mDir.file("picture.png"), 3), 1U) << "whose file is not there yet";
    mDir.write("real/a.png", "");
    EXPECT_EQ(claim(mDir.file("picture.png"), 4), 1U);
    EXPECT_EQ(claim(mDir.file("linked/a.png"), 5), 1U);
}

TEST_F(Claims, LinksInACircle_AreLeftToTheWriter) {
    std::filesystem::create_symlink("circle", mDir.file("circle"));
    EXPECT_FALSE(claim(mDir.file("circle"), 1));
    EXPECT_FALSE(claim(mDir.file("circle/a.png"), 2));
}

TEST_F(Claims, OpenFiles_AreForAll) {
    const std::string path = mDir.file("open");
    std::FILE* open = std::fopen(path.c_str(), "wb");
    ASSERT_NE(open, nullptr);
    const std::string name = "/dev/fd/" + std::to_string(::fileno(open));
    EXPECT_FALSE(claim(name, 1));
    EXPECT_FALSE(claim(name, 2));
    std::fclose(open);
}

TEST_F(Claims, Devices_AreForAll) {
    EXPECT_FALSE(claim("/dev/null", 1));
    EXPECT_FALSE(claim("/dev/null", 2));
}

}  // namespace
}  // namespace vorelpaint
