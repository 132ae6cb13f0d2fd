package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.BasicStroke;
import java.awt.Component;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.geom.Path2D;
import java.awt.geom.RoundRectangle2D;
import javax.swing.AbstractButton;
import javax.swing.Icon;

/** The box of a check box. */
final class CheckIcon implements Icon {
    private static final int SIDE = 16;

    @Override
    public void paintIcon(Component component, Graphics graphics, int x, int y) {
        AbstractButton button = (AbstractButton) component;
        Graphics2D drawn = Theme.smooth(graphics);
        drawn.translate(x, y);
        var box = new RoundRectangle2D.Float(0.5f, 0.5f, SIDE - 1, SIDE - 1, 5, 5);
        boolean on = button.isSelected() && button.isEnabled();
        drawn.setColor(on ? Theme.ACCENT_DEEP : Theme.RAISED);
        drawn.fill(box);
        drawn.setColor(on ? Theme.ACCENT : Theme.EDGE);
        drawn.draw(box);
        if (button.isSelected()) {
            drawn.setColor(button.isEnabled() ? Theme.TEXT : Theme.DISABLED_TEXT);
            drawn.setStroke(new BasicStroke(1.8f, BasicStroke.CAP_ROUND, BasicStroke.JOIN_ROUND));
            Path2D tick = new Path2D.Float();
            tick.moveTo(4, 8.4);
            tick.lineTo(7, 11.4);
            tick.lineTo(12, 5);
            drawn.draw(tick);
        }
        drawn.dispose();
    }

    @Override
    public int getIconWidth() {
        return SIDE;
    }

    @Override
    public int getIconHeight() {
        return SIDE;
    }
}
