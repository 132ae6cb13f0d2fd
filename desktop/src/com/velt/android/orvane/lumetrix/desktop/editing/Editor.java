package com.velt.android.orvane.lumetrix.desktop.editing;

import android.graphics.Point;
import com.velt.android.orvane.lumetrix.desktop.Digest;
import com.velt.android.orvane.lumetrix.desktop.Drawings;
import com.velt.android.orvane.lumetrix.desktop.Picture;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.Mode;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import java.io.IOException;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.TimeUnit;
import java.util.function.Consumer;
import java.util.function.Function;
import java.util.function.Supplier;

/**
 * The editing screen's engine room: a photo, its selection, and a drawing of what is seen.
 *
 * <p>All methods return at once; what they ask for is done in their order by a thread of the
 * editor, files are read and written by another one. The listener is told of what comes of it.
 * Without a photo, and while a script is replayed, what would change the selection does nothing.
 *
 * <p>A process can have one editor, for the library has one selection.
 */
public final class Editor implements AutoCloseable {
    /** The longest time without a redraw while there is more and more to draw, in nanoseconds. */
    private static final long LONGEST_UNDRAWN = TimeUnit.SECONDS.toNanos(1) / 30;

    private final EditorListener listener;
    private final Worker worker = new Worker("editor", this::failed);
    private final FileThread files = new FileThread(this::busy, this::failed);
    private final Screen screen = new Screen();

    private volatile View wanted;
    private volatile boolean replaying;
    private volatile boolean replayStopped;

    // The rest belongs to the worker's thread.
    private Document document;        // or null
    private View drawn;               // what the screen shows, or null
    private Area dirty = Area.EMPTY;  // where the photo may look otherwise than on the screen
    private int dashes;
    private long lastDrawn;
    private long redrawNanos;
    private long changeNanos;
    private String work = "";         // what takes a while, or empty
    private Replay replay;            // the one under way, or null

    /** What a window wants to see. */
    private record View(OpenedPhoto photo, Placement placement, ViewKind kind) {}

    /** Makes an editor without a photo. */
    public Editor(EditorListener listener) {
        this.listener = listener;
    }

    // Photo and view

    /** Opens a photo with nothing selected. One that cannot be read leaves all as it is. */
    public void open(Path file) {
        if (refusedInReplay()) return;
        files.run("Opening " + nameOf(file), nameOf(file) + " cannot be opened", () -> {
            OpenedPhoto photo = OpenedPhoto.read(file);
            worker.add(() -> {
                begin(photo);
                if (photo.isReduced()) say(Message.Kind.HINT, reduction(photo));
            });
        });
    }

    private static String reduction(OpenedPhoto photo) {
        return photo.name() + " has " + photo.fileWidth() + " x " + photo.fileHeight()
                + " pixels and is reduced to " + photo.width() + " x " + photo.height()
                + " for editing.";
    }

    private void begin(OpenedPhoto photo) {
        closeDocument();
        document = new Document(photo, this::strokeChanged);
        publish();
    }

    private void closeDocument() {
        if (document == null) return;
        document.close();
        document = null;
        screen.clear();
        drawn = null;
        dirty = Area.EMPTY;
    }

    /** Shows a photo that is open from now on like this. */
    public void show(OpenedPhoto photo, Placement placement, ViewKind kind) {
        wanted = new View(photo, placement, kind);
        worker.add(this::drawWhenIdle);
    }

    /**
     * Lets the reader look at the frame, if there is one. It holds up the drawing of the next one
     * and must keep nothing of the pixels.
     */
    public void look(Consumer<Frame> reader) {
        screen.look(reader);
    }

    /** Moves the dashes of the outline, unless there is something else to do. */
    public void moveDashes() {
        worker.add(() -> {
            boolean seen = document != null && document.selectedPixels > 0 && drawn != null
                    && drawn.kind() == ViewKind.OUTLINE;
            if (!seen || !worker.isIdle() || document.strokes.underWay()) return;
            dashes = 1 - dashes;
            screen.change(frame -> document.renderer.drawChange(frame,
                    document.session.objectBox(), dashes));
            listener.frameDrawn();
        });
    }

    private void drawWhenIdle() {
        if (worker.isIdle() || System.nanoTime() - lastDrawn > LONGEST_UNDRAWN) draw();
    }

    private void draw() {
        View view = wanted;
        if (document == null || view == null || view.photo() != document.photo) return;
        if (view == drawn && dirty.isEmpty()) return;
        long start = System.nanoTime();
        if (view == drawn) {
            screen.change(frame -> document.renderer.drawChange(frame, dirty, dashes));
            changeNanos = System.nanoTime() - start;
        } else {
            screen.replace(view.placement(), view.kind(),
                    frame -> document.renderer.drawWhole(frame, dashes));
            redrawNanos = System.nanoTime() - start;
        }
        drawn = view;
        dirty = Area.EMPTY;
        lastDrawn = System.nanoTime();
        listener.frameDrawn();
    }

    // Strokes

    /**
     * Begins a stroke of a brush.
     *
     * @param mode grow, shrink, paint or erase
     * @param x column of its first dab; it may lie outside the photo
     * @param y row of its first dab
     */
    public void beginStroke(Mode mode, Brush brush, int x, int y) {
        edit(() -> document.strokes.begin(mode, brush, x, y));
    }

    /** Leads a stroke that is begun to a point, which may lie outside the photo. */
    public void moveStroke(int x, int y) {
        edit(() -> {
            if (document.strokes.underWay()) document.strokes.moveTo(x, y);
        });
    }

    /** Ends a stroke that is begun. */
    public void endStroke() {
        edit(() -> {
            if (!document.strokes.underWay()) return;
            document.strokes.end();
            strokeEnded();
        });
    }

    /** Draws a lasso through corners; those outside the photo are moved to its border. */
    public void lasso(Mode mode, List<Point> corners) {
        edit(() -> {
            if (document.strokes.underWay()) return;
            List<Point> inside = corners.stream().map(this::onPhoto).toList();
            if (inside.size() < 3) {
                say(Message.Kind.HINT, Hints.LASSO_TOO_SHORT);
                return;
            }
            document.strokes.lasso(mode, inside);
            strokeEnded();
        });
    }

    private Point onPhoto(Point point) {
        return new Point(Math.max(0, Math.min(point.x, document.photo.width() - 1)),
                Math.max(0, Math.min(point.y, document.photo.height() - 1)));
    }

    /** Is called after each dab. */
    private void strokeChanged(Area changed) {
        dirty = dirty.union(changed);
        if (System.nanoTime() - lastDrawn > LONGEST_UNDRAWN) draw();
    }

    private void strokeEnded() {
        int before = document.selectedPixels;
        stepDone();
        if (document.selectedPixels == before) say(Message.Kind.HINT, document.strokes.reason());
    }

    /** Inverts the selection. */
    public void invert() {
        step(SelectionSession::invert);
    }

    /** Clears the selection. */
    public void clear() {
        step(SelectionSession::reset);
    }

    /** Takes back the last step. */
    public void undo() {
        step(session -> {
            if (session.canUndo()) return session.undo();
            say(Message.Kind.HINT, "There is nothing to undo.");
            return Area.EMPTY;
        });
    }

    /** Brings back the step that was undone last. */
    public void redo() {
        step(session -> {
            if (session.canRedo()) return session.redo();
            say(Message.Kind.HINT, "There is nothing to redo.");
            return Area.EMPTY;
        });
    }

    /** Tells whether strokes fill holes, and erase what they cut off. */
    public void setFill(boolean on) {
        edit(() -> {
            document.session.setFill(on);
            publish();
        });
    }

    private void step(Function<SelectionSession, Area> operation) {
        edit(() -> {
            if (document.strokes.underWay()) return;
            dirty = dirty.union(operation.apply(document.session));
            stepDone();
        });
    }

    private void stepDone() {
        document.selectedPixels = document.session.selectedPixels();
        ++document.steps;
        publish();
    }

    private void edit(Runnable task) {
        if (refusedInReplay()) return;
        worker.add(() -> {
            if (document == null) return;
            task.run();
            drawWhenIdle();
        });
    }

    // Files

    /** Selects what is bright in a picture of the photo's size. */
    public void loadMask(Path file) {
        edit(() -> {
            OpenedPhoto photo = document.photo;
            files.run("Loading " + nameOf(file), nameOf(file) + " cannot be loaded", () -> {
                byte[] mask = PictureFiles.readMask(file, photo.width(), photo.height());
                worker.add(() -> select(photo, mask));
            });
        });
    }

    private void select(OpenedPhoto photo, byte[] mask) {
        if (document == null || document.photo != photo || document.strokes.underWay()) return;
        dirty = dirty.union(document.session.select(mask));
        stepDone();
        draw();
    }

    /** Saves the selection, white on black, as PNG. The result tells whether it is saved. */
    public CompletableFuture<Boolean> saveMask(Path file) {
        return saveWork(file, () -> {
            Picture mask = Drawings.mask(document.session);
            return () -> PictureFiles.write(file, mask);
        });
    }

    /** Saves the photo with all that is not selected transparent, as PNG. */
    public CompletableFuture<Boolean> saveCutOut(Path file) {
        return saveWork(file, () -> {
            Picture cutOut = document.cutOut();
            return () -> PictureFiles.write(file, cutOut);
        });
    }

    /**
     * Saves what was done as a stroke script. A photo that was reduced is saved beside it, for the
     * points of the strokes are those of the reduced one.
     */
    public CompletableFuture<Boolean> saveScript(Path file) {
        return saveWork(file, () -> {
            OpenedPhoto photo = document.photo;
            Path named = ScriptFile.photoOf(file, photo);
            String script = document.session.script(ScriptFile.nameIn(file, named));
            return () -> ScriptFile.write(file, script, photo);
        });
    }

    /** Saves what is seen of the photo, as PNG. The selection counts as unsaved still. */
    public CompletableFuture<Boolean> saveView(Path file) {
        return save(file, () -> {
            List<Picture> seen = new ArrayList<>();
            screen.look(frame -> seen.add(frame.seen()));
            return () -> PictureFiles.write(file, seen.get(0));
        });
    }

    private CompletableFuture<Boolean> saveWork(Path file, Supplier<FileThread.Job> taking) {
        return save(file, () -> {
            Document taken = document;
            int steps = taken.steps;
            FileThread.Job writing = taking.get();
            return () -> {
                writing.run();
                worker.add(() -> {
                    taken.stepsSaved = steps;
                    publish();
                });
            };
        });
    }

    /** {@code taking} takes down what is to be saved, and returns what writes it. */
    private CompletableFuture<Boolean> save(Path file, Supplier<FileThread.Job> taking) {
        if (refusedInReplay()) return CompletableFuture.completedFuture(false);
        return CompletableFuture.supplyAsync(() -> takeDown(taking), worker::add)
                .thenCompose(writing -> files.run("Saving " + nameOf(file),
                        nameOf(file) + " cannot be saved", () -> {
                            writing.run();
                            say(Message.Kind.DONE, "Saved " + file + ".");
                        }));
    }

    private FileThread.Job takeDown(Supplier<FileThread.Job> taking) {
        boolean possible = document != null && drawn != null && !document.strokes.underWay();
        try {
            if (possible) return taking.get();
        } catch (OutOfMemoryError e) {
            return () -> {
                throw e;
            };
        }
        return () -> {
            throw new IOException("there is no photo, or a stroke is under way");
        };
    }

    private static String nameOf(Path file) {
        return String.valueOf(file.getFileName());
    }

    // Replay

    /**
     * Plays a stroke script on its photo, in place of what is open. A script that cannot be played
     * leaves all as it is. Its pictures are not written.
     */
    public void replay(Path file) {
        if (refusedInReplay()) return;
        replaying = true;
        replayStopped = false;
        files.run("Reading " + nameOf(file), nameOf(file) + " cannot be played", () -> {
            ScriptFile.Playable playable = ScriptFile.read(file);
            worker.add(() -> play(playable, nameOf(file)));
        }).thenAccept(read -> replaying &= read);
    }

    /** Stops a replay; what it has done so far stays. */
    public void stopReplay() {
        replayStopped = true;
    }

    private void play(ScriptFile.Playable playable, String name) {
        try {
            begin(playable.photo());
            replay = new Replay(document.session, playable.script(), this::replayGoesOn);
            work = "Replaying " + name;
            boolean all = replay.play();
            say(Message.Kind.DONE, all
                    ? "Replayed " + name + ", digest " + Digest.of(document.session) + "."
                    : "Stopped " + name + " after " + replay.performed() + " of "
                            + replay.commands() + " commands.");
            document.selectedPixels = document.session.selectedPixels();
        } catch (IOException e) {
            throw new IllegalStateException("a replay writes no files", e);
        } finally {
            replaying = false;
            replay = null;
            work = "";
            publish();
            drawAll();
        }
    }

    /** Is asked before each dab, and shows how far the replay has come. */
    private boolean replayGoesOn() {
        if (System.nanoTime() - lastDrawn > LONGEST_UNDRAWN) {
            publish();
            drawAll();
        }
        return !replayStopped;
    }

    /** Draws the whole view, whatever has changed. */
    private void drawAll() {
        drawn = null;
        draw();
        lastDrawn = System.nanoTime();  // also when there is nothing to draw yet
    }

    private boolean refusedInReplay() {
        if (replaying) say(Message.Kind.HINT, "A script is being replayed. Stop it first.");
        return replaying;
    }

    // What the listener is told

    private void publish() {
        if (document == null) {
            listener.stateChanged(EditorState.EMPTY.during(work));
            return;
        }
        SelectionSession session = document.session;
        listener.stateChanged(new EditorState(document.photo, document.selectedPixels,
                session.fill(), session.canUndo(), session.canRedo(), document.unsaved(),
                document.strokes.nanos(), document.strokes.dabs(), redrawNanos, changeNanos, work,
                replay == null ? 0 : replay.performed(), replay == null ? 0 : replay.commands()));
    }

    /** Is called by the thread that reads and writes files. */
    private void busy(String what) {
        worker.add(() -> {
            work = what;
            publish();
        });
    }

    private void say(Message.Kind kind, String text) {
        listener.said(new Message(kind, text));
    }

    private void failed(String text) {
        say(Message.Kind.PROBLEM, text);
    }

    /** Is called when a task of the worker has failed, which none should. */
    private void failed(Throwable trouble) {
        failed("That did not work: " + Troubles.describe(trouble) + ".");
    }

    /** Waits until all that was asked for so far is done, also what follows from it. */
    void settle() {
        for (int round = 0; round < 3; ++round) {  // files to worker to files
            files.run("", "", () -> {}).join();
            CompletableFuture.runAsync(() -> {}, worker::add).join();
        }
    }

    /** Stops a replay, finishes what is being saved, and ends the editor's threads. */
    @Override
    public void close() {
        replayStopped = true;
        worker.add(this::closeDocument);
        worker.close();
        files.close();
    }
}
