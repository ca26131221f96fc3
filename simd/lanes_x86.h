#pragma once

#include <immintrin.h>

#include "simd/vectors.h"

/// What the levels of x86-64 say alike. A level's file gives the instructions' prefix as VOREL_X86(name)
/// and the names of its registers, X86Ints and X86Floats, before it takes this one in.
namespace VFontEffect::internal::VOREL_LEVEL {

template <class V>
VOREL_INLINE X86Ints ints(V v) {
    return bitCast<X86Ints>(v);
}

constexpr int kAmountShift = 8;

VOREL_INLINE U8s addSaturated(U8s a, U8s b) {
    return bitCast<U8s>(VOREL_X86(adds_epu8)(ints(a), ints(b)));
}
VOREL_INLINE U8s subSaturated(U8s a, U8s b) {
    return bitCast<U8s>(VOREL_X86(subs_epu8)(ints(a), ints(b)));
}
VOREL_INLINE U16s multiplyHigh(U16s a, U16s b) {
    return bitCast<U16s>(VOREL_X86(mulhi_epu16)(ints(a), ints(b)));
}
/// x86 converts what does not fit to the lowest integer: made the highest above the range, 0 for NaN.
VOREL_INLINE I32s toInt(F32s v) {
    const auto converted = bitCast<I32s>(VOREL_X86(cvttps_epi32)(bitCast<X86Floats>(v)));
    return (converted ^ (v >= 2147483648.0F)) & (v == v);
}
VOREL_INLINE F32s squareRoot(F32s v) { return bitCast<F32s>(VOREL_X86(sqrt_ps)(bitCast<X86Floats>(v))); }
VOREL_INLINE U8s interleaveLow(U8s a, U8s b) {
    return bitCast<U8s>(VOREL_X86(unpacklo_epi8)(ints(a), ints(b)));
}
VOREL_INLINE U8s interleaveHigh(U8s a, U8s b) {
    return bitCast<U8s>(VOREL_X86(unpackhi_epi8)(ints(a), ints(b)));
}
VOREL_INLINE U16s interleaveLow(U16s a, U16s b) {
    return bitCast<U16s>(VOREL_X86(unpacklo_epi16)(ints(a), ints(b)));
}
VOREL_INLINE U16s interleaveHigh(U16s a, U16s b) {
    return bitCast<U16s>(VOREL_X86(unpackhi_epi16)(ints(a), ints(b)));
}
VOREL_INLINE U16s pack(U32s a, U32s b) {
    return bitCast<U16s>(VOREL_X86(packs_epi32)(ints(a), ints(b)));
}
VOREL_INLINE U8s pack(U16s a, U16s b) { return bitCast<U8s>(VOREL_X86(packus_epi16)(ints(a), ints(b))); }
VOREL_INLINE U8s quarters(U16s even, U16s odd) {
    const auto most = splat<I16s>(int16_t{1023});
    const auto low = bitCast<U16s>(min(bitCast<I16s>(even), most));
    const auto high = bitCast<U16s>(min(bitCast<I16s>(odd), most));
    return bitCast<U8s>((low >> 2) | (high << 6 & 0xFF00));
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
