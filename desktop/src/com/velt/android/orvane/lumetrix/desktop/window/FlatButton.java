package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.BasicStroke;
import java.awt.Color;
import java.awt.Dimension;
import java.awt.FontMetrics;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.geom.RoundRectangle2D;
import javax.swing.Action;
import javax.swing.DefaultButtonModel;
import javax.swing.Icon;
import javax.swing.JToggleButton;

/**
 * A flat button with an icon or a text; one that is selected is filled with the accent.
 *
 * <p>It never takes the focus, so that keys keep their meaning for the canvas.
 */
final class FlatButton extends JToggleButton {
    private static final long serialVersionUID = 1;
    private static final int TEXT_HEIGHT = 28;
    private static final int TEXT_PADDING = 11;
    private static final float RIM = 1;

    private final boolean framed;

    private FlatButton(Action action, boolean latching, boolean framed) {
        super(action);
        this.framed = framed;
        if (!latching) {
            setModel(new DefaultButtonModel());
            setEnabled(action.isEnabled());
        }
        setFocusable(false);
        setRolloverEnabled(true);
        setOpaque(false);
        setBorder(Theme.padding(0, 0));
        setForeground(Theme.TEXT);
    }

    /** Makes a square button with an icon that stays selected, for one of several choices. */
    static FlatButton choice(Action action, Icon icon, int side) {
        return withIcon(new FlatButton(action, true, false), icon, side);
    }

    /** Makes a square button with an icon that does something. */
    static FlatButton push(Action action, Icon icon, int side) {
        return withIcon(new FlatButton(action, false, false), icon, side);
    }

    /** Makes a button with a text that stays selected. */
    static FlatButton choice(Action action) {
        return withText(new FlatButton(action, true, true));
    }

    /** Makes a button with a text that does something. */
    static FlatButton push(Action action) {
        return withText(new FlatButton(action, false, true));
    }

    private static FlatButton withIcon(FlatButton button, Icon icon, int side) {
        button.setText(null);
        button.setIcon(icon);
        button.setFixedSize(new Dimension(side, side));
        return button;
    }

    private static FlatButton withText(FlatButton button) {
        button.setFont(Theme.label("", Theme.TEXT).getFont());
        int width = button.getFontMetrics(button.getFont()).stringWidth(button.getText());
        button.setFixedSize(new Dimension(width + 2 * TEXT_PADDING, TEXT_HEIGHT));
        return button;
    }

    private void setFixedSize(Dimension size) {
        setPreferredSize(size);
        setMinimumSize(size);
        setMaximumSize(size);
    }

    @Override
    protected void paintComponent(Graphics graphics) {
        Graphics2D drawn = Theme.smooth(graphics);
        var outline = new RoundRectangle2D.Float(RIM / 2, RIM / 2, getWidth() - RIM,
                getHeight() - RIM, Theme.ROUNDING, Theme.ROUNDING);
        Color fill = fill();
        if (fill != null) {
            drawn.setColor(fill);
            drawn.fill(outline);
        }
        if (framed && !isSelected()) {
            drawn.setColor(isEnabled() ? Theme.EDGE : Theme.RAISED);
            drawn.setStroke(new BasicStroke(RIM));
            drawn.draw(outline);
        }
        drawContent(drawn);
        drawn.dispose();
    }

    private Color fill() {
        boolean held = getModel().isArmed() && getModel().isPressed();
        if (isSelected()) return isEnabled() ? Theme.ACCENT_DEEP : Theme.RAISED;
        if (!isEnabled()) return null;
        if (held) return Theme.PRESSED;
        if (getModel().isRollover()) return Theme.HOVERED;
        return framed ? Theme.RAISED : null;
    }

    private void drawContent(Graphics2D drawn) {
        Icon icon = getIcon();
        if (icon != null) {
            icon.paintIcon(this, drawn, (getWidth() - icon.getIconWidth()) / 2,
                    (getHeight() - icon.getIconHeight()) / 2);
            return;
        }
        FontMetrics metrics = drawn.getFontMetrics(getFont());
        drawn.setFont(getFont());
        drawn.setColor(isEnabled() ? getForeground() : Theme.DISABLED_TEXT);
        drawn.drawString(getText(), (getWidth() - metrics.stringWidth(getText())) / 2,
                (getHeight() - metrics.getHeight()) / 2 + metrics.getAscent());
    }
}
