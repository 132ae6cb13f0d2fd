package com.velt.android.orvane.lumetrix.desktop;

import android.graphics.Point;
import java.util.ArrayList;
import java.util.List;
import java.util.regex.Matcher;
import java.util.regex.Pattern;

/** The words of one script line, taken from left to right. */
final class Words {
    /** A comment, a word in double quotes, a quote that never ends, or a plain word. */
    private static final Pattern WORD = Pattern.compile("#.*|\"([^\"]*)\"(?=\\s|$)|(\".*)|(\\S+)");

    private static final Pattern INTEGER = Pattern.compile("-?[0-9]{1,9}");
    private static final Pattern DECIMAL = Pattern.compile("[0-9]{1,5}(\\.[0-9]{1,9})?");
    private static final Pattern POINT = Pattern.compile("(-?[0-9]{1,9}),(-?[0-9]{1,9})");
    private static final Pattern ROW = Pattern.compile("[0-9]{1,9}");
    private static final Pattern RUN = Pattern.compile("([0-9]{1,9})-([0-9]{1,9})");
    private static final Pattern COLOUR = Pattern.compile("[0-9A-Fa-f]{8}");

    private final int line;
    private final List<String> words;
    private int taken;

    private Words(int line, List<String> words) {
        this.line = line;
        this.words = words;
    }

    /** Splits a line at white space, leaving out the comment. */
    static Words of(int line, String text) throws ScriptException {
        List<String> words = new ArrayList<>();
        Matcher matcher = WORD.matcher(text);
        while (matcher.find()) {
            if (matcher.group().startsWith("#")) break;
            if (matcher.group(2) != null) {
                throw new ScriptException(line, "a quote is out of place in " + matcher.group(2),
                        "one quote before the word and one after it");
            }
            words.add(matcher.group(1) != null ? matcher.group(1) : matcher.group(3));
        }
        return new Words(line, words);
    }

    int line() {
        return line;
    }

    boolean hasNext() {
        return taken < words.size();
    }

    /** Takes the next word if it is this one. */
    boolean takeIf(String word) {
        boolean found = hasNext() && words.get(taken).equals(word);
        if (found) ++taken;
        return found;
    }

    /** Takes the next word, whatever it is. */
    String take(String expected) throws ScriptException {
        if (!hasNext()) throw new ScriptException(line, "the line ends too early", expected);
        return words.get(taken++);
    }

    int takeInteger(String name, int least, int most) throws ScriptException {
        String expected = name + ", a whole number from " + least + " to " + most;
        String word = take(expected);
        if (INTEGER.matcher(word).matches()) {
            int value = Integer.parseInt(word);
            if (value >= least && value <= most) return value;
        }
        throw new ScriptException(line, quote(word) + " is out of place", expected);
    }

    /** Takes a number above 0, in digits with at most one decimal point. */
    float takeDecimal(String name, float most) throws ScriptException {
        String expected = name + ", a decimal number above 0 and up to " + (int) most;
        String word = take(expected);
        if (DECIMAL.matcher(word).matches()) {
            float value = Float.parseFloat(word);
            if (value > 0 && value <= most) return value;
        }
        throw new ScriptException(line, quote(word) + " is out of place", expected);
    }

    Point takePoint() throws ScriptException {
        String expected = "a point X,Y such as 120,45";
        String word = take(expected);
        Matcher point = POINT.matcher(word);
        if (!point.matches()) {
            throw new ScriptException(line, quote(word) + " is no point", expected);
        }
        return new Point(Integer.parseInt(point.group(1)), Integer.parseInt(point.group(2)));
    }

    /** Takes the runs of one row and adds them to those of the rows above it. */
    void takeRow(SelectedRuns runs) throws ScriptException {
        String form = "ROW:FIRST-LAST[,FIRST-LAST]... such as 12:5-9,14-20";
        String word = take(form);
        int colon = word.indexOf(':');
        if (colon < 0 || !ROW.matcher(word.substring(0, colon)).matches()) {
            throw new ScriptException(line, quote(word) + " is no row of runs", form);
        }
        int row = Integer.parseInt(word.substring(0, colon));
        if (row <= runs.lastRow()) {
            throw new ScriptException(line, "row " + row + " comes after row " + runs.lastRow(),
                    "each row once, from top to bottom");
        }
        for (String run : word.substring(colon + 1).split(",", -1)) addRun(run, row, runs);
    }

    private void addRun(String run, int row, SelectedRuns runs) throws ScriptException {
        Matcher columns = RUN.matcher(run);
        if (!columns.matches()) {
            throw new ScriptException(line, quote(run) + " is no run of row " + row,
                    "its first and last column FIRST-LAST such as 5-9");
        }
        int first = Integer.parseInt(columns.group(1));
        int last = Integer.parseInt(columns.group(2));
        if (first > last) {
            throw new ScriptException(line, "the run " + run + " of row " + row
                    + " ends before it begins", "its first column and then its last");
        }
        boolean behind = row != runs.lastRow() || first > runs.last(runs.count() - 1);
        if (!behind) {
            throw new ScriptException(line, "the run " + run + " of row " + row
                    + " begins at or before column " + runs.last(runs.count() - 1)
                    + ", where the run before it ends", "runs from left to right");
        }
        runs.add(row, first, last);
    }

    int takeColour() throws ScriptException {
        String expected = "a colour AARRGGBB such as FFFFFFFF";
        String word = take(expected);
        if (!COLOUR.matcher(word).matches()) {
            throw new ScriptException(line, quote(word) + " is no colour", expected);
        }
        return Integer.parseUnsignedInt(word, 16);
    }

    /** Takes the name of a picture: a file in the output folder, never elsewhere. */
    String takePictureName() throws ScriptException {
        String expected = "a picture's file name such as view.png, without a folder";
        String word = take(expected);
        boolean plain = word.endsWith(".png") && !word.startsWith(".") && !word.contains("/")
                && !word.contains("\\") && word.indexOf('\0') < 0;
        if (!plain) throw new ScriptException(line, quote(word) + " is no picture name", expected);
        return word;
    }

    /** Takes one of several words and returns its place among them. */
    int takeOneOf(String... choices) throws ScriptException {
        String expected = String.join(" or ", choices);
        String word = take(expected);
        for (int i = 0; i < choices.length; ++i) {
            if (choices[i].equals(word)) return i;
        }
        throw new ScriptException(line, quote(word) + " is out of place", expected);
    }

    static String quote(String word) {
        return '"' + word + '"';
    }
}
