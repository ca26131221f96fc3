#pragma once

#include <wasm_simd128.h>

#include "simd/vectors.h"

#if !defined(__wasm_simd128__) || defined(__wasm_relaxed_simd__)
#error "the level simd128 is compiled with the flags of its name"
#endif

#include "simd/taps_in_pairs.h"

/// The vectors of WebAssembly: 16 bytes. Relaxed ones, whose results depend on the CPU, are not used.
namespace VFontEffect::internal::VOREL_LEVEL {

template <class V>
VOREL_INLINE v128_t bits(V v) {
    return bitCast<v128_t>(v);
}

VOREL_INLINE U8s addSaturated(U8s a, U8s b) {
    return bitCast<U8s>(wasm_u8x16_add_sat(bits(a), bits(b)));
}
VOREL_INLINE U8s subSaturated(U8s a, U8s b) {
    return bitCast<U8s>(wasm_u8x16_sub_sat(bits(a), bits(b)));
}
VOREL_INLINE U16s multiplyHigh(U16s a, U16s b) {
    const v128_t low = wasm_u32x4_extmul_low_u16x8(bits(a), bits(b));
    const v128_t high = wasm_u32x4_extmul_high_u16x8(bits(a), bits(b));
    return bitCast<U16s>(wasm_i16x8_shuffle(low, high, 1, 3, 5, 7, 9, 11, 13, 15));
}
VOREL_INLINE bool allZero(U8s v) { return !wasm_v128_any_true(bits(v)); }
constexpr int kLaneBits = 1;
VOREL_INLINE uint64_t nonZeroLanes(U8s v) { return wasm_i8x16_bitmask(bits(v != 0)); }
VOREL_INLINE I32s toInt(F32s v) { return bitCast<I32s>(wasm_i32x4_trunc_sat_f32x4(bits(v))); }
VOREL_INLINE F32s squareRoot(F32s v) { return bitCast<F32s>(wasm_f32x4_sqrt(bits(v))); }

constexpr int kAmountShift = 0;
// By indices in a register, of which -1 gives 0: with shuffles of a vector and zeros in their place
// blends take a quarter more time in V8 (blend/mask-mode1/random).
VOREL_INLINE U16s loadInPairs(const uint8_t* from) {
    return bitCast<U16s>(
        wasm_i8x16_swizzle(wasm_v128_load32_zero(from),
                           wasm_i8x16_const(0, -1, 0, -1, 1, -1, 1, -1, 2, -1, 2, -1, 3, -1, 3, -1)));
}
VOREL_INLINE U16s highBytesInPairs(U8s v) {
    return bitCast<U16s>(wasm_i8x16_swizzle(
        bits(v), wasm_i8x16_const(3, -1, 3, -1, 7, -1, 7, -1, 11, -1, 11, -1, 15, -1, 15, -1)));
}
VOREL_INLINE U8s swapRedBlue(U8s v) {
    return bitCast<U8s>(
        wasm_i8x16_shuffle(bits(v), bits(v), 2, 1, 0, 3, 6, 5, 4, 7, 10, 9, 8, 11, 14, 13, 12, 15));
}
VOREL_INLINE U16s widenLow(U8s v) { return bitCast<U16s>(wasm_u16x8_extend_low_u8x16(bits(v))); }
VOREL_INLINE U16s widenHigh(U8s v) { return bitCast<U16s>(wasm_u16x8_extend_high_u8x16(bits(v))); }
VOREL_INLINE U8s interleaveLow(U8s a, U8s b) {
    return bitCast<U8s>(
        wasm_i8x16_shuffle(bits(a), bits(b), 0, 16, 1, 17, 2, 18, 3, 19, 4, 20, 5, 21, 6, 22, 7, 23));
}
VOREL_INLINE U8s interleaveHigh(U8s a, U8s b) {
    return bitCast<U8s>(wasm_i8x16_shuffle(bits(a), bits(b), 8, 24, 9, 25, 10, 26, 11, 27, 12, 28, 13,
                                           29, 14, 30, 15, 31));
}
VOREL_INLINE U16s interleaveLow(U16s a, U16s b) {
    return bitCast<U16s>(wasm_i16x8_shuffle(bits(a), bits(b), 0, 8, 1, 9, 2, 10, 3, 11));
}
VOREL_INLINE U16s interleaveHigh(U16s a, U16s b) {
    return bitCast<U16s>(wasm_i16x8_shuffle(bits(a), bits(b), 4, 12, 5, 13, 6, 14, 7, 15));
}
VOREL_INLINE U16s pack(U32s a, U32s b) {
    return bitCast<U16s>(wasm_i16x8_narrow_i32x4(bits(a), bits(b)));
}
VOREL_INLINE U8s pack(U16s a, U16s b) { return bitCast<U8s>(wasm_u8x16_narrow_i16x8(bits(a), bits(b))); }
VOREL_INLINE U8s narrow(U16s a, U16s b) { return pack(a, b); }
VOREL_INLINE U16s pairSums(U8s v) { return bitCast<U16s>(wasm_u16x8_extadd_pairwise_u8x16(bits(v))); }
VOREL_INLINE U8s quarters(U16s even, U16s odd) {
    const U16s most = splat<U16s>(uint16_t{1023});
    return bitCast<U8s>((min(even, most) >> 2) | (min(odd, most) << 6 & 0xFF00));
}

template <int64_t kFour>
VOREL_INLINE U32s addDots(U32s sums, Taps taps, const WeightCell* weights) {
    const v128_t even = wasm_i32x4_dot_i16x8(bits(taps.even), bits(weights[4 * kFour]));
    const v128_t odd = wasm_i32x4_dot_i16x8(bits(taps.odd), bits(weights[4 * kFour + 1]));
    return sums + bitCast<U32s>(even) + bitCast<U32s>(odd);
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
