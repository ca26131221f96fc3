#pragma once

#include "simd/lanes.h"

#if defined(VOREL_PLANAR_PIXELS)
#include "simd/pixels_planar.h"
#else
#include "simd/pixels_packed.h"
#endif

/// Vectors of colour pixels, and one amount of 0..255 for each of them: what the per-pixel rules
/// compute with. All products are product(x, y) = ((x + 1) * y) >> 8 of core/fixed_point.h.
///
/// Pixels stand in one of two forms, whichever the level's instructions handle in fewer steps: packed or
/// planar. Both have the same names.
