#include <cstdint>

#include "core/effect_types.h"
#include "core/size_limit.h"
#include "cores/paint_input.h"
#include "cores/painters.h"
#include "cores/property_copy.h"
#include "cores/shadow_offset.h"
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
    if (mProperty != nullptr) paintAll<ShadowPainter>(params, *mProperty);
}

bool internal::begin(std::optional<ShadowPainter>& painter, const VFECore::ParamPostProcessing* params,
                     const VFInnerShadowProperty& record, int64_t workingBytes) {
    const CoverageBox box = coverageOf(params);
    if (!box || exceedsSizeLimit(record.mSize)) return true;
    const CpuLevel level = chosenLevel();
    const int radius = shadowRadius(record.mSize);
    const ShadowOffset offset = shadowOffset(record.mAngle, record.mDistance);
    const int64_t dx = offset.x;
    const int64_t dy = offset.y;
    if (!meetsItself(box, radius, dx, dy)) {
        // The glyph moved clear of itself: all of it lies in shadow, by its own coverage.
        const PlacedTarget unmoved(level, params->dstBitmap, box.left, box.top);
        painter.emplace(unmoved, box.rows(), record.mColor);
        return true;
    }
    const PlacedTarget target(level, params->dstBitmap, box.left + dx, box.top + dy);
    return beginBlurred(painter, target, box.rows(), BlurPainter::Of::inverse, radius,
                        translated(wholeOf(box.rows()), -dx, -dy), record.mColor, workingBytes);
}

}  // namespace VFontEffect
