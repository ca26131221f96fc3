#pragma once

#include "blend/blend_loops.h"
#include "core/box.h"
#include "core/views.h"

namespace VFontEffect::internal {

/// The part of a picture placed at (x, y) that falls on the target, in the target's coordinates.
inline Box placement(int x, int y, int64_t width, int64_t height, int64_t targetWidth,
                     int64_t targetHeight) {
    return intersection({x, y, x + width, y + height}, {0, 0, targetWidth, targetHeight});
}

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
