#include <algorithm>
#include <cstdint>
#include <cstring>

#include "core/blend_modes.h"
#include "core/effect_types.h"
#include "core/numeric.h"
#include "cores/blur.h"
#include "cores/paint_input.h"
#include "cores/property_copy.h"
#include "cores/shadow_offset.h"
#include "voreleffect/VFBlender.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// How far the shadow reaches on a side towards which it is moved by `shift` pixels.
int reach(const VFOuterShadowProperty* record, int64_t shift) {
    if (record == nullptr) return 0;
    return saturateToInt(std::max<int64_t>(0, toInt(record->mSize + 0.5F) + shift));
}

/// The picture's place in the destination.
struct Placement {
    int64_t left;
    int64_t top;
    int64_t width;
    int64_t height;

    /// A picture that ends right at the left or top edge still counts.
    bool touches(const VFBitmap& destination) const {
        return left + width >= 0 && left < destination.mWidth && top + height >= 0 &&
               top < destination.mHeight;
    }
};

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
    if (!box || mProperty == nullptr || isAbsurd(mProperty->mSize)) return;

    // Deliberate: a margin of twice the blur's reach: every tap of every pixel that is not 0 lies
    // inside.
    const int radius = shadowRadius(mProperty->mSize);
    const int64_t margin = 2 * int64_t{radius};
    const Placement place = {box.left - margin + mOffsetX, box.top - margin + mOffsetY,
                             box.width + 2 * margin, box.height + 2 * margin};
    if (!place.touches(*params->dstBitmap)) return;

    const Plane mask = paddedMask(box, margin, margin);
    Plane shadow = Plane::filled(place.width, place.height, 0);
    const BlurKernel kernel = shadowKernel(radius);
    if (!mask || !shadow || !kernel) return;
    const bool blurred = blurPlane(mask, kernel, Sense::plain, [&](int64_t y, const uint8_t* values) {
        std::memcpy(shadow.row(y) + radius, values, static_cast<size_t>(place.width - margin));
    });
    if (!blurred) return;

    const int width = saturateToInt(place.width);
    VFBlender().drawBitmapBlend8(saturateToInt(place.left), saturateToInt(place.top), params->dstBitmap,
                                 shadow.bytes.data(), width, saturateToInt(place.height), width,
                                 mProperty->mColor, kModeDstOver);
}

}  // namespace VFontEffect
