package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.Component;
import java.awt.KeyEventDispatcher;
import java.awt.KeyboardFocusManager;
import java.awt.event.KeyEvent;
import java.util.ArrayList;
import java.util.List;

/**
 * Knows which of the keys are held that change what the pointer does: Alt and Space.
 *
 * <p>They count while the canvas has the focus. A window that loses it gets no release of a key, so
 * {@link #forget} is called then.
 */
final class HeldKeys implements KeyEventDispatcher {
    private final Component canvas;
    private final List<Runnable> listeners = new ArrayList<>();
    private boolean alt;
    private boolean space;

    HeldKeys(Component canvas) {
        this.canvas = canvas;
    }

    /** Begins to watch the keys. */
    void watch() {
        KeyboardFocusManager.getCurrentKeyboardFocusManager().addKeyEventDispatcher(this);
    }

    /** Ends it: the manager of keys outlives the window. */
    void close() {
        KeyboardFocusManager.getCurrentKeyboardFocusManager().removeKeyEventDispatcher(this);
    }

    /** Has somebody told when a key is held or released. */
    void listen(Runnable listener) {
        listeners.add(listener);
    }

    boolean alt() {
        return alt;
    }

    boolean space() {
        return space;
    }

    /** Is told by events of the pointer, which know it also when the window lacks the focus. */
    void setAlt(boolean held) {
        set(held, space);
    }

    /** Takes all keys as released. */
    void forget() {
        set(false, false);
    }

    private void set(boolean nextAlt, boolean nextSpace) {
        if (nextAlt == alt && nextSpace == space) return;
        alt = nextAlt;
        space = nextSpace;
        listeners.forEach(Runnable::run);
    }

    @Override
    public boolean dispatchKeyEvent(KeyEvent event) {
        if (event.getComponent() != canvas) return false;
        boolean pressed = event.getID() == KeyEvent.KEY_PRESSED;
        boolean released = event.getID() == KeyEvent.KEY_RELEASED;
        if (!pressed && !released) return false;
        if (event.getKeyCode() == KeyEvent.VK_ALT) set(pressed, space);
        if (event.getKeyCode() == KeyEvent.VK_SPACE) set(alt, pressed);
        return false;
    }
}
