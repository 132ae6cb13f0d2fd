package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.Component;
import java.awt.Container;
import java.awt.Dimension;
import java.awt.LayoutManager2;
import java.util.HashMap;
import java.util.Map;

/** Places what lies over the canvas: centred, and at the top, in the middle or at the bottom. */
final class CanvasLayout implements LayoutManager2 {
    static final String TOP = "top";
    static final String MIDDLE = "middle";
    static final String BOTTOM = "bottom";

    private static final int MARGIN = 20;

    private final Map<Component, Object> places = new HashMap<>();

    @Override
    public void addLayoutComponent(Component component, Object place) {
        places.put(component, place);
    }

    @Override
    public void addLayoutComponent(String place, Component component) {
        places.put(component, place);
    }

    @Override
    public void removeLayoutComponent(Component component) {
        places.remove(component);
    }

    @Override
    public void layoutContainer(Container parent) {
        for (Component component : parent.getComponents()) {
            Dimension size = component.getPreferredSize();
            int width = Math.min(size.width, Math.max(0, parent.getWidth() - 2 * MARGIN));
            int x = (parent.getWidth() - width) / 2;
            component.setBounds(x, top(parent.getHeight(), size.height, places.get(component)),
                    width, size.height);
        }
    }

    private static int top(int room, int height, Object place) {
        if (TOP.equals(place)) return MARGIN;
        if (BOTTOM.equals(place)) return room - height - MARGIN;
        return (room - height) / 2;
    }

    @Override
    public Dimension preferredLayoutSize(Container parent) {
        return new Dimension(0, 0);
    }

    @Override
    public Dimension minimumLayoutSize(Container parent) {
        return new Dimension(0, 0);
    }

    @Override
    public Dimension maximumLayoutSize(Container parent) {
        return new Dimension(Integer.MAX_VALUE, Integer.MAX_VALUE);
    }

    @Override
    public float getLayoutAlignmentX(Container parent) {
        return Component.CENTER_ALIGNMENT;
    }

    @Override
    public float getLayoutAlignmentY(Container parent) {
        return Component.CENTER_ALIGNMENT;
    }

    @Override
    public void invalidateLayout(Container parent) {}
}
