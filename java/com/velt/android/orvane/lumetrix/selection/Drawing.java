package com.velt.android.orvane.lumetrix.selection;

import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.jni.Util;

/** Draws a photo and its selection into pictures of the caller, whose sizes it checks. */
final class Drawing {
    private static final String OUTPUT = "the array to draw into";

    private final int[] pixels;
    private final byte[] mask;
    private final int width;
    private final int height;

    Drawing(int[] pixels, byte[] mask, int width, int height) {
        this.pixels = pixels;
        this.mask = mask;
        this.width = width;
        this.height = height;
    }

    void plainView(int[] view, Viewport port, Area part) {
        checkView(view, port, part);
        Util.native_drawImage(view, port.width(), port.height(), pixels, width, height,
                port.scale(), port.offsetX(), port.offsetY(), rectOf(part));
    }

    void outlinedView(int[] view, Viewport port, Area part, int firstColour, int secondColour) {
        checkView(view, port, part);
        Util.native_drawImageWithMaskContour(view, port.width(), port.height(), pixels, width,
                height, mask, port.scale(), port.offsetX(), port.offsetY(), firstColour,
                secondColour, rectOf(part));
    }

    void plainSmallView(int[] view, int viewWidth, int viewHeight, Area part) {
        check(view, "view", viewWidth, viewHeight, part);
        Util.native_drawSmallImage(view, viewWidth, viewHeight, pixels, width, height,
                rectOf(part));
    }

    void outlinedSmallView(int[] view, int viewWidth, int viewHeight, Area part, int firstColour,
            int secondColour) {
        check(view, "view", viewWidth, viewHeight, part);
        Util.native_drawSmallImageWithMaskContour(view, viewWidth, viewHeight, pixels, width,
                height, mask, firstColour, secondColour, rectOf(part));
    }

    void colourOnGrey(int[] picture, Area part) {
        check(picture, "photo", width, height, part);
        Util.draw_withmask(pixels, picture, mask, width, rectOf(part));
    }

    void reverse(int[] picture) {
        check(picture, "photo", width, height, Area.EMPTY);
        byte[] inverted = mask.clone();  // drawing inverts it
        Util.draw_reversemask(pixels, picture, inverted, width, height);
    }

    private void checkView(int[] view, Viewport port, Area part) {
        Checks.notNull("the viewport", port);
        check(view, "view", port.width(), port.height(), part);
    }

    private void check(int[] output, String what, int outputWidth, int outputHeight, Area part) {
        Checks.notNull(OUTPUT, output);
        Checks.size(what, outputWidth, outputHeight);
        Checks.length(OUTPUT, output.length, outputWidth, outputHeight);
        if (output == pixels) {
            throw new IllegalArgumentException(
                    OUTPUT + " is the session's own photo, expected another one");
        }
        Checks.partInside(part, what, outputWidth, outputHeight);
    }

    private static Rect rectOf(Area area) {
        return new Rect(area.left(), area.top(), area.right(), area.bottom());
    }
}
