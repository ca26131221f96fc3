#pragma once

#include <arm_neon.h>

#include "simd/vectors.h"

/// NEON, which every 64-bit ARM has: 16 bytes. The level dotprod is the same with dot products.
#define VOREL_PLANAR_PIXELS
namespace VFontEffect::internal::VOREL_LEVEL {

VOREL_INLINE U8s addSaturated(U8s a, U8s b) {
    return bitCast<U8s>(vqaddq_u8(bitCast<uint8x16_t>(a), bitCast<uint8x16_t>(b)));
}
VOREL_INLINE U8s subSaturated(U8s a, U8s b) {
    return bitCast<U8s>(vqsubq_u8(bitCast<uint8x16_t>(a), bitCast<uint8x16_t>(b)));
}
VOREL_INLINE bool allZero(U8s v) { return vmaxvq_u32(bitCast<uint32x4_t>(v)) == 0; }
constexpr int kLaneBits = 4;
VOREL_INLINE uint64_t nonZeroLanes(U8s v) {
    const uint16x8_t nonZero = bitCast<uint16x8_t>(v != 0);
    return vget_lane_u64(vreinterpret_u64_u8(vshrn_n_u16(nonZero, 4)), 0);
}
VOREL_INLINE U16s multiplyHigh(U16s a, U16s b) {
    const auto x = bitCast<uint16x8_t>(a);
    const auto y = bitCast<uint16x8_t>(b);
    const uint32x4_t low = vmull_u16(vget_low_u16(x), vget_low_u16(y));
    return bitCast<U16s>(
        vuzp2q_u16(bitCast<uint16x8_t>(low), bitCast<uint16x8_t>(vmull_high_u16(x, y))));
}
#define VOREL_NATIVE_MULTIPLY_HIGH_SUM
VOREL_INLINE U16s multiplyHighSum(U16s a, U16s x, U16s b, U16s y) {
    const auto a16 = bitCast<uint16x8_t>(a);
    const auto x16 = bitCast<uint16x8_t>(x);
    const auto b16 = bitCast<uint16x8_t>(b);
    const auto y16 = bitCast<uint16x8_t>(y);
    const uint32x4_t first = vmull_u16(vget_low_u16(a16), vget_low_u16(x16));
    const uint32x4_t low = vmlal_u16(first, vget_low_u16(b16), vget_low_u16(y16));
    const uint32x4_t high = vmlal_high_u16(vmull_high_u16(a16, x16), b16, y16);
    return bitCast<U16s>(vuzp2q_u16(bitCast<uint16x8_t>(low), bitCast<uint16x8_t>(high)));
}
/// Four numbers less kFirst, 0 or -128, in the bytes of a word: at least 0, at most 255.
template <int32_t kFirst>
VOREL_INLINE uint32_t toBytes(I32s v) {
    static_assert(kFirst == 0 || kFirst == -128);
    const int16x4_t halved = vqmovn_s32(bitCast<int32x4_t>(v));
    const int16x8_t both = vcombine_s16(halved, vdup_n_s16(0));
    if constexpr (kFirst == 0) return vget_lane_u32(vreinterpret_u32_u8(vqmovun_s16(both)), 0);
    return vget_lane_u32(vreinterpret_u32_s8(vqmovn_s16(both)), 0) ^ 0x80808080U;
}
VOREL_INLINE I32s toInt(F32s v) { return bitCast<I32s>(vcvtq_s32_f32(bitCast<float32x4_t>(v))); }
#define VOREL_NATIVE_TO_INT_UP_TO
template <int32_t kMost>
VOREL_INLINE U32s toIntUpTo(F32s v) {
    return min(bitCast<U32s>(vcvtq_u32_f32(bitCast<float32x4_t>(v))), splat<U32s>(uint32_t{kMost}));
}
VOREL_INLINE F32s squareRoot(F32s v) { return bitCast<F32s>(vsqrtq_f32(bitCast<float32x4_t>(v))); }
VOREL_INLINE U16s widenLow(U8s v) {
    return bitCast<U16s>(vmovl_u8(vget_low_u8(bitCast<uint8x16_t>(v))));
}
VOREL_INLINE U16s widenHigh(U8s v) { return bitCast<U16s>(vmovl_high_u8(bitCast<uint8x16_t>(v))); }
VOREL_INLINE U8s interleaveLow(U8s a, U8s b) {
    return bitCast<U8s>(vzip1q_u8(bitCast<uint8x16_t>(a), bitCast<uint8x16_t>(b)));
}
VOREL_INLINE U8s interleaveHigh(U8s a, U8s b) {
    return bitCast<U8s>(vzip2q_u8(bitCast<uint8x16_t>(a), bitCast<uint8x16_t>(b)));
}
VOREL_INLINE U16s interleaveLow(U16s a, U16s b) {
    return bitCast<U16s>(vzip1q_u16(bitCast<uint16x8_t>(a), bitCast<uint16x8_t>(b)));
}
VOREL_INLINE U16s interleaveHigh(U16s a, U16s b) {
    return bitCast<U16s>(vzip2q_u16(bitCast<uint16x8_t>(a), bitCast<uint16x8_t>(b)));
}
VOREL_INLINE U16s pack(U32s a, U32s b) {
    return bitCast<U16s>(vuzp1q_u16(bitCast<uint16x8_t>(a), bitCast<uint16x8_t>(b)));
}
VOREL_INLINE U8s pack(U16s a, U16s b) {
    return bitCast<U8s>(vuzp1q_u8(bitCast<uint8x16_t>(a), bitCast<uint8x16_t>(b)));
}
VOREL_INLINE U8s narrow(U16s a, U16s b) { return pack(a, b); }
#define VOREL_NATIVE_UPPER_BYTES
VOREL_INLINE U8s upperBytes(U16s a, U16s b) {
    return bitCast<U8s>(vuzp2q_u8(bitCast<uint8x16_t>(a), bitCast<uint8x16_t>(b)));
}
#define VOREL_NATIVE_UPPER_BYTES_IN_TURN
VOREL_INLINE U8s upperBytesInTurn(U16s a, U16s b) {
    return bitCast<U8s>(vtrn2q_u8(bitCast<uint8x16_t>(a), bitCast<uint8x16_t>(b)));
}
#define VOREL_NATIVE_IN_BOTH_HALVES
VOREL_INLINE U16s inBothHalves(U32s v) {
    return bitCast<U16s>(vtrn1q_u16(bitCast<uint16x8_t>(v), bitCast<uint16x8_t>(v)));
}
#define VOREL_NATIVE_JOINED_BYTES
VOREL_INLINE U8s joinedBytes(U32s a, U32s b, U32s c, U32s d) {
    const auto pairs = [](U32s low, U32s high) {
        return vreinterpretq_u16_u8(vtrn1q_u8(bitCast<uint8x16_t>(low), bitCast<uint8x16_t>(high)));
    };
    return bitCast<U8s>(vtrn1q_u16(pairs(a, b), pairs(c, d)));
}
VOREL_INLINE U16s pairSums(U8s v) { return bitCast<U16s>(vpaddlq_u8(bitCast<uint8x16_t>(v))); }
VOREL_INLINE U8s quarters(U16s even, U16s odd) {
    const auto raised = [](U16s sums) {
        return vreinterpretq_u8_u16(vqshlq_n_u16(bitCast<uint16x8_t>(sums), 6));
    };
    return bitCast<U8s>(vtrn2q_u8(raised(even), raised(odd)));
}

#define VOREL_NATIVE_LARGER_OF
/// Both offsets by one load: that of a pair that widens them takes twice as long.
template <class V>
VOREL_INLINE V largerOf(const uint8_t* place, const int32_t* offsets) {
    int64_t both;
    std::memcpy(&both, offsets, sizeof both);
    return max(load<V>(place + static_cast<int32_t>(both)), load<V>(place + (both >> 32)));
}

#define VOREL_NATIVE_WEIGHTS
/// A string's first sixteen weights.
using Weights = uint8x16_t;

VOREL_INLINE Weights weightsAt(const uint8_t* cells) { return vld1q_u8(cells); }

constexpr uint8_t kTapBias = 0;
#if defined(__ARM_FEATURE_DOTPROD)
#define VOREL_DOT_PRODUCTS
template <int64_t kFour>
VOREL_INLINE U32s addDots(U32s sums, U8s taps, Weights weights) {
    return bitCast<U32s>(
        vdotq_laneq_u32(bitCast<uint32x4_t>(sums), bitCast<uint8x16_t>(taps), weights, kFour));
}
#else
/// The sums of two products, of weights of 256 together, just fit in 16 bits.
template <int64_t kFour>
VOREL_INLINE U32s addDots(U32s sums, U8s taps, Weights weights) {
    const auto four = vreinterpretq_u8_u32(vdupq_laneq_u32(vreinterpretq_u32_u8(weights), kFour));
    const uint16x8_t low = vmull_u8(vget_low_u8(bitCast<uint8x16_t>(taps)), vget_low_u8(four));
    const uint16x8_t high = vmull_high_u8(bitCast<uint8x16_t>(taps), four);
    return bitCast<U32s>(vpadalq_u16(bitCast<uint32x4_t>(sums), vpaddq_u16(low, high)));
}
#endif

}  // namespace VFontEffect::internal::VOREL_LEVEL
