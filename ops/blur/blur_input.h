#pragma once

#include <cstdint>

#include "core/box.h"
#include "core/coverage_rows.h"
#include "core/windows.h"
#include "ops/blur/blur_weights.h"

namespace VFontEffect::internal {

/// Columns before the one and from the other on count as 255 between the passes.
struct FullColumns {
    int64_t before;
    int64_t from;
};
/// Farther away than any column is, but not so far that places could not be taken from it.
constexpr FullColumns kNoFullColumns = {INT64_MIN / 2, INT64_MAX / 2};

/// What is blurred, and how. Each of the two passes drops the rest of its division, so their order is
/// part of the result.
struct BlurInput {
    enum class Order { downThenAcross, acrossThenDown };

    const BlurWeights& weights;  // for the plan's making only
    CoverageRows source;
    Box window;  // what is wanted of the results, in the source's coordinates; not empty
    Order order;
    FullColumns full;
    PassEnding first;
    PassEnding second;

    /// Down the columns of the source, then across its rows, each pass rounding down. Around the source
    /// is 0, but for the full columns. `inverted` gives 255 minus the mean of the second pass, rounded
    /// down as a whole: the mean rounded up, inverted.
    static BlurInput down(const BlurWeights& weights, const CoverageRows& source, const Box& window,
                          const FullColumns& full, bool inverted) {
        const PassEnding second = {inverted, inverted ? kInverse : kAsIs};
        return {weights, source, window, Order::downThenAcross, full, {false, kAsIs}, second};
    }

    /// Across the rows of the source's inverse, then down its columns, each pass rounding down. Around
    /// the source is 255 in its inverse. 255 minus a mean that is rounded down is the mean of the
    /// inverse rounded up: both passes work on what is missing from 255, which is 0 around the source,
    /// and round up, and the second gives 255 minus its result.
    static BlurInput inverseAcross(const BlurWeights& weights, const CoverageRows& source,
                                   const Box& window) {
        return {weights,        source,        window,          Order::acrossThenDown,
                kNoFullColumns, {true, kAsIs}, {true, kInverse}};
    }

    /// The same blur of a part of its window.
    BlurInput of(const Box& part) const { return {weights, source, part, order, full, first, second}; }

    /// One that takes as much memory as that of any of the windows that its own is cut into. Its source
    /// has sizes alone. A vector and a group more make up for where in them a window begins.
    BlurInput largestOf(const Windows& windows) const {
        BlurInput largest = *this;
        const int64_t around = weights.radius;
        if (windows.areCutAcross()) {
            largest.window.left = around;
            largest.window.right = around + windows.width + kWidestVector;
            largest.source.width = largest.window.right + around;
            const Box reach = expanded(window, around);
            if (full.before > reach.left || full.from < reach.right) largest.full.before = around + 1;
        }
        if (windows.areCutDown()) {
            largest.window.top = around;
            largest.window.bottom = around + windows.height + kQuad;
            largest.source.height = largest.window.bottom + around;
        }
        return largest;
    }
};

/// The part of a source that the results in a window depend on, and its place in the source.
struct ReachedSource {
    CoverageRows part;
    int64_t left;
    int64_t top;

    /// Where the window reaches no part there is an empty one, at the reach's upper left corner.
    static ReachedSource of(const BlurInput& input) {
        const Box reach = expanded(input.window, input.weights.radius);
        const Box common = intersection(reach, wholeOf(input.source));
        ReachedSource reached = {input.source, reach.left, reach.top};
        reached.part.width = reached.part.height = 0;
        if (common.empty()) return reached;
        reached.part.start += common.top * input.source.stride + common.left;
        reached.part.width = common.width();
        reached.part.height = common.height();
        reached.left = common.left;
        reached.top = common.top;
        return reached;
    }
};

/// Rows of results, `stride` bytes apart.
struct BlurredRows {
    uint8_t* values;
    int64_t stride;
};

}  // namespace VFontEffect::internal
