package com.velt.android.orvane.lumetrix.desktop.window;

import java.nio.file.Path;
import java.util.List;
import java.util.Locale;

/** The kinds of files that are opened and saved. */
enum FileType {
    PHOTO("Photos (JPEG, PNG)", "jpg", "jpeg", "png"),
    SCRIPT("Stroke scripts", "strokes"),
    PICTURE("PNG pictures", "png");

    private final String title;
    private final List<String> extensions;

    FileType(String title, String... extensions) {
        this.title = title;
        this.extensions = List.of(extensions);
    }

    /** Returns its name for people. */
    String title() {
        return title;
    }

    /** Returns the extensions of its files, the usual one first. */
    List<String> extensions() {
        return extensions;
    }

    /** Tells whether a file has one of the extensions, in small letters or capitals. */
    boolean fits(Path file) {
        String name = file.getFileName() == null ? "" : file.getFileName().toString();
        String small = name.toLowerCase(Locale.ROOT);
        return extensions.stream().anyMatch(extension -> small.endsWith("." + extension));
    }

    /** Returns the file itself when it has an extension of the kind, or else with one added. */
    Path withExtension(Path file) {
        if (fits(file)) return file;
        return file.resolveSibling(file.getFileName() + "." + extensions.get(0));
    }
}
