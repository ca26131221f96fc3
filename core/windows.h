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
    int64_t memoryBytes = 0;  ///< what an operator takes for any of them

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

/// What is painted in windows, in bands of rows from a window's top down.
class WindowBands {
  public:
    WindowBands() = default;
    WindowBands(const WindowBands&) = delete;
    WindowBands& operator=(const WindowBands&) = delete;

    /// Turns to a window.
    virtual void beginWindow(const Box& window) = 0;
    /// Rows of its next band; the last one may have fewer.
    virtual int64_t bandRows() const = 0;
    virtual void paintBand(const Box& band) = 0;

  protected:
    ~WindowBands() = default;
};

/// A walk through all windows of a part, that can rest after any band, or, where windows lie side by
/// side, after any row of them.
class WindowWalk {
  public:
    explicit WindowWalk(const Windows& windows) : mWindows(windows) {
        turnTo(windows.part.left, windows.part.top);
    }

    /// Goes on with all that ends above a row. Returns the row above which nothing is left.
    int64_t goAbove(int64_t limit, WindowBands& bands);

  private:
    void turnTo(int64_t left, int64_t top);
    void turnToNext();

    Windows mWindows;
    Box mWindow;    ///< empty behind the last one
    int64_t mNext;  ///< its first row that is left
    bool mHasBegun;
};

/// An effect takes about so much working memory at most, whatever the size of its picture.
constexpr int64_t kWorkingBytes = 3'900'000;

/// Cuts a part into windows of which memoryBytes(windows), what an operator of that reach takes for any
/// of them, is at most `mostBytes`, if there are any such.
///
/// What lies in reach beside a cut is worked out twice, so windows are few and not thin. Low ones are
/// best, for they are painted in long rows; from a height of some reaches on they are cut on the side
/// where that saves more memory, which for planes is the longer one. An operator that keeps some rows
/// at a time has nothing to save by low ones.
template <class MemoryBytes>
Windows windowsWithin(int64_t mostBytes, const Box& part, int64_t reach, MemoryBytes memoryBytes) {
    constexpr int64_t kReachesOfLowWindow = 8;
    Windows windows = Windows::oneOf(part);
    int64_t across = 1;
    int64_t down = 1;
    const auto inPieces = [](int64_t length, int64_t& count) {
        count += count / 8 + 1;
        return (length + count - 1) / count;
    };
    while ((windows.memoryBytes = memoryBytes(windows)) > mostBytes) {
        const int64_t narrow = memoryBytes({part, (windows.width + 1) / 2, windows.height});
        const int64_t low = memoryBytes({part, windows.width, (windows.height + 1) / 2});
        const bool staysHigh =
            windows.height > kReachesOfLowWindow * reach && low < windows.memoryBytes / 4 * 3;
        if (windows.height > 1 && (windows.width == 1 || staysHigh || low < narrow)) {
            windows.height = inPieces(part.height(), down);
        } else if (windows.width > 1) {
            windows.width = inPieces(part.width(), across);
        } else {
            break;
        }
    }
    return windows;
}

}  // namespace VFontEffect::internal
