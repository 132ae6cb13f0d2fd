package com.velt.android.orvane.lumetrix.desktop;

import android.graphics.Point;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.Mode;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.util.List;
import java.util.function.Function;
import java.util.stream.IntStream;

/** One line of a script, after the photo. */
public sealed interface Command {
    /** Returns the line in the script, counted from 1. */
    int line();

    /** Throws when the command does not fit the photo. */
    default void check(Photo photo) throws ScriptException {}

    /** Performs the command. */
    void perform(Stage stage) throws OutputException;

    /** Sets the brush for the strokes that follow. */
    record Brush(int line, int radius, int core) implements Command {
        @Override
        public void perform(Stage stage) {
            stage.session().setBrush(radius, core);
        }
    }

    /** Switches filling on or off for the strokes that follow. */
    record Fill(int line, boolean on) implements Command {
        @Override
        public void perform(Stage stage) {
            stage.session().setFill(on);
        }
    }

    /** A stroke of the brush: grow, shrink, paint or erase. */
    record Stroke(int line, Mode mode, DabPath path) implements Command {
        @Override
        public void check(Photo photo) throws ScriptException {
            checkInside(path.points(), photo, line);
        }

        @Override
        public void perform(Stage stage) {
            int spacing = DabPath.spacing(stage.session().brushRadius());
            List<Point> dabs = path.dabs(spacing);
            Area changed = draw(dabs, stage);
            String where = span(path.points()) + " " + count(dabs.size(), "dab");
            stage.done(line, mode.toString(), where, changed);
        }

        private Area draw(List<Point> dabs, Stage stage) {
            Area changed;
            stage.session().begin(mode);
            try {
                for (Point dab : dabs) {
                    stage.beforeDab();
                    stage.session().dab(dab.x, dab.y);
                }
            } finally {
                changed = stage.session().end();
            }
            return changed;
        }
    }

    /** A closed lasso, adding or removing. */
    record Lasso(int line, Mode mode, List<Point> corners) implements Command {
        @Override
        public void check(Photo photo) throws ScriptException {
            checkInside(corners, photo, line);
        }

        @Override
        public void perform(Stage stage) {
            Area changed = stage.session().lasso(mode, coordinates(corners));
            String where = span(corners) + " " + count(corners.size(), "corner");
            stage.done(line, mode.toString(), where, changed);
        }
    }

    /** Something done to the whole selection. */
    record Whole(int line, String what, Function<SelectionSession, Area> operation)
            implements Command {
        @Override
        public void perform(Stage stage) {
            stage.done(line, what, "", operation.apply(stage.session()));
        }
    }

    /** A selection in place of the one before. */
    record Select(int line, SelectedRuns runs) implements Command {
        @Override
        public void check(Photo photo) throws ScriptException {
            for (int i = 0; i < runs.count(); ++i) {
                boolean inside = runs.row(i) < photo.height() && runs.last(i) < photo.width();
                if (inside) continue;
                throw new ScriptException(line, "the run " + runs.first(i) + "-" + runs.last(i)
                        + " of row " + runs.row(i) + " reaches beyond the photo", "rows 0 to "
                        + (photo.height() - 1) + " and columns 0 to " + (photo.width() - 1));
            }
        }

        @Override
        public void perform(Stage stage) {
            SelectionSession session = stage.session();
            Area changed = session.select(runs.mask(session.width(), session.height()));
            stage.done(line, "select", count(runs.rows(), "row"), changed);
        }
    }

    /** A picture of the selection as it stands. */
    record Snapshot(int line, String name, Function<SelectionSession, Picture> drawing)
            implements Command {
        @Override
        public void perform(Stage stage) throws OutputException {
            stage.picture(name, drawing);
        }
    }

    private static void checkInside(List<Point> points, Photo photo, int line)
            throws ScriptException {
        for (Point p : points) {
            boolean inside = p.x >= 0 && p.x < photo.width() && p.y >= 0 && p.y < photo.height();
            if (inside) continue;
            throw new ScriptException(line, "the point " + describe(p) + " lies outside the photo",
                    "0,0 to " + (photo.width() - 1) + "," + (photo.height() - 1));
        }
    }

    private static int[] coordinates(List<Point> points) {
        return points.stream().flatMapToInt(p -> IntStream.of(p.x, p.y)).toArray();
    }

    private static String span(List<Point> points) {
        String first = describe(points.get(0));
        if (points.size() == 1) return first;
        return first + " .. " + describe(points.get(points.size() - 1));
    }

    private static String describe(Point p) {
        return p.x + "," + p.y;
    }

    private static String count(int number, String what) {
        return "(" + number + " " + what + (number == 1 ? ")" : "s)");
    }
}
