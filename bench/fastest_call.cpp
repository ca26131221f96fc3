#include "fastest_call.h"

#include <algorithm>
#include <chrono>
#include <limits>

namespace vorel_bench {

double fastestCall(Job& job, double seconds) {
    using Clock = std::chrono::steady_clock;
    constexpr int kFewestCalls = 3;
    constexpr double kLong = 1.0;
    double fastest = std::numeric_limits<double>::infinity();
    double taken = 0;
    for (int calls = 0; taken < seconds || (calls < kFewestCalls && taken < kLong); ++calls) {
        job.reset();
        const Clock::time_point before = Clock::now();
        job.paint();
        const double call = std::chrono::duration<double>(Clock::now() - before).count();
        taken += call;
        fastest = std::min(fastest, call);
    }
    return fastest;
}

}  // namespace vorel_bench
