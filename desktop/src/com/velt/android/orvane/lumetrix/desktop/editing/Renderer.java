package com.velt.android.orvane.lumetrix.desktop.editing;

import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.desktop.Drawings;
import com.velt.android.orvane.lumetrix.jni.Util;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;

/**
 * Draws what is seen of a session's photo and selection, with the library's drawing methods.
 *
 * <p>{@link #drawDirectly} draws the visible part of the photo as the app does. Others give the
 * same picture sooner: a virtual machine copies whole photos for each drawing, so
 * {@link #drawChange} first samples photo and mask where a dab can be seen, and draws these small
 * samples; and so does {@link #drawWhole} where the photo is large beside the view.
 */
final class Renderer {
    /** How many times the pixels of a view a photo has for samples to be drawn sooner; measured. */
    private static final int LARGE = 2;

    private static final int DASH_PERIOD = 10;  // view pixels after which the dashes repeat
    private static final byte NEITHER_SELECTED_NOR_OUTSIDE = 2;

    private final SelectionSession session;
    private final int[] photo;
    private final int width;
    private final int height;
    private final byte[] mask;

    Renderer(SelectionSession session, int[] photo) {
        this.session = session;
        this.photo = photo;
        width = session.width();
        height = session.height();
        mask = new byte[width * height];
    }

    /** Draws the visible part of the photo. {@code dashes} is 0 or 1: which colour comes first. */
    void drawWhole(Frame frame, int dashes) {
        boolean direct = frame.kind() == ViewKind.OUTLINE || frame.kind() == ViewKind.PHOTO;
        boolean large = photo.length > LARGE * frame.pixels().length;
        if (direct && !large) {
            drawDirectly(frame, dashes);
        } else {
            drawSamples(frame, frame.placement().part(), dashes);
        }
    }

    /** Has the library draw from the whole photo: the definition of what its views look like. */
    void drawDirectly(Frame frame, int dashes) {
        Placement placement = frame.placement();
        switch (frame.kind()) {
            case OUTLINE -> session.drawOutlinedView(frame.pixels(), placement.port(),
                    placement.part(), dashColour(dashes), dashColour(1 - dashes));
            case PHOTO -> session.drawPlainView(frame.pixels(), placement.port(),
                    placement.part());
            default -> throw new IllegalArgumentException("no view of the library's own");
        }
    }

    /** Draws what may look otherwise after the selection has changed in a part of the photo. */
    void drawChange(Frame frame, Area changed, int dashes) {
        if (changed.isEmpty() || frame.kind() == ViewKind.PHOTO) return;
        Area seen = seenIn(frame, changed);
        if (!seen.isEmpty()) drawSamples(frame, seen, dashes);
    }

    private static int dashColour(int dash) {
        return dash == 0 ? Drawings.WHITE : Drawings.BLACK;
    }

    /** Returns where in the frame a part of the photo and its neighbours are, or more than that. */
    private Area seenIn(Frame frame, Area photoArea) {
        var port = frame.placement().port();
        float scale = port.scale();
        // Two more on each side: for the outline beside it, and for rounding.
        return new Area((int) ((photoArea.left() - 1 - port.offsetX()) / scale) - 2,
                (int) ((photoArea.top() - 1 - port.offsetY()) / scale) - 2,
                (int) ((photoArea.right() + 1 - port.offsetX()) / scale) + 2,
                (int) ((photoArea.bottom() + 1 - port.offsetY()) / scale) + 2)
                .intersection(frame.placement().part());
    }

    private void drawSamples(Frame frame, Area seen, int dashes) {
        session.copyMask(mask);
        Area part = frame.placement().part();
        // The outline of a pixel depends on its neighbours; and the library dashes all selected
        // pixels on the edge of what it draws, which is right at the edge of the part alone.
        Area drawn = new Area(seen.left() - 1, seen.top() - 1, seen.right() + 1, seen.bottom() + 1)
                .intersection(part);
        Samples samples = new Samples(frame, drawn);
        samples.draw(frame.kind(), dashes);
        samples.copyTo(frame, seen);
    }

    /**
     * Photo and mask as a part of a frame shows them, one element a view pixel. Column and row 0
     * lie on a border of the dashes' pattern, which is bound to a drawing's columns and rows.
     */
    private final class Samples {
        private final int originX;
        private final int originY;
        private final int columns;
        private final int rows;
        private final Area drawn;
        private final int[] pixels;
        private final byte[] selection;
        private final int[] drawing;

        Samples(Frame frame, Area drawn) {
            originX = drawn.left() - drawn.left() % DASH_PERIOD;
            originY = drawn.top() - drawn.top() % DASH_PERIOD;
            columns = drawn.right() - originX + 1;
            rows = drawn.bottom() - originY + 1;
            this.drawn = drawn;
            pixels = new int[columns * rows];
            selection = new byte[columns * rows];
            drawing = new int[columns * rows];
            take(frame);
        }

        private void take(Frame frame) {
            var port = frame.placement().port();
            float rounding = frame.kind().rounding();
            int[] photoColumns = new int[drawn.width()];
            for (int i = 0; i < photoColumns.length; ++i) {
                photoColumns[i] = sampled(port.offsetX(), port.scale(), rounding,
                        drawn.left() + i, width);
            }
            for (int y = drawn.top(); y <= drawn.bottom(); ++y) {
                int row = sampled(port.offsetY(), port.scale(), rounding, y, height) * width;
                int to = (y - originY) * columns + drawn.left() - originX;
                for (int column : photoColumns) {
                    pixels[to] = photo[row + column];
                    selection[to] = mask[row + column];
                    ++to;
                }
            }
            if (frame.kind() == ViewKind.OUTLINE) hidePhotoBorder(frame, photoColumns);
        }

        /**
         * Selected pixels on the photo's border show the photo, unless they lie on the edge of what
         * is drawn. In the samples nobody could tell, so they get a value that gives no outline.
         */
        private void hidePhotoBorder(Frame frame, int[] photoColumns) {
            Area part = frame.placement().part();
            var port = frame.placement().port();
            for (int y = drawn.top(); y <= drawn.bottom(); ++y) {
                if (y == part.top() || y == part.bottom()) continue;
                int row = sampled(port.offsetY(), port.scale(), frame.kind().rounding(), y, height);
                boolean borderRow = row == 0 || row == height - 1;
                for (int x = drawn.left(); x <= drawn.right(); ++x) {
                    if (x == part.left() || x == part.right()) continue;
                    int column = photoColumns[x - drawn.left()];
                    if (!borderRow && column != 0 && column != width - 1) continue;
                    int at = (y - originY) * columns + x - originX;
                    boolean selected = selection[at] == 1 || selection[at] == 3;
                    if (selected) selection[at] = NEITHER_SELECTED_NOR_OUTSIDE;
                }
            }
        }

        void draw(ViewKind kind, int dashes) {
            Rect all = new Rect(drawn.left() - originX, drawn.top() - originY, columns - 1,
                    rows - 1);
            switch (kind) {
                case OUTLINE -> Util.native_drawImageWithMaskContour(drawing, columns, rows, pixels,
                        columns, rows, selection, 1, 0, 0, dashColour(dashes),
                        dashColour(1 - dashes), all);
                case GREY_REST -> Util.draw_withmask(pixels, drawing, selection, columns, all);
                case REVERSE -> Util.draw_reversemask(pixels, drawing, selection, columns, rows);
                case MASK -> drawMask();
                case PHOTO -> Util.native_drawImage(drawing, columns, rows, pixels, columns, rows,
                        1, 0, 0, all);
            }
        }

        private void drawMask() {
            for (int i = 0; i < drawing.length; ++i) {
                drawing[i] = selection[i] == 1 ? Drawings.WHITE : Drawings.BLACK;
            }
        }

        void copyTo(Frame frame, Area seen) {
            int stride = frame.placement().port().width();
            for (int y = seen.top(); y <= seen.bottom(); ++y) {
                System.arraycopy(drawing, (y - originY) * columns + seen.left() - originX,
                        frame.pixels(), y * stride + seen.left(), seen.width());
            }
        }
    }

    private static int sampled(int offset, float scale, float rounding, int column, int photo) {
        int position = Placement.sampled(offset, scale, rounding, column);
        return Math.max(0, Math.min(position, photo - 1));
    }
}
