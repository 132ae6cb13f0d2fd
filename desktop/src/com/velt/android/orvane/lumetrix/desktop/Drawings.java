package com.velt.android.orvane.lumetrix.desktop;

import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import com.velt.android.orvane.lumetrix.selection.Viewport;

/** Pictures of a session's photo and selection. */
public final class Drawings {
    public static final int WHITE = 0xFFFFFFFF;
    public static final int BLACK = 0xFF000000;

    private Drawings() {}

    /** Draws the photo with the selection's outline, dashed in two colours. */
    public static Picture view(SelectionSession session, Viewport port, int firstColour,
            int secondColour) {
        Picture view = blank(port.width(), port.height());
        session.drawOutlinedView(view.pixels(), port, port.area(), firstColour, secondColour);
        return view;
    }

    public static Picture colourOnGrey(SelectionSession session) {
        Picture picture = blankOf(session);
        session.drawColourOnGrey(picture.pixels(),
                new Area(0, 0, session.width() - 1, session.height() - 1));
        return picture;
    }

    public static Picture reverse(SelectionSession session) {
        Picture picture = blankOf(session);
        session.drawReverse(picture.pixels());
        return picture;
    }

    /** Draws selected pixels white and all others black. */
    public static Picture mask(SelectionSession session) {
        Picture picture = blankOf(session);
        byte[] mask = session.mask();
        for (int i = 0; i < mask.length; ++i) picture.pixels()[i] = mask[i] == 1 ? WHITE : BLACK;
        return picture;
    }

    private static Picture blankOf(SelectionSession session) {
        return blank(session.width(), session.height());
    }

    private static Picture blank(int width, int height) {
        return new Picture(width, height, new int[width * height]);
    }
}
