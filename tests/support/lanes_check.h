#pragma once

#include <cstdint>

#include "simd/cpu_level.h"

/// Every operation that simd/lanes.h asks a level for, beside a loop over its lanes. Compiled once per
/// level, as the inner loops are.
namespace VFontEffect::internal {

struct LanesCheck {
    /// Tries each on random lanes and on the ends of their ranges: the first whose result is another
    /// one, by name, or null.
    const char* (*wrongOperation)(uint64_t seed);
};

const LanesCheck& lanesCheck(CpuLevel level);

}  // namespace VFontEffect::internal
