package com.velt.android.orvane.lumetrix.desktop;

/**
 * The calls that a session makes on the library, as far as the selection or its digest depend on
 * them. Photo and mask are always the session's own and so are their sizes.
 */
enum Call {
    /** Arguments: radius, core. */
    SET_BRUSH(1),
    INIT(2),
    /** Arguments: mode, fill, column and row of the first point, column and row of the second. */
    MODIFY(3),
    INVERT(4),
    RESET(5),
    UPDATE_BOX(6),
    /** Draws the view that the digest shows, and takes the digest. */
    DIGEST(7),
    DESTROY(8);

    private final int number;

    Call(int number) {
        this.number = number;
    }

    /** Returns what stands for the call in a recording, 1 to 255. */
    int number() {
        return number;
    }
}
