package com.velt.android.orvane.lumetrix.desktop;

import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.jni.Util;
import java.io.File;
import java.io.IOException;
import java.net.URISyntaxException;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.LinkedHashSet;
import java.util.List;
import java.util.Set;

/** What a Java program of its own process printed, and how it ended. */
public record ChildJvm(int status, String out, String err) {
    /** Runs a class with the classes under test, but without any option of this process. */
    public static ChildJvm run(Path scratch, Class<?> main, String... arguments)
            throws IOException, InterruptedException {
        return run(scratch, List.of("-Djava.awt.headless=true"), main, arguments);
    }

    /** Runs a class that may want to open windows, where there is no display. */
    public static ChildJvm runWithoutDisplay(Path scratch, Class<?> main, String... arguments)
            throws IOException, InterruptedException {
        return run(scratch, List.of(), main, arguments);
    }

    private static ChildJvm run(Path scratch, List<String> options, Class<?> main,
            String... arguments) throws IOException, InterruptedException {
        Path out = scratch.resolve("child.out");
        Path err = scratch.resolve("child.err");
        ProcessBuilder child = new ProcessBuilder(command(options, main, arguments))
                .redirectOutput(out.toFile())
                .redirectError(err.toFile());
        child.environment().remove("DISPLAY");
        int status = child.start().waitFor();
        return new ChildJvm(status, read(out), read(err));
    }

    /** Returns the command that runs a class with the classes under test. */
    static List<String> command(List<String> options, Class<?> main, String... arguments) {
        List<String> command = new ArrayList<>();
        command.add(Path.of(System.getProperty("java.home"), "bin", "java").toString());
        command.addAll(options);
        command.addAll(List.of("-cp", classPath(), main.getName()));
        command.addAll(List.of(arguments));
        return command;
    }

    private static String classPath() {
        Set<String> places = new LinkedHashSet<>();
        places.add(placeOf(ChildJvm.class));
        places.add(placeOf(Player.class));
        places.add(placeOf(Util.class));
        places.add(placeOf(Rect.class));
        return String.join(File.pathSeparator, places);
    }

    private static String placeOf(Class<?> type) {
        try {
            return Path.of(type.getProtectionDomain().getCodeSource().getLocation().toURI())
                    .toString();
        } catch (URISyntaxException e) {
            throw new IllegalStateException(e);
        }
    }

    private static String read(Path file) throws IOException {
        return new String(Files.readAllBytes(file), StandardCharsets.UTF_8);
    }
}
