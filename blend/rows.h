#pragma once

#include <cstdint>
#include <cstring>

#include "blend/kernels.h"
#include "blend/rules.h"

/// The row driver of all blending kernels: the loop over rows and pixels, empty stretches, and the tail.
///
/// A painter gives the pixels that belong at a place of a row: `paint(place)`. It also tells what an
/// empty stretch (`isEmpty(place)`, kBytes pixels long) leaves there, if it can tell at all, and may
/// know stretches that it paints quicker as a whole (`paintWhole(place)`, which returns whether it has
/// done so).
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

/// Whether `kCount` bytes are 0.
template <int64_t kCount>
VOREL_INLINE bool allZero(const uint8_t* bytes) {
    if (kCount == kBytes) return allZero(load<Bytes>(bytes));
    static constexpr uint8_t kNone[kCount] = {};
    return std::memcmp(bytes, kNone, kCount) == 0;
}

/// Whether the mask is 0 for kBytes pixels.
VOREL_INLINE bool hasEmptyMask(const Place& place) {
    return allZero<kBytes>(place.mask());
}

/// Whether the mask is full for kBytes pixels.
VOREL_INLINE bool hasFullMask(const Place& place) {
    return allZero(~load<Bytes>(place.mask()));
}

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

/// Pixels from `destination` to the next address where a vector lies within one line of the cache.
VOREL_INLINE int64_t pixelsToAlignment(const uint8_t* destination) {
    return static_cast<int64_t>((0 - reinterpret_cast<uintptr_t>(destination)) / 4 % kPixels);
}

/// Paints pixels x to `end`, in whole vectors.
template <class Painter>
VOREL_INLINE void paintVectors(const Painter& painter, const Row& row, int64_t x, int64_t end) {
    for (; x < end; x += kPixels) {
        const Place place = {row, x};
        storePixels(place.destination(), painter.paint(place));
    }
}

/// Paints from `x` on, in whole vectors, as far as `end`, and leaves empty stretches early.
template <class Painter>
VOREL_INLINE void paintStretches(const Painter& painter, const Row& row, int64_t x, int64_t end) {
    for (; end - x >= kBytes; x += kBytes) {
        if (painter.isEmpty({row, x})) {
            paintEmpty(Painter::kEmpty, {row, x});
        } else if (!painter.paintWhole({row, x})) {
            paintVectors(painter, row, x, x + kBytes);
        }
    }
    paintVectors(painter, row, x, end);
}

/// The first and the last vector begin and end with the row, and the loop between them keeps to whole
/// lines of the cache: the three overlap. So the two are computed from what the row held before, and
/// stored when the loop is done.
template <class Painter>
VOREL_INLINE void paintRow(const Painter& painter, const Row& row, int64_t count) {
    if (kPixels > 1 && count < kPixels) return paintShortRow(painter, row, count);
    const Place first = {row, 0};
    const Place last = {row, count - kPixels};
    const Pixels firstPixels = painter.paint(first);
    const Pixels lastPixels = painter.paint(last);
    paintStretches(painter, row, pixelsToAlignment(row.destinationStart), last.x);
    storePixels(first.destination(), firstPixels);
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
