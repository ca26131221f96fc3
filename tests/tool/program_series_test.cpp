#include <gtest/gtest.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <csignal>
#include <filesystem>
#include <fstream>
#include <map>
#include <string>
#include <thread>
#include <vector>

#include "memory_meter.h"
#include "program.h"
#include "tests/support/thinned.h"

namespace vorelpaint {
namespace {

namespace fs = std::filesystem;

using vorel_test::Outcome;
using vorel_test::readBytes;
using vorel_test::RunningVorelpaint;
using vorel_test::runVorelpaint;
using vorel_test::runVorelpaintIn;
using vorel_test::Surroundings;
using vorel_test::TempDir;
using Words = std::vector<std::string>;
using Files = std::map<std::string, std::string>;

/// Waits for what another process does, for at most half a minute.
template <typename Condition>
bool becomesTrue(Condition condition) {
    const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(30);
    while (!condition()) {
        if (std::chrono::steady_clock::now() > end) return false;
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return true;
}

/// Batches whose jobs paint into the test's directory.
class Series : public ::testing::Test {
  protected:
    std::string job(const std::string& output, const std::string& members) const {
        return R"({"output": ")" + mDir.file(output) + R"(", )" + members + "}\n";
    }

    /// `count` jobs with looks, sizes and words of all kinds.
    std::string jobs(int count) const {
        const Words presets{"plain", "gold", "neon", "chalk"};
        std::string lines;
        for (int i = 0; i < count; ++i) {
            const std::string number = std::to_string(i);
            lines +=
                job(number + ".png", R"("text": "Line )" + std::to_string(i / 3) + R"(", "preset": ")" +
                                         presets[static_cast<size_t>(i) % presets.size()] + "\"");
        }
        return lines;
    }

    /// Lines of which some are wrong in every way, between good ones.
    std::string faultyJobs() const {
        return jobs(5) + job("size.png", R"("text": "A", "size": 0)") + "\n{oops\n" +
               job("look.png", R"("text": "A", "style": {"stroke": {"size": 2, "color": "#F00", )"
                               R"("position": "outside"}})") +
               job("missing.png", R"("text": "A\ud80c\udc00")") +
               job("font.png", R"("text": "A", "font": "/no/such/font.ttf")") +
               job("family.png", R"("text": "A", "font": "No Such Family At All")") +
               job("pattern.png", R"("text": "A", "style": {"pattern": {"image": "/no/such.png"}})") +
               job("no/such/a.png", R"("text": "A")") +
               job("cut.png", R"("text": "A", "preset": "gold", "width": 16, "height": 16)") +
               job("markup.png", R"("text": "<c #F00>A</c>b", "markup": true)") +
               job("blank.png", R"("text": " ")") + job("last.png", R"("text": "A")");
    }

    std::string batch(const std::string& lines) const { return mInputs.write("jobs.jsonl", lines); }

    Outcome run(const std::string& lines, Words arguments) const {
        arguments.insert(arguments.begin(), {"--size", "20", "--batch", batch(lines)});
        return runVorelpaint(arguments);
    }

    Files painted() const {
        Files files;
        for (const std::string& name : mDir.list())
            files[name] = readBytes(mDir.file(name));
        return files;
    }

    /// What is painted, which is removed.
    Files takePainted() {
        Files files = painted();
        for (const auto& file : files)
            fs::remove(mDir.file(file.first));
        return files;
    }

    TempDir mInputs;
    TempDir mDir;
};

TEST_F(Series, AnyNumberOfThreads_GivesTheSame) {
    const auto outcomeOf = [&](const char* jobs) {
        return run(faultyJobs(), {"--report", "json", "--jobs", jobs});
    };
    const Outcome one = outcomeOf("1");
    const Files files = takePainted();
    EXPECT_EQ(one.exitCode, 2);
    EXPECT_EQ(files.size(), 10U);
    EXPECT_EQ(std::count(one.out.begin(), one.out.end(), '\n'), 10) << one.out;
    EXPECT_NE(one.err.find("7 of 17 jobs failed"), std::string::npos) << one.err;
    for (const char* jobs : {"2", "5", "64"}) {
        const Outcome many = outcomeOf(jobs);
        EXPECT_EQ(many.exitCode, one.exitCode);
        EXPECT_EQ(many.out, one.out);
        EXPECT_EQ(many.err, one.err);
        EXPECT_EQ(takePainted(), files);
    }
}

TEST_F(Series, StrictJobs_FailAloneOnAnyNumberOfThreads) {
    const std::string lines =
        job("a.png", R"("text": "A\ud80c\udc00")") + job("b.png", R"("text": "B")");
    for (const char* jobs : {"1", "2"}) {
        const Outcome outcome = run(lines, {"--strict", "--jobs", jobs});
        EXPECT_EQ(outcome.exitCode, 2);
        EXPECT_NE(outcome.err.find("vorelpaint: line 1: no font has U+13000"), std::string::npos)
            << outcome.err;
        EXPECT_EQ(takePainted().size(), 1U);
    }
}

TEST_F(Series, Sheet_IsTheSameOnAnyNumberOfThreads) {
    const auto sheetBy = [&](const char* jobs) {
        const std::string path = mDir.file("sheet.png");
        const Outcome outcome =
            runVorelpaint({"--sheet", "--sizes", "12,30", "--jobs", jobs, "-o", path, "Ag"});
        EXPECT_EQ(outcome.exitCode, 0);
        return outcome.err + readBytes(path);
    };
    const std::string one = sheetBy("1");
    EXPECT_EQ(sheetBy("2"), one);
    EXPECT_EQ(sheetBy("5"), one);
}

TEST_F(Series, WhatCameBefore_ChangesNoPicture) {
    // Repetitions find fonts, texts and looks kept; each must be as it is alone.
    const std::string scripts =
        R"("text": "\u0e01\u0e02 \u4e00\u4e8c A")";  // their fonts are found as they are needed
    const Words members{
        scripts,
        R"("text": "\u4e00 x \u0e02")",
        R"("text": "A", "preset": "gold")",
        R"("text": "A", "preset": "gold", "size": 21)",
        R"("text": "A", "preset": "gold", "color": "#00F")",
        R"("text": "A", "preset": "gold", "opacity": 0.5)",
        R"("text": "A", "preset": "gold", "effect-scale": 2)",
        R"("text": "Av", "font-features": "kern=0")",
        R"("text": "Av")",
        R"("text": "A b c")",
        R"("text": "Av", "letter-spacing": 3)",
        R"("text": "Av", "letter-spacing": "3%")",
        R"("text": "A b c", "fit": "wrap", "width": 20, "height": 90)",
        R"("text": "A b c", "fit": "shrink", "width": 20)",
        R"("text": "A b c", "box": "line")",
        R"("text": "A\nb c", "align": "right")",
        R"("text": "A\nb c", "line-height": 2)",
        R"("text": "<c #F00>A</c>b", "markup": true, "preset": "plain")",
        R"("text": "A<c #F00>b</c>", "markup": true, "preset": "plain")",
        R"("text": "A", "style": {"stroke": {"size": 1, "color": "#F00", "position": "outside"}})",
        R"("text": "A", "style": {"stroke": {"size": 2, "color": "#F00", "position": "outside"}})"};
    std::string lines;
    for (size_t i = 0; i < members.size(); ++i) {
        lines += job("a" + std::to_string(i) + ".png", members[i]);
        lines += job("b" + std::to_string(i) + ".png", members[i]);
    }
    for (size_t i = 0; i < members.size(); ++i)
        lines += job("c" + std::to_string(i) + ".png", members[i]);
    const Outcome outcome = run(lines, {"--jobs", "1", "--report", "json"});
    EXPECT_EQ(outcome.exitCode, 0) << outcome.err;
    const Files files = takePainted();
    for (size_t i = 0; i < members.size(); ++i) {
        const std::string name = std::to_string(i) + ".png";
        const Outcome alone = run(job("alone.png", members[i]), {"--jobs", "1"});
        EXPECT_EQ(alone.exitCode, 0);
        const std::string expected = readBytes(mDir.file("alone.png"));
        for (const char* round : {"a", "b", "c"})
            EXPECT_EQ(files.at(round + name), expected) << round << " " << members[i];
    }
}

TEST_F(Series, Notes_AreGivenToEveryJobThatHasThem) {
    const std::string style = mInputs.write(
        "look.json", R"({"version": 2, "looks": [{"stroke": {"size": "100%", "color": "#F00",)"
                     R"("position": "outside"}}]})");
    std::string lines;
    for (int i = 0; i < 4; ++i)
        lines +=
            job(std::to_string(i) + ".png", R"("text": "A", "size": 200, "style": ")" + style + "\"");
    for (const char* jobs : {"1", "2"}) {
        const Outcome outcome = run(lines, {"--jobs", jobs});
        EXPECT_EQ(outcome.exitCode, 0) << outcome.err;
        EXPECT_EQ(std::count(outcome.err.begin(), outcome.err.end(), '\n'), 4) << outcome.err;
    }
}

/// Paints line by line from a pipe: each line is written when the picture of the one before is there.
class PipedSeries : public Series, public ::testing::WithParamInterface<const char*> {
  protected:
    void SetUp() override { ASSERT_EQ(::mkfifo(mFifo.c_str(), 0600), 0); }

    /// Whether the picture comes without another line.
    bool paint(std::ofstream& pipe, const std::string& name, const std::string& members) {
        pipe << job(name, members) << std::flush;
        return becomesTrue([&] { return fs::exists(mDir.file(name)); });
    }

    std::string mFifo = mInputs.file("fifo");
};

TEST_P(PipedSeries, EachLine_IsPaintedAsItComes) {
    RunningVorelpaint program({"--size", "20", "--batch", mFifo, "--jobs", GetParam()});
    std::ofstream pipe(mFifo, std::ios::binary);
    for (int i = 0; i < 3; ++i)
        EXPECT_TRUE(paint(pipe, std::to_string(i) + ".png", R"("text": "A")"));
    pipe.close();
    EXPECT_EQ(program.wait(), 0);
}

TEST_P(PipedSeries, FilesThatChangeBetweenLines_AreReadAnew) {
    const std::string style = mInputs.file("look.json");
    const std::string members = R"("text": "A", "style": ")" + style + "\"";
    RunningVorelpaint program({"--size", "20", "--batch", mFifo, "--jobs", GetParam()});
    std::ofstream pipe(mFifo, std::ios::binary);
    std::map<std::string, std::string> byColour;
    int number = 0;
    for (const std::string colour : {"#FF0000", "#00FF00", "#FF0000", "#0000FF"}) {
        mInputs.write("look.json",
                      R"({"stroke": {"size": 2, "position": "outside", "color": ")" + colour + "\"}}");
        const std::string name = std::to_string(number++) + ".png";
        ASSERT_TRUE(paint(pipe, name, members));
        const std::string bytes = readBytes(mDir.file(name));
        EXPECT_EQ(byColour.try_emplace(colour, bytes).first->second, bytes) << number;
    }
    pipe.close();
    EXPECT_EQ(program.wait(), 0);
    EXPECT_NE(byColour["#FF0000"], byColour["#00FF00"]);
    EXPECT_NE(byColour["#FF0000"], byColour["#0000FF"]);
}

TEST_P(PipedSeries, OldFilesThatChangeBetweenLines_AreReadAnew) {
    const std::string image = mInputs.file("tile.png");
    const auto writeTile = [&](const char* colour) {
        runVorelpaint({"--size", "9", "--background", colour, "--color", colour, "-o", image, "I"});
    };
    const auto writeStyle = [&](const char* scale) {
        return mInputs.write(
            "look.json", std::string(R"({"pattern": {"image": "tile.png", "scale": )") + scale + "}}");
    };
    const std::string members = R"("text": "A", "style": ")" + writeStyle("1") + "\"";
    writeTile("#F00");
    std::this_thread::sleep_for(std::chrono::milliseconds(3100));  // until they are kept
    RunningVorelpaint program({"--size", "20", "--batch", mFifo, "--jobs", GetParam()});
    std::ofstream pipe(mFifo, std::ios::binary);
    int number = 0;
    const auto next = [&] {
        const std::string name = std::to_string(number++) + ".png";
        EXPECT_TRUE(paint(pipe, name, members));
        return readBytes(mDir.file(name));
    };
    const std::string red = next();
    for (int i = 0; i < 5; ++i)
        EXPECT_EQ(next(), red);
    writeTile("#00F");
    const std::string blue = next();
    EXPECT_NE(blue, red);
    writeStyle("1, \"opacity\": 0.5");
    EXPECT_NE(next(), blue);
    pipe.close();
    EXPECT_EQ(program.wait(), 0);
}

INSTANTIATE_TEST_SUITE_P(Jobs, PipedSeries, ::testing::Values("1", "2", "5"));

TEST_F(Series, Shards_PaintTheWholeTogether) {
    const std::string lines = faultyJobs();
    const Outcome whole = run(lines, {});
    const Files files = takePainted();
    for (const int count : {1, 2, 5, 20}) {
        Files parts;
        size_t failed = 0;
        for (int i = 1; i <= count; ++i) {
            const std::string shard = std::to_string(i) + "/" + std::to_string(count);
            const Outcome outcome = run(lines, {"--shard", shard, "--jobs", "2"});
            const auto said =
                static_cast<size_t>(std::count(outcome.err.begin(), outcome.err.end(), '\n'));
            if (outcome.exitCode == 2) ++failed;
            EXPECT_EQ(outcome.exitCode == 2, outcome.err.find("jobs failed") != std::string::npos)
                << said;
            const Files part = takePainted();
            for (const auto& file : part)
                EXPECT_TRUE(parts.insert(file).second) << file.first << " is painted twice";
        }
        EXPECT_GE(failed, 1U);
        EXPECT_EQ(parts, files) << count << " shards";
    }
    EXPECT_EQ(whole.exitCode, 2);
}

TEST_F(Series, Shard_TakesEveryNthJobFromItsOwnOn) {
    EXPECT_EQ(run("\n" + jobs(7), {"--shard", "2/3"}).exitCode, 0);
    EXPECT_EQ(mDir.list(), (Words{"1.png", "4.png"})) << "blank lines are no jobs";
}

TEST_F(Series, TwoJobsOfOneOutput_AreFoundInEveryShard) {
    const std::string lines = job("a.png", R"("text": "A")") + job("a.png", R"("text": "B")");
    for (const char* shard : {"1/2", "2/2"}) {
        const Outcome outcome = run(lines, {"--shard", shard});
        EXPECT_EQ(outcome.exitCode, 2);
        EXPECT_NE(outcome.err.find("nothing is painted: of 2 jobs 1 would"), std::string::npos);
    }
    EXPECT_TRUE(mDir.list().empty());
}

TEST_F(Series, SkipExisting_LeavesWhatIsThereAndNotEmpty) {
    const std::string lines = jobs(4);
    run(lines, {});
    const Files files = painted();
    mDir.write("0.png", "older picture");
    mDir.write("1.png", "");
    fs::remove(mDir.file("2.png"));
    for (const char* count : {"1", "2"}) {
        const Outcome outcome = run(lines, {"--skip-existing", "--report", "json", "--jobs", count});
        EXPECT_EQ(outcome.exitCode, 0);
        EXPECT_EQ(outcome.err, "");
        EXPECT_EQ(std::count(outcome.out.begin(), outcome.out.end(), '\n'), count[0] == '1' ? 2 : 0)
            << "who is left out is not reported";
        EXPECT_EQ(readBytes(mDir.file("0.png")), "older picture");
        for (const char* name : {"1.png", "2.png", "3.png"})
            EXPECT_EQ(readBytes(mDir.file(name)), files.at(name)) << name;
    }
}

TEST_F(Series, SkipExisting_StillTellsOfLinesThatAreWrong) {
    const std::string lines = jobs(2) + "{oops\n";
    run(lines, {});
    const Outcome again = run(lines, {"--skip-existing"});
    EXPECT_EQ(again.exitCode, 2);
    EXPECT_NE(again.err.find("1 of 3 jobs failed"), std::string::npos) << again.err;
}

TEST_F(Series, KilledShards_AreFinishedByTheirRepetition) {
    const std::string lines = jobs(60);
    run(lines, {});
    const Files files = takePainted();
    for (const bool unnamed : {true, false}) {
        Surroundings surroundings;
        surroundings.unnamedFiles = unnamed;
        for (const size_t atLeast : {1U, 5U, 15U}) {
            RunningVorelpaint program(
                {"--size", "20", "--batch", batch(lines), "--shard", "1/2", "--jobs", "2"},
                surroundings);
            EXPECT_TRUE(becomesTrue([&] { return mDir.list().size() >= atLeast; }));
            program.send(SIGKILL);
            program.wait();
        }
        for (const auto& [name, bytes] : painted()) {
            const bool isPassing = name.rfind(".vorelpaint.", 0) == 0;
            EXPECT_TRUE(isPassing || bytes == files.at(name)) << name << " is half written";
            if (isPassing) fs::remove(mDir.file(name));
        }
        for (const char* shard : {"1/2", "2/2"})
            EXPECT_EQ(run(lines, {"--shard", shard, "--skip-existing"}).exitCode, 0);
        EXPECT_EQ(takePainted(), files);
    }
}

TEST_F(Series, FilesThatAreTooLarge_FailAloneAndASecondRunPaintsThem) {
    std::string lines;
    for (int i = 0; i < 6; ++i) {
        lines +=
            job(std::to_string(i) + ".png",
                std::string(R"("text": "Ag", "preset": "chalk", "size": )") + (i % 2 ? "10" : "90"));
    }
    Surroundings limited;
    limited.largestFile = 3000;
    for (const char* jobs : {"1", "2", "5"}) {
        const Outcome first =
            runVorelpaintIn(limited, {"--size", "20", "--batch", batch(lines), "--jobs", jobs});
        EXPECT_EQ(first.exitCode, 2);
        EXPECT_NE(first.err.find("line 1: cannot write '" + mDir.file("0.png") + "': File too large\n"),
                  std::string::npos)
            << first.err;
        EXPECT_NE(first.err.find("3 of 6 jobs failed"), std::string::npos) << first.err;
        EXPECT_EQ(mDir.list(), (Words{"1.png", "3.png", "5.png"}));
        EXPECT_EQ(run(lines, {"--jobs", jobs, "--skip-existing"}).exitCode, 0);
        EXPECT_EQ(takePainted().size(), 6U);
    }
}

TEST_F(Series, ClosedOutput_FailsTheReportsAndPaintsThePictures) {
    Surroundings closed;
    closed.closedOutput = true;
    for (const char* count : {"1", "2"}) {
        const Outcome outcome = runVorelpaintIn(
            closed, {"--size", "20", "--batch", batch(jobs(3)), "--report", "json", "--jobs", count});
        EXPECT_EQ(outcome.exitCode, 2);
        EXPECT_NE(outcome.err.find("3 of 3 jobs failed"), std::string::npos) << outcome.err;
        EXPECT_EQ(takePainted().size(), 3U);
    }
}

TEST_F(Series, LittleRoomForThreads_GivesTheSame) {
    if (!MemoryMeter::works()) GTEST_SKIP() << "a sanitizer maps more";
    for (const char* count : {"1", "2", "7", "64"}) {
        for (const size_t mib : {size_t{96}, size_t{192}, size_t{300}}) {
            Surroundings limited;
            limited.addressSpace = mib << 20;
            const Outcome outcome =
                runVorelpaintIn(limited, {"--size", "20", "--batch", batch(jobs(12)), "--jobs", count});
            EXPECT_EQ(outcome.exitCode, 0) << count << " threads, " << mib << " MiB";
            EXPECT_EQ(outcome.err, "");
            EXPECT_EQ(takePainted().size(), 12U);
        }
    }
}

TEST_F(Series, PicturesThatOneAloneHasMemoryFor_ArePaintedOneByOne) {
    if (!MemoryMeter::works()) GTEST_SKIP() << "a sanitizer maps more";
    std::string lines;
    for (int i = 0; i < 3; ++i)
        lines += job(std::to_string(i) + ".png",
                     R"("text": "Ag", "preset": "gold", "width": 5700, "height": 5700)");
    Surroundings limited;
    limited.addressSpace = size_t{600} << 20;
    for (const char* count : {"1", "2"}) {
        const Outcome outcome = runVorelpaintIn(
            limited, {"--size", "120", "--png", "fast", "--batch", batch(lines), "--jobs", count});
        EXPECT_EQ(outcome.exitCode, 0);
        EXPECT_EQ(outcome.err, "");
        EXPECT_EQ(takePainted().size(), 3U);
    }
}

TEST_F(Series, MissingInput_IsNoFileThatIsOpenedLater) {
    Surroundings surroundings;
    surroundings.missingStream = STDIN_FILENO;
    for (const char* count : {"1", "2"}) {
        const Outcome outcome = runVorelpaintIn(surroundings, {"--batch", "-", "--jobs", count});
        EXPECT_EQ(outcome.exitCode, 2);
        EXPECT_EQ(outcome.err, "vorelpaint: cannot read standard input: Bad file descriptor\n");
    }
}

TEST_F(Series, Signals_EndABatchOfManyThreadsAndLeaveWholePictures) {
    const std::string lines = jobs(40);
    run(lines, {});
    const Files files = takePainted();
    const std::string fifo = mInputs.file("fifo");
    ASSERT_EQ(::mkfifo(fifo.c_str(), 0600), 0);
    for (const int signal : {SIGINT, SIGTERM, SIGHUP}) {
        for (const bool unnamed : {true, false}) {
            Surroundings surroundings;
            surroundings.unnamedFiles = unnamed;
            RunningVorelpaint program({"--size", "20", "--batch", fifo, "--jobs", "3"}, surroundings);
            // As long as the pipe is open, more jobs may come: the batch cannot have ended.
            std::ofstream pipe(fifo, std::ios::binary);
            pipe << lines << std::flush;
            EXPECT_TRUE(becomesTrue([&] { return !mDir.list().empty(); }));
            program.send(signal);
            const int status = program.wait();
            EXPECT_TRUE(WIFSIGNALED(status));
            EXPECT_EQ(WTERMSIG(status), signal);
            for (const auto& [name, bytes] : takePainted())
                EXPECT_EQ(bytes, files.at(name)) << name;
        }
    }
}

/// In KiB, at this moment.
size_t memoryOf(const RunningVorelpaint& program) {
    std::ifstream status("/proc/" + std::to_string(program.id()) + "/status");
    for (std::string line; std::getline(status, line);) {
        if (line.rfind("VmRSS:", 0) == 0) return std::stoul(line.substr(6));
    }
    return 0;
}

TEST_F(Series, LongBatch_HoldsItsMemory) {
    if (!MemoryMeter::works()) GTEST_SKIP() << "a sanitizer has the allocator";
    // Every job has words and a size of its own, so nothing that is kept is of use for long.
    const int count = std::max(400, vorel_test::thinned(2000));
    const std::string fifo = mInputs.file("fifo");
    ASSERT_EQ(::mkfifo(fifo.c_str(), 0600), 0);
    RunningVorelpaint program({"--size", "20", "--batch", fifo, "--jobs", "2"});
    std::ofstream pipe(fifo, std::ios::binary);
    size_t early = 0;
    for (int i = 0; i < count; ++i) {
        const std::string number = std::to_string(i);
        pipe << job(number + ".png", R"("text": "Line )" + number + R"(", "preset": "gold", "size": )" +
                                         std::to_string(10 + i % 50));
        if (i != count / 2) continue;
        pipe << std::flush;
        ASSERT_TRUE(becomesTrue([&] { return fs::exists(mDir.file(number + ".png")); }));
        early = memoryOf(program);
    }
    pipe << std::flush;
    ASSERT_TRUE(becomesTrue([&] { return fs::exists(mDir.file(std::to_string(count - 1) + ".png")); }));
    const size_t late = memoryOf(program);
    pipe.close();
    EXPECT_EQ(program.wait(), 0);
    EXPECT_GT(early, 0U);
    EXPECT_LE(late, early + early / 8 + 2048) << "KiB, and " << early << " half way";
}

TEST_F(Series, WhatIsNoNumberOfThreads_IsRefused) {
    for (const char* jobs : {"0", "-1", "65", "1e9", "99999999999999999999", "2.5", "two", ""}) {
        const Outcome outcome = run("", {"--jobs", jobs});
        EXPECT_EQ(outcome.exitCode, 2) << jobs;
        EXPECT_EQ(outcome.err.rfind("vorelpaint: --jobs: '", 0), 0U) << outcome.err;
        EXPECT_EQ(std::count(outcome.err.begin(), outcome.err.end(), '\n'), 1) << outcome.err;
    }
}

TEST_F(Series, WhatIsNoShard_IsRefused) {
    for (const char* shard : {"", "1", "0/2", "3/2", "1/0", "-1/2", "1/2/3", "a/b", "1/", "/2", "1/1e9",
                              "1/99999999999999999999", "1.5/2"}) {
        const Outcome outcome = run("", {"--shard", shard});
        EXPECT_EQ(outcome.exitCode, 2) << shard;
        EXPECT_NE(outcome.err.find("is no shard I/N, as 2/8 is: N is 1 to 100000, I is 1 to N"),
                  std::string::npos)
            << outcome.err;
    }
}

TEST_F(Series, WithoutABatch_ItsOptionsAreRefused) {
    for (const Words& words :
         {Words{"--shard", "1/2"}, Words{"--skip-existing"}, Words{"--jobs", "2"}}) {
        Words arguments{"-o", mDir.file("a.png"), "A"};
        arguments.insert(arguments.end(), words.begin(), words.end());
        const Outcome outcome = runVorelpaint(arguments);
        EXPECT_EQ(outcome.exitCode, 2);
        EXPECT_NE(outcome.err.find(words[0]), std::string::npos) << outcome.err;
    }
    EXPECT_TRUE(mDir.list().empty());
}

}  // namespace
}  // namespace vorelpaint
