package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.event.ActionEvent;
import java.awt.event.InputEvent;
import java.util.EnumMap;
import java.util.Map;
import java.util.function.BooleanSupplier;
import javax.swing.AbstractAction;
import javax.swing.Action;
import javax.swing.InputMap;
import javax.swing.JComponent;
import javax.swing.JRootPane;
import javax.swing.KeyStroke;
import javax.swing.MenuSelectionManager;

/** The acts of the screen as Swing's actions: buttons, menus and keys run the same one. */
final class Actions {
    private final Map<Act, ScreenAction> actions = new EnumMap<>(Act.class);
    private final BooleanSupplier strokeUnderWay;

    /** {@code strokeUnderWay} tells whether the pointer draws: all acts but stopping wait then. */
    Actions(BooleanSupplier strokeUnderWay) {
        this.strokeUnderWay = strokeUnderWay;
    }

    private final class ScreenAction extends AbstractAction {
        private static final long serialVersionUID = 1;

        private final transient Act act;
        private final transient Runnable deed;

        ScreenAction(Act act, Runnable deed) {
            super(act.title());
            this.act = act;
            this.deed = deed;
            putValue(SHORT_DESCRIPTION, act.tooltip());
            putValue(ACCELERATOR_KEY, act.keys().get(0));
            if (act.isSwitch()) putValue(SELECTED_KEY, false);
        }

        @Override
        public void actionPerformed(ActionEvent event) {
            MenuSelectionManager menus = MenuSelectionManager.defaultManager();
            if (menus.getSelectedPath().length > 0) {  // a key; an item closes its menu first
                menus.clearSelectedPath();
                return;
            }
            if (act == Act.STOP || !strokeUnderWay.getAsBoolean()) deed.run();
        }
    }

    /** Says what an act does. */
    void define(Act act, Runnable deed) {
        actions.put(act, new ScreenAction(act, deed));
    }

    /** Returns the action of an act that is defined. */
    Action of(Act act) {
        return actions.get(act);
    }

    /** Shows whether an act is possible. */
    void enable(Act act, boolean possible) {
        of(act).setEnabled(possible);
    }

    /** Shows whether a switch is on. */
    void select(Act act, boolean on) {
        of(act).putValue(Action.SELECTED_KEY, on);
    }

    /**
     * Makes all keys work wherever the focus is in the window, and those of tools also while Alt
     * is held, which has the tool do its opposite.
     */
    void bindKeys(JRootPane pane) {
        for (Act act : Act.values()) {
            pane.getActionMap().put(act.name(), of(act));
            InputMap keys = pane.getInputMap(JComponent.WHEN_IN_FOCUSED_WINDOW);
            for (KeyStroke key : act.keys()) {
                keys.put(key, act.name());
                if (!ToolBar.TOOL_ACTS.containsValue(act)) continue;
                keys.put(KeyStroke.getKeyStroke(key.getKeyCode(), InputEvent.ALT_DOWN_MASK),
                        act.name());
            }
        }
    }
}
