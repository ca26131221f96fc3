#include "level.h"

#include "tests/support/levels.h"

namespace vorel_bench {

std::vector<Level> levels() {
    const auto here = vorel_test::levelsHere();
    const auto named = [](const char* label, vorel_test::CpuLevel level) {
        return Level{label, [level] { vorel_test::useLevel(level); }};
    };
    // The scalar level is the first; the next one has vectors of 16 bytes on every kind of CPU.
    std::vector<Level> chosen = {named("best", here.back())};
    if (here.size() > 2) chosen.push_back(named("16-byte", here[1]));
    return chosen;
}

}  // namespace vorel_bench
