package android.graphics;

/** Stand-in for Android's class of this name: pixels 0xAARRGGBB. */
public final class Bitmap {
    /** How a pixel is kept. */
    public enum Config { ARGB_8888 }

    private final int width;
    private final int height;
    private final int[] kept;

    private Bitmap(int width, int height) {
        this.width = width;
        this.height = height;
        kept = new int[width * height];
    }

    public static Bitmap createBitmap(int width, int height, Config config) {
        return new Bitmap(width, height);
    }

    public int getWidth() {
        return width;
    }

    public int getHeight() {
        return height;
    }

    public void getPixels(int[] pixels, int offset, int stride, int x, int y, int columns,
            int rows) {
        for (int row = 0; row < rows; ++row) {
            System.arraycopy(kept, (y + row) * width + x, pixels, offset + row * stride, columns);
        }
    }

    public void setPixels(int[] pixels, int offset, int stride, int x, int y, int columns,
            int rows) {
        for (int row = 0; row < rows; ++row) {
            System.arraycopy(pixels, offset + row * stride, kept, (y + row) * width + x, columns);
        }
    }
}
