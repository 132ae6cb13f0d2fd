package com.velt.android.orvane.lumetrix.desktop;

import java.io.ByteArrayOutputStream;
import java.io.PrintStream;
import java.nio.charset.StandardCharsets;
import java.util.Arrays;
import java.util.List;

/** What the player printed, and its status. */
public record PlayerRun(int status, List<String> out, List<String> err) {
    public static PlayerRun of(Object... arguments) {
        ByteArrayOutputStream out = new ByteArrayOutputStream();
        ByteArrayOutputStream err = new ByteArrayOutputStream();
        List<String> words = Arrays.stream(arguments).map(Object::toString).toList();
        int status = Player.run(words, stream(out), stream(err));
        return new PlayerRun(status, lines(out), lines(err));
    }

    private static PrintStream stream(ByteArrayOutputStream bytes) {
        return new PrintStream(bytes, true, StandardCharsets.UTF_8);
    }

    private static List<String> lines(ByteArrayOutputStream bytes) {
        return bytes.toString(StandardCharsets.UTF_8).lines().toList();
    }
}
