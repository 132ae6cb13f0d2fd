package com.velt.android.orvane.lumetrix.desktop;

import java.awt.image.BufferedImage;
import java.io.IOException;
import java.io.OutputStream;
import javax.imageio.ImageIO;
import javax.imageio.stream.ImageOutputStream;
import javax.imageio.stream.MemoryCacheImageOutputStream;

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

    /** Writes the picture as PNG. */
    public void write(OutputStream to) throws IOException {
        try (ImageOutputStream out = new MemoryCacheImageOutputStream(to)) {
            if (!ImageIO.write(toImage(), "png", out)) {
                throw new IOException("no PNG writer in this Java");
            }
        }
    }
}
