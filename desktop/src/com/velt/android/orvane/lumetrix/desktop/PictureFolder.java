package com.velt.android.orvane.lumetrix.desktop;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.StandardCopyOption;
import java.util.ArrayDeque;
import java.util.ArrayList;
import java.util.Deque;
import java.util.List;
import javax.imageio.ImageIO;

/**
 * The folder that receives the pictures, all at once.
 *
 * <p>Pictures are written to a temporary folder beside their place and moved there by
 * {@link #commit}. Closed without that, the folder is as it was before, or gone if it was missing.
 */
final class PictureFolder implements AutoCloseable {
    private final Path folder;
    private final Deque<Path> made = new ArrayDeque<>();  // folders made here, the innermost first
    private final List<String> written = new ArrayList<>();
    private Path temporary;

    private PictureFolder(Path folder) {
        this.folder = folder;
    }

    /**
     * Opens a folder, making it if it is missing, and finds out whether it can take the pictures.
     * Without pictures it is not looked at.
     *
     * @throws IOException when it cannot; nothing is left behind
     */
    static PictureFolder open(Path folder, List<String> names) throws IOException {
        PictureFolder opened = new PictureFolder(folder);
        if (names.isEmpty()) return opened;
        try {
            opened.make(folder.toAbsolutePath());
            opened.temporary = Files.createTempDirectory(folder, ".pictures");
            opened.made.push(opened.temporary);
            for (String name : names) {
                if (Files.isDirectory(folder.resolve(name))) {
                    throw new IOException(name + " is a folder there");
                }
            }
            return opened;
        } catch (IOException e) {
            opened.close();
            throw e;
        }
    }

    private void make(Path missing) throws IOException {
        if (Files.isDirectory(missing)) return;
        if (missing.getParent() != null) make(missing.getParent());
        Files.createDirectory(missing);
        made.push(missing);
    }

    void write(String name, Picture picture) throws IOException {
        Path file = temporary.resolve(name);
        written.add(name);
        if (!ImageIO.write(picture.toImage(), "png", file.toFile())) {
            throw new IOException("no PNG writer in this Java");
        }
    }

    /** Moves the pictures into place, over older ones, and returns their paths. */
    List<Path> commit() throws IOException {
        List<Path> places = new ArrayList<>();
        for (String name : written) {
            Path place = folder.resolve(name);
            Files.move(temporary.resolve(name), place, StandardCopyOption.ATOMIC_MOVE);
            places.add(place);
        }
        return places;
    }

    /** Deletes what was not committed, and each folder made here that holds nothing. */
    @Override
    public void close() {
        for (String name : written) deleteIfPossible(temporary.resolve(name));
        for (Path each : made) deleteIfPossible(each);
    }

    private static void deleteIfPossible(Path path) {
        try {
            Files.deleteIfExists(path);
        } catch (IOException e) {
            // A folder with pictures in it stays; there is nobody to tell about anything else.
        }
    }
}
