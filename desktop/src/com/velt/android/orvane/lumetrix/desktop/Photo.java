package com.velt.android.orvane.lumetrix.desktop;

import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.awt.image.BufferedImage;
import java.awt.image.ColorModel;
import java.awt.image.ComponentColorModel;
import java.awt.image.DataBuffer;
import java.awt.image.Raster;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Iterator;
import javax.imageio.ImageIO;
import javax.imageio.ImageReader;
import javax.imageio.stream.ImageInputStream;

/**
 * A photo as the library takes it.
 *
 * @param width width in pixels
 * @param height height in pixels
 * @param pixels width * height values 0xAARRGGBB, row by row
 */
public record Photo(int width, int height, int[] pixels) {
    /** Larger photos are refused: pixels, picture and copies for the library take 1.5 GB here. */
    public static final int MOST_PIXELS = 64_000_000;

    private static final int JPEG_BANDS_OF_CMYK = 4;
    private static final int LONGEST_SIDE = SelectionSession.LONGEST_SIDE;

    /**
     * Reads a photo.
     *
     * <p>Samples of 8 bits are taken as they are stored: an embedded colour profile or a request
     * for rotation changes nothing, so that the same file gives the same pixels everywhere. Grey
     * goes into all three channels.
     *
     * @throws IOException when there is no photo that can be had; the message says why
     */
    public static Photo read(Path file) throws IOException {
        if (Files.isDirectory(file)) throw new IOException("it is a folder");
        if (!Files.isRegularFile(file)) throw new IOException("there is no such file");
        try (ImageInputStream in = ImageIO.createImageInputStream(file.toFile())) {
            if (in == null) throw new IOException("it cannot be opened");
            Iterator<ImageReader> readers = ImageIO.getImageReaders(in);
            if (!readers.hasNext()) throw new IOException("it is no picture");
            ImageReader reader = readers.next();
            try {
                return decode(reader, in);
            } finally {
                reader.dispose();
            }
        } catch (RuntimeException e) {  // what the decoders throw at damaged files
            throw new IOException("it is damaged", e);
        }
    }

    private static Photo decode(ImageReader reader, ImageInputStream in) throws IOException {
        reader.setInput(in, true, true);
        int width = reader.getWidth(0);
        int height = reader.getHeight(0);
        if ((long) width * height > MOST_PIXELS || Math.max(width, height) > LONGEST_SIDE) {
            throw new IOException("it has " + width + " x " + height + " pixels, more than "
                    + MOST_PIXELS / 1_000_000 + " million or a side beyond " + LONGEST_SIDE);
        }
        // The decoder has no type for some JPEGs of four channels, and takes the rest for
        // transparent ones.
        boolean types = reader.getImageTypes(0).hasNext();
        boolean[] cutOff = {false};
        reader.addIIOReadWarningListener((source, warning) ->
                cutOff[0] |= warning.contains("premature end"));  // the rest would be grey
        BufferedImage image = types ? reader.read(0) : null;
        boolean jpeg = reader.getFormatName().equalsIgnoreCase("jpeg");
        if (!types || (jpeg && image.getRaster().getNumBands() == JPEG_BANDS_OF_CMYK)) {
            throw new IOException("its colours are CMYK, not RGB or grey");
        }
        if (cutOff[0]) throw new IOException("it is damaged: its end is missing");
        return new Photo(width, height, pixelsOf(image));
    }

    private static int[] pixelsOf(BufferedImage image) {
        ColorModel model = image.getColorModel();
        boolean plain = model instanceof ComponentColorModel
                && model.getTransferType() == DataBuffer.TYPE_BYTE
                && model.getComponentSize(0) == 8;
        if (plain) return samplesOf(image.getRaster(), model.hasAlpha());
        return image.getRGB(0, 0, image.getWidth(), image.getHeight(), null, 0, image.getWidth());
    }

    private static int[] samplesOf(Raster raster, boolean hasAlpha) {
        int width = raster.getWidth();
        int height = raster.getHeight();
        int bands = raster.getNumBands();
        boolean grey = bands < 3;
        int[] pixels = new int[width * height];
        int[] row = new int[width * bands];
        for (int y = 0; y < height; ++y) {
            raster.getPixels(0, y, width, 1, row);
            for (int x = 0; x < width; ++x) {
                int first = x * bands;
                int red = row[first];
                int green = grey ? red : row[first + 1];
                int blue = grey ? red : row[first + 2];
                int alpha = hasAlpha ? row[first + bands - 1] : 255;
                pixels[y * width + x] = alpha << 24 | red << 16 | green << 8 | blue;
            }
        }
        return pixels;
    }
}
