package com.velt.android.orvane.lumetrix.desktop;

/**
 * A view of the photo.
 *
 * @param width width in view pixels
 * @param height height in view pixels
 * @param scale photo pixels per view pixel
 * @param offsetX photo column at view column 0
 * @param offsetY photo row at view row 0
 * @param firstColour first colour of the selection's outline, 0xAARRGGBB
 * @param secondColour second colour of the outline, dashed with the first
 */
record Viewport(int width, int height, float scale, int offsetX, int offsetY, int firstColour,
        int secondColour) {
    static final int WHITE = 0xFFFFFFFF;
    static final int BLACK = 0xFF000000;

    /** Returns the view of this size that shows the whole photo as large as it can. */
    static Viewport fitting(Photo photo, int width, int height) {
        float scale = Math.max((float) photo.width() / width, (float) photo.height() / height);
        return new Viewport(width, height, scale, 0, 0, WHITE, BLACK);
    }
}
