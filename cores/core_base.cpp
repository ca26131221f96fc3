#include "core/effect_types.h"
#include "core/strict_math.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

VFECore::~VFECore() = default;

VFECoreBase::VFECoreBase() : mEffectType(internal::kNoEffect), mId(-1) {}
VFECoreBase::~VFECoreBase() = default;

int VFECoreBase::initEffect(ParamInit* /*init*/) {
    return 1;
}
int VFECoreBase::render(ParamRender* /*render*/) {
    return 1;
}
void VFECoreBase::doPostProcessing(ParamPostProcessing* /*params*/) {}
float VFECoreBase::getOpacity() {
    return 1.0F;
}
int VFECoreBase::getStyle() {
    return mEffectType;
}
int VFECoreBase::getLeftOffset() {
    return getOffset();
}
int VFECoreBase::getRightOffset() {
    return getOffset();
}
int VFECoreBase::getTopOffset() {
    return getOffset();
}
int VFECoreBase::getBottomOffset() {
    return getOffset();
}
void VFECoreBase::setId(int id) {
    mId = id;
}
int VFECoreBase::getId() {
    return mId;
}
int VFECoreBase::getOffset() {
    return 0;
}

}  // namespace VFontEffect
