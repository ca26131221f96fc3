#pragma once

#include "simd/lanes.h"

namespace VFontEffect::internal::VOREL_LEVEL {

/// In a class, as g++ forgets the attribute of a type that depends on a function's parameters.
template <int64_t kWidth>
struct Piece {
    typedef uint8_t Vector __attribute__((vector_size(kWidth)));
};

/// Cuts a row of `count` bytes into vectors and calls work(V{}, x) for each, V being the vector's type
/// and x its first byte. Vectors are as wide as the level's; a shorter row takes the widest that fit in
/// it. The last one may lie over its predecessor, so work done twice must be as good as once.
template <int64_t kWidth = kBytes, class Work>
VOREL_INLINE void forPieces(int64_t count, Work work) {
    using V = typename Piece<kWidth>::Vector;
    if (count >= kWidth) {
        int64_t x = 0;
        for (; x + kWidth <= count; x += kWidth)
            work(V{}, x);
        if (x < count) work(V{}, count - kWidth);
    } else if constexpr (kWidth > 1) {
        forPieces<kWidth / 2>(count, work);
    }
}

/// Copies `count` bytes, each ^ invertMask.
VOREL_INLINE void copyInverted(const uint8_t* from, int64_t count, uint8_t invertMask, uint8_t* to) {
    forPieces(count, [=](auto v, int64_t x) VOREL_INLINE_LAMBDA {
        using V = decltype(v);
        store(to + x, load<V>(from + x) ^ splat<V>(invertMask));
    });
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
