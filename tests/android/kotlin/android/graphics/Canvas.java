package android.graphics;

/** Stands in for Android's canvas: text is the block that Paint tells of. */
public class Canvas {
    private final Bitmap bitmap;

    public Canvas(Bitmap bitmap) {
        this.bitmap = bitmap;
    }

    public void drawText(String text, float x, float y, Paint paint) {
        for (int row = (int) y - 10; row < (int) y; ++row) {
            for (int column = (int) x; column < (int) x + 20; ++column) {
                bitmap.memory.put(row * bitmap.getRowBytes() + column, (byte) 255);
            }
        }
    }
}
