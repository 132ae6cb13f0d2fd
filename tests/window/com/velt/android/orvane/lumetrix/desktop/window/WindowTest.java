package com.velt.android.orvane.lumetrix.desktop.window;

import static java.awt.event.KeyEvent.*;
import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.velt.android.orvane.lumetrix.desktop.editing.Tool;
import com.velt.android.orvane.lumetrix.desktop.editing.ViewKind;
import java.awt.datatransfer.DataFlavor;
import java.awt.datatransfer.Transferable;
import java.awt.image.BufferedImage;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.List;
import javax.imageio.ImageIO;
import javax.swing.JButton;
import javax.swing.JComponent;
import javax.swing.JDialog;
import javax.swing.JFileChooser;
import javax.swing.JLabel;
import javax.swing.JOptionPane;
import javax.swing.JProgressBar;
import javax.swing.JScrollPane;
import javax.swing.TransferHandler;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** The window under a real pointer and real keys. Its pictures are kept for people to look at. */
class WindowTest {
    private static final Path DESKTOP = Path.of(System.getProperty("desktop.folder"));
    private static final Path FIG = DESKTOP.resolve("photos/fig.jpg");
    private static final String FIG_DIGEST = "384A3168";

    // Along the fig's white rind, a little inside its edge, once around.
    private static final int[] RIND = {912, 530, 962, 484, 1010, 457, 1060, 447, 1110, 451,
        1145, 463, 1192, 498, 1232, 550, 1250, 600, 1247, 650, 1232, 692, 1204, 730, 1194, 785,
        1168, 843, 1120, 886, 1065, 900, 1015, 890, 962, 852, 922, 808, 890, 765, 872, 720,
        862, 670, 858, 610, 880, 570, 912, 530};
    // Corners of a lasso around the fig.
    private static final int[] AROUND = {845, 480, 960, 415, 1110, 395, 1240, 455, 1310, 590,
        1290, 760, 1210, 890, 1080, 950, 950, 920, 850, 800, 790, 680, 740, 590, 760, 520};
    private static final int[] FLESH = {1050, 650};
    private static final int[] BOWL = {1400, 420};

    @TempDir
    private Path folder;

    private Hand hand;

    @AfterEach
    void closeWindow() {
        if (hand != null) hand.close();
        Hand.waitForEnd();
    }

    // Tools

    @Test
    void withoutAPhotoTheWindowSaysHowToOpenOne() {
        hand = Hand.on();
        hand.screenshot("empty");
        assertFalse(hand.state().work().length() > 0);
        assertTrue(hand.find(JComponent.class, "empty").isPresent());
        hand.act(VK_I);  // nothing to invert
        hand.act(VK_CONTROL, VK_Z);
        assertEquals(0, hand.state().selectedPixels());
    }

    @Test
    void theListOfKeysIsShownOnce() {
        hand = Hand.on();
        hand.keys(VK_F1);
        hand.await("list", () -> hand.find(JScrollPane.class).isPresent());
        hand.screenshot("keys");
        hand.click(hand.find(JComponent.class, "status").orElseThrow());
        hand.await("focus", () -> hand.frame().isFocused());
        hand.act(VK_F1);
        assertEquals(1, Hand.inWindow(() -> Arrays.stream(hand.frame().getOwnedWindows())
                .filter(window -> window.isShowing() && window instanceof JDialog).count()));
    }

    @Test
    void theSmartBrushSelectsTheFigUpToItsEdge() throws IOException {
        hand = Hand.on(FIG);
        hand.keys(VK_S);
        hand.beginDrag(Hand.LEFT, RIND);
        hand.screenshot("smart-brush");
        hand.release(Hand.LEFT);
        assertTrue(hand.state().unsaved());
        assertTrue(hand.state().strokeDabs() > 50);
        double share = hand.state().share();
        assertTrue(share > 0.05 && share < 0.12, "share " + share);
        assertTrue(selected(FLESH), "filled from the rind");
        assertFalse(selected(BOWL), "the bowl");
    }

    @Test
    void altAndTheRightButtonTurnTheSmartBrushIntoAnEraser() throws IOException {
        hand = Hand.on(FIG);
        hand.drag(Hand.LEFT, RIND);
        int before = hand.state().selectedPixels();
        hand.drag(Hand.RIGHT, 1050, 600, 1050, 700);
        int afterRight = hand.state().selectedPixels();
        assertTrue(afterRight < before);
        hand.moveTo(1000, 560);
        hand.hold(VK_ALT);
        hand.moveBy(2, 2);
        hand.screenshot("takes-away");
        hand.drag(Hand.LEFT, 1000, 560, 1100, 560);
        hand.letGo(VK_ALT);
        assertTrue(hand.state().selectedPixels() < afterRight);
        assertFalse(selected(new int[] {1050, 650}));
    }

    @Test
    void theSmartEraserSaysWhyAStrokeDidNothing() throws IOException {
        hand = Hand.on(FIG);
        hand.drag(Hand.LEFT, RIND);
        int before = hand.state().selectedPixels();
        hand.act(VK_D);
        assertEquals(Tool.SMART_ERASER, hand.frame().model().tool());
        hand.drag(Hand.LEFT, BOWL[0], BOWL[1], BOWL[0] + 40, BOWL[1]);
        assertEquals(before, hand.state().selectedPixels());
        JLabel toast = hand.find(JLabel.class, "toast").orElseThrow();
        assertTrue(toast.getText().contains("starts on a selected pixel"), toast.getText());
        hand.screenshot("hint");
        hand.beginDrag(Hand.LEFT, 1050, 640, 1050, 720);
        hand.screenshot("smart-eraser");
        hand.release(Hand.LEFT);
        assertTrue(hand.state().selectedPixels() < before);
    }

    @Test
    void brushAndEraserTakeAllThatTheyTouch() throws IOException {
        hand = Hand.on(FIG);
        hand.act(VK_B);
        hand.beginDrag(Hand.LEFT, 900, 600, 1200, 600);
        hand.screenshot("brush");
        hand.release(Hand.LEFT);
        int radius = hand.frame().model().brush().radius();
        assertTrue(selected(new int[] {1050, 600 - radius + 2}));
        assertFalse(selected(new int[] {1050, 600 - radius - 2}));
        hand.act(VK_G);  // filling off, else the smaller piece would go as well
        hand.act(VK_E);
        hand.beginDrag(Hand.LEFT, 1050, 520, 1050, 690);
        hand.screenshot("eraser");
        hand.release(Hand.LEFT);
        assertFalse(selected(new int[] {1050, 600}));
        assertTrue(selected(new int[] {950, 600}));
        assertTrue(selected(new int[] {1150, 600}));
        assertFalse(hand.state().fill());
    }

    @Test
    void toolsAreChosenWhileAltIsHeld() {
        hand = Hand.on(FIG);
        hand.moveTo(900, 600);
        hand.hold(VK_ALT);
        hand.act(VK_B);
        assertEquals(Tool.BRUSH, hand.frame().model().tool());
        hand.act(VK_E);
        assertEquals(Tool.ERASER, hand.frame().model().tool());
        hand.drag(Hand.LEFT, 900, 600, 1000, 600);
        hand.letGo(VK_ALT);
        assertTrue(hand.state().selectedPixels() > 0, "the eraser's opposite adds");
    }

    @Test
    void theLassoAddsWhatItEnclosesAndTheRightButtonTakesIt() throws IOException {
        hand = Hand.on(FIG);
        hand.act(VK_L);
        hand.beginDrag(Hand.LEFT, AROUND);
        hand.screenshot("lasso");
        hand.release(Hand.LEFT);
        assertTrue(selected(FLESH));
        assertFalse(selected(BOWL));
        int before = hand.state().selectedPixels();
        assertEquals(areaOf(AROUND), before, 8000);
        hand.drag(Hand.RIGHT, 950, 550, 1150, 550, 1150, 750, 950, 750);
        assertFalse(selected(FLESH));
        assertEquals(before - 200 * 200, hand.state().selectedPixels(), 4000);
        hand.screenshot("lasso-removed");
    }

    @Test
    void bracketsAndTheSliderSetTheBrushAndAConstantBrushGoesWithTheZoom() {
        hand = Hand.on(FIG);
        int size = hand.frame().model().brushSettings().size();
        hand.act(VK_CLOSE_BRACKET);
        int larger = hand.frame().model().brushSettings().size();
        assertTrue(larger > size);
        hand.act(VK_OPEN_BRACKET);
        assertEquals(size, hand.frame().model().brushSettings().size());
        JLabel tool = hand.find(JLabel.class, "status.tool").orElseThrow();
        assertTrue(tool.getText().contains("radius " + size), tool.getText());

        hand.moveTo(900, 600);
        hand.act(VK_C);
        float scale = hand.view().scale();
        hand.wheel(-6);
        assertTrue(hand.view().scale() < scale / 1.5);
        int onScreen = hand.frame().model().brushSettings().size();
        assertEquals(Math.round(onScreen * hand.view().scale()),
                hand.frame().model().brush().radius());
        assertEquals(size, Math.round(onScreen * scale), 1);
    }

    // View

    @Test
    void theWheelZoomsAtThePointer() {
        hand = Hand.on(FIG);
        hand.moveTo(1200, 500);
        // The pointer stands on whole pixels of the window: less than one off at first.
        double x = Math.floor(hand.view().viewX(1200.5));
        double y = Math.floor(hand.view().viewY(500.5));
        int column = hand.view().column(x);
        int row = hand.view().row(y);
        hand.wheel(-5);
        assertTrue(hand.view().scale() < 1);
        assertEquals(column, hand.view().column(x));
        assertEquals(row, hand.view().row(y));
        hand.screenshot("zoomed-in");
        hand.wheel(3);
        assertEquals(column, hand.view().column(x));
        hand.act(VK_F);
        assertTrue(hand.view().fitted());
        hand.act(VK_1);
        assertEquals(1, hand.view().scale());
        assertEquals(column, hand.view().column(x));
        hand.act(VK_0);
        assertTrue(hand.view().fitted());
    }

    @Test
    void spaceAndTheMiddleButtonPan() {
        hand = Hand.on(FIG);
        hand.moveTo(900, 600);
        hand.act(VK_1);
        double x = hand.view().viewX(0);
        double y = hand.view().viewY(0);
        hand.press(Hand.MIDDLE);
        hand.moveBy(60, -40);
        hand.release(Hand.MIDDLE);
        assertEquals(x + 60, hand.view().viewX(0), 0.01);
        assertEquals(y - 40, hand.view().viewY(0), 0.01);
        hand.hold(VK_SPACE);
        hand.press(Hand.LEFT);
        hand.moveBy(-30, 20);
        hand.release(Hand.LEFT);
        hand.letGo(VK_SPACE);
        assertEquals(x + 30, hand.view().viewX(0), 0.01);
        assertEquals(y - 20, hand.view().viewY(0), 0.01);
        assertEquals(0, hand.state().selectedPixels(), "panning draws nothing");
        hand.drag(Hand.LEFT, 900, 600, 920, 600);
        assertTrue(hand.state().selectedPixels() > 0, "without space it draws again");
    }

    @Test
    void viewsShowTheSelectionEachInItsWay() {
        hand = Hand.on(FIG);
        hand.drag(Hand.LEFT, RIND);
        hand.moveTo(10, 10);
        hand.act(VK_F3);
        hand.screenshot("grey-rest");
        assertTrue(isGrey(pixelAt(BOWL)));
        assertFalse(isGrey(pixelAt(FLESH)));
        hand.act(VK_F4);
        hand.screenshot("reverse");
        assertFalse(isGrey(pixelAt(BOWL)));
        assertTrue(isGrey(pixelAt(FLESH)));
        hand.act(VK_V);
        assertEquals(ViewKind.MASK, hand.frame().model().shownKind());
        hand.screenshot("mask");
        assertEquals(0x000000, pixelAt(BOWL));
        assertEquals(0xFFFFFF, pixelAt(FLESH));
        hand.act(VK_F2);
        BufferedImage outlined = hand.look();
        hand.act(VK_H);
        assertEquals(ViewKind.PHOTO, hand.frame().model().shownKind());
        assertNotEquals(0, differences(outlined, hand.look()), "the outline is hidden");
        hand.act(VK_H);
        assertEquals(ViewKind.OUTLINE, hand.frame().model().shownKind());
    }

    @Test
    void aStrokeOverThePhotoAloneSaysThatTheSelectionIsHidden() {
        hand = Hand.on(FIG);
        hand.act(VK_H);
        hand.drag(Hand.LEFT, 1000, 600, 1050, 600);
        JLabel toast = hand.find(JLabel.class, "toast").orElseThrow();
        assertTrue(toast.getText().contains("selection is hidden"), toast.getText());
        JLabel selected = hand.find(JLabel.class, "status.selected").orElseThrow();
        assertTrue(selected.getText().endsWith("(hidden)"), selected.getText());
        hand.screenshot("hidden");
        hand.act(VK_H);
        assertFalse(selected.getText().contains("hidden"), selected.getText());
    }

    @Test
    void theCircleAtThePointerHasTheBrushsSize() {
        hand = Hand.on(FIG);
        hand.moveTo(600, 600);
        double zoom = 1 / hand.view().scale();
        double radius = hand.frame().model().brush().radius() * zoom;
        double middle = hand.view().viewX(600.5);
        int row = 600;
        BufferedImage with = canvas(hand.look());
        hand.moveTo(1500, 1000);
        BufferedImage without = canvas(hand.look());
        int y = (int) hand.view().viewY(row + 0.5);
        int first = -1;
        int last = -1;
        for (int x = 0; x < with.getWidth(); ++x) {
            if (x > hand.view().viewX(1300) || with.getRGB(x, y) == without.getRGB(x, y)) continue;
            if (first < 0) first = x;
            last = x;
        }
        assertEquals(middle - radius, first, 4);
        assertEquals(middle + radius, last, 4);
    }

    // Steps

    @Test
    void stepsAreUndoneAndRedoneByKeys() {
        hand = Hand.on(FIG);
        hand.act(VK_CONTROL, VK_Z);  // nothing yet
        hand.drag(Hand.LEFT, 1000, 600, 1050, 600);
        int one = hand.state().selectedPixels();
        hand.drag(Hand.LEFT, 1100, 700, 1150, 700);
        int two = hand.state().selectedPixels();
        assertTrue(0 < one && one < two);
        hand.act(VK_CONTROL, VK_Z);
        assertEquals(one, hand.state().selectedPixels());
        hand.act(VK_CONTROL, VK_Z);
        assertEquals(0, hand.state().selectedPixels());
        hand.act(VK_CONTROL, VK_SHIFT, VK_Z);
        hand.act(VK_CONTROL, VK_Y);
        assertEquals(two, hand.state().selectedPixels());
        hand.act(VK_I);
        assertEquals(1800 * 1218 - two, hand.state().selectedPixels());
        hand.act(VK_DELETE);
        assertEquals(0, hand.state().selectedPixels());
        hand.act(VK_CONTROL, VK_Z);
        hand.act(VK_CONTROL, VK_Z);
        assertEquals(two, hand.state().selectedPixels());
    }

    // Files

    @Test
    void aSavedSessionReplaysToTheSavedMaskInTheWindowAndInThePlayer() throws Exception {
        hand = Hand.on(FIG);
        hand.drag(Hand.LEFT, RIND);
        hand.act(VK_CONTROL, VK_Z);
        hand.act(VK_OPEN_BRACKET);
        hand.drag(Hand.LEFT, RIND);
        hand.drag(Hand.RIGHT, 1050, 640, 1060, 640);
        hand.act(VK_L);
        hand.drag(Hand.LEFT, 300, 300, 500, 320, 400, 500);
        assertTrue(hand.state().unsaved());

        Path script = folder.resolve("fig.strokes");
        hand.act(VK_CONTROL, VK_S);
        answerFileDialogue(folder.resolve("fig"));  // the extension is added
        assertTrue(Files.exists(script));
        assertFalse(hand.state().unsaved());
        Path mask = folder.resolve("mask.png");
        hand.act(VK_CONTROL, VK_SHIFT, VK_S);
        answerFileDialogue(mask);
        Path cutOut = folder.resolve("cut-out.png");
        hand.act(VK_CONTROL, VK_E);
        answerFileDialogue(cutOut);
        checkCutOut(mask, cutOut);

        hand.act(VK_CONTROL, VK_R);
        answerFileDialogue(script);
        JLabel toast = hand.find(JLabel.class, "toast").orElseThrow();
        String digest = toast.getText().replaceFirst(".*digest ([0-9A-F]{8}).*", "$1");
        hand.screenshot("replayed");
        assertEquals(8, digest.length(), toast.getText());
        hand.act(VK_CONTROL, VK_SHIFT, VK_S);
        answerFileDialogue(folder.resolve("again.png"));
        assertArrayEquals(Files.readAllBytes(mask),
                Files.readAllBytes(folder.resolve("again.png")));
        Process player = new ProcessBuilder(System.getProperty("player"), script.toString(),
                "--expect", digest).redirectErrorStream(true).start();
        String said = new String(player.getInputStream().readAllBytes());
        assertEquals(0, player.waitFor(), said);
    }

    private static void checkCutOut(Path mask, Path cutOut) throws IOException {
        BufferedImage selection = ImageIO.read(mask.toFile());
        BufferedImage picture = ImageIO.read(cutOut.toFile());
        BufferedImage photo = ImageIO.read(FIG.toFile());
        for (int[] place : new int[][] {{880, 600}, BOWL, {400, 360}, {5, 5}}) {
            boolean in = (selection.getRGB(place[0], place[1]) & 1) == 1;
            int alpha = picture.getRGB(place[0], place[1]) >>> 24;
            assertEquals(in ? 255 : 0, alpha);
            if (!in) continue;
            assertEquals(photo.getRGB(place[0], place[1]), picture.getRGB(place[0], place[1]));
        }
    }

    @Test
    void aMaskThatWasSavedIsLoadedAndIsAStep() throws IOException {
        BufferedImage mask = new BufferedImage(1800, 1218, BufferedImage.TYPE_BYTE_GRAY);
        for (int y = 500; y < 600; ++y) {
            for (int x = 900; x < 1100; ++x) mask.setRGB(x, y, 0xFFFFFFFF);
        }
        ImageIO.write(mask, "png", folder.resolve("mask.png").toFile());
        hand = Hand.on(FIG);
        hand.act(VK_CONTROL, VK_L);
        answerFileDialogue(folder.resolve("mask.png"));
        assertEquals(200 * 100, hand.state().selectedPixels());
        hand.act(VK_CONTROL, VK_Z);
        assertEquals(0, hand.state().selectedPixels());
        hand.act(VK_CONTROL, VK_Y);
        assertEquals(200 * 100, hand.state().selectedPixels());
    }

    @Test
    void aFileIsReplacedOnlyWhenTheUserSaysSo() throws IOException {
        Path file = folder.resolve("view.png");
        Files.writeString(file, "mine");
        hand = Hand.on(FIG);
        hand.act(VK_CONTROL, VK_SHIFT, VK_E);
        enterFile(file);
        hand.await("question", () -> shows("exists already"));
        hand.act(VK_ESCAPE);
        assertEquals("mine", Files.readString(file));
        hand.act(VK_ESCAPE);
        hand.act(VK_CONTROL, VK_SHIFT, VK_E);
        enterFile(file);
        hand.await("question", () -> shows("exists already"));
        hand.click(button("Replace"));
        hand.settle();
        assertTrue(ImageIO.read(file.toFile()).getWidth() > 500);
    }

    @Test
    void aDroppedPhotoIsOpenedAndADroppedScriptReplayed() {
        hand = Hand.on();
        drop(FIG);
        assertEquals(1800, hand.state().photo().width());
        drop(DESKTOP.resolve("scripts/fig.strokes"));
        JLabel toast = hand.find(JLabel.class, "toast").orElseThrow();
        assertTrue(toast.getText().contains(FIG_DIGEST), toast.getText());
    }

    @Test
    void aScriptOfTheCommandLineIsReplayedToItsDigest() {
        hand = Hand.on(DESKTOP.resolve("scripts/fig.strokes"));
        JLabel toast = hand.find(JLabel.class, "toast").orElseThrow();
        assertTrue(toast.getText().contains(FIG_DIGEST), toast.getText());
        assertFalse(hand.state().unsaved());
        hand.screenshot("fig");
    }

    @Test
    void escapeStopsAReplayAndStrokesGoOnFromThere() throws IOException {
        StringBuilder script = new StringBuilder("photo \"" + FIG + "\"\nbrush 60 10\n");
        for (int i = 0; i < 400; ++i) {
            int x = 200 + i * 7 % 1000;
            int y = 200 + i * 91 % 800;
            script.append("grow ").append(x).append(',').append(y).append(" to ").append(x + 120)
                    .append(',').append(y).append('\n');
        }
        Path file = Files.writeString(folder.resolve("long.strokes"), script);
        hand = Hand.on(FIG);
        Hand.inWindow(() -> {
            hand.frame().use(file);
            return null;
        });
        hand.await("progress", () -> hand.find(JProgressBar.class, "work.bar")
                .filter(bar -> bar.getValue() >= 40).isPresent());
        hand.await("selection", () -> hand.state().selectedPixels() > 0);
        hand.picture("replaying");
        hand.keys(VK_ESCAPE);
        hand.settle();
        JLabel toast = hand.find(JLabel.class, "toast").orElseThrow();
        assertTrue(toast.getText().startsWith("Stopped long.strokes after "), toast.getText());
        int before = hand.state().selectedPixels();
        assertTrue(before > 0);
        hand.act(VK_B);
        hand.drag(Hand.LEFT, 1650, 1100, 1700, 1100);
        assertTrue(hand.state().selectedPixels() > before);
    }

    @Test
    void whatIsNoPictureIsRefusedWithAReason() throws IOException {
        Path file = Files.writeString(folder.resolve("notes.jpg"), "no picture");
        hand = Hand.on(FIG);
        drop(file);
        hand.await("message", () -> shows("notes.jpg cannot be opened: it is no picture. Choose a"
                + " JPEG or PNG file."));
        hand.screenshot("refused");
        hand.act(VK_ENTER);
        assertFalse(Hand.inWindow(() -> shows("notes.jpg")));
        assertEquals("fig.jpg", hand.state().photo().name());
    }

    @Test
    void savingAsksForTheFolderToSaveIn() {
        hand = Hand.on(FIG);
        hand.keys(VK_CONTROL, VK_S);
        hand.await("file dialogue", () -> hand.find(JFileChooser.class).isPresent());
        assertTrue(hand.findLabel("Save In:").isPresent());
        hand.picture("saving");
        hand.act(VK_ESCAPE);
        hand.keys(VK_CONTROL, VK_O);
        hand.await("file dialogue", () -> hand.find(JFileChooser.class).isPresent());
        assertTrue(hand.findLabel("Look In:").isPresent());
        hand.act(VK_ESCAPE);
    }

    @Test
    void aFolderThatIsMissingIsNotWhereTheNextFileIsLookedFor() {
        hand = Hand.on(FIG);
        hand.act(VK_CONTROL, VK_S);
        enterFile(folder.resolve("none").resolve("fig.strokes"));
        hand.await("message", () -> shows("Choose another place."));
        hand.act(VK_ENTER);
        hand.keys(VK_CONTROL, VK_S);
        hand.await("file dialogue", () -> hand.find(JFileChooser.class).isPresent());
        assertEquals(FIG.getParent().toFile(),
                hand.find(JFileChooser.class).orElseThrow().getCurrentDirectory());
        hand.act(VK_ESCAPE);
    }

    @Test
    void closingWithUnsavedWorkAsks() {
        hand = Hand.on(FIG);
        hand.drag(Hand.LEFT, 1000, 600, 1050, 600);
        hand.keys(VK_CONTROL, VK_Q);
        hand.await("question", () -> shows("is not saved"));
        hand.picture("closing");
        hand.keys(VK_ESCAPE);
        hand.settle();
        assertTrue(hand.frame().isShowing());
        hand.keys(VK_CONTROL, VK_Q);
        hand.await("question", () -> shows("is not saved"));
        hand.clickAway(button("Discard"));
        hand.await("end", () -> !hand.frame().isShowing());
        hand = null;
    }

    @Test
    void closingSavesWhenAskedTo() {
        hand = Hand.on(FIG);
        hand.drag(Hand.LEFT, 1000, 600, 1050, 600);
        hand.keys(VK_CONTROL, VK_Q);
        hand.await("question", () -> shows("is not saved"));
        hand.clickAway(button("Save"));
        enterFile(folder.resolve("work.strokes"));
        hand.await("end", () -> !hand.frame().isShowing());
        assertTrue(Files.exists(folder.resolve("work.strokes")));
        hand = null;
    }

    // Helpers

    private boolean selected(int[] place) throws IOException {
        Path file = folder.resolve("selected-" + System.nanoTime() + ".png");
        hand.frame().editor().saveMask(file).join();
        hand.settle();
        return (ImageIO.read(file.toFile()).getRGB(place[0], place[1]) & 0xFFFFFF) == 0xFFFFFF;
    }

    private static double areaOf(int[] corners) {
        double twice = 0;
        for (int i = 0; i < corners.length; i += 2) {
            int next = (i + 2) % corners.length;
            twice += (double) corners[i] * corners[next + 1] - (double) corners[next] * corners[i + 1];
        }
        return Math.abs(twice) / 2;
    }

    private static boolean isGrey(int pixel) {
        int red = pixel >> 16 & 255;
        return red == (pixel >> 8 & 255) && red == (pixel & 255);
    }

    private int pixelAt(int[] place) {
        int x = (int) hand.view().viewX(place[0] + 0.5);
        int y = (int) hand.view().viewY(place[1] + 0.5);
        return canvas(hand.look()).getRGB(x, y) & 0xFFFFFF;
    }

    private BufferedImage canvas(BufferedImage screen) {
        return Hand.inWindow(() -> {
            JComponent canvas = hand.frame().canvas();
            return screen.getSubimage(canvas.getLocationOnScreen().x,
                    canvas.getLocationOnScreen().y, canvas.getWidth(), canvas.getHeight());
        });
    }

    private static int differences(BufferedImage one, BufferedImage other) {
        int count = 0;
        for (int y = 0; y < one.getHeight(); ++y) {
            for (int x = 0; x < one.getWidth(); ++x) {
                if (one.getRGB(x, y) != other.getRGB(x, y)) ++count;
            }
        }
        return count;
    }

    private void answerFileDialogue(Path file) {
        enterFile(file);
        hand.await("end of the dialogue",
                () -> hand.frame().isFocused() && hand.find(JFileChooser.class).isEmpty());
        hand.settle();
    }

    private void enterFile(Path file) {
        hand.await("file dialogue", () -> hand.find(JFileChooser.class).isPresent());
        hand.keys(VK_CONTROL, VK_A);
        hand.type(file.toString());
        hand.keys(VK_ENTER);
    }

    /** Tells whether a dialogue shows a text. */
    private boolean shows(String text) {
        return hand.find(JOptionPane.class)
                .filter(pane -> String.valueOf(pane.getMessage()).replace('\n', ' ').contains(text))
                .isPresent();
    }

    private JButton button(String text) {
        return hand.findButton(text).orElseThrow();
    }

    private void drop(Path file) {
        Transferable files = new Transferable() {
            @Override
            public DataFlavor[] getTransferDataFlavors() {
                return new DataFlavor[] {DataFlavor.javaFileListFlavor};
            }

            @Override
            public boolean isDataFlavorSupported(DataFlavor flavor) {
                return flavor.equals(DataFlavor.javaFileListFlavor);
            }

            @Override
            public Object getTransferData(DataFlavor flavor) {
                return List.of(file.toFile());
            }
        };
        Hand.inWindow(() -> {
            JComponent root = hand.frame().getRootPane();
            return root.getTransferHandler()
                    .importData(new TransferHandler.TransferSupport(root, files));
        });
        hand.settle();
    }
}
