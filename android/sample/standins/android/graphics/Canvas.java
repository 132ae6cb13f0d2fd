package android.graphics;

/** Stand-in for Android's class of this name: it keeps the bitmap that was drawn last. */
public class Canvas {
    private Bitmap drawn;

    public void drawBitmap(Bitmap bitmap, float left, float top, Paint paint) {
        drawn = bitmap;
    }

    /** Returns the bitmap that was drawn last, or null. */
    public Bitmap drawn() {
        return drawn;
    }
}
