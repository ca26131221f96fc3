#include <cstdio>
#include <memory>
#include <regex>

#include "case.h"
#include "level.h"
#include "tests/reliability/allocation_watch.h"

/// The most memory that each row of the library holds at one time beside its layers:
///
///     voreleffect_memory [REGEX]
namespace {

using namespace vorel_bench;

void report(const Case& which, const Level& level) {
    level.choose();
    const std::unique_ptr<Job> job = which.make();
    job->reset();
    const vorel_test::PeakMemory peak;
    job->paint();
    const auto held = static_cast<double>(peak.bytes());
    const double working = held - static_cast<double>(job->layerBytes());
    const auto layer = static_cast<double>(job->painted().size);
    std::printf("%-40s %-12s %10.1f KB", which.row.c_str(), level.label.c_str(), working / 1024.0);
    if (layer > 0) std::printf("  %6.2f of its layer", working / layer);
    std::printf("\n");
}

}  // namespace

int main(int argc, char** argv) {
    const std::regex wanted(argc > 1 ? argv[1] : "look/");
    for (const Case& which : allCases()) {
        if (which.maker != kOurs || !std::regex_search(which.row, wanted)) continue;
        for (const Level& level : levels())
            report(which, level);
    }
    return 0;
}
