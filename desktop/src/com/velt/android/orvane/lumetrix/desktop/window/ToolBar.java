package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.desktop.editing.Tool;
import java.awt.Component;
import java.awt.Dimension;
import java.util.EnumMap;
import java.util.Map;
import javax.swing.BorderFactory;
import javax.swing.Box;
import javax.swing.BoxLayout;
import javax.swing.JPanel;

/** The column of tools, and below them what acts at once. */
final class ToolBar extends JPanel {
    private static final long serialVersionUID = 1;
    private static final int BUTTON = 40;
    private static final int ICON = 22;
    private static final int BETWEEN = 4;

    static final Map<Tool, Act> TOOL_ACTS = new EnumMap<>(Map.of(
            Tool.SMART_BRUSH, Act.SMART_BRUSH,
            Tool.SMART_ERASER, Act.SMART_ERASER,
            Tool.BRUSH, Act.BRUSH,
            Tool.ERASER, Act.ERASER,
            Tool.LASSO, Act.LASSO));

    private final transient Map<Tool, FlatButton> tools = new EnumMap<>(Tool.class);
    private final transient ScreenModel model;

    ToolBar(ScreenModel model, Actions actions) {
        this.model = model;
        setName("tools");
        setLayout(new BoxLayout(this, BoxLayout.Y_AXIS));
        setBackground(Theme.BAR);
        setBorder(BorderFactory.createCompoundBorder(
                BorderFactory.createMatteBorder(0, 0, 0, 1, Theme.LINE),
                Theme.padding(Theme.GAP, Theme.GAP)));
        for (Tool tool : Tool.values()) {
            Act act = TOOL_ACTS.get(tool);
            FlatButton button = FlatButton.choice(actions.of(act),
                    Icons.valueOf(tool.name()).ofSize(ICON), BUTTON);
            button.setToolTipText(tooltip(tool, act));
            button.setName("tool." + tool);
            tools.put(tool, button);
            addSpaced(button);
        }
        addSeparator();
        addPush(actions, Act.UNDO, Icons.UNDO);
        addPush(actions, Act.REDO, Icons.REDO);
        addPush(actions, Act.INVERT, Icons.INVERT);
        addPush(actions, Act.CLEAR, Icons.CLEAR);
        add(Box.createVerticalGlue());
        model.listen(this::refresh);
    }

    private static String tooltip(Tool tool, Act act) {
        String opposite = tool.takesAway(true) ? "takes away" : "adds";
        return act.tooltip().replace("</html>",
                "<br>With Alt or the right button it " + opposite + ".</html>");
    }

    private void addPush(Actions actions, Act act, Icons icon) {
        FlatButton button = FlatButton.push(actions.of(act), icon.ofSize(ICON), BUTTON);
        button.setName("act." + act);
        addSpaced(button);
    }

    private void addSpaced(FlatButton button) {
        button.setAlignmentX(Component.CENTER_ALIGNMENT);
        add(button);
        add(Box.createVerticalStrut(BETWEEN));
    }

    private void addSeparator() {
        JPanel line = new JPanel();
        line.setBackground(Theme.RAISED);
        line.setOpaque(true);
        line.setMaximumSize(new Dimension(BUTTON - 2 * BETWEEN, 1));
        line.setPreferredSize(line.getMaximumSize());
        line.setMinimumSize(line.getMaximumSize());
        add(Box.createVerticalStrut(BETWEEN));
        add(line);
        add(Box.createVerticalStrut(2 * BETWEEN));
    }

    private void refresh() {
        tools.forEach((tool, button) -> button.setSelected(tool == model.tool()));
    }
}
