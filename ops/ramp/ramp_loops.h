#pragma once

#include <cstdint>

#include "blend/blend_loops.h"

/// The inner loops of gradients and patterns, compiled once per level of the instruction set.
namespace VFontEffect::internal {

/// The colours of a gradient, entries 0..255, premultiplied, as pixels in memory: R, G, B, A.
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

/// Rows may be read and written this many pixels past their count where a kernel says so.
constexpr int64_t kRowSlack = 16;

/// A stretch of a ramp between two stops with straight colours 0xAARRGGBB, from `start` on.
struct RampSegment {
    uint32_t lower;
    uint32_t upper;
    float start;
    float span;
};

/// Where each column of a row is sampled: two neighbouring pattern pixels and their weights, which add
/// up to 255. A weight stands in both halves of its word.
struct ColumnTaps {
    const int32_t* near;
    const int32_t* far;
    const uint32_t* nearWeights;
    const uint32_t* farWeights;
};

/// A row of the pattern mixed along its columns, before any shift: red and blue of each pixel in one
/// plane of words, green and alpha in the other, 16 bits each, up to 255 * 255.
struct MixedRow {
    uint32_t* redBlue;
    uint32_t* greenAlpha;
};

struct RampLoops {
    /// Fill a covered box from its corner on: the job's mask is its coverage, which gates the colour.
    void (*linear)(const BlendJob& job, const LinearRamp& ramp);
    void (*radial)(const BlendJob& job, const RadialRamp& ramp);

    /// The colours of a segment at `count` positions, which may be read past their count.
    void (*mixStops)(const RampSegment& segment, const float* positions, int64_t count,
                     uint32_t* colours);

    /// Straight colours 0xAARRGGBB as premultiplied pixels in memory: R, G, B, A. Their count is a
    /// multiple of kRowSlack.
    void (*premultiplied)(const uint32_t* colours, int64_t count, uint32_t* pixels);

    /// Mixes `count` columns of a pattern row of words (memory order A, R, G, B). Rows of a pattern are
    /// read and written past their count.
    void (*mixColumns)(const uint32_t* patternRow, const ColumnTaps& taps, int64_t count,
                       const MixedRow& out);

    /// `count` pixels (R, G, B, A, premultiplied) between two mixed rows, their alpha times `opacity`.
    void (*mixRows)(const MixedRow& near, const MixedRow& far, uint32_t nearWeight, uint32_t farWeight,
                    float opacity, int64_t count, uint32_t* out);
};

/// The kernels of the chosen level.
const RampLoops& rampLoops();

}  // namespace VFontEffect::internal
