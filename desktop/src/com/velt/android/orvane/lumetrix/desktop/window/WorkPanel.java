package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.desktop.editing.EditorState;
import java.awt.Color;
import java.awt.Dimension;
import java.awt.FlowLayout;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.geom.RoundRectangle2D;
import javax.swing.JLabel;
import javax.swing.JPanel;
import javax.swing.JProgressBar;
import javax.swing.Timer;
import javax.swing.plaf.basic.BasicProgressBarUI;

/** Says over the canvas what takes a while, how far it is, and stops a replay. */
final class WorkPanel extends JPanel {
    private static final long serialVersionUID = 1;
    private static final int PATIENCE_MILLIS = 150;  // shorter work would only flicker
    private static final Dimension BAR_SIZE = new Dimension(180, 8);
    private static final Color BACKGROUND = new Color(0x30, 0x30, 0x30, 240);

    private final transient ScreenModel model;
    private final JLabel text = new JLabel();
    private final JProgressBar bar = new FlatProgress();
    private final FlatButton stop;
    private final transient Timer patience = new Timer(PATIENCE_MILLIS, event -> setVisible(true));

    WorkPanel(ScreenModel model, Actions actions) {
        super(new FlowLayout(FlowLayout.CENTER, 12, Theme.GAP));
        this.model = model;
        setName("work");
        setOpaque(false);
        setVisible(false);
        text.setName("work.text");
        text.setForeground(Theme.TEXT);
        bar.setName("work.bar");
        bar.setPreferredSize(BAR_SIZE);
        stop = FlatButton.push(actions.of(Act.STOP));
        stop.setName("work.stop");
        add(text);
        add(bar);
        add(stop);
        patience.setRepeats(false);
        model.listen(this::refresh);
    }

    /** A bar without the look-and-feel's own frame. */
    private static final class FlatProgress extends JProgressBar {
        private static final long serialVersionUID = 1;

        FlatProgress() {
            setUI(new BasicProgressBarUI());
            setBorderPainted(false);
            setBackground(Theme.EDGE);
            setForeground(Theme.ACCENT);
        }
    }

    private void refresh() {
        EditorState state = model.state();
        boolean busy = !state.work().isEmpty();
        if (!busy) {
            patience.stop();
            setVisible(false);
            bar.setIndeterminate(false);
            return;
        }
        boolean counted = state.workTotal() > 0;
        text.setText(state.work());
        bar.setIndeterminate(!counted);
        bar.setMaximum(Math.max(1, state.workTotal()));
        bar.setValue(state.workDone());
        stop.setVisible(counted);
        if (!isVisible() && !patience.isRunning()) patience.start();
        revalidate();
    }

    /** Ends its timer. */
    void close() {
        patience.stop();
        bar.setIndeterminate(false);
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        Graphics2D drawn = Theme.smooth(graphics);
        var shape = new RoundRectangle2D.Float(0.5f, 0.5f, getWidth() - 1, getHeight() - 1,
                2 * Theme.GAP, 2 * Theme.GAP);
        drawn.setColor(BACKGROUND);
        drawn.fill(shape);
        drawn.setColor(Theme.EDGE);
        drawn.draw(shape);
        drawn.dispose();
    }
}
