package android.graphics;

/** Stand-in for Android's class of this name. */
public class Paint {}
