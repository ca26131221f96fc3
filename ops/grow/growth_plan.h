#pragma once

#include <cstdint>

#include "core/arena.h"
#include "core/box.h"
#include "core/coverage_rows.h"
#include "core/line_buffer.h"
#include "ops/grow/growth_loops.h"

namespace VFontEffect::internal {

/// What grows: each pass makes a pixel a quarter of its 3 x 3 sum, at most 255. Around what grows is a
/// frame of one pixel, which counts in the sums and stays.
struct GrowthInput {
    CoverageRows source;
    /// So many pixels around the source grow too, at first 0 ^ invertMask as the frame around them; with
    /// -1 the source's own edge is the frame.
    int64_t margin;
    int passes;

    /// All that grows, in the source's coordinates.
    Box whole() const { return expanded(wholeOf(source), margin); }
};

/// A growth, done at once for a part of it, as a pass needs all of the one before; its memory serves one
/// part after the other. It is ready, or empty when memory ran out.
///
/// A pass looks a pixel farther, so a part needs as many pixels around it as there are passes. The last
/// of them is the frame, which is right for the first pass; where growth goes on there, each later pass
/// brings what is wrong a pixel nearer.
class GrowthPlan {
  public:
    /// What a plan takes for parts of that size.
    static int64_t memoryBytes(const GrowthInput& input, int64_t width, int64_t height);

    /// For parts up to that size.
    GrowthPlan(CpuLevel level, const GrowthInput& input, int64_t width, int64_t height);

    explicit operator bool() const { return static_cast<bool>(mMemory); }

    /// The part of what grows, grown. First pixel that of the part, to be taken as the source is: each
    /// byte ^ its invertMask. It stays until the next call.
    CoverageRows grown(const Box& part);

  private:
    /// What is worked on, and its places in the working memory.
    struct Layout {
        int64_t width;
        int64_t height;
        int64_t stride;
        uint8_t* planes[2];
        uint8_t* tiles;

        static Layout of(int64_t width, int64_t height, Arena& arena);
        /// Row 0 to height - 1 of what grows, between the frame's pixels at -1 and width; row -1 and row
        /// `height` are the frame's.
        uint8_t* row(int plane, int64_t y) const;
    };

    void copyIn(const Box& worked);
    void setFrame();
    void grow(int passes);

    const GrowthLoops& mLoops;
    GrowthInput mInput;
    int64_t mMemoryBytes;
    LineBuffer mMemory;
    Layout mLayout = {};
    int mCurrent = 0;  ///< the plane of the last pass
};

}  // namespace VFontEffect::internal
