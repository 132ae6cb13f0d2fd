package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertEquals;

import android.graphics.Point;
import java.util.List;
import org.junit.jupiter.api.Test;

class LassoPathTest {
    @Test
    void cornersNearerThanThreeScreenPixelsToTheLastOneAreLeftOut() {
        LassoPath path = new LassoPath(2);
        path.add(10, 10);
        path.add(15, 10);
        path.add(16, 10);
        path.add(16, 15);
        path.add(20, 15);
        assertEquals(List.of(new Point(10, 10), new Point(16, 10), new Point(20, 15)),
                path.corners());
    }

    @Test
    void enlargedPhotosHaveACornerForEachPixel() {
        LassoPath path = new LassoPath(0.1f);
        path.add(5, 5);
        path.add(5, 5);
        path.add(6, 5);
        assertEquals(List.of(new Point(5, 5), new Point(6, 5)), path.corners());
    }

    @Test
    void cornersOutsideThePhotoAreKept() {
        LassoPath path = new LassoPath(1);
        path.add(-50, -60);
        assertEquals(List.of(new Point(-50, -60)), path.corners());
    }

    @Test
    void pathBeginsWithoutACorner() {
        assertEquals(List.of(), new LassoPath(1).corners());
    }
}
