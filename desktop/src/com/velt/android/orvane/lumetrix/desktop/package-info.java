/**
 * The editing screen on desktop Java: plays stroke scripts through the native library.
 *
 * <p>A {@link com.velt.android.orvane.lumetrix.desktop.Script} is read and checked, then its
 * commands act one after the other on an
 * {@link com.velt.android.orvane.lumetrix.desktop.EditingSession}, the only class that calls the
 * library.
 */
package com.velt.android.orvane.lumetrix.desktop;
