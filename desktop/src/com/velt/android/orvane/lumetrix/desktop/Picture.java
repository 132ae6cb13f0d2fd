package com.velt.android.orvane.lumetrix.desktop;

import java.awt.image.BufferedImage;

/**
 * A drawn picture.
 *
 * @param width width in pixels
 * @param height height in pixels
 * @param pixels width * height values 0xAARRGGBB, row by row
 */
public record Picture(int width, int height, int[] pixels) {
    /** Returns the picture for a file, without an alpha channel when no pixel needs one. */
    public BufferedImage toImage() {
        boolean opaque = true;
        for (int pixel : pixels) opaque &= pixel >>> 24 == 255;
        int type = opaque ? BufferedImage.TYPE_INT_RGB : BufferedImage.TYPE_INT_ARGB;
        BufferedImage image = new BufferedImage(width, height, type);
        image.setRGB(0, 0, width, height, pixels, 0, width);
        return image;
    }
}
