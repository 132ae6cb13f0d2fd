/**
 * The window of the editing screen: it turns events into calls on an
 * {@link com.velt.android.orvane.lumetrix.desktop.editing.Editor} and paints what that draws.
 *
 * <p>Everything here belongs to the event thread, where nothing takes long: the editor reads files
 * and changes the selection in threads of its own.
 */
package com.velt.android.orvane.lumetrix.desktop.window;
