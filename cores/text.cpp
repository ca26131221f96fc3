#include "core/effect_types.h"
#include "core/views.h"
#include "cores/placed_target.h"
#include "cores/property_copy.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

VOREL_KEEPS_RECORD(VFText, kText)

void VFText::doPostProcessing(ParamPostProcessing* params) {
    if (params == nullptr || mProperty == nullptr || params->dstBitmap == nullptr) return;
    const MaskView mask = MaskView::of(params->srcBitmap);
    if (!mask) return;
    const PlacedTarget target(chosenLevel(), params->dstBitmap, 0, 0);
    // In layered mode the fill only slides beneath what is there; else it also clips everything painted
    // so far to the glyph.
    const auto rule = params->useOuterLayer == 1 ? &BlendLoops::dstOverGate : &BlendLoops::dstOverClip;
    const CoverageRows coverage = {mask.data, mask.width, mask.width, mask.height, kAsIs};
    target.paintCoverage(rule, coverage, 0, 0, mProperty->mColor);
}

}  // namespace VFontEffect
