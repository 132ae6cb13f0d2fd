package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.graphics.Point;
import com.velt.android.orvane.lumetrix.desktop.DabPath;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.Mode;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import java.util.stream.Collectors;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

class StrokesTest {
    private static final int WIDTH = 200;
    private static final int HEIGHT = 100;
    private static final Brush BRUSH = new Brush(10, 3);

    private final List<Area> changes = new ArrayList<>();
    private SelectionSession session;
    private Strokes strokes;

    @BeforeEach
    void open() {
        int[] photo = new int[WIDTH * HEIGHT];
        Arrays.fill(photo, 0xFF808080);
        session = new SelectionSession(photo, WIDTH, HEIGHT);
        strokes = new Strokes(session, changes::add);
    }

    @AfterEach
    void close() {
        session.close();
    }

    /** Returns the lines that the script has for the strokes so far. */
    private List<String> script() {
        return session.script("p").lines().skip(1).toList();
    }

    private static String line(String mode, List<Point> dabs) {
        return mode + dabs.stream().map(p -> " " + p.x + "," + p.y).collect(Collectors.joining());
    }

    private void stroke(Mode mode, Brush brush, int... points) {
        strokes.begin(mode, brush, points[0], points[1], () -> true);
        for (int i = 2; i < points.length; i += 2) strokes.moveTo(points[i], points[i + 1]);
        strokes.end();
    }

    @Test
    void waysAreJoinedByTheDabsOfAScriptsJoinedPoints() {
        stroke(Mode.PAINT, BRUSH, 20, 20, 63, 41, 63, 90);
        List<Point> dabs = new ArrayList<>(List.of(new Point(20, 20)));
        dabs.addAll(DabPath.between(new Point(20, 20), new Point(63, 41), 5));
        dabs.addAll(DabPath.between(new Point(63, 41), new Point(63, 90), 5));
        assertEquals(List.of("brush 10 3", line("paint", dabs)), script());
        assertEquals(dabs.size(), strokes.dabs());
    }

    @Test
    void dabFollowsASpacingAwayFromTheLastOne() {
        strokes.begin(Mode.PAINT, BRUSH, 20, 20, () -> true);
        strokes.moveTo(24, 24);
        assertEquals(1, strokes.dabs());
        strokes.moveTo(25, 24);
        assertEquals(2, strokes.dabs());
        strokes.end();
        assertEquals("paint 20,20 25,24", script().get(1));
    }

    @Test
    void strokeEndsAtThePointer() {
        stroke(Mode.PAINT, BRUSH, 20, 20, 22, 21);
        assertEquals("paint 20,20 22,21", script().get(1));
        assertFalse(strokes.underWay());
    }

    @Test
    void strokeThatStaysWhereItBeginsIsOneDab() {
        stroke(Mode.PAINT, BRUSH, 20, 20);
        assertEquals("paint 20,20", script().get(1));
    }

    @Test
    void pointsOutsideThePhotoHaveNoDabs() {
        stroke(Mode.PAINT, BRUSH, -12, 50, 9, 50, WIDTH + 100, 50);
        List<Point> dabs = new ArrayList<>();
        dabs.addAll(DabPath.between(new Point(-12, 50), new Point(9, 50), 5));
        dabs.addAll(DabPath.between(new Point(9, 50), new Point(WIDTH + 100, 50), 5));
        dabs.removeIf(dab -> dab.x < 0 || dab.x >= WIDTH);
        assertEquals(line("paint", dabs), script().get(1));
        assertTrue(session.isSelected(WIDTH - 1, 50));
    }

    @Test
    void strokeThatMissesThePhotoDoesNothing() {
        stroke(Mode.PAINT, BRUSH, -1, 50, -30, 60);
        assertEquals(0, strokes.dabs());
        assertEquals(0, session.selectedPixels());
        assertFalse(session.canUndo());
        assertEquals(Hints.OUTSIDE, strokes.reason());
    }

    @Test
    void brushThatStaysIsNotSetAnew() {
        stroke(Mode.PAINT, BRUSH, 20, 20);
        stroke(Mode.ERASE, BRUSH, 25, 20);
        stroke(Mode.PAINT, new Brush(10, 4), 40, 20);
        assertEquals(List.of("brush 10 3", "paint 20,20", "erase 25,20", "brush 10 4",
                "paint 40,20"), script());
    }

    @Test
    void changesAreToldAfterEachDab() {
        strokes.begin(Mode.PAINT, BRUSH, 50, 50, () -> true);
        assertEquals(List.of(new Area(40, 40, 59, 59)), changes);
        strokes.moveTo(55, 50);
        assertEquals(2, changes.size());
        strokes.end();
        assertEquals(new Area(40, 40, 64, 59), changes.get(2));
    }

    @Test
    void strokeThatIsCutSetsNoMoreDabs() {
        boolean[] cut = {false};
        strokes.begin(Mode.PAINT, BRUSH, 20, 20, () -> !cut[0]);
        strokes.moveTo(30, 20);
        cut[0] = true;
        strokes.moveTo(90, 20);
        strokes.end();
        assertEquals("paint 20,20 25,20 30,20", script().get(1));
        assertFalse(strokes.underWay());
    }

    @Test
    void strokeThatIsCutBeforeItsFirstDabSaysSo() {
        strokes.begin(Mode.PAINT, BRUSH, 20, 20, () -> false);
        strokes.end();
        assertEquals(Hints.CUT, strokes.reason());
        assertEquals(0, strokes.dabs());
    }

    @Test
    void lassoIsOneStroke() {
        strokes.lasso(Mode.LASSO_ADD,
                List.of(new Point(10, 10), new Point(50, 10), new Point(30, 60)));
        assertEquals(List.of("lasso add 10,10 50,10 30,60"), script());
        assertEquals(3, strokes.dabs());
        assertTrue(session.isSelected(30, 30));
        assertFalse(strokes.underWay());
    }

    @Test
    void hugeBrushOnAPhotoOfOnePixelSelectsIt() {
        session.close();
        session = new SelectionSession(new int[] {0xFF123456}, 1, 1);
        strokes = new Strokes(session, changes::add);
        for (Mode mode : List.of(Mode.GROW, Mode.PAINT, Mode.SHRINK, Mode.ERASE)) {
            stroke(mode, new Brush(250, 75), 0, 0, 300, 300);
        }
        stroke(Mode.PAINT, new Brush(250, 225), 0, 0);
        assertEquals(1, session.selectedPixels());
    }

    // Hints

    /** Makes a stroke that does nothing and returns the reason. */
    private String reason(Mode mode, int... points) {
        byte[] before = session.mask();
        stroke(mode, BRUSH, points);
        assertTrue(Arrays.equals(before, session.mask()), "it did something");
        return strokes.reason();
    }

    private String lassoReason(Mode mode) {
        int before = session.selectedPixels();
        strokes.lasso(mode, List.of(new Point(20, 20), new Point(30, 20), new Point(25, 30)));
        assertEquals(before, session.selectedPixels());
        return strokes.reason();
    }

    @Test
    void smartEraserOnAnUnselectedPixelSaysWhereToBegin() {
        assertEquals("The smart eraser starts on a selected pixel. Begin inside the selection.",
                reason(Mode.SHRINK, 50, 50));
    }

    @Test
    void smartBrushOnThePhotosBorderSaysWhereToBegin() {
        String expected = "The smart brush does nothing on the photo's outermost pixels. Begin"
                + " further inside.";
        assertEquals(expected, reason(Mode.GROW, 0, 50));
        assertEquals(expected, reason(Mode.GROW, 50, 0));
        assertEquals(expected, reason(Mode.GROW, WIDTH - 1, 50));
        assertEquals(expected, reason(Mode.GROW, 50, HEIGHT - 1));
    }

    @Test
    void addingWhatIsSelectedSaysSo() {
        session.invert();
        assertEquals("Nothing was added: all that the brush reached was selected already.",
                reason(Mode.GROW, 50, 50));
        assertEquals("Nothing was added: all that the brush touched was selected already.",
                reason(Mode.PAINT, 50, 50));
        assertEquals("Nothing was added: all of it was selected already.",
                lassoReason(Mode.LASSO_ADD));
    }

    @Test
    void takingAwayWhatIsNotSelectedSaysSo() {
        assertEquals("Nothing was taken away: none of it was selected.",
                reason(Mode.ERASE, 50, 50));
        assertEquals("Nothing was taken away: none of it was selected.",
                lassoReason(Mode.LASSO_REMOVE));
    }

    @Test
    void lassoWithoutFillingSaysThatItIsOff() {
        session.setFill(false);
        assertEquals(Hints.LASSO_OPEN, lassoReason(Mode.LASSO_REMOVE));
    }

    @Test
    void smartEraserInsideThatTakesNothingAwaySaysSo() {
        session.invert();
        strokes.begin(Mode.SHRINK, new Brush(0, 0), 50, 50, () -> true);
        strokes.end();
        assertEquals(WIDTH * HEIGHT, session.selectedPixels());
        assertEquals("Nothing was taken away.", strokes.reason());
    }

    @Test
    void strokeThatBeginsOutsideSaysWhatItsFirstPointOnThePhotoTells() {
        assertEquals("The smart eraser starts on a selected pixel. Begin inside the selection.",
                reason(Mode.SHRINK, -20, 50, 20, 50));
    }
}
