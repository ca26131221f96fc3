#include "core/pixel_buffer.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <utility>

/// Working memory: its limit, its contents and its owner.
namespace {

using VFontEffect::internal::PixelBuffer;

constexpr int64_t kMostBytes = int64_t{1} << 32;

template <class T>
void expectRefusedBeyondTheLimit() {
    constexpr int64_t kMost = kMostBytes / int64_t{sizeof(T)};
    EXPECT_FALSE(PixelBuffer<T>::uninitialised(kMost + 1));
    EXPECT_FALSE(PixelBuffer<T>::zeroed(kMost + 1));
    EXPECT_FALSE(PixelBuffer<T>::uninitialised(kMost / 2, 3));
    EXPECT_FALSE(PixelBuffer<T>::uninitialised(INT64_MAX, INT64_MAX));
    EXPECT_FALSE(PixelBuffer<T>::uninitialised(INT64_MAX / 2 + 1, 4));
}

TEST(PixelBuffer, BeyondFourGigabytes_IsRefusedWhateverAnElementTakes) {
    expectRefusedBeyondTheLimit<uint8_t>();
    expectRefusedBeyondTheLimit<uint16_t>();
    expectRefusedBeyondTheLimit<uint32_t>();
    expectRefusedBeyondTheLimit<uint64_t>();
}

TEST(PixelBuffer, BeyondWhatPointersSpan_IsRefused) {
    constexpr int64_t kMost = std::min<int64_t>(kMostBytes, PTRDIFF_MAX);
    EXPECT_FALSE(PixelBuffer<uint8_t>::uninitialised(kMost + 1));
    // Where a size has 32 bits this is one of no bytes.
    const int64_t wrapped = kMostBytes;
    if (sizeof(size_t) == 4) {
        EXPECT_FALSE(PixelBuffer<uint8_t>::uninitialised(wrapped));
        EXPECT_FALSE(PixelBuffer<uint32_t>::zeroed(wrapped / 8, 2));
    }
}

TEST(PixelBuffer, NegativeSides_AreRefused) {
    EXPECT_FALSE(PixelBuffer<uint8_t>::uninitialised(-1));
    EXPECT_FALSE(PixelBuffer<uint8_t>::uninitialised(-1, -1));
    EXPECT_FALSE(PixelBuffer<uint32_t>::zeroed(1, -1));
}

TEST(PixelBuffer, WithoutElements_IsNoFailure) {
    EXPECT_TRUE(PixelBuffer<uint32_t>::uninitialised(0));
    EXPECT_TRUE(PixelBuffer<uint32_t>::zeroed(INT64_MAX, 0));
}

TEST(PixelBuffer, Zeroed_IsZero) {
    auto buffer = PixelBuffer<uint32_t>::zeroed(100, 7);
    ASSERT_TRUE(buffer);
    for (size_t i = 0; i < 700; ++i)
        EXPECT_EQ(0U, buffer[i]) << i;
}

TEST(PixelBuffer, Moved_LeavesNothingBehind) {
    auto buffer = PixelBuffer<uint8_t>::zeroed(3);
    uint8_t* const block = buffer.data();
    const PixelBuffer<uint8_t> taken = std::move(buffer);
    EXPECT_EQ(block, taken.data());
    EXPECT_FALSE(buffer);
}

}  // namespace
