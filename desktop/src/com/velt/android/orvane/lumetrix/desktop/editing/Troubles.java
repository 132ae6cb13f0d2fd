package com.velt.android.orvane.lumetrix.desktop.editing;

import java.nio.file.AccessDeniedException;
import java.nio.file.FileSystemException;
import java.nio.file.NoSuchFileException;

/** Says in words what went wrong with a file. */
final class Troubles {
    private Troubles() {}

    /** Returns what went wrong, to stand behind a colon. */
    static String describe(Throwable trouble) {
        if (trouble instanceof OutOfMemoryError) {
            return "it does not fit into memory; for more, start with JAVA_TOOL_OPTIONS=-Xmx4g set";
        }
        if (trouble instanceof AccessDeniedException) return "access is denied";
        if (trouble instanceof NoSuchFileException) return "there is no such file";
        if (trouble instanceof FileSystemException e && e.getReason() != null) return e.getReason();
        return trouble.getMessage() == null ? trouble.toString() : trouble.getMessage();
    }
}
