package android.os;

/** Stand-in for Android's class of this name. */
public final class Bundle {}
