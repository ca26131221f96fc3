#include <gtest/gtest.h>
#include <sys/wait.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <csignal>
#include <cstddef>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <thread>
#include <tuple>
#include <vector>

#include "compose/system/png_reader.h"
#include "program.h"
#include "tests/support/thinned.h"

namespace vorelpaint {
namespace {

using vorel_test::Outcome;
using vorel_test::readBytes;
using vorel_test::RunningVorelpaint;
using vorel_test::runVorelpaintIn;
using vorel_test::runVorelpaintInto;
using vorel_test::Surroundings;
using vorel_test::TempDir;
using vorelcompose::readPng;
using Clock = std::chrono::steady_clock;
using Words = std::vector<std::string>;

/// Between two looks whether a program writes: short beside the writing, long beside a look.
constexpr std::chrono::microseconds kLook{200};

/// How often each signal stops each program: once, for all signals take one way, and VOREL_STOPS times
/// to look for what is rare.
int stopsAskedFor() {
    const char* asked = std::getenv("VOREL_STOPS");
    return asked != nullptr ? std::max(1, std::atoi(asked)) : 1;
}

const int kRounds = stopsAskedFor();
const int kMostRounds =
    std::max(200, 20 * kRounds);  ///< on a machine where the signal often comes too late

/// Every signal that ends a program by default and that a program can do something about, but the two
/// that are errors of writing here. Those of real time behave like the first of them.
const std::array<int, 23> kEndingSignals{SIGHUP,    SIGINT,  SIGTERM,   SIGQUIT,  SIGUSR1,     SIGUSR2,
                                         SIGALRM,   SIGXCPU, SIGPROF,   SIGIO,    SIGPWR,      SIGTRAP,
                                         SIGVTALRM, SIGABRT, SIGSTKFLT, SIGSYS,   SIGSEGV,     SIGFPE,
                                         SIGILL,    SIGBUS,  SIGRTMIN,  SIGRTMAX, SIGRTMIN + 5};

/// A picture of many bytes, which are soon painted and longer in the writing than those of others.
Words heavy(Words arguments) {
    arguments.insert(arguments.begin(),
                     {"--font", VOREL_TEST_FONT, "--size", "300", "--preset", "neon", "--png", "fast"});
    return arguments;
}

/// Small text in much room: soon painted.
Words roomy(Words arguments, const char* padding = "300") {
    arguments.insert(arguments.begin(),
                     {"--font", VOREL_TEST_FONT, "--size", "30", "--padding", padding});
    return arguments;
}

/// Runs vorelpaint over and over and stops it by one signal while it writes.
class StoppedProgram : public ::testing::TestWithParam<std::tuple<int, bool>> {
  protected:
    int signal() const { return std::get<0>(GetParam()); }
    bool unnamedFiles() const { return std::get<1>(GetParam()); }

    /// Stops what these arguments start; only whole pictures may be left, beside the older `kept`.
    void expectOnlyWholePictures(const Words& arguments, const std::string& kept = "") {
        SCOPED_TRACE(::testing::PrintToString(arguments));
        int stopped = 0;
        for (int round = 0; stopped < kRounds && round < kMostRounds; ++round) {
            if (stop(arguments)) ++stopped;
            for (const std::string& name : mDir.list()) {
                if (name == kept && readBytes(mDir.file(name)) == "older picture") continue;
                EXPECT_EQ(std::filesystem::path(name).extension(), ".png") << name;
                EXPECT_NO_THROW(readPng(mDir.file(name))) << name;
                std::filesystem::remove(mDir.file(name));
            }
        }
        EXPECT_EQ(stopped, kRounds) << "the others came too late";
    }

    TempDir mDir;
    TempDir mInputs;

  private:
    /// Whether the signal found it writing; it has ended it then.
    bool stop(const Words& arguments) {
        Surroundings surroundings;
        surroundings.unnamedFiles = unnamedFiles();
        RunningVorelpaint program(arguments, surroundings);
        const bool isCaught = freezeInWriting(program);
        if (isCaught) program.send(signal());
        program.thaw();
        const int status = program.wait();
        if (!isCaught) return false;
        EXPECT_TRUE(WIFSIGNALED(status));
        EXPECT_EQ(WTERMSIG(status), signal());
        return true;
    }

    /// A picture is written in an instant: the program is frozen as soon as it is seen to write, which
    /// may be too late for this picture, and for all.
    bool freezeInWriting(const RunningVorelpaint& program) const {
        const Clock::time_point end = Clock::now() + std::chrono::seconds(60);
        while (!program.hasEnded()) {
            if (Clock::now() > end) {
                ADD_FAILURE() << "nothing was written";
                return false;
            }
            if (!program.isWritingIn(mDir.path())) continue;
            if (program.freeze() && program.isWritingIn(mDir.path())) return true;
            program.thaw();
        }
        return false;
    }
};

TEST_P(StoppedProgram, LeavesNoHalfWrittenPicture) {
    const std::string path = mDir.file("a.png");
    expectOnlyWholePictures(heavy({"-o", path, "Grains"}));
    mDir.write("a.png", "older picture");
    expectOnlyWholePictures(heavy({"-o", path, "Grains"}), "a.png");
}

TEST_P(StoppedProgram, LeavesNoHalfWrittenSheet) {
    // A sheet has this room around each of its looks.
    expectOnlyWholePictures(roomy({"--sheet", "-o", mDir.file("a.png"), "Ag"}, "60"));
}

TEST_P(StoppedProgram, LeavesOnlyTheWholePicturesOfABatch) {
    std::string jobs;
    for (int i = 0; i < 8; ++i) {
        const std::string output = mDir.file(std::to_string(i) + ".png");
        jobs += R"({"text": "Dust", "output": ")" + output + "\"}\n";
    }
    expectOnlyWholePictures(heavy({"--batch", mInputs.write("jobs.jsonl", jobs)}));
}

/// In a build of thinned sweeps the first of them.
std::vector<int> triedSignals() {
    const auto count = static_cast<std::ptrdiff_t>(vorel_test::thinned(kEndingSignals.size()));
    return {kEndingSignals.begin(), kEndingSignals.begin() + count};
}

INSTANTIATE_TEST_SUITE_P(Signals, StoppedProgram,
                         ::testing::Combine(::testing::ValuesIn(triedSignals()), ::testing::Bool()));

class WritingProgram : public ::testing::TestWithParam<bool> {
  protected:
    Surroundings surroundings() const {
        Surroundings given;
        given.unnamedFiles = GetParam();
        return given;
    }
    TempDir mDir;
};

TEST_P(WritingProgram, GoesOnAfterTheSignalsThatAreErrorsOfWriting) {
    for (const int number : {SIGPIPE, SIGXFSZ}) {
        const std::string path = mDir.file("a.png");
        RunningVorelpaint program(roomy({"-o", path, "Grains"}), surroundings());
        while (!program.isWritingIn(mDir.path()) && !program.hasEnded())
            std::this_thread::sleep_for(kLook);
        program.send(number);
        EXPECT_EQ(program.wait(), 0);
        EXPECT_NO_THROW(readPng(path));
    }
}

TEST_P(WritingProgram, SaysThatTheFileIsTooLarge) {
    Surroundings limited = surroundings();
    limited.largestFile = 2000;
    const std::string path = mDir.file("a.png");
    const Outcome outcome = runVorelpaintIn(limited, roomy({"--preset", "chalk", "-o", path, "Grains"}));
    EXPECT_EQ(outcome.exitCode, 2);
    const std::string fault = "cannot write '" + path + "': File too large\n";
    EXPECT_EQ(outcome.err, "vorelpaint: " + fault);
    EXPECT_TRUE(mDir.list().empty());

    const TempDir inputs;
    const std::string job = R"({"text": "Grains", "output": ")" + path + "\"}\n";
    const std::string jobs = inputs.write("jobs.jsonl", job);
    const Outcome batch = runVorelpaintIn(limited, roomy({"--preset", "chalk", "--batch", jobs}));
    EXPECT_EQ(batch.exitCode, 2);
    EXPECT_EQ(batch.err, "vorelpaint: line 1: " + fault + "vorelpaint: 1 of 1 jobs failed\n");
    EXPECT_TRUE(mDir.list().empty());
}

INSTANTIATE_TEST_SUITE_P(UnnamedFiles, WritingProgram, ::testing::Bool());

TEST(ProgramOutput, NobodyReads_IsAnErrorOfWriting) {
    Surroundings surroundings;
    surroundings.closedOutput = true;
    for (const Words& arguments : {roomy({"-o", "-", "A"}), Words{"--print-key"}, Words{"--help"}}) {
        const Outcome outcome = runVorelpaintIn(surroundings, arguments);
        EXPECT_EQ(outcome.exitCode, 2);
        EXPECT_EQ(outcome.err, "vorelpaint: cannot write standard output: Broken pipe\n");
    }
    EXPECT_EQ(runVorelpaintInto("/dev/full", {"--print-key"}).err,
              "vorelpaint: cannot write standard output: No space left on device\n");
}

}  // namespace
}  // namespace vorelpaint
