#include <algorithm>
#include <new>

#include "core/effect_types.h"
#include "core/views.h"
#include "effect/routing.h"
#include "voreleffect/VFEffect.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// A zeroed layer; one whose byte count does not fit in 32 bits has its size but no pixels.
VFBitmap* makeLayer(int width, int height, unsigned int bytesPerPixel) {
    const auto columns = static_cast<unsigned int>(std::max(width, 0));
    const auto rows = static_cast<unsigned int>(std::max(height, 0));
    const bool fits = fitsByteCount(columns, rows, bytesPerPixel);
    return fits ? new (std::nothrow) VFBitmap(columns, rows, bytesPerPixel)
                : new (std::nothrow) VFBitmap(columns, rows, nullptr, bytesPerPixel);
}

/// An effect that needs the outer layer whatever the text opacity.
bool needsOuterLayer(VFECore* core) {
    const int type = core->getStyle();
    return type == kEmboss || (isStroke(type) && strokePosition(*core) == kStrokeCentre);
}

template <class Query>
int largestOffset(const std::vector<VFECore*>& cores, Query query) {
    int largest = 0;
    for (VFECore* core : cores)
        largest = std::max(largest, query(core));
    return largest;
}

}  // namespace

void VFEffect::initEffect(int width, int height) {
    const bool layered =
        mTextOpacity < 1.0F || std::any_of(mEffects.begin(), mEffects.end(), needsOuterLayer);
    mUseOuterLayer = layered ? 1 : 0;

    delete mSrcBitmap;
    mSrcBitmap = makeLayer(width, height, kMaskBytes);
    if (layered) {
        delete mOuterLayer;
        mOuterLayer = makeLayer(width, height, kColourBytes);
    }

    if (!mOrdered) reorderEffects();
    mOrdered = true;

    VFECore::ParamInit init = {width, height, mUseOuterLayer};
    for (VFECore* core : mEffects)
        core->initEffect(&init);
    mDstBitmap = nullptr;
}

// Deliberate: the order is made by reversing the list as it stands, so a second ordering of the same
// list restores the earlier order within each group.
void VFEffect::reorderEffects() {
    const auto rank = [this](VFECore* core) {
        if (core->getStyle() == kText) return 1;
        return mUseOuterLayer != 1 && isUnderEffect(core) ? 2 : 0;
    };
    std::reverse(mEffects.begin(), mEffects.end());
    std::stable_sort(mEffects.begin(), mEffects.end(),
                     [&](VFECore* a, VFECore* b) { return rank(a) < rank(b); });
}

bool VFEffect::isUnderEffect(VFECore* core) {
    if (core == nullptr) return false;
    const int type = core->getStyle();
    if (isStroke(type)) {
        const int position = strokePosition(*core);
        return position == kStrokeOutside || (position == kStrokeCentre && mUseOuterLayer != 1);
    }
    switch (type) {
        case kNoEffect:
        case kOuterShadow:
        case kOuterGlow:
            return true;
        case kEmboss:
            return mUseOuterLayer != 1;
        case kBevel:
            return !isInnerBevel(*core);
        default:
            return false;
    }
}

int VFEffect::getLeftOffset() {
    return largestOffset(mEffects, [](VFECore* core) { return core->getLeftOffset(); });
}

int VFEffect::getRightOffset() {
    return largestOffset(mEffects, [](VFECore* core) { return core->getRightOffset(); });
}

int VFEffect::getTopOffset() {
    return largestOffset(mEffects, [](VFECore* core) { return core->getTopOffset(); });
}

int VFEffect::getBottomOffset() {
    return largestOffset(mEffects, [](VFECore* core) { return core->getBottomOffset(); });
}

VFRect* VFEffect::getTextRect() {
    return &mTextRect;
}

}  // namespace VFontEffect
