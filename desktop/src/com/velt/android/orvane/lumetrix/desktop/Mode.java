package com.velt.android.orvane.lumetrix.desktop;

/** What a stroke does, with the number by which the library knows it. */
enum Mode {
    GROW(0, "grow"),
    SHRINK(1, "shrink"),
    PAINT(2, "paint"),
    ERASE(3, "erase"),
    LASSO_ADD(4, "lasso add"),
    LASSO_REMOVE(5, "lasso remove");

    private final int number;
    private final String words;

    Mode(int number, String words) {
        this.number = number;
        this.words = words;
    }

    int number() {
        return number;
    }

    /** Returns the words of a script that stand for the mode. */
    @Override
    public String toString() {
        return words;
    }
}
