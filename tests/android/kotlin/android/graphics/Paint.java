package android.graphics;

/** Stands in for Android's paint: its text is a block of 20 x 10 pixels on the base line. */
public class Paint {
    public static final int ANTI_ALIAS_FLAG = 1;

    private float textSize = 12;

    public Paint(int flags) {}

    public float getTextSize() {
        return textSize;
    }

    public void setTextSize(float size) {
        textSize = size;
    }

    public void getTextBounds(String text, int start, int end, Rect bounds) {
        bounds.left = 0;
        bounds.top = text.isEmpty() ? 0 : -10;
        bounds.right = text.isEmpty() ? 0 : 20;
        bounds.bottom = 0;
    }
}
