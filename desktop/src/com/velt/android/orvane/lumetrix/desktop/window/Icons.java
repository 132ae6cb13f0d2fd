package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.BasicStroke;
import java.awt.Color;
import java.awt.Component;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.Image;
import java.awt.Shape;
import java.awt.geom.AffineTransform;
import java.awt.geom.Ellipse2D;
import java.awt.geom.Line2D;
import java.awt.geom.Path2D;
import java.awt.geom.Rectangle2D;
import java.awt.geom.RoundRectangle2D;
import java.awt.image.BufferedImage;
import java.util.List;
import java.util.stream.IntStream;
import javax.swing.Icon;

/** The icons, drawn from shapes in a square of 24 units and so sharp in any size. */
enum Icons {
    SMART_BRUSH(Icons::smartBrush),
    SMART_ERASER(Icons::smartEraser),
    BRUSH(Icons::brush),
    ERASER(Icons::eraser),
    LASSO(Icons::lasso),
    UNDO(Icons::undo),
    REDO(Icons::redo),
    INVERT(Icons::invert),
    CLEAR(Icons::clear),
    PHOTO(Icons::photo);

    private static final double UNITS = 24;
    private static final float LINE_WIDTH = 1.7f;

    private final Drawing drawing;

    /** Draws an icon in its square. */
    private interface Drawing {
        void draw(Graphics2D graphics);
    }

    Icons(Drawing drawing) {
        this.drawing = drawing;
    }

    /** Returns an icon of this side in the colour of the component that shows it. */
    Icon ofSize(int side) {
        return new Icon() {
            @Override
            public void paintIcon(Component component, Graphics graphics, int x, int y) {
                Graphics2D drawn = Theme.smooth(graphics);
                drawn.translate(x, y);
                drawn.scale(side / UNITS, side / UNITS);
                drawn.setColor(component.isEnabled() ? component.getForeground()
                        : Theme.DISABLED_TEXT);
                drawn.setStroke(new BasicStroke(LINE_WIDTH, BasicStroke.CAP_ROUND,
                        BasicStroke.JOIN_ROUND));
                drawing.draw(drawn);
                drawn.dispose();
            }

            @Override
            public int getIconWidth() {
                return side;
            }

            @Override
            public int getIconHeight() {
                return side;
            }
        };
    }

    /** Returns the program's icon in the sizes that desktops ask for. */
    static List<Image> ofProgram() {
        return IntStream.of(16, 24, 32, 48, 64, 128).mapToObj(Icons::programIcon).toList();
    }

    private static Image programIcon(int side) {
        BufferedImage image = new BufferedImage(side, side, BufferedImage.TYPE_INT_ARGB);
        Graphics2D graphics = Theme.smooth(image.createGraphics());
        graphics.scale(side / UNITS, side / UNITS);
        graphics.setColor(Theme.ACCENT_DEEP);
        graphics.fill(new RoundRectangle2D.Double(0, 0, UNITS, UNITS, 6, 6));
        graphics.setColor(Color.WHITE);
        graphics.setStroke(new BasicStroke(LINE_WIDTH, BasicStroke.CAP_ROUND,
                BasicStroke.JOIN_ROUND));
        graphics.translate(UNITS * 0.1, UNITS * 0.1);
        graphics.scale(0.8, 0.8);
        smartBrush(graphics);
        graphics.dispose();
        return image;
    }

    private static Path2D path(boolean closed, double... points) {
        Path2D path = new Path2D.Double();
        path.moveTo(points[0], points[1]);
        for (int i = 2; i < points.length; i += 2) path.lineTo(points[i], points[i + 1]);
        if (closed) path.closePath();
        return path;
    }

    private static void brush(Graphics2D graphics) {
        graphics.draw(path(true, 19.2, 2.8, 21.2, 4.8, 12.6, 14.2, 9.8, 11.4));
        Path2D hair = new Path2D.Double();
        hair.moveTo(8.3, 12.9);
        hair.curveTo(5.4, 13, 5.6, 17.6, 2.8, 19);
        hair.curveTo(6, 21.6, 11.2, 20.4, 11.1, 15.7);
        hair.closePath();
        graphics.fill(hair);
    }

    private static void eraser(Graphics2D graphics) {
        AffineTransform upright = graphics.getTransform();
        graphics.rotate(-Math.PI / 4, 11.5, 11.5);
        graphics.draw(new RoundRectangle2D.Double(3.2, 7.2, 16.6, 8.6, 2, 2));
        graphics.fill(new RoundRectangle2D.Double(3.2, 7.2, 7.4, 8.6, 2, 2));
        graphics.setTransform(upright);
        graphics.draw(new Line2D.Double(11, 20.8, 21, 20.8));
    }

    private static void smartBrush(Graphics2D graphics) {
        lowered(graphics, Icons::brush);
        graphics.fill(sparkle(5.6, 6.2, 4.6));
    }

    private static void smartEraser(Graphics2D graphics) {
        lowered(graphics, Icons::eraser);
        graphics.fill(sparkle(5.6, 6.2, 4.6));
    }

    /** Leaves room at the top left. */
    private static void lowered(Graphics2D graphics, Drawing drawing) {
        AffineTransform whole = graphics.getTransform();
        graphics.translate(3.6, 3.6);
        graphics.scale(0.86, 0.86);
        drawing.draw(graphics);
        graphics.setTransform(whole);
    }

    /** A star of four points: what follows the edge by itself. */
    private static Shape sparkle(double x, double y, double radius) {
        Path2D star = new Path2D.Double();
        double waist = radius * 0.16;
        star.moveTo(x, y - radius);
        star.quadTo(x + waist, y - waist, x + radius, y);
        star.quadTo(x + waist, y + waist, x, y + radius);
        star.quadTo(x - waist, y + waist, x - radius, y);
        star.quadTo(x - waist, y - waist, x, y - radius);
        star.closePath();
        return star;
    }

    private static void lasso(Graphics2D graphics) {
        Path2D loop = new Path2D.Double();
        loop.moveTo(7.6, 15.2);
        loop.curveTo(-0.6, 12.4, 2.4, 3.4, 12, 3.4);
        loop.curveTo(21.6, 3.4, 24.4, 12.4, 15.4, 15.2);
        loop.curveTo(12.6, 16, 10.6, 16, 9.4, 15.7);
        graphics.draw(loop);
        graphics.draw(new Ellipse2D.Double(5.4, 13.8, 4, 4));
        Path2D end = new Path2D.Double();
        end.moveTo(7.2, 17.8);
        end.curveTo(7.6, 19.6, 6.8, 20.6, 5.2, 21.2);
        graphics.draw(end);
    }

    private static void undo(Graphics2D graphics) {
        Path2D arc = new Path2D.Double();
        arc.moveTo(4.4, 9.2);
        arc.lineTo(14, 9.2);
        arc.curveTo(21.6, 9.2, 21.6, 19.4, 14, 19.4);
        arc.lineTo(9.5, 19.4);
        graphics.draw(arc);
        graphics.draw(path(false, 8.6, 4.8, 4.2, 9.2, 8.6, 13.6));
    }

    private static void redo(Graphics2D graphics) {
        AffineTransform plain = graphics.getTransform();
        graphics.translate(UNITS, 0);
        graphics.scale(-1, 1);
        undo(graphics);
        graphics.setTransform(plain);
    }

    private static void invert(Graphics2D graphics) {
        graphics.draw(new Ellipse2D.Double(3.6, 3.6, 16.8, 16.8));
        Shape clip = graphics.getClip();
        graphics.clip(new Rectangle2D.Double(12, 0, 12, UNITS));
        graphics.fill(new Ellipse2D.Double(3.6, 3.6, 16.8, 16.8));
        graphics.setClip(clip);
    }

    private static void clear(Graphics2D graphics) {
        graphics.draw(new Line2D.Double(4, 6.4, 20, 6.4));
        graphics.draw(path(false, 9, 6.2, 9.6, 3.6, 14.4, 3.6, 15, 6.2));
        graphics.draw(path(false, 5.8, 6.6, 6.8, 20.6, 17.2, 20.6, 18.2, 6.6));
        graphics.draw(new Line2D.Double(10, 10, 10.2, 17));
        graphics.draw(new Line2D.Double(14, 10, 13.8, 17));
    }

    private static void photo(Graphics2D graphics) {
        graphics.setStroke(new BasicStroke(0.8f, BasicStroke.CAP_ROUND, BasicStroke.JOIN_ROUND));
        graphics.draw(new RoundRectangle2D.Double(2, 4, 20, 16, 2.4, 2.4));
        graphics.draw(new Ellipse2D.Double(14.6, 6.8, 3.6, 3.6));
        graphics.draw(path(false, 2.4, 17, 8.6, 10.4, 14.4, 16.6, 17, 14.2, 21.6, 18.4));
    }
}
