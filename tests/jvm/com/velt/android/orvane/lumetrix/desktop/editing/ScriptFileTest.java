package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;

import com.velt.android.orvane.lumetrix.desktop.Photo;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class ScriptFileTest {
    @TempDir
    private Path folder;

    private static OpenedPhoto reduced(Path file) {
        return new OpenedPhoto(file, new Photo(2, 1, new int[] {0xFF000001, 0x80000002}), 4, 2);
    }

    /** Writes a script as the editor does and returns the photo that a reader of it gets. */
    private OpenedPhoto photoBack(Path script, OpenedPhoto photo) throws IOException {
        String name = ScriptFile.nameIn(script, ScriptFile.photoOf(script, photo));
        ScriptFile.write(script, "photo \"" + name + "\"\n", photo);
        return ScriptFile.read(script).photo();
    }

    private void assertComesBack(String photoName, String scriptName) throws IOException {
        Path photo = folder.resolve(photoName);
        Path script = folder.resolve(scriptName);
        Files.createDirectories(photo.getParent());
        Files.createDirectories(script.getParent());
        OpenedPhoto back = photoBack(script, OpenedPhoto.read(Photos.save(photo, 3, 2)));
        assertEquals(3, back.width());
    }

    @Test
    void photoBesideTheScriptIsNamedAlone() {
        assertEquals("a.jpg", ScriptFile.nameIn(folder.resolve("s.strokes"),
                folder.resolve("a.jpg")));
    }

    @Test
    void photoElsewhereIsNamedFromTheScriptsFolder() throws IOException {
        Files.createDirectories(folder.resolve("scripts"));
        Files.createDirectories(folder.resolve("photos"));
        assertEquals(Path.of("..", "photos", "a.jpg").toString(), ScriptFile.nameIn(
                folder.resolve("scripts/s.strokes"), folder.resolve("photos/../photos/a.jpg")));
        assertEquals("a.jpg", ScriptFile.nameIn(Path.of("s.strokes"), Path.of("a.jpg")));
    }

    @Test
    void photosOfAnyNameComeBack() throws IOException {
        assertComesBack("a.png", "s.strokes");
        assertComesBack("deep/down/a.png", "other/folder/s.strokes");
        assertComesBack("my photo #1.png", "my script.strokes");
        assertComesBack(" blank .png", " s");
        assertComesBack("a \"quoted\" one.png", "quoted.strokes");
        assertComesBack("two\nlines.png", "lines\n\".strokes");
    }

    @Test
    void photoComesBackWhenTheScriptsFolderIsALink() throws IOException {
        Files.createDirectories(folder.resolve("far/away/scripts"));
        Files.createSymbolicLink(folder.resolve("link"), folder.resolve("far/away/scripts"));
        assertComesBack("a.png", "link/s.strokes");
    }

    @Test
    void photoThatAScriptCannotNameIsCopiedBesideIt() throws IOException {
        Path file = Photos.save(folder.resolve("a \"b\".png"), 3, 2);
        Path script = folder.resolve("s.strokes");
        assertEquals(folder.resolve("s-photo.png"), photoBack(script, OpenedPhoto.read(file))
                .file());
    }

    @Test
    void reducedPhotoIsCopiedBesideTheScript() throws IOException {
        OpenedPhoto photo = reduced(folder.resolve("a.png"));
        OpenedPhoto back = photoBack(folder.resolve("s.strokes"), photo);
        assertEquals("s-photo.png", back.name());
        assertArrayEquals(photo.photo().pixels(), back.photo().pixels());
    }

    @Test
    void copyOfAReducedPhotoNeverOverwritesThePhoto() throws IOException {
        Path file = Photos.save(folder.resolve("s-photo.png"), 4, 2);
        OpenedPhoto back = photoBack(folder.resolve("s.strokes"), reduced(file));
        assertEquals("s-photo-copy.png", back.name());
        assertEquals(2, back.width());
        assertEquals(4, Photo.read(file).width());
    }

    @Test
    void scriptIsNotWrittenOverThePhoto() throws IOException {
        Path file = Photos.save(folder.resolve("a.png"), 4, 2);
        byte[] before = Files.readAllBytes(file);
        OpenedPhoto photo = OpenedPhoto.read(file);
        assertEquals("it is the photo that is open and would be replaced", assertThrows(
                IOException.class, () -> ScriptFile.write(file, "photo a.png", photo))
                .getMessage());
        assertArrayEquals(before, Files.readAllBytes(file));
    }

    @Test
    void copyOfAReducedPhotoReplacesNothingElse() throws IOException {
        Path copy = Photos.save(folder.resolve("s-photo.png"), 2, 1);
        Path script = Files.writeString(folder.resolve("s.strokes"), "older");
        byte[] before = Files.readAllBytes(copy);
        assertEquals("the photo has to be saved beside it as s-photo.png, and there is another file"
                + " of this name", assertThrows(IOException.class, () -> ScriptFile.write(script,
                "photo s-photo.png", reduced(folder.resolve("a.png")))).getMessage());
        assertArrayEquals(before, Files.readAllBytes(copy));
        assertEquals("older", Files.readString(script));
    }

    @Test
    void scriptOfAReducedPhotoCanBeSavedAgain() throws IOException {
        OpenedPhoto photo = reduced(folder.resolve("a.png"));
        Path script = folder.resolve("s.strokes");
        photoBack(script, photo);
        assertArrayEquals(photo.photo().pixels(), photoBack(script, photo).photo().pixels());
    }

    private String refusalOf(String script) throws IOException {
        Path file = Files.writeString(folder.resolve("s.strokes"), script);
        return assertThrows(IOException.class, () -> ScriptFile.read(file)).getMessage();
    }

    @Test
    void scriptThatCannotBePlayedIsRefusedWithItsLine() throws IOException {
        Photos.save(folder.resolve("a.png"), 3, 2);
        assertEquals("s.strokes:2: the point 3,0 lies outside the photo, expected 0,0 to 2,1",
                refusalOf("photo a.png\npaint 3,0\n"));
        assertEquals("the photo \"b.png\" in line 1 cannot be read: there is no such file;"
                + " correct that line or put a photo there",
                refusalOf("photo b.png\n"));
        assertEquals("s.strokes:1: the script ends without a photo, expected photo FILE as the"
                + " first command", refusalOf(""));
    }

    @Test
    void missingScriptIsRefused() {
        IOException refusal = assertThrows(IOException.class,
                () -> ScriptFile.read(folder.resolve("none.strokes")));
        assertEquals("there is no such file", Troubles.describe(refusal));
    }
}
