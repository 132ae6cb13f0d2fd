package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.Color;
import java.awt.Dimension;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.event.MouseEvent;
import java.awt.geom.Ellipse2D;
import java.awt.geom.RoundRectangle2D;
import javax.swing.JSlider;
import javax.swing.plaf.basic.BasicSliderUI;

/** A slider with a thin track that is filled up to a round thumb. It never takes the focus. */
final class FlatSlider extends JSlider {
    private static final long serialVersionUID = 1;
    private static final int THUMB = 14;
    private static final int TRACK = 4;
    private static final int HEIGHT = 24;

    /** Makes a slider that is as wide as this, or down to half of it in a narrow window. */
    FlatSlider(int from, int to, int width) {
        super(from, to);
        setUI(new Look(this));
        setFocusable(false);
        setOpaque(false);
        Dimension size = new Dimension(width, HEIGHT);
        setPreferredSize(size);
        setMaximumSize(size);
        setMinimumSize(new Dimension(width / 2, HEIGHT));
    }

    private static final class Look extends BasicSliderUI {
        Look(JSlider slider) {
            super(slider);
        }

        @Override
        protected Dimension getThumbSize() {
            return new Dimension(THUMB, THUMB);
        }

        @Override
        public void paintFocus(Graphics graphics) {}

        @Override
        public void paintTrack(Graphics graphics) {
            Graphics2D drawn = Theme.smooth(graphics);
            int top = trackRect.y + (trackRect.height - TRACK) / 2;
            int thumbAt = thumbRect.x + thumbRect.width / 2;
            drawn.setColor(slider.isEnabled() ? Theme.EDGE : Theme.RAISED);
            drawn.fill(line(trackRect.x, top, trackRect.width));
            if (slider.isEnabled()) {
                drawn.setColor(Theme.ACCENT);
                drawn.fill(line(trackRect.x, top, thumbAt - trackRect.x));
            }
            drawn.dispose();
        }

        private static RoundRectangle2D line(int x, int y, int width) {
            return new RoundRectangle2D.Float(x, y, width, TRACK, TRACK, TRACK);
        }

        @Override
        public void paintThumb(Graphics graphics) {
            Graphics2D drawn = Theme.smooth(graphics);
            Color colour = isDragging() ? Color.WHITE : Theme.TEXT;
            drawn.setColor(slider.isEnabled() ? colour : Theme.EDGE);
            drawn.fill(new Ellipse2D.Float(thumbRect.x + 0.5f, thumbRect.y + 0.5f, THUMB - 1,
                    THUMB - 1));
            drawn.dispose();
        }

        /** A click on the track moves the thumb there, not by a block. */
        @Override
        protected TrackListener createTrackListener(JSlider owner) {
            return new TrackListener() {
                @Override
                public void mousePressed(MouseEvent event) {
                    if (slider.isEnabled() && !thumbRect.contains(event.getPoint())) {
                        slider.setValue(valueForXPosition(event.getX()));
                    }
                    super.mousePressed(event);
                }

                @Override
                public boolean shouldScroll(int direction) {
                    return false;
                }
            };
        }
    }
}
