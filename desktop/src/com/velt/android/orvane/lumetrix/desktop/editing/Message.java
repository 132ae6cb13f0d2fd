package com.velt.android.orvane.lumetrix.desktop.editing;

/**
 * Something to tell the user.
 *
 * @param kind how much it matters
 * @param text a sentence
 */
public record Message(Kind kind, String text) {
    /** How much a message matters. */
    public enum Kind {
        /** Why something did nothing, or how to go on. */
        HINT,
        /** Something asked for is done. */
        DONE,
        /** Something asked for could not be done. */
        PROBLEM
    }
}
