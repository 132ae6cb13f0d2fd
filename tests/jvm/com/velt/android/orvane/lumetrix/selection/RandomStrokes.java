package com.velt.android.orvane.lumetrix.selection;

import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.jni.Util;
import java.util.Arrays;
import java.util.Random;

/** Does at random whatever a session can do, much of it at the border of a small photo. */
public final class RandomStrokes {
    public static final int WIDTH = 24;
    public static final int HEIGHT = 18;

    private final Random random;
    private final SelectionSession session;

    /** What was done, and the area that the session said had changed, if it says one. */
    public record Deed(String what, Area changed) {
        boolean isUndo() {
            return what.equals("undo");
        }

        boolean isRedo() {
            return what.equals("redo");
        }

        boolean isSelect() {
            return what.startsWith("select ");
        }
    }

    /** Mask and object box, the box as the library holds it. */
    public record State(byte[] mask, Rect box) {
        public static State of(SelectionSession session) {
            Rect box = new Rect();
            Util.get_objectROI(box);
            return new State(session.mask(), box);
        }

        @Override
        public boolean equals(Object other) {
            return other instanceof State that && Arrays.equals(mask, that.mask)
                    && box.equals(that.box);
        }

        @Override
        public int hashCode() {
            return Arrays.hashCode(mask);
        }

        @Override
        public String toString() {
            return box + " " + Arrays.toString(mask);
        }
    }

    public RandomStrokes(Random random, SelectionSession session) {
        this.random = random;
        this.session = session;
    }

    /** Patches of few colours, so that there are edges and flat places. */
    public static int[] photo(Random random) {
        int[] pixels = new int[WIDTH * HEIGHT];
        int colours = 1 + random.nextInt(60);
        for (int i = 0; i < pixels.length; ++i) {
            boolean likeLeft = i % WIDTH > 0 && random.nextInt(3) > 0;
            pixels[i] = likeLeft ? pixels[i - 1] : 0xFF000000 | random.nextInt(colours) * 0x30507;
        }
        return pixels;
    }

    public Deed next() {
        int die = random.nextInt(100);
        if (die < 50) return brush(Mode.values()[random.nextInt(4)]);
        if (die < 60) return lasso(random.nextBoolean() ? Mode.LASSO_ADD : Mode.LASSO_REMOVE);
        if (die < 64) return new Deed("invert", session.invert());
        if (die < 66) return new Deed("reset", session.reset());
        if (die < 69) return new Deed("update-box", session.updateBox());
        if (die < 72) return select();
        if (die < 75) return setBrush();
        if (die < 80) return setFill();
        if (die < 91) return session.canUndo() ? new Deed("undo", session.undo()) : setBrush();
        return session.canRedo() ? new Deed("redo", session.redo()) : setFill();
    }

    private Deed brush(Mode mode) {
        int[] points = points(1 + random.nextInt(4));
        String what = mode + " " + Arrays.toString(points);
        if (random.nextBoolean()) return new Deed(what, session.brush(mode, points));
        session.begin(mode);
        for (int i = 0; i < points.length; i += 2) session.dab(points[i], points[i + 1]);
        return new Deed(what, session.end());
    }

    private Deed lasso(Mode mode) {
        int[] corners = points(3 + random.nextInt(3));
        if (random.nextInt(4) == 0) {
            int again = 2 * random.nextInt(corners.length / 2);
            int at = 2 * random.nextInt(corners.length / 2);
            corners[at] = corners[again];
            corners[at + 1] = corners[again + 1];
        }
        return new Deed(mode + " " + Arrays.toString(corners), session.lasso(mode, corners));
    }

    /** Takes over what is selected, a rectangle, or noise. */
    private Deed select() {
        byte[] selection = session.mask();
        int kind = random.nextInt(4);
        if (kind > 0) Arrays.fill(selection, (byte) 0);
        if (kind == 1) {
            int[] corners = points(2);
            for (int y = corners[1]; y <= corners[3]; ++y) {
                for (int x = corners[0]; x <= corners[2]; ++x) selection[y * WIDTH + x] = 1;
            }
        }
        if (kind > 1) {
            int values = 1 + random.nextInt(6);
            for (int i = 0; i < selection.length; ++i) selection[i] = (byte) random.nextInt(values);
        }
        return new Deed("select " + Arrays.toString(selection), session.select(selection));
    }

    private Deed setBrush() {
        int radius = random.nextInt(8);
        int core = random.nextInt(4);
        session.setBrush(radius, core);
        return new Deed("brush " + radius + " " + core, Area.EMPTY);
    }

    private Deed setFill() {
        boolean on = random.nextInt(3) > 0;
        session.setFill(on);
        return new Deed("fill " + on, Area.EMPTY);
    }

    private int[] points(int count) {
        int[] points = new int[2 * count];
        for (int i = 0; i < points.length; i += 2) {
            points[i] = coordinate(WIDTH);
            points[i + 1] = coordinate(HEIGHT);
        }
        return points;
    }

    private int coordinate(int size) {
        int nearBorder = random.nextInt(3);
        switch (random.nextInt(5)) {
            case 0:
                return nearBorder;
            case 1:
                return size - 1 - nearBorder;
            default:
                return random.nextInt(size);
        }
    }
}
