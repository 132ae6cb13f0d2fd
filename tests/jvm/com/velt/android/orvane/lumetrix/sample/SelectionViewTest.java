package com.velt.android.orvane.lumetrix.sample;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.content.Context;
import android.graphics.Bitmap;
import android.graphics.Canvas;
import android.view.MotionEvent;
import com.velt.android.orvane.lumetrix.selection.Mode;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** Touches on the sample's view, which shows a red disc on blue ground at half its size. */
class SelectionViewTest {
    private static final int RED = 0xFFFF0000;
    private static final int BLUE = 0xFF0000FF;
    private static final int WIDTH = 400;
    private static final int HEIGHT = 300;
    private static final int DISC_RADIUS = 60;

    private final SelectionView view = new SelectionView(new Context());

    @BeforeEach
    void openPhoto() {
        view.open(discOnGround());
        view.layout(0, 0, WIDTH / 2, HEIGHT / 2);
    }

    @AfterEach
    void close() {
        view.close();
    }

    private static Bitmap discOnGround() {
        int[] pixels = new int[WIDTH * HEIGHT];
        for (int y = 0; y < HEIGHT; ++y) {
            for (int x = 0; x < WIDTH; ++x) {
                int dx = x - WIDTH / 2;
                int dy = y - HEIGHT / 2;
                boolean inDisc = dx * dx + dy * dy <= DISC_RADIUS * DISC_RADIUS;
                pixels[y * WIDTH + x] = inDisc ? RED : BLUE;
            }
        }
        Bitmap photo = Bitmap.createBitmap(WIDTH, HEIGHT, Bitmap.Config.ARGB_8888);
        photo.setPixels(pixels, 0, WIDTH, 0, 0, WIDTH, HEIGHT);
        return photo;
    }

    private boolean touch(int action, float x, float y) {
        return view.onTouchEvent(MotionEvent.obtain(0, 0, action, x, y, 0));
    }

    private void touchCentre() {
        touch(MotionEvent.ACTION_DOWN, WIDTH / 4, HEIGHT / 4);
        touch(MotionEvent.ACTION_UP, WIDTH / 4, HEIGHT / 4);
    }

    private int[] shownPixels() {
        Canvas canvas = new Canvas();
        view.draw(canvas);
        int[] pixels = new int[WIDTH / 2 * (HEIGHT / 2)];
        canvas.drawn().getPixels(pixels, 0, WIDTH / 2, 0, 0, WIDTH / 2, HEIGHT / 2);
        return pixels;
    }

    @Test
    void aTouchSelectsTheObjectUnderIt() {
        touchCentre();
        double disc = Math.PI * DISC_RADIUS * DISC_RADIUS;
        assertEquals(disc, view.selectedPixels(), disc * 0.02);
    }

    @Test
    void theOutlineIsShown() {
        int[] before = shownPixels();
        touchCentre();
        int[] after = shownPixels();
        int outline = 0;
        for (int i = 0; i < before.length; ++i) {
            if (before[i] == after[i]) continue;
            assertTrue(after[i] == 0xFFFFFFFF || after[i] == 0xFF000000);
            ++outline;
        }
        assertEquals(Math.PI * DISC_RADIUS, outline, Math.PI * DISC_RADIUS * 0.3);
    }

    @Test
    void undoTakesATouchBack() {
        touchCentre();
        assertNotEquals(0, view.selectedPixels());
        view.undo();
        assertEquals(0, view.selectedPixels());
        view.undo();  // nothing is left to take back
        assertEquals(0, view.selectedPixels());
    }

    @Test
    void aCancelledTouchLeavesWhatWasThere() {
        touchCentre();
        int selected = view.selectedPixels();
        touch(MotionEvent.ACTION_DOWN, 10, 10);
        touch(MotionEvent.ACTION_MOVE, 12, 12);
        assertNotEquals(selected, view.selectedPixels());
        touch(MotionEvent.ACTION_CANCEL, 12, 12);
        assertEquals(selected, view.selectedPixels());
    }

    @Test
    void aCancelledTouchBesideThePhotoTakesNothingElseBack() {
        touchCentre();
        int selected = view.selectedPixels();
        touch(MotionEvent.ACTION_DOWN, -5, 500);
        touch(MotionEvent.ACTION_CANCEL, -5, 500);
        assertEquals(selected, view.selectedPixels());
    }

    @Test
    void aViewThatIsTurnedDuringATouchKeepsWhatWasSelected() {
        touch(MotionEvent.ACTION_DOWN, WIDTH / 4, HEIGHT / 4);
        int selected = view.selectedPixels();
        assertNotEquals(0, selected);
        view.layout(0, 0, HEIGHT / 2, WIDTH / 2);
        touch(MotionEvent.ACTION_MOVE, 20, 20);
        touch(MotionEvent.ACTION_UP, 20, 20);
        assertEquals(selected, view.selectedPixels());
    }

    @Test
    void aHugePhotoOnATinyViewTakesTheLargestBrush() {
        view.layout(0, 0, 2, 2);
        touch(MotionEvent.ACTION_DOWN, 1, 1);
        touch(MotionEvent.ACTION_UP, 1, 1);
        assertNotEquals(0, view.selectedPixels());
    }

    @Test
    void deselectingTakesAway() {
        touchCentre();
        int selected = view.selectedPixels();
        view.setMode(Mode.SHRINK);
        touchCentre();
        assertTrue(view.selectedPixels() < selected);
    }

    @Test
    void withoutAPhotoATouchIsNotTaken() {
        view.close();
        assertFalse(touch(MotionEvent.ACTION_DOWN, 5, 5));
        assertEquals(0, view.selectedPixels());
    }
}
