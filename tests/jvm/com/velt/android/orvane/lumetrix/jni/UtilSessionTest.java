package com.velt.android.orvane.lumetrix.jni;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertThrows;

import android.graphics.Point;
import android.graphics.Rect;
import java.util.Arrays;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

class UtilSessionTest {
    private static final int RED = 0xFFC00000;
    private static final int BLUE = 0xFF0000C0;
    private static final int GROW = 0;

    private static final int WIDTH = 21;
    private static final int HEIGHT = 15;

    private final int[] pixels = halfRedHalfBlue();
    private final byte[] mask = new byte[WIDTH * HEIGHT];

    @AfterEach
    void endSession() {
        Util.destroy_objectsel();
    }

    @Test
    void initRefusesSizesBelowOneAndLeavesTheObjectBox() {
        Util.set_objectROI(new Rect(1, 2, 3, 4));
        assertEquals(0, Util.init_objectsel(0, 100));
        assertEquals(0, Util.init_objectsel(100, -1));
        assertEquals(new Rect(1, 2, 3, 4), objectBox());
        assertEquals(1, Util.init_objectsel(1, 1));
    }

    @Test
    void initEmptiesTheObjectBox() {
        assertEquals(1, Util.init_objectsel(640, 480));
        assertEquals(new Rect(639, 479, 0, 0), objectBox());
    }

    @Test
    void initKeepsTheBrush() {
        Util.set_brush_size(20, 3);
        Util.init_objectsel(10, 10);
        assertEquals(20, Util.get_brush_radius());
        assertEquals(3, Util.get_brush_center());
    }

    @Test
    void destroyKeepsBrushAndObjectBox() {
        Util.set_brush_size(7, 2);
        Util.set_objectROI(new Rect(1, 2, 3, 4));
        Util.destroy_objectsel();
        assertEquals(7, Util.get_brush_radius());
        assertEquals(2, Util.get_brush_center());
        assertEquals(new Rect(1, 2, 3, 4), objectBox());
    }

    @Test
    void objectBoxComesBackAsItWasSetAlsoTurnedOver() {
        Rect turnedOver = new Rect(9, -8, 3, -20);
        Util.set_objectROI(turnedOver);
        assertEquals(turnedOver, objectBox());
        assertEquals(new Rect(9, -8, 3, -20), turnedOver);
    }

    @Test
    void strokeWithoutEngineEmptiesTheRectangleAndNothingElse() {
        Util.init_objectsel(WIDTH, HEIGHT);
        Util.destroy_objectsel();
        assertEquals(new Rect(WIDTH, HEIGHT, 0, 0), stroke(new Point(7, 7), GROW, 1));
        assertArrayEquals(new byte[WIDTH * HEIGHT], mask);
        assertEquals(new Rect(WIDTH - 1, HEIGHT - 1, 0, 0), objectBox());
    }

    @Test
    void unknownModesEmptyTheRectangleAndNothingElse() {
        begin(5, 1);
        for (int mode : new int[] {-1, 6}) {
            assertEquals(new Rect(WIDTH, HEIGHT, 0, 0), stroke(new Point(7, 7), mode, 1));
        }
        assertArrayEquals(new byte[WIDTH * HEIGHT], mask);
        assertEquals(new Rect(WIDTH - 1, HEIGHT - 1, 0, 0), objectBox());
    }

    @Test
    void growingStopsAtAnEdgeAndWidensTheObjectBox() {
        begin(5, 1);
        Rect changed = stroke(new Point(7, 7), GROW, 0);
        for (int y = 6; y <= 8; ++y) {
            for (int x = 6; x <= 8; ++x) assertEquals(1, at(x, y), "core pixel");
        }
        for (int y = 0; y < HEIGHT; ++y) {
            for (int x = 10; x < WIDTH; ++x) assertEquals(0, at(x, y), "beyond the edge");
        }
        assertEquals(boxOfSelected(), changed);
        assertEquals(changed, objectBox());
    }

    @Test
    void strokeReturnsThePixelsAsTheyWere() {
        begin(5, 1);
        stroke(new Point(7, 7), GROW, 1);
        assertArrayEquals(halfRedHalfBlue(), pixels);
    }

    @Test
    void growingAtTheOutermostPixelsDoesNothing() {
        begin(5, 1);
        Point[] outermost = {new Point(0, 7), new Point(WIDTH - 1, 7), new Point(7, 0),
            new Point(7, HEIGHT - 1)};
        for (Point point : outermost) {
            assertEquals(new Rect(WIDTH, HEIGHT, 0, 0), stroke(point, GROW, 1));
        }
        assertArrayEquals(new byte[WIDTH * HEIGHT], mask);
    }

    @Test
    void fillOneClosesAHoleAndReportsIt() {
        drawRing();
        begin(1, 1);
        Util.set_objectROI(new Rect(2, 2, 4, 4));
        Rect changed = stroke(new Point(10, 10), GROW, 1);
        assertEquals(1, at(3, 3));
        assertEquals(3, changed.left);
        assertEquals(3, changed.top);
    }

    @Test
    void anyOtherFillLeavesTheHole() {
        for (int fill : new int[] {0, 2, -1}) {
            drawRing();
            begin(1, 1);
            Util.set_objectROI(new Rect(2, 2, 4, 4));
            stroke(new Point(10, 10), GROW, fill);
            assertEquals(0, at(3, 3), "fill " + fill);
        }
    }

    @Test
    void inverseSelectsAllButOneAndMeasuresTheBox() {
        byte[] inverted = {1, 0, 1, 1, 2, 1, 1, 1, -1, 1, 1, 1};
        Util.inverse_objectsel(inverted, 4, 3);
        assertArrayEquals(new byte[] {0, 1, 0, 0, 1, 0, 0, 0, 1, 0, 0, 0}, inverted);
        assertEquals(new Rect(0, 0, 1, 2), objectBox());
    }

    @Test
    void inverseOfEverythingLeavesAnEmptyBox() {
        byte[] inverted = new byte[12];
        Arrays.fill(inverted, (byte) 1);
        Util.inverse_objectsel(inverted, 4, 3);
        assertArrayEquals(new byte[12], inverted);
        assertEquals(new Rect(3, 2, 0, 0), objectBox());
    }

    @Test
    void inverseRefusesBadInputAndLeavesTheSession() {
        Util.set_objectROI(new Rect(1, 2, 3, 4));
        byte[] untouched = {0, 1, 2};
        Util.inverse_objectsel(null, 10, 10);
        Util.inverse_objectsel(untouched, 0, 1);
        Util.inverse_objectsel(untouched, 3, -1);
        assertArrayEquals(new byte[] {0, 1, 2}, untouched);
        assertEquals(new Rect(1, 2, 3, 4), objectBox());
    }

    @Test
    void resetClearsExactlyTheGivenSize() {
        byte[] cleared = {1, 5, 1, 1, 1, 1, 1};
        Util.reset_objectsel(cleared, 3, 2);
        assertArrayEquals(new byte[] {0, 0, 0, 0, 0, 0, 1}, cleared);
        assertEquals(new Rect(2, 1, 0, 0), objectBox());
    }

    @Test
    void resetRefusesBadInputAndLeavesTheSession() {
        Util.set_objectROI(new Rect(1, 2, 3, 4));
        byte[] untouched = {0, 1, 2};
        Util.reset_objectsel(null, 10, 10);
        Util.reset_objectsel(untouched, 0, 10);
        Util.reset_objectsel(untouched, 3, 0);
        assertArrayEquals(new byte[] {0, 1, 2}, untouched);
        assertEquals(new Rect(1, 2, 3, 4), objectBox());
    }

    @Test
    void updateShrinksTheBoxAndNeverLooksOutside() {
        mask[3 * WIDTH + 4] = 1;
        mask[5 * WIDTH + 6] = 1;
        mask[9 * WIDTH + 12] = 1;
        Util.set_objectROI(new Rect(2, 2, 8, 8));
        Util.update_objectROI(mask, WIDTH, HEIGHT);
        assertEquals(new Rect(4, 3, 6, 5), objectBox());

        Util.set_objectROI(new Rect(-5, -5, WIDTH + 5, HEIGHT + 5));
        Util.update_objectROI(mask, WIDTH, HEIGHT);
        assertEquals(new Rect(4, 3, 12, 9), objectBox());

        Util.set_objectROI(new Rect(14, 2, 16, 4));
        Util.update_objectROI(mask, WIDTH, HEIGHT);
        assertEquals(new Rect(WIDTH, HEIGHT, 0, 0), objectBox());
    }

    @Test
    void resettingTheFillRectangleAndReinitChangeNothing() {
        mask[20] = 1;
        byte[] before = mask.clone();
        Util.set_objectROI(new Rect(1, 2, 3, 4));
        Util.reset_fill_ROI(30, 40);
        Rect roi = new Rect(5, 6, 7, 8);
        Util.reinit_objectsel(mask, WIDTH, HEIGHT, roi);
        assertArrayEquals(before, mask);
        assertEquals(new Rect(5, 6, 7, 8), roi);
        assertEquals(new Rect(1, 2, 3, 4), objectBox());
    }

    @Test
    void allocatedArraysAreOrdinaryArraysOfZeros() {
        assertArrayEquals(new int[0], Util.nativeIntAlloc(0));
        int[] array = Util.nativeIntAlloc(3);
        assertNotNull(array);
        assertArrayEquals(new int[3], array);
        array[1] = 7;
        assertEquals(0, Util.nativeIntRelease(array));
        assertArrayEquals(new int[] {0, 7, 0}, array);
    }

    @Test
    void releasingNullReturnsZero() {
        assertEquals(0, Util.nativeIntRelease(null));
    }

    @Test
    void allocatingANegativeLengthThrows() {
        assertThrows(NegativeArraySizeException.class, () -> Util.nativeIntAlloc(-1));
    }

    private static void begin(int radius, int center) {
        Util.set_brush_size(radius, center);
        Util.init_objectsel(WIDTH, HEIGHT);
    }

    private Rect stroke(Point point, int mode, int fill) {
        Rect changed = new Rect(5, 7, 6, 8);
        Util.modify_objectsel(pixels, mask, WIDTH, HEIGHT, point, point, mode, changed, fill);
        return changed;
    }

    /** Selects the eight pixels around (3, 3) and nothing else. */
    private void drawRing() {
        Arrays.fill(mask, (byte) 0);
        for (int y = 2; y <= 4; ++y) {
            for (int x = 2; x <= 4; ++x) mask[y * WIDTH + x] = 1;
        }
        mask[3 * WIDTH + 3] = 0;
    }

    private byte at(int x, int y) {
        return mask[y * WIDTH + x];
    }

    private Rect boxOfSelected() {
        Rect box = new Rect(WIDTH, HEIGHT, 0, 0);
        for (int i = 0; i < mask.length; ++i) {
            if (mask[i] != 1) continue;
            box.left = Math.min(box.left, i % WIDTH);
            box.right = Math.max(box.right, i % WIDTH);
            box.top = Math.min(box.top, i / WIDTH);
            box.bottom = Math.max(box.bottom, i / WIDTH);
        }
        return box;
    }

    private static Rect objectBox() {
        Rect box = new Rect();
        Util.get_objectROI(box);
        return box;
    }

    private static int[] halfRedHalfBlue() {
        int[] pixels = new int[WIDTH * HEIGHT];
        for (int i = 0; i < pixels.length; ++i) pixels[i] = i % WIDTH < 10 ? RED : BLUE;
        return pixels;
    }
}
