#pragma once

#include <cstdint>

#include "core/coverage_rows.h"
#include "core/line_buffer.h"
#include "core/pixel_buffer.h"
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
};

/// A growth, done at once, for a pass needs all of the one before. It is ready, or empty when memory ran
/// out.
class GrowthPlan {
  public:
    GrowthPlan(CpuLevel level, const GrowthInput& input);

    explicit operator bool() const { return mPlanes[0] || mPlanes[1]; }

    /// `count` rows from the source's row y on, first column -margin, to be taken as the source is: each
    /// byte ^ its invertMask.
    CoverageRows rows(int64_t y, int64_t count);

  private:
    uint8_t* rowOf(int plane, int64_t y);
    void copyIn(const GrowthInput& input);
    void setFrame(int other);
    void grow(int passes);

    const GrowthLoops& mLoops;
    int64_t mMargin;
    int64_t mWidth;
    int64_t mHeight;
    uint8_t mInvertMask;
    int64_t mStride;
    LineBuffer mPlanes[2];
    PixelBuffer<uint8_t> mTiles;
    int mCurrent = 0;
};

}  // namespace VFontEffect::internal
