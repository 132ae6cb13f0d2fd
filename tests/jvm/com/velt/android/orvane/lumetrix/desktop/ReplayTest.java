package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertEquals;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import java.util.stream.Stream;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.ValueSource;

/** Replays the project's scripts; {@code -Ddesktop.folder=} names their folder. */
class ReplayTest {
    private static final Path DESKTOP = Path.of(System.getProperty("desktop.folder", "desktop"));

    @TempDir
    private Path folder;

    @ParameterizedTest
    @ValueSource(strings = {"fig", "dandelion", "lasso", "select", "torture"})
    void scriptEndsWithItsDigest(String name)
            throws IOException, ScriptException, InterruptedException {
        String expected = Files.readString(DESKTOP.resolve("scripts/" + name + ".digest")).strip();
        Path script = beside(name);

        PlayerRun run = PlayerRun.of(script, "--out", folder.resolve("out"), "--expect", expected);

        assertEquals(List.of(), run.err());
        assertEquals("digest " + expected, run.out().get(run.out().size() - 1));
        assertEquals(0, run.status());
    }

    @Test
    void everyScriptIsReplayed() throws IOException {
        try (Stream<Path> files = Files.list(DESKTOP.resolve("scripts"))) {
            assertEquals(List.of("dandelion", "fig", "lasso", "select", "torture"),
                    files.map(file -> file.getFileName().toString())
                            .filter(file -> file.endsWith(".strokes"))
                            .map(file -> file.replace(".strokes", "")).sorted().toList());
        }
    }

    /**
     * Copies a script beside a folder of photos in which its photo is stored as PNG; the name stays
     * as the script has it, since files are recognised by their content.
     */
    private Path beside(String name) throws IOException, ScriptException, InterruptedException {
        Path scripts = Files.createDirectories(folder.resolve("scripts"));
        String scriptName = name + ".strokes";
        Path script = Files.copy(DESKTOP.resolve("scripts").resolve(scriptName),
                scripts.resolve(scriptName));

        String photo = ScriptParser.parse(Files.readAllBytes(script)).photo();
        Path copy = scripts.resolve(photo).normalize();
        Files.createDirectories(copy.getParent());
        ChildJvm conversion = ChildJvm.run(folder, JpegToPng.class,
                DESKTOP.resolve("scripts").resolve(photo).toString(), copy.toString());
        assertEquals("", conversion.err());
        assertEquals(0, conversion.status());
        return script;
    }
}
