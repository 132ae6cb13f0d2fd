package com.velt.android.orvane.lumetrix.selection;

/**
 * A rectangle of pixels that never changes. {@link #right} and {@link #bottom} are the last column
 * and row inside.
 *
 * <p>All rectangles without a pixel are one and the same, {@link #EMPTY}, which reads 0, 0, -1, -1.
 */
public final class Area {
    /** The rectangle without a pixel. */
    public static final Area EMPTY = new Area(0, 0, -1, -1);

    private final int left;
    private final int top;
    private final int right;
    private final int bottom;

    /**
     * Makes a rectangle; it is empty when {@code left} lies beyond {@code right} or {@code top}
     * beyond {@code bottom}.
     *
     * @param left first column
     * @param top first row
     * @param right last column
     * @param bottom last row
     * @throws IllegalArgumentException when it has more columns or rows than an {@code int} counts
     */
    public Area(int left, int top, int right, int bottom) {
        boolean empty = left > right || top > bottom;
        this.left = empty ? 0 : left;
        this.top = empty ? 0 : top;
        this.right = empty ? -1 : right;
        this.bottom = empty ? -1 : bottom;
        long longer = Math.max((long) this.right - this.left, (long) this.bottom - this.top) + 1;
        if (longer > Integer.MAX_VALUE) {
            throw new IllegalArgumentException("the rectangle " + this + " has a side of " + longer
                    + ", expected up to " + Integer.MAX_VALUE);
        }
    }

    /** Returns the rectangle of a picture. */
    static Area ofSize(int width, int height) {
        return new Area(0, 0, width - 1, height - 1);
    }

    /**
     * Returns the first column.
     *
     * @return the first column inside; 0 when empty
     */
    public int left() {
        return left;
    }

    /**
     * Returns the first row.
     *
     * @return the first row inside; 0 when empty
     */
    public int top() {
        return top;
    }

    /**
     * Returns the last column.
     *
     * @return the last column inside; -1 when empty
     */
    public int right() {
        return right;
    }

    /**
     * Returns the last row.
     *
     * @return the last row inside; -1 when empty
     */
    public int bottom() {
        return bottom;
    }

    /**
     * Tells whether there is a pixel inside.
     *
     * @return true for {@link #EMPTY} and its equals
     */
    public boolean isEmpty() {
        return left > right;
    }

    /**
     * Returns the number of columns.
     *
     * @return 0 when empty
     */
    public int width() {
        return right - left + 1;
    }

    /**
     * Returns the number of rows.
     *
     * @return 0 when empty
     */
    public int height() {
        return bottom - top + 1;
    }

    /**
     * Returns the smallest rectangle around this one and another.
     *
     * @param other the other rectangle, not null
     * @return one of the two when the other is empty
     * @throws IllegalArgumentException when it has more columns or rows than an {@code int} counts
     */
    public Area union(Area other) {
        if (other.isEmpty()) return this;
        if (isEmpty()) return other;
        return new Area(Math.min(left, other.left), Math.min(top, other.top),
                Math.max(right, other.right), Math.max(bottom, other.bottom));
    }

    /**
     * Returns what this rectangle and another have in common.
     *
     * @param other the other rectangle, not null
     * @return {@link #EMPTY} when they have nothing in common
     */
    public Area intersection(Area other) {
        return new Area(Math.max(left, other.left), Math.max(top, other.top),
                Math.min(right, other.right), Math.min(bottom, other.bottom));
    }

    @Override
    public boolean equals(Object other) {
        if (!(other instanceof Area)) return false;
        Area that = (Area) other;
        return left == that.left && top == that.top && right == that.right && bottom == that.bottom;
    }

    @Override
    public int hashCode() {
        return ((31 * left + top) * 31 + right) * 31 + bottom;
    }

    /**
     * Returns columns and rows, first to last.
     *
     * @return such as {@code 5..9 x 6..10}, or {@code none}
     */
    @Override
    public String toString() {
        if (isEmpty()) return "none";
        return left + ".." + right + " x " + top + ".." + bottom;
    }
}
