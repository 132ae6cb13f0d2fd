package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;

import java.awt.image.BufferedImage;
import java.io.ByteArrayOutputStream;
import java.io.DataOutputStream;
import java.io.IOException;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.zip.CRC32;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class PhotoTest {
    private static final int JPEG_FRAME = 0xC0;  // the marker before size and channels

    @TempDir
    private Path folder;

    @Test
    void colourPixelsComeAsOpaqueArgbRowByRow() throws IOException {
        BufferedImage image = new BufferedImage(2, 2, BufferedImage.TYPE_3BYTE_BGR);
        image.setRGB(0, 0, 0x102030);
        image.setRGB(1, 0, 0x405060);
        image.setRGB(0, 1, 0x708090);
        Photo photo = Photo.read(save(image));
        assertEquals(2, photo.width());
        assertEquals(2, photo.height());
        assertArrayEquals(
                new int[] {0xFF102030, 0xFF405060, 0xFF708090, 0xFF000000}, photo.pixels());
    }

    @Test
    void alphaIsKept() throws IOException {
        BufferedImage image = new BufferedImage(1, 1, BufferedImage.TYPE_4BYTE_ABGR);
        image.setRGB(0, 0, 0x40102030);
        assertArrayEquals(new int[] {0x40102030}, Photo.read(save(image)).pixels());
    }

    @Test
    void greySamplesAreTakenAsTheyAre() throws IOException {
        BufferedImage image = new BufferedImage(1, 1, BufferedImage.TYPE_BYTE_GRAY);
        image.getRaster().setSample(0, 0, 0, 0x80);
        assertArrayEquals(new int[] {0xFF808080}, Photo.read(save(image)).pixels());
    }

    @Test
    void paletteAndBitmapPixelsAreLookedUp() throws IOException {
        BufferedImage image = new BufferedImage(2, 1, BufferedImage.TYPE_BYTE_BINARY);
        image.setRGB(1, 0, 0xFFFFFFFF);
        assertArrayEquals(new int[] {0xFF000000, 0xFFFFFFFF}, Photo.read(save(image)).pixels());
    }

    @Test
    void missingFilesAndFoldersAreRefused() {
        assertEquals("there is no such file", refusalOf(folder.resolve("none.png")));
        assertEquals("it is a folder", refusalOf(folder));
    }

    @Test
    void filesThatAreNoPictureAreRefused() throws IOException {
        Path file = Files.writeString(folder.resolve("a.png"), "no picture at all");
        assertEquals("it is no picture", refusalOf(file));
    }

    @Test
    void jpegOfFourChannelsIsRefused() throws IOException {
        BufferedImage image = new BufferedImage(8, 8, BufferedImage.TYPE_3BYTE_BGR);
        ByteArrayOutputStream jpeg = new ByteArrayOutputStream();
        ImageIO.write(image, "jpeg", jpeg);
        assertEquals(8, Photo.read(Files.write(folder.resolve("rgb.jpg"), jpeg.toByteArray()))
                .width());
        Path cmyk = Files.write(folder.resolve("cmyk.jpg"), withFourthChannel(jpeg.toByteArray()));
        assertEquals("its colours are CMYK, not RGB or grey", refusalOf(cmyk));
    }

    @Test
    void truncatedPicturesAreRefused() throws IOException {
        Path file = save(new BufferedImage(50, 50, BufferedImage.TYPE_3BYTE_BGR));
        byte[] whole = Files.readAllBytes(file);
        Files.write(file, Arrays.copyOf(whole, 45));
        assertThrows(IOException.class, () -> Photo.read(file));
    }

    @Test
    void truncatedJpegIsRefused() throws IOException {
        BufferedImage image = new BufferedImage(80, 80, BufferedImage.TYPE_3BYTE_BGR);
        for (int i = 0; i < 80 * 80; ++i) image.setRGB(i % 80, i / 80, i * 0x10203);
        ByteArrayOutputStream jpeg = new ByteArrayOutputStream();
        ImageIO.write(image, "jpeg", jpeg);
        byte[] half = Arrays.copyOf(jpeg.toByteArray(), jpeg.size() * 2 / 3);
        assertEquals("it is damaged: its end is missing",
                refusalOf(Files.write(folder.resolve("half.jpg"), half)));
    }

    @Test
    void picturesBeyondTheLimitsAreRefusedByTheirHeader() throws IOException {
        assertEquals("it has 8001 x 8000 pixels, more than 64 million or a side beyond 32767",
                refusalOf(pngHeader(8001, 8000)));
        assertEquals("it has 32768 x 1 pixels, more than 64 million or a side beyond 32767",
                refusalOf(pngHeader(32768, 1)));
    }

    private Path save(BufferedImage image) throws IOException {
        Path file = folder.resolve("photo.png");
        ImageIO.write(image, "png", file.toFile());
        return file;
    }

    /** Declares a channel more in a JPEG's frame, with the tables of the third. */
    private static byte[] withFourthChannel(byte[] jpeg) {
        int frame = 2;
        while ((jpeg[frame + 1] & 255) != JPEG_FRAME) {
            frame += 2 + ((jpeg[frame + 2] & 255) << 8 | jpeg[frame + 3] & 255);
        }
        int end = frame + 2 + jpeg[frame + 3];
        byte[] four = new byte[jpeg.length + 3];
        System.arraycopy(jpeg, 0, four, 0, end);
        System.arraycopy(jpeg, end - 3, four, end, jpeg.length - end + 3);
        four[frame + 3] += 3;
        four[frame + 9] = 4;
        four[end] = 4;
        return four;
    }

    private static String refusalOf(Path file) {
        return assertThrows(IOException.class, () -> Photo.read(file)).getMessage();
    }

    /** Writes a PNG that ends after its first chunk, which tells the size. */
    private Path pngHeader(int width, int height) throws IOException {
        ByteArrayOutputStream chunk = new ByteArrayOutputStream();
        DataOutputStream header = new DataOutputStream(chunk);
        header.write("IHDR".getBytes(StandardCharsets.US_ASCII));
        header.writeInt(width);
        header.writeInt(height);
        header.write(new byte[] {8, 2, 0, 0, 0});
        CRC32 crc = new CRC32();
        crc.update(chunk.toByteArray());

        ByteArrayOutputStream png = new ByteArrayOutputStream();
        DataOutputStream file = new DataOutputStream(png);
        file.writeLong(0x89504E470D0A1A0AL);
        file.writeInt(13);
        file.write(chunk.toByteArray());
        file.writeInt((int) crc.getValue());
        // ImageIO looks ahead for the type of the next chunk when it reads the header.
        file.writeInt(0);
        file.write("IDAT".getBytes(StandardCharsets.US_ASCII));
        return Files.write(folder.resolve("header.png"), png.toByteArray());
    }
}
