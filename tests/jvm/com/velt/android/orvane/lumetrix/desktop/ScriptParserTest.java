package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.graphics.Point;
import com.velt.android.orvane.lumetrix.selection.Mode;
import java.nio.charset.StandardCharsets;
import java.nio.file.Path;
import java.util.List;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

class ScriptParserTest {
    @Test
    void photoIsFoundWithItsLine() throws ScriptException {
        Script script = parse("# a comment\n\n  photo ../a.jpg  # the photo\n");
        assertEquals(new Script(3, "../a.jpg", List.of()), script);
    }

    @Test
    void wordInQuotesMayHoldBlanksAndCommentSigns() throws ScriptException {
        assertEquals("my #1 photo.png", parse("photo \"my #1 photo.png\"").photo());
    }

    @Test
    void commentSignInsideAWordIsPartOfIt() throws ScriptException {
        assertEquals("a#1.png", parse("photo a#1.png").photo());
    }

    @Test
    void linesMayEndInCarriageReturnAndTheFileBeginWithAMark() throws ScriptException {
        Script script = parse("\uFEFFphoto \u00E4.png\r\ninvert\r\n");
        assertEquals("\u00E4.png", script.photo());
        assertEquals(2, script.commands().get(0).line());
    }

    @Test
    void brushAndFill() throws ScriptException {
        assertEquals(new Command.Brush(2, 28, 4), command("brush 28 4"));
        assertEquals(new Command.Brush(2, 0, 0), command("brush 0 0"));
        assertEquals(new Command.Brush(2, 0, 500), command("brush 0 500"));
        assertEquals(new Command.Brush(2, 500, 0), command("brush 500 0"));
        assertEquals(new Command.Fill(2, true), command("fill on"));
        assertEquals(new Command.Fill(2, false), command("fill off"));
    }

    @ParameterizedTest
    @CsvSource({"grow, GROW", "shrink, SHRINK", "paint, PAINT", "erase, ERASE"})
    void strokes(String word, Mode mode) throws ScriptException {
        DabPath path = new DabPath(List.of(
                new DabPath.Stop(new Point(1, 2), false),
                new DabPath.Stop(new Point(3, 4), true),
                new DabPath.Stop(new Point(5, 6), false)));
        assertEquals(new Command.Stroke(2, mode, path), command(word + " 1,2 to 3,4 5,6"));
    }

    @ParameterizedTest
    @CsvSource({"add, LASSO_ADD", "remove, LASSO_REMOVE"})
    void lassos(String word, Mode mode) throws ScriptException {
        List<Point> corners = List.of(new Point(1, 2), new Point(3, 4), new Point(5, 6));
        assertEquals(new Command.Lasso(2, mode, corners),
                command("lasso " + word + " 1,2 3,4 5,6"));
    }

    @Test
    void pointsMayStandAnywhereAndAlsoTwice() throws ScriptException {
        List<Point> corners = List.of(new Point(-1, 2), new Point(32767, 4), new Point(-1, 2),
                new Point(-1, 2));
        assertEquals(new Command.Lasso(2, Mode.LASSO_ADD, corners),
                command("lasso add -1,2 32767,4 -1,2 -1,2"));
    }

    @ParameterizedTest
    @CsvSource({"invert", "reset", "update-box"})
    void commandsOnTheWholeSelection(String word) throws ScriptException {
        assertEquals(word, ((Command.Whole) command(word)).what());
    }

    @Test
    void selections() throws ScriptException {
        SelectedRuns runs = new SelectedRuns();
        assertEquals(new Command.Select(2, runs), command("select"));
        runs.add(0, 0, 0);
        runs.add(12, 5, 9);
        runs.add(12, 14, 20);
        assertEquals(new Command.Select(2, runs), command("select 0:0-0 12:5-9,14-20"));
        runs.add(12, 21, 21);
        runs.add(999999999, 3, 999999999);
        assertEquals(new Command.Select(2, runs),
                command("select 0:0-0 12:5-9,14-20,21-21 999999999:3-999999999"));
    }

    @Test
    void selectionOfManyRunsIsReadToItsEnd() throws ScriptException {
        StringBuilder line = new StringBuilder("select 0:0-0");
        for (int x = 2; x < 400_000; x += 2) line.append(',').append(x).append('-').append(x);
        for (int y = 1; y < 100_000; ++y) line.append(' ').append(y).append(":7-8");
        SelectedRuns runs = ((Command.Select) command(line.toString())).runs();
        assertEquals(200_000 + 99_999, runs.count());
        assertEquals(100_000, runs.rows());
        assertEquals(99_999, runs.lastRow());
    }

    @ParameterizedTest
    @CsvSource({"view p.png 10 20 0.5 -3 4", "view p.png 10 20 1 0 0 FFFF0000 ff00ff00",
            "colour-on-grey p.png", "reverse p.png", "mask p.png"})
    void pictures(String line) throws ScriptException {
        assertEquals("p.png", ((Command.Snapshot) command(line)).name());
    }

    @Test
    void snapshotsAreListedInOrder() throws ScriptException {
        Script script = parse("photo a.png\nmask b.png\ninvert\nmask a.png\n");
        assertEquals(List.of("b.png", "a.png"),
                script.snapshots().stream().map(Command.Snapshot::name).toList());
    }

    @Test
    void everyCommandHasAUsage() {
        assertEquals(16, ScriptParser.usages().size());
        assertTrue(ScriptParser.usages().contains("brush RADIUS CORE"));
    }

    @ParameterizedTest
    @CsvSource(delimiter = '|', quoteCharacter = '`', value = {
        "grwo 1,2          | `\"grwo\" is no command, expected photo, brush, fill, grow, shrink,"
                + " paint, erase, lasso, invert, reset, select, update-box, view, colour-on-grey,"
                + " reverse, mask`",
        "photo b.png       | a second photo, expected one photo a script",
        "brush             | `the line ends too early, expected the brush's radius, a whole number"
                + " from 0 to 500`",
        "brush 4           | `the line ends too early, expected the radius of the brush's core,"
                + " a whole number from 0 to 500`",
        "brush 4 x         | `\"x\" is out of place, expected the radius of the brush's core,"
                + " a whole number from 0 to 500`",
        "brush 501 4       | `\"501\" is out of place, expected the brush's radius, a whole number"
                + " from 0 to 500`",
        "brush -1 4        | `\"-1\" is out of place, expected the brush's radius, a whole number"
                + " from 0 to 500`",
        "brush 9999999999 4 | `\"9999999999\" is out of place, expected the brush's radius,"
                + " a whole number from 0 to 500`",
        "brush 4 1 1       | `\"1\" is one word too many, expected brush RADIUS CORE`",
        "fill              | `the line ends too early, expected on or off`",
        "fill yes          | `\"yes\" is out of place, expected on or off`",
        "brush 4 501       | `\"501\" is out of place, expected the radius of the brush's core,"
                + " a whole number from 0 to 500`",
        "fill on off       | `\"off\" is one word too many, expected fill on|off`",
        "grow              | `the line ends too early, expected a point X,Y such as 120,45`",
        "grow 1;2          | `\"1;2\" is no point, expected a point X,Y such as 120,45`",
        "grow 1,2 to       | `the line ends too early, expected a point X,Y such as 120,45`",
        "grow to 1,2       | `\"to\" is no point, expected a point X,Y such as 120,45`",
        "shrink            | `the line ends too early, expected a point X,Y such as 120,45`",
        "paint 1,2 to to   | `\"to\" is no point, expected a point X,Y such as 120,45`",
        "erase 1,2,3       | `\"1,2,3\" is no point, expected a point X,Y such as 120,45`",
        "lasso             | `the line ends too early, expected add or remove`",
        "lasso remove 1,2 3,4 5,6 x | `\"x\" is no point, expected a point X,Y such as 120,45`",
        "lasso 1,2         | `\"1,2\" is out of place, expected add or remove`",
        "lasso add 1,2 3,4 | `the line ends too early, expected a point X,Y such as 120,45`",
        "lasso add 1,2 to 3,4 | `\"to\" is no point, expected a point X,Y such as 120,45`",
        "invert now        | `\"now\" is one word too many, expected invert`",
        "select 12         | `\"12\" is no row of runs, expected ROW:FIRST-LAST[,FIRST-LAST]..."
                + " such as 12:5-9,14-20`",
        "select 1:2-3 x:5-9 | `\"x:5-9\" is no row of runs, expected ROW:FIRST-LAST"
                + "[,FIRST-LAST]... such as 12:5-9,14-20`",
        "select -1:5-9     | `\"-1:5-9\" is no row of runs, expected ROW:FIRST-LAST"
                + "[,FIRST-LAST]... such as 12:5-9,14-20`",
        "select 9999999999:5-9 | `\"9999999999:5-9\" is no row of runs, expected ROW:FIRST-LAST"
                + "[,FIRST-LAST]... such as 12:5-9,14-20`",
        "select 12:        | `\"\" is no run of row 12, expected its first and last column"
                + " FIRST-LAST such as 5-9`",
        "select 12:5       | `\"5\" is no run of row 12, expected its first and last column"
                + " FIRST-LAST such as 5-9`",
        "select 12:5-9,    | `\"\" is no run of row 12, expected its first and last column"
                + " FIRST-LAST such as 5-9`",
        "select 12:5-9,,14-20 | `\"\" is no run of row 12, expected its first and last column"
                + " FIRST-LAST such as 5-9`",
        "select 12:5--9    | `\"5--9\" is no run of row 12, expected its first and last column"
                + " FIRST-LAST such as 5-9`",
        "select 12:5-9:14-20 | `\"5-9:14-20\" is no run of row 12, expected its first and last"
                + " column FIRST-LAST such as 5-9`",
        "select 12:5-9999999999 | `\"5-9999999999\" is no run of row 12, expected its first and"
                + " last column FIRST-LAST such as 5-9`",
        "select 12:9-5     | `the run 9-5 of row 12 ends before it begins, expected its first"
                + " column and then its last`",
        "select 12:14-20,5-9 | `the run 5-9 of row 12 begins at or before column 20, where the run"
                + " before it ends, expected runs from left to right`",
        "select 12:5-9,9-20 | `the run 9-20 of row 12 begins at or before column 9, where the run"
                + " before it ends, expected runs from left to right`",
        "select 12:5-9 12:14-20 | `row 12 comes after row 12, expected each row once, from top to"
                + " bottom`",
        "select 13:5-9 12:5-9 | `row 12 comes after row 13, expected each row once, from top to"
                + " bottom`",
        "mask              | `the line ends too early, expected a picture's file name such as"
                + " view.png, without a folder`",
        "mask ../a.png     | `\"../a.png\" is no picture name, expected a picture's file name such"
                + " as view.png, without a folder`",
        "mask sub/a.png    | `\"sub/a.png\" is no picture name, expected a picture's file name such"
                + " as view.png, without a folder`",
        "mask a.jpg        | `\"a.jpg\" is no picture name, expected a picture's file name such as"
                + " view.png, without a folder`",
        "mask .png         | `\".png\" is no picture name, expected a picture's file name such as"
                + " view.png, without a folder`",
        "mask \"a.png      | `a quote is out of place in \"a.png, expected one quote before the"
                + " word and one after it`",
        "view a.png 0 9 1 0 0 | `\"0\" is out of place, expected the view's width, a whole number"
                + " from 1 to 8192`",
        "view a.png 9 9999 1 0 0 | `\"9999\" is out of place, expected the view's height, a whole"
                + " number from 1 to 8192`",
        "view a.png 9 9 0.0 0 0 | `\"0.0\" is out of place, expected the photo pixels per view"
                + " pixel, a decimal number above 0 and up to 256`",
        "view a.png 9 9 1f 0 0 | `\"1f\" is out of place, expected the photo pixels per view"
                + " pixel, a decimal number above 0 and up to 256`",
        "view a.png 9 9 1 40000 0 | `\"40000\" is out of place, expected the photo column at the"
                + " left, a whole number from -32767 to 32767`",
        "view a.png 9 9 1 0 | `the line ends too early, expected the photo row at the top, a whole"
                + " number from -32767 to 32767`",
        "view a.png 9 9 1 0 0 white black | `\"white\" is no colour, expected a colour AARRGGBB"
                + " such as FFFFFFFF`",
        "view a.png 9 9 1 0 0 FFFFFFFF | `the line ends too early, expected a colour AARRGGBB such"
                + " as FFFFFFFF`"})
    void brokenLinesSayWhatIsWrongAndWhatWasExpected(String line, String message) {
        assertEquals("s.strokes:2: " + message, messageOf("photo a.png\n" + line + "\n"));
    }

    @Test
    void pictureNamesAreUsedOnce() {
        assertEquals("s.strokes:3: a second picture \"p.png\", expected a name of its own for each"
                        + " picture",
                messageOf("photo a.png\nmask p.png\nreverse p.png\n"));
    }

    @Test
    void photoComesFirst() {
        assertEquals("s.strokes:2: grow comes before the photo, expected photo FILE as the first"
                + " command", messageOf("# strokes\ngrow 1,2\nphoto a.png\n"));
        assertEquals("s.strokes:1: the script ends without a photo, expected photo FILE as the"
                + " first command", messageOf(""));
        assertEquals("s.strokes:3: the script ends without a photo, expected photo FILE as the"
                + " first command", messageOf("#\n\n#\n"));
    }

    @Test
    void textThatIsNotUtf8IsRefusedAtItsLine() {
        byte[] latin1 = "photo a.png\n# \u00E4\n".getBytes(StandardCharsets.ISO_8859_1);
        ScriptException e =
                assertThrows(ScriptException.class, () -> ScriptParser.parse(latin1));
        assertEquals("s.strokes:2: the line is not UTF-8, expected a text file in UTF-8",
                e.in(Path.of("s.strokes")));
    }

    private static Script parse(String text) throws ScriptException {
        return ScriptParser.parse(text.getBytes(StandardCharsets.UTF_8));
    }

    private static Command command(String line) throws ScriptException {
        return parse("photo a.png\n" + line + "\n").commands().get(0);
    }

    private static String messageOf(String text) {
        return assertThrows(ScriptException.class, () -> parse(text)).in(Path.of("s.strokes"));
    }
}
