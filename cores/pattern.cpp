#include <algorithm>
#include <cstdint>

#include "blend/job.h"
#include "core/effect_types.h"
#include "cores/fills.h"
#include "cores/property_copy.h"
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
    if (mProperty != nullptr) paintAll<PatternPainter>(params, *mProperty);
}

namespace internal {

PatternPainter::PatternPainter(CpuLevel level, const CoverageBox& box, const VFBitmap* destination,
                               const ColourView& pattern, const VFPatternProperty& record)
    : mPaint(blendLoops(level).dstOverWhereCovered),
      mFill(level, box, destination),
      mTiles(level, pattern, record.mScale, record.mOpacity, box.width) {}

int64_t PatternPainter::paintAbove(int64_t limit) {
    return mFill.paintAbove(limit, [&](const BlendJob& job, int64_t y) {
        for (int64_t i = 0; i < job.height; ++i) {
            BlendJob row = rowOf(job, i);
            row.image = reinterpret_cast<const uint8_t*>(mTiles.row(y + i));
            mPaint(row);
        }
    });
}

bool begin(std::optional<PatternPainter>& painter, const VFECore::ParamPostProcessing* params,
           const VFPatternProperty& record) {
    const CoverageBox box = fillBox(params);
    if (!box || record.mScale < kSmallestScale) return true;
    const ColourView pattern = ColourView::of(record.mPattern);
    if (!pattern || pattern.width == 0 || pattern.height == 0) return true;
    painter.emplace(chosenLevel(), box, params->dstBitmap, pattern, record);
    return static_cast<bool>(*painter);
}

}  // namespace internal

}  // namespace VFontEffect
