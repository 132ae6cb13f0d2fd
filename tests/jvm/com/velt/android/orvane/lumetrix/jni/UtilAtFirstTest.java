package com.velt.android.orvane.lumetrix.jni;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;

import android.graphics.Point;
import android.graphics.Rect;
import org.junit.jupiter.api.Test;

/** What the library says before anything is set; needs a process of its own. */
class UtilAtFirstTest {
    @Test
    void brushIsTenAndOneTheObjectBoxZeroAndNoEngineThere() {
        assertEquals(10, Util.get_brush_radius());
        assertEquals(1, Util.get_brush_center());

        Rect box = new Rect(5, 6, 7, 8);
        Util.get_objectROI(box);
        assertEquals(new Rect(0, 0, 0, 0), box);

        int[] pixels = new int[40 * 30];
        byte[] mask = new byte[40 * 30];
        Rect changed = new Rect(5, 7, 6, 8);
        Util.modify_objectsel(pixels, mask, 40, 30, new Point(20, 15), new Point(20, 15), 0,
                changed, 1);
        assertEquals(new Rect(40, 30, 0, 0), changed);
        assertArrayEquals(new byte[40 * 30], mask);
    }
}
