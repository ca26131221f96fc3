#pragma once

#include <cstdint>

#include "core/box.h"
#include "core/coverage_rows.h"
#include "core/line_buffer.h"
#include "ops/dilate/dilation_loops.h"

namespace VFontEffect::internal {

/// A dilation, planned once: the strategy, its layout and its memory. It is ready, or empty when memory
/// ran out.
class DilationPlan {
  public:
    /// All that the disc reaches from a source and the pixel around it, in the source's coordinates.
    static Box reached(const CoverageRows& source, const DiscShape& disc) {
        return expanded(wholeOf(source), disc.reach + kDilationBorder);
    }

    /// `part` is what is wanted, in the source's coordinates; not empty. The disc must outlive the plan.
    DilationPlan(CpuLevel level, const CoverageRows& source, const DiscShape& disc, const Box& part);

    explicit operator bool() const { return static_cast<bool>(mMemory); }

    /// The first column of the results: that of the part, or one before it.
    int64_t left() const { return mInput.left - kDilationBorder; }

    /// Rows that are asked for at once; the last ones may be fewer.
    int64_t bandRows() const { return mInput.bandRows; }

    /// `count` rows of results from row y of the source on. Bands are asked for in order, from the
    /// part's top on. The rows stay until the next call.
    CoverageRows rows(int64_t y, int64_t count);

    /// Likewise, of each result the smaller one of this plan's and of another's for the same part.
    CoverageRows minRows(DilationPlan& other, int64_t y, int64_t count);

  private:
    uint8_t* nextRows(int64_t y, int64_t count);
    CoverageRows asRows(const uint8_t* values, int64_t count) const;

    Dilation mInput;
    const DilationLoops& mLoops;
    const DilationStrategy& mStrategy;
    LineBuffer mMemory;
    int64_t mNextRow;
};

}  // namespace VFontEffect::internal
