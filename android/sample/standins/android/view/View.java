package android.view;

import android.content.Context;
import android.graphics.Canvas;

/** Stand-in for Android's class of this name: a view that a test gives a size. */
public class View {
    private int width;
    private int height;

    public View(Context context) {}

    public final int getWidth() {
        return width;
    }

    public final int getHeight() {
        return height;
    }

    /** Places the view, as a layout does. */
    public void layout(int left, int top, int right, int bottom) {
        int oldWidth = width;
        int oldHeight = height;
        width = right - left;
        height = bottom - top;
        if (width != oldWidth || height != oldHeight) {
            onSizeChanged(width, height, oldWidth, oldHeight);
        }
    }

    /** Draws the view, as its window does. */
    public void draw(Canvas canvas) {
        onDraw(canvas);
    }

    public boolean onTouchEvent(MotionEvent event) {
        return false;
    }

    public void invalidate() {}

    protected void onSizeChanged(int width, int height, int oldWidth, int oldHeight) {}

    protected void onDraw(Canvas canvas) {}
}
