package com.velt.android.orvane.lumetrix.selection;

import java.nio.ByteBuffer;
import java.util.Arrays;

/**
 * What a step changed in a mask, as runs of pixels that had one value before and have another one
 * after.
 *
 * <p>A run is the number of pixels since the end of the run before it, its length, and a byte of
 * both values (before * 16 + after). The numbers are written 7 bits a byte, the lowest first, the
 * highest bit telling that more follow. No run goes on from one row to the next.
 */
final class MaskChange {
    private static final int FIRST_CAPACITY = 64;
    private static final int LONGEST_RUN = 5 + 5 + 1;  // bytes

    private final int width;
    private final int most;
    private byte[] runs = new byte[FIRST_CAPACITY];
    private int length;
    private int end;
    private Area area = Area.EMPTY;

    /** Begins without a run; {@code most} is the number of bytes beyond which runs are given up. */
    private MaskChange(int width, long most) {
        this.width = width;
        this.most = (int) Math.min(most, Integer.MAX_VALUE - LONGEST_RUN);
    }

    /**
     * Returns where {@code mask} differs from {@code earlier}, a copy from before the step, and
     * brings the copy up to date.
     *
     * @param area outside it nothing differs
     * @param most a change of more bytes cannot be applied and {@link #isTooLarge}
     */
    static MaskChange take(byte[] mask, byte[] earlier, int width, Area area, long most) {
        MaskChange change = new MaskChange(width, most);
        ByteBuffer after = ByteBuffer.wrap(mask);
        ByteBuffer before = ByteBuffer.wrap(earlier);
        for (int y = area.top(); y <= area.bottom(); ++y) {
            int end = y * width + area.right() + 1;
            int i = firstDifference(before, after, y * width + area.left(), end);
            while (i < end) {
                int start = i;
                i = endOfRun(earlier, mask, start, end);
                change.add(start, i, earlier[start], mask[start]);
                Arrays.fill(earlier, start, i, mask[start]);
                i = firstDifference(before, after, i, end);
            }
        }
        change.runs = change.isTooLarge() ? null : Arrays.copyOf(change.runs, change.length);
        return change;
    }

    private static int firstDifference(ByteBuffer one, ByteBuffer other, int from, int end) {
        int i = from;
        while (end - i >= Long.BYTES && one.getLong(i) == other.getLong(i)) i += Long.BYTES;
        while (i < end && one.get(i) == other.get(i)) ++i;
        return i;
    }

    private static int endOfRun(byte[] before, byte[] after, int start, int end) {
        int i = start + 1;
        while (i < end && before[i] == before[start] && after[i] == after[start]) ++i;
        return i;
    }

    private void add(int start, int stop, byte before, byte after) {
        int y = start / width;
        area = area.union(new Area(start - y * width, y, stop - 1 - y * width, y));
        if (isTooLarge()) return;
        if (length + LONGEST_RUN > runs.length) {
            runs = Arrays.copyOf(runs, (int) Math.min(2L * runs.length, (long) most + LONGEST_RUN));
        }
        addNumber(start - end);
        addNumber(stop - start);
        runs[length++] = (byte) (before << 4 | after);
        end = stop;
    }

    private void addNumber(int number) {
        for (; number >= 128; number >>= 7) runs[length++] = (byte) (number | 128);
        runs[length++] = (byte) number;
    }

    /** Writes the values from before or after the step into both masks. */
    void apply(boolean after, byte[] mask, byte[] copy) {
        int start = 0;
        for (int at = 0; at < runs.length; ) {
            int[] numbers = new int[2];
            for (int i = 0; i < 2; ++i) {
                int shift = 0;
                for (; runs[at] < 0; shift += 7) numbers[i] |= (runs[at++] & 127) << shift;
                numbers[i] |= runs[at++] << shift;
            }
            int values = runs[at++] & 255;
            start += numbers[0];
            int stop = start + numbers[1];
            byte value = (byte) (after ? values & 15 : values >> 4);
            Arrays.fill(mask, start, stop, value);
            Arrays.fill(copy, start, stop, value);
            start = stop;
        }
    }

    /** Returns the smallest rectangle around all pixels that changed. */
    Area area() {
        return area;
    }

    boolean isTooLarge() {
        return length > most;
    }

    int bytes() {
        return length;
    }
}
