package android.view;

/** Stand-in for Android's interface of this name: the method that the sample calls. */
public interface Menu {
    MenuItem add(int group, int item, int order, CharSequence title);
}
