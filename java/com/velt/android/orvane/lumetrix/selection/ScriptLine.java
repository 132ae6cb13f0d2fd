package com.velt.android.orvane.lumetrix.selection;

/** A line of a stroke script, and the settings under which its stroke was made. */
final class ScriptLine {
    private final String words;
    private final int[] points;
    private final Settings settings;

    /**
     * Makes a line.
     *
     * @param words the command
     * @param points what follows it, columns and rows by turns; kept
     */
    ScriptLine(String words, int[] points, Settings settings) {
        this.words = words;
        this.points = points;
        this.settings = settings;
    }

    Settings settings() {
        return settings;
    }

    void write(StringBuilder script) {
        script.append(words);
        for (int i = 0; i < points.length; i += 2) {
            script.append(' ').append(points[i]).append(',').append(points[i + 1]);
        }
        script.append('\n');
    }

    /** Brush and fill flag before a line. */
    static final class Settings {
        private final boolean newEngine;
        private final int radius;
        private final int core;
        private final boolean fill;

        /** {@code newEngine}: the engine was built since the line before, for this brush. */
        Settings(boolean newEngine, int radius, int core, boolean fill) {
            this.newEngine = newEngine;
            this.radius = radius;
            this.core = core;
            this.fill = fill;
        }

        boolean fill() {
            return fill;
        }

        /** Writes what it takes to have these settings; {@code fillBefore} holds so far. */
        void write(StringBuilder script, boolean fillBefore) {
            if (newEngine) {
                script.append("brush ").append(radius).append(' ').append(core).append('\n');
            }
            if (fill != fillBefore) script.append(fill ? "fill on\n" : "fill off\n");
        }
    }
}
