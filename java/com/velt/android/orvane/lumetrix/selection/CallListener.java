package com.velt.android.orvane.lumetrix.selection;

/** Is told of each call that a session makes on the library. */
public interface CallListener {
    /** Takes no notice. */
    CallListener NONE = (call, arguments) -> {};

    /**
     * Is called before each call, in the session's thread.
     *
     * <p>It must not call the session, and should not throw: the call is then not made, which is
     * without harm in the constructor and at {@link NativeCall#SET_BOX}, and elsewhere leaves a
     * step half done.
     *
     * @param call which call
     * @param arguments its arguments, as {@link NativeCall} lists them; change nothing in the
     *     array, for the call reads it
     */
    void beforeCall(NativeCall call, int... arguments);
}
