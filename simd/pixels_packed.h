#pragma once

#include "core/fixed_point.h"
#include "simd/lanes.h"

/// Packed pixels: one a 32-bit lane, multiplied as even and odd bytes in 16-bit lanes.
namespace VFontEffect::internal::VOREL_LEVEL {

constexpr int64_t kPixels = kU32Lanes;

struct Pixels {
    U8s bytes;
};
/// The bytes of pixels as products take and leave them, one a 16-bit lane: red and blue, green and
/// alpha.
struct Halves {
    U16s even;
    U16s odd;
};
struct Amounts {
    U16s u16s;  // a pixel's amount in both 16-bit lanes of its word, moved up by kAmountShift
};

constexpr uint16_t kEvenByte = 0x00FF;
constexpr uint16_t kAmountByte = 0xFF << kAmountShift;
constexpr uint32_t kAlphaByte = 0xFF000000U;

VOREL_INLINE Pixels loadPixels(const uint8_t* from) { return {load<U8s>(from)}; }
VOREL_INLINE void storePixels(uint8_t* to, const Pixels& pixels) { store(to, pixels.bytes); }

/// The entries of a ramp of 256, pixels in memory order, at the places of kPixels pixels, the first
/// entry being that of place kFirst; what lies before or behind has that of the end. placesAt(i) are
/// those of pixel i and the next kU32Lanes - 1.
template <int32_t kFirst, class PlacesAt>
VOREL_INLINE Pixels rampEntries(const uint32_t* ramp, PlacesAt placesAt) {
    constexpr int32_t kEntries = 256;
    const I32s places = clamped(placesAt(0), kFirst, kFirst + kEntries - 1);
    return {bitCast<U8s>(gatherNear(ramp, kEntries, places - kFirst))};
}
/// Those of kPixels bytes.
VOREL_INLINE Pixels rampEntries(const uint32_t* ramp, const uint8_t* bytes) {
    return {bitCast<U8s>(gather(ramp, bytes))};
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
VOREL_INLINE Pixels inverse(const Pixels& p) { return {~p.bytes}; }
/// 255 - alpha. Inverted before it is spread: one instruction takes the upper byte of the inverse.
VOREL_INLINE Amounts inverseAlphaOf(const Pixels& p) { return {highBytesInPairs(~p.bytes)}; }
VOREL_INLINE Amounts inverse(Amounts a) { return {a.u16s ^ kAmountByte}; }
/// Whether all pixels are zeros.
VOREL_INLINE bool isClear(const Pixels& p) { return allZero(p.bytes); }

#if defined(VOREL_MASK_REGISTERS)

using Where = __mmask16;  // one bit for each pixel

VOREL_INLINE Where isZero(Amounts a) {
    return _mm512_testn_epi32_mask(bitCast<__m512i>(a.u16s), bitCast<__m512i>(a.u16s));
}
VOREL_INLINE Where isFull(Amounts a) {
    return _mm512_cmpeq_epi32_mask(bitCast<__m512i>(a.u16s), bitCast<__m512i>(splat<U16s>(kAmountByte)));
}
VOREL_INLINE Where isTransparent(const Pixels& p) {
    return _mm512_testn_epi32_mask(bitCast<__m512i>(p.bytes), bitCast<__m512i>(splat<U32s>(kAlphaByte)));
}
/// Amounts for scaledSum: 255 in some pixels.
VOREL_INLINE Amounts raisedToFull(Where where, Amounts a) {
    return {bitCast<U16s>(_mm512_mask_mov_epi32(bitCast<__m512i>(a.u16s), where,
                                                bitCast<__m512i>(splat<U16s>(kAmountByte))))};
}
VOREL_INLINE Pixels filled(Where where, const Pixels& p) {
    return {bitCast<U8s>(_mm512_mask_mov_epi32(bitCast<__m512i>(p.bytes), where,
                                               bitCast<__m512i>(splat<U8s>(uint8_t{255}))))};
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
VOREL_INLINE Where isFull(Amounts a) { return bitCast<Where>(a.u16s == kAmountByte); }
VOREL_INLINE Where isTransparent(const Pixels& p) {
    return bitCast<Where>(bitCast<U32s>(p.bytes) >> 24 == 0);
}
/// Amounts for scaledSum: 255 in some pixels, or all ones, which are as good for sums up to 255, as
/// (x + 1) * 0xFFFF >> 16 = x.
VOREL_INLINE Amounts raisedToFull(Where where, Amounts a) { return {a.u16s | bitCast<U16s>(where)}; }
VOREL_INLINE Pixels filled(Where where, const Pixels& p) { return {p.bytes | bitCast<U8s>(where)}; }
VOREL_INLINE Pixels kept(Where where, const Pixels& p) { return {p.bytes & bitCast<U8s>(where)}; }
VOREL_INLINE Pixels cleared(Where where, const Pixels& p) { return {p.bytes & bitCast<U8s>(~where)}; }

#endif

VOREL_INLINE Pixels added(const Pixels& a, const Pixels& b) { return {addSaturated(a.bytes, b.bytes)}; }

VOREL_INLINE Halves halvesOf(const Pixels& p) {
    return {bitCast<U16s>(p.bytes) & kEvenByte, bitCast<U16s>(p.bytes) >> 8};
}
VOREL_INLINE Halves inWholeVectors(const Halves& h) { return h; }
VOREL_INLINE Pixels joined(const Pixels& p) { return p; }
VOREL_INLINE Pixels joined(const Halves& h) { return {bitCast<U8s>(h.even | h.odd << 8)}; }

/// product(x, amount). An amount in the upper byte makes the upper half of one multiplication of it.
VOREL_INLINE U16s productOf(U16s x, Amounts amounts) {
    if constexpr (kAmountShift == 8) return multiplyHigh(x + 1, amounts.u16s);
    return product(x, amounts.u16s);
}
VOREL_INLINE Halves scaled(const Halves& h, Amounts amounts) {
    return {productOf(h.even, amounts), productOf(h.odd, amounts)};
}
VOREL_INLINE Pixels scaled(const Pixels& p, Amounts amounts) {
    return joined(scaled(halvesOf(p), amounts));
}

/// a + b, where no sum is above 255.
VOREL_INLINE Pixels sumOf(const Halves& a, const Halves& b) {
    return joined({a.even + b.even, a.odd + b.odd});
}

/// min(product(a + b, amount), 255) of 255 - a, where a + b may reach 510 and the product 17 bits: the
/// amount stands in the upper byte, and the upper half of the 32-bit product is the result. In 16 bits
/// a + b + 1 is b - (0xFF00 + 255 - a).
VOREL_INLINE Pixels scaledSum(const Pixels& inverseOfA, const Halves& b, Amounts amounts) {
    const U16s factor = amounts.u16s << (8 - kAmountShift);
    const auto scaledLanes = [factor](U16s inverseOfX, U16s y) {
        const U16s result = multiplyHigh(y - (inverseOfX | 0xFF00), factor);
        return bitCast<U16s>(min(bitCast<I16s>(result), splat<I16s>(int16_t{255})));
    };
    const auto inverse = bitCast<U16s>(inverseOfA.bytes);
    return joined({scaledLanes(inverse, b.even), scaledLanes(inverse >> 8, b.odd)});
}

/// The colours of `p` with the alpha of `alpha`.
VOREL_INLINE Pixels withAlphaOf(const Pixels& p, const Pixels& alpha) {
    const U32s own = bitCast<U32s>(p.bytes) & ~kAlphaByte;
    return {bitCast<U8s>(own | (bitCast<U32s>(alpha.bytes) & kAlphaByte))};
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
