#pragma once

#include "core/fixed_point.h"
#include "simd/lanes.h"
#include "simd/unrolled.h"

/// Planar pixels: one vector a channel, as NEON loads, multiplies and stores them.
namespace VFontEffect::internal::VOREL_LEVEL {

constexpr int64_t kPixels = kBytes;

struct Pixels {
    uint8x16_t channels[4];  // red, green, blue, alpha
};
using Halves = Pixels;  // as products take and leave them
using Amounts = uint8x16_t;
using Where = uint8x16_t;  // all ones or all zeros for each pixel

VOREL_INLINE Pixels loadPixels(const uint8_t* from) {
    const uint8x16x4_t p = vld4q_u8(from);
    return {{p.val[0], p.val[1], p.val[2], p.val[3]}};
}
VOREL_INLINE void storePixels(uint8_t* to, const Pixels& pixels) {
    const uint8x16_t* const c = pixels.channels;
#if defined(__clang__)
    const uint8x16x4_t planes = {{c[0], c[1], c[2], c[3]}};
    vst4q_u8(to, planes);
#else
    // g++ computes channels in registers of their own and moves them into the four that the store takes.
    // Loads come first: what an instrumented build calls for them could change those.
    const uint8x16_t r = c[0], g = c[1], b = c[2], a = c[3];
    register uint8x16_t red asm("v0") = r;
    register uint8x16_t green asm("v1") = g;
    register uint8x16_t blue asm("v2") = b;
    register uint8x16_t alpha asm("v3") = a;
    using Bytes = uint8_t[4 * kPixels];
    asm("st4 {%1.16b - %4.16b}, %0"
        : "=Q"(*reinterpret_cast<Bytes*>(to))
        : "w"(red), "w"(green), "w"(blue), "w"(alpha));
#endif
}
/// The words of a table, as pixels in memory order; indicesAt(i) are those of pixel i and the next
/// three, in the bytes of a word. The words come together in pairs: a vector takes longer to be put
/// together by single words.
template <class IndicesAt>
VOREL_INLINE Pixels lookedUp(const uint32_t* table, IndicesAt indicesAt) {
    uint64_t pairs[kPixels / 2];
    unrolled<kPixels / 4>([&](auto i) VOREL_INLINE_LAMBDA {
        const uint32_t four = indicesAt(4 * i.value);
        uint64_t first = table[four & 0xFF] | uint64_t{table[four >> 8 & 0xFF]} << 32;
        uint64_t second = table[four >> 16 & 0xFF] | uint64_t{table[four >> 24]} << 32;
        // g++ would make vectors of these shifts.
        asm("" : "+r"(first), "+r"(second));
        pairs[2 * i.value] = first;
        pairs[2 * i.value + 1] = second;
    });
    return loadPixels(reinterpret_cast<const uint8_t*>(pairs));
}
/// The entries of a ramp of 256, pixels in memory order, at the places of kPixels pixels, the first
/// entry being that of place kFirst; what lies before or behind has that of the end. placesAt(i) are
/// those of pixel i and the next kU32Lanes - 1.
template <int32_t kFirst, class PlacesAt>
VOREL_INLINE Pixels rampEntries(const uint32_t* ramp, PlacesAt placesAt) {
    return lookedUp(ramp, [&](int64_t i) VOREL_INLINE_LAMBDA { return toBytes<kFirst>(placesAt(i)); });
}
/// Those of kPixels bytes.
VOREL_INLINE Pixels rampEntries(const uint32_t* ramp, const uint8_t* bytes) {
    return lookedUp(ramp, [bytes](int64_t i) VOREL_INLINE_LAMBDA {
        uint32_t four;
        std::memcpy(&four, bytes + i, sizeof four);
        return four;
    });
}
/// From words 0xAARRGGBB: memory order B, G, R, A.
VOREL_INLINE Pixels loadWords(const uint8_t* from) {
    const uint8x16x4_t p = vld4q_u8(from);
    return {{p.val[2], p.val[1], p.val[0], p.val[3]}};
}
/// From memory order A, R, G, B.
VOREL_INLINE Pixels loadArgb(const uint8_t* from) {
    const uint8x16x4_t p = vld4q_u8(from);
    return {{p.val[1], p.val[2], p.val[3], p.val[0]}};
}
VOREL_INLINE Amounts loadAmounts(const uint8_t* from) { return vld1q_u8(from); }

/// The same colour word 0xAARRGGBB in every pixel.
VOREL_INLINE Pixels splatColour(uint32_t color) {
    const auto channel = [color](int shift) { return vdupq_n_u8(static_cast<uint8_t>(color >> shift)); };
    return {{channel(16), channel(8), channel(0), channel(24)}};
}

VOREL_INLINE Amounts alphaOf(const Pixels& p) { return p.channels[3]; }
VOREL_INLINE Amounts inverse(Amounts a) { return vmvnq_u8(a); }
VOREL_INLINE Amounts inverseAlphaOf(const Pixels& p) { return inverse(alphaOf(p)); }
/// Whether all pixels are zeros.
VOREL_INLINE bool isClear(const Pixels& p) {
    const uint8x16_t* const c = p.channels;
    return allZero(bitCast<U8s>(vorrq_u8(vorrq_u8(c[0], c[1]), vorrq_u8(c[2], c[3]))));
}
VOREL_INLINE Where isZero(Amounts a) { return vceqzq_u8(a); }
VOREL_INLINE Where isFull(Amounts a) { return isZero(inverse(a)); }
VOREL_INLINE Where isTransparent(const Pixels& p) { return isZero(alphaOf(p)); }
VOREL_INLINE Amounts raisedToFull(Where where, Amounts a) { return vorrq_u8(a, where); }

template <class Operation>
VOREL_INLINE Pixels perChannel(const Pixels& a, const Pixels& b, Operation operation) {
    const uint8x16_t* const x = a.channels;
    const uint8x16_t* const y = b.channels;
    return {
        {operation(x[0], y[0]), operation(x[1], y[1]), operation(x[2], y[2]), operation(x[3], y[3])}};
}

VOREL_INLINE Pixels kept(Where where, const Pixels& p) {
    return perChannel(p, p, [where](uint8x16_t x, uint8x16_t) { return vandq_u8(x, where); });
}
VOREL_INLINE Pixels cleared(Where where, const Pixels& p) {
    return perChannel(p, p, [where](uint8x16_t x, uint8x16_t) { return vbicq_u8(x, where); });
}
VOREL_INLINE Pixels filled(Where where, const Pixels& p) {
    return perChannel(p, p, [where](uint8x16_t x, uint8x16_t) { return vorrq_u8(x, where); });
}
VOREL_INLINE Pixels inverse(const Pixels& p) {
    return perChannel(p, p, [](uint8x16_t x, uint8x16_t) { return vmvnq_u8(x); });
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

VOREL_INLINE Halves halvesOf(const Pixels& p) { return p; }
VOREL_INLINE Pixels joined(const Halves& h) { return h; }
/// What has been multiplied and will be again. g++ would keep its lower half apart, for the next
/// product, and move it to join the upper one.
VOREL_INLINE Halves inWholeVectors(Halves h) {
#if !defined(__clang__)
    for (uint8x16_t& channel : h.channels)
        asm("" : "+w"(channel));
#endif
    return h;
}
VOREL_INLINE Pixels sumOf(const Halves& a, const Halves& b) { return added(a, b); }

/// min(product(a + b, amount), 255) of 255 - a. With b - (255 - a) = 256 (h - 1) + l it is
/// h * amount + (l * amount >> 8).
VOREL_INLINE Pixels scaledSum(const Pixels& inverseOfA, const Halves& b, Amounts amounts) {
    return perChannel(inverseOfA, b, [amounts](uint8x16_t x, uint8x16_t y) {
        const uint8x16_t low = vsubq_u8(y, x);
        const uint8x16_t carry = vcgeq_u8(y, x);
        const uint8x8_t near = vshrn_n_u16(vmull_u8(vget_low_u8(low), vget_low_u8(amounts)), 8);
        const uint8x16_t scaledLow = vshrn_high_n_u16(near, vmull_high_u8(low, amounts), 8);
        return vqaddq_u8(scaledLow, vandq_u8(carry, amounts));
    });
}

/// The colours of `p` with the alpha of `alpha`.
VOREL_INLINE Pixels withAlphaOf(const Pixels& p, const Pixels& alpha) {
    return {{p.channels[0], p.channels[1], p.channels[2], alpha.channels[3]}};
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
