#pragma once

#include <cstdint>

#include "blend/blend_loops.h"
#include "core/box.h"
#include "core/coverage_rows.h"
#include "core/views.h"

namespace VFontEffect::internal {

/// A colour destination in the coordinates of a picture that lies on it.
class PlacedTarget {
  public:
    /// The picture's origin lies at (left, top) of the destination.
    PlacedTarget(CpuLevel level, const VFBitmap* destination, int64_t left, int64_t top);

    /// The picture's row that lies on that row of the destination.
    int64_t ownRow(int64_t row) const { return row - mTop; }
    int64_t destinationRow(int64_t ownRow) const { return ownRow + mTop; }

    /// The part of the picture that lies on the destination; empty for one that cannot be trusted.
    Box seen(const Box& part) const;

    /// A job on a part that is seen, through a mask of the part's size.
    BlendJob jobOn(const Box& part, const uint8_t* mask, int64_t stride) const;

    /// Paints one colour through such a mask.
    void paint(BlendLoop BlendLoops::*rule, const Box& part, const uint8_t* mask, int64_t stride,
               uint32_t color) const;

    /// Paints one colour through coverage whose first pixel lies at (x, y) of the picture, where it is
    /// seen.
    void paintCoverage(BlendLoop BlendLoops::*rule, const CoverageRows& coverage, int64_t x, int64_t y,
                       uint32_t color) const;

  private:
    const BlendLoops& mLoops;
    ColourView mPixels;
    int64_t mLeft;
    int64_t mTop;
};

}  // namespace VFontEffect::internal
