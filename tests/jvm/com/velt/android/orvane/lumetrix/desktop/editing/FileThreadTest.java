package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.io.IOException;
import java.nio.file.AccessDeniedException;
import java.nio.file.FileSystemException;
import java.nio.file.NoSuchFileException;
import java.util.ArrayList;
import java.util.Collections;
import java.util.List;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

class FileThreadTest {
    private final List<String> told = Collections.synchronizedList(new ArrayList<>());
    private final FileThread files = new FileThread(what -> told.add("<" + what + ">"), told::add);

    @AfterEach
    void close() {
        files.close();
    }

    @Test
    void jobsAreDoneInTheirOrder() {
        files.run("one", "", () -> told.add("first"));
        assertTrue(files.run("two", "", () -> told.add("second")).join());
        assertEquals(List.of("<one>", "first", "<>", "<two>", "second", "<>"), told);
    }

    @Test
    void jobThatFailsIsToldAndTheNextOneDone() {
        assertFalse(files.run("one", "a.png cannot be saved", () -> {
            throw new IOException("the disk is full");
        }).join());
        assertTrue(files.run("two", "", () -> {}).join());
        assertEquals(List.of("<one>", "a.png cannot be saved: the disk is full.", "<>", "<two>",
                "<>"), told);
    }

    private String reason(FileThread.Job job) {
        told.clear();
        files.run("", "x", job).join();
        return told.get(1);
    }

    @Test
    void cureIsSaidOfWhatIsWrongWithAFileAndOfNothingElse() {
        files.run("", "a.png cannot be opened", "Choose a PNG file.", () -> {
            throw new IOException("it is no picture");
        }).join();
        files.run("", "a.png cannot be opened", "Choose a PNG file.", () -> {
            throw new IllegalStateException("a stroke is under way");
        }).join();
        assertEquals(List.of("<>", "a.png cannot be opened: it is no picture. Choose a PNG file.",
                "<>", "<>", "a.png cannot be opened: a stroke is under way.", "<>"), told);
    }

    @Test
    void troublesAreSaidInWords() {
        assertEquals("x: it does not fit into memory; for more, start with"
                + " JAVA_TOOL_OPTIONS=-Xmx4g set.", reason(() -> {
                    throw new OutOfMemoryError();
                }));
        assertEquals("x: access is denied.", reason(() -> {
            throw new AccessDeniedException("/f");
        }));
        assertEquals("x: there is no such file.", reason(() -> {
            throw new NoSuchFileException("/f");
        }));
        assertEquals("x: File name too long.", reason(() -> {
            throw new FileSystemException("/f", null, "File name too long");
        }));
        assertEquals("x: /f.", reason(() -> {
            throw new FileSystemException("/f");
        }));
        assertEquals("x: java.lang.IllegalStateException.", reason(() -> {
            throw new IllegalStateException();
        }));
    }

    @Test
    void closingWaitsForJobsAndTakesNoMore() {
        for (int i = 0; i < 100; ++i) files.run("", "", () -> {});
        files.run("", "", () -> told.add("last"));
        files.close();
        assertTrue(told.contains("last"));
        told.clear();
        assertFalse(files.run("late", "", () -> told.add("late")).join());
        assertEquals(List.of(), told);
    }
}
