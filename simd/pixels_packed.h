#pragma once

#include "core/fixed_point.h"
#include "simd/lanes.h"

/// Packed pixels: one a 32-bit lane, multiplied as even and odd bytes in 16-bit lanes.
namespace VFontEffect::internal::VOREL_LEVEL {

constexpr int64_t kPixels = kU32Lanes;

struct Pixels {
    U8s bytes;
};
struct Amounts {
    U16s u16s;  // a pixel's amount in both 16-bit lanes of its word
};

constexpr uint16_t kEvenByte = 0x00FF;
constexpr uint16_t kOddByte = 0xFF00;
constexpr uint32_t kAlphaByte = 0xFF000000U;

VOREL_INLINE Pixels loadPixels(const uint8_t* from) { return {load<U8s>(from)}; }
VOREL_INLINE void storePixels(uint8_t* to, const Pixels& pixels) { store(to, pixels.bytes); }

/// Pixels in memory order from the words that `wordsAt(i)` gives for pixel i and the next ones.
template <class WordsAt>
VOREL_INLINE Pixels madeOfWords(WordsAt wordsAt) {
    return {bitCast<U8s>(wordsAt(0))};
}
/// From words 0xAARRGGBB: memory order B, G, R, A.
VOREL_INLINE Pixels loadWords(const uint8_t* from) { return {swapRedBlue(load<U8s>(from))}; }
/// From memory order A, R, G, B.
VOREL_INLINE Pixels loadArgb(const uint8_t* from) {
    const U32s words = load<U32s>(from);
    return {bitCast<U8s>(words >> 8 | words << 24)};
}
VOREL_INLINE Amounts loadAmounts(const uint8_t* from) { return {loadInPairs(from)}; }

/// The same colour word 0xAARRGGBB in every pixel.
VOREL_INLINE Pixels splatColour(uint32_t color) {
    const uint32_t swapped = (color & 0xFF00FF00U) | (color & 0xFFU) << 16 | (color >> 16 & 0xFFU);
    return {bitCast<U8s>(splat<U32s>(swapped))};
}

VOREL_INLINE Amounts alphaOf(const Pixels& p) { return {highBytesInPairs(p.bytes)}; }
VOREL_INLINE Amounts inverse(Amounts a) { return {a.u16s ^ kEvenByte}; }
/// Whether all pixels are zeros.
VOREL_INLINE bool isClear(const Pixels& p) { return allZero(p.bytes); }

#if defined(VOREL_MASK_REGISTERS)

using Where = __mmask16;  // one bit for each pixel

VOREL_INLINE Where isZero(Amounts a) {
    return _mm512_testn_epi32_mask(bitCast<__m512i>(a.u16s), bitCast<__m512i>(a.u16s));
}
VOREL_INLINE Where isTransparent(const Pixels& p) {
    return _mm512_testn_epi32_mask(bitCast<__m512i>(p.bytes), bitCast<__m512i>(splat<U32s>(kAlphaByte)));
}
VOREL_INLINE Amounts raisedToFull(Where where, Amounts a) {
    return {bitCast<U16s>(_mm512_mask_mov_epi32(bitCast<__m512i>(a.u16s), where,
                                                bitCast<__m512i>(splat<U16s>(kEvenByte))))};
}
VOREL_INLINE Pixels kept(Where where, const Pixels& p) {
    return {bitCast<U8s>(_mm512_maskz_mov_epi32(where, bitCast<__m512i>(p.bytes)))};
}
VOREL_INLINE Pixels cleared(Where where, const Pixels& p) {
    return {bitCast<U8s>(_mm512_mask_mov_epi32(bitCast<__m512i>(p.bytes), where, __m512i{}))};
}

#else

using Where = U32s;  // all ones or all zeros for each pixel

VOREL_INLINE Where isZero(Amounts a) { return bitCast<Where>(a.u16s == 0); }
VOREL_INLINE Where isTransparent(const Pixels& p) {
    return bitCast<Where>(bitCast<U32s>(p.bytes) >> 24 == 0);
}
VOREL_INLINE Amounts raisedToFull(Where where, Amounts a) {
    return {a.u16s | (bitCast<U16s>(where) & kEvenByte)};
}
VOREL_INLINE Pixels kept(Where where, const Pixels& p) { return {p.bytes & bitCast<U8s>(where)}; }
VOREL_INLINE Pixels cleared(Where where, const Pixels& p) { return {p.bytes & bitCast<U8s>(~where)}; }

#endif

VOREL_INLINE Pixels added(const Pixels& a, const Pixels& b) { return {addSaturated(a.bytes, b.bytes)}; }

VOREL_INLINE U16s evenBytes(const Pixels& p) { return bitCast<U16s>(p.bytes) & kEvenByte; }
VOREL_INLINE U16s oddBytes(const Pixels& p) { return bitCast<U16s>(p.bytes) >> 8; }

VOREL_INLINE Pixels scaled(const Pixels& p, Amounts amounts) {
    const U16s even = product(evenBytes(p), amounts.u16s);
    const U16s odd = (oddBytes(p) + 1) * amounts.u16s;
    return {bitCast<U8s>(even | (odd & kOddByte))};
}

/// min(product(a + b, amount), 255), where a + b may reach 510 and the product 17 bits: the amount
/// stands in the upper byte, and the upper half of the 32-bit product is the result.
VOREL_INLINE Pixels scaledSum(const Pixels& a, const Pixels& b, Amounts amounts) {
    const U16s factor = amounts.u16s << 8;
    const auto scaledLanes = [factor](U16s x, U16s y) {
        const U16s result = multiplyHigh(x + y + 1, factor);
        return bitCast<U16s>(min(bitCast<I16s>(result), splat<I16s>(int16_t{255})));
    };
    const U16s even = scaledLanes(evenBytes(a), evenBytes(b));
    const U16s odd = scaledLanes(oddBytes(a), oddBytes(b));
    return {bitCast<U8s>(even | odd << 8)};
}

/// The colours of `p` with the alpha of `alpha`.
VOREL_INLINE Pixels withAlphaOf(const Pixels& p, const Pixels& alpha) {
    const U32s own = bitCast<U32s>(p.bytes) & ~kAlphaByte;
    return {bitCast<U8s>(own | (bitCast<U32s>(alpha.bytes) & kAlphaByte))};
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
