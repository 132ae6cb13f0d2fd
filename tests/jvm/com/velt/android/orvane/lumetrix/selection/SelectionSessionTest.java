package com.velt.android.orvane.lumetrix.selection;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.MaskDrawing;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

/** What strokes do to the mask, and what a session says about it. */
class SelectionSessionTest {
    private static final int WIDTH = 8;
    private static final int HEIGHT = 6;
    private static final int[] TRIANGLE = {2, 1, 5, 1, 5, 4};
    private static final Area WHOLE = new Area(0, 0, WIDTH - 1, HEIGHT - 1);

    private final List<String> calls = new ArrayList<>();
    private final SelectionSession session = new SelectionSession(new int[WIDTH * HEIGHT], WIDTH,
            HEIGHT, SelectionSession.DEFAULT_HISTORY_BYTES,
            (call, arguments) -> calls.add(call + " " + Arrays.toString(arguments)));

    @AfterEach
    void close() {
        session.close();
    }

    @Test
    void beginsWithNothingSelectedAndTheLibrarysBrush() {
        assertEquals(0, session.selectedPixels());
        assertEquals(Area.EMPTY, session.objectBox());
        assertEquals(10, session.brushRadius());
        assertEquals(1, session.coreRadius());
        assertTrue(session.fill());
        assertFalse(session.canUndo());
        assertFalse(session.canRedo());
        assertEquals(16 << 20, session.historyLimit());
        assertEquals(0, session.historyBytes());
        assertEquals(WIDTH, session.width());
        assertEquals(HEIGHT, session.height());
    }

    @Test
    void settingsAreKept() {
        session.setBrush(0, 500);
        session.setFill(false);
        assertEquals(0, session.brushRadius());
        assertEquals(500, session.coreRadius());
        assertFalse(session.fill());
        session.setBrush(500, 0);
        assertEquals(500, session.brushRadius());
        assertEquals(0, session.coreRadius());
    }

    @Test
    void brushesDoWhatTheirModesSay() {
        session.setBrush(2, 1);
        session.brush(Mode.GROW, 3, 2);
        assertMask("""
            ........
            ..###...
            ..###...
            ..###...
            ........
            ........""");
        session.brush(Mode.PAINT, 3, 2);
        assertMask("""
            ..###...
            .####...
            .####...
            .####...
            ........
            ........""");
        session.setBrush(1, 0);
        session.brush(Mode.ERASE, 1, 2);
        assertMask("""
            ..###...
            ..###...
            ..###...
            .####...
            ........
            ........""");
        session.brush(Mode.SHRINK, 3, 3);
        assertFalse(session.isSelected(3, 3));
    }

    @Test
    void lassoJoinsEachCornerToTheNextAndTheLastToTheFirst() {
        session.setFill(false);
        Area changed = session.lasso(Mode.LASSO_ADD, TRIANGLE);
        // Where two segments meet, the second finds what the first has drawn: 5.
        assertMask("""
            ........
            ..5##5..
            ...#.#..
            ....##..
            .....5..
            ........""");
        assertEquals(new Area(2, 1, 5, 4), changed);
        assertEquals(6, session.selectedPixels());
        assertFalse(session.isSelected(2, 1));
    }

    @Test
    void lassoIsFilledOnceItIsClosed() {
        session.lasso(Mode.LASSO_ADD, TRIANGLE);
        assertMask("""
            ........
            ..####..
            ...###..
            ....##..
            .....#..
            ........""");
    }

    @Test
    void removingLassoIsFilledOnceItIsClosed() {
        session.invert();
        Area changed = session.lasso(Mode.LASSO_REMOVE, TRIANGLE);
        assertMask("""
            ########
            ##....##
            ###...##
            ####..##
            #####.##
            ########""");
        assertEquals(new Area(2, 1, 5, 4), changed);
    }

    @Test
    void removingLassoWithFillOffStaysOpen() {
        session.invert();
        session.setFill(false);
        session.lasso(Mode.LASSO_REMOVE, TRIANGLE);
        assertMask("""
            ########
            ##3443##
            ###4#4##
            ####44##
            #####3##
            ########""");
    }

    @Test
    void repeatedCornerIsASegmentToItself() {
        session.setFill(false);
        for (Mode mode : List.of(Mode.LASSO_ADD, Mode.LASSO_REMOVE)) {
            calls.clear();
            session.lasso(mode, 2, 1, 5, 1, 5, 1, 5, 4, 2, 1);
            String call = "MODIFY [" + mode.number() + ", 0, ";
            assertEquals(List.of(call + "2, 1, 5, 1]", call + "5, 1, 5, 1]", call + "5, 1, 5, 4]",
                    call + "5, 4, 2, 1]", call + "2, 1, 2, 1]"), calls);
            String script = session.script("photo.png");
            assertTrue(script.endsWith(mode + " 2,1 5,1 5,1 5,4 2,1\n"), script);
        }
    }

    @Test
    void repeatedCornerIsDrawnOnceMore() {
        session.setFill(false);
        session.lasso(Mode.LASSO_ADD, 1, 1, 1, 1, 1, 1);
        assertMask("""
            ........
            .5......
            ........
            ........
            ........
            ........""");
        session.reset();
        session.invert();
        Area changed = session.lasso(Mode.LASSO_REMOVE, 1, 1, 1, 1, 1, 1);
        // The first segment finds 1 and leaves 4, the second makes 3 of it, the third leaves that.
        assertMask("""
            ########
            #3######
            ########
            ########
            ########
            ########""");
        assertEquals(new Area(1, 1, 1, 1), changed);
    }

    @Test
    void onlyTheLastSegmentFillsAlsoWhenAnEarlierOneEndsAtTheFirstCorner() {
        for (Mode mode : List.of(Mode.LASSO_ADD, Mode.LASSO_REMOVE)) {
            calls.clear();
            session.lasso(mode, 3, 2, 3, 2, 1, 4, 3, 2, 6, 4);
            String call = "MODIFY [" + mode.number();
            assertEquals(List.of(call + ", 0, 3, 2, 3, 2]", call + ", 0, 3, 2, 1, 4]",
                    call + ", 0, 1, 4, 3, 2]", call + ", 0, 3, 2, 6, 4]",
                    call + ", 1, 6, 4, 3, 2]"), calls);
        }
    }

    @Test
    void repeatedCornersChangeNothingOfAFilledLasso() {
        int[] repeated = {2, 1, 2, 1, 5, 1, 5, 1, 5, 1, 5, 4, 2, 1, 2, 1};
        session.lasso(Mode.LASSO_ADD, repeated);
        assertMask("""
            ........
            ..####..
            ...###..
            ....##..
            .....#..
            ........""");
        session.reset();
        session.invert();
        assertEquals(new Area(2, 1, 5, 4), session.lasso(Mode.LASSO_REMOVE, repeated));
        assertMask("""
            ########
            ##....##
            ###...##
            ####..##
            #####.##
            ########""");
    }

    @Test
    void lassoReturnsAlsoWhatIsFilledOutsideItsOutline() {
        session.setFill(false);
        session.lasso(Mode.LASSO_ADD, 0, 0, 2, 0, 2, 2);
        session.setFill(true);
        assertEquals(new Area(0, 0, 7, 5), session.lasso(Mode.LASSO_ADD, 5, 4, 7, 4, 7, 5));
    }

    @Test
    void brushCallsOnceAPointAndUnitesWhatChanged() {
        session.setBrush(1, 1);
        Area changed = session.brush(Mode.PAINT, 1, 1, 6, 3);
        assertMask("""
            ##......
            ##......
            .....##.
            .....##.
            ........
            ........""");
        assertEquals(new Area(0, 0, 6, 3), changed);
        assertEquals(new Area(0, 0, 6, 3), session.objectBox());
    }

    @Test
    void endReturnsAlsoOutlinesThatABrushWipedOut() {
        session.setFill(false);
        session.lasso(Mode.LASSO_REMOVE, TRIANGLE);
        Area outline = new Area(2, 1, 5, 4);
        session.setBrush(3, 0);
        session.begin(Mode.GROW);
        Area dab = session.dab(3, 3);
        assertNotEquals(outline, dab.intersection(outline));
        assertEquals(outline, session.end().intersection(outline));
        assertEquals(0, countOf(3));
    }

    @Test
    void wholeOperationsReturnThePhotoAndUpdatingTheBoxNothing() {
        assertEquals(WHOLE, session.invert());
        assertEquals(WIDTH * HEIGHT, session.selectedPixels());
        assertEquals(WHOLE, session.objectBox());
        assertEquals(WHOLE, session.reset());
        assertEquals(0, session.selectedPixels());
        assertEquals(Area.EMPTY, session.updateBox());
    }

    @Test
    void selectTakesOverOnesAndNothingElse() {
        byte[] selection = new byte[WIDTH * HEIGHT];
        byte[] others = {0, 2, 3, 4, 5, 6, 127, -1, -128, 17};
        System.arraycopy(others, 0, selection, WIDTH, others.length);
        selection[0] = 1;
        selection[7] = 1;
        selection[8] = 1;
        selection[28] = 1;
        byte[] given = selection.clone();
        session.invert();
        session.select(selection);
        assertMask("""
            #......#
            #.......
            ........
            ....#...
            ........
            ........""");
        assertArrayEquals(given, selection);
    }

    @Test
    void selectReturnsJustWhatHasChanged() {
        session.select(cells("""
            ........
            .###....
            ........
            ........
            ........
            ........"""));
        Area changed = session.select(cells("""
            ........
            .##.....
            ........
            .....##.
            ........
            ........"""));
        assertEquals(new Area(3, 1, 6, 3), changed);
        assertEquals(new Area(1, 1, 6, 3), session.select(new byte[WIDTH * HEIGHT]));
    }

    @Test
    void selectTakesOpenOutlinesAway() {
        session.setFill(false);
        session.lasso(Mode.LASSO_ADD, TRIANGLE);
        session.lasso(Mode.LASSO_REMOVE, 6, 0, 7, 0, 7, 5);
        String ring = """
            ........
            ..####..
            ...#.#..
            ....##..
            .....#..
            ........""";
        assertNotEquals(0, countOf(3));
        assertNotEquals(0, countOf(5));
        assertEquals(new Area(2, 0, 7, 5), session.select(cells(ring)));
        assertMask(ring);
    }

    @Test
    void selectMakesTheObjectBoxTight() {
        session.setBrush(1, 1);
        session.brush(Mode.PAINT, 1, 1);
        session.select(cells("""
            ........
            ........
            ........
            ....#...
            ......#.
            ........"""));
        assertEquals(new Area(4, 3, 6, 4), session.objectBox());
        byte[] corners = new byte[WIDTH * HEIGHT];
        corners[0] = 1;
        corners[corners.length - 1] = 1;
        session.select(corners);
        assertEquals(WHOLE, session.objectBox());
    }

    @Test
    void selectingNothingLeavesTheEmptyBoxOfUpdating() {
        session.invert();
        assertEquals(WHOLE, session.select(new byte[WIDTH * HEIGHT]));
        assertEquals(0, session.selectedPixels());
        assertEquals(Area.EMPTY, session.objectBox());
        assertEquals(new Rect(WIDTH, HEIGHT, 0, 0), RandomStrokes.State.of(session).box());
    }

    @Test
    void selectedArrayIsNotKept() {
        byte[] selection = new byte[WIDTH * HEIGHT];
        Arrays.fill(selection, 9, 12, (byte) 1);
        session.select(selection);
        Arrays.fill(selection, (byte) 1);
        session.invert();
        session.undo();
        assertMask("""
            ........
            .###....
            ........
            ........
            ........
            ........""");
    }

    @Test
    void strokesGoOnFromWhatWasTakenOver() {
        session.select(cells("""
            .....###
            .....#.#
            .....###
            ........
            ........
            ........"""));
        session.setBrush(1, 1);
        session.brush(Mode.PAINT, 1, 4);  // far away, with filling
        assertMask("""
            .....###
            .....###
            .....###
            ##......
            ##......
            ........""");
    }

    @Test
    void selectIsOneCallWithTheRunsOfEachRow() {
        session.select(cells("""
            #......#
            ########
            ........
            .##.###.
            ........
            #......."""));
        session.select(new byte[WIDTH * HEIGHT]);
        assertEquals(List.of("SELECT [0, 0, 0, 0, 7, 7, 1, 0, 7, 3, 1, 2, 3, 4, 6, 5, 0, 0]",
                "SELECT []"), calls.subList(2, calls.size()));
    }

    @Test
    void maskIsACopy() {
        session.invert();
        byte[] copy = session.mask();
        Arrays.fill(copy, (byte) 0);
        assertTrue(session.isSelected(0, 0));
        session.copyMask(copy);
        assertArrayEquals(session.mask(), copy);
    }

    @Test
    void listenerIsToldOfEachCallBeforeItIsMade() {
        session.setBrush(4, 2);
        session.brush(Mode.GROW, 1, 2);
        session.setFill(false);
        session.lasso(Mode.LASSO_REMOVE, TRIANGLE);
        session.invert();
        session.undo();
        session.redo();
        session.updateBox();
        session.reset();
        session.close();
        assertEquals(List.of("SET_BRUSH [10, 1]", "INIT []", "SET_BRUSH [4, 2]",
                "MODIFY [0, 1, 1, 2, 1, 2]", "MODIFY [5, 0, 2, 1, 5, 1]",
                "MODIFY [5, 0, 5, 1, 5, 4]", "MODIFY [5, 0, 5, 4, 2, 1]", "INVERT []",
                "SET_BOX [0, 0, 5, 4]", "SET_BRUSH [4, 2]", "SET_BOX [0, 0, 7, 5]",
                "SET_BRUSH [4, 2]", "UPDATE_BOX []", "RESET []", "DESTROY []"), calls);
    }

    @Test
    void photoOfOnePixelIsEnough() {
        session.close();
        try (SelectionSession one = new SelectionSession(new int[1], 1, 1)) {
            one.brush(Mode.GROW, 0, 0);
            one.brush(Mode.PAINT, 0, 0);
            assertEquals(1, one.selectedPixels());
            one.lasso(Mode.LASSO_REMOVE, 0, 0, 0, 0, 0, 0);
            assertEquals(0, one.selectedPixels());
            one.undo();
            assertTrue(one.isSelected(0, 0));
            one.select(new byte[] {2});
            assertEquals(0, one.selectedPixels());
            one.select(new byte[] {1});
            assertTrue(one.isSelected(0, 0));
        }
    }

    private static byte[] cells(String drawing) {
        return MaskDrawing.of(drawing).cells();
    }

    private int countOf(int value) {
        int count = 0;
        for (byte cell : session.mask()) {
            if (cell == value) ++count;
        }
        return count;
    }

    private void assertMask(String expected) {
        assertEquals(MaskDrawing.of(expected), new MaskDrawing(WIDTH, HEIGHT, session.mask()));
    }
}
