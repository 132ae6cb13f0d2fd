#include "selection/ER_selection.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <cstdint>
#include <vector>

#include "selection/brush_cells.h"
#include "selection/competition_memory.h"
#include "tests/helpers/failing_allocations.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"
#include "tests/helpers/sparse_memory.h"

namespace {

struct brush : ER_selection {
    brush(int r, int c) { initial(r, c); }

    // The classes of the cells: . outside, # rim, 2 inner, 3 core.
    Picture classes() const {
        Picture map(2 * radius + 1, 2 * radius + 1, 0);
        std::copy_n(brush_map, map.cells.size(), map.cells.begin());
        return map;
    }
    int cells_of(brush_class cls) const {
        const Picture map = classes();
        return static_cast<int>(std::count(map.cells.begin(), map.cells.end(), cls));
    }
};

// What a stroke in the middle of a picture of odd values leaves of it.
bool strokes_do_nothing(ER_selection* engine) {
    std::vector<int> photo(81);
    Picture mask(9, 9, 7);
    ze_rect rect = {9, 0, 9, 0};
    engine->DoSelection(photo.data(), mask.data(), 9, 9, 4, 4, &rect);
    return mask == Picture(9, 9, 7) && rect == ze_rect{9, 0, 9, 0};
}

}  // namespace

TEST(ER_selection, HasNoBuffersUntilInitial) {
    ER_selection engine;
    EXPECT_EQ(engine.brush_map, nullptr);
    EXPECT_EQ(engine.node_pool, nullptr);
    EXPECT_EQ(engine.node_map, nullptr);
    EXPECT_EQ(engine.cost_h, nullptr);
    EXPECT_EQ(engine.cost_v, nullptr);
    EXPECT_EQ(engine.queue, nullptr);
    EXPECT_FALSE(has_buffers(engine));
    EXPECT_TRUE(strokes_do_nothing(&engine));
}

// ---- the brush

TEST(ER_selection_initial, CountsTheCellsOfEachClass) {
    const struct {
        int radius, rim, inner, core, step;
    } cases[] = {{10, 56, 284, 9, 3}, {2, 12, 0, 9, 1}, {1, 8, 0, 1, 1}, {0, 1, 0, 0, 1}};
    for (const auto& c : cases) {
        const brush b(c.radius, 1);
        EXPECT_EQ(b.cells_of(BRUSH_RIM), c.rim) << c.radius;
        EXPECT_EQ(b.cells_of(BRUSH_INNER), c.inner) << c.radius;
        EXPECT_EQ(b.cells_of(BRUSH_CORE), c.core) << c.radius;
        EXPECT_EQ(b.brush_cells, c.rim + c.inner + c.core) << c.radius;
        EXPECT_EQ(b.queue->step, c.step) << c.radius;
    }
}

TEST(ER_selection_initial, TiesTheQueuesStepToAHundredthOfTheCells) {
    const struct {
        int radius, cells, step;
    } cases[] = {{5, 97, 1}, {10, 349, 3}, {19, 1201, 12}, {20, 1313, 13}, {22, 1597, 15}};
    for (const auto& c : cases) {
        const brush b(c.radius, 1);
        EXPECT_EQ(b.brush_cells, c.cells) << c.radius;
        EXPECT_EQ(b.queue->step, c.step) << c.radius;
    }
}

TEST(ER_selection_initial, ClassesCellsByTheirRoundedDistance) {
    EXPECT_EQ(brush(5, 1).classes(), Picture(R"(
        ...#####...
        ..#22222#..
        .#2222222#.
        #222222222#
        #222333222#
        #222333222#
        #222333222#
        #222222222#
        .#2222222#.
        ..#22222#..
        ...#####...)"));
}

TEST(ER_selection_initial, RoundsHalfUpSoThatTheDiagonalIsInACoreOfOne) {
    const brush b(4, 1);
    for (const int dx : {-1, 1}) {
        for (const int dy : {-1, 1}) {
            EXPECT_EQ(b.brush_map[brush_cell(b, dx, dy)], BRUSH_CORE);
        }
    }
    EXPECT_EQ(b.brush_map[brush_cell(b, 2, 0)], BRUSH_INNER);
}

TEST(ER_selection_initial, KeepsTheRimAndHasNothingInnerWhenTheCoreReachesIt) {
    EXPECT_EQ(brush(3, 3).classes(), Picture(R"(
        ..###..
        .#333#.
        #33333#
        #33333#
        #33333#
        .#333#.
        ..###..)"));
}

TEST(ER_selection_initial, MakesCoreOfCellsBeyondTheRimWhenTheCoreIsLarger) {
    const brush b(2, 3);
    EXPECT_EQ(b.classes(), Picture(R"(
        3###3
        #333#
        #333#
        #333#
        3###3)"));
    EXPECT_EQ(b.brush_cells, 25);
}

TEST(ER_selection_initial, HasNoCoreBelowRadiusZero) {
    EXPECT_EQ(brush(2, -1).classes(), Picture(R"(
        .###.
        #222#
        #222#
        #222#
        .###.)"));
    EXPECT_EQ(brush(2, 0).classes(), Picture(R"(
        .###.
        #222#
        #232#
        #222#
        .###.)"));
}

TEST(ER_selection_initial, GivesAnEmptySquareToANegativeRadius) {
    for (const int radius : {-1, -2, -1000, INT_MIN / 2, INT_MIN + 3, INT_MIN + 1, INT_MIN}) {
        brush b(radius, 1);
        EXPECT_EQ(b.radius, radius);
        EXPECT_EQ(b.brush_cells, 0) << radius;
        EXPECT_TRUE(strokes_do_nothing(&b)) << radius;
    }
}

TEST(ER_selection_initial, TakesASquareBeyondAllMemoryForAFailedAllocation) {
    for (const int radius : {100000, 1 << 30, INT_MAX - 1, INT_MAX}) {
        brush b(radius, 1);
        EXPECT_EQ(b.radius, radius);
        EXPECT_FALSE(has_buffers(b)) << radius;
        EXPECT_TRUE(strokes_do_nothing(&b)) << radius;
    }
}

TEST(ER_selection_initial, AsksForNoMoreCellsThanAnIntCanCount) {
    const struct {
        int radius, asked;
    } cases[] = {
        {23169, 3},  // 2,147,302,921 cells: the queue, its index, and a brush that cannot be had
        {23170, 2},  // 2,147,488,281
    };
    for (const auto& c : cases) {
        ER_selection engine;
        failing_allocations out_of_memory(3);
        engine.initial(c.radius, 1);
        EXPECT_EQ(out_of_memory.asked(), c.asked) << c.radius;
        EXPECT_FALSE(has_buffers(engine)) << c.radius;
    }
}

TEST(ER_selection_initial, TakesAnyCoreRadius) {
    EXPECT_EQ(brush(1, INT_MIN).classes(), Picture("### #2# ###"));
    EXPECT_EQ(brush(1, INT_MAX).classes(), Picture("### #3# ###"));
}

// ---- buffers

TEST(ER_selection_initial, ZeroesCostsAndNodeMap) {
    brush b(3, 1);
    std::fill_n(b.cost_h, 49, 5);
    std::fill_n(b.cost_v, 49, 5);
    std::fill_n(b.node_map, 49, b.node_pool);

    b.initial(3, 1);  // the same brush again: rebuilt all the same

    EXPECT_EQ(std::count(b.cost_h, b.cost_h + 49, 0), 49);
    EXPECT_EQ(std::count(b.cost_v, b.cost_v + 49, 0), 49);
    EXPECT_EQ(std::count(b.node_map, b.node_map + 49, nullptr), 49);
}

TEST(ER_selection_initial, BeginsWithAnEmptyQueueAndNoNodesUsed) {
    brush b(3, 1);
    node stranded = {0, 0, 0, 0, nullptr, nullptr};
    b.queue->push(&stranded);
    b.nodes_used = 17;

    b.initial(3, 1);

    EXPECT_EQ(b.queue->head, nullptr);
    EXPECT_EQ(b.queue->count, 0);
    EXPECT_EQ(b.nodes_used, 0);
}

TEST(ER_selection_initial, TakesAnEntryPerCellAndWhatTheCompetitionNeeds) {
    const struct {
        int radius;
        size_t square, brush;
    } cases[] = {{10, 441, 349}, {2, 25, 21}, {0, 1, 1}, {-1, 0, 0}, {-2, 0, 0}};
    for (const auto& c : cases) {
        const failing_allocations counted(0);
        const brush b(c.radius, 1);
        const size_t needed = sizeof(D_Queue) + 100 * sizeof(node*) +
                              c.square * (1 + sizeof(node*) + 2 * sizeof(int)) +
                              (c.brush + 1) * sizeof(node);
        EXPECT_GE(counted.bytes(), needed + sizeof(cost_slots)) << c.radius;
        // A cell's record in the competition takes less than 32 bytes; and there are some more.
        const size_t side = c.radius < 0 ? 0 : 2 * static_cast<size_t>(c.radius) + 1;
        EXPECT_LE(counted.bytes(), needed + sizeof(cost_slots) + 32 * (c.square + 3 * side + 8))
            << c.radius;
    }
}

TEST(ER_selection_initial, StopsAtTheFirstFailedAllocation) {
    // The queue, its index, and the buffers in the order in which they are taken.
    for (int nth = 1; nth <= 7; ++nth) {
        SCOPED_TRACE(nth);
        ER_selection engine;
        {
            failing_allocations out_of_memory(nth);
            engine.initial(3, 1);
            EXPECT_EQ(out_of_memory.asked(), nth);
        }
        EXPECT_EQ(engine.queue != nullptr, nth > 1);
        EXPECT_EQ(engine.queue && engine.queue->index, nth > 2);
        EXPECT_EQ(engine.brush_map != nullptr, nth > 3);
        EXPECT_EQ(engine.node_map != nullptr, nth > 4);
        EXPECT_EQ(engine.cost_h != nullptr, nth > 5);
        EXPECT_EQ(engine.cost_v != nullptr, nth > 6);
        EXPECT_EQ(engine.node_pool, nullptr);
        EXPECT_FALSE(has_buffers(engine));
        EXPECT_TRUE(strokes_do_nothing(&engine));

        engine.initial(3, 1);
        EXPECT_TRUE(has_buffers(engine));
        EXPECT_FALSE(strokes_do_nothing(&engine));
    }
}

TEST(ER_selection_destroyResource, FreesAndForgetsEverything) {
    brush b(3, 1);
    for (int i = 0; i < 2; ++i) {
        b.destroyResource();
        EXPECT_EQ(b.brush_map, nullptr);
        EXPECT_EQ(b.node_pool, nullptr);
        EXPECT_EQ(b.node_map, nullptr);
        EXPECT_EQ(b.cost_h, nullptr);
        EXPECT_EQ(b.cost_v, nullptr);
        EXPECT_EQ(b.queue, nullptr);
    }
    EXPECT_TRUE(strokes_do_nothing(&b));
}

// ---- set_brush

TEST(ER_selection_set_brush, DoesNothingWithTheCurrentPair) {
    brush b(3, 1);
    b.nodes_used = 17;
    b.cost_h[5] = 99;
    b.brush_map[0] = 9;
    const D_Queue* const queue = b.queue;
    {
        failing_allocations counted(0);
        b.set_brush(3, 1);
        EXPECT_EQ(counted.asked(), 0);
    }
    EXPECT_EQ(b.nodes_used, 17);
    EXPECT_EQ(b.cost_h[5], 99);
    EXPECT_EQ(b.brush_map[0], 9);
    EXPECT_EQ(b.queue, queue);
}

TEST(ER_selection_set_brush, RebuildsWhenEitherValueChangesAndKeepsNodesUsed) {
    const struct { int radius, core; } cases[] = {{10, 1}, {3, 2}, {10, 2}};
    for (const auto& c : cases) {
        brush b(3, 1);
        b.nodes_used = 17;

        b.set_brush(c.radius, c.core);

        const brush fresh(c.radius, c.core);
        EXPECT_EQ(b.nodes_used, 17);
        EXPECT_EQ(b.radius, c.radius);
        EXPECT_EQ(b.core_radius, c.core);
        EXPECT_EQ(b.brush_cells, fresh.brush_cells);
        EXPECT_EQ(b.queue->step, fresh.queue->step);
        EXPECT_EQ(b.classes(), fresh.classes());
        const int cells = (2 * c.radius + 1) * (2 * c.radius + 1);
        EXPECT_EQ(std::count(b.cost_h, b.cost_h + cells, 0), cells);
        EXPECT_EQ(std::count(b.cost_v, b.cost_v + cells, 0), cells);
        EXPECT_EQ(std::count(b.node_map, b.node_map + cells, nullptr), cells);
    }
}

TEST(ER_selection_set_brush, LeavesAnEngineThatStrokesLeaveAloneWhenMemoryRunsOut) {
    for (int nth = 1; nth <= 7; ++nth) {
        brush b(2, 1);
        {
            failing_allocations out_of_memory(nth, failing_allocations::FROM_THEN_ON);
            b.set_brush(3, 1);
        }
        EXPECT_FALSE(has_buffers(b)) << nth;
        EXPECT_TRUE(strokes_do_nothing(&b)) << nth;
    }
}

// ---- cal_cost

TEST(ER_selection_cal_cost, IsTheSquaredDistanceInRedGreenAndBlue) {
    const struct {
        unsigned a, b;
        int cost;
    } cases[] = {
        {0xFF102030u, 0xFF102030u, 0},
        {0x00123456u, 0xFF123456u, 0},  // alpha does not count
        {0xFF000000u, 0xFFFFFFFFu, 195075},
        {0xFF000000u, 0xFF010000u, 1},
        {0xFF000000u, 0xFF000200u, 4},
        {0xFF000000u, 0xFF000003u, 9},
        {0xFF050505u, 0xFF040302u, 1 + 4 + 9},
        {0xFF0A00FFu, 0xFF00FF0Au, 100 + 65025 + 60025},
    };
    ER_selection engine;
    for (const auto& c : cases) {
        int photo[] = {static_cast<int>(c.a), static_cast<int>(c.b)};
        EXPECT_EQ(engine.cal_cost(photo, 2, 0, 0, 1, 0), c.cost) << std::hex << c.a << ' ' << c.b;
        EXPECT_EQ(engine.cal_cost(photo, 2, 1, 0, 0, 0), c.cost) << std::hex << c.a << ' ' << c.b;
    }
}

TEST(ER_selection_cal_cost, FindsPixelsByRowsOfTheGivenWidth) {
    std::vector<int> photo(12);
    photo[2 * 4 + 1] = 5;  // (1, 2) in rows of 4
    ER_selection engine;
    EXPECT_EQ(engine.cal_cost(photo.data(), 4, 1, 2, 0, 2), 25);
    EXPECT_EQ(engine.cal_cost(photo.data(), 4, 1, 1, 1, 2), 25);
    EXPECT_EQ(engine.cal_cost(photo.data(), 4, 2, 1, 2, 2), 0);
}

#if UINTPTR_MAX > UINT32_MAX  // no room for it on 32-bit machines
TEST(ER_selection_cal_cost, ReachesTheFarCornerOfAHugePhoto) {
    const int size = 50000;
    sparse_array<int> photo(2500000000ull);
    ASSERT_TRUE(photo.data()) << NO_ROOM;
    photo[2499999999ull] = 3;
    ER_selection engine;
    EXPECT_EQ(engine.cal_cost(photo.data(), size, size - 1, size - 1, size - 2, size - 1), 9);
}
#endif
