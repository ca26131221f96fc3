#include <gtest/gtest.h>
#include <sys/time.h>

#include <csignal>

#include "build_kind.h"
#include "whole_looks.h"

/// Signals that arrive while a thread paints, as a profiler or a timer sends them.
namespace {

using namespace vorel_test;

volatile std::sig_atomic_t gSignals = 0;

/// While it lives, a timer interrupts the process every 200 microseconds, and a handler counts.
class Interruptions {
  public:
    Interruptions(int timer, int signal) : mTimer(timer), mSignal(signal) {
        struct sigaction count = {};
        count.sa_handler = [](int) { gSignals = gSignals + 1; };
        count.sa_flags = SA_RESTART;
        sigaction(signal, &count, &mBefore);
        gSignals = 0;
        const itimerval often = {{0, 200}, {0, 200}};
        setitimer(timer, &often, nullptr);
    }
    ~Interruptions() {
        const itimerval never = {};
        setitimer(mTimer, &never, nullptr);
        sigaction(mSignal, &mBefore, nullptr);
    }
    Interruptions(const Interruptions&) = delete;
    Interruptions& operator=(const Interruptions&) = delete;

  private:
    int mTimer;
    int mSignal;
    struct sigaction mBefore;
};

struct Source {
    int timer;
    int signal;
};

class Signals : public ::testing::TestWithParam<Source> {};

TEST_P(Signals, WhilePainting_ChangeNothing) {
    for (const WholeLook look : kWholeLooks)
        expectedPicture(look);
    constexpr int kEnough = kEmulated ? 20 : 100;
    const Interruptions interruptions(GetParam().timer, GetParam().signal);
    // Until so many have come; a machine under load sends them late.
    for (int round = 0; gSignals < kEnough && round < 5000; ++round) {
        for (const WholeLook look : kWholeLooks)
            ASSERT_TRUE(paintsAsExpected(look)) << "look " << look << ", round " << round;
    }
    EXPECT_GE(gSignals, kEnough) << "signals came while painting";
}

INSTANTIATE_TEST_SUITE_P(Timers, Signals,
                         ::testing::Values(Source{ITIMER_PROF, SIGPROF}, Source{ITIMER_REAL, SIGALRM}),
                         [](const auto& source) {
                             return source.param.signal == SIGPROF ? "Profiling" : "Alarm";
                         });

}  // namespace
