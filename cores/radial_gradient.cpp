#include "core/effect_types.h"
#include "core/float_state.h"
#include "cores/covered_fill.h"
#include "cores/paint_input.h"
#include "cores/property_copy.h"
#include "ops/ramp/ramp_loops.h"
#include "ops/ramp/stop_ramp.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

VOREL_KEEPS_RECORD(VFRadialGradient, kRadialGradient)

void VFRadialGradient::doPostProcessing(ParamPostProcessing* params) {
    const OwnFloatState floatState;
    const CoverageBox box = coverageOf(params);
    if (!box || !canFill(mProperty)) return;
    const CpuLevel level = chosenLevel();
    const RampLoops& loops = rampLoops(level);
    const GradientTable table(loops, mProperty->mGradient, mProperty->mGradientCount);

    // Deliberate: the radius is measured by the width alone, so a tall box ends in a plain colour.
    const auto w = static_cast<float>(box.width);
    const float step = (256.0F / w + 256.0F / w) / mProperty->mScale;
    const RadialRamp ramp = {table.pixels(), step, w * 0.5F, static_cast<float>(box.height) * 0.5F};
    fillCovered(level, box, params->dstBitmap, [&](const BlendJob& job) { loops.radial(job, ramp); });
}

}  // namespace VFontEffect
