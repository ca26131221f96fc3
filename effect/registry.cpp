#include <algorithm>
#include <cstdint>
#include <new>

#include "core/effect_types.h"
#include "core/float_state.h"
#include "core/numeric.h"
#include "effect/placement.h"
#include "voreleffect/VFEffect.h"

namespace VFontEffect {

using namespace internal;

namespace {

[[nodiscard]] VFECore* makeCore(int type) {
    switch (type) {
        case kOuterShadow:
            return new (std::nothrow) VFOuterShadow;
        case kInnerShadow:
            return new (std::nothrow) VFInnerShadow;
        case kOuterGlow:
            return new (std::nothrow) VFOuterGlow;
        case kInnerGlow:
            return new (std::nothrow) VFInnerGlow;
        case kLinearGradient:
            return new (std::nothrow) VFLinearGradient;
        case kRadialGradient:
            return new (std::nothrow) VFRadialGradient;
        case kStroke:
            return new (std::nothrow) VFStroke;
        case kPattern:
            return new (std::nothrow) VFPattern;
        case kText:
            return new (std::nothrow) VFText;
        default:
            return nullptr;
    }
}

}  // namespace

VFEffect::VFEffect() = default;

VFEffect::VFEffect(void* /*ignored*/) : VFEffect() {}

VFEffect::VFEffect(const VFEffect& other)
    : mUseOuterLayer(other.mUseOuterLayer),
      mTextOpacity(other.mTextOpacity),
      mTextColor(other.mTextColor),
      mNextEffectId(other.mNextEffectId),
      mTextAlpha(other.mTextAlpha),
      mOrdered(other.mOrdered) {
    for (VFECore* core : other.mEffects)
        addEffect(core->getId(), core->getStyle(), core->getProperty());
}

VFEffect::~VFEffect() {
    releaseEffect();
    releaseBitmap();
}

int VFEffect::addEffect(int id, int type, VFProperty* property) {
    mOrdered = false;
    VFECore* core = getEffect(type);
    if (core == nullptr) {
        // Room for one of each type. The first time it may throw: before there is a core to leak.
        mEffects.reserve(kNoEffect);
        core = createEffect(id, type, nullptr);
        if (core == nullptr) return -1;
        mEffects.push_back(core);
    }
    core->setProperty(property);
    return core->getId();
}

int VFEffect::addEffect(int type, VFProperty* property) {
    return addEffect(-1, type, property);
}

VFECore* VFEffect::createEffect(int id, int type, VFECore* /*ignored*/) {
    VFECore* core = makeCore(type);
    if (core != nullptr) core->setId(id < 0 ? getNewEffectId() : id);
    return core;
}

int VFEffect::getNewEffectId() {
    const int id = std::max(mNextEffectId, 0);
    mNextEffectId = saturateToInt(int64_t{id} + 1);
    return id;
}

VFECore* VFEffect::getEffect(int type) {
    const auto found = std::find_if(mEffects.begin(), mEffects.end(),
                                    [type](VFECore* core) { return core->getStyle() == type; });
    return found != mEffects.end() ? *found : nullptr;
}

// Deliberate: mOrdered stays as it is, so the rest of the list is not put in paint order anew.
bool VFEffect::removeEffect(int id) {
    const auto found = std::find_if(mEffects.begin(), mEffects.end(),
                                    [id](VFECore* core) { return core->getId() == id; });
    if (found == mEffects.end()) return false;
    releaseEffect(*found);
    mEffects.erase(found);
    return true;
}

void VFEffect::releaseEffect(VFECore* core) {
    delete core;
}

void VFEffect::releaseEffect() {
    for (VFECore* core : mEffects)
        releaseEffect(core);
    mEffects.clear();
    mNextEffectId = 0;
}

void VFEffect::cleanAllEffect() {
    releaseEffect();
}

void VFEffect::releaseBitmap() {
    delete mSrcBitmap;
    delete mOuterLayer;
    mSrcBitmap = nullptr;
    mOuterLayer = nullptr;
    mDstBitmap = nullptr;
}

void VFEffect::cleanLayers() {}

bool VFEffect::hasEffects() {
    return !mEffects.empty() || isTranslucent(mTextOpacity);
}

void VFEffect::setTextOpacity(float opacity) {
    inOwnFloatState([&] {
        // Deliberate: compared as given, so an opacity above 1 re-arms the ordering every time it is
        // set.
        if (opacity != mTextOpacity) mOrdered = false;
        mTextOpacity = clampOrLow(opacity, 0.0F, 1.0F);
    });
}

float VFEffect::getTextOpacity() {
    return mTextOpacity;
}

// Deliberate: mOrdered stays as it is; see setTextOpacity.
void VFEffect::clearTextOpacity() {
    mTextOpacity = 1.0F;
}

VFBitmap* VFEffect::getSrcBitmap() {
    return mSrcBitmap;
}
void VFEffect::setSrcBitmap(VFBitmap* mask) {
    mSrcBitmap = mask;
}
VFBitmap* VFEffect::getDstBitmap() {
    return mDstBitmap;
}
void VFEffect::setDstBitmap(VFBitmap* destination) {
    mDstBitmap = destination;
}

}  // namespace VFontEffect
