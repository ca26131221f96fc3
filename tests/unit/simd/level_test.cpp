#include <gtest/gtest.h>

#include "simd/cpu_level.h"
#include "tests/support/levels.h"

/// Which levels of the instruction set a CPU has, and which of them the library runs at.
namespace {

using namespace vorel_test;
using VFontEffect::internal::chosenLevel;
using VFontEffect::internal::CpuFeatures;
using VFontEffect::internal::runsHere;
using VFontEffect::internal::suffices;

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

/// A CPU that lacks nothing, or one thing.
CpuFeatures everythingBut(bool CpuFeatures::*missing) {
    CpuFeatures features = {true, true, true, true, true, true};
    if (missing != nullptr) features.*missing = false;
    return features;
}

TEST(Level, EachNeedsAllThatItsCodeUses) {
    EXPECT_TRUE(suffices(everythingBut(nullptr), CpuLevel::avx2));
    EXPECT_FALSE(suffices(everythingBut(&CpuFeatures::avx2), CpuLevel::avx2));
    EXPECT_TRUE(suffices(everythingBut(nullptr), CpuLevel::avx512));
    for (const auto feature : {&CpuFeatures::avx512f, &CpuFeatures::avx512bw, &CpuFeatures::avx512dq,
                               &CpuFeatures::avx512vl, &CpuFeatures::avx512vnni}) {
        EXPECT_FALSE(suffices(everythingBut(feature), CpuLevel::avx512));
        EXPECT_TRUE(suffices(everythingBut(feature), CpuLevel::avx2));
    }
}

TEST(Level, TheSixteenByteLevelNeedsNothing) {
    EXPECT_TRUE(suffices(CpuFeatures{}, CpuLevel::sse2));
    EXPECT_TRUE(suffices(CpuFeatures{}, CpuLevel::scalar));
}
#elif defined(__aarch64__)
TEST(Level, SixteenByteVectorsRunOnEveryArm) {
    EXPECT_TRUE(runsHere(CpuLevel::neon));
    EXPECT_TRUE(suffices(CpuFeatures{}, CpuLevel::neon));
}

TEST(Level, DotProductsAreAskedFor) {
    EXPECT_FALSE(suffices(CpuFeatures{false}, CpuLevel::dotprod));
    EXPECT_TRUE(suffices(CpuFeatures{true}, CpuLevel::dotprod));
}
#endif

}  // namespace
