#pragma once

#include <cstdint>
#include <limits>

#include "core/assert.h"
#include "core/inline.h"
#include "core/strict_math.h"

namespace VFontEffect::internal {

/// Every conversion from floating point to a signed integer goes through here: toward zero,
/// saturating at the limits of 32 bits, NaN to 0, as 64-bit ARM converts. A plain cast would be
/// undefined outside the range and differs between CPUs.
template <class Real>
VOREL_INLINE int32_t toInt(Real value) {
    if (!(value == value)) return 0;
    if (value >= static_cast<Real>(2147483648.0)) return INT32_MAX;
    if (value < static_cast<Real>(-2147483648.0)) return INT32_MIN;
    return static_cast<int32_t>(value);
}

/// The value inside [low, high]; a NaN, not being above `low`, gives `low`.
inline float clampOrLow(float value, float low, float high) {
    if (!(value > low)) return low;
    return value < high ? value : high;
}

/// The value inside [low, high]; a NaN, being neither below nor above, stays.
inline float clampKeepingNan(float value, float low, float high) {
    if (value < low) return low;
    return value > high ? high : value;
}

/// The angle cut to whole degrees, modulo `turn`. The result keeps the angle's sign.
inline int32_t reducedDegrees(float degrees, int32_t turn) {
    return toInt(degrees) % turn;
}

/// The angle cut to whole degrees and brought into 0..turn - 1.
inline int32_t wholeDegrees(float degrees, int32_t turn) {
    const int32_t reduced = reducedDegrees(degrees, turn);
    return reduced < 0 ? reduced + turn : reduced;
}

/// A value of 0 or more, rounded up to a whole multiple.
VOREL_INLINE int64_t roundedUp(int64_t value, int64_t multiple) {
    VOREL_ASSERT(value >= 0);
    return (value + multiple - 1) / multiple * multiple;
}

/// A 64-bit coordinate clamped to the range of an int.
inline int saturateToInt(int64_t value) {
    constexpr int64_t kLow = std::numeric_limits<int>::min();
    constexpr int64_t kHigh = std::numeric_limits<int>::max();
    return static_cast<int>(value < kLow ? kLow : value > kHigh ? kHigh : value);
}

}  // namespace VFontEffect::internal
