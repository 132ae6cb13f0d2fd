package com.velt.android.orvane.lumetrix.desktop;

import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.io.IOException;
import java.io.PrintStream;
import java.nio.file.Files;
import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.List;
import java.util.function.Function;

/**
 * Plays a stroke script: prints a row for each stroke, writes the script's pictures, and ends with
 * the digest of the selection.
 *
 * <p>The script is read and checked as a whole before its first stroke.
 */
public final class Player {
    private static final int DONE = 0;
    private static final int OTHER_DIGEST = 1;
    private static final int NOT_PLAYED = 2;

    private static final long NO_HISTORY = 0;  // a script has no undo

    private static final String HELP_HEAD = String.join("\n",
            "Usage: " + Options.USAGE,
            "",
            "Plays a stroke script on its photo, prints a row for each stroke and writes pictures.",
            "",
            "  --out DIR        folder for the pictures, made if missing (default: here)",
            "  --expect DIGEST  end with status 1 unless the selection has this digest",
            "  --record FILE    write the calls on the library there, for a replay without Java",
            "  --help           this text",
            "",
            "Status: 0 played, 1 played with another digest, 2 not played.",
            "",
            "A script is UTF-8 text, a command a line; # begins a comment. Commands:",
            "");

    private final Options options;
    private final PrintStream out;

    private Player(Options options, PrintStream out) {
        this.options = options;
        this.out = out;
    }

    /**
     * Runs the player and ends the process with its status.
     *
     * @param arguments the command line, see {@code --help}
     */
    public static void main(String[] arguments) {
        System.exit(run(List.of(arguments), System.out, System.err));
    }

    /** Runs the player and returns its status: 0 played, 1 with another digest, 2 not played. */
    static int run(List<String> arguments, PrintStream out, PrintStream err) {
        if (arguments.contains("--help")) {
            out.println(HELP_HEAD + "\n  " + String.join("\n  ", ScriptParser.usages()));
            return DONE;
        }
        Options options;
        try {
            options = Options.parse(arguments);
        } catch (IllegalArgumentException e) {
            err.println("Player: " + e.getMessage());
            return NOT_PLAYED;
        }
        try {
            Digest digest = new Player(options, out).play();
            if (digest.equals(options.expected().orElse(digest))) return DONE;
            err.println("Player: the selection has the digest " + digest + ", expected "
                    + options.expected().get());
            return OTHER_DIGEST;
        } catch (ScriptException e) {
            err.println(e.in(options.script()));
        } catch (UnsatisfiedLinkError e) {
            err.println("Player: the native library draventaUtil does not load (" + e.getMessage()
                    + "), expected its folder in -Djava.library.path; ./dev build builds it");
        } catch (OutOfMemoryError e) {
            err.println("Player: the photo does not fit into memory, expected more, such as with"
                    + " java -Xmx2g");
        }
        return NOT_PLAYED;
    }

    /** Prints a row for each command and keeps the pictures. */
    private record PlayerStage(SelectionSession session, StrokeTable table, PictureFolder pictures)
            implements Stage {
        @Override
        public void done(int line, String what, String where, Area changed) {
            table.row(line, what, where, changed, session.selectedPixels(), session.objectBox());
        }

        @Override
        public void picture(String name, Function<SelectionSession, Picture> drawing)
                throws IOException {
            pictures.write(name, drawing.apply(session));
        }
    }

    private Digest play() throws ScriptException {
        Script script = readScript();
        Photo photo = readPhoto(script);
        for (Command command : script.commands()) command.check(photo);
        try (PictureFolder pictures = openFolder(script.snapshots());
                CallLog calls = openLog(photo);
                SelectionSession session = open(photo, calls)) {
            perform(script.commands(), new PlayerStage(session, new StrokeTable(out), pictures));
            commit(script.snapshots(), pictures);
            calls.digest();
            Digest digest = Digest.of(session);
            out.println("digest " + digest);
            return digest;
        } catch (IOException e) {
            throw unrecordable(e);
        }
    }

    private Script readScript() throws ScriptException {
        byte[] text;
        try {
            text = Files.readAllBytes(options.script());
        } catch (IOException e) {
            throw new ScriptException(ScriptException.WHOLE_FILE, "the script cannot be read",
                    "a stroke script");
        }
        return ScriptParser.parse(text);
    }

    private Photo readPhoto(Script script) throws ScriptException {
        try {
            return Photo.read(options.script().resolveSibling(script.photo()));
        } catch (IOException | InvalidPathException e) {
            throw new ScriptException(script.photoLine(), "the photo "
                    + Words.quote(script.photo()) + " cannot be read: " + e.getMessage(),
                    "a JPEG or PNG file");
        }
    }

    private PictureFolder openFolder(List<Command.Snapshot> snapshots) throws ScriptException {
        try {
            return PictureFolder.open(options.out(),
                    snapshots.stream().map(Command.Snapshot::name).toList());
        } catch (IOException e) {
            throw unwritable(snapshots.get(0), e);
        }
    }

    private CallLog openLog(Photo photo) throws IOException {
        if (options.recording().isEmpty()) return CallLog.NONE;
        return Recording.open(options.recording().get(), photo);
    }

    private static SelectionSession open(Photo photo, CallLog calls) {
        return new SelectionSession(photo.pixels(), photo.width(), photo.height(), NO_HISTORY,
                calls);
    }

    private void perform(List<Command> commands, Stage stage) throws ScriptException {
        for (Command command : commands) {
            try {
                command.perform(stage);
            } catch (IOException e) {
                throw unwritable(command, e);
            }
        }
    }

    private void commit(List<Command.Snapshot> snapshots, PictureFolder pictures)
            throws ScriptException {
        try {
            pictures.commit().forEach(out::println);
        } catch (IOException e) {
            throw unwritable(snapshots.get(0), e);
        }
    }

    private ScriptException unrecordable(IOException e) {
        return new ScriptException(ScriptException.WHOLE_FILE, "the calls cannot be written to "
                + Words.quote(options.recording().orElseThrow().toString()) + ": " + e,
                "a file to write to");
    }

    private ScriptException unwritable(Command command, IOException e) {
        return new ScriptException(command.line(), "pictures cannot be written to "
                + Words.quote(options.out().toString()) + ": " + e, "a folder to write to");
    }
}
