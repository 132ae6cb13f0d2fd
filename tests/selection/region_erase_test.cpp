#include <gtest/gtest.h>

#include "selection/region_shaping.h"
#include "tests/helpers/failing_allocations.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"

namespace {

// What a call leaves behind.
struct erased {
    Picture mask;
    ze_rect boundary;
    ze_rect rect;
};

erased erase_in(const char* drawing, ze_rect box) {
    Picture mask(drawing);
    ze_rect rect = {mask.width, 0, mask.height, 0};
    Erase_Region(mask.data(), mask.width, mask.height, &box, &rect);
    return {mask, box, rect};
}

erased erase(const char* drawing) {
    const Picture mask(drawing);
    return erase_in(drawing, {0, mask.width - 1, 0, mask.height - 1});
}

void expect_erased(const erased& result, const char* mask, const ze_rect& boundary,
                   const ze_rect& rect) {
    EXPECT_EQ(result.mask, Picture(mask));
    EXPECT_EQ(result.boundary, boundary);
    EXPECT_EQ(result.rect, rect);
}

}  // namespace

// ---- which region survives

TEST(Erase_Region, ErasesNothingOfASingleRegion) {
    const char* const drawing = R"(
        ........
        ..###...
        .#####..
        ..###...)";
    expect_erased(erase(drawing), drawing, {1, 5, 1, 3}, {8, 0, 4, 0});
}

TEST(Erase_Region, EmptiesTheBoundaryWhenNothingIsSelected) {
    expect_erased(erase("... ..."), "... ...", {3, 0, 2, 0}, {3, 0, 2, 0});
}

TEST(Erase_Region, KeepsALargerRegionThatIsFoundLater) {
    expect_erased(erase(R"(
        ...........
        .###..####.
        .###..####.
        .###..####.
        ...........)"),
                  R"(
        ...........
        ......####.
        ......####.
        ......####.
        ...........)",
                  {6, 9, 1, 3}, {1, 3, 1, 3});
}

TEST(Erase_Region, KeepsALargerRegionThatIsFoundFirst) {
    expect_erased(erase(R"(
        ...........
        .####..###.
        .####..###.
        .####..###.
        ...........)"),
                  R"(
        ...........
        .####......
        .####......
        .####......
        ...........)",
                  {1, 4, 1, 3}, {7, 9, 1, 3});
}

TEST(Erase_Region, ErasesARegionInTheNotchOfTheSurvivor) {
    // In row 1 the survivor's inside ends at column 2, though its contour box goes on.
    expect_erased(erase(R"(
        ###....
        ###..#.
        ###....
        ###....
        #######)"),
                  R"(
        ###....
        ###....
        ###....
        ###....
        #######)",
                  {0, 6, 0, 4}, {5, 5, 1, 1});
}

TEST(Erase_Region, LeavesARowThatHoldsOnlyAStartOutOfTheUnionInATallMaskToo) {
    // With the first pixel's row in the box of the contours, it would count the one in column 0.
    expect_erased(erase(R"(
        .....
        .....
        .....
        .....
        .....
        .....
        ...#.
        #.###
        ..###
        ####.)"),
                  R"(
        .....
        .....
        .....
        .....
        .....
        .....
        ...#.
        ..###
        ..###
        ####.)",
                  {0, 4, 6, 9}, {0, 0, 7, 7});
}

TEST(Erase_Region, KeepsTheLaterOfTwoEquals) {
    expect_erased(erase(R"(
        .....###
        .....###
        ###..###
        ###.....
        ###.....)"),
                  R"(
        ........
        ........
        ###.....
        ###.....
        ###.....)",
                  {0, 2, 2, 4}, {5, 7, 0, 2});
}

TEST(Erase_Region, KeepsTheLastOfThinRegionsHoweverSmall) {
    expect_erased(erase(R"(
        .......
        .#####.
        .......
        .#.....
        ....#..)"),
                  R"(
        .......
        .......
        .......
        .......
        ....#..)",
                  {4, 4, 4, 4}, {1, 5, 1, 3});
}

TEST(Erase_Region, MeasuresTheInteriorAndNotTheArea) {
    expect_erased(erase(R"(
        .....########
        .###.########
        .###.........
        .###.........)"),
                  R"(
        .............
        .###.........
        .###.........
        .###.........)",
                  {1, 3, 1, 3}, {5, 12, 0, 1});
}

TEST(Erase_Region, KeepsIslandsInsideTheSurvivorAndItsHoles) {
    expect_erased(erase(R"(
        ..........
        .#####..#.
        .#...#..#.
        .#.#.#....
        .#...#....
        .#####....)"),
                  R"(
        ..........
        .#####....
        .#...#....
        .#.#.#....
        .#...#....
        .#####....)",
                  {1, 5, 1, 5}, {8, 8, 1, 2});
}

// ---- box and rects

TEST(Erase_Region, LooksInsideTheBoxOnly) {
    // Inside: one region, the left part of the block.
    const char* const drawing = R"(
        #.......
        ..####..
        ..####.#
        ..####..)";
    expect_erased(erase_in(drawing, {1, 3, 1, 2}), drawing, {2, 3, 1, 2}, {8, 0, 4, 0});
    // Two regions, of which the box cuts off a row and a column.
    expect_erased(erase_in(R"(
        ###..####
        ###..####
        ###..####
        ###..####)",
                           {1, 8, 0, 2}),
                  R"(
        #....####
        #....####
        #....####
        ###..####)",
                  {5, 8, 0, 2}, {1, 2, 0, 2});
}

TEST(Erase_Region, ClipsTheBoxToTheImage) {
    expect_erased(erase_in(R"(
        ###.####
        ###.####
        ###.####)",
                           {-5, 100, -7, 200}),
                  R"(
        ....####
        ....####
        ....####)",
                  {4, 7, 0, 2}, {0, 2, 0, 2});
}

TEST(Erase_Region, EmptiesTheBoundaryOfABoxBesideTheImage) {
    const char* const drawing = "#.# #.#";
    const ze_rect boxes[] = {{0, 2, -9, -1}, {0, 2, 2, 9}, {-9, -1, 0, 1}, {3, 9, 0, 1},
                             {2, 0, 1, 0},   {2, 0, 0, 1}, {0, 2, 1, 0}};
    for (const ze_rect& box : boxes) {
        SCOPED_TRACE(box);
        expect_erased(erase_in(drawing, box), drawing, {3, 0, 2, 0}, {3, 0, 2, 0});
    }
}

TEST(Erase_Region, WidensTheRectItIsGiven) {
    Picture mask("#....###");
    ze_rect box = {0, 7, 0, 0};
    ze_rect rect = {3, 4, 2, 2};
    Erase_Region(mask.data(), 8, 1, &box, &rect);
    EXPECT_EQ(mask, Picture(".....###"));
    EXPECT_EQ(rect, (ze_rect{0, 4, 0, 2}));
}

TEST(Erase_Region, EmptiesTheBoundaryAndNothingElseWithoutMemory) {
    const failing_allocations out_of_memory(1);
    const char* const drawing = "#.# #.#";
    expect_erased(erase(drawing), drawing, {3, 0, 2, 0}, {3, 0, 2, 0});
}

TEST(Erase_Region, TakesOneWorkBuffer) {
    const failing_allocations counted(0);
    erase("###.#### ###.#### ###.####");
    EXPECT_EQ(counted.asked(), 1);
}

TEST(Erase_Region, EmptiesTheBoundaryOfAnImageWithoutPixels) {
    for (const int size : {0, -1, -2, -3}) {
        ze_rect box = {0, 5, 0, 5};
        ze_rect rect = {7, 0, 7, 0};
        Erase_Region(nullptr, size, size, &box, &rect);
        EXPECT_EQ(box, (ze_rect{size, 0, size, 0}));
        EXPECT_EQ(rect, (ze_rect{7, 0, 7, 0}));
    }
}

// ---- mask values

TEST(Erase_Region, TakesOtherValuesForBackgroundAndLeavesThem) {
    // Both rings count 0: what they hold is no 1.
    expect_erased(erase(R"(
        ###3####
        #4#3#55#
        ###3####)"),
                  R"(
        ...3####
        .4.3#55#
        ...3####)",
                  {4, 7, 0, 2}, {0, 2, 0, 2});
}

TEST(Erase_Region, LeavesNoTwoInTheBox) {
    // A 2 starts no region.
    expect_erased(erase(".2.2."), ".#.#.", {1, 3, 0, 0}, {5, 0, 1, 0});
    expect_erased(erase("2.#.#"), "....#", {4, 4, 0, 0}, {0, 2, 0, 0});
}

// ---- how interiors are counted and restored

TEST(Erase_Region, CountsWhatLiesRightOfAThinContour) {
    // Each row of the thin region's left stroke sets inside, and nothing to its right is looked at
    // before the block, which thereby belongs to it: one region.
    const char* const drawing = R"(
        .........
        .#.......
        .#.###...
        .#.###...
        .#.###...
        .#.......
        .#######.
        .........)";
    expect_erased(erase(drawing), drawing, {1, 7, 1, 6}, {9, 0, 8, 0});
}

TEST(Erase_Region, CarriesTheCountOverToTheNextRow) {
    // Here the stroke is on the right: it sets inside for the beginning of the row below.
    const char* const drawing = R"(
        .........
        .......#.
        .......#.
        ..###..#.
        ..###..#.
        ..###..#.
        .......#.
        .#######.
        .........)";
    expect_erased(erase(drawing), drawing, {1, 7, 1, 7}, {9, 0, 9, 0});
}

TEST(Erase_Region, CountsOverTheUnionOfAllContoursSoFar) {
    // The two pixels in column 2 count the one at (5, 2), which lies inside the contour box of the
    // pair above, so that they outdo the last pixel. It is not restored with them.
    expect_erased(erase(R"(
        ....##
        ......
        ..#..#
        #.#...)"),
                  R"(
        ......
        ......
        ..#...
        ..#...)",
                  {2, 2, 2, 3}, {0, 5, 0, 3});
}

TEST(Erase_Region, LeavesTheStartOfATraceOutOfTheUnion) {
    // With (2, 0) in the box of the contours, it would count (2, 2).
    expect_erased(erase(R"(
        #.#
        #..
        #.#)"),
                  R"(
        ...
        ...
        ..#)",
                  {2, 2, 2, 2}, {0, 2, 0, 2});
}

TEST(Erase_Region, LosesWhatHangsOnTheStartByOnePixel) {
    // The trace from the top pixel goes round the right block and ends when it looks at the top
    // pixel again; the left block counts as a smaller region.
    expect_erased(erase(R"(
        ...........
        .....#.....
        ..###.####.
        ..###.####.
        ..###.####.
        ...........)"),
                  R"(
        ...........
        .....#.....
        ......####.
        ......####.
        ......####.
        ...........)",
                  {5, 9, 1, 4}, {2, 4, 2, 4});
}

TEST(Erase_Region, RestoresNothingBesideAThinSurvivor) {
    // Unlike the count, restoring ends at a marker on the right.
    expect_erased(erase(R"(
        ##.#
        #..#)"),
                  R"(
        ...#
        ...#)",
                  {3, 3, 0, 1}, {0, 1, 0, 1});
}

TEST(Erase_Region, RestoresFromRowToRowWhereNoMarkerEndsIt) {
    // The survivor's trace starts at (0, 2) and ends when it comes back to it from above, without a
    // look to the right. So (4, 2), then (0, 3) and (4, 3) are restored.
    expect_erased(erase(R"(
        .##..
        #...#
        #...#
        #...#)"),
                  R"(
        .##..
        #....
        #...#
        #...#)",
                  {0, 4, 0, 3}, {4, 4, 1, 1});
}

TEST(Erase_Region, RestoresByTheMarkersOfTheSurvivorsTraceOnly) {
    // The survivor's trace starts at (2, 2), goes by (1, 2) to (2, 3) and ends without a marker:
    // (1, 3) is lost, although an earlier trace left a marker beside (1, 2).
    expect_erased(erase(R"(
        .##
        #..
        .##
        .##)"),
                  R"(
        ...
        ...
        .##
        ..#)",
                  {1, 2, 2, 3}, {0, 2, 0, 3});
}

TEST(Erase_Region, TakesAMarkerBeyondTheLastColumnForOneInTheFirst) {
    // The marker right of (5, 0) is also that of (0, 1): (1, 1) does not end the count of (3, 1),
    // with which the right region outdoes the left.
    expect_erased(erase(R"(
        ##..##
        ##.#.#)"),
                  R"(
        ....##
        .....#)",
                  {4, 5, 0, 1}, {0, 3, 0, 1});
}
