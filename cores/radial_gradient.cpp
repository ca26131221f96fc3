#include "core/effect_types.h"
#include "cores/fills.h"
#include "cores/property_copy.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

VOREL_KEEPS_RECORD(VFRadialGradient, kRadialGradient)

void VFRadialGradient::doPostProcessing(ParamPostProcessing* params) {
    if (mProperty != nullptr) paintAll<RadialPainter>(params, *mProperty);
}

namespace internal {

RadialPainter::RadialPainter(CpuLevel level, const CoverageBox& box, const VFBitmap* destination,
                             const VFRadialGradientProperty& record)
    : mLoops(rampLoops(level)),
      mFill(level, box, destination),
      mTable(mLoops, record.mGradient, record.mGradientCount) {
    // Deliberate: the radius is measured by the width alone, so a tall box ends in a plain colour.
    const auto w = static_cast<float>(box.width);
    const float step = (256.0F / w + 256.0F / w) / record.mScale;
    mRamp = {mTable.pixels(), step, w * 0.5F, static_cast<float>(box.height) * 0.5F};
}

int64_t RadialPainter::paintAbove(int64_t limit) {
    return mFill.paintAbove(limit,
                            [&](const BlendJob& job, int64_t y) { mLoops.radial(job, y, mRamp); });
}

bool begin(std::optional<RadialPainter>& painter, const VFECore::ParamPostProcessing* params,
           const VFRadialGradientProperty& record) {
    const CoverageBox box = coverageOf(params);
    if (box && canFill(record)) painter.emplace(chosenLevel(), box, params->dstBitmap, record);
    return true;
}

}  // namespace internal

}  // namespace VFontEffect
