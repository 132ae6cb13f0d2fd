package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.selection.Mode;

/** What the pointer does to the selection. */
public enum Tool {
    /** Selects up to where the colour changes. */
    SMART_BRUSH("Smart brush", Mode.GROW, Mode.SHRINK),
    /** Takes away up to where the colour changes. */
    SMART_ERASER("Smart eraser", Mode.SHRINK, Mode.GROW),
    /** Selects all that it touches. */
    BRUSH("Brush", Mode.PAINT, Mode.ERASE),
    /** Takes away all that it touches. */
    ERASER("Eraser", Mode.ERASE, Mode.PAINT),
    /** Selects what it encloses. */
    LASSO("Lasso", Mode.LASSO_ADD, Mode.LASSO_REMOVE);

    private final String title;
    private final Mode mode;
    private final Mode oppositeMode;

    Tool(String title, Mode mode, Mode oppositeMode) {
        this.title = title;
        this.mode = mode;
        this.oppositeMode = oppositeMode;
    }

    /** Returns the tool's name for people. */
    public String title() {
        return title;
    }

    /** Returns what a stroke does, {@code opposite} with Alt or the right button held. */
    public Mode mode(boolean opposite) {
        return opposite ? oppositeMode : mode;
    }

    /** Tells whether a stroke takes pixels away, {@code opposite} as for {@link #mode}. */
    public boolean takesAway(boolean opposite) {
        return switch (mode(opposite)) {
            case GROW, PAINT, LASSO_ADD -> false;
            case SHRINK, ERASE, LASSO_REMOVE -> true;
        };
    }

    /** Tells whether the tool draws with a brush that has a size. */
    public boolean hasSize() {
        return this != LASSO;
    }

    /** Tells whether the brush's core makes a difference. */
    public boolean hasCore() {
        return this == SMART_BRUSH || this == SMART_ERASER;
    }
}
