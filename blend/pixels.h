#pragma once

#include "blend/lanes.h"
#include "core/fixed_point.h"

/// Vectors of colour pixels, and one amount of 0..255 for each of them: what the per-pixel rules
/// compute with. All products are product(x, y) = ((x + 1) * y) >> 8 of core/fixed_point.h.
///
/// Pixels stand in one of two ways, whichever the level's instructions handle in fewer steps: packed,
/// one pixel a 32-bit lane, multiplied as even and odd bytes in 16-bit halves; or planar, one vector a
/// channel, as NEON loads, multiplies and stores them.
namespace VFontEffect::internal::VOREL_LEVEL {

#if defined(VOREL_NEON)

constexpr int64_t kPixels = kBytes;

struct Pixels {
    uint8x16x4_t channels;  // red, green, blue, alpha
};
using Amounts = uint8x16_t;
using Where = uint8x16_t;  // all ones or all zeros for each pixel

VOREL_INLINE Pixels loadPixels(const uint8_t* from) {
    return {vld4q_u8(from)};
}
VOREL_INLINE void storePixels(uint8_t* to, const Pixels& pixels) {
    vst4q_u8(to, pixels.channels);
}
/// Pixels in memory order from the words that `wordsAt(i)` gives for pixel i and the next ones.
template <class WordsAt>
VOREL_INLINE Pixels madeOfWords(WordsAt wordsAt) {
    const uint8x16x4_t words = {{as<uint8x16_t>(wordsAt(0)), as<uint8x16_t>(wordsAt(4)),
                                 as<uint8x16_t>(wordsAt(8)), as<uint8x16_t>(wordsAt(12))}};
    uint8_t pixels[4 * kPixels] = {};
    vst1q_u8_x4(pixels, words);
    return loadPixels(pixels);
}
/// From words 0xAARRGGBB: memory order B, G, R, A.
VOREL_INLINE Pixels loadWords(const uint8_t* from) {
    const uint8x16x4_t p = vld4q_u8(from);
    return {{{p.val[2], p.val[1], p.val[0], p.val[3]}}};
}
/// From memory order A, R, G, B.
VOREL_INLINE Pixels loadArgb(const uint8_t* from) {
    const uint8x16x4_t p = vld4q_u8(from);
    return {{{p.val[1], p.val[2], p.val[3], p.val[0]}}};
}
VOREL_INLINE Amounts loadAmounts(const uint8_t* from) {
    return vld1q_u8(from);
}

/// The same colour word 0xAARRGGBB in every pixel.
VOREL_INLINE Pixels spreadColour(uint32_t color) {
    const auto channel = [color](int shift) { return vdupq_n_u8(static_cast<uint8_t>(color >> shift)); };
    return {{{channel(16), channel(8), channel(0), channel(24)}}};
}

VOREL_INLINE Amounts alphaOf(const Pixels& p) {
    return p.channels.val[3];
}
VOREL_INLINE Amounts inverse(Amounts a) {
    return vmvnq_u8(a);
}
/// Whether all pixels are zeros.
VOREL_INLINE bool isClear(const Pixels& p) {
    const uint8x16_t* const c = p.channels.val;
    return allZero(as<Bytes>(vorrq_u8(vorrq_u8(c[0], c[1]), vorrq_u8(c[2], c[3]))));
}
VOREL_INLINE Where isZero(Amounts a) {
    return vceqzq_u8(a);
}
VOREL_INLINE Where isTransparent(const Pixels& p) {
    return isZero(alphaOf(p));
}
VOREL_INLINE Amounts raisedToFull(Where where, Amounts a) {
    return vorrq_u8(a, where);
}

template <class Operation>
VOREL_INLINE Pixels perChannel(const Pixels& a, const Pixels& b, Operation operation) {
    const uint8x16_t* const x = a.channels.val;
    const uint8x16_t* const y = b.channels.val;
    return {
        {{operation(x[0], y[0]), operation(x[1], y[1]), operation(x[2], y[2]), operation(x[3], y[3])}}};
}

VOREL_INLINE Pixels kept(Where where, const Pixels& p) {
    return perChannel(p, p, [where](uint8x16_t x, uint8x16_t) { return vandq_u8(x, where); });
}
VOREL_INLINE Pixels cleared(Where where, const Pixels& p) {
    return perChannel(p, p, [where](uint8x16_t x, uint8x16_t) { return vbicq_u8(x, where); });
}
VOREL_INLINE Pixels added(const Pixels& a, const Pixels& b) {
    return perChannel(a, b, [](uint8x16_t x, uint8x16_t y) { return vqaddq_u8(x, y); });
}

/// (x * y + y) >> 8, the sum and its upper half in one instruction.
VOREL_INLINE uint8x16_t productOf(uint8x16_t x, uint8x16_t y) {
    const uint8x8_t low = vaddhn_u16(vmull_u8(vget_low_u8(x), vget_low_u8(y)), vmovl_u8(vget_low_u8(y)));
    return vaddhn_high_u16(low, vmull_high_u8(x, y), vmovl_high_u8(y));
}
VOREL_INLINE Pixels scaled(const Pixels& p, Amounts amounts) {
    return perChannel(p, p, [amounts](uint8x16_t x, uint8x16_t) { return productOf(x, amounts); });
}

/// min(product(a + b, amount), 255), where a + b may reach 510. With a + b + 1 = 256 h + l it is
/// h * amount + (l * amount >> 8).
VOREL_INLINE Pixels scaledSum(const Pixels& a, const Pixels& b, Amounts amounts) {
    return perChannel(a, b, [amounts](uint8x16_t x, uint8x16_t y) {
        const uint8x16_t low = vsubq_u8(vaddq_u8(x, y), vdupq_n_u8(255));
        const uint8x16_t carry = vcgeq_u8(y, vmvnq_u8(x));
        const uint8x8_t near = vshrn_n_u16(vmull_u8(vget_low_u8(low), vget_low_u8(amounts)), 8);
        const uint8x16_t scaledLow = vshrn_high_n_u16(near, vmull_high_u8(low, amounts), 8);
        return vqaddq_u8(scaledLow, vandq_u8(carry, amounts));
    });
}

/// The colours of `p` with the alpha of `alpha`.
VOREL_INLINE Pixels withAlphaOf(const Pixels& p, const Pixels& alpha) {
    return {{{p.channels.val[0], p.channels.val[1], p.channels.val[2], alpha.channels.val[3]}}};
}

#else

constexpr int64_t kPixels = kWords;

struct Pixels {
    Bytes bytes;
};
struct Amounts {
    Halves halves;  // a pixel's amount in both halves of its word
};

constexpr uint16_t kEvenByte = 0x00FF;
constexpr uint16_t kOddByte = 0xFF00;
constexpr uint32_t kAlphaByte = 0xFF000000U;

VOREL_INLINE Pixels loadPixels(const uint8_t* from) {
    return {load<Bytes>(from)};
}
VOREL_INLINE void storePixels(uint8_t* to, const Pixels& pixels) {
    store(to, pixels.bytes);
}

/// Pixels in memory order from the words that `wordsAt(i)` gives for pixel i and the next ones.
template <class WordsAt>
VOREL_INLINE Pixels madeOfWords(WordsAt wordsAt) {
    return {as<Bytes>(wordsAt(0))};
}
/// From words 0xAARRGGBB: memory order B, G, R, A.
VOREL_INLINE Pixels loadWords(const uint8_t* from) {
    return {endsSwapped(load<Bytes>(from))};
}
/// From memory order A, R, G, B.
VOREL_INLINE Pixels loadArgb(const uint8_t* from) {
    const Words words = load<Words>(from);
    return {as<Bytes>(words >> 8 | words << 24)};
}
VOREL_INLINE Amounts loadAmounts(const uint8_t* from) {
    return {loadInPairs(from)};
}

/// The same colour word 0xAARRGGBB in every pixel.
VOREL_INLINE Pixels spreadColour(uint32_t color) {
    const uint32_t swapped = (color & 0xFF00FF00U) | (color & 0xFFU) << 16 | (color >> 16 & 0xFFU);
    return {as<Bytes>(spread<Words>(swapped))};
}

VOREL_INLINE Amounts alphaOf(const Pixels& p) {
    return {highBytesInPairs(p.bytes)};
}
VOREL_INLINE Amounts inverse(Amounts a) {
    return {a.halves ^ kEvenByte};
}
/// Whether all pixels are zeros.
VOREL_INLINE bool isClear(const Pixels& p) {
    return allZero(p.bytes);
}

#if defined(VOREL_AVX512)

using Where = __mmask16;  // one bit for each pixel

VOREL_INLINE Where isZero(Amounts a) {
    return _mm512_testn_epi32_mask(as<__m512i>(a.halves), as<__m512i>(a.halves));
}
VOREL_INLINE Where isTransparent(const Pixels& p) {
    return _mm512_testn_epi32_mask(as<__m512i>(p.bytes), as<__m512i>(spread<Words>(kAlphaByte)));
}
VOREL_INLINE Amounts raisedToFull(Where where, Amounts a) {
    return {as<Halves>(
        _mm512_mask_mov_epi32(as<__m512i>(a.halves), where, as<__m512i>(spread<Halves>(kEvenByte))))};
}
VOREL_INLINE Pixels kept(Where where, const Pixels& p) {
    return {as<Bytes>(_mm512_maskz_mov_epi32(where, as<__m512i>(p.bytes)))};
}
VOREL_INLINE Pixels cleared(Where where, const Pixels& p) {
    return {as<Bytes>(_mm512_mask_mov_epi32(as<__m512i>(p.bytes), where, __m512i{}))};
}

#else

using Where = Words;  // all ones or all zeros for each pixel

VOREL_INLINE Where isZero(Amounts a) {
    return as<Where>(a.halves == 0);
}
VOREL_INLINE Where isTransparent(const Pixels& p) {
    return as<Where>(as<Words>(p.bytes) >> 24 == 0);
}
VOREL_INLINE Amounts raisedToFull(Where where, Amounts a) {
    return {a.halves | (as<Halves>(where) & kEvenByte)};
}
VOREL_INLINE Pixels kept(Where where, const Pixels& p) {
    return {p.bytes & as<Bytes>(where)};
}
VOREL_INLINE Pixels cleared(Where where, const Pixels& p) {
    return {p.bytes & as<Bytes>(~where)};
}

#endif

VOREL_INLINE Pixels added(const Pixels& a, const Pixels& b) {
    return {addSaturated(a.bytes, b.bytes)};
}

VOREL_INLINE Halves evenBytes(const Pixels& p) {
    return as<Halves>(p.bytes) & kEvenByte;
}
VOREL_INLINE Halves oddBytes(const Pixels& p) {
    return as<Halves>(p.bytes) >> 8;
}

VOREL_INLINE Pixels scaled(const Pixels& p, Amounts amounts) {
    const Halves even = product(evenBytes(p), amounts.halves);
    const Halves odd = (oddBytes(p) + 1) * amounts.halves;
    return {as<Bytes>(even | (odd & kOddByte))};
}

/// min(product(a + b, amount), 255), where a + b may reach 510 and the product 17 bits: the amount
/// stands in the upper byte, and the upper half of the 32-bit product is the result.
VOREL_INLINE Pixels scaledSum(const Pixels& a, const Pixels& b, Amounts amounts) {
    using SignedHalves = int16_t __attribute__((vector_size(kBytes)));
    const Halves factor = amounts.halves << 8;
    const auto scaledHalves = [factor](Halves x, Halves y) {
        const Halves result = multiplyHigh(x + y + 1, factor);
        return as<Halves>(smaller(as<SignedHalves>(result), spread<SignedHalves>(int16_t{255})));
    };
    const Halves even = scaledHalves(evenBytes(a), evenBytes(b));
    const Halves odd = scaledHalves(oddBytes(a), oddBytes(b));
    return {as<Bytes>(even | odd << 8)};
}

/// The colours of `p` with the alpha of `alpha`.
VOREL_INLINE Pixels withAlphaOf(const Pixels& p, const Pixels& alpha) {
    const Words own = as<Words>(p.bytes) & ~kAlphaByte;
    return {as<Bytes>(own | (as<Words>(alpha.bytes) & kAlphaByte))};
}

#endif

}  // namespace VFontEffect::internal::VOREL_LEVEL
