package com.velt.android.orvane.lumetrix.desktop;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayDeque;
import java.util.Collection;
import java.util.Deque;

/**
 * The files and folders that this program has made and not finished. They are deleted when it ends,
 * also when SIGINT, SIGTERM or SIGHUP ends it; only SIGKILL and a loss of power leave them.
 *
 * <p>Once they are being deleted nothing can be made or finished any more.
 */
final class Unfinished {
    private static final Deque<Path> PATHS = new ArrayDeque<>();  // the newest first
    private static boolean ending;

    static {
        try {
            Runtime.getRuntime().addShutdownHook(new Thread(Unfinished::end, "unfinished files"));
        } catch (IllegalStateException e) {
            ending = true;  // already
        }
    }

    private Unfinished() {}

    /** Something done with files. */
    interface Step {
        void run() throws IOException;
    }

    static synchronized void make(Path path, Step making) throws IOException {
        refuseWhenEnding();
        making.run();
        PATHS.push(path);
    }

    /** Runs the step as a whole before the program ends, or not at all. */
    static synchronized void finish(Collection<Path> paths, Step finishing) throws IOException {
        refuseWhenEnding();
        finishing.run();
        PATHS.removeAll(paths);
    }

    /** Deletes a file, or a folder if it holds nothing. */
    static synchronized void delete(Path path) {
        PATHS.remove(path);
        try {
            Files.deleteIfExists(path);
        } catch (IOException e) {
            // A folder with files in it stays; there is nobody to tell about anything else.
        }
    }

    private static void refuseWhenEnding() throws OutputException {
        if (ending) throw new OutputException("the program is being ended", "another run");
    }

    private static synchronized void end() {
        ending = true;
        while (!PATHS.isEmpty()) delete(PATHS.peek());
    }
}
