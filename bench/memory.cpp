#include <cstdio>
#include <memory>
#include <regex>

#include "case.h"
#include "level.h"
#include "tests/reliability/allocation_watch.h"

/// The most memory that each row of the library holds at one time beside its layers, also in sizes of
/// the picture that it paints:
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
    const double working = static_cast<double>(peak.bytes()) - static_cast<double>(job->layerBytes());
    const auto layer = static_cast<double>(job->painted().size);
    std::printf("| %-32s | %-7s | %9.1f |", which.row.c_str(), level.label.c_str(), working / 1024.0);
    if (layer > 0) {
        std::printf(" %6.2f |\n", working / layer);
    } else {
        std::printf(" %6s |\n", "");
    }
}

}  // namespace

int main(int argc, char** argv) {
    std::printf("| %-32s | %-7s | %9s | %6s |\n", "row", "level", "KB", "layers");
    std::printf("| -------------------------------- | ------- | --------: | -----: |\n");
    const std::regex wanted(argc > 1 ? argv[1] : "look/");
    for (const Case& which : allCases()) {
        if (which.maker != kOurs || !std::regex_search(which.row, wanted)) continue;
        for (const Level& level : levels())
            report(which, level);
    }
    return 0;
}
