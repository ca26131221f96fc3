#pragma once

#include "simd/vectors.h"

/// The scalar level: a vector is one 32-bit word, in plain C++ for any CPU. The others are compared with
/// it.
namespace VFontEffect::internal::VOREL_LEVEL {

VOREL_INLINE U8s addSaturated(U8s a, U8s b) {
    const U8s sum = a + b;
    return sum | bitCast<U8s>(sum < a);
}
VOREL_INLINE U8s subSaturated(U8s a, U8s b) { return (a - b) & bitCast<U8s>(a > b); }
VOREL_INLINE U16s multiplyHigh(U16s a, U16s b) {
    const auto high = [](uint32_t x, uint32_t y) { return static_cast<uint16_t>((x * y) >> 16); };
    return U16s{high(a[0], b[0]), high(a[1], b[1])};
}
VOREL_INLINE bool allZero(U8s v) { return bitCast<U32s>(v)[0] == 0; }
constexpr int kLaneBits = 8;
VOREL_INLINE uint64_t nonZeroLanes(U8s v) { return bitCast<U32s>(v != 0)[0]; }
constexpr int kAmountShift = 0;
VOREL_INLINE U16s loadInPairs(const uint8_t* from) { return bitCast<U16s>(U32s{*from * 0x10001U}); }
VOREL_INLINE U16s highBytesInPairs(U8s v) { return bitCast<U16s>((bitCast<U32s>(v) >> 24) * 0x10001U); }
VOREL_INLINE U8s swapRedBlue(U8s v) { return U8s{v[2], v[1], v[0], v[3]}; }
VOREL_INLINE I32s toInt(F32s v) { return I32s{internal::toInt(v[0])}; }
VOREL_INLINE F32s squareRoot(F32s v) { return F32s{__builtin_sqrtf(v[0])}; }

VOREL_INLINE U16s widenLow(U8s v) { return U16s{v[0], v[1]}; }
VOREL_INLINE U16s widenHigh(U8s v) { return U16s{v[2], v[3]}; }
VOREL_INLINE U8s narrow(U16s a, U16s b) {
    return __builtin_convertvector(__builtin_shufflevector(a, b, 0, 1, 2, 3), U8s);
}
VOREL_INLINE U8s interleaveLow(U8s a, U8s b) { return U8s{a[0], b[0], a[1], b[1]}; }
VOREL_INLINE U8s interleaveHigh(U8s a, U8s b) { return U8s{a[2], b[2], a[3], b[3]}; }
VOREL_INLINE U16s interleaveLow(U16s a, U16s b) { return U16s{a[0], b[0]}; }
VOREL_INLINE U16s interleaveHigh(U16s a, U16s b) { return U16s{a[1], b[1]}; }
VOREL_INLINE U16s pack(U32s a, U32s b) { return bitCast<U16s>(a | b << 16); }
VOREL_INLINE U8s pack(U16s a, U16s b) { return narrow(a, b); }
VOREL_INLINE U16s pairSums(U8s v) { return (bitCast<U16s>(v) & 0x00FF) + (bitCast<U16s>(v) >> 8); }
VOREL_INLINE U8s quarters(U16s even, U16s odd) {
    const auto quarter = [](uint32_t sum) { return static_cast<uint8_t>(sum > 1023 ? 255 : sum >> 2); };
    return U8s{quarter(even[0]), quarter(odd[0]), quarter(even[1]), quarter(odd[1])};
}

constexpr uint8_t kTapBias = 0;
template <int64_t kFour>
VOREL_INLINE U32s addDots(U32s sums, U8s taps, const uint8_t* weights) {
    const uint8_t* const w = weights + 4 * kFour;
    return sums + (w[0] * taps[0] + w[1] * taps[1] + w[2] * taps[2] + w[3] * taps[3]);
}
}  // namespace VFontEffect::internal::VOREL_LEVEL
