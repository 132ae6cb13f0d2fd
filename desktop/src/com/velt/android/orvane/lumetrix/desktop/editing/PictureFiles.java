package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.desktop.Photo;
import com.velt.android.orvane.lumetrix.desktop.Picture;
import java.io.IOException;
import java.io.OutputStream;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.StandardCopyOption;
import javax.imageio.ImageIO;
import javax.imageio.stream.ImageOutputStream;
import javax.imageio.stream.MemoryCacheImageOutputStream;

/** Reads masks, and writes files all or nothing: a write that fails leaves an older file alone. */
final class PictureFiles {
    private PictureFiles() {}

    /** Writes a picture as PNG. */
    static void write(Path file, Picture picture) throws IOException {
        replace(file, temporary -> {
            // By way of a stream of our own, which says why a file cannot be written.
            try (OutputStream to = Files.newOutputStream(temporary);
                    ImageOutputStream out = new MemoryCacheImageOutputStream(to)) {
                if (!ImageIO.write(picture.toImage(), "png", out)) {
                    throw new IOException("no PNG writer in this Java");
                }
            }
        });
    }

    /** Writes a text in UTF-8. */
    static void write(Path file, String text) throws IOException {
        replace(file, temporary -> Files.writeString(temporary, text));
    }

    private interface Writing {
        void to(Path temporary) throws IOException;
    }

    private static void replace(Path file, Writing writing) throws IOException {
        Path folder = file.toAbsolutePath().getParent();
        if (!Files.isDirectory(folder)) throw new IOException("there is no folder " + folder);
        if (Files.isDirectory(file)) throw new IOException("there is a folder of this name");
        Path temporary = folder.resolve("." + file.getFileName() + ".part");
        try {
            writing.to(temporary);
            Files.move(temporary, file, StandardCopyOption.REPLACE_EXISTING);
        } finally {
            Files.deleteIfExists(temporary);
        }
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
