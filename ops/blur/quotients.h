#pragma once

#include <cstdint>

#include "simd/lanes.h"

namespace VFontEffect::internal::VOREL_LEVEL {

/// Of a sum below 2^23 that began with kNumberBias. With an inverse just above 1 / total the rounded
/// product reaches n exactly when the sum reaches n * total (inverseAbove in blur_weights.h).
VOREL_INLINE U32s quotient(U32s sum, F32s inverse) {
    return bitCast<U32s>(__builtin_convertvector(timesFactor(sum, inverse), I32s));
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
