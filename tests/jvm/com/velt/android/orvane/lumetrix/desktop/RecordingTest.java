package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.awt.image.BufferedImage;
import java.io.ByteArrayOutputStream;
import java.io.DataOutputStream;
import java.io.IOException;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import java.util.Map;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** What {@code --record} writes; tests/replay shows that it replays to the script's digest. */
class RecordingTest {
    private static final int SET_BRUSH = 1;
    private static final int INIT = 2;
    private static final int MODIFY = 3;
    private static final int INVERT = 4;
    private static final int RESET = 5;
    private static final int UPDATE_BOX = 6;
    private static final int DIGEST = 7;
    private static final int DESTROY = 8;
    private static final int SELECT = 9;

    @TempDir
    private Path folder;
    private Path file;

    @BeforeEach
    void savePhoto() throws IOException {
        BufferedImage image = new BufferedImage(3, 2, BufferedImage.TYPE_INT_RGB);
        for (int i = 0; i < 6; ++i) image.setRGB(i % 3, i / 3, 0x123450 + i);
        ImageIO.write(image, "png", folder.resolve("photo.png").toFile());
        file = folder.resolve("s.calls");
    }

    @Test
    void recordingHoldsThePhotoAndEachCall() throws IOException {
        PlayerRun run = record("photo photo.png", "brush 4 2", "grow 1,1 to 2,0", "fill off",
                "shrink 1,1", "erase 2,1", "fill on", "paint 0,1", "lasso add 0,0 2,0 2,1",
                "lasso remove 0,1 1,1 1,0", "invert", "reset", "update-box",
                "select 0:0-0,2-2 1:1-2", "select");
        assertEquals(List.of(), run.err());
        assertEquals(0, run.status());

        ByteArrayOutputStream expected = new ByteArrayOutputStream();
        expected.writeBytes("calls 1\n".getBytes(StandardCharsets.US_ASCII));
        DataOutputStream numbers = new DataOutputStream(expected);
        int[] sizesAndPixels = {3, 2, 0xFF123450, 0xFF123451, 0xFF123452, 0xFF123453, 0xFF123454,
            0xFF123455};
        for (int number : sizesAndPixels) numbers.writeInt(number);
        int[][] calls = {{SET_BRUSH, 10, 1}, {INIT}, {SET_BRUSH, 4, 2},
            {MODIFY, 0, 1, 1, 1, 1, 1}, {MODIFY, 0, 1, 2, 0, 2, 0},
            {MODIFY, 1, 0, 1, 1, 1, 1}, {MODIFY, 3, 0, 2, 1, 2, 1}, {MODIFY, 2, 1, 0, 1, 0, 1},
            {MODIFY, 4, 0, 0, 0, 2, 0}, {MODIFY, 4, 0, 2, 0, 2, 1}, {MODIFY, 4, 1, 2, 1, 0, 0},
            {MODIFY, 5, 0, 0, 1, 1, 1}, {MODIFY, 5, 0, 1, 1, 1, 0}, {MODIFY, 5, 1, 1, 0, 0, 1},
            {INVERT}, {RESET}, {UPDATE_BOX}, {SELECT, 3, 0, 0, 0, 0, 2, 2, 1, 1, 2}, {SELECT, 0},
            {DIGEST}, {DESTROY}};
        for (int[] call : calls) {
            numbers.writeByte(call[0]);
            for (int i = 1; i < call.length; ++i) numbers.writeInt(call[i]);
        }
        assertArrayEquals(expected.toByteArray(), Files.readAllBytes(file));
    }

    @Test
    void picturesAreNoCallsAndChangeNothingElse() throws IOException {
        PlayerRun plain = record("photo photo.png", "paint 1,1");
        byte[] calls = Files.readAllBytes(file);
        PlayerRun withPictures = record("photo photo.png", "paint 1,1", "mask m.png",
                "view v.png 3 2 1 0 0", "reverse r.png", "colour-on-grey c.png");
        assertArrayEquals(calls, Files.readAllBytes(file));
        assertEquals(lastOf(plain.out()), lastOf(withPictures.out()));
    }

    @Test
    void recordingChangesNothingThatThePlayerPrints() throws IOException {
        Path script = write("photo photo.png", "paint 1,1");
        PlayerRun without = PlayerRun.of(script);
        assertFalse(Files.exists(file));
        assertEquals(without, PlayerRun.of(script, "--record", file));
    }

    @Test
    void undoCannotBeRecordedAndIsRefusedBeforeItBegins() throws IOException {
        Photo photo = new Photo(3, 2, new int[6]);
        try (Outputs outputs = new Outputs(Map.of());
                Recording recording = new Recording(outputs.add(file), photo);
                SelectionSession session =
                        new SelectionSession(photo.pixels(), 3, 2, 1000, recording)) {
            session.invert();
            IllegalStateException e =
                    assertThrows(IllegalStateException.class, session::undo);
            assertEquals("undo and redo cannot be recorded, expected a script of what is in effect",
                    e.getMessage());
            assertEquals(6, session.selectedPixels());
            assertTrue(session.canUndo());
        }
    }

    @Test
    void olderRecordingIsReplaced() throws IOException {
        Files.write(file, new byte[10_000]);
        record("photo photo.png");
        byte[] calls = Files.readAllBytes(file);
        assertTrue(calls.length < 100, calls.length + " bytes");
        assertEquals(DESTROY, calls[calls.length - 1]);
    }

    @Test
    void scriptThatFailsLeavesTheOlderRecording() throws IOException {
        Files.writeString(file, "older");
        PlayerRun run = PlayerRun.of(
                write("photo photo.png", "mask " + "x".repeat(300) + ".png"), "--out",
                folder.resolve("out"), "--record", file);
        assertEquals(2, run.status());
        assertEquals("older", Files.readString(file));
    }

    @Test
    void fileThatCannotBeMadeIsRefusedBeforeTheFirstStroke() throws IOException {
        Path missing = folder.resolve("none");
        assertRefused(missing.resolve("s.calls"), "there is no folder " + missing
                + ", expected a folder that exists");
        assertRefused(folder, "it is a folder, expected a file's name");
        assertRefused(Path.of("/dev/full"), "it is a device or a pipe, expected an ordinary file");
    }

    private void assertRefused(Path unwritable, String why) throws IOException {
        Path script = write("photo photo.png", "grow 1,1", "mask m.png");
        PlayerRun run = PlayerRun.of(script, "--out", folder.resolve("out"), "--record",
                unwritable);
        assertEquals(2, run.status());
        assertEquals(List.of(), run.out());
        assertEquals(List.of(script + ": the calls cannot be written to \"" + unwritable + "\": "
                + why), run.err());
        assertFalse(Files.exists(folder.resolve("out")));
    }

    private PlayerRun record(String... lines) throws IOException {
        return PlayerRun.of(write(lines), "--out", folder.resolve("out"), "--record", file);
    }

    private Path write(String... lines) throws IOException {
        return Files.write(folder.resolve("s.strokes"), List.of(lines));
    }

    private static String lastOf(List<String> lines) {
        return lines.get(lines.size() - 1);
    }
}
