package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.Viewport;

/**
 * Zoom and pan: which part of a photo a window shows, and how large.
 *
 * <p>Positions in the window are in pixels of the screen. The middle of the window never leaves the
 * photo, so some of it can always be seen.
 */
public final class ViewModel {
    /** The smallest scale: 32 screen pixels a photo pixel. */
    public static final float SMALLEST_SCALE = 1f / 32;

    private static final float LARGEST_SCALE = 128;
    private static final int LARGEST_MARGIN = 12;  // around a photo that fits

    private int viewWidth = 1;
    private int viewHeight = 1;
    private int photoWidth = 1;
    private int photoHeight = 1;
    private float scale = 1;  // photo pixels per screen pixel, a multiple of 1/65536
    private double left;      // position on the photo of the window's left edge
    private double top;
    private boolean fitted = true;

    /** Sets the size of the window. A fitted photo stays fitted; else the centre stays in place. */
    public void setView(int width, int height) {
        double centreX = left + viewWidth * scale / 2.0;
        double centreY = top + viewHeight * scale / 2.0;
        viewWidth = Math.max(1, width);
        viewHeight = Math.max(1, height);
        if (fitted) {
            fit();
        } else {
            moveTo(centreX - viewWidth * scale / 2.0, centreY - viewHeight * scale / 2.0);
        }
    }

    /** Shows a whole photo of this size. */
    public void setPhoto(int width, int height) {
        photoWidth = width;
        photoHeight = height;
        fit();
    }

    /** Shows the whole photo, as large as it can be. */
    public void fit() {
        scale = fittingScale();
        centre();
        fitted = true;
    }

    /** Tells whether the whole photo is shown, also after the window has changed its size. */
    public boolean fitted() {
        return fitted;
    }

    private float fittingScale() {
        double wide = photoWidth / (double) withoutMargins(viewWidth);
        double high = photoHeight / (double) withoutMargins(viewHeight);
        double exact = Math.max(wide, high);
        return limited(Math.ceil(exact * 65536) / 65536);
    }

    /** Small windows have small margins, or the photo would have no room. */
    private static int withoutMargins(int view) {
        return view - 2 * Math.min(LARGEST_MARGIN, view / 8);
    }

    private void centre() {
        moveTo((photoWidth - viewWidth * (double) scale) / 2,
                (photoHeight - viewHeight * (double) scale) / 2);
    }

    /** Shows a photo pixel in each screen pixel; what is at a position stays there. */
    public void showTruePixels(double x, double y) {
        setScale(1, x, y);
    }

    /** Zooms, by a factor above 1 to enlarge; what is at a position stays there. */
    public void zoom(double factor, double x, double y) {
        setScale(limited(scale / factor), x, y);
    }

    /** The scale is truncated to 1/65536 by the library, so it has no finer steps here. */
    private float limited(double wanted) {
        double largest = Math.min(LARGEST_SCALE, Math.max(1, 4 * Math.max(
                photoWidth / (double) viewWidth, photoHeight / (double) viewHeight)));
        double limited = Math.max(SMALLEST_SCALE, Math.min(wanted, largest));
        return (float) (Math.round(limited * 65536) / 65536.0);
    }

    private void setScale(float next, double x, double y) {
        double fixedX = left + x * scale;
        double fixedY = top + y * scale;
        scale = next;
        moveTo(fixedX - x * next, fixedY - y * next);
    }

    /** Moves the photo by screen pixels. */
    public void pan(double dx, double dy) {
        moveTo(left - dx * scale, top - dy * scale);
    }

    private void moveTo(double newLeft, double newTop) {
        left = withMiddleOnPhoto(newLeft, viewWidth, photoWidth);
        top = withMiddleOnPhoto(newTop, viewHeight, photoHeight);
        fitted = false;
    }

    /** Keeps a whole screen pixel in the middle of the window on the photo, if it has the room. */
    private double withMiddleOnPhoto(double start, int view, int photo) {
        double shown = view * (double) scale;
        double half = Math.min(scale, photo) / 2.0;
        return Math.max(half - shown / 2, Math.min(start, photo - half - shown / 2));
    }

    /** Returns photo pixels per screen pixel. */
    public float scale() {
        return scale;
    }

    /** Returns the photo's column at a position; it may lie outside. */
    public int column(double x) {
        return (int) Math.floor(left + x * scale);
    }

    /** Returns the photo's row at a position; it may lie outside. */
    public int row(double y) {
        return (int) Math.floor(top + y * scale);
    }

    /** Returns where a position on the photo is in the window; 0.5 is the first pixel's middle. */
    public double viewX(double photoX) {
        return (photoX - left) / scale;
    }

    /** Returns where a position on the photo is in the window; 0.5 is the first pixel's middle. */
    public double viewY(double photoY) {
        return (photoY - top) / scale;
    }

    /** Tells whether a pixel lies on the photo. */
    public boolean onPhoto(int column, int row) {
        return column >= 0 && column < photoWidth && row >= 0 && row < photoHeight;
    }

    /** Returns where to draw what can be seen. */
    public Placement placement(ViewKind kind) {
        Line columns = line(left, photoWidth, viewWidth, kind.rounding());
        Line rows = line(top, photoHeight, viewHeight, kind.rounding());
        Viewport port = new Viewport(columns.last + 1, rows.last + 1, scale, columns.offset,
                rows.offset);
        Area part = new Area(columns.first, rows.first, columns.last, rows.last);
        Area window = new Area(-columns.place, -rows.place, viewWidth - 1 - columns.place,
                viewHeight - 1 - rows.place);
        return new Placement(port, part, part.intersection(window), columns.place, rows.place);
    }

    /**
     * One direction of a placement.
     *
     * @param offset the photo's column at the drawing's column 0
     * @param place the window's column there
     * @param first the first column drawn
     * @param last the last column drawn
     */
    private record Line(int offset, int place, int first, int last) {}

    private Line line(double start, int photo, int view, float rounding) {
        int from = (int) Math.max(-1, Math.ceil(-start / scale));
        int to = (int) Math.min(view, Math.ceil((photo - start) / scale) - 1);
        if (from > to) {  // all of the photo lies between two screen pixels
            from = (int) Math.floor((photo / 2.0 - start) / scale);
            from = Math.max(0, Math.min(from, view - 1));
            to = from;
        }
        // Reduced, the drawing's offset is the finer of the two steps; enlarged, its place is.
        int place = from;
        int offset = (int) Math.round(start + from * (double) scale - rounding);
        offset = Math.max(0, Math.min(offset, photo - 1));
        if (scale < 1) {
            offset = (int) Math.floor(start + from * (double) scale) - 1;
            place = (int) Math.round((offset + rounding - start) / scale);
        }
        // The drawing is up to half a pixel beside its place, so the photo may begin or end a pixel
        // sooner or later.
        int first = Math.max(0, Math.max(-1, from - 1) - place);
        int last = Math.max(first, Math.min(view, to + 1) - place);
        while (first < last && Placement.sampled(offset, scale, rounding, first) < 0) ++first;
        while (first < last && Placement.sampled(offset, scale, rounding, last) >= photo) --last;
        return new Line(offset, place, first, last);
    }
}
