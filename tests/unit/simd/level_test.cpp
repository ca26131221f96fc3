#include <gtest/gtest.h>

#include "simd/cpu_level.h"
#include "tests/support/levels.h"

/// Which levels of the instruction set a CPU has, and which of them the library runs at.
namespace {

using namespace vorel_test;
using VFontEffect::internal::chosenLevel;
using VFontEffect::internal::runsHere;

TEST(Level, ScalarRunsAnywhere) {
    EXPECT_TRUE(runsHere(CpuLevel::scalar));
    EXPECT_EQ(CpuLevel::scalar, levelsHere().front());
}

TEST(Level, TheLibraryChoosesTheBest) {
    EXPECT_EQ(levelsHere().back(), chosenLevel());
}

#if defined(__x86_64__)
TEST(Level, SixteenByteVectorsRunOnEveryX86) {
    EXPECT_TRUE(runsHere(CpuLevel::sse2));
}

TEST(Level, ABetterLevelHasWhatThePlainerOnesHave) {
    EXPECT_TRUE(!runsHere(CpuLevel::avx512) || runsHere(CpuLevel::avx2));
}
#elif defined(__aarch64__)
TEST(Level, SixteenByteVectorsRunOnEveryArm) {
    EXPECT_TRUE(runsHere(CpuLevel::neon));
}
#endif

}  // namespace
