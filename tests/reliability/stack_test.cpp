#include <gtest/gtest.h>
#include <pthread.h>
#include <sys/mman.h>
#include <ucontext.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdio>

#include "build_kind.h"
#include "whole_looks.h"

/// Threads with small stacks: hosts give their workers as little as 16 KB, of which the C library takes
/// a part for itself.
namespace {

using namespace vorel_test;

constexpr size_t kSmallStack = 16384;
/// What a call may use, so that a thread with a small stack still has some of it left for its own.
constexpr size_t kAllowed = kSmallStack / 2;

/// A stack of our own, filled with a pattern that use wears away.
class MeasuredStack {
  public:
    MeasuredStack()
        : mBytes(static_cast<uint8_t*>(
              mmap(nullptr, kSize, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0))) {}
    ~MeasuredStack() { munmap(mBytes, kSize); }
    MeasuredStack(const MeasuredStack&) = delete;
    MeasuredStack& operator=(const MeasuredStack&) = delete;

    /// Calls `step` on this stack. Returns how many bytes it used.
    size_t usedBy(void (*step)()) {
        std::fill_n(mBytes, kSize, kUntouched);
        ucontext_t here;
        ucontext_t there;
        getcontext(&there);
        there.uc_stack.ss_sp = mBytes;
        there.uc_stack.ss_size = kSize;
        there.uc_link = &here;
        makecontext(&there, step, 0);
        swapcontext(&here, &there);
        const uint8_t* const end = mBytes + kSize;
        const uint8_t* const deepest =
            std::find_if(mBytes, mBytes + kSize, [](uint8_t byte) { return byte != kUntouched; });
        return static_cast<size_t>(end - deepest);
    }

  private:
    static constexpr size_t kSize = 1 << 20;
    static constexpr uint8_t kUntouched = 0xA5;
    uint8_t* mBytes;
};

WholeLook gLook;
bool gSame;

void paintAndCompare() {
    gSame = paintsAsExpected(gLook);
}

/// On a picture that effects paint by turns.
void paintLarge() {
    Kit<VFontEffect::VFEffect> kit;
    VFontEffect::VFEffect set;
    describe(gLook, set, kit);
    paintedRun(set, wholeMask(), {1024, 4200, 500, 2000});
}

void nothing() {}

TEST(Stack, WholeLooks_UseLittleOfIt) {
    if (kSanitized) GTEST_SKIP() << "a sanitizer's frames are its own";
    MeasuredStack stack;
    const size_t own = stack.usedBy(nothing);
    size_t most = 0;
    for (const WholeLook look : kWholeLooks) {
        gLook = look;
        // What the loader uses when it binds a name at its first call is not the library's.
        ASSERT_TRUE(paintsAsExpected(look)) << look;
        const size_t used = stack.usedBy(paintAndCompare) - own;
        EXPECT_TRUE(gSame) << look;
        EXPECT_LE(used, kAllowed) << "bytes of stack, look " << look;
        most = std::max(most, used);
    }
    std::printf("[ stack    ] %zu bytes at most\n", most);
}

TEST(Stack, LargePictures_UseLittleOfIt) {
    if (kSanitized) GTEST_SKIP() << "a sanitizer's frames are its own";
    MeasuredStack stack;
    const size_t own = stack.usedBy(nothing);
    for (const WholeLook look : kWholeLooks) {
        gLook = look;
        paintLarge();
        EXPECT_LE(stack.usedBy(paintLarge) - own, kAllowed) << "bytes of stack, look " << look;
    }
}

TEST(Stack, ThreadOfSixteenKilobytes_PaintsWholeLooks) {
    if (kSanitized) GTEST_SKIP() << "a sanitizer's frames are its own";
    pthread_attr_t small;
    ASSERT_EQ(0, pthread_attr_init(&small));
    if (pthread_attr_setstacksize(&small, kSmallStack) != 0) {
        pthread_attr_destroy(&small);
        GTEST_SKIP() << "this system has no threads so small";
    }
    for (const WholeLook look : kWholeLooks) {
        gLook = look;
        gSame = false;
        expectedPicture(look);
        pthread_t thread;
        const auto paint = [](void*) -> void* {
            paintAndCompare();
            return nullptr;
        };
        ASSERT_EQ(0, pthread_create(&thread, &small, paint, nullptr));
        pthread_join(thread, nullptr);
        EXPECT_TRUE(gSame) << look;
    }
    pthread_attr_destroy(&small);
}

}  // namespace
