#include "new_file.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <string>
#include <vector>

#include "error.h"
#include "program.h"

namespace vorelpaint {
namespace {

using std::filesystem::perms;
using vorel_test::readBytes;
using vorel_test::TempDir;
using Words = std::vector<std::string>;

class NewFiles : public ::testing::TestWithParam<NewFile::Kind> {
  protected:
    void SetUp() override {
        if (GetParam() == NewFile::Kind::named) return;
        const int unnamed = ::open(mDir.path().c_str(), O_TMPFILE | O_WRONLY, 0600);
        if (unnamed < 0) GTEST_SKIP() << "the file system has no unnamed files";
        ::close(unnamed);
    }

    std::string faultOf(const std::string& path) const {
        try {
            write(path);
            return "";
        } catch (const ToolError& error) {
            return error.what();
        }
    }

    /// Looks at the directory through `look` before the file has its name.
    template <typename Look>
    void write(const std::string& path, Look look) const {
        NewFile file(path, GetParam());
        EXPECT_EQ(file.kind(), GetParam());
        std::fputs("new", file.get());
        std::fflush(file.get());
        look();
        file.finish();
    }

    void write(const std::string& path) const {
        write(path, [] {});
    }

    perms permissionsOf(const std::string& path) const {
        return std::filesystem::status(path).permissions();
    }

    TempDir mDir;
};

TEST_P(NewFiles, TakeTheirNameWhenTheyAreWhole) {
    const std::string path = mDir.file("a");
    write(path, [&] { EXPECT_FALSE(std::filesystem::exists(path)); });
    EXPECT_EQ(readBytes(path), "new");
    EXPECT_EQ(mDir.list(), Words{"a"});
}

TEST_P(NewFiles, ReplaceTheOlderOneInOneStep) {
    const std::string path = mDir.write("a", "something older");
    write(path, [&] { EXPECT_EQ(readBytes(path), "something older"); });
    EXPECT_EQ(readBytes(path), "new");
    EXPECT_EQ(mDir.list(), Words{"a"});
}

TEST_P(NewFiles, ThatAreNotFinishedLeaveNothing) {
    const std::string path = mDir.write("a", "old");
    for (const std::string& target : {path, mDir.file("b")}) {
        const NewFile file(target, GetParam());
        std::fputs("ne", file.get());
    }
    EXPECT_EQ(readBytes(path), "old");
    EXPECT_EQ(mDir.list(), Words{"a"});
}

TEST_P(NewFiles, MayFindATargetThatCameMeanwhile) {
    const std::string path = mDir.file("a");
    write(path, [&] { mDir.write("a", "quicker"); });
    EXPECT_EQ(readBytes(path), "new");
    EXPECT_EQ(mDir.list(), Words{"a"});
}

TEST_P(NewFiles, ThatCannotTakeTheirNameLeaveNothing) {
    const std::string path = mDir.file("a");
    try {
        write(path, [&] { std::filesystem::create_directory(path); });
        FAIL() << "replaced a directory";
    } catch (const ToolError& error) {
        EXPECT_EQ(std::string(error.what()), "cannot write '" + path + "': Is a directory");
    }
    EXPECT_EQ(mDir.list(), Words{"a"});
}

TEST_P(NewFiles, StepOverPassingNamesThatAreTaken) {
    const std::string passing = ".vorelpaint." + std::to_string(::getpid()) + ".0";
    mDir.write(passing, "another's");
    write(mDir.write("a", "old"));
    EXPECT_EQ(readBytes(mDir.file("a")), "new");
    EXPECT_EQ(readBytes(mDir.file(passing)), "another's");
    EXPECT_EQ(mDir.list().size(), 2U);
}

TEST_P(NewFiles, KeepThePermissionsOfTheOlderOne) {
    for (const perms allowed :
         {perms::owner_read, perms::owner_read | perms::owner_write | perms::group_exec, perms::all}) {
        const std::string path = mDir.write("a", "old");
        std::filesystem::permissions(path, allowed);
        write(path);
        EXPECT_EQ(readBytes(path), "new");
        EXPECT_EQ(permissionsOf(path), allowed);
        std::filesystem::remove(path);
    }
}

TEST_P(NewFiles, HaveThePermissionsOfAnyOther) {
    for (const mode_t mask : {0022U, 0077U, 0U, 0777U}) {
        const mode_t before = ::umask(mask);
        write(mDir.file("written"));
        const std::string other = mDir.write("other", "");
        ::umask(before);
        EXPECT_EQ(permissionsOf(mDir.file("written")), permissionsOf(other)) << mask;
        std::filesystem::remove(mDir.file("written"));
        std::filesystem::remove(other);
    }
}

TEST_P(NewFiles, StandInTheWorkingDirectoryWithoutAnother) {
    const std::filesystem::path before = std::filesystem::current_path();
    std::filesystem::current_path(mDir.path());
    EXPECT_EQ(faultOf("plain"), "");
    EXPECT_EQ(faultOf("plain"), "");
    std::filesystem::current_path(before);
    EXPECT_EQ(mDir.list(), Words{"plain"});
}

TEST_P(NewFiles, NameMayBeAsLongAsTheSystemAllows) {
    const std::string name(255, 'n');
    EXPECT_EQ(faultOf(mDir.file(name)), "");
    EXPECT_EQ(faultOf(mDir.file(name)), "");
    EXPECT_EQ(mDir.list(), Words{name});
}

TEST_P(NewFiles, ThatFindNoSpaceWhenTheyAreClosedLeaveNothing) {
    const std::string path = mDir.file("a");
    EXPECT_EXIT(
        {
            try {
                write(path, vorel_test::refuseToClose);
            } catch (const ToolError& error) {
                std::fputs(error.what(), stderr);
            }
            ::_exit(0);
        },
        ::testing::ExitedWithCode(0), "cannot write '.*/a': No space left on device");
    EXPECT_TRUE(mDir.list().empty());
}

TEST_P(NewFiles, GiveNobodyTheRightsOfTheirOwner) {
    const std::string path = mDir.write("a", "old");
    ASSERT_EQ(::chmod(path.c_str(), 06755), 0);
    write(path);
    EXPECT_EQ(permissionsOf(path), perms{0755});
}

TEST_P(NewFiles, KeepTheOwnerOfTheOlderOne) {
    if (::geteuid() != 0) GTEST_SKIP() << "none but root gives files away";
    const std::string path = mDir.write("a", "old");
    ASSERT_EQ(::chown(path.c_str(), 1, 2), 0);
    ASSERT_EQ(::chmod(path.c_str(), 0640), 0);
    write(path);
    struct stat status {};
    ASSERT_EQ(::stat(path.c_str(), &status), 0);
    EXPECT_EQ(status.st_uid, 1U);
    EXPECT_EQ(status.st_gid, 2U);
    EXPECT_EQ(permissionsOf(path), perms{0640});
}

INSTANTIATE_TEST_SUITE_P(Kinds, NewFiles,
                         ::testing::Values(NewFile::Kind::unnamed, NewFile::Kind::named));

TEST(NewFile, WithoutADirectory_IsRefusedWithTheSystemsReason) {
    const TempDir dir;
    const std::string path = dir.file("none/a");
    try {
        const NewFile file(path);
        FAIL() << "made";
    } catch (const ToolError& error) {
        EXPECT_EQ(std::string(error.what()), "cannot write '" + path + "': No such file or directory");
    }
}

}  // namespace
}  // namespace vorelpaint
