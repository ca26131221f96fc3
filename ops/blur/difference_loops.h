#pragma once

#include <cstdint>

#include "core/coverage_rows.h"
#include "ops/blur/dot_loops.h"

/// The inner loop of a wide blur, compiled once per level of the instruction set: one pass down a strip
/// of columns, whose results are stored transposed, so that the pass across is the same loop.
namespace VFontEffect::internal {

/// Results of four neighbouring rows are summed together.
constexpr int64_t kDifferenceRows = 4;

/// Every line of taps is followed by one of pairs: of each pixel and the one `distance` rows on their
/// sum, or their difference.
struct TapPairs {
    int distance;
    bool areDifferences;
};

/// Lines by their distances from a result's row, in bytes, in the order of their rows.
struct TermList {
    const int32_t* offsets;
    int64_t count;
};

/// The second difference of the weights: the lines that add up to it.
struct DifferenceTerms {
    TapPairs pairs;
    TermList added;
    TermList takenAway;
};

struct DifferencePass {
    const DifferenceTerms& terms;
    int radius;
    uint32_t total;
    float inverse;  // just above 1 / total
    PassEnding ending;
};

/// No pair is wider.
constexpr int64_t kLargestPairDistance = 2;
/// The working memory of a strip: for each row of the source, and for so many more, a line of taps and
/// one of pairs, each of a vector's pixels in 16 bits.
constexpr int64_t kLinesOfRow = 2;
constexpr int64_t kLinePixelBytes = 2;
constexpr int64_t kDifferenceRowsAround = kLargestPairDistance + 2 * (kDifferenceRows - 1);

/// Results in squares of vectorBytes a side, transposed ones with a row for each column of results.
struct SquareRows {
    uint8_t* start;
    int64_t squareStride;  // from one square of the strip to the next
    int64_t rowStride;     // from one row of a square to the next
    bool areTransposed;
};

struct DifferenceLoops {
    int64_t vectorBytes;
    /// The source's rows from `row` on, as many as a vector has bytes, transposed: a line for each
    /// column. Lines are written up to a whole number of squares.
    void (*transpose)(const CoverageRows& source, int64_t row, uint8_t* lines);
    /// Sums the strip of the source that begins at column x, as wide as a vector: `count` results from
    /// row `first` on, in whole squares. `lines` is the working memory, aligned to a vector.
    void (*blurStrip)(const DifferencePass& pass, const CoverageRows& source, int64_t x, uint8_t* lines,
                      int64_t first, int64_t count, const SquareRows& out);
};

/// The loops of a level.
const DifferenceLoops& differenceLoops(CpuLevel level);

}  // namespace VFontEffect::internal
