package com.velt.android.orvane.lumetrix.desktop.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.nio.file.Path;
import org.junit.jupiter.api.Test;

class FileTypeTest {
    @Test
    void aMissingExtensionIsAdded() {
        assertEquals(Path.of("out/fig.png"), FileType.PICTURE.withExtension(Path.of("out/fig")));
        assertEquals(Path.of("fig.strokes"), FileType.SCRIPT.withExtension(Path.of("fig")));
    }

    @Test
    void anotherExtensionIsKeptInFrontOfTheRightOne() {
        assertEquals(Path.of("fig.v2.png"), FileType.PICTURE.withExtension(Path.of("fig.v2")));
        assertEquals(Path.of("fig.jpg.png"), FileType.PICTURE.withExtension(Path.of("fig.jpg")));
        assertEquals(Path.of("png.png"), FileType.PICTURE.withExtension(Path.of("png")));
    }

    @Test
    void theRightExtensionIsEnoughInCapitalsToo() {
        assertEquals(Path.of("FIG.PNG"), FileType.PICTURE.withExtension(Path.of("FIG.PNG")));
        assertEquals(Path.of("fig.Strokes"), FileType.SCRIPT.withExtension(Path.of("fig.Strokes")));
    }

    @Test
    void filesAreToldByTheirExtension() {
        assertTrue(FileType.PHOTO.fits(Path.of("a/b.jpeg")));
        assertTrue(FileType.PHOTO.fits(Path.of("a/B.JPG")));
        assertFalse(FileType.PHOTO.fits(Path.of("b.strokes")));
        assertFalse(FileType.SCRIPT.fits(Path.of("strokes")));
        assertFalse(FileType.SCRIPT.fits(Path.of("/")));
    }
}
