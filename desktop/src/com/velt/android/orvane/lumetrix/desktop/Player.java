package com.velt.android.orvane.lumetrix.desktop;

import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.io.IOException;
import java.io.PrintStream;
import java.nio.file.Files;
import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.HashMap;
import java.util.List;
import java.util.Map;
import java.util.Optional;
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
            "Status: 0 played, 1 played with another digest, 2 not played or not printed.",
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
            return isPrinted(out, err) ? DONE : NOT_PLAYED;
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
            if (!isPrinted(out, err)) return NOT_PLAYED;
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

    private static boolean isPrinted(PrintStream out, PrintStream err) {
        if (!out.checkError()) return true;
        err.println("Player: not everything could be printed, for the disk of the standard output"
                + " is full or its reader has ended, expected another place for the standard"
                + " output");
        return false;
    }

    /** Prints a row for each command and writes the pictures. */
    private record PlayerStage(SelectionSession session, StrokeTable table,
            Map<String, OutputFile> pictures) implements Stage {
        @Override
        public void done(int line, String what, String where, Area changed) {
            table.row(line, what, where, changed, session.selectedPixels(), session.objectBox());
        }

        @Override
        public void picture(String name, Function<SelectionSession, Picture> drawing)
                throws OutputException {
            Picture picture = drawing.apply(session);
            pictures.get(name).write(picture::write);
        }
    }

    private Digest play() throws ScriptException {
        Script script = readScript();
        Photo photo = readPhoto(script);
        for (Command command : script.commands()) command.check(photo);
        try (Outputs outputs = new Outputs(Map.of(options.script(), "the script",
                photoOf(script), "the script's photo"))) {
            Map<String, OutputFile> pictures = addPictures(outputs, script.snapshots());
            Digest digest = play(script, photo, pictures, addRecording(outputs));
            // Not before everything is written: session and recording are closed by now.
            commit(outputs);
            script.snapshots().forEach(snapshot -> out.println(placeOf(snapshot)));
            out.println("digest " + digest);
            return digest;
        }
    }

    private Digest play(Script script, Photo photo, Map<String, OutputFile> pictures,
            Optional<OutputFile> recording) throws ScriptException {
        try (CallLog calls = recording.isPresent() ? new Recording(recording.get(), photo)
                        : CallLog.NONE;
                SelectionSession session = open(photo, calls)) {
            perform(script.commands(), new PlayerStage(session, new StrokeTable(out), pictures));
            calls.digest();
            return Digest.of(session);
        } catch (OutputException e) {
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
            return Photo.read(photoOf(script));
        } catch (IOException | InvalidPathException e) {
            throw new ScriptException(script.photoLine(), "the photo "
                    + Words.quote(script.photo()) + " cannot be read: " + e.getMessage(),
                    "a JPEG or PNG file");
        }
    }

    private Path photoOf(Script script) {
        return options.script().resolveSibling(script.photo());
    }

    private Path placeOf(Command.Snapshot snapshot) {
        return options.out().resolve(snapshot.name());
    }

    /** Finds out whether the pictures can be written, and makes their folder. */
    private Map<String, OutputFile> addPictures(Outputs outputs, List<Command.Snapshot> snapshots)
            throws ScriptException {
        Map<String, OutputFile> pictures = new HashMap<>();
        for (Command.Snapshot snapshot : snapshots) {
            try {
                outputs.makeFolder(options.out());
                pictures.put(snapshot.name(), outputs.add(placeOf(snapshot)));
            } catch (OutputException e) {
                throw unwritable(snapshot, e);
            }
        }
        return pictures;
    }

    private Optional<OutputFile> addRecording(Outputs outputs) throws ScriptException {
        if (options.recording().isEmpty()) return Optional.empty();
        try {
            return Optional.of(outputs.add(options.recording().get()));
        } catch (OutputException e) {
            throw unrecordable(e);
        }
    }

    private static SelectionSession open(Photo photo, CallLog calls) {
        return new SelectionSession(photo.pixels(), photo.width(), photo.height(), NO_HISTORY,
                calls);
    }

    private void perform(List<Command> commands, Stage stage) throws ScriptException {
        for (Command command : commands) {
            try {
                command.perform(stage);
            } catch (OutputException e) {
                throw unwritable((Command.Snapshot) command, e);  // no other command writes
            }
        }
    }

    private static void commit(Outputs outputs) throws ScriptException {
        try {
            outputs.commit();
        } catch (OutputException e) {
            throw new ScriptException(ScriptException.WHOLE_FILE, "what is written cannot be put"
                    + " into its place: " + e.getMessage(), e.expected());
        }
    }

    private ScriptException unrecordable(OutputException e) {
        return new ScriptException(ScriptException.WHOLE_FILE, "the calls cannot be written to "
                + Words.quote(options.recording().orElseThrow().toString()) + ": "
                + e.getMessage(), e.expected());
    }

    private ScriptException unwritable(Command.Snapshot snapshot, OutputException e) {
        return new ScriptException(snapshot.line(), "the picture cannot be written to "
                + Words.quote(placeOf(snapshot).toString()) + ": " + e.getMessage(), e.expected());
    }
}
