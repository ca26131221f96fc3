#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <atomic>
#include <cstdio>
#include <thread>

#include "build_kind.h"
#include "whole_looks.h"

/// Sets that live as long as the program or a thread, and processes that split.
namespace {

using namespace vorel_test;
using VFontEffect::VFEffect;

/// A look of static storage; its end is the last that the process does, and it paints there once more.
class LongLived {
  public:
    LongLived() { describe(kEveryEffect, mSet, mKit); }
    ~LongLived() {
        if (mPainted && !paintsTheSame()) {
            std::fprintf(stderr, "FAILED: a set paints otherwise at the end of its %s\n", mOwner);
            _exit(1);
        }
    }
    LongLived(const LongLived&) = delete;
    LongLived& operator=(const LongLived&) = delete;

    void ownedBy(const char* owner) { mOwner = owner; }

    bool paintsTheSame() {
        mPainted = true;
        // A copy: the order of the effects turns with every run of one set.
        VFEffect copy(mSet);
        const literal::Picture picture = paintedRun(copy, mMask, kWholeStage);
        return picture.bytes == mExpected.bytes;
    }

  private:
    Kit<VFEffect> mKit;
    VFEffect mSet;
    const literal::Mask mMask = wholeMask();
    const literal::Picture mExpected = expectedPicture(kEveryEffect);
    bool mPainted = false;
    const char* mOwner = "process";
};

LongLived gStatic;
thread_local LongLived gOfThread;

TEST(Lifetimes, StaticSet_PaintsUntilTheProcessEnds) {
    EXPECT_TRUE(gStatic.paintsTheSame());
}

TEST(Lifetimes, ThreadLocalSets_PaintUntilTheirThreadsEnd) {
    std::atomic<int> same{0};
    constexpr int kThreads = 8;
    std::vector<std::thread> threads;
    for (int i = 0; i < kThreads; ++i) {
        threads.emplace_back([&same] {
            gOfThread.ownedBy("thread");
            if (gOfThread.paintsTheSame()) ++same;
        });
    }
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(kThreads, same);
    // That of the first thread lives until the process ends.
    EXPECT_TRUE(gOfThread.paintsTheSame());
}

/// Whether a child of this process paints every look as expected.
bool childPaintsTheSame() {
    const pid_t child = fork();
    if (child == 0) {
        bool same = gStatic.paintsTheSame();
        for (const WholeLook look : kWholeLooks)
            same = same && paintsAsExpected(look);
        _exit(same ? 0 : 1);
    }
    int status = -1;
    waitpid(child, &status, 0);
    return WIFEXITED(status) && WEXITSTATUS(status) == 0;
}

TEST(Lifetimes, ChildOfAProcessThatHasPainted_PaintsTheSame) {
    for (const WholeLook look : kWholeLooks)
        ASSERT_TRUE(paintsAsExpected(look));
    EXPECT_TRUE(childPaintsTheSame());
    for (const WholeLook look : kWholeLooks)
        EXPECT_TRUE(paintsAsExpected(look)) << "in the parent, afterwards";
}

TEST(Lifetimes, ChildOfAProcessWhoseThreadsPaint_PaintsTheSame) {
    if (kSanitized || kEmulated) GTEST_SKIP() << "their own locks may be held where the process splits";
    for (const WholeLook look : kWholeLooks)
        expectedPicture(look);
    std::atomic<bool> ended{false};
    std::atomic<bool> same{true};
    std::vector<std::thread> painters;
    for (int i = 0; i < 3; ++i) {
        painters.emplace_back([&] {
            while (!ended)
                same = paintsAsExpected(kEveryEffect) && same;
        });
    }
    for (int child = repetitions(10); child > 0; --child)
        EXPECT_TRUE(childPaintsTheSame());
    ended = true;
    for (std::thread& painter : painters)
        painter.join();
    EXPECT_TRUE(same) << "in the parent's threads";
}

}  // namespace
