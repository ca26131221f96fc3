#include <gtest/gtest.h>

#include <cstdio>
#include <string>
#include <utility>
#include <vector>

#include "levels.h"
#include "thinned.h"

/// Runs all tests once for each level of the instruction set that the CPU has.
namespace {

using vorel_test::CpuLevel;

/// Sets the level of an iteration, and names it beside a failure.
class LevelOfIteration : public testing::EmptyTestEventListener {
  public:
    explicit LevelOfIteration(std::vector<CpuLevel> levels) : mLevels(std::move(levels)) {}

  private:
    void OnTestIterationStart(const testing::UnitTest&, int iteration) override {
        mLevel = mLevels[static_cast<size_t>(iteration) % mLevels.size()];
        vorel_test::useLevel(mLevel);
    }
    void OnTestEnd(const testing::TestInfo& info) override {
        if (info.result()->Passed() || info.result()->Skipped()) return;
        std::printf("    at the level %s\n", vorel_test::nameOf(mLevel).c_str());
    }

    std::vector<CpuLevel> mLevels;
    CpuLevel mLevel = CpuLevel::scalar;
};

}  // namespace

int main(int argc, char** argv) {
    const std::vector<CpuLevel> levels = vorel_test::levelsHere();
    testing::FLAGS_gtest_repeat = static_cast<int>(levels.size());
    testing::InitGoogleTest(&argc, argv);
    std::printf("%zu levels; of the random cases of a sweep one in %d\n", levels.size(),
                vorel_test::kThinned);
    testing::UnitTest::GetInstance()->listeners().Append(new LevelOfIteration(levels));
    return RUN_ALL_TESTS();
}
