package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.desktop.Drawings;
import com.velt.android.orvane.lumetrix.jni.Util;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.Mode;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import com.velt.android.orvane.lumetrix.selection.Viewport;
import java.util.Arrays;
import java.util.Random;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.EnumSource;

class RendererTest {
    private static final int SESSIONS = 250;
    private static final int UNTOUCHED = 0x12345678;

    /** A photo of random size and colours, with a selection that random strokes have left. */
    private static final class Edited implements AutoCloseable {
        final Random random;
        final int width;
        final int height;
        final int[] photo;
        final SelectionSession session;
        final Renderer renderer;

        Edited(int seed) {
            random = new Random(seed);
            int longest = random.nextInt(4) == 0 ? 4 : 90;
            width = 1 + random.nextInt(longest);
            height = 1 + random.nextInt(longest);
            photo = random.ints(width * height).toArray();
            for (int i = 1; i < photo.length; ++i) {
                if (random.nextInt(4) > 0) photo[i] = photo[i - 1];
            }
            session = new SelectionSession(photo, width, height);
            renderer = new Renderer(session, photo);
            int strokes = random.nextInt(6);
            for (int i = 0; i < strokes; ++i) deed();
        }

        /** Does something and returns where it has changed the selection. */
        Area deed() {
            return switch (random.nextInt(8)) {
                case 0, 1 -> lasso();
                case 2 -> random.nextInt(4) == 0 ? session.invert() : Area.EMPTY;
                case 3 -> session.canUndo() ? session.undo() : Area.EMPTY;
                default -> stroke();
            };
        }

        private Area lasso() {
            session.setFill(random.nextInt(3) == 0);
            Mode mode = random.nextBoolean() ? Mode.LASSO_ADD : Mode.LASSO_REMOVE;
            return session.lasso(mode, point(width), point(height), point(width), point(height),
                    point(width), point(height), point(width), point(height));
        }

        private Area stroke() {
            session.setFill(random.nextInt(3) == 0);
            session.setBrush(random.nextInt(12), random.nextInt(6));
            Area changed = Area.EMPTY;
            session.begin(Mode.values()[random.nextInt(4)]);
            for (int dabs = random.nextInt(3); dabs >= 0; --dabs) {
                changed = changed.union(session.dab(point(width), point(height)));
            }
            return changed.union(session.end());
        }

        int point(int size) {
            return random.nextInt(size);
        }

        Placement placement(ViewKind kind) {
            ViewModel model = new ViewModel();
            int viewWidth = 1 + random.nextInt(80);
            int viewHeight = 1 + random.nextInt(60);
            model.setView(viewWidth, viewHeight);
            model.setPhoto(width, height);
            for (int moves = random.nextInt(3); moves > 0; --moves) {
                model.zoom(Math.pow(2, random.nextDouble() * 8 - 3),
                        random.nextDouble() * viewWidth, random.nextDouble() * viewHeight);
                model.pan(random.nextDouble() * 60 - 30, random.nextInt(41) - 20);
            }
            return model.placement(kind);
        }

        Frame draw(Placement placement, ViewKind kind, int dashes) {
            Frame frame = emptyFrame(placement, kind);
            renderer.drawWhole(frame, dashes);
            return frame;
        }

        @Override
        public void close() {
            session.close();
        }
    }

    private static Frame emptyFrame(Placement placement, ViewKind kind) {
        int[] pixels = new int[placement.port().width() * placement.port().height()];
        Arrays.fill(pixels, UNTOUCHED);
        return new Frame(pixels, placement, kind);
    }

    private static Rect rectOf(Area area) {
        return new Rect(area.left(), area.top(), area.right(), area.bottom());
    }

    @ParameterizedTest
    @EnumSource
    void changesDrawnOneByOneGiveThePictureDrawnAsAWhole(ViewKind kind) {
        for (int seed = 0; seed < SESSIONS; ++seed) {
            try (Edited edited = new Edited(seed)) {
                Placement placement = edited.placement(kind);
                int dashes = edited.random.nextInt(2);
                Frame frame = edited.draw(placement, kind, dashes);
                for (int i = 0; i < 6; ++i) {
                    edited.renderer.drawChange(frame, edited.deed(), dashes);
                    assertArrayEquals(edited.draw(placement, kind, dashes).pixels(),
                            frame.pixels(), "seed " + seed + ", " + placement);
                }
            }
        }
    }

    @ParameterizedTest
    @EnumSource
    void dabsDrawnInAStrokeGiveThePictureDrawnAsAWhole(ViewKind kind) {
        for (int seed = 0; seed < SESSIONS; ++seed) {
            try (Edited edited = new Edited(seed)) {
                edited.session.reset();  // dabs do not tell of outlines that they wipe out
                edited.session.setBrush(5, 2);
                edited.session.setFill(seed % 2 == 0);
                Placement placement = edited.placement(kind);
                Frame frame = edited.draw(placement, kind, 0);
                for (Mode mode : new Mode[] {Mode.PAINT, Mode.ERASE, Mode.GROW, Mode.SHRINK}) {
                    edited.session.begin(mode);
                    for (int i = 0; i < 4; ++i) {
                        Area changed = edited.session.dab(edited.point(edited.width),
                                edited.point(edited.height));
                        edited.renderer.drawChange(frame, changed, 0);
                        assertArrayEquals(edited.draw(placement, kind, 0).pixels(),
                                frame.pixels(), "seed " + seed + ", " + placement);
                    }
                    edited.session.end();
                }
            }
        }
    }

    @ParameterizedTest
    @EnumSource(names = {"GREY_REST", "REVERSE", "MASK"})
    void viewIsThePictureOfTheWholePhotoDrawnPlainly(ViewKind kind) {
        for (int seed = 0; seed < SESSIONS; ++seed) {
            try (Edited edited = new Edited(seed)) {
                Placement placement = edited.placement(kind);
                Viewport port = placement.port();
                int[] picture = new int[edited.photo.length];
                switch (kind) {
                    case GREY_REST -> edited.session.drawColourOnGrey(picture,
                            new Area(0, 0, edited.width - 1, edited.height - 1));
                    case REVERSE -> edited.session.drawReverse(picture);
                    default -> picture = Drawings.mask(edited.session).pixels();
                }
                Frame expected = emptyFrame(placement, kind);
                Util.native_drawImage(expected.pixels(), port.width(), port.height(), picture,
                        edited.width, edited.height, port.scale(), port.offsetX(), port.offsetY(),
                        rectOf(placement.part()));
                assertArrayEquals(expected.pixels(), edited.draw(placement, kind, 0).pixels(),
                        "seed " + seed + ", " + placement);
            }
        }
    }

    @Test
    void outlineAndPhotoAreTheLibrarysOwnViewsHoweverLargeThePhoto() {
        int[] large = new int[2];
        for (int seed = 0; seed < SESSIONS; ++seed) {
            try (Edited edited = new Edited(seed)) {
                for (ViewKind kind : new ViewKind[] {ViewKind.OUTLINE, ViewKind.PHOTO}) {
                    Frame drawn = edited.draw(edited.placement(kind), kind, seed % 2);
                    Frame expected = emptyFrame(drawn.placement(), kind);
                    edited.renderer.drawDirectly(expected, seed % 2);
                    assertArrayEquals(expected.pixels(), drawn.pixels(), "seed " + seed);
                    ++large[edited.photo.length > 2 * drawn.pixels().length ? 1 : 0];
                }
            }
        }
        assertTrue(large[0] > 50 && large[1] > 50, Arrays.toString(large));
    }

    @ParameterizedTest
    @EnumSource
    void drawingWritesInsideThePartAloneAndChangesNeitherPhotoNorMask(ViewKind kind) {
        for (int seed = 0; seed < SESSIONS; ++seed) {
            try (Edited edited = new Edited(seed)) {
                int[] photo = edited.photo.clone();
                byte[] mask = edited.session.mask();
                Frame frame = edited.draw(edited.placement(kind), kind, 0);
                edited.renderer.drawChange(frame,
                        new Area(0, 0, edited.width - 1, edited.height - 1), 1);
                assertArrayEquals(photo, edited.photo);
                assertArrayEquals(mask, edited.session.mask());
                Area part = frame.placement().part();
                int stride = frame.placement().port().width();
                for (int i = 0; i < frame.pixels().length; ++i) {
                    boolean inside = i % stride >= part.left() && i % stride <= part.right()
                            && i / stride >= part.top() && i / stride <= part.bottom();
                    if (!inside) assertEquals(UNTOUCHED, frame.pixels()[i], "seed " + seed);
                }
            }
        }
    }

    @Test
    void otherDashesExchangeTheTwoColours() {
        int width = 40;
        int[] photo = new int[width * width];
        Arrays.fill(photo, 0xFF123456);
        try (SelectionSession session = new SelectionSession(photo, width, width)) {
            session.setBrush(12, 3);
            session.brush(Mode.PAINT, 20, 20);
            Frame first = outline(session, photo, 0);
            Frame second = outline(session, photo, 1);
            int[] dashed = new int[2];
            for (int i = 0; i < first.pixels().length; ++i) {
                int before = first.pixels()[i];
                int after = switch (before) {
                    case Drawings.WHITE -> Drawings.BLACK;
                    case Drawings.BLACK -> Drawings.WHITE;
                    default -> before;
                };
                assertEquals(after, second.pixels()[i]);
                if (before == Drawings.WHITE) ++dashed[0];
                if (before == Drawings.BLACK) ++dashed[1];
            }
            assertTrue(dashed[0] > 20 && dashed[1] > 20, Arrays.toString(dashed));
            Renderer renderer = new Renderer(session, photo);
            renderer.drawChange(first, session.objectBox(), 1);
            assertArrayEquals(second.pixels(), first.pixels());
        }
    }

    private static Frame outline(SelectionSession session, int[] photo, int dashes) {
        ViewModel model = new ViewModel();
        model.setView(150, 150);
        model.setPhoto(session.width(), session.height());
        Frame frame = emptyFrame(model.placement(ViewKind.OUTLINE), ViewKind.OUTLINE);
        new Renderer(session, photo).drawWhole(frame, dashes);
        return frame;
    }

    @Test
    void selectionThatReachesBeyondTheWindowHasNoOutlineInIt() {
        int width = 300;
        int[] photo = new int[width * width];
        Arrays.fill(photo, 0xFF123456);
        try (SelectionSession session = new SelectionSession(photo, width, width)) {
            session.invert();
            Random random = new Random(8);
            for (int i = 0; i < 300; ++i) {
                ViewModel model = new ViewModel();
                model.setView(60, 50);
                model.setPhoto(width, width);
                model.zoom(Math.pow(2, 2 + random.nextDouble() * 5), 30, 25);
                model.pan(random.nextDouble() * 80 - 40, random.nextDouble() * 80 - 40);
                Frame frame = emptyFrame(model.placement(ViewKind.OUTLINE), ViewKind.OUTLINE);
                new Renderer(session, photo).drawWhole(frame, 0);
                int inWindow = 0;
                for (int pixel : frame.seen().pixels()) {
                    if (pixel != 0xFF123456) ++inWindow;
                }
                assertEquals(0, inWindow, frame.placement().toString());
                assertEquals(60 * 50, frame.seen().pixels().length);
                Area part = frame.placement().part();
                assertTrue(isDash(frame, part.left(), part.top())
                        && isDash(frame, part.right(), part.bottom()));
            }
        }
    }

    private static boolean isDash(Frame frame, int x, int y) {
        int pixel = frame.pixels()[y * frame.placement().port().width() + x];
        return pixel == Drawings.WHITE || pixel == Drawings.BLACK;
    }
}
