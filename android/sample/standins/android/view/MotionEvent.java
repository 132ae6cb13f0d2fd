package android.view;

/** Stand-in for Android's class of this name: one finger, without history. */
public final class MotionEvent {
    public static final int ACTION_DOWN = 0;
    public static final int ACTION_UP = 1;
    public static final int ACTION_MOVE = 2;
    public static final int ACTION_CANCEL = 3;

    private final int action;
    private final float x;
    private final float y;

    private MotionEvent(int action, float x, float y) {
        this.action = action;
        this.x = x;
        this.y = y;
    }

    public static MotionEvent obtain(long downTime, long eventTime, int action, float x, float y,
            int metaState) {
        return new MotionEvent(action, x, y);
    }

    public int getActionMasked() {
        return action;
    }

    public float getX() {
        return x;
    }

    public float getY() {
        return y;
    }

    public int getHistorySize() {
        return 0;
    }

    public float getHistoricalX(int i) {
        throw new IllegalArgumentException("there is no history");
    }

    public float getHistoricalY(int i) {
        throw new IllegalArgumentException("there is no history");
    }
}
