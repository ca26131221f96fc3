#pragma once

#include "blend/blend_loops.h"
#include "core/box.h"
#include "core/views.h"

namespace VFontEffect::internal {

/// A job on the clipped part of a colour destination, with nothing to paint there yet.
inline BlendJob jobOn(const ColourView& target, const Box& clip) {
    BlendJob job = {};
    job.destination = target.at(clip.left, clip.top);
    job.destinationStride = target.width * kColourBytes;
    job.width = clip.width();
    job.height = clip.height();
    return job;
}

/// Row y of a job's mask and destination.
inline BlendJob rowOf(const BlendJob& job, int64_t y) {
    BlendJob row = job;
    row.destination += y * job.destinationStride;
    row.mask += y * job.maskStride;
    row.height = 1;
    return row;
}

}  // namespace VFontEffect::internal
