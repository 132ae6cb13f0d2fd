// DoSelection. Most tests use a brush of radius 3 with a core of radius 1, in which every inner
// cell touches both the core and the rim:
//
//     . . r r r . .      r  rim: seeds of the keep front, where the mask is 0
//     . r i i i r .      i  inner
//     r i c c c i r      c  core: seeds of the stroke's front
//     r i c c c i r
//     r i c c c i r
//     . r i i i r .
//     . . r r r . .
//
// Its 37 cells make the queue's step 1, so that every seed but the second comes out before the ones
// pushed before it: from the last row to the first.
#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <cstdint>
#include <cstdlib>
#include <vector>

#include "selection/ER_selection.h"
#include "selection/brush_cells.h"
#include "selection/competition_plain.h"
#include "tests/helpers/failing_allocations.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"
#include "tests/helpers/sparse_memory.h"

namespace {

struct engine : ER_selection {
    explicit engine(int r = 3, int c = 1) { initial(r, c); }

    // A stroke at (x, y) on a photo of grey levels (. is 0 and # is 1), on which a step between
    // levels a and b costs 3 * (a - b)^2. Returns what the empty rectangle has become.
    ze_rect grow(const Picture& levels, Picture* mask, int x, int y) {
        std::vector<int> photo;
        for (const int level : levels.cells) photo.push_back(level * 0x010101);
        ze_rect rect = {mask->width, 0, mask->height, 0};
        DoSelection(photo.data(), mask->data(), mask->width, mask->height, x, y, &rect);
        return rect;
    }

    bool node_map_is_empty() const {
        const ptrdiff_t cells = brush_side(*this) * brush_side(*this);
        return std::count(node_map, node_map + cells, nullptr) == cells;
    }
};

const Picture FLAT(7, 7, 0);

// With every step free, the bottom and the sides go to the keep front, whose seeds there come out
// first; the core comes out before the seeds of the top.
const Picture GROWN_ON_FLAT(R"(
    .......
    ..###..
    ..###..
    ..###..
    ..###..
    .......
    .......)");

// Core and inner cells of one colour, the rim of another.
const Picture DISC(R"(
    9999999
    99...99
    9.....9
    9.....9
    9.....9
    99...99
    9999999)");

const Picture GROWN_ON_DISC(R"(
    .......
    ..###..
    .#####.
    .#####.
    .#####.
    ..###..
    .......)");

// Free everywhere, but a step of 3 leads into the inner cells of the top.
const Picture STEP_AT_THE_TOP(R"(
    .......
    ..222..
    .......
    .......
    .......
    .......
    .......)");

Picture chequered(int width, int height) {
    Picture p(width, height, 0);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) p.at(x, y) = (x + y) % 2 == 0 ? 0 : 9;
    }
    return p;
}

Picture transposed(const Picture& p) {
    Picture t(p.height, p.width, 0);
    for (int y = 0; y < p.height; ++y) {
        for (int x = 0; x < p.width; ++x) t.at(y, x) = p.at(x, y);
    }
    return t;
}

}  // namespace

TEST(DoSelection, IgnoresPointsOnTheOutermostRowsAndColumnsAndBeyond) {
    const struct {
        int x, y;
    } points[] = {{0, 3}, {6, 3},  {3, 0}, {3, 6},       {0, 0},       {6, 6},       {-1, 3},
                  {7, 3}, {3, -1}, {3, 7}, {INT_MIN, 3}, {INT_MAX, 3}, {3, INT_MIN}, {3, INT_MAX}};
    for (const auto& p : points) {
        engine e;
        e.nodes_used = 17;
        Picture mask(7, 7, 9);  // a stroke would make 0 of it
        EXPECT_EQ(e.grow(FLAT, &mask, p.x, p.y), (ze_rect{7, 0, 7, 0})) << p.x << ", " << p.y;
        EXPECT_EQ(mask, Picture(7, 7, 9)) << p.x << ", " << p.y;
        EXPECT_EQ(e.nodes_used, 17);
    }
}

TEST(DoSelection, TakesPointsOneInsideTheEdges) {
    for (const int x : {1, 5}) {
        for (const int y : {1, 5}) {
            engine e(1);
            Picture mask(7, 7, 0);
            EXPECT_EQ(e.grow(FLAT, &mask, x, y), (ze_rect{x, x, y, y}));
            EXPECT_EQ(mask.at(x, y), 1);
        }
    }
}

TEST(DoSelection, IgnoresImagesWithoutAnInside) {
    for (const int size : {2, 0, -5, INT_MIN}) {
        engine e;
        Picture mask(7, 7, 9);
        std::vector<int> photo(49);
        ze_rect rect = {1, 2, 3, 4};
        e.DoSelection(photo.data(), mask.data(), size, 7, 1, 1, &rect);
        e.DoSelection(photo.data(), mask.data(), 7, size, 1, 1, &rect);
        EXPECT_EQ(mask, Picture(7, 7, 9)) << size;
        EXPECT_EQ(rect, (ze_rect{1, 2, 3, 4})) << size;
    }
}

TEST(DoSelection, SelectsExactlyTheCoreWithoutInnerCells) {
    engine two(2), one(1), zero(0);
    Picture mask(7, 7, 0);
    EXPECT_EQ(two.grow(FLAT, &mask, 3, 3), (ze_rect{2, 4, 2, 4}));
    EXPECT_EQ(mask, Picture(R"(
        .......
        .......
        ..###..
        ..###..
        ..###..
        .......
        .......)"));

    Picture dot(3, 3, 0);
    EXPECT_EQ(one.grow(Picture(3, 3, 0), &dot, 1, 1), (ze_rect{1, 1, 1, 1}));
    EXPECT_EQ(dot, Picture("... .#. ..."));

    // The one cell of radius 0 is rim.
    Picture none(3, 3, 0);
    EXPECT_EQ(zero.grow(Picture(3, 3, 0), &none, 1, 1), (ze_rect{3, 0, 3, 0}));
    EXPECT_EQ(none, Picture(3, 3, 0));
}

TEST(DoSelection, SelectsTheCoreWhateverTheColours) {
    engine e;
    Picture mask(7, 7, 0);
    e.grow(chequered(7, 7), &mask, 3, 3);
    for (int y = 2; y <= 4; ++y) {
        for (int x = 2; x <= 4; ++x) EXPECT_EQ(mask.at(x, y), 1) << x << ", " << y;
    }
}

// ---- where the fronts meet

TEST(DoSelection, FillsAnObjectUpToItsEdge) {
    engine e;
    Picture mask(7, 7, 0);
    EXPECT_EQ(e.grow(DISC, &mask, 3, 3), (ze_rect{1, 5, 1, 5}));
    EXPECT_EQ(mask, GROWN_ON_DISC);
}

TEST(DoSelection, LeavesInnerCellsToTheFrontThatComesCheaper) {
    // On the right, the rim's colour reaches in as far as the core.
    const Picture photo(R"(
        9999999
        99...99
        9....99
        9....99
        9....99
        99...99
        9999999)");
    const Picture grown(R"(
        .......
        ..###..
        .####..
        .####..
        .####..
        ..###..
        .......)");
    engine e;
    Picture mask(7, 7, 0);
    EXPECT_EQ(e.grow(photo, &mask, 3, 3), (ze_rect{1, 4, 1, 5}));
    EXPECT_EQ(mask, grown);

    Picture turned(7, 7, 0);
    EXPECT_EQ(e.grow(transposed(photo), &turned, 3, 3), (ze_rect{1, 5, 1, 4}));
    EXPECT_EQ(turned, transposed(grown));
}

TEST(DoSelection, AddsUpTheCostOfAPath) {
    // Radius 4 has two rings of inner cells. The inner ring costs 48 from the core; from the rim it
    // takes two steps of 27.
    const Picture photo(R"(
        444444444
        444777444
        447444744
        474...474
        474...474
        474...474
        447444744
        444777444
        444444444)");
    engine e(4);
    Picture mask(9, 9, 0);
    EXPECT_EQ(e.grow(photo, &mask, 4, 4), (ze_rect{2, 6, 2, 6}));
    EXPECT_EQ(mask, Picture(R"(
        .........
        .........
        ...###...
        ..#####..
        ..#####..
        ..#####..
        ...###...
        .........
        .........)"));
}

TEST(DoSelection, GoesByPopOrderWhereEveryStepIsFree) {
    engine e;
    Picture mask(7, 7, 0);
    EXPECT_EQ(e.grow(FLAT, &mask, 3, 3), (ze_rect{2, 4, 1, 4}));
    EXPECT_EQ(mask, GROWN_ON_FLAT);
}

TEST(DoSelection, LeavesATieToTheFrontThatArrivedFirst) {
    // With a wide step nodes of equal cost come out as they went in: the seeds row by row, and only
    // then what they reached. Each inner cell belongs to the first seed that touches it.
    engine e;
    e.queue->step = 100;
    Picture mask(7, 7, 0);
    EXPECT_EQ(e.grow(FLAT, &mask, 3, 3), (ze_rect{2, 5, 2, 5}));
    EXPECT_EQ(mask, Picture(R"(
        .......
        .......
        ..###..
        ..####.
        ..####.
        ..###..
        .......)"));
}

TEST(DoSelection, VisitsNeighboursLeftRightUpDown) {
    // With a core of one pixel and no rim seeds, the plain version's first five records tell.
    engine e(3, 0);
    Picture mask(7, 7, 1);
    std::vector<int> photo(49);
    ze_rect rect = {7, 0, 7, 0};
    plain::DoSelection(&e, photo.data(), mask.data(), 7, 7, 3, 3, &rect);
    const struct { int x, y; } order[] = {{3, 3}, {2, 3}, {4, 3}, {3, 2}, {3, 4}};
    for (int i = 0; i < 5; ++i) {
        EXPECT_EQ(e.node_pool[i].x, order[i].x) << i;
        EXPECT_EQ(e.node_pool[i].y, order[i].y) << i;
    }
}

TEST(DoSelection, TakesAllItCanReachWithoutRimSeeds) {
    engine e(5);
    Picture mask(R"(
        ...#####...
        ..#.....#..
        .#.......#.
        #.........#
        #.........#
        #.........#
        #.........#
        #.........#
        .#.......#.
        ..#.....#..
        ...#####...)");
    EXPECT_EQ(e.grow(chequered(11, 11), &mask, 5, 5), (ze_rect{0, 10, 0, 10}));
    EXPECT_EQ(mask, Picture(R"(
        ...#####...
        ..#######..
        .#########.
        ###########
        ###########
        ###########
        ###########
        ###########
        .#########.
        ..#######..
        ...#####...)"));
}

// ---- at the image's edges

TEST(DoSelection, ClipsTheSquareToTheImage) {
    engine small;
    Picture mask(R"(
        ....#
        ....#
        ....#
        ...#.
        ###..)");  // the part of the rim inside the image
    EXPECT_EQ(small.grow(chequered(5, 5), &mask, 1, 1), (ze_rect{0, 4, 0, 4}));
    EXPECT_EQ(mask, Picture(R"(
        #####
        #####
        #####
        ####.
        ###..)"));

    engine large(10);
    Picture whole(3, 4, 0);
    EXPECT_EQ(large.grow(chequered(3, 4), &whole, 1, 2), (ze_rect{0, 2, 0, 3}));
    EXPECT_EQ(whole, Picture(3, 4, 1));
}

TEST(DoSelection, LeavesTheNextRowAloneWhereTheSquareEndsBeyondTheRow) {
    engine e(2);
    Picture mask(R"(
        7........
        7........
        7........
        7........
        7........
        7........
        7........)");
    EXPECT_EQ(e.grow(Picture(9, 7, 0), &mask, 7, 3), (ze_rect{6, 8, 2, 4}));
    EXPECT_EQ(mask, Picture(R"(
        7........
        7........
        7.....###
        7.....###
        7.....###
        7........
        7........)"));
}

TEST(DoSelection, ReachesNoPixelBeyondTheImage) {
    const struct { int x, y; } points[] = {{1, 6}, {11, 6}, {6, 1}, {6, 11}};
    for (const auto& p : points) {
        engine e(6);
        Picture mask(13, 13, 0);
        e.grow(Picture(13, 13, 0), &mask, p.x, p.y);

        int cells_inside = 0;
        for (int y = 0; y < 13; ++y) {
            for (int x = 0; x < 13; ++x) {
                if (std::max(std::abs(x - p.x), std::abs(y - p.y)) > 6) continue;
                const ptrdiff_t cell = brush_cell(e, x - p.x, y - p.y);
                cells_inside += e.brush_map[cell] != BRUSH_OUTSIDE;
            }
        }
        EXPECT_EQ(e.nodes_used, cells_inside) << p.x << ", " << p.y;
    }
}

TEST(DoSelection, PricesBrushCellsOutsideImageRowAndColumnZero) {
    engine e(2);
    const Picture levels = chequered(5, 5);
    Picture mask(5, 5, 0);
    e.grow(levels, &mask, 1, 1);
    for (int y = 0; y <= 3; ++y) {
        for (int x = 0; x <= 3; ++x) {
            const ptrdiff_t cell = brush_cell(e, x - 1, y - 1);
            const bool priced = x > 0 && y > 0 && e.brush_map[cell] != BRUSH_OUTSIDE;
            EXPECT_EQ(e.cost_h[cell], priced ? 243 : 0) << x << ", " << y;
            EXPECT_EQ(e.cost_v[cell], priced ? 243 : 0) << x << ", " << y;
        }
    }
}

TEST(DoSelection, StepsAlongTheImagesEdgeAtTheCostsOfAnEarlierStroke) {
    // The levels in image row 0 are 9 and 1: a step from the core costs 3, one from the rim would
    // cost 192.
    const Picture photo(R"(
        99###99
        9.....9
        9.....9
        9.....9
        99...99
        9999999
        9999999)");
    // After a rebuild the keep front walks along the row for nothing.
    const Picture kept(R"(
        .......
        .#####.
        .#####.
        .#####.
        ..###..
        .......
        .......)");
    // After a stroke that left 243 in the cells of that row, it does not.
    const Picture taken(R"(
        ..###..
        .#####.
        .#####.
        .#####.
        ..###..
        .......
        .......)");

    engine by_row, by_column;
    for (int i = 0; i < 2; ++i) {
        Picture mask(7, 7, 0);
        EXPECT_EQ(by_row.grow(photo, &mask, 3, 2), (ze_rect{1, 5, 1, 4}));
        EXPECT_EQ(mask, kept);
        Picture turned(7, 7, 0);
        EXPECT_EQ(by_column.grow(transposed(photo), &turned, 2, 3), (ze_rect{1, 4, 1, 5}));
        EXPECT_EQ(turned, transposed(kept));
    }

    for (engine* e : {&by_row, &by_column}) {
        Picture elsewhere(9, 9, 1);
        e->grow(chequered(9, 9), &elsewhere, 4, 4);
    }
    Picture mask(7, 7, 0);
    EXPECT_EQ(by_row.grow(photo, &mask, 3, 2), (ze_rect{1, 5, 0, 4}));
    EXPECT_EQ(mask, taken);
    Picture turned(7, 7, 0);
    EXPECT_EQ(by_column.grow(transposed(photo), &turned, 2, 3), (ze_rect{0, 4, 1, 5}));
    EXPECT_EQ(turned, transposed(taken));

    by_row.initial(3, 1);
    Picture rebuilt(7, 7, 0);
    by_row.grow(photo, &rebuilt, 3, 2);
    EXPECT_EQ(rebuilt, kept);
}

#if UINTPTR_MAX > UINT32_MAX  // no room for it on 32-bit machines
TEST(DoSelection, ReachesTheFarCornerOfAHugePhoto) {
    const int size = 50000;
    sparse_array<int> photo(2500000000ull);
    sparse_array<unsigned char> mask(2500000000ull);
    ASSERT_TRUE(photo.data()) << NO_ROOM;
    ASSERT_TRUE(mask.data()) << NO_ROOM;
    engine e;
    ze_rect rect = {size, 0, size, 0};

    e.DoSelection(photo.data(), mask.data(), size, size, size - 4, size - 4, &rect);

    EXPECT_EQ(rect, (ze_rect{size - 5, size - 3, size - 6, size - 3}));
    for (int y = 0; y < 7; ++y) {
        for (int x = 0; x < 7; ++x) {
            EXPECT_EQ(mask[(size - 7ull + y) * size + size - 7 + x], GROWN_ON_FLAT.at(x, y))
                << x << ", " << y;
        }
    }
}
#endif

// ---- what becomes of mask and rect

TEST(DoSelection, KeepsSelectedPixelsWhicheverFrontWinsThem) {
    // (2, 5) and (5, 3) go to the keep front, (3, 1) to the stroke; nobody reaches the corner.
    Picture mask(R"(
        #......
        ...#...
        .......
        .....#.
        .......
        ..#....
        .......)");
    engine e;
    EXPECT_EQ(e.grow(FLAT, &mask, 3, 3), (ze_rect{0, 5, 0, 5}));
    EXPECT_EQ(mask, Picture(R"(
        #......
        ..###..
        ..###..
        ..####.
        ..###..
        ..#....
        .......)"));
}

TEST(DoSelection, GrowsThroughSelectedPixels) {
    Picture mask(R"(
        .......
        .......
        ..###..
        ..###..
        ..###..
        .......
        .......)");
    engine e;
    e.grow(DISC, &mask, 3, 3);
    EXPECT_EQ(mask, GROWN_ON_DISC);
}

TEST(DoSelection, SeedsTheKeepFrontOnUnselectedRimPixelsOnly) {
    // With the rim selected at the bottom, the stroke's front is the only one to get there.
    Picture mask(R"(
        .......
        .......
        .......
        .......
        .......
        .#...#.
        ..###..)");
    engine e;
    EXPECT_EQ(e.grow(FLAT, &mask, 3, 3), (ze_rect{1, 5, 1, 6}));
    EXPECT_EQ(mask.at(2, 5), 1);
    EXPECT_EQ(mask.at(3, 5), 1);
    EXPECT_EQ(mask.at(4, 5), 1);
}

TEST(DoSelection, WidensRectOverEverySelectedPixelOfTheSquareAndNoOther) {
    Picture mask(9, 9, 1);  // the square leaves a frame of one pixel
    engine e;
    EXPECT_EQ(e.grow(Picture(9, 9, 0), &mask, 4, 4), (ze_rect{1, 7, 1, 7}));
    EXPECT_EQ(mask, Picture(9, 9, 1));

    std::vector<int> photo(81);
    ze_rect rect = {5, 8, 2, 3};
    Picture fresh(9, 9, 0);
    e.DoSelection(photo.data(), fresh.data(), 9, 9, 4, 4, &rect);  // selects {3, 5, 2, 5}
    EXPECT_EQ(rect, (ze_rect{3, 8, 2, 5}));
}

TEST(DoSelection, ClearsForeignValuesInTheSquareAndIsBlockedByThem) {
    // 2 and 4 count as won, 3 and the rest as lost, in the corners too. A foreign core pixel is not
    // selected, a foreign inner one not reached.
    Picture mask(R"(
        4.....29
        ..5.....
        ........
        ...5....
        ........
        ........
        3..5..9.
        9.......)");
    const Picture photo(R"(
        99999999
        99...999
        9.....99
        9.....99
        9.....99
        99...999
        99999999
        99999999)");
    engine e;
    EXPECT_EQ(e.grow(photo, &mask, 3, 3), (ze_rect{0, 6, 0, 5}));
    EXPECT_EQ(mask, Picture(R"(
        #.....#9
        ...##...
        .#####..
        .##.##..
        .#####..
        ..###...
        ........
        9.......)"));
    EXPECT_EQ(e.nodes_used, 9 + 15 + 11);  // core, rim without the 5, inner without the 5
}

// ---- engine and queue

TEST(DoSelection, AllocatesNothingAndForgetsItsNodes) {
    engine e;
    Picture mask(7, 7, 0);
    e.queue->spare = 5;
    {
        failing_allocations counted(0);
        e.grow(DISC, &mask, 3, 3);
        EXPECT_EQ(counted.asked(), 0);
    }
    EXPECT_TRUE(e.node_map_is_empty());
    EXPECT_EQ(e.nodes_used, 37);  // every cell has been reached
    EXPECT_EQ(e.queue->head, nullptr);
    EXPECT_EQ(e.queue->count, 0);
    EXPECT_EQ(e.queue->spare, 0);
}

TEST(DoSelection, ForgetsTheNodeOfABrushOfOnePixel) {
    engine e(0, 0);
    Picture mask(3, 3, 0);
    e.grow(Picture(3, 3, 0), &mask, 1, 1);
    EXPECT_EQ(e.nodes_used, 1);  // the one cell is rim
    EXPECT_EQ(e.node_map[0], nullptr);
}

TEST(DoSelection, ForgetsCountAndIndexOfAnEarlierStroke) {
    engine e;
    node stale = {3, 3, -1, 1, nullptr, nullptr};
    stale.prev = stale.next = &stale;
    std::fill_n(e.queue->index, 100, &stale);
    e.queue->count = 50;
    e.nodes_used = 30;
    Picture mask(7, 7, 0);
    e.grow(FLAT, &mask, 3, 3);
    EXPECT_EQ(mask, GROWN_ON_FLAT);
    EXPECT_EQ(e.nodes_used, 37);
    EXPECT_EQ(e.queue->count, 0);
    EXPECT_EQ(std::count(e.queue->index, e.queue->index + 100, &stale), 0);
}

TEST(DoSelection, PassesOverNodesThatLieOutsideTheImage) {
    // A node left in the queue, one column beyond the image: by its flat index it is (0, 6). The
    // first seed is lost to it; the last row's seeds still come out first.
    engine e;
    node left_over = {7, 5, 0, 1, nullptr, nullptr};
    e.queue->head = e.queue->tail = &left_over;
    Picture mask(7, 7, 0);
    EXPECT_EQ(e.grow(FLAT, &mask, 3, 3), (ze_rect{2, 4, 1, 4}));
    EXPECT_EQ(mask, GROWN_ON_FLAT);
}

TEST(DoSelection, AbandonsTheStrokeOnABrokenListWhileSeeding) {
    // Cheaper than a seed, then dearer with no `prev`: the first seed is only counted, the second
    // walk ends after one node, the third finds the break.
    engine e;
    node cheap = {0, 0, -1, 0, nullptr, nullptr};
    node dear = {0, 0, 5, 0, nullptr, nullptr};
    cheap.next = &dear;
    e.queue->head = &cheap;
    e.queue->tail = &dear;
    const Picture before(R"(
        9......
        ..2....
        .......
        ...#...
        .......
        .......
        ......9)");
    Picture mask = before;

    EXPECT_EQ(e.grow(FLAT, &mask, 3, 3), (ze_rect{7, 0, 7, 0}));

    EXPECT_EQ(mask, before);
    EXPECT_EQ(e.nodes_used, 2);
    EXPECT_EQ(e.queue->count, 2);
    EXPECT_EQ(e.node_map[brush_cell(e, -1, -3)], &e.node_pool[0]);
    EXPECT_EQ(e.node_map[brush_cell(e, 0, -3)], &e.node_pool[1]);
    EXPECT_EQ(e.node_map[brush_cell(e, 1, -3)], nullptr);
    EXPECT_EQ(e.queue->head, &cheap);

    e.initial(3, 1);
    Picture fresh(7, 7, 0);
    e.grow(FLAT, &fresh, 3, 3);
    EXPECT_EQ(fresh, GROWN_ON_FLAT);
}

TEST(DoSelection, AbandonsTheStrokeOnABrokenListWhileSeedingTheCore) {
    // The list of the test before. Without unselected rim pixels the core has the first seeds.
    engine e;
    node cheap = {0, 0, -1, 0, nullptr, nullptr};
    node dear = {0, 0, 5, 0, nullptr, nullptr};
    cheap.next = &dear;
    e.queue->head = &cheap;
    e.queue->tail = &dear;
    Picture mask(7, 7, 1);
    mask.at(3, 3) = 0;
    const Picture before = mask;

    EXPECT_EQ(e.grow(FLAT, &mask, 3, 3), (ze_rect{7, 0, 7, 0}));

    EXPECT_EQ(mask, before);
    EXPECT_EQ(e.nodes_used, 2);
    EXPECT_EQ(e.node_map[brush_cell(e, -1, -1)], &e.node_pool[0]);
    EXPECT_EQ(e.node_map[brush_cell(e, 0, -1)], &e.node_pool[1]);
    EXPECT_EQ(e.node_map[brush_cell(e, 1, -1)], nullptr);
}

TEST(DoSelection, CommitsWhatIsWonWhenTheListBreaksWhileGrowing) {
    // The seeds go before `free`. The first step that costs something, from the core's upper right
    // pixel to the top, has to go before `dear`, which has no `prev`.
    engine e;
    node free = {-1, -1, 0, 0, nullptr, nullptr};
    node dear = {-1, -1, 50, 0, nullptr, nullptr};
    free.next = &dear;
    e.queue->head = &free;
    e.queue->tail = &dear;
    const Picture cut_short(R"(
        .......
        .......
        ....#..
        ..###..
        ..###..
        .......
        .......)");
    Picture mask(7, 7, 0);
    mask.at(0, 0) = 9;

    EXPECT_EQ(e.grow(STEP_AT_THE_TOP, &mask, 3, 3), (ze_rect{2, 4, 2, 4}));

    EXPECT_EQ(mask, cut_short);
    EXPECT_TRUE(e.node_map_is_empty());
    // Seed 8 is the next one; 25 seeds and 9 inner cells have been taken.
    EXPECT_EQ(e.queue->head, &e.node_pool[7]);
    EXPECT_EQ(e.nodes_used, 34);

    // The next stroke reuses the records of the six seeds that are still queued, which closes them
    // into a ring. Nobody notices before the same step as above, whose walk would never end: the
    // list is dropped, what is won is committed.
    Picture second(7, 7, 0);
    EXPECT_EQ(e.grow(STEP_AT_THE_TOP, &second, 3, 3), (ze_rect{2, 4, 2, 4}));
    EXPECT_EQ(second, cut_short);
    EXPECT_EQ(e.queue->head, nullptr);
    EXPECT_EQ(e.queue->tail, nullptr);
    EXPECT_EQ(e.queue->count, 0);

    // The one after starts clean.
    Picture third(7, 7, 0);
    EXPECT_EQ(e.grow(STEP_AT_THE_TOP, &third, 3, 3), (ze_rect{2, 4, 1, 4}));
    EXPECT_EQ(third, GROWN_ON_FLAT);
}

// ---- moving a queued node whose cost falls

namespace {

// A stroke of which everything is laid out by hand. The brush has no core; all inner pixels are
// blocked but (3, 3) and its left neighbour, a step of 3 apart. `from` on the one and `lowered` on
// the other are queued already, in a list of the test's own, when the stroke begins. Its seeds
// reach nothing and only make the queue count; the first and the second are never linked (see
// D_Queue::push).
struct hand_made_stroke {
    // Queues the nodes in this order.
    void queue(const std::vector<node*>& nodes) {
        for (size_t i = 1; i < nodes.size(); ++i) {
            nodes[i - 1]->next = nodes[i];
            nodes[i]->prev = nodes[i - 1];
        }
        e.queue->head = nodes.front();
        e.queue->tail = nodes.back();
    }

    // REQUIRES: seeds <= 4.
    void run(int seeds) {
        Picture levels(7, 7, 0);
        levels.at(2, 3) = 1;
        const struct { int x, y; } rim[] = {{2, 6}, {3, 6}, {4, 6}, {5, 5}};
        for (int i = 0; i < seeds; ++i) mask.at(rim[i].x, rim[i].y) = 0;
        e.node_map[brush_cell(e, -1, 0)] = &lowered;
        e.grow(levels, &mask, 3, 3);
    }

    engine e{3, -1};
    Picture mask{R"(
        ..###..
        .#555#.
        #55555#
        #5..55#
        #55555#
        .#555#.
        ..###..)"};
    node from = {3, 3, 0, 1, nullptr, nullptr};
    node lowered = {2, 3, 100, 0, nullptr, nullptr};
    node a = {-1, -1, 0, 0, nullptr, nullptr};  // outside the image: popped, it does nothing
    node b = {-1, -1, 200, 0, nullptr, nullptr};
};

}  // namespace

TEST(DoSelection, GivesALoweredNodeTheCostAndLabelOfItsNewPath) {
    hand_made_stroke s;
    s.queue({&s.from, &s.lowered});
    s.run(1);
    EXPECT_EQ(s.lowered.cost, 3);
    EXPECT_EQ(s.lowered.label, 1);
    EXPECT_EQ(s.mask.at(3, 3), 1);

    hand_made_stroke tie;
    tie.lowered.cost = 3;
    tie.queue({&tie.from, &tie.lowered});
    tie.run(1);
    EXPECT_EQ(tie.lowered.cost, 3);
    EXPECT_EQ(tie.lowered.label, 0);
    EXPECT_EQ(tie.e.queue->tail, &tie.lowered);
}

// In the next three, the one seed's count is used up by the first pop. The push that follows the
// unlinking then only counts, and what the unlinking did can be seen.

TEST(DoSelection, UnlinksTheTail) {
    hand_made_stroke s;
    s.queue({&s.from, &s.a, &s.lowered});
    s.run(1);
    EXPECT_EQ(s.e.queue->tail, &s.a);
    EXPECT_EQ(s.a.next, nullptr);
    EXPECT_EQ(s.e.queue->head, &s.a);
    EXPECT_EQ(s.e.queue->count, 0);

    hand_made_stroke alone;
    alone.queue({&alone.from, &alone.lowered});
    alone.run(1);
    EXPECT_EQ(alone.e.queue->tail, nullptr);
    EXPECT_EQ(alone.e.queue->head, &alone.lowered);
}

TEST(DoSelection, UnlinksTheHeadAndLeavesThePrevOfTheNextOne) {
    hand_made_stroke s;
    s.queue({&s.from, &s.lowered, &s.a, &s.b});
    s.run(1);
    EXPECT_EQ(s.e.queue->head, &s.a);
    EXPECT_EQ(s.a.prev, &s.lowered);
    EXPECT_EQ(s.e.queue->tail, &s.b);
    EXPECT_EQ(s.e.queue->count, 0);
}

TEST(DoSelection, UnlinksFromTheMiddle) {
    hand_made_stroke s;
    s.queue({&s.from, &s.a, &s.lowered, &s.b});
    s.run(1);
    EXPECT_EQ(s.a.next, &s.b);
    EXPECT_EQ(s.b.prev, &s.a);
    EXPECT_EQ(s.e.queue->head, &s.a);
    EXPECT_EQ(s.e.queue->tail, &s.b);
    EXPECT_EQ(s.e.queue->count, 0);
}

TEST(DoSelection, UnlinksNothingWhereTheLoweredNodeWasNeverLinked) {
    // As D_Queue::push leaves a node that it only counts.
    hand_made_stroke s;
    s.queue({&s.from, &s.a, &s.b});
    s.run(1);
    EXPECT_EQ(s.lowered.cost, 3);
    EXPECT_EQ(s.lowered.prev, nullptr);
    EXPECT_EQ(s.lowered.next, nullptr);
    EXPECT_EQ(s.a.next, &s.b);
    EXPECT_EQ(s.b.prev, &s.a);
    EXPECT_EQ(s.e.queue->head, &s.a);
    EXPECT_EQ(s.e.queue->tail, &s.b);
    EXPECT_EQ(s.e.queue->count, 0);
}

TEST(DoSelection, LeavesALoweredNodeInItsPlaceWhenCountIsOne) {
    hand_made_stroke s;
    s.queue({&s.from, &s.a, &s.lowered});
    s.run(2);  // a count of 1 is left after the first pop, none after that of `a`
    EXPECT_EQ(s.lowered.cost, 3);
    EXPECT_EQ(s.lowered.label, 1);
    EXPECT_EQ(s.a.next, &s.lowered);
    EXPECT_EQ(s.e.queue->head, &s.lowered);
    EXPECT_EQ(s.e.queue->tail, &s.lowered);
    EXPECT_EQ(s.mask.at(2, 3), 0);
}

TEST(DoSelection, DoesNotTellTheIndexThatANodeMoves) {
    hand_made_stroke s;
    s.queue({&s.from, &s.a, &s.lowered, &s.b});
    s.e.queue->tail = &s.a;  // marked by the seed, and moved on to `lowered` by the pop
    s.run(1);
    EXPECT_EQ(s.a.next, &s.b);
    EXPECT_EQ(s.e.queue->index[0], &s.lowered);
}

TEST(DoSelection, EndsTheGrowthWhenALoweredNodeFindsTheListBroken) {
    // Two seeds go before `a`; `lowered` would go before `dear`, which has no `prev`. `open` would
    // be won next.
    hand_made_stroke s;
    s.mask.at(3, 1) = 0;
    s.from.cost = -1;
    node open = {3, 1, -1, 1, nullptr, nullptr};
    node dear = {-1, -1, 5, 0, nullptr, nullptr};
    s.queue({&s.from, &open, &s.a, &dear, &s.lowered});
    dear.prev = nullptr;
    s.run(4);
    EXPECT_EQ(s.lowered.cost, 2);
    EXPECT_EQ(s.e.queue->head, &open);
    EXPECT_EQ(s.e.queue->count, 2);
    EXPECT_EQ(s.mask.at(3, 3), 1);
    EXPECT_EQ(s.mask.at(3, 1), 0);
    EXPECT_TRUE(s.e.node_map_is_empty());
}

TEST(DoSelection, KeepsToThePoppedPixelWhenItsRecordIsHandedOutAnew) {
    // A record that an earlier stroke left queued, and which this one hands out second, for the
    // popped pixel's left neighbour.
    engine e(3, -1);
    e.node_pool[1] = {3, 3, 0, 1, nullptr, nullptr};
    e.queue->head = e.queue->tail = &e.node_pool[1];
    Picture mask(7, 7, 1);
    mask.at(3, 6) = 0;  // the only seed
    e.grow(FLAT, &mask, 3, 3);
    const struct { int x, y; } order[] = {{3, 6}, {2, 3}, {4, 3}, {3, 2}, {3, 4}};
    for (int i = 0; i < 5; ++i) {
        EXPECT_EQ(e.node_pool[i].x, order[i].x) << i;
        EXPECT_EQ(e.node_pool[i].y, order[i].y) << i;
    }
}
