package com.velt.android.orvane.lumetrix.selection;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.util.Arrays;
import java.util.Random;
import org.junit.jupiter.api.Test;

class MaskChangeTest {
    @Test
    void runsOfAnyLengthAndDistanceComeBack() {
        int width = 70_000;
        for (int distance : new int[] {0, 1, 127, 128, 16_383, 16_384}) {
            for (int length : new int[] {1, 127, 128, 16_383, 16_384, 40_000}) {
                byte[] before = new byte[width];
                byte[] after = new byte[width];
                Arrays.fill(after, distance, distance + length, (byte) 5);
                Area changed = new Area(distance, 0, distance + length - 1, 0);
                assertReturns(before, after, width, changed);
            }
        }
    }

    @Test
    void allPairsOfValuesComeBack() {
        Random random = new Random(1);
        for (int round = 0; round < 200; ++round) {
            byte[] before = new byte[15];
            byte[] after = new byte[15];
            for (int i = 0; i < before.length; ++i) {
                before[i] = (byte) random.nextInt(6);
                after[i] = (byte) random.nextInt(6);
            }
            after[0] = (byte) (before[0] ^ 1);
            after[14] = (byte) (before[14] ^ 1);
            assertReturns(before, after, 5, new Area(0, 0, 4, 2));
        }
    }

    @Test
    void outsideTheAreaNothingIsLookedAt() {
        byte[] before = new byte[12];
        byte[] after = new byte[12];
        Arrays.fill(after, (byte) 1);
        MaskChange change = MaskChange.take(after, before, 4, new Area(1, 1, 2, 1), 1000);
        assertEquals(new Area(1, 1, 2, 1), change.area());
        assertArrayEquals(new byte[] {0, 0, 0, 0, 0, 1, 1, 0, 0, 0, 0, 0}, before);
    }

    @Test
    void changeOfExactlyTheLimitIsKeptAndALargerOneOnlyMeasured() {
        byte[] after = {1, 0, 1, 0, 1, 0};  // three runs of three bytes
        assertFalse(MaskChange.take(after, new byte[6], 6, new Area(0, 0, 5, 0), 9).isTooLarge());
        byte[] copy = new byte[6];
        MaskChange larger = MaskChange.take(after, copy, 6, new Area(0, 0, 5, 0), 8);
        assertTrue(larger.isTooLarge());
        assertEquals(new Area(0, 0, 4, 0), larger.area());
        assertArrayEquals(after, copy);
        assertTrue(MaskChange.take(after, after.clone(), 6, Area.EMPTY, -1).isTooLarge());
    }

    private static void assertReturns(byte[] before, byte[] after, int width, Area changed) {
        byte[] copy = before.clone();
        Area whole = Area.ofSize(width, before.length / width);
        MaskChange change = MaskChange.take(after, copy, width, whole, 1000);
        assertEquals(changed, change.area());
        assertArrayEquals(after, copy);

        byte[] mask = after.clone();
        change.apply(false, mask, copy);
        assertArrayEquals(before, mask);
        assertArrayEquals(before, copy);
        change.apply(true, mask, copy);
        assertArrayEquals(after, mask);
        assertArrayEquals(after, copy);
    }
}
