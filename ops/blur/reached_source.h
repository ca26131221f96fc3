#pragma once

#include <cstdint>

#include "core/box.h"
#include "cores/paint_input.h"
#include "ops/blur/dot_loops.h"

namespace VFontEffect::internal {

/// A part of a picture, in the coordinates of what is blurred.
using Box = Box;

/// Columns before the one and from the other on count as 255 between the passes.
struct FullColumns {
    int64_t before;
    int64_t from;
};
/// Farther away than any column is, but not so far that places could not be taken from it.
constexpr FullColumns kNoFullColumns = {INT64_MIN / 2, INT64_MAX / 2};

/// The coverage of a box.
inline BlurSource sourceOf(const CoverageBox& box) {
    return {box.row(0), box.mask.width, box.width, box.height, 0};
}

/// The part of a source that the results in a window depend on, and its place in the source.
struct ReachedSource {
    BlurSource part;
    int64_t left;
    int64_t top;

    static ReachedSource of(const BlurSource& source, int64_t radius, const Box& window);
};

}  // namespace VFontEffect::internal
