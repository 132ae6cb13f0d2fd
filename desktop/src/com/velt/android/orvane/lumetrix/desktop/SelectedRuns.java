package com.velt.android.orvane.lumetrix.desktop;

import java.util.Arrays;

/** The selected pixels of a photo as runs in its rows, in reading order, none reaching another. */
final class SelectedRuns {
    private static final int NUMBERS = 3;

    private int[] numbers = new int[NUMBERS * 16];  // row, first and last column of each
    private int length;

    /**
     * Adds a run behind those before.
     *
     * @param row 0 and up, not above that of the run before
     * @param first 0 and up, in the same row beyond the last column of the run before
     * @param last {@code first} and up
     */
    void add(int row, int first, int last) {
        if (length == numbers.length) numbers = Arrays.copyOf(numbers, 2 * length);
        numbers[length++] = row;
        numbers[length++] = first;
        numbers[length++] = last;
    }

    int count() {
        return length / NUMBERS;
    }

    int row(int i) {
        return numbers[NUMBERS * i];
    }

    int first(int i) {
        return numbers[NUMBERS * i + 1];
    }

    int last(int i) {
        return numbers[NUMBERS * i + 2];
    }

    /** Returns the row of the last run, -1 when there is none. */
    int lastRow() {
        return length == 0 ? -1 : row(count() - 1);
    }

    /** Returns the number of rows that have a run. */
    int rows() {
        int rows = 0;
        for (int i = 0; i < count(); ++i) {
            if (i == 0 || row(i) != row(i - 1)) ++rows;
        }
        return rows;
    }

    /** Returns a mask of a photo that holds all runs: 1 where there is one, 0 elsewhere. */
    byte[] mask(int width, int height) {
        byte[] mask = new byte[width * height];
        for (int i = 0; i < count(); ++i) {
            int start = row(i) * width;
            Arrays.fill(mask, start + first(i), start + last(i) + 1, (byte) 1);
        }
        return mask;
    }

    @Override
    public boolean equals(Object other) {
        return other instanceof SelectedRuns that
                && Arrays.equals(numbers, 0, length, that.numbers, 0, that.length);
    }

    @Override
    public int hashCode() {
        int hash = 0;
        for (int i = 0; i < length; ++i) hash = 31 * hash + numbers[i];
        return hash;
    }

    /** Returns such as {@code 12:5-9 12:14-20}. */
    @Override
    public String toString() {
        StringBuilder text = new StringBuilder();
        for (int i = 0; i < count(); ++i) {
            if (i > 0) text.append(' ');
            text.append(row(i)).append(':').append(first(i)).append('-').append(last(i));
        }
        return text.toString();
    }
}
