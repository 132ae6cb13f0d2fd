package com.velt.android.orvane.lumetrix.desktop.editing;

import java.util.function.Consumer;

/**
 * The frame that is shown. One thread draws it, another looks at it.
 *
 * <p>A whole frame is drawn aside and then put in place; a change is drawn into the frame in place.
 * Either happens while nobody looks.
 */
final class Screen {
    private Frame shown;
    private int[] aside = new int[0];

    /** Draws a frame aside and puts it in place. */
    void replace(Placement placement, ViewKind kind, Consumer<Frame> drawing) {
        int size = placement.port().width() * placement.port().height();
        Frame next = new Frame(aside.length == size ? aside : new int[size], placement, kind);
        drawing.accept(next);
        synchronized (this) {
            aside = shown == null ? new int[0] : shown.pixels();
            shown = next;
        }
    }

    /** Draws into the frame in place. */
    synchronized void change(Consumer<Frame> drawing) {
        if (shown != null) drawing.accept(shown);
    }

    /** Takes the frame away. */
    synchronized void clear() {
        shown = null;
    }

    /** Shows the frame to a reader, if there is one; it must keep nothing of the pixels. */
    synchronized void look(Consumer<Frame> reader) {
        if (shown != null) reader.accept(shown);
    }
}
