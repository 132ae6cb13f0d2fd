package com.velt.android.orvane.lumetrix.desktop;

import java.io.IOException;
import java.nio.file.AccessDeniedException;
import java.nio.file.FileSystemException;
import java.nio.file.Files;
import java.nio.file.NoSuchFileException;
import java.nio.file.Path;

/** A file that cannot be written. The message says what is wrong, to stand behind a colon. */
public final class OutputException extends IOException {
    private static final long serialVersionUID = 1;

    /** A disk with less room than a block of a usual file system takes nothing more. */
    private static final long BLOCK = 4096;

    private final String expected;

    OutputException(String wrong, String expected) {
        super(wrong);
        this.expected = expected;
    }

    private OutputException(String wrong, String expected, IOException cause) {
        super(wrong, cause);
        this.expected = expected;
    }

    /** Returns what would mend it, such as {@code another folder}. */
    public String expected() {
        return expected;
    }

    /**
     * Says why a file could not be written. It is asked before the file is deleted, for that gives
     * its room back.
     */
    static OutputException of(IOException failure, Path folder) {
        IOException cause = failure;
        while (cause.getCause() instanceof IOException deeper) cause = deeper;
        if (cause instanceof OutputException said) return said;
        String reason = cause instanceof FileSystemException e && e.getReason() != null
                ? e.getReason() : String.valueOf(cause.getMessage());
        if (reason.contains("quota")) {
            return new OutputException("the disk quota is used up", "room in the quota or a folder"
                    + " on another disk", cause);
        }
        if (reason.contains("No space left") || isFull(folder)) {
            return new OutputException("the disk is full", "free space or a folder on another disk",
                    cause);
        }
        if (reason.contains("Read-only")) {
            return new OutputException("the disk of " + folder + " is mounted read-only",
                    "a folder on another disk", cause);
        }
        if (reason.contains("name too long")) {
            return new OutputException("its name is too long", "a shorter name", cause);
        }
        if (cause instanceof AccessDeniedException) {
            return new OutputException("nothing may be written in the folder " + folder,
                    "the right to write there or another folder", cause);
        }
        if (cause instanceof NoSuchFileException) {
            return new OutputException("there is no folder " + folder, "a folder that exists",
                    cause);
        }
        return new OutputException(reason, "another place", cause);
    }

    /** The system's own words come in its user's language, so the disk is asked as well. */
    private static boolean isFull(Path folder) {
        try {
            return Files.getFileStore(folder).getUsableSpace() < BLOCK;
        } catch (IOException e) {
            return false;
        }
    }
}
