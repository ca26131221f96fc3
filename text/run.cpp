#include "text/run.h"

#include <new>
#include <string>
#include <vector>

#include "text/error.h"

namespace voreltext {
namespace {

using VFontEffect::VFBitmap;
using VFontEffect::VFEffect;
using VFontEffect::VFGlyph;

const Frame& checked(const Frame& frame) {
    checkSize(frame.width(), frame.height());
    return frame;
}

void requirePixels(const VFBitmap* bitmap) {
    if (bitmap == nullptr || bitmap->mData == nullptr) throw std::bad_alloc();
}

}  // namespace

Margins marginsOf(VFEffect& effects) {
    return {effects.getLeftOffset(), effects.getTopOffset(), effects.getRightOffset(),
            effects.getBottomOffset()};
}

void checkSize(int width, int height) {
    const bool fits = width >= 0 && width <= TextLayout::kMaxSide && height >= 0 &&
                      height <= TextLayout::kMaxSide && int64_t{width} * height <= kMaxPixels;
    if (fits) return;
    throw TextError("the picture would be " + std::to_string(width) + " x " + std::to_string(height) +
                    " pixels; at most " + std::to_string(TextLayout::kMaxSide) + " on a side and " +
                    std::to_string(kMaxPixels) + " in all");
}

Run::Run(VFEffect& effects, const Frame& frame)
    : mEffects(effects),
      mFrame(checked(frame)),
      mPicture(static_cast<unsigned int>(frame.width()), static_cast<unsigned int>(frame.height()), 4) {
    requirePixels(&mPicture);
}

void Run::begin() {
    mEffects.initEffect(mFrame.width(), mFrame.height());
    requirePixels(mEffects.getSrcBitmap());
    mEffects.setDstBitmap(&mPicture);
}

void Run::draw(const GlyphMask& glyph) {
    // The library reads the coverage without changing it, but takes a pointer to mutable bytes.
    VFGlyph shape{const_cast<uint8_t*>(glyph.coverage.data()),
                  static_cast<unsigned short>(glyph.box.width()),
                  static_cast<unsigned short>(glyph.box.height())};
    mEffects.renderEffectLayer(glyph.box.left + mFrame.shiftX(), glyph.box.top + mFrame.shiftY(),
                               &shape);
}

void Run::merge() {
    mEffects.compositeLayers(&mPicture);
}

Image Run::picture() const {
    const size_t bytes = size_t{mPicture.mWidth} * mPicture.mHeight * mPicture.mBytesPerPixel;
    return {static_cast<int>(mPicture.mWidth), static_cast<int>(mPicture.mHeight),
            std::vector<uint8_t>(mPicture.mData, mPicture.mData + bytes)};
}

Image paint(VFEffect& effects, const TextLayout& text, int padding) {
    Run run(effects, {text.inkBox(), marginsOf(effects), padding});
    run.begin();
    for (size_t i = 0; i < text.glyphCount(); ++i)
        run.draw(text.rasterise(i));
    effects.doEffectPostProcessing();
    run.merge();
    return run.picture();
}

}  // namespace voreltext
