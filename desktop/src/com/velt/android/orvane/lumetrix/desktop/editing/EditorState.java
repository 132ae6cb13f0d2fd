package com.velt.android.orvane.lumetrix.desktop.editing;

/**
 * What a window shows of an editor, as it stood at one moment.
 *
 * @param photo the photo, or null before the first one
 * @param selectedPixels how many pixels are selected
 * @param fill whether strokes fill holes, and erase what they cut off
 * @param canUndo whether there is a step to undo
 * @param canRedo whether there is a step to redo
 * @param unsaved whether something was done since the selection was last saved
 * @param strokeNanos what the library took for the last stroke, in nanoseconds
 * @param strokeDabs the number of its dabs, or of a lasso's corners
 * @param redrawNanos what the last redraw of the whole view took
 * @param changeNanos what the last redraw of a dab took
 * @param work what is going on that takes a while, or an empty text
 * @param workDone how much of it is done
 * @param workTotal how much there is of it, or 0 when nobody knows
 */
public record EditorState(OpenedPhoto photo, int selectedPixels, boolean fill, boolean canUndo,
        boolean canRedo, boolean unsaved, long strokeNanos, int strokeDabs, long redrawNanos,
        long changeNanos, String work, int workDone, int workTotal) {
    /** Before the first photo. */
    public static final EditorState EMPTY = new EditorState(null, 0, true, false, false, false, 0,
            0, 0, 0, "", 0, 0);

    /** Returns this state with another work. */
    EditorState during(String otherWork) {
        return new EditorState(photo, selectedPixels, fill, canUndo, canRedo, unsaved, strokeNanos,
                strokeDabs, redrawNanos, changeNanos, otherWork, workDone, workTotal);
    }

    /** Returns the share of the photo that is selected, 0 to 1. */
    public double share() {
        if (photo == null) return 0;
        return selectedPixels / ((double) photo.width() * photo.height());
    }
}
