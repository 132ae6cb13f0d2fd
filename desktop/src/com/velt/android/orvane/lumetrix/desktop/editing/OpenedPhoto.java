package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.desktop.Photo;
import com.velt.android.orvane.lumetrix.desktop.Picture;
import java.awt.Graphics2D;
import java.awt.RenderingHints;
import java.awt.image.BufferedImage;
import java.io.IOException;
import java.nio.file.Path;
import java.util.Map;

/**
 * A photo to be edited, reduced when it has more pixels than strokes can follow.
 *
 * @param file where it comes from
 * @param photo its pixels
 * @param fileWidth its width in the file
 * @param fileHeight its height in the file
 */
public record OpenedPhoto(Path file, Photo photo, int fileWidth, int fileHeight) {
    /** Larger photos are reduced to this. */
    public static final int MOST_PIXELS = 12_500_000;  // 12 megapixels, as cameras count them

    /**
     * Reads a photo.
     *
     * @throws IOException when there is no photo that can be had; the message says why
     */
    static OpenedPhoto read(Path file) throws IOException {
        Photo photo = Photo.read(file);
        double pixels = (double) photo.width() * photo.height();
        double factor = Math.sqrt(MOST_PIXELS / pixels);
        Photo edited = factor < 1 ? reduced(photo, factor) : photo;
        return new OpenedPhoto(file, edited, photo.width(), photo.height());
    }

    /** Reads a photo as it is, however large. */
    static OpenedPhoto readWhole(Path file) throws IOException {
        Photo photo = Photo.read(file);
        return new OpenedPhoto(file, photo, photo.width(), photo.height());
    }

    /** The factor lies above 0.4, for files have at most 64 million pixels: two samples reach. */
    private static Photo reduced(Photo photo, double factor) {
        int width = Math.max(1, (int) (photo.width() * factor));
        int height = Math.max(1, (int) (photo.height() * factor));
        BufferedImage small = new BufferedImage(width, height, BufferedImage.TYPE_INT_ARGB);
        Graphics2D graphics = small.createGraphics();
        graphics.setRenderingHint(RenderingHints.KEY_INTERPOLATION,
                RenderingHints.VALUE_INTERPOLATION_BILINEAR);
        BufferedImage large = new Picture(photo.width(), photo.height(), photo.pixels()).toImage();
        graphics.drawImage(large, 0, 0, width, height, null);
        graphics.dispose();
        return new Photo(width, height, small.getRGB(0, 0, width, height, null, 0, width));
    }

    public int width() {
        return photo.width();
    }

    public int height() {
        return photo.height();
    }

    /** Returns what no file may be saved over, and what it is. */
    Map<Path, String> asInput() {
        return Map.of(file, "the photo that is open");
    }

    /** Tells whether the photo has fewer pixels than its file. */
    public boolean isReduced() {
        return width() != fileWidth || height() != fileHeight;
    }

    /** Returns the file's name for people. */
    public String name() {
        return file.getFileName().toString();
    }
}
