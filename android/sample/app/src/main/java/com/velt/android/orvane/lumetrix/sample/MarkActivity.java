package com.velt.android.orvane.lumetrix.sample;

import android.app.Activity;
import android.content.Intent;
import android.graphics.Bitmap;
import android.graphics.BitmapFactory;
import android.os.Bundle;
import android.view.Menu;
import android.view.MenuItem;
import android.widget.Toast;
import com.velt.android.orvane.lumetrix.selection.Mode;
import java.io.IOException;
import java.io.InputStream;

/** Opens a photo, in which the user marks an object by touch. */
public final class MarkActivity extends Activity {
    private static final int PHOTO_CHOSEN = 1;

    private static final int OPEN = 1;
    private static final int GROW = 2;
    private static final int SHRINK = 3;
    private static final int UNDO = 4;

    private SelectionView view;

    @Override
    protected void onCreate(Bundle saved) {
        super.onCreate(saved);
        view = new SelectionView(this);
        setContentView(view);
    }

    @Override
    public boolean onCreateOptionsMenu(Menu menu) {
        menu.add(0, OPEN, 0, "Open");
        menu.add(0, GROW, 1, "Select");
        menu.add(0, SHRINK, 2, "Deselect");
        menu.add(0, UNDO, 3, "Undo");
        return true;
    }

    @Override
    public boolean onOptionsItemSelected(MenuItem item) {
        switch (item.getItemId()) {
            case OPEN:
                Intent choose = new Intent(Intent.ACTION_GET_CONTENT).setType("image/*");
                startActivityForResult(choose, PHOTO_CHOSEN);
                return true;
            case GROW:
                view.setMode(Mode.GROW);
                return true;
            case SHRINK:
                view.setMode(Mode.SHRINK);
                return true;
            case UNDO:
                view.undo();
                return true;
            default:
                return super.onOptionsItemSelected(item);
        }
    }

    @Override
    protected void onActivityResult(int request, int result, Intent data) {
        if (request != PHOTO_CHOSEN || result != RESULT_OK) return;
        try (InputStream in = getContentResolver().openInputStream(data.getData())) {
            Bitmap photo = BitmapFactory.decodeStream(in);
            if (photo == null) throw new IOException("no picture that can be read");
            view.open(photo);
        } catch (IOException e) {
            Toast.makeText(this, "This photo cannot be opened: " + e.getMessage(),
                    Toast.LENGTH_LONG).show();
        }
    }

    @Override
    protected void onDestroy() {
        view.close();
        super.onDestroy();
    }
}
