#include <gtest/gtest.h>

#include "selection/ER_selection.h"
#include "selection/region_shaping.h"
#include "tests/helpers/failing_allocations.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"

namespace {

using fill = int(unsigned char*, int, int, int, int, int, int);

int run_in(fill* pass, Picture* mask, const ze_rect& box) {
    return pass(mask->data(), mask->width, mask->height, box.left, box.right, box.top, box.bottom);
}

Picture filled(fill* pass, const char* drawing) {
    Picture mask(drawing);
    EXPECT_EQ(run_in(pass, &mask, {0, mask.width - 1, 0, mask.height - 1}), 1);
    return mask;
}

Picture add_filled(const char* drawing) { return filled(ze_lasso_add_fill_mask, drawing); }
Picture del_filled(const char* drawing) { return filled(ze_lasso_del_fill_mask, drawing); }

// Draws the outline of a rectangle as four segments.
void add_outline(Picture* mask, int left, int right, int top, int bottom) {
    ER_selection engine;
    ze_rect rect = {0, 0, 0, 0};
    const auto draw = [&](int x0, int y0, int x1, int y1) {
        engine.Lasso_Add(mask->data(), mask->width, mask->height, x0, y0, x1, y1, &rect);
    };
    draw(left, top, right, top);
    draw(right, top, right, bottom);
    draw(right, bottom, left, bottom);
    draw(left, bottom, left, top);
}

void remove_outline(Picture* mask, int left, int right, int top, int bottom) {
    ER_selection engine;
    ze_rect rect = {0, 0, 0, 0};
    const auto draw = [&](int x0, int y0, int x1, int y1) {
        engine.Lasso_Del(mask->data(), mask->width, mask->height, x0, y0, x1, y1, &rect);
    };
    draw(left, top, right, top);
    draw(right, top, right, bottom);
    draw(right, bottom, left, bottom);
    draw(left, bottom, left, top);
}

}  // namespace

// ---- adding

TEST(ze_lasso_add_fill_mask, SelectsAClosedOutlineWithItsInterior) {
    Picture mask(7, 6, 0);
    add_outline(&mask, 1, 5, 1, 4);
    ASSERT_EQ(mask, Picture(R"(
        .......
        .5###5.
        .#...#.
        .#...#.
        .5###5.
        .......)"));

    EXPECT_EQ(run_in(ze_lasso_add_fill_mask, &mask, {1, 5, 1, 4}), 1);

    EXPECT_EQ(mask, Picture(R"(
        .......
        .#####.
        .#####.
        .#####.
        .#####.
        .......)"));
}

TEST(ze_lasso_add_fill_mask, FillsTheOutlineAndTheSelectionThatItCrossesAsOne) {
    Picture mask(R"(
        .........
        .###.....
        .###.....
        .###.....
        .###.....
        .........)");
    add_outline(&mask, 2, 7, 2, 4);
    ASSERT_EQ(mask, Picture(R"(
        .........
        .###.....
        .#55###5.
        .#5#...#.
        .#55###5.
        .........)"));

    EXPECT_EQ(run_in(ze_lasso_add_fill_mask, &mask, {1, 7, 1, 4}), 1);

    EXPECT_EQ(mask, Picture(R"(
        .........
        .###.....
        .#######.
        .#######.
        .#######.
        .........)"));
}

TEST(ze_lasso_add_fill_mask, ClosesAnOpenOutlineWithTheSelection) {
    EXPECT_EQ(add_filled(R"(
        .#......
        .#5###..
        .#...#..
        .#...#..
        .#5###..
        .#......)"),
              Picture(R"(
        .#......
        .#####..
        .#####..
        .#####..
        .#####..
        .#......)"));
}

TEST(ze_lasso_add_fill_mask, MakesOrdinarySelectionOfAnOpenOutline) {
    EXPECT_EQ(add_filled(R"(
        ........
        .###55..
        .#...#..
        .5......
        ........)"),
              Picture(R"(
        ........
        .#####..
        .#...#..
        .#......
        ........)"));
}

TEST(ze_lasso_add_fill_mask, FillsEverySelectedRegionInTheBox) {
    EXPECT_EQ(add_filled(R"(
        ...........
        .###...555.
        .#.#...5.5.
        .###...555.
        ...........)"),
              Picture(R"(
        ...........
        .###...###.
        .###...###.
        .###...###.
        ...........)"));
}

TEST(ze_lasso_add_fill_mask, SelectsWhateverItEncloses) {
    EXPECT_EQ(add_filled(R"(
        .......
        .5#5#5.
        .#347#.
        .589.#.
        .#####.
        .......)"),
              Picture(R"(
        .......
        .#####.
        .#####.
        .#####.
        .#####.
        .......)"));
}

TEST(ze_lasso_add_fill_mask, TakesOtherValuesForBackgroundAndLeavesThem) {
    EXPECT_EQ(add_filled("#.3.4.6.9"), Picture("#.3.4.6.9"));
    EXPECT_EQ(add_filled(R"(
        3333
        3553
        4444)"),
              Picture(R"(
        3333
        3##3
        4444)"));
}

TEST(ze_lasso_add_fill_mask, LeavesNoTwoAndNoFive) {
    EXPECT_EQ(add_filled("5.2.#"), Picture("#.#.#"));
    EXPECT_EQ(add_filled("2"), Picture("#"));
}

// ---- removing

TEST(ze_lasso_del_fill_mask, ClearsAClosedOutlineWithItsInterior) {
    Picture mask(8, 7, 1);
    remove_outline(&mask, 2, 5, 2, 5);
    ASSERT_EQ(mask, Picture(R"(
        ########
        ########
        ##3443##
        ##4##4##
        ##4##4##
        ##3443##
        ########)"));

    EXPECT_EQ(run_in(ze_lasso_del_fill_mask, &mask, {0, 7, 0, 6}), 1);

    EXPECT_EQ(mask, Picture(R"(
        ########
        ########
        ##....##
        ##....##
        ##....##
        ##....##
        ########)"));
}

TEST(ze_lasso_del_fill_mask, ClearsAnOutlineThatLeavesTheSelection) {
    EXPECT_EQ(del_filled(R"(
        ####....
        ##443333
        ##4#...3
        ##4#...3
        ##443333
        ####....)"),
              Picture(R"(
        ####....
        ##......
        ##......
        ##......
        ##......
        ####....)"));
}

TEST(ze_lasso_del_fill_mask, ClearsJustThePixelsOfAnOpenOutline) {
    Picture mask(R"(
        .......
        .#####.
        .#####.
        .#####.
        .......)");
    ER_selection engine;
    ze_rect rect = {0, 0, 0, 0};
    engine.Lasso_Del(mask.data(), 7, 5, 3, 0, 3, 4, &rect);

    EXPECT_EQ(run_in(ze_lasso_del_fill_mask, &mask, {0, 6, 0, 4}), 1);

    EXPECT_EQ(mask, Picture(R"(
        .......
        .##.##.
        .##.##.
        .##.##.
        .......)"));
}

TEST(ze_lasso_del_fill_mask, IsNotClosedByTheSelection) {
    EXPECT_EQ(del_filled(R"(
        .#......
        .#444#..
        .#.##4..
        .#.##4..
        .#444...
        .#......)"),
              Picture(R"(
        .#......
        .#...#..
        .#.##...
        .#.##...
        .#......
        .#......)"));
}

TEST(ze_lasso_del_fill_mask, FillsNoHolesOfTheSelection) {
    const char* const drawing = R"(
        .###.
        .#.#.
        .###.)";
    EXPECT_EQ(del_filled(drawing), Picture(drawing));
}

TEST(ze_lasso_del_fill_mask, ClearsWhateverItEncloses) {
    EXPECT_EQ(del_filled(R"(
        #######
        #34343#
        #4#574#
        #3.893#
        #44444#
        #######)"),
              Picture(R"(
        #######
        #.....#
        #.....#
        #.....#
        #.....#
        #######)"));
}

TEST(ze_lasso_del_fill_mask, TakesOtherValuesForBackgroundAndLeavesThem) {
    EXPECT_EQ(del_filled(R"(
        #5567
        #5347
        #5889)"),
              Picture(R"(
        #5567
        #5..7
        #5889)"));
}

TEST(ze_lasso_del_fill_mask, LeavesNoTwoThreeOrFour) {
    EXPECT_EQ(del_filled("2#3#4#5"), Picture(".#.#.#5"));
}

// ---- box and memory

TEST(lasso_fills, LookInsideTheBoxOnly) {
    const char* const added = R"(
        5555..
        5..5.5
        5..5..
        5555..)";
    Picture mask(added);
    EXPECT_EQ(run_in(ze_lasso_add_fill_mask, &mask, {0, 2, 0, 2}), 1);
    // The box cuts the outline open: nothing is enclosed.
    EXPECT_EQ(mask, Picture(R"(
        ###5..
        #..5.5
        #..5..
        5555..)"));

    Picture removed(R"(
        4444##
        4##4#4
        4##4##
        4444##)");
    EXPECT_EQ(run_in(ze_lasso_del_fill_mask, &removed, {0, 3, 0, 3}), 1);
    EXPECT_EQ(removed, Picture(R"(
        ....##
        ....#4
        ....##
        ....##)"));
}

TEST(lasso_fills, ClipTheBoxToTheImage) {
    Picture mask("555 5.5 555");
    EXPECT_EQ(run_in(ze_lasso_add_fill_mask, &mask, {-5, 100, -7, 200}), 1);
    EXPECT_EQ(mask, Picture(3, 3, 1));
    mask = Picture("444 4#4 444");
    EXPECT_EQ(run_in(ze_lasso_del_fill_mask, &mask, {-5, 100, -7, 200}), 1);
    EXPECT_EQ(mask, Picture(3, 3, 0));
}

TEST(lasso_fills, DoNothingInAnEmptyBox) {
    const Picture outlines("#2345 543#2");
    const ze_rect boxes[] = {{0, 4, 1, 0}, {0, 4, 2, 9}, {0, 4, -9, -1},
                             {4, 0, 0, 1}, {5, 9, 0, 1}, {-9, -1, 0, 1}};
    for (const ze_rect& box : boxes) {
        Picture mask = outlines;
        EXPECT_EQ(run_in(ze_lasso_add_fill_mask, &mask, box), 1) << box;
        EXPECT_EQ(run_in(ze_lasso_del_fill_mask, &mask, box), 1) << box;
        EXPECT_EQ(mask, outlines) << box;
    }
}

TEST(lasso_fills, ReportTheWorkBufferThatTheyCannotHave) {
    const Picture outlines("#2345 543#2");
    for (fill* const pass : {ze_lasso_add_fill_mask, ze_lasso_del_fill_mask}) {
        Picture mask = outlines;
        const failing_allocations out_of_memory(1);
        EXPECT_EQ(run_in(pass, &mask, {0, 4, 0, 1}), 0);
        EXPECT_EQ(mask, outlines);
        EXPECT_EQ(out_of_memory.asked(), 1);
    }
}

// Their work buffer would have (width + 2) * (height + 2) bytes, here 3 * -1, -3 * 6 and 6 * -3.
TEST(lasso_fills, HaveNoWorkBufferForSizesOfUnlikeSign) {
    for (fill* const pass : {ze_lasso_add_fill_mask, ze_lasso_del_fill_mask}) {
        unsigned char pixel = 5;
        EXPECT_EQ(pass(&pixel, 1, -3, 0, 0, 0, 0), 0);
        EXPECT_EQ(pass(&pixel, -5, 4, 0, 0, 0, 0), 0);
        EXPECT_EQ(pass(&pixel, 4, -5, 0, 0, 0, 0), 0);
        EXPECT_EQ(pixel, 5);
    }
}

TEST(lasso_fills, TakeOneWorkBufferOfTheSizeOfTheBox) {
    for (fill* const pass : {ze_lasso_add_fill_mask, ze_lasso_del_fill_mask}) {
        Picture mask(1000, 1000, 0);
        const failing_allocations counted(0);
        run_in(pass, &mask, {450, 549, 450, 549});
        EXPECT_EQ(counted.asked(), 1);
        EXPECT_EQ(counted.freed(), 1);
        EXPECT_LE(counted.bytes(), 100u * 100) << "a byte for each pixel of the box";
    }
}

// ---- where fills reach further

TEST(lasso_fills, ReachOnToTheUnionOfAllContoursWhereATraceEndedEarly) {
    // The trace from (0, 2) goes up and round the top and ends when it comes back, without a look
    // to the right of (0, 2). The pixels below then widen the union over that row, which is filled
    // to its end; the next row begins outside again.
    EXPECT_EQ(add_filled(R"(
        .5.
        5.5
        5..
        ..5
        .5.)"),
              Picture(R"(
        .#.
        #.#
        ###
        ..#
        .#.)"));
    EXPECT_EQ(del_filled(R"(
        .4.
        4#4
        4##
        ##4
        #4.)"),
              Picture(R"(
        ...
        .#.
        ...
        ##.
        #..)"));
}

TEST(lasso_fills, LeaveTheStartOfATraceOutOfTheUnion) {
    EXPECT_EQ(add_filled(R"(
        .55
        5.5
        5..)"),
              Picture(R"(
        .##
        #.#
        #..)"));
}

TEST(lasso_fills, KeepTheMarkersOfEarlierRegions) {
    // The last pixel's markers include one that counts as left of (0, 1); the one right of (0, 1)
    // dates from the first trace.
    EXPECT_EQ(add_filled(R"(
        55..
        5..5)"),
              Picture(R"(
        ##..
        #..#)"));
    EXPECT_EQ(del_filled(R"(
        44#.
        4#.3)"),
              Picture(R"(
        ..#.
        .#..)"));
}
