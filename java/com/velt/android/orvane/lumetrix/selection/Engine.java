package com.velt.android.orvane.lumetrix.selection;

import android.graphics.Point;
import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.jni.Util;

/**
 * The library's selection engine on one photo and mask: each call is announced to the listener and
 * made. Checks nothing.
 *
 * <p>Rectangles of the class {@link Rect} are the library's own four numbers, empty forms included.
 */
final class Engine {
    private static final int[] NO_PHOTO = {0};

    private final int[] pixels;
    private final byte[] mask;
    private final int width;
    private final int height;
    private final CallListener listener;
    private int brushRadius;
    private int coreRadius;

    Engine(int[] pixels, byte[] mask, int width, int height, CallListener listener) {
        this.pixels = pixels;
        this.mask = mask;
        this.width = width;
        this.height = height;
        this.listener = listener;
    }

    void begin() {
        listener.beforeCall(NativeCall.INIT);
        Util.init_objectsel(width, height);
    }

    /** Sets the brush and builds a new engine, which remembers nothing of earlier strokes. */
    void setBrush(int radius, int core) {
        listener.beforeCall(NativeCall.SET_BRUSH, radius, core);
        Util.set_brush_size(radius, core);
        brushRadius = radius;
        coreRadius = core;
    }

    /** Builds a new engine for the brush that is set. */
    void renew() {
        setBrush(brushRadius, coreRadius);
    }

    int brushRadius() {
        return brushRadius;
    }

    int coreRadius() {
        return coreRadius;
    }

    /** Makes one dab or draws one segment, and returns the rectangle that the library reports. */
    Area modify(Mode mode, boolean fill, int x1, int y1, int x2, int y2) {
        int fillFlag = fill ? 1 : 0;
        listener.beforeCall(NativeCall.MODIFY, mode.number(), fillFlag, x1, y1, x2, y2);
        // Only growing and shrinking read the photo. Virtual machines that copy arrays for the
        // library spend most of a call on it.
        boolean readsPhoto = mode == Mode.GROW || mode == Mode.SHRINK;
        Rect changed = new Rect();
        Util.modify_objectsel(readsPhoto ? pixels : NO_PHOTO, mask, width, height,
                new Point(x1, y1), new Point(x2, y2), mode.number(), changed, fillFlag);
        return areaOf(changed);
    }

    void invert() {
        listener.beforeCall(NativeCall.INVERT);
        Util.inverse_objectsel(mask, width, height);
    }

    void reset() {
        listener.beforeCall(NativeCall.RESET);
        Util.reset_objectsel(mask, width, height);
    }

    /** Selects the pixels of the runs and no others, and measures the object box from scratch. */
    void select(int[] runs) {
        listener.beforeCall(NativeCall.SELECT, runs);
        PixelRuns.write(runs, mask, width);
        Util.set_objectROI(new Rect(0, 0, width - 1, height - 1));
        Util.update_objectROI(mask, width, height);
    }

    void updateBox() {
        listener.beforeCall(NativeCall.UPDATE_BOX);
        Util.update_objectROI(mask, width, height);
    }

    Rect box() {
        Rect box = new Rect();
        Util.get_objectROI(box);
        return box;
    }

    void setBox(Rect box) {
        listener.beforeCall(NativeCall.SET_BOX, box.left, box.top, box.right, box.bottom);
        Util.set_objectROI(box);
    }

    void end() {
        listener.beforeCall(NativeCall.DESTROY);
        Util.destroy_objectsel();
    }

    static Area areaOf(Rect rect) {
        return new Area(rect.left, rect.top, rect.right, rect.bottom);
    }
}
