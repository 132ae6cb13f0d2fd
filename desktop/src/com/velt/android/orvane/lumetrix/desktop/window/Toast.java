package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.desktop.editing.Message;
import java.awt.AlphaComposite;
import java.awt.Color;
import java.awt.Dimension;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.geom.Ellipse2D;
import java.awt.geom.RoundRectangle2D;
import javax.swing.BorderFactory;
import javax.swing.JLabel;
import javax.swing.Timer;

/** A sentence over the canvas that fades away by itself and is in nobody's way. */
final class Toast extends JLabel {
    private static final long serialVersionUID = 1;
    private static final int SHORTEST_MILLIS = 3000;
    private static final int MILLIS_PER_LETTER = 45;
    private static final int FADE_STEP_MILLIS = 40;
    private static final float FADE_STEP = 0.1f;
    private static final int DOT = 8;
    private static final int LEFT = 30;
    private static final int RIGHT = 16;
    private static final int HEIGHT = 36;
    private static final Color HINT = new Color(0xE8B64C);
    private static final Color BACKGROUND = new Color(0x30, 0x30, 0x30, 240);

    private final transient Timer wait = new Timer(SHORTEST_MILLIS, event -> fade());
    private final transient Timer fading = new Timer(FADE_STEP_MILLIS, event -> fadeOn());
    private Color dot = Theme.QUIET_TEXT;
    private float opacity;

    Toast() {
        setName("toast");
        setForeground(Theme.TEXT);
        setVisible(false);
        wait.setRepeats(false);
        setBorder(BorderFactory.createEmptyBorder(0, LEFT, 0, RIGHT));
    }

    /** Shows a hint, or that something is done. */
    void show(Message message) {
        dot = message.kind() == Message.Kind.DONE ? Theme.ACCENT : HINT;
        setText(message.text());
        opacity = 1;
        fading.stop();
        wait.setInitialDelay(SHORTEST_MILLIS + MILLIS_PER_LETTER * message.text().length());
        wait.restart();
        setVisible(true);
        revalidate();
        repaint();
    }

    /** Ends it at once. */
    void close() {
        wait.stop();
        fading.stop();
        setVisible(false);
    }

    private void fade() {
        fading.start();
    }

    private void fadeOn() {
        opacity = Math.max(0, opacity - FADE_STEP);
        if (opacity == 0) close();
        repaint();
    }

    @Override
    public Dimension getPreferredSize() {
        return new Dimension(super.getPreferredSize().width, HEIGHT);
    }

    /** The pointer acts on the canvas below. */
    @Override
    public boolean contains(int x, int y) {
        return false;
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        Graphics2D drawn = Theme.smooth(graphics);
        drawn.setComposite(AlphaComposite.SrcOver.derive(opacity));
        var shape = new RoundRectangle2D.Float(0.5f, 0.5f, getWidth() - 1, getHeight() - 1,
                HEIGHT / 2f, HEIGHT / 2f);
        drawn.setColor(BACKGROUND);
        drawn.fill(shape);
        drawn.setColor(Theme.EDGE);
        drawn.draw(shape);
        drawn.setColor(dot);
        drawn.fill(new Ellipse2D.Float((LEFT - DOT) / 2f, (getHeight() - DOT) / 2f, DOT, DOT));
        super.paintComponent(drawn);
        drawn.dispose();
    }
}
