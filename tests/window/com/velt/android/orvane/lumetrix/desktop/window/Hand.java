package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.desktop.editing.EditorState;
import com.velt.android.orvane.lumetrix.desktop.editing.Settling;
import com.velt.android.orvane.lumetrix.desktop.editing.ViewModel;
import java.awt.AWTException;
import java.awt.Component;
import java.awt.Container;
import java.awt.Image;
import java.awt.Point;
import java.awt.Robot;
import java.awt.Toolkit;
import java.awt.Window;
import java.awt.event.InputEvent;
import java.awt.event.KeyEvent;
import java.awt.image.BufferedImage;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import java.util.Optional;
import java.util.concurrent.Callable;
import java.util.concurrent.FutureTask;
import java.util.function.BooleanSupplier;
import java.util.function.Predicate;
import javax.imageio.ImageIO;
import javax.swing.JButton;
import javax.swing.JLabel;
import javax.swing.SwingUtilities;

/**
 * A hand on mouse and keyboard: real events of the display, as slow as a hand. Places are those of
 * photo pixels.
 */
final class Hand implements AutoCloseable {
    static final int LEFT = InputEvent.BUTTON1_DOWN_MASK;
    static final int MIDDLE = InputEvent.BUTTON2_DOWN_MASK;
    static final int RIGHT = InputEvent.BUTTON3_DOWN_MASK;

    private static final int STEP = 8;          // pixels that the pointer moves at once
    private static final int STEP_MILLIS = 4;   // and how long that takes
    private static final int PRESS_MILLIS = 15;
    private static final long PATIENCE_NANOS = 20_000_000_000L;

    private static final Path SCREENSHOTS = Path.of(System.getProperty("screenshots"));

    private final ScreenFrame frame;
    private final Robot robot;
    private Point pointer = new Point();

    private Hand(ScreenFrame frame) {
        this.frame = frame;
        try {
            robot = new Robot();
        } catch (AWTException e) {
            throw new IllegalStateException("this display takes no events of programs", e);
        }
    }

    /** Opens the window, with its own dialogues, and waits until it shows what it was given. */
    static Hand on(Path... file) {
        List<String> words = List.of(file).stream().map(Path::toString).toList();
        Hand hand = new Hand(EditingScreen.open(null, null, Arguments.parse(words)));
        hand.settle();
        return hand;
    }

    ScreenFrame frame() {
        return frame;
    }

    /** Closes the window, whatever is not saved. */
    @Override
    public void close() {
        inWindow(() -> {
            for (Window window : Window.getWindows()) {
                if (window != frame) window.dispose();
            }
            frame.close();
            return null;
        });
        waitForEnd();
    }

    /** Waits for the end of the window's threads; then another one can be opened. */
    static void waitForEnd() {
        for (Thread thread : Thread.getAllStackTraces().keySet()) {
            if (!List.of("closing", "editor", "files").contains(thread.getName())) continue;
            try {
                thread.join();
            } catch (InterruptedException e) {
                throw new IllegalStateException("nobody interrupts this thread", e);
            }
        }
    }

    // What the window knows

    EditorState state() {
        return inWindow(() -> frame.model().state());
    }

    ViewModel view() {
        return frame.model().view();
    }

    /** Returns what is asked of the window, in its own thread. */
    static <T> T inWindow(Callable<T> question) {
        if (SwingUtilities.isEventDispatchThread()) return answer(question);
        FutureTask<T> task = new FutureTask<>(question);
        SwingUtilities.invokeLater(task);
        try {
            return task.get();
        } catch (Exception e) {
            throw new IllegalStateException(e);
        }
    }

    private static <T> T answer(Callable<T> question) {
        try {
            return question.call();
        } catch (Exception e) {
            throw new IllegalStateException(e);
        }
    }

    /** Waits until all that was done so far can be seen. */
    void settle() {
        for (int round = 0; round < 2; ++round) {
            robot.waitForIdle();
            Settling.of(frame.editor());
        }
        robot.waitForIdle();
    }

    /** Waits for something; fails when it does not come. */
    void await(String what, BooleanSupplier condition) {
        long start = System.nanoTime();
        while (!inWindow(condition::getAsBoolean)) {
            if (System.nanoTime() - start > PATIENCE_NANOS) {
                screenshot("missing");
                throw new AssertionError("no " + what + " came; see the screenshot missing.png");
            }
            robot.delay(PRESS_MILLIS);
        }
    }

    /** Returns a part of any window that is shown, by its name. */
    <T extends Component> Optional<T> find(Class<T> type, String name) {
        return find(type, part -> name.equals(part.getName()));
    }

    /** Returns a part of any window that is shown. */
    <T extends Component> Optional<T> find(Class<T> type) {
        return find(type, part -> true);
    }

    /** Returns a button of a dialogue, by its text. */
    Optional<JButton> findButton(String text) {
        return find(JButton.class, button -> text.equals(button.getText()));
    }

    /** Returns a label of any window that is shown, by its text. */
    Optional<JLabel> findLabel(String text) {
        return find(JLabel.class, label -> text.equals(label.getText()));
    }

    private <T extends Component> Optional<T> find(Class<T> type, Predicate<T> wanted) {
        return inWindow(() -> {
            for (Window window : Window.getWindows()) {
                T found = window.isShowing() ? find(window, type, wanted) : null;
                if (found != null) return Optional.of(found);
            }
            return Optional.empty();
        });
    }

    private static <T extends Component> T find(Component in, Class<T> type, Predicate<T> wanted) {
        if (type.isInstance(in) && in.isShowing() && wanted.test(type.cast(in))) {
            return type.cast(in);
        }
        if (!(in instanceof Container container)) return null;
        for (Component child : container.getComponents()) {
            T found = find(child, type, wanted);
            if (found != null) return found;
        }
        return null;
    }

    // Pointer

    /** Moves the pointer to the middle of a photo pixel. */
    void moveTo(int column, int row) {
        glideTo(placeOf(column, row));
    }

    private Point placeOf(int column, int row) {
        return inWindow(() -> {
            PhotoCanvas canvas = frame.canvas();
            double scale = canvas.deviceScale();
            Point corner = canvas.getLocationOnScreen();
            return new Point(
                    corner.x + (int) Math.floor(view().viewX(column + 0.5) / scale),
                    corner.y + (int) Math.floor(view().viewY(row + 0.5) / scale));
        });
    }

    private void glideTo(Point place) {
        Point from = new Point(pointer);
        double way = from.distance(place);
        for (double gone = STEP; gone < way; gone += STEP) {
            step(from.x + (int) ((place.x - from.x) * gone / way),
                    from.y + (int) ((place.y - from.y) * gone / way));
        }
        step(place.x, place.y);
    }

    private void step(int x, int y) {
        pointer.setLocation(x, y);
        robot.mouseMove(x, y);
        robot.delay(STEP_MILLIS);
    }

    void press(int button) {
        robot.mousePress(button);
        robot.delay(PRESS_MILLIS);
    }

    void release(int button) {
        robot.mouseRelease(button);
        robot.delay(PRESS_MILLIS);
        settle();
    }

    /** Drags from point to point, columns and rows by turns. */
    void drag(int button, int... points) {
        beginDrag(button, points);
        release(button);
    }

    /** Drags, and keeps the button pressed. */
    void beginDrag(int button, int... points) {
        moveTo(points[0], points[1]);
        press(button);
        for (int i = 2; i < points.length; i += 2) moveTo(points[i], points[i + 1]);
        settle();
    }

    /** Moves the pointer by pixels of the window, in steps. */
    void moveBy(int dx, int dy) {
        glideTo(new Point(pointer.x + dx, pointer.y + dy));
    }

    /** Turns the wheel; below 0 is away from the hand. */
    void wheel(int notches) {
        for (int i = 0; i < Math.abs(notches); ++i) {
            robot.mouseWheel(Integer.signum(notches));
            robot.delay(PRESS_MILLIS);
        }
        settle();
    }

    void click(Component part) {
        clickAway(part);
        settle();
    }

    /** Clicks, perhaps for the last time in this window. */
    void clickAway(Component part) {
        Point place = inWindow(() -> {
            Point corner = part.getLocationOnScreen();
            corner.translate(part.getWidth() / 2, part.getHeight() / 2);
            return corner;
        });
        glideTo(place);
        press(LEFT);
        robot.mouseRelease(LEFT);
        robot.delay(PRESS_MILLIS);
    }

    // Keys

    void hold(int key) {
        robot.keyPress(key);
        robot.delay(PRESS_MILLIS);
    }

    void letGo(int key) {
        robot.keyRelease(key);
        robot.delay(PRESS_MILLIS);
        robot.waitForIdle();
    }

    /** Presses keys together, in this order, such as Ctrl and Z. */
    void keys(int... keys) {
        for (int key : keys) hold(key);
        for (int i = keys.length - 1; i >= 0; --i) robot.keyRelease(keys[i]);
        robot.delay(PRESS_MILLIS);
        robot.waitForIdle();
    }

    /** Presses keys and waits until what they ask for is done. */
    void act(int... keys) {
        keys(keys);
        settle();
    }

    /** Types a text of letters, digits and the signs of paths. */
    void type(String text) {
        for (char letter : text.toCharArray()) {
            int key = KeyEvent.getExtendedKeyCodeForChar(letter);
            if (letter == '_') {
                keys(KeyEvent.VK_SHIFT, KeyEvent.VK_MINUS);
            } else if (Character.isUpperCase(letter)) {
                keys(KeyEvent.VK_SHIFT, key);
            } else {
                keys(key);
            }
        }
    }

    // Pictures

    /** Returns the screen's own pixels, also where windows are enlarged. */
    BufferedImage look() {
        settle();
        return capture();
    }

    private BufferedImage capture() {
        Image image = robot.createMultiResolutionScreenCapture(
                new java.awt.Rectangle(Toolkit.getDefaultToolkit().getScreenSize()))
                .getResolutionVariants().stream()
                .reduce((smaller, larger) -> larger).orElseThrow();
        BufferedImage copy = new BufferedImage(image.getWidth(null), image.getHeight(null),
                BufferedImage.TYPE_INT_RGB);
        copy.getGraphics().drawImage(image, 0, 0, null);
        return copy;
    }

    /** Keeps a picture of the screen as NAME.png. */
    void screenshot(String name) {
        settle();
        picture(name);
    }

    /** Keeps a picture of the screen while something is going on. */
    void picture(String name) {
        try {
            Files.createDirectories(SCREENSHOTS);
            ImageIO.write(capture(), "png", SCREENSHOTS.resolve(name + ".png").toFile());
        } catch (IOException e) {
            throw new java.io.UncheckedIOException(e);
        }
    }
}
