package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.event.InputEvent;
import java.awt.event.KeyEvent;
import java.util.Arrays;
import java.util.List;
import java.util.stream.Collectors;
import javax.swing.KeyStroke;

/**
 * All that can be asked of the screen by menu, button or key: the one table of titles and keys.
 *
 * <p>Characters that some keyboards have only with Shift or AltGr are bound as typed, letters and
 * function keys as pressed.
 */
enum Act {
    OPEN_PHOTO(Group.FILE, "Open photo…", "Opens a JPEG or PNG file.", "ctrl O"),
    REPLAY(Group.FILE, "Replay script…", "Plays a stroke script on its photo.", "ctrl R"),
    LOAD_MASK(Group.FILE, "Load mask…", "Selects what is bright in a picture of the photo's size.",
            "ctrl L"),
    SAVE_SCRIPT(Group.FILE, "Save script…", "Saves what was done as text; a replay does it again.",
            "ctrl S"),
    SAVE_MASK(Group.FILE, "Save mask…", "Saves the selection as PNG, white on black.",
            "ctrl shift S"),
    SAVE_CUT_OUT(Group.FILE, "Save cut-out…", "Saves the selected pixels as PNG, the rest"
            + " transparent.", "ctrl E"),
    SAVE_VIEW(Group.FILE, "Save view…", "Saves what is seen of the photo as PNG.", "ctrl shift E"),
    STOP(Group.FILE, "Stop", "Stops a replay, ends a stroke and drops a lasso.", "ESCAPE"),
    CLOSE(Group.FILE, "Close", "Closes the window; asks when something is not saved.", "ctrl Q",
            "ctrl W"),

    UNDO(Group.EDIT, "Undo", "Takes back the last step.", "ctrl Z"),
    REDO(Group.EDIT, "Redo", "Brings back what was undone last.", "ctrl shift Z", "ctrl Y"),
    CLEAR(Group.EDIT, "Clear", "Selects nothing.", "DELETE", "BACK_SPACE"),
    INVERT(Group.EDIT, "Invert", "Selects what is not selected, and nothing else.", "I", "ctrl I"),
    FILL(Group.EDIT, "Fill", "Strokes fill holes and erase what they cut off; lassos are"
            + " filled.", "G"),

    SMART_BRUSH(Group.TOOL, "Smart brush", "Selects up to where the colour changes.", "S"),
    SMART_ERASER(Group.TOOL, "Smart eraser", "Takes away up to where the colour changes.", "D"),
    BRUSH(Group.TOOL, "Brush", "Selects all that it touches.", "B"),
    ERASER(Group.TOOL, "Eraser", "Takes away all that it touches.", "E"),
    LASSO(Group.TOOL, "Lasso", "Selects what it encloses.", "L"),
    SMALLER(Group.TOOL, "Smaller brush", "Makes the brush smaller.", "typed ["),
    LARGER(Group.TOOL, "Larger brush", "Makes the brush larger.", "typed ]"),
    CORE_SMALLER(Group.TOOL, "Smaller core", "Makes the core of a smart tool smaller: what it"
            + " always takes.", "typed {"),
    CORE_LARGER(Group.TOOL, "Larger core", "Makes the core of a smart tool larger: what it always"
            + " takes.", "typed }"),
    SAME_SIZE(Group.TOOL, "Same size at any zoom", "Keeps the brush the same size on the screen.",
            "C"),

    OUTLINE(Group.VIEW, "Outline", "Shows a dashed line around the selection.", "F2"),
    GREY_REST(Group.VIEW, "Grey rest", "Shows the selection in colour, the rest grey.", "F3"),
    REVERSE(Group.VIEW, "Reverse", "Shows the selection grey, the rest in colour.", "F4"),
    MASK(Group.VIEW, "Mask", "Shows the selection white on black.", "F5"),
    NEXT_VIEW(Group.VIEW, "Next view", "Goes on to the next of the four views.", "V"),
    PHOTO_ALONE(Group.VIEW, "Photo alone", "Hides the selection while on.", "H"),
    ZOOM_IN(Group.VIEW, "Zoom in", "Enlarges at the pointer, as the wheel does.", "typed +",
            "typed ="),
    ZOOM_OUT(Group.VIEW, "Zoom out", "Reduces at the pointer, as the wheel does.", "typed -"),
    FIT(Group.VIEW, "Fit", "Shows the whole photo.", "typed 0", "F"),
    TRUE_PIXELS(Group.VIEW, "True pixels", "Shows each photo pixel in one of the screen.",
            "typed 1"),

    KEYS(Group.HELP, "Keys and pointer", "Lists what keys and pointer do.", "F1");

    /** The menu that an act is in. */
    enum Group {
        FILE("File", 'F'),
        EDIT("Edit", 'I'),  // Alt and E is the eraser
        TOOL("Tool", 'T'),
        VIEW("View", 'V'),
        HELP("Help", 'H');

        private final String title;
        private final char letter;

        Group(String title, char letter) {
            this.title = title;
            this.letter = letter;
        }

        String title() {
            return title;
        }

        /** Returns the letter that opens the menu together with Alt. */
        char letter() {
            return letter;
        }

        List<Act> acts() {
            return Arrays.stream(Act.values()).filter(act -> act.group == this).toList();
        }
    }

    private final Group group;
    private final String title;
    private final String help;
    private final List<KeyStroke> keys;

    Act(Group group, String title, String help, String... keys) {
        this.group = group;
        this.title = title;
        this.help = help;
        this.keys = Arrays.stream(keys).map(KeyStroke::getKeyStroke).toList();
    }

    String title() {
        return title;
    }

    /** Returns a sentence about what it does. */
    String help() {
        return help;
    }

    /** Returns its keys; menus show the first one. */
    List<KeyStroke> keys() {
        return keys;
    }

    /** Tells whether it switches something on and off. */
    boolean isSwitch() {
        return this == FILL || this == SAME_SIZE || this == PHOTO_ALONE;
    }

    /** Returns its keys for people, such as {@code Ctrl+Y or F}. */
    String keysInWords() {
        return keys.stream().map(Act::inWords).collect(Collectors.joining(" or "));
    }

    /** Returns the text of its tooltip: title, keys, and what it does. */
    String tooltip() {
        return "<html><b>" + title.replace("…", "") + "</b>&ensp;" + keysInWords() + "<br>" + help
                + "</html>";
    }

    private static String inWords(KeyStroke key) {
        if (key.getKeyCode() == KeyEvent.VK_UNDEFINED) return String.valueOf(key.getKeyChar());
        String modifiers = InputEvent.getModifiersExText(key.getModifiers()
                & (InputEvent.CTRL_DOWN_MASK | InputEvent.SHIFT_DOWN_MASK));
        String name = KeyEvent.getKeyText(key.getKeyCode());
        return modifiers.isEmpty() ? name : modifiers + "+" + name;
    }
}
