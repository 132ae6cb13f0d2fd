package com.velt.android.orvane.lumetrix.selection;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.velt.android.orvane.lumetrix.selection.RandomStrokes.Deed;
import com.velt.android.orvane.lumetrix.selection.RandomStrokes.State;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import java.util.Random;
import org.junit.jupiter.api.Test;

/** Undo and redo, against a model that keeps the whole mask after each step. */
class SelectionUndoTest {
    private static final int WIDTH = RandomStrokes.WIDTH;
    private static final int HEIGHT = RandomStrokes.HEIGHT;
    private static final int SESSIONS = 300;
    private static final int DEEDS = 80;

    private int[] photo = new int[WIDTH * HEIGHT];

    @Test
    void undoAndRedoBringBackMaskAndBoxOfRandomSessions() {
        int undone = 0;
        int redone = 0;
        int passedOver = 0;
        int selected = 0;
        for (int seed = 0; seed < SESSIONS; ++seed) {
            Random random = new Random(seed);
            photo = RandomStrokes.photo(random);
            try (SelectionSession session = open(SelectionSession.DEFAULT_HISTORY_BYTES)) {
                RandomStrokes strokes = new RandomStrokes(random, session);
                Model model = new Model(session);
                for (int i = 0; i < DEEDS; ++i) {
                    Deed deed = strokes.next();
                    String where = "seed " + seed + ", deed " + i + ": " + deed.what();
                    model.follow(deed, where);
                    assertEquals(model.at > 0, session.canUndo(), where);
                    assertEquals(model.at < model.states.size() - 1, session.canRedo(), where);
                    if (deed.isUndo()) ++undone;
                    if (deed.isRedo()) ++redone;
                    if (deed.isSelect()) ++selected;
                }
                passedOver += model.strokesWithoutEffectBeforeRedo;
            }
        }
        assertTrue(undone > 1000 && redone > 300 && passedOver > 30 && selected > 300,
                undone + " undone, " + redone + " redone, " + passedOver + " passed over, "
                        + selected + " selected");
    }

    @Test
    void allStepsOfARandomSessionAreUndoneToTheBeginningAndRedone() {
        for (int seed = 1000; seed < 1000 + SESSIONS / 3; ++seed) {
            Random random = new Random(seed);
            photo = RandomStrokes.photo(random);
            try (SelectionSession session = open(SelectionSession.DEFAULT_HISTORY_BYTES)) {
                State beginning = State.of(session);
                RandomStrokes strokes = new RandomStrokes(random, session);
                for (int i = 0; i < DEEDS; ++i) strokes.next();
                while (session.canRedo()) session.redo();
                State end = State.of(session);
                while (session.canUndo()) session.undo();
                assertEquals(beginning, State.of(session), "seed " + seed);
                while (session.canRedo()) session.redo();
                assertEquals(end, State.of(session), "seed " + seed);
            }
        }
    }

    @Test
    void historyKeepsToItsLimitAndForgetsTheOldestFirst() {
        int forgotten = 0;
        for (int seed = 0; seed < SESSIONS; ++seed) {
            Random random = new Random(seed);
            photo = RandomStrokes.photo(random);
            long limit = random.nextInt(5000);
            try (SelectionSession session = open(limit)) {
                assertEquals(limit, session.historyLimit());
                RandomStrokes strokes = new RandomStrokes(random, session);
                List<State> states = new ArrayList<>(List.of(State.of(session)));
                for (int i = 0; i < DEEDS; ++i) {
                    Deed deed = strokes.next();
                    if (deed.isUndo() || deed.isRedo()) states.clear();
                    State now = State.of(session);
                    if (states.isEmpty() || !now.equals(states.get(states.size() - 1))) {
                        states.add(now);
                    }
                    assertTrue(session.historyBytes() <= limit, "seed " + seed + ", deed " + i);
                }
                for (int at = states.size() - 2; at >= 0 && session.canUndo(); --at) {
                    session.undo();
                    assertEquals(states.get(at), State.of(session), "seed " + seed);
                }
                if (!session.canUndo()) ++forgotten;
            }
        }
        assertTrue(forgotten > SESSIONS / 10, forgotten + " sessions forgot steps");
    }

    @Test
    void newestStepStaysWhileItFits() {
        try (SelectionSession session = open(2 * (Step.OVERHEAD + 10))) {
            session.setBrush(1, 1);
            for (int x = 2; x < 12; x += 2) session.brush(Mode.PAINT, x, 5);
            // Two runs of three bytes each.
            assertEquals(2 * (Step.OVERHEAD + 6), session.historyBytes());
            assertEquals(new Area(9, 4, 10, 5), session.undo());
            assertEquals(new Area(7, 4, 8, 5), session.undo());
            assertFalse(session.canUndo());
            assertTrue(session.isSelected(6, 5));
            session.redo();
            session.redo();
            assertFalse(session.canRedo());
            assertTrue(session.isSelected(10, 5));
        }
    }

    @Test
    void stepLargerThanTheLimitIsKeptNowhereAndTakesThoseBeforeItAlong() {
        try (SelectionSession session = open(Step.OVERHEAD + 6)) {
            session.setBrush(1, 1);
            session.brush(Mode.PAINT, 5, 5);
            assertTrue(session.canUndo());
            session.invert();
            assertFalse(session.canUndo());
            assertEquals(0, session.historyBytes());
            session.brush(Mode.ERASE, 1, 1);
            assertTrue(session.canUndo());
            session.undo();
            assertFalse(session.canUndo());
            assertTrue(session.isSelected(1, 1));
            assertFalse(session.isSelected(5, 5));
        }
    }

    @Test
    void withoutHistoryNothingCanBeUndone() {
        try (SelectionSession session = open(0)) {
            session.invert();
            assertFalse(session.canUndo());
            assertEquals(0, session.historyBytes());
        }
    }

    @Test
    void strokeOfManyDabsIsOneStep() {
        try (SelectionSession session = open(SelectionSession.DEFAULT_HISTORY_BYTES)) {
            session.setBrush(2, 1);
            session.begin(Mode.PAINT);
            assertEquals(new Area(3, 3, 6, 6), session.dab(5, 5));
            assertEquals(new Area(10, 8, 13, 11), session.dab(12, 10));
            assertFalse(session.canUndo());
            assertEquals(new Area(3, 3, 13, 11), session.end());
            assertEquals(new Area(3, 3, 13, 11), session.undo());
            assertEquals(0, session.selectedPixels());
            assertFalse(session.canUndo());
            assertEquals(new Area(3, 3, 13, 11), session.redo());
            assertEquals(new Area(3, 3, 13, 11), session.objectBox());
        }
    }

    @Test
    void newStepForgetsWhatWasUndone() {
        try (SelectionSession session = open(SelectionSession.DEFAULT_HISTORY_BYTES)) {
            session.brush(Mode.PAINT, 5, 5);
            session.undo();
            long kept = session.historyBytes();
            session.setBrush(1, 1);
            session.brush(Mode.PAINT, 5, 5);
            assertFalse(session.canRedo());
            assertTrue(session.historyBytes() < kept, session.historyBytes() + " bytes");
        }
    }

    @Test
    void strokeWithoutEffectLeavesWhatWasUndone() {
        try (SelectionSession session = open(SelectionSession.DEFAULT_HISTORY_BYTES)) {
            session.brush(Mode.PAINT, 5, 5);
            session.undo();
            assertEquals(Area.EMPTY, session.brush(Mode.ERASE, 5, 5));
            session.redo();
            assertTrue(session.isSelected(5, 5));
        }
    }

    @Test
    void strokeBegunAndEndedWithoutADabIsNoStep() {
        try (SelectionSession session = open(SelectionSession.DEFAULT_HISTORY_BYTES)) {
            session.begin(Mode.GROW);
            assertEquals(Area.EMPTY, session.end());
            assertFalse(session.canUndo());
            assertEquals("photo \"p.png\"\n", session.script("p.png"));
        }
    }

    @Test
    void boxAloneIsAStep() {
        try (SelectionSession session = open(SelectionSession.DEFAULT_HISTORY_BYTES)) {
            session.setBrush(1, 1);
            session.brush(Mode.PAINT, 1, 1, 6, 3);
            session.brush(Mode.ERASE, 1, 1);
            assertEquals(Area.EMPTY, session.updateBox());
            assertEquals(new Area(5, 2, 6, 3), session.objectBox());
            assertEquals(Area.EMPTY, session.undo());
            assertEquals(new Area(0, 0, 6, 3), session.objectBox());
        }
    }

    @Test
    void selectIsAStepOfMaskAndBox() {
        try (SelectionSession session = open(SelectionSession.DEFAULT_HISTORY_BYTES)) {
            session.setBrush(2, 1);
            session.setFill(false);
            session.brush(Mode.PAINT, 5, 5);
            session.brush(Mode.ERASE, 4, 4);  // the box outgrows what is selected
            session.lasso(Mode.LASSO_REMOVE, 8, 2, 14, 2, 14, 9);
            State before = State.of(session);
            Area changed = session.select(bar(1, 16, 20));
            State after = State.of(session);
            assertEquals(changed, session.undo());
            assertEquals(before, State.of(session));
            assertEquals(changed, session.redo());
            assertEquals(after, State.of(session));
            session.select(new byte[WIDTH * HEIGHT]);
            session.undo();
            assertEquals(after, State.of(session));
        }
    }

    @Test
    void selectionThatIsThereAlreadyIsNoStep() {
        try (SelectionSession session = open(SelectionSession.DEFAULT_HISTORY_BYTES)) {
            session.select(bar(3, 4, 9));
            session.invert();
            session.undo();
            String script = session.script("p.png");
            assertEquals(Area.EMPTY, session.select(bar(3, 4, 9)));
            assertEquals(script, session.script("p.png"));
            session.redo();
            assertFalse(session.isSelected(4, 3));
            session.undo();
            session.undo();
            assertFalse(session.canUndo());
        }
    }

    @Test
    void selectionThatIsThereAlreadyInAnOutgrownBoxIsAStepOfTheBox() {
        try (SelectionSession session = open(SelectionSession.DEFAULT_HISTORY_BYTES)) {
            session.setBrush(1, 1);
            session.brush(Mode.PAINT, 1, 1, 6, 3);
            session.brush(Mode.ERASE, 1, 1);
            assertEquals(Area.EMPTY, session.select(session.mask()));
            assertEquals(new Area(5, 2, 6, 3), session.objectBox());
            assertEquals(Area.EMPTY, session.undo());
            assertEquals(new Area(0, 0, 6, 3), session.objectBox());
        }
    }

    /** A session begins with the library's other empty box. */
    @Test
    void selectingNothingAtTheBeginningIsAStepOnce() {
        try (SelectionSession session = open(SelectionSession.DEFAULT_HISTORY_BYTES)) {
            assertEquals(Area.EMPTY, session.select(new byte[WIDTH * HEIGHT]));
            assertTrue(session.canUndo());
            session.select(new byte[WIDTH * HEIGHT]);
            session.undo();
            assertFalse(session.canUndo());
        }
    }

    /** Selects columns of one row. */
    private static byte[] bar(int row, int first, int last) {
        byte[] selection = new byte[WIDTH * HEIGHT];
        Arrays.fill(selection, row * WIDTH + first, row * WIDTH + last + 1, (byte) 1);
        return selection;
    }

    private SelectionSession open(long historyBytes) {
        return new SelectionSession(photo, WIDTH, HEIGHT, historyBytes, CallListener.NONE);
    }

    /** All states, and which of them the session is to be in. */
    private static final class Model {
        final SelectionSession session;
        final List<State> states = new ArrayList<>();
        int at;
        int strokesWithoutEffectBeforeRedo;

        Model(SelectionSession session) {
            this.session = session;
            states.add(State.of(session));
        }

        void follow(Deed deed, String where) {
            State before = states.get(at);
            State now = State.of(session);
            Area difference = difference(before.mask(), now.mask());
            if (deed.isUndo() || deed.isRedo()) {
                at += deed.isUndo() ? -1 : 1;
                assertEquals(states.get(at), now, where);
                assertEquals(difference, deed.changed(), where);
                return;
            }
            assertEquals(deed.changed().union(difference), deed.changed(), where);
            if (deed.isSelect()) assertEquals(difference, deed.changed(), where);
            if (now.equals(before)) {
                if (at < states.size() - 1) ++strokesWithoutEffectBeforeRedo;
                return;
            }
            states.subList(at + 1, states.size()).clear();
            states.add(now);
            ++at;
        }

        private static Area difference(byte[] one, byte[] other) {
            Area area = Area.EMPTY;
            for (int i = 0; i < one.length; ++i) {
                int x = i % WIDTH;
                int y = i / WIDTH;
                if (one[i] != other[i]) area = area.union(new Area(x, y, x, y));
            }
            return area;
        }
    }
}
