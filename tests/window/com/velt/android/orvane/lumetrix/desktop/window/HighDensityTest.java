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
        hand.click(hand.frame().getRootPane().getJMenuBar());  // the pointer is off the photo
        hand.act(VK_ESCAPE);
        hand.screenshot("density-" + SCALE);
        BufferedImage screen = hand.look();
        Point corner = Hand.inWindow(() -> hand.frame().canvas().getLocationOnScreen());
        int left = (int) Math.floor(corner.x * SCALE);
        int top = (int) Math.floor(corner.y * SCALE);
        int[] compared = {0, 0};
        hand.frame().editor().look(frame -> {
            Placement placement = frame.placement();
            Area seen = placement.seen();
            for (int y = seen.top() + 2; y <= seen.bottom() - 2; ++y) {
                for (int x = seen.left() + 2; x <= seen.right() - 2; ++x) {
                    int drawn = frame.pixels()[y * placement.port().width() + x];
                    int shown = screen.getRGB(left + placement.x() + x, top + placement.y() + y);
                    ++compared[0];
                    if ((drawn & 0xFFFFFF) != (shown & 0xFFFFFF)) ++compared[1];
                }
            }
        });
        assertTrue(compared[0] > 500_000, "compared " + compared[0]);
        assertEquals(0, compared[1], "other pixels of " + compared[0]);
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
