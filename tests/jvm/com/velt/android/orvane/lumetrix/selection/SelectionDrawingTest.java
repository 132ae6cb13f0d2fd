package com.velt.android.orvane.lumetrix.selection;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;

import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.jni.Util;
import java.util.Arrays;
import java.util.Random;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** Pictures of a session are those of the library. */
class SelectionDrawingTest {
    private static final int WIDTH = 12;
    private static final int HEIGHT = 10;
    private static final int FIRST = 0xFFFF0000;
    private static final int SECOND = 0xFF00FF00;
    private static final Area PART = new Area(1, 2, 8, 6);
    private static final Viewport PORT = new Viewport(10, 8, 1.25f, -1, 1);

    private final int[] photo = new Random(7).ints(WIDTH * HEIGHT).toArray();
    private final int[] expected = new int[PORT.width() * PORT.height()];
    private final int[] actual = new int[PORT.width() * PORT.height()];
    private final int[] expectedPicture = new int[WIDTH * HEIGHT];
    private final int[] actualPicture = new int[WIDTH * HEIGHT];
    private SelectionSession session;

    @BeforeEach
    void selectSomething() {
        session = new SelectionSession(photo, WIDTH, HEIGHT);
        session.setBrush(3, 1);
        session.brush(Mode.PAINT, 5, 4);
        Arrays.fill(expected, 0x12345678);
        Arrays.fill(actual, 0x12345678);
    }

    @AfterEach
    void close() {
        session.close();
    }

    @Test
    void plainView() {
        Util.native_drawImage(expected, 10, 8, photo, WIDTH, HEIGHT, 1.25f, -1, 1, rect(PART));
        session.drawPlainView(actual, PORT, PART);
        assertDrawn();
    }

    @Test
    void outlinedView() {
        Util.native_drawImageWithMaskContour(expected, 10, 8, photo, WIDTH, HEIGHT, session.mask(),
                1.25f, -1, 1, FIRST, SECOND, rect(PART));
        session.drawOutlinedView(actual, PORT, PART, FIRST, SECOND);
        assertDrawn();
    }

    @Test
    void plainSmallView() {
        Util.native_drawSmallImage(expected, 10, 8, photo, WIDTH, HEIGHT, rect(PART));
        session.drawPlainSmallView(actual, 10, 8, PART);
        assertDrawn();
    }

    @Test
    void outlinedSmallView() {
        Util.native_drawSmallImageWithMaskContour(expected, 10, 8, photo, WIDTH, HEIGHT,
                session.mask(), FIRST, SECOND, rect(PART));
        session.drawOutlinedSmallView(actual, 10, 8, PART, FIRST, SECOND);
        assertDrawn();
    }

    @Test
    void colourOnGreyOfAPart() {
        Util.draw_withmask(photo, expectedPicture, session.mask(), WIDTH, rect(PART));
        session.drawColourOnGrey(actualPicture, PART);
        assertFalse(Arrays.equals(new int[WIDTH * HEIGHT], actualPicture));
        assertArrayEquals(expectedPicture, actualPicture);
        assertEquals(0, actualPicture[0]);
    }

    @Test
    void reverseLeavesTheSelection() {
        byte[] mask = session.mask();
        session.drawReverse(actualPicture);
        assertArrayEquals(mask, session.mask());
        Util.draw_reversemask(photo, expectedPicture, mask, WIDTH, HEIGHT);
        assertArrayEquals(expectedPicture, actualPicture);
    }

    @Test
    void emptyPartDrawsNothing() {
        session.drawPlainView(actual, PORT, Area.EMPTY);
        session.drawOutlinedView(actual, PORT, Area.EMPTY, FIRST, SECOND);
        session.drawPlainSmallView(actual, 10, 8, Area.EMPTY);
        session.drawOutlinedSmallView(actual, 10, 8, Area.EMPTY, FIRST, SECOND);
        assertArrayEquals(expected, actual);
        session.drawColourOnGrey(actualPicture, Area.EMPTY);
        assertArrayEquals(expectedPicture, actualPicture);
    }

    @Test
    void strokeIsSeenBeforeItsEnd() {
        session.begin(Mode.ERASE);
        session.dab(5, 4);
        int[] during = actual.clone();
        session.drawOutlinedView(during, PORT, PART, FIRST, SECOND);
        session.end();
        session.drawOutlinedView(actual, PORT, PART, FIRST, SECOND);
        assertArrayEquals(actual, during);
        session.undo();
        session.drawOutlinedView(actual, PORT, PART, FIRST, SECOND);
        assertFalse(Arrays.equals(actual, during));
    }

    @Test
    void fittingViewportShowsTheWholePhoto() {
        assertEquals(new Viewport(640, 480, 2.5f, 0, 0), Viewport.fitting(1600, 900, 640, 480));
        assertEquals(new Viewport(640, 480, 3f, 0, 0), Viewport.fitting(1600, 1440, 640, 480));
        assertEquals(new Area(0, 0, 639, 479), Viewport.fitting(1, 1, 640, 480).area());
    }

    private void assertDrawn() {
        assertEquals(0x12345678, actual[0]);
        int[] untouched = new int[actual.length];
        Arrays.fill(untouched, 0x12345678);
        assertFalse(Arrays.equals(untouched, actual));
        assertArrayEquals(expected, actual);
    }

    private static Rect rect(Area area) {
        return new Rect(area.left(), area.top(), area.right(), area.bottom());
    }
}
