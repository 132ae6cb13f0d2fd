package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.Component;
import java.awt.Dimension;
import javax.swing.Box;
import javax.swing.BoxLayout;
import javax.swing.JComponent;
import javax.swing.JLabel;
import javax.swing.JPanel;

/** What the canvas shows before the first photo: how to open one. */
final class EmptyScreen extends JPanel {
    private static final long serialVersionUID = 1;
    private static final int ICON = 88;
    private static final float TITLE_SIZE = 20;

    EmptyScreen(ScreenModel model, Actions actions) {
        setName("empty");
        setOpaque(false);
        setLayout(new BoxLayout(this, BoxLayout.Y_AXIS));
        JLabel icon = new JLabel(Icons.PHOTO.ofSize(ICON));
        icon.setForeground(Theme.DISABLED_TEXT);
        JLabel title = new JLabel("Open a photo, then brush over what you want to select");
        title.setFont(title.getFont().deriveFont(TITLE_SIZE));
        title.setForeground(Theme.TEXT);
        JLabel drop = new JLabel("or drop a JPEG, a PNG or a stroke script here");
        drop.setForeground(Theme.QUIET_TEXT);
        FlatButton open = FlatButton.push(actions.of(Act.OPEN_PHOTO));
        open.setName("empty.open");
        JLabel keys = Theme.label(Act.OPEN_PHOTO.keysInWords() + " opens a photo,  "
                + Act.KEYS.keysInWords() + " lists all keys", Theme.DISABLED_TEXT);
        addCentred(icon, 18);
        addCentred(title, 16);
        addCentred(open, 12);
        addCentred(drop, 28);
        addCentred(keys, 0);
        model.listen(() -> setVisible(!model.hasPhoto() && model.state().work().isEmpty()));
    }

    private void addCentred(JComponent component, int gapBelow) {
        component.setAlignmentX(Component.CENTER_ALIGNMENT);
        add(component);
        add(Box.createRigidArea(new Dimension(0, gapBelow)));
    }
}
