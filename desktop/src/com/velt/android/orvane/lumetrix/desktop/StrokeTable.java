package com.velt.android.orvane.lumetrix.desktop;

import com.velt.android.orvane.lumetrix.selection.Area;
import java.io.PrintStream;

/** Prints one row for each command that works on the selection, as soon as it is done. */
final class StrokeTable {
    private static final String ROW = "%5s  %-12s  %-33s  %-24s  %9s  %s%n";

    private final PrintStream out;
    private boolean begun;

    StrokeTable(PrintStream out) {
        this.out = out;
    }

    void row(int line, String what, String where, Area changed, int selectedPixels, Area box) {
        if (!begun) {
            out.printf(ROW, "line", "what", "where", "changed", "selected", "object box");
            begun = true;
        }
        out.printf(ROW, line, what, where, changed, selectedPixels, box);
    }
}
