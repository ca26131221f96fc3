#pragma once

#include "simd/vectors.h"

#if defined(VOREL_SCALAR)
#include "simd/lanes_scalar.h"
#elif defined(__AVX512F__)
#include "simd/lanes_avx512.h"
#elif defined(__AVX2__)
#include "simd/lanes_avx2.h"
#elif defined(__x86_64__)
#include "simd/lanes_sse2.h"
#elif defined(__aarch64__)
#include "simd/lanes_neon.h"
#elif defined(__wasm_simd128__)
#include "simd/lanes_simd128.h"
#else
#error "there is no such level on this machine"
#endif

#include "simd/lanes_default.h"

// clang-format off
/// Lanes: what a level of the instruction set must provide beside its width, VOREL_VECTOR_BYTES, and
/// what vectors.h has for all. A level is one file, lanes_<level>.h, or shares one as NEON with dot
/// products does; what stands in brackets it may leave to lanes_default.h. All levels give the same
/// bytes: the scalar one is what the tests compare with.
///
/// | operation                     | result                                                               |
/// | ----------------------------- | -------------------------------------------------------------------- |
/// | addSaturated, subSaturated    | bytes: a + b, at most 255; a - b, at least 0                         |
/// | multiplyHigh                  | the upper 16 bits of products of 16-bit lanes                        |
/// | [multiplyHighSum]             | the upper 16 bits of a * x + b * y of 16-bit lanes, below 2^32       |
/// | allZero                       | whether no lane holds anything but 0                                 |
/// | nonZeroLanes, kLaneBits       | kLaneBits ones for each byte but 0, the first one's lowest           |
/// | toInt                         | as core/numeric.h converts: toward zero, saturating, NaN to 0        |
/// | [toIntUpTo<most>]             | as toInt, at least 0, at most `most`                                 |
/// | squareRoot                    | correctly rounded                                                    |
/// | [timesFactor, kNumberBias]    | numbers below 2^23, stored with the bias added, as floats, times a   |
/// |                               | factor, rounded once                                                 |
/// | [loadFirst]                   | 1 to kBytes bytes of memory, zeros after them                        |
/// | [largerOf]                    | of two vectors of bytes, whose two offsets stand side by side        |
/// | [gather]                      | the words of a table at kU32Lanes indices, in a vector or in bytes   |
/// | [gatherNear]                  | the same from a table of `size` words, 32 at least, by indices that  |
/// |                               | mostly lie close together: looked up in registers then               |
/// | widenLow, widenHigh           | the first, the second half of the bytes, each byte in 16 bits        |
/// | narrow                        | 16-bit lanes of at most 255 as bytes: the first vector's, the second's |
/// | interleaveLow, interleaveHigh | the lanes of two vectors in turn, from their lower, their upper ends; |
/// |                               | AVX does so in each 128 bits by itself                               |
/// | pack                          | lanes of at most 255 in half the width, as before interleaving       |
/// | [upperBytes]                  | the upper bytes of 16-bit lanes: the first vector's, the second's    |
/// | [upperBytesInTurn]            | the upper bytes of the 16-bit lanes of two vectors, in turn          |
/// | [inBothHalves]                | words below 2^16, in both of their 16-bit lanes                      |
/// | [joinedBytes]                 | words of at most 255 from four vectors, as the bytes of words        |
/// | pairSums                      | of each two neighbouring bytes                                       |
/// | [pairProducts]                | of bytes of 0 to 255 and -128 to 127, each two neighbouring ones     |
/// |                               | added, if that fits in 16 signed bits; VOREL_PAIR_PRODUCTS is said   |
/// |                               | where there is one                                                   |
/// | quarters                      | a quarter of each 16-bit lane, at most 255, from two vectors in turn |
///
/// Dot products of taps, four to a word:
///
/// | operation                     | result                                                               |
/// | ----------------------------- | -------------------------------------------------------------------- |
/// | [Taps, tapsOf]                | four taps in each word, made of bytes                                |
/// | [WeightCell, cellOf]          | what stands for a weight: made of the plain weights (at most 128)    |
/// |                               | from that one on                                                     |
/// | [Weights, weightsAt]          | the string of cells that begins there                                |
/// | addDots<i>(sums, taps, w)     | adds to each word its four taps times the i-th four weights (0..3)   |
/// | kTapBias                      | taps are stored as tap ^ kTapBias: a sum is then too small by the    |
/// |                               | bias times the total of the weights                                  |
/// | [VOREL_DOT_PRODUCTS]          | said where addDots is one instruction                                |
///
/// and pixels, in one of two forms: pixels_packed.h (which asks for loadInPairs, highBytesInPairs and
/// swapRedBlue; pairs are moved up by kAmountShift: 8 where multiplyHigh is one instruction, otherwise 0)
/// or pixels_planar.h.
// clang-format on
