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
import org.junit.jupiter.api.Assumptions;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class PictureFilesTest {
    private static final Picture PICTURE =
            new Picture(2, 2, new int[] {0xFF102030, 0x00000000, 0x80FF00FF, 0xFFFFFFFF});

    @TempDir
    private Path folder;

    private List<String> names() throws IOException {
        try (Stream<Path> files = Files.list(folder)) {
            return files.map(file -> file.getFileName().toString()).sorted().toList();
        }
    }

    private static String refusal(Path file, Picture picture) {
        return Troubles.describe(assertThrows(IOException.class,
                () -> PictureFiles.write(file, picture)));
    }

    @Test
    void pictureComesBackWithItsAlpha() throws IOException {
        Path file = folder.resolve("cut out.png");
        PictureFiles.write(file, PICTURE);
        Photo read = Photo.read(file);
        assertEquals(2, read.width());
        assertArrayEquals(PICTURE.pixels(), read.pixels());
        assertEquals(List.of("cut out.png"), names());
    }

    @Test
    void olderFileIsReplaced() throws IOException {
        Path file = folder.resolve("a.txt");
        PictureFiles.write(file, "one");
        PictureFiles.write(file, "zwölf");
        assertEquals("zwölf", Files.readString(file));
        assertEquals(List.of("a.txt"), names());
    }

    @Test
    void missingFolderIsNamed() throws IOException {
        Path missing = folder.resolve("none");
        assertEquals("there is no folder " + missing, refusal(missing.resolve("a.png"), PICTURE));
        assertEquals(List.of(), names());
    }

    @Test
    void folderIsNotOverwritten() throws IOException {
        Files.createDirectories(folder.resolve("a.png/inner"));
        assertEquals("there is a folder of this name", refusal(folder.resolve("a.png"), PICTURE));
        assertEquals(List.of("a.png"), names());
    }

    @Test
    void writeThatFailsLeavesTheOlderFileAndNothingElse() throws IOException {
        Path file = folder.resolve("a.png");
        PictureFiles.write(file, PICTURE);
        assertThrows(RuntimeException.class,
                () -> PictureFiles.write(file, new Picture(0, 0, new int[0])));
        assertArrayEquals(PICTURE.pixels(), Photo.read(file).pixels());
        assertEquals(List.of("a.png"), names());
    }

    @Test
    void folderThatCannotBeWrittenToIsSaid() throws IOException {
        Path file = folder.resolve("a.png");
        PictureFiles.write(file, PICTURE);
        folder.toFile().setWritable(false);
        try {
            Assumptions.assumeFalse(Files.isWritable(folder), "this user may write anywhere");
            assertEquals("access is denied", refusal(file, new Picture(1, 1, new int[1])));
            assertArrayEquals(PICTURE.pixels(), Photo.read(file).pixels());
            assertEquals(List.of("a.png"), names());
        } finally {
            folder.toFile().setWritable(true);
        }
    }

    @Test
    void nameTooLongIsSaid() throws IOException {
        String name = "a".repeat(300);
        assertEquals("File name too long", refusal(folder.resolve(name), PICTURE));
        assertEquals(List.of(), names());
    }

    @Test
    void maskIsWhatIsOpaqueAndBright() throws IOException {
        Path file = folder.resolve("mask.png");
        PictureFiles.write(file, new Picture(6, 1, new int[] {0xFFFFFFFF, 0xFF000000, 0xFF808080,
                0xFF7F8080, 0x7FFFFFFF, 0x80FFFFFF}));
        assertArrayEquals(new byte[] {1, 0, 1, 0, 0, 1}, PictureFiles.readMask(file, 6, 1));
    }

    @Test
    void maskOfAnotherSizeIsRefusedWithBothSizes() throws IOException {
        Path file = folder.resolve("mask.png");
        PictureFiles.write(file, PICTURE);
        assertEquals("it has 2 x 2 pixels, the photo 4 x 1", assertThrows(IOException.class,
                () -> PictureFiles.readMask(file, 4, 1)).getMessage());
    }
}
