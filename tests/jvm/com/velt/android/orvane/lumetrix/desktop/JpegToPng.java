package com.velt.android.orvane.lumetrix.desktop;

import java.io.IOException;
import java.nio.file.Path;
import javax.imageio.ImageIO;

/**
 * Stores the pixels of a photo as PNG.
 *
 * <p>{@code -Xcheck:jni} warns about the JDK's own JPEG reader, so tests that run under it have
 * this program convert their photos in a process without it.
 */
public final class JpegToPng {
    private JpegToPng() {}

    /** Reads the file of the first argument and writes that of the second. */
    public static void main(String[] arguments) throws IOException {
        Photo photo = Photo.read(Path.of(arguments[0]));
        Picture picture = new Picture(photo.width(), photo.height(), photo.pixels());
        ImageIO.write(picture.toImage(), "png", Path.of(arguments[1]).toFile());
    }
}
