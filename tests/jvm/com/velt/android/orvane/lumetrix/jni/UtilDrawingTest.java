package com.velt.android.orvane.lumetrix.jni;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;

import android.graphics.Rect;
import org.junit.jupiter.api.Test;

class UtilDrawingTest {
    private static final int[] PHOTO = {0xFF102030, 0x80FF0000, 0xFF0000FF,
                                        0xFFFFFFFF, 0x00030303, 0xFF000102};
    private static final int[] GREY = {0xFF202020, 0x80555555, 0xFF555555,
                                       0xFFFFFFFF, 0x00030303, 0xFF010101};
    private static final Rect WHOLE = new Rect(0, 0, 2, 1);
    private static final int FIRST = 0xFFFFFFFE;
    private static final int SECOND = 0xFF000001;

    @Test
    void withMaskOnlyOneCountsAsSelected() {
        byte[] mask = {1, 0, 2, -1, 1, 3};
        int[] drawn = new int[6];
        Util.draw_withmask(PHOTO.clone(), drawn, mask, 3, WHOLE);
        assertArrayEquals(
                new int[] {PHOTO[0], GREY[1], GREY[2], GREY[3], PHOTO[4], GREY[5]}, drawn);
        assertArrayEquals(new byte[] {1, 0, 2, -1, 1, 3}, mask);
    }

    @Test
    void withMaskDrawsOnlyItsRectangle() {
        int[] drawn = new int[6];
        Util.draw_withmask(PHOTO.clone(), drawn, new byte[6], 3, new Rect(1, 1, 2, 1));
        assertArrayEquals(new int[] {0, 0, 0, 0, GREY[4], GREY[5]}, drawn);
    }

    @Test
    void withMaskDrawsNothingInATurnedOverRectangle() {
        int[] drawn = new int[6];
        Util.draw_withmask(PHOTO.clone(), drawn, new byte[6], 3, new Rect(0, 1, 2, 0));
        Util.draw_withmask(PHOTO.clone(), drawn, new byte[6], 3, new Rect(2, 0, 1, 1));
        assertArrayEquals(new int[6], drawn);
    }

    @Test
    void withMaskMayDrawOverThePhotoItself() {
        int[] photo = PHOTO.clone();
        Util.draw_withmask(photo, photo, new byte[6], 3, WHOLE);
        assertArrayEquals(GREY, photo);
    }

    @Test
    void reverseMaskTwiceDrawsBothPicturesAndRestoresTheMask() {
        byte[] mask = {1, 0, 0, 1, 1, 0};
        int[] drawn = new int[6];
        Util.draw_reversemask(PHOTO.clone(), drawn, mask, 3, 2);
        assertArrayEquals(
                new int[] {GREY[0], PHOTO[1], PHOTO[2], GREY[3], GREY[4], PHOTO[5]}, drawn);
        assertArrayEquals(new byte[] {0, 1, 1, 0, 0, 1}, mask);

        Util.draw_reversemask(PHOTO.clone(), drawn, mask, 3, 2);
        assertArrayEquals(
                new int[] {PHOTO[0], GREY[1], GREY[2], PHOTO[3], PHOTO[4], GREY[5]}, drawn);
        assertArrayEquals(new byte[] {1, 0, 0, 1, 1, 0}, mask);
    }

    @Test
    void imageIsRepeatedBeyondThePhotosEdge() {
        int[] view = new int[4 * 3];
        assertEquals(1, Util.native_drawImage(view, 4, 3, PHOTO.clone(), 3, 2, 1f, 0, 0,
                new Rect(0, 0, 3, 2)));
        assertArrayEquals(new int[] {
            PHOTO[0], PHOTO[1], PHOTO[2], PHOTO[2],
            PHOTO[3], PHOTO[4], PHOTO[5], PHOTO[5],
            PHOTO[3], PHOTO[4], PHOTO[5], PHOTO[5]}, view);
    }

    @Test
    void imageFollowsScaleAndOffset() {
        int[] view = new int[4];
        Util.native_drawImage(view, 4, 1, PHOTO.clone(), 3, 2, 0.5f, 1, 1, new Rect(0, 0, 3, 0));
        assertArrayEquals(new int[] {PHOTO[4], PHOTO[4], PHOTO[5], PHOTO[5]}, view);
    }

    @Test
    void imageClampsNegativeOffsets() {
        int[] view = new int[4];
        Util.native_drawImage(view, 4, 1, PHOTO.clone(), 3, 2, 1f, -2, -7, new Rect(0, 0, 3, 0));
        assertArrayEquals(new int[] {PHOTO[0], PHOTO[0], PHOTO[0], PHOTO[1]}, view);
    }

    @Test
    void turnedOverRectanglesDrawNothingAndReturnOne() {
        int[] view = new int[9];
        for (Rect rect : new Rect[] {new Rect(0, 2, 2, 1), new Rect(2, 0, 1, 2)}) {
            assertEquals(1,
                    Util.native_drawImage(view, 3, 3, PHOTO.clone(), 3, 2, 1f, 0, 0, rect));
            assertEquals(1, Util.native_drawSmallImage(view, 3, 3, PHOTO.clone(), 3, 2, rect));
            assertEquals(1, Util.native_drawSmallImageWithMaskContour(view, 3, 3, PHOTO.clone(), 3,
                    2, new byte[6], FIRST, SECOND, rect));
        }
        assertArrayEquals(new int[9], view);
    }

    @Test
    void imagePointsAreThePositionsOfTheImageWithoutClamping() {
        int[] points = new int[13];
        Util.native_setImagePoints(11, 2, 0, 0, 0.3f, 100, -5, points);
        assertArrayEquals(
                new int[] {100, 100, 100, 100, 101, 101, 101, 102, 102, 102, 102, -5, -5}, points);
        Util.native_setImagePoints(0, 0, 0, 0, 1f, 9, 9, points);
        assertEquals(100, points[0]);
    }

    @Test
    void smallImageStartsAtTheRectanglesCorner() {
        int[] view = new int[4 * 4];
        assertEquals(1, Util.native_drawSmallImage(view, 4, 4, PHOTO.clone(), 3, 2,
                new Rect(2, 1, 3, 3)));
        assertArrayEquals(new int[] {
            0, 0, 0, 0,
            0, 0, PHOTO[0], PHOTO[1],
            0, 0, PHOTO[3], PHOTO[4],
            0, 0, PHOTO[3], PHOTO[4]}, view);
    }

    @Test
    void smallImageOutlinesASinglePixel() {
        int[] photo = new int[9];
        byte[] mask = {0, 0, 0, 0, 1, 0, 0, 0, 0};
        int[] view = new int[9];
        assertEquals(1, Util.native_drawSmallImageWithMaskContour(view, 3, 3, photo, 3, 3, mask,
                FIRST, SECOND, new Rect(0, 0, 2, 2)));
        assertArrayEquals(new int[] {0, 0, 0, 0, FIRST, 0, 0, 0, 0}, view);
    }

    @Test
    void contourWithoutSelectionIsThePhotoRoundedToNearest() {
        int[] view = new int[4];
        assertEquals(1, Util.native_drawImageWithMaskContour(view, 4, 1, PHOTO.clone(), 3, 2,
                new byte[6], 0.5f, 0, 0, FIRST, SECOND, new Rect(0, 0, 3, 0)));
        assertArrayEquals(new int[] {PHOTO[0], PHOTO[1], PHOTO[1], PHOTO[2]}, view);
    }

    @Test
    void contourIsOneViewPixelWideAndDashedInSquaresOfFive() {
        int side = 20;
        byte[] mask = new byte[25];
        mask[2 * 5 + 2] = 1;
        int[] view = new int[side * side];
        Util.native_drawImageWithMaskContour(view, side, side, new int[25], 5, 5, mask, 0.25f, 0,
                0, FIRST, SECOND, new Rect(0, 0, side - 1, side - 1));
        // Photo pixel (2, 2) covers the view columns and rows 6 to 9.
        for (int y = 0; y < side; ++y) {
            for (int x = 0; x < side; ++x) {
                boolean inside = x >= 6 && x <= 9 && y >= 6 && y <= 9;
                boolean edge = inside && (x == 6 || x == 9 || y == 6 || y == 9);
                assertEquals(edge ? FIRST : 0, view[y * side + x], x + "," + y);
            }
        }
    }

    @Test
    void contourDrawsSelectedPixelsOnTheRectanglesEdgeInDashes() {
        byte[] mask = {1, 1, 1, 1, 1, 1, 1, 1, 1};
        int side = 7;
        int[] view = new int[side * side];
        Util.native_drawImageWithMaskContour(view, side, side, new int[9], 3, 3, mask, 0.3f, 0, 0,
                FIRST, SECOND, new Rect(0, 0, side - 1, side - 1));
        for (int y = 0; y < side; ++y) {
            for (int x = 0; x < side; ++x) {
                boolean edge = x == 0 || y == 0 || x == side - 1 || y == side - 1;
                int dash = (x / 5 + y / 5) % 2 == 0 ? FIRST : SECOND;
                assertEquals(edge ? dash : 0, view[y * side + x], x + "," + y);
            }
        }
    }
}
