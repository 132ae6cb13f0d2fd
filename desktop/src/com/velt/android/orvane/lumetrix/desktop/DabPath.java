package com.velt.android.orvane.lumetrix.desktop;

import android.graphics.Point;
import java.util.ArrayList;
import java.util.List;

/**
 * The way of the brush in one stroke: points, some of them joined to the point before by dabs in
 * between.
 *
 * @param stops the points in order; the first is joined to nothing
 */
public record DabPath(List<Stop> stops) {
    /**
     * A point of the path.
     *
     * @param point the point
     * @param joined whether dabs lead here from the stop before
     */
    record Stop(Point point, boolean joined) {}

    public DabPath {
        stops = List.copyOf(stops);
    }

    /**
     * Returns the distance between dabs on a joined stretch: half the brush's radius, so that
     * neighbouring dabs overlap well.
     */
    public static int spacing(int radius) {
        return Math.max(1, radius / 2);
    }

    /** Returns the points as the script gives them. */
    List<Point> points() {
        return stops.stream().map(Stop::point).toList();
    }

    /** Returns all dabs, in order; those of a joined stretch as {@link #between} sets them. */
    public List<Point> dabs(int spacing) {
        List<Point> dabs = new ArrayList<>();
        Point from = null;
        for (Stop stop : stops) {
            if (stop.joined()) {
                dabs.addAll(between(from, stop.point(), spacing));
            } else {
                dabs.add(stop.point());
            }
            from = stop.point();
        }
        return dabs;
    }

    /**
     * Returns the dabs that lead from one point to another, which is the last of them.
     *
     * <p>The stretch is cut into the fewest equal steps whose longer side is at most
     * {@code spacing}; positions are rounded to nearest, halves up. Whole numbers only, so a path
     * gives the same dabs everywhere.
     */
    public static List<Point> between(Point from, Point to, int spacing) {
        List<Point> dabs = new ArrayList<>();
        int dx = to.x - from.x;
        int dy = to.y - from.y;
        int steps = (Math.max(Math.abs(dx), Math.abs(dy)) + spacing - 1) / spacing;
        for (int i = 1; i < steps; ++i) {
            dabs.add(new Point(from.x + share(dx, i, steps), from.y + share(dy, i, steps)));
        }
        dabs.add(to);
        return dabs;
    }

    /** Returns {@code distance * i / steps}, rounded to nearest, halves up. */
    private static int share(int distance, int i, int steps) {
        return (int) Math.floorDiv(2L * distance * i + steps, 2L * steps);
    }
}
