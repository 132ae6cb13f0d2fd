package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.BasicStroke;
import java.awt.Color;
import java.awt.Font;
import java.awt.Graphics;
import java.awt.Graphics2D;
import java.awt.RenderingHints;
import java.awt.geom.Ellipse2D;
import java.awt.geom.Path2D;
import java.awt.geom.RoundRectangle2D;
import javax.swing.BorderFactory;
import javax.swing.JComponent;
import javax.swing.JLabel;
import javax.swing.Painter;
import javax.swing.UIDefaults;
import javax.swing.UIManager;
import javax.swing.UnsupportedLookAndFeelException;
import javax.swing.border.Border;
import javax.swing.plaf.ColorUIResource;
import javax.swing.plaf.FontUIResource;
import javax.swing.plaf.InsetsUIResource;
import javax.swing.plaf.nimbus.NimbusLookAndFeel;

/**
 * The dark look of the screen: greys without a tint, so that a photo's colours are judged right,
 * and one accent.
 */
final class Theme {
    static final Color CANVAS = new Color(0x1C1C1C);
    static final Color BAR = new Color(0x2B2B2B);
    static final Color RAISED = new Color(0x3A3A3A);
    static final Color HOVERED = new Color(0x474747);
    static final Color PRESSED = new Color(0x232323);
    static final Color LINE = new Color(0x151515);
    static final Color EDGE = new Color(0x555555);
    static final Color TEXT = new Color(0xE2E2E2);
    static final Color QUIET_TEXT = new Color(0xA8A8A8);
    static final Color DISABLED_TEXT = new Color(0x737373);
    static final Color ACCENT = new Color(0x4A9BF5);
    static final Color ACCENT_DEEP = new Color(0x2A69B5);
    /** For what takes away from the selection. */
    static final Color TAKING = new Color(0xFFC933);

    static final int GAP = 8;
    static final int ROUNDING = 6;

    private static final int FONT_SIZE = 13;
    private static final int SMALL_FONT_SIZE = 12;

    private static final String[] MENU_PARTS = {"MenuBar:Menu", "Menu", "MenuItem",
        "CheckBoxMenuItem", "RadioButtonMenuItem"};

    private Theme() {}

    /** Sets the look of all components made after it. */
    static void install() {
        try {
            setColours();
            UIManager.setLookAndFeel(new NimbusLookAndFeel());
            setDetails();
        } catch (UnsupportedLookAndFeelException e) {
            throw new IllegalStateException("every Java has Nimbus", e);
        }
    }

    private static void setColours() {
        put("control", BAR);
        put("info", RAISED);
        put("nimbusBase", new Color(0x2F2F2F));
        put("nimbusBlueGrey", new Color(0x4A4A4A));
        put("nimbusLightBackground", new Color(0x242424));
        put("nimbusDisabledText", DISABLED_TEXT);
        put("nimbusFocus", ACCENT);
        put("nimbusInfoBlue", ACCENT);
        put("nimbusOrange", ACCENT_DEEP);
        put("nimbusSelectedText", Color.WHITE);
        put("nimbusSelection", ACCENT_DEEP);
        put("nimbusSelectionBackground", ACCENT_DEEP);
        put("text", TEXT);
        put("controlText", TEXT);
        put("infoText", TEXT);
        put("menuText", TEXT);
        put("menu", BAR);
        UIManager.put("defaultFont", new FontUIResource(Font.SANS_SERIF, Font.PLAIN, FONT_SIZE));
    }

    private static void put(String key, Color colour) {
        UIManager.put(key, new ColorUIResource(colour));
    }

    /** Nimbus has colours of its own for menus, which follow no other colour. */
    private static void setDetails() {
        UIDefaults look = UIManager.getLookAndFeelDefaults();
        look.put("MenuBar[Enabled].backgroundPainter", filled(BAR));
        look.put("MenuBar[Enabled].borderPainter", filled(BAR));
        look.put("MenuBar.contentMargins", new InsetsUIResource(3, GAP - 2, 3, GAP - 2));
        look.put("PopupMenu[Enabled].backgroundPainter", framed(BAR));
        look.put("PopupMenu.contentMargins", new InsetsUIResource(5, 1, 5, 1));
        for (String item : MENU_PARTS) setMenuColours(look, item);
        look.put("MenuBar:Menu.contentMargins", new InsetsUIResource(3, GAP, 3, GAP));
        look.put("CheckBoxMenuItem[Enabled+Selected].checkIconPainter", tick(TEXT));
        look.put("CheckBoxMenuItem[MouseOver+Selected].checkIconPainter", tick(Color.WHITE));
        look.put("CheckBoxMenuItem[Disabled+Selected].checkIconPainter", tick(DISABLED_TEXT));
        look.put("RadioButtonMenuItem[Enabled+Selected].checkIconPainter", dot(TEXT));
        look.put("RadioButtonMenuItem[MouseOver+Selected].checkIconPainter", dot(Color.WHITE));
        look.put("RadioButtonMenuItem[Disabled+Selected].checkIconPainter", dot(DISABLED_TEXT));
        setButtonColours(look, "Button");
        setButtonColours(look, "ToggleButton");
        setBoxColours(look);
        setScrollBarColours(look);
        look.put("ToolTip[Enabled].backgroundPainter", framed(RAISED));
        look.put("ToolTip.contentMargins", new InsetsUIResource(6, GAP, 6, GAP));
        look.put("ToolTip.textForeground", new ColorUIResource(TEXT));
    }

    private static void setButtonColours(UIDefaults look, String button) {
        look.put(button + "[Disabled].backgroundPainter", rounded(BAR, RAISED));
        for (String state : new String[] {"", "Default+", "Selected+"}) {
            Color usual = state.isEmpty() ? RAISED : ACCENT_DEEP;
            Color pointed = state.isEmpty() ? HOVERED : ACCENT_DEEP.brighter();
            for (String focus : new String[] {"", "Focused+"}) {
                Color edge = focus.isEmpty() ? EDGE : ACCENT;
                String name = button + "[" + state.replace("Selected+", "") + focus;
                String end = state.equals("Selected+") ? "+Selected" : "";
                look.put(name + "MouseOver" + end + "].backgroundPainter", rounded(pointed, edge));
                look.put(name + "Pressed" + end + "].backgroundPainter", rounded(PRESSED, edge));
            }
            look.put(button + "[" + state + "Focused].backgroundPainter", rounded(usual, ACCENT));
        }
        look.put(button + "[Enabled].backgroundPainter", rounded(RAISED, EDGE));
        look.put(button + "[Default].backgroundPainter", rounded(ACCENT_DEEP, EDGE));
        look.put(button + "[Selected].backgroundPainter", rounded(ACCENT_DEEP, EDGE));
        look.put(button + "[Focused+Selected].backgroundPainter", rounded(ACCENT_DEEP, ACCENT));
        put(look, button + "[Default].textForeground", Color.WHITE);
    }

    private static void setBoxColours(UIDefaults look) {
        String box = "ComboBox";
        for (String state : new String[] {"Enabled", "MouseOver", "Pressed", "Enabled+Selected",
            "Focused", "Focused+MouseOver", "Focused+Pressed", "Disabled", "Disabled+Pressed"}) {
            Color edge = state.startsWith("Focused") ? ACCENT : EDGE;
            Color fill = state.endsWith("MouseOver") ? HOVERED : RAISED;
            look.put(box + "[" + state + "].backgroundPainter", rounded(fill, edge));
        }
        String arrow = box + ":\"ComboBox.arrowButton\"";
        for (String state : new String[] {"Enabled", "MouseOver", "Pressed", "Selected"}) {
            look.put(arrow + "[" + state + "].foregroundPainter", arrow());
        }
    }

    /** Nimbus turns what is painted: to the left here is down there. */
    private static Painter<JComponent> arrow() {
        return (graphics, component, width, height) -> {
            graphics.setColor(TEXT);
            double x = width / 2.0;
            double y = height / 2.0;
            Path2D arrow = new Path2D.Double();
            arrow.moveTo(x + 2, y - 3.5);
            arrow.lineTo(x + 2, y + 3.5);
            arrow.lineTo(x - 2.5, y);
            arrow.closePath();
            graphics.fill(arrow);
        };
    }

    private static void setScrollBarColours(UIDefaults look) {
        for (String state : new String[] {"Enabled", "Disabled", "MouseOver", "Pressed"}) {
            Color thumb = state.equals("Enabled") ? EDGE : DISABLED_TEXT;
            look.put("ScrollBar:ScrollBarThumb[" + state + "].backgroundPainter",
                    rounded(thumb, thumb));
            look.put("ScrollBar:ScrollBarTrack[" + state + "].backgroundPainter", filled(BAR));
            String button = "ScrollBar:\"ScrollBar.button\"[" + state + "]";
            look.put(button + ".foregroundPainter", arrow());
            look.put(button + ".backgroundPainter", filled(BAR));
        }
    }

    private static void setMenuColours(UIDefaults look, String item) {
        String accelerator = item + ":" + item.replace("MenuBar:", "") + "Accelerator";
        put(look, item + "[Enabled].textForeground", TEXT);
        put(look, item + "[Disabled].textForeground", DISABLED_TEXT);
        put(look, accelerator + "[Enabled].textForeground", QUIET_TEXT);
        put(look, accelerator + "[Disabled].textForeground", DISABLED_TEXT);
        for (String state : new String[] {"MouseOver", "Selected", "Enabled+Selected",
            "MouseOver+Selected"}) {
            boolean pointed = state.contains("MouseOver") || item.endsWith("Menu");
            put(look, item + "[" + state + "].textForeground", pointed ? Color.WHITE : TEXT);
            if (pointed) {
                look.put(item + "[" + state + "].backgroundPainter", filled(ACCENT_DEEP));
                put(look, accelerator + "[" + state + "].textForeground", Color.WHITE);
            }
        }
        look.put(item + ".contentMargins", new InsetsUIResource(4, 12, 4, 14));
    }

    private static void put(UIDefaults look, String key, Color colour) {
        look.put(key, new ColorUIResource(colour));
    }

    private static Painter<JComponent> framed(Color colour) {
        return (graphics, component, width, height) -> {
            graphics.setColor(EDGE);
            graphics.fillRect(0, 0, width, height);
            graphics.setColor(colour);
            graphics.fillRect(1, 1, width - 2, height - 2);
        };
    }

    private static Painter<JComponent> rounded(Color colour, Color edge) {
        return (graphics, component, width, height) -> {
            Graphics2D drawn = smooth(graphics);
            var shape = new RoundRectangle2D.Float(1.5f, 1.5f, width - 3, height - 3, ROUNDING,
                    ROUNDING);
            drawn.setColor(colour);
            drawn.fill(shape);
            drawn.setColor(edge);
            drawn.draw(shape);
            drawn.dispose();
        };
    }

    private static Painter<JComponent> tick(Color colour) {
        return (graphics, component, width, height) -> {
            graphics.setColor(colour);
            graphics.setStroke(new BasicStroke(1.6f, BasicStroke.CAP_ROUND,
                    BasicStroke.JOIN_ROUND));
            Path2D tick = new Path2D.Float();
            tick.moveTo(1, height * 0.55);
            tick.lineTo(width * 0.4, height - 2.0);
            tick.lineTo(width - 1.0, 1.5);
            graphics.draw(tick);
        };
    }

    private static Painter<JComponent> dot(Color colour) {
        return (graphics, component, width, height) -> {
            graphics.setColor(colour);
            double side = Math.min(width, height) * 0.7;
            graphics.fill(new Ellipse2D.Double((width - side) / 2, (height - side) / 2, side,
                    side));
        };
    }

    private static Painter<JComponent> filled(Color colour) {
        return (graphics, component, width, height) -> {
            graphics.setColor(colour);
            graphics.fillRect(0, 0, width, height);
        };
    }

    /** Returns graphics for smooth shapes, to be disposed of. */
    static Graphics2D smooth(Graphics graphics) {
        Graphics2D smooth = (Graphics2D) graphics.create();
        smooth.setRenderingHint(RenderingHints.KEY_ANTIALIASING,
                RenderingHints.VALUE_ANTIALIAS_ON);
        smooth.setRenderingHint(RenderingHints.KEY_STROKE_CONTROL,
                RenderingHints.VALUE_STROKE_PURE);
        smooth.setRenderingHint(RenderingHints.KEY_TEXT_ANTIALIASING,
                RenderingHints.VALUE_TEXT_ANTIALIAS_ON);
        return smooth;
    }

    static Border padding(int vertical, int horizontal) {
        return BorderFactory.createEmptyBorder(vertical, horizontal, vertical, horizontal);
    }

    /** Makes a label in the smaller font. */
    static JLabel label(String text, Color colour) {
        JLabel label = new JLabel(text);
        label.setFont(label.getFont().deriveFont((float) SMALL_FONT_SIZE));
        label.setForeground(colour);
        return label;
    }
}
