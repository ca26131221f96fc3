#pragma once

#include <cstdint>

#include "simd/cpu_level.h"

/// The inner loops of tiled patterns, compiled once per level of the instruction set.
namespace VFontEffect::internal {

/// Rows of a pattern are read and written in whole vectors: up to so many pixels past their count.
constexpr int64_t kTileSlack = kWidestVector / 4;

/// Where each column of a row is sampled: two neighbouring pattern pixels and their weights, which add
/// up to 255. A weight stands in both 16-bit lanes of its word.
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

struct TileLoops {
    /// Mixes `count` columns of a pattern row of words (memory order A, R, G, B). Taps and `out`
    /// have slack.
    void (*mixColumns)(const uint32_t* patternRow, const ColumnTaps& taps, int64_t count,
                       const MixedRow& out);

    /// `count` pixels (R, G, B, A, premultiplied) between two mixed rows, their alpha times `opacity`.
    void (*mixRows)(const MixedRow& near, const MixedRow& far, uint32_t nearWeight, uint32_t farWeight,
                    float opacity, int64_t count, uint32_t* out);
};

/// The loops of a level.
const TileLoops& tileLoops(CpuLevel level);

}  // namespace VFontEffect::internal
