#include <cmath>

#include "core/effect_types.h"
#include "core/portable_math.h"
#include "cores/fills.h"
#include "cores/property_copy.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// Radians per degree, negated: with y downwards, positive angles turn counter-clockwise. Deliberate:
/// seven digits, a little below pi / 180.
constexpr float kRadiansPerDegree = -0.01745328F;

/// The length of the line through the centre of a w x h box at an angle.
float lengthAcross(const Turn& angle, float w, float h) {
    if (std::fabs(angle.tangent) < h / w) return w / std::fabs(angle.cosine);
    return h / std::fabs(angle.sine);
}

}  // namespace

VOREL_KEEPS_RECORD(VFLinearGradient, kLinearGradient)

void VFLinearGradient::doPostProcessing(ParamPostProcessing* params) {
    if (mProperty != nullptr) paintAll<LinearPainter>(params, *mProperty);
}

namespace internal {

LinearPainter::LinearPainter(CpuLevel level, const CoverageBox& box, const VFBitmap* destination,
                             const VFLinearGradientProperty& record)
    : mLoops(rampLoops(level)),
      mFill(level, box, destination),
      mTable(mLoops, record.mGradient, record.mGradientCount) {
    const auto w = static_cast<float>(box.width);
    const auto h = static_cast<float>(box.height);
    const Turn angle = portableTurn(record.mAngle * kRadiansPerDegree);
    const float step = (256.0F / record.mScale) / lengthAcross(angle, w, h);
    mRamp = {mTable.pixels(), angle.cosine * step, angle.sine * step, w * 0.5F, h * 0.5F};
}

int64_t LinearPainter::paintAbove(int64_t limit) {
    return mFill.paintAbove(limit,
                            [&](const BlendJob& job, int64_t y) { mLoops.linear(job, y, mRamp); });
}

bool begin(std::optional<LinearPainter>& painter, const VFECore::ParamPostProcessing* params,
           const VFLinearGradientProperty& record) {
    const CoverageBox box = coverageOf(params);
    if (box && canFill(record)) painter.emplace(chosenLevel(), box, params->dstBitmap, record);
    return true;
}

}  // namespace internal

}  // namespace VFontEffect
