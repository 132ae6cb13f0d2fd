package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.selection.Mode;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;

/** Says why a stroke did nothing. */
final class Hints {
    static final String OUTSIDE = "The middle of the brush was never on the photo.";
    static final String CUT = "The stroke was stopped before its first dab.";
    static final String LASSO_TOO_SHORT = "A lasso needs three corners or more: drag it around the"
            + " object.";
    static final String LASSO_OPEN = "Filling is off, so a lasso leaves only its outline. Switch"
            + " filling on to take what it encloses.";

    private Hints() {}

    /**
     * Returns the reason that a stroke may have to do nothing, known where it begins.
     *
     * @param x column of its first dab, on the photo
     * @param y row of its first dab, on the photo
     * @return a sentence for when it did nothing
     */
    static String reason(SelectionSession session, Mode mode, int x, int y) {
        boolean selected = session.isSelected(x, y);
        boolean onBorder = x == 0 || y == 0 || x == session.width() - 1
                || y == session.height() - 1;
        return switch (mode) {
            case GROW -> onBorder
                    ? "The smart brush does nothing on the photo's outermost pixels. Begin further"
                            + " inside."
                    : "Nothing was added: all that the brush reached was selected already.";
            case SHRINK -> selected
                    ? "Nothing was taken away."
                    : "The smart eraser starts on a selected pixel. Begin inside the selection.";
            case PAINT -> "Nothing was added: all that the brush touched was selected already.";
            case ERASE -> "Nothing was taken away: none of it was selected.";
            case LASSO_ADD -> "Nothing was added: all of it was selected already.";
            case LASSO_REMOVE -> "Nothing was taken away: none of it was selected.";
        };
    }
}
