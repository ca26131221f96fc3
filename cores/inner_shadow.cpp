#include <algorithm>
#include <cstdint>

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

// Deliberate: the shadow is painted over the whole box, and is 255 outside the glyphs. The text fill, or
// the composite, takes away what lies outside them.

/// Whether the moved, blurred glyph still meets the box.
///
/// Deliberate: the comparisons are not all strict. A glyph whose right or bottom reach ends exactly on
/// the left or top edge counts; one whose left or top reach starts on the right or bottom edge does
/// not.
bool meetsItself(const CoverageBox& box, int64_t radius, int64_t dx, int64_t dy) {
    return box.width + radius + dx >= 0 && dx - radius < box.width && dy < box.height + radius &&
           box.height + dy >= -radius;
}

/// The inverted mask, blurred along its rows and moved by (dx, dy), with `radius` rows above and below
/// the box for the taps of the vertical pass. Whatever the move leaves open is 255: uncovered.
Plane movedInverse(const CoverageBox& box, const BlurKernel& kernel, int64_t dx, int64_t dy) {
    const int64_t radius = kernel.radius;
    Plane moved = Plane::filled(box.width, box.height + 2 * radius, 0xFF);
    // A row's blur reaches `radius` columns beyond the box, its taps as many again.
    const Plane mask = paddedMask(box, 2 * radius, 0);
    if (!moved || !mask) return {PixelBuffer<uint8_t>(nullptr), 0, 0};

    const int64_t first = std::max<int64_t>(0, dx - radius);
    const int64_t end = std::min(box.width, box.width + dx + radius);
    for (int64_t y = 0; y < box.height && first < end; ++y) {
        const int64_t target = y + dy + radius;
        if (target < 0 || target >= moved.height) continue;
        blurLine(mask.row(y) + first - dx + 2 * radius, 1, end - first, kernel, Sense::inverted,
                 moved.row(target) + first);
    }
    return moved;
}

}  // namespace

VFInnerShadow::VFInnerShadow() : mProperty(nullptr) {
    mEffectType = kInnerShadow;
}

VFInnerShadow::~VFInnerShadow() {
    releaseCopy(mProperty);
}

void VFInnerShadow::setProperty(VFProperty* property) {
    replaceCopy(mProperty, property);
}

VFProperty* VFInnerShadow::getProperty() {
    return mProperty;
}

int VFInnerShadow::getOffset() {
    return 0;
}

void VFInnerShadow::doPostProcessing(ParamPostProcessing* params) {
    const CoverageBox box = coverageOf(params);
    if (!box || mProperty == nullptr || isAbsurd(mProperty->mSize)) return;

    const auto draw = [&](unsigned char* mask, int64_t stride) {
        VFBlender().drawBitmapBlend8(saturateToInt(box.left), saturateToInt(box.top), params->dstBitmap,
                                     mask, saturateToInt(box.width), saturateToInt(box.height),
                                     saturateToInt(stride), mProperty->mColor, kModeDstOver);
    };
    const int radius = shadowRadius(mProperty->mSize);
    const ShadowOffset offset = shadowOffset(mProperty->mAngle, mProperty->mDistance);
    if (!meetsItself(box, radius, offset.x, offset.y)) {
        // The glyph moved clear of itself: all of it lies in shadow, by its own coverage.
        draw(box.row(0), box.mask.width);
        return;
    }

    const BlurKernel kernel = shadowKernel(radius);
    Plane shadow = Plane::filled(box.width, box.height, 0);
    if (!kernel || !shadow) return;
    const Plane moved = movedInverse(box, kernel, offset.x, offset.y);
    if (!moved) return;
    for (int64_t y = 0; y < box.height; ++y) {
        blurLine(moved.row(y + radius), moved.width, box.width, kernel, Sense::plain, shadow.row(y));
    }
    draw(shadow.bytes.data(), shadow.width);
}

}  // namespace VFontEffect
