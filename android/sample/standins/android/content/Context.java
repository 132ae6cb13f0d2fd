package android.content;

/** Stand-in for Android's class of this name: the methods that the sample calls. */
public class Context {
    public ContentResolver getContentResolver() {
        return new ContentResolver();
    }
}
