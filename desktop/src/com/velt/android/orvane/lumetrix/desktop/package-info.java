/**
 * Photos, pictures and stroke scripts on the desktop, and the player of the latter. The editing
 * screen is built on them.
 *
 * <p>A {@link com.velt.android.orvane.lumetrix.desktop.Script} is read and checked, then its
 * commands act one after the other on a
 * {@link com.velt.android.orvane.lumetrix.selection.SelectionSession}.
 */
package com.velt.android.orvane.lumetrix.desktop;
