#include <gtest/gtest.h>

#include <cstdint>
#include <cstdio>

#include "allocation_watch.h"
#include "build_kind.h"
#include "call_sequence.h"
#include "tests/support/thinned.h"

/// Any order of public calls, on sets that share bitmaps, with memory and without.
namespace {

using namespace vorel_test;
using Memory = CallSequence::Memory;

constexpr int kCalls = 120;

/// Makes the calls of a seed. Returns how many were refused memory.
int play(uint64_t seed, Memory memory) {
    CallSequence sequence(seed, memory);
    for (int call = 1; call <= kCalls; ++call) {
        const auto same = sequence.step();
        EXPECT_TRUE(same) << "after call " << call << " of the seed " << seed;
        if (!same) break;
    }
    return sequence.refused();
}

TEST(CallSequences, OnSetsThatShareBitmaps_PaintWhatTheLiteralFormPaints) {
    const int sequences = repetitions(thinned(400));
    for (int seed = 1; seed <= sequences && !HasFailure(); ++seed)
        play(static_cast<uint64_t>(seed), Memory::kPlenty);
}

TEST(CallSequences, RefusedMemoryAtAnyPoint_LeakNothingAndPaintWhatTheLiteralFormPaints) {
    if (!canWatchMemory()) GTEST_SKIP() << "malloc cannot be stood before in this build";
    const int sequences = repetitions(thinned(400));
    int refused = 0;
    for (int seed = 1; seed <= sequences && !HasFailure(); ++seed) {
        const long before = liveBlocks();
        refused += play(static_cast<uint64_t>(seed) << 32, Memory::kRefused);
        EXPECT_EQ(before, liveBlocks()) << "blocks leak, seed " << seed;
    }
    EXPECT_GE(refused, 5 * sequences) << "calls that were refused memory";
    std::printf("[ refusals ] %d calls of %d sequences were refused memory\n", refused, sequences);
}

}  // namespace
