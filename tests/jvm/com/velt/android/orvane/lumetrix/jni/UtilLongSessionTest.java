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
 * One session of many thousand random calls of every native method on a small photo. After each
 * stroke the mask, the stroke's rectangle and the object box are held against what holds for every
 * stroke of its mode, and every picture against what holds for all of its kind.
 */
class UtilLongSessionTest {
    private static final int STROKES = 20_000;
    private static final long SEED = 20_240_611;

    private static final int WIDTH = 44;
    private static final int HEIGHT = 31;
    private static final int VIEW_WIDTH = 38;
    private static final int VIEW_HEIGHT = 27;

    /** No colours of the photo. */
    private static final int FIRST_DASH = 0x00000001;
    private static final int SECOND_DASH = 0x00000002;

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
            if (i % 10 == 9) drawPictures();
            if (i % 100 == 99) endAndBegin();
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

    /** Without an engine a stroke does nothing; a new session begins with an empty box. */
    private void endAndBegin() {
        byte[] maskBefore = mask.clone();
        Util.destroy_objectsel();
        Rect changed = new Rect(1, 2, 3, 4);
        Point middle = new Point(WIDTH / 2, HEIGHT / 2);
        Util.modify_objectsel(photo, mask, WIDTH, HEIGHT, middle, middle, PAINT, changed, 1);
        assertTrue(isEmpty(changed), "a stroke without an engine reports " + changed);
        assertArrayEquals(maskBefore, mask, "a stroke without an engine");
        assertEquals(1, Util.init_objectsel(WIDTH, HEIGHT));
        assertEquals(new Rect(WIDTH - 1, HEIGHT - 1, 0, 0), objectBox());
    }

    /** Calls what leaves session and selection as they are. */
    private void drawPictures() {
        byte[] maskBefore = mask.clone();
        Rect box = objectBox();

        checkColourOnGrey();
        checkReverse();
        float scale = new float[] {0.5f, 1, 2}[random.nextInt(3)];
        int offsetX = random.nextInt(60) - 8;
        int offsetY = random.nextInt(50) - 8;
        Rect area = randomArea();
        checkImagePoints(scale, offsetX, offsetY);
        checkView(scale, offsetX, offsetY, area);
        checkOutlinedView(scale, offsetX, offsetY, area);
        checkSmallViews(area);
        int[] array = Util.nativeIntAlloc(radius);
        assertArrayEquals(new int[radius], array);
        assertEquals(0, Util.nativeIntRelease(array));
        Util.reinit_objectsel(mask, WIDTH, HEIGHT, area);
        Util.reset_fill_ROI(WIDTH, HEIGHT);

        assertArrayEquals(maskBefore, mask, "drawing after " + stroke);
        assertEquals(box, objectBox(), "drawing after " + stroke);
        assertEquals(radius, Util.get_brush_radius());
    }

    private void checkColourOnGrey() {
        int[] picture = new int[photo.length];
        Util.draw_withmask(photo, picture, mask, WIDTH, new Rect(0, 0, WIDTH - 1, HEIGHT - 1));
        for (int i = 0; i < mask.length; ++i) {
            assertEquals(mask[i] == 1 ? photo[i] : grey(photo[i]), picture[i], stroke);
        }
    }

    private void checkReverse() {
        int[] picture = new int[photo.length];
        byte[] inverted = mask.clone();
        Util.draw_reversemask(photo, picture, inverted, WIDTH, HEIGHT);
        for (int i = 0; i < mask.length; ++i) {
            assertEquals(mask[i] == 1 ? grey(photo[i]) : photo[i], picture[i], stroke);
            assertEquals(mask[i] == 1 ? 0 : 1, inverted[i], stroke);
        }
    }

    private void checkImagePoints(float scale, int offsetX, int offsetY) {
        int[] points = new int[VIEW_WIDTH + VIEW_HEIGHT];
        Util.native_setImagePoints(VIEW_WIDTH, VIEW_HEIGHT, 0, 0, scale, offsetX, offsetY, points);
        for (int x = 0; x < VIEW_WIDTH; ++x) {
            assertEquals((int) Math.floor(offsetX + x * scale), points[x]);
        }
        for (int y = 0; y < VIEW_HEIGHT; ++y) {
            assertEquals((int) Math.floor(offsetY + y * scale), points[VIEW_WIDTH + y]);
        }
    }

    private void checkView(float scale, int offsetX, int offsetY, Rect area) {
        int[] view = new int[VIEW_WIDTH * VIEW_HEIGHT];
        assertEquals(1, Util.native_drawImage(view, VIEW_WIDTH, VIEW_HEIGHT, photo, WIDTH, HEIGHT,
                scale, offsetX, offsetY, area));
        for (int i = 0; i < view.length; ++i) {
            int shown = pixelAt(offsetX + i % VIEW_WIDTH * scale, offsetY + i / VIEW_WIDTH * scale);
            assertEquals(inView(area, i) ? photo[shown] : 0, view[i], "drawn to " + area);
        }
    }

    /** On the edges of the area, whatever is selected is outline; elsewhere it may be. */
    private void checkOutlinedView(float scale, int offsetX, int offsetY, Rect area) {
        int[] view = new int[VIEW_WIDTH * VIEW_HEIGHT];
        assertEquals(1, Util.native_drawImageWithMaskContour(view, VIEW_WIDTH, VIEW_HEIGHT, photo,
                WIDTH, HEIGHT, mask, scale, offsetX, offsetY, FIRST_DASH, SECOND_DASH, area));
        for (int i = 0; i < view.length; ++i) {
            int x = i % VIEW_WIDTH;
            int y = i / VIEW_WIDTH;
            int shown = pixelAt(offsetX + x * scale + 0.5, offsetY + y * scale + 0.5);
            boolean edge = x == area.left || x == area.right || y == area.top || y == area.bottom;
            boolean selected = mask[shown] == 1 || mask[shown] == 3;
            checkViewPixel(view, i, area, shown, selected, edge);
        }
    }

    private void checkSmallViews(Rect area) {
        int[] plain = new int[VIEW_WIDTH * VIEW_HEIGHT];
        int[] outlined = new int[VIEW_WIDTH * VIEW_HEIGHT];
        assertEquals(1, Util.native_drawSmallImage(plain, VIEW_WIDTH, VIEW_HEIGHT, photo, WIDTH,
                HEIGHT, area));
        assertEquals(1, Util.native_drawSmallImageWithMaskContour(outlined, VIEW_WIDTH, VIEW_HEIGHT,
                photo, WIDTH, HEIGHT, mask, FIRST_DASH, SECOND_DASH, area));
        for (int i = 0; i < plain.length; ++i) {
            int shown = pixelAt(i % VIEW_WIDTH - area.left, i / VIEW_WIDTH - area.top);
            int x = shown % WIDTH;
            int y = shown / WIDTH;
            boolean border = x == 0 || x == WIDTH - 1 || y == 0 || y == HEIGHT - 1;
            assertEquals(inView(area, i) ? photo[shown] : 0, plain[i], "drawn to " + area);
            checkViewPixel(outlined, i, area, shown, mask[shown] == 1, border);
        }
    }

    /** Nothing beyond the area; inside it the photo, or on selected pixels the dash's colour. */
    private void checkViewPixel(int[] view, int i, Rect area, int shown, boolean selected,
            boolean surely) {
        boolean firstColour = (i % VIEW_WIDTH / 5 + i / VIEW_WIDTH / 5) % 2 == 0;
        int dash = firstColour ? FIRST_DASH : SECOND_DASH;
        if (!inView(area, i)) {
            assertEquals(0, view[i], "drawn beyond " + area);
        } else if (selected && (surely || view[i] != photo[shown])) {
            assertEquals(dash, view[i], "outline drawn to " + area + " after " + stroke);
        } else {
            assertEquals(photo[shown], view[i], "drawn to " + area + " after " + stroke);
        }
    }

    private static int grey(int pixel) {
        int sum = (pixel >> 16 & 255) + (pixel >> 8 & 255) + (pixel & 255);
        return pixel & 0xFF000000 | sum / 3 * 0x010101;
    }

    /** The photo's pixel at a position, or the outermost one beside it. */
    private static int pixelAt(double x, double y) {
        int column = Math.max(0, Math.min(WIDTH - 1, (int) Math.floor(x)));
        int row = Math.max(0, Math.min(HEIGHT - 1, (int) Math.floor(y)));
        return row * WIDTH + column;
    }

    private static boolean inView(Rect area, int i) {
        int x = i % VIEW_WIDTH;
        int y = i / VIEW_WIDTH;
        return area.left <= x && x <= area.right && area.top <= y && y <= area.bottom;
    }

    private Rect randomArea() {
        int left = random.nextInt(VIEW_WIDTH);
        int top = random.nextInt(VIEW_HEIGHT);
        return new Rect(left, top, left + random.nextInt(VIEW_WIDTH - left),
                top + random.nextInt(VIEW_HEIGHT - top));
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
