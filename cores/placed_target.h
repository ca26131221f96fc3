#pragma once

#include <cstdint>

#include "blend/blend_loops.h"
#include "blend/job.h"
#include "core/box.h"
#include "core/views.h"
#include "cores/paint_input.h"

namespace VFontEffect::internal {

/// A colour destination in the coordinates of a picture that lies on it.
class PlacedTarget {
  public:
    /// The picture's origin lies at (left, top) of the destination.
    PlacedTarget(const VFBitmap* destination, int64_t left, int64_t top)
        : mPixels(ColourView::of(destination)), mLeft(left), mTop(top) {}

    /// The part of the picture that lies on the destination; empty for one that cannot be trusted.
    Box seen(const Box& part) const {
        return intersection(part, translated({0, 0, mPixels.width, mPixels.height}, -mLeft, -mTop));
    }

    /// A job on a part that is seen, with nothing to paint yet.
    BlendJob jobOn(const Box& part) const {
        return internal::jobOn(mPixels, translated(part, mLeft, mTop));
    }

    /// A job that paints through a mask of the part's size.
    BlendJob jobOn(const Box& part, const uint8_t* mask, int64_t stride) const {
        BlendJob job = jobOn(part);
        job.mask = mask;
        job.maskStride = stride;
        return job;
    }

    /// Paints one colour through a mask of the part's size beneath what is there.
    void paintBeneath(const Box& part, const uint8_t* mask, int64_t stride, uint32_t color) const {
        BlendJob job = jobOn(part, mask, stride);
        job.color = color;
        blendLoops().dstOverMask(job);
    }

  private:
    ColourView mPixels;
    int64_t mLeft;
    int64_t mTop;
};

/// The whole of a box, in its own coordinates.
inline Box wholeOf(const CoverageBox& box) {
    return {0, 0, box.width, box.height};
}

}  // namespace VFontEffect::internal
