#pragma once

#include <cstdint>

#include "core/line_buffer.h"
#include "core/pixel_buffer.h"
#include "ops/blur/dot_loops.h"

namespace VFontEffect::internal {

/// Coverage that grows: each pass makes a pixel a quarter of its 3 x 3 sum, at most 255. Around it is a
/// frame of one pixel, which counts in the sums and does not grow.
class Growth {
  public:
    Growth(int64_t width, int64_t height);

    /// Whether there is memory for it.
    explicit operator bool() const { return mPlanes[0] && mPlanes[1] && mTiles; }

    /// The coverage of row 0 to height - 1, between the frame's pixels at -1 and width; row -1 and row
    /// `height` are the frame's.
    uint8_t* row(int64_t y) { return rowOf(mCurrent, y); }

    /// From the second pass on the frame beside the rows is `beside`; above and below it stays.
    void grow(int passes, uint8_t beside);

    /// Gives back the memory that only growing takes.
    void finish();

    /// The coverage, each byte ^ invertMask.
    BlurSource source(uint8_t invertMask) { return {row(0), mStride, mWidth, mHeight, invertMask}; }

  private:
    uint8_t* rowOf(int plane, int64_t y);
    void frameOther(uint8_t beside);

    int64_t mWidth;
    int64_t mHeight;
    int64_t mStride;
    LineBuffer mPlanes[2];
    PixelBuffer<uint8_t> mTiles;
    int mCurrent = 0;
};

/// Grows the coverage of a whole picture in place; see VFOuterGlow::increaseByBoxFilter. When memory
/// runs out it stays as it was.
void growByBoxFilter(unsigned char* mask, int passes, int width, int height);

}  // namespace VFontEffect::internal
