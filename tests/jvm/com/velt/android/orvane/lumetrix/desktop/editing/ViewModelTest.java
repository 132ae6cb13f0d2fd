package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.velt.android.orvane.lumetrix.jni.Util;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.Viewport;
import java.util.Arrays;
import java.util.Random;
import org.junit.jupiter.api.Test;

class ViewModelTest {
    private static final double TINY = 1e-6;
    private static final int RANDOM_VIEWS = 20_000;

    private static ViewModel model(int viewWidth, int viewHeight, int photoWidth,
            int photoHeight) {
        ViewModel model = new ViewModel();
        model.setView(viewWidth, viewHeight);
        model.setPhoto(photoWidth, photoHeight);
        return model;
    }

    @Test
    void fittedPhotoLiesCentredInTheWindow() {
        for (int[] photo : new int[][] {{4000, 3000}, {3000, 4000}, {1400, 900}, {20000, 3},
                {60, 40}}) {
            ViewModel model = model(1400, 900, photo[0], photo[1]);
            double left = model.viewX(0);
            double top = model.viewY(0);
            assertTrue(left >= 12 && top >= 12, left + ", " + top);
            assertEquals(left, 1400 - model.viewX(photo[0]), TINY);
            assertEquals(top, 900 - model.viewY(photo[1]), TINY);
            assertTrue(model.fitted());
        }
    }

    @Test
    void fittedPhotoTouchesOneMargin() {
        ViewModel model = model(1400, 900, 4000, 3000);
        assertEquals(12, model.viewY(0), 0.1);
    }

    @Test
    void photoOfOnePixelIsCentredAndAsLargeAsCanBe() {
        ViewModel model = model(1400, 900, 1, 1);
        assertEquals(ViewModel.SMALLEST_SCALE, model.scale());
        assertEquals(700 - 16, model.viewX(0), TINY);
        assertEquals(450 - 16, model.viewY(0), TINY);
    }

    @Test
    void fittedPhotoLeavesNoMarginThatASmallWindowHasNotRoomFor() {
        for (int view = 1; view < 60; ++view) {
            ViewModel model = model(view, view, 100, 100);
            assertTrue(model.viewX(0) >= -TINY && model.viewX(100) <= view + TINY, "view " + view);
        }
    }

    @Test
    void fittedPhotoStaysFittedWhenTheWindowChangesItsSize() {
        ViewModel model = model(1400, 900, 4000, 3000);
        model.setView(500, 800);
        assertTrue(model.fitted());
        assertEquals(12, model.viewX(0), 0.1);
        assertEquals(model.viewY(0), 800 - model.viewY(3000), TINY);
    }

    @Test
    void middleStaysWhenTheWindowOfAMovedPhotoChangesItsSize() {
        ViewModel model = model(1400, 900, 4000, 3000);
        model.showTruePixels(300, 200);
        model.pan(-30, 12);
        double x = 700 - model.viewX(0);
        double y = 450 - model.viewY(0);
        model.setView(333, 777);
        assertFalse(model.fitted());
        assertEquals(x, 333 / 2.0 - model.viewX(0), TINY);
        assertEquals(y, 777 / 2.0 - model.viewY(0), TINY);
    }

    @Test
    void viewOfNoSizeCountsAsOnePixel() {
        ViewModel model = model(0, -5, 100, 100);
        Placement placement = model.placement(ViewKind.OUTLINE);
        assertEquals(1, placement.seen().width());
        assertEquals(1, placement.seen().height());
    }

    @Test
    void zoomingKeepsWhatIsUnderThePointer() {
        Random random = new Random(1);
        for (int i = 0; i < 2000; ++i) {
            ViewModel model = model(800, 600, 4000, 3000);
            model.showTruePixels(400, 300);
            double x = random.nextDouble() * 800;
            double y = random.nextDouble() * 600;
            double photoX = x * model.scale() - model.viewX(0) * model.scale();
            double photoY = y * model.scale() - model.viewY(0) * model.scale();
            for (int k = 0; k < 5; ++k) model.zoom(0.9 + random.nextDouble(), x, y);
            assertEquals(x, model.viewX(photoX), 1);
            assertEquals(y, model.viewY(photoY), 1);
        }
    }

    @Test
    void truePixelsShowAPhotoPixelInEachScreenPixel() {
        ViewModel model = model(800, 600, 4000, 3000);
        int column = model.column(100);
        model.showTruePixels(100, 100);
        assertEquals(1, model.scale());
        assertEquals(column, model.column(100), 1);
        assertFalse(model.fitted());
    }

    @Test
    void panningMovesThePhotoByScreenPixels() {
        ViewModel model = model(800, 600, 4000, 3000);
        model.zoom(3.7, 400, 300);
        double x = model.viewX(2000);
        double y = model.viewY(1500);
        model.pan(17, -9);
        assertEquals(x + 17, model.viewX(2000), TINY);
        assertEquals(y - 9, model.viewY(1500), TINY);
    }

    @Test
    void scaleKeepsToItsLimits() {
        ViewModel model = model(800, 600, 4000, 3000);
        model.zoom(1e9, 400, 300);
        assertEquals(ViewModel.SMALLEST_SCALE, model.scale());
        model.zoom(1e-9, 400, 300);
        assertEquals(20, model.scale());
        ViewModel small = model(800, 600, 40, 30);
        small.zoom(1e-9, 400, 300);
        assertEquals(1, small.scale());
    }

    @Test
    void scalesAreWholeStepsOfTheLibrary() {
        Random random = new Random(2);
        ViewModel model = model(801, 603, 4000, 3000);
        for (int i = 0; i < 1000; ++i) {
            model.zoom(0.5 + random.nextDouble(), 400, 300);
            assertEquals(Math.rint(model.scale() * 65536.0), model.scale() * 65536.0);
        }
    }

    @Test
    void middleOfTheWindowNeverLeavesThePhoto() {
        ViewModel model = model(800, 600, 4000, 3000);
        model.zoom(5, 400, 300);
        model.pan(1e7, -1e7);
        assertTrue(model.onPhoto(model.column(400), model.row(300)));
        model.pan(-1e7, 1e7);
        assertTrue(model.onPhoto(model.column(400), model.row(300)));
    }

    @Test
    void positionsAndPixelsAgree() {
        Random random = new Random(3);
        for (int i = 0; i < 2000; ++i) {
            ViewModel model = randomly(random).model;
            int column = random.nextInt(100) - 20;
            int row = random.nextInt(100) - 20;
            assertEquals(column, model.column(model.viewX(column + 0.5)));
            assertEquals(row, model.row(model.viewY(row + 0.5)));
        }
    }

    @Test
    void pixelsOnThePhotoAreThoseOfItsSize() {
        ViewModel model = model(80, 60, 4, 3);
        assertTrue(model.onPhoto(0, 0) && model.onPhoto(3, 2));
        assertFalse(model.onPhoto(-1, 0) || model.onPhoto(0, -1) || model.onPhoto(4, 0)
                || model.onPhoto(0, 3));
    }

    // Placements

    private record Shown(ViewModel model, int viewWidth, int viewHeight, int photoWidth,
            int photoHeight) {}

    private static Shown randomly(Random random) {
        int[][] photos = {{1, 1}, {1, 2000}, {20000, 3}, {2, 2}, {4000, 3000}, {640, 480},
                {1 + random.nextInt(50), 1 + random.nextInt(50)}};
        int[] photo = photos[random.nextInt(photos.length)];
        int longest = random.nextInt(3) == 0 ? 3 : 700;
        int viewWidth = 1 + random.nextInt(longest);
        int viewHeight = 1 + random.nextInt(longest);
        ViewModel model = model(random.nextInt(longest), 9, photo[0], photo[1]);
        model.setView(viewWidth, viewHeight);
        int moves = random.nextInt(6);
        for (int i = 0; i < moves; ++i) {
            double x = random.nextDouble() * viewWidth;
            double y = random.nextDouble() * viewHeight;
            switch (random.nextInt(4)) {
                case 0 -> model.zoom(Math.pow(2, random.nextDouble() * 12 - 5), x, y);
                case 1 -> model.pan(random.nextInt(801) - 400, random.nextInt(801) - 400);
                case 2 -> model.pan(random.nextDouble() * 9 - 4, random.nextDouble() * 9 - 4);
                default -> model.showTruePixels(x, y);
            }
        }
        return new Shown(model, viewWidth, viewHeight, photo[0], photo[1]);
    }

    /** One direction of a placement, and what it has to show. */
    private record Line(double start, double scale, float rounding, int photo, int view, int size,
            int offset, int first, int last, int place, int seenFirst, int seenLast) {
        /** Returns where on the photo the drawing's column samples. */
        double sampled(int column) {
            return offset + column * scale + rounding;
        }

        /** Returns where on the photo a column of the window is. */
        double wanted(int windowColumn) {
            return start + windowColumn * scale;
        }

        /** Half a screen pixel, or half a photo pixel when reduced, in photo pixels. */
        double tolerance() {
            return 0.5 * Math.min(1, scale) + TINY;
        }

        void check() {
            assertTrue(0 <= first && first <= last && last < size, toString());
            for (int column : new int[] {first, last}) {
                int position = Placement.sampled(offset, (float) scale, rounding, column);
                assertTrue(position >= 0 && position < photo, toString());
            }
            assertTrue(place + first >= -1 && place + last <= view, toString());
            if (photo < scale) return;  // it may lie between two screen pixels
            assertEquals(wanted(place), sampled(0), tolerance(), toString());
            int mostLeft = (int) Math.ceil((tolerance() - start) / scale);
            int mostRight = (int) Math.floor((photo - tolerance() - start) / scale);
            // All columns of the window that lie on the photo, and one more where it goes on.
            assertTrue(place + first <= Math.max(-1, mostLeft), toString());
            assertTrue(place + last >= Math.min(view, mostRight), toString());
            if (seenLast < 0) return;
            assertEquals(Math.max(0, place + first), place + seenFirst, toString());
            assertEquals(Math.min(view - 1, place + last), place + seenLast, toString());
        }
    }

    @Test
    void placementsShowThePhotoWhereItIs() {
        Random random = new Random(4);
        for (int i = 0; i < RANDOM_VIEWS; ++i) {
            Shown shown = randomly(random);
            ViewModel model = shown.model;
            for (ViewKind kind : new ViewKind[] {ViewKind.OUTLINE, ViewKind.PHOTO}) {
                Placement placement = model.placement(kind);
                Viewport port = placement.port();
                Area part = placement.part();
                Area seen = placement.seen();
                assertEquals(model.scale(), port.scale());
                // In a window of one column the nearest sample may belong to the column beside it.
                boolean narrow = shown.viewWidth == 1 || shown.viewHeight == 1;
                assertTrue(narrow || !seen.isEmpty(), shown.toString());
                new Line(-model.viewX(0) * model.scale(), model.scale(), kind.rounding(),
                        shown.photoWidth, shown.viewWidth, port.width(), port.offsetX(),
                        part.left(), part.right(), placement.x(), seen.left(), seen.right())
                        .check();
                new Line(-model.viewY(0) * model.scale(), model.scale(), kind.rounding(),
                        shown.photoHeight, shown.viewHeight, port.height(), port.offsetY(),
                        part.top(), part.bottom(), placement.y(), seen.top(), seen.bottom())
                        .check();
            }
        }
    }

    @Test
    void samplesArePositionsOfTheLibrary() {
        Random random = new Random(5);
        for (int i = 0; i < 500; ++i) {
            Viewport port = randomly(random).model.placement(ViewKind.PHOTO).port();
            int[] expected = new int[port.width() + port.height()];
            Util.native_setImagePoints(port.width(), port.height(), 0, 0, port.scale(),
                    port.offsetX(), port.offsetY(), expected);
            int[] actual = new int[expected.length];
            Arrays.setAll(actual, k -> k < port.width()
                    ? Placement.sampled(port.offsetX(), port.scale(), 0, k)
                    : Placement.sampled(port.offsetY(), port.scale(), 0, k - port.width()));
            assertArrayEquals(expected, actual, port.toString());
        }
    }
}
