#pragma once

#include <cstdint>

#include "cores/padded_mask.h"
#include "voreleffect/VFECore.h"

/// The machinery of both glows.
namespace VFontEffect::internal {

/// What a glow reads from its record.
struct GlowRecord {
    float sizePx;
    uint32_t color;
    const VFGradient* stops;
    int count;

    /// A missing record is one of size 0; a missing array counts as no stops.
    template <class Property>
    static GlowRecord of(const Property* p) {
        if (p == nullptr) return {0.0F, 0, nullptr, 0};
        return {p->mSize, p->mColor, p->mGradient, p->mGradient != nullptr ? p->mGradientCount : 0};
    }
};

/// Pixels that a glow reaches beyond the text.
int glowReach(const GlowRecord& record);

/// The colours from the text outwards, straight; see VFOuterGlow::makeColorLUT.
void fillGlowTable(const GlowRecord& record, float fadeStart, int curve, unsigned int* table);

/// Paints a glow around the coverage (plain) or around its inverse (inverted).
void paintGlow(const VFECore::ParamPostProcessing* params, const GlowRecord& record, Sense sense);

}  // namespace VFontEffect::internal
