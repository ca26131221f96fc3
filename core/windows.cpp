#include "core/windows.h"

namespace VFontEffect::internal {

int64_t WindowWalk::goAbove(int64_t limit, WindowBands& bands) {
    for (; !mWindow.empty(); turnToNext()) {
        if (limit <= mNext) return limit;
        if (mWindows.areCutAcross() && limit < mWindow.bottom) return mNext;
        if (!mHasBegun) bands.beginWindow(mWindow);
        mHasBegun = true;
        while (mNext < mWindow.bottom) {
            const int64_t end = std::min(mNext + bands.bandRows(), mWindow.bottom);
            if (end > limit) return mNext;
            bands.paintBand({mWindow.left, mNext, mWindow.right, end});
            mNext = end;
        }
    }
    return limit;
}

void WindowWalk::turnTo(int64_t left, int64_t top) {
    mWindow = intersection(mWindows.part, {left, top, left + mWindows.width, top + mWindows.height});
    mNext = top;
    mHasBegun = false;
}

void WindowWalk::turnToNext() {
    const bool isLast = mWindow.right == mWindows.part.right;
    turnTo(isLast ? mWindows.part.left : mWindow.right, isLast ? mWindow.bottom : mWindow.top);
}

}  // namespace VFontEffect::internal
