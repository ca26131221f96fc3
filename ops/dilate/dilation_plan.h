#pragma once

#include <cstdint>

#include "core/box.h"
#include "core/coverage_rows.h"
#include "core/windows.h"
#include "ops/dilate/dilation_loops.h"

namespace VFontEffect::internal {

/// What is dilated. The disc must outlive the plan.
struct DilationInput {
    CoverageRows source;
    const DiscShape& disc;
};

/// A dilation, planned once: the strategy, whose memory serves one window after the other. Memory is the
/// caller's, who may need several plans: one block of it costs less than several, which allocators give
/// back to the system, and take anew page by page.
class DilationPlan {
  public:
    /// All that the disc reaches from a source and the pixel around it, in the source's coordinates.
    static Box reached(const DilationInput& input) {
        return expanded(wholeOf(input.source), input.disc.reach + kDilationBorder);
    }

    /// What a plan for any of the windows takes, whatever is in it: a multiple of kArenaAlignment.
    static int64_t memoryBytes(CpuLevel level, const DilationInput& input, const Windows& windows);
    /// Likewise, as long as tiles do not give up. Squares of a large disc take more.
    static int64_t memoryBytesOfTiles(CpuLevel level, const DilationInput& input,
                                      const Windows& windows);

    /// So many bytes of memory, aligned to kArenaAlignment, must outlive the plan. Windows, in the
    /// source's coordinates, are of what is reached.
    DilationPlan(CpuLevel level, const DilationInput& input, uint8_t* memory, int64_t memoryBytes);

    /// Turns to a window, or a part of one. Returns false when tiles have given up, in this window or in
    /// an earlier one, and memory does not suffice for squares: from there on windows have to be such as
    /// memoryBytes() allows.
    [[nodiscard]] bool begin(const Box& window);

    /// From the next window on what tiles would do is done by squares, as if they had given up.
    void giveUpTiles();

    /// Rows that are asked for at once; the last ones of a window may be fewer.
    int64_t bandRows() const { return mDilation.bandRows; }

    /// `count` rows of the window's results from row y of the source on. Bands are asked for in order,
    /// from the window's top on. The rows stay until the next call.
    ///
    /// There are none, and their start is null, where tiles give up and memory does not suffice for
    /// squares.
    CoverageRows rows(int64_t y, int64_t count);

    /// Likewise, of each result the smaller one of this plan's and of another's for the same window.
    CoverageRows minRows(DilationPlan& other, int64_t y, int64_t count);

  private:
    uint8_t* nextRows(int64_t y, int64_t count);
    bool hasMemory() const { return mStrategy->memoryBytes(mDilation) <= mMemoryBytes; }
    CoverageRows asRows(const uint8_t* values, int64_t count) const;

    DilationInput mInput;
    const DilationLoops& mLoops;
    const DilationStrategy* mStrategy;
    uint8_t* mMemory;
    int64_t mMemoryBytes;
    Dilation mDilation = {};  ///< of the window
    int64_t mFirstRow = 0;    ///< of the source, its row 0
    int64_t mNextRow = 0;
};

}  // namespace VFontEffect::internal
