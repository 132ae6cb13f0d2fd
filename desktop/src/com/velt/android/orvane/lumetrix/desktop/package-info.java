/**
 * The editing screen on desktop Java: plays stroke scripts through the native library.
 *
 * <p>A {@link com.velt.android.orvane.lumetrix.desktop.Script} is read and checked, then its
 * commands act one after the other on a
 * {@link com.velt.android.orvane.lumetrix.selection.SelectionSession}.
 */
package com.velt.android.orvane.lumetrix.desktop;
