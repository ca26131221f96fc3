#include "cores/placed_target.h"

#include "blend/job.h"
#include "core/assert.h"

namespace VFontEffect::internal {

PlacedTarget::PlacedTarget(CpuLevel level, const VFBitmap* destination, int64_t left, int64_t top)
    : mLoops(blendLoops(level)), mPixels(ColourView::of(destination)), mLeft(left), mTop(top) {}

Box PlacedTarget::seen(const Box& part) const {
    return intersection(part, translated({0, 0, mPixels.width, mPixels.height}, -mLeft, -mTop));
}

BlendJob PlacedTarget::jobOn(const Box& part, const uint8_t* mask, int64_t stride) const {
    VOREL_ASSERT(!part.empty() && seen(part) == part);
    BlendJob job = internal::jobOn(mPixels, translated(part, mLeft, mTop));
    job.mask = mask;
    job.maskStride = stride;
    return job;
}

void PlacedTarget::paint(BlendLoop BlendLoops::*rule, const Box& part, const uint8_t* mask,
                         int64_t stride, uint32_t color) const {
    BlendJob job = jobOn(part, mask, stride);
    job.color = color;
    (mLoops.*rule)(job);
}

void PlacedTarget::paintCoverage(BlendLoop BlendLoops::*rule, const CoverageRows& coverage, int64_t x,
                                 int64_t y, uint32_t color) const {
    const Box part = seen(translated(wholeOf(coverage), x, y));
    if (part.empty()) return;
    const uint8_t* const mask = coverage.start + (part.top - y) * coverage.stride + (part.left - x);
    paint(rule, part, mask, coverage.stride, color);
}

}  // namespace VFontEffect::internal
