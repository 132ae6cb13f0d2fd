// Every allocation of the library fails in turn, once and from then on.

#include <gtest/gtest.h>

#include <functional>

#include "selection/brush_cells.h"
#include "selection/objectsel.h"
#include "selection/region_shaping.h"
#include "tests/helpers/failing_allocations.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"

namespace {

const Picture RING(R"(
    ........
    .######.
    .#....#.
    .#.##.#.
    .#....#.
    .######.
    ........)");

// A session on the ring with a small brush, put back as it was afterwards.
class AllocationFailure : public ::testing::Test {
protected:
    AllocationFailure() { ze_init_objectsel(mask.width, mask.height); }
    ~AllocationFailure() override {
        ze_set_brush_size(10, 1);
        ze_destroy_objectsel();
        g_object_boundary = {0, 0, 0, 0};
    }

    void stroke(int mode, int fill) {
        ze_modify_objectsel(photo.data(), mask.data(), mask.width, mask.height, 3, 3, 5, 3, mode,
                            &changed, fill);
    }

    // Runs `call` with its first allocation failing, then its second, and so on through all of
    // them; `check` looks at the outcome of each.
    static void fail_each(failing_allocations::extent how_long, const std::function<void()>& call,
                          const std::function<void(int nth)>& check) {
        int allocations = 0;
        {
            failing_allocations counted(0);
            call();
            allocations = counted.asked();
        }
        ASSERT_GT(allocations, 0) << "the call allocates nothing";
        for (int nth = 1; nth <= allocations; ++nth) {
            {
                failing_allocations failing(nth, how_long);
                call();
            }
            check(nth);
        }
    }

    Picture mask = RING;
    std::vector<int> photo = std::vector<int>(RING.cells.size(), 0x336699);
    ze_rect changed = {0, 0, 0, 0};
};

// Object, queue, its index, map, nodes of cells, two cost arrays, node pool.
constexpr int ALLOCATIONS_OF_AN_ENGINE = 8;

}  // namespace

class EngineFailure : public AllocationFailure,
                      public ::testing::WithParamInterface<failing_allocations::extent> {};

TEST_P(EngineFailure, LeavesBrushStrokesWithoutEffectUntilTheNextEngine) {
    const auto check = [this](int nth) {
        EXPECT_EQ(g_ERBrush == nullptr, nth == 1);
        for (const int mode : {0, 1, 2, 3}) {
            mask = RING;
            changed = {5, 6, 7, 8};
            stroke(mode, 0);
            EXPECT_EQ(mask, RING) << "mode " << mode << ", allocation " << nth;
            EXPECT_EQ(changed, (ze_rect{8, 0, 7, 0}));
        }
        ze_set_brush_size(2, 1);
        stroke(2, 0);
        EXPECT_FALSE(mask == RING) << "the next engine is whole";
    };
    fail_each(
        GetParam(), [] { ze_set_brush_size(2, 1); }, check);
    fail_each(
        GetParam(), [this] { EXPECT_EQ(ze_init_objectsel(mask.width, mask.height), 1); }, check);
}

TEST_P(EngineFailure, OfABrushChangeLeavesAnEngineThatDoesNothing) {
    fail_each(
        GetParam(),
        [] {
            ER_selection engine;
            engine.set_brush(3, 1);
            Picture canvas(9, 9, 0);
            ze_rect rect = {9, 0, 9, 0};
            engine.Brush_Add(canvas.data(), 9, 9, 4, 4, &rect);
            EXPECT_TRUE(rect == (ze_rect{9, 0, 9, 0}) || has_buffers(engine));
        },
        [](int) {});
}

INSTANTIATE_TEST_SUITE_P(OnceAndFromThenOn, EngineFailure,
                         ::testing::Values(failing_allocations::ONCE,
                                           failing_allocations::FROM_THEN_ON));

TEST_F(AllocationFailure, AnEngineTakesEightAllocations) {
    failing_allocations counted(0);
    ze_set_brush_size(2, 1);
    EXPECT_EQ(counted.asked(), ALLOCATIONS_OF_AN_ENGINE);
}

TEST_F(AllocationFailure, StrokesWithoutFillAllocateNothing) {
    failing_allocations counted(0);
    for (int mode = 0; mode <= 5; ++mode) stroke(mode, 0);
    EXPECT_EQ(counted.asked(), 0);
}

TEST_F(AllocationFailure, APassOnRegionsAllocatesOnceAndFreesIt) {
    for (const int mode : {0, 1, 2, 4, 5}) {
        failing_allocations counted(0);
        stroke(mode, 1);
        EXPECT_EQ(counted.asked(), 1) << "mode " << mode;
        EXPECT_EQ(counted.freed(), 1) << "mode " << mode;
    }
}

TEST_F(AllocationFailure, OfHoleFillingLeavesMaskAndRectangle) {
    changed = {5, 6, 7, 8};
    failing_allocations failing(1);
    Fill_Region(mask.data(), mask.width, mask.height, 0, 7, 0, 6, &changed);
    EXPECT_EQ(mask, RING);
    EXPECT_EQ(changed, (ze_rect{5, 6, 7, 8}));
}

TEST_F(AllocationFailure, OfErasingLeavesTheMaskAndAnEmptyBox) {
    changed = {5, 6, 7, 8};
    ze_rect boundary = {0, 7, 0, 6};
    failing_allocations failing(1);
    Erase_Region(mask.data(), mask.width, mask.height, &boundary, &changed);
    EXPECT_EQ(mask, RING);
    EXPECT_EQ(boundary, (ze_rect{8, 0, 7, 0}));
    EXPECT_EQ(changed, (ze_rect{5, 6, 7, 8}));
}

TEST_F(AllocationFailure, OfTheLassoFillsIsTheirResultZero) {
    const Picture outline(R"(
        .55555..
        .5...5..
        .33334..)");
    for (const auto fill : {ze_lasso_add_fill_mask, ze_lasso_del_fill_mask}) {
        Picture canvas = outline;
        failing_allocations failing(1);
        EXPECT_EQ(fill(canvas.data(), 8, 3, 0, 7, 0, 2), 0);
        EXPECT_EQ(canvas, outline);
    }
}

TEST_F(AllocationFailure, OfTheFillKeepsTheStrokeItself) {
    ze_set_brush_size(1, 0);
    {
        failing_allocations failing(1);
        stroke(4, 1);
    }
    EXPECT_EQ(mask, Picture(R"(
        ........
        .######.
        .#....#.
        .#.55##.
        .#....#.
        .######.
        ........)"))
        << "the outline stays as it was drawn";
}
