package com.velt.android.orvane.lumetrix.desktop.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.nio.file.Path;
import java.util.List;
import java.util.Optional;
import org.junit.jupiter.api.Test;

class ArgumentsTest {
    @Test
    void nothingIsNeeded() {
        Arguments arguments = Arguments.parse(List.of());

        assertEquals(Optional.empty(), arguments.file());
        assertFalse(arguments.help());
    }

    @Test
    void aFileIsTaken() {
        assertEquals(Optional.of(Path.of("a photo.jpg")),
                Arguments.parse(List.of("a photo.jpg")).file());
    }

    @Test
    void helpGoesBeforeEverythingElse() {
        assertTrue(Arguments.parse(List.of("--wrong", "--help")).help());
        assertTrue(Arguments.parse(List.of("-h")).help());
    }

    @Test
    void whatIsWrongIsSaidTogetherWithTheUsage() {
        assertRefused("there is no option --fast", "--fast", "a.jpg");
        assertRefused("\"b.jpg\" is a second file", "a.jpg", "b.jpg");
        assertRefused("\"\" is no path", "");
        assertRefused("\"a\0b\" is no path", "a\0b");
    }

    private static void assertRefused(String expected, String... words) {
        Exception refusal = assertThrows(IllegalArgumentException.class,
                () -> Arguments.parse(List.of(words)));
        assertEquals(expected + ", expected window [PHOTO or SCRIPT]", refusal.getMessage());
    }
}
