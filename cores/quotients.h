#pragma once

#include <cstdint>

#include "blend/lanes.h"

/// Division of a blur's sums, which are whole numbers below 2^23 and exact as floats. With an inverse
/// just above 1 / total the rounded product reaches n exactly when the sum reaches n * total, as long as
/// the total is at most 26,000 (blur_kernel.h).
namespace VFontEffect::internal::VOREL_LEVEL {

#if defined(VOREL_AVX512)
/// The bits of 2^23 as a float: with them before it a sum is the float 2^23 + sum, unconverted. The
/// fused product takes 2^23 * inverse away again, exactly, and so rounds sum * inverse once, as any
/// other does.
constexpr uint32_t kSumStart = 0x4B000000;
VOREL_INLINE Floats timesInverse(Words sum, Floats inverse) {
    return multipliedSum(as<Floats>(sum), inverse, inverse * -8388608.0F);
}
#else
constexpr uint32_t kSumStart = 0;
VOREL_INLINE Floats timesInverse(Words sum, Floats inverse) {
    return __builtin_convertvector(as<Integers>(sum), Floats) * inverse;
}
#endif

/// Of a sum that began with kSumStart.
VOREL_INLINE Words quotient(Words sum, Floats inverse) {
    return as<Words>(__builtin_convertvector(timesInverse(sum, inverse), Integers));
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
