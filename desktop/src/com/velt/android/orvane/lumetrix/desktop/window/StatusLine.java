package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.desktop.editing.Brush;
import com.velt.android.orvane.lumetrix.desktop.editing.EditorState;
import com.velt.android.orvane.lumetrix.desktop.editing.OpenedPhoto;
import java.awt.Component;
import java.awt.Dimension;
import java.util.Locale;
import javax.swing.BorderFactory;
import javax.swing.Box;
import javax.swing.BoxLayout;
import javax.swing.JLabel;
import javax.swing.JPanel;

/** The line below the canvas: photo, zoom, tool, selection, and how long things took. */
final class StatusLine extends JPanel {
    private static final long serialVersionUID = 1;
    private static final int BETWEEN = 18;
    private static final double NANOS_PER_MILLISECOND = 1e6;
    private static final int LONGEST_NAME = 32;  // letters
    private static final double TENTHS_BELOW = 100;  // from there on whole numbers do

    private final transient ScreenModel model;
    private final JLabel photo = part("status.photo", "The photo, columns x rows", "");
    private final JLabel zoom = part("status.zoom", "Screen pixels a photo pixel", "3200 %");
    private final JLabel tool = part("status.tool", "The tool, and its brush in photo pixels", "");
    private final JLabel selected = part("status.selected", "Selected pixels, and their share", "");
    private final JLabel times = part("status.times", "What the library took for the last stroke,"
            + " and the last drawing of the view", "");
    private final JLabel position = part("status.position", "The photo's column and row at the"
            + " pointer", "00000, 00000");

    StatusLine(ScreenModel model) {
        this.model = model;
        setName("status");
        setLayout(new BoxLayout(this, BoxLayout.X_AXIS));
        setBackground(Theme.BAR);
        setBorder(BorderFactory.createCompoundBorder(
                BorderFactory.createMatteBorder(1, 0, 0, 0, Theme.LINE),
                Theme.padding(5, Theme.GAP + 4)));
        photo.setForeground(Theme.TEXT);
        for (JLabel label : new JLabel[] {photo, zoom, tool, selected, times}) {
            add(label);
            add(Box.createHorizontalStrut(BETWEEN));
        }
        add(Box.createHorizontalGlue());
        position.setHorizontalAlignment(JLabel.RIGHT);
        add(position);
        model.listen(this::refresh);
    }

    /** {@code longest} is the text that there is always room for; empty for what it holds. */
    private static JLabel part(String name, String help, String longest) {
        JLabel label = Theme.label(longest, Theme.QUIET_TEXT);
        label.setName(name);
        label.setToolTipText(help);
        label.setAlignmentY(Component.CENTER_ALIGNMENT);
        if (!longest.isEmpty()) {
            Dimension room = label.getPreferredSize();
            label.setPreferredSize(room);
            label.setMinimumSize(room);
            label.setMaximumSize(room);
            label.setText("");
        }
        return label;
    }

    /** Shows the pointer's place on the photo, or an empty text elsewhere. */
    void showPosition(String text) {
        if (!text.equals(position.getText())) position.setText(text);
    }

    private void refresh() {
        EditorState state = model.state();
        tool.setText(toolText());
        if (state.photo() == null) {
            photo.setText("No photo");
            zoom.setText("");
            selected.setText("");
            times.setText("");
            return;
        }
        photo.setText(photoText(state.photo()));
        double percent = model.zoomPercent();
        zoom.setText(String.format(Locale.ROOT, percent < 10 ? "%.1f %%" : "%.0f %%", percent));
        selected.setText(selectedText(state) + (model.photoAlone() ? " (hidden)" : ""));
        times.setText(timesText(state));
    }

    private static String photoText(OpenedPhoto photo) {
        String size = shortened(photo.name()) + "  " + photo.width() + " × " + photo.height();
        if (!photo.isReduced()) return size;
        return size + " (reduced from " + photo.fileWidth() + " × " + photo.fileHeight() + ")";
    }

    /** Leaves out the middle of a long name, which the window's title shows whole. */
    private static String shortened(String name) {
        if (name.length() <= LONGEST_NAME) return name;
        int half = LONGEST_NAME / 2;
        return name.substring(0, half) + "…" + name.substring(name.length() - half + 1);
    }

    private String toolText() {
        String title = model.tool().title();
        if (!model.tool().hasSize()) return title;
        Brush brush = model.brush();
        String radius = title + "  radius " + brush.radius();
        return model.tool().hasCore() ? radius + ", core " + brush.core() : radius;
    }

    private static String selectedText(EditorState state) {
        // A narrow space between thousands, which no locale reads as a decimal mark.
        String pixels = String.format(Locale.ROOT, "%,d", state.selectedPixels())
                .replace(',', '\u202f');
        double percent = 100 * state.share();
        return pixels + " px selected, "
                + String.format(Locale.ROOT, percent < 1 ? "%.2f %%" : "%.1f %%", percent);
    }

    private static String timesText(EditorState state) {
        String redraw = "view " + milliseconds(state.redrawNanos());
        if (state.strokeDabs() == 0) return redraw;
        return "stroke " + milliseconds(state.strokeNanos()) + " (" + state.strokeDabs()
                + (state.strokeDabs() == 1 ? " point), " : " points), ") + redraw;
    }

    private static String milliseconds(long nanos) {
        double time = nanos / NANOS_PER_MILLISECOND;
        return String.format(Locale.ROOT, time < TENTHS_BELOW ? "%.1f ms" : "%.0f ms", time);
    }
}
