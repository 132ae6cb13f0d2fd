package android.graphics;

/**
 * Desktop stand-in for Android's class of the same name: the two fields that the native library
 * reads by name, and what tests and tables need.
 */
public class Point {
    /** Column. */
    public int x;

    /** Row. */
    public int y;

    /** Makes the point (0, 0). */
    public Point() {}

    /**
     * Makes a point.
     *
     * @param x column
     * @param y row
     */
    public Point(int x, int y) {
        this.x = x;
        this.y = y;
    }

    @Override
    public boolean equals(Object other) {
        return other instanceof Point && ((Point) other).x == x && ((Point) other).y == y;
    }

    @Override
    public int hashCode() {
        return 31 * x + y;
    }

    @Override
    public String toString() {
        return "Point(" + x + ", " + y + ")";
    }
}
