package com.velt.android.orvane.lumetrix.desktop.window;

import android.graphics.Point;
import com.velt.android.orvane.lumetrix.desktop.editing.Brush;
import com.velt.android.orvane.lumetrix.desktop.editing.ViewModel;
import java.awt.BasicStroke;
import java.awt.Color;
import java.awt.Graphics2D;
import java.awt.Shape;
import java.awt.geom.Ellipse2D;
import java.awt.geom.Path2D;
import java.awt.geom.Rectangle2D;
import java.util.List;

/**
 * What is drawn over the photo: the brush at the pointer, and the lasso under way.
 *
 * <p>Lines are light on dark, so that they are seen on any photo, and of another colour when the
 * stroke takes away. All in pixels of the screen.
 */
final class Overlay {
    private static final float LIGHT_WIDTH = 1.4f;
    private static final float DARK_WIDTH = 3.6f;
    private static final float CLOSING_DASH = 5;
    private static final double SMALLEST_RING = 1.5;
    private static final Color DARK = new Color(0, 0, 0, 150);
    private static final Color ADDING = Color.WHITE;

    private final ScreenModel model;
    private boolean brushShown;
    private double brushX;
    private double brushY;
    private boolean brushTakesAway;
    private List<Point> lasso = List.of();
    private boolean lassoTakesAway;

    Overlay(ScreenModel model) {
        this.model = model;
    }

    void showBrush(double x, double y, boolean takesAway) {
        brushShown = true;
        brushX = x;
        brushY = y;
        brushTakesAway = takesAway;
    }

    void hideBrush() {
        brushShown = false;
    }

    void showLasso(List<Point> corners, boolean takesAway) {
        lasso = corners;
        lassoTakesAway = takesAway;
    }

    private boolean hasRing() {
        return brushShown && model.hasPhoto() && model.tool().hasSize();
    }

    /** Returns a rectangle around all of it, or null when there is nothing. */
    Rectangle2D bounds(double deviceScale) {
        Rectangle2D bounds = hasRing() ? ring(model.brush().radius()).getBounds2D() : null;
        if (lasso.size() > 1) {
            Rectangle2D around = lassoPath().getBounds2D();
            bounds = bounds == null ? around : bounds.createUnion(around);
        }
        if (bounds == null) return null;
        double margin = DARK_WIDTH * deviceScale + 1;
        return new Rectangle2D.Double(bounds.getX() - margin, bounds.getY() - margin,
                bounds.getWidth() + 2 * margin, bounds.getHeight() + 2 * margin);
    }

    void draw(Graphics2D graphics, double deviceScale) {
        float unit = (float) deviceScale;
        if (lasso.size() > 1) drawLasso(graphics, unit);
        if (hasRing()) drawBrush(graphics, unit);
    }

    private void drawBrush(Graphics2D graphics, float unit) {
        Brush brush = model.brush();
        Color colour = brushTakesAway ? Theme.TAKING : ADDING;
        drawLine(graphics, ring(brush.radius()), colour, unit, null);
        boolean coreSeen = model.tool().hasCore() && brush.core() < brush.radius();
        if (coreSeen) drawLine(graphics, ring(brush.core()), colour, unit * 0.7f, null);
    }

    /** The dab's centre is a whole photo pixel, so the ring moves in steps of one. */
    private Ellipse2D ring(int radius) {
        ViewModel view = model.view();
        double x = view.viewX(view.column(brushX) + 0.5);
        double y = view.viewY(view.row(brushY) + 0.5);
        double onScreen = Math.max(SMALLEST_RING, (radius + 0.5) / view.scale());
        return new Ellipse2D.Double(x - onScreen, y - onScreen, 2 * onScreen, 2 * onScreen);
    }

    private void drawLasso(Graphics2D graphics, float unit) {
        Color colour = lassoTakesAway ? Theme.TAKING : ADDING;
        Point last = lasso.get(lasso.size() - 1);
        Path2D closing = new Path2D.Double();
        closing.moveTo(viewX(last), viewY(last));
        closing.lineTo(viewX(lasso.get(0)), viewY(lasso.get(0)));
        drawLine(graphics, closing, colour, unit, new float[] {CLOSING_DASH * unit});
        drawLine(graphics, lassoPath(), colour, unit, null);
    }

    private Path2D lassoPath() {
        Path2D path = new Path2D.Double();
        path.moveTo(viewX(lasso.get(0)), viewY(lasso.get(0)));
        for (Point corner : lasso) path.lineTo(viewX(corner), viewY(corner));
        return path;
    }

    private double viewX(Point corner) {
        return model.view().viewX(corner.x + 0.5);
    }

    private double viewY(Point corner) {
        return model.view().viewY(corner.y + 0.5);
    }

    private static void drawLine(Graphics2D graphics, Shape line, Color colour, float unit,
            float[] dashes) {
        graphics.setColor(DARK);
        graphics.setStroke(stroke(DARK_WIDTH * unit, dashes));
        graphics.draw(line);
        graphics.setColor(colour);
        graphics.setStroke(stroke(LIGHT_WIDTH * unit, dashes));
        graphics.draw(line);
    }

    private static BasicStroke stroke(float width, float[] dashes) {
        return new BasicStroke(width, BasicStroke.CAP_BUTT, BasicStroke.JOIN_ROUND, 1, dashes, 0);
    }
}
