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
