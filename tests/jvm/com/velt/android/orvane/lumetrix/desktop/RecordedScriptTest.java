package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.CallListener;
import com.velt.android.orvane.lumetrix.selection.Mode;
import com.velt.android.orvane.lumetrix.selection.RandomStrokes;
import com.velt.android.orvane.lumetrix.selection.RandomStrokes.State;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.awt.image.BufferedImage;
import java.io.IOException;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.List;
import java.util.Random;
import java.util.function.Function;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** The script that a session writes of itself leads the player to the same selection. */
class RecordedScriptTest {
    private static final int WIDTH = RandomStrokes.WIDTH;
    private static final int HEIGHT = RandomStrokes.HEIGHT;
    private static final int SESSIONS = 400;
    private static final int DEEDS = 60;

    @TempDir
    private Path folder;

    /** What a session ends with. */
    private record End(State state, int radius, int core, boolean fill) {
        static End of(SelectionSession session) {
            return new End(State.of(session), session.brushRadius(), session.coreRadius(),
                    session.fill());
        }
    }

    @Test
    void scriptsOfRandomSessionsReplayExactly() throws IOException, ScriptException {
        int withSelect = 0;
        for (int seed = 0; seed < SESSIONS; ++seed) {
            Random random = new Random(seed);
            int[] photo = RandomStrokes.photo(random);
            StringBuilder deeds = new StringBuilder("seed " + seed);
            String script;
            End end;
            try (SelectionSession session = open(photo, historyOf(random))) {
                RandomStrokes strokes = new RandomStrokes(random, session);
                for (int i = 0; i < DEEDS; ++i) deeds.append('\n').append(strokes.next().what());
                script = session.script("photo.png");
                end = End.of(session);
            }
            String tried = deeds + "\n---\n" + script;
            try (SelectionSession session = open(photo, 0)) {
                replay(script, session);
                assertEquals(end, End.of(session), tried);
                assertEquals(script, session.script("photo.png"), tried);
            }
            if (script.contains("\nselect ")) ++withSelect;
        }
        assertTrue(withSelect > SESSIONS / 4, withSelect + " scripts take over a selection");
    }

    @Test
    void playerEndsWithTheSessionsDigest() throws IOException {
        Random random = new Random(20);
        int[] photo = RandomStrokes.photo(random);
        BufferedImage image = new BufferedImage(WIDTH, HEIGHT, BufferedImage.TYPE_INT_RGB);
        image.setRGB(0, 0, WIDTH, HEIGHT, photo, 0, WIDTH);
        ImageIO.write(image, "png", folder.resolve("my photo #1.png").toFile());
        Path file = folder.resolve("s.strokes");
        Digest digest;
        try (SelectionSession session = open(photo, SelectionSession.DEFAULT_HISTORY_BYTES)) {
            RandomStrokes strokes = new RandomStrokes(random, session);
            for (int i = 0; i < DEEDS; ++i) strokes.next();
            Files.writeString(file, session.script("my photo #1.png"));
            digest = Digest.of(session);
        }
        PlayerRun run = PlayerRun.of(file, "--expect", digest);
        assertEquals(List.of(), run.err());
        assertEquals(0, run.status());
    }

    @Test
    void scriptHoldsTheStrokesInEffectAndABrushWhereOneWasUndoneOrRedone() {
        try (SelectionSession session = open(new int[WIDTH * HEIGHT], 100_000)) {
            session.brush(Mode.PAINT, 5, 5, 7, 5);
            session.setBrush(3, 2);
            session.setFill(false);
            session.lasso(Mode.LASSO_ADD, 1, 1, 4, 1, 4, 4);
            session.setFill(true);
            session.invert();
            String beginning = "photo \"p.png\"\npaint 5,5 7,5\n";
            String lasso = "brush 3 2\nfill off\nlasso add 1,1 4,1 4,4\n";
            assertEquals(beginning + lasso + "fill on\ninvert\n", session.script("p.png"));

            session.undo();
            assertEquals(beginning + lasso + "brush 3 2\nfill on\n", session.script("p.png"));
            session.setBrush(4, 1);
            session.undo();
            assertEquals(beginning + "brush 4 1\n", session.script("p.png"));
            session.redo();
            session.redo();
            assertEquals(beginning + lasso + "fill on\ninvert\nbrush 4 1\n",
                    session.script("p.png"));
            session.undo();
            session.brush(Mode.ERASE, 5, 5);
            assertEquals(beginning + lasso + "brush 4 1\nfill on\nerase 5,5\n",
                    session.script("p.png"));
        }
    }

    @Test
    void strokeWithoutEffectStaysInTheScriptUntilTheStepBeforeItIsUndone() {
        try (SelectionSession session = open(new int[WIDTH * HEIGHT], 100_000)) {
            session.setBrush(2, 1);
            session.brush(Mode.ERASE, 9, 9);
            session.brush(Mode.PAINT, 5, 5);
            session.brush(Mode.PAINT, 5, 5);
            String all = "photo \"p.png\"\nbrush 2 1\nerase 9,9\npaint 5,5\npaint 5,5\n";
            assertEquals(all, session.script("p.png"));
            session.undo();
            session.brush(Mode.ERASE, 5, 5);
            assertEquals("photo \"p.png\"\nbrush 2 1\nerase 9,9\nbrush 2 1\n",
                    session.script("p.png"));
            session.redo();
            assertEquals(all + "brush 2 1\n", session.script("p.png"));
        }
    }

    @Test
    void selectionTakenOverIsOneLineWithAWordARow() {
        try (SelectionSession session = open(new int[WIDTH * HEIGHT], 100_000)) {
            byte[] selection = new byte[WIDTH * HEIGHT];
            Arrays.fill(selection, 12 * WIDTH + 5, 12 * WIDTH + 10, (byte) 1);
            Arrays.fill(selection, 12 * WIDTH + 14, 12 * WIDTH + 24, (byte) 1);
            Arrays.fill(selection, 13 * WIDTH, 13 * WIDTH + 1, (byte) 1);
            session.select(selection);
            session.select(new byte[WIDTH * HEIGHT]);
            String one = "photo \"p.png\"\nselect 12:5-9,14-23 13:0-0\n";
            assertEquals(one + "select\n", session.script("p.png"));
            session.undo();
            assertEquals(one + "brush 10 1\n", session.script("p.png"));
        }
    }

    @Test
    void forgottenStepsStayInTheScript() {
        try (SelectionSession session = open(new int[WIDTH * HEIGHT], 0)) {
            session.invert();
            session.brush(Mode.ERASE, 5, 5);
            assertEquals("photo \"p.png\"\ninvert\nerase 5,5\n", session.script("p.png"));
        }
    }

    /** Growing where all is selected changes nothing but what the engine remembers. */
    @Test
    void scriptReplaysExactlyAfterStrokesThatOnlyTheEngineRemembers() throws Exception {
        int remembered = 0;
        for (int seed = 0; seed < SESSIONS; ++seed) {
            Random random = new Random(seed);
            int[] photo = RandomStrokes.photo(random);
            int[] noticed = {random.nextInt(WIDTH), 6};
            int[] dependent = {1 + random.nextInt(WIDTH - 2), 1};
            State without = endOf(photo, false, null, dependent);
            State with = endOf(photo, false, noticed, dependent);
            if (!with.equals(without)) ++remembered;
            assertEquals(without, endOf(photo, true, noticed, dependent), "seed " + seed);
        }
        assertTrue(remembered > 0, "no stroke depended on an earlier one");
    }

    /**
     * Selects all, grows without effect (unless the point is null), clears all and grows. The
     * script must replay to the same. With {@code undo} there is a step to redo meanwhile.
     */
    private static State endOf(int[] photo, boolean undo, int[] noticed, int[] dependent)
            throws Exception {
        String script;
        State end;
        try (SelectionSession session = open(photo, SelectionSession.DEFAULT_HISTORY_BYTES)) {
            session.setBrush(6, 1);
            session.invert();
            if (undo) {
                session.reset();
                session.undo();
            }
            if (noticed != null) session.brush(Mode.GROW, noticed);
            session.reset();
            session.brush(Mode.GROW, dependent);
            script = session.script("photo.png");
            end = State.of(session);
        }
        try (SelectionSession session = open(photo, 0)) {
            replay(script, session);
            assertEquals(end, State.of(session), script);
        }
        return end;
    }

    private static void replay(String script, SelectionSession session)
            throws IOException, ScriptException {
        Stage stage = new SilentStage(session);
        List<Command> commands =
                ScriptParser.parse(script.getBytes(StandardCharsets.UTF_8)).commands();
        for (Command command : commands) command.perform(stage);
    }

    private record SilentStage(SelectionSession session) implements Stage {
        @Override
        public void done(int line, String what, String where, Area changed) {}

        @Override
        public void picture(String name, Function<SelectionSession, Picture> drawing) {}
    }

    private static long historyOf(Random random) {
        return random.nextInt(3) > 0 ? SelectionSession.DEFAULT_HISTORY_BYTES
                : random.nextInt(3000);
    }

    private static SelectionSession open(int[] photo, long historyBytes) {
        return new SelectionSession(photo, WIDTH, HEIGHT, historyBytes, CallListener.NONE);
    }
}
