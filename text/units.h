#pragma once

#include <cstdint>

/// 64ths of a pixel, the units of fonts and shapers.
namespace voreltext {

constexpr int64_t kUnit = 64;

/// Division that rounds downwards; the divisor is positive.
inline int64_t floorOf(int64_t number, int64_t divisor) {
    return number / divisor - (number % divisor < 0 ? 1 : 0);
}

inline int floorToPixel(int64_t units) {
    return static_cast<int>(units >> 6);
}
inline int ceilToPixel(int64_t units) {
    return floorToPixel(units + kUnit - 1);
}

}  // namespace voreltext
