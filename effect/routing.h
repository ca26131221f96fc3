#pragma once

#include "core/effect_types.h"
#include "cores/stroke_shape.h"
#include "voreleffect/VFECore.h"

/// Where each kind of effect lies and, in layered mode, which layer it paints into.
namespace VFontEffect::internal {

inline bool isStroke(int type) {
    return type == kStroke || type == kReservedStroke;
}

inline StrokeSide strokeSide(VFECore& core) {
    const auto* stroke = static_cast<const VFStrokeProperty*>(core.getProperty());
    return stroke != nullptr ? strokeSide(stroke->mPosition) : StrokeSide::unknown;
}

/// Style 1 of a bevel lies inside the glyph.
inline bool isInnerBevel(VFECore& core) {
    const auto* bevel = static_cast<const VFBevelProperty*>(core.getProperty());
    return bevel != nullptr && bevel->mStyle == 1;
}

/// The layers that a core may be routed to.
enum class Target { destination, outerLayer, both };

inline Target strokeTarget(StrokeSide side) {
    // Deliberate: here only position 2 is inside, while isUnderEffect takes every position but 0 and
    // 1 for inside. An unknown position paints into the outer layer, which the composite hides where
    // the glyph covers.
    if (side == StrokeSide::centre) return Target::both;
    return side == StrokeSide::inside ? Target::destination : Target::outerLayer;
}

/// Where a core paints in layered mode; `both` means the outer layer with the destination as second
/// target.
inline Target layeredTarget(VFECore& core) {
    const int type = core.getStyle();
    if (isStroke(type)) return strokeTarget(strokeSide(core));
    switch (type) {
        case kOuterShadow:
        case kOuterGlow:
        case kNoEffect:
            return Target::outerLayer;
        case kBevel:
            return isInnerBevel(core) ? Target::destination : Target::outerLayer;
        case kEmboss:
            return Target::both;
        default:
            return Target::destination;
    }
}

}  // namespace VFontEffect::internal
