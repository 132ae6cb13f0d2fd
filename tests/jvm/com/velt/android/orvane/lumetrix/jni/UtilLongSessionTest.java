package com.velt.android.orvane.lumetrix.jni;

import static com.velt.android.orvane.lumetrix.jni.UtilStrokesTest.ERASE;
import static com.velt.android.orvane.lumetrix.jni.UtilStrokesTest.GROW;
import static com.velt.android.orvane.lumetrix.jni.UtilStrokesTest.LASSO_ADD;
import static com.velt.android.orvane.lumetrix.jni.UtilStrokesTest.LASSO_REMOVE;
import static com.velt.android.orvane.lumetrix.jni.UtilStrokesTest.PAINT;
import static com.velt.android.orvane.lumetrix.jni.UtilStrokesTest.SHRINK;
import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.graphics.Point;
import android.graphics.Rect;
import java.util.Arrays;
import java.util.Random;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/**
 * One session of many thousand random calls on a small photo. After each stroke the mask, the
 * stroke's rectangle and the object box are held against what holds for every stroke of its mode.
 */
class UtilLongSessionTest {
    private static final int STROKES = 20_000;
    private static final long SEED = 20_240_611;

    private static final int WIDTH = 44;
    private static final int HEIGHT = 31;

    private final Random random = new Random(SEED);
    private final int[] photo = patches();
    private final byte[] mask = new byte[WIDTH * HEIGHT];
    private byte[] before;
    private int radius;
    private String stroke;

    @BeforeEach
    void beginSession() {
        changeBrush();
        Util.init_objectsel(WIDTH, HEIGHT);
    }

    @AfterEach
    void endSession() {
        Util.destroy_objectsel();
    }

    @Test
    void everyStrokeKeepsToItsMode() {
        int[] photoBefore = photo.clone();
        int[] strokesWithEffect = new int[6];
        for (int i = 0; i < STROKES; ++i) {
            if (i % 40 == 39) changeSomethingElse();
            int mode = random.nextInt(6);
            if (drawStroke(i, mode)) ++strokesWithEffect[mode];
            assertArrayEquals(photoBefore, photo, stroke);
        }
        for (int mode = GROW; mode <= LASSO_REMOVE; ++mode) {
            assertTrue(strokesWithEffect[mode] > STROKES / 20,
                    "mode " + mode + " changed the mask " + strokesWithEffect[mode] + " times");
        }
    }

    /** Draws one stroke, holds it against the rules and returns whether the mask changed. */
    private boolean drawStroke(int number, int mode) {
        boolean lasso = mode == LASSO_ADD || mode == LASSO_REMOVE;
        Point from = randomPoint(lasso ? 1 : 5);
        Point to = randomPoint(1);
        int fill = random.nextInt(3) - 1;
        Rect oldBox = objectBox();
        before = mask.clone();
        stroke = "stroke " + number + " of seed " + SEED + ": mode " + mode + ", " + from + " "
                + to + ", radius " + radius + ", fill " + fill;

        Rect changed = new Rect();
        Util.modify_objectsel(photo, mask, WIDTH, HEIGHT, from, to, mode, changed, fill);

        checkValues(mode, fill);
        assertTrue(isEmpty(changed) || liesOnThePhoto(changed), stroke + " reports " + changed);
        switch (mode) {
            case GROW -> checkGrown(from, fill, changed);
            case SHRINK -> checkShrunk(from, fill, changed);
            case PAINT -> checkPainted(from, fill, changed);
            case ERASE -> checkErased(from, changed);
            default -> checkLasso(mode, from, to, fill, changed);
        }
        Rect expectedBox = oldBox;
        if (mode == SHRINK && fill == 1) {
            expectedBox = boxOfSelected(oldBox);
        } else if (mode != SHRINK && mode != ERASE) {
            expectedBox = union(oldBox, changed);
        }
        assertEquals(expectedBox, objectBox(), stroke);
        return !Arrays.equals(before, mask);
    }

    /** 0 and 1, and the lasso's 3, 4 and 5, which only a lasso writes. */
    private void checkValues(int mode, int fill) {
        Rect box = objectBox();
        for (int i = 0; i < mask.length; ++i) {
            int value = mask[i];
            boolean outline = value >= 3 && value <= 5;
            assertTrue(value == 0 || value == 1 || outline, stroke + " leaves " + value);
            if (!outline) continue;
            if (mode == LASSO_ADD) {
                assertTrue(value == before[i] || value == 5, stroke);
            } else if (mode == LASSO_REMOVE) {
                assertTrue(value == before[i] || value != 5, stroke);
            } else {
                assertEquals(before[i], value, stroke);
            }
            boolean settled = fill == 1
                    && (mode == LASSO_ADD && value == 5 || mode == LASSO_REMOVE && value != 5);
            assertTrue(!settled || !contains(box, i), stroke + " leaves an outline in the box");
        }
    }

    private void checkGrown(Point at, int fill, Rect changed) {
        boolean inside = at.x > 0 && at.x < WIDTH - 1 && at.y > 0 && at.y < HEIGHT - 1;
        for (int i = 0; i < mask.length; ++i) {
            if (before[i] == 1) assertEquals(1, mask[i], stroke + " deselects");
            if (fill == 1 || mask[i] == before[i]) continue;
            assertTrue(inside && inBrushSquare(at, i), stroke + " reaches beyond the brush");
            if (mask[i] == 1) assertTrue(contains(changed, i), stroke + " reports too little");
        }
        if (!inside && fill != 1) assertTrue(isEmpty(changed), stroke);
    }

    private void checkShrunk(Point at, int fill, Rect changed) {
        boolean onPhoto = at.x >= 0 && at.x < WIDTH && at.y >= 0 && at.y < HEIGHT;
        boolean starts = onPhoto && before[at.y * WIDTH + at.x] == 1;
        for (int i = 0; i < mask.length; ++i) {
            if (before[i] == 0) assertEquals(0, mask[i], stroke + " selects");
            if (before[i] == 1 && mask[i] == 0) {
                assertTrue(contains(changed, i), stroke + " reports too little");
            }
            if (fill == 1 || mask[i] == before[i]) continue;
            assertTrue(starts && inBrushSquare(at, i), stroke + " reaches beyond the brush");
        }
        if (!starts && fill != 1) assertTrue(isEmpty(changed), stroke);
    }

    private void checkPainted(Point at, int fill, Rect changed) {
        for (int i = 0; i < mask.length; ++i) {
            if (before[i] == 1) assertEquals(1, mask[i], stroke + " deselects");
            if (fill == 1) continue;
            boolean paints = before[i] == 0 && inPaintedDisc(at, i);
            assertEquals(paints ? 1 : before[i], mask[i], stroke);
        }
        assertEquals(boxOfChange(0, 1), changed, stroke);
    }

    private void checkErased(Point at, Rect changed) {
        for (int i = 0; i < mask.length; ++i) {
            boolean erases = before[i] == 1 && inPaintedDisc(at, i);
            assertEquals(erases ? 0 : before[i], mask[i], stroke);
        }
        assertEquals(boxOfChange(1, 0), changed, stroke);
    }

    private void checkLasso(int mode, Point from, Point to, int fill, Rect changed) {
        Rect ends = union(new Rect(from.x, from.y, from.x, from.y),
                new Rect(to.x, to.y, to.x, to.y));
        assertEquals(liesOnThePhoto(ends) ? ends : empty(), changed, stroke);
        if (fill == 1) return;
        int drawn = 0;
        for (int i = 0; i < mask.length; ++i) {
            if (mask[i] == before[i]) continue;
            ++drawn;
            assertTrue(contains(changed, i), stroke + " draws elsewhere");
            int expected = mode == LASSO_ADD ? before[i] == 0 ? 1 : 5 : before[i] == 1 ? 4 : 3;
            assertEquals(expected, mask[i], stroke);
        }
        int longer = Math.max(ends.right - ends.left, ends.bottom - ends.top);
        assertTrue(drawn <= longer + 1, stroke + " draws " + drawn + " pixels");
    }

    /** Changes the brush, or works on the whole selection, now and then. */
    private void changeSomethingElse() {
        switch (random.nextInt(8)) {
            case 0 -> Util.inverse_objectsel(mask, WIDTH, HEIGHT);
            case 1 -> Util.reset_objectsel(mask, WIDTH, HEIGHT);
            case 2 -> Util.update_objectROI(mask, WIDTH, HEIGHT);
            case 3 -> Util.set_objectROI(new Rect(random.nextInt(60) - 8, random.nextInt(50) - 8,
                    random.nextInt(60) - 8, random.nextInt(50) - 8));
            default -> changeBrush();
        }
    }

    private void changeBrush() {
        radius = random.nextInt(10);
        Util.set_brush_size(radius, random.nextInt(radius + 3));
    }

    /** A point on the photo or up to {@code beyond} pixels outside. */
    private Point randomPoint(int beyond) {
        return new Point(random.nextInt(WIDTH + 2 * beyond) - beyond,
                random.nextInt(HEIGHT + 2 * beyond) - beyond);
    }

    private boolean inBrushSquare(Point at, int i) {
        return Math.abs(i % WIDTH - at.x) <= radius && Math.abs(i / WIDTH - at.y) <= radius;
    }

    /** Whether painting and erasing reach a pixel: not in the last row and column. */
    private boolean inPaintedDisc(Point at, int i) {
        int dx = i % WIDTH - at.x;
        int dy = i / WIDTH - at.y;
        int distance = (int) (Math.sqrt(dx * dx + dy * dy) + 0.5);
        return inBrushSquare(at, i) && dx < radius && dy < radius
                && distance <= Math.max(radius, Util.get_brush_center());
    }

    private static boolean isEmpty(Rect rect) {
        return rect.equals(empty());
    }

    private static Rect empty() {
        return new Rect(WIDTH, HEIGHT, 0, 0);
    }

    private static boolean liesOnThePhoto(Rect rect) {
        return 0 <= rect.left && rect.left <= rect.right && rect.right < WIDTH && 0 <= rect.top
                && rect.top <= rect.bottom && rect.bottom < HEIGHT;
    }

    private static boolean contains(Rect rect, int i) {
        int x = i % WIDTH;
        int y = i / WIDTH;
        return rect.left <= x && x <= rect.right && rect.top <= y && y <= rect.bottom;
    }

    private static Rect union(Rect a, Rect b) {
        return new Rect(Math.min(a.left, b.left), Math.min(a.top, b.top),
                Math.max(a.right, b.right), Math.max(a.bottom, b.bottom));
    }

    private Rect boxOfSelected(Rect within) {
        Rect box = empty();
        for (int i = 0; i < mask.length; ++i) {
            if (mask[i] == 1 && contains(within, i)) box = union(box, pixel(i));
        }
        return box;
    }

    private Rect boxOfChange(int from, int to) {
        Rect box = empty();
        for (int i = 0; i < mask.length; ++i) {
            if (before[i] == from && mask[i] == to) box = union(box, pixel(i));
        }
        return box;
    }

    private static Rect pixel(int i) {
        return new Rect(i % WIDTH, i / WIDTH, i % WIDTH, i / WIDTH);
    }

    private static Rect objectBox() {
        Rect box = new Rect();
        Util.get_objectROI(box);
        return box;
    }

    /** Patches of a few colours, a little noisy. */
    private static int[] patches() {
        Random noise = new Random(SEED);
        int[] colours = {0xFF203040, 0xFFC08040, 0xFF40A060, 0xFFE0E0D0};
        int[] pixels = new int[WIDTH * HEIGHT];
        for (int i = 0; i < pixels.length; ++i) {
            int patch = i % WIDTH / 9 + 3 * (i / WIDTH / 7);
            pixels[i] = colours[patch % colours.length] + noise.nextInt(12) * 0x010101;
        }
        return pixels;
    }
}
