package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.io.File;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.attribute.PosixFilePermissions;
import java.util.ArrayList;
import java.util.List;
import java.util.Map;
import java.util.TreeMap;
import java.util.concurrent.TimeUnit;
import java.util.stream.Stream;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.ValueSource;

/** The player as a process of its own: whatever it is asked to write, it destroys nothing. */
class PlayerOutputsTest {
    private static final String IS_PHOTO = ": it is the script's photo and would be replaced,"
            + " expected another name or folder";
    private static final String IS_SCRIPT = ": it is the script and would be replaced, expected"
            + " another name or folder";
    private static final String SAME = ": another output goes to the same file, expected a file for"
            + " each";

    @TempDir
    private Path scratch;
    private PlayerProcess process;
    private Path folder;  // what it may spoil

    @BeforeEach
    void savePhoto() throws IOException {
        process = new PlayerProcess(scratch);
        folder = process.folder();
        script("photo photo.png", "mask photo.png");
    }

    private void script(String... lines) throws IOException {
        process.script(lines);
    }

    private ChildJvm play(String... arguments) throws IOException, InterruptedException {
        return process.run(List.of(), arguments);
    }

    /** Returns everything in the folder: for each path the bytes of a file, or what else it is. */
    private Map<String, String> contents() throws IOException {
        Map<String, String> contents = new TreeMap<>();
        try (Stream<Path> paths = Files.walk(folder)) {
            for (Path path : paths.toList()) {
                String what = Files.isDirectory(path) ? "folder"
                        : new String(Files.readAllBytes(path), "ISO-8859-1");
                contents.put(folder.relativize(path).toString(), what);
            }
        }
        return contents;
    }

    /** Plays, and sees to it that one line says why not, and that the folder is as it was. */
    private void assertRefused(String line, String... arguments)
            throws IOException, InterruptedException {
        Map<String, String> before = contents();
        ChildJvm run = play(arguments);
        assertEquals(line + "\n", run.err());
        assertEquals("", run.out());
        assertEquals(2, run.status());
        assertEquals(before, contents());
    }

    private static String picture(String place, String why) {
        return "s.strokes:2: the picture cannot be written to \"" + place + "\"" + why;
    }

    private static String recording(String place, String why) {
        return "s.strokes: the calls cannot be written to \"" + place + "\"" + why;
    }

    @Test
    void pictureIsNotWrittenOverThePhoto() throws Exception {
        assertRefused(picture("photo.png", IS_PHOTO), "s.strokes");
        assertRefused(picture("./photo.png", IS_PHOTO), "s.strokes", "--out", ".");
    }

    @Test
    void pictureIsNotWrittenOverThePhotoByAnotherPath() throws Exception {
        Files.createDirectory(folder.resolve("sub"));
        Files.createSymbolicLink(folder.resolve("link"), folder);
        assertRefused(picture("sub/../photo.png", IS_PHOTO), "s.strokes", "--out", "sub/..");
        assertRefused(picture("link/photo.png", IS_PHOTO), "s.strokes", "--out", "link");
        String absolute = folder.toString();
        assertRefused(picture(absolute + "/photo.png", IS_PHOTO), "s.strokes", "--out", absolute);
        assertRefused(picture("new/../photo.png", IS_PHOTO), "s.strokes", "--out", "new/..");
    }

    @Test
    void pictureIsNotWrittenOverThePhotoThroughALink() throws Exception {
        script("photo photo.png", "mask m.png");
        Files.createSymbolicLink(folder.resolve("m.png"), Path.of("photo.png"));
        assertRefused(picture("m.png", IS_PHOTO), "s.strokes");
        Files.delete(folder.resolve("m.png"));
        Files.createLink(folder.resolve("m.png"), folder.resolve("photo.png"));
        assertRefused(picture("m.png", IS_PHOTO), "s.strokes");
    }

    @Test
    void pictureIsNotWrittenOverAPhotoThatIsALink() throws Exception {
        script("photo link.png", "mask photo.png");
        Files.createSymbolicLink(folder.resolve("link.png"), Path.of("photo.png"));
        assertRefused(picture("photo.png", IS_PHOTO), "s.strokes");
    }

    @Test
    void pictureIsNotWrittenOverTheScript() throws Exception {
        Files.write(folder.resolve("s.png"), List.of("photo photo.png", "mask s.png"));
        assertRefused("s.png:2: the picture cannot be written to \"s.png\"" + IS_SCRIPT, "s.png");
    }

    @Test
    void callsAreNotWrittenOverScriptPhotoOrPicture() throws Exception {
        script("photo photo.png", "mask m.png");
        Files.createLink(folder.resolve("hard"), folder.resolve("s.strokes"));
        Files.createSymbolicLink(folder.resolve("soft"), Path.of("photo.png"));
        assertRefused(recording("s.strokes", IS_SCRIPT), "s.strokes", "--record", "s.strokes");
        assertRefused(recording("hard", IS_SCRIPT), "s.strokes", "--record", "hard");
        assertRefused(recording("photo.png", IS_PHOTO), "s.strokes", "--record", "photo.png");
        assertRefused(recording("soft", IS_PHOTO), "s.strokes", "--record", "soft");
        assertRefused(recording("m.png", SAME), "s.strokes", "--record", "m.png");
        assertRefused(recording("new/m.png", SAME), "s.strokes", "--out", "new", "--record",
                "new/m.png");
    }

    @Test
    void outputThatIsAFolderIsRefused() throws Exception {
        script("photo photo.png", "mask m.png");
        Files.createDirectory(folder.resolve("sub"));
        String isFolder = ": it is a folder, expected a file's name";
        assertRefused(recording("sub", isFolder), "s.strokes", "--record", "sub");
        assertRefused(recording("new", isFolder), "s.strokes", "--out", "new", "--record", "new");
        Files.createDirectory(folder.resolve("m.png"));
        assertRefused(picture("m.png", isFolder), "s.strokes");
    }

    @Test
    void outputThatIsNoFileIsRefused() throws Exception {
        String isDevice = ": it is a device or a pipe, expected an ordinary file";
        script("photo photo.png");
        assertRefused(recording("/dev/null", isDevice), "s.strokes", "--record", "/dev/null");
    }

    @Test
    void linkThatLeadsNowhereIsRefused() throws Exception {
        script("photo photo.png");
        Path link = Files.createSymbolicLink(scratch.resolve("link"), Path.of("none"));
        assertRefused(recording(link.toString(), ": it is a link to a file that is missing,"
                + " expected a name that is free"), "s.strokes", "--record", link.toString());
    }

    @Test
    void fileInPlaceOfTheFolderIsRefused() throws Exception {
        script("photo photo.png", "mask m.png");
        String isFile = ": " + folder.toRealPath().resolve("s.strokes")
                + " is no folder, expected a folder to write to";
        assertRefused(picture("s.strokes/m.png", isFile), "s.strokes", "--out", "s.strokes");
        assertRefused(picture("s.strokes/deep/m.png", isFile), "s.strokes", "--out",
                "s.strokes/deep");
    }

    @Test
    void fileBehindALinkIsReplacedAndTheLinkStays() throws Exception {
        script("photo photo.png", "mask m.png");
        Files.createDirectory(folder.resolve("far"));
        Files.writeString(folder.resolve("far/real.png"), "old");
        Files.createSymbolicLink(folder.resolve("m.png"), Path.of("far/real.png"));
        Files.setPosixFilePermissions(folder.resolve("far/real.png"),
                PosixFilePermissions.fromString("rw-r-----"));

        ChildJvm run = play("s.strokes");

        assertEquals("", run.err());
        assertTrue(Files.isSymbolicLink(folder.resolve("m.png")));
        assertEquals(PlayerProcess.PHOTO_SIDE,
                ImageIO.read(folder.resolve("far/real.png").toFile()).getWidth());
        assertEquals("rw-r-----", PosixFilePermissions.toString(
                Files.getPosixFilePermissions(folder.resolve("far/real.png"))));
        assertEquals(List.of("", "far", "far/real.png", "m.png", "photo.png", "s.strokes"),
                List.copyOf(contents().keySet()));
    }

    /**
     * Stops the player while it waits for somebody to read its rows: by then it has written a
     * picture, and has not put it into its place.
     */
    @ParameterizedTest
    @ValueSource(strings = {"INT", "TERM", "HUP"})
    void stopLeavesEverythingAsItWas(String signal) throws Exception {
        List<String> lines = new ArrayList<>(List.of("photo photo.png", "mask m.png"));
        for (int i = 0; i < 3000; ++i) lines.add("paint 5,5");  // rows beyond what a pipe holds
        lines.add("mask n.png");
        script(lines.toArray(String[]::new));
        Files.writeString(folder.resolve("m.png"), "older");
        Files.writeString(folder.resolve("calls"), "older");
        Map<String, String> before = contents();

        Process player = process.player(List.of("env", "--default-signal=" + signal), "s.strokes",
                "--record", "calls", "--out", ".").start();
        while (hiddenBytes() == 0) {
            assertTrue(player.isAlive(), process.err());
            Thread.sleep(10);
        }
        assertEquals(0, new ProcessBuilder("kill", "-" + signal, String.valueOf(player.pid()))
                .start().waitFor());
        assertTrue(player.waitFor(1, TimeUnit.MINUTES));

        assertTrue(player.exitValue() > 128, "status " + player.exitValue());
        assertEquals(before, contents());
    }

    private long hiddenBytes() throws IOException {
        long bytes = 0;
        try (Stream<Path> files = Files.list(folder)) {
            for (Path file : files.toList()) {
                if (file.getFileName().toString().startsWith(".")) bytes += Files.size(file);
            }
        }
        return bytes;
    }

    @Test
    void rowsThatCannotBePrintedAreAFailure() throws Exception {
        script("photo photo.png", "paint 5,5");
        Process player = process.player(List.of(), "s.strokes")
                .redirectOutput(new File("/dev/full")).start();
        assertEquals(2, player.waitFor());
        assertEquals(List.of("Player: not everything could be printed, for the disk of the standard"
                + " output is full or its reader has ended, expected another place for the"
                + " standard output"), process.err().lines().toList());
    }

    @Test
    void everythingIsWrittenInTheEndAndNothingElse() throws Exception {
        script("photo photo.png", "paint 5,5", "mask m.png", "reverse r.png");
        Files.writeString(folder.resolve("m.png"), "older");
        byte[] photo = Files.readAllBytes(folder.resolve("photo.png"));
        ChildJvm run = play("s.strokes", "--record", "calls", "--out", "new/deep/..");
        assertEquals("", run.err());
        assertEquals(0, run.status());
        assertEquals(List.of("", "calls", "m.png", "new", "new/deep", "new/m.png", "new/r.png",
                "photo.png", "s.strokes"), List.copyOf(contents().keySet()));
        assertEquals("older", contents().get("m.png"));
        assertArrayEquals(photo, Files.readAllBytes(folder.resolve("photo.png")));
        assertFalse(contents().get("calls").isEmpty());
    }
}
