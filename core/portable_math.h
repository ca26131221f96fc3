#pragma once

#include "core/strict_math.h"

/// The transcendental functions of the library, the same bits on every CPU and C library.
///
/// Those of a C library may differ in the last bit from machine to machine, and a pixel may depend on
/// that bit. These compute in double precision with basic operations only, whose results IEEE 754
/// defines to the bit, and round to float once: correctly, unless the true value lies within some 1e-16
/// of the midpoint of two floats. (Square root needs no such care: IEEE 754 defines it too.)
namespace VFontEffect::internal {

/// e to the power of x, for x in -80..0; 0 below.
float portableExp(float x);

struct Turn {
    float sine;
    float cosine;
    float tangent;
};

/// Sine, cosine and tangent of an angle in radians. Beyond 100,000 radians, and for infinities and
/// NaN, they are the C library's.
Turn portableTurn(float radians);

}  // namespace VFontEffect::internal
