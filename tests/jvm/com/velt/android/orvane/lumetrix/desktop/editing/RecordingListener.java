package com.velt.android.orvane.lumetrix.desktop.editing;

import java.util.ArrayList;
import java.util.List;
import java.util.function.BooleanSupplier;
import java.util.function.Predicate;

/** Keeps what an editor tells. */
final class RecordingListener implements EditorListener {
    private final List<EditorState> states = new ArrayList<>();
    private final List<Message> messages = new ArrayList<>();
    private int frames;

    @Override
    public synchronized void frameDrawn() {
        ++frames;
        notifyAll();
    }

    @Override
    public synchronized void stateChanged(EditorState state) {
        states.add(state);
        notifyAll();
    }

    @Override
    public synchronized void said(Message message) {
        messages.add(message);
    }

    synchronized int frames() {
        return frames;
    }

    /** Waits for more frames than a number. */
    synchronized void awaitFrameAfter(int number) {
        awaitUntil(() -> frames > number);
    }

    /** Waits for a state. */
    synchronized void awaitState(Predicate<EditorState> wanted) {
        awaitUntil(() -> !states.isEmpty() && wanted.test(state()));
    }

    private void awaitUntil(BooleanSupplier condition) {
        try {
            while (!condition.getAsBoolean()) wait();
        } catch (InterruptedException e) {
            throw new IllegalStateException(e);
        }
    }

    /** Returns the last state. */
    synchronized EditorState state() {
        return states.get(states.size() - 1);
    }

    synchronized List<EditorState> states() {
        return List.copyOf(states);
    }

    /** Returns what was said since this was asked last. */
    synchronized List<Message> takeMessages() {
        List<Message> taken = List.copyOf(messages);
        messages.clear();
        return taken;
    }
}
