package com.velt.android.orvane.lumetrix.selection;

import android.graphics.Rect;
import java.util.ArrayList;
import java.util.List;

/** What undo and redo take back and bring back at once, with its lines of the script. */
final class Step {
    /** What a step takes beside its runs: objects, arrays' headers and two boxes, rounded up. */
    static final int OVERHEAD = 256;

    private final List<ScriptLine> lines = new ArrayList<>(1);
    private final Rect boxBefore;
    private final Rect boxAfter;
    private MaskChange change;

    Step(ScriptLine line, MaskChange change, Rect boxBefore, Rect boxAfter) {
        lines.add(line);
        this.change = change;
        this.boxBefore = boxBefore;
        this.boxAfter = boxAfter;
    }

    /** The beginning, before the first step. */
    Step() {
        boxBefore = null;
        boxAfter = null;
    }

    /** Adds a stroke without effect: it comes and goes with this step. */
    void add(ScriptLine line) {
        lines.add(line);
    }

    List<ScriptLine> lines() {
        return lines;
    }

    MaskChange change() {
        return change;
    }

    /** Returns the library's object box on one side of the step. */
    Rect box(boolean after) {
        return after ? boxAfter : boxBefore;
    }

    long bytes() {
        return OVERHEAD + (long) change.bytes();
    }

    /** From now on the step cannot be undone; its lines stay. */
    void forgetChange() {
        change = null;
    }
}
