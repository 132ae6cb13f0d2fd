#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <vector>

#include "selection/ER_selection.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/pixels.h"
#include "tests/helpers/rect_printing.h"

// Most tests use a brush of radius 3 with a core of 1:
//
//   ..###..      # rim, where the keep front starts on selected pixels
//   .#222#.      2 inner, where the fronts compete
//   #23332#      3 core, where the stroke's own front starts
//   #23332#
//   #23332#
//   .#222#.
//   ..###..
//
// The inner cells are four bars of three that touch one another by corners only.

namespace {

struct brush : ER_selection {
    brush(int r, int c) { initial(r, c); }
};

// A photo on which a stroke at (4, 4) has its core in another colour than all around it: fronts
// move freely within a colour, and between the two at a cost.
const Pixels BUMP(R"(
    aaaaaaaaa
    aaaaaaaaa
    aaaaaaaaa
    aaabbbaaa
    aaabbbaaa
    aaabbbaaa
    aaaaaaaaa
    aaaaaaaaa
    aaaaaaaaa)");

constexpr ze_rect EMPTY = {9, 0, 9, 0};  // for masks of 9 * 9

// A picture and what a stroke reports about it.
struct stroke_result {
    Picture mask;
    ze_rect rect;
};

stroke_result shrink_at(brush* b, Pixels photo, const Picture& drawing, int x, int y) {
    stroke_result result = {drawing, {drawing.width, 0, drawing.height, 0}};
    b->DeSelection(photo.ints(), result.mask.data(), drawing.width, drawing.height, x, y,
                   &result.rect);
    return result;
}

// A stroke with the usual brush at (4, 4) of a mask of 9 * 9.
stroke_result shrink(const Pixels& photo, const Picture& drawing) {
    brush b(3, 1);
    return shrink_at(&b, photo, drawing, 4, 4);
}
stroke_result shrink(const Pixels& photo, const char* drawing) {
    return shrink(photo, Picture(drawing));
}

void expect_result(const stroke_result& result, const Picture& mask, const ze_rect& rect) {
    EXPECT_EQ(result.mask, mask);
    EXPECT_EQ(result.rect, rect);
}

void expect_result(const stroke_result& result, const char* mask, const ze_rect& rect) {
    expect_result(result, Picture(mask), rect);
}

// The cost array of the usual brush, . where it is 0 and 7 where it holds a 7.
Picture costs(const int* values) {
    Picture picture(7, 7, 0);
    std::copy_n(values, 49, picture.cells.begin());
    return picture;
}

int recorded_nodes(const ER_selection& engine) {
    return static_cast<int>(49 - std::count(engine.node_map, engine.node_map + 49, nullptr));
}

const Picture NONE_SELECTED(9, 9, 0);
const Picture ALL_SELECTED(9, 9, 1);

// The core and the inner cells of a brush at (4, 4), and nothing of its rim.
const Picture INNER_SELECTED(R"(
    .........
    .........
    ...###...
    ..#####..
    ..#####..
    ..#####..
    ...###...
    .........
    .........)");

}  // namespace

// ---- what is deselected

TEST(DeSelection, DeselectsTheCoreAndStopsWhereTheColourChanges) {
    expect_result(shrink(BUMP, ALL_SELECTED), R"(
        #########
        #########
        #########
        ###...###
        ###...###
        ###...###
        #########
        #########
        #########)",
                  {3, 5, 3, 5});
}

TEST(DeSelection, FollowsTheColourOfTheCore) {
    // Two bars of inner cells have the core's colour; of the lower one, a cell has not.
    const Pixels photo(R"(
        aaaaaaaaa
        aaaaaaaaa
        aaaaaaaaa
        aabbbbaaa
        aabbbbaaa
        aabbbbaaa
        aaabbaaaa
        aaaaaaaaa
        aaaaaaaaa)");
    expect_result(shrink(photo, ALL_SELECTED), R"(
        #########
        #########
        #########
        ##....###
        ##....###
        ##....###
        ###..####
        #########
        #########)",
                  {2, 5, 3, 6});
}

TEST(DeSelection, DeselectsTheWholeInnerAreaWithoutASelectedRim) {
    expect_result(shrink(BUMP, INNER_SELECTED), NONE_SELECTED, {2, 6, 2, 6});
}

TEST(DeSelection, DeselectsJustTheCoreWithoutInnerCells) {
    brush b(2, 1);
    const stroke_result result = shrink_at(&b, Pixels(9, 9, 'a'), ALL_SELECTED, 4, 4);
    expect_result(result, R"(
        #########
        #########
        #########
        ###...###
        ###...###
        ###...###
        #########
        #########
        #########)",
                  {3, 5, 3, 5});
}

TEST(DeSelection, SelectsNothing) {
    // The keep front, from the rim on the left, comes to three pixels that are not selected.
    expect_result(shrink(BUMP, R"(
        .........
        .........
        .........
        .#.###...
        .#.###...
        .#.###...
        .........
        .........
        .........)"),
                  R"(
        .........
        .........
        .........
        .#.......
        .#.......
        .#.......
        .........
        .........
        .........)",
                  {2, 6, 2, 6});
}

// ---- the guard

TEST(DeSelection, StartsOnASelectedPixelOnly) {
    for (const unsigned char value : {0, 2, 3, 4, 5, 255}) {
        brush b(3, 1);
        Picture mask = ALL_SELECTED;
        mask.at(4, 4) = value;
        const stroke_result result = shrink_at(&b, BUMP, mask, 4, 4);
        EXPECT_EQ(result.mask, mask);
        EXPECT_EQ(result.rect, EMPTY);
    }
}

TEST(DeSelection, StartsOnTheImagesEdgeUnlikeGrowing) {
    const Picture mask(R"(
        ###..
        ###..
        ##...
        .....)");
    brush b(3, 1);
    expect_result(shrink_at(&b, Pixels(5, 4, 'a'), mask, 0, 0), Picture(5, 4, 0), {0, 2, 0, 2});

    Picture unselected(5, 4, 0);
    ze_rect rect = {5, 0, 4, 0};
    Pixels photo(5, 4, 'a');
    b.DoSelection(photo.ints(), unselected.data(), 5, 4, 0, 0, &rect);
    EXPECT_EQ(unselected, Picture(5, 4, 0));
}

TEST(DeSelection, DoesNothingAtAPointOutsideTheImage) {
    const int outside[][2] = {{-1, 4},      {9, 4},       {4, -1},      {4, 9},
                              {INT_MIN, 4}, {INT_MAX, 4}, {4, INT_MIN}, {4, INT_MAX}};
    for (const auto& point : outside) {
        brush b(3, 1);
        const stroke_result result = shrink_at(&b, BUMP, ALL_SELECTED, point[0], point[1]);
        EXPECT_EQ(result.mask, ALL_SELECTED) << point[0] << ' ' << point[1];
        EXPECT_EQ(result.rect, EMPTY);
    }
    brush b(3, 1);
    ze_rect rect = EMPTY;
    b.DeSelection(nullptr, nullptr, 0, 9, 0, 0, &rect);
    b.DeSelection(nullptr, nullptr, 9, -1, 0, 0, &rect);
    EXPECT_EQ(rect, EMPTY);
}

// ---- the reset

TEST(DeSelection, BeginsWithAnEmptyIndexAndAllNodes) {
    brush b(3, 1);
    b.queue->step = 2;                           // so that all seeds but the first go by the index
    node stale = {0, 0, -1, 1, &stale, &stale};  // whoever searches behind it is lost
    std::fill_n(b.queue->index, QUEUE_INDEX_ENTRIES, &stale);
    b.queue->count = 1000;
    b.nodes_used = b.brush_cells;

    expect_result(shrink_at(&b, BUMP, INNER_SELECTED, 4, 4), NONE_SELECTED, {2, 6, 2, 6});
    EXPECT_EQ(b.queue->count, 0);
    EXPECT_EQ(b.nodes_used, 9 + 12);
}

TEST(DeSelection, LeavesTheQueuesSpareFieldUnlikeGrowing) {
    brush b(3, 1);
    b.queue->spare = 77;
    shrink_at(&b, BUMP, ALL_SELECTED, 4, 4);
    EXPECT_EQ(b.queue->spare, 77);

    Pixels photo = BUMP;
    Picture mask = NONE_SELECTED;
    ze_rect rect = EMPTY;
    b.DoSelection(photo.ints(), mask.data(), 9, 9, 4, 4, &rect);
    EXPECT_EQ(b.queue->spare, 0);
}

// ---- costs and seeds

TEST(DeSelection, PricesAllButTheLastRowAndColumnOfTheBrush) {
    brush b(3, 1);
    std::fill_n(b.cost_h, 49, 7);
    std::fill_n(b.cost_v, 49, 7);
    shrink_at(&b, Pixels(9, 9, 'a'), ALL_SELECTED, 4, 4);
    const Picture priced(R"(
        77...77
        7.....7
        ......7
        ......7
        ......7
        7.....7
        7777777)");
    EXPECT_EQ(costs(b.cost_h), priced);
    EXPECT_EQ(costs(b.cost_v), priced);

    std::fill_n(b.cost_h, 49, 7);
    Pixels photo(9, 9, 'a');
    Picture mask = NONE_SELECTED;
    ze_rect rect = EMPTY;
    b.DoSelection(photo.ints(), mask.data(), 9, 9, 4, 4, &rect);
    EXPECT_EQ(costs(b.cost_h), Picture(R"(
        77...77
        7.....7
        .......
        .......
        .......
        7.....7
        77...77)"));
}

TEST(DeSelection, PricesNoCellInTheImagesFirstRowAndColumn) {
    brush b(3, 1);
    std::fill_n(b.cost_h, 49, 7);
    std::fill_n(b.cost_v, 49, 7);
    shrink_at(&b, Pixels(9, 9, 'a'), ALL_SELECTED, 2, 1);
    const Picture priced(R"(
        7777777
        7777777
        7777777
        77....7
        77....7
        77....7
        7777777)");
    EXPECT_EQ(costs(b.cost_h), priced);
    EXPECT_EQ(costs(b.cost_v), priced);
}

TEST(DeSelection, StepsAlongTheImagesEdgeAtTheCostsOfEarlierStrokes) {
    // Of the bar in the first row, the core's colour is nearer than that of the one rim pixel that
    // seeds the keep front, at (2, 0).
    const Pixels photo(R"(
        zzzbbbzzz
        zzzccczzz
        zzzccczzz
        zzzccczzz
        zzzzzzzzz)");
    const Picture mask(R"(
        ..####...
        ..#####..
        ..#####..
        ..#####..
        ...###...)");

    brush fresh(3, 1);  // its costs are 0
    expect_result(shrink_at(&fresh, photo, mask, 4, 2), R"(
        ..####...
        ..#......
        ..#......
        ..#......
        .........)",
                  {3, 6, 1, 4});

    brush used(3, 1);
    std::fill_n(used.cost_h, 49, 195075);
    expect_result(shrink_at(&used, photo, mask, 4, 2), R"(
        ..#......
        ..#......
        ..#......
        ..#......
        .........)",
                  {3, 6, 0, 4});
}

TEST(DeSelection, SeedsNothingInTheLastRowAndColumnOfTheBrush) {
    // Rim pixels on the left keep the bar beside them; those on the right and at the bottom do not.
    expect_result(shrink(BUMP, R"(
        .........
        .........
        ...###...
        .#######.
        .#######.
        .#######.
        ...###...
        ...###...
        .........)"),
                  R"(
        .........
        .........
        .........
        .##....#.
        .##....#.
        .##....#.
        .........
        ...###...
        .........)",
                  {3, 6, 2, 6});
    // The top keeps its bar too.
    expect_result(shrink(BUMP, R"(
        .........
        ...###...
        ...###...
        ..#####..
        ..#####..
        ..#####..
        ...###...
        .........
        .........)"),
                  R"(
        .........
        ...###...
        ...###...
        .........
        .........
        .........
        .........
        .........
        .........)",
                  {2, 6, 3, 6});
}

TEST(DeSelection, SeedsTheKeepFrontOnPixelsOfValueOneOnly) {
    // No other value on the rim holds the stroke's front up, and all stay.
    expect_result(shrink(BUMP, R"(
        .........
        ...759...
        ..5###6..
        .5#####7.
        .6#####8.
        .7#####9.
        ..8###9..
        ...567...
        .........)"),
                  R"(
        .........
        ...759...
        ..5...6..
        .5.....7.
        .6.....8.
        .7.....9.
        ..8...9..
        ...567...
        .........)",
                  {2, 6, 2, 6});
}

TEST(DeSelection, SeedsTheWholeCoreWhateverItHolds) {
    expect_result(shrink(BUMP, R"(
        #########
        #########
        #########
        ###.5.###
        ###9#7###
        ###.8.###
        #########
        #########
        #########)"),
                  R"(
        #########
        #########
        #########
        ###...###
        ###...###
        ###...###
        #########
        #########
        #########)",
                  {3, 5, 3, 5});
}

TEST(DeSelection, SeedsNothingWithoutARadius) {
    for (const int radius : {0, -1, -7, INT_MIN}) {
        for (const int at : {4, 0}) {
            brush b(radius, 1);
            const stroke_result result = shrink_at(&b, BUMP, ALL_SELECTED, at, at);
            EXPECT_EQ(result.mask, ALL_SELECTED) << radius;
            EXPECT_EQ(result.rect, EMPTY) << radius;
            EXPECT_EQ(b.nodes_used, 0) << radius << " at " << at;
        }
    }
}

// ---- the growth

TEST(DeSelection, WinsForeignValuesLikeUnselectedPixels) {
    // The stroke's front takes the bar on the right, the keep front comes to the one at the top.
    const Pixels photo(R"(
        aaaaaaaaa
        aaaaaaaaa
        aaaaaaaaa
        aaabbbbaa
        aaabbbbaa
        aaabbbbaa
        aaaaaaaaa
        aaaaaaaaa
        aaaaaaaaa)");
    expect_result(shrink(photo, R"(
        #########
        #########
        ####9####
        ######5##
        ######6##
        ######7##
        #########
        #########
        #########)"),
                  R"(
        #########
        #########
        ####.####
        ###....##
        ###....##
        ###....##
        #########
        #########
        #########)",
                  {3, 6, 2, 5});
}

TEST(DeSelection, ReportsUnselectedPixelsThatTheKeepFrontComesTo) {
    expect_result(shrink(BUMP, R"(
        #########
        #########
        ####.####
        ##.######
        #########
        #########
        #########
        #########
        #########)"),
                  R"(
        #########
        #########
        ####.####
        ##....###
        ###...###
        ###...###
        #########
        #########
        #########)",
                  {2, 5, 2, 5});
}

TEST(DeSelection, ReachesNoPixelThatHoldsATwoThreeOrFour) {
    // They wall the centre in.
    brush b(4, 0);
    const Picture mask(R"(
        .........
        .........
        ...###...
        ..##2##..
        ..#3#4#..
        ..##3##..
        ...###...
        .........
        .........)");
    expect_result(shrink_at(&b, Pixels(9, 9, 'a'), mask, 4, 4), R"(
        .........
        .........
        ...###...
        ..##.##..
        ..##..#..
        ..#####..
        ...###...
        .........
        .........)",
                  {4, 5, 3, 4});
}

TEST(DeSelection, LeavesACorePixelThatHoldsAThreeSelected) {
    expect_result(shrink(BUMP, R"(
        #########
        #########
        #########
        ###3#4###
        #########
        ###2##3##
        #########
        #########
        #########)"),
                  R"(
        #########
        #########
        #########
        ####..###
        ###...###
        ###...###
        #########
        #########
        #########)",
                  {3, 5, 3, 5});
}

// ---- the final pass

TEST(DeSelection, LeavesForeignValuesThatNoFrontReachesUnlikeGrowing) {
    // In corners of the square, on the rim, and beyond the brush.
    const char* const drawing = R"(
        9.......9
        .7.....8.
        .........
        ......6..
        ....#..9.
        .........
        .........
        .6.....5.
        9.......9)";
    brush b(3, 0);
    const stroke_result result = shrink_at(&b, Pixels(9, 9, 'a'), Picture(drawing), 4, 4);
    // Every inner cell is reached: the square of inner cells is reported, the 6 in it is gone.
    expect_result(result, R"(
        9.......9
        .7.....8.
        .........
        .........
        .......9.
        .........
        .........
        .6.....5.
        9.......9)",
                  {2, 6, 2, 6});

    Pixels photo(9, 9, 'a');
    Picture mask(drawing);
    ze_rect rect = EMPTY;
    b.DoSelection(photo.ints(), mask.data(), 9, 9, 4, 4, &rect);
    EXPECT_EQ(mask.at(1, 1), 0);
    EXPECT_EQ(mask.at(7, 4), 0);
    EXPECT_EQ(mask.at(0, 0), 9);
}

TEST(DeSelection, SettlesTwosThreesAndFoursOfTheWholeSquare) {
    // A 3 comes out selected and is not reported; 2 and 4 come out unselected and are: also in the
    // corners and in the last row and column, not beyond.
    expect_result(shrink(BUMP, R"(
        234234234
        33.....42
        4........
        2........
        3...#....
        4........
        2........
        33..2..34
        234234234)"),
                  R"(
        234234234
        3#......2
        4........
        2........
        3........
        4........
        2........
        3#.....#4
        234234234)",
                  {2, 7, 1, 7});
}

TEST(DeSelection, ForgetsTheNodesOfTheStroke) {
    brush b(3, 1);
    shrink_at(&b, BUMP, ALL_SELECTED, 4, 4);
    EXPECT_GT(b.nodes_used, 0);
    EXPECT_EQ(recorded_nodes(b), 0);
}

// ---- broken lists

TEST(DeSelection, IsAbandonedByABrokenListAmongTheSeeds) {
    // With what an earlier stroke left in the queue, the first seed is counted only, the second
    // ends its walk unlinked, and the third should go before `last`, which has no `prev`.
    node last = {0, 0, 5, 0, nullptr, nullptr};
    node first = {0, 0, -5, 0, nullptr, &last};
    brush b(3, 1);
    b.queue->head = &first;
    b.queue->tail = &last;

    const stroke_result result = shrink_at(&b, BUMP, ALL_SELECTED, 4, 4);

    EXPECT_EQ(result.mask, ALL_SELECTED);
    EXPECT_EQ(result.rect, EMPTY);
    EXPECT_EQ(recorded_nodes(b), 2);
    EXPECT_EQ(b.nodes_used, 2);
}

TEST(DeSelection, KeepsThePartialResultOfABrokenListWhileGrowing) {
    // The one seed is counted only and the centre's stale node is popped in its stead. Of its
    // neighbours, left and right are counted; the upper one should go before `last`, which has no
    // `prev`.
    node last = {0, 0, 1, 1, nullptr, nullptr};
    node second = {0, 0, -1, 1, nullptr, &last};
    node first = {4, 4, 0, 1, nullptr, &second};
    brush b(2, 0);
    b.queue->head = &first;
    b.queue->tail = &last;
    Picture mask = NONE_SELECTED;
    for (int y = 3; y <= 5; ++y) {
        for (int x = 3; x <= 5; ++x) mask.at(x, y) = 1;
    }

    const stroke_result result = shrink_at(&b, Pixels(9, 9, 'a'), mask, 4, 4);

    mask.at(4, 4) = 0;
    EXPECT_EQ(result.mask, mask);
    EXPECT_EQ(result.rect, (ze_rect{4, 4, 4, 4}));
    EXPECT_EQ(std::count(b.node_map, b.node_map + 25, nullptr), 25);
}

TEST(DeSelection, DoesNothingOnAnEngineWithoutBuffers) {
    ER_selection engine;
    engine.radius = 3;
    Pixels photo = BUMP;
    Picture mask = ALL_SELECTED;
    ze_rect rect = EMPTY;
    engine.DeSelection(photo.ints(), mask.data(), 9, 9, 4, 4, &rect);
    EXPECT_EQ(mask, ALL_SELECTED);
    EXPECT_EQ(rect, EMPTY);
}
