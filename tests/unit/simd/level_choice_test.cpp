#include <gtest/gtest.h>

#include "simd/cpu_level.h"

/// Which level the library chooses of those that a CPU has: any CPU, told by the test.
namespace VFontEffect::internal {
namespace {

int bestLevelThere = 0;
int questions = 0;

}  // namespace

/// In the place of the CPU's answer: the levels up to the best one run.
bool runsHere(CpuLevel level) {
    ++questions;
    return static_cast<int>(level) <= bestLevelThere;
}

namespace {

TEST(LevelChoice, IsTheBestThatRuns) {
    for (bestLevelThere = kPlainestLevel; bestLevelThere < kCpuLevels; ++bestLevelThere)
        EXPECT_EQ(static_cast<CpuLevel>(bestLevelThere), chosenLevel()) << bestLevelThere;
}

TEST(LevelChoice, IsThePlainestWhereNoneRuns) {
    bestLevelThere = -1;
    EXPECT_EQ(static_cast<CpuLevel>(kPlainestLevel), chosenLevel());
}

TEST(LevelChoice, IsAskedAnewEachTime) {
    bestLevelThere = kCpuLevels - 1;
    chosenLevel();
    questions = 0;
    chosenLevel();
    EXPECT_GT(questions, 0);
}

}  // namespace
}  // namespace VFontEffect::internal
