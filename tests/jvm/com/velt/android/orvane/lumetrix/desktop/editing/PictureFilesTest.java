package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;

import com.velt.android.orvane.lumetrix.desktop.Photo;
import com.velt.android.orvane.lumetrix.desktop.Picture;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import java.util.stream.Stream;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class PictureFilesTest {
    private static final Picture PICTURE =
            new Picture(2, 2, new int[] {0xFF102030, 0x00000000, 0x80FF00FF, 0xFFFFFFFF});
    private static final OpenedPhoto NO_PHOTO =
            new OpenedPhoto(Path.of("none.png"), new Photo(1, 1, new int[1]), 1, 1);

    @TempDir
    private Path folder;

    private List<String> names() throws IOException {
        try (Stream<Path> files = Files.list(folder)) {
            return files.map(file -> file.getFileName().toString()).sorted().toList();
        }
    }

    private static String refusal(Path file, OpenedPhoto photo) {
        return Troubles.describe(assertThrows(IOException.class,
                () -> PictureFiles.write(file, new Picture(1, 1, new int[1]), photo)));
    }

    @Test
    void pictureComesBackWithItsAlpha() throws IOException {
        Path file = folder.resolve("cut out.png");
        PictureFiles.write(file, PICTURE, NO_PHOTO);
        Photo read = Photo.read(file);
        assertEquals(2, read.width());
        assertArrayEquals(PICTURE.pixels(), read.pixels());
        assertEquals(List.of("cut out.png"), names());
    }

    @Test
    void pictureIsNotWrittenOverTheOpenPhoto() throws IOException {
        Path file = folder.resolve("photo.png");
        PictureFiles.write(file, PICTURE, NO_PHOTO);
        OpenedPhoto photo = OpenedPhoto.read(file);
        Files.createSymbolicLink(folder.resolve("link.png"), file);
        String refusal = "it is the photo that is open and would be replaced";
        assertEquals(refusal, refusal(file, photo));
        assertEquals(refusal, refusal(folder.resolve("link.png"), photo));
        assertArrayEquals(PICTURE.pixels(), Photo.read(file).pixels());
        assertEquals(List.of("link.png", "photo.png"), names());
    }

    @Test
    void maskIsWhatIsOpaqueAndBright() throws IOException {
        Path file = folder.resolve("mask.png");
        PictureFiles.write(file, new Picture(6, 1, new int[] {0xFFFFFFFF, 0xFF000000, 0xFF808080,
                0xFF7F8080, 0x7FFFFFFF, 0x80FFFFFF}), NO_PHOTO);
        assertArrayEquals(new byte[] {1, 0, 1, 0, 0, 1}, PictureFiles.readMask(file, 6, 1));
    }

    @Test
    void maskOfAnotherSizeIsRefusedWithBothSizes() throws IOException {
        Path file = folder.resolve("mask.png");
        PictureFiles.write(file, PICTURE, NO_PHOTO);
        assertEquals("it has 2 x 2 pixels, the photo 4 x 1", assertThrows(IOException.class,
                () -> PictureFiles.readMask(file, 4, 1)).getMessage());
    }
}
