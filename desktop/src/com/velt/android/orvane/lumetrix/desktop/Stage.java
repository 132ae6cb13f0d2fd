package com.velt.android.orvane.lumetrix.desktop;

import com.velt.android.orvane.lumetrix.selection.SelectionSession;

/**
 * What commands act on.
 *
 * @param session the photo being edited
 * @param table receives a row from each command that works on the selection
 * @param pictures receives the pictures
 */
record Stage(SelectionSession session, StrokeTable table, PictureFolder pictures) {}
