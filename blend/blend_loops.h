#pragma once

#include <cstdint>

#include "simd/cpu_level.h"

/// The inner loops of blending, compiled once per level of the instruction set.
namespace VFontEffect::internal {

/// A rectangle of a destination and what is painted there, all clipped: no check is made. Strides are in
/// bytes, counts in pixels. Destination and image have 4 bytes a pixel, the mask has 1. A loop reads
/// what its name says and leaves the rest alone.
struct BlendJob {
    uint8_t* destination;
    int64_t destinationStride;
    const uint8_t* image;
    int64_t imageStride;
    const uint8_t* mask;
    int64_t maskStride;
    int64_t width;
    int64_t height;
    uint32_t color;  // 0xAARRGGBB
};

using BlendLoop = void (*)(const BlendJob& job);

struct BlendLoops {
    // One colour through the mask.
    BlendLoop srcOverMask;
    BlendLoop dstOverMask;
    BlendLoop dstOverGate;
    BlendLoop dstOverClip;
    BlendLoop solidColour;
    // The image: words 0xAARRGGBB, or bytes in the order of the name.
    BlendLoop srcOverWords;
    BlendLoop dstOverWords;
    BlendLoop dstOverArgb;
    BlendLoop dstOverRgba;
    // The image of bytes R, G, B, A and the mask.
    BlendLoop dstOverWhereCovered;
    BlendLoop mixByCoverage;
    // The mask into a destination of 1 byte a pixel.
    BlendLoop maxCoverage;
};

/// The loops of a level.
const BlendLoops& blendLoops(CpuLevel level);

}  // namespace VFontEffect::internal
