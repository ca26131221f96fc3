#include "blend/blend_loops.h"
#include "core/views.h"
#include "voreleffect/VFEffect.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// Mixes the outer layer into the destination by the coverage. Does nothing unless all have one size.
void mergeLayers(const ColourView& destination, const ColourView& outer, const MaskView& mask) {
    if (!destination || !outer || !mask) return;
    const auto sameSize = [&](const auto& layer) {
        return layer.width == destination.width && layer.height == destination.height;
    };
    if (!sameSize(outer) || !sameSize(mask)) return;
    // Packed rows of one size: the images are one long row each.
    BlendJob job = {};
    job.destination = destination.data;
    job.image = outer.data;
    job.mask = mask.data;
    job.width = destination.width * destination.height;
    job.height = 1;
    blendLoops(chosenLevel()).mixByCoverage(job);
}

}  // namespace

void VFEffect::compositeLayers(VFBitmap* destination) {
    if (mUseOuterLayer == 1) {
        mergeLayers(ColourView::of(destination), ColourView::of(mOuterLayer), MaskView::of(mSrcBitmap));
    }
    releaseBitmap();
    mUseOuterLayer = 0;
}

}  // namespace VFontEffect
