#include <cstdint>

#include "blend/rows.h"
#include "core/blend_modes.h"
#include "core/views.h"
#include "voreleffect/VFBlender.h"

namespace VFontEffect {

using namespace internal;

namespace {

template <class Rule>
struct MaskBlendRow {
    unsigned char* destination;
    const unsigned char* mask;
    uint32_t color;

    template <class L>
    void paint(int64_t i) const {
        unsigned char* const pixel = destination + i * kColourBytes;
        storePixel(pixel,
                   Rule::apply(loadPixel<L>(pixel), loadBytes<L>(mask + i), spreadColour<L>(color)));
    }
};

template <class Rule>
void blendMask(int x, int y, const VFBitmap* dst, const unsigned char* mask, int width, int height,
               int maskStride, uint32_t color) {
    const ColourView target = ColourView::of(dst);
    if (!target || mask == nullptr || maskStride < 0) return;
    const Clip clip = clipPlacement(x, y, width, height, target.width, target.height);
    paintRows(clip, [&](int64_t row) {
        return MaskBlendRow<Rule>{target.at(clip.left, row),
                                  mask + (row - y) * maskStride + (clip.left - x), color};
    });
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
    blendMask<SrcOverMask>(x, y, dst, mask, width, height, maskStride, color);
}

void VFBlender::blendDstOver8To32(int x, int y, const VFBitmap* dst, unsigned char* mask, int width,
                                  int height, int maskStride, unsigned int color) {
    blendMask<DstOverMask>(x, y, dst, mask, width, height, maskStride, color);
}

void VFBlender::blendDstOver8To32NSA(int x, int y, const VFBitmap* dst, unsigned char* mask, int width,
                                     int height, int maskStride, unsigned int color) {
    blendMask<DstOverGate>(x, y, dst, mask, width, height, maskStride, color);
}

void VFBlender::blendDstOverSA8To32(int x, int y, const VFBitmap* dst, unsigned char* mask, int width,
                                    int height, int maskStride, unsigned int color) {
    blendMask<DstOverClip>(x, y, dst, mask, width, height, maskStride, color);
}

}  // namespace VFontEffect
