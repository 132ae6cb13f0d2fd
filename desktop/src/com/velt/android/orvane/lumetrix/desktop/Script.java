package com.velt.android.orvane.lumetrix.desktop;

import java.util.List;

/**
 * A stroke script, parsed.
 *
 * @param photoLine the line that names the photo
 * @param photo the photo's file, as the script names it: relative to the script's folder
 * @param commands what to do with it, in order
 */
public record Script(int photoLine, String photo, List<Command> commands) {
    public Script {
        commands = List.copyOf(commands);
    }

    /** Returns the commands that write pictures, in order. */
    List<Command.Snapshot> snapshots() {
        return commands.stream()
                .filter(Command.Snapshot.class::isInstance)
                .map(Command.Snapshot.class::cast)
                .toList();
    }
}
