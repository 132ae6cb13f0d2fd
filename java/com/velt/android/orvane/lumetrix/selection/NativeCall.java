package com.velt.android.orvane.lumetrix.selection;

/**
 * The calls that a session makes on the library, as far as the selection depends on them. Photo and
 * mask are always the session's own and so are their sizes.
 */
public enum NativeCall {
    /** {@code set_brush_size}; arguments: radius, core. */
    SET_BRUSH,
    /** {@code init_objectsel}. */
    INIT,
    /**
     * {@code modify_objectsel}; arguments: mode, fill, column and row of the first point, column
     * and row of the second.
     */
    MODIFY,
    /** {@code inverse_objectsel}. */
    INVERT,
    /** {@code reset_objectsel}. */
    RESET,
    /**
     * Three things at once: the session makes the pixels of the given runs 1 in the mask and all
     * others 0; {@code set_objectROI} of the whole photo, that is 0, 0, width - 1, height - 1; and
     * {@code update_objectROI}. Arguments: row, first and last column of each run of selected
     * pixels in a row, in reading order, with a pixel that is not selected between two of a row;
     * none when nothing is selected.
     */
    SELECT,
    /** {@code update_objectROI}. */
    UPDATE_BOX,
    /**
     * {@code set_objectROI}; arguments: left, top, right, bottom. Undo and redo make it; between it
     * and the next call the session also writes into the mask.
     */
    SET_BOX,
    /** {@code destroy_objectsel}. */
    DESTROY
}
