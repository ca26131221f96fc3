#pragma once

#include "ops/dilate/disc_shape.h"
#include "voreleffect/VFProperty.h"

/// Where a stroke lies and how far it goes: its position and its size are judged here alone.
namespace VFontEffect::internal {

/// The side of the glyph's edge that a stroke lies on, by its mPosition. One of an unknown position is
/// painted like one inside, but placed among the effects differently: see effect/placement.h.
enum class StrokeSide { centre = 0, outside = 1, inside = 2, unknown };

/// Unknown without a record.
inline StrokeSide sideOf(const VFStrokeProperty* stroke) {
    const bool known = stroke != nullptr && stroke->mPosition >= 0 && stroke->mPosition <= 2;
    return known ? static_cast<StrokeSide>(stroke->mPosition) : StrokeSide::unknown;
}

struct StrokeShape {
    explicit StrokeShape(const VFStrokeProperty& stroke)
        : side(sideOf(&stroke)),
          radiusPx(side == StrokeSide::centre ? stroke.mSize * 0.5F : stroke.mSize),
          growsGlyph(side == StrokeSide::centre || side == StrokeSide::outside),
          reach(growsGlyph ? static_cast<int>(discReach(radiusPx)) : 0) {}

    StrokeSide side;
    float radiusPx;   ///< of the disc that the coverage, its inverse or both are grown by
    bool growsGlyph;  ///< whether the coverage is grown; if not, only its inverse is
    int reach;        ///< pixels that the stroke reaches beyond the glyph
};

}  // namespace VFontEffect::internal
