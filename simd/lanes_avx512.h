#pragma once

#include <immintrin.h>

#include "simd/vectors.h"

#if !defined(__AVX512BW__) || !defined(__AVX512VNNI__)
#error "the level avx512 is compiled with the flags of its name"
#endif

/// AVX-512 with byte and word instructions and dot products: 64 bytes, and registers of masks.
#define VOREL_MASK_REGISTERS
namespace VFontEffect::internal::VOREL_LEVEL {

using X86Ints = __m512i;
using X86Floats = __m512;
#define VOREL_X86(name) _mm512_##name
}  // namespace VFontEffect::internal::VOREL_LEVEL

#include "simd/lanes_x86.h"

namespace VFontEffect::internal::VOREL_LEVEL {

VOREL_INLINE bool allZero(U8s v) { return _mm512_test_epi32_mask(ints(v), ints(v)) == 0; }
constexpr int kLaneBits = 1;
VOREL_INLINE uint64_t nonZeroLanes(U8s v) { return _mm512_test_epi8_mask(ints(v), ints(v)); }
/// Moves bytes within each 128 bits; an index of -1 gives 0.
VOREL_INLINE U8s shuffled(U8s v, __m128i indices) {
    return bitCast<U8s>(_mm512_shuffle_epi8(ints(v), _mm512_broadcast_i32x4(indices)));
}
/// Words of kU32Lanes bytes.
VOREL_INLINE U32s widened(const uint8_t* from) {
    return bitCast<U32s>(_mm512_cvtepu8_epi32(_mm_loadu_si128(reinterpret_cast<const __m128i*>(from))));
}
VOREL_INLINE U32s gather(const uint32_t* table, I32s indices) {
    return bitCast<U32s>(_mm512_i32gather_epi32(ints(indices), table, 4));
}
/// Of the words of two vectors those at the given places.
VOREL_INLINE U32s lookUp(U32s first, U32s second, U32s places) {
    return bitCast<U32s>(_mm512_permutex2var_epi32(ints(first), ints(places), ints(second)));
}
VOREL_INLINE U16s widenLow(U8s v) {
    return bitCast<U16s>(_mm512_cvtepu8_epi16(_mm512_castsi512_si256(ints(v))));
}
VOREL_INLINE U16s widenHigh(U8s v) {
    return bitCast<U16s>(_mm512_cvtepu8_epi16(_mm512_extracti64x4_epi64(ints(v), 1)));
}
VOREL_INLINE U8s narrow(U16s a, U16s b) {
    return bitCast<U8s>(
        _mm512_permutexvar_epi64(_mm512_setr_epi64(0, 2, 4, 6, 1, 3, 5, 7), ints(pack(a, b))));
}

#define VOREL_NATIVE_LOAD_FIRST
VOREL_INLINE U8s loadFirst(const uint8_t* from, int64_t count) {
    const uint64_t lanes = ~uint64_t{0} >> (64 - count);
    return bitCast<U8s>(_mm512_maskz_loadu_epi8(lanes, from));
}

#define VOREL_NATIVE_TIMES_FACTOR
/// The bits of 2^23 as a float: with them before it a number is the float 2^23 + number, unconverted.
constexpr uint32_t kNumberBias = 0x4B000000;
/// The fused product takes 2^23 * factor away again, exactly, and so rounds number * factor once, as any
/// other does.
VOREL_INLINE F32s timesFactor(U32s biased, F32s factor) {
    return bitCast<F32s>(_mm512_fmadd_ps(bitCast<__m512>(biased), bitCast<__m512>(factor),
                                         bitCast<__m512>(factor * -8388608.0F)));
}

#define VOREL_DOT_PRODUCTS
constexpr uint8_t kTapBias = 0x80;
template <int64_t kFour>
VOREL_INLINE U32s addDots(U32s sums, U8s taps, const uint8_t* weights) {
    const __m512i four = _mm512_set1_epi32(load<int>(weights + 4 * kFour));
    return bitCast<U32s>(_mm512_dpbusd_epi32(ints(sums), four, ints(taps)));
}

}  // namespace VFontEffect::internal::VOREL_LEVEL

#include "simd/lanes_avx.h"
