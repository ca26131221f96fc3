#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <utility>

#include "core/assert.h"
#include "core/inline.h"
#include "core/numeric.h"

/// Vectors as wide as the registers of the level that a source of inner loops is compiled for, in that
/// level's namespace, and what the compilers' vector types express by themselves: both g++ and clang
/// turn arithmetic, comparisons and choices (`mask ? a : b`) into single instructions.
namespace VFontEffect::internal::VOREL_LEVEL {

static_assert(__BYTE_ORDER__ == __ORDER_LITTLE_ENDIAN__, "pixels are loaded as little-endian words");

constexpr int64_t kBytes = VOREL_VECTOR_BYTES;
constexpr int64_t kU32Lanes = kBytes / 4;

using U8s = uint8_t __attribute__((vector_size(kBytes)));
using U16s = uint16_t __attribute__((vector_size(kBytes)));
using I16s = int16_t __attribute__((vector_size(kBytes)));
using U32s = uint32_t __attribute__((vector_size(kBytes)));
using I32s = int32_t __attribute__((vector_size(kBytes)));
using F32s = float __attribute__((vector_size(kBytes)));

/// One vector's bits as another type of lanes.
template <class To, class From>
VOREL_INLINE To bitCast(From vector) {
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
    VOREL_ASSERT(reinterpret_cast<uintptr_t>(from) % sizeof(V) == 0);
    return load<V>(__builtin_assume_aligned(from, sizeof(V)));
}
template <class V>
VOREL_INLINE void store(void* to, V vector) {
    std::memcpy(to, &vector, sizeof vector);
}

/// `value` in every lane.
template <class V, class T>
VOREL_INLINE V splat(T value) {
    return V{} + value;
}

/// 0, 1, 2, ... in the lanes. Listed, not counted: in a loop clang would insert lane after lane.
template <class V, size_t... kLanes>
VOREL_INLINE V iota(std::index_sequence<kLanes...>) {
    return V{kLanes...};
}
template <class V>
VOREL_INLINE V iota() {
    return iota<V>(std::make_index_sequence<sizeof(V) / sizeof(V{}[0])>());
}

/// All ones in the first `count` bytes, 0 to kBytes of them.
VOREL_INLINE U8s firstBytes(int64_t count) {
    return bitCast<U8s>(iota<U8s>() < splat<U8s>(static_cast<uint8_t>(count)));
}

template <class V>
VOREL_INLINE V max(V a, V b) {
    return a > b ? a : b;
}
template <class V>
VOREL_INLINE V min(V a, V b) {
    return a < b ? a : b;
}
VOREL_INLINE I32s clamped(I32s value, int32_t low, int32_t high) {
    return max(min(value, splat<I32s>(high)), splat<I32s>(low));
}

/// Two bytes of each word, one in each of its 16-bit lanes.
constexpr uint32_t kEvenBytes = 0x00FF00FFU;

}  // namespace VFontEffect::internal::VOREL_LEVEL
