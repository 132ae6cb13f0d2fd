package com.velt.android.orvane.lumetrix.selection;

import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.jni.Util;
import java.util.concurrent.atomic.AtomicReference;

/**
 * The selection of an object in a photo: strokes, undo and redo, pictures, and a script of all
 * that was done.
 *
 * <p>A session keeps the caller's photo and owns the mask, so sizes always fit. Every argument is
 * checked before the library is called: a method that throws has changed nothing, and its message
 * says what was given and what is allowed.
 *
 * <h2>One session, one thread</h2>
 *
 * <p>The library holds one selection in a process. So one session is open at a time; a second one
 * is refused until {@link #close} frees the place, also when nobody holds the first one any more.
 * Its methods belong to the thread that made it. While it is open, nobody else may call the
 * selection methods of {@link Util}. An {@link IllegalStateException} refuses a call from another
 * thread, after closing, and in the middle of a stroke what has to wait for its end.
 *
 * <h2>Strokes</h2>
 *
 * <p>A brush stroke arrives dab by dab ({@link #begin}, {@link #dab}, {@link #end}) or at once
 * ({@link #brush}); a lasso at once ({@link #lasso}). Dabs are not joined: the caller sets them as
 * densely as the stroke shall be. Modes, edges of the photo and the passes with filling are those
 * of {@link Util#modify_objectsel}. Inside a stroke, pictures can be drawn and the selection be
 * read; everything else waits for its end.
 *
 * <p>The mask holds 1 for selected and 0 for not. Lassos without filling leave outline values 3, 4
 * and 5 there, which do not count as selected; {@link #drawOutlinedView} draws 3 as if it did.
 *
 * <h2>Undo</h2>
 *
 * <p>A step is a stroke, {@link #invert}, {@link #reset}, {@link #select} or {@link #updateBox}.
 * Undo and redo bring back mask and object box exactly; brush and fill flag stay as they are. What
 * changed neither is no step: undo passes over it, and what was undone can still be redone. Any
 * other step forgets what was undone.
 *
 * <p>Deliberate: the engine remembers colour costs along the photo's first row and column from
 * stroke to stroke, until its brush is set. Undo and redo set the brush again, so a stroke there
 * may come out otherwise than it would have without them. The script says so, too, and replays to
 * the same selection.
 *
 * <h2>Memory</h2>
 *
 * <p>A session takes two bytes a pixel, the mask and a copy to tell changes by, beside the photo's
 * four. Its steps take together at most the limit given to the constructor, or
 * {@link #DEFAULT_HISTORY_BYTES}: each 256 bytes, and 3 to 11 for each run of changed pixels in a
 * row. Beyond the limit the oldest are forgotten. A step that exceeds it alone is not kept, and
 * neither is any before it: {@link #canUndo} is false then. For the script, 8 bytes a dab and some
 * 150 a stroke stay as long as the session is open, whatever the limit. Of each {@link #select} in
 * effect or undone, its line of the script stays as well: 4 to 12 bytes for each run of selected
 * pixels in a row and up to 7 for each such row. That is tens of kilobytes for an object in a large
 * photo, and up to five or six bytes a pixel where every second one is selected.
 *
 * <p>When a step ends, the mask is compared with its copy where it may have changed; with filling
 * that is the object box. The step takes up to three times its bytes for that moment,
 * {@link #select} 12 bytes a run and three times its line, and {@link #drawReverse} a byte a pixel.
 * A virtual machine that copies arrays for native methods copies the mask for each dab and each
 * segment of a lasso, and for growing and shrinking the photo as well: on a large photo that takes
 * longer than the stroke itself.
 */
public final class SelectionSession implements AutoCloseable {
    /** The longest side of a photo: positions are 16.16 fixed point numbers and wrap beyond. */
    public static final int LONGEST_SIDE = Viewport.LAST_POSITION;

    /** The largest radius of brush and core: a dab covers three quarters of a million pixels. */
    public static final int LARGEST_RADIUS = 500;

    /** The limit of the history unless another one is given: 16 MiB. */
    public static final long DEFAULT_HISTORY_BYTES = 16L << 20;

    private static final int RADIUS_AT_FIRST = 10;
    private static final int CORE_AT_FIRST = 1;
    private static final int FEWEST_CORNERS = 3;

    private static final AtomicReference<SelectionSession> OPEN = new AtomicReference<>();

    private final int width;
    private final int height;
    private final byte[] mask;
    private final byte[] maskOfLastStep;
    private final Engine engine;
    private final Drawing drawing;
    private final History history;
    private final Thread thread = Thread.currentThread();
    private boolean closed;
    private boolean fill = true;
    private Mode strokeMode;  // of the stroke that is begun, or null
    private Stroke stroke;

    /** The engine was built since the last line of the script. */
    private boolean newEngine;

    /**
     * Begins with nothing selected, a brush of radius 10 and core 1, filling on, and
     * {@link #DEFAULT_HISTORY_BYTES} for undo.
     *
     * @param pixels the photo, width * height values 0xAARRGGBB, row by row. It is kept, not
     *     copied: change nothing in it while the session is open, for strokes read it, and the
     *     library writes it back as it was at the end of each call.
     * @param width width in pixels, 1 to {@value #LONGEST_SIDE}
     * @param height height in pixels, 1 to {@value #LONGEST_SIDE}
     * @throws NullPointerException when {@code pixels} is null
     * @throws IllegalArgumentException when a size is out of its range or the array of another
     *     length
     * @throws IllegalStateException when another session is open
     */
    public SelectionSession(int[] pixels, int width, int height) {
        this(pixels, width, height, DEFAULT_HISTORY_BYTES, CallListener.NONE);
    }

    /**
     * Begins with a limit of the history and a listener.
     *
     * @param pixels the photo, as for the other constructor
     * @param width width in pixels, 1 to {@value #LONGEST_SIDE}
     * @param height height in pixels, 1 to {@value #LONGEST_SIDE}
     * @param historyBytes what undo and redo may take; with 0 nothing can be undone
     * @param listener is told of each call on the library
     * @throws NullPointerException when {@code pixels} or {@code listener} is null
     * @throws IllegalArgumentException when a size is out of its range, the array of another
     *     length or the limit negative
     * @throws IllegalStateException when another session is open
     */
    public SelectionSession(int[] pixels, int width, int height, long historyBytes,
            CallListener listener) {
        Checks.notNull("the photo", pixels);
        Checks.photoSize(width, height);
        Checks.length("the photo", pixels.length, width, height);
        Checks.range("the limit of the history", historyBytes, 0, Long.MAX_VALUE);
        Checks.notNull("the listener", listener);
        this.width = width;
        this.height = height;
        mask = new byte[width * height];
        maskOfLastStep = new byte[width * height];
        engine = new Engine(pixels, mask, width, height, listener);
        drawing = new Drawing(pixels, mask, width, height);
        history = new History(historyBytes);
        takePlace();
    }

    private void takePlace() {
        if (!OPEN.compareAndSet(null, this)) {
            throw new IllegalStateException("another session is open, expected it to be closed");
        }
        boolean begun = false;
        try {
            engine.setBrush(RADIUS_AT_FIRST, CORE_AT_FIRST);
            engine.begin();
            begun = true;
        } finally {
            if (!begun) OPEN.set(null);
        }
    }

    // Settings

    /**
     * Returns the width of the photo.
     *
     * @return pixels
     */
    public int width() {
        checkOpen();
        return width;
    }

    /**
     * Returns the height of the photo.
     *
     * @return pixels
     */
    public int height() {
        checkOpen();
        return height;
    }

    /**
     * Sets the brush for the strokes that follow.
     *
     * @param radius its radius in photo pixels, 0 to {@value #LARGEST_RADIUS}
     * @param core the radius of its core, whose pixels growing and shrinking always take, in photo
     *     pixels, 0 to {@value #LARGEST_RADIUS}; from {@code radius} - 1 on they have no room
     *     between core and rim
     * @throws IllegalArgumentException when a radius is out of its range
     */
    public void setBrush(int radius, int core) {
        checkNoStroke();
        Checks.range("the radius of the brush", radius, 0, LARGEST_RADIUS);
        Checks.range("the radius of the brush's core", core, 0, LARGEST_RADIUS);
        engine.setBrush(radius, core);
        newEngine = true;
    }

    /**
     * Returns the radius of the brush.
     *
     * @return photo pixels
     */
    public int brushRadius() {
        checkOpen();
        return engine.brushRadius();
    }

    /**
     * Returns the radius of the brush's core.
     *
     * @return photo pixels
     */
    public int coreRadius() {
        checkOpen();
        return engine.coreRadius();
    }

    /**
     * Tells whether strokes that follow run their pass over whole regions: holes filled, cut-off
     * pieces erased, lassos filled.
     *
     * @param on whether they do
     */
    public void setFill(boolean on) {
        checkNoStroke();
        fill = on;
    }

    /**
     * Returns whether strokes run their pass over whole regions.
     *
     * @return true at first
     */
    public boolean fill() {
        checkOpen();
        return fill;
    }

    // Strokes

    /**
     * Begins a stroke of the brush.
     *
     * @param mode grow, shrink, paint or erase
     * @throws NullPointerException when {@code mode} is null
     * @throws IllegalArgumentException when {@code mode} is a lasso
     */
    public void begin(Mode mode) {
        checkNoStroke();
        checkMode(mode, false);
        strokeMode = mode;
        stroke = newStroke(mode.toString());
    }

    /**
     * Sets the brush on a point in the stroke that is begun.
     *
     * <p>Growing does nothing at the outermost pixels of the photo, shrinking nothing at a point
     * that is not selected.
     *
     * @param x column, on the photo
     * @param y row, on the photo
     * @return what the library reports as changed, passes included. Deliberate: growing counts
     *     pixels of the brush's square that were selected before as well, shrinking unselected ones
     *     that it reached; open outlines of lassos that a brush wipes out are not counted until
     *     {@link #end}.
     * @throws IndexOutOfBoundsException when the point lies outside the photo
     */
    public Area dab(int x, int y) {
        checkStroke();
        Checks.pointInside(x, y, width, height);
        int radius = engine.brushRadius();
        Area square = new Area(x - radius, y - radius, x + radius, y + radius);
        stroke.addPoint(x, y);
        return modify(strokeMode, fill, x, y, x, y, square);
    }

    /**
     * Ends the stroke that is begun: all its dabs are one step.
     *
     * @return the union of what its dabs returned and of what has changed
     */
    public Area end() {
        checkStroke();
        strokeMode = null;
        return finish();
    }

    /**
     * Performs a whole stroke of the brush.
     *
     * @param mode grow, shrink, paint or erase
     * @param points a dab each: columns and rows by turns, on the photo, at least one point
     * @return the union of what its dabs changed, see {@link #end}
     * @throws NullPointerException when an argument is null
     * @throws IllegalArgumentException when {@code mode} is a lasso, or the number of coordinates
     *     is odd or 0
     * @throws IndexOutOfBoundsException when a point lies outside the photo
     */
    public Area brush(Mode mode, int... points) {
        checkNoStroke();
        checkMode(mode, false);
        Checks.pointsInside(points, 1, width, height);
        begin(mode);
        for (int i = 0; i < points.length; i += 2) dab(points[i], points[i + 1]);
        return end();
    }

    /**
     * Draws a closed lasso, from each corner to the next and from the last to the first.
     *
     * <p>With filling, what it encloses follows once it is closed; without, its outline stays in
     * the mask until a lasso of the same mode with filling takes it.
     *
     * @param mode the adding or the removing lasso
     * @param corners columns and rows by turns, on the photo, at least three corners
     * @return the outline's rectangle and all that has changed
     * @throws NullPointerException when an argument is null
     * @throws IllegalArgumentException when {@code mode} is a brush, the number of coordinates odd
     *     or below 6
     * @throws IndexOutOfBoundsException when a corner lies outside the photo
     */
    public Area lasso(Mode mode, int... corners) {
        checkNoStroke();
        checkMode(mode, true);
        Checks.pointsInside(corners, FEWEST_CORNERS, width, height);
        stroke = newStroke(mode.toString());
        for (int i = 0; i < corners.length; i += 2) {
            int next = (i + 2) % corners.length;
            stroke.addPoint(corners[i], corners[i + 1]);
            // An open outline encloses nothing, and filling would lose it.
            boolean closing = next == 0;
            modify(mode, closing && fill, corners[i], corners[i + 1], corners[next],
                    corners[next + 1], Area.EMPTY);
        }
        return finish();
    }

    /**
     * Inverts the selection; outline values of lassos become selected.
     *
     * @return the whole photo
     */
    public Area invert() {
        return changeWhole("invert", engine::invert, whole(), Area.EMPTY);
    }

    /**
     * Clears the selection.
     *
     * @return the whole photo
     */
    public Area reset() {
        return changeWhole("reset", engine::reset, whole(), Area.EMPTY);
    }

    /**
     * Takes over a selection, such as one that was saved, in place of the present one. Open
     * outlines of lassos are gone afterwards, and the object box is the tight one around what is
     * selected.
     *
     * <p>Deliberate: selecting nothing where nothing is selected may be a step all the same; the
     * library has two empty object boxes, and a session begins with the other one.
     *
     * @param selection width * height bytes, row by row: 1 is selected, any other value is not. It
     *     is read, not kept.
     * @return what has changed in the mask
     * @throws NullPointerException when {@code selection} is null
     * @throws IllegalArgumentException when it has another length
     */
    public Area select(byte[] selection) {
        checkNoStroke();
        Checks.notNull("the selection", selection);
        Checks.length("the selection", selection.length, width, height);
        int[] runs = PixelRuns.of(selection, width);
        return changeWhole("select" + PixelRuns.words(runs), () -> engine.select(runs), Area.EMPTY,
                whole());
    }

    /**
     * Shrinks the object box to what is selected inside it.
     *
     * @return {@link Area#EMPTY}: no pixel changes
     */
    public Area updateBox() {
        return changeWhole("update-box", engine::updateBox, Area.EMPTY, Area.EMPTY);
    }

    private Area changeWhole(String words, Runnable operation, Area changed, Area touched) {
        checkNoStroke();
        stroke = newStroke(words);
        operation.run();
        stroke.addChange(changed, touched);
        return finish();
    }

    private Stroke newStroke(String words) {
        return new Stroke(words, engine.box());
    }

    private Area modify(Mode mode, boolean filling, int x1, int y1, int x2, int y2, Area square) {
        Area changed = engine.modify(mode, filling, x1, y1, x2, y2);
        // The passes keep to the object box, but for pieces that shrinking erased: those were
        // reported, and the box is smaller now.
        Area passes = filling ? Engine.areaOf(engine.box()) : Area.EMPTY;
        stroke.addChange(changed, square.union(passes));
        return changed;
    }

    /** Makes a step of the stroke and returns what it changed. */
    private Area finish() {
        Stroke ended = stroke;
        stroke = null;
        Rect boxAfter = engine.box();
        MaskChange change = MaskChange.take(mask, maskOfLastStep, width,
                ended.reach().intersection(whole()), history.mostBytesOfAChange());
        boolean changed = !change.area().isEmpty() || !boxAfter.equals(ended.boxBefore());
        if (changed) {
            history.add(new Step(ended.line(settings()), change, ended.boxBefore(), boxAfter));
            newEngine = false;
        } else if (ended.hasPoints()) {
            passOver(ended);
        }
        return ended.reported().union(change.area());
    }

    /** Keeps the script true to the engine, which may remember also a stroke without effect. */
    private void passOver(Stroke ended) {
        if (history.canRedo()) {
            engine.renew();  // as the undo before left it; the stroke is forgotten
            return;
        }
        history.addWithoutEffect(ended.line(settings()));
        newEngine = false;
    }

    private ScriptLine.Settings settings() {
        return new ScriptLine.Settings(newEngine, engine.brushRadius(), engine.coreRadius(), fill);
    }

    // Undo

    /**
     * Takes back the last step.
     *
     * @return what has changed in the mask
     * @throws IllegalStateException when there is nothing to undo, see {@link #canUndo}
     */
    public Area undo() {
        checkNoStroke();
        if (!history.canUndo()) {
            throw new IllegalStateException("there is no step to undo, expected canUndo()");
        }
        Area changed = restore(history.nextToUndo(), false);
        history.moveBack();
        return changed;
    }

    /**
     * Brings back the step that was undone last.
     *
     * @return what has changed in the mask
     * @throws IllegalStateException when there is nothing to redo, see {@link #canRedo}
     */
    public Area redo() {
        checkNoStroke();
        if (!history.canRedo()) {
            throw new IllegalStateException("there is no step to redo, expected canRedo()");
        }
        Area changed = restore(history.nextToRedo(), true);
        history.moveOn();
        return changed;
    }

    private Area restore(Step step, boolean after) {
        engine.setBox(step.box(after));
        step.change().apply(after, mask, maskOfLastStep);
        engine.renew();
        newEngine = true;
        return step.change().area();
    }

    /**
     * Tells whether there is a step to undo.
     *
     * @return false during a stroke as well
     */
    public boolean canUndo() {
        checkOpen();
        return strokeMode == null && history.canUndo();
    }

    /**
     * Tells whether there is a step to redo.
     *
     * @return false during a stroke as well
     */
    public boolean canRedo() {
        checkOpen();
        return strokeMode == null && history.canRedo();
    }

    /**
     * Returns the limit of the history.
     *
     * @return bytes
     */
    public long historyLimit() {
        checkOpen();
        return history.limit();
    }

    /**
     * Returns what the steps take that can be undone or redone.
     *
     * @return bytes, at most {@link #historyLimit}
     */
    public long historyBytes() {
        checkOpen();
        return history.bytes();
    }

    // The selection

    /**
     * Returns a copy of the mask.
     *
     * @return width * height bytes, row by row
     */
    public byte[] mask() {
        checkOpen();
        return mask.clone();
    }

    /**
     * Copies the mask.
     *
     * @param copy receives it; width * height bytes
     * @throws NullPointerException when {@code copy} is null
     * @throws IllegalArgumentException when it has another length
     */
    public void copyMask(byte[] copy) {
        checkOpen();
        Checks.notNull("the array for the mask", copy);
        Checks.length("the array for the mask", copy.length, width, height);
        System.arraycopy(mask, 0, copy, 0, mask.length);
    }

    /**
     * Tells whether a pixel is selected.
     *
     * @param x column, on the photo
     * @param y row, on the photo
     * @return whether the mask holds 1
     * @throws IndexOutOfBoundsException when the point lies outside the photo
     */
    public boolean isSelected(int x, int y) {
        checkOpen();
        Checks.pointInside(x, y, width, height);
        return mask[y * width + x] == 1;
    }

    /**
     * Counts the selected pixels, looking at all.
     *
     * @return 0 to width * height
     */
    public int selectedPixels() {
        checkOpen();
        int count = 0;
        for (byte value : mask) {
            if (value == 1) ++count;
        }
        return count;
    }

    /**
     * Returns the object box, a rectangle around what strokes have selected.
     *
     * <p>Deliberate: removing pixels does not shrink it; see {@link #updateBox}. On a photo of one
     * pixel the box of nothing and that of the pixel may be the same.
     *
     * @return may be empty
     */
    public Area objectBox() {
        checkOpen();
        return Engine.areaOf(engine.box());
    }

    // Pictures

    /**
     * Draws the photo into a part of a view; see {@link Util#native_drawImage}.
     *
     * @param view receives the picture: as many values as the viewport has pixels, not the photo
     * @param port what the view shows
     * @param part the rectangle to draw, in the view; nothing is drawn when it is empty
     * @throws NullPointerException when an argument is null
     * @throws IllegalArgumentException when {@code view} has another length or is the photo
     * @throws IndexOutOfBoundsException when {@code part} reaches beyond the view
     */
    public void drawPlainView(int[] view, Viewport port, Area part) {
        checkOpen();
        drawing.plainView(view, port, part);
    }

    /**
     * Draws the photo with the selection's outline into a part of a view; see
     * {@link Util#native_drawImageWithMaskContour}.
     *
     * <p>Deliberate: in the first and last row and column of {@code part} every selected pixel
     * takes the outline's colour, so draw all of the view, or a part whose edges lie outside the
     * selection.
     *
     * @param view receives the picture: as many values as the viewport has pixels, not the photo
     * @param port what the view shows
     * @param part the rectangle to draw, in the view; nothing is drawn when it is empty
     * @param firstColour first colour of the outline, 0xAARRGGBB
     * @param secondColour second colour of the outline, 0xAARRGGBB
     * @throws NullPointerException when an argument is null
     * @throws IllegalArgumentException when {@code view} has another length or is the photo
     * @throws IndexOutOfBoundsException when {@code part} reaches beyond the view
     */
    public void drawOutlinedView(int[] view, Viewport port, Area part, int firstColour,
            int secondColour) {
        checkOpen();
        drawing.outlinedView(view, port, part, firstColour, secondColour);
    }

    /**
     * Copies the photo unscaled into a part of a view, its first pixel at the top left of the part;
     * see {@link Util#native_drawSmallImage}.
     *
     * @param view receives the picture: {@code viewWidth} * {@code viewHeight} values, not the
     *     photo
     * @param viewWidth width of the view, at least 1
     * @param viewHeight height of the view, at least 1
     * @param part the rectangle to draw, in the view; nothing is drawn when it is empty
     * @throws NullPointerException when an argument is null
     * @throws IllegalArgumentException when a size is out of its range, or {@code view} has another
     *     length or is the photo
     * @throws IndexOutOfBoundsException when {@code part} reaches beyond the view
     */
    public void drawPlainSmallView(int[] view, int viewWidth, int viewHeight, Area part) {
        checkOpen();
        drawing.plainSmallView(view, viewWidth, viewHeight, part);
    }

    /**
     * Copies the photo unscaled into a part of a view, with the selection's outline; see
     * {@link Util#native_drawSmallImageWithMaskContour}.
     *
     * @param view receives the picture: {@code viewWidth} * {@code viewHeight} values, not the
     *     photo
     * @param viewWidth width of the view, at least 1
     * @param viewHeight height of the view, at least 1
     * @param part the rectangle to draw, in the view; nothing is drawn when it is empty
     * @param firstColour first colour of the outline, 0xAARRGGBB
     * @param secondColour second colour of the outline, 0xAARRGGBB
     * @throws NullPointerException when an argument is null
     * @throws IllegalArgumentException when a size is out of its range, or {@code view} has another
     *     length or is the photo
     * @throws IndexOutOfBoundsException when {@code part} reaches beyond the view
     */
    public void drawOutlinedSmallView(int[] view, int viewWidth, int viewHeight, Area part,
            int firstColour, int secondColour) {
        checkOpen();
        drawing.outlinedSmallView(view, viewWidth, viewHeight, part, firstColour, secondColour);
    }

    /**
     * Draws a part of the photo with the selection in colour and the rest grey.
     *
     * @param picture receives it: width * height values, not the photo
     * @param part the rectangle to draw, on the photo; the rest of the picture stays
     * @throws NullPointerException when an argument is null
     * @throws IllegalArgumentException when {@code picture} has another length or is the photo
     * @throws IndexOutOfBoundsException when {@code part} reaches beyond the photo
     */
    public void drawColourOnGrey(int[] picture, Area part) {
        checkOpen();
        drawing.colourOnGrey(picture, part);
    }

    /**
     * Draws the photo with the selection grey and the rest in colour. The selection stays as it is.
     *
     * @param picture receives it: width * height values, not the photo
     * @throws NullPointerException when {@code picture} is null
     * @throws IllegalArgumentException when it has another length or is the photo
     */
    public void drawReverse(int[] picture) {
        checkOpen();
        drawing.reverse(picture);
    }

    // Script and end

    /**
     * Returns a stroke script that leads to this selection, brush and fill flag: all strokes in
     * effect, dab by dab, and the brush wherever the engine was built anew. Steps that were
     * forgotten are in it, undone ones are not.
     *
     * <p>A new session on the same photo that plays it ends with the same mask and object box.
     *
     * @param photoFile the photo's file, relative to the script's folder; not empty, without double
     *     quotes and line feeds
     * @return the lines, each ending with a line feed
     * @throws NullPointerException when {@code photoFile} is null
     * @throws IllegalArgumentException when a script cannot name it
     */
    public String script(String photoFile) {
        checkNoStroke();
        Checks.notNull("the name of the photo's file", photoFile);
        if (photoFile.isEmpty() || photoFile.indexOf('"') >= 0 || photoFile.indexOf('\n') >= 0) {
            throw new IllegalArgumentException("the name of the photo's file is <" + photoFile
                    + ">, expected one without double quotes and line feeds");
        }
        StringBuilder script = new StringBuilder("photo \"").append(photoFile).append("\"\n");
        history.write(script, settings());
        return script.toString();
    }

    /** Ends the session, in a stroke as well, and frees its place. A second time does nothing. */
    @Override
    public void close() {
        checkThread();
        if (closed) return;
        closed = true;
        try {
            engine.end();
        } finally {
            OPEN.set(null);
        }
    }

    private Area whole() {
        return Area.ofSize(width, height);
    }

    private static void checkMode(Mode mode, boolean lasso) {
        Checks.notNull("the mode", mode);
        if (mode.isLasso() == lasso) return;
        throw new IllegalArgumentException("the mode is " + mode + ", expected "
                + (lasso ? "lasso add or lasso remove" : "grow, shrink, paint or erase"));
    }

    private void checkNoStroke() {
        checkOpen();
        if (strokeMode == null) return;
        throw new IllegalStateException(
                "a stroke is begun (" + strokeMode + "), expected end() first");
    }

    private void checkStroke() {
        checkOpen();
        if (strokeMode != null) return;
        throw new IllegalStateException("no stroke is begun, expected begin() first");
    }

    private void checkOpen() {
        checkThread();
        if (closed) {
            throw new IllegalStateException("the session is closed, expected an open one");
        }
    }

    private void checkThread() {
        if (Thread.currentThread() == thread) return;
        throw new IllegalStateException("called from thread " + Thread.currentThread().getName()
                + ", expected " + thread.getName() + ", which made the session");
    }
}
