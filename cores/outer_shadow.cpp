#include <algorithm>
#include <cstdint>

#include "core/effect_types.h"
#include "core/numeric.h"
#include "core/size_limit.h"
#include "cores/paint_input.h"
#include "cores/placed_target.h"
#include "cores/property_copy.h"
#include "cores/shadow_offset.h"
#include "ops/blur/blur_plan.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// How far the shadow reaches on a side towards which it is moved by `shift` pixels.
int reach(const VFOuterShadowProperty* record, int64_t shift) {
    if (record == nullptr) return 0;
    return saturateToInt(std::max<int64_t>(0, toInt(record->mSize + 0.5F) + shift));
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
    const ShadowOffset offset = shadowOffset(mProperty->mAngle, mProperty->mDistance);
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
    const CoverageBox box = coverageOf(params);
    if (!box || mProperty == nullptr || exceedsSizeLimit(mProperty->mSize)) return;

    const PlacedTarget target(params->dstBitmap, box.left + mOffsetX, box.top + mOffsetY);
    const int radius = shadowRadius(mProperty->mSize);
    const Box window = target.seen(expanded(wholeOf(box), radius));
    if (window.empty()) return;
    // Without blur the coverage itself is the shadow.
    const uint32_t color = mProperty->mColor;
    if (radius == 0) {
        return target.paintBeneath(window, box.row(window.top) + window.left, box.mask.width, color);
    }

    blurDownThenAcross(
        shadowWeights(radius), sourceOf(box), window, kNoFullColumns, false,
        [&](int64_t y, int64_t rows, const uint8_t* values, int64_t stride) {
            target.paintBeneath({window.left, y, window.right, y + rows}, values, stride, color);
        });
}

}  // namespace VFontEffect
