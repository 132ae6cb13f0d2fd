package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.Viewport;

/**
 * Where the visible part of a photo is drawn, and where that drawing goes.
 *
 * <p>The library starts a drawing at a whole photo pixel. For pans in steps of a screen pixel the
 * drawing starts a little outside the window, and its place there varies.
 *
 * @param port the drawing: its size, scale and offset
 * @param part the rectangle of it that is drawn: the visible part of the photo and, where the photo
 *     goes on, a row or column more, for the outlined view dashes selected pixels at this edge.
 *     Every pixel in it samples the photo and none is clamped, unless all of a tiny photo lies
 *     between two screen pixels.
 * @param seen what of the part lies in the window
 * @param x the window's column, in its own pixels, of the drawing's column 0
 * @param y the window's row of the drawing's row 0
 */
public record Placement(Viewport port, Area part, Area seen, int x, int y) {
    /** Returns the photo column that the library samples in a column of the drawing. */
    static int sampled(int offset, float scale, float rounding, int column) {
        long position = ((long) offset << 16) + column * (long) (scale * 65536)
                + (long) (rounding * 65536);
        return (int) (position >> 16);
    }
}
