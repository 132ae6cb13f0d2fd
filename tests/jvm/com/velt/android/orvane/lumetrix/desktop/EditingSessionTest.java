package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertEquals;

import android.graphics.Point;
import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.MaskDrawing;
import com.velt.android.orvane.lumetrix.jni.Util;
import java.util.List;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

/** What the session hands to the library; masks are told apart by their digest. */
class EditingSessionTest {
    private static final int WIDTH = 8;
    private static final int HEIGHT = 6;
    private static final List<Point> TRIANGLE =
            List.of(new Point(2, 1), new Point(5, 1), new Point(5, 4));

    private final Photo photo = new Photo(WIDTH, HEIGHT, new int[WIDTH * HEIGHT]);
    private final EditingSession session = new EditingSession(photo, CallLog.NONE);

    @AfterEach
    void close() {
        session.close();
    }

    @Test
    void lassoJoinsEachCornerToTheNextAndTheLastToTheFirst() {
        session.setFill(false);
        Rect changed = session.lasso(Mode.LASSO_ADD, TRIANGLE);
        // Where two segments meet, the second finds what the first has drawn: 5.
        assertMask("""
            ........
            ..5##5..
            ...#.#..
            ....##..
            .....5..
            ........""");
        assertEquals(new Rect(2, 1, 5, 4), changed);
    }

    @Test
    void lassoIsFilledOnceItIsClosed() {
        session.lasso(Mode.LASSO_ADD, TRIANGLE);
        assertMask("""
            ........
            ..####..
            ...###..
            ....##..
            .....#..
            ........""");
    }

    @Test
    void removingLassoIsFilledOnceItIsClosed() {
        session.invert();
        Rect changed = session.lasso(Mode.LASSO_REMOVE, TRIANGLE);
        assertMask("""
            ########
            ##....##
            ###...##
            ####..##
            #####.##
            ########""");
        assertEquals(new Rect(2, 1, 5, 4), changed);
    }

    @Test
    void removingLassoWithFillOffStaysOpen() {
        session.invert();
        session.setFill(false);
        session.lasso(Mode.LASSO_REMOVE, TRIANGLE);
        assertMask("""
            ########
            ##3443##
            ###4#4##
            ####44##
            #####3##
            ########""");
    }

    @Test
    void brushCallsOnceAPointAndUnitesWhatChanged() {
        session.setBrush(1, 1);
        Rect changed = session.brush(Mode.PAINT, List.of(new Point(1, 1), new Point(6, 3)));
        assertMask("""
            ##......
            ##......
            .....##.
            .....##.
            ........
            ........""");
        assertEquals(new Rect(0, 0, 6, 3), changed);
        assertEquals(new Rect(0, 0, 6, 3), session.objectBox());
    }

    @Test
    void onlyOnesCountAsSelected() {
        session.setFill(false);
        session.lasso(Mode.LASSO_ADD, TRIANGLE);
        assertEquals(6, session.selectedPixels());
    }

    @Test
    void updatingTheBoxChangesNoPixel() {
        session.setBrush(1, 1);
        session.brush(Mode.PAINT, List.of(new Point(1, 1), new Point(6, 3)));
        session.brush(Mode.ERASE, List.of(new Point(1, 1)));
        assertEquals(new Rect(0, 0, 6, 3), session.objectBox());
        assertEquals(new Rect(WIDTH, HEIGHT, 0, 0), session.updateBox());
        assertEquals(new Rect(5, 2, 6, 3), session.objectBox());
    }

    private void assertMask(String expected) {
        byte[] mask = MaskDrawing.of(expected).cells();
        Viewport port = Viewport.fitting(photo, Digest.VIEW_WIDTH, Digest.VIEW_HEIGHT);
        int[] view = new int[port.width() * port.height()];
        Util.native_drawImageWithMaskContour(view, port.width(), port.height(), photo.pixels(),
                WIDTH, HEIGHT, mask, port.scale(), 0, 0, port.firstColour(), port.secondColour(),
                new Rect(0, 0, port.width() - 1, port.height() - 1));
        assertEquals(Digest.of(mask, view), session.digest(), expected);
    }
}
