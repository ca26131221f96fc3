#include "core/blend_modes.h"
#include "core/effect_types.h"
#include "core/numeric.h"
#include "core/views.h"
#include "cores/property_copy.h"
#include "voreleffect/VFBlender.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

VFText::VFText() : mProperty(nullptr) {
    mEffectType = kText;
}

VFText::~VFText() {
    releaseCopy(mProperty);
}

void VFText::setProperty(VFProperty* property) {
    (void)replaceCopy(mProperty, property);
}

VFProperty* VFText::getProperty() {
    return mProperty;
}

void VFText::doPostProcessing(ParamPostProcessing* params) {
    if (params == nullptr || mProperty == nullptr || params->dstBitmap == nullptr) return;
    const MaskView mask = MaskView::of(params->srcBitmap);
    if (!mask) return;
    // In layered mode the fill only slides beneath what is there; else it also clips everything painted
    // so far to the glyph.
    const int mode = params->useOuterLayer == 1 ? kModeDstOverGate : kModeDstOverClip;
    const int width = saturateToInt(mask.width);
    VFBlender().drawBitmapBlend8(0, 0, params->dstBitmap, mask.data, width, saturateToInt(mask.height),
                                 width, mProperty->mColor, mode);
}

}  // namespace VFontEffect
