package com.velt.android.orvane.lumetrix;

import java.util.Arrays;
import java.util.List;

/**
 * A mask drawn as text: {@code .} is 0, {@code #} is 1, {@code 2} to {@code 9} are themselves.
 * Lines are rows.
 *
 * <p>Two are equal when they look the same; a test compares them as wholes and prints both.
 */
public record MaskDrawing(int width, int height, byte[] cells) {
    private static final String SIGNS = ".#23456789";

    public static MaskDrawing of(String drawing) {
        List<String> rows = drawing.strip().lines().map(String::strip).toList();
        int width = rows.get(0).length();
        byte[] cells = new byte[width * rows.size()];
        int i = 0;
        for (String row : rows) {
            if (row.length() != width) throw new IllegalArgumentException("a ragged row: " + row);
            for (char sign : row.toCharArray()) {
                int value = SIGNS.indexOf(sign);
                if (value < 0) throw new IllegalArgumentException("no cell of a mask: " + sign);
                cells[i++] = (byte) value;
            }
        }
        return new MaskDrawing(width, rows.size(), cells);
    }

    @Override
    public boolean equals(Object other) {
        return other instanceof MaskDrawing that && width == that.width && height == that.height
                && Arrays.equals(cells, that.cells);
    }

    @Override
    public int hashCode() {
        return Arrays.hashCode(cells);
    }

    @Override
    public String toString() {
        StringBuilder text = new StringBuilder();
        for (int i = 0; i < cells.length; ++i) {
            if (i % width == 0) text.append('\n');
            boolean drawable = cells[i] >= 0 && cells[i] < SIGNS.length();
            text.append(drawable ? SIGNS.charAt(cells[i]) : '?');
        }
        return text.append('\n').toString();
    }
}
