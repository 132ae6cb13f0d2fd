package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.selection.SelectionSession;

/**
 * Size and core of the brush, as the user sets them.
 *
 * <p>The size is a radius in photo pixels or, when the brush stays constant on the screen, in view
 * pixels. The core is a share of it, so that it goes along when the size changes.
 */
public final class BrushSettings {
    public static final int SMALLEST_SIZE = 1;
    public static final int LARGEST_SIZE = 250;
    public static final int LARGEST_CORE_PERCENT = 90;

    private int size = 30;
    private int corePercent = 30;
    private boolean constantOnScreen;

    public int size() {
        return size;
    }

    /** Sets the size, or the nearest that there is. */
    public void setSize(int wanted) {
        size = Math.max(SMALLEST_SIZE, Math.min(wanted, LARGEST_SIZE));
    }

    /** Makes the brush larger by about a seventh, at least by 1. */
    public void enlarge() {
        setSize(size + step(size));
    }

    /** Takes back one {@link #enlarge}, as far as there are smaller sizes. */
    public void reduce() {
        int smaller = size - 1;
        while (smaller > SMALLEST_SIZE && smaller + step(smaller) > size) --smaller;
        setSize(smaller);
    }

    private static int step(int size) {
        return Math.max(1, Math.round(size / 7f));
    }

    public int corePercent() {
        return corePercent;
    }

    /** Sets the core's share of the radius, 0 to {@value #LARGEST_CORE_PERCENT}, or the nearest. */
    public void setCorePercent(int wanted) {
        corePercent = Math.max(0, Math.min(wanted, LARGEST_CORE_PERCENT));
    }

    public boolean constantOnScreen() {
        return constantOnScreen;
    }

    /**
     * Decides whether the size is one on the screen. The brush stays as large as it is.
     *
     * @param scale photo pixels per view pixel
     */
    public void setConstantOnScreen(boolean constant, float scale) {
        if (constant == constantOnScreen) return;
        constantOnScreen = constant;
        setSize(Math.round(constant ? size / scale : size * scale));
    }

    /**
     * Returns the brush for a stroke.
     *
     * @param scale photo pixels per view pixel
     */
    public Brush brush(float scale) {
        int wanted = constantOnScreen ? Math.round(size * scale) : size;
        int radius = Math.max(SMALLEST_SIZE, Math.min(wanted, SelectionSession.LARGEST_RADIUS));
        return new Brush(radius, Math.round(radius * corePercent / 100f));
    }
}
