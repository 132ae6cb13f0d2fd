package com.velt.android.orvane.lumetrix.desktop.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.velt.android.orvane.lumetrix.desktop.ChildJvm;
import java.nio.file.Path;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class EditingScreenTest {
    @TempDir
    Path folder;

    @Test
    void withoutADisplayOneLineSaysSo() throws Exception {
        ChildJvm screen = ChildJvm.runWithoutDisplay(folder, EditingScreen.class, "fig.jpg");

        assertEquals("window: there is no display to open a window on, expected one named in"
                + " DISPLAY and a Java with windows, on Debian openjdk-17-jre\n", screen.err());
        assertEquals("", screen.out());
        assertEquals(2, screen.status());
    }

    @Test
    void helpNeedsNoDisplay() throws Exception {
        ChildJvm screen = ChildJvm.runWithoutDisplay(folder, EditingScreen.class, "--help");

        assertTrue(screen.out().startsWith("Usage: window [PHOTO or SCRIPT]\n"), screen.out());
        assertEquals("", screen.err());
        assertEquals(0, screen.status());
    }

    @Test
    void aWrongCommandLineIsOneLine() throws Exception {
        ChildJvm screen = ChildJvm.runWithoutDisplay(folder, EditingScreen.class, "a.jpg", "b.jpg");

        assertEquals("window: \"b.jpg\" is a second file, expected window [PHOTO or SCRIPT]\n",
                screen.err());
        assertEquals(2, screen.status());
    }
}
