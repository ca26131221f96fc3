#pragma once

/// The transcendental functions of the library, the same bits on every CPU and C library.
///
/// Those of a C library may differ in the last bit from machine to machine, and a pixel may hang on
/// that bit. These compute in double precision with basic operations only, which IEEE 754 fixes, and
/// round once: the result is the float nearest to the true value, but for arguments whose value lies
/// within some 1e-16 of the middle between two floats. (Square root and floor need no such care: they
/// are exact everywhere.)
namespace VFontEffect::internal {

/// e to the power of x, for x in -80..0; 0 below.
float portableExp(float x);

/// Sine, cosine and tangent of an angle in radians. Beyond 100,000 radians, and for infinities and
/// NaN, the C library answers.
float portableSin(float radians);
float portableCos(float radians);
float portableTan(float radians);

}  // namespace VFontEffect::internal
