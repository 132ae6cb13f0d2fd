package com.velt.android.orvane.lumetrix.desktop.window;

import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.List;
import java.util.Optional;

/**
 * The command line of the editing screen.
 *
 * @param help whether the usage is asked for
 * @param file the photo to open or the script to replay, if one was given
 */
record Arguments(boolean help, Optional<Path> file) {
    static final String USAGE = "window [PHOTO or SCRIPT]";

    /**
     * Reads the command line.
     *
     * @throws IllegalArgumentException when it is wrong; the message is a line for the user
     */
    static Arguments parse(List<String> arguments) {
        if (arguments.contains("--help") || arguments.contains("-h")) {
            return new Arguments(true, Optional.empty());
        }
        for (String argument : arguments) {
            if (argument.startsWith("--")) throw wrong("there is no option " + argument);
        }
        if (arguments.size() > 1) throw wrong("\"" + arguments.get(1) + "\" is a second file");
        return new Arguments(false, arguments.stream().findFirst().map(Arguments::path));
    }

    private static Path path(String text) {
        try {
            if (!text.isEmpty()) return Path.of(text);
        } catch (InvalidPathException e) {
            // said below
        }
        throw wrong("\"" + text + "\" is no path");
    }

    private static IllegalArgumentException wrong(String what) {
        return new IllegalArgumentException(what + ", expected " + USAGE);
    }
}
