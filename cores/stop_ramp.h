#pragma once

#include <cstdint>

#include "core/numeric.h"
#include "voreleffect/VFBitmap.h"

namespace VFontEffect::internal {

/// Tables of colours along a ramp have 257 entries; entry i stands at position i / 256.
constexpr int kTableSize = 257;
constexpr int kTableLast = kTableSize - 1;

inline float tablePosition(int entry) {
    return static_cast<float>(entry) * 0.00390625F;
}

/// The mix of two straight colours, all four bytes alike, two of them at a time; weight 0..256.
inline uint32_t mixedColours(uint32_t lower, uint32_t upper, uint32_t weight) {
    constexpr uint32_t kEven = 0x00FF00FFU;
    const uint32_t rest = 256 - weight;
    const uint32_t low = ((weight * (upper & kEven) + rest * (lower & kEven)) >> 8) & kEven;
    const uint32_t high = (weight * ((upper >> 8) & kEven) + rest * ((lower >> 8) & kEven)) & ~kEven;
    return low | high;
}

/// Walks the segments between stops as a table is filled from its start.
///
/// Deliberate: a call moves on by one segment at most, even when the position has passed several
/// stops, so stops closer together than a table entry take effect one entry late. When no stop is
/// left the last segment stays.
class StopRamp {
  public:
    /// `count` of 2 or more; the first segment runs from `start` to the position of stop 1.
    StopRamp(const VFGradient* stops, int count, float start)
        : mStops(stops),
          mCount(count),
          mLower(stops[0].mColor),
          mUpper(stops[1].mColor),
          mStart(start),
          mEnd(stops[1].mLocation),
          mSpan(mEnd - start) {}

    /// The colour at a position; positions of successive calls ascend.
    uint32_t colourAt(float position) {
        if (mEnd < position && mNext < mCount) moveOn();
        const int32_t weight = toInt((position - mStart) / mSpan * 256.0F);
        if (weight < 1) return mLower;
        return weight >= 256 ? mUpper : mixedColours(mLower, mUpper, static_cast<uint32_t>(weight));
    }

  private:
    void moveOn() {
        const VFGradient& next = mStops[mNext++];
        mStart = mEnd;
        mLower = mUpper;
        mSpan = next.mLocation - mEnd;
        mEnd = next.mLocation;
        mUpper = next.mColor;
    }

    const VFGradient* mStops;
    int mCount;
    int mNext = 2;
    uint32_t mLower;
    uint32_t mUpper;
    float mStart;
    float mEnd;
    float mSpan;
};

}  // namespace VFontEffect::internal
