package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertEquals;

import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** The player on disks that are full or read-only. Needs a kernel that lets us mount our own. */
class PlayerDisksTest {
    @TempDir
    private Path scratch;
    private PlayerProcess process;

    @BeforeEach
    void savePhoto() throws Exception {
        process = new PlayerProcess(scratch);
    }

    /**
     * Plays with a mount of its own on the folder {@code disk}, and then prints all files there,
     * one after the other, and their names.
     */
    private ChildJvm playOnDisk(String mount, String... arguments) throws Exception {
        Files.createDirectory(process.folder().resolve("disk"));
        return process.run(List.of("unshare", "--user", "--map-root-user", "--mount", "sh", "-c",
                mount + "\n\"$@\"; status=$?\n"
                + "find disk -type f -exec cat {} +; find disk | sort; exit $status", "sh"),
                arguments);
    }

    @Test
    void fullDiskIsSaidAndLeavesTheOlderFiles() throws Exception {
        process.script("photo photo.png", "mask m.png", "mask n.png");
        ChildJvm run = playOnDisk(
                "mount -t tmpfs -o size=16k tmpfs disk && printf older > disk/m.png", "s.strokes",
                "--record", "disk/calls", "--out", "disk");
        assertEquals("s.strokes: the calls cannot be written to \"disk/calls\": the disk is"
                + " full, expected free space or a folder on another disk\n", run.err());
        assertEquals(2, run.status());
        assertEquals("olderdisk\ndisk/m.png\n", run.out());
    }

    @Test
    void fullDiskIsSaidOfAPictureToo() throws Exception {
        process.script("photo photo.png", "view m.png 4000 3000 1 0 0");
        ChildJvm run = playOnDisk(
                "mount -t tmpfs -o size=8k tmpfs disk && printf older > disk/m.png", "s.strokes",
                "--out", "disk");
        assertEquals("s.strokes:2: the picture cannot be written to \"disk/m.png\": the"
                + " disk is full, expected free space or a folder on another disk\n", run.err());
        assertEquals(2, run.status());
        assertEquals("olderdisk\ndisk/m.png\n", run.out());
    }

    @Test
    void diskMountedReadOnlyIsSaid() throws Exception {
        process.script("photo photo.png", "mask m.png");
        ChildJvm run = playOnDisk("mount -t tmpfs -o ro tmpfs disk", "s.strokes", "--out", "disk");
        assertEquals("s.strokes:2: the picture cannot be written to \"disk/m.png\": the"
                + " disk of " + process.folder().toRealPath().resolve("disk")
                + " is mounted read-only,"
                + " expected a folder on another disk\n", run.err());
        assertEquals(2, run.status());
        assertEquals("disk\n", run.out());
    }
}
