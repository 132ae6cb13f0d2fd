package com.velt.android.orvane.lumetrix.desktop.window;

import android.graphics.Point;
import com.velt.android.orvane.lumetrix.desktop.editing.Editor;
import com.velt.android.orvane.lumetrix.desktop.editing.LassoPath;
import com.velt.android.orvane.lumetrix.desktop.editing.Message;
import com.velt.android.orvane.lumetrix.desktop.editing.Tool;
import com.velt.android.orvane.lumetrix.selection.Mode;
import java.awt.Cursor;
import java.awt.event.MouseAdapter;
import java.awt.event.MouseEvent;
import java.awt.event.MouseWheelEvent;
import java.util.List;
import java.util.function.Consumer;
import javax.swing.SwingUtilities;

/**
 * Turns what the pointer does on the canvas into strokes, pans and zooms.
 *
 * <p>A drag is a stroke, or a pan with the middle button or Space held. Which of them, and whether
 * the stroke does the tool's opposite, is decided when the button goes down; another button that
 * goes down during a drag does nothing.
 */
final class PointerInput extends MouseAdapter {
    private static final double WHEEL_FACTOR = 1.2;  // for each step of the wheel

    private static final String HIDDEN = "The selection is hidden while the photo is shown alone: "
            + Act.PHOTO_ALONE.keysInWords() + " shows it.";

    private final PhotoCanvas canvas;
    private final ScreenModel model;
    private final Editor editor;
    private final HeldKeys held;
    private final StatusLine status;
    private final Consumer<Message> say;
    private Drag drag;         // under way, or null
    private int dragButton;
    private double x;          // where the pointer is, in pixels of the screen
    private double y;
    private boolean inside;

    /** What follows from a button that is held down. */
    private interface Drag {
        void moved();

        void released();

        /** It ends before the button is released. */
        void cut();
    }

    PointerInput(PhotoCanvas canvas, ScreenModel model, Editor editor, HeldKeys held,
            StatusLine status, Consumer<Message> say) {
        this.canvas = canvas;
        this.model = model;
        this.editor = editor;
        this.held = held;
        this.status = status;
        this.say = say;
        canvas.addMouseListener(this);
        canvas.addMouseMotionListener(this);
        canvas.addMouseWheelListener(this);
        held.listen(this::showPointer);
        model.listen(this::showPointer);
    }

    /** Tells whether a stroke is drawn. */
    boolean strokeUnderWay() {
        return drag instanceof BrushStroke || drag instanceof LassoStroke;
    }

    /** Ends a drag whose button is still held: a stroke stays as it is, a lasso is dropped. */
    void cut() {
        if (drag == null) return;
        drag.cut();
        drag = null;
        showPointer();
    }

    /** Returns the pointer's column on the canvas in pixels of the screen, or the middle's. */
    double zoomX() {
        return inside ? x : canvas.devicePixels(canvas.getWidth()) / 2;
    }

    /** Returns the pointer's row on the canvas in pixels of the screen, or the middle's. */
    double zoomY() {
        return inside ? y : canvas.devicePixels(canvas.getHeight()) / 2;
    }

    @Override
    public void mousePressed(MouseEvent event) {
        canvas.requestFocusInWindow();
        follow(event);
        if (drag != null || !model.hasPhoto()) return;
        drag = begin(event);
        dragButton = event.getButton();
        showPointer();
    }

    private Drag begin(MouseEvent event) {
        boolean left = SwingUtilities.isLeftMouseButton(event);
        boolean right = event.getButton() == MouseEvent.BUTTON3;
        if (event.getButton() == MouseEvent.BUTTON2 || (left && held.space())) return new Pan();
        if (!left && !right) return null;
        if (model.replaying()) {
            editor.endStroke();  // there is none, but the editor says why there can be none
            return null;
        }
        if (model.photoAlone()) say.accept(new Message(Message.Kind.HINT, HIDDEN));
        boolean opposite = right || event.isAltDown();
        Tool tool = model.tool();
        Mode mode = tool.mode(opposite);
        boolean takesAway = tool.takesAway(opposite);
        return tool == Tool.LASSO ? new LassoStroke(mode, takesAway)
                : new BrushStroke(mode, takesAway);
    }

    @Override
    public void mouseDragged(MouseEvent event) {
        follow(event);
        if (drag != null) drag.moved();
        showPointer();
    }

    @Override
    public void mouseReleased(MouseEvent event) {
        follow(event);
        if (drag == null || event.getButton() != dragButton) return;
        drag.moved();
        drag.released();
        drag = null;
        showPointer();
    }

    @Override
    public void mouseMoved(MouseEvent event) {
        follow(event);
        held.setAlt(event.isAltDown());
        showPointer();
    }

    @Override
    public void mouseEntered(MouseEvent event) {
        mouseMoved(event);
    }

    @Override
    public void mouseExited(MouseEvent event) {
        inside = false;
        showPointer();
    }

    @Override
    public void mouseWheelMoved(MouseWheelEvent event) {
        follow(event);
        if (strokeUnderWay() || !model.hasPhoto()) return;
        double factor = Math.pow(WHEEL_FACTOR, -event.getPreciseWheelRotation());
        model.change(changed -> changed.view().zoom(factor, x, y));
    }

    private void follow(MouseEvent event) {
        x = canvas.devicePixels(event.getX());
        y = canvas.devicePixels(event.getY());
        inside = canvas.contains(event.getPoint());
    }

    private int column() {
        return model.view().column(x);
    }

    private int row() {
        return model.view().row(y);
    }

    private void showPointer() {
        boolean panning = drag instanceof Pan || (drag == null && held.space());
        if (!model.hasPhoto()) {
            canvas.setCursor(Cursor.getDefaultCursor());
        } else {
            canvas.setCursor(Cursor.getPredefinedCursor(
                    panning ? Cursor.HAND_CURSOR : Cursor.CROSSHAIR_CURSOR));
        }
        boolean brushSeen = model.hasPhoto() && !panning && (inside || drag != null);
        if (brushSeen) {
            canvas.showBrush(x, y, takesAway());
        } else {
            canvas.hideBrush();
        }
        boolean onPhoto = model.hasPhoto() && inside && model.view().onPhoto(column(), row());
        status.showPosition(onPhoto ? column() + ", " + row() : "");
    }

    private boolean takesAway() {
        if (drag instanceof BrushStroke stroke) return stroke.takesAway;
        return model.tool().takesAway(held.alt());
    }

    /** The photo follows the pointer. */
    private final class Pan implements Drag {
        private double lastX = x;
        private double lastY = y;

        @Override
        public void moved() {
            double dx = x - lastX;
            double dy = y - lastY;
            lastX = x;
            lastY = y;
            if (dx != 0 || dy != 0) model.change(changed -> changed.view().pan(dx, dy));
        }

        @Override
        public void released() {}

        @Override
        public void cut() {}
    }

    /** The brush follows the pointer. */
    private final class BrushStroke implements Drag {
        private final boolean takesAway;

        BrushStroke(Mode mode, boolean takesAway) {
            this.takesAway = takesAway;
            editor.beginStroke(mode, model.brush(), column(), row());
        }

        @Override
        public void moved() {
            editor.moveStroke(column(), row());
        }

        @Override
        public void released() {
            editor.endStroke();
        }

        @Override
        public void cut() {
            editor.cutStroke();
        }
    }

    /** The pointer draws a line that becomes a lasso when the button is released. */
    private final class LassoStroke implements Drag {
        private final Mode mode;
        private final boolean takesAway;
        private final LassoPath path = new LassoPath(model.view().scale());

        LassoStroke(Mode mode, boolean takesAway) {
            this.mode = mode;
            this.takesAway = takesAway;
            moved();
        }

        @Override
        public void moved() {
            path.add(column(), row());
            canvas.showLasso(path.corners(), takesAway);
        }

        @Override
        public void released() {
            editor.lasso(mode, path.corners());
            cut();
        }

        @Override
        public void cut() {
            canvas.showLasso(List.<Point>of(), takesAway);
        }
    }
}
