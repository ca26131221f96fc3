#pragma once

#include <cstdint>
#include <cstring>

#include "core/effect_types.h"
#include "core/strict_math.h"
#include "cores/stroke_shape.h"
#include "voreleffect/VFECore.h"

/// Where an effect lies relative to the glyph, and what a run makes of that. A run is layered, with an
/// outer layer for the paint outside the glyphs, or plain, without one.
namespace VFontEffect::internal {

/// What a run asks about a placement. A layered run gives an effect one target or both.
struct Placement {
    bool underText;         ///< painted beneath the text in a plain run
    bool underTextLayered;  ///< the same in a layered run
    bool needsOuterLayer;   ///< makes a run layered, whatever its text opacity
    bool inOuterLayer;      ///< painted into the outer layer of a layered run
    bool inDestination;     ///< painted into the destination of a layered run
};

/// Outside the glyph.
inline constexpr Placement kBeneath = {true, true, false, true, false};
/// On both sides of the glyph's edge.
inline constexpr Placement kAstride = {true, false, true, true, true};
/// Inside the glyph, or the text fill itself.
inline constexpr Placement kWithin = {false, false, false, false, true};
/// Deliberate: a stroke at an unknown position is painted among the effects inside the glyph, but into
/// the outer layer, of which the composite shows nothing where the glyph covers.
inline constexpr Placement kStray = {false, false, false, true, false};

inline const Placement& placementOf(StrokeSide side) {
    if (side == StrokeSide::centre) return kAstride;
    if (side == StrokeSide::outside) return kBeneath;
    return side == StrokeSide::inside ? kWithin : kStray;
}

inline bool isInnerBevel(const VFBevelProperty* bevel) {
    return bevel != nullptr && bevel->mStyle == 1;
}

/// Whether a text opacity, 0 to 1, makes a run layered. What is not 1 is less: its bits tell, in every
/// floating-point state.
inline bool isTranslucent(float textOpacity) {
    constexpr uint32_t kBitsOfOne = 0x3F800000U;
    uint32_t bits = 0;
    static_assert(sizeof bits == sizeof textOpacity);
    std::memcpy(&bits, &textOpacity, sizeof bits);
    return bits != kBitsOfOne;
}

/// By the type of the core and, if it is a bevel or a stroke and has one, its record.
inline const Placement& placementOf(VFECore& core) {
    const VFProperty* const record = core.getProperty();
    switch (core.getStyle()) {
        case kOuterShadow:
        case kOuterGlow:
        case kNoEffect:
            return kBeneath;
        case kEmboss:
            return kAstride;
        case kBevel:
            return isInnerBevel(static_cast<const VFBevelProperty*>(record)) ? kWithin : kBeneath;
        case kStroke:
        case kReservedStroke:
            return placementOf(sideOf(static_cast<const VFStrokeProperty*>(record)));
        default:
            return kWithin;
    }
}

/// What the effects of a run paint into and from.
struct RunBitmaps {
    VFBitmap* destination;
    VFBitmap* outerLayer;  ///< null in a run that is not layered
    VFBitmap* mask;
    VFRect* textRect;

    /// What a core is given. Of two targets the destination is the second.
    VFECore::ParamPostProcessing paramsFor(VFECore& core) const {
        if (outerLayer == nullptr) return {destination, mask, textRect, 0, nullptr};
        const Placement& placement = placementOf(core);
        VFBitmap* const second =
            placement.inOuterLayer && placement.inDestination ? destination : nullptr;
        return {placement.inOuterLayer ? outerLayer : destination, mask, textRect, 1, second};
    }
};

}  // namespace VFontEffect::internal
