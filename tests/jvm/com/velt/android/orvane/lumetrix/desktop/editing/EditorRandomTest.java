package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.graphics.Point;
import com.velt.android.orvane.lumetrix.desktop.PlayerRun;
import com.velt.android.orvane.lumetrix.selection.Mode;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;
import java.util.Random;
import java.util.stream.Stream;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Whatever is done in whatever order: nothing goes wrong, and what is seen is what there is. */
class EditorRandomTest {
    private static final int ROUNDS = 40;
    private static final int DEEDS = 80;

    @TempDir
    private Path folder;

    private final RecordingListener listener = new RecordingListener();
    private final ViewModel view = new ViewModel();
    private Random random;
    private Editor editor;

    @Test
    void anyOrderOfCommandsEndsWithTheSelectionThatIsShownCountedSavedAndReplayed()
            throws IOException {
        Path photo = Photos.savePatches(folder.resolve("photo.png"), 60, 40, 7);
        for (int seed = 0; seed < ROUNDS; ++seed) {
            random = new Random(seed);
            Path script = folder.resolve("s" + seed + ".strokes");
            String round = "seed " + seed;
            try (Editor opened = new Editor(listener)) {
                editor = opened;
                editor.open(photo);
                editor.settle();
                view.setPhoto(60, 40);
                for (int i = 0; i < DEEDS; ++i) deed();
                editor.endStroke();
                editor.setFill(true);
                editor.settle();
                assertEquals(List.of(), problems(), round);
                assertShown(round);
                assertSaved(script, round);
            }
            PlayerRun run = PlayerRun.of(script, "--out", folder);
            assertEquals(0, run.status(), round);
        }
    }

    private List<Message> problems() {
        return listener.takeMessages().stream()
                .filter(message -> message.kind() == Message.Kind.PROBLEM).toList();
    }

    private void deed() {
        switch (random.nextInt(14)) {
            case 0, 1 -> editor.beginStroke(Mode.values()[random.nextInt(4)],
                    new Brush(1 + random.nextInt(60), random.nextInt(9)), column(), row());
            case 2, 3, 4 -> editor.moveStroke(column(), row());
            case 5, 6 -> editor.endStroke();
            case 7 -> editor.lasso(random.nextBoolean() ? Mode.LASSO_ADD : Mode.LASSO_REMOVE,
                    Stream.generate(() -> new Point(column(), row()))
                            .limit(random.nextInt(8)).toList());
            case 8 -> editor.undo();
            case 9 -> editor.redo();
            case 10 -> editor.setFill(random.nextBoolean());
            case 11 -> editor.moveDashes();
            case 12 -> {
                if (random.nextBoolean()) editor.invert();
                if (random.nextInt(4) == 0) editor.clear();
            }
            default -> {
                view.setView(random.nextInt(90), random.nextInt(90));
                view.zoom(0.5 + random.nextDouble(), random.nextInt(90), random.nextInt(90));
                view.pan(random.nextInt(9) - 4, random.nextInt(9) - 4);
                show(ViewKind.values()[random.nextInt(5)]);
            }
        }
    }

    private int column() {
        return random.nextInt(80) - 10;
    }

    private int row() {
        return random.nextInt(60) - 10;
    }

    private void show(ViewKind kind) {
        editor.show(listener.state().photo(), view.placement(kind), kind);
    }

    private int[] part() {
        List<int[]> pixels = new ArrayList<>();
        editor.look(frame -> pixels.add(new Frame(frame.pixels(), new Placement(
                frame.placement().port(), frame.placement().part(), frame.placement().part(),
                0, 0), frame.kind()).seen().pixels()));
        return pixels.get(0);
    }

    private void assertShown(String round) {
        List<Frame> last = new ArrayList<>();
        editor.look(last::add);
        if (last.isEmpty()) return;  // nothing was to be shown yet
        int[] changed = part();
        editor.show(listener.state().photo(), last.get(0).placement(), last.get(0).kind());
        editor.settle();
        assertArrayEquals(part(), changed, round);
    }

    private void assertSaved(Path script, String round) throws IOException {
        Path file = folder.resolve("mask.png");
        assertTrue(editor.saveMask(file).join(), round);
        assertTrue(editor.saveScript(script).join(), round);
        int selected = 0;
        for (byte value : PictureFiles.readMask(file, 60, 40)) selected += value;
        editor.settle();
        EditorState state = listener.state();
        assertEquals(state.selectedPixels(), selected, round);
        assertTrue(!state.unsaved(), round);
        byte[] mask = PictureFiles.readMask(file, 60, 40);
        assertReplayed(script, mask, round);
    }

    private void assertReplayed(Path script, byte[] mask, String round) throws IOException {
        editor.replay(script);
        editor.settle();
        Path file = folder.resolve("replayed.png");
        assertTrue(editor.saveMask(file).join(), round);
        assertArrayEquals(mask, PictureFiles.readMask(file, 60, 40), round);
        Files.delete(file);
    }
}
