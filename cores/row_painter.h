#pragma once

#include <algorithm>
#include <cstdint>
#include <optional>

#include "core/box.h"
#include "core/float_state.h"
#include "core/windows.h"
#include "cores/placed_target.h"

namespace VFontEffect::internal {

/// Below every row, but not so far that places could not be taken from it.
constexpr int64_t kAllRows = INT64_MAX / 2;

/// An effect that paints from the top of a picture down, as far as it is asked to. What it needs is made
/// with it, and stays until all is painted: effects can take turns without doing anything twice.
///
/// paintAbove(limit) of each goes on with what lies above row `limit` of the targets, and paints nothing
/// below it. It returns the row above which nothing is left, which may lie above `limit`: some effects
/// paint bands of several rows, which wait until all of a band may be painted.
class RowPainter {
  public:
    RowPainter() = default;
    RowPainter(const RowPainter&) = delete;
    RowPainter& operator=(const RowPainter&) = delete;
};

/// Such an effect that paints a part of a picture in windows.
class WindowPainter : public WindowBands {
  public:
    int64_t paintAbove(int64_t limit) {
        if (!mWalk) return limit;
        return mTarget.destinationRow(mWalk->goAbove(mTarget.ownRow(limit), *this));
    }

  protected:
    /// The target, or what it is made of. Without windows it paints nothing.
    template <class... Target>
    explicit WindowPainter(const Target&... target) : mTarget(target...) {}
    ~WindowPainter() = default;

    /// In the coordinates of the picture that lies on the target.
    void setWindows(const Windows& windows) { mWalk.emplace(windows); }

    PlacedTarget mTarget;

  private:
    std::optional<WindowWalk> mWalk;
};

/// The part that an effect has not painted yet.
class RemainingRows {
  public:
    explicit RemainingRows(const Box& part) : mPart(part) {}

    /// What of it lies above a row. It counts as painted from now on.
    Box takenAbove(int64_t row) {
        Box taken = mPart;
        taken.bottom = std::min(row, taken.bottom);
        mPart.top = std::max(taken.top, taken.bottom);
        return taken;
    }

  private:
    Box mPart;
};

/// Paints all that an effect has to paint. Its begin() makes a painter if there is anything to paint,
/// with all memory that it needs, and returns false when there is none.
template <class Painter, class... Arguments>
void paintAll(const Arguments&... arguments) {
    const OwnFloatState floatState;
    std::optional<Painter> painter;
    if (begin(painter, arguments...) && painter) painter->paintAbove(kAllRows);
}

}  // namespace VFontEffect::internal
