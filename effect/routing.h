#pragma once

#include "core/effect_types.h"
#include "voreleffect/VFECore.h"

/// Where each kind of effect lies and, in layered mode, which layer it paints into.
namespace VFontEffect::internal {

/// A value that mPosition and mStyle never name, for a core without a record.
constexpr int kUnknown = -1;

inline bool isStroke(int type) {
    return type == kStroke || type == kReservedStroke;
}

inline int strokePosition(VFECore& core) {
    const auto* stroke = static_cast<const VFStrokeProperty*>(core.getProperty());
    return stroke != nullptr ? stroke->mPosition : kUnknown;
}

/// Style 1 of a bevel lies inside the glyph.
inline bool isInnerBevel(VFECore& core) {
    const auto* bevel = static_cast<const VFBevelProperty*>(core.getProperty());
    return bevel != nullptr && bevel->mStyle == 1;
}

/// The layers that a core may be routed to.
enum class Target { destination, outerLayer, both };

inline Target strokeTarget(int position) {
    // Deliberate: here only position 2 is inside, while isUnderEffect takes every position but 0 and
    // 1 for inside. An unknown position paints into the outer layer, which the composite hides where
    // the glyph covers.
    if (position == kStrokeCentre) return Target::both;
    return position == kStrokeInside ? Target::destination : Target::outerLayer;
}

/// Where a core paints in layered mode; `both` means the outer layer with the destination as second
/// target.
inline Target layeredTarget(VFECore& core) {
    const int type = core.getStyle();
    if (isStroke(type)) return strokeTarget(strokePosition(core));
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
