#pragma once

#include <climits>

#include "simd/lanes.h"

/// Numbers that depend on the level: which method suits what, and how much is done at a time. None of
/// them changes a byte. How each was measured stands beside it; docs/benchmarks.md has the figures.
namespace VFontEffect::internal::VOREL_LEVEL {

// Vectors of taps that the blur's dot products take at a time, each for four results: of 32 registers
// half are sums.
#if defined(VOREL_MASK_REGISTERS) || defined(VOREL_PLANAR_PIXELS)
constexpr int kGridVectors = 4;
#else
constexpr int kGridVectors = 2;
#endif

// Steps of four taps between two looks at the loop's end. An indexed dot product picks its four weights
// from a register that holds four times as many.
#if defined(VOREL_DOT_PRODUCTS) && defined(VOREL_PLANAR_PIXELS)
constexpr int kStepsAtOnce = 4;
#else
constexpr int kStepsAtOnce = 1;
#endif

// Up to this radius dot products take less time than differences of the weights, which cost about the
// same whatever the radius.
#if defined(VOREL_DOT_PRODUCTS) && defined(VOREL_PLANAR_PIXELS)
constexpr int kLargestDotRadius = INT_MAX;
#elif defined(VOREL_DOT_PRODUCTS)
constexpr int kLargestDotRadius = 72;
#elif defined(__AVX2__)
constexpr int kLargestDotRadius = 20;
#else
constexpr int kLargestDotRadius = 15;
#endif

// Up to this reach of the disc a dilation by spreading takes less time than one by tiles, whose vectors
// are short: measured at 16 and 64 bytes.
constexpr int64_t kLongestSpreadReach = 8 + kBytes / 8;

}  // namespace VFontEffect::internal::VOREL_LEVEL
