package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotEquals;

import android.graphics.Point;
import android.graphics.Rect;
import org.junit.jupiter.api.Test;

class StandInsTest {
    @Test
    void rectTakesItsValuesInAndroidsOrder() {
        Rect rect = new Rect(1, 2, 3, 4);
        assertEquals(1, rect.left);
        assertEquals(2, rect.top);
        assertEquals(3, rect.right);
        assertEquals(4, rect.bottom);
        assertEquals("Rect(1, 2 - 3, 4)", rect.toString());
    }

    @Test
    void rectsAreEqualWhenAllFieldsAre() {
        assertEquals(new Rect(0, 0, 0, 0), new Rect());
        assertEquals(new Rect(1, 2, 3, 4), new Rect(1, 2, 3, 4));
        assertEquals(new Rect(1, 2, 3, 4).hashCode(), new Rect(1, 2, 3, 4).hashCode());
        assertNotEquals(new Rect(9, 2, 3, 4), new Rect(1, 2, 3, 4));
        assertNotEquals(new Rect(1, 9, 3, 4), new Rect(1, 2, 3, 4));
        assertNotEquals(new Rect(1, 2, 9, 4), new Rect(1, 2, 3, 4));
        assertNotEquals(new Rect(1, 2, 3, 9), new Rect(1, 2, 3, 4));
    }

    @Test
    void pointsAreEqualWhenBothFieldsAre() {
        assertEquals(new Point(0, 0), new Point());
        assertEquals(new Point(1, 2), new Point(1, 2));
        assertEquals(new Point(1, 2).hashCode(), new Point(1, 2).hashCode());
        assertNotEquals(new Point(9, 2), new Point(1, 2));
        assertNotEquals(new Point(1, 9), new Point(1, 2));
        assertEquals("Point(1, 2)", new Point(1, 2).toString());
    }
}
