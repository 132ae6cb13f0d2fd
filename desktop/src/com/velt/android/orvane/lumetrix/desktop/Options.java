package com.velt.android.orvane.lumetrix.desktop;

import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.Iterator;
import java.util.List;
import java.util.Optional;

/**
 * The player's command line.
 *
 * @param script the script to play
 * @param out the folder for its pictures
 * @param expected the digest that the script should end with, if one was given
 * @param recording the file for the calls on the library, if one was given
 */
record Options(Path script, Path out, Optional<Digest> expected, Optional<Path> recording) {
    static final String USAGE = "Player SCRIPT [--out DIR] [--expect DIGEST] [--record FILE]";

    /**
     * Reads the command line.
     *
     * @throws IllegalArgumentException when it is wrong; the message is a line for the user
     */
    static Options parse(List<String> arguments) {
        Path script = null;
        Path out = Path.of("");
        Optional<Digest> expected = Optional.empty();
        Optional<Path> recording = Optional.empty();
        for (Iterator<String> rest = arguments.iterator(); rest.hasNext(); ) {
            String argument = rest.next();
            if (argument.equals("--out")) {
                out = path(value(argument, rest));
            } else if (argument.equals("--expect")) {
                String digest = value(argument, rest);
                expected = Digest.parse(digest);
                if (expected.isEmpty()) {
                    throw wrong(Words.quote(digest) + " is no digest of 8 hexadecimal digits");
                }
            } else if (argument.equals("--record")) {
                recording = Optional.of(path(value(argument, rest)));
            } else if (argument.startsWith("--")) {
                throw wrong("there is no option " + argument);
            } else if (script != null) {
                throw wrong(Words.quote(argument) + " is a second script");
            } else {
                script = path(argument);
            }
        }
        if (script == null) throw wrong("no script is given");
        return new Options(script, out, expected, recording);
    }

    private static String value(String option, Iterator<String> rest) {
        if (!rest.hasNext()) throw wrong(option + " lacks its value");
        return rest.next();
    }

    private static Path path(String text) {
        try {
            return Path.of(text);
        } catch (InvalidPathException e) {
            throw wrong(Words.quote(text) + " is no path");
        }
    }

    private static IllegalArgumentException wrong(String what) {
        return new IllegalArgumentException(what + ", expected " + USAGE);
    }
}
