#include <algorithm>
#include <new>

#include "core/effect_types.h"
#include "core/views.h"
#include "effect/placement.h"
#include "voreleffect/VFEffect.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// A layer that has its size, but no pixels: nothing is painted into it or from it.
[[nodiscard]] VFBitmap* makeHollowLayer(int width, int height, unsigned int bytesPerPixel) {
    return new (std::nothrow)
        VFBitmap(static_cast<unsigned int>(std::max(width, 0)),
                 static_cast<unsigned int>(std::max(height, 0)), nullptr, bytesPerPixel);
}

/// A zeroed layer; a hollow one when its byte count does not fit in 32 bits.
[[nodiscard]] VFBitmap* makeLayer(int width, int height, unsigned int bytesPerPixel) {
    const auto columns = static_cast<unsigned int>(std::max(width, 0));
    const auto rows = static_cast<unsigned int>(std::max(height, 0));
    return fitsByteCount(columns, rows, bytesPerPixel) ? new (std::nothrow)
                                                             VFBitmap(columns, rows, bytesPerPixel)
                                                       : makeHollowLayer(width, height, bytesPerPixel);
}

/// Puts the cores in paint order: over the text, the text fill, beneath the text. In layered mode only
/// the text fill has a place of its own, the end.
///
/// Deliberate: the order is made by reversing the list as it stands, so a second ordering of the same
/// list restores the earlier order within each group.
void reorder(std::vector<VFECore*>& cores, bool layered) {
    const auto rank = [layered](VFECore* core) {
        if (core->getStyle() == kText) return 1;
        return !layered && placementOf(*core).underText ? 2 : 0;
    };
    const auto isAbove = [&](int place, VFECore* core) { return place < rank(core); };
    std::reverse(cores.begin(), cores.end());
    // By insertion: the list is short, and a stable sort would take memory for it.
    for (auto next = cores.begin(); next != cores.end(); ++next)
        std::rotate(std::upper_bound(cores.begin(), next, rank(*next), isAbove), next, next + 1);
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
    const bool layered = isTranslucent(mTextOpacity) ||
                         std::any_of(mEffects.begin(), mEffects.end(),
                                     [](VFECore* core) { return placementOf(*core).needsOuterLayer; });
    mUseOuterLayer = layered ? 1 : 0;

    delete mSrcBitmap;
    mSrcBitmap = makeLayer(width, height, kMaskBytes);
    if (layered) {
        delete mOuterLayer;
        mOuterLayer = makeLayer(width, height, kColourBytes);
        if (!ColourView::of(mOuterLayer)) {
            // Unmerged, what goes into one layer alone is another picture. The mask tells the caller.
            delete mSrcBitmap;
            mSrcBitmap = makeHollowLayer(width, height, kMaskBytes);
        }
    }

    if (!mOrdered) reorder(mEffects, layered);
    mOrdered = true;

    VFECore::ParamInit init = {width, height, mUseOuterLayer};
    for (VFECore* core : mEffects)
        core->initEffect(&init);
    mDstBitmap = nullptr;
}

bool VFEffect::isUnderEffect(VFECore* core) {
    if (core == nullptr) return false;
    const Placement& placement = placementOf(*core);
    return mUseOuterLayer == 1 ? placement.underTextLayered : placement.underText;
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
