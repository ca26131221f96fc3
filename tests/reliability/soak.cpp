#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <fstream>

#include "allocation_watch.h"
#include "build_kind.h"
#include "random_caller.h"

/// Long use: many random runs, at the end of which memory and results must be what they were at the
/// start.
///
///     soak [RUNS]
namespace {

using vorel_test::RandomCaller;

constexpr int kSamples = 20;
constexpr int kWarmSamples = 2;  // by then every cache of the C library is filled
constexpr long kAllowedGrowthKb = 300;

/// Where a sanitizer or an emulator keeps memory of its own the resident size says nothing.
constexpr bool kResidentIsOurs = !vorel_test::kSanitized && !vorel_test::kEmulated;

long residentKb() {
    std::ifstream statm("/proc/self/statm");
    long total = 0;
    long resident = 0;
    statm >> total >> resident;
    return resident * (sysconf(_SC_PAGESIZE) / 1024);
}

/// The results of a fixed set of callers, with seeds that the soaking itself does not use.
uint64_t hashOfFixedScenes() {
    uint64_t hash = 0;
    for (uint64_t seed = 1; seed <= 25; ++seed) {
        RandomCaller caller(seed << 32);
        for (int run = 0; run < 8; ++run)
            hash = hash * 1099511628211ULL + caller.run();
    }
    return hash;
}

/// A caller from its first look to its end; afterwards all its memory must be back.
void soak(int sample, long runs) {
    RandomCaller caller(static_cast<uint64_t>(sample));
    for (long run = 0; run < runs; ++run)
        caller.run();
}

long runsFrom(int argc, char** argv) {
    constexpr long kDefaultRuns = 100000;
    if (argc < 2) return kDefaultRuns;
    char* end = nullptr;
    errno = 0;
    const long runs = std::strtol(argv[1], &end, 10);
    const bool valid = argc == 2 && errno == 0 && end != argv[1] && *end == '\0' && runs >= kSamples;
    return valid ? runs : 0;
}

bool expect(bool holds, const char* what) {
    if (!holds) std::printf("FAILED: %s\n", what);
    return holds;
}

}  // namespace

int main(int argc, char** argv) {
    const long runs = runsFrom(argc, argv);
    if (runs == 0) {
        std::fprintf(stderr, "usage: soak [RUNS], %d runs at least\n", kSamples);
        return 2;
    }
    std::printf("%9s %12s %12s %9s\n", "runs", "live blocks", "resident kB", "runs/s");
    const uint64_t hashAtStart = hashOfFixedScenes();
    const long liveAtStart = vorel_test::liveBlocks();
    bool same = true;
    long warmResident = 0;
    long highestResident = 0;
    long done = 0;
    for (int sample = 1; sample <= kSamples; ++sample) {
        const auto start = std::chrono::steady_clock::now();
        const long until = runs * sample / kSamples;
        const long count = until - done;
        soak(sample, count);
        done = until;
        const std::chrono::duration<double> seconds = std::chrono::steady_clock::now() - start;

        const long live = vorel_test::liveBlocks();
        const long resident = residentKb();
        std::printf("%9ld %12ld %12ld %9.0f\n", done, live, resident,
                    static_cast<double>(count) / seconds.count());
        std::fflush(stdout);
        same &= expect(live == liveAtStart, "blocks were not given back");
        if (sample <= kWarmSamples) warmResident = std::max(warmResident, resident);
        highestResident = std::max(highestResident, resident);
        if (sample == kSamples / 2) {
            same &= expect(hashOfFixedScenes() == hashAtStart, "the results changed by half-time");
        }
    }
    same &= expect(hashOfFixedScenes() == hashAtStart, "the results changed by the end");

    const long growth = highestResident - warmResident;
    std::printf("resident size after warm-up %ld kB, highest growth %ld kB\n", warmResident, growth);
    std::printf("fixed scenes %016llx at the start, half-way and at the end\n",
                static_cast<unsigned long long>(hashAtStart));
    if (!vorel_test::canWatchMemory()) std::printf("live blocks are not counted in this build\n");
    if (kResidentIsOurs) {
        same &= expect(growth <= kAllowedGrowthKb, "the resident size grows");
    } else {
        std::printf("the resident size is that of a sanitizer or emulator too: not judged\n");
    }
    return same ? 0 : 1;
}
