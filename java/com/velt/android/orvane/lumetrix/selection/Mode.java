package com.velt.android.orvane.lumetrix.selection;

/** What a stroke does. */
public enum Mode {
    /** The brush selects from its core outwards, up to edges of colour. */
    GROW(0, "grow"),
    /** The brush deselects from its core outwards, up to edges of colour. */
    SHRINK(1, "shrink"),
    /** The brush selects its disc. */
    PAINT(2, "paint"),
    /** The brush deselects its disc. */
    ERASE(3, "erase"),
    /** A lasso selects what it encloses. */
    LASSO_ADD(4, "lasso add"),
    /** A lasso deselects what it encloses. */
    LASSO_REMOVE(5, "lasso remove");

    private final int number;
    private final String words;

    Mode(int number, String words) {
        this.number = number;
        this.words = words;
    }

    /** Returns the number by which the library knows the mode. */
    int number() {
        return number;
    }

    /**
     * Tells the lassos from the brushes.
     *
     * @return whether strokes of this mode are lassos
     */
    public boolean isLasso() {
        return this == LASSO_ADD || this == LASSO_REMOVE;
    }

    /**
     * Returns the words of a stroke script that stand for the mode.
     *
     * @return one or two words in small letters
     */
    @Override
    public String toString() {
        return words;
    }
}
