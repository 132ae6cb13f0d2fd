package com.velt.android.orvane.lumetrix.desktop;

import com.velt.android.orvane.lumetrix.selection.NativeCall;
import java.io.ByteArrayOutputStream;
import java.io.IOException;
import java.io.OutputStream;
import java.nio.ByteBuffer;
import java.nio.charset.StandardCharsets;

/**
 * A file of a photo and the calls made on it, from which a program without Java or a JPEG decoder
 * can make the same calls.
 *
 * <p>All numbers are 32 bits, the highest byte first: after {@link #MAGIC} width and height of the
 * photo and its pixels 0xAARRGGBB, row by row; then for each call a byte, its number, and its
 * arguments. Those of {@link NativeCall#SELECT} come after the number of its runs.
 *
 * <p>Calls are kept until it is closed, and the file is written then.
 */
final class Recording implements CallLog {
    /** The first eight bytes. */
    static final byte[] MAGIC = "calls 1\n".getBytes(StandardCharsets.US_ASCII);

    private static final int DIGEST = 7;
    private static final int NUMBERS_OF_A_RUN = 3;

    private final OutputFile file;
    private final Photo photo;
    private final ByteArrayOutputStream calls = new ByteArrayOutputStream();

    Recording(OutputFile file, Photo photo) {
        this.file = file;
        this.photo = photo;
    }

    @Override
    public void beforeCall(NativeCall call, int... arguments) {
        calls.write(numberOf(call));
        if (call == NativeCall.SELECT) calls.writeBytes(bytes(arguments.length / NUMBERS_OF_A_RUN));
        calls.writeBytes(bytes(arguments));
    }

    @Override
    public void digest() {
        calls.write(DIGEST);
    }

    @Override
    public void close() throws OutputException {
        file.write(out -> {
            writePhoto(out);
            calls.writeTo(out);
        });
    }

    private void writePhoto(OutputStream out) throws IOException {
        out.write(MAGIC);
        out.write(bytes(photo.width(), photo.height()));
        int[] row = new int[photo.width()];
        for (int y = 0; y < photo.height(); ++y) {
            System.arraycopy(photo.pixels(), y * row.length, row, 0, row.length);
            out.write(bytes(row));
        }
    }

    private static int numberOf(NativeCall call) {
        return switch (call) {
            case SET_BRUSH -> 1;
            case INIT -> 2;
            case MODIFY -> 3;
            case INVERT -> 4;
            case RESET -> 5;
            case UPDATE_BOX -> 6;
            case DESTROY -> 8;
            case SELECT -> 9;
            case SET_BOX -> throw new IllegalStateException(
                    "undo and redo cannot be recorded, expected a script of what is in effect");
        };
    }

    private static byte[] bytes(int... numbers) {
        ByteBuffer bytes = ByteBuffer.allocate(Integer.BYTES * numbers.length);
        bytes.asIntBuffer().put(numbers);
        return bytes.array();
    }
}
