package com.velt.android.orvane.lumetrix.selection;

/** Which part of a photo a view shows, and how large. */
public final class Viewport {
    /** Positions on the photo are 16.16 fixed point numbers and wrap beyond this column or row. */
    static final int LAST_POSITION = 32767;

    private final int width;
    private final int height;
    private final float scale;
    private final int offsetX;
    private final int offsetY;

    /**
     * Makes a viewport.
     *
     * <p>It need not lie on the photo, whose outermost pixels are repeated. Deliberate: where
     * offset and size times scale lead beyond column or row 32767, positions wrap around.
     *
     * @param width width of the view in pixels, at least 1
     * @param height height of the view in pixels, at least 1
     * @param scale photo pixels per view pixel, above 0 and up to 32767: above 1 the photo is
     *     reduced, below 1 enlarged. It is truncated to 1/65536; below that the view shows one
     *     photo pixel all over.
     * @param offsetX photo column at view column 0, -32767 to 32767
     * @param offsetY photo row at view row 0, -32767 to 32767
     * @throws IllegalArgumentException when a value is out of its range, or the view has more
     *     pixels than an array holds
     */
    public Viewport(int width, int height, float scale, int offsetX, int offsetY) {
        Checks.size("view", width, height);
        if (!(scale > 0 && scale <= LAST_POSITION)) {  // NaN is neither
            throw new IllegalArgumentException("the scale is " + scale
                    + ", expected photo pixels per view pixel, above 0 and up to "
                    + LAST_POSITION);
        }
        Checks.range("the photo column at the left of the view", offsetX, -LAST_POSITION,
                LAST_POSITION);
        Checks.range("the photo row at the top of the view", offsetY, -LAST_POSITION,
                LAST_POSITION);
        this.width = width;
        this.height = height;
        this.scale = scale;
        this.offsetX = offsetX;
        this.offsetY = offsetY;
    }

    /**
     * Returns the viewport of a size that shows a whole photo as large as it can, at the top left.
     *
     * @param photoWidth width of the photo, 1 to {@value SelectionSession#LONGEST_SIDE}
     * @param photoHeight height of the photo, 1 to {@value SelectionSession#LONGEST_SIDE}
     * @param width width of the view, at least 1
     * @param height height of the view, at least 1
     * @return scale is the larger of {@code photoWidth / width} and {@code photoHeight / height}
     * @throws IllegalArgumentException when a size is out of its range
     */
    public static Viewport fitting(int photoWidth, int photoHeight, int width, int height) {
        Checks.photoSize(photoWidth, photoHeight);
        Checks.size("view", width, height);
        float scale = Math.max((float) photoWidth / width, (float) photoHeight / height);
        return new Viewport(width, height, scale, 0, 0);
    }

    /**
     * Returns the width of the view.
     *
     * @return view pixels
     */
    public int width() {
        return width;
    }

    /**
     * Returns the height of the view.
     *
     * @return view pixels
     */
    public int height() {
        return height;
    }

    /**
     * Returns the scale.
     *
     * @return photo pixels per view pixel
     */
    public float scale() {
        return scale;
    }

    /**
     * Returns the photo column at view column 0.
     *
     * @return photo pixels
     */
    public int offsetX() {
        return offsetX;
    }

    /**
     * Returns the photo row at view row 0.
     *
     * @return photo pixels
     */
    public int offsetY() {
        return offsetY;
    }

    /**
     * Returns the rectangle of the whole view.
     *
     * @return in view pixels
     */
    public Area area() {
        return Area.ofSize(width, height);
    }

    @Override
    public boolean equals(Object other) {
        if (!(other instanceof Viewport)) return false;
        Viewport that = (Viewport) other;
        return width == that.width && height == that.height && scale == that.scale
                && offsetX == that.offsetX && offsetY == that.offsetY;
    }

    @Override
    public int hashCode() {
        return (((31 * width + height) * 31 + Float.hashCode(scale)) * 31 + offsetX) * 31 + offsetY;
    }

    @Override
    public String toString() {
        return width + " x " + height + " at scale " + scale + " from " + offsetX + "," + offsetY;
    }
}
