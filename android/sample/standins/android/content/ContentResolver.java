package android.content;

import android.net.Uri;
import java.io.FileNotFoundException;
import java.io.InputStream;

/** Stand-in for Android's class of this name: it finds nothing. */
public class ContentResolver {
    public InputStream openInputStream(Uri uri) throws FileNotFoundException {
        throw new FileNotFoundException(String.valueOf(uri));
    }
}
