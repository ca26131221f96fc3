#include <cstdint>

#include "blend/rows.h"
#include "core/blend_modes.h"
#include "core/views.h"
#include "voreleffect/VFBlender.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// How four source bytes stand in memory. A little-endian word 0xAARRGGBB is B, G, R, A.
struct WordSource {
    template <class L>
    static Pixel<L> load(const unsigned char* from) {
        const Quad<L> q = loadQuad<L>(from);
        return {q.byte2, q.byte1, q.byte0, q.byte3};
    }
};

struct ArgbSource {
    template <class L>
    static Pixel<L> load(const unsigned char* from) {
        const Quad<L> q = loadQuad<L>(from);
        return {q.byte1, q.byte2, q.byte3, q.byte0};
    }
};

struct RgbaSource {
    template <class L>
    static Pixel<L> load(const unsigned char* from) {
        return loadPixel<L>(from);
    }
};

template <class Rule, class Source>
struct ColourBlendRow {
    unsigned char* destination;
    const unsigned char* source;

    template <class L>
    void paint(int64_t i) const {
        unsigned char* const pixel = destination + i * kColourBytes;
        storePixel(pixel, Rule::apply(loadPixel<L>(pixel),
                                      Source::template load<L>(source + i * kColourBytes)));
    }
};

/// `skipBytes` is what each source column left of the destination is skipped by.
template <class Rule, class Source>
void blendColour(int x, int y, const VFBitmap* dst, const unsigned char* source, int width, int height,
                 int64_t strideBytes, int skipBytes) {
    const ColourView target = ColourView::of(dst);
    if (!target || source == nullptr || strideBytes < 0) return;
    const Clip clip = clipPlacement(x, y, width, height, target.width, target.height);
    paintRows(clip, [&](int64_t row) {
        return ColourBlendRow<Rule, Source>{
            target.at(clip.left, row), source + (row - y) * strideBytes + (clip.left - x) * skipBytes};
    });
}

template <class Rule>
void blendWords(int x, int y, const VFBitmap* dst, const unsigned int* source, int width, int height,
                int strideWords) {
    blendColour<Rule, WordSource>(x, y, dst, reinterpret_cast<const unsigned char*>(source), width,
                                  height, static_cast<int64_t>(strideWords) * kColourBytes,
                                  kColourBytes);
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
    blendWords<SrcOver>(x, y, dst, src, width, height, srcStride);
}

void VFBlender::blendDstOver32To32(int x, int y, const VFBitmap* dst, unsigned int* src, int width,
                                   int height, int srcStride) {
    blendWords<DstOver>(x, y, dst, src, width, height, srcStride);
}

void VFBlender::blendDstOver32To32(int x, int y, const VFBitmap* dst, unsigned char* src, int width,
                                   int height, int srcStride, int order) {
    if (order == kOrderArgb) {
        blendColour<DstOver, ArgbSource>(x, y, dst, src, width, height, srcStride, kByteSourceSkip);
    } else if (order == kOrderRgba) {
        blendColour<DstOver, RgbaSource>(x, y, dst, src, width, height, srcStride, kByteSourceSkip);
    }
}

}  // namespace VFontEffect
