package android.app;

import android.content.Context;
import android.content.Intent;
import android.os.Bundle;
import android.view.Menu;
import android.view.MenuItem;
import android.view.View;

/** Stand-in for Android's class of this name: the methods that the sample calls or overrides. */
public class Activity extends Context {
    public static final int RESULT_OK = -1;

    protected void onCreate(Bundle saved) {}

    protected void onDestroy() {}

    protected void onActivityResult(int request, int result, Intent data) {}

    public boolean onCreateOptionsMenu(Menu menu) {
        return true;
    }

    public boolean onOptionsItemSelected(MenuItem item) {
        return false;
    }

    public void setContentView(View view) {}

    public void startActivityForResult(Intent intent, int request) {}
}
