package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.desktop.OutputException;
import com.velt.android.orvane.lumetrix.desktop.Outputs;
import com.velt.android.orvane.lumetrix.desktop.Photo;
import com.velt.android.orvane.lumetrix.desktop.Picture;
import java.io.IOException;
import java.nio.file.Path;

/** Reads masks and writes pictures. */
final class PictureFiles {
    private PictureFiles() {}

    /** Writes a picture as PNG, but never over the photo that it was made from. */
    static void write(Path file, Picture picture, OpenedPhoto photo) throws OutputException {
        Outputs.write(file, photo.asInput(), picture::write);
    }

    /**
     * Reads a mask: what is opaque and at least half as bright as white is selected.
     *
     * @return a byte a pixel, 1 or 0, beside the picture's size
     * @throws IOException when there is no picture of this size that can be had; the message says
     *     why
     */
    static byte[] readMask(Path file, int width, int height) throws IOException {
        Photo picture = Photo.read(file);
        if (picture.width() != width || picture.height() != height) {
            throw new IOException("it has " + picture.width() + " x " + picture.height()
                    + " pixels, the photo " + width + " x " + height);
        }
        byte[] mask = new byte[width * height];
        for (int i = 0; i < mask.length; ++i) {
            if (isBright(picture.pixels()[i])) mask[i] = 1;
        }
        return mask;
    }

    private static boolean isBright(int pixel) {
        int sum = (pixel >> 16 & 255) + (pixel >> 8 & 255) + (pixel & 255);
        return pixel >>> 24 >= 128 && sum >= 3 * 128;
    }
}
