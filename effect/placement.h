#pragma once

#include "core/effect_types.h"
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
constexpr Placement kBeneath = {true, true, false, true, false};
/// On both sides of the glyph's edge.
constexpr Placement kAstride = {true, false, true, true, true};
/// Inside the glyph, or the text fill itself.
constexpr Placement kWithin = {false, false, false, false, true};
/// Deliberate: a stroke at an unknown position is painted among the effects inside the glyph, but into
/// the outer layer, of which the composite shows nothing where the glyph covers.
constexpr Placement kStray = {false, false, false, true, false};

inline const Placement& placementOf(StrokeSide side) {
    switch (side) {
        case StrokeSide::centre:
            return kAstride;
        case StrokeSide::outside:
            return kBeneath;
        case StrokeSide::inside:
            return kWithin;
        default:
            return kStray;
    }
}

/// The bevel style that lies inside the glyph.
constexpr int kInnerBevel = 1;

/// The placement of a core by its type and, for bevels and strokes, its record. One without a record is
/// no inner bevel, and a stroke at an unknown position.
inline const Placement& placementOf(VFECore& core) {
    const VFProperty* const record = core.getProperty();
    switch (core.getStyle()) {
        case kOuterShadow:
        case kOuterGlow:
        case kNoEffect:
            return kBeneath;
        case kEmboss:
            return kAstride;
        case kBevel: {
            const auto* const bevel = static_cast<const VFBevelProperty*>(record);
            return bevel != nullptr && bevel->mStyle == kInnerBevel ? kWithin : kBeneath;
        }
        case kStroke:
        case kReservedStroke: {
            const auto* const stroke = static_cast<const VFStrokeProperty*>(record);
            return placementOf(stroke != nullptr ? strokeSide(stroke->mPosition) : StrokeSide::unknown);
        }
        default:
            return kWithin;
    }
}

}  // namespace VFontEffect::internal
