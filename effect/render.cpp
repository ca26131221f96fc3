#include <algorithm>
#include <cstdint>

#include "core/numeric.h"
#include "core/views.h"
#include "effect/strips.h"
#include "voreleffect/VFBlender.h"
#include "voreleffect/VFEffect.h"

namespace VFontEffect {

using namespace internal;

namespace {

constexpr unsigned int kGlyphColour = 0xFF000000U;  // not looked at: a mask takes coverage only

VFRect glyphBox(int x, int y, const VFGlyph& glyph) {
    return {x, y, saturateToInt(int64_t{x} + glyph.mWidth), saturateToInt(int64_t{y} + glyph.mHeight)};
}

void growTo(VFRect& box, const VFRect& other) {
    box.mLeft = std::min(box.mLeft, other.mLeft);
    box.mTop = std::min(box.mTop, other.mTop);
    box.mRight = std::max(box.mRight, other.mRight);
    box.mBottom = std::max(box.mBottom, other.mBottom);
}

void clampTo(VFRect& box, const VFBitmap& mask) {
    const int width = saturateToInt(mask.mWidth);
    const int height = saturateToInt(mask.mHeight);
    box.mLeft = std::clamp(box.mLeft, 0, width);
    box.mRight = std::clamp(box.mRight, 0, width);
    box.mTop = std::clamp(box.mTop, 0, height);
    box.mBottom = std::clamp(box.mBottom, 0, height);
}

}  // namespace

void VFEffect::renderEffectLayer(int x, int y, VFGlyph* glyph) {
    if (glyph != nullptr && mSrcBitmap != nullptr) {
        const VFRect box = glyphBox(x, y, *glyph);
        if (mResetTextRect) {
            mTextRect = box;
            mResetTextRect = false;
        } else {
            growTo(mTextRect, box);
        }
        VFBlender().drawBitmap(x, y, mSrcBitmap, glyph->mBuffer, glyph->mWidth, glyph->mHeight,
                               kGlyphColour);
    }
    VFECore::ParamRender params = {x, y, glyph, mDstBitmap};
    for (VFECore* core : mEffects)
        core->render(&params);
}

void VFEffect::doEffectPostProcessing() {
    mResetTextRect = true;
    if (mSrcBitmap == nullptr) return;
    clampTo(mTextRect, *mSrcBitmap);
    if (mTextRect.mRight <= mTextRect.mLeft || mTextRect.mBottom <= mTextRect.mTop) return;
    if (mUseOuterLayer == 1 && !ColourView::of(mOuterLayer)) return;

    const RunBitmaps run = {mDstBitmap, mUseOuterLayer == 1 ? mOuterLayer : nullptr, mSrcBitmap,
                            &mTextRect};
    const int64_t stripRows = stripRowsFor(run);
    if (stripRows > 0 && paintInStrips(mEffects, run, stripRows)) return;
    for (VFECore* core : mEffects) {
        VFECore::ParamPostProcessing params = run.paramsFor(*core);
        core->doPostProcessing(&params);
    }
}

}  // namespace VFontEffect
