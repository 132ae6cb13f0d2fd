package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.desktop.editing.BrushSettings;
import com.velt.android.orvane.lumetrix.desktop.editing.ViewKind;
import java.awt.Dimension;
import java.util.EnumMap;
import java.util.Map;
import javax.swing.BorderFactory;
import javax.swing.Box;
import javax.swing.BoxLayout;
import javax.swing.JCheckBox;
import javax.swing.JLabel;
import javax.swing.JPanel;
import javax.swing.SwingConstants;

/** The options above the canvas: brush, filling, and the view. */
final class OptionsBar extends JPanel {
    private static final long serialVersionUID = 1;
    private static final int SIZE_WIDTH = 130;
    private static final int CORE_WIDTH = 80;
    private static final int SECTION = 18;

    static final Map<ViewKind, Act> VIEW_ACTS = new EnumMap<>(Map.of(
            ViewKind.OUTLINE, Act.OUTLINE,
            ViewKind.GREY_REST, Act.GREY_REST,
            ViewKind.REVERSE, Act.REVERSE,
            ViewKind.MASK, Act.MASK));

    private final transient ScreenModel model;
    private final FlatSlider size = new FlatSlider(BrushSettings.SMALLEST_SIZE,
            BrushSettings.LARGEST_SIZE, SIZE_WIDTH);
    private final FlatSlider core = new FlatSlider(0, BrushSettings.LARGEST_CORE_PERCENT,
            CORE_WIDTH);
    private final JLabel sizeTitle = Theme.label("Size", Theme.TEXT);
    private final JLabel coreTitle = Theme.label("Core", Theme.TEXT);
    private final JLabel sizeNumber = number("000 px");
    private final JLabel coreNumber = number("00 %");
    private final transient Map<ViewKind, FlatButton> views = new EnumMap<>(ViewKind.class);
    private boolean refreshing;

    OptionsBar(ScreenModel model, Actions actions) {
        this.model = model;
        setName("options");
        setLayout(new BoxLayout(this, BoxLayout.X_AXIS));
        setBackground(Theme.BAR);
        setBorder(BorderFactory.createCompoundBorder(
                BorderFactory.createMatteBorder(1, 0, 1, 0, Theme.LINE),
                Theme.padding(Theme.GAP, Theme.GAP + 4)));
        addSlider(sizeTitle, size, sizeNumber, "size", "Radius of the brush", Act.SMALLER,
                Act.LARGER);
        addGap(SECTION);
        addSlider(coreTitle, core, coreNumber, "core", "Core of the smart tools, which they always"
                + " take", Act.CORE_SMALLER, Act.CORE_LARGER);
        addGap(SECTION);
        addCheck(actions, Act.SAME_SIZE, "sameSize");
        addGap(SECTION);
        addCheck(actions, Act.FILL, "fill");
        add(Box.createHorizontalGlue());
        addGap(SECTION);
        addViews(actions);
        size.addChangeListener(change -> sizeMoved());
        core.addChangeListener(change -> coreMoved());
        model.listen(this::refresh);
    }

    private void addSlider(JLabel title, FlatSlider slider, JLabel number, String name, String help,
            Act smaller, Act larger) {
        String tooltip = "<html><b>" + help + "</b>&ensp;" + smaller.keysInWords() + " and "
                + larger.keysInWords() + "</html>";
        slider.setName(name);
        slider.setToolTipText(tooltip);
        title.setToolTipText(tooltip);
        number.setName(name + ".number");
        add(title);
        addGap(Theme.GAP);
        add(slider);
        addGap(Theme.GAP);
        add(number);
    }

    private void addCheck(Actions actions, Act act, String name) {
        JCheckBox box = new JCheckBox(actions.of(act));
        box.setName(name);
        box.setFont(sizeTitle.getFont());
        box.setFocusable(false);
        box.setOpaque(false);
        box.setIcon(new CheckIcon());
        box.setIconTextGap(Theme.GAP - 2);
        add(box);
    }

    private void addViews(Actions actions) {
        for (ViewKind kind : VIEW_ACTS.keySet()) {
            FlatButton button = FlatButton.choice(actions.of(VIEW_ACTS.get(kind)));
            button.setName("view." + kind);
            views.put(kind, button);
            add(button);
            addGap(Theme.GAP / 2);
        }
        FlatButton alone = FlatButton.choice(actions.of(Act.PHOTO_ALONE));
        alone.setName("view." + ViewKind.PHOTO);
        add(alone);
    }

    private void addGap(int width) {
        add(Box.createHorizontalStrut(width));
    }

    private static JLabel number(String longest) {
        JLabel label = Theme.label(longest, Theme.QUIET_TEXT);
        label.setHorizontalAlignment(SwingConstants.LEFT);
        Dimension room = label.getPreferredSize();
        label.setPreferredSize(room);
        label.setMinimumSize(room);
        label.setMaximumSize(room);
        return label;
    }

    private void sizeMoved() {
        if (refreshing) return;
        model.change(changed -> changed.brushSettings().setSize(size.getValue()));
    }

    private void coreMoved() {
        if (refreshing) return;
        model.change(changed -> changed.brushSettings().setCorePercent(core.getValue()));
    }

    private void refresh() {
        refreshing = true;  // the sliders' listeners cannot tell it from the user
        BrushSettings brush = model.brushSettings();
        boolean hasSize = model.tool().hasSize();
        boolean hasCore = model.tool().hasCore();
        size.setValue(brush.size());
        core.setValue(brush.corePercent());
        size.setEnabled(hasSize);
        core.setEnabled(hasCore);
        sizeNumber.setText(brush.size() + " px");
        coreNumber.setText(brush.corePercent() + " %");
        sizeTitle.setForeground(hasSize ? Theme.TEXT : Theme.DISABLED_TEXT);
        coreTitle.setForeground(hasCore ? Theme.TEXT : Theme.DISABLED_TEXT);
        sizeNumber.setForeground(hasSize ? Theme.QUIET_TEXT : Theme.DISABLED_TEXT);
        coreNumber.setForeground(hasCore ? Theme.QUIET_TEXT : Theme.DISABLED_TEXT);
        views.forEach((kind, button) -> button.setSelected(kind == model.shownKind()));
        refreshing = false;
    }
}
