package com.velt.android.orvane.lumetrix.selection;

import java.util.Arrays;

/**
 * The selected pixels of a mask as runs: three numbers each, row, first and last column, in reading
 * order. Each run is as long as can be.
 */
final class PixelRuns {
    private static final int NUMBERS = 3;

    private PixelRuns() {}

    /** Returns the runs of value 1. */
    static int[] of(byte[] mask, int width) {
        int[] runs = new int[NUMBERS * count(mask, width)];
        int length = 0;
        for (int start = 0; start < mask.length; start += width) {
            int end = start + width;
            for (int i = start; i < end; ++i) {
                if (mask[i] != 1) continue;
                runs[length++] = start / width;
                runs[length++] = i - start;
                while (i < end && mask[i] == 1) ++i;
                runs[length++] = i - 1 - start;
            }
        }
        return runs;
    }

    private static int count(byte[] mask, int width) {
        int count = 0;
        for (int start = 0; start < mask.length; start += width) {
            for (int i = start; i < start + width; ++i) {
                boolean begins = mask[i] == 1 && (i == start || mask[i - 1] != 1);
                if (begins) ++count;
            }
        }
        return count;
    }

    /** Makes the pixels of the runs 1 and all others 0. */
    static void write(int[] runs, byte[] mask, int width) {
        Arrays.fill(mask, (byte) 0);
        for (int i = 0; i < runs.length; i += NUMBERS) {
            int start = runs[i] * width;
            Arrays.fill(mask, start + runs[i + 1], start + runs[i + 2] + 1, (byte) 1);
        }
    }

    /** Returns the words of a script that stand for the runs, a row each, a blank before each. */
    static String words(int[] runs) {
        StringBuilder words = new StringBuilder();
        int row = -1;
        for (int i = 0; i < runs.length; i += NUMBERS) {
            if (runs[i] == row) {
                words.append(',');
            } else {
                row = runs[i];
                words.append(' ').append(row).append(':');
            }
            words.append(runs[i + 1]).append('-').append(runs[i + 2]);
        }
        return words.toString();
    }
}
