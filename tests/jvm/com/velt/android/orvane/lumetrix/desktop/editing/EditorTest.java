package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotEquals;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.graphics.Point;
import com.velt.android.orvane.lumetrix.desktop.Photo;
import com.velt.android.orvane.lumetrix.desktop.Picture;
import com.velt.android.orvane.lumetrix.selection.Mode;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import java.util.stream.Stream;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.EnumSource;

class EditorTest {
    private static final int WIDTH = 120;
    private static final int HEIGHT = 80;
    private static final Brush BRUSH = new Brush(10, 3);
    private static final List<Message> NOTHING = List.of();

    @TempDir
    private Path folder;

    private final RecordingListener listener = new RecordingListener();
    private Editor editor;
    private Path photo;

    @BeforeEach
    void begin() throws IOException {
        photo = Photos.savePatches(folder.resolve("photo.png"), WIDTH, HEIGHT, 1);
        editor = new Editor(listener);
    }

    @AfterEach
    void end() {
        editor.close();
    }

    private void open() {
        editor.open(photo);
        editor.settle();
    }

    private EditorState state() {
        editor.settle();
        return listener.state();
    }

    private List<Message> said() {
        editor.settle();
        return listener.takeMessages();
    }

    private static List<Message> hint(String text) {
        return List.of(new Message(Message.Kind.HINT, text));
    }

    private static List<Message> problem(String text) {
        return List.of(new Message(Message.Kind.PROBLEM, text));
    }

    private void stroke(Mode mode, int... points) {
        editor.beginStroke(mode, BRUSH, points[0], points[1]);
        for (int i = 2; i < points.length; i += 2) editor.moveStroke(points[i], points[i + 1]);
        editor.endStroke();
    }

    private static List<Point> corners(int... numbers) {
        List<Point> corners = new ArrayList<>();
        for (int i = 0; i < numbers.length; i += 2) {
            corners.add(new Point(numbers[i], numbers[i + 1]));
        }
        return corners;
    }

    private ViewModel show(ViewKind kind) {
        OpenedPhoto opened = listener.state().photo();
        ViewModel model = new ViewModel();
        model.setView(200, 150);
        model.setPhoto(opened.width(), opened.height());
        editor.show(opened, model.placement(kind), kind);
        editor.settle();
        return model;
    }

    private int[] shown() {
        List<int[]> pixels = new ArrayList<>();
        editor.look(frame -> pixels.add(frame.pixels().clone()));
        return pixels.isEmpty() ? null : pixels.get(0);
    }

    /** Returns the mask that the editor saves, 1 and 0. */
    private byte[] mask() throws IOException {
        Path file = folder.resolve("current mask.png");
        assertTrue(editor.saveMask(file).join());
        return PictureFiles.readMask(file, listener.state().photo().width(),
                listener.state().photo().height());
    }

    // Opening

    @Test
    void photoOpensWithNothingSelected() {
        open();
        EditorState state = state();
        assertEquals(WIDTH, state.photo().width());
        assertEquals("photo.png", state.photo().name());
        assertEquals(0, state.selectedPixels());
        assertEquals(0, state.share());
        assertTrue(state.fill());
        assertFalse(state.canUndo() || state.canRedo() || state.unsaved());
        assertEquals("", state.work());
        assertEquals(NOTHING, said());
    }

    @Test
    void openingTellsWhatIsGoingOn() {
        open();
        assertTrue(listener.states().stream().anyMatch(s -> s.work().equals("Opening photo.png")));
    }

    @Test
    void fileThatCannotBeOpenedLeavesAllAsItIs() throws IOException {
        open();
        stroke(Mode.PAINT, 50, 40);
        EditorState before = state();
        editor.open(Files.writeString(folder.resolve("bad.png"), "no picture"));
        assertEquals(problem("bad.png cannot be opened: it is no picture. Choose a JPEG or PNG"
                + " file."), said());
        assertEquals(before, state());
        editor.open(folder.resolve("none.png"));
        assertEquals(problem("none.png cannot be opened: there is no such file. Choose a JPEG or"
                + " PNG file."), said());
        assertEquals(before, state());
    }

    @Test
    void nothingHappensWithoutAPhoto() {
        editor.invert();
        stroke(Mode.PAINT, 5, 5);
        editor.undo();
        editor.setFill(false);
        editor.lasso(Mode.LASSO_ADD, corners(1, 1));
        editor.moveDashes();
        editor.loadMask(folder.resolve("none.png"));
        assertEquals(NOTHING, said());
        assertNull(shown());
    }

    @Test
    void savingWithoutAPhotoFailsWithAMessage() {
        for (String name : List.of("m.png", "c.png", "v.png", "s.strokes")) {
            Path file = folder.resolve(name);
            boolean saved = switch (name) {
                case "m.png" -> editor.saveMask(file).join();
                case "c.png" -> editor.saveCutOut(file).join();
                case "v.png" -> editor.saveView(file).join();
                default -> editor.saveScript(file).join();
            };
            assertFalse(saved);
            assertEquals(problem(name + " cannot be saved: no photo is open."), said());
            assertFalse(Files.exists(file));
        }
    }

    @Test
    void anotherPhotoTakesThePlaceOfTheFirstAlsoInAStroke() throws IOException {
        open();
        editor.beginStroke(Mode.PAINT, BRUSH, 50, 40);
        editor.open(Photos.save(folder.resolve("other.png"), 30, 20));
        EditorState state = state();
        assertEquals("other.png", state.photo().name());
        assertEquals(0, state.selectedPixels());
        assertFalse(state.canUndo() || state.unsaved());
        editor.moveStroke(5, 5);
        editor.endStroke();
        assertEquals(0, state().selectedPixels());
        assertEquals(NOTHING, said());
    }

    @Test
    void photoOfOnePixelCanBeEdited() throws IOException {
        editor.open(Photos.save(folder.resolve("one.png"), 1, 1));
        editor.settle();
        ViewModel model = show(ViewKind.OUTLINE);
        for (Mode mode : List.of(Mode.GROW, Mode.PAINT, Mode.SHRINK, Mode.ERASE)) {
            editor.beginStroke(mode, new Brush(250, 200), 0, 0);
            editor.moveStroke(-400, 300);
            editor.endStroke();
        }
        model.zoom(0.001, 3, 3);
        editor.show(listener.state().photo(), model.placement(ViewKind.MASK), ViewKind.MASK);
        editor.lasso(Mode.LASSO_ADD, corners(-5, -5, 9, 9, 3, -7));
        editor.moveDashes();
        assertEquals(1, state().selectedPixels());
        editor.undo();
        editor.invert();
        assertEquals(1, state().selectedPixels());
        assertTrue(said().stream().allMatch(message -> message.kind() == Message.Kind.HINT));
        assertArrayEquals(new byte[] {1}, mask());
    }

    // Strokes

    @Test
    void strokeSelectsAndCountsItsDabs() {
        open();
        stroke(Mode.PAINT, 30, 40, 60, 40);
        EditorState state = state();
        assertTrue(state.selectedPixels() > 600, state.toString());
        assertEquals(state.selectedPixels() / (double) (WIDTH * HEIGHT), state.share());
        assertEquals(7, state.strokeDabs());
        assertTrue(state.canUndo() && state.unsaved());
        assertEquals(NOTHING, said());
    }

    @Test
    void undoRedoClearAndInvertDoWhatTheySay() throws IOException {
        open();
        stroke(Mode.PAINT, 30, 40);
        byte[] painted = mask();
        editor.undo();
        assertEquals(0, state().selectedPixels());
        assertTrue(state().canRedo());
        editor.redo();
        assertArrayEquals(painted, mask());
        int selected = state().selectedPixels();
        editor.invert();
        assertEquals(WIDTH * HEIGHT - selected, state().selectedPixels());
        editor.clear();
        assertEquals(0, state().selectedPixels());
        editor.undo();
        editor.undo();
        assertArrayEquals(painted, mask());
    }

    @Test
    void undoAndRedoWithoutAStepSaySo() {
        open();
        editor.undo();
        assertEquals(hint("There is nothing to undo."), said());
        editor.redo();
        assertEquals(hint("There is nothing to redo."), said());
        assertFalse(state().unsaved());
    }

    @Test
    void fillingDecidesWhatALassoTakes() {
        open();
        editor.setFill(false);
        assertFalse(state().fill());
        editor.lasso(Mode.LASSO_ADD, corners(20, 20, 60, 20, 60, 60));
        int outline = state().selectedPixels();
        assertEquals(hint(Hints.LASSO_OPEN), said());
        editor.undo();
        editor.setFill(true);
        editor.lasso(Mode.LASSO_ADD, corners(20, 20, 60, 20, 60, 60));
        assertTrue(state().selectedPixels() > 3 * outline);
        assertEquals(NOTHING, said());
    }

    @Test
    void lassoWithFewerThanThreeCornersIsNone() {
        open();
        editor.lasso(Mode.LASSO_ADD, corners(20, 20, 60, 20));
        assertEquals(hint(Hints.LASSO_TOO_SHORT), said());
        editor.lasso(Mode.LASSO_ADD, List.of());
        assertEquals(hint(Hints.LASSO_TOO_SHORT), said());
        assertFalse(state().canUndo() || state().unsaved());
    }

    @Test
    void cornersOutsideThePhotoAreMovedToItsBorder() throws IOException {
        open();
        editor.lasso(Mode.LASSO_ADD, corners(-50, -50, 999, -1, 999, 999, -3, 999));
        byte[] outside = mask();
        editor.undo();
        editor.lasso(Mode.LASSO_ADD,
                corners(0, 0, WIDTH - 1, 0, WIDTH - 1, HEIGHT - 1, 0, HEIGHT - 1));
        assertArrayEquals(outside, mask());
        assertEquals(WIDTH * HEIGHT, state().selectedPixels());
    }

    @Test
    void strokesThatDoNothingSayWhy() {
        open();
        stroke(Mode.SHRINK, 50, 40);
        assertEquals(hint("The smart eraser starts on a selected pixel. Begin inside the"
                + " selection."), said());
        stroke(Mode.PAINT, -50, 40);
        assertEquals(hint(Hints.OUTSIDE), said());
        stroke(Mode.GROW, 50, 40);
        assertEquals(NOTHING, said());
    }

    @Test
    void strokeThatMissesThePhotoLeavesNothingToSave() {
        open();
        stroke(Mode.PAINT, -50, 40);
        assertFalse(state().canUndo() || state().unsaved());
    }

    @Test
    void movesAndEndsWithoutABeginningDoNothing() {
        open();
        editor.moveStroke(50, 40);
        editor.endStroke();
        assertEquals(NOTHING, said());
        assertEquals(0, state().strokeDabs());
    }

    @Test
    void secondBeginningEndsTheFirstStroke() {
        open();
        editor.beginStroke(Mode.PAINT, BRUSH, 20, 20);
        editor.beginStroke(Mode.PAINT, new Brush(4, 1), 90, 60);
        editor.endStroke();
        assertEquals(NOTHING, said());
        int both = state().selectedPixels();
        editor.undo();
        int first = state().selectedPixels();
        assertTrue(first > 0 && first < both);
    }

    @Test
    void whatCannotBeDoneInAStrokeIsLeftOut() throws IOException {
        open();
        stroke(Mode.PAINT, 20, 20);
        int selected = state().selectedPixels();
        editor.beginStroke(Mode.PAINT, BRUSH, 60, 40);
        editor.undo();
        editor.redo();
        editor.clear();
        editor.invert();
        editor.setFill(false);
        editor.lasso(Mode.LASSO_ADD, corners(1, 1, 50, 1, 50, 50));
        assertTrue(state().fill());
        assertEquals(NOTHING, said());
        assertFalse(editor.saveMask(folder.resolve("m.png")).join());
        assertEquals(problem("m.png cannot be saved: a stroke is under way."), said());
        editor.endStroke();
        assertEquals(2 * selected, state().selectedPixels());
        editor.setFill(false);
        assertFalse(state().fill());
    }

    // The drawing

    @Test
    void everyDoneTaskIsDrawnInTheEnd() {
        open();
        show(ViewKind.MASK);
        int[] empty = shown();
        stroke(Mode.PAINT, 30, 40);
        editor.moveDashes();
        editor.settle();
        int[] painted = shown();
        assertFalse(Arrays.equals(empty, painted));
        editor.clear();
        editor.moveDashes();
        editor.moveDashes();
        editor.settle();
        assertArrayEquals(empty, shown());
    }

    @ParameterizedTest
    @EnumSource
    void dabsLeadToTheFrameThatIsDrawnAsAWhole(ViewKind kind) {
        open();
        show(kind);
        stroke(Mode.PAINT, 30, 40, 60, 60);
        stroke(Mode.GROW, 80, 30, 90, 50);
        editor.invert();
        stroke(Mode.ERASE, 30, 10, 60, 30);
        editor.undo();
        editor.settle();
        int[] changed = shown();
        show(kind);
        assertArrayEquals(changed, shown());
    }

    @Test
    void framesAreToldAndShowWhatWasAskedFor() {
        open();
        int before = listener.frames();
        ViewModel model = show(ViewKind.GREY_REST);
        assertTrue(listener.frames() > before);
        Placement placement = model.placement(ViewKind.GREY_REST);
        editor.look(frame -> {
            assertSame(ViewKind.GREY_REST, frame.kind());
            assertEquals(placement, frame.placement());
            assertEquals(placement.port().width() * placement.port().height(),
                    frame.pixels().length);
        });
        assertTrue(state().redrawNanos() >= 0);
    }

    @Test
    void movedDashesExchangeTheColoursOfTheOutline() {
        open();
        stroke(Mode.PAINT, 60, 40);
        editor.settle();
        show(ViewKind.OUTLINE);
        int[] before = shown();
        moveDashes();
        int[] moved = shown();
        assertFalse(Arrays.equals(before, moved));
        moveDashes();
        assertArrayEquals(before, shown());
    }

    /** Dashes move only when nothing else is to be done, such as to settle. */
    private void moveDashes() {
        int before = listener.frames();
        editor.moveDashes();
        listener.awaitFrameAfter(before);
    }

    @Test
    void placementOfAnEarlierPhotoDrawsNothing() throws IOException {
        open();
        OpenedPhoto earlier = listener.state().photo();
        ViewModel model = show(ViewKind.PHOTO);
        editor.open(Photos.save(folder.resolve("other.png"), 3, 2));
        editor.settle();
        assertNull(shown());
        editor.show(earlier, model.placement(ViewKind.OUTLINE), ViewKind.OUTLINE);
        stroke(Mode.PAINT, 1, 1);
        assertEquals(NOTHING, said());
        assertNull(shown());
        show(ViewKind.PHOTO);
        assertNotEquals(null, shown());
    }

    // Files

    @Test
    void savedMaskAndCutOutShowTheSelection() throws IOException {
        open();
        stroke(Mode.PAINT, 30, 40);
        int selected = state().selectedPixels();
        byte[] mask = mask();
        int[] pixels = Photo.read(photo).pixels();
        Path file = folder.resolve("cut.png");
        assertTrue(editor.saveCutOut(file).join());
        int[] cutOut = Photo.read(file).pixels();
        int ones = 0;
        for (int i = 0; i < mask.length; ++i) {
            ones += mask[i];
            assertEquals(mask[i] == 1 ? pixels[i] : 0, cutOut[i]);
        }
        assertEquals(selected, ones);
        assertEquals(List.of(new Message(Message.Kind.DONE, "Saved "
                + folder.resolve("current mask.png") + "."),
                new Message(Message.Kind.DONE, "Saved " + file + ".")), said());
    }

    @Test
    void savedViewIsWhatIsSeen() throws IOException {
        open();
        Path file = folder.resolve("view.png");
        assertFalse(editor.saveView(file).join());
        assertEquals(problem("view.png cannot be saved: nothing of the photo is seen."), said());
        show(ViewKind.OUTLINE);
        stroke(Mode.PAINT, 60, 40);
        editor.settle();
        List<Picture> seen = new ArrayList<>();
        editor.look(frame -> seen.add(frame.seen()));
        assertTrue(editor.saveView(file).join());
        assertArrayEquals(seen.get(0).pixels(), Photo.read(file).pixels());
        assertTrue(state().unsaved());
    }

    @Test
    void failedSavingIsToldAndLeavesTheSelectionUnsaved() {
        open();
        stroke(Mode.PAINT, 60, 40);
        Path missing = folder.resolve("none");
        assertFalse(editor.saveMask(missing.resolve("m.png")).join());
        assertEquals(problem("m.png cannot be saved: there is no folder " + missing
                + ". Choose another place."), said());
        assertFalse(editor.saveScript(Path.of("/")).join());
        assertEquals(1, said().size());
        assertTrue(state().unsaved());
    }

    @Test
    void selectionIsUnsavedFromAStepToTheNextSaving() {
        open();
        stroke(Mode.PAINT, 30, 40);
        assertTrue(state().unsaved());
        editor.saveScript(folder.resolve("s.strokes")).join();
        assertFalse(state().unsaved());
        editor.undo();
        assertTrue(state().unsaved());
        editor.saveMask(folder.resolve("m.png")).join();
        assertFalse(state().unsaved());
        editor.redo();
        editor.saveCutOut(folder.resolve("c.png")).join();
        assertFalse(state().unsaved());
        editor.saveMask(folder.resolve("m.png"));
        stroke(Mode.PAINT, 60, 40);
        assertTrue(state().unsaved());
    }

    @Test
    void loadedMaskIsTheSelectionAndOneStep() throws IOException {
        open();
        stroke(Mode.PAINT, 30, 40);
        byte[] first = mask();
        Path file = folder.resolve("m.png");
        editor.saveMask(file).join();
        editor.clear();
        stroke(Mode.PAINT, 90, 50);
        byte[] second = mask();
        show(ViewKind.MASK);
        editor.loadMask(file);
        editor.settle();
        assertArrayEquals(first, mask());
        editor.undo();
        assertArrayEquals(second, mask());
        editor.redo();
        editor.settle();
        assertArrayEquals(first, mask());
        int[] drawn = shown();
        show(ViewKind.MASK);
        assertArrayEquals(drawn, shown());
    }

    @Test
    void whatIsBeingSavedCountsAsSaved() {
        open();
        stroke(Mode.PAINT, 50, 40, 60, 40);
        assertTrue(editor.unsaved().join());
        editor.saveMask(folder.resolve("m.png"));
        assertFalse(editor.unsaved().join());
    }

    @Test
    void rootOfAllFoldersIsRefusedByItsName() {
        editor.open(Path.of("/"));
        assertEquals(problem("/ cannot be opened: it is a folder. Choose a JPEG or PNG file."),
                said());
    }

    @Test
    void maskOfAnotherSizeIsRefused() throws IOException {
        open();
        editor.loadMask(Photos.save(folder.resolve("m.png"), 3, 2));
        assertEquals(problem("m.png cannot be loaded: it has 3 x 2 pixels, the photo 120 x 80."
                + " Choose a mask saved from this photo."),
                said());
        assertFalse(state().canUndo());
    }

    @Test
    void maskIsNotLoadedInAStroke() throws IOException {
        open();
        editor.beginStroke(Mode.PAINT, BRUSH, 30, 40);
        editor.loadMask(Photos.save(folder.resolve("m.png"), WIDTH, HEIGHT));
        editor.settle();
        editor.endStroke();
        assertEquals(hint("m.png is not loaded, for a stroke is under way. Load it again."),
                said());
        assertTrue(state().selectedPixels() < WIDTH * HEIGHT);
    }

    // Life

    @Test
    void closingFinishesWhatIsBeingSaved() throws IOException {
        open();
        stroke(Mode.PAINT, 30, 40);
        Path file = folder.resolve("m.png");
        var saved = editor.saveMask(file);
        editor.close();
        assertTrue(saved.join());
        assertEquals(WIDTH, Photo.read(file).width());
    }

    @Test
    void nothingHappensAfterClosing() {
        open();
        show(ViewKind.OUTLINE);
        OpenedPhoto opened = state().photo();
        ViewModel model = new ViewModel();
        model.setPhoto(WIDTH, HEIGHT);
        editor.close();
        listener.takeMessages();
        editor.open(photo);
        editor.show(opened, model.placement(ViewKind.MASK), ViewKind.MASK);
        stroke(Mode.PAINT, 5, 5);
        editor.replay(folder.resolve("s.strokes"));
        editor.saveMask(folder.resolve("m.png"));
        editor.stopReplay();
        editor.close();
        assertNull(shown());
        assertEquals(NOTHING, listener.takeMessages());
        assertFalse(Files.exists(folder.resolve("m.png")));
    }

    @Test
    void anotherEditorCanBeOpenedAfterClosing() {
        open();
        editor.beginStroke(Mode.PAINT, BRUSH, 30, 40);
        editor.close();
        editor = new Editor(listener);
        open();
        stroke(Mode.PAINT, 30, 40);
        assertTrue(state().selectedPixels() > 0);
        assertEquals(NOTHING, said());
    }

    @Test
    void closingRightAfterOpeningLeavesNoSessionOpen() {
        for (int i = 0; i < 50; ++i) {
            editor.open(photo);
            editor.close();
            editor = new Editor(listener);
        }
        open();
        assertEquals(NOTHING, said());
        assertEquals(WIDTH, state().photo().width());
    }

    @Test
    void troubleInATaskIsToldAndTheEditorGoesOn() {
        open();
        editor.beginStroke(Mode.LASSO_ADD, BRUSH, 5, 5);
        assertEquals(problem("That did not work: the mode is lasso add, expected grow, shrink,"
                + " paint or erase."), said());
        stroke(Mode.PAINT, 30, 40);
        assertTrue(state().selectedPixels() > 0);
    }

    @Test
    void nothingIsLeftBesideSavedFiles() throws IOException {
        open();
        editor.saveMask(folder.resolve("m.png")).join();
        editor.saveScript(folder.resolve("s.strokes")).join();
        try (Stream<Path> files = Files.list(folder)) {
            assertEquals(List.of("m.png", "photo.png", "s.strokes"),
                    files.map(file -> file.getFileName().toString()).sorted().toList());
        }
    }
}
