package com.velt.android.orvane.lumetrix.desktop;

import android.graphics.Rect;
import java.io.PrintStream;

/** Prints one row for each command that works on the selection, as soon as it is done. */
final class StrokeTable {
    private static final String ROW = "%5s  %-12s  %-33s  %-24s  %9s  %s%n";

    private final PrintStream out;
    private boolean begun;

    StrokeTable(PrintStream out) {
        this.out = out;
    }

    void row(int line, String what, String where, Rect changed, int selectedPixels, Rect box) {
        if (!begun) {
            out.printf(ROW, "line", "what", "where", "changed", "selected", "object box");
            begun = true;
        }
        out.printf(ROW, line, what, where, describe(changed), selectedPixels, describe(box));
    }

    /** Returns the columns and rows of a rectangle, first to last, or {@code none}. */
    static String describe(Rect rect) {
        if (rect.left > rect.right || rect.top > rect.bottom) return "none";
        return rect.left + ".." + rect.right + " x " + rect.top + ".." + rect.bottom;
    }
}
