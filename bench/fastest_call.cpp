#include "fastest_call.h"

#include <malloc.h>

#include <algorithm>
#include <limits>

namespace vorel_bench {

double now(clockid_t clock) {
    timespec time = {};
    clock_gettime(clock, &time);
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * 1e-9;
}

clockid_t clockFor(double fastest) {
    return fastest > 1e-3 ? CLOCK_THREAD_CPUTIME_ID : CLOCK_MONOTONIC;
}

double fastestCall(Job& job, double seconds) {
    constexpr int kFewestCalls = 3;
    constexpr double kLong = 1.0;
    double fastest = std::numeric_limits<double>::infinity();
    double taken = 0;
    for (int calls = 0; taken < seconds || (calls < kFewestCalls && taken < kLong); ++calls) {
        job.reset();
        const clockid_t clock = clockFor(fastest);
        const double before = now(clock);
        job.paint();
        const double call = now(clock) - before;
        taken += call;
        fastest = std::min(fastest, call);
    }
    return fastest;
}

void keepLargeBlocks() {
    constexpr int kNeverReached = 1 << 30;
    mallopt(M_MMAP_THRESHOLD, kNeverReached);
    mallopt(M_TRIM_THRESHOLD, kNeverReached);
}

}  // namespace vorel_bench
