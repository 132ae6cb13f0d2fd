package com.velt.android.orvane.lumetrix.desktop.editing;

/** Lets tests of the window wait for the editor behind it. */
public final class Settling {
    private Settling() {}

    /** Waits until all that was asked of the editor is done. */
    public static void of(Editor editor) {
        editor.settle();
    }
}
