package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertEquals;

import android.graphics.Point;
import java.util.ArrayList;
import java.util.List;
import org.junit.jupiter.api.Test;

class DabPathTest {
    @Test
    void spacingIsHalfTheRadiusAndAtLeastOne() {
        assertEquals(1, DabPath.spacing(0));
        assertEquals(1, DabPath.spacing(3));
        assertEquals(2, DabPath.spacing(4));
        assertEquals(14, DabPath.spacing(28));
    }

    @Test
    void separatePointsAreOneDabEach() {
        DabPath path = new DabPath(List.of(stop(1, 2, false), stop(90, 70, false)));
        assertEquals(points(1, 2, 90, 70), path.dabs(5));
    }

    @Test
    void joinedPointsAreBridgedInEqualStepsNoLongerThanTheSpacing() {
        assertEquals(points(0, 0, 4, 2, 8, 4, 12, 6), joined(0, 0, 12, 6).dabs(4));
        assertEquals(points(0, 0, 3, 0, 7, 0, 10, 0), joined(0, 0, 10, 0).dabs(4));
    }

    @Test
    void halvesRoundUpInEitherDirection() {
        assertEquals(points(0, 0, 3, 1, 5, 1), joined(0, 0, 5, 1).dabs(4));
        assertEquals(points(5, 1, 3, 1, 0, 0), joined(5, 1, 0, 0).dabs(4));
    }

    @Test
    void joinedPointWithinOneStepOrTheSameIsOneDab() {
        assertEquals(points(3, 3, 5, 3), joined(3, 3, 5, 3).dabs(2));
        assertEquals(points(3, 3, 3, 3), joined(3, 3, 3, 3).dabs(2));
    }

    @Test
    void pathMixesJoinedAndSeparatePoints() {
        DabPath path = new DabPath(
                List.of(stop(0, 0, false), stop(0, 4, true), stop(9, 9, false)));
        assertEquals(points(0, 0, 0, 2, 0, 4, 9, 9), path.dabs(2));
        assertEquals(points(0, 0, 0, 4, 9, 9), path.points());
    }

    private static DabPath joined(int x0, int y0, int x1, int y1) {
        return new DabPath(List.of(stop(x0, y0, false), stop(x1, y1, true)));
    }

    private static DabPath.Stop stop(int x, int y, boolean joined) {
        return new DabPath.Stop(new Point(x, y), joined);
    }

    private static List<Point> points(int... values) {
        List<Point> points = new ArrayList<>();
        for (int i = 0; i < values.length; i += 2) points.add(new Point(values[i], values[i + 1]));
        return points;
    }
}
