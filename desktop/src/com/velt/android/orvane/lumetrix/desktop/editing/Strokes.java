package com.velt.android.orvane.lumetrix.desktop.editing;

import android.graphics.Point;
import com.velt.android.orvane.lumetrix.desktop.DabPath;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.Mode;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.util.List;
import java.util.function.BooleanSupplier;
import java.util.function.Consumer;
import java.util.stream.IntStream;

/**
 * Turns the way of the pointer into the dabs of a stroke.
 *
 * <p>A dab follows when the pointer is a spacing away from the last one, and at the end; further
 * ways are joined by dabs in between. Points outside the photo have none.
 */
final class Strokes {
    private final SelectionSession session;
    private final Consumer<Area> changed;
    private BooleanSupplier goesOn;
    private Mode mode;      // of the stroke under way, or null
    private Point lastDab;  // may lie outside the photo
    private Point pointer;
    private String reason;  // for the stroke to do nothing, if it does nothing
    private int dabs;
    private long nanos;

    /** {@code changed} is told after each dab where the selection has changed. */
    Strokes(SelectionSession session, Consumer<Area> changed) {
        this.session = session;
        this.changed = changed;
    }

    boolean underWay() {
        return mode != null;
    }

    /** Returns the number of dabs of the last stroke. */
    int dabs() {
        return dabs;
    }

    /** Returns what the library took for the last stroke. */
    long nanos() {
        return nanos;
    }

    /**
     * Begins a stroke and sets its first dab.
     *
     * @param goesOnStill is asked before each dab, for a fast hand is far ahead on a large photo;
     *     once it says no, the stroke sets no more of them
     */
    void begin(Mode strokeMode, Brush brush, int x, int y, BooleanSupplier goesOnStill) {
        setBrush(brush);
        session.begin(strokeMode);
        goesOn = goesOnStill;
        mode = strokeMode;
        reason = Hints.OUTSIDE;
        dabs = 0;
        nanos = 0;
        pointer = new Point(x, y);
        dab(pointer);
    }

    /** A brush that stays is not set again: that would build a new engine. */
    private void setBrush(Brush brush) {
        boolean same = session.brushRadius() == brush.radius()
                && session.coreRadius() == brush.core();
        if (!same) session.setBrush(brush.radius(), brush.core());
    }

    /** Leads the stroke on. */
    void moveTo(int x, int y) {
        pointer = new Point(x, y);
        int spacing = DabPath.spacing(session.brushRadius());
        int way = Math.max(Math.abs(x - lastDab.x), Math.abs(y - lastDab.y));
        if (way >= spacing) dabsTo(pointer, spacing);
    }

    private void dabsTo(Point point, int spacing) {
        DabPath.between(lastDab, point, spacing).forEach(this::dab);
    }

    private void dab(Point point) {
        lastDab = point;
        boolean onPhoto = point.x >= 0 && point.x < session.width() && point.y >= 0
                && point.y < session.height();
        if (!onPhoto) return;
        if (!goesOn.getAsBoolean()) {
            if (dabs == 0) reason = Hints.CUT;
            return;
        }
        if (dabs == 0) reason = Hints.reason(session, mode, point.x, point.y);
        ++dabs;
        long start = System.nanoTime();
        Area area = session.dab(point.x, point.y);
        nanos += System.nanoTime() - start;
        changed.accept(area);
    }

    /** Ends the stroke where the pointer is. */
    void end() {
        if (!pointer.equals(lastDab)) dabsTo(pointer, DabPath.spacing(session.brushRadius()));
        mode = null;
        changed.accept(session.end());
    }

    /** Draws a lasso through corners on the photo, at least three. */
    void lasso(Mode lassoMode, List<Point> corners) {
        Point first = corners.get(0);
        reason = session.fill() ? Hints.reason(session, lassoMode, first.x, first.y)
                : Hints.LASSO_OPEN;
        dabs = corners.size();
        int[] coordinates =
                corners.stream().flatMapToInt(p -> IntStream.of(p.x, p.y)).toArray();
        long start = System.nanoTime();
        Area area = session.lasso(lassoMode, coordinates);
        nanos = System.nanoTime() - start;
        changed.accept(area);
    }

    /** Returns why the stroke that has ended did nothing, if that is what it did. */
    String reason() {
        return reason;
    }
}
