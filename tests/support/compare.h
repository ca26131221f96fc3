#pragma once

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>

namespace vorel_test {

/// Compares two packed images byte for byte; a failure names the first ten differing pixels.
inline ::testing::AssertionResult sameBytes(const uint8_t* expected, const uint8_t* actual, int width,
                                            int height, int bytesPerPixel) {
    const size_t pixels = static_cast<size_t>(width) * static_cast<size_t>(height);
    size_t different = 0;
    ::testing::AssertionResult failure = ::testing::AssertionFailure();
    for (size_t i = 0; i < pixels; ++i) {
        const size_t at = i * static_cast<size_t>(bytesPerPixel);
        bool same = true;
        for (int c = 0; c < bytesPerPixel; ++c) {
            same = same && expected[at + static_cast<size_t>(c)] == actual[at + static_cast<size_t>(c)];
        }
        if (same || ++different > 10) continue;
        failure << "(" << i % static_cast<size_t>(width) << ", " << i / static_cast<size_t>(width)
                << ") expected";
        for (int c = 0; c < bytesPerPixel; ++c)
            failure << " " << int{expected[at + static_cast<size_t>(c)]};
        failure << " actual";
        for (int c = 0; c < bytesPerPixel; ++c)
            failure << " " << int{actual[at + static_cast<size_t>(c)]};
        failure << "\n";
    }
    if (different == 0) return ::testing::AssertionSuccess();
    return failure << different << " of " << pixels << " pixels differ";
}

}  // namespace vorel_test
