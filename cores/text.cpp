#include "core/effect_types.h"
#include "core/views.h"
#include "cores/painters.h"
#include "cores/property_copy.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

VOREL_KEEPS_RECORD(VFText, kText)

void VFText::doPostProcessing(ParamPostProcessing* params) {
    if (mProperty != nullptr) paintAll<CoveragePainter>(params, *mProperty);
}

bool internal::begin(std::optional<CoveragePainter>& painter, const VFECore::ParamPostProcessing* params,
                     const VFTextProperty& record) {
    if (params == nullptr || params->dstBitmap == nullptr) return true;
    const MaskView mask = MaskView::of(params->srcBitmap);
    if (!mask) return true;
    const PlacedTarget target(chosenLevel(), params->dstBitmap, 0, 0);
    // In layered mode the fill only slides beneath what is there; else it also clips everything painted
    // so far to the glyph.
    const auto rule = params->useOuterLayer == 1 ? &BlendLoops::dstOverGate : &BlendLoops::dstOverClip;
    const CoverageRows coverage = {mask.data, mask.width, mask.width, mask.height, kAsIs};
    painter.emplace(rule, target, coverage, record.mColor);
    return true;
}

int64_t internal::CoveragePainter::paintAbove(int64_t limit) {
    const Box part = mRest.takenAbove(mTarget.ownRow(limit));
    if (part.empty()) return limit;
    const uint8_t* const mask = mCoverage.start + part.top * mCoverage.stride + part.left;
    mTarget.paint(mRule, part, mask, mCoverage.stride, mColor);
    return limit;
}

}  // namespace VFontEffect
