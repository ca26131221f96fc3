#pragma once

#include "core/inline.h"

/// Loops written out when the source is compiled.
namespace VFontEffect::internal::VOREL_LEVEL {

template <int kValue>
struct Index {
    static constexpr int value = kValue;
};

/// Calls action(i) for i.value = 0 ... kCount - 1. Compilers keep an array of vectors in registers only
/// when all of its indices are constants from the start.
template <int kCount, int kFirst = 0, class Action>
VOREL_INLINE void unrolled(const Action& action) {
    if constexpr (kFirst < kCount) {
        action(Index<kFirst>{});
        unrolled<kCount, kFirst + 1>(action);
    }
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
