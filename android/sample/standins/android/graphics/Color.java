package android.graphics;

/** Stand-in for Android's class of this name: the constants that the sample uses. */
public class Color {
    public static final int BLACK = 0xFF000000;
    public static final int WHITE = 0xFFFFFFFF;
}
