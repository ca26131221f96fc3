#pragma once

#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

namespace vorelpaint {

/// Collects bits, the first one lowest in its byte.
class BitWriter {
  public:
    /// Where bits go, for a while in which so many are known to come. To be a local variable, whose
    /// members are not taken for the bytes that are written.
    class Cursor {
      public:
        /// Adds `count` bits, at most 32; those above them are 0.
        void put(uint64_t bits, unsigned int count) {
            mBits |= bits << mCount;
            mCount += count;
            if (mCount < 32) return;
            for (unsigned int i = 0; i < 4; ++i)
                mTo[i] = static_cast<uint8_t>(mBits >> (8 * i));
            mTo += 4;
            mBits >>= 32;
            mCount -= 32;
        }

      private:
        friend class BitWriter;
        uint8_t* mTo;
        uint64_t mBits;
        unsigned int mCount;
    };

    /// For at most so many bits.
    Cursor begin(size_t bits) {
        constexpr size_t kSpare = 8;  // for bits that wait, and the rest of a byte
        mBytes.resize(mAt + bits / 8 + kSpare);
        Cursor cursor;
        cursor.mTo = mBytes.data() + mAt;
        cursor.mBits = mBits;
        cursor.mCount = mCount;
        return cursor;
    }

    /// Takes over what the cursor of the last begin() has written.
    void end(const Cursor& cursor) {
        mAt = static_cast<size_t>(cursor.mTo - mBytes.data());
        mBits = cursor.mBits;
        mCount = cursor.mCount;
    }

    /// The bytes; the last one is filled up with 0.
    std::vector<uint8_t> finish() {
        mBytes.resize(mAt);
        for (unsigned int i = 0; i < mCount; i += 8)
            mBytes.push_back(static_cast<uint8_t>(mBits >> i));
        return std::move(mBytes);
    }

  private:
    std::vector<uint8_t> mBytes;
    size_t mAt = 0;
    uint64_t mBits = 0;
    unsigned int mCount = 0;
};

}  // namespace vorelpaint
