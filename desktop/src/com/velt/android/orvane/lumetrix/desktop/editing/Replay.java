package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.desktop.Command;
import com.velt.android.orvane.lumetrix.desktop.OutputException;
import com.velt.android.orvane.lumetrix.desktop.Picture;
import com.velt.android.orvane.lumetrix.desktop.Script;
import com.velt.android.orvane.lumetrix.desktop.Stage;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.util.List;
import java.util.function.BooleanSupplier;
import java.util.function.Function;

/** Plays the commands of a script, but for its pictures, as long as nobody stops it. */
final class Replay implements Stage {
    private final SelectionSession session;
    private final List<Command> commands;
    private final BooleanSupplier goesOn;
    private int performed;

    /** {@code goesOn} is asked before each dab and each command. */
    Replay(SelectionSession session, Script script, BooleanSupplier goesOn) {
        this.session = session;
        commands = script.commands();
        this.goesOn = goesOn;
    }

    /** Ends a stroke in the middle. */
    private static final class Stopped extends RuntimeException {
        private static final long serialVersionUID = 1;
    }

    /** Plays all commands and returns true, or false when it was stopped. */
    boolean play() throws OutputException {
        try {
            for (Command command : commands) {
                beforeDab();
                command.perform(this);
                ++performed;
            }
            return true;
        } catch (Stopped e) {
            return false;
        }
    }

    int performed() {
        return performed;
    }

    int commands() {
        return commands.size();
    }

    @Override
    public SelectionSession session() {
        return session;
    }

    @Override
    public void beforeDab() {
        if (!goesOn.getAsBoolean()) throw new Stopped();
    }

    @Override
    public void done(int line, String what, String where, Area changed) {}

    @Override
    public void picture(String name, Function<SelectionSession, Picture> drawing) {}
}
