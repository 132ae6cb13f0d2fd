package com.velt.android.orvane.lumetrix.desktop;

import java.io.IOException;

/** Is told of each call that a session makes on the library. */
interface CallLog extends AutoCloseable {
    /** Takes no notice. */
    CallLog NONE = (call, arguments) -> {};

    void add(Call call, int... arguments);

    @Override
    default void close() throws IOException {}
}
