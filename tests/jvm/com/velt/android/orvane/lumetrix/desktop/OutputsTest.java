package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.io.IOException;
import java.nio.charset.StandardCharsets;
import java.nio.file.AccessDeniedException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.attribute.PosixFilePermissions;
import java.util.List;
import java.util.Map;
import java.util.stream.Stream;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class OutputsTest {
    private static final byte[] NEW = "new".getBytes(StandardCharsets.UTF_8);

    @TempDir
    private Path folder;

    private List<String> names() throws IOException {
        try (Stream<Path> files = Files.list(folder)) {
            return files.map(file -> file.getFileName().toString()).sorted().toList();
        }
    }

    private Path older(String name) throws IOException {
        return Files.writeString(folder.resolve(name), "older");
    }

    private static void write(Path file) throws IOException {
        Outputs.write(file, Map.of(), out -> out.write(NEW));
    }

    private static String refusal(Path file) {
        OutputException refusal = assertThrows(OutputException.class, () -> write(file));
        return refusal.getMessage() + ", expected " + refusal.expected();
    }

    @Test
    void olderFileIsReplacedAndKeepsItsPermissions() throws IOException {
        Path file = older("a");
        Files.setPosixFilePermissions(file, PosixFilePermissions.fromString("rw-------"));
        write(file);
        assertEquals("new", Files.readString(file));
        assertEquals("rw-------",
                PosixFilePermissions.toString(Files.getPosixFilePermissions(file)));
        assertEquals(List.of("a"), names());
    }

    @Test
    void nothingIsInItsPlaceBeforeAllIs() throws IOException {
        Path file = older("a");
        try (Outputs outputs = new Outputs(Map.of())) {
            outputs.add(file).write(out -> out.write(NEW));
            outputs.add(folder.resolve("b")).write(out -> out.write(NEW));
            assertEquals("older", Files.readString(file));
            assertFalse(Files.exists(folder.resolve("b")));
            outputs.commit();
        }
        assertEquals("new", Files.readString(file));
        assertEquals("new", Files.readString(folder.resolve("b")));
        assertEquals(List.of("a", "b"), names());
    }

    @Test
    void closingWithoutCommitLeavesTheFolderAsItWas() throws IOException {
        Path file = older("a");
        try (Outputs outputs = new Outputs(Map.of())) {
            outputs.makeFolder(folder.resolve("deep/down"));
            outputs.add(folder.resolve("deep/down/b")).write(out -> out.write(NEW));
            outputs.add(file).write(out -> out.write(NEW));
        }
        assertEquals("older", Files.readString(file));
        assertEquals(List.of("a"), names());
    }

    @Test
    void fileBesideThatLooksLikeATemporaryOneIsNotTouched() throws IOException {
        Path other = older(".a.part");
        write(folder.resolve("a"));
        assertEquals("older", Files.readString(other));
    }

    /** The words come from the system itself, by way of the device that is always full. */
    @Test
    void fullDiskIsSaidAndLeavesTheOlderFile() throws IOException {
        Path file = older("a");
        OutputException refusal = assertThrows(OutputException.class, () -> Outputs.write(file,
                Map.of(), out -> Files.write(Path.of("/dev/full"), NEW)));
        assertEquals("the disk is full", refusal.getMessage());
        assertEquals("free space or a folder on another disk", refusal.expected());
        assertEquals("older", Files.readString(file));
        assertEquals(List.of("a"), names());
    }

    @Test
    void usedUpQuotaIsSaid() {
        // As Linux says it; a quota cannot be had here.
        OutputException said = OutputException.of(new IOException("Disk quota exceeded"), folder);
        assertEquals("the disk quota is used up", said.getMessage());
    }

    @Test
    void causeInsideAnEncodersFailureIsSaid() {
        IOException cause = new IOException("No space left on device");
        OutputException said = OutputException.of(
                new javax.imageio.IIOException("I/O error writing PNG file!", cause), folder);
        assertEquals("the disk is full", said.getMessage());
    }

    @Test
    void programErrorWhileWritingLeavesTheOlderFile() throws IOException {
        Path file = older("a");
        assertThrows(IllegalStateException.class, () -> Outputs.write(file, Map.of(), out -> {
            throw new IllegalStateException();
        }));
        assertEquals("older", Files.readString(file));
        assertEquals(List.of("a"), names());
    }

    @Test
    void placesThatCannotBeWrittenAreRefused() throws IOException {
        Path missing = folder.resolve("none");
        assertEquals("there is no folder " + missing + ", expected a folder that exists",
                refusal(missing.resolve("a")));
        Files.createDirectories(folder.resolve("b/inner"));
        assertEquals("it is a folder, expected a file's name", refusal(folder.resolve("b")));
        assertEquals("it is a folder, expected a file's name", refusal(Path.of("/")));
        assertEquals("its name is too long, expected a shorter name",
                refusal(folder.resolve("a".repeat(300))));
        assertEquals(List.of("b"), names());
    }

    @Test
    void longestNameIsWritten() throws IOException {
        String name = "a".repeat(255);
        write(folder.resolve(name));
        assertEquals(List.of(name), names());
    }

    @Test
    void folderThatNobodyMayWriteToIsSaid() {
        OutputException said = OutputException.of(new AccessDeniedException("a"), folder);
        assertEquals("nothing may be written in the folder " + folder, said.getMessage());
    }

    @Test
    void whatThisUserMayNotWriteIsRefused() throws IOException {
        Path file = older("a");
        file.toFile().setWritable(false);
        boolean writesAnywhere = Files.isWritable(file);  // as root does
        expectRefusal(writesAnywhere, file,
                "it is write-protected, expected a file that may be replaced or another name");
        file.toFile().setWritable(true);
        folder.toFile().setWritable(false);
        try {
            expectRefusal(writesAnywhere, file, "nothing may be written in the folder "
                    + folder.toRealPath()
                    + ", expected the right to write there or another folder");
        } finally {
            folder.toFile().setWritable(true);
        }
        assertEquals(List.of("a"), names());
    }

    /** Or, for a user who may write anywhere, that the file is replaced. */
    private void expectRefusal(boolean writesAnywhere, Path file, String reason)
            throws IOException {
        if (writesAnywhere) {
            write(file);
            assertArrayEquals(NEW, Files.readAllBytes(file));
        } else {
            assertEquals(reason, refusal(file));
            assertEquals("older", Files.readString(file));
        }
    }

    @Test
    void inputIsNotReplacedByAnyName() throws IOException {
        Path input = older("a");
        Files.createLink(folder.resolve("hard"), input);
        Files.createSymbolicLink(folder.resolve("soft"), input);
        Files.createSymbolicLink(folder.resolve("here"), folder);
        for (String name : List.of("a", "./a", "here/a", "here/../" + folder.getFileName() + "/a",
                "hard", "soft", "here/soft")) {
            OutputException refusal = assertThrows(OutputException.class, () -> Outputs.write(
                    folder.resolve(name), Map.of(input, "the photo"), out -> out.write(NEW)), name);
            assertEquals("it is the photo and would be replaced", refusal.getMessage());
        }
        assertEquals("older", Files.readString(input));
        assertEquals(List.of("a", "hard", "here", "soft"), names());
    }

    @Test
    void twoOutputsDoNotShareAFile() throws IOException {
        Files.createSymbolicLink(folder.resolve("here"), folder);
        try (Outputs outputs = new Outputs(Map.of())) {
            outputs.add(folder.resolve("a"));
            OutputException refusal = assertThrows(OutputException.class,
                    () -> outputs.add(folder.resolve("here/a")));
            assertEquals("another output goes to the same file", refusal.getMessage());
        }
        assertEquals(List.of("here"), names());
        assertTrue(Files.isSymbolicLink(folder.resolve("here")));
    }
}
