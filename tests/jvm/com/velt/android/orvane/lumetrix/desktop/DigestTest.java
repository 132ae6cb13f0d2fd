package com.velt.android.orvane.lumetrix.desktop;

import static org.junit.jupiter.api.Assertions.assertEquals;

import java.nio.charset.StandardCharsets;
import java.util.Optional;
import org.junit.jupiter.api.Test;

class DigestTest {
    /** The well-known check value of CRC-32. */
    private static final Digest OF_123456789 = new Digest(0xCBF43926);

    @Test
    void isTheCrcOfTheMasksBytes() {
        assertEquals(OF_123456789, Digest.of(ascii("123456789"), new int[0]));
    }

    @Test
    void goesOnWithAlphaRedGreenBlueOfEachPixel() {
        assertEquals(OF_123456789, Digest.of(ascii("1"), new int[] {0x32333435, 0x36373839}));
    }

    @Test
    void isWrittenAsEightDigitsAndReadInEitherCase() {
        assertEquals("CBF43926", OF_123456789.toString());
        assertEquals("0000000A", new Digest(10).toString());
        assertEquals(Optional.of(OF_123456789), Digest.parse("cbF43926"));
        assertEquals(Optional.empty(), Digest.parse("CBF4392"));
        assertEquals(Optional.empty(), Digest.parse("0xCBF439"));
    }

    private static byte[] ascii(String text) {
        return text.getBytes(StandardCharsets.US_ASCII);
    }
}
