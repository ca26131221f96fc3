#include <algorithm>
#include <cstdint>
#include <cstring>

#include "core/box.h"
#include "cores/glow.h"
#include "ops/grow/growth_plan.h"

namespace VFontEffect::internal {
namespace {

/// A packed plane of bytes.
struct Picture {
    uint8_t* bytes;
    int64_t width;
    int64_t height;

    uint8_t* at(int64_t x, int64_t y) const { return bytes + y * width + x; }
};

/// The first place from `x` to `end` - 1 that is not 0, or end.
int64_t firstCovered(const uint8_t* row, int64_t x, int64_t end) {
    uint64_t eight = 0;
    for (; x + 8 <= end; x += 8) {
        std::memcpy(&eight, row + x, sizeof eight);
        if (eight != 0) break;
    }
    while (x < end && row[x] == 0)
        ++x;
    return x;
}

/// One place behind the last from `x` to `end` - 1 that is not 0, or x.
int64_t coveredEnd(const uint8_t* row, int64_t x, int64_t end) {
    uint64_t eight = 0;
    for (; x + 8 <= end; end -= 8) {
        std::memcpy(&eight, row + end - 8, sizeof eight);
        if (eight != 0) break;
    }
    while (end > x && row[end - 1] == 0)
        --end;
    return end;
}

/// The smallest box around what is not 0.
Box coveredPart(const Picture& picture) {
    Box covered = {picture.width, picture.height, 0, 0};
    for (int64_t y = 0; y < picture.height; ++y) {
        const uint8_t* const row = picture.at(0, y);
        const int64_t first = firstCovered(row, 0, picture.width);
        if (first == picture.width) continue;
        covered = {std::min(covered.left, first), std::min(covered.top, y),
                   std::max(covered.right, coveredEnd(row, first, picture.width)), y + 1};
    }
    return covered;
}

/// Deliberate: the first and the last column count as 0 after a pass, but for their ends.
void clearEndColumns(const Picture& picture) {
    for (int64_t y = 1; y < picture.height - 1; ++y)
        *picture.at(0, y) = *picture.at(picture.width - 1, y) = 0;
}

}  // namespace

// What is not 0 spreads by a pixel a pass: the part that changes lies within `passes` pixels of it.
void growByBoxFilter(CpuLevel level, unsigned char* mask, int passes, int width, int height) {
    if (mask == nullptr || passes < 1 || width < 1 || height <= 2) return;
    const Picture picture = {mask, width, height};
    const Box inner = {1, 1, int64_t{width} - 1, int64_t{height} - 1};
    const Box part = intersection(expanded(coveredPart(picture), passes), inner);
    if (part.empty()) return clearEndColumns(picture);
    const CoverageRows framed = {picture.at(part.left - 1, part.top - 1), width, part.width() + 2,
                                 part.height() + 2, kAsIs};
    const GrowthInput input = {framed, -1, passes};
    GrowthPlan plan(level, input, part.width(), part.height());
    if (!plan) return;
    const CoverageRows grown = plan.grown(input.whole());
    for (int64_t y = 0; y < grown.height; ++y) {
        std::memcpy(picture.at(part.left, part.top + y), grown.start + y * grown.stride,
                    static_cast<size_t>(grown.width));
    }
    clearEndColumns(picture);
}

}  // namespace VFontEffect::internal
