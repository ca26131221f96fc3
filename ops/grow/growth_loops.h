#pragma once

#include <cstdint>

#include "simd/cpu_level.h"

/// The inner loops of growth, compiled once per level of the instruction set.
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
};

constexpr int64_t kGrowthMargin = 64;

/// What is skipped where nothing changes any more: so many rows of one vector each.
constexpr int64_t kGrowthTileRows = 16;
constexpr int64_t kNarrowestGrowthTile = 4;

inline int64_t growthTileBytes(int64_t width, int64_t height) {
    return 2 * (width / kNarrowestGrowthTile + 3) * (height / kGrowthTileRows + 3);
}

struct GrowthLoops {
    /// Copies `count` bytes, each ^ invertMask.
    void (*copyInverted)(const uint8_t* from, int64_t count, uint8_t invertMask, uint8_t* to);
    /// Grows plane 0 by turns; the result is in plane `passes` % 2. `tiles` is working memory of
    /// growthTileBytes(width, height).
    void (*grow)(const GrowthJob& job, uint8_t* tiles);
};

/// The loops of a level.
const GrowthLoops& growthLoops(CpuLevel level);

}  // namespace VFontEffect::internal
