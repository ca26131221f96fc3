#include <cstdint>

#include "blend/blend_loops.h"
#include "blend/blend_modes.h"
#include "blend/job.h"
#include "core/views.h"
#include "voreleffect/VFBlender.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// `skipBytes` is what each source column left of the destination is skipped by.
void blendColour(BlendLoop loop, int x, int y, const VFBitmap* dst, const unsigned char* source,
                 int width, int height, int64_t strideBytes, int skipBytes) {
    const ColourView target = ColourView::of(dst);
    if (!target || source == nullptr || strideBytes < 0) return;
    const Box clip = placement(x, y, width, height, target.width, target.height);
    if (clip.empty()) return;
    BlendJob job = jobOn(target, clip);
    job.image = source + (clip.top - y) * strideBytes + (clip.left - x) * skipBytes;
    job.imageStride = strideBytes;
    loop(job);
}

void blendWords(BlendLoop loop, int x, int y, const VFBitmap* dst, const unsigned int* source, int width,
                int height, int strideWords) {
    blendColour(loop, x, y, dst, reinterpret_cast<const unsigned char*>(source), width, height,
                static_cast<int64_t>(strideWords) * kColourBytes, kColourBytes);
}

/// Deliberate: a byte source skips one byte, not one pixel, per column left of the destination.
constexpr int kByteSourceSkip = 1;

constexpr int kOrderArgb = 0;
constexpr int kOrderRgba = 1;

}  // namespace

void VFBlender::drawBitmapBlend32(int x, int y, const VFBitmap* dst, unsigned int* src, int width,
                                  int height, int srcStride, int mode) {
    if (mode == kModeSrcOver) blendSrcOver32To32(x, y, dst, src, width, height, srcStride);
    if (mode == kModeDstOver) blendDstOver32To32(x, y, dst, src, width, height, srcStride);
}

void VFBlender::drawBitmapBlend32(int x, int y, const VFBitmap* dst, unsigned char* src, int width,
                                  int height, int srcStride, int order) {
    blendDstOver32To32(x, y, dst, src, width, height, srcStride, order);
}

void VFBlender::blendSrcOver32To32(int x, int y, const VFBitmap* dst, unsigned int* src, int width,
                                   int height, int srcStride) {
    blendWords(blendLoops(chosenLevel()).srcOverWords, x, y, dst, src, width, height, srcStride);
}

void VFBlender::blendDstOver32To32(int x, int y, const VFBitmap* dst, unsigned int* src, int width,
                                   int height, int srcStride) {
    blendWords(blendLoops(chosenLevel()).dstOverWords, x, y, dst, src, width, height, srcStride);
}

void VFBlender::blendDstOver32To32(int x, int y, const VFBitmap* dst, unsigned char* src, int width,
                                   int height, int srcStride, int order) {
    if (order == kOrderArgb) {
        blendColour(blendLoops(chosenLevel()).dstOverArgb, x, y, dst, src, width, height, srcStride,
                    kByteSourceSkip);
    } else if (order == kOrderRgba) {
        blendColour(blendLoops(chosenLevel()).dstOverRgba, x, y, dst, src, width, height, srcStride,
                    kByteSourceSkip);
    }
}

}  // namespace VFontEffect
