#include "child_program.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdio>
#include <memory>
#include <string>
#include <vector>

#include "error.h"
#include "interrupt.h"
#include "program.h"

namespace vorelpaint {
namespace {

using vorel_test::readBytes;
using vorel_test::TempDir;
using Stream = ChildProgram::Stream;

constexpr size_t kPlenty = 1 << 20;

std::string faultOf(ChildProgram& program, const std::vector<std::string>& faults = {}) {
    try {
        program.finish(faults);
        return "";
    } catch (const ToolError& error) {
        return error.what();
    }
}

TEST(ChildProgram, Output_IsRead) {
    ChildProgram program({"echo", "-n", "one", "two"}, Stream::output);
    EXPECT_EQ(program.readAll(kPlenty), "one two");
    program.finish();
}

TEST(ChildProgram, Words_AreNoShellsWords) {
    const std::string odd = "$(id); `id` 'a' \"b\" *\n\\ \xFF";
    ChildProgram program({"printf", "%s|%s", odd, "-n"}, Stream::output);
    EXPECT_EQ(program.readAll(kPlenty), odd + "|-n");
    program.finish();
}

TEST(ChildProgram, Input_IsWrittenToTheGivenFile) {
    const TempDir dir;
    const std::string path = dir.file("kept");
    const std::unique_ptr<std::FILE, int (*)(std::FILE*)> file(std::fopen(path.c_str(), "wbe"),
                                                               std::fclose);
    const std::string much(3 << 20, 'x');
    ChildProgram program({"sh", "-c", "cat >&3"}, Stream::input, ::fileno(file.get()));
    EXPECT_TRUE(program.write(much.data(), much.size()));
    EXPECT_TRUE(program.write("end", 3));
    program.finish();
    EXPECT_EQ(readBytes(path), much + "end");
}

TEST(ChildProgram, InputThatIsNotReadOn_IsNoFailure) {
    cleanUpOnSignals();  // a pipe that nobody reads would end this program
    ChildProgram program({"true"}, Stream::input);
    const std::string much(1 << 20, 'x');
    bool isRead = true;
    for (int i = 0; i < 4 && isRead; ++i)
        isRead = program.write(much.data(), much.size());
    EXPECT_FALSE(isRead);
    program.finish();
}

TEST(ChildProgram, FailureIsToldWithItsFirstLine) {
    ChildProgram program(
        {"sh", "-c", "echo >&2; echo '[mov @ 0x55d3286a] no atom' >&2; echo b >&2; exit 3"},
        Stream::output);
    EXPECT_EQ(faultOf(program), "sh failed: no atom");
    ChildProgram silent({"false"}, Stream::output);
    EXPECT_EQ(faultOf(silent), "false failed: it does not say why");
    ChildProgram killed({"sh", "-c", "kill -9 $$"}, Stream::output);
    EXPECT_EQ(faultOf(killed), "sh was ended by signal 9");
}

TEST(ChildProgram, FailureThatItDoesNotEndWith_IsAmongItsLastLines) {
    const std::vector<std::string> words{
        "sh", "-c",
        "yes noise | head -n 100000 >&2; echo '[out @ 0x5] Error writing: x' >&2; echo b >&2"};
    ChildProgram program(words, Stream::output);
    EXPECT_EQ(faultOf(program, {"Error reading", "Error writing"}), "sh failed: Error writing: x");
    ChildProgram other(words, Stream::output);
    EXPECT_EQ(faultOf(other, {"writing"}), "") << "within a line it is another one's word";
}

TEST(ChildProgram, ManyComplaints_DoNotBlockIt) {
    ChildProgram program({"sh", "-c", "yes complaint | head -c 1000000 >&2; cat > /dev/null; exit 1"},
                         Stream::input);
    EXPECT_TRUE(program.write("x", 1));
    EXPECT_EQ(faultOf(program), "sh failed: complaint");
}

TEST(ChildProgram, TooMuchOutput_IsRefused) {
    ChildProgram program({"yes"}, Stream::output);
    EXPECT_THROW(program.readAll(10000), ToolError);
}

TEST(ChildProgram, NoSuchProgram_IsRefused) {
    try {
        ChildProgram program({"no-such-program"}, Stream::output);
        ADD_FAILURE() << "it was started";
    } catch (const ToolError& error) {
        EXPECT_STREQ(error.what(),
                     "there is no no-such-program: films are made by FFmpeg, which is not installed");
    }
    EXPECT_THROW(ChildProgram({"/etc/passwd"}, Stream::output), ToolError) << "not to be run";
}

TEST(ChildProgram, EndsWithItsObject) {
    const TempDir dir;
    const std::string path = dir.file("pid");
    std::string child;
    {
        ChildProgram program({"sh", "-c", "echo $$ > \"$1\"; exec cat", "sh", path}, Stream::input);
        while (child.empty() || child.back() != '\n')
            child = readBytes(path);
    }
    EXPECT_EQ(::kill(std::stoi(child), 0), -1);
}

}  // namespace
}  // namespace vorelpaint
