package com.velt.android.orvane.lumetrix.jni;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;

import android.graphics.Point;
import android.graphics.Rect;
import com.velt.android.orvane.lumetrix.MaskDrawing;
import java.util.Arrays;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.ValueSource;

/** Each mode of a stroke on small masks: what it changes, what it reports, and the object box. */
class UtilStrokesTest {
    static final int GROW = 0;
    static final int SHRINK = 1;
    static final int PAINT = 2;
    static final int ERASE = 3;
    static final int LASSO_ADD = 4;
    static final int LASSO_REMOVE = 5;

    private MaskDrawing mask;
    private int[] photo;

    @AfterEach
    void endSession() {
        Util.destroy_objectsel();
    }

    @Test
    void paintingSelectsTheDiscWithoutItsLastRowAndColumn() {
        begin(3, 1, """
            .........
            .........
            .........
            .........
            .........
            .........
            .........
            .........""");
        Rect changed = dab(PAINT, 4, 4, 0);
        assertMask("""
            .........
            ...###...
            ..#####..
            .######..
            .######..
            .######..
            ..#####..
            .........""");
        assertEquals(new Rect(1, 1, 6, 6), changed);
        assertEquals(new Rect(1, 1, 6, 6), objectBox());
    }

    @Test
    void paintingOutsideThePhotoPaintsThePartInside() {
        begin(3, 1, """
            .....
            .....
            .....""");
        Rect changed = dab(PAINT, -1, 1, 0);
        assertMask("""
            ##...
            ##...
            ##...""");
        assertEquals(new Rect(0, 0, 1, 2), changed);
    }

    @Test
    void paintingReportsOnlyWhatItSelected() {
        begin(1, 1, """
            ####
            ###.
            ####""");
        assertEquals(new Rect(4, 3, 0, 0), dab(PAINT, 1, 1, 0));
        assertEquals(new Rect(3, 2, 0, 0), objectBox());
        assertEquals(new Rect(3, 1, 3, 1), dab(PAINT, 3, 1, 0));
        assertEquals(new Rect(3, 1, 3, 1), objectBox());
    }

    @Test
    void aBrushOfRadiusZeroPaintsNothing() {
        begin(0, 0, """
            ..#
            ..#""");
        assertEquals(new Rect(3, 2, 0, 0), dab(PAINT, 1, 1, 0));
        assertEquals(new Rect(3, 2, 0, 0), dab(ERASE, 2, 1, 0));
        assertMask("""
            ..#
            ..#""");
    }

    @Test
    void paintingAndErasingLeaveOutlineValues() {
        String outlines = """
            3.4
            5.#
            3#4""";
        begin(2, 1, outlines);
        dab(ERASE, 1, 1, 0);
        assertMask("""
            3.4
            5..
            3.4""");
        dab(PAINT, 1, 1, 0);
        assertMask("""
            3#4
            5##
            3#4""");
    }

    @Test
    void paintingWithFillOneFillsHolesAndReportsThem() {
        begin(1, 1, """
            .........
            .#####...
            .#...#...
            .#####...
            .......#.
            .........""");
        boxOfSelection();
        Rect changed = dab(PAINT, 7, 4, 1);
        assertMask("""
            .........
            .#####...
            .#####...
            .#######.
            ......##.
            .........""");
        assertEquals(new Rect(2, 2, 7, 4), changed);
        assertEquals(new Rect(1, 1, 7, 4), objectBox());
    }

    @ParameterizedTest
    @ValueSource(ints = {0, 2, -1})
    void paintingWithAnotherFillLeavesHoles(int fill) {
        begin(1, 1, """
            #####
            #...#
            #####""");
        boxOfSelection();
        dab(PAINT, 0, 0, fill);
        assertMask("""
            #####
            #...#
            #####""");
    }

    @Test
    void holesOutsideTheObjectBoxStay() {
        begin(1, 1, """
            ###.....
            #.#.....
            ###.....
            .......#""");
        Util.set_objectROI(new Rect(4, 0, 7, 3));
        dab(PAINT, 6, 1, 1);
        assertMask("""
            ###..##.
            #.#..##.
            ###.....
            .......#""");
    }

    @ParameterizedTest
    @ValueSource(ints = {0, 1})
    void erasingDeselectsTheDiscAndNothingElseWhateverTheFill(int fill) {
        begin(1, 1, """
            #########
            #.#...#.#
            #########""");
        boxOfSelection();
        assertEquals(new Rect(3, 0, 4, 0), dab(ERASE, 4, 0, fill));
        assertEquals(new Rect(3, 2, 4, 2), dab(ERASE, 4, 3, fill));
        assertMask("""
            ###..####
            #.#...#.#
            ###..####""");
        assertEquals(new Rect(0, 0, 8, 2), objectBox());
    }

    @Test
    void erasingEverythingKeepsTheObjectBox() {
        begin(4, 1, """
            ####
            ####""");
        boxOfSelection();
        assertEquals(new Rect(0, 0, 3, 1), dab(ERASE, 1, 1, 1));
        assertMask("""
            ....
            ....""");
        assertEquals(new Rect(0, 0, 3, 1), objectBox());
    }

    @Test
    void shrinkingTakesTheCoreWhereItHasNoRoomToGrow() {
        begin(2, 1, """
            #######
            #######
            #######
            #######
            #######""");
        boxOfSelection();
        assertEquals(new Rect(2, 1, 4, 3), dab(SHRINK, 3, 2, 0));
        assertMask("""
            #######
            ##...##
            ##...##
            ##...##
            #######""");
        assertEquals(new Rect(0, 0, 6, 4), objectBox());
    }

    @Test
    void shrinkingStopsAtAnEdge() {
        begin(5, 1, """
            ###############
            ###############
            ###############
            ###############
            ###############
            ###############
            ###############
            ###############
            ###############
            ###############
            ###############""");
        for (int i = 0; i < photo.length; ++i) photo[i] = i % 15 < 8 ? 0xFFC00000 : 0xFF0000C0;
        dab(SHRINK, 5, 5, 0);
        for (int y = 0; y < 11; ++y) {
            for (int x = 0; x < 15; ++x) {
                if (Math.abs(x - 5) <= 1 && Math.abs(y - 5) <= 1) {
                    assertEquals(0, at(x, y), "core pixel " + x + "," + y);
                } else if (x >= 8 || Math.hypot(x - 5, y - 5) >= 5.5) {
                    assertEquals(1, at(x, y), "beyond the edge or the brush " + x + "," + y);
                }
            }
        }
    }

    @Test
    void shrinkingHasNoMarginAtThePhotosBorder() {
        begin(2, 1, """
            ####
            ####
            ####""");
        assertEquals(new Rect(0, 0, 1, 1), dab(SHRINK, 0, 0, 0));
        assertEquals(new Rect(2, 1, 3, 2), dab(SHRINK, 3, 2, 0));
        assertMask("""
            ..##
            ....
            ##..""");
    }

    @Test
    void shrinkingWhereNothingIsSelectedOrOutsideChangesNothing() {
        String before = """
            ##..
            ##5.
            ##..""";
        begin(2, 1, before);
        int[][] points = {{3, 1}, {2, 1}, {-1, 1}, {1, -1}, {4, 1}, {1, 3}};
        for (int[] point : points) {
            assertEquals(new Rect(4, 3, 0, 0), dab(SHRINK, point[0], point[1], 0));
        }
        assertMask(before);
    }

    @Test
    void shrinkingWithFillOneErasesTheSmallerPieceAndRebuildsTheObjectBox() {
        begin(2, 1, """
            ..............
            .####....####.
            .############.
            .############.
            .############.
            .####....#####
            ..............""");
        boxOfSelection();
        Rect changed = dab(SHRINK, 6, 3, 1);
        assertMask("""
            ..............
            .........####.
            ........#####.
            ........#####.
            ........#####.
            .........#####
            ..............""");
        assertEquals(new Rect(1, 1, 7, 5), changed);
        assertEquals(new Rect(8, 1, 13, 5), objectBox());
    }

    @ParameterizedTest
    @ValueSource(ints = {0, 2, -1})
    void shrinkingWithAnotherFillKeepsThePiecesAndTheObjectBox(int fill) {
        begin(2, 1, """
            #########
            #########
            #########""");
        boxOfSelection();
        assertEquals(new Rect(3, 0, 5, 2), dab(SHRINK, 4, 1, fill));
        assertMask("""
            ###...###
            ###...###
            ###...###""");
        assertEquals(new Rect(0, 0, 8, 2), objectBox());
    }

    @Test
    void thePassRunsAfterAnOperationThatChangedNothing() {
        begin(2, 1, """
            ###....
            ###.###
            ###.###""");
        Util.set_objectROI(new Rect(-3, -3, 9, 9));
        assertEquals(new Rect(4, 1, 6, 2), dab(SHRINK, 3, 0, 1));
        assertMask("""
            ###....
            ###....
            ###....""");
        assertEquals(new Rect(0, 0, 2, 2), objectBox());
    }

    @Test
    void growingSettlesOutlineValuesInItsSquare() {
        begin(2, 1, """
            3453453
            .......
            .......
            .......
            3.4.5.3""");
        assertEquals(new Rect(1, 0, 4, 4), dab(GROW, 3, 2, 0));
        assertMask("""
            3#..#.3
            ..###..
            ..###..
            ..###..
            3.#...3""");
    }

    @Test
    void shrinkingSettlesOutlineValuesInItsSquare() {
        begin(2, 1, """
            3453453
            #######
            ##3#5##
            #######
            3.4.5.3""");
        dab(SHRINK, 3, 2, 0);
        assertMask("""
            3.5#.53
            ##...##
            ###..##
            ##...##
            3...5.3""");
    }

    @Test
    void lassoSegmentTouchesARowOrColumnEachInEitherDirection() {
        for (boolean turned : new boolean[] {false, true}) {
            begin(10, 1, """
                .......
                .......
                .......
                .......
                .......""");
            assertEquals(new Rect(2, 2, 5, 3),
                    turned ? segment(LASSO_ADD, 5, 3, 2, 2, 0) : segment(LASSO_ADD, 2, 2, 5, 3, 0));
            assertMask("""
                .......
                .......
                ..##...
                ....##.
                .......""");
            assertEquals(new Rect(2, 2, 5, 3), objectBox());
        }
    }

    @Test
    void addingLassoTurnsZeroToOneAndAllElseToFive() {
        begin(10, 1, ".#2345.");
        assertEquals(new Rect(0, 0, 6, 0), segment(LASSO_ADD, 0, 0, 6, 0, 0));
        assertMask("#55555#");
        assertEquals(new Rect(0, 0, 6, 0), objectBox());
    }

    @Test
    void removingLassoTurnsOneToFourAndAllElseToThree() {
        begin(10, 1, ".#2345.");
        assertEquals(new Rect(0, 0, 6, 0), segment(LASSO_REMOVE, 0, 0, 6, 0, 0));
        assertMask("3433333");
    }

    @Test
    void lassoOfOnePointIsOnePixel() {
        begin(10, 1, "...");
        assertEquals(new Rect(1, 0, 1, 0), segment(LASSO_ADD, 1, 0, 1, 0, 0));
        assertMask(".#.");

        begin(10, 1, "###");
        assertEquals(new Rect(1, 0, 1, 0), segment(LASSO_REMOVE, 1, 0, 1, 0, 0));
        assertMask("#4#");
    }

    @Test
    void lassoOfOnePointDrawnAgainEndsAsFiveOrThree() {
        for (int times : new int[] {2, 3}) {
            begin(10, 1, ".");
            for (int i = 0; i < times; ++i) segment(LASSO_ADD, 0, 0, 0, 0, 0);
            assertMask("5");
            begin(10, 1, "#");
            for (int i = 0; i < times; ++i) segment(LASSO_REMOVE, 0, 0, 0, 0, 0);
            assertMask("3");
        }
    }

    @Test
    void lassoSegmentThatEndsOutsideIsNotDrawn() {
        begin(10, 1, """
            .#.
            .#.""");
        int[][] ends = {{3, 0}, {-1, 0}, {0, 2}, {0, -1}};
        for (int mode : new int[] {LASSO_ADD, LASSO_REMOVE}) {
            for (int[] end : ends) {
                assertEquals(new Rect(3, 2, 0, 0), segment(mode, 1, 1, end[0], end[1], 0));
                assertEquals(new Rect(3, 2, 0, 0), segment(mode, end[0], end[1], 1, 1, 0));
            }
        }
        assertMask("""
            .#.
            .#.""");
        assertEquals(new Rect(2, 1, 0, 0), objectBox());
    }

    @Test
    void addingLassoIsFilledByItsClosingCall() {
        String before = """
            ........
            ........
            ........
            ...###..
            ...###..
            ........""";
        begin(10, 1, before);
        drawSquare(LASSO_ADD, 0);
        assertMask("""
            ........
            .5##5...
            .#..#...
            .#.#5#..
            .5#55#..
            ........""");

        begin(10, 1, before);
        assertEquals(new Rect(1, 1, 1, 4), drawSquare(LASSO_ADD, 1));
        assertMask("""
            ........
            .####...
            .####...
            .#####..
            .#####..
            ........""");
    }

    @Test
    void removingLassoIsFilledByItsClosingCallAndWidensTheObjectBox() {
        String before = """
            ######..
            ######..
            ######..
            ######..
            ######..
            ######..""";
        begin(10, 1, before);
        drawSquare(LASSO_REMOVE, 0);
        assertMask("""
            ######..
            #3443#..
            #4##4#..
            #4##4#..
            #3443#..
            ######..""");

        begin(10, 1, before);
        assertEquals(new Rect(7, 5, 0, 0), objectBox());
        assertEquals(new Rect(1, 1, 1, 4), drawSquare(LASSO_REMOVE, 1));
        assertMask("""
            ######..
            #....#..
            #....#..
            #....#..
            #....#..
            ######..""");
        assertEquals(new Rect(1, 1, 4, 4), objectBox());
    }

    @Test
    void removingLineTakesOnlyItsOwnPixels() {
        begin(10, 1, """
            ####.
            ####.
            ####.""");
        assertEquals(new Rect(0, 1, 4, 1), segment(LASSO_REMOVE, 0, 1, 4, 1, 1));
        assertMask("""
            ####.
            .....
            ####.""");
    }

    @ParameterizedTest
    @ValueSource(ints = {2, -1})
    void otherFillsLeaveTheLassoOpen(int fill) {
        begin(10, 1, "#..");
        segment(LASSO_ADD, 0, 0, 1, 0, fill);
        assertMask("5#.");
        segment(LASSO_REMOVE, 1, 0, 2, 0, fill);
        assertMask("543");
    }

    @Test
    void eachLassosPassLeavesTheOthersOutlineAndWhatIsOutsideTheObjectBox() {
        begin(10, 1, "3.5.4.5.3");
        Util.set_objectROI(new Rect(0, 0, 4, 0));
        segment(LASSO_ADD, 1, 0, 1, 0, 1);
        assertMask("3##.4.5.3");
        segment(LASSO_REMOVE, 3, 0, 3, 0, 1);
        assertMask(".##...5.3");
    }

    @Test
    void strokesReturnThePhotoAsItWas() {
        begin(2, 1, """
            #####
            #####
            #####
            #####""");
        for (int i = 0; i < photo.length; ++i) photo[i] = 0x01020304 * i;
        int[] before = photo.clone();
        for (int mode = GROW; mode <= LASSO_REMOVE; ++mode) {
            dab(mode, 2, 2, 1);
            assertArrayEquals(before, photo, "mode " + mode);
        }
    }

    /** Begins on a photo of one colour with the selection given and an empty object box. */
    private void begin(int radius, int core, String selection) {
        mask = MaskDrawing.of(selection);
        photo = new int[mask.cells().length];
        Arrays.fill(photo, 0xFF808080);
        Util.set_brush_size(radius, core);
        Util.init_objectsel(mask.width(), mask.height());
    }

    /** Sets the object box to the exact box of what is selected. */
    private void boxOfSelection() {
        Util.set_objectROI(new Rect(0, 0, mask.width() - 1, mask.height() - 1));
        Util.update_objectROI(mask.cells(), mask.width(), mask.height());
    }

    private Rect dab(int mode, int x, int y, int fill) {
        return segment(mode, x, y, x, y, fill);
    }

    private Rect segment(int mode, int x1, int y1, int x2, int y2, int fill) {
        Rect changed = new Rect(5, 7, 6, 8);
        Util.modify_objectsel(photo, mask.cells(), mask.width(), mask.height(), new Point(x1, y1),
                new Point(x2, y2), mode, changed, fill);
        return changed;
    }

    /** Draws a lasso around the pixels 1,1 to 4,4 and returns what the closing call reports. */
    private Rect drawSquare(int mode, int fillAtTheEnd) {
        segment(mode, 1, 1, 4, 1, 0);
        segment(mode, 4, 1, 4, 4, 0);
        segment(mode, 4, 4, 1, 4, 0);
        return segment(mode, 1, 4, 1, 1, fillAtTheEnd);
    }

    private byte at(int x, int y) {
        return mask.cells()[y * mask.width() + x];
    }

    private void assertMask(String expected) {
        assertEquals(MaskDrawing.of(expected), mask);
    }

    private static Rect objectBox() {
        Rect box = new Rect();
        Util.get_objectROI(box);
        return box;
    }
}
