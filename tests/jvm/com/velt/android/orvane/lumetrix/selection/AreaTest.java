package com.velt.android.orvane.lumetrix.selection;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import org.junit.jupiter.api.Test;

class AreaTest {
    private static final Area AREA = new Area(2, 3, 5, 9);

    @Test
    void countsItsLastColumnAndRow() {
        assertEquals(4, AREA.width());
        assertEquals(7, AREA.height());
        assertFalse(AREA.isEmpty());
        assertEquals("2..5 x 3..9", AREA.toString());
        assertEquals(1, new Area(7, 7, 7, 7).width());
    }

    @Test
    void emptyOnesAreAllTheSame() {
        for (Area empty : new Area[] {new Area(8, 6, 0, 0), new Area(7, 5, 0, 0),
            new Area(0, 5, 3, 4), new Area(5, 0, 4, 3)}) {
            assertEquals(Area.EMPTY, empty);
            assertEquals(Area.EMPTY.hashCode(), empty.hashCode());
            assertTrue(empty.isEmpty());
            assertEquals(0, empty.width());
            assertEquals(0, empty.height());
            assertEquals("none", empty.toString());
        }
    }

    @Test
    void equalsNothingButAreas() {
        assertFalse(AREA.equals((Object) AREA.toString()));
        assertFalse(AREA.equals(null));
    }

    @Test
    void unionLeavesEmptyOnesOut() {
        assertEquals(AREA, AREA.union(Area.EMPTY));
        assertEquals(AREA, Area.EMPTY.union(AREA));
        assertEquals(new Area(0, 3, 7, 10), AREA.union(new Area(0, 10, 7, 10)));
    }

    @Test
    void intersectionIsWhatBothHave() {
        assertEquals(new Area(4, 3, 5, 6), AREA.intersection(new Area(4, 0, 9, 6)));
        assertEquals(Area.EMPTY, AREA.intersection(new Area(6, 0, 9, 9)));
        assertEquals(Area.EMPTY, AREA.intersection(Area.EMPTY));
        assertEquals(Area.EMPTY, Area.EMPTY.intersection(AREA));
    }

    @Test
    void sideThatNoIntCountsIsRefused() {
        IllegalArgumentException e = assertThrows(IllegalArgumentException.class,
                () -> new Area(0, 0, 0, Integer.MAX_VALUE));
        assertEquals("the rectangle 0..0 x 0..2147483647 has a side of 2147483648, expected up to"
                + " 2147483647", e.getMessage());
        assertEquals(Integer.MAX_VALUE, new Area(1, 0, Integer.MAX_VALUE, 0).width());
    }
}
