package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotSame;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertThrows;

import com.velt.android.orvane.lumetrix.desktop.Picture;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.Viewport;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import org.junit.jupiter.api.Test;

class ScreenTest {
    private final Screen screen = new Screen();

    private static Placement placement(int width, int height) {
        Area all = new Area(0, 0, width - 1, height - 1);
        return new Placement(new Viewport(width, height, 1, 0, 0), all, all, 0, 0);
    }

    private void draw(int width, int height, int colour) {
        screen.replace(placement(width, height), ViewKind.PHOTO,
                frame -> Arrays.fill(frame.pixels(), colour));
    }

    private Frame shown() {
        List<Frame> frames = new ArrayList<>();
        screen.look(frames::add);
        return frames.isEmpty() ? null : frames.get(0);
    }

    @Test
    void nothingIsShownAtFirstAndAfterClearing() {
        assertEquals(null, shown());
        screen.change(frame -> Arrays.fill(frame.pixels(), 1));
        draw(2, 1, 5);
        screen.clear();
        assertEquals(null, shown());
    }

    @Test
    void drawingAsideLeavesWhatIsShown() {
        draw(2, 2, 5);
        Frame first = shown();
        screen.replace(placement(2, 2), ViewKind.MASK, frame -> {
            Arrays.fill(frame.pixels(), 6);
            assertArrayEquals(new int[] {5, 5, 5, 5}, shown().pixels());
        });
        assertNotSame(first.pixels(), shown().pixels());
        assertArrayEquals(new int[] {6, 6, 6, 6}, shown().pixels());
        assertEquals(ViewKind.MASK, shown().kind());
    }

    @Test
    void twoBuffersTakeTurnsWhileTheSizeStays() {
        draw(2, 2, 1);
        int[] first = shown().pixels();
        draw(2, 2, 2);
        draw(2, 2, 3);
        assertSame(first, shown().pixels());
        draw(3, 2, 4);
        assertEquals(6, shown().pixels().length);
    }

    @Test
    void failedDrawingLeavesWhatIsShown() {
        draw(2, 1, 5);
        assertThrows(IllegalStateException.class,
                () -> screen.replace(placement(2, 1), ViewKind.MASK, frame -> {
                    throw new IllegalStateException();
                }));
        assertArrayEquals(new int[] {5, 5}, shown().pixels());
    }

    @Test
    void changesAreDrawnInPlace() {
        draw(2, 1, 5);
        screen.change(frame -> frame.pixels()[1] = 7);
        assertArrayEquals(new int[] {5, 7}, shown().pixels());
    }

    @Test
    void whatIsSeenOfAFrameIsCutOut() {
        Area all = new Area(0, 0, 3, 2);
        Frame frame = new Frame(new int[] {0, 1, 2, 3, 10, 11, 12, 13, 20, 21, 22, 23},
                new Placement(new Viewport(4, 3, 1, 0, 0), all, new Area(1, 1, 2, 2), -1, -1),
                ViewKind.PHOTO);
        Picture seen = frame.seen();
        assertEquals(2, seen.width());
        assertEquals(2, seen.height());
        assertArrayEquals(new int[] {11, 12, 21, 22}, seen.pixels());
    }
}
