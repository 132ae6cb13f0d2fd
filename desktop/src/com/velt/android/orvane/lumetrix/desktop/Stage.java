package com.velt.android.orvane.lumetrix.desktop;

import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.util.function.Function;

/** What the commands of a script act on. */
public interface Stage {
    /** Returns the photo being edited. */
    SelectionSession session();

    /** Is called before each dab of a stroke; what it throws ends the stroke there. */
    default void beforeDab() {}

    /**
     * Is told of what a command has done to the selection.
     *
     * @param line the command's line in the script
     * @param what the command
     * @param where its first and last point and how many there are, or how many rows; may be empty
     * @param changed the rectangle that it changed
     */
    void done(int line, String what, String where, Area changed);

    /**
     * Takes a picture of the selection as it stands, if it wants one.
     *
     * @param name the picture's file
     * @param drawing draws it
     * @throws OutputException when the picture cannot be written
     */
    void picture(String name, Function<SelectionSession, Picture> drawing)
            throws OutputException;
}
