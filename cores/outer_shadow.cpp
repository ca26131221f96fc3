#include <algorithm>
#include <cstdint>

#include "core/effect_types.h"
#include "core/float_state.h"
#include "core/numeric.h"
#include "core/size_limit.h"
#include "cores/paint_input.h"
#include "cores/painters.h"
#include "cores/property_copy.h"
#include "cores/shadow_offset.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// How far the shadow reaches on a side towards which it is moved by `shift` pixels.
int reach(const VFOuterShadowProperty* record, int64_t shift) {
    if (record == nullptr) return 0;
    const int blur = inOwnFloatState([&] { return toInt(record->mSize + 0.5F); });
    return saturateToInt(std::max<int64_t>(0, blur + shift));
}

}  // namespace

VFOuterShadow::VFOuterShadow() : mProperty(nullptr), mOffsetX(0), mOffsetY(0) {
    mEffectType = kOuterShadow;
}

VFOuterShadow::~VFOuterShadow() {
    releaseCopy(mProperty);
}

void VFOuterShadow::setProperty(VFProperty* property) {
    if (!replaceCopy(mProperty, property)) return;
    const ShadowOffset offset =
        inOwnFloatState([&] { return shadowOffset(mProperty->mAngle, mProperty->mDistance); });
    mOffsetX = offset.x;
    mOffsetY = offset.y;
}

VFProperty* VFOuterShadow::getProperty() {
    return mProperty;
}

int VFOuterShadow::getLeftOffset() {
    return reach(mProperty, -int64_t{mOffsetX});
}
int VFOuterShadow::getRightOffset() {
    return reach(mProperty, mOffsetX);
}
int VFOuterShadow::getTopOffset() {
    return reach(mProperty, -int64_t{mOffsetY});
}
int VFOuterShadow::getBottomOffset() {
    return reach(mProperty, mOffsetY);
}

void VFOuterShadow::doPostProcessing(ParamPostProcessing* params) {
    if (mProperty != nullptr)
        paintAll<ShadowPainter>(params, *mProperty, ShadowOffset{mOffsetX, mOffsetY});
}

bool internal::begin(std::optional<ShadowPainter>& painter, const VFECore::ParamPostProcessing* params,
                     const VFOuterShadowProperty& record, const ShadowOffset& offset,
                     int64_t workingBytes) {
    const CoverageBox box = coverageOf(params);
    if (!box || exceedsSizeLimit(record.mSize)) return true;
    const PlacedTarget target(chosenLevel(), params->dstBitmap, box.left + offset.x, box.top + offset.y);
    const int radius = shadowRadius(record.mSize);
    // Without blur the coverage itself is the shadow.
    if (radius == 0) {
        painter.emplace(target, box.rows(), record.mColor);
        return true;
    }
    return beginBlurred(painter, target, box.rows(), BlurPainter::Of::coverage, radius,
                        expanded(wholeOf(box.rows()), radius), record.mColor, workingBytes);
}

}  // namespace VFontEffect
