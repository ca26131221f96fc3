#include <cstdint>

#include "blend/blend_loops.h"
#include "blend/job.h"
#include "core/numeric.h"
#include "core/views.h"
#include "voreleffect/VFBlender.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// A job that copies the clipped part of a packed mask placed at (x, y).
BlendJob copyJob(const unsigned char* mask, int maskWidth, int x, int y, const Box& clip) {
    BlendJob job = {};
    const int64_t skipped = (clip.top - y) * int64_t{maskWidth} + (clip.left - x);
    job.mask = mask + skipped;
    job.maskStride = maskWidth;
    job.width = clip.width();
    job.height = clip.height();
    return job;
}

}  // namespace

VFBlender::VFBlender() = default;
VFBlender::~VFBlender() = default;

void VFBlender::drawBitmap(int x, int y, const VFBitmap* dst, VFBitmap* src, unsigned int color) {
    const MaskView mask = MaskView::ofBytes(src);
    if (!mask) return;
    drawBitmap(x, y, dst, mask.data, saturateToInt(mask.width), saturateToInt(mask.height), color);
}

void VFBlender::drawBitmap(int x, int y, const VFBitmap* dst, unsigned char* mask, int maskWidth,
                           int maskHeight, unsigned int color) {
    if (dst == nullptr) return;
    if (dst->mBytesPerPixel == kColourBytes) {
        drawBitmap8To32(x, y, dst, mask, maskWidth, maskHeight, color);
    } else {
        drawBitmap8To8(x, y, dst, mask, maskWidth, maskHeight);
    }
}

void VFBlender::drawBitmap8To8(int x, int y, const VFBitmap* dst, unsigned char* mask, int maskWidth,
                               int maskHeight) {
    const MaskView target = MaskView::ofBytes(dst);
    if (!target || mask == nullptr) return;
    const Box clip = placement(x, y, maskWidth, maskHeight, target.width, target.height);
    if (clip.empty()) return;
    BlendJob job = copyJob(mask, maskWidth, x, y, clip);
    job.destination = target.at(clip.left, clip.top);
    job.destinationStride = target.width;
    blendLoops(chosenLevel()).maxCoverage(job);
}

void VFBlender::drawBitmap8To32(int x, int y, const VFBitmap* dst, unsigned char* mask, int maskWidth,
                                int maskHeight, unsigned int color) {
    const ColourView target = ColourView::of(dst);
    if (!target || mask == nullptr) return;
    const Box clip = placement(x, y, maskWidth, maskHeight, target.width, target.height);
    if (clip.empty()) return;
    BlendJob job = copyJob(mask, maskWidth, x, y, clip);
    // Deliberate: the run starts at a pixel count taken as bytes, so it lies in the first quarter of the
    // image and rows overlap; its 4-byte steps end at most at width * (height + 3) bytes.
    job.destination = target.data + target.width * clip.top + clip.left;
    job.destinationStride = target.width;
    job.color = color;
    blendLoops(chosenLevel()).solidColour(job);
}

}  // namespace VFontEffect
