/**
 * Selection on a photo with every argument checked, undo and redo, and a record of the strokes.
 *
 * <p>{@link com.velt.android.orvane.lumetrix.selection.SelectionSession} is where to begin. It
 * calls the raw native methods of {@link com.velt.android.orvane.lumetrix.jni.Util} and adds what
 * those leave to their callers.
 */
package com.velt.android.orvane.lumetrix.selection;
