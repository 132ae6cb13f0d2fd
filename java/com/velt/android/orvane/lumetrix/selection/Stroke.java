package com.velt.android.orvane.lumetrix.selection;

import android.graphics.Rect;
import java.util.Arrays;

/** What is known of a step while it is made. */
final class Stroke {
    private final String words;
    private final Rect boxBefore;
    private int[] points = new int[16];
    private int length;
    private Area reported = Area.EMPTY;
    private Area reach = Area.EMPTY;

    /**
     * Begins a step.
     *
     * @param words the command of a script that stands for it
     * @param boxBefore the library's object box as it stands
     */
    Stroke(String words, Rect boxBefore) {
        this.words = words;
        this.boxBefore = boxBefore;
    }

    void addPoint(int x, int y) {
        if (length == points.length) points = Arrays.copyOf(points, 2 * length);
        points[length++] = x;
        points[length++] = y;
    }

    /**
     * Adds what the library did.
     *
     * @param changed what it reported
     * @param touched where else it may have changed something
     */
    void addChange(Area changed, Area touched) {
        reported = reported.union(changed);
        reach = reach.union(changed).union(touched);
    }

    Rect boxBefore() {
        return boxBefore;
    }

    /** Returns what the library reported as changed. */
    Area reported() {
        return reported;
    }

    /** Returns a rectangle outside which nothing has changed. */
    Area reach() {
        return reach;
    }

    boolean hasPoints() {
        return length > 0;
    }

    ScriptLine line(ScriptLine.Settings settings) {
        return new ScriptLine(words, Arrays.copyOf(points, length), settings);
    }
}
