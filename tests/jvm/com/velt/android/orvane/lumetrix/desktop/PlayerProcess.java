package com.velt.android.orvane.lumetrix.desktop;

import java.awt.image.BufferedImage;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;
import javax.imageio.ImageIO;

/** Runs the player as a process of its own in a folder with {@code photo.png}. */
final class PlayerProcess {
    static final int PHOTO_SIDE = 40;

    private final Path scratch;
    private final Path folder;

    PlayerProcess(Path scratch) throws IOException {
        this.scratch = scratch;
        folder = Files.createDirectory(scratch.resolve("work"));
        BufferedImage image =
                new BufferedImage(PHOTO_SIDE, PHOTO_SIDE, BufferedImage.TYPE_INT_RGB);
        ImageIO.write(image, "png", folder.resolve("photo.png").toFile());
    }

    Path folder() {
        return folder;
    }

    /** Writes the script {@code s.strokes}. */
    void script(String... lines) throws IOException {
        Files.write(folder.resolve("s.strokes"), List.of(lines));
    }

    /** Returns the player, to be started behind the words of another command, or of none. */
    ProcessBuilder player(List<String> before, String... arguments) {
        List<String> command = new ArrayList<>(before);
        command.addAll(ChildJvm.command(List.of("-Djava.awt.headless=true",
                "-Djava.library.path=" + System.getProperty("java.library.path")), Player.class,
                arguments));
        return new ProcessBuilder(command).directory(folder.toFile())
                .redirectError(scratch.resolve("err").toFile());
    }

    /** Runs the player to its end. */
    ChildJvm run(List<String> before, String... arguments)
            throws IOException, InterruptedException {
        Path out = scratch.resolve("out");
        int status = player(before, arguments).redirectOutput(out.toFile()).start().waitFor();
        return new ChildJvm(status, Files.readString(out), err());
    }

    /** Returns what it has printed on its standard error. */
    String err() throws IOException {
        return Files.readString(scratch.resolve("err"));
    }
}
