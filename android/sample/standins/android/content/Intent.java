package android.content;

import android.net.Uri;

/** Stand-in for Android's class of this name: the methods that the sample calls. */
public class Intent {
    public static final String ACTION_GET_CONTENT = "android.intent.action.GET_CONTENT";

    public Intent(String action) {}

    public Intent setType(String type) {
        return this;
    }

    public Uri getData() {
        return null;
    }
}
