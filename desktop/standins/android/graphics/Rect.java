package android.graphics;

/**
 * Desktop stand-in for Android's class of the same name: the four fields that the native library
 * reads and writes by name, and what tests and tables need.
 *
 * <p>Deliberate: the constructor takes left, top, right, bottom, as on Android, while the library
 * lists its fields as left, right, top, bottom and counts {@code right} and {@code bottom} in.
 * Android's own methods, which count them out, are left away.
 */
public class Rect {
    /** First column. */
    public int left;

    /** First row. */
    public int top;

    /** Last column. */
    public int right;

    /** Last row. */
    public int bottom;

    /** Makes a rectangle with all fields 0. */
    public Rect() {}

    /**
     * Makes a rectangle; no order of the values is enforced.
     *
     * @param left first column
     * @param top first row
     * @param right last column
     * @param bottom last row
     */
    public Rect(int left, int top, int right, int bottom) {
        this.left = left;
        this.top = top;
        this.right = right;
        this.bottom = bottom;
    }

    @Override
    public boolean equals(Object other) {
        if (!(other instanceof Rect)) return false;
        Rect that = (Rect) other;
        return left == that.left && top == that.top && right == that.right && bottom == that.bottom;
    }

    @Override
    public int hashCode() {
        return ((31 * left + top) * 31 + right) * 31 + bottom;
    }

    @Override
    public String toString() {
        return "Rect(" + left + ", " + top + " - " + right + ", " + bottom + ")";
    }
}
