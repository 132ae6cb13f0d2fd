package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.Color;
import java.awt.Font;
import java.awt.Frame;
import java.awt.GridBagConstraints;
import java.awt.GridBagLayout;
import java.awt.Insets;
import java.awt.Window;
import java.util.ArrayList;
import java.util.List;
import javax.swing.JComponent;
import javax.swing.JDialog;
import javax.swing.JLabel;
import javax.swing.JPanel;
import javax.swing.JScrollPane;
import javax.swing.KeyStroke;

/** Lists what keys and pointer do. */
final class KeysDialog {
    private static final String NAME = "keys";
    private static final int HEIGHT = 620;
    private static final int SCROLL_STEP = 20;

    private static final List<Row> POINTER = List.of(
            new Row("Drag", "", "Draws with the tool."),
            new Row("Alt or right button", "", "The tool does its opposite, from the press on."),
            new Row("", "", "Where the desktop moves windows by Alt, the right button is the way."),
            new Row("Wheel", "", "Zooms at the pointer."),
            new Row("Space or middle button", "", "Dragging moves the photo."),
            new Row("Drop a file", "", "Opens a photo, or replays a script."));

    private KeysDialog() {}

    /**
     * A line of the list.
     *
     * @param keys what is pressed
     * @param title the act, or empty
     * @param help what it does
     */
    record Row(String keys, String title, String help) {}

    /** Returns the lines about the acts of a group, from the table of acts. */
    static List<Row> rows(Act.Group group) {
        return group.acts().stream()
                .map(act -> new Row(act.keysInWords(), act.title().replace("…", ""), act.help()))
                .toList();
    }

    /** Shows the list in a window of its own, which comes to the front if it is there already. */
    static void show(Frame owner) {
        for (Window window : owner.getOwnedWindows()) {
            if (window.isShowing() && NAME.equals(window.getName())) {
                window.toFront();
                return;
            }
        }
        JDialog dialog = new JDialog(owner, "Keys and pointer", false);
        dialog.setName(NAME);
        JScrollPane scroll = new JScrollPane(page(), JScrollPane.VERTICAL_SCROLLBAR_ALWAYS,
                JScrollPane.HORIZONTAL_SCROLLBAR_NEVER);
        scroll.setBorder(Theme.padding(0, 0));
        scroll.getVerticalScrollBar().setUnitIncrement(SCROLL_STEP);
        dialog.add(scroll);
        dialog.getRootPane().registerKeyboardAction(event -> dialog.dispose(),
                KeyStroke.getKeyStroke("ESCAPE"), JComponent.WHEN_IN_FOCUSED_WINDOW);
        dialog.pack();
        dialog.setSize(dialog.getWidth(), Math.min(dialog.getHeight(), HEIGHT));
        dialog.setLocationRelativeTo(owner);
        dialog.setDefaultCloseOperation(JDialog.DISPOSE_ON_CLOSE);
        dialog.setVisible(true);
    }

    private static JPanel page() {
        JPanel page = new JPanel(new GridBagLayout());
        page.setBackground(Theme.CANVAS);
        page.setBorder(Theme.padding(Theme.GAP, 2 * Theme.GAP));
        List<JLabel[]> lines = new ArrayList<>();
        addSection(lines, "Pointer", POINTER);
        for (Act.Group group : Act.Group.values()) addSection(lines, group.title(), rows(group));
        for (int y = 0; y < lines.size(); ++y) {
            boolean heading = lines.get(y).length == 1;
            for (int x = 0; x < lines.get(y).length; ++x) {
                boolean last = x == lines.get(y).length - 1;
                page.add(lines.get(y)[x], new GridBagConstraints(x, y,
                        last ? GridBagConstraints.REMAINDER : 1, 1, last ? 1 : 0, 0,
                        GridBagConstraints.WEST, GridBagConstraints.NONE,
                        new Insets(heading ? 14 : 2, 0, 2, 3 * Theme.GAP), 0, 0));
            }
        }
        return page;
    }

    private static void addSection(List<JLabel[]> lines, String title, List<Row> rows) {
        lines.add(new JLabel[] {bold(title, Theme.ACCENT)});
        for (Row row : rows) {
            lines.add(new JLabel[] {bold(row.keys(), Theme.TEXT),
                Theme.label(row.title(), Theme.TEXT), Theme.label(row.help(), Theme.QUIET_TEXT)});
        }
    }

    private static JLabel bold(String text, Color colour) {
        JLabel label = Theme.label(text, colour);
        label.setFont(label.getFont().deriveFont(Font.BOLD));
        return label;
    }
}
