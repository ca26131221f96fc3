#include <algorithm>
#include <cstdint>

#include "core/effect_types.h"
#include "core/float_state.h"
#include "cores/covered_fill.h"
#include "cores/paint_input.h"
#include "cores/property_copy.h"
#include "ops/tile/tile_plan.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// The covered box. Unlike the other cores' boxes, one larger than the mask is first cut to the mask's
/// size; unless it starts at the left or top edge it still leaves the mask then, and nothing is drawn.
CoverageBox fillBox(const VFECore::ParamPostProcessing* params) {
    if (params == nullptr || params->dstBitmap == nullptr || params->textRect == nullptr) return {};
    const MaskView mask = MaskView::of(params->srcBitmap);
    const VFRect& box = *params->textRect;
    return CoverageBox::of(mask, box.mLeft, box.mTop,
                           std::min(mask.width, int64_t{box.mRight} - box.mLeft),
                           std::min(mask.height, int64_t{box.mBottom} - box.mTop));
}

}  // namespace

VOREL_KEEPS_RECORD(VFPattern, kPattern)

void VFPattern::doPostProcessing(ParamPostProcessing* params) {
    const OwnFloatState floatState;
    const CoverageBox box = fillBox(params);
    if (!box || mProperty == nullptr || mProperty->mScale < kSmallestScale) return;
    const ColourView pattern = ColourView::of(mProperty->mPattern);
    if (!pattern || pattern.width == 0 || pattern.height == 0) return;

    const CpuLevel level = chosenLevel();
    TilePlan tiles(level, pattern, mProperty->mScale, mProperty->mOpacity, box.width);
    if (!tiles) return;
    const BlendLoop paint = blendLoops(level).dstOverWhereCovered;
    fillCovered(level, box, params->dstBitmap, [&](const BlendJob& job) {
        for (int64_t y = 0; y < job.height; ++y) {
            BlendJob row = rowOf(job, y);
            row.image = reinterpret_cast<const uint8_t*>(tiles.row(y));
            paint(row);
        }
    });
}

}  // namespace VFontEffect
