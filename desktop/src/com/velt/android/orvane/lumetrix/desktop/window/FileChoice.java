package com.velt.android.orvane.lumetrix.desktop.window;

import java.nio.file.Path;
import java.util.Optional;

/** Asks the user for files. */
interface FileChoice {
    /**
     * Asks for a file to read.
     *
     * @param title what the file is for, such as {@code Open photo}
     * @param type what kind of file it is
     * @return the file, or nothing when the user thought better of it
     */
    Optional<Path> toOpen(String title, FileType type);

    /**
     * Asks for a file to write; one that exists only when the user wants it replaced.
     *
     * @param title what the file is for
     * @param type what kind of file it is
     * @param suggestion the name of the file unless the user gives another one
     * @return the file, its extension that of the kind, or nothing
     */
    Optional<Path> toSave(String title, FileType type, String suggestion);

    /** Is told of a file that was used without being asked for: the next question begins there. */
    void used(Path file);
}
