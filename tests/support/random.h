#pragma once

#include <cstdint>

namespace vorel_test {

/// A small seeded generator (xorshift64*), the same numbers on every platform.
class Random {
  public:
    explicit Random(uint64_t seed) : mState(seed * 2685821657736338717ULL + 88172645463325252ULL) {}

    uint32_t next() {
        mState ^= mState >> 12;
        mState ^= mState << 25;
        mState ^= mState >> 27;
        return static_cast<uint32_t>((mState * 2685821657736338717ULL) >> 32);
    }

    /// A whole number from `low` to `high`, both included.
    int between(int low, int high) {
        const auto span = static_cast<uint64_t>(static_cast<int64_t>(high) - low + 1);
        return static_cast<int>(low + static_cast<int64_t>(next() % span));
    }

    float real(float low, float high) {
        return low + (high - low) * (static_cast<float>(next() >> 8) / 16777216.0F);
    }

    bool chance(int percent) { return between(1, 100) <= percent; }
    uint8_t byte() { return static_cast<uint8_t>(next() >> 24); }

  private:
    uint64_t mState;
};

}  // namespace vorel_test
