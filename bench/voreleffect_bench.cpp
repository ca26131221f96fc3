#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <limits>
#include <memory>
#include <regex>
#include <string>
#include <vector>

#include "case.h"
#include "fastest_call.h"
#include "level.h"

/// Times every case; see docs/benchmarks.md.
///
///     voreleffect_bench [options of Google Benchmark]
///     voreleffect_bench --check [REGEX]    compares the library with the literal form instead
namespace {

using namespace vorel_bench;

/// What a benchmark remembers from repetition to repetition.
struct Memory {
    double inCalls = 0.0;
    double inAll = 0.0;  ///< with the refills
    double fastest = std::numeric_limits<double>::infinity();

    /// What takes seconds is sampled seldom: past these budgets a case is not painted again.
    bool usedUp() const { return inCalls > 1.5 || inAll > 8.0; }
};

/// The seconds of one call. The refill of the destination is not part of them.
double timedCall(Job& job, Memory& memory) {
    job.reset();
    const clockid_t clock = clockFor(memory.fastest);
    const double before = now(clock);
    job.paint();
    const double after = now(clock);
    benchmark::ClobberMemory();
    memory.inCalls += after - before;
    return after - before;
}

double middleOf(std::vector<double> calls) {
    const auto middle = calls.begin() + static_cast<std::ptrdiff_t>(calls.size() / 2);
    std::nth_element(calls.begin(), middle, calls.end());
    return *middle;
}

/// The counters `fastest` and `middle` are seconds of single calls.
void measure(benchmark::State& state, const Case& which, const Level* level, Memory& memory) {
    const double start = now(CLOCK_MONOTONIC);
    const bool remembered = memory.usedUp();
    std::unique_ptr<Job> job;
    if (!remembered) {
        if (level != nullptr) level->choose();
        job = which.make();
        timedCall(*job, memory);  // meets cold code and fresh pages
    }
    std::vector<double> calls;
    for (auto _ : state) {
        calls.push_back(remembered ? memory.fastest : timedCall(*job, memory));
        memory.fastest = std::min(memory.fastest, calls.back());
        state.SetIterationTime(calls.back());
    }
    memory.inAll += now(CLOCK_MONOTONIC) - start;
    state.counters["fastest"] = memory.fastest;
    state.counters["middle"] = middleOf(calls);
    state.counters["pixels"] = static_cast<double>(which.pixels);
}

double smallest(const std::vector<double>& values) {
    return *std::min_element(values.begin(), values.end());
}

void registerCase(const Case& which, const Level* level) {
    const std::string name = which.row + "/" + (level != nullptr ? level->label : which.maker);
    const auto memory = std::make_shared<Memory>();
    benchmark::RegisterBenchmark(name.c_str(),
                                 [=](benchmark::State& state) { measure(state, which, level, *memory); })
        ->UseManualTime()
        ->ComputeStatistics("min", smallest)
        ->Unit(benchmark::kMicrosecond);
}

bool samePixels(const Case& ours, const Case& literal) {
    const std::unique_ptr<Job> jobs[] = {ours.make(), literal.make()};
    for (const std::unique_ptr<Job>& job : jobs) {
        job->reset();
        job->paint();
    }
    const Bytes a = jobs[0]->painted();
    const Bytes b = jobs[1]->painted();
    return a.size > 0 && a.size == b.size && std::memcmp(a.data, b.data, a.size) == 0;
}

/// Paints every row that has a literal form once, at every level. The rows whose forms take seconds
/// are only checked when the expression names them.
int check(const Cases& cases, const std::vector<Level>& levels, const std::string& expression) {
    const std::regex wanted(expression);
    int checked = 0;
    int wrong = 0;
    for (const Case& literal : cases) {
        if (literal.maker != kLiteral || !std::regex_search(literal.row, wanted)) continue;
        const auto ours = std::find_if(cases.begin(), cases.end(), [&](const Case& other) {
            return other.maker == kOurs && other.row == literal.row;
        });
        for (const Level& level : levels) {
            level.choose();
            ++checked;
            if (samePixels(*ours, literal)) continue;
            ++wrong;
            std::printf("%s at level %s differs from the literal form\n", literal.row.c_str(),
                        level.label.c_str());
        }
    }
    std::printf("%d rows compared with the literal form, %d differ\n", checked, wrong);
    return wrong == 0 && checked > 0 ? 0 : 1;
}

}  // namespace

int main(int argc, char** argv) {
    const Cases cases = allCases();
    static const std::vector<Level> kLevels = levels();
    if (argc > 1 && std::strcmp(argv[1], "--check") == 0) {
        return check(cases, kLevels, argc > 2 ? argv[2] : "R:[1-8]$|47|blend|fill|look");
    }

    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    for (const Case& which : cases) {
        if (which.maker != kOurs) {
            registerCase(which, nullptr);
            continue;
        }
        for (const Level& level : kLevels)
            registerCase(which, &level);
    }
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
