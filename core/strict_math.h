#pragma once

/// Included by everything that names a float: no build of it may reorder or approximate. g++ tells of
/// each option that -ffast-math stands for by saying that its arithmetic is not that of IEC 559.
#if defined(__FAST_MATH__) || (defined(__FINITE_MATH_ONLY__) && __FINITE_MATH_ONLY__ != 0) || \
    (defined(__GCC_IEC_559) && __GCC_IEC_559 == 0)
#error "voreleffect paints the same bytes everywhere: not with -Ofast, -ffast-math and their like"
#endif
