#pragma once

#include <cstdint>
#include <cstring>

#include "blend/blend_loops.h"
#include "blend/rules.h"
#include "core/assert.h"

/// The row driver of all blending loops: over rows and pixels, empty stretches, and the tail.
///
/// A painter gives the pixels that belong at a place of a row: `paint(place)`. It also tells empty
/// stretches (`isEmpty<pixels>(place)`, kBytes or kPixels of them), which leave there what its kEmpty
/// says. Where kIsSparse even vectors of other stretches are mostly empty: so it is between the strokes
/// of glyphs, not in their shadows, where asking costs more than it saves. A painter may know stretches
/// of kBytes pixels that it paints quicker as a whole (`paintWhole(place)`, which returns whether it has
/// done so).
namespace VFontEffect::internal::VOREL_LEVEL {

/// The planes of one row; those that a painter does not read may be null.
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

/// Whether the mask is 0 for kCount pixels.
template <int64_t kCount>
VOREL_INLINE bool hasEmptyMask(const Place& place) {
    if constexpr (kCount == kBytes) return allZero(load<U8s>(place.mask()));
    static constexpr uint8_t kNone[kCount] = {};
    return std::memcmp(place.mask(), kNone, kCount) == 0;
}

/// Whether the mask is full for kBytes pixels.
VOREL_INLINE bool hasFullMask(const Place& place) {
    return allZero(~load<U8s>(place.mask()));
}

/// Whether kCount pixels are nothing but zeros; the first of them mostly tell.
template <int64_t kCount>
VOREL_INLINE bool isClear(const uint8_t* pixels) {
    U8s all = load<U8s>(pixels);
    if (!allZero(all)) return false;
    for (int64_t i = kBytes; i < 4 * kCount; i += kBytes)
        all |= load<U8s>(pixels + i);
    return allZero(all);
}

/// What a painter says whose mask tells what is empty.
template <Empty kWhatEmptyDoes = Empty::keeps, bool kSparse = false, bool kImage = false>
struct MaskReader {
    static constexpr bool kReadsImage = kImage;
    static constexpr bool kReadsMask = true;
    static constexpr bool kIsSparse = kSparse;
    static constexpr Empty kEmpty = kWhatEmptyDoes;

    template <int64_t kCount>
    VOREL_INLINE bool isEmpty(const Place& place) const {
        return hasEmptyMask<kCount>(place);
    }
    VOREL_INLINE bool paintWhole(const Place&) const { return false; }
};

/// Paints a whole stretch of kBytes pixels that is empty. What is clear already is not written: lines of
/// the cache that stay as they are need not be written back.
VOREL_INLINE void paintEmpty(Empty what, const Place& place) {
    if (what == Empty::clears && !isClear<kBytes>(place.destination()))
        std::memset(place.destination(), 0, 4 * kBytes);
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

/// What belongs at a place where much is empty: worth a look.
template <class Painter>
VOREL_INLINE Pixels sparsePixels(const Painter& painter, const Place& place) {
    if (!painter.template isEmpty<kPixels>(place)) return painter.paint(place);
    if (Painter::kEmpty == Empty::clears) return Pixels{};
    return loadPixels(Painter::kEmpty == Empty::copiesImage ? place.image() : place.destination());
}

/// Paints from `x` on, in whole vectors, as far as `end`, and leaves empty stretches early. The last
/// vector may hang over the end, and so may a stretch that is no longer.
template <class Painter>
VOREL_INLINE void paintStretches(const Painter& painter, const Row& row, int64_t x, int64_t end) {
    constexpr int64_t kFewest = kPixels < kBytes ? kBytes : 1;
    for (; end - x >= kFewest; x += kBytes) {
        if (painter.template isEmpty<kBytes>({row, x})) {
            paintEmpty(Painter::kEmpty, {row, x});
        } else if (!painter.paintWhole({row, x})) {
            for (int64_t at = x; at < x + kBytes; at += kPixels) {
                const Place place = {row, at};
                storePixels(place.destination(),
                            Painter::kIsSparse ? sparsePixels(painter, place) : painter.paint(place));
            }
        }
    }
    for (; x < end; x += kPixels)
        storePixels(Place{row, x}.destination(), sparsePixels(painter, {row, x}));
}

/// Whether the loop keeps to whole lines of the cache. Planar pixels are taken apart and put together as
/// they are loaded and stored, which hides where they lie.
constexpr bool kKeepsToLines = kPixels > 1 && kPixels < kBytes;

/// The first and the last vector begin and end with the row, and the loop between them may keep to whole
/// lines of the cache: the three overlap.
///
///     row        |abcdefghijklmnopqrstuvwxyz|
///     first      |abcdefgh|
///     loop           |efghijkl|mnopqrst|       from a line's start on, while a vector starts before the
///     last last                         |stuvwxyz|
///
/// Blending the same pixel twice would change it. So the two are computed from what the row held before,
/// and stored when the loop is done.
template <class Painter>
VOREL_INLINE void paintRow(const Painter& painter, const Row& row, int64_t count) {
    if (kPixels > 1 && count < kPixels) return paintShortRow(painter, row, count);
    const Place last = {row, count - kPixels};
    const Pixels lastPixels = sparsePixels(painter, last);
    if constexpr (kKeepsToLines) {
        const Pixels firstPixels = sparsePixels(painter, {row, 0});
        paintStretches(painter, row, pixelsToAlignment(row.destinationStart), last.x);
        storePixels(row.destinationStart, firstPixels);
    } else {
        paintStretches(painter, row, 0, last.x);
    }
    storePixels(last.destination(), lastPixels);
}

template <class Painter>
VOREL_INLINE void paintRows(const Painter& painter, const BlendJob& job) {
    if (job.width <= 0) return;
    VOREL_ASSERT(job.destination != nullptr && (!Painter::kReadsImage || job.image != nullptr) &&
                 (!Painter::kReadsMask || job.mask != nullptr));
    for (int64_t y = 0; y < job.height; ++y) {
        const Row row = {job.destination + y * job.destinationStride,
                         Painter::kReadsImage ? job.image + y * job.imageStride : nullptr,
                         Painter::kReadsMask ? job.mask + y * job.maskStride : nullptr};
        paintRow(painter, row, job.width);
    }
}

}  // namespace VFontEffect::internal::VOREL_LEVEL
