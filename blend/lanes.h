#pragma once

#include <cstdint>
#include <cstring>
#include <utility>

#include "core/inline.h"
#include "core/numeric.h"

#if defined(VOREL_SCALAR)
#elif defined(__AVX512BW__)
#define VOREL_AVX512
#elif defined(__AVX2__)
#define VOREL_AVX2
#elif defined(__x86_64__)
#define VOREL_SSE2
#elif defined(__aarch64__)
#define VOREL_NEON
#else
#error "there is no such level on this machine"
#endif

#if defined(VOREL_NEON)
#include <arm_neon.h>
#elif !defined(VOREL_SCALAR)
#include <immintrin.h>
#endif

/// Lanes: vectors as wide as the registers of the level that a source of inner loops is compiled for,
/// in that level's namespace. Arithmetic, comparisons and choices (`mask ? a : b`) are those of the
/// compilers' vector types, which both g++ and clang turn into single instructions; here is what these
/// do not express. The scalar level's vector is one 32-bit word, in plain C++ for any CPU.
namespace VFontEffect::internal::VOREL_LEVEL {

static_assert(__BYTE_ORDER__ == __ORDER_LITTLE_ENDIAN__, "pixels are loaded as little-endian words");

#if defined(VOREL_SCALAR)
constexpr int64_t kBytes = 4;
#elif defined(VOREL_AVX512)
constexpr int64_t kBytes = 64;
#elif defined(VOREL_AVX2)
constexpr int64_t kBytes = 32;
#else
constexpr int64_t kBytes = 16;
#endif
static_assert(kBytes == VOREL_VECTOR_BYTES, "the flags of a level give the vectors of its name");
constexpr int64_t kWords = kBytes / 4;

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
/// At a multiple of its size, where an instruction can take it from memory.
template <class V>
VOREL_INLINE V loadAligned(const void* from) {
    return load<V>(__builtin_assume_aligned(from, sizeof(V)));
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

/// 0, 1, 2, ... in the lanes. Listed, not counted: in a loop clang would insert lane after lane.
template <class V, size_t... kLanes>
VOREL_INLINE V ascending(std::index_sequence<kLanes...>) {
    return V{kLanes...};
}
template <class V>
VOREL_INLINE V ascending() {
    return ascending<V>(std::make_index_sequence<sizeof(V) / sizeof(V{}[0])>());
}

/// All ones in the first `count` bytes, 0 to kBytes of them.
VOREL_INLINE Bytes firstBytes(int64_t count) {
    return as<Bytes>(ascending<Bytes>() < spread<Bytes>(static_cast<uint8_t>(count)));
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
//   nonZeroLanes   kLaneBits ones for each lane that holds anything but 0, the first lane's lowest
//   loadInPairs    kWords bytes of memory, each in both halves of its word (not on NEON)
//   highBytesInPairs   of each word its highest byte, in both halves of the word (not on NEON)
//   endsSwapped    bytes 0 1 2 3 of each word as 2 1 0 3 (not on NEON)
//   toInt          as core/numeric.h converts: toward zero, saturating, NaN to 0
//   squareRoot     correctly rounded
//   multipliedSum  a * b + c, rounded once (on AVX-512)
//   gathered       the words of a table at the given indices, kWords of them, in a vector or in bytes
//   gatheredNear   the same from a table of `size` words, 32 at least, by indices that as a rule lie
//                  close together: looked up in registers then
//   loadFirst      1 to kBytes bytes of memory, zeros after them
//   widenedLow, widenedHigh   the first and the second half of the bytes, each byte in a half
//   narrowed       halves of at most 255 as bytes: those of the first vector, then of the second
//   interleavedLow, interleavedHigh   the lanes of the two vectors in turn, from their lower and from
//                  their upper ends; AVX does so in each 128 bits by itself
//   packed         lanes of at most 255 in half the width, as they were before interleaving
//   pairSums       of each two neighbouring bytes
//   quarters       a quarter of each half, at most 255, from the two vectors in turn
//
// and products of taps, four to a word. `addDots<i>(sums, taps, weights)` adds to each word its four
// taps, each times its weight, the i-th four weights (0..3) of the string that `weights` were loaded
// from. A string is an array of cells, one for each tap, which `cellOf` makes from the plain weights
// (at most 128) from there on. Taps are stored as tap ^ kTapBias: the sum is then too small by
// kTapBias times the total of the weights.

// What several levels share.

#if !defined(VOREL_AVX512)
VOREL_INLINE Bytes loadFirst(const uint8_t* from, int64_t count) {
    uint8_t bytes[kBytes] = {};
    std::memcpy(bytes, from, static_cast<size_t>(count));
    return load<Bytes>(bytes);
}
#endif

#if defined(VOREL_SSE2) || defined(VOREL_NEON)
VOREL_INLINE Words gathered(const uint32_t* table, Integers indices) {
    return Words{table[indices[0]], table[indices[1]], table[indices[2]], table[indices[3]]};
}
VOREL_INLINE Words gathered(const uint32_t* table, const uint8_t* indices) {
    return Words{table[indices[0]], table[indices[1]], table[indices[2]], table[indices[3]]};
}
#endif

#if defined(VOREL_SSE2)
/// Taps 0 and 2 of each word, and taps 1 and 3. The cell of a tap holds its weight and that of the next
/// but one.
struct Taps {
    Halves even;
    Halves odd;
};
using WeightCell = Halves;

VOREL_INLINE Taps tapsOf(Bytes v) {
    return {as<Halves>(v) & 0x00FF, as<Halves>(v) >> 8};
}
VOREL_INLINE WeightCell cellOf(const uint8_t* weights) {
    return as<Halves>(spread<Words>(weights[0] | uint32_t{weights[2]} << 16));
}
#else
using Taps = Bytes;
using WeightCell = uint8_t;

VOREL_INLINE Taps tapsOf(Bytes v) {
    return v;
}
VOREL_INLINE WeightCell cellOf(const uint8_t* weights) {
    return *weights;
}
#endif

/// Whether a dot product of bytes is an instruction.
#if defined(VOREL_AVX512) || defined(__ARM_FEATURE_DOTPROD)
constexpr bool kHasDotProducts = true;
#else
constexpr bool kHasDotProducts = false;
#endif

#if defined(VOREL_NEON)
using Weights = uint8x16_t;

VOREL_INLINE Weights weightsAt(const WeightCell* cells) {
    return vld1q_u8(cells);
}
#else
using Weights = const WeightCell*;

VOREL_INLINE Weights weightsAt(const WeightCell* cells) {
    return cells;
}
#endif

#if !defined(VOREL_SCALAR) && !defined(VOREL_NEON)
/// x86 converts what does not fit to the lowest integer: made the highest above the range, 0 for NaN.
VOREL_INLINE Integers saturated(Floats value, Integers converted) {
    return (converted ^ (value >= 2147483648.0F)) & (value == value);
}
VOREL_INLINE Bytes quartersInTurn(Halves even, Halves odd) {
    using SignedHalves = int16_t __attribute__((vector_size(kBytes)));
    const auto most = spread<SignedHalves>(int16_t{1023});
    const auto low = as<Halves>(smaller(as<SignedHalves>(even), most));
    const auto high = as<Halves>(smaller(as<SignedHalves>(odd), most));
    return as<Bytes>((low >> 2) | (high << 6 & 0xFF00));
}
#endif

#if defined(VOREL_AVX2) || defined(VOREL_AVX512)
constexpr int32_t kNearEntries = 2 * kWords;
/// The first of a table's kNearEntries entries that may hold all that the indices ask for: as a rule
/// they ascend or descend.
VOREL_INLINE int32_t firstNear(Integers indices, int32_t size) {
    const int32_t one = indices[0];
    const int32_t other = indices[kWords - 1];
    const int32_t lower = one < other ? one : other;
    return lower < size - kNearEntries ? lower : size - kNearEntries;
}
#endif

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
VOREL_INLINE Halves loadInPairs(const uint8_t* from) {
    return as<Halves>(Words{*from * 0x10001U});
}
VOREL_INLINE Halves highBytesInPairs(Bytes v) {
    return as<Halves>((as<Words>(v) >> 24) * 0x10001U);
}
VOREL_INLINE Bytes endsSwapped(Bytes v) {
    return Bytes{v[2], v[1], v[0], v[3]};
}
VOREL_INLINE Integers toInt(Floats v) {
    return Integers{internal::toInt(v[0])};
}
VOREL_INLINE Floats squareRoot(Floats v) {
    return Floats{__builtin_sqrtf(v[0])};
}
VOREL_INLINE Words gathered(const uint32_t* table, Integers indices) {
    return Words{table[indices[0]]};
}
VOREL_INLINE Words gathered(const uint32_t* table, const uint8_t* indices) {
    return Words{table[*indices]};
}

VOREL_INLINE Halves widenedLow(Bytes v) {
    return Halves{v[0], v[1]};
}
VOREL_INLINE Halves widenedHigh(Bytes v) {
    return Halves{v[2], v[3]};
}
VOREL_INLINE Bytes narrowed(Halves a, Halves b) {
    return __builtin_convertvector(__builtin_shufflevector(a, b, 0, 1, 2, 3), Bytes);
}
VOREL_INLINE Bytes interleavedLow(Bytes a, Bytes b) {
    return Bytes{a[0], b[0], a[1], b[1]};
}
VOREL_INLINE Bytes interleavedHigh(Bytes a, Bytes b) {
    return Bytes{a[2], b[2], a[3], b[3]};
}
VOREL_INLINE Halves interleavedLow(Halves a, Halves b) {
    return Halves{a[0], b[0]};
}
VOREL_INLINE Halves interleavedHigh(Halves a, Halves b) {
    return Halves{a[1], b[1]};
}
VOREL_INLINE Halves packed(Words a, Words b) {
    return as<Halves>(a | b << 16);
}
VOREL_INLINE Bytes packed(Halves a, Halves b) {
    return narrowed(a, b);
}
VOREL_INLINE Halves pairSums(Bytes v) {
    return (as<Halves>(v) & 0x00FF) + (as<Halves>(v) >> 8);
}
VOREL_INLINE Bytes quarters(Halves even, Halves odd) {
    const auto quarter = [](uint32_t sum) { return static_cast<uint8_t>(sum > 1023 ? 255 : sum >> 2); };
    return Bytes{quarter(even[0]), quarter(odd[0]), quarter(even[1]), quarter(odd[1])};
}

constexpr uint8_t kTapBias = 0;
template <int64_t kFour>
VOREL_INLINE Words addDots(Words sums, Taps taps, Weights weights) {
    const uint8_t* const w = weights + 4 * kFour;
    return sums + (w[0] * taps[0] + w[1] * taps[1] + w[2] * taps[2] + w[3] * taps[3]);
}

#elif defined(VOREL_AVX512)

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
VOREL_INLINE Halves loadInPairs(const uint8_t* from) {
    const __m512i words = _mm512_cvtepu8_epi32(_mm_loadu_si128(reinterpret_cast<const __m128i*>(from)));
    return as<Halves>(shuffled(as<Bytes>(words),
                               _mm_setr_epi8(0, -1, 0, -1, 4, -1, 4, -1, 8, -1, 8, -1, 12, -1, 12, -1)));
}
VOREL_INLINE Halves highBytesInPairs(Bytes v) {
    return as<Halves>(
        shuffled(v, _mm_setr_epi8(3, -1, 3, -1, 7, -1, 7, -1, 11, -1, 11, -1, 15, -1, 15, -1)));
}
VOREL_INLINE Bytes endsSwapped(Bytes v) {
    return shuffled(v, _mm_setr_epi8(2, 1, 0, 3, 6, 5, 4, 7, 10, 9, 8, 11, 14, 13, 12, 15));
}
VOREL_INLINE Integers toInt(Floats v) {
    return saturated(v, as<Integers>(_mm512_cvttps_epi32(as<__m512>(v))));
}
VOREL_INLINE Floats squareRoot(Floats v) {
    return as<Floats>(_mm512_sqrt_ps(as<__m512>(v)));
}
VOREL_INLINE Floats multipliedSum(Floats a, Floats b, Floats c) {
    return as<Floats>(_mm512_fmadd_ps(as<__m512>(a), as<__m512>(b), as<__m512>(c)));
}
VOREL_INLINE Words gathered(const uint32_t* table, Integers indices) {
    return as<Words>(_mm512_i32gather_epi32(as<__m512i>(indices), table, 4));
}
VOREL_INLINE Words gathered(const uint32_t* table, const uint8_t* indices) {
    const __m128i bytes = _mm_loadu_si128(reinterpret_cast<const __m128i*>(indices));
    return gathered(table, as<Integers>(_mm512_cvtepu8_epi32(bytes)));
}
VOREL_INLINE Words gatheredNear(const uint32_t* table, int32_t size, Integers indices) {
    const int32_t first = firstNear(indices, size);
    const auto offsets = as<__m512i>(indices - first);
    if (_mm512_cmpge_epu32_mask(offsets, _mm512_set1_epi32(kNearEntries)) != 0)
        return gathered(table, indices);
    return as<Words>(_mm512_permutex2var_epi32(as<__m512i>(load<Words>(table + first)), offsets,
                                               as<__m512i>(load<Words>(table + first + kWords))));
}

VOREL_INLINE Bytes loadFirst(const uint8_t* from, int64_t count) {
    const uint64_t lanes = ~uint64_t{0} >> (64 - count);
    return as<Bytes>(_mm512_maskz_loadu_epi8(lanes, from));
}
VOREL_INLINE Halves widenedLow(Bytes v) {
    return as<Halves>(_mm512_cvtepu8_epi16(_mm512_castsi512_si256(as<__m512i>(v))));
}
VOREL_INLINE Halves widenedHigh(Bytes v) {
    return as<Halves>(_mm512_cvtepu8_epi16(_mm512_extracti64x4_epi64(as<__m512i>(v), 1)));
}
VOREL_INLINE Bytes interleavedLow(Bytes a, Bytes b) {
    return as<Bytes>(_mm512_unpacklo_epi8(as<__m512i>(a), as<__m512i>(b)));
}
VOREL_INLINE Bytes interleavedHigh(Bytes a, Bytes b) {
    return as<Bytes>(_mm512_unpackhi_epi8(as<__m512i>(a), as<__m512i>(b)));
}
VOREL_INLINE Halves interleavedLow(Halves a, Halves b) {
    return as<Halves>(_mm512_unpacklo_epi16(as<__m512i>(a), as<__m512i>(b)));
}
VOREL_INLINE Halves interleavedHigh(Halves a, Halves b) {
    return as<Halves>(_mm512_unpackhi_epi16(as<__m512i>(a), as<__m512i>(b)));
}
VOREL_INLINE Halves packed(Words a, Words b) {
    return as<Halves>(_mm512_packs_epi32(as<__m512i>(a), as<__m512i>(b)));
}
VOREL_INLINE Bytes packed(Halves a, Halves b) {
    return as<Bytes>(_mm512_packus_epi16(as<__m512i>(a), as<__m512i>(b)));
}
VOREL_INLINE Bytes narrowed(Halves a, Halves b) {
    return as<Bytes>(
        _mm512_permutexvar_epi64(_mm512_setr_epi64(0, 2, 4, 6, 1, 3, 5, 7), as<__m512i>(packed(a, b))));
}
VOREL_INLINE Halves pairSums(Bytes v) {
    return as<Halves>(_mm512_maddubs_epi16(as<__m512i>(v), _mm512_set1_epi8(1)));
}
VOREL_INLINE Bytes quarters(Halves even, Halves odd) {
    return quartersInTurn(even, odd);
}

constexpr uint8_t kTapBias = 0x80;
template <int64_t kFour>
VOREL_INLINE Words addDots(Words sums, Taps taps, Weights weights) {
    const __m512i four = _mm512_set1_epi32(load<int>(weights + 4 * kFour));
    return as<Words>(_mm512_dpbusd_epi32(as<__m512i>(sums), four, as<__m512i>(taps)));
}

#elif defined(VOREL_AVX2)

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
VOREL_INLINE Halves loadInPairs(const uint8_t* from) {
    const __m256i words = _mm256_cvtepu8_epi32(_mm_loadl_epi64(reinterpret_cast<const __m128i*>(from)));
    return as<Halves>(shuffled(as<Bytes>(words),
                               _mm_setr_epi8(0, -1, 0, -1, 4, -1, 4, -1, 8, -1, 8, -1, 12, -1, 12, -1)));
}
VOREL_INLINE Halves highBytesInPairs(Bytes v) {
    return as<Halves>(
        shuffled(v, _mm_setr_epi8(3, -1, 3, -1, 7, -1, 7, -1, 11, -1, 11, -1, 15, -1, 15, -1)));
}
VOREL_INLINE Bytes endsSwapped(Bytes v) {
    return shuffled(v, _mm_setr_epi8(2, 1, 0, 3, 6, 5, 4, 7, 10, 9, 8, 11, 14, 13, 12, 15));
}
VOREL_INLINE Integers toInt(Floats v) {
    return saturated(v, as<Integers>(_mm256_cvttps_epi32(as<__m256>(v))));
}
VOREL_INLINE Floats squareRoot(Floats v) {
    return as<Floats>(_mm256_sqrt_ps(as<__m256>(v)));
}
VOREL_INLINE Words gathered(const uint32_t* table, Integers indices) {
    return as<Words>(
        _mm256_i32gather_epi32(reinterpret_cast<const int*>(table), as<__m256i>(indices), 4));
}
VOREL_INLINE Words gathered(const uint32_t* table, const uint8_t* indices) {
    const __m128i bytes = _mm_loadl_epi64(reinterpret_cast<const __m128i*>(indices));
    return gathered(table, as<Integers>(_mm256_cvtepu8_epi32(bytes)));
}
VOREL_INLINE Words gatheredNear(const uint32_t* table, int32_t size, Integers indices) {
    const int32_t first = firstNear(indices, size);
    const Words offsets = as<Words>(indices - first);
    if (!allZero(as<Bytes>(offsets & ~static_cast<uint32_t>(kNearEntries - 1))))
        return gathered(table, indices);
    const auto at = [offsets](const uint32_t* from) VOREL_INLINE_LAMBDA {
        return as<Words>(
            _mm256_permutevar8x32_epi32(as<__m256i>(load<Words>(from)), as<__m256i>(offsets)));
    };
    return offsets < kWords ? at(table + first) : at(table + first + kWords);
}

VOREL_INLINE Halves widenedLow(Bytes v) {
    return as<Halves>(_mm256_cvtepu8_epi16(_mm256_castsi256_si128(as<__m256i>(v))));
}
VOREL_INLINE Halves widenedHigh(Bytes v) {
    return as<Halves>(_mm256_cvtepu8_epi16(_mm256_extracti128_si256(as<__m256i>(v), 1)));
}
VOREL_INLINE Bytes interleavedLow(Bytes a, Bytes b) {
    return as<Bytes>(_mm256_unpacklo_epi8(as<__m256i>(a), as<__m256i>(b)));
}
VOREL_INLINE Bytes interleavedHigh(Bytes a, Bytes b) {
    return as<Bytes>(_mm256_unpackhi_epi8(as<__m256i>(a), as<__m256i>(b)));
}
VOREL_INLINE Halves interleavedLow(Halves a, Halves b) {
    return as<Halves>(_mm256_unpacklo_epi16(as<__m256i>(a), as<__m256i>(b)));
}
VOREL_INLINE Halves interleavedHigh(Halves a, Halves b) {
    return as<Halves>(_mm256_unpackhi_epi16(as<__m256i>(a), as<__m256i>(b)));
}
VOREL_INLINE Halves packed(Words a, Words b) {
    return as<Halves>(_mm256_packs_epi32(as<__m256i>(a), as<__m256i>(b)));
}
VOREL_INLINE Bytes packed(Halves a, Halves b) {
    return as<Bytes>(_mm256_packus_epi16(as<__m256i>(a), as<__m256i>(b)));
}
VOREL_INLINE Bytes narrowed(Halves a, Halves b) {
    return as<Bytes>(_mm256_permute4x64_epi64(as<__m256i>(packed(a, b)), _MM_SHUFFLE(3, 1, 2, 0)));
}
VOREL_INLINE Halves pairSums(Bytes v) {
    return as<Halves>(_mm256_maddubs_epi16(as<__m256i>(v), _mm256_set1_epi8(1)));
}
VOREL_INLINE Bytes quarters(Halves even, Halves odd) {
    return quartersInTurn(even, odd);
}

constexpr uint8_t kTapBias = 0x80;
/// The sums of two products, each up to 256 * -128 or 256 * 127, just fit in 16 bits.
template <int64_t kFour>
VOREL_INLINE Words addDots(Words sums, Taps taps, Weights weights) {
    const __m256i four = _mm256_set1_epi32(load<int>(weights + 4 * kFour));
    const __m256i pairs = _mm256_maddubs_epi16(four, as<__m256i>(taps));
    return sums + as<Words>(_mm256_madd_epi16(pairs, _mm256_set1_epi16(1)));
}

#elif defined(VOREL_SSE2)

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
VOREL_INLINE Halves loadInPairs(const uint8_t* from) {
    const __m128i halves = _mm_unpacklo_epi8(_mm_cvtsi32_si128(load<int>(from)), _mm_setzero_si128());
    return as<Halves>(_mm_unpacklo_epi16(halves, halves));
}
/// Moves the halves of each word: both take the one that `selector` names for them.
template <int kSelector>
VOREL_INLINE Halves halvesMoved(Halves v) {
    return as<Halves>(_mm_shufflehi_epi16(_mm_shufflelo_epi16(as<__m128i>(v), kSelector), kSelector));
}
VOREL_INLINE Halves highBytesInPairs(Bytes v) {
    return halvesMoved<_MM_SHUFFLE(3, 3, 1, 1)>(as<Halves>(v) >> 8);
}
VOREL_INLINE Bytes endsSwapped(Bytes v) {
    const Halves ends = as<Halves>(v) & 0x00FF;
    return v ^ as<Bytes>(ends) ^ as<Bytes>(halvesMoved<_MM_SHUFFLE(2, 3, 0, 1)>(ends));
}
VOREL_INLINE Integers toInt(Floats v) {
    return saturated(v, as<Integers>(_mm_cvttps_epi32(as<__m128>(v))));
}
VOREL_INLINE Floats squareRoot(Floats v) {
    return as<Floats>(_mm_sqrt_ps(as<__m128>(v)));
}

VOREL_INLINE Halves widenedLow(Bytes v) {
    return as<Halves>(_mm_unpacklo_epi8(as<__m128i>(v), _mm_setzero_si128()));
}
VOREL_INLINE Halves widenedHigh(Bytes v) {
    return as<Halves>(_mm_unpackhi_epi8(as<__m128i>(v), _mm_setzero_si128()));
}
VOREL_INLINE Bytes interleavedLow(Bytes a, Bytes b) {
    return as<Bytes>(_mm_unpacklo_epi8(as<__m128i>(a), as<__m128i>(b)));
}
VOREL_INLINE Bytes interleavedHigh(Bytes a, Bytes b) {
    return as<Bytes>(_mm_unpackhi_epi8(as<__m128i>(a), as<__m128i>(b)));
}
VOREL_INLINE Halves interleavedLow(Halves a, Halves b) {
    return as<Halves>(_mm_unpacklo_epi16(as<__m128i>(a), as<__m128i>(b)));
}
VOREL_INLINE Halves interleavedHigh(Halves a, Halves b) {
    return as<Halves>(_mm_unpackhi_epi16(as<__m128i>(a), as<__m128i>(b)));
}
VOREL_INLINE Halves packed(Words a, Words b) {
    return as<Halves>(_mm_packs_epi32(as<__m128i>(a), as<__m128i>(b)));
}
VOREL_INLINE Bytes packed(Halves a, Halves b) {
    return as<Bytes>(_mm_packus_epi16(as<__m128i>(a), as<__m128i>(b)));
}
VOREL_INLINE Bytes narrowed(Halves a, Halves b) {
    return packed(a, b);
}
VOREL_INLINE Halves pairSums(Bytes v) {
    return (as<Halves>(v) & 0x00FF) + (as<Halves>(v) >> 8);
}
VOREL_INLINE Bytes quarters(Halves even, Halves odd) {
    return quartersInTurn(even, odd);
}

constexpr uint8_t kTapBias = 0;
template <int64_t kFour>
VOREL_INLINE Words addDots(Words sums, Taps taps, Weights weights) {
    const __m128i even = _mm_madd_epi16(as<__m128i>(taps.even), as<__m128i>(weights[4 * kFour]));
    const __m128i odd = _mm_madd_epi16(as<__m128i>(taps.odd), as<__m128i>(weights[4 * kFour + 1]));
    // In this order: compilers would rather make a tree of all the steps' products, and spill it.
    Words sum = sums + as<Words>(even);
    __asm__("" : "+x"(sum));
    return sum + as<Words>(odd);
}

#elif defined(VOREL_NEON)

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
    const uint16x8_t nonZero = as<uint16x8_t>(v != 0);
    return vget_lane_u64(vreinterpret_u64_u8(vshrn_n_u16(nonZero, 4)), 0);
}
VOREL_INLINE Halves multiplyHigh(Halves a, Halves b) {
    const auto x = as<uint16x8_t>(a);
    const auto y = as<uint16x8_t>(b);
    const uint32x4_t low = vmull_u16(vget_low_u16(x), vget_low_u16(y));
    return as<Halves>(vuzp2q_u16(as<uint16x8_t>(low), as<uint16x8_t>(vmull_high_u16(x, y))));
}
VOREL_INLINE Integers toInt(Floats v) {
    return as<Integers>(vcvtq_s32_f32(as<float32x4_t>(v)));
}
VOREL_INLINE Floats squareRoot(Floats v) {
    return as<Floats>(vsqrtq_f32(as<float32x4_t>(v)));
}
VOREL_INLINE Halves widenedLow(Bytes v) {
    return as<Halves>(vmovl_u8(vget_low_u8(as<uint8x16_t>(v))));
}
VOREL_INLINE Halves widenedHigh(Bytes v) {
    return as<Halves>(vmovl_high_u8(as<uint8x16_t>(v)));
}
VOREL_INLINE Bytes interleavedLow(Bytes a, Bytes b) {
    return as<Bytes>(vzip1q_u8(as<uint8x16_t>(a), as<uint8x16_t>(b)));
}
VOREL_INLINE Bytes interleavedHigh(Bytes a, Bytes b) {
    return as<Bytes>(vzip2q_u8(as<uint8x16_t>(a), as<uint8x16_t>(b)));
}
VOREL_INLINE Halves interleavedLow(Halves a, Halves b) {
    return as<Halves>(vzip1q_u16(as<uint16x8_t>(a), as<uint16x8_t>(b)));
}
VOREL_INLINE Halves interleavedHigh(Halves a, Halves b) {
    return as<Halves>(vzip2q_u16(as<uint16x8_t>(a), as<uint16x8_t>(b)));
}
VOREL_INLINE Halves packed(Words a, Words b) {
    return as<Halves>(vuzp1q_u16(as<uint16x8_t>(a), as<uint16x8_t>(b)));
}
VOREL_INLINE Bytes packed(Halves a, Halves b) {
    return as<Bytes>(vuzp1q_u8(as<uint8x16_t>(a), as<uint8x16_t>(b)));
}
VOREL_INLINE Bytes narrowed(Halves a, Halves b) {
    return packed(a, b);
}
VOREL_INLINE Halves pairSums(Bytes v) {
    return as<Halves>(vpaddlq_u8(as<uint8x16_t>(v)));
}
VOREL_INLINE Bytes quarters(Halves even, Halves odd) {
    const auto raised = [](Halves sums) {
        return vreinterpretq_u8_u16(vqshlq_n_u16(as<uint16x8_t>(sums), 6));
    };
    return as<Bytes>(vtrn2q_u8(raised(even), raised(odd)));
}

constexpr uint8_t kTapBias = 0;
#if defined(__ARM_FEATURE_DOTPROD)
template <int64_t kFour>
VOREL_INLINE Words addDots(Words sums, Taps taps, Weights weights) {
    return as<Words>(vdotq_laneq_u32(as<uint32x4_t>(sums), as<uint8x16_t>(taps), weights, kFour));
}
#else
/// The sums of two products, of weights of 256 together, just fit in 16 bits.
template <int64_t kFour>
VOREL_INLINE Words addDots(Words sums, Taps taps, Weights weights) {
    const auto four = vreinterpretq_u8_u32(vdupq_laneq_u32(vreinterpretq_u32_u8(weights), kFour));
    const uint16x8_t low = vmull_u8(vget_low_u8(as<uint8x16_t>(taps)), vget_low_u8(four));
    const uint16x8_t high = vmull_high_u8(as<uint8x16_t>(taps), four);
    return as<Words>(vpadalq_u16(as<uint32x4_t>(sums), vpaddq_u16(low, high)));
}
#endif

#endif

#if !defined(VOREL_AVX2) && !defined(VOREL_AVX512)
VOREL_INLINE Words gatheredNear(const uint32_t* table, int32_t, Integers indices) {
    return gathered(table, indices);
}
#endif

}  // namespace VFontEffect::internal::VOREL_LEVEL
