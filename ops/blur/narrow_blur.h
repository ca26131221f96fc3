#pragma once

#include <cstdint>

#include "core/arena.h"
#include "core/line_buffer.h"
#include "ops/blur/blur_input.h"
#include "ops/blur/narrow_loops.h"

namespace VFontEffect::internal {

/// A blur whose sums fit in 16 bits, four rows at a time. Where the pass down is the first it reads the
/// source itself; what is to be inverted or is narrower than a vector goes through a copy of the last
/// few rows, as do the results of a pass across that is the first.
class NarrowBlur {
  public:
    static bool suits(const BlurWeights& weights);

    /// What a blur takes for an input.
    static int64_t memoryBytes(const NarrowLoops& loops, const BlurInput& input);

    /// For inputs that take no more than this one, which is `memoryBytes`.
    NarrowBlur(const NarrowLoops& loops, const BlurInput& largest, int64_t memoryBytes);

    /// Whether there is memory for it.
    explicit operator bool() const { return static_cast<bool>(mMemory); }

    void begin(const BlurInput& input);

    /// Rows that are asked for at once.
    int64_t bandRows() const { return kQuad; }

    /// A band of rows from row y on, in order.
    BlurredRows rows(int64_t y);

  private:
    /// A window, and its places in the working memory.
    struct Layout {
        Box window;
        ReachedSource source;
        bool isAcrossFirst;
        int64_t firstRow;  // of the source, with the uppermost taps of the first results
        int64_t stride;    // of results
        PlacedIntermediate intermediate;
        bool keepsRows;
        IntermediateRows kept;  // quads for the pass down take turns; if none is kept, a row of zeros
        uint8_t* out;

        static Layout of(const NarrowLoops& loops, const BlurInput& input, Arena& arena);
    };

    uint8_t* keptRow(int64_t tapRow) const;
    void keep(int64_t quad);
    TapRows tapsOf(int64_t quad) const;
    void blurDown(int64_t quad);
    void blurAcross(const PassEnding& ending, uint8_t* out, int64_t stride);

    const NarrowLoops& mLoops;
    const NarrowPasses& mPasses;
    int mRadius;
    NarrowWeights mWeights;
    PassEnding mFirst;
    PassEnding mSecond;
    int64_t mMemoryBytes;
    LineBuffer mMemory;
    Layout mLayout = {};
    int64_t mKeptQuads = 0;
};

}  // namespace VFontEffect::internal
