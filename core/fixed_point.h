#pragma once

#include <cstdint>

#include "core/inline.h"

namespace VFontEffect::internal {

/// The fixed-point product of the whole library: ((x + 1) * y) >> 8, standing for x * y / 255.
///
/// The first argument is the one that grows by 1. For x and y in 0..255 the result is in 0..255,
/// product(x, 0) = 0, product(255, y) = y, product(x, 255) = x, and the widest intermediate is
/// 256 * 255 = 65280: it fits in 16 bits, so T may be a vector of 16-bit lanes.
template <class T>
VOREL_INLINE T product(T x, T y) {
    return static_cast<T>(((x + 1) * y) >> 8);
}

/// A straight 0xAARRGGBB colour with its channels multiplied by its alpha.
inline uint32_t premultiply(uint32_t color) {
    const uint32_t alpha = color >> 24;
    const uint32_t red = product((color >> 16) & 0xFFU, alpha);
    const uint32_t green = product((color >> 8) & 0xFFU, alpha);
    const uint32_t blue = product(color & 0xFFU, alpha);
    return alpha << 24 | red << 16 | green << 8 | blue;
}

}  // namespace VFontEffect::internal
