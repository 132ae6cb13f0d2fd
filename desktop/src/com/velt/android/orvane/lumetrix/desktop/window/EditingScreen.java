package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.awt.AWTError;
import java.awt.GraphicsEnvironment;
import java.awt.HeadlessException;
import java.io.PrintStream;
import java.lang.reflect.InvocationTargetException;
import java.util.List;
import javax.swing.SwingUtilities;

/** The editing screen as a program: selects an object in a photo, in a window. */
public final class EditingScreen {
    private static final int STARTED = 0;
    private static final int NOT_STARTED = 2;

    private static final String HELP = String.join("\n",
            "Usage: " + Arguments.USAGE,
            "",
            "Selects an object in a photo with a few strokes.",
            "",
            "  PHOTO   a JPEG or PNG file to open",
            "  SCRIPT  a stroke script to replay, its name ending in .strokes",
            "  --help  this text",
            "",
            "Without a file, the window says how to open one; F1 lists keys and pointer.",
            "Status: 0 closed, 2 no window.");

    private EditingScreen() {}

    /**
     * Opens the window. The process ends when it is closed, or with a status and a line that says
     * why there is none.
     *
     * @param arguments the command line, see {@code --help}
     */
    public static void main(String[] arguments) {
        int status = run(List.of(arguments), System.out, System.err);
        if (status != STARTED) System.exit(status);
    }

    /** Opens the window and returns 0, or says why it cannot and returns 2. */
    static int run(List<String> words, PrintStream out, PrintStream err) {
        try {
            Arguments arguments = Arguments.parse(words);
            if (arguments.help()) {
                out.println(HELP);
                return STARTED;
            }
            if (GraphicsEnvironment.isHeadless()) throw new HeadlessException();
            loadLibrary();
            open(null, null, arguments);
            return STARTED;
        } catch (IllegalArgumentException e) {
            err.println("window: " + e.getMessage());
        } catch (HeadlessException | AWTError | NoClassDefFoundError e) {
            err.println("window: there is no display to open a window on, expected one named in"
                    + " DISPLAY and a Java with windows, on Debian openjdk-17-jre");
        } catch (UnsatisfiedLinkError e) {
            err.println("window: the native library draventaUtil does not load (" + e.getMessage()
                    + "), expected its folder in -Djava.library.path; ./dev build builds it");
        }
        return NOT_STARTED;
    }

    /** Loads the native library here, where one can say that it does not load. */
    private static void loadLibrary() {
        new SelectionSession(new int[1], 1, 1).close();
    }

    /**
     * Opens the window.
     *
     * @param files asks for files, or null for dialogues
     * @param questions asks the rest, or null for dialogues
     * @return the window, which is shown
     */
    static ScreenFrame open(FileChoice files, Questions questions, Arguments arguments) {
        if (System.getProperty("awt.useSystemAAFontSettings") == null) {
            System.setProperty("awt.useSystemAAFontSettings", "on");
        }
        ScreenFrame[] opened = new ScreenFrame[1];
        try {
            SwingUtilities.invokeAndWait(() -> {
                Theme.install();
                opened[0] = new ScreenFrame(files, questions);
                opened[0].setVisible(true);
                arguments.file().ifPresent(opened[0]::use);
            });
        } catch (InvocationTargetException e) {
            if (e.getCause() instanceof RuntimeException cause) throw cause;
            if (e.getCause() instanceof Error cause) throw cause;
            throw new IllegalStateException(e);
        } catch (InterruptedException e) {
            throw new IllegalStateException("nobody interrupts this thread", e);
        }
        return opened[0];
    }
}
