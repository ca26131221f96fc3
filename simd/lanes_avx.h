#pragma once

#include "simd/lanes_x86.h"

/// What AVX2 and AVX-512 say alike. Their levels give `shuffled`, which moves bytes within each 128 bits
/// (an index of -1 gives 0), and `widened`, words of as many bytes in memory.
namespace VFontEffect::internal::VOREL_LEVEL {

VOREL_INLINE U16s loadInPairs(const uint8_t* from) {
    return bitCast<U16s>(
        shuffled(bitCast<U8s>(widened(from)),
                 _mm_setr_epi8(-1, 0, -1, 0, -1, 4, -1, 4, -1, 8, -1, 8, -1, 12, -1, 12)));
}
VOREL_INLINE U16s highBytesInPairs(U8s v) {
    return bitCast<U16s>(
        shuffled(v, _mm_setr_epi8(-1, 3, -1, 3, -1, 7, -1, 7, -1, 11, -1, 11, -1, 15, -1, 15)));
}
VOREL_INLINE U8s swapRedBlue(U8s v) {
    return shuffled(v, _mm_setr_epi8(2, 1, 0, 3, 6, 5, 4, 7, 10, 9, 8, 11, 14, 13, 12, 15));
}
VOREL_INLINE U16s pairSums(U8s v) {
    return bitCast<U16s>(VOREL_X86(maddubs_epi16)(ints(v), VOREL_X86(set1_epi8)(1)));
}

#define VOREL_PAIR_PRODUCTS
VOREL_INLINE U16s pairProducts(U8s a, U8s b) {
    return bitCast<U16s>(VOREL_X86(maddubs_epi16)(ints(a), ints(b)));
}

#define VOREL_NATIVE_GATHER
VOREL_INLINE U32s gather(const uint32_t* table, const uint8_t* indices) {
    return gather(table, bitCast<I32s>(widened(indices)));
}

#define VOREL_NATIVE_GATHER_NEAR
constexpr int32_t kNearEntries = 2 * kU32Lanes;
/// The first of a table's kNearEntries entries that may hold all that the indices ask for: as a rule
/// they ascend or descend.
VOREL_INLINE int32_t firstNear(I32s indices, int32_t size) {
    const int32_t one = indices[0];
    const int32_t other = indices[kU32Lanes - 1];
    return min(min(one, other), static_cast<int32_t>(size - kNearEntries));
}
VOREL_INLINE U32s gatherNear(const uint32_t* table, int32_t size, I32s indices) {
    VOREL_ASSERT(size >= kNearEntries);
    const int32_t first = firstNear(indices, size);
    const auto offsets = bitCast<U32s>(indices - first);
    if (!allZero(bitCast<U8s>(offsets & ~static_cast<uint32_t>(kNearEntries - 1))))
        return gather(table, indices);
    return lookUp(load<U32s>(table + first), load<U32s>(table + first + kU32Lanes), offsets);
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
