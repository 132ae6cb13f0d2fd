package com.velt.android.orvane.lumetrix.selection;

import java.util.ArrayDeque;
import java.util.ArrayList;
import java.util.Deque;
import java.util.List;

/**
 * The steps in effect, oldest first, and those undone.
 *
 * <p>Changes of the newest steps are kept, as many as fit into the limit; lines of the script are
 * kept of all.
 */
final class History {
    private final long limit;
    private final List<Step> done = new ArrayList<>();
    private final Deque<Step> undone = new ArrayDeque<>();
    private int undoable;
    private long bytes;

    History(long limit) {
        this.limit = limit;
        done.add(new Step());
    }

    long limit() {
        return limit;
    }

    long bytes() {
        return bytes;
    }

    /** Returns the number of bytes that the runs of a step may take. */
    long mostBytesOfAChange() {
        return limit - Step.OVERHEAD;
    }

    boolean canUndo() {
        return undoable > 0;
    }

    boolean canRedo() {
        return !undone.isEmpty();
    }

    /** Adds a new step; what was undone is gone. */
    void add(Step step) {
        for (Step gone : undone) bytes -= gone.bytes();
        undone.clear();
        done.add(step);
        ++undoable;
        bytes += step.bytes();
        while (bytes > limit) forgetOldest();
    }

    private void forgetOldest() {
        Step oldest = done.get(done.size() - undoable);
        bytes -= oldest.bytes();
        oldest.forgetChange();
        --undoable;
    }

    /** Adds a stroke that changed nothing. */
    void addWithoutEffect(ScriptLine line) {
        done.get(done.size() - 1).add(line);
    }

    Step nextToUndo() {
        return done.get(done.size() - 1);
    }

    Step nextToRedo() {
        return undone.peek();
    }

    void moveBack() {
        undone.push(done.remove(done.size() - 1));
        --undoable;
    }

    void moveOn() {
        done.add(undone.pop());
        ++undoable;
    }

    /** Writes the strokes in effect, after which the given settings hold. */
    void write(StringBuilder script, ScriptLine.Settings now) {
        boolean fill = true;
        for (Step step : done) {
            for (ScriptLine line : step.lines()) {
                line.settings().write(script, fill);
                line.write(script);
                fill = line.settings().fill();
            }
        }
        now.write(script, fill);
    }
}
