package com.velt.android.orvane.lumetrix.sample;

import android.content.Context;
import android.graphics.Bitmap;
import android.graphics.Canvas;
import android.graphics.Color;
import android.view.MotionEvent;
import android.view.View;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.Mode;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import com.velt.android.orvane.lumetrix.selection.Viewport;

/**
 * Shows a photo with the outline of what is selected. A finger is the edge-aware brush: each touch,
 * from down to up, is one stroke.
 */
public final class SelectionView extends View {
    /** Radius of the brush in view pixels, and its core's share of it. */
    private static final float BRUSH = 60;
    private static final float CORE_SHARE = 0.3f;

    private SelectionSession session;
    private Viewport port;
    private int[] pixels;
    private Bitmap shown;
    private Mode mode = Mode.GROW;
    private boolean touching;

    /** Makes a view without a photo. */
    public SelectionView(Context context) {
        super(context);
    }

    /** Begins with nothing selected in a photo. */
    public void open(Bitmap photo) {
        close();
        int width = photo.getWidth();
        int height = photo.getHeight();
        int[] colours = new int[width * height];
        photo.getPixels(colours, 0, width, 0, 0, width, height);
        session = new SelectionSession(colours, width, height);
        fitPhoto();
    }

    /** Chooses what touches do from now on: {@link Mode#GROW} or {@link Mode#SHRINK}. */
    public void setMode(Mode chosen) {
        mode = chosen;
    }

    /** Takes back the last stroke. */
    public void undo() {
        if (session == null || touching || !session.canUndo()) return;
        session.undo();
        redraw();
    }

    /** Gives up photo and selection. */
    public void close() {
        if (session == null) return;
        session.close();
        session = null;
        touching = false;
    }

    /** Returns the number of selected pixels. */
    public int selectedPixels() {
        return session == null ? 0 : session.selectedPixels();
    }

    @Override
    protected void onSizeChanged(int width, int height, int oldWidth, int oldHeight) {
        fitPhoto();
    }

    private void fitPhoto() {
        if (session == null || getWidth() == 0 || getHeight() == 0) return;
        port = Viewport.fitting(session.width(), session.height(), getWidth(), getHeight());
        pixels = new int[getWidth() * getHeight()];
        shown = Bitmap.createBitmap(getWidth(), getHeight(), Bitmap.Config.ARGB_8888);
        finishStroke();  // the brush of a stroke stays what it is
        int radius = Math.min(Math.max(2, Math.round(BRUSH * port.scale())),
                SelectionSession.LARGEST_RADIUS);
        session.setBrush(radius, Math.max(1, Math.round(radius * CORE_SHARE)));
        redraw();
    }

    @Override
    public boolean onTouchEvent(MotionEvent event) {
        if (session == null || port == null) return false;
        switch (event.getActionMasked()) {
            case MotionEvent.ACTION_DOWN:
                session.begin(mode);
                touching = true;
                dab(event.getX(), event.getY());
                break;
            case MotionEvent.ACTION_MOVE:
                for (int i = 0; i < event.getHistorySize(); ++i) {
                    dab(event.getHistoricalX(i), event.getHistoricalY(i));
                }
                dab(event.getX(), event.getY());
                break;
            case MotionEvent.ACTION_UP:
                finishStroke();
                break;
            case MotionEvent.ACTION_CANCEL:
                if (finishStroke()) undo();
                break;
            default:
                return false;
        }
        redraw();
        return true;
    }

    private void dab(float x, float y) {
        int column = port.offsetX() + (int) Math.floor(x * port.scale());
        int row = port.offsetY() + (int) Math.floor(y * port.scale());
        boolean onPhoto = column >= 0 && column < session.width() && row >= 0
                && row < session.height();
        if (touching && onPhoto) session.dab(column, row);
    }

    /** Returns whether the stroke has changed the selection. */
    private boolean finishStroke() {
        boolean changed = touching && !session.end().isEmpty();
        touching = false;
        return changed;
    }

    /** Draws the part of the view that shows the photo, and has it shown. */
    private void redraw() {
        Area photo = new Area(0, 0,
                Math.min(getWidth(), (int) (session.width() / port.scale())) - 1,
                Math.min(getHeight(), (int) (session.height() / port.scale())) - 1);
        session.drawOutlinedView(pixels, port, photo, Color.WHITE, Color.BLACK);
        shown.setPixels(pixels, 0, getWidth(), 0, 0, getWidth(), getHeight());
        invalidate();
    }

    @Override
    protected void onDraw(Canvas canvas) {
        if (shown != null) canvas.drawBitmap(shown, 0, 0, null);
    }
}
