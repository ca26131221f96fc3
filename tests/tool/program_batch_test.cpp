#include <gtest/gtest.h>
#include <sys/stat.h>
#include <sys/wait.h>

#include <algorithm>
#include <csignal>
#include <filesystem>
#include <fstream>
#include <string>
#include <thread>
#include <vector>

#include "compose/system/png_reader.h"
#include "program.h"

namespace vorelpaint {
namespace {

using vorel_test::Outcome;
using vorel_test::readBytes;
using vorel_test::RunningVorelpaint;
using vorel_test::runVorelpaint;
using vorel_test::runVorelpaintOnTerminal;
using vorel_test::TempDir;
using Words = std::vector<std::string>;

class BatchProgram : public ::testing::Test {
  protected:
    /// A job that paints into the test's directory.
    std::string job(const std::string& output, const std::string& members) const {
        return R"({"output": ")" + mDir.file(output) + "\", " + members + "}\n";
    }

    Outcome run(const std::string& lines, Words arguments = {}) {
        arguments.insert(arguments.begin(), {"--batch", mInputs.write("jobs.jsonl", lines)});
        return runVorelpaint(arguments);
    }

    TempDir mInputs;
    TempDir mDir;
};

TEST_F(BatchProgram, EveryJob_IsPaintedAsTheCommandLineWould) {
    const std::string style = R"({"stroke": {"size": 3, "color": "#FF0000", "position": "outside"}})";
    const Outcome outcome =
        run(job("a.png", R"("text": "Ag", "preset": "gold", "size": 30, "background": "#102030")") +
            job("b.png", R"("text": "two\nlines", "align": "right", "style": )" + style));
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(outcome.err, "") << "quiet where there is no terminal";
    EXPECT_EQ(mDir.list(), (Words{"a.png", "b.png"}));

    const std::string expected = mInputs.file("expected.png");
    runVorelpaint({"--preset", "gold", "--size", "30", "--background", "#102030", "-o", expected, "Ag"});
    EXPECT_EQ(readBytes(mDir.file("a.png")), readBytes(expected));
    runVorelpaint({"--style", mInputs.write("style.json", style), "--align", "right", "-o", expected,
                   "two\nlines"});
    EXPECT_EQ(readBytes(mDir.file("b.png")), readBytes(expected));
}

TEST_F(BatchProgram, CommandLine_HoldsForWhatAJobDoesNotSay) {
    run(job("a.png", R"("text": "Ag")"), {"--size", "20", "--preset", "neon"});
    const std::string expected = mInputs.file("expected.png");
    runVorelpaint({"--size", "20", "--preset", "neon", "-o", expected, "Ag"});
    EXPECT_EQ(readBytes(mDir.file("a.png")), readBytes(expected));
}

TEST_F(BatchProgram, BadLine_IsReportedAndTheNextGoesOn) {
    const Outcome outcome =
        run(job("a.png", R"("text": "A")") + "\n" + job("b.png", R"("text": "B", "size": 0)") +
            "{oops\n" + job("no/such/c.png", R"("text": "C")") + job("d.png", R"("text": "D")"));
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(mDir.list(), (Words{"a.png", "d.png"}));
    const std::string& err = outcome.err;
    EXPECT_EQ(err.rfind("vorelpaint: line 3: size: '0' is no whole number from 1 to 1000\n"
                        "vorelpaint: line 4: no valid JSON: column 2: ",
                        0),
              0U)
        << err;
    EXPECT_NE(err.find("\nvorelpaint: line 5: cannot write '" + mDir.file("no/such/c.png") + "'"),
              std::string::npos)
        << err;
    EXPECT_NE(err.find("\nvorelpaint: 3 of 5 jobs failed\n"), std::string::npos) << err;
    EXPECT_EQ(std::count(err.begin(), err.end(), '\n'), 4) << err;
}

TEST_F(BatchProgram, Warnings_NameTheLineAndFailNothing) {
    const Outcome outcome = run("\n" + job("a.png", R"("text": "A\ud80c\udc00")"));
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(
        outcome.err,
        "vorelpaint: line 2: note: no font has U+13000 (line 1, character 2); its sign for missing "
        "characters is painted\n");
}

TEST_F(BatchProgram, FailedJob_KeepsTheOlderPicture) {
    mDir.write("a.png", "older picture");
    EXPECT_EQ(run(job("a.png", R"("text": " ")")).exitCode, 2);
    EXPECT_EQ(readBytes(mDir.file("a.png")), "older picture");
    EXPECT_EQ(mDir.list(), Words{"a.png"});
}

TEST_F(BatchProgram, StandardInput_IsABatchToo) {
    const Outcome outcome = runVorelpaint({"--batch", "-"}, job("a.png", R"("text": "A")"));
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(mDir.list(), Words{"a.png"});
}

TEST_F(BatchProgram, NoJobs_AreNoFailure) {
    EXPECT_EQ(run("").exitCode, 0);
    EXPECT_EQ(run("\n \n").exitCode, 0);
}

TEST_F(BatchProgram, BatchThatCannotBeRead_FailsInOneLine) {
    for (const std::string& path : {mInputs.file("none"), mInputs.path().string()}) {
        const Outcome outcome = runVorelpaint({"--batch", path});
        EXPECT_EQ(outcome.exitCode, 2);
        EXPECT_EQ(outcome.err.rfind("vorelpaint: cannot read '" + path + "': ", 0), 0U) << outcome.err;
        EXPECT_EQ(std::count(outcome.err.begin(), outcome.err.end(), '\n'), 1);
    }
}

TEST_F(BatchProgram, WhatCannotGoWithABatch_IsRefused) {
    const std::string jobs = mInputs.write("jobs.jsonl", job("a.png", R"("text": "A")"));
    for (const Words& arguments : {Words{"-o", "x.png"}, Words{"--sheet"}, Words{"--explain"},
                                   Words{"--write-cpp"}, Words{"--print-key"}, Words{"--print-margins"},
                                   Words{"--text-file", "-"}, Words{"--style", "-"}}) {
        Words all{"--batch", jobs};
        all.insert(all.end(), arguments.begin(), arguments.end());
        const Outcome outcome = runVorelpaint(all);
        EXPECT_EQ(outcome.exitCode, 2) << arguments[0];
        EXPECT_EQ(std::count(outcome.err.begin(), outcome.err.end(), '\n'), 1) << outcome.err;
    }
    EXPECT_TRUE(mDir.list().empty());
}

TEST_F(BatchProgram, TwoJobsWithOneOutput_ArePaintedByNone) {
    std::filesystem::create_directory_symlink(mDir.path(), mInputs.file("linked"));
    const std::string a = R"({"text": "A", "output": ")" + mDir.file("./a.png") + "\"}\n";
    const std::string linked = R"({"text": "A", "output": ")" + mInputs.file("linked/b.png") + "\"}\n";
    const Outcome outcome = run(job("a.png", R"("text": "A")") + "\n" + job("b.png", R"("text": "B")") +
                                "{oops\n" + a + linked);
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(outcome.err,
              "vorelpaint: line 5: output: '" + mDir.file("./a.png") +
                  "' is the file that line 1 writes\n"
                  "vorelpaint: line 6: output: '" +
                  mInputs.file("linked/b.png") +
                  "' is the file that line 3 writes\n"
                  "vorelpaint: nothing is painted: of 5 jobs 2 would replace the picture of "
                  "another\n");
    EXPECT_TRUE(mDir.list().empty());
}

TEST_F(BatchProgram, OutputThatIsALinkToItself_FailsAlone) {
    std::filesystem::create_symlink("circle", mInputs.file("circle"));
    const std::string circle = mInputs.file("circle");
    const Outcome outcome =
        run(R"({"text": "A", "output": ")" + circle + "\"}\n" + job("a.png", R"("text": "A")"));
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(outcome.err, "vorelpaint: line 1: cannot write '" + circle +
                               "': too many links\nvorelpaint: 1 of 2 jobs failed\n");
    EXPECT_EQ(mDir.list(), Words{"a.png"});
}

TEST_F(BatchProgram, SecondJobOfAnOutput_IsRefusedInAPipe) {
    const std::string jobs =
        mInputs.write("jobs.jsonl", job("a.png", R"("text": "A")") + job("a.png", R"("text": "B")"));
    const std::string fifo = mInputs.file("fifo");
    ASSERT_EQ(::mkfifo(fifo.c_str(), 0600), 0);
    std::thread writer([&] { std::ofstream(fifo, std::ios::binary) << readBytes(jobs); });
    const Outcome outcome = runVorelpaint({"--batch", fifo});
    writer.join();
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(outcome.err, "vorelpaint: line 2: output: '" + mDir.file("a.png") +
                               "' is the file that line 1 writes\nvorelpaint: 1 of 2 jobs failed\n");
    const std::string expected = mInputs.file("expected.png");
    runVorelpaint({"-o", expected, "A"});
    EXPECT_EQ(readBytes(mDir.file("a.png")), readBytes(expected)) << "the first one stays";
}

TEST_F(BatchProgram, JobNamedLikeAnotherKindOfFile_IsRefused) {
    const Outcome outcome = run(job("a.jpg", R"("text": "A")"));
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(outcome.err,
              "vorelpaint: line 1: output: '" + mDir.file("a.jpg") +
                  "' is named like another kind of file; only PNG is written: end it with .png\n"
                  "vorelpaint: 1 of 1 jobs failed\n");
    EXPECT_TRUE(mDir.list().empty());
}

TEST_F(BatchProgram, Terminal_ShowsABarThatGoesInTheEnd) {
    std::string lines;
    for (int i = 0; i < 3; ++i)
        lines += job(std::to_string(i) + ".png", R"("text": "A")") + " \t\r\n\n";
    const std::string jobs = mInputs.write("jobs.jsonl", lines + "{}\n");
    const Outcome outcome = runVorelpaintOnTerminal({"--batch", jobs}, 80);
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(outcome.err.rfind("[--------------------------------] 0 of 4 pictures", 0), 0U)
        << outcome.err;
    const std::string erased = "\r\x1B[K";
    const size_t message = outcome.err.find("vorelpaint: line 10: output: missing");
    ASSERT_NE(message, std::string::npos) << outcome.err;
    EXPECT_EQ(outcome.err.substr(message - erased.size(), erased.size()), erased)
        << "the bar makes room for the message";
    EXPECT_EQ(outcome.err.substr(outcome.err.rfind(erased)),
              erased + "vorelpaint: 1 of 4 jobs failed\r\n");
}

TEST_F(BatchProgram, NarrowTerminal_KeepsTheBarOnItsLine) {
    const std::string jobs = mInputs.write("jobs.jsonl", job("a.png", R"("text": "A")"));
    EXPECT_EQ(runVorelpaintOnTerminal({"--batch", jobs}, 20).err, "[------------------\r\x1B[K");
}

TEST_F(BatchProgram, IgnoredSignal_StaysIgnored) {
    std::string lines;
    for (int i = 0; i < 20; ++i)
        lines += job(std::to_string(i) + ".png", R"("text": "Dust", "preset": "chalk", "size": 200)");
    RunningVorelpaint batch({"--batch", mInputs.write("jobs.jsonl", lines)}, {SIGHUP});
    while (mDir.list().empty())
        std::this_thread::yield();
    batch.send(SIGHUP);
    const int status = batch.wait();
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 0);
    EXPECT_EQ(mDir.list().size(), 20U);
}

}  // namespace
}  // namespace vorelpaint
