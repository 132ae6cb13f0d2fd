package com.velt.android.orvane.lumetrix.desktop;

import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import com.velt.android.orvane.lumetrix.selection.Viewport;
import java.util.Optional;
import java.util.regex.Pattern;
import java.util.zip.CRC32;

/**
 * Fingerprint of a selection: the CRC-32 (that of zip and PNG) of the mask's bytes, row by row, and
 * after them the pixels of a view of {@value #VIEW_WIDTH} x {@value #VIEW_HEIGHT} that shows the
 * whole photo with a white and black outline, each pixel as the four bytes alpha, red, green, blue.
 *
 * @param value the 32 bits
 */
public record Digest(int value) {
    static final int VIEW_WIDTH = 640;
    static final int VIEW_HEIGHT = 480;

    private static final Pattern FORM = Pattern.compile("[0-9A-Fa-f]{8}");

    /** Returns the digest of a session's selection and of how it looks. */
    public static Digest of(SelectionSession session) {
        Viewport whole = Viewport.fitting(session.width(), session.height(), VIEW_WIDTH,
                VIEW_HEIGHT);
        Picture view = Drawings.view(session, whole, Drawings.WHITE, Drawings.BLACK);
        return of(session.mask(), view.pixels());
    }

    static Digest of(byte[] mask, int[] view) {
        CRC32 crc = new CRC32();
        crc.update(mask);
        byte[] bytes = new byte[4 * view.length];
        for (int i = 0; i < view.length; ++i) {
            for (int k = 0; k < 4; ++k) bytes[4 * i + k] = (byte) (view[i] >>> (24 - 8 * k));
        }
        crc.update(bytes);
        return new Digest((int) crc.getValue());
    }

    /** Reads a digest of eight hexadecimal digits, in either case. */
    static Optional<Digest> parse(String text) {
        if (!FORM.matcher(text).matches()) return Optional.empty();
        return Optional.of(new Digest(Integer.parseUnsignedInt(text, 16)));
    }

    /** Returns eight hexadecimal digits. */
    @Override
    public String toString() {
        return String.format("%08X", value);
    }
}
