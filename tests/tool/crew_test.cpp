#include "crew.h"

#include <gtest/gtest.h>
#include <pthread.h>
#include <sys/resource.h>
#include <unistd.h>

#include <array>
#include <atomic>
#include <chrono>
#include <csignal>
#include <new>
#include <set>
#include <stdexcept>
#include <thread>
#include <vector>

namespace vorelpaint {
namespace {

class CrewOf : public ::testing::TestWithParam<int> {};

TEST_P(CrewOf, Tasks_AreTakenInTheOrderInWhichTheyWereGiven) {
    constexpr size_t kTasks = 200;
    std::vector<size_t> done(kTasks);
    Crew crew(GetParam());
    size_t given = 0;
    for (size_t taken = 0; taken < kTasks; ++taken) {
        for (; given < kTasks && !crew.isFull(); ++given) {
            crew.give([&done, given](Workbench& /*bench*/) {
                if (given % 3 == 0) std::this_thread::sleep_for(std::chrono::microseconds(200));
                done[given] = given + 1;
            });
        }
        crew.take();
        EXPECT_EQ(done[taken], taken + 1);
    }
    EXPECT_TRUE(crew.isEmpty());
}

TEST_P(CrewOf, WhatATaskThrows_ComesWhereItIsTaken) {
    Crew crew(GetParam());
    crew.give([](Workbench& /*bench*/) { throw std::bad_alloc(); });
    EXPECT_THROW(crew.take(), std::bad_alloc);
    bool isDone = false;
    crew.give([&](Workbench& /*bench*/) { isDone = true; });
    EXPECT_NO_THROW(crew.take());
    EXPECT_TRUE(isDone);
}

TEST_P(CrewOf, TasksThatNobodyTakes_HinderNoEnd) {
    std::atomic<int> begun{0};
    {
        Crew crew(GetParam());
        while (!crew.isFull())
            crew.give([&](Workbench& /*bench*/) { ++begun; });
    }
    EXPECT_LE(begun, 2 * GetParam());
}

TEST_P(CrewOf, WaitForAll_EndsWhenEveryTaskIsDone) {
    Crew crew(GetParam());
    std::atomic<int> given{0};
    std::atomic<int> done{0};
    for (; !crew.isFull(); ++given) {
        crew.give([&](Workbench& /*bench*/) {
            std::this_thread::sleep_for(std::chrono::milliseconds(2));
            ++done;
        });
    }
    crew.waitForAll();
    EXPECT_EQ(done, given);
    EXPECT_FALSE(crew.isEmpty());
}

TEST_P(CrewOf, Signals_AreHeldInEveryOtherThread) {
    Crew crew(GetParam());
    bool isHeld = false;
    crew.give([&](Workbench& /*bench*/) {
        sigset_t held;
        pthread_sigmask(SIG_BLOCK, nullptr, &held);
        isHeld = sigismember(&held, SIGINT) == 1 && sigismember(&held, SIGTERM) == 1;
    });
    crew.take();
    EXPECT_EQ(isHeld, GetParam() > 1);
}

INSTANTIATE_TEST_SUITE_P(Threads, CrewOf, ::testing::Values(1, 2, 5));

TEST(Crew, ItsTasks_AreTwoForEachThread) {
    Crew crew(3);
    for (int i = 0; i < 6; ++i) {
        EXPECT_FALSE(crew.isFull());
        crew.give([](Workbench& /*bench*/) {});
    }
    EXPECT_TRUE(crew.isFull());
}

TEST(Crew, Wait_EndsWhenThereIsInput) {
    std::array<int, 2> ends{};
    ASSERT_EQ(::pipe(ends.data()), 0);
    std::atomic<bool> mayEnd{false};
    Crew crew(2);
    crew.give([&](Workbench& /*bench*/) {
        while (!mayEnd)
            std::this_thread::yield();
    });
    ASSERT_EQ(::write(ends[1], "x", 1), 1);
    crew.wait(ends[0]);
    EXPECT_FALSE(crew.isFirstDone());
    mayEnd = true;
    crew.wait();
    EXPECT_TRUE(crew.isFirstDone());
    ::close(ends[0]);
    ::close(ends[1]);
}

/// Ends with 0 when all tasks were done by a crew that was given no thread.
[[noreturn]] void workWithoutThreads() {
    const rlimit none{0, 0};
    if (::setrlimit(RLIMIT_NPROC, &none) != 0 || ::setuid(65534) != 0) ::_exit(77);
    Crew crew(4);
    std::set<std::thread::id> threads;
    for (int i = 0; i < 3; ++i) {
        crew.give([&](Workbench& /*bench*/) { threads.insert(std::this_thread::get_id()); });
        crew.take();
    }
    // Not by exit(): what looks for leaks there needs threads.
    ::_exit(threads == std::set<std::thread::id>{std::this_thread::get_id()} ? 0 : 1);
}

TEST(CrewDeathTest, WithoutThreads_TheWorkIsDoneAllTheSame) {
    if (::getuid() != 0) GTEST_SKIP() << "the limit counts what the user runs elsewhere";
    EXPECT_EXIT(workWithoutThreads(), ::testing::ExitedWithCode(0), "");
}

TEST(Crew, Threads_AreThoseThatAreAskedForOrTheCores) {
    Options options;
    EXPECT_GE(threadsFor(options), 1);
    EXPECT_LE(threadsFor(options), 64);
    options.jobs = 7;
    EXPECT_EQ(threadsFor(options), 7);
}

}  // namespace
}  // namespace vorelpaint
