#include <gtest/gtest.h>

#include <climits>

#include "selection/region_shaping.h"
#include "tests/helpers/failing_allocations.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"

namespace {

// Fills `mask` inside `box` and returns what the empty rectangle of the image has become.
ze_rect fill(Picture* mask, const ze_rect& box) {
    ze_rect changed = {mask->width, 0, mask->height, 0};
    Fill_Region(mask->data(), mask->width, mask->height, box.left, box.right, box.top, box.bottom,
                &changed);
    return changed;
}

ze_rect fill(Picture* mask) { return fill(mask, {0, mask->width - 1, 0, mask->height - 1}); }

ze_rect nothing(const Picture& mask) { return {mask.width, 0, mask.height, 0}; }

void expect_unchanged(const Picture& drawing) {
    Picture mask = drawing;
    EXPECT_EQ(fill(&mask), nothing(mask));
    EXPECT_EQ(mask, drawing);
}

}  // namespace

TEST(Fill_Region, FillsARingAndReportsOnlyTheHole) {
    Picture mask(R"(
        .......
        .#####.
        .#...#.
        .#####.)");
    ze_rect changed = {7, 0, 4, 0};  // empty

    Fill_Region(mask.data(), 7, 4, 0, 6, 0, 3, &changed);

    EXPECT_EQ(mask, Picture(R"(
        .......
        .#####.
        .#####.
        .#####.)"));
    EXPECT_EQ(changed, (ze_rect{2, 4, 2, 2}));
}

TEST(Fill_Region, FillsARingBelowTheSquareAtTheTop) {
    Picture mask("... ... ... ### #.# ###");
    EXPECT_EQ(fill(&mask), (ze_rect{1, 1, 4, 4}));
    EXPECT_EQ(mask, Picture("... ... ... ### ### ###"));
}

TEST(Fill_Region, OnlyWidensTheRectangle) {
    Picture mask(R"(
        .....
        .###.
        .#.#.
        .###.)");
    ze_rect changed = {3, 4, 0, 1};
    Fill_Region(mask.data(), 5, 4, 0, 4, 0, 3, &changed);
    EXPECT_EQ(changed, (ze_rect{2, 4, 0, 2}));
}

TEST(Fill_Region, TakesInARegionThatLiesInAHole) {
    Picture mask(R"(
        #######
        #.....#
        #.##..#
        #.....#
        #######)");

    EXPECT_EQ(fill(&mask), (ze_rect{1, 5, 1, 3}));

    EXPECT_EQ(mask, Picture(7, 5, 1));
}

TEST(Fill_Region, FillsWhateverAHoleHoldsButReportsOnlyWhatWasZero) {
    Picture mask(R"(
        ######
        #3.94#
        ######)");

    EXPECT_EQ(fill(&mask), (ze_rect{2, 2, 1, 1}));

    EXPECT_EQ(mask, Picture(6, 3, 1));
}

TEST(Fill_Region, FillsSeveralRegions) {
    Picture mask(R"(
        ###..###
        #.#..#.#
        ###..###)");

    EXPECT_EQ(fill(&mask), (ze_rect{1, 6, 1, 1}));

    EXPECT_EQ(mask, Picture(R"(
        ###..###
        ###..###
        ###..###)"));
}

TEST(Fill_Region, LeavesWhatEnclosesNothing) {
    expect_unchanged(Picture("..... ..#.. ....."));
    expect_unchanged(Picture("....... .#####. ......."));
    expect_unchanged(Picture("... .#. .#. .#. ..."));
    expect_unchanged(Picture("##### #...# #...# #...#"));
    expect_unchanged(Picture(".....  ....."));
}

TEST(Fill_Region, FillsARegionAtTheEdgesOfTheImage) {
    Picture mask(R"(
        #####
        #...#
        #...#
        #####)");
    EXPECT_EQ(fill(&mask), (ze_rect{1, 3, 1, 2}));
    EXPECT_EQ(mask, Picture(5, 4, 1));
}

TEST(Fill_Region, TakesWhatLiesBeyondTheBoxForBackground) {
    // The block goes on beyond the box; inside it there is a ring around the hole.
    Picture block(R"(
        #######
        #######
        ###.###
        #######
        #######)");
    EXPECT_EQ(fill(&block, {2, 4, 1, 3}), (ze_rect{3, 3, 2, 2}));
    EXPECT_EQ(block, Picture(7, 5, 1));

    // The ring closes beyond the box only.
    const Picture ring(R"(
        #####
        #...#
        #####)");
    for (const ze_rect& box :
         {ze_rect{0, 3, 0, 2}, ze_rect{1, 4, 0, 2}, ze_rect{0, 4, 0, 1}, ze_rect{0, 4, 1, 2}}) {
        Picture mask = ring;
        EXPECT_EQ(fill(&mask, box), nothing(mask)) << box;
        EXPECT_EQ(mask, ring) << box;
    }
}

TEST(Fill_Region, ChangesNothingInAnEmptyBox) {
    const Picture drawing(R"(
        ###2
        #.#2
        ###2)");
    for (const ze_rect& box : {ze_rect{0, 3, 2, 1}, ze_rect{3, 2, 0, 2}, ze_rect{4, 0, 3, 0},
                               ze_rect{INT_MAX, INT_MIN, 0, 2}, ze_rect{0, 3, INT_MAX, INT_MIN}}) {
        Picture mask = drawing;
        EXPECT_EQ(fill(&mask, box), nothing(mask)) << box;
        EXPECT_EQ(mask, drawing) << box;
    }
}

TEST(Fill_Region, WorksOnThePartOfABoxThatLiesInsideTheImage) {
    const Picture ring(R"(
        ####
        #..#
        ####)");
    for (const ze_rect& box :
         {ze_rect{-5, 9, -5, 8}, ze_rect{INT_MIN, INT_MAX, INT_MIN, INT_MAX}, ze_rect{0, 4, 0, 2},
          ze_rect{-1, 3, 0, 2}, ze_rect{0, 3, -1, 2}, ze_rect{0, 3, 0, 3}}) {
        Picture mask = ring;
        EXPECT_EQ(fill(&mask, box), (ze_rect{1, 2, 1, 1})) << box;
        EXPECT_EQ(mask, Picture(4, 3, 1)) << box;
    }
    for (const ze_rect& box :
         {ze_rect{4, 9, 0, 2}, ze_rect{-9, -1, 0, 2}, ze_rect{0, 3, 3, 9}, ze_rect{0, 3, -9, -1}}) {
        Picture mask = ring;
        EXPECT_EQ(fill(&mask, box), nothing(mask)) << box;
        EXPECT_EQ(mask, ring) << box;
    }
}

TEST(Fill_Region, ChangesNothingInAnImageWithoutPixels) {
    for (const int width : {0, -3, INT_MIN}) {
        for (const int height : {0, -3, INT_MIN}) {
            unsigned char beyond = 1;
            ze_rect changed = {8, 0, 8, 0};
            Fill_Region(&beyond, width, height, 0, 0, 0, 0, &changed);
            EXPECT_EQ(changed, (ze_rect{8, 0, 8, 0}));
            EXPECT_EQ(beyond, 1);
        }
    }
}

TEST(Fill_Region, LeavesNoTwoInsideTheBox) {
    // A 2 belongs to a region, is the end of one it was found in, and comes out as 1.
    Picture mask(R"(
        2..2222
        ...#..2
        2..####
        .......)");
    EXPECT_EQ(fill(&mask, {1, 6, 0, 3}), (ze_rect{4, 5, 1, 1}));
    EXPECT_EQ(mask, Picture(R"(
        2..####
        ...####
        2..####
        .......)"));
}

TEST(Fill_Region, TakesOtherValuesForBackground) {
    for (const int value : {0, 3, 4, 5, 6, 33, 255}) {
        Picture drawing(R"(
            #####
            #...#
            ##.##)");
        drawing.at(2, 2) = static_cast<unsigned char>(value);
        expect_unchanged(drawing);
    }
}

TEST(Fill_Region, ChangesNothingWithoutAWorkBuffer) {
    const Picture ring("### #.# #2#");
    Picture mask = ring;
    failing_allocations out_of_memory(1);
    const ze_rect changed = fill(&mask);
    EXPECT_EQ(changed, nothing(mask));
    EXPECT_EQ(mask, ring);
}

TEST(Fill_Region, TakesOneWorkBuffer) {
    Picture mask("###.### #.#.#.# ###.###");
    failing_allocations counted(0);
    fill(&mask);
    EXPECT_EQ(counted.asked(), 1);
}

// ---- what a trace leaves out

TEST(Fill_Region, LeavesAHoleWhoseContourBeginsBesideIt) {
    // By itself the diamond is traced from its top and filled.
    Picture alone(R"(
        .......
        .......
        ..#....
        .#.#...
        ..#....)");
    EXPECT_EQ(fill(&alone), (ze_rect{2, 2, 3, 3}));

    // Hung up by its top, it is traced from its left corner only, which no contour box holds: the
    // trace of the top goes up, and is over when it has come down again.
    expect_unchanged(Picture(R"(
        ....#..
        ...#.#.
        ..#....
        .#.#...
        ..#....)"));
}

TEST(Fill_Region, DoesNotScanARowThatHoldsOnlyStarts) {
    // The lowest pixel carries a marker on its left and none on its right.
    expect_unchanged(Picture(R"(
        .##.
        #...
        #...)"));
}

TEST(Fill_Region, RunsOnToTheUnionOfAllContoursBesideAnUnmarkedPixel) {
    // In the last row the trace of the right pixel goes to the left and comes back from above: its
    // right side is never looked at. The contour box ends there ...
    expect_unchanged(Picture(R"(
        ..##......
        .#........
        ..##......)"));

    // ... unless an earlier contour reaches further.
    Picture mask(R"(
        ..##...##.
        .#........
        ..##......)");
    EXPECT_EQ(fill(&mask), (ze_rect{4, 8, 2, 2}));
    EXPECT_EQ(mask, Picture(R"(
        ..##...##.
        .#........
        ..#######.)"));
}

TEST(Fill_Region, EndsRunsAtMarkersOfEarlierRegions) {
    // The single pixel marks what counts as left of the second row (see below). The right side of
    // that row's first pixel was marked by the first region.
    expect_unchanged(Picture(R"(
        ##..
        #..#
        ....)"));
}

TEST(Fill_Region, SeesTheRightEdgeOfOneRowAtTheLeftOfTheNext) {
    // Neither side of the lowest pixel is looked at, so nothing begins there ...
    expect_unchanged(Picture(R"(
        .##..
        #....
        .##..
        .#...)"));

    // ... until a pixel in the last column marks what lies beyond the row above.
    Picture mask(R"(
        .##..
        #....
        .##.#
        .#...)");
    EXPECT_EQ(fill(&mask), (ze_rect{2, 2, 3, 3}));
    EXPECT_EQ(mask, Picture(R"(
        .##..
        #....
        .##.#
        .##..)"));
}
