package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.io.IOException;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.stream.IntStream;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class OpenedPhotoTest {
    @TempDir
    private Path folder;

    private OpenedPhoto read(int width, int height, int[] pixels) throws IOException {
        return OpenedPhoto.read(Photos.save(folder.resolve("p.png"), width, height, pixels));
    }

    @Test
    void photoUpToTheLimitIsTakenAsItIs() throws IOException {
        int[] pixels = IntStream.range(0, 12).map(i -> i * 0x15000103).toArray();
        OpenedPhoto photo = read(4, 3, pixels);
        assertArrayEquals(pixels, photo.photo().pixels());
        assertFalse(photo.isReduced());
        assertEquals("p.png", photo.name());

        OpenedPhoto largest = OpenedPhoto.read(Photos.save(folder.resolve("p.png"), 5000, 2500));
        assertFalse(largest.isReduced());
        assertEquals(5000, largest.width());
    }

    @Test
    void largerPhotoIsReducedInProportionAndKeepsItsColoursAndAlpha() throws IOException {
        int width = 5200;
        int height = 2600;
        int[] pixels = new int[width * height];
        Arrays.fill(pixels, 0, pixels.length / 2, 0xFF204060);
        Arrays.fill(pixels, pixels.length / 2, pixels.length, 0x80FF8000);
        OpenedPhoto photo = read(width, height, pixels);
        assertTrue(photo.isReduced());
        assertEquals(5200, photo.fileWidth());
        assertEquals(2600, photo.fileHeight());
        assertEquals(5000, photo.width(), 1);
        assertEquals(2500, photo.height(), 1);
        assertTrue(photo.photo().pixels().length <= OpenedPhoto.MOST_PIXELS);
        assertEquals(0xFF204060, photo.photo().pixels()[1000 * photo.width() + 700]);
        int half = photo.photo().pixels()[2000 * photo.width() + 700];
        assertEquals(0x80, half >>> 24);
        assertEquals(0xFF, half >> 16 & 255, 1);
        assertEquals(0x80, half >> 8 & 255, 1);
        assertEquals(0, half & 255, 1);
    }

    @Test
    void photoThatIsReadWholeIsNeverReduced() throws IOException {
        OpenedPhoto photo = OpenedPhoto.readWhole(
                Photos.save(folder.resolve("p.png"), 5001, 2500));
        assertEquals(5001, photo.width());
        assertFalse(photo.isReduced());
    }
}
