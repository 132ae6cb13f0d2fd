package com.velt.android.orvane.lumetrix.selection;

/** Refusals of arguments: each says what was given and what is allowed. */
final class Checks {
    private Checks() {}

    static void notNull(String what, Object value) {
        if (value == null) throw new NullPointerException(what + " is null, expected one");
    }

    static void range(String what, long value, long least, long most) {
        if (value >= least && value <= most) return;
        throw new IllegalArgumentException(
                what + " is " + value + ", expected " + least + " to " + most);
    }

    /** Refuses sizes that are no picture's: sides below 1, or more pixels than an array holds. */
    static void size(String what, int width, int height) {
        range("the width of the " + what, width, 1, Integer.MAX_VALUE);
        range("the height of the " + what, height, 1, Integer.MAX_VALUE);
        long pixels = (long) width * height;
        if (pixels <= Integer.MAX_VALUE) return;
        throw new IllegalArgumentException("the " + what + " has " + width + " x " + height + " = "
                + pixels + " pixels, expected up to " + Integer.MAX_VALUE);
    }

    /** Within these sides the number of pixels cannot overflow. */
    static void photoSize(int width, int height) {
        range("the width of the photo", width, 1, SelectionSession.LONGEST_SIDE);
        range("the height of the photo", height, 1, SelectionSession.LONGEST_SIDE);
    }

    /** Refuses an array of another length than that of its picture, whose size is right. */
    static void length(String what, int length, int width, int height) {
        if (length == width * height) return;
        throw new IllegalArgumentException(what + " has " + length + " elements, expected " + width
                + " x " + height + " = " + width * height);
    }

    static void pointInside(int x, int y, int width, int height) {
        if (x >= 0 && x < width && y >= 0 && y < height) return;
        throw new IndexOutOfBoundsException("the point " + x + "," + y
                + " lies outside the photo, expected 0,0 to " + (width - 1) + "," + (height - 1));
    }

    /** Refuses points, columns and rows by turns, of which there are too few or one is outside. */
    static void pointsInside(int[] points, int fewest, int width, int height) {
        notNull("the array of points", points);
        if (points.length % 2 != 0) {
            throw new IllegalArgumentException("there are " + points.length
                    + " coordinates, expected an even number: columns and rows by turns");
        }
        if (points.length < 2 * fewest) {
            throw new IllegalArgumentException("there are " + points.length / 2
                    + " points, expected at least " + fewest);
        }
        for (int i = 0; i < points.length; i += 2) {
            pointInside(points[i], points[i + 1], width, height);
        }
    }

    static void partInside(Area part, String what, int width, int height) {
        notNull("the rectangle to draw", part);
        Area whole = Area.ofSize(width, height);
        if (part.intersection(whole).equals(part)) return;
        throw new IndexOutOfBoundsException("the rectangle " + part + " reaches beyond the " + what
                + ", expected one in " + whole);
    }
}
