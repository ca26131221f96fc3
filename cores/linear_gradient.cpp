#include <cmath>

#include "core/effect_types.h"
#include "core/float_state.h"
#include "core/portable_math.h"
#include "cores/covered_fill.h"
#include "cores/paint_input.h"
#include "cores/property_copy.h"
#include "ops/ramp/ramp_loops.h"
#include "ops/ramp/stop_ramp.h"
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
    const OwnFloatState floatState;
    const CoverageBox box = coverageOf(params);
    if (!box || !canFill(mProperty)) return;
    const CpuLevel level = chosenLevel();
    const RampLoops& loops = rampLoops(level);
    const GradientTable table(loops, mProperty->mGradient, mProperty->mGradientCount);

    const auto w = static_cast<float>(box.width);
    const auto h = static_cast<float>(box.height);
    const Turn angle = portableTurn(mProperty->mAngle * kRadiansPerDegree);
    const float step = (256.0F / mProperty->mScale) / lengthAcross(angle, w, h);
    const LinearRamp ramp = {table.pixels(), angle.cosine * step, angle.sine * step, w * 0.5F, h * 0.5F};
    fillCovered(level, box, params->dstBitmap, [&](const BlendJob& job) { loops.linear(job, ramp); });
}

}  // namespace VFontEffect
