#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>

/// Lanes: unsigned 16-bit values that a per-pixel rule computes with, one value or a vector of them.
/// A rule written once over a lane type runs on one pixel (Lane<uint16_t>) and on eight.
///
/// The two forms agree as long as no intermediate leaves 0..65535. Branches are `select`s over masks
/// of all ones or all zeros. Loads and stores take the machine's bytes as little-endian.
namespace VFontEffect::internal {

static_assert(__BYTE_ORDER__ == __ORDER_LITTLE_ENDIAN__, "pixels are loaded as little-endian words");

using U16x8 = uint16_t __attribute__((vector_size(16)));
using U8x8 = uint8_t __attribute__((vector_size(8)));

template <class V>
struct Lane {
    V v;

    explicit Lane(V value) : v(value) {}
    explicit Lane(int value) : v(static_cast<V>(V{} + static_cast<uint16_t>(value))) {}

    friend Lane operator+(Lane a, Lane b) { return Lane(static_cast<V>(a.v + b.v)); }
    friend Lane operator-(Lane a, Lane b) { return Lane(static_cast<V>(a.v - b.v)); }
    friend Lane operator*(Lane a, Lane b) { return Lane(static_cast<V>(a.v * b.v)); }
    friend Lane operator&(Lane a, Lane b) { return Lane(static_cast<V>(a.v & b.v)); }
    friend Lane operator|(Lane a, Lane b) { return Lane(static_cast<V>(a.v | b.v)); }
    friend Lane operator>>(Lane a, int bits) { return Lane(static_cast<V>(a.v >> bits)); }
    friend Lane operator<<(Lane a, int bits) { return Lane(static_cast<V>(a.v << bits)); }
};

using OneLane = Lane<uint16_t>;
using EightLanes = Lane<U16x8>;

template <class L>
constexpr size_t kPixels = sizeof(L) / sizeof(uint16_t);

/// All ones where a == b, else zeros.
inline OneLane equal(OneLane a, OneLane b) {
    return OneLane(static_cast<uint16_t>(a.v == b.v ? 0xFFFF : 0));
}
inline EightLanes equal(EightLanes a, EightLanes b) {
    return EightLanes(reinterpret_cast<U16x8>(a.v == b.v));
}

/// All ones where a < b, else zeros.
inline OneLane less(OneLane a, OneLane b) {
    return OneLane(static_cast<uint16_t>(a.v < b.v ? 0xFFFF : 0));
}
inline EightLanes less(EightLanes a, EightLanes b) {
    return EightLanes(reinterpret_cast<U16x8>(a.v < b.v));
}

/// `a` where the mask is all ones, `b` where it is zeros.
template <class L>
L select(L mask, L a, L b) {
    return b - (mask & (b - a));
}

template <class L>
L smaller(L a, L b) {
    return select(less(a, b), a, b);
}

template <class L>
L larger(L a, L b) {
    return select(less(a, b), b, a);
}

/// Pixels of 8 bits.
inline OneLane loadBytes(const unsigned char* from, OneLane*) {
    return OneLane(static_cast<uint16_t>(*from));
}
inline EightLanes loadBytes(const unsigned char* from, EightLanes*) {
    U8x8 bytes;
    std::memcpy(&bytes, from, sizeof bytes);
    return EightLanes(__builtin_convertvector(bytes, U16x8));
}
template <class L>
L loadBytes(const unsigned char* from) {
    return loadBytes(from, static_cast<L*>(nullptr));
}

inline void storeBytes(unsigned char* to, OneLane value) {
    *to = static_cast<unsigned char>(value.v);
}
inline void storeBytes(unsigned char* to, EightLanes value) {
    const U8x8 bytes = __builtin_convertvector(value.v, U8x8);
    std::memcpy(to, &bytes, sizeof bytes);
}

/// The two 16-bit halves of each 32-bit pixel: bytes 0 and 1, and bytes 2 and 3.
template <class L>
struct Halves {
    L low;
    L high;
};

inline Halves<OneLane> loadHalves(const unsigned char* from, OneLane*) {
    uint16_t halves[2];
    std::memcpy(halves, from, sizeof halves);
    return {OneLane(halves[0]), OneLane(halves[1])};
}
inline Halves<EightLanes> loadHalves(const unsigned char* from, EightLanes*) {
    U16x8 first;
    U16x8 second;
    std::memcpy(&first, from, sizeof first);
    std::memcpy(&second, from + sizeof first, sizeof second);
    return {EightLanes(__builtin_shufflevector(first, second, 0, 2, 4, 6, 8, 10, 12, 14)),
            EightLanes(__builtin_shufflevector(first, second, 1, 3, 5, 7, 9, 11, 13, 15))};
}

inline void storeHalves(unsigned char* to, Halves<OneLane> halves) {
    const uint16_t both[2] = {halves.low.v, halves.high.v};
    std::memcpy(to, both, sizeof both);
}
inline void storeHalves(unsigned char* to, Halves<EightLanes> halves) {
    const U16x8 first = __builtin_shufflevector(halves.low.v, halves.high.v, 0, 8, 1, 9, 2, 10, 3, 11);
    const U16x8 second =
        __builtin_shufflevector(halves.low.v, halves.high.v, 4, 12, 5, 13, 6, 14, 7, 15);
    std::memcpy(to, &first, sizeof first);
    std::memcpy(to + sizeof first, &second, sizeof second);
}

/// The four bytes of each 32-bit pixel, in memory order.
template <class L>
struct Quad {
    L byte0;
    L byte1;
    L byte2;
    L byte3;
};

template <class L>
Quad<L> loadQuad(const unsigned char* from) {
    const Halves<L> halves = loadHalves(from, static_cast<L*>(nullptr));
    const L lowByte(0xFF);
    return {halves.low & lowByte, halves.low >> 8, halves.high & lowByte, halves.high >> 8};
}

template <class L>
void storeQuad(unsigned char* to, const Quad<L>& quad) {
    storeHalves(to, {quad.byte0 | quad.byte1 << 8, quad.byte2 | quad.byte3 << 8});
}

}  // namespace VFontEffect::internal
