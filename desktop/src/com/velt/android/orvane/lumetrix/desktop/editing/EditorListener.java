package com.velt.android.orvane.lumetrix.desktop.editing;

/**
 * Is told what happens in an editor: in threads of the editor's own, and of what is refused at once
 * in the thread that asked for it. It must not wait for another thread, which may be waiting for
 * the editor to close.
 */
public interface EditorListener {
    /** There is a new frame to look at. */
    void frameDrawn();

    /** Something that a window shows is different. */
    void stateChanged(EditorState state);

    /** There is something to tell the user. */
    void said(Message message);
}
