#pragma once

#include "simd/vectors.h"

/// What a level has from here unless its file says VOREL_NATIVE_... of it.
namespace VFontEffect::internal::VOREL_LEVEL {

#if !defined(VOREL_NATIVE_LOAD_FIRST)
VOREL_INLINE U8s loadFirst(const uint8_t* from, int64_t count) {
    uint8_t bytes[kBytes] = {};
    std::memcpy(bytes, from, static_cast<size_t>(count));
    return load<U8s>(bytes);
}
#endif

#if !defined(VOREL_NATIVE_LARGER_OF)
template <class V>
VOREL_INLINE V largerOf(const uint8_t* place, const int32_t* offsets) {
    return max(load<V>(place + offsets[0]), load<V>(place + offsets[1]));
}
#endif

#if !defined(VOREL_NATIVE_MULTIPLY_HIGH_SUM)
VOREL_INLINE U16s multiplyHighSum(U16s a, U16s x, U16s b, U16s y) {
    // The upper halves of both products, and the carry of the lower ones.
    const U16s low = a * x;
    const U16s carry = bitCast<U16s>(low + b * y < low);
    return multiplyHigh(a, x) + multiplyHigh(b, y) - carry;
}
#endif

#if !defined(VOREL_NATIVE_TO_INT_UP_TO)
template <int32_t kMost>
VOREL_INLINE U32s toIntUpTo(F32s v) {
    return bitCast<U32s>(clamped(toInt(v), 0, kMost));
}
#endif

#if !defined(VOREL_NATIVE_UPPER_BYTES)
VOREL_INLINE U8s upperBytes(U16s a, U16s b) { return narrow(a >> 8, b >> 8); }
#endif

#if !defined(VOREL_NATIVE_UPPER_BYTES_IN_TURN)
VOREL_INLINE U8s upperBytesInTurn(U16s a, U16s b) { return bitCast<U8s>(a >> 8 | (b & 0xFF00)); }
#endif

#if !defined(VOREL_NATIVE_IN_BOTH_HALVES)
VOREL_INLINE U16s inBothHalves(U32s v) { return bitCast<U16s>(v | v << 16); }
#endif

#if !defined(VOREL_NATIVE_JOINED_BYTES)
VOREL_INLINE U8s joinedBytes(U32s a, U32s b, U32s c, U32s d) {
    return bitCast<U8s>(a | b << 8 | c << 16 | d << 24);
}
#endif

#if !defined(VOREL_NATIVE_GATHER)
template <class Index, size_t... kLanes>
VOREL_INLINE U32s gather(const uint32_t* table, const Index& indices, std::index_sequence<kLanes...>) {
    return U32s{table[indices[kLanes]]...};
}
VOREL_INLINE U32s gather(const uint32_t* table, I32s indices) {
    return gather(table, indices, std::make_index_sequence<kU32Lanes>());
}
VOREL_INLINE U32s gather(const uint32_t* table, const uint8_t* indices) {
    return gather(table, indices, std::make_index_sequence<kU32Lanes>());
}
#endif

#if !defined(VOREL_NATIVE_GATHER_NEAR)
VOREL_INLINE U32s gatherNear(const uint32_t* table, int32_t, I32s indices) {
    return gather(table, indices);
}
#endif

#if !defined(VOREL_NATIVE_TIMES_FACTOR)
constexpr uint32_t kNumberBias = 0;
VOREL_INLINE F32s timesFactor(U32s number, F32s factor) {
    return __builtin_convertvector(bitCast<I32s>(number), F32s) * factor;
}
#endif

#if !defined(VOREL_NATIVE_TAPS)
using Taps = U8s;
using WeightCell = uint8_t;

VOREL_INLINE Taps tapsOf(U8s v) { return v; }
VOREL_INLINE WeightCell cellOf(const uint8_t* weights) { return *weights; }
#endif

#if !defined(VOREL_NATIVE_WEIGHTS)
using Weights = const WeightCell*;

VOREL_INLINE Weights weightsAt(const WeightCell* cells) { return cells; }
#endif

/// Whether a dot product of bytes is an instruction.
#if defined(VOREL_DOT_PRODUCTS)
constexpr bool kHasDotProducts = true;
#else
constexpr bool kHasDotProducts = false;
#endif

}  // namespace VFontEffect::internal::VOREL_LEVEL
