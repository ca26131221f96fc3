#pragma once

#include <immintrin.h>

#include "simd/vectors.h"

#if !defined(__SSE2__) || defined(__AVX__)
#error "the level sse2 is compiled with the flags of its name"
#endif

/// SSE2, which every x86-64 has: 16 bytes.
namespace VFontEffect::internal::VOREL_LEVEL {

using X86Ints = __m128i;
using X86Floats = __m128;
#define VOREL_X86(name) _mm_##name
}  // namespace VFontEffect::internal::VOREL_LEVEL

#include "simd/lanes_x86.h"
#include "simd/taps_in_pairs.h"

namespace VFontEffect::internal::VOREL_LEVEL {

VOREL_INLINE bool allZero(U8s v) {
    return _mm_movemask_epi8(_mm_cmpeq_epi8(ints(v), _mm_setzero_si128())) == 0xFFFF;
}
constexpr int kLaneBits = 1;
VOREL_INLINE uint64_t nonZeroLanes(U8s v) {
    return static_cast<uint32_t>(_mm_movemask_epi8(ints(v != 0)));
}
VOREL_INLINE U16s loadInPairs(const uint8_t* from) {
    const __m128i u16s = _mm_unpacklo_epi8(_mm_setzero_si128(), _mm_cvtsi32_si128(load<int>(from)));
    return bitCast<U16s>(_mm_unpacklo_epi16(u16s, u16s));
}
/// Moves the 16-bit lanes of each word: both take the one that `selector` names for them.
template <int kSelector>
VOREL_INLINE U16s u16sMoved(U16s v) {
    return bitCast<U16s>(_mm_shufflehi_epi16(_mm_shufflelo_epi16(ints(v), kSelector), kSelector));
}
VOREL_INLINE U16s highBytesInPairs(U8s v) {
    const U32s high = bitCast<U32s>(v) & 0xFF000000U;
    return bitCast<U16s>(high | high >> 16);
}
VOREL_INLINE U8s swapRedBlue(U8s v) {
    const U16s ends = bitCast<U16s>(v) & 0x00FF;
    return v ^ bitCast<U8s>(ends) ^ bitCast<U8s>(u16sMoved<_MM_SHUFFLE(2, 3, 0, 1)>(ends));
}
VOREL_INLINE U16s widenLow(U8s v) {
    return bitCast<U16s>(_mm_unpacklo_epi8(ints(v), _mm_setzero_si128()));
}
VOREL_INLINE U16s widenHigh(U8s v) {
    return bitCast<U16s>(_mm_unpackhi_epi8(ints(v), _mm_setzero_si128()));
}
VOREL_INLINE U8s narrow(U16s a, U16s b) { return pack(a, b); }
VOREL_INLINE U16s pairSums(U8s v) { return (bitCast<U16s>(v) & 0x00FF) + (bitCast<U16s>(v) >> 8); }

/// In place: compilers would rather make a tree of all products and spill it, or add the sum to the
/// product and copy it back.
VOREL_INLINE void addTo(U32s& sum, __m128i products) {
    __asm__("paddd {%1, %0|%0, %1}" : "+x"(sum) : "x"(products));
}
template <int64_t kFour>
VOREL_INLINE U32s addDots(U32s sums, Taps taps, const WeightCell* weights) {
    addTo(sums, _mm_madd_epi16(ints(taps.even), ints(weights[4 * kFour])));
    addTo(sums, _mm_madd_epi16(ints(taps.odd), ints(weights[4 * kFour + 1])));
    return sums;
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
