#pragma once

#include "simd/vectors.h"

/// Taps of dot products for levels of 16 bytes that multiply 16-bit lanes and add the products in pairs:
/// what they say alike, but for that product itself.
namespace VFontEffect::internal::VOREL_LEVEL {

#define VOREL_NATIVE_TAPS
/// Taps 0 and 2 of each word, and taps 1 and 3. The cell of a tap holds its weight and that of the next
/// but one.
struct Taps {
    U16s even;
    U16s odd;
};
using WeightCell = U16s;

VOREL_INLINE Taps tapsOf(U8s v) { return {bitCast<U16s>(v) & 0x00FF, bitCast<U16s>(v) >> 8}; }
VOREL_INLINE WeightCell cellOf(const uint8_t* weights) {
    return bitCast<U16s>(splat<U32s>(weights[0] | uint32_t{weights[2]} << 16));
}

constexpr uint8_t kTapBias = 0;

}  // namespace VFontEffect::internal::VOREL_LEVEL
