package com.velt.android.orvane.lumetrix.desktop;

import com.velt.android.orvane.lumetrix.selection.CallListener;

/** Is told of each call on the library that the selection or its digest depends on. */
interface CallLog extends CallListener, AutoCloseable {
    /** Takes no notice. */
    CallLog NONE = (call, arguments) -> {};

    /** The view that the digest shows is drawn, and the digest taken. */
    default void digest() {}

    @Override
    default void close() throws OutputException {}
}
