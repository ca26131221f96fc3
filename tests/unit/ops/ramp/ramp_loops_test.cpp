#include "ops/ramp/ramp_loops.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <vector>

#include "tests/support/plans.h"

namespace {

using VFontEffect::internal::kFadedValues;

TEST(RampLoops, EveryValueAndAlpha_FadesByWholeQuotients) {
    // Also of counts that fill no vector.
    for (uint32_t alpha = 0; alpha <= 255; ++alpha) {
        std::vector<uint8_t> values;
        std::vector<uint8_t> expected;
        for (uint32_t value = 0; value <= 255; ++value) {
            const uint32_t factor = std::min(256 * value / kFadedValues, 256U);
            values.push_back(static_cast<uint8_t>(value));
            expected.push_back(static_cast<uint8_t>(alpha * factor >> 8));
        }
        values.resize(256 - alpha % 70);
        expected.resize(values.size());
        ASSERT_EQ(vorel_test::faded(values, alpha), expected) << "alpha " << alpha;
    }
}

}  // namespace
