package com.velt.android.orvane.lumetrix.jni;

import static com.velt.android.orvane.lumetrix.jni.UtilStrokesTest.GROW;
import static com.velt.android.orvane.lumetrix.jni.UtilStrokesTest.LASSO_REMOVE;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.graphics.Point;
import android.graphics.Rect;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.Random;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/**
 * That no call keeps memory: neither the library's own nor the virtual machine's copies of arrays
 * that were not released.
 *
 * <p>The process is measured as a whole, so all else must stand still: CMakeLists.txt runs this
 * class without a compiler and with a heap that is resident from the start, and the calls are made
 * on the same few objects again and again.
 */
class UtilMemoryTest {
    private static final int WARM_UP_STROKES = 20_000;
    private static final int STROKES = 100_000;

    /** In KB: 10 bytes a stroke. Without a leak the process grows by an eighth of that. */
    private static final long MOST_GROWTH = 10L * STROKES / 1024;

    private static final int WIDTH = 32;
    private static final int HEIGHT = 24;
    private static final int VIEW_WIDTH = 40;
    private static final int VIEW_HEIGHT = 30;

    private final Random random = new Random(7);
    private final int[] photo = random.ints(WIDTH * HEIGHT, 0, 0x30).map(i -> i * 0x010101)
            .toArray();
    private final int[] picture = new int[WIDTH * HEIGHT];
    private final int[] view = new int[VIEW_WIDTH * VIEW_HEIGHT];
    private final byte[] mask = new byte[WIDTH * HEIGHT];
    private final byte[] copy = new byte[WIDTH * HEIGHT];
    private final Point from = new Point();
    private final Point to = new Point();
    private final Rect rect = new Rect();
    private final int[] strokesWithEffect = new int[LASSO_REMOVE + 1];

    @BeforeEach
    void beginSession() {
        Util.set_brush_size(5, 2);
        Util.init_objectsel(WIDTH, HEIGHT);
    }

    @AfterEach
    void endSession() {
        Util.destroy_objectsel();
    }

    @Test
    void strokesAndDrawingKeepNoMemory() throws IOException {
        Runtime java = Runtime.getRuntime();
        assertEquals(java.maxMemory(), java.totalMemory(), "the heap must not grow or shrink");
        draw(WARM_UP_STROKES);
        long resident = memory("VmRSS");
        long writable = memory("VmData");
        Arrays.fill(strokesWithEffect, 0);

        draw(STROKES);

        assertNotGrown("resident", resident, memory("VmRSS"));
        assertNotGrown("writable", writable, memory("VmData"));
        for (int mode = GROW; mode <= LASSO_REMOVE; ++mode) {
            assertTrue(strokesWithEffect[mode] > STROKES / 20, "mode " + mode + " had an effect "
                    + strokesWithEffect[mode] + " times");
        }
    }

    /** Draws strokes of every mode in turn; after every fourth, calls every other method. */
    private void draw(int strokes) {
        for (int i = 0; i < strokes; ++i) {
            int mode = i % (LASSO_REMOVE + 1);
            moveAnywhere(from);
            moveAnywhere(to);
            System.arraycopy(mask, 0, copy, 0, mask.length);
            Util.modify_objectsel(photo, mask, WIDTH, HEIGHT, from, to, mode, rect,
                    random.nextInt(2));
            if (!Arrays.equals(copy, mask)) ++strokesWithEffect[mode];
            if (i % 4 == 3) callEveryOtherMethod(i);
        }
    }

    private void callEveryOtherMethod(int round) {
        Util.draw_reversemask(photo, picture, copy, WIDTH, HEIGHT);
        setRect(WIDTH, HEIGHT);
        Util.draw_withmask(photo, picture, mask, WIDTH, rect);
        Util.reinit_objectsel(mask, WIDTH, HEIGHT, rect);
        Util.reset_fill_ROI(WIDTH, HEIGHT);

        setRect(VIEW_WIDTH, VIEW_HEIGHT);
        Util.native_setImagePoints(VIEW_WIDTH, VIEW_HEIGHT, 0, 0, 0.7f, 1, 2, view);
        Util.native_drawImage(view, VIEW_WIDTH, VIEW_HEIGHT, photo, WIDTH, HEIGHT, 0.7f, 1, 2,
                rect);
        Util.native_drawImageWithMaskContour(view, VIEW_WIDTH, VIEW_HEIGHT, photo, WIDTH, HEIGHT,
                mask, 0.7f, 1, 2, -1, 0, rect);
        Util.native_drawSmallImage(view, VIEW_WIDTH, VIEW_HEIGHT, photo, WIDTH, HEIGHT, rect);
        Util.native_drawSmallImageWithMaskContour(view, VIEW_WIDTH, VIEW_HEIGHT, photo, WIDTH,
                HEIGHT, mask, -1, 0, rect);
        Util.nativeIntRelease(Util.nativeIntAlloc(round % 50));

        Util.get_objectROI(rect);
        Util.set_objectROI(rect);
        Util.update_objectROI(mask, WIDTH, HEIGHT);
        if (round % 400 == 3) {
            Util.reset_objectsel(mask, WIDTH, HEIGHT);
        } else if (round % 20 == 3) {
            Util.inverse_objectsel(mask, WIDTH, HEIGHT);
        }
        int radius = 3 + round / 4 % 4;
        Util.set_brush_size(radius, Util.get_brush_center() % radius);
        if (round % 16 == 3) Util.destroy_objectsel();
        Util.init_objectsel(WIDTH, HEIGHT);
    }

    private void moveAnywhere(Point point) {
        point.x = random.nextInt(WIDTH);
        point.y = random.nextInt(HEIGHT);
    }

    private void setRect(int width, int height) {
        rect.left = 0;
        rect.top = 0;
        rect.right = width - 1;
        rect.bottom = height - 1;
    }

    private static void assertNotGrown(String what, long before, long after) {
        assertTrue(after - before < MOST_GROWTH, STROKES + " strokes grew " + what + " memory from "
                + before + " to " + after + " KB");
    }

    /** Returns a line of the kernel's account of this process, in KB. */
    private static long memory(String line) throws IOException {
        System.gc();
        return Files.readAllLines(Path.of("/proc/self/status")).stream()
                .filter(each -> each.startsWith(line + ":"))
                .mapToLong(each -> Long.parseLong(each.replaceAll("[^0-9]", "")))
                .findFirst().orElseThrow();
    }
}
