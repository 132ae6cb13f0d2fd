/**
 * The editing screen without its window: tools, zoom and pan, strokes, files, and the drawing of
 * what is seen, all testable without a display.
 *
 * <p>An {@link com.velt.android.orvane.lumetrix.desktop.editing.Editor} keeps the selection session
 * in a thread of its own, so that no stroke or file makes a window wait.
 */
package com.velt.android.orvane.lumetrix.desktop.editing;
