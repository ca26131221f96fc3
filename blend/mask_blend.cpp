#include <cstdint>

#include "blend/blend_loops.h"
#include "blend/blend_modes.h"
#include "blend/job.h"
#include "core/views.h"
#include "voreleffect/VFBlender.h"

namespace VFontEffect {

using namespace internal;

namespace {

void blendMask(BlendLoop loop, int x, int y, const VFBitmap* dst, const unsigned char* mask, int width,
               int height, int maskStride, uint32_t color) {
    const ColourView target = ColourView::of(dst);
    if (!target || mask == nullptr || maskStride < 0) return;
    const Box clip = placement(x, y, width, height, target.width, target.height);
    if (clip.empty()) return;
    BlendJob job = jobOn(target, clip);
    job.mask = mask + (clip.top - y) * maskStride + (clip.left - x);
    job.maskStride = maskStride;
    job.color = color;
    loop(job);
}

}  // namespace

void VFBlender::drawBitmapBlend8(int x, int y, const VFBitmap* dst, unsigned char* mask, int width,
                                 int height, int maskStride, unsigned int color, int mode) {
    switch (mode) {
        case kModeSrcOver:
            return blendSrcOver8To32(x, y, dst, mask, width, height, maskStride, color);
        case kModeDstOver:
            return blendDstOver8To32(x, y, dst, mask, width, height, maskStride, color);
        case kModeDstOverGate:
            return blendDstOver8To32NSA(x, y, dst, mask, width, height, maskStride, color);
        case kModeDstOverClip:
            return blendDstOverSA8To32(x, y, dst, mask, width, height, maskStride, color);
        default:
            return;
    }
}

void VFBlender::blendSrcOver8To32(int x, int y, const VFBitmap* dst, unsigned char* mask, int width,
                                  int height, int maskStride, unsigned int color) {
    blendMask(blendLoops(chosenLevel()).srcOverMask, x, y, dst, mask, width, height, maskStride, color);
}

void VFBlender::blendDstOver8To32(int x, int y, const VFBitmap* dst, unsigned char* mask, int width,
                                  int height, int maskStride, unsigned int color) {
    blendMask(blendLoops(chosenLevel()).dstOverMask, x, y, dst, mask, width, height, maskStride, color);
}

void VFBlender::blendDstOver8To32NSA(int x, int y, const VFBitmap* dst, unsigned char* mask, int width,
                                     int height, int maskStride, unsigned int color) {
    blendMask(blendLoops(chosenLevel()).dstOverGate, x, y, dst, mask, width, height, maskStride, color);
}

void VFBlender::blendDstOverSA8To32(int x, int y, const VFBitmap* dst, unsigned char* mask, int width,
                                    int height, int maskStride, unsigned int color) {
    blendMask(blendLoops(chosenLevel()).dstOverClip, x, y, dst, mask, width, height, maskStride, color);
}

}  // namespace VFontEffect
