#include "core/effect_types.h"
#include "cores/glow.h"
#include "cores/property_copy.h"
#include "ops/grow/growth_plan.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

VFInnerGlow::VFInnerGlow() : mProperty(nullptr) {
    mEffectType = kInnerGlow;
}

VFInnerGlow::~VFInnerGlow() {
    releaseCopy(mProperty);
}

void VFInnerGlow::setProperty(VFProperty* property) {
    (void)replaceCopy(mProperty, property);
}

VFProperty* VFInnerGlow::getProperty() {
    return mProperty;
}

int VFInnerGlow::getOffset() {
    return glowReach(GlowRecord::of(mProperty));
}

void VFInnerGlow::makeColorLUT(unsigned int* table, float fadeStart, int curve) {
    fillGlowTable(GlowRecord::of(mProperty), fadeStart, curve, table);
}

void VFInnerGlow::increaseByBoxFilter(unsigned char* mask, int passes, int width, int height) {
    growByBoxFilter(mask, passes, width, height);
}

void VFInnerGlow::doPostProcessing(ParamPostProcessing* params) {
    if (mProperty != nullptr) paintGlow(params, GlowRecord::of(mProperty), GlowSide::inside);
}

}  // namespace VFontEffect
