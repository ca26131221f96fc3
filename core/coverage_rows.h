#pragma once

#include <cstdint>

#include "core/box.h"

namespace VFontEffect::internal {

/// What a byte of coverage is xored with: taken as it is, or as 255 minus it.
constexpr uint8_t kAsIs = 0;
constexpr uint8_t kInverse = 0xFF;

/// Coverage that an operator reads: `height` rows of `width` bytes, `stride` bytes apart, each taken as
/// byte ^ invertMask.
struct CoverageRows {
    const uint8_t* start;
    int64_t stride;
    int64_t width;
    int64_t height;
    uint8_t invertMask;  // kAsIs or kInverse
};

inline Box wholeOf(const CoverageRows& rows) {
    return {0, 0, rows.width, rows.height};
}

}  // namespace VFontEffect::internal
