package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.desktop.editing.Frame;
import java.awt.Point;
import java.awt.image.BufferedImage;
import java.awt.image.DataBufferInt;
import java.awt.image.DirectColorModel;
import java.awt.image.Raster;
import java.awt.image.WritableRaster;

/**
 * Images around the pixels of frames, without a copy of them.
 *
 * <p>An editor draws by turns into two arrays, so the last two images are kept.
 */
final class FrameImage {
    private static final DirectColorModel COLOURS =
            new DirectColorModel(24, 0xFF0000, 0x00FF00, 0x0000FF);
    private static final int[] MASKS = {0xFF0000, 0x00FF00, 0x0000FF};

    private Wrapped last = new Wrapped(null, 0, null);
    private Wrapped other = last;

    private record Wrapped(int[] pixels, int width, BufferedImage image) {
        boolean fits(Frame frame) {
            return pixels == frame.pixels() && width == frame.placement().port().width();
        }
    }

    /** Returns an image of what a frame holds at any time. */
    BufferedImage of(Frame frame) {
        if (!last.fits(frame)) {
            Wrapped next = other.fits(frame) ? other : wrap(frame);
            other = last;
            last = next;
        }
        return last.image;
    }

    private static Wrapped wrap(Frame frame) {
        int width = frame.placement().port().width();
        int height = frame.placement().port().height();
        // A buffer made from an array is read anew for each drawing; nothing is cached elsewhere.
        DataBufferInt buffer = new DataBufferInt(frame.pixels(), width * height);
        WritableRaster raster = Raster.createPackedRaster(buffer, width, height, width, MASKS,
                new Point());
        return new Wrapped(frame.pixels(), width, new BufferedImage(COLOURS, raster, false, null));
    }

    /** Forgets the images, so that a closed photo's frames are not held. */
    void clear() {
        last = new Wrapped(null, 0, null);
        other = last;
    }
}
