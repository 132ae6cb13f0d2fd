package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.desktop.Picture;
import com.velt.android.orvane.lumetrix.selection.Area;

/**
 * A drawing of the visible part of the photo.
 *
 * @param pixels the drawing, as large as the placement's viewport says, 0xAARRGGBB, row by row
 * @param placement what it shows, and its place in the window
 * @param kind what kind of view it is
 */
public record Frame(int[] pixels, Placement placement, ViewKind kind) {
    /** Returns a copy of what lies in the window. */
    Picture seen() {
        Area seen = placement.seen();
        int[] copy = new int[seen.width() * seen.height()];
        for (int y = 0; y < seen.height(); ++y) {
            System.arraycopy(pixels, (seen.top() + y) * placement.port().width() + seen.left(),
                    copy, y * seen.width(), seen.width());
        }
        return new Picture(seen.width(), seen.height(), copy);
    }
}
