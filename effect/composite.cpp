#include <cstdint>

#include "blend/rows.h"
#include "core/views.h"
#include "voreleffect/VFEffect.h"

namespace VFontEffect {

using namespace internal;

namespace {

struct LayerRow {
    unsigned char* destination;
    const unsigned char* outer;
    const unsigned char* mask;

    template <class L>
    void paint(int64_t i) const {
        unsigned char* const pixel = destination + i * kColourBytes;
        storePixel(pixel,
                   MixByCoverage::apply(loadPixel<L>(pixel), loadPixel<L>(outer + i * kColourBytes),
                                        loadBytes<L>(mask + i)));
    }
};

/// Merges the outer layer into the destination by the coverage; all three must have one size.
void mergeLayers(const ColourView& destination, const ColourView& outer, const MaskView& mask) {
    if (!destination || !outer || !mask) return;
    const auto sameSize = [&](const auto& layer) {
        return layer.width == destination.width && layer.height == destination.height;
    };
    if (!sameSize(outer) || !sameSize(mask)) return;
    // Packed rows of one size: the images are one long row each.
    paintRow(LayerRow{destination.data, outer.data, mask.data}, destination.width * destination.height);
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
