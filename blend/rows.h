#pragma once

#include <cstdint>
#include <cstring>

#include "blend/kernels.h"
#include "blend/rules.h"

/// The row driver of all blending kernels: the loop over rows and pixels, empty stretches, and the tail.
///
/// A painter gives the pixels that belong at a place of a row: `paint(place)`. It also tells what an
/// empty stretch (`isEmpty(place)`, kBytes pixels long) leaves there, if it can tell at all.
namespace VFontEffect::internal::VOREL_LEVEL {

/// The planes of one row; those that a kernel does not read may be null.
struct Row {
    uint8_t* destinationStart;
    const uint8_t* imageStart;
    const uint8_t* maskStart;
};

/// A pixel of a row.
struct Place {
    Row row;
    int64_t x;

    VOREL_INLINE uint8_t* destination() const { return row.destinationStart + 4 * x; }
    VOREL_INLINE const uint8_t* image() const { return row.imageStart + 4 * x; }
    VOREL_INLINE const uint8_t* mask() const { return row.maskStart + x; }
};

/// Paints a whole stretch of kBytes pixels that is empty.
VOREL_INLINE void paintEmpty(Empty what, const Place& place) {
    if (what == Empty::clears) std::memset(place.destination(), 0, 4 * kBytes);
    if (what == Empty::copiesImage) std::memcpy(place.destination(), place.image(), 4 * kBytes);
}

/// A row narrower than a vector goes through copies of a vector's length.
template <class Painter>
VOREL_INLINE void paintShortRow(const Painter& painter, const Row& row, int64_t count) {
    uint8_t destination[4 * kPixels] = {};
    uint8_t image[4 * kPixels] = {};
    uint8_t mask[kPixels] = {};
    const auto pixels = static_cast<size_t>(count);
    std::memcpy(destination, row.destinationStart, 4 * pixels);
    if (Painter::kReadsImage) std::memcpy(image, row.imageStart, 4 * pixels);
    if (Painter::kReadsMask) std::memcpy(mask, row.maskStart, pixels);
    storePixels(destination, painter.paint({{destination, image, mask}, 0}));
    std::memcpy(row.destinationStart, destination, 4 * pixels);
}

/// The last vector ends with the row, over pixels that the loop painted too: it is computed from what
/// the row held before, and stored when the loop is done.
template <class Painter>
VOREL_INLINE void paintRow(const Painter& painter, const Row& row, int64_t count) {
    if (count < kPixels) return paintShortRow(painter, row, count);
    const Place last = {row, count - kPixels};
    const Pixels lastPixels = painter.paint(last);
    int64_t x = 0;
    while (x < last.x) {
        int64_t stretchEnd = last.x;
        if (last.x - x >= kBytes) {
            stretchEnd = x + kBytes;
            if (painter.isEmpty({row, x})) {
                paintEmpty(Painter::kEmpty, {row, x});
                x = stretchEnd;
                continue;
            }
        }
        for (; x < stretchEnd; x += kPixels) {
            const Place place = {row, x};
            storePixels(place.destination(), painter.paint(place));
        }
    }
    storePixels(last.destination(), lastPixels);
}

template <class Painter>
VOREL_INLINE void paintRows(const Painter& painter, const BlendJob& job) {
    if (job.width <= 0) return;
    for (int64_t y = 0; y < job.height; ++y) {
        const Row row = {job.destination + y * job.destinationStride,
                         Painter::kReadsImage ? job.image + y * job.imageStride : nullptr,
                         Painter::kReadsMask ? job.mask + y * job.maskStride : nullptr};
        paintRow(painter, row, job.width);
    }
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
