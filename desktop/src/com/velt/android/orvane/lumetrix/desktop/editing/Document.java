package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.desktop.Picture;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.util.function.Consumer;

/** A photo that is open, with its selection. Belongs to the thread that makes it. */
final class Document implements AutoCloseable {
    final OpenedPhoto photo;
    final SelectionSession session;
    final Strokes strokes;
    final Renderer renderer;
    int selectedPixels;  // as they were counted last
    int selectedBefore;  // the last stroke
    int steps;           // that did something, undone and redone ones included
    int stepsSaved;      // as many of them as there were when the selection was saved last

    /** {@code changed} is told where strokes have changed the selection, as soon as they have. */
    Document(OpenedPhoto photo, Consumer<Area> changed) {
        this.photo = photo;
        session = new SelectionSession(photo.photo().pixels(), photo.width(), photo.height());
        boolean made = false;
        try {
            strokes = new Strokes(session, changed);
            renderer = new Renderer(session, photo.photo().pixels());
            made = true;
        } finally {
            if (!made) session.close();  // memory is short; another photo can be opened still
        }
    }

    /** Returns the photo with all that is not selected transparent. */
    Picture cutOut() {
        int[] pixels = photo.photo().pixels().clone();
        byte[] mask = session.mask();
        for (int i = 0; i < pixels.length; ++i) {
            if (mask[i] != 1) pixels[i] = 0;
        }
        return new Picture(photo.width(), photo.height(), pixels);
    }

    boolean unsaved() {
        return steps != stepsSaved;
    }

    @Override
    public void close() {
        session.close();
    }
}
