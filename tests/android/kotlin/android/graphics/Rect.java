package android.graphics;

/** Stands in for Android's rectangle. */
public final class Rect {
    public int left;
    public int top;
    public int right;
    public int bottom;

    public boolean isEmpty() {
        return left >= right || top >= bottom;
    }

    public int width() {
        return right - left;
    }

    public int height() {
        return bottom - top;
    }

    public void inset(int dx, int dy) {
        left += dx;
        top += dy;
        right -= dx;
        bottom -= dy;
    }
}
