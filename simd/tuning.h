#pragma once

#include <climits>

#include "simd/lanes.h"

/// Numbers that depend on the level: which method suits what, and how much is done at a time. None of
/// them changes a byte. Where a row of the benchmarks is named, `scripts/bench.sh --filter ROW` measures
/// it: change the number, and compare. Figures are times of one choice as multiples of the other's, on
/// an EPYC with AVX-512 VNNI; those of NEON are instructions a result and 16 taps, by
/// bench/arm64_loops.py.
namespace VFontEffect::internal::VOREL_LEVEL {

// Vectors of taps that the blur's dot products take at a time, each for four results: of 32 registers
// half are sums. Two take 1.06 to 1.09 times as long as four at AVX-512
// (shadow/outer/.*/R:(8|16|32|64)/best), and on NEON 1.38 instructions for 1.27 down, 1.59 for 1.48
// across.
#if defined(VOREL_MASK_REGISTERS) || defined(VOREL_PLANAR_PIXELS)
constexpr int kGridVectors = 4;
#else
constexpr int kGridVectors = 2;
#endif

// Steps of four taps between two looks at the loop's end. An indexed dot product picks its four weights
// from a register that holds four times as many: 1.27 instructions down for 1.62, 1.48 across for 1.88.
#if defined(VOREL_DOT_PRODUCTS) && defined(VOREL_PLANAR_PIXELS)
constexpr int kStepsAtOnce = 4;
#else
constexpr int kStepsAtOnce = 1;
#endif

// Up to this radius dot products take less time than differences of the weights, which cost about the
// same whatever the radius (shadow/outer/.*/R:). Dot products by differences: at AVX-512 0.7 to 0.9 at a
// radius of 64, at 100 still 0.9 on lines but 1.4 on a glyph, narrower than the vectors; on NEON with
// instructions for them 6.3 cycles for 8.4 at 100; at AVX2 0.95 to 1.01 at 20 and 1.2 to 2 at 24; at 16
// bytes 0.92 to 1.11 at 16 and 1.5 to 1.8 at 32.
#if defined(VOREL_DOT_PRODUCTS) && defined(VOREL_PLANAR_PIXELS)
constexpr int kLargestDotRadius = INT_MAX;
#elif defined(VOREL_DOT_PRODUCTS)
constexpr int kLargestDotRadius = 72;
#elif defined(__AVX2__)
constexpr int kLargestDotRadius = 20;
#else
constexpr int kLargestDotRadius = 15;
#endif

// Whether a blur whose sums fit in 16 bits takes less time by them than by dot products, which at
// AVX-512 take 1.3 to 1.6 times as long (shadow/outer/.*/R:[12]/best).
#if defined(VOREL_DOT_PRODUCTS) && defined(VOREL_PLANAR_PIXELS)
constexpr bool kLeavesNarrow = false;
#else
constexpr bool kLeavesNarrow = true;
#endif

// Up to this reach of the disc a dilation by spreading takes less time than one by tiles, whose vectors
// are short (stroke/outside/). Tiles by spreading: at 64 bytes 1.6 to 4.0 at 16 and 0.7 to 1.8 at 32, at
// 16 bytes 1.8 to 3.8 at 8 and 0.7 to 1.6 at 16.
constexpr int64_t kLongestSpreadReach = 8 + kBytes / 8;

}  // namespace VFontEffect::internal::VOREL_LEVEL
