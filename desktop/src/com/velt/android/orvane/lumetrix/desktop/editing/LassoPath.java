package com.velt.android.orvane.lumetrix.desktop.editing;

import android.graphics.Point;
import java.util.ArrayList;
import java.util.List;

/**
 * The corners of a lasso while it is drawn.
 *
 * <p>Each corner costs a call of the library, so those nearer to the last one than the eye can tell
 * are left out.
 */
public final class LassoPath {
    private final List<Point> corners = new ArrayList<>();
    private final double distance;

    /**
     * Begins without a corner.
     *
     * @param scale photo pixels per screen pixel
     */
    public LassoPath(float scale) {
        distance = Math.max(1, 3 * scale);
    }

    /** Adds the place of the pointer, on the photo's grid but perhaps outside the photo. */
    public void add(int x, int y) {
        if (!corners.isEmpty()) {
            Point last = corners.get(corners.size() - 1);
            if (Math.hypot(x - last.x, y - last.y) < distance) return;
        }
        corners.add(new Point(x, y));
    }

    /** Returns the corners so far. */
    public List<Point> corners() {
        return List.copyOf(corners);
    }
}
