#pragma once

/// Included by everything that names a float: no build of it may reorder or approximate.
#if defined(__FAST_MATH__) || (defined(__FINITE_MATH_ONLY__) && __FINITE_MATH_ONLY__ != 0)
#error "voreleffect paints the same bytes everywhere: not with -Ofast, -ffast-math and their like"
#endif
