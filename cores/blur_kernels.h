#pragma once

#include <cstdint>

/// The inner loops of the blur, compiled once per level of the instruction set: one pass down the
/// columns and one across the rows, and between them a plane in a form of the level's own.
namespace VFontEffect::internal {

/// Rows are blurred four at a time.
constexpr int64_t kQuad = 4;
/// No level's vector is wider; planes have a margin of as many pixels on both sides.
constexpr int64_t kWidestVector = 64;
/// Empty groups of four rows on both sides of a strip's.
constexpr int64_t kSpareGroups = 3;
/// Up to this radius, and a total that fits in a byte, sums fit in 16 bits.
constexpr int kLargestNarrowRadius = 3;

/// Division by a number of up to 255 as (x + start) * multiplier >> 16 >> shift, for 16-bit x.
struct NarrowDivision {
    uint16_t start;
    uint16_t multiplier;
    uint16_t shift;
};

/// A blur in the form in which a level's loops read it; without cells when memory ran out.
struct PreparedBlur {
    explicit operator bool() const { return cells != nullptr; }

    int radius;
    uint32_t total;
    float inverse;           // just above 1 / total
    const void* cells;       // the weights as the level wants them, from distance -radius on
    const uint32_t* totals;  // of the weights before each of them
    bool isNarrow;           // whether sums fit in 16 bits, and then:
    uint16_t weights[kLargestNarrowRadius + 1];
    NarrowDivision division;
};

/// What a pass makes of the mean of the taps: rounded down or up, and then byte ^ flip.
struct BlurEnding {
    bool roundsUp;
    uint8_t flip;
};

/// Rows between two passes, `columns` wide; what lies beyond counts as 0. The columns from `inkColumn`
/// on come from the source, the others are 0, or 255 before column `fullBefore` and from `fullFrom` on.
/// For every four rows and every vector of columns `inked` tells whether there is anything but 0.
struct MiddlePlane {
    uint8_t* start;  // of row 0, column 0
    int64_t strideBytes;
    int64_t columns;
    int64_t inkColumn;  // a multiple of kWidestVector
    int64_t fullBefore;
    int64_t fullFrom;
    uint8_t* inked;
    int64_t inkedStride;
};

/// `height` rows of `width` bytes, each taken as byte ^ flip. All around them is 0.
struct BlurSource {
    const uint8_t* start;
    int64_t stride;
    int64_t width;
    int64_t height;
    uint8_t flip;
};

/// Bytes of a pixel of the middle plane and of a strip, of a narrow blur; others have 1.
constexpr int64_t kNarrowMiddleBytes = 2;

/// The pass down makes 4 * quads rows from row `top` of the source on.
struct DownPass {
    const PreparedBlur* blur;
    BlurSource source;
    int64_t top;
    int64_t quads;
    uint8_t* strip;  // working memory: the groups of four rows in reach, 2 + 2 * kSpareGroups more,
                     // each of a vector's width, and 4 bytes for each of them
};

/// The pass across makes the columns `left` to `right` - 1 of four rows of the middle plane, and writes
/// whole vectors: up to kWidestVector - 1 bytes too many in each row.
struct AcrossPass {
    const PreparedBlur* blur;
    MiddlePlane middle;
    int64_t quad;
    int64_t left;
    int64_t right;
    BlurEnding ending;
    uint8_t* out;
    int64_t outStride;
};

/// Cells of zeros before and behind those of the weights.
constexpr int64_t kCellsBefore = 4;
constexpr int64_t kCellsBehind = 20;

struct BlurKernels {
    int64_t vectorBytes;
    /// Bytes of a weight's cell.
    int64_t cellBytes;
    /// Makes the cells of the weights at distances 0 to radius and of the zeros around them.
    void (*fillCells)(const uint32_t* weights, int radius, uint8_t* cells);
    /// From the source into the middle plane.
    void (*down)(const DownPass& pass, const MiddlePlane& middle);
    /// From the source, or back into it, as plain bytes; writes whole vectors like the pass across.
    void (*downToBytes)(const DownPass& pass, const BlurEnding& ending, uint8_t* out, int64_t outStride);
    /// The source's rows from `top` on as they are, into the four rows of the middle plane.
    void (*copyQuad)(const DownPass& pass, const MiddlePlane& middle);
    void (*across)(const AcrossPass& pass);
};

/// The kernels of the chosen level.
const BlurKernels& blurKernels();

}  // namespace VFontEffect::internal
