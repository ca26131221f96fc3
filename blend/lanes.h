#pragma once

#include <cstdint>
#include <cstring>

#include "core/inline.h"

#if !defined(VOREL_SCALAR) && defined(__x86_64__)
#include <immintrin.h>
#elif !defined(VOREL_SCALAR) && defined(__aarch64__)
#include <arm_neon.h>
#endif

/// Lanes: vectors as wide as the registers of the level that a source of inner loops is compiled for,
/// in that level's namespace. Arithmetic, comparisons and choices (`mask ? a : b`) are those of the
/// compilers' vector types, which both g++ and clang turn into single instructions; here is what these
/// do not express. The scalar level's vector is one 32-bit word, in plain C++ for any CPU.
namespace VFontEffect::internal::VOREL_LEVEL {

static_assert(__BYTE_ORDER__ == __ORDER_LITTLE_ENDIAN__, "pixels are loaded as little-endian words");

#if defined(VOREL_SCALAR)
constexpr int kBytes = 4;
#elif defined(__AVX512BW__)
constexpr int kBytes = 64;
#elif defined(__AVX2__)
constexpr int kBytes = 32;
#else
constexpr int kBytes = 16;
#endif
constexpr int kWords = kBytes / 4;

using Bytes = uint8_t __attribute__((vector_size(kBytes)));
using Halves = uint16_t __attribute__((vector_size(kBytes)));
using Words = uint32_t __attribute__((vector_size(kBytes)));
using Integers = int32_t __attribute__((vector_size(kBytes)));
using Floats = float __attribute__((vector_size(kBytes)));

/// One vector's bits as another type of lanes.
template <class To, class From>
VOREL_INLINE To as(From vector) {
    return reinterpret_cast<To>(vector);
}

/// Vectors in memory, at any address.
template <class V>
VOREL_INLINE V load(const void* from) {
    V vector;
    std::memcpy(&vector, from, sizeof vector);
    return vector;
}
template <class V>
VOREL_INLINE void store(void* to, V vector) {
    std::memcpy(to, &vector, sizeof vector);
}

/// `value` in every lane.
template <class V, class T>
VOREL_INLINE V spread(T value) {
    return V{} + value;
}

template <class V>
VOREL_INLINE V larger(V a, V b) {
    return a > b ? a : b;
}
template <class V>
VOREL_INLINE V smaller(V a, V b) {
    return a < b ? a : b;
}

// Each level's own instructions:
//   addSaturated   a + b, at most 255
//   subSaturated   a - b, at least 0
//   multiplyHigh   the upper 16 bits of 32-bit products
//   allZero        whether no lane holds anything but 0
//   nonZeroLanes   kLaneBits ones for each lane that holds anything but 0, those of the first lane
//   lowest fourthBytes    of each word its highest byte, in both halves of the word firstAndThirdSwapped
//   each word's bytes 0 1 2 3 as 2 1 0 3

#if defined(VOREL_SCALAR)

VOREL_INLINE Bytes addSaturated(Bytes a, Bytes b) {
    const Bytes sum = a + b;
    return sum | as<Bytes>(sum < a);
}
VOREL_INLINE Bytes subSaturated(Bytes a, Bytes b) {
    return (a - b) & as<Bytes>(a > b);
}
VOREL_INLINE Halves multiplyHigh(Halves a, Halves b) {
    const auto high = [](uint32_t x, uint32_t y) { return static_cast<uint16_t>((x * y) >> 16); };
    return Halves{high(a[0], b[0]), high(a[1], b[1])};
}
VOREL_INLINE bool allZero(Bytes v) {
    return as<Words>(v)[0] == 0;
}
constexpr int kLaneBits = 8;
VOREL_INLINE uint64_t nonZeroLanes(Bytes v) {
    return as<Words>(v != 0)[0];
}

#elif defined(__AVX512BW__)

VOREL_INLINE Bytes addSaturated(Bytes a, Bytes b) {
    return as<Bytes>(_mm512_adds_epu8(as<__m512i>(a), as<__m512i>(b)));
}
VOREL_INLINE Bytes subSaturated(Bytes a, Bytes b) {
    return as<Bytes>(_mm512_subs_epu8(as<__m512i>(a), as<__m512i>(b)));
}
VOREL_INLINE Halves multiplyHigh(Halves a, Halves b) {
    return as<Halves>(_mm512_mulhi_epu16(as<__m512i>(a), as<__m512i>(b)));
}
VOREL_INLINE bool allZero(Bytes v) {
    return _mm512_test_epi32_mask(as<__m512i>(v), as<__m512i>(v)) == 0;
}
constexpr int kLaneBits = 1;
VOREL_INLINE uint64_t nonZeroLanes(Bytes v) {
    return _mm512_test_epi8_mask(as<__m512i>(v), as<__m512i>(v));
}
/// Moves bytes within each 128 bits; an index of -1 gives 0.
VOREL_INLINE Bytes shuffled(Bytes v, __m128i indices) {
    return as<Bytes>(_mm512_shuffle_epi8(as<__m512i>(v), _mm512_broadcast_i32x4(indices)));
}

#elif defined(__AVX2__)

VOREL_INLINE Bytes addSaturated(Bytes a, Bytes b) {
    return as<Bytes>(_mm256_adds_epu8(as<__m256i>(a), as<__m256i>(b)));
}
VOREL_INLINE Bytes subSaturated(Bytes a, Bytes b) {
    return as<Bytes>(_mm256_subs_epu8(as<__m256i>(a), as<__m256i>(b)));
}
VOREL_INLINE Halves multiplyHigh(Halves a, Halves b) {
    return as<Halves>(_mm256_mulhi_epu16(as<__m256i>(a), as<__m256i>(b)));
}
VOREL_INLINE bool allZero(Bytes v) {
    return _mm256_testz_si256(as<__m256i>(v), as<__m256i>(v)) != 0;
}
constexpr int kLaneBits = 1;
VOREL_INLINE uint64_t nonZeroLanes(Bytes v) {
    return static_cast<uint32_t>(_mm256_movemask_epi8(as<__m256i>(v != 0)));
}
/// Moves bytes within each 128 bits; an index of -1 gives 0.
VOREL_INLINE Bytes shuffled(Bytes v, __m128i indices) {
    return as<Bytes>(_mm256_shuffle_epi8(as<__m256i>(v), _mm256_broadcastsi128_si256(indices)));
}

#elif defined(__x86_64__)

VOREL_INLINE Bytes addSaturated(Bytes a, Bytes b) {
    return as<Bytes>(_mm_adds_epu8(as<__m128i>(a), as<__m128i>(b)));
}
VOREL_INLINE Bytes subSaturated(Bytes a, Bytes b) {
    return as<Bytes>(_mm_subs_epu8(as<__m128i>(a), as<__m128i>(b)));
}
VOREL_INLINE Halves multiplyHigh(Halves a, Halves b) {
    return as<Halves>(_mm_mulhi_epu16(as<__m128i>(a), as<__m128i>(b)));
}
VOREL_INLINE bool allZero(Bytes v) {
    return _mm_movemask_epi8(_mm_cmpeq_epi8(as<__m128i>(v), _mm_setzero_si128())) == 0xFFFF;
}
constexpr int kLaneBits = 1;
VOREL_INLINE uint64_t nonZeroLanes(Bytes v) {
    return static_cast<uint32_t>(_mm_movemask_epi8(as<__m128i>(v != 0)));
}

#else

VOREL_INLINE Bytes addSaturated(Bytes a, Bytes b) {
    return as<Bytes>(vqaddq_u8(as<uint8x16_t>(a), as<uint8x16_t>(b)));
}
VOREL_INLINE Bytes subSaturated(Bytes a, Bytes b) {
    return as<Bytes>(vqsubq_u8(as<uint8x16_t>(a), as<uint8x16_t>(b)));
}
VOREL_INLINE bool allZero(Bytes v) {
    return vmaxvq_u32(as<uint32x4_t>(v)) == 0;
}
constexpr int kLaneBits = 4;
VOREL_INLINE uint64_t nonZeroLanes(Bytes v) {
    const uint16x8_t all = vreinterpretq_u16_u8(as<uint8x16_t>(v != 0));
    return vget_lane_u64(vreinterpret_u64_u8(vshrn_n_u16(all, 4)), 0);
}

#endif

}  // namespace VFontEffect::internal::VOREL_LEVEL
