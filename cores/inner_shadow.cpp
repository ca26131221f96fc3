#include <cstdint>

#include "core/effect_types.h"
#include "core/float_state.h"
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

}  // namespace

VOREL_KEEPS_RECORD(VFInnerShadow, kInnerShadow)

int VFInnerShadow::getOffset() {
    return 0;
}

void VFInnerShadow::doPostProcessing(ParamPostProcessing* params) {
    const OwnFloatState floatState;
    const CoverageBox box = coverageOf(params);
    if (!box || mProperty == nullptr || exceedsSizeLimit(mProperty->mSize)) return;

    const CpuLevel level = chosenLevel();
    const PlacedTarget target(level, params->dstBitmap, box.left, box.top);
    const Box window = target.seen(wholeOf(box.rows()));
    if (window.empty()) return;
    const uint32_t color = mProperty->mColor;
    const int radius = shadowRadius(mProperty->mSize);
    const ShadowOffset offset = shadowOffset(mProperty->mAngle, mProperty->mDistance);
    if (!meetsItself(box, radius, offset.x, offset.y)) {
        // The glyph moved clear of itself: all of it lies in shadow, by its own coverage.
        return target.paintCoverage(&BlendLoops::dstOverMask, box.rows(), 0, 0, color);
    }

    const Box unmoved = translated(window, -int64_t{offset.x}, -int64_t{offset.y});
    const BlurWeights weights = gaussianOf100(radius);
    BlurPlan blur(level, BlurInput::inverseAcross(weights, box.rows(), unmoved));
    if (!blur) return;
    forBands(blur, unmoved, [&](const Box& band, const BlurredRows& rows) {
        target.paint(&BlendLoops::dstOverMask, translated(band, offset.x, offset.y), rows.values,
                     rows.stride, color);
    });
}

}  // namespace VFontEffect
