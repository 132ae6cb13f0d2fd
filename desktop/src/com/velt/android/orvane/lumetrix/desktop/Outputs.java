package com.velt.android.orvane.lumetrix.desktop;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayDeque;
import java.util.ArrayList;
import java.util.Deque;
import java.util.List;
import java.util.Map;

/**
 * Files that a program writes: all of them appear in their places, or none does.
 *
 * <p>Each is written under a fresh hidden name beside its place and moved there by {@link #commit}.
 * Closed without that, or ended by a signal, the program leaves older files as they were and
 * nothing else. Only when a move itself fails do those before it stay.
 *
 * <p>A place that is a link stands for the file that it leads to. A file that is replaced keeps its
 * permissions.
 */
public final class Outputs implements AutoCloseable {
    private final Map<Path, String> inputs;
    private final List<OutputFile> files = new ArrayList<>();
    private final Deque<Path> folders = new ArrayDeque<>();  // made here, the innermost first

    /**
     * @param inputs files that no output may replace, by whatever name or link, and what each is,
     *     such as {@code the script}
     */
    public Outputs(Map<Path, String> inputs) {
        this.inputs = Map.copyOf(inputs);
    }

    /** Writes one file. */
    public static void write(Path place, Map<Path, String> inputs, OutputFile.Writing writing)
            throws OutputException {
        try (Outputs outputs = new Outputs(inputs)) {
            outputs.add(place).write(writing);
            outputs.commit();
        }
    }

    /** Makes a folder that is missing, for as long as it takes to have files in it. */
    public void makeFolder(Path folder) throws OutputException {
        make(folder.toAbsolutePath());
    }

    private void make(Path folder) throws OutputException {
        if (Files.isDirectory(folder)) return;
        if (Files.exists(folder)) {
            throw new OutputException(folder + " is no folder", "a folder to write to");
        }
        make(folder.getParent());
        if (Files.isDirectory(folder)) return;  // it ends in .. and its parent was missing
        try {
            Unfinished.make(folder, () -> Files.createDirectory(folder));
        } catch (IOException e) {
            throw OutputException.of(e, folder.getParent());
        }
        folders.push(folder);
    }

    /**
     * Adds a file, and finds out whether it can be written.
     *
     * @throws OutputException when it cannot be, or would replace an input or another output
     */
    public OutputFile add(Path place) throws OutputException {
        Path target = OutputFile.targetOf(place);
        for (Map.Entry<Path, String> input : inputs.entrySet()) {
            if (isSame(target, input.getKey())) {
                throw new OutputException("it is " + input.getValue() + " and would be replaced",
                        "another name or folder");
            }
        }
        for (OutputFile other : files) {
            if (isSame(target, other.target())) {
                throw new OutputException("another output goes to the same file",
                        "a file for each");
            }
        }
        OutputFile file = new OutputFile(target);
        files.add(file);
        return file;
    }

    private static boolean isSame(Path target, Path other) {
        try {
            return target.equals(other) || Files.isSameFile(target, other);
        } catch (IOException e) {
            return false;  // one of them is missing, and its name is free
        }
    }

    /** Moves the files into their places, over older ones. */
    public void commit() throws OutputException {
        List<Path> made = new ArrayList<>(folders);
        for (OutputFile file : files) made.add(file.temporary());
        try {
            Unfinished.finish(made, () -> {
                for (OutputFile file : files) file.move();
            });
        } catch (IOException e) {
            throw OutputException.of(e, Path.of(""));
        }
        files.clear();
        folders.clear();
    }

    /** Deletes what was not committed, and each folder made here that holds nothing. */
    @Override
    public void close() {
        for (OutputFile file : files) Unfinished.delete(file.temporary());
        for (Path folder : folders) Unfinished.delete(folder);
    }
}
