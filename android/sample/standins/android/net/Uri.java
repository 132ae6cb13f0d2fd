package android.net;

/** Stand-in for Android's class of this name. */
public abstract class Uri {}
