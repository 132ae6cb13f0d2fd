package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.desktop.Command;
import com.velt.android.orvane.lumetrix.desktop.Outputs;
import com.velt.android.orvane.lumetrix.desktop.Photo;
import com.velt.android.orvane.lumetrix.desktop.Picture;
import com.velt.android.orvane.lumetrix.desktop.Script;
import com.velt.android.orvane.lumetrix.desktop.ScriptException;
import com.velt.android.orvane.lumetrix.desktop.ScriptParser;
import java.io.IOException;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.Arrays;

/** Reads and writes stroke scripts together with their photos. */
final class ScriptFile {
    private ScriptFile() {}

    /**
     * A script that can be played.
     *
     * @param script its commands; their points lie on the photo
     * @param photo its photo, as it is in its file
     */
    record Playable(Script script, OpenedPhoto photo) {}

    /**
     * Reads a script and its photo.
     *
     * @throws IOException when it cannot be played; the message says why, and in which line
     */
    static Playable read(Path file) throws IOException {
        byte[] text = Files.readAllBytes(file);
        try {
            Script script = ScriptParser.parse(text);
            OpenedPhoto photo = readPhoto(file, script);
            for (Command command : script.commands()) command.check(photo.photo());
            return new Playable(script, photo);
        } catch (ScriptException e) {
            throw new IOException(e.in(file.getFileName()), e);
        }
    }

    private static OpenedPhoto readPhoto(Path file, Script script) throws IOException {
        try {
            return OpenedPhoto.readWhole(file.resolveSibling(script.photo()));
        } catch (IOException | InvalidPathException e) {
            throw new IOException("the photo \"" + script.photo() + "\" in line "
                    + script.photoLine() + " cannot be read: " + Troubles.describe(e)
                    + "; correct that line or put a photo there", e);
        }
    }

    /**
     * Returns the file that a script has to name: the photo's own, or a copy beside the script of
     * a photo that is reduced, or whose file a script cannot name.
     */
    static Path photoOf(Path script, OpenedPhoto photo) {
        String path = photo.file().toAbsolutePath().toString();
        boolean nameable = path.indexOf('"') < 0 && path.indexOf('\n') < 0;
        if (!photo.isReduced() && nameable) return photo.file();
        String name = script.getFileName().toString().replaceFirst("\\.strokes$", "")
                .replaceAll("[\"\n]", "_");
        Path copy = script.resolveSibling(name + "-photo.png");
        // Never over the photo itself.
        return isSame(copy, photo.file()) ? script.resolveSibling(name + "-photo-copy.png") : copy;
    }

    private static boolean isSame(Path one, Path other) {
        try {
            return Files.isSameFile(one, other);
        } catch (IOException e) {
            return false;  // there is nothing to overwrite
        }
    }

    /** Returns the name of a script's photo in the script. */
    static String nameIn(Path script, Path photo) {
        Path folder = real(script).getParent();
        Path file = real(photo);
        boolean oneTree = file.getRoot().equals(folder.getRoot());
        return (oneTree ? folder.relativize(file) : file).toString();
    }

    /** Returns a path without links to folders: whoever follows {@code ..} follows none either. */
    private static Path real(Path file) {
        Path path = file.toAbsolutePath();
        try {
            return path.getParent().toRealPath().resolve(path.getFileName());
        } catch (IOException e) {
            return path.normalize();  // the folder is missing, so nothing will be written
        }
    }

    /**
     * Writes a script and, if its photo is a copy, that as well: both, or neither.
     *
     * @throws IOException when they cannot be written, or when the copy would replace a file that
     *     holds anything else; the message says why
     */
    static void write(Path file, String script, OpenedPhoto photo) throws IOException {
        Path named = photoOf(file, photo);
        try (Outputs outputs = new Outputs(photo.asInput())) {
            outputs.add(file).write(out -> out.write(script.getBytes(StandardCharsets.UTF_8)));
            if (!named.equals(photo.file())) writeCopy(named, photo.photo(), outputs);
            outputs.commit();
        }
    }

    private static void writeCopy(Path copy, Photo photo, Outputs outputs) throws IOException {
        // Nobody was asked whether this name may be replaced.
        if (Files.exists(copy)) {
            if (isSame(copy, photo)) return;
            throw new IOException("the photo has to be saved beside it as " + copy.getFileName()
                    + ", and there is another file of this name");
        }
        Picture picture = new Picture(photo.width(), photo.height(), photo.pixels());
        outputs.add(copy).write(picture::write);
    }

    private static boolean isSame(Path file, Photo photo) {
        try {
            Photo saved = Photo.read(file);
            return saved.width() == photo.width() && Arrays.equals(saved.pixels(), photo.pixels());
        } catch (IOException e) {
            return false;  // no photo
        }
    }
}
