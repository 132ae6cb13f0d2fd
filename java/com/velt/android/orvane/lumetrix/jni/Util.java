package com.velt.android.orvane.lumetrix.jni;

import android.graphics.Point;
import android.graphics.Rect;

/**
 * The native image library: selection of an object in a photo, and drawing of photo and selection.
 *
 * <h2>Shapes and units</h2>
 *
 * <dl>
 *   <dt>Pixels
 *   <dd>{@code int[]} of width x height values 0xAARRGGBB, row by row, rows {@code width} apart.
 *   <dt>Mask
 *   <dd>{@code byte[]} of width x height values, laid out like the photo that it belongs to. 1 is
 *       selected, 0 is not. A lasso leaves 3, 4 and 5 while its outline is open (see
 *       {@link #modify_objectsel}); every test for a selected pixel is a test for exactly 1, unless
 *       a method says otherwise.
 *   <dt>Rectangle
 *   <dd>A {@link Rect} as a holder of four numbers. Deliberate: {@code right} and {@code bottom}
 *       are the last column and row <em>inside</em>, unlike in Android's own methods, so {@code
 *       Rect.width()} is one short.
 *   <dt>Empty rectangle
 *   <dd>Either {@code left} = width - 1, {@code right} = 0, {@code top} = height - 1,
 *       {@code bottom} = 0 or {@code left} = width, {@code right} = 0, {@code top} = height,
 *       {@code bottom} = 0; each method says which. Deliberate: both forms are passed on as they
 *       are; on a photo one pixel wide and high the first cannot be told from the box of its only
 *       pixel.
 * </dl>
 *
 * <h2>Session</h2>
 *
 * <p>One selection session exists in a process: the engine with its brush, and the object box, a
 * rectangle around what strokes have selected. Photo, mask and view belong to the caller and are
 * not kept beyond a call. The usual order is {@link #set_brush_size}, {@link #init_objectsel}, any
 * number of strokes with {@link #modify_objectsel}, {@link #destroy_objectsel}.
 *
 * <p>Call the session's methods from one thread at a time. The methods whose names begin with
 * {@code native_} share nothing and may run on any thread, as long as no two are handed the same
 * array. Deliberate: every array is written back at the end of a call, also one that was only read,
 * so what another thread put into it meanwhile may be lost.
 *
 * <h2>Bad input</h2>
 *
 * <p>Only {@link #init_objectsel}, {@link #inverse_objectsel} and {@link #reset_objectsel} check
 * arguments. Everywhere else an array that is null or shorter than its sizes say, a null rectangle
 * or point, or a rectangle that reaches beyond its array is not detected and may end the process.
 * So does an array whose elements the virtual machine has no memory to hand out.
 * No method throws, {@link #nativeIntAlloc} apart.
 */
public final class Util {
    static {
        System.loadLibrary("draventaUtil");
    }

    private Util() {}

    // The session

    /**
     * Begins the selection on a photo: builds a new engine for the current brush and empties the
     * object box ({@code left} = width - 1, {@code right} = 0, {@code top} = height - 1,
     * {@code bottom} = 0).
     *
     * <p>The mask is the caller's and is not touched; see {@link #reset_objectsel}. An engine that
     * exists is released first. The new engine is built for a brush, not for a size: every stroke
     * is told the size of its photo.
     *
     * @param width width of the photo in pixels, at least 1
     * @param height height of the photo in pixels, at least 1
     * @return 1; 0 with a line in the log and no other effect when {@code width} or {@code height}
     *     is below 1. Deliberate: 1 also when memory for the engine ran out; strokes then change
     *     nothing.
     */
    public static native int init_objectsel(int width, int height);

    /**
     * Performs one point of a brush stroke, or one segment of a lasso.
     *
     * <table>
     *   <caption>Modes; any other mode only empties {@code rect}</caption>
     *   <tr><th>{@code mode}</th><th>what happens in the mask</th>
     *       <th>then, with {@code fill} 1</th></tr>
     *   <tr><td>0 grow</td><td>selects from the brush's core outwards, up to edges of
     *       colour inside the brush</td><td>holes of the selection are filled</td></tr>
     *   <tr><td>1 shrink</td><td>the same with deselecting</td><td>of several pieces the largest
     *       stays, the others are erased; the object box is rebuilt</td></tr>
     *   <tr><td>2 paint</td><td>selects the brush's disc</td><td>holes of the selection are
     *       filled</td></tr>
     *   <tr><td>3 erase</td><td>deselects the brush's disc</td><td>nothing</td></tr>
     *   <tr><td>4 lasso, adding</td><td>draws an outline from {@code p1} to {@code p2}: 0 becomes
     *       1, any other value 5</td><td>what outline and selection enclose is selected; 5
     *       becomes 1</td></tr>
     *   <tr><td>5 lasso, removing</td><td>draws an outline from {@code p1} to {@code p2}: 1
     *       becomes 4, any other value 3</td><td>what the outline encloses is deselected, the
     *       outline too</td></tr>
     * </table>
     *
     * <p>Modes 0, 2, 4 and 5 widen the object box by the rectangle of the operation itself; 1 and 3
     * leave it, apart from the rebuilding named above. The passes with {@code fill} look only
     * inside the object box; they run also after an operation that changed nothing.
     *
     * <p>Points: mode 0 does nothing at a point on or beyond the outermost rows and columns of the
     * photo. Mode 1 has no such margin; it does nothing at a point outside the photo or where the
     * mask is not 1. Modes 2 and 3 paint that part of the disc that lies on the photo. A lasso
     * segment with an end outside the photo is not drawn.
     *
     * <p>Deliberate: without an engine, and for an unknown mode, {@code rect} is emptied and
     * nothing else happens. Modes 2 and 3 leave out the last row and the last column of the brush's
     * square, so a brush of radius 0 paints nothing. Mode 5 widens the object box although it
     * removes pixels. With {@code fill} 0, outline values 3, 4 and 5 stay in the mask, so a lasso
     * of several segments passes 0 until its last one. Brushes treat such values each in their way:
     * mode 0 makes 4 selected and clears the others in the brush's square, mode 1 makes 3 selected
     * and clears 4 there and each 5 that it reaches, modes 2 and 3 leave them. Mode 1's pass
     * measures a piece by the pixels inside its contour and keeps the later one of two equals.
     *
     * @param pixels the photo, read by modes 0 and 1; never changed, though written back as it was
     * @param mask the selection, changed
     * @param width width of photo and mask
     * @param height height of photo and mask
     * @param p1 the brush's point, or the start of the lasso segment, in photo pixels
     * @param p2 the end of the lasso segment; must not be null in the other modes either, where its
     *     fields are read and not used
     * @param mode 0 to 5, see the table
     * @param rect receives the rectangle changed by the call, its former fields do not matter:
     *     around the pixels that the operation selected, removed or drew, and with modes 0, 1 and 2
     *     also those that the pass filled or erased; {@code left} = width, {@code right} = 0,
     *     {@code top} = height, {@code bottom} = 0 when there are none. Deliberate: mode 0 counts
     *     pixels of the brush's square that were selected before as well, and mode 1 unselected
     *     ones that it reached; what a lasso's pass changes is not counted.
     * @param fill 1 runs the pass of the mode's last column; any other value, also 2 or -1, does
     *     not
     */
    public static native void modify_objectsel(int[] pixels, byte[] mask, int width, int height,
            Point p1, Point p2, int mode, Rect rect, int fill);

    /**
     * Ends the selection: releases the engine, if there is one.
     *
     * <p>Brush settings and object box stay as they are.
     */
    public static native void destroy_objectsel();

    /**
     * Inverts a selection and sets the object box to the exact box of the new one.
     *
     * <p>Deliberate: every value but 1 becomes 1, outline values of a lasso included. When nothing
     * is selected afterwards, the object box is empty in the form {@code left} = width - 1,
     * {@code right} = 0, {@code top} = height - 1, {@code bottom} = 0.
     *
     * @param mask the selection, changed; null does nothing but write a line to the log
     * @param width width of the mask; below 1 does nothing but write a line to the log
     * @param height height of the mask; below 1 does nothing but write a line to the log
     */
    public static native void inverse_objectsel(byte[] mask, int width, int height);

    /**
     * Clears a selection: sets every byte of the mask to 0 and empties the object box
     * ({@code left} = width - 1, {@code right} = 0, {@code top} = height - 1, {@code bottom} = 0).
     *
     * <p>Engine and brush stay as they are.
     *
     * @param mask the selection, changed; null does nothing but write a line to the log
     * @param width width of the mask; below 1 does nothing but write a line to the log
     * @param height height of the mask; below 1 does nothing but write a line to the log
     */
    public static native void reset_objectsel(byte[] mask, int width, int height);

    /**
     * Sets the brush and builds a new engine for it.
     *
     * <p>Deliberate: the engine is rebuilt also when nothing changed, and is made when there was
     * none. Mask and object box stay as they are. Nothing is checked: a negative radius makes a
     * brush without pixels, and a radius whose buffers exceed memory an engine whose strokes do
     * nothing.
     *
     * @param radius radius of the brush in photo pixels; before the first call it is 10
     * @param center radius of the core, whose pixels a growing or shrinking stroke always takes, in
     *     photo pixels; before the first call it is 1. From {@code radius} - 1 on, growing and
     *     shrinking have no room between core and rim; beyond {@code radius} the core goes on
     *     outside the rim.
     */
    public static native void set_brush_size(int radius, int center);

    /**
     * Does nothing. Deliberate: it is kept for callers that call it; start over with
     * {@link #reset_objectsel} instead.
     *
     * @param mask not changed, though written back as it was; must not be null
     * @param width not used
     * @param height not used
     * @param roi its fields are read and not used; must not be null
     */
    public static native void reinit_objectsel(byte[] mask, int width, int height, Rect roi);

    /**
     * Returns the radius of the brush.
     *
     * @return what {@link #set_brush_size} stored last; 10 before
     */
    public static native int get_brush_radius();

    /**
     * Returns the radius of the brush's core.
     *
     * @return what {@link #set_brush_size} stored last; 1 before
     */
    public static native int get_brush_center();

    // The object box

    /**
     * Reads the object box.
     *
     * @param roi receives the four values as they stand, empty forms included; all 0 until a
     *     method first sets them
     */
    public static native void get_objectROI(Rect roi);

    /**
     * Sets the object box.
     *
     * <p>Deliberate: the values are stored as they are, also a {@code left} beyond {@code right} or
     * a box larger than the photo. What looks inside it takes the part that lies on the photo.
     *
     * @param roi the new box
     */
    public static native void set_objectROI(Rect roi);

    /**
     * Shrinks the object box to the pixels of value 1 inside it.
     *
     * <p>Deliberate: a selected pixel outside the old box is not found, the box never grows here.
     * When there is no pixel, the box becomes {@code left} = width, {@code right} = 0,
     * {@code top} = height, {@code bottom} = 0. To measure a mask from scratch, set the box to the
     * whole photo first.
     *
     * @param mask the selection, not changed
     * @param width width of the mask
     * @param height height of the mask
     */
    public static native void update_objectROI(byte[] mask, int width, int height);

    /**
     * Empties the fill rectangle ({@code left} = width - 1, {@code right} = 0, {@code top} =
     * height - 1, {@code bottom} = 0). Deliberate: nothing reads that rectangle, so the call has no
     * effect that Java code could see.
     *
     * @param width width of the photo
     * @param height height of the photo
     */
    public static native void reset_fill_ROI(int width, int height);

    // Photo and selection, pixel for pixel

    /**
     * Draws the selection in colour on grey: inside the rectangle selected pixels are copied, all
     * others become grey, (red + green + blue) / 3 rounded down, with their alpha kept.
     *
     * <p>Pixels outside the rectangle are not touched. {@code top} beyond {@code bottom} or
     * {@code left} beyond {@code right} draws nothing.
     *
     * @param src the photo
     * @param dst receives the picture; as large as the photo, may be the same array
     * @param mask the selection, not changed
     * @param width width of photo, picture and mask
     * @param roi the rectangle to draw, in photo pixels; must lie on the photo, nothing is clipped
     */
    public static native void draw_withmask(int[] src, int[] dst, byte[] mask, int width, Rect roi);

    /**
     * Draws the selection grey in the coloured photo, and inverts the mask.
     *
     * <p>Deliberate: the mask comes back inverted (1 becomes 0, any other value 1), so a second
     * call with it draws the opposite picture. Hand over a copy to keep the selection. The object
     * box does not follow. Sizes below 1 do nothing.
     *
     * @param src the photo
     * @param dst receives the picture; as large as the photo, may be the same array
     * @param mask the selection, inverted
     * @param width width of photo, picture and mask
     * @param height height of photo, picture and mask
     */
    public static native void draw_reversemask(int[] src, int[] dst, byte[] mask, int width,
            int height);

    // The view
    //
    // Scale is photo pixels per view pixel. It is turned into a step of scale * 65536, truncated;
    // positions are sums of steps in 32 bits that wrap, so a position holds up to column or row
    // 32767. Offsets are the photo column and row that view pixel (0, 0) shows.

    /**
     * Tells which photo column each view column shows and which photo row each view row.
     *
     * <p>{@code points[x]} becomes the photo column of view column {@code x}, and
     * {@code points[columns + y]} the photo row of view row {@code y}, as {@link #native_drawImage}
     * samples them. Deliberate: unlike there, nothing is clamped to the photo; negative values and
     * values beyond its edge are reported. A count of 0 or less writes nothing.
     *
     * @param columns number of view columns
     * @param rows number of view rows
     * @param unused1 not read
     * @param unused2 not read
     * @param scale photo pixels per view pixel: above 1 the photo is reduced, below 1 enlarged
     * @param offsetX photo column at view column 0
     * @param offsetY photo row at view row 0
     * @param points receives the positions; at least {@code columns} + {@code rows} long
     */
    public static native void native_setImagePoints(int columns, int rows, int unused1, int unused2,
            float scale, int offsetX, int offsetY, int[] points);

    /**
     * Draws the photo into a rectangle of the view, scaled, each view pixel a copy of one photo
     * pixel.
     *
     * <p>View pixel (x, y) shows photo column {@code offsetX} + x x {@code scale}, rounded down,
     * and the row likewise; beyond the photo's edge its outermost columns and rows are repeated.
     * Deliberate: {@link #native_drawImageWithMaskContour} rounds to nearest instead. The scale is
     * truncated to 1/65536, which adds up: with 0.3, view column 10 shows photo column 2, not 3.
     *
     * @param view receives the picture
     * @param viewWidth width of the view
     * @param viewHeight not read: nothing is clipped against the view
     * @param photo the photo
     * @param photoWidth width of the photo
     * @param photoHeight height of the photo
     * @param scale photo pixels per view pixel: above 1 the photo is reduced, below 1 enlarged
     * @param offsetX photo column at view column 0
     * @param offsetY photo row at view row 0
     * @param rect the rectangle to draw, in view pixels; must lie in the view. Nothing is drawn
     *     when {@code left} lies beyond {@code right} or {@code top} beyond {@code bottom}.
     * @return 1
     */
    public static native int native_drawImage(int[] view, int viewWidth, int viewHeight,
            int[] photo, int photoWidth, int photoHeight, float scale, int offsetX, int offsetY,
            Rect rect);

    /**
     * Draws the photo into a rectangle of the view, scaled, with the outline of the selection.
     *
     * <p>The outline is one view pixel wide whatever the scale: it goes over each view pixel whose
     * mask value is 1 or 3 and beside which (right, below, left, above in the view) lies a pixel of
     * value 0, 4 or 5. It is dashed in two colours on a checkerboard of 5 x 5 view pixels that
     * stays put when the photo moves; the first colour is that of the view's top left pixel.
     *
     * <p>Deliberate: photo positions are rounded to nearest, while {@link #native_drawImage} rounds
     * down. In the first and last row and column of {@code rect} every pixel of value 1 or 3 takes
     * the outline's colour. Elsewhere selected pixels on the photo's own border show the photo.
     * With {@code top} beyond {@code bottom} these two rows are drawn all the same (when
     * {@code left} is not beyond {@code right}); with {@code left} beyond {@code right} these two
     * columns of the rows between.
     *
     * @param view receives the picture
     * @param viewWidth width of the view
     * @param viewHeight not read: nothing is clipped against the view
     * @param photo the photo
     * @param photoWidth width of photo and mask
     * @param photoHeight height of photo and mask
     * @param mask the selection, not changed
     * @param scale photo pixels per view pixel: above 1 the photo is reduced, below 1 enlarged
     * @param offsetX photo column at view column 0
     * @param offsetY photo row at view row 0
     * @param firstColour first colour of the outline, 0xAARRGGBB, written as it is
     * @param secondColour second colour of the outline, 0xAARRGGBB, written as it is
     * @param rect the rectangle to draw, in view pixels; must lie in the view
     * @return 1
     */
    public static native int native_drawImageWithMaskContour(int[] view, int viewWidth,
            int viewHeight, int[] photo, int photoWidth, int photoHeight, byte[] mask, float scale,
            int offsetX, int offsetY, int firstColour, int secondColour, Rect rect);

    /**
     * Copies the photo unscaled into a rectangle of the view, its first pixel at the rectangle's
     * top left corner.
     *
     * <p>A larger photo is cut off at the rectangle; of a smaller one the last column and row are
     * repeated up to the rectangle's edges.
     *
     * @param view receives the picture
     * @param viewWidth width of the view
     * @param viewHeight not read: nothing is clipped against the view
     * @param photo the photo
     * @param photoWidth width of the photo
     * @param photoHeight height of the photo
     * @param rect the rectangle to draw, in view pixels; must lie in the view. Nothing is drawn
     *     when {@code left} lies beyond {@code right} or {@code top} beyond {@code bottom}.
     * @return 1
     */
    public static native int native_drawSmallImage(int[] view, int viewWidth, int viewHeight,
            int[] photo, int photoWidth, int photoHeight, Rect rect);

    /**
     * Copies the photo unscaled into a rectangle of the view, like {@link #native_drawSmallImage},
     * with the outline of the selection.
     *
     * <p>The outline goes over each photo pixel of mask value 1 that has a 0 to its right, below,
     * to its left or above, dashed as in {@link #native_drawImageWithMaskContour}, with the
     * checkerboard fixed to the view.
     *
     * <p>Deliberate: here only 1 is selected and only 0 is outside, selected pixels on the photo's
     * border are outline, and the rectangle's own edges are nothing special.
     *
     * @param view receives the picture
     * @param viewWidth width of the view
     * @param viewHeight not read: nothing is clipped against the view
     * @param photo the photo
     * @param photoWidth width of photo and mask
     * @param photoHeight height of photo and mask
     * @param mask the selection, not changed
     * @param firstColour first colour of the outline, 0xAARRGGBB, written as it is
     * @param secondColour second colour of the outline, 0xAARRGGBB, written as it is
     * @param rect the rectangle to draw, in view pixels; must lie in the view. Nothing is drawn
     *     when {@code left} lies beyond {@code right} or {@code top} beyond {@code bottom}.
     * @return 1
     */
    public static native int native_drawSmallImageWithMaskContour(int[] view, int viewWidth,
            int viewHeight, int[] photo, int photoWidth, int photoHeight, byte[] mask,
            int firstColour, int secondColour, Rect rect);

    // Arrays

    /**
     * Makes an array on the Java heap; the library keeps nothing of it.
     *
     * @param length number of elements, 0 or more
     * @return a new array of zeros
     * @throws NegativeArraySizeException if {@code length} is negative
     * @throws OutOfMemoryError if there is no room for the array
     */
    public static native int[] nativeIntAlloc(int length);

    /**
     * Releases nothing. Deliberate: an array from {@link #nativeIntAlloc} is an ordinary Java array
     * that the virtual machine collects; the call is there to stand beside its counterpart.
     *
     * @param array any array, unchanged afterwards, or null
     * @return 0
     */
    public static native int nativeIntRelease(int[] array);
}
