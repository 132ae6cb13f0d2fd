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
import java.util.concurrent.atomic.AtomicLong;
import java.util.function.Consumer;
import java.util.function.Function;
import java.util.function.Supplier;

/**
 * The editing screen's engine room: a photo, its selection, and a drawing of what is seen.
 *
 * <p>All methods return at once; what they ask for is done in their order by a thread of the
 * editor, files are read and written by another one. The listener is told of what comes of it.
 * Without a photo, and while a script is replayed, what would change the selection does nothing;
 * nor does what is asked for after closing.
 *
 * <p>A process can have one editor, for the library has one selection.
 */
public final class Editor implements AutoCloseable {
    /** The longest time without a redraw while there is more and more to draw, in nanoseconds. */
    private static final long LONGEST_UNDRAWN = TimeUnit.SECONDS.toNanos(1) / 30;

    /** The longest time in a stroke or replay without counting what is selected. */
    private static final long LONGEST_UNCOUNTED = TimeUnit.SECONDS.toNanos(1) / 5;

    private static final String CHOOSE_PHOTO = "Choose a JPEG or PNG file.";
    private static final String CHOOSE_MASK = "Choose a mask saved from this photo.";
    private static final String CHOOSE_PLACE = "Choose another place.";

    private final EditorListener listener;
    private final Worker worker = new Worker("editor", this::drawWhenIdle, this::failed);
    private final FileThread files = new FileThread(this::busy, this::failed);
    private final Screen screen = new Screen();

    private volatile View wanted;
    private volatile boolean replaying;
    private volatile boolean replayStopped;
    private final AtomicLong strokesBegun = new AtomicLong();
    private volatile long strokesCut;  // so many of those begun set no more dabs

    // The rest belongs to the worker's thread.
    private Document document;        // or null
    private View drawn;               // what the screen shows, or null
    private Area dirty = Area.EMPTY;  // where the photo may look otherwise than on the screen
    private int dashes;
    private long lastDrawn;
    private long lastCounted;
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
        String name = nameOf(file);
        files.run("Opening " + name, name + " cannot be opened", CHOOSE_PHOTO, () -> {
            OpenedPhoto photo = OpenedPhoto.read(file);
            worker.add(() -> {
                boolean fill = document == null || document.session.fill();
                begin(photo);
                document.session.setFill(fill);
                publish();
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
        try {
            document = new Document(photo, this::strokeChanged);
        } finally {
            publish();
        }
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
        worker.add(() -> {});  // it draws after each task
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

    /** Is called after each task. */
    private void drawWhenIdle() {
        if (worker.isIdle() || System.nanoTime() - lastDrawn > LONGEST_UNDRAWN) draw();
    }

    private void draw() {
        View view = wanted;
        if (document == null || view == null || view.photo() != document.photo) return;
        if (view == drawn && dirty.isEmpty()) return;
        Area changed = dirty;
        boolean sameView = view == drawn;
        drawn = view;  // also when drawing fails, for it would fail again after each task
        dirty = Area.EMPTY;
        long start = System.nanoTime();
        if (sameView) {
            screen.change(frame -> document.renderer.drawChange(frame, changed, dashes));
            changeNanos = System.nanoTime() - start;
        } else {
            screen.replace(view.placement(), view.kind(),
                    frame -> document.renderer.drawWhole(frame, dashes));
            redrawNanos = System.nanoTime() - start;
        }
        lastDrawn = System.nanoTime();
        listener.frameDrawn();
        if (!sameView) publish();  // how long it took
    }

    // Strokes

    /**
     * Begins a stroke of a brush; one that is under way still ends before.
     *
     * @param mode grow, shrink, paint or erase
     * @param x column of its first dab; it may lie outside the photo
     * @param y row of its first dab
     */
    public void beginStroke(Mode mode, Brush brush, int x, int y) {
        long number = strokesBegun.incrementAndGet();
        edit(() -> {
            endStrokeUnderWay();
            document.selectedBefore = document.selectedPixels;
            document.strokes.begin(mode, brush, x, y, () -> number > strokesCut);
        });
    }

    /** Leads a stroke that is begun to a point, which may lie outside the photo. */
    public void moveStroke(int x, int y) {
        edit(() -> {
            if (document.strokes.underWay()) document.strokes.moveTo(x, y);
        });
    }

    /** Ends a stroke that is begun. */
    public void endStroke() {
        edit(this::endStrokeUnderWay);
    }

    /** Ends a stroke that is begun where it is: what waits to be done of it is left out. */
    public void cutStroke() {
        strokesCut = strokesBegun.get();
        endStroke();
    }

    private void endStrokeUnderWay() {
        if (!document.strokes.underWay()) return;
        document.strokes.end();
        strokeEnded(false);
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
            document.selectedBefore = document.selectedPixels;
            document.strokes.lasso(mode, inside);
            // An outline alone changes what it runs over; hardly ever is that what was meant.
            strokeEnded(!document.session.fill());
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
        if (System.nanoTime() - lastCounted > LONGEST_UNCOUNTED && document.strokes.underWay()) {
            count();
            publish();
        }
    }

    private void count() {
        document.selectedPixels = document.session.selectedPixels();
        lastCounted = System.nanoTime();
    }

    /** Says why a stroke did nothing; {@code inVain} also when it did something. */
    private void strokeEnded(boolean inVain) {
        stepDone(document.strokes.dabs() > 0);
        boolean nothing = document.selectedPixels == document.selectedBefore;
        if (nothing || inVain) say(Message.Kind.HINT, document.strokes.reason());
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

    /** Tells whether strokes fill holes, and erase what they cut off. Not during a stroke. */
    public void setFill(boolean on) {
        edit(() -> {
            if (!document.strokes.underWay()) document.session.setFill(on);
            publish();
        });
    }

    private void step(Function<SelectionSession, Area> operation) {
        edit(() -> {
            if (document.strokes.underWay()) return;
            Area changed = operation.apply(document.session);
            dirty = dirty.union(changed);
            stepDone(!changed.isEmpty());
        });
    }

    /** Takes notice of a step, which may have done nothing. */
    private void stepDone(boolean something) {
        count();
        if (something) ++document.steps;
        publish();
    }

    private void edit(Runnable task) {
        if (refusedInReplay()) return;
        worker.add(() -> {
            if (document != null) task.run();
        });
    }

    // Files

    /** Selects what is bright in a picture of the photo's size. */
    public void loadMask(Path file) {
        edit(() -> {
            OpenedPhoto photo = document.photo;
            files.run("Loading " + nameOf(file), nameOf(file) + " cannot be loaded", CHOOSE_MASK,
                    () -> {
                        byte[] mask = PictureFiles.readMask(file, photo.width(), photo.height());
                        worker.add(() -> select(photo, mask, nameOf(file)));
                    });
        });
    }

    private void select(OpenedPhoto photo, byte[] mask, String name) {
        if (document == null || document.photo != photo) return;
        if (document.strokes.underWay()) {
            say(Message.Kind.HINT, name + " is not loaded, for a stroke is under way. Load it"
                    + " again.");
            return;
        }
        Area changed = document.session.select(mask);
        dirty = dirty.union(changed);
        stepDone(!changed.isEmpty());
    }

    /** Saves the selection, white on black, as PNG. The result tells whether it is saved. */
    public CompletableFuture<Boolean> saveMask(Path file) {
        return saveWork(file, () -> {
            OpenedPhoto photo = document.photo;
            Picture mask = Drawings.mask(document.session);
            return () -> PictureFiles.write(file, mask, photo);
        });
    }

    /** Saves the photo with all that is not selected transparent, as PNG. */
    public CompletableFuture<Boolean> saveCutOut(Path file) {
        return saveWork(file, () -> {
            OpenedPhoto photo = document.photo;
            Picture cutOut = document.cutOut();
            return () -> PictureFiles.write(file, cutOut, photo);
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
            OpenedPhoto photo = document.photo;
            List<Picture> seen = new ArrayList<>();
            screen.look(frame -> {
                if (!frame.placement().seen().isEmpty()) seen.add(frame.seen());
            });
            if (seen.isEmpty()) throw new IllegalStateException("nothing of the photo is seen");
            return () -> PictureFiles.write(file, seen.get(0), photo);
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
                        nameOf(file) + " cannot be saved", CHOOSE_PLACE, () -> {
                            writing.run();
                            say(Message.Kind.DONE, "Saved " + file + ".");
                        }));
    }

    private FileThread.Job takeDown(Supplier<FileThread.Job> taking) {
        if (document == null) return failing("no photo is open");
        if (document.strokes.underWay()) return failing("a stroke is under way");
        try {
            return taking.get();
        } catch (RuntimeException | OutOfMemoryError e) {
            return failing(Troubles.describe(e));
        }
    }

    private static FileThread.Job failing(String why) {
        return () -> {
            throw new IllegalStateException(why);
        };
    }

    private static String nameOf(Path file) {
        return file.getFileName() == null ? file.toString() : file.getFileName().toString();
    }

    /** Tells whether something will be unsaved once all that was asked for so far is done. */
    public CompletableFuture<Boolean> unsaved() {
        return CompletableFuture.runAsync(() -> {}, worker::add)  // what to save is taken down
                .thenCompose(nothing -> files.run("", "", () -> {}))  // and written
                .thenApplyAsync(written -> document != null && document.unsaved(), worker::add);
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
        }).whenComplete((read, trouble) -> {
            if (trouble != null || !read) replaying = false;  // else the end of the replay does it
        });
    }

    /** Stops a replay; what it has done so far stays. */
    public void stopReplay() {
        replayStopped = true;
    }

    private void play(ScriptFile.Playable playable, String name) {
        String result;
        try {
            begin(playable.photo());
            replay = new Replay(document.session, playable.script(), this::replayGoesOn);
            work = "Replaying " + name;
            boolean all = replay.play();
            result = all
                    ? "Replayed " + name + ", digest " + Digest.of(document.session) + "."
                    : "Stopped " + name + " after " + replay.performed() + " of "
                            + replay.commands() + " commands.";
        } catch (IOException e) {
            throw new IllegalStateException("a replay writes no files", e);
        } finally {
            replaying = false;
            replay = null;
            work = "";
            if (document != null) count();
            publish();
            drawAll();
        }
        say(Message.Kind.DONE, result);
    }

    /** Is asked before each dab, and shows how far the replay has come. */
    private boolean replayGoesOn() {
        if (System.nanoTime() - lastDrawn > LONGEST_UNDRAWN) {
            if (System.nanoTime() - lastCounted > LONGEST_UNCOUNTED) count();
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
            CompletableFuture.runAsync(this::draw, worker::add).join();
        }
    }

    /**
     * Stops a replay, cuts a stroke, finishes what is being saved, and ends the editor's threads.
     * Waits for all of that, so the listener must not call it.
     */
    @Override
    public void close() {
        replayStopped = true;
        strokesCut = Long.MAX_VALUE;
        worker.close(this::closeDocument);
        files.close();
    }
}
