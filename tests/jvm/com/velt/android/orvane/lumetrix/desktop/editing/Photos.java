package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.desktop.Picture;
import java.awt.image.BufferedImage;
import java.awt.image.DataBufferByte;
import java.io.IOException;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.Random;
import javax.imageio.ImageIO;

/** Makes photos for tests. */
final class Photos {
    private Photos() {}

    /** Saves a photo all of 0xFF808080; quick, also for large ones. */
    static Path save(Path file, int width, int height) throws IOException {
        BufferedImage image = new BufferedImage(width, height, BufferedImage.TYPE_BYTE_GRAY);
        byte[] samples = ((DataBufferByte) image.getRaster().getDataBuffer()).getData();
        Arrays.fill(samples, (byte) 0x80);
        ImageIO.write(image, "png", file.toFile());
        return file;
    }

    /** Saves a photo with patches of some colours, the same for the same seed. */
    static Path savePatches(Path file, int width, int height, int seed) throws IOException {
        Random random = new Random(seed);
        int[] colours = random.ints(64).map(colour -> colour | 0xFF000000).toArray();
        int[] pixels = new int[width * height];
        Arrays.setAll(pixels, i -> colours[i / width * 8 / height * 8 + i % width * 8 / width]);
        return save(file, width, height, pixels);
    }

    static Path save(Path file, int width, int height, int[] pixels) throws IOException {
        ImageIO.write(new Picture(width, height, pixels).toImage(), "png", file.toFile());
        return file;
    }
}
