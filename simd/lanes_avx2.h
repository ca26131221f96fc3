#pragma once

#include <immintrin.h>

#include "simd/vectors.h"

#if !defined(__AVX2__) || defined(__AVX512F__)
#error "the level avx2 is compiled with the flags of its name"
#endif

/// AVX2: 32 bytes.
namespace VFontEffect::internal::VOREL_LEVEL {

using X86Ints = __m256i;
using X86Floats = __m256;
#define VOREL_X86(name) _mm256_##name
}  // namespace VFontEffect::internal::VOREL_LEVEL

#include "simd/lanes_x86.h"

namespace VFontEffect::internal::VOREL_LEVEL {

VOREL_INLINE bool allZero(U8s v) { return _mm256_testz_si256(ints(v), ints(v)) != 0; }
constexpr int kLaneBits = 1;
VOREL_INLINE uint64_t nonZeroLanes(U8s v) {
    return static_cast<uint32_t>(_mm256_movemask_epi8(ints(v != 0)));
}
/// Moves bytes within each 128 bits; an index of -1 gives 0.
VOREL_INLINE U8s shuffled(U8s v, __m128i indices) {
    return bitCast<U8s>(_mm256_shuffle_epi8(ints(v), _mm256_broadcastsi128_si256(indices)));
}
/// Words of kU32Lanes bytes.
VOREL_INLINE U32s widened(const uint8_t* from) {
    return bitCast<U32s>(_mm256_cvtepu8_epi32(_mm_loadl_epi64(reinterpret_cast<const __m128i*>(from))));
}
VOREL_INLINE U32s gather(const uint32_t* table, I32s indices) {
    return bitCast<U32s>(_mm256_i32gather_epi32(reinterpret_cast<const int*>(table), ints(indices), 4));
}
/// Of the words of two vectors those at the given places.
VOREL_INLINE U32s lookUp(U32s first, U32s second, U32s places) {
    const auto at = [places](U32s words) VOREL_INLINE_LAMBDA {
        return bitCast<U32s>(_mm256_permutevar8x32_epi32(ints(words), ints(places)));
    };
    return places < kU32Lanes ? at(first) : at(second);
}
VOREL_INLINE U16s widenLow(U8s v) {
    return bitCast<U16s>(_mm256_cvtepu8_epi16(_mm256_castsi256_si128(ints(v))));
}
VOREL_INLINE U16s widenHigh(U8s v) {
    return bitCast<U16s>(_mm256_cvtepu8_epi16(_mm256_extracti128_si256(ints(v), 1)));
}
VOREL_INLINE U8s narrow(U16s a, U16s b) {
    return bitCast<U8s>(_mm256_permute4x64_epi64(ints(pack(a, b)), _MM_SHUFFLE(3, 1, 2, 0)));
}

constexpr uint8_t kTapBias = 0x80;
/// The sums of two products, each up to 256 * -128 or 256 * 127, just fit in 16 bits.
template <int64_t kFour>
VOREL_INLINE U32s addDots(U32s sums, U8s taps, const uint8_t* weights) {
    const __m256i four = _mm256_set1_epi32(load<int>(weights + 4 * kFour));
    const __m256i pairs = _mm256_maddubs_epi16(four, ints(taps));
    return sums + bitCast<U32s>(_mm256_madd_epi16(pairs, _mm256_set1_epi16(1)));
}

}  // namespace VFontEffect::internal::VOREL_LEVEL

#include "simd/lanes_avx.h"
