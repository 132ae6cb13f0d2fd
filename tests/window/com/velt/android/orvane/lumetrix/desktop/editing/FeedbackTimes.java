package com.velt.android.orvane.lumetrix.desktop.editing;

import com.velt.android.orvane.lumetrix.selection.Mode;
import java.awt.Graphics2D;
import java.awt.RenderingHints;
import java.awt.image.BufferedImage;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.Locale;
import java.util.concurrent.BlockingQueue;
import java.util.concurrent.LinkedBlockingQueue;
import javax.imageio.ImageIO;

/**
 * Prints how long a dab takes to be seen: from the pointer's move to the frame that shows it, and
 * how long a pan does. It needs no display.
 */
public final class FeedbackTimes {
    private static final int VIEW_WIDTH = 1400;
    private static final int VIEW_HEIGHT = 900;
    private static final int RADIUS = 40;
    private static final int CORE = 12;
    private static final int WARM_UP = 40;
    private static final int DABS = 100;

    private final BlockingQueue<Long> frames = new LinkedBlockingQueue<>();
    private volatile EditorState state = EditorState.EMPTY;

    private FeedbackTimes() {}

    /** Prints a table for photos of 3 and 12 megapixels; {@code arguments} is a photo's file. */
    public static void main(String[] arguments) throws Exception {
        BufferedImage photo = ImageIO.read(Path.of(arguments[0]).toFile());
        System.out.printf("%-11s  %-9s  %-22s  %s%n", "photo", "view",
                "dab: median, 95 %, most", "pan: median, most (ms)");
        for (int[] size : new int[][] {{2125, 1412}, {4000, 3000}}) {
            Path file = Files.createTempFile("photo", ".png");
            try {
                ImageIO.write(scaled(photo, size[0], size[1]), "png", file.toFile());
                new FeedbackTimes().measure(file);
            } finally {
                Files.delete(file);
            }
        }
    }

    private static BufferedImage scaled(BufferedImage photo, int width, int height) {
        BufferedImage scaled = new BufferedImage(width, height, BufferedImage.TYPE_INT_RGB);
        Graphics2D graphics = scaled.createGraphics();
        graphics.setRenderingHint(RenderingHints.KEY_INTERPOLATION,
                RenderingHints.VALUE_INTERPOLATION_BILINEAR);
        graphics.drawImage(photo, 0, 0, width, height, null);
        graphics.dispose();
        return scaled;
    }

    private void measure(Path file) throws IOException, InterruptedException {
        try (Editor editor = new Editor(new Listener())) {
            editor.open(file);
            editor.settle();
            OpenedPhoto photo = state.photo();
            ViewModel view = new ViewModel();
            view.setView(VIEW_WIDTH, VIEW_HEIGHT);
            view.setPhoto(photo.width(), photo.height());
            for (ViewKind kind : ViewKind.values()) {
                if (kind == ViewKind.PHOTO) continue;  // shows no dab
                editor.show(photo, view.placement(kind), kind);
                long[] dabs = dabs(editor, photo);
                long[] pans = pans(editor, photo, view, kind);
                System.out.printf(Locale.ROOT, "%4d x %4d  %-9s  %8s %6s %6s  %8s %6s%n",
                        photo.width(), photo.height(), kind.title(), share(dabs, 50),
                        share(dabs, 95), share(dabs, 100), share(pans, 50), share(pans, 100));
            }
        }
    }

    /** Brushes to and fro over the middle of the photo, a dab a time, and returns the times. */
    private long[] dabs(Editor editor, OpenedPhoto photo) throws InterruptedException {
        int left = photo.width() / 4;
        int y = photo.height() / 4;
        int row = photo.width() / 2;
        long[] times = new long[DABS];
        editor.clear();
        editor.beginStroke(Mode.GROW, new Brush(RADIUS, CORE), left, y);
        for (int i = -WARM_UP; i < DABS; ++i) {
            int way = (i + WARM_UP + 1) * RADIUS / 2;
            int gone = way / row % 2 == 0 ? way % row : row - way % row;
            editor.settle();
            frames.clear();
            long start = System.nanoTime();
            editor.moveStroke(left + gone, y + way / row * RADIUS / 2);
            long time = frames.take() - start;
            if (i >= 0) times[i] = time;
        }
        editor.endStroke();
        editor.settle();
        return times;
    }

    private long[] pans(Editor editor, OpenedPhoto photo, ViewModel view, ViewKind kind)
            throws InterruptedException {
        long[] times = new long[30];
        for (int i = 0; i < times.length; ++i) {
            view.pan(i % 2 == 0 ? 3 : -3, 1);
            editor.settle();
            frames.clear();
            long start = System.nanoTime();
            editor.show(photo, view.placement(kind), kind);
            times[i] = frames.take() - start;
        }
        view.fit();
        return times;
    }

    private static String share(long[] times, int percent) {
        long[] sorted = times.clone();
        Arrays.sort(sorted);
        int last = sorted.length - 1;
        return String.format(Locale.ROOT, "%.1f", sorted[last * percent / 100] / 1e6);
    }

    private final class Listener implements EditorListener {
        @Override
        public void frameDrawn() {
            frames.add(System.nanoTime());
        }

        @Override
        public void stateChanged(EditorState next) {
            state = next;
        }

        @Override
        public void said(Message message) {}
    }
}
