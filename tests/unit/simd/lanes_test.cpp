#include <gtest/gtest.h>

#include "tests/support/core_compare.h"
#include "tests/support/plans.h"

namespace {

TEST(Lanes, EveryOperation_DoesInAVectorWhatALoopDoes) {
    for (uint64_t seed = 0; seed < 3000; ++seed) {
        const char* const wrong = vorel_test::wrongLanesOperation(seed);
        ASSERT_EQ(wrong, nullptr) << wrong << ", seed " << seed;
    }
}

}  // namespace
