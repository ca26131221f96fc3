#include "levels.h"

#include <atomic>

namespace vorel_test {

using VFontEffect::internal::kCpuLevels;
using VFontEffect::internal::runsHere;

namespace {

/// Nothing has been set yet while it is negative.
std::atomic<int> chosen{-1};

}  // namespace

void useLevel(CpuLevel level) {
    chosen = static_cast<int>(level);
}

std::vector<CpuLevel> levelsHere() {
    std::vector<CpuLevel> levels;
    for (int i = 0; i < kCpuLevels; ++i) {
        const auto level = static_cast<CpuLevel>(i);
        if (runsHere(level)) levels.push_back(level);
    }
    return levels;
}

#define VOREL_LEVEL_TEXT(level, a, b) #level,
std::string nameOf(CpuLevel level) {
    static const char* const names[] = {"scalar", VOREL_EACH_VECTOR_LEVEL(VOREL_LEVEL_TEXT, , )};
    return names[static_cast<int>(level)];
}
#undef VOREL_LEVEL_TEXT

}  // namespace vorel_test

// In the place of simd/chosen_level.cpp.
namespace VFontEffect::internal {

CpuLevel chosenLevel() {
    const int level = vorel_test::chosen;
    return level < 0 ? vorel_test::levelsHere().back() : static_cast<CpuLevel>(level);
}

}  // namespace VFontEffect::internal
