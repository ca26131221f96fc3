#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <limits>
#include <memory>
#include <string>
#include <vector>

#include "case.h"
#include "tests/support/levels.h"

/// Times rows at the scalar level, at that of 16 bytes and in the literal form, by nothing but a clock,
/// so on any machine; one line each: the row, the maker, microseconds of the fastest call.
///
///     voreleffect_rows ROUNDS START...    the rows that begin like that, look/A ...
namespace {

using namespace vorel_bench;
using Clock = std::chrono::steady_clock;

/// A row by one maker.
struct Subject {
    const Case* which;
    const vorel_test::CpuLevel* level;  ///< null for what has none
    std::unique_ptr<Job> job;
    double fastest = std::numeric_limits<double>::infinity();
};

double timedCall(Job& job) {
    const Clock::time_point before = Clock::now();
    job.paint();
    return std::chrono::duration<double, std::micro>(Clock::now() - before).count();
}

/// Short jobs are called often, long ones once a round.
void run(Subject& subject) {
    constexpr double kMicrosecondsOfRound = 20000;
    if (subject.level != nullptr) vorel_test::useLevel(*subject.level);
    for (double taken = 0; taken < kMicrosecondsOfRound;) {
        subject.job->reset();
        const double call = timedCall(*subject.job);
        subject.fastest = std::min(subject.fastest, call);
        taken += call;
    }
}

std::string nameOf(const Subject& subject) {
    return subject.level == nullptr ? subject.which->maker : vorel_test::nameOf(*subject.level);
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 3) {
        std::fprintf(stderr, "usage: voreleffect_rows ROUNDS START...\n");
        return 2;
    }
    const int rounds = std::atoi(argv[1]);
    const std::vector<std::string> starts(argv + 2, argv + argc);
    const Cases cases = allCases();
    const std::vector<vorel_test::CpuLevel> levels = vorel_test::levelsHere();
    std::vector<Subject> subjects;
    for (const Case& which : cases) {
        const auto begins = [&](const std::string& start) { return which.row.rfind(start, 0) == 0; };
        if (std::none_of(starts.begin(), starts.end(), begins)) continue;
        if (which.maker == kLiteral) subjects.push_back({&which, nullptr, which.make()});
        if (which.maker != kOurs) continue;
        // The scalar level is the first; the next one has vectors of 16 bytes on every kind of CPU.
        for (size_t i = 0; i < 2 && i < levels.size(); ++i)
            subjects.push_back({&which, &levels[i], which.make()});
    }
    for (int round = 0; round < rounds; ++round) {
        for (Subject& subject : subjects)
            run(subject);
    }
    for (const Subject& subject : subjects)
        std::printf("%s %s %.3f\n", subject.which->row.c_str(), nameOf(subject).c_str(),
                    subject.fastest);
    return 0;
}
