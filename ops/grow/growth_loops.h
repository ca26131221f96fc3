#pragma once

#include <cstdint>

#include "blend/blend_loops.h"

/// The inner loops of the glows, compiled once per level of the instruction set.
namespace VFontEffect::internal {

/// Coverage that grows, in two planes of the same shape that take turns: `height` rows of `width` bytes
/// and a frame of one byte around them, which stays as it is. Rows are read and written in whole
/// vectors: from the frame's byte before a row to kGrowthMargin bytes behind it, where the frame is
/// `behind` and they are written as that.
struct GrowthJob {
    uint8_t* planes[2];  // of row 0, column 0
    int64_t stride;
    int64_t width;
    int64_t height;
    uint8_t behind;
    int passes;
    uint8_t* tiles;  // working memory of growthTileBytes(width, height)
};

constexpr int64_t kGrowthMargin = 64;

/// What is skipped where nothing changes any more: squares of 16 pixels, or wider at some levels.
constexpr int64_t kGrowthTile = 16;

inline int64_t growthTileBytes(int64_t width, int64_t height) {
    return 2 * (width / kGrowthTile + 3) * (height / kGrowthTile + 3);
}

/// The job's mask is blurred coverage, and `pixels` has the colour of each value as the pixel in memory:
/// R, G, B, A.
struct GlowJob {
    BlendJob blend;
    const uint32_t* pixels;
};

/// Weaker values than this fade.
constexpr uint32_t kFadedValues = 180;

struct GrowthLoops {
    /// Copies `count` bytes, each ^ invertMask.
    void (*copyInverted)(const uint8_t* from, int64_t count, uint8_t invertMask, uint8_t* to);
    /// Grows plane 0 by turns; the result is in plane `passes` % 2.
    void (*grow)(const GrowthJob& job);
    /// Makes blurred values the alphas of a glow of that alpha: (alpha * factor) >> 8, where the factor
    /// is 256 * value / kFadedValues, rounded down, and 256 at most.
    void (*fade)(uint8_t* values, int64_t count, uint32_t alpha);
    /// The values' colours beneath the destination. That of 0 must be transparent.
    void (*paint)(const GlowJob& job);
};

/// The kernels of the chosen level.
const GrowthLoops& growthLoops();

}  // namespace VFontEffect::internal
