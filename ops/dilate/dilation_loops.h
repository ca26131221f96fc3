#pragma once

#include <cstddef>
#include <cstdint>

#include "core/inline.h"
#include "core/numeric.h"
#include "ops/dilate/disc_shape.h"

/// The inner loops of the stroke, compiled once per level of the instruction set.
namespace VFontEffect::internal {

/// What grows: the coverage, or its inverse, each byte ^ this.
constexpr uint8_t kCoverage = 0;
constexpr uint8_t kInverse = 0xFF;

/// Grey-scale dilation of a box of coverage by a disc. The source is the box with a border of one empty
/// pixel; all coordinates are the source's, the border's corner being (0, 0).
///
/// The result at p is the largest c - (255 - weight) over all source pixels of coverage c, with the
/// weight that the disc around p has there; 0 where nothing is above 0.
struct Dilation {
    const uint8_t* box;  ///< the source without its border
    int64_t boxStride;
    int64_t width;       ///< of the source, border included
    int64_t height;      ///< likewise
    uint8_t invertMask;  ///< kCoverage; kInverse, of which the border then is full
    const DiscShape* disc;
    int64_t left;  ///< the columns that are wanted, the source's own among them
    int64_t right;
    int64_t top;       ///< the first row of results that is asked for
    int64_t bandRows;  ///< rows that are asked for at once; the last ones may be fewer
    uint8_t* memory;   ///< as many bytes as the kernel says, from a line of the cache on, of any values
    uint8_t largest;   ///< for the kernels
};

/// Rows of results are so far apart.
VOREL_INLINE int64_t dilatedStride(const Dilation& dilation) {
    return roundedUp(dilation.right - dilation.left, 64);
}

/// One disc of any weights stamped around each pixel of some source rows, as VFStroke::DilationWork
/// tells.
struct Stamping {
    const uint8_t* source;
    int64_t sourceWidth;
    int64_t firstRow;
    int64_t endRow;
    uint8_t invertMask;  ///< kCoverage or kInverse
    const uint8_t* weights;
    int64_t side;
    uint8_t* plane;
    int64_t planeWidth;
};

struct DilationLoops {
    int64_t (*memoryBytes)(const Dilation& dilation);
    /// Prepares the memory.
    void (*begin)(Dilation& dilation);
    /// `count` rows of results from row y on, first column `left`: from row `top` on a band after the
    /// other, all of bandRows rows but the last. They may be changed, and stay until the next call.
    uint8_t* (*dilateRows)(const Dilation& dilation, int64_t y, int64_t count);
    /// first = min(first, second), whole rows of results
    void (*keepSmaller)(uint8_t* first, const uint8_t* second, int64_t count);
    void (*stamp)(const Stamping& stamping);
};

/// The kernels of the chosen level.
const DilationLoops& dilationLoops();

}  // namespace VFontEffect::internal
