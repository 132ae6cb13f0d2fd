package com.velt.android.orvane.lumetrix.desktop.window;

import static java.awt.event.KeyEvent.*;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.velt.android.orvane.lumetrix.desktop.editing.Placement;
import com.velt.android.orvane.lumetrix.selection.Area;
import java.awt.Point;
import java.awt.image.BufferedImage;
import java.nio.file.Path;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** The window on a screen whose pixels are smaller than the units of window positions. */
class HighDensityTest {
    private static final double SCALE = Double.parseDouble(System.getProperty("sun.java2d.uiScale"));
    private static final Path FIG =
            Path.of(System.getProperty("desktop.folder")).resolve("photos/fig.jpg");

    private Hand hand;

    @BeforeEach
    void openFig() {
        hand = Hand.on(FIG);
    }

    @AfterEach
    void closeWindow() {
        hand.close();
    }

    @Test
    void eachPixelOfTheViewIsOneOfTheScreen() {
        assertEquals(SCALE, Hand.inWindow(() -> hand.frame().canvas().deviceScale()));
        hand.drag(Hand.LEFT, 1000, 600, 1100, 600);
        hand.screenshot("density-" + SCALE);
        hand.act(VK_H);  // without dashes, which move
        hand.click(hand.frame().getRootPane().getJMenuBar());  // the pointer is off the photo
        hand.act(VK_ESCAPE);
        BufferedImage screen = hand.look();
        Point corner = Hand.inWindow(() -> hand.frame().canvas().getLocationOnScreen());
        // The window may begin at any pixel of the screen, which its own units do not tell.
        int least = Integer.MAX_VALUE;
        for (int y = -1; y <= 1; ++y) {
            for (int x = -1; x <= 1; ++x) {
                least = Math.min(least, differences(screen, (int) (corner.x * SCALE) + x,
                        (int) (corner.y * SCALE) + y));
            }
        }
        assertEquals(0, least);
    }

    /** Counts the pixels of the view that differ from those of the screen, from a corner on. */
    private int differences(BufferedImage screen, int left, int top) {
        int[] count = {0, 0};
        hand.frame().editor().look(frame -> {
            Placement placement = frame.placement();
            Area seen = placement.seen();
            for (int y = seen.top(); y <= seen.bottom(); ++y) {
                for (int x = seen.left(); x <= seen.right(); ++x) {
                    int drawn = frame.pixels()[y * placement.port().width() + x];
                    int shown = screen.getRGB(left + placement.x() + x, top + placement.y() + y);
                    if ((drawn & 0xFFFFFF) != (shown & 0xFFFFFF)) ++count[0];
                    ++count[1];
                }
            }
        });
        assertTrue(count[1] > 500_000, "compared " + count[1]);
        return count[0];
    }

    @Test
    void aDabLandsUnderThePointer() {
        hand.act(VK_B);
        hand.moveTo(900, 600);
        hand.wheel(-4);
        hand.drag(Hand.LEFT, 900, 600, 900, 600);
        int radius = hand.frame().model().brush().radius();
        hand.moveBy(250, 0);  // and takes its circle along
        hand.act(VK_F5);
        Area box = whiteBox(hand.look());
        double zoom = 1 / hand.view().scale();
        Point corner = Hand.inWindow(() -> hand.frame().canvas().getLocationOnScreen());
        double x = hand.view().viewX(900.5) + corner.x * SCALE;
        double y = hand.view().viewY(600.5) + corner.y * SCALE;
        // The pointer stands on a whole unit of the window, half a photo pixel off at most.
        double tolerance = SCALE + zoom + 1;
        assertEquals(x - (radius + 0.5) * zoom, box.left(), tolerance);
        assertEquals(x + (radius + 0.5) * zoom, box.right(), tolerance);
        assertEquals(y - (radius + 0.5) * zoom, box.top(), tolerance);
        assertEquals(y + (radius + 0.5) * zoom, box.bottom(), tolerance);
    }

    /** Returns where the screen is white in the row and column of the dab's middle. */
    private Area whiteBox(BufferedImage screen) {
        Point corner = Hand.inWindow(() -> hand.frame().canvas().getLocationOnScreen());
        int x = (int) (hand.view().viewX(900.5) + corner.x * SCALE);
        int y = (int) (hand.view().viewY(600.5) + corner.y * SCALE);
        int left = x;
        int right = x;
        int top = y;
        int bottom = y;
        while (isWhite(screen, left - 1, y)) --left;
        while (isWhite(screen, right + 1, y)) ++right;
        while (isWhite(screen, x, top - 1)) --top;
        while (isWhite(screen, x, bottom + 1)) ++bottom;
        return new Area(left, top, right, bottom);
    }

    private static boolean isWhite(BufferedImage screen, int x, int y) {
        return (screen.getRGB(x, y) & 0xFFFFFF) == 0xFFFFFF;
    }
}
