#pragma once

#include <algorithm>
#include <cstdint>

#include "core/box.h"

namespace VFontEffect::internal {

/// A part of a picture, cut into windows of one size but for the last ones of each row and column.
struct Windows {
    Box part;
    int64_t width;
    int64_t height;

    static Windows oneOf(const Box& part) { return {part, part.width(), part.height()}; }

    bool areCutAcross() const { return width < part.width(); }
    bool areCutDown() const { return height < part.height(); }

    /// Calls paint(window) for each, row after row.
    template <class Paint>
    void forEach(Paint paint) const {
        for (int64_t y = part.top; y < part.bottom; y += height) {
            for (int64_t x = part.left; x < part.right; x += width)
                paint(intersection(part, {x, y, x + width, y + height}));
        }
    }
};

/// An effect takes about so much working memory at most, whatever the size of its picture.
constexpr int64_t kWorkingBytes = 3'900'000;

/// Cuts a part into windows of which memoryBytes(windows), what an operator takes for any of them, is at
/// most `mostBytes`. A cut costs twice what lies in the operator's reach beside it, so the windows are
/// few, and are cut on the side where that saves more: both sides of what is kept as a plane come out
/// alike, and what is kept as some rows of a window stays as high as it is.
template <class MemoryBytes>
Windows windowsWithin(int64_t mostBytes, const Box& part, MemoryBytes memoryBytes) {
    Windows windows = Windows::oneOf(part);
    int64_t across = 1;
    int64_t down = 1;
    const auto inPieces = [](int64_t length, int64_t& count) {
        count += count / 8 + 1;
        return (length + count - 1) / count;
    };
    while (memoryBytes(windows) > mostBytes && (windows.width > 1 || windows.height > 1)) {
        const Windows narrow = {part, (windows.width + 1) / 2, windows.height};
        const Windows low = {part, windows.width, (windows.height + 1) / 2};
        const bool cutsAcross = windows.width > 1 && memoryBytes(narrow) <= memoryBytes(low);
        if (cutsAcross || windows.height == 1) {
            windows.width = inPieces(part.width(), across);
        } else {
            windows.height = inPieces(part.height(), down);
        }
    }
    return windows;
}

}  // namespace VFontEffect::internal
