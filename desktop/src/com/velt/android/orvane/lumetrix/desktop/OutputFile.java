package com.velt.android.orvane.lumetrix.desktop;

import java.io.BufferedOutputStream;
import java.io.IOException;
import java.io.OutputStream;
import java.nio.channels.Channels;
import java.nio.channels.FileChannel;
import java.nio.file.Files;
import java.nio.file.LinkOption;
import java.nio.file.NoSuchFileException;
import java.nio.file.Path;
import java.nio.file.StandardCopyOption;
import java.nio.file.StandardOpenOption;
import java.nio.file.attribute.BasicFileAttributes;
import java.util.concurrent.ThreadLocalRandom;

/** A file of {@link Outputs}: written under a fresh name beside its place, and moved there. */
public final class OutputFile {
    private final Path target;
    private final Path folder;
    private final Path temporary;

    /** Something that writes a file. */
    public interface Writing {
        void to(OutputStream out) throws IOException;
    }

    /** {@code target} comes from {@link #targetOf}. */
    OutputFile(Path target) throws OutputException {
        this.target = target;
        folder = target.getParent();
        String name = String.format(".draventa-%016x.part", ThreadLocalRandom.current().nextLong());
        temporary = folder.resolve(name);
        try {
            Unfinished.make(temporary, () -> Files.createFile(temporary));
        } catch (IOException e) {
            throw OutputException.of(e, folder);
        }
    }

    /**
     * Follows links from a place to the file that would be replaced there.
     *
     * @throws OutputException when no file can be written there
     */
    static Path targetOf(Path place) throws OutputException {
        Path absolute = place.toAbsolutePath();
        Path folder = absolute.getParent();
        if (folder == null || Files.isDirectory(absolute)) {
            throw new OutputException("it is a folder", "a file's name");
        }
        if (!Files.isDirectory(folder)) {
            throw new OutputException("there is no folder " + folder, "a folder that exists");
        }
        try {
            Files.readAttributes(absolute, BasicFileAttributes.class, LinkOption.NOFOLLOW_LINKS);
        } catch (NoSuchFileException e) {
            return inRealFolder(folder, absolute.getFileName());
        } catch (IOException e) {
            throw OutputException.of(e, folder);
        }
        if (!Files.exists(absolute)) {
            throw new OutputException("it is a link to a file that is missing",
                    "a name that is free");
        }
        if (!Files.isRegularFile(absolute)) {
            throw new OutputException("it is a device or a pipe", "an ordinary file");
        }
        if (!Files.isWritable(absolute)) {
            throw new OutputException("it is write-protected",
                    "a file that may be replaced or another name");
        }
        try {
            return absolute.toRealPath();
        } catch (IOException e) {
            throw OutputException.of(e, folder);
        }
    }

    private static Path inRealFolder(Path folder, Path name) throws OutputException {
        try {
            return folder.toRealPath().resolve(name);
        } catch (IOException e) {
            throw OutputException.of(e, folder);
        }
    }

    /** Writes the file and waits until the disk has it. */
    public void write(Writing writing) throws OutputException {
        try (FileChannel channel = FileChannel.open(temporary, StandardOpenOption.WRITE)) {
            if (Files.exists(target)) keepPermissions();  // before anything can be read there
            OutputStream out = new BufferedOutputStream(Channels.newOutputStream(channel));
            writing.to(out);
            out.flush();
            channel.force(true);
        } catch (IOException e) {
            throw OutputException.of(e, folder);
        }
    }

    private void keepPermissions() throws IOException {
        try {
            Files.setPosixFilePermissions(temporary, Files.getPosixFilePermissions(target));
        } catch (UnsupportedOperationException e) {
            // This file system has others, or none.
        }
    }

    /** Puts the file into its place, over an older one. */
    void move() throws OutputException {
        try {
            Files.move(temporary, target, StandardCopyOption.ATOMIC_MOVE);
        } catch (IOException e) {
            throw OutputException.of(e, folder);
        }
        try (FileChannel channel = FileChannel.open(folder, StandardOpenOption.READ)) {
            channel.force(true);
        } catch (IOException e) {
            // Not every system writes folders to the disk on demand. The file is in its place.
        }
    }

    Path target() {
        return target;
    }

    Path temporary() {
        return temporary;
    }
}
