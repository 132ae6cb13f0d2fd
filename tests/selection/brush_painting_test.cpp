#include <gtest/gtest.h>

#include <climits>

#include "selection/ER_selection.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"

namespace {

struct brush : ER_selection {
    brush(int r, int c) { initial(r, c); }
};

constexpr ze_rect EMPTY = {9, 0, 9, 0};  // for masks of 9 * 9

}  // namespace

TEST(Brush_Add, PaintsTheDiscWithoutItsLastRowAndColumn) {
    brush b(3, 1);
    Picture mask(9, 9, 0);
    ze_rect changed = EMPTY;

    b.Brush_Add(mask.data(), 9, 9, 4, 4, &changed);

    EXPECT_EQ(mask, Picture(R"(
        .........
        ...###...
        ..#####..
        .######..
        .######..
        .######..
        ..#####..
        .........
        .........)"));
    EXPECT_EQ(changed, (ze_rect{1, 6, 1, 6}));
}

TEST(Brush_Del, ErasesTheDiscWithoutItsLastRowAndColumn) {
    brush b(3, 1);
    Picture mask(9, 9, 1);
    ze_rect changed = EMPTY;

    b.Brush_Del(mask.data(), 9, 9, 4, 4, &changed);

    EXPECT_EQ(mask, Picture(R"(
        #########
        ###...###
        ##.....##
        #......##
        #......##
        #......##
        ##.....##
        #########
        #########)"));
    EXPECT_EQ(changed, (ze_rect{1, 6, 1, 6}));
}

TEST(Brush_Del, ErasesWhereThePointIsInAMaskOfAnySize) {
    brush b(1, 0);
    Picture mask(5, 3, 1);
    ze_rect changed = {5, 0, 3, 0};

    b.Brush_Del(mask.data(), 5, 3, 3, 1, &changed);

    EXPECT_EQ(mask, Picture(R"(
        ##..#
        ##..#
        #####)"));
    EXPECT_EQ(changed, (ze_rect{2, 3, 0, 1}));
}

TEST(Brush_Add, ReachesOnePixelLessToTheRightAndDownwards) {
    brush b(10, 1);
    Picture mask(31, 31, 0);
    ze_rect changed = {31, 0, 31, 0};

    b.Brush_Add(mask.data(), 31, 31, 15, 15, &changed);

    EXPECT_EQ(mask.at(5, 15), 1);
    EXPECT_EQ(mask.at(24, 15), 1);
    EXPECT_EQ(mask.at(25, 15), 0);
    EXPECT_EQ(mask.at(15, 5), 1);
    EXPECT_EQ(mask.at(15, 24), 1);
    EXPECT_EQ(mask.at(15, 25), 0);
    EXPECT_EQ(changed, (ze_rect{5, 24, 5, 24}));
}

TEST(Brush_Add, PaintsCoreCellsBeyondTheRimToo) {
    brush b(2, 3);
    Picture mask(7, 7, 0);
    ze_rect changed = {7, 0, 7, 0};

    b.Brush_Add(mask.data(), 7, 7, 3, 3, &changed);

    EXPECT_EQ(mask, Picture(R"(
        .......
        .####..
        .####..
        .####..
        .####..
        .......
        .......)"));
    EXPECT_EQ(changed, (ze_rect{1, 4, 1, 4}));
}

TEST(Brush_Add, ChangesNothingOverTheSelection) {
    brush b(3, 1);
    Picture mask(9, 9, 1);
    ze_rect changed = EMPTY;
    b.Brush_Add(mask.data(), 9, 9, 4, 4, &changed);
    EXPECT_EQ(mask, Picture(9, 9, 1));
    EXPECT_EQ(changed, EMPTY);
}

TEST(Brush_Del, ChangesNothingOffTheSelection) {
    brush b(3, 1);
    Picture mask(9, 9, 0);
    ze_rect changed = EMPTY;
    b.Brush_Del(mask.data(), 9, 9, 4, 4, &changed);
    EXPECT_EQ(mask, Picture(9, 9, 0));
    EXPECT_EQ(changed, EMPTY);
}

TEST(Brush_Add, ReportsThePixelsThatItChangesOnly) {
    brush b(1, 0);  // paints (x - 1 .. x, y - 1 .. y)
    Picture mask(R"(
        .....
        .##..
        .#...
        .....)");
    ze_rect changed = {5, 0, 4, 0};

    b.Brush_Add(mask.data(), 5, 4, 2, 2, &changed);

    EXPECT_EQ(mask, Picture(R"(
        .....
        .##..
        .##..
        .....)"));
    EXPECT_EQ(changed, (ze_rect{2, 2, 2, 2}));
}

TEST(Brush_Add, WidensTheRectItIsGiven) {
    brush b(1, 0);
    Picture mask(9, 9, 0);
    ze_rect changed = {7, 8, 0, 1};
    b.Brush_Add(mask.data(), 9, 9, 4, 4, &changed);
    EXPECT_EQ(changed, (ze_rect{3, 8, 0, 4}));
    b.Brush_Del(mask.data(), 9, 9, 3, 4, &changed);
    EXPECT_EQ(changed, (ze_rect{3, 8, 0, 4}));
}

TEST(Brush_Add, LeavesValuesOtherThanZeroAndOneAlone) {
    const Picture odd(R"(
        .2.3.
        #4#5#
        .6.7.
        #8#9#
        .#.#.)");
    brush b(2, 3);  // the whole square but its last row and column

    Picture mask = odd;
    ze_rect changed = {5, 0, 5, 0};
    b.Brush_Add(mask.data(), 5, 5, 2, 2, &changed);
    EXPECT_EQ(mask, Picture(R"(
        #2#3.
        #4#5#
        #6#7.
        #8#9#
        .#.#.)"));
    EXPECT_EQ(changed, (ze_rect{0, 2, 0, 2}));

    mask = odd;
    changed = {5, 0, 5, 0};
    b.Brush_Del(mask.data(), 5, 5, 2, 2, &changed);
    EXPECT_EQ(mask, Picture(R"(
        .2.3.
        .4.5#
        .6.7.
        .8.9#
        .#.#.)"));
    EXPECT_EQ(changed, (ze_rect{0, 2, 1, 3}));
}

TEST(Brush_Add, PaintsWhatFallsInsideFromAPointOutside) {
    brush b(3, 1);
    Picture mask(5, 4, 0);
    ze_rect changed = {5, 0, 4, 0};

    b.Brush_Add(mask.data(), 5, 4, -1, 1, &changed);  // reaches column 1

    EXPECT_EQ(mask, Picture(R"(
        ##...
        ##...
        ##...
        ##...)"));
    EXPECT_EQ(changed, (ze_rect{0, 1, 0, 3}));

    changed = {5, 0, 4, 0};
    b.Brush_Del(mask.data(), 5, 4, 1, -3, &changed);  // reaches row -1 only
    EXPECT_EQ(changed, (ze_rect{5, 0, 4, 0}));

    mask = Picture(5, 4, 0);
    b.Brush_Add(mask.data(), 5, 4, 7, 6, &changed);  // the rim's upper left: (5, 4) is its nearest
    EXPECT_EQ(mask, Picture(5, 4, 0));
    b.Brush_Add(mask.data(), 5, 4, 6, 5, &changed);
    EXPECT_EQ(mask, Picture(R"(
        .....
        .....
        .....
        ....#)"));
    EXPECT_EQ(changed, (ze_rect{4, 4, 3, 3}));
}

TEST(Brush_Add, TakesAnyPoint) {
    brush b(3, 1);
    Picture mask(9, 9, 0);
    ze_rect changed = EMPTY;
    for (const int far : {INT_MIN, INT_MIN + 2, -4, 12, INT_MAX - 2, INT_MAX}) {
        b.Brush_Add(mask.data(), 9, 9, far, 4, &changed);
        b.Brush_Add(mask.data(), 9, 9, 4, far, &changed);
    }
    EXPECT_EQ(mask, Picture(9, 9, 0));
    EXPECT_EQ(changed, EMPTY);
}

TEST(Brush_Add, PaintsNothingWithoutARadius) {
    for (const int radius : {0, -1, -7, INT_MIN}) {
        brush b(radius, 1);
        Picture mask(9, 9, 0);
        ze_rect changed = EMPTY;
        b.Brush_Add(mask.data(), 9, 9, 4, 4, &changed);
        EXPECT_EQ(mask, Picture(9, 9, 0)) << radius;
        mask = Picture(9, 9, 1);
        b.Brush_Del(mask.data(), 9, 9, 4, 4, &changed);
        EXPECT_EQ(mask, Picture(9, 9, 1)) << radius;
        EXPECT_EQ(changed, EMPTY) << radius;
    }
}

TEST(Brush_Add, PaintsNothingIntoAnImageWithoutPixels) {
    brush b(3, 1);
    ze_rect changed = EMPTY;
    b.Brush_Add(nullptr, 0, 9, 0, 4, &changed);
    b.Brush_Add(nullptr, 9, 0, 4, 0, &changed);
    b.Brush_Del(nullptr, -9, -9, -4, -4, &changed);
    EXPECT_EQ(changed, EMPTY);
}

TEST(Brush_Add, DoesNothingOnAnEngineWithoutBuffers) {
    ER_selection engine;
    engine.radius = 3;
    Picture mask(9, 9, 0);
    ze_rect changed = EMPTY;
    engine.Brush_Add(mask.data(), 9, 9, 4, 4, &changed);
    EXPECT_EQ(mask, Picture(9, 9, 0));
    mask = Picture(9, 9, 1);
    engine.Brush_Del(mask.data(), 9, 9, 4, 4, &changed);
    EXPECT_EQ(mask, Picture(9, 9, 1));
    EXPECT_EQ(changed, EMPTY);
}
