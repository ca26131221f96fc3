#pragma once

#include <cstdint>

#include "core/coverage_rows.h"
#include "simd/lanes.h"

/// What both strategies of the blur begin and end with.
namespace VFontEffect::internal::VOREL_LEVEL {

/// A strip of the source: `count` columns from `x` on, as many as a vector holds at most.
struct SourceStrip {
    const uint8_t* start;
    int64_t stride;
    int64_t height;
    int64_t count;
    U8s invertMask;

    static SourceStrip of(const CoverageRows& source, int64_t x) {
        const int64_t left = source.width - x;
        const int64_t count = left < kBytes ? left : int64_t{kBytes};
        return {source.start + x, source.stride, source.height, count,
                splat<U8s>(source.invertMask) & firstBytes(count)};
    }

    bool has(int64_t y) const { return y >= 0 && y < height; }
    VOREL_INLINE U8s row(int64_t y) const {
        const uint8_t* const from = start + y * stride;
        return (count == kBytes ? load<U8s>(from) : loadFirst(from, count)) ^ invertMask;
    }
};

/// Of a sum below 2^23 that began with kNumberBias. With an inverse just above 1 / total the rounded
/// product reaches n exactly when the sum reaches n * total (inverseAbove in blur_weights.h).
VOREL_INLINE U32s quotient(U32s sum, F32s inverse) {
    return bitCast<U32s>(__builtin_convertvector(timesFactor(sum, inverse), I32s));
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
