package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.velt.android.orvane.lumetrix.desktop.ChildJvm;
import com.velt.android.orvane.lumetrix.desktop.JpegToPng;
import com.velt.android.orvane.lumetrix.desktop.PlayerRun;
import com.velt.android.orvane.lumetrix.selection.Mode;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import java.util.Random;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Scripts that the editor saves and plays. */
class EditorReplayTest {
    private static final Path DESKTOP = Path.of(System.getProperty("desktop.folder", "desktop"));
    private static final Brush BRUSH = new Brush(10, 3);

    @TempDir
    private Path folder;

    private final RecordingListener listener = new RecordingListener();
    private Editor editor;

    @BeforeEach
    void begin() {
        editor = new Editor(listener);
    }

    @AfterEach
    void end() {
        editor.close();
    }

    private void open(Path photo) {
        editor.open(photo);
        editor.settle();
    }

    /** Plays a script to its end or until it is stopped. */
    private List<Message> replay(Path script) {
        editor.replay(script);
        editor.settle();
        return listener.takeMessages();
    }

    private void stroke(Mode mode, int x, int y, int toX, int toY) {
        editor.beginStroke(mode, BRUSH, x, y);
        editor.moveStroke(toX, toY);
        editor.endStroke();
    }

    private byte[] mask() throws IOException {
        Path file = folder.resolve("mask.png");
        assertTrue(editor.saveMask(file).join());
        OpenedPhoto photo = listener.state().photo();
        return PictureFiles.readMask(file, photo.width(), photo.height());
    }

    private static List<Message> done(String text) {
        return List.of(new Message(Message.Kind.DONE, text));
    }

    /** Saves what was done and plays it: the player and the editor end with the same selection. */
    private void assertReplays(Path script) throws IOException {
        byte[] mask = mask();
        assertTrue(editor.saveScript(script).join());
        int selected = listener.state().selectedPixels();
        editor.close();  // a process has one session
        PlayerRun run = PlayerRun.of(script, "--out", folder);
        assertEquals(List.of(), run.err());
        String digest = run.out().get(run.out().size() - 1);
        editor = new Editor(listener);
        listener.takeMessages();
        assertEquals(done("Replayed " + script.getFileName() + ", " + digest + "."),
                replay(script));
        assertArrayEquals(mask, mask());
        assertEquals(selected, listener.state().selectedPixels());
    }

    @Test
    void savedScriptReplaysToTheSameSelection() throws IOException {
        Random random = new Random(5);
        open(Photos.savePatches(folder.resolve("my photo.png"), 120, 80, 1));
        Mode[] modes = {Mode.GROW, Mode.PAINT, Mode.SHRINK, Mode.ERASE};
        for (int i = 0; i < 30; ++i) {
            editor.setFill(random.nextInt(4) > 0);
            stroke(modes[random.nextInt(4)], random.nextInt(140) - 10, random.nextInt(100) - 10,
                    random.nextInt(140) - 10, random.nextInt(100) - 10);
            if (random.nextInt(6) == 0) editor.undo();
            if (random.nextInt(9) == 0) editor.redo();
            if (random.nextInt(9) == 0) editor.invert();
        }
        assertReplays(Files.createDirectories(folder.resolve("scripts")).resolve("s.strokes"));
    }

    @Test
    void scriptOfAReducedPhotoReplaysToTheSameSelection() throws IOException {
        open(Photos.save(folder.resolve("large.png"), 5001, 2510));
        assertEquals(List.of(new Message(Message.Kind.HINT, "large.png has 5001 x 2510 pixels and"
                + " is reduced to 4990 x 2504 for editing.")), listener.takeMessages());
        stroke(Mode.PAINT, 4900, 2400, 4989, 2503);
        assertReplays(folder.resolve("s.strokes"));
        assertEquals("s-photo.png", listener.state().photo().name());
    }

    @Test
    void scriptWithALoadedMaskReplaysToTheSameSelection() throws IOException {
        Path photo = Photos.savePatches(folder.resolve("photo.png"), 120, 80, 1);
        int[] pixels = new int[120 * 80];
        for (int i = 0; i < pixels.length; ++i) pixels[i] = i % 7 < 3 ? 0xFFFFFFFF : 0xFF000000;
        Path loaded = Photos.save(folder.resolve("loaded.png"), 120, 80, pixels);
        open(photo);
        stroke(Mode.PAINT, 20, 20, 60, 60);
        editor.loadMask(loaded);
        editor.settle();
        assertArrayEquals(PictureFiles.readMask(loaded, 120, 80), mask());
        stroke(Mode.GROW, 40, 40, 90, 30);
        stroke(Mode.ERASE, 90, 60, 100, 60);
        assertReplays(folder.resolve("s.strokes"));
    }

    @Test
    void projectsScriptEndsWithItsDigest() throws IOException, InterruptedException {
        Path script = fig();
        assertEquals(done("Replayed fig.strokes, digest 384A3168."), replay(script));
        EditorState state = listener.state();
        assertEquals("fig.jpg", state.photo().name());
        assertTrue(state.selectedPixels() > 0 && state.canUndo());
        assertFalse(state.unsaved());
        assertEquals("", state.work());
        assertEquals(0, state.workTotal());
    }

    /** Returns the fig's script beside its photo stored as PNG, under the name the script has. */
    private Path fig() throws IOException, InterruptedException {
        Path scripts = Files.createDirectories(folder.resolve("scripts"));
        Files.createDirectories(folder.resolve("photos"));
        ChildJvm conversion = ChildJvm.run(folder, JpegToPng.class,
                DESKTOP.resolve("photos/fig.jpg").toString(),
                folder.resolve("photos/fig.jpg").toString());
        assertEquals("", conversion.err());
        return Files.copy(DESKTOP.resolve("scripts/fig.strokes"), scripts.resolve("fig.strokes"));
    }

    /** Returns a script that takes much longer than a test. */
    private Path endless() throws IOException {
        Photos.save(folder.resolve("photo.png"), 200, 100);
        return Files.writeString(folder.resolve("endless.strokes"), "photo photo.png\nbrush 60 5\n"
                + "paint 100,50\n" + "grow 50,50 150,50\nreset\n".repeat(20_000));
    }

    @Test
    void stoppedReplayKeepsWhatItHasDoneAndAllowsStrokesAgain() throws IOException {
        editor.replay(endless());
        listener.awaitState(state -> state.work().startsWith("Replaying")
                && state.workDone() > 2);
        assertEquals("Replaying endless.strokes", listener.state().work());
        assertEquals(40_002, listener.state().workTotal());
        editor.stopReplay();
        editor.settle();
        List<Message> messages = listener.takeMessages();
        assertEquals(1, messages.size(), messages.toString());
        assertTrue(messages.get(0).text().matches(
                "Stopped endless\\.strokes after [0-9]+ of 40002 commands\\."),
                messages.toString());
        assertEquals("photo.png", listener.state().photo().name());
        editor.clear();
        stroke(Mode.PAINT, 50, 50, 60, 50);
        editor.settle();
        assertTrue(listener.state().selectedPixels() > 0);
        assertEquals(List.of(), listener.takeMessages());
    }

    @Test
    void nothingElseIsDoneDuringAReplay() throws IOException {
        editor.replay(endless());
        editor.clear();
        editor.open(folder.resolve("photo.png"));
        editor.replay(folder.resolve("endless.strokes"));
        assertFalse(editor.saveMask(folder.resolve("m.png")).join());
        Message refusal = new Message(Message.Kind.HINT,
                "A script is being replayed. Stop it first.");
        assertEquals(List.of(refusal, refusal, refusal, refusal), listener.takeMessages());
        editor.stopReplay();
        editor.settle();
        assertFalse(Files.exists(folder.resolve("m.png")));
    }

    @Test
    void selectedPixelsAreCountedDuringAReplay() throws IOException {
        editor.replay(endless());
        listener.awaitState(state -> state.workDone() > 0 && state.selectedPixels() > 0);
        editor.stopReplay();
    }

    @Test
    void closingStopsAReplay() throws IOException {
        editor.replay(endless());
        listener.awaitState(state -> state.workDone() > 2);
        editor.close();
        assertEquals(1, listener.takeMessages().size());
    }

    @Test
    void replayIsSeenWhileItGoesOn() throws IOException {
        Path script = endless();
        open(folder.resolve("photo.png"));
        editor.replay(script);
        listener.awaitState(state -> state.workDone() > 2);
        OpenedPhoto photo = listener.state().photo();
        ViewModel model = new ViewModel();
        model.setView(50, 50);
        model.setPhoto(photo.width(), photo.height());
        int before = listener.frames();
        editor.show(photo, model.placement(ViewKind.MASK), ViewKind.MASK);
        listener.awaitFrameAfter(before);
        editor.stopReplay();
    }

    @Test
    void scriptThatCannotBePlayedLeavesThePhotoAlone() throws IOException {
        open(Photos.save(folder.resolve("photo.png"), 120, 80));
        stroke(Mode.PAINT, 50, 40, 60, 40);
        editor.settle();
        EditorState before = listener.state();
        Path script = Files.writeString(folder.resolve("s.strokes"), "photo photo.png\npaint x\n");
        assertEquals(List.of(new Message(Message.Kind.PROBLEM, "s.strokes cannot be played: "
                + "s.strokes:2: \"x\" is no point, expected a point X,Y such as 120,45.")),
                replay(script));
        assertEquals(before, listener.state());
        editor.undo();
        editor.settle();
        assertEquals(0, listener.state().selectedPixels());
        assertEquals(List.of(), listener.takeMessages());
    }

    @Test
    void strokesAreAllowedAfterEachOfManyShortReplays() throws IOException {
        Photos.save(folder.resolve("photo.png"), 20, 10);
        Path good = Files.writeString(folder.resolve("s.strokes"), "photo photo.png\n");
        Path bad = Files.writeString(folder.resolve("bad.strokes"), "photo none.png\n");
        for (int i = 0; i < 100; ++i) {
            replay(i % 3 == 2 ? bad : good);
            editor.invert();
            editor.settle();
            assertEquals(List.of(), listener.takeMessages());
        }
    }

    @Test
    void picturesOfAScriptAreNotWritten() throws IOException {
        Photos.save(folder.resolve("photo.png"), 20, 10);
        Path script = Files.writeString(folder.resolve("s.strokes"),
                "photo photo.png\ninvert\nmask picture.png\n");
        assertTrue(replay(script).get(0).text().startsWith("Replayed s.strokes, digest "));
        assertEquals(200, listener.state().selectedPixels());
        assertFalse(Files.exists(folder.resolve("picture.png")));
    }
}
