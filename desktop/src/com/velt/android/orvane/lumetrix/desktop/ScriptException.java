package com.velt.android.orvane.lumetrix.desktop;

import java.nio.file.Path;

/** A script that cannot be played: where, what is wrong, and what was expected. */
public final class ScriptException extends Exception {
    private static final long serialVersionUID = 1;

    /** Stands for the line when the trouble is the file itself. */
    static final int WHOLE_FILE = 0;

    private final int line;

    ScriptException(int line, String wrong, String expected) {
        super(wrong + ", expected " + expected);
        this.line = line;
    }

    /** Returns the message as {@code FILE:LINE: what is wrong, what was expected}. */
    public String in(Path script) {
        String place = line == WHOLE_FILE ? script.toString() : script + ":" + line;
        return place + ": " + getMessage();
    }
}
