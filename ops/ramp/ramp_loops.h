#pragma once

#include <cstdint>

#include "blend/blend_loops.h"

/// The inner loops of colour ramps, compiled once per level of the instruction set.
namespace VFontEffect::internal {

/// The colours of a gradient, entries 0..255, premultiplied, as pixels in memory: R, G, B, A.
/// Transparent ones are 0.
using RampPixels = const uint32_t*;

/// Entry 128 + trunc(stepY * (y - centreY) + stepX * (x - centreX)), counted from the box's corner.
struct LinearRamp {
    RampPixels pixels;
    float stepX;
    float stepY;
    float centreX;
    float centreY;
};

/// Entry trunc(step * sqrt((y - centreY)^2 + (x - centreX)^2)).
struct RadialRamp {
    RampPixels pixels;
    float step;
    float centreX;
    float centreY;
};

/// Tables are read and written in whole vectors: up to so many entries past their count.
constexpr int64_t kRampSlack = kWidestVector / 4;

/// A stretch of a ramp between two stops with straight colours 0xAARRGGBB, from `start` on.
struct RampSegment {
    uint32_t lower;
    uint32_t upper;
    float start;
    float span;
};

/// Weaker values than this fade.
constexpr uint32_t kFadedValues = 180;

struct RampLoops {
    /// Fill a covered box from row y on, at its left edge: the job's mask is its coverage, which gates
    /// the colour.
    void (*linear)(const BlendJob& job, int64_t y, const LinearRamp& ramp);
    void (*radial)(const BlendJob& job, int64_t y, const RadialRamp& ramp);

    /// The colours of a segment at `count` positions, which may be read past their count.
    void (*mixStops)(const RampSegment& segment, const float* positions, int64_t count,
                     uint32_t* colours);

    /// Straight colours 0xAARRGGBB as premultiplied pixels in memory: R, G, B, A. Their count is a
    /// multiple of kRampSlack.
    void (*premultiplied)(const uint32_t* colours, int64_t count, uint32_t* pixels);

    /// The job's mask is values: their colours beneath the destination. That of 0 must be transparent.
    void (*byValue)(const BlendJob& job, RampPixels pixels);

    /// Makes values the alphas of a colour of that alpha: (alpha * factor) >> 8, where the factor is
    /// 256 * value / kFadedValues, rounded down, and 256 at most.
    void (*fade)(uint8_t* values, int64_t count, uint32_t alpha);
};

/// The loops of a level.
const RampLoops& rampLoops(CpuLevel level);

}  // namespace VFontEffect::internal
