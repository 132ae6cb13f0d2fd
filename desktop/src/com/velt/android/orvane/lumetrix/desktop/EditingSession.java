package com.velt.android.orvane.lumetrix.desktop;

import android.graphics.Point;
import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.jni.Util;
import java.util.List;

/**
 * A photo being edited: the photo, its selection, the brush and the fill flag.
 *
 * <p>It calls the library as the app's editing screen does. The library holds one session in a
 * process, so only one of these may be open at a time.
 */
final class EditingSession implements AutoCloseable {
    /** The library's own brush before the first one is set. */
    private static final int RADIUS_AT_FIRST = 10;
    private static final int CORE_AT_FIRST = 1;

    private final Photo photo;
    private final CallLog calls;
    private final byte[] mask;
    private int brushRadius;
    private boolean fill = true;

    /**
     * Begins with nothing selected, the library's first brush and filling on.
     *
     * @param calls is told of each call before it is made
     */
    EditingSession(Photo photo, CallLog calls) {
        this.photo = photo;
        this.calls = calls;
        mask = new byte[photo.width() * photo.height()];
        setBrush(RADIUS_AT_FIRST, CORE_AT_FIRST);
        calls.add(Call.INIT);
        Util.init_objectsel(photo.width(), photo.height());
    }

    void setBrush(int radius, int core) {
        brushRadius = radius;
        calls.add(Call.SET_BRUSH, radius, core);
        Util.set_brush_size(radius, core);
    }

    int brushRadius() {
        return brushRadius;
    }

    void setFill(boolean on) {
        fill = on;
    }

    /** Dabs the brush on each point and returns what changed. */
    Rect brush(Mode mode, List<Point> dabs) {
        Rect changed = nothing();
        for (Point dab : dabs) modify(mode, dab, dab, fill, changed);
        return changed;
    }

    /**
     * Draws a closed lasso, from each corner to the next and from the last to the first, and
     * returns the rectangle of its outline.
     *
     * <p>Filling waits for the segment that closes the outline; an open one encloses nothing, and
     * would lose its outline.
     */
    Rect lasso(Mode mode, List<Point> corners) {
        Rect changed = nothing();
        int last = corners.size() - 1;
        for (int i = 0; i < last; ++i) {
            modify(mode, corners.get(i), corners.get(i + 1), false, changed);
        }
        modify(mode, corners.get(last), corners.get(0), fill, changed);
        return changed;
    }

    private void modify(Mode mode, Point from, Point to, boolean filling, Rect changed) {
        Rect stroke = new Rect();
        int fillFlag = filling ? 1 : 0;
        calls.add(Call.MODIFY, mode.number(), fillFlag, from.x, from.y, to.x, to.y);
        Util.modify_objectsel(photo.pixels(), mask, photo.width(), photo.height(), from, to,
                mode.number(), stroke, fillFlag);
        changed.left = Math.min(changed.left, stroke.left);
        changed.right = Math.max(changed.right, stroke.right);
        changed.top = Math.min(changed.top, stroke.top);
        changed.bottom = Math.max(changed.bottom, stroke.bottom);
    }

    Rect invert() {
        calls.add(Call.INVERT);
        Util.inverse_objectsel(mask, photo.width(), photo.height());
        return everything();
    }

    Rect reset() {
        calls.add(Call.RESET);
        Util.reset_objectsel(mask, photo.width(), photo.height());
        return everything();
    }

    /** Shrinks the object box to what is selected inside it; no pixel changes. */
    Rect updateBox() {
        calls.add(Call.UPDATE_BOX);
        Util.update_objectROI(mask, photo.width(), photo.height());
        return nothing();
    }

    Rect objectBox() {
        Rect box = new Rect();
        Util.get_objectROI(box);
        return box;
    }

    int selectedPixels() {
        int count = 0;
        for (byte value : mask) {
            if (value == 1) ++count;
        }
        return count;
    }

    Picture view(Viewport port) {
        Picture view = blank(port.width(), port.height());
        Util.native_drawImageWithMaskContour(view.pixels(), port.width(), port.height(),
                photo.pixels(), photo.width(), photo.height(), mask, port.scale(), port.offsetX(),
                port.offsetY(), port.firstColour(), port.secondColour(),
                new Rect(0, 0, port.width() - 1, port.height() - 1));
        return view;
    }

    Picture colourOnGrey() {
        Picture picture = blank(photo.width(), photo.height());
        Util.draw_withmask(photo.pixels(), picture.pixels(), mask, photo.width(), everything());
        return picture;
    }

    Picture reverse() {
        Picture picture = blank(photo.width(), photo.height());
        byte[] inverted = mask.clone();  // drawing inverts it
        Util.draw_reversemask(photo.pixels(), picture.pixels(), inverted, photo.width(),
                photo.height());
        return picture;
    }

    /** Draws selected pixels white and all others black. */
    Picture maskPicture() {
        Picture picture = blank(photo.width(), photo.height());
        for (int i = 0; i < mask.length; ++i) {
            picture.pixels()[i] = mask[i] == 1 ? Viewport.WHITE : Viewport.BLACK;
        }
        return picture;
    }

    /** Returns the digest of the selection and of how it looks. */
    Digest digest() {
        calls.add(Call.DIGEST);
        Viewport whole = Viewport.fitting(photo, Digest.VIEW_WIDTH, Digest.VIEW_HEIGHT);
        return Digest.of(mask, view(whole).pixels());
    }

    @Override
    public void close() {
        calls.add(Call.DESTROY);
        Util.destroy_objectsel();
    }

    private Rect everything() {
        return new Rect(0, 0, photo.width() - 1, photo.height() - 1);
    }

    private Rect nothing() {
        return new Rect(photo.width(), photo.height(), 0, 0);
    }

    private static Picture blank(int width, int height) {
        return new Picture(width, height, new int[width * height]);
    }
}
