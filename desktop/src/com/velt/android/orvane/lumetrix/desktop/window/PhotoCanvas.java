package com.velt.android.orvane.lumetrix.desktop.window;

import android.graphics.Point;
import com.velt.android.orvane.lumetrix.desktop.editing.Editor;
import com.velt.android.orvane.lumetrix.desktop.editing.Frame;
import com.velt.android.orvane.lumetrix.desktop.editing.OpenedPhoto;
import com.velt.android.orvane.lumetrix.desktop.editing.Placement;
import com.velt.android.orvane.lumetrix.desktop.editing.ViewKind;
import com.velt.android.orvane.lumetrix.selection.Area;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.GraphicsConfiguration;
import java.awt.Rectangle;
import java.awt.event.ComponentAdapter;
import java.awt.event.ComponentEvent;
import java.awt.geom.AffineTransform;
import java.awt.geom.Rectangle2D;
import java.util.List;
import javax.swing.JComponent;

/**
 * Shows the editor's frames, and over them what the pointer is about to do.
 *
 * <p>Frames are drawn pixel by pixel on the screen's own pixels, whatever factor the desktop
 * enlarges windows by. The {@link ScreenModel}'s view is in pixels of the screen, too;
 * {@link #devicePixels} converts to them.
 */
final class PhotoCanvas extends JComponent {
    private static final long serialVersionUID = 1;

    private final transient ScreenModel model;
    private final transient Editor editor;
    private final transient FrameImage images = new FrameImage();
    private final transient Overlay overlay;
    private transient OpenedPhoto photo;
    private transient Wanted wanted;
    private transient Rectangle overlayBounds;

    /** What the editor was asked to show. */
    private record Wanted(OpenedPhoto photo, Placement placement, ViewKind kind) {}

    PhotoCanvas(ScreenModel model, Editor editor) {
        this.model = model;
        this.editor = editor;
        overlay = new Overlay(model);
        setName("canvas");
        setOpaque(true);
        setBackground(Theme.CANVAS);
        setFocusable(true);
        setFocusTraversalKeysEnabled(false);
        addComponentListener(new ComponentAdapter() {
            @Override
            public void componentResized(ComponentEvent event) {
                fitToSize();
            }
        });
        // The window has gone to a screen with another factor.
        addPropertyChangeListener("graphicsConfiguration", change -> fitToSize());
        model.listen(this::modelChanged);
    }

    /** Returns how many of the screen's pixels a unit of the window's positions is. */
    double deviceScale() {
        GraphicsConfiguration configuration = getGraphicsConfiguration();
        return configuration == null ? 1 : configuration.getDefaultTransform().getScaleX();
    }

    /** Returns the screen's pixel for a position of the pointer. */
    double devicePixels(int position) {
        return position * deviceScale();
    }

    private void fitToSize() {
        model.view().setView((int) Math.ceil(devicePixels(getWidth())),
                (int) Math.ceil(devicePixels(getHeight())));
        model.changed();
    }

    private void modelChanged() {
        OpenedPhoto next = model.state().photo();
        if (next != photo) {
            photo = next;
            images.clear();
            if (photo != null) model.view().setPhoto(photo.width(), photo.height());
        }
        showView();
        repaintOverlay();
    }

    private void showView() {
        if (photo == null) return;
        ViewKind kind = model.shownKind();
        Wanted next = new Wanted(photo, model.view().placement(kind), kind);
        if (next.equals(wanted)) return;
        wanted = next;
        editor.show(photo, next.placement(), kind);
    }

    /** Shows the brush at a position of the pointer in the screen's pixels. */
    void showBrush(double x, double y, boolean takesAway) {
        overlay.showBrush(x, y, takesAway);
        repaintOverlay();
    }

    /** Shows no brush, for the pointer is elsewhere or does something else. */
    void hideBrush() {
        overlay.hideBrush();
        repaintOverlay();
    }

    /** Shows a lasso that is being drawn; no corners take it away. */
    void showLasso(List<Point> corners, boolean takesAway) {
        overlay.showLasso(corners, takesAway);
        repaintOverlay();
    }

    /** Repaints where the overlay was, and where it is. */
    private void repaintOverlay() {
        if (overlayBounds != null) repaint(overlayBounds);
        overlayBounds = inWindow(overlay.bounds(deviceScale()));
        if (overlayBounds != null) repaint(overlayBounds);
    }

    private Rectangle inWindow(Rectangle2D device) {
        if (device == null) return null;
        double scale = deviceScale();
        return new Rectangle2D.Double(device.getX() / scale, device.getY() / scale,
                device.getWidth() / scale, device.getHeight() / scale).getBounds();
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        graphics.setColor(getBackground());
        graphics.fillRect(0, 0, getWidth(), getHeight());
        Graphics2D device = (Graphics2D) graphics.create();
        AffineTransform window = device.getTransform();
        device.setTransform(AffineTransform.getTranslateInstance(
                Math.round(window.getTranslateX()), Math.round(window.getTranslateY())));
        editor.look(frame -> drawFrame(device, frame));
        Graphics2D smooth = Theme.smooth(device);
        overlay.draw(smooth, deviceScale());
        smooth.dispose();
        device.dispose();
    }

    private void drawFrame(Graphics2D device, Frame frame) {
        Area seen = frame.placement().seen();
        if (seen.isEmpty()) return;
        int x = frame.placement().x();
        int y = frame.placement().y();
        int right = seen.right() + 1;
        int bottom = seen.bottom() + 1;
        device.drawImage(images.of(frame), x + seen.left(), y + seen.top(), x + right, y + bottom,
                seen.left(), seen.top(), right, bottom, null);
    }
}
