#pragma once

#include <cstdint>

#include "core/strict_math.h"
#include "core/windows.h"
#include "simd/cpu_level.h"
#include "voreleffect/VFECore.h"

/// The machinery of both glows.
namespace VFontEffect::internal {

/// Which side of the outline the glow lies on: around the coverage, or around its inverse.
enum class GlowSide { outside, inside };

/// What a glow reads from its record.
struct GlowRecord {
    float sizePx;
    uint32_t color;
    const VFGradient* stops;
    int count;

    bool hasOneColour() const { return count < 2; }
    uint32_t oneColour() const { return count == 1 ? stops[0].mColor : color; }

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
void fillGlowTable(CpuLevel level, const GlowRecord& record, float fadeStart, int curve,
                   unsigned int* table);

/// Grows the coverage of a whole picture in place; see VFOuterGlow::increaseByBoxFilter. When memory
/// runs out it stays as it was.
void growByBoxFilter(CpuLevel level, unsigned char* mask, int passes, int width, int height);

/// Paints a glow in windows that take `workingBytes` at most, if they can. All of it is taken before the
/// first pixel is painted: without it nothing is.
void paintGlow(const VFECore::ParamPostProcessing* params, const GlowRecord& record, GlowSide side,
               int64_t workingBytes = kWorkingBytes);

}  // namespace VFontEffect::internal
