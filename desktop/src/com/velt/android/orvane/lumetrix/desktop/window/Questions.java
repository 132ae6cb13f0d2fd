package com.velt.android.orvane.lumetrix.desktop.window;

/** What the user is told and asked in dialogues, but for files. */
interface Questions {
    /** What is to become of work that is not saved. */
    enum Answer { SAVE, DISCARD, CANCEL }

    /** Asks what is to become of the selection of a photo, which is not saved. */
    Answer aboutUnsaved(String photo);

    /** Tells that something asked for could not be done. */
    void tellProblem(String text);
}
