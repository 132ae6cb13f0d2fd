package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.desktop.editing.Tool;
import com.velt.android.orvane.lumetrix.desktop.editing.ViewKind;
import java.util.EnumMap;
import java.util.Map;
import java.util.Set;
import javax.swing.JCheckBoxMenuItem;
import javax.swing.JMenu;
import javax.swing.JMenuBar;
import javax.swing.JMenuItem;
import javax.swing.JRadioButtonMenuItem;

/** The menu bar, made of the table of acts. */
final class ScreenMenus {
    /** A line is drawn above these. */
    private static final Set<Act> SECTIONS = Set.of(Act.LOAD_MASK, Act.SAVE_SCRIPT, Act.STOP,
            Act.CLOSE, Act.CLEAR, Act.FILL, Act.SMALLER, Act.SAME_SIZE, Act.NEXT_VIEW, Act.ZOOM_IN);

    private final ScreenModel model;
    private final Map<Act, JMenuItem> items = new EnumMap<>(Act.class);

    ScreenMenus(ScreenModel model) {
        this.model = model;
        model.listen(this::refresh);
    }

    /** Makes the menu bar. */
    JMenuBar bar(Actions actions) {
        JMenuBar bar = new JMenuBar();
        bar.setName("menus");
        for (Act.Group group : Act.Group.values()) {
            JMenu menu = new JMenu(group.title());
            menu.setName("menu." + group);
            menu.setMnemonic(group.letter());
            for (Act act : group.acts()) {
                if (SECTIONS.contains(act)) menu.addSeparator();
                JMenuItem item = item(act);
                item.setAction(actions.of(act));
                item.setName("menu." + act);
                items.put(act, item);
                menu.add(item);
            }
            bar.add(menu);
        }
        return bar;
    }

    private static JMenuItem item(Act act) {
        if (act.isSwitch()) return new JCheckBoxMenuItem();
        boolean choice = ToolBar.TOOL_ACTS.containsValue(act)
                || OptionsBar.VIEW_ACTS.containsValue(act);
        return choice ? new JRadioButtonMenuItem() : new JMenuItem();
    }

    private void refresh() {
        for (Tool tool : Tool.values()) {
            items.get(ToolBar.TOOL_ACTS.get(tool)).setSelected(tool == model.tool());
        }
        for (ViewKind kind : OptionsBar.VIEW_ACTS.keySet()) {
            items.get(OptionsBar.VIEW_ACTS.get(kind)).setSelected(kind == model.chosenKind());
        }
    }
}
