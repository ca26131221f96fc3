#include "core/effect_types.h"
#include "cores/glow.h"
#include "cores/property_copy.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

VOREL_KEEPS_RECORD(VFInnerGlow, kInnerGlow)

int VFInnerGlow::getOffset() {
    return glowReach(GlowRecord::of(mProperty));
}

void VFInnerGlow::makeColorLUT(unsigned int* table, float fadeStart, int curve) {
    fillGlowTable(chosenLevel(), GlowRecord::of(mProperty), fadeStart, curve, table);
}

void VFInnerGlow::increaseByBoxFilter(unsigned char* mask, int passes, int width, int height) {
    growByBoxFilter(chosenLevel(), mask, passes, width, height);
}

void VFInnerGlow::doPostProcessing(ParamPostProcessing* params) {
    if (mProperty != nullptr) paintAll<GlowPainter>(params, *mProperty);
}

}  // namespace VFontEffect
