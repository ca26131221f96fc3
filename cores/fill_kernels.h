#pragma once

#include <cstdint>

#include "blend/kernels.h"

/// The inner loops of gradients and patterns, compiled once per level of the instruction set.
namespace VFontEffect::internal {

/// The clipped part of a covered box: the job's mask is its coverage, which gates the colour. `left` and
/// `top` are the part's place in the box.
struct FillJob {
    BlendJob blend;
    int64_t left;
    int64_t top;
};

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

/// Two neighbouring pattern pixels on one axis and their weights, which add up to 255.
struct Tap {
    uint32_t near;
    uint32_t far;
    uint32_t nearWeight;
    uint32_t farWeight;
};

/// One row of the pattern between two of its rows, before the shift: 4 channels a pixel, A, R, G, B,
/// each up to 255 * 255.
using MixedRow = uint16_t*;

struct FillKernels {
    void (*linear)(const FillJob& job, const LinearRamp& ramp);
    void (*radial)(const FillJob& job, const RadialRamp& ramp);

    /// near * nearWeight + far * farWeight for each of `bytes` bytes.
    void (*mixRows)(const uint8_t* near, const uint8_t* far, const Tap& weights, int64_t bytes,
                    MixedRow out);

    /// The pixels (R, G, B, A, premultiplied) of `count` taps along a mixed row; `alphas` gives each
    /// alpha its value at the pattern's opacity.
    void (*sampleRow)(const uint16_t* mixed, const Tap* taps, int64_t count, const uint8_t* alphas,
                      uint32_t* out);
};

/// The kernels of the chosen level.
const FillKernels& fillKernels();

}  // namespace VFontEffect::internal
