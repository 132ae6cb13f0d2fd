package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.awt.image.BufferedImage;
import java.io.IOException;
import java.nio.ByteBuffer;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.List;
import java.util.stream.Stream;
import java.util.zip.CRC32;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

class PlayerTest {
    private static final int WIDTH = 40;
    private static final int HEIGHT = 30;
    private static final int RED = 0xFFC00000;
    private static final int BLUE = 0xFF0000C0;
    private static final int GREY = 0xFF404040;  // of either colour

    @TempDir
    private Path folder;
    private Path out;

    @BeforeEach
    void savePhoto() throws IOException {
        BufferedImage image = new BufferedImage(WIDTH, HEIGHT, BufferedImage.TYPE_INT_RGB);
        for (int y = 0; y < HEIGHT; ++y) {
            for (int x = 0; x < WIDTH; ++x) image.setRGB(x, y, x < WIDTH / 2 ? RED : BLUE);
        }
        ImageIO.write(image, "png", folder.resolve("photo.png").toFile());
        out = folder.resolve("out");
    }

    @Test
    void eachStrokePrintsARow() throws IOException {
        PlayerRun run = play("photo photo.png", "brush 1 1", "grow 5,6", "grow 8,6 to 10,6 20,9");
        assertEquals(List.of(
                " line  what          where                              changed"
                        + "                    selected  object box",
                "    3  grow          5,6 (1 dab)                        5..5 x 6..6"
                        + "                       1  5..5 x 6..6",
                "    4  grow          8,6 .. 20,9 (4 dabs)               8..20 x 6..9"
                        + "                      5  5..20 x 6..9"), run.out().subList(0, 3));
    }

    /** Each command on a selection of nothing, and again on one of all 1200 pixels. */
    @ParameterizedTest
    @CsvSource({
        "'grow 10,10', 1, 1200",
        "'shrink 10,10', 0, 1199",
        "'paint 10,10', 4, 1200",
        "'erase 10,10', 0, 1196",
        "'lasso add 8,8 10,8 10,10 8,10', 9, 1200",
        "'lasso remove 8,8 10,8 10,10 8,10', 0, 1191"})
    void eachCommandIsAModeOfItsOwn(String line, String ofNone, String ofAll) throws IOException {
        PlayerRun none = play("photo photo.png", "brush 1 1", line);
        assertEquals(ofNone, selectedIn(lastRow(none)));
        PlayerRun all = play("photo photo.png", "brush 1 1", "invert", line);
        assertEquals(ofAll, selectedIn(lastRow(all)));
    }

    @Test
    void lassoPrintsItsCornersItsOutlineAndTheObjectBox() throws IOException {
        PlayerRun run = play("photo photo.png", "lasso add 5,6 9,6 9,10", "invert",
                "lasso remove 20,20 30,20 25,25");
        assertEquals("2 lasso add 5,6 .. 9,10 (3 corners) 5..9 x 6..10 15 5..9 x 6..10",
                squeezed(run.out()).get(1));
        assertEquals("4 lasso remove 20,20 .. 25,25 (3 corners) 20..30 x 20..25 1149"
                + " 0..39 x 0..29", squeezed(run.out()).get(3));
    }

    @Test
    void lassoWithFillOffIsFilledByALaterOne() throws IOException {
        PlayerRun run = play("photo photo.png", "fill off", "lasso add 5,6 9,6 9,10", "fill on",
                "lasso add 20,20 20,20 20,20");
        // Of twelve outline pixels the three corners hold 5, which does not count as selected.
        assertTrue(squeezed(run.out()).get(1).contains(" 9 5..9 x 6..10"), run.out().get(1));
        assertTrue(squeezed(run.out()).get(2).contains(" 16 5..20 x 6..20"), run.out().get(2));
    }

    @Test
    void shrinkingWithFillErasesTheSmallerPieceAndTheBoxFollows() throws IOException {
        String[] lines = {"photo photo.png", "brush 4 3", "", "paint 8,10 to 30,10",
            "shrink 14,7 14,11"};
        lines[2] = "fill on";
        assertEquals("5 shrink 14,7 .. 14,11 (2 dabs) 4..17 x 4..14 129 17..33 x 6..13",
                squeezed(play(lines).out()).get(2));
        lines[2] = "fill off";
        assertEquals("5 shrink 14,7 .. 14,11 (2 dabs) 11..17 x 4..14 183 4..33 x 6..13",
                squeezed(play(lines).out()).get(2));
    }

    @Test
    void largestAndSmallestBrushesArePlayed() throws IOException {
        PlayerRun run = play("photo photo.png", "brush 500 500", "paint 20,15", "brush 0 0",
                "erase 20,15", "shrink 20,15");
        assertEquals(List.of("3 paint 20,15 (1 dab) 0..39 x 0..29 1200 0..39 x 0..29",
                "5 erase 20,15 (1 dab) none 1200 0..39 x 0..29"),
                squeezed(run.out()).subList(1, 3));
        assertEquals(0, run.status());
    }

    @Test
    void strokeThatChangesNothingSaysSo() throws IOException {
        PlayerRun run = play("photo photo.png", "grow 0,0");
        assertEquals("2 grow 0,0 (1 dab) none 0 none", squeezed(run.out()).get(1));
    }

    @Test
    void rowsOfCommandsOnTheWholeSelectionHaveNoPlace() throws IOException {
        PlayerRun run = play("photo photo.png", "invert", "reset", "update-box");
        assertEquals(List.of("2 invert 0..39 x 0..29 1200 0..39 x 0..29",
                "3 reset 0..39 x 0..29 0 none", "4 update-box none 0 none"),
                squeezed(run.out().subList(1, 4)));
    }

    @Test
    void rowOfATakenSelectionSaysHowManyRowsItHas() throws IOException {
        PlayerRun run = play("photo photo.png", "select 12:5-9,14-20 13:5-5 29:0-39",
                "select 12:5-9", "select");
        assertEquals(List.of("2 select (3 rows) 0..39 x 12..29 53 0..39 x 12..29",
                "3 select (1 row) 0..39 x 12..29 5 5..9 x 12..12",
                "4 select (0 rows) 5..9 x 12..12 0 none"), squeezed(run.out().subList(1, 4)));
    }

    @Test
    void scriptWithoutStrokesPrintsOnlyTheDigest() throws IOException {
        PlayerRun run = play("photo photo.png");
        assertEquals(1, run.out().size());
        assertTrue(run.out().get(0).matches("digest [0-9A-F]{8}"), run.out().get(0));
        assertEquals(0, run.status());
    }

    @Test
    void digestIsOfMaskAndFittedView() throws IOException {
        BufferedImage image = new BufferedImage(640, 480, BufferedImage.TYPE_INT_RGB);
        image.setRGB(3, 4, 0x123456);
        ImageIO.write(image, "png", folder.resolve("photo.png").toFile());
        ByteBuffer bytes = ByteBuffer.allocate(640 * 480 * 5);
        bytes.position(640 * 480);
        for (int pixel : image.getRGB(0, 0, 640, 480, null, 0, 640)) bytes.putInt(pixel);
        CRC32 crc = new CRC32();
        crc.update(bytes.array());

        PlayerRun run = play("photo photo.png");

        assertEquals(List.of(String.format("digest %08X", crc.getValue())), run.out());
    }

    @Test
    void picturesAreWrittenAndListedInOrder() throws IOException {
        PlayerRun run = play("photo photo.png", "brush 3 1", "grow 10,10", "mask m.png",
                "colour-on-grey c.png", "reverse r.png", "view v.png 20 15 2 0 0");
        int count = run.out().size();
        assertEquals(Stream.of("m.png", "c.png", "r.png", "v.png")
                .map(name -> out.resolve(name).toString()).toList(),
                run.out().subList(count - 5, count - 1));
        assertEquals(List.of("c.png", "m.png", "r.png", "v.png"), filesIn(out));
        assertEquals(0, run.status());
    }

    @Test
    void maskPictureIsWhiteWhereSelected() throws IOException {
        play("photo photo.png", "brush 1 1", "grow 10,10", "mask m.png");
        int[] pixels = new int[WIDTH * HEIGHT];
        Arrays.fill(pixels, 0xFF000000);
        pixels[10 * WIDTH + 10] = 0xFFFFFFFF;
        assertArrayEquals(pixels, pixelsOf("m.png"));
    }

    @Test
    void compositesShowTheSelectionInColourOrGrey() throws IOException {
        play("photo photo.png", "brush 1 1", "grow 10,10", "colour-on-grey c.png",
                "reverse r.png");
        int[] colour = pixelsOf("c.png");
        int[] reverse = pixelsOf("r.png");
        for (int i = 0; i < colour.length; ++i) {
            int photo = i % WIDTH < WIDTH / 2 ? RED : BLUE;
            boolean selected = i == 10 * WIDTH + 10;
            assertEquals(selected ? photo : GREY, colour[i]);
            assertEquals(selected ? GREY : photo, reverse[i]);
        }
    }

    @Test
    void reverseLeavesTheSelectionAsItIs() throws IOException {
        PlayerRun plain = play("photo photo.png", "grow 10,10", "mask a.png");
        PlayerRun withReverse = play("photo photo.png", "grow 10,10", "reverse r.png",
                "mask b.png");
        assertArrayEquals(pixelsOf("a.png"), pixelsOf("b.png"));
        assertEquals(lastOf(plain.out()), lastOf(withReverse.out()));
    }

    @Test
    void viewFollowsScaleOffsetAndColours() throws IOException {
        play("photo photo.png", "brush 1 1", "grow 10,10",
                "view v.png 4 3 1 8 9 FF00FF00 FFFFFF00");
        assertArrayEquals(new int[] {
            RED, RED, RED, RED,
            RED, RED, 0xFF00FF00, RED,
            RED, RED, RED, RED}, pixelsOf("v.png"));
    }

    @Test
    void pictureShowsTheSelectionAtItsPlaceInTheScript() throws IOException {
        play("photo photo.png", "mask a.png", "invert", "mask b.png");
        assertEquals(0xFF000000, pixelsOf("a.png")[0]);
        assertEquals(0xFFFFFFFF, pixelsOf("b.png")[0]);
    }

    @Test
    void fillSwitchIsHandedToTheStroke() throws IOException {
        // Inverting leaves a hole at the dab's place, and an object box around the whole photo.
        String[] hole = {"photo photo.png", "brush 1 1", "grow 10,10", "invert", "", "grow 30,20"};
        hole[4] = "fill on";
        assertTrue(lastRow(play(hole)).contains(" 1200 "), "filled");
        hole[4] = "fill off";
        assertTrue(lastRow(play(hole)).contains(" 1199 "), "not filled");
    }

    @Test
    void eachRunStartsWithTheSameBrushAndNothingSelected() throws IOException {
        PlayerRun first = play("photo photo.png", "grow 10,10");
        play("photo photo.png", "brush 4 2", "grow 20,20");
        assertEquals(first, play("photo photo.png", "grow 10,10"));
    }

    @Test
    void expectedDigestGivesStatusZeroAndAnotherStatusOne() throws IOException {
        Path script = write("photo photo.png", "mask m.png");
        String digest = lastOf(PlayerRun.of(script, "--out", out).out()).substring(7);
        PlayerRun same = PlayerRun.of(script, "--out", out, "--expect", digest.toLowerCase());
        assertEquals(0, same.status());
        assertEquals(List.of(), same.err());

        PlayerRun other = PlayerRun.of(script, "--out", out, "--expect", "0BADF00D");
        assertEquals(1, other.status());
        assertEquals(List.of("Player: the selection has the digest " + digest
                + ", expected 0BADF00D"), other.err());
        assertEquals(List.of("m.png"), filesIn(out));
    }

    @Test
    void olderPicturesAreReplaced() throws IOException {
        Files.createDirectory(out);
        Files.writeString(out.resolve("m.png"), "old");
        assertEquals(0, play("photo photo.png", "mask m.png").status());
        assertEquals(WIDTH * HEIGHT, pixelsOf("m.png").length);
    }

    @Test
    void brokenScriptIsRefusedBeforeTheFirstStroke() throws IOException {
        assertRefused(4, "\"grwo\" is no command, expected photo, brush, fill, grow, shrink, paint,"
                + " erase, lasso, invert, reset, select, update-box,"
                + " view, colour-on-grey, reverse, mask",
                play("photo photo.png", "grow 5,5", "mask m.png", "grwo 5,5"));
    }

    @ParameterizedTest
    @CsvSource({"'grow 5,5 to 40,5', '40,5'", "'erase 5,30', '5,30'", "'grow -1,5', '-1,5'",
            "'lasso add 1,1 5,1 5,-2', '5,-2'"})
    void pointOutsideThePhotoIsRefusedBeforeTheFirstStroke(String line, String point)
            throws IOException {
        assertRefused(4, "the point " + point + " lies outside the photo, expected 0,0 to 39,29",
                play("photo photo.png", "grow 5,5", "mask m.png", line));
    }

    @ParameterizedTest
    @CsvSource({"'select 0:0-40', 0-40, 0", "'select 0:0-39 30:5-5', 5-5, 30"})
    void runBeyondThePhotoIsRefusedBeforeTheFirstStroke(String line, String run, String row)
            throws IOException {
        assertRefused(4, "the run " + run + " of row " + row + " reaches beyond the photo, expected"
                + " rows 0 to 29 and columns 0 to 39",
                play("photo photo.png", "grow 5,5", "mask m.png", line));
    }

    @Test
    void missingPhotoIsRefused() throws IOException {
        assertRefused(1, "the photo \"none.png\" cannot be read: there is no such file, expected a"
                + " JPEG or PNG file", play("photo none.png", "mask m.png"));
    }

    @Test
    void undecodablePhotoIsRefused() throws IOException {
        Files.writeString(folder.resolve("photo.png"), "no picture");
        assertRefused(2, "the photo \"photo.png\" cannot be read: it is no picture, expected a JPEG"
                + " or PNG file", play("# a photo", "photo photo.png", "mask m.png"));
    }

    @Test
    void missingScriptIsRefused() {
        Path script = folder.resolve("none.strokes");
        PlayerRun run = PlayerRun.of(script);
        assertEquals(2, run.status());
        assertEquals(List.of(script + ": the script cannot be read, expected a stroke script"),
                run.err());
    }

    @Test
    void folderThatCannotBeMadeIsRefusedBeforeTheFirstStroke() throws IOException {
        Path file = Files.writeString(folder.resolve("file"), "");
        Path script = write("photo photo.png", "grow 5,5", "mask m.png");
        PlayerRun run = PlayerRun.of(script, "--out", file.resolve("out"));
        assertEquals(2, run.status());
        assertEquals(List.of(), run.out());
        assertEquals(1, run.err().size());
        assertEquals(script + ":3: the picture cannot be written to \""
                + file.resolve("out/m.png") + "\": " + file + " is no folder, expected a folder to"
                + " write to", run.err().get(0));
        assertEquals(List.of("file", "photo.png", "s.strokes"), filesIn(folder));
    }

    @Test
    void pictureInPlaceOfAFolderIsRefusedBeforeTheFirstStroke() throws IOException {
        Files.createDirectories(out.resolve("m.png"));
        PlayerRun run = play("photo photo.png", "grow 5,5", "mask m.png");
        assertEquals(2, run.status());
        assertEquals(List.of(), run.out());
        assertTrue(run.err().get(0).endsWith("it is a folder, expected a file's name"),
                run.err().get(0));
        assertEquals(List.of("m.png"), filesIn(out));
    }

    @Test
    void pictureThatCannotBeWrittenLeavesNone() throws IOException {
        String tooLong = "x".repeat(300) + ".png";
        Path deep = out.resolve("deep");
        PlayerRun run = PlayerRun.of(
                write("photo photo.png", "mask m.png", "grow 5,5", "mask " + tooLong), "--out",
                deep);
        assertEquals(List.of(folder.resolve("s.strokes") + ":4: the picture cannot be written to \""
                + deep.resolve(tooLong) + "\": its name is too long, expected a shorter name"),
                run.err());
        assertEquals(2, run.status());
        assertFalse(Files.exists(out));
    }

    @Test
    void scriptWithoutPicturesNeedsNoFolder() throws IOException {
        Files.writeString(out, "a file in place of the folder");
        PlayerRun run = play("photo photo.png", "grow 5,5");
        assertEquals(List.of(), run.err());
        assertEquals(0, run.status());
    }

    @Test
    void missingLibraryIsOneLine() throws IOException, InterruptedException {
        Path script = write("photo photo.png", "grow 5,5", "mask m.png");
        ChildJvm child = ChildJvm.run(folder, Player.class, script.toString(), "--out",
                out.toString());
        assertEquals(2, child.status());
        assertEquals("", child.out());
        assertEquals(1, child.err().lines().count(), child.err());
        assertTrue(child.err().contains("./dev build"), child.err());
        assertFalse(Files.exists(out));
    }

    @ParameterizedTest
    @CsvSource({
        "'', no script is given",
        "a b, '\"b\" is a second script'",
        "a --out, --out lacks its value",
        "a --expect, --expect lacks its value",
        "a --record, --record lacks its value",
        "a --expect 12, '\"12\" is no digest of 8 hexadecimal digits'",
        "a --fast, there is no option --fast"})
    void wrongCommandLineIsOneLine(String arguments, String message) {
        Object[] words = arguments.isEmpty() ? new Object[0] : arguments.split(" ");
        PlayerRun run = PlayerRun.of(words);
        assertEquals(2, run.status());
        assertEquals(List.of("Player: " + message
                + ", expected Player SCRIPT [--out DIR] [--expect DIGEST] [--record FILE]"),
                run.err());
    }

    @Test
    void helpListsOptionsAndCommands() {
        PlayerRun run = PlayerRun.of("--help");
        assertEquals(0, run.status());
        assertTrue(run.out().contains(
                "Usage: Player SCRIPT [--out DIR] [--expect DIGEST] [--record FILE]"));
        for (String usage : ScriptParser.usages()) assertTrue(run.out().contains("  " + usage));
    }

    private PlayerRun play(String... lines) throws IOException {
        return PlayerRun.of(write(lines), "--out", out);
    }

    private Path write(String... lines) throws IOException {
        return Files.write(folder.resolve("s.strokes"), List.of(lines));
    }

    private void assertRefused(int line, String message, PlayerRun run) throws IOException {
        assertEquals(List.of(folder.resolve("s.strokes") + ":" + line + ": " + message), run.err());
        assertEquals(List.of(), run.out());
        assertEquals(2, run.status());
        assertFalse(Files.exists(out));
    }

    private int[] pixelsOf(String name) throws IOException {
        BufferedImage image = ImageIO.read(out.resolve(name).toFile());
        int width = image.getWidth();
        return image.getRGB(0, 0, width, image.getHeight(), null, 0, width);
    }

    private static List<String> filesIn(Path folder) throws IOException {
        try (Stream<Path> files = Files.list(folder)) {
            return files.map(file -> file.getFileName().toString()).sorted().toList();
        }
    }

    private static List<String> squeezed(List<String> rows) {
        return rows.stream().map(row -> row.strip().replaceAll(" +", " ")).toList();
    }

    private static String lastRow(PlayerRun run) {
        return run.out().get(run.out().size() - 2);
    }

    /** The count of selected pixels: the number before the object box. */
    private static String selectedIn(String row) {
        return row.replaceAll("(none|\\S+ x \\S+)$", "").strip().replaceAll(".* ", "");
    }

    private static String lastOf(List<String> lines) {
        return lines.get(lines.size() - 1);
    }
}
