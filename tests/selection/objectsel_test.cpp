#include "selection/objectsel.h"

#include <android/log.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <climits>
#include <cstdint>
#include <vector>

#include "selection/brush_cells.h"
#include "tests/helpers/failing_allocations.h"
#include "tests/helpers/log_lines.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"
#include "tests/helpers/sparse_memory.h"

namespace {

// The globals, read before any test has run.
const struct {
    const ER_selection* engine = g_ERBrush;
    ze_rect object = g_object_boundary;
    ze_rect fill = g_fill_boundary;
    int radius = g_Brush_Radius;
    int center = g_Brush_Center;
} AT_START;

// A session of its own for each test: it starts without an engine, and what it did to the globals
// is undone.
class objectsel : public ::testing::Test {
protected:
    objectsel()
        : old_object(g_object_boundary),
          old_fill(g_fill_boundary),
          old_radius(g_Brush_Radius),
          old_center(g_Brush_Center) {
        ze_destroy_objectsel();
        take_log_lines();
    }
    ~objectsel() override {
        ze_destroy_objectsel();
        g_object_boundary = old_object;
        g_fill_boundary = old_fill;
        g_Brush_Radius = old_radius;
        g_Brush_Center = old_center;
        take_log_lines();
    }

    // A stroke at (x, y) on a photo of one colour. Returns its rectangle.
    static ze_rect stroke(Picture* mask, int x, int y, int mode, int fill_flag) {
        std::vector<int> photo(mask->cells.size());
        ze_rect rect = {-1, -2, -3, -4};
        ze_modify_objectsel(photo.data(), mask->data(), mask->width, mask->height, x, y, -9, -9,
                            mode, &rect, fill_flag);
        return rect;
    }

private:
    const ze_rect old_object, old_fill;
    const int old_radius, old_center;
};

const Picture RING(R"(
    ..........
    .####.....
    .#..#.....
    .####.....
    ..........
    ..........)");

}  // namespace

TEST_F(objectsel, HasDefaultsBeforeAnyCall) {
    EXPECT_EQ(AT_START.engine, nullptr);
    EXPECT_EQ(AT_START.object, (ze_rect{0, 0, 0, 0}));
    EXPECT_EQ(AT_START.fill, (ze_rect{0, 0, 0, 0}));
    EXPECT_EQ(AT_START.radius, 10);
    EXPECT_EQ(AT_START.center, 1);
    g_Brush_Radius = AT_START.radius;
    g_Brush_Center = AT_START.center;
    EXPECT_EQ(ze_get_brush_radius(), 10);
    EXPECT_EQ(ze_get_brush_center(), 1);
}

// ---- engine and brush

TEST_F(objectsel, InitBuildsAnEngineFromTheBrushGlobalsAndEmptiesTheObjectBox) {
    g_Brush_Radius = 7;
    g_Brush_Center = 2;
    g_fill_boundary = {1, 2, 3, 4};

    EXPECT_EQ(ze_init_objectsel(640, 480), 1);

    ASSERT_NE(g_ERBrush, nullptr);
    EXPECT_TRUE(has_buffers(*g_ERBrush));
    EXPECT_EQ(g_ERBrush->radius, 7);
    EXPECT_EQ(g_ERBrush->core_radius, 2);
    EXPECT_EQ(g_object_boundary, (ze_rect{639, 0, 479, 0}));
    EXPECT_EQ(g_fill_boundary, (ze_rect{1, 2, 3, 4}));
    EXPECT_EQ(g_Brush_Radius, 7);
    EXPECT_EQ(g_Brush_Center, 2);
}

TEST_F(objectsel, InitReplacesTheEngine) {
    ze_init_objectsel(8, 8);
    g_ERBrush->nodes_used = 17;
    g_Brush_Radius = 4;

    EXPECT_EQ(ze_init_objectsel(9, 9), 1);

    EXPECT_EQ(g_ERBrush->radius, 4);
    EXPECT_EQ(g_ERBrush->nodes_used, 0);
}

TEST_F(objectsel, DestroyReleasesTheEngineAndNothingElse) {
    ze_set_brush_size(5, 2);
    g_object_boundary = {1, 2, 3, 4};
    g_fill_boundary = {5, 6, 7, 8};
    for (int i = 0; i < 2; ++i) {
        ze_destroy_objectsel();
        EXPECT_EQ(g_ERBrush, nullptr);
        EXPECT_EQ(g_Brush_Radius, 5);
        EXPECT_EQ(g_Brush_Center, 2);
        EXPECT_EQ(g_object_boundary, (ze_rect{1, 2, 3, 4}));
        EXPECT_EQ(g_fill_boundary, (ze_rect{5, 6, 7, 8}));
    }
}

TEST_F(objectsel, SetBrushSizeMakesAnEngineWhereThereIsNone) {
    ze_set_brush_size(20, 3);
    ASSERT_NE(g_ERBrush, nullptr);
    EXPECT_EQ(g_ERBrush->radius, 20);
    EXPECT_EQ(g_ERBrush->core_radius, 3);
    EXPECT_EQ(ze_get_brush_radius(), 20);
    EXPECT_EQ(ze_get_brush_center(), 3);

    ze_destroy_objectsel();
    ze_init_objectsel(8, 8);
    EXPECT_EQ(g_ERBrush->radius, 20);
    EXPECT_EQ(g_ERBrush->core_radius, 3);
    EXPECT_EQ(g_Brush_Radius, 20);
    EXPECT_EQ(g_Brush_Center, 3);
}

TEST_F(objectsel, SetBrushSizeRebuildsTheEngineForTheSameValues) {
    ze_set_brush_size(5, 1);
    g_ERBrush->nodes_used = 17;
    g_ERBrush->cost_h[3] = 99;
    ze_set_brush_size(5, 1);
    EXPECT_EQ(g_ERBrush->nodes_used, 0);
    EXPECT_EQ(g_ERBrush->cost_h[3], 0);
}

TEST_F(objectsel, SetBrushSizeKeepsTheObjectBox) {
    g_object_boundary = {1, 2, 3, 4};
    g_fill_boundary = {5, 6, 7, 8};
    ze_set_brush_size(5, 1);
    EXPECT_EQ(g_object_boundary, (ze_rect{1, 2, 3, 4}));
    EXPECT_EQ(g_fill_boundary, (ze_rect{5, 6, 7, 8}));
}

TEST_F(objectsel, TakesAnyBrushSizeAndDoesNothingWithAnImpossibleOne) {
    for (const int radius : {INT_MAX, 1 << 30, -1, -2, INT_MIN + 1, INT_MIN}) {
        ze_set_brush_size(radius, 1);
        EXPECT_EQ(ze_get_brush_radius(), radius);
        EXPECT_EQ(ze_init_objectsel(10, 6), 1) << radius;
        Picture mask = RING;
        EXPECT_EQ(stroke(&mask, 3, 3, 0, 0), (ze_rect{10, 0, 6, 0})) << radius;
        EXPECT_EQ(mask, RING) << radius;
        EXPECT_EQ(g_object_boundary, (ze_rect{9, 0, 5, 0})) << radius;
    }
}

TEST_F(objectsel, InitReturnsOneWhenMemoryRunsOut) {
    // The engine itself, its queue with the index, five buffers.
    for (int nth = 1; nth <= 8; ++nth) {
        SCOPED_TRACE(nth);
        int result;
        {
            failing_allocations out_of_memory(nth, failing_allocations::FROM_THEN_ON);
            result = ze_init_objectsel(10, 6);
        }
        EXPECT_EQ(result, 1);
        EXPECT_EQ(g_ERBrush == nullptr, nth == 1);
        EXPECT_EQ(g_object_boundary, (ze_rect{9, 0, 5, 0}));
        Picture mask = RING;
        EXPECT_EQ(stroke(&mask, 3, 3, 0, 0), (ze_rect{10, 0, 6, 0}));
        EXPECT_EQ(mask, RING);
        EXPECT_EQ(take_log_lines().size(), 0u);
    }
    ze_init_objectsel(10, 6);
    EXPECT_TRUE(has_buffers(*g_ERBrush));
}

// ---- strokes

TEST_F(objectsel, OnlyEmptiesTheStrokesRectangleWithoutAnEngine) {
    g_object_boundary = {0, 9, 0, 5};
    for (int i = 0; i < 2; ++i) {
        Picture mask = RING;
        EXPECT_EQ(stroke(&mask, 5, 3, 0, 1), (ze_rect{10, 0, 6, 0}));
        EXPECT_EQ(mask, RING);
        EXPECT_EQ(g_object_boundary, (ze_rect{0, 9, 0, 5}));
        ze_set_brush_size(1, 1);
        ze_destroy_objectsel();
    }
}

TEST_F(objectsel, OnlyEmptiesTheStrokesRectangleInAnUnknownMode) {
    ze_set_brush_size(1, 1);
    for (const int mode : {6, -1, 7, 100, 256, INT_MAX, INT_MIN}) {
        g_object_boundary = {0, 9, 0, 5};
        Picture mask = RING;
        EXPECT_EQ(stroke(&mask, 6, 3, mode, 1), (ze_rect{10, 0, 6, 0})) << mode;
        EXPECT_EQ(mask, RING) << mode;
        EXPECT_EQ(g_object_boundary, (ze_rect{0, 9, 0, 5})) << mode;
    }
    EXPECT_EQ(take_log_lines().size(), 0u);
}

TEST_F(objectsel, GrowsAtTheFirstPoint) {
    ze_set_brush_size(2, 1);
    ze_init_objectsel(7, 6);
    Picture mask(7, 6, 0);
    EXPECT_EQ(stroke(&mask, 4, 2, 0, 0), (ze_rect{3, 5, 1, 3}));
    EXPECT_EQ(mask, Picture(R"(
        .......
        ...###.
        ...###.
        ...###.
        .......
        .......)"));
}

TEST_F(objectsel, MergesTheStrokesRectangleIntoTheObjectBox) {
    ze_set_brush_size(10, 1);
    ze_init_objectsel(640, 480);
    Picture mask(640, 480, 1);
    EXPECT_EQ(stroke(&mask, 110, 60, 0, 0), (ze_rect{100, 120, 50, 70}));
    EXPECT_EQ(g_object_boundary, (ze_rect{100, 120, 50, 70}));

    // The second rectangle is the stroke's alone.
    EXPECT_EQ(stroke(&mask, 105, 100, 0, 0), (ze_rect{95, 115, 90, 110}));
    EXPECT_EQ(g_object_boundary, (ze_rect{95, 120, 50, 110}));
}

TEST_F(objectsel, FillsOnlyWhenFillIsOne) {
    ze_set_brush_size(1, 1);
    for (const int fill_flag : {0, 2, -1, 257, INT_MIN}) {
        g_object_boundary = {0, 9, 0, 5};
        Picture mask = RING;
        EXPECT_EQ(stroke(&mask, 7, 4, 0, fill_flag), (ze_rect{7, 7, 4, 4})) << fill_flag;
        EXPECT_EQ(mask.at(2, 2), 0) << fill_flag;
        EXPECT_EQ(mask.at(7, 4), 1) << fill_flag;
    }
}

TEST_F(objectsel, FillsTheObjectBoxAndReportsStrokeAndFillTogether) {
    ze_set_brush_size(1, 1);
    g_object_boundary = {1, 4, 1, 3};
    Picture mask = RING;
    EXPECT_EQ(stroke(&mask, 7, 4, 0, 1), (ze_rect{2, 7, 2, 4}));
    EXPECT_EQ(mask, Picture(R"(
        ..........
        .####.....
        .####.....
        .####.....
        .......#..
        ..........)"));
    EXPECT_EQ(g_object_boundary, (ze_rect{1, 7, 1, 4}));
}

TEST_F(objectsel, LeavesHolesBeyondTheObjectBox) {
    ze_set_brush_size(1, 1);
    g_object_boundary = {4, 9, 1, 3};
    Picture mask = RING;
    EXPECT_EQ(stroke(&mask, 7, 4, 0, 1), (ze_rect{7, 7, 4, 4}));
    EXPECT_EQ(mask.at(2, 2), 0);
}

TEST_F(objectsel, FillsInTheBoxThatTheStrokeHasJustWidened) {
    // The hole lies in the square, outside the disc.
    ze_set_brush_size(5, 1);
    ze_init_objectsel(13, 13);
    Picture mask(13, 13, 1);
    mask.at(2, 2) = 0;
    EXPECT_EQ(stroke(&mask, 6, 6, 0, 1), (ze_rect{1, 11, 1, 11}));
    EXPECT_EQ(mask, Picture(13, 13, 1));
    EXPECT_EQ(g_object_boundary, (ze_rect{1, 11, 1, 11}));
}

TEST_F(objectsel, FillsAlsoWhenTheStrokeItselfDidNothing) {
    ze_set_brush_size(1, 1);
    g_object_boundary = {0, 9, 0, 5};
    Picture mask = RING;
    EXPECT_EQ(stroke(&mask, 0, 0, 0, 1), (ze_rect{2, 3, 2, 2}));
    EXPECT_EQ(g_object_boundary, (ze_rect{0, 9, 0, 5}));
}

TEST_F(objectsel, MergesAnEmptyStrokeRectangleToo) {
    // Its right and bottom are 0, which is more than a box left of and above the image has.
    ze_set_brush_size(1, 1);
    g_object_boundary = {-9, -5, -8, -4};
    Picture mask = RING;
    EXPECT_EQ(stroke(&mask, 0, 0, 0, 0), (ze_rect{10, 0, 6, 0}));
    EXPECT_EQ(g_object_boundary, (ze_rect{-9, 0, -8, 0}));
}

TEST_F(objectsel, FillsThePartOfAStoredBoxInsideTheImage) {
    ze_set_brush_size(1, 1);
    ze_set_objectROI({-100, 100, INT_MIN, INT_MAX});
    Picture mask = RING;
    EXPECT_EQ(stroke(&mask, 7, 4, 0, 1), (ze_rect{2, 7, 2, 4}));
    EXPECT_EQ(mask.at(2, 2), 1);
    EXPECT_EQ(g_object_boundary, (ze_rect{-100, 100, INT_MIN, INT_MAX}));
}

// ---- reset and reinit

TEST_F(objectsel, ResetClearsExactlyTheMaskAndEmptiesTheObjectBox) {
    ze_set_brush_size(5, 2);
    g_ERBrush->nodes_used = 17;
    g_fill_boundary = {5, 6, 7, 8};
    std::vector<unsigned char> mask(4 * 3 + 1, 9);

    ze_reset_objectsel(mask.data(), 4, 3);

    EXPECT_EQ(std::vector<unsigned char>(mask.begin(), mask.end() - 1),
              std::vector<unsigned char>(12, 0));
    EXPECT_EQ(mask.back(), 9);
    EXPECT_EQ(g_object_boundary, (ze_rect{3, 0, 2, 0}));
    EXPECT_EQ(g_fill_boundary, (ze_rect{5, 6, 7, 8}));
    EXPECT_EQ(g_ERBrush->nodes_used, 17);
    EXPECT_EQ(g_Brush_Radius, 5);
    EXPECT_EQ(g_Brush_Center, 2);
    EXPECT_EQ(take_log_lines().size(), 0u);
}

TEST_F(objectsel, ResetTakesAMaskOfOneRowOrColumn) {
    for (const ze_rect& last : {ze_rect{2, 0, 0, 0}, ze_rect{0, 0, 2, 0}, ze_rect{0, 0, 0, 0}}) {
        Picture mask(last.left + 1, last.top + 1, 1);
        ze_reset_objectsel(mask.data(), mask.width, mask.height);
        EXPECT_EQ(mask, Picture(mask.width, mask.height, 0));
        EXPECT_EQ(g_object_boundary, last);
    }
}

TEST_F(objectsel, ResetLogsBadInputAndChangesNothing) {
    const struct {
        bool has_mask;
        int width, height;
    } cases[] = {{false, 4, 3}, {true, 0, 10},      {true, -1, 3},      {true, 4, 0},
                 {true, 4, -3}, {true, INT_MIN, 3}, {true, 4, INT_MIN}, {true, -4, -3}};
    for (const auto& c : cases) {
        g_object_boundary = {1, 2, 3, 4};
        std::vector<unsigned char> mask(12, 9);
        ze_reset_objectsel(c.has_mask ? mask.data() : nullptr, c.width, c.height);
        EXPECT_EQ(mask, std::vector<unsigned char>(12, 9)) << c.width << " x " << c.height;
        EXPECT_EQ(g_object_boundary, (ze_rect{1, 2, 3, 4})) << c.width << " x " << c.height;
        EXPECT_THAT(take_log_lines(),
                    testing::ElementsAre(log_line{4, "KOVA_RM", "invalid input parameters\n"}));
    }
}

TEST_F(objectsel, ReinitDoesNothing) {
    ze_set_brush_size(5, 2);
    g_ERBrush->nodes_used = 17;
    g_object_boundary = {1, 2, 3, 4};
    g_fill_boundary = {5, 6, 7, 8};
    Picture mask = RING;

    ze_reinit_objectsel(mask.data(), mask.width, mask.height, {0, 9, 0, 5});
    ze_reinit_objectsel(nullptr, -1, INT_MIN, {3, 2, 1, 0});

    EXPECT_EQ(mask, RING);
    EXPECT_EQ(g_object_boundary, (ze_rect{1, 2, 3, 4}));
    EXPECT_EQ(g_fill_boundary, (ze_rect{5, 6, 7, 8}));
    EXPECT_EQ(g_ERBrush->nodes_used, 17);
    EXPECT_EQ(g_Brush_Radius, 5);
    EXPECT_EQ(g_Brush_Center, 2);
    EXPECT_EQ(take_log_lines().size(), 0u);
}

// ---- the object box and the mask

TEST_F(objectsel, InverseSelectsAnEmptyMaskWhole) {
    Picture mask(4, 3, 0);
    ze_inverse_mask(mask.data(), 4, 3);
    EXPECT_EQ(mask, Picture(4, 3, 1));
    EXPECT_EQ(g_object_boundary, (ze_rect{0, 3, 0, 2}));
}

TEST_F(objectsel, InverseClearsAFullMask) {
    Picture mask(4, 3, 1);
    ze_inverse_mask(mask.data(), 4, 3);
    EXPECT_EQ(mask, Picture(4, 3, 0));
    EXPECT_EQ(g_object_boundary, (ze_rect{3, 0, 2, 0}));
}

TEST_F(objectsel, InverseSelectsEveryValueButOne) {
    Picture mask(R"(
        #####
        #2.9#
        #####)");
    mask.at(2, 1) = 255;
    ze_inverse_mask(mask.data(), 5, 3);
    EXPECT_EQ(mask, Picture(R"(
        .....
        .###.
        .....)"));
    EXPECT_EQ(g_object_boundary, (ze_rect{1, 3, 1, 1}));
}

TEST_F(objectsel, InverseForgetsTheOldObjectBox) {
    g_object_boundary = {0, 100, 0, 100};
    Picture mask("#### ##.# ####");
    ze_inverse_mask(mask.data(), 4, 3);
    EXPECT_EQ(g_object_boundary, (ze_rect{2, 2, 1, 1}));
}

TEST_F(objectsel, InverseOfAnImageWithoutPixelsOnlyEmptiesTheBox) {
    const struct { int width, height; } sizes[] = {{4, 0}, {4, -3}, {0, 3}, {-4, 3}, {-4, -3}};
    for (const auto& s : sizes) {
        unsigned char beyond = 9;
        ze_inverse_mask(&beyond, s.width, s.height);
        EXPECT_EQ(beyond, 9);
        EXPECT_EQ(g_object_boundary, (ze_rect{s.width - 1, 0, s.height - 1, 0}));
    }
}

TEST_F(objectsel, GetObjectROIReturnsWhatWasSet) {
    for (const ze_rect& roi : {ze_rect{1, 2, 3, 4}, ze_rect{9, -5, 8, -6},
                               ze_rect{INT_MIN, INT_MAX, INT_MAX, INT_MIN}}) {
        ze_set_objectROI(roi);
        EXPECT_EQ(g_object_boundary, roi);
        EXPECT_EQ(ze_get_objectROI(), roi);
    }
}

TEST_F(objectsel, UpdateShrinksTheBoxToTheSelectionInsideIt) {
    Picture mask(R"(
        #......#
        ...#....
        ..2.#...
        ........
        #......#)");
    ze_set_objectROI({1, 6, 0, 4});
    ze_update_objectROI(mask.data(), 8, 5);
    EXPECT_EQ(ze_get_objectROI(), (ze_rect{3, 4, 1, 2}));  // neither the corners nor the 2
    ze_update_objectROI(mask.data(), 8, 5);
    EXPECT_EQ(ze_get_objectROI(), (ze_rect{3, 4, 1, 2}));
}

TEST_F(objectsel, UpdateLooksAtEveryEdgeOfTheBox) {
    Picture mask(R"(
        .....
        ..#..
        .#.#.
        ..#..
        .....)");
    ze_set_objectROI({1, 3, 1, 3});
    ze_update_objectROI(mask.data(), 5, 5);
    EXPECT_EQ(ze_get_objectROI(), (ze_rect{1, 3, 1, 3}));
}

TEST_F(objectsel, UpdateClipsTheBoxToTheImage) {
    Picture mask(R"(
        .......
        ......#
        .#.....
        ...2...)");
    for (const ze_rect& roi :
         {ze_rect{-5, 12, -5, 9}, ze_rect{INT_MIN, INT_MAX, INT_MIN, INT_MAX}}) {
        ze_set_objectROI(roi);
        ze_update_objectROI(mask.data(), 7, 4);
        EXPECT_EQ(ze_get_objectROI(), (ze_rect{1, 6, 1, 2}));
    }
}

TEST_F(objectsel, UpdateFindsNothingInABoxWithoutSelectedPixels) {
    Picture mask = RING;
    const ze_rect boxes[] = {{2, 3, 2, 2},    // cleared
                             {5, 9, 0, 5},    // the selection lies outside
                             {3, 1, 0, 5},    // left behind right
                             {0, 9, 3, 1},    // top behind bottom
                             {10, 20, 0, 5},  // beyond the image
                             {-9, -1, 0, 5}, {0, 9, 6, 9}, {0, 9, -9, -1}};
    for (const ze_rect& box : boxes) {
        ze_set_objectROI(box);
        ze_update_objectROI(mask.data(), 10, 6);
        EXPECT_EQ(ze_get_objectROI(), (ze_rect{10, 0, 6, 0})) << box;
    }
}

TEST_F(objectsel, UpdateAfterInitFindsNothingWhateverTheMaskHolds) {
    ze_init_objectsel(5, 2);
    Picture mask(5, 2, 1);
    ze_update_objectROI(mask.data(), 5, 2);
    EXPECT_EQ(ze_get_objectROI(), (ze_rect{5, 0, 2, 0}));
}

TEST_F(objectsel, UpdateOfAnImageWithoutPixelsEmptiesTheBox) {
    const struct {
        int width, height;
    } sizes[] = {{0, 0}, {4, 0}, {0, 3}, {4, -3}, {-4, 3}, {INT_MIN, 1}, {1, INT_MIN}};
    for (const auto& s : sizes) {
        unsigned char beyond = 1;
        ze_set_objectROI({0, 9, 0, 9});
        ze_update_objectROI(&beyond, s.width, s.height);
        EXPECT_EQ(ze_get_objectROI(), (ze_rect{s.width, 0, s.height, 0}));
    }
}

#if UINTPTR_MAX > UINT32_MAX  // no room for it on 32-bit machines
TEST_F(objectsel, UpdateReachesTheFarCornerOfAHugeMask) {
    const int size = 50000;
    sparse_array<unsigned char> mask(2500000000ull);
    ASSERT_TRUE(mask.data()) << NO_ROOM;
    mask[2499999999ull] = 1;
    ze_set_objectROI({size - 3, size - 1, size - 3, size - 1});
    ze_update_objectROI(mask.data(), size, size);
    EXPECT_EQ(ze_get_objectROI(), (ze_rect{size - 1, size - 1, size - 1, size - 1}));
}
#endif

TEST_F(objectsel, ResetFillBoundaryTouchesOnlyThatRectangle) {
    g_object_boundary = {1, 2, 3, 4};
    ze_reset_fill_boundary(640, 480);
    EXPECT_EQ(g_fill_boundary, (ze_rect{639, 0, 479, 0}));
    EXPECT_EQ(g_object_boundary, (ze_rect{1, 2, 3, 4}));
    ze_reset_fill_boundary(0, -3);
    EXPECT_EQ(g_fill_boundary, (ze_rect{-1, 0, -4, 0}));
}
