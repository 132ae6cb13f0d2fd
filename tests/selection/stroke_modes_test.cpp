#include <gtest/gtest.h>

#include <climits>
#include <vector>

#include "selection/objectsel.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/pixels.h"
#include "tests/helpers/rect_printing.h"

namespace {

// A photo of which a stroke of the brush at (4, 4) takes the core only.
const Pixels BUMP(R"(
    aaaaaaaaaaaa
    aaaaaaaaaaaa
    aaaaaaaaaaaa
    aaabbbaaaaaa
    aaabbbaaaaaa
    aaabbbaaaaaa
    aaaaaaaaaaaa
    aaaaaaaaaaaa
    aaaaaaaaaaaa)");

// The session with an engine of radius 3 and core 1, for masks of 12 * 9.
class ze_modify_objectsel_modes : public testing::Test {
protected:
    ze_modify_objectsel_modes() {
        ze_set_brush_size(3, 1);
        ze_init_objectsel(12, 9);
    }
    ~ze_modify_objectsel_modes() override {
        ze_destroy_objectsel();
        g_Brush_Radius = 10;
        g_Brush_Center = 1;
        g_object_boundary = {0, 0, 0, 0};
    }

    // A stroke at (4, 4), of a lasso to (x2, y2). Returns the rect, which was garbage before.
    ze_rect stroke(int mode, Picture* mask, int fill, int x2 = 9, int y2 = 4) {
        return stroke_from(4, 4, mode, mask, fill, x2, y2);
    }

    ze_rect stroke_from(int x1, int y1, int mode, Picture* mask, int fill, int x2, int y2) {
        Pixels photo = BUMP;
        ze_rect rect = {-77, 77, -77, 77};
        ze_modify_objectsel(mode <= 1 ? photo.ints() : nullptr, mask->data(), mask->width,
                            mask->height, x1, y1, x2, y2, mode, &rect, fill);
        return rect;
    }
};

constexpr ze_rect EMPTY = {12, 0, 9, 0};
constexpr ze_rect WHOLE = {0, 11, 0, 8};
constexpr ze_rect FAR_CORNER = {10, 11, 7, 8};

// A ring that the filling passes close and the erasing pass, which keeps the last dot, removes.
const Picture RING_AND_DOTS(R"(
    ............
    ............
    ............
    ............
    ....#.......
    ............
    .........###
    .........#.#
    #........###)");

}  // namespace

// ---- what each mode does

TEST_F(ze_modify_objectsel_modes, DispatchEachToItsOwnOperation) {
    const struct {
        int mode;
        unsigned char before;
        const char* after;
        ze_rect rect;
    } cases[] = {
        {0,
         0,
         R"(
            ............
            ............
            ............
            ...###......
            ...###......
            ...###......
            ............
            ............
            ............)",
         {3, 5, 3, 5}},
        {1,
         1,
         R"(
            ############
            ############
            ############
            ###...######
            ###...######
            ###...######
            ############
            ############
            ############)",
         {3, 5, 3, 5}},
        {2,
         0,
         R"(
            ............
            ...###......
            ..#####.....
            .######.....
            .######.....
            .######.....
            ..#####.....
            ............
            ............)",
         {1, 6, 1, 6}},
        {3,
         1,
         R"(
            ############
            ###...######
            ##.....#####
            #......#####
            #......#####
            #......#####
            ##.....#####
            ############
            ############)",
         {1, 6, 1, 6}},
        {4,
         0,
         R"(
            ............
            ............
            ............
            ............
            ....######..
            ............
            ............
            ............
            ............)",
         {4, 9, 4, 4}},
        {5,
         1,
         R"(
            ############
            ############
            ############
            ############
            ####444444##
            ############
            ############
            ############
            ############)",
         {4, 9, 4, 4}},
    };
    for (const auto& c : cases) {
        Picture mask(12, 9, c.before);
        EXPECT_EQ(stroke(c.mode, &mask, 0), c.rect) << "mode " << c.mode;
        EXPECT_EQ(mask, Picture(c.after)) << "mode " << c.mode;
    }
}

TEST_F(ze_modify_objectsel_modes, TakeColumnAndRowOfTheFirstPoint) {
    ze_set_brush_size(1, 1);  // a core of one pixel, and nothing inner
    const struct {
        int mode;
        unsigned char before;
        ze_rect rect;
    } cases[] = {{0, 0, {8, 8, 2, 2}}, {1, 1, {8, 8, 2, 2}}, {2, 0, {7, 8, 1, 2}},
                 {3, 1, {7, 8, 1, 2}}, {4, 0, {8, 8, 2, 2}}, {5, 1, {8, 8, 2, 2}}};
    for (const auto& c : cases) {
        Picture wide(12, 9, c.before);
        EXPECT_EQ(stroke_from(8, 2, c.mode, &wide, 0, 8, 2), c.rect) << "mode " << c.mode;
        EXPECT_NE(wide.at(8, 2), c.before) << "mode " << c.mode;

        // The same six columns to the left and eight rows further down.
        Picture tall(5, 12, c.before);
        const ze_rect rect = {c.rect.left - 6, c.rect.right - 6, c.rect.top + 8, c.rect.bottom + 8};
        EXPECT_EQ(stroke_from(2, 10, c.mode, &tall, 0, 2, 10), rect) << "mode " << c.mode;
        EXPECT_NE(tall.at(2, 10), c.before) << "mode " << c.mode;
    }
}

TEST_F(ze_modify_objectsel_modes, ReadTheSecondPointForLassosOnly) {
    for (const int mode : {0, 1, 2, 3}) {
        Picture here(12, 9, mode % 2);
        Picture there = here;
        EXPECT_EQ(stroke(mode, &here, 0, 0, 0), stroke(mode, &there, 0, INT_MIN, INT_MAX)) << mode;
        EXPECT_EQ(here, there) << mode;
    }
    for (const int mode : {4, 5}) {
        Picture mask(12, 9, 0);
        EXPECT_EQ(stroke(mode, &mask, 0, 4, 6), (ze_rect{4, 4, 4, 6})) << mode;
    }
}

TEST_F(ze_modify_objectsel_modes, DoNothingWhenUnknown) {
    for (const int mode : {6, -1, 7, INT_MAX, INT_MIN}) {
        g_object_boundary = {20, -3, 20, -3};  // not even an empty rect is merged
        Picture mask = RING_AND_DOTS;
        EXPECT_EQ(stroke(mode, &mask, 1), EMPTY) << mode;
        EXPECT_EQ(mask, RING_AND_DOTS) << mode;
        EXPECT_EQ(g_object_boundary, (ze_rect{20, -3, 20, -3})) << mode;
    }
}

TEST_F(ze_modify_objectsel_modes, DoNothingWithoutAnEngine) {
    ze_destroy_objectsel();
    for (int mode = -1; mode <= 6; ++mode) {
        g_object_boundary = WHOLE;
        Picture mask = RING_AND_DOTS;
        EXPECT_EQ(stroke(mode, &mask, 1), EMPTY) << mode;
        EXPECT_EQ(mask, RING_AND_DOTS) << mode;
        EXPECT_EQ(g_object_boundary, WHOLE) << mode;
    }
}

// ---- the object box

TEST_F(ze_modify_objectsel_modes, WidenTheObjectBoxUnlessTheyShrinkOrErase) {
    const struct {
        int mode;
        unsigned char before;
        ze_rect box;
    } cases[] = {
        {0, 0, {3, 11, 3, 8}}, {1, 1, FAR_CORNER},    {2, 0, {1, 11, 1, 8}},
        {3, 1, FAR_CORNER},    {4, 0, {4, 11, 4, 8}}, {5, 1, {4, 11, 4, 8}},
    };
    for (const auto& c : cases) {
        g_object_boundary = FAR_CORNER;
        Picture mask(12, 9, c.before);
        stroke(c.mode, &mask, 0);
        EXPECT_EQ(g_object_boundary, c.box) << "mode " << c.mode;
    }
}

TEST_F(ze_modify_objectsel_modes, BeginTheObjectBoxWithTheFirstStroke) {
    for (const int mode : {0, 2, 4, 5}) {
        ze_init_objectsel(12, 9);
        ASSERT_EQ(g_object_boundary, (ze_rect{11, 0, 8, 0}));
        Picture mask(12, 9, 0);
        const ze_rect rect = stroke(mode, &mask, 0);
        EXPECT_EQ(g_object_boundary, rect) << "mode " << mode;
    }
}

TEST_F(ze_modify_objectsel_modes, GiveTheObjectBoxTheRectOfAGrowingStroke) {
    ze_set_brush_size(10, 1);
    ze_init_objectsel(640, 480);
    EXPECT_EQ(g_object_boundary, (ze_rect{639, 0, 479, 0}));
    std::vector<int> photo(640 * 480);
    Picture mask(640, 480, 1);  // so that the whole square of the brush is reported
    ze_rect rect;

    ze_modify_objectsel(photo.data(), mask.data(), 640, 480, 110, 60, 0, 0, 0, &rect, 0);

    EXPECT_EQ(rect, (ze_rect{100, 120, 50, 70}));
    EXPECT_EQ(g_object_boundary, (ze_rect{100, 120, 50, 70}));
}

TEST_F(ze_modify_objectsel_modes, LeaveTheObjectBoxWhenTheyChangeNothing) {
    for (const ze_rect& box : {ze_rect{11, 0, 8, 0}, ze_rect{12, 0, 9, 0}, ze_rect{2, 5, 3, 4}}) {
        g_object_boundary = box;
        Picture mask(12, 9, 1);
        EXPECT_EQ(stroke(2, &mask, 0), EMPTY);
        EXPECT_EQ(stroke_from(0, 0, 0, &mask, 0, 0, 0), EMPTY);  // no growing from the edge
        EXPECT_EQ(stroke(4, &mask, 0, 12, 4), EMPTY);            // an end outside the image
        EXPECT_EQ(stroke(5, &mask, 0, 4, -1), EMPTY);
        EXPECT_EQ(g_object_boundary, box);
    }
}

TEST_F(ze_modify_objectsel_modes, LeaveTheObjectBoxWhenErasingTakesEveryPixel) {
    Picture mask(12, 9, 0);
    mask.at(4, 4) = 1;
    g_object_boundary = {4, 4, 4, 4};

    EXPECT_EQ(stroke(3, &mask, 1), (ze_rect{4, 4, 4, 4}));

    EXPECT_EQ(mask, Picture(12, 9, 0));
    EXPECT_EQ(g_object_boundary, (ze_rect{4, 4, 4, 4}));
}

// ---- passes

TEST_F(ze_modify_objectsel_modes, RunNoPassUnlessFillIsOne) {
    for (const int fill : {0, 2, -1, 256 + 1, INT_MAX, INT_MIN}) {
        for (int mode = 0; mode <= 5; ++mode) {
            ze_set_objectROI(WHOLE);
            Picture mask = RING_AND_DOTS;
            stroke(mode, &mask, fill);
            EXPECT_EQ(mask.at(10, 7), 0) << "mode " << mode << " fill " << fill;
            EXPECT_EQ(mask.at(9, 6), 1) << "mode " << mode << " fill " << fill;
            if (mode == 5) {
                EXPECT_EQ(mask.at(5, 4), 3) << "fill " << fill;
            }
        }
    }
}

TEST_F(ze_modify_objectsel_modes, FillHolesAndReportThemAfterGrowing) {
    ze_set_objectROI({9, 11, 6, 8});
    Picture mask = RING_AND_DOTS;

    EXPECT_EQ(stroke(0, &mask, 1), (ze_rect{3, 10, 3, 7}));

    EXPECT_EQ(mask, Picture(R"(
        ............
        ............
        ............
        ...###......
        ...###......
        ...###......
        .........###
        .........###
        #........###)"));
    EXPECT_EQ(g_object_boundary, (ze_rect{3, 11, 3, 8}));
}

TEST_F(ze_modify_objectsel_modes, FillHolesAndReportThemAfterPainting) {
    ze_set_objectROI({9, 11, 6, 8});
    Picture mask = RING_AND_DOTS;

    EXPECT_EQ(stroke(2, &mask, 1), (ze_rect{1, 10, 1, 7}));

    EXPECT_EQ(mask.at(10, 7), 1);
    EXPECT_EQ(g_object_boundary, (ze_rect{1, 11, 1, 8}));
}

TEST_F(ze_modify_objectsel_modes, FillWithinTheObjectBoxOnly) {
    // The box of the stroke alone: the ring lies outside.
    for (const int mode : {0, 2, 4}) {
        ze_init_objectsel(12, 9);
        Picture mask = RING_AND_DOTS;
        stroke(mode, &mask, 1);
        EXPECT_EQ(mask.at(10, 7), 0) << "mode " << mode;
    }
}

TEST_F(ze_modify_objectsel_modes, FillTheObjectBoxAsTheStrokeHasWidenedIt) {
    ze_set_objectROI({2, 6, 3, 4});
    Picture mask(R"(
        ............
        ............
        ............
        ..5###5.....
        ..#...#.....
        ............
        ............
        ............
        ............)");

    EXPECT_EQ(stroke_from(2, 5, 4, &mask, 1, 6, 5), (ze_rect{2, 6, 5, 5}));

    EXPECT_EQ(mask, Picture(R"(
        ............
        ............
        ............
        ..#####.....
        ..#####.....
        ..#####.....
        ............
        ............
        ............)"));
}

TEST_F(ze_modify_objectsel_modes, KeepTheLargestRegionAfterShrinking) {
    ze_set_objectROI({0, 10, 1, 8});
    Picture mask(R"(
        ............
        ..........#.
        .######.....
        .######..###
        .######..###
        .######..###
        .######.....
        ............
        #...........)");

    // The core's pixels, then what the pass erases.
    EXPECT_EQ(stroke(1, &mask, 1), (ze_rect{0, 10, 1, 8}));

    // The hole stays: nothing is filled. So does what lies outside the object box.
    EXPECT_EQ(mask, Picture(R"(
        ............
        ............
        .######.....
        .##...#....#
        .##...#....#
        .##...#....#
        .######.....
        ............
        ............)"));
    EXPECT_EQ(g_object_boundary, (ze_rect{1, 6, 2, 6}));
}

TEST_F(ze_modify_objectsel_modes, EmptyAnObjectBoxThatWasNeverWidenedAfterShrinking) {
    Picture mask(12, 9, 1);
    EXPECT_EQ(stroke(1, &mask, 1), (ze_rect{3, 5, 3, 5}));
    EXPECT_EQ(g_object_boundary, EMPTY);
}

TEST_F(ze_modify_objectsel_modes, RunNoPassAfterErasing) {
    ze_set_objectROI(WHOLE);
    Picture mask = RING_AND_DOTS;

    EXPECT_EQ(stroke(3, &mask, 1), (ze_rect{4, 4, 4, 4}));

    Picture expected = RING_AND_DOTS;
    expected.at(4, 4) = 0;
    EXPECT_EQ(mask, expected);
    EXPECT_EQ(g_object_boundary, WHOLE);
}

TEST_F(ze_modify_objectsel_modes, FillAnAddingLassoWithTheSegmentThatClosesIt) {
    Picture mask(12, 9, 0);
    EXPECT_EQ(stroke_from(2, 1, 4, &mask, 0, 8, 1), (ze_rect{2, 8, 1, 1}));
    EXPECT_EQ(stroke_from(8, 1, 4, &mask, 0, 5, 4), (ze_rect{5, 8, 1, 4}));
    ASSERT_EQ(mask, Picture(R"(
        ............
        ..######5...
        .......#....
        ......#.....
        .....#......
        ............
        ............
        ............
        ............)"));

    // The rect is that of the segment, not of the fill.
    EXPECT_EQ(stroke_from(5, 4, 4, &mask, 1, 2, 1), (ze_rect{2, 5, 1, 4}));

    EXPECT_EQ(mask, Picture(R"(
        ............
        ..#######...
        ...#####....
        ....###.....
        .....#......
        ............
        ............
        ............
        ............)"));
    EXPECT_EQ(g_object_boundary, (ze_rect{2, 8, 1, 4}));
}

TEST_F(ze_modify_objectsel_modes, ClearARemovingLassoWithTheSegmentThatClosesIt) {
    ze_set_objectROI({4, 5, 2, 3});
    Picture mask(12, 9, 1);
    EXPECT_EQ(stroke_from(2, 1, 5, &mask, 0, 8, 1), (ze_rect{2, 8, 1, 1}));
    EXPECT_EQ(stroke_from(8, 1, 5, &mask, 0, 5, 4), (ze_rect{5, 8, 1, 4}));

    EXPECT_EQ(stroke_from(5, 4, 5, &mask, 1, 2, 1), (ze_rect{2, 5, 1, 4}));

    EXPECT_EQ(mask, Picture(R"(
        ############
        ##.......###
        ###.....####
        ####...#####
        #####.######
        ############
        ############
        ############
        ############)"));
    EXPECT_EQ(g_object_boundary, (ze_rect{2, 8, 1, 4}));
}

TEST_F(ze_modify_objectsel_modes, RunThePassWhenTheStrokeItselfDoesNothing) {
    const struct {
        int mode, x1, y1, x2, y2;
    } cases[] = {{0, 0, 0, 0, 0}, {2, -50, 0, 0, 0}, {4, 0, 0, 12, 0}};
    for (const auto& c : cases) {
        ze_set_objectROI(WHOLE);
        Picture mask = RING_AND_DOTS;
        stroke_from(c.x1, c.y1, c.mode, &mask, 1, c.x2, c.y2);
        EXPECT_EQ(mask.at(10, 7), 1) << "mode " << c.mode;
    }

    ze_set_objectROI(WHOLE);
    Picture mask = RING_AND_DOTS;
    EXPECT_EQ(stroke_from(1, 1, 1, &mask, 1, 0, 0), (ze_rect{4, 11, 4, 8}));  // not selected there
    EXPECT_EQ(mask.at(4, 4), 0);
    EXPECT_EQ(g_object_boundary, (ze_rect{0, 0, 8, 8}));

    ze_set_objectROI(WHOLE);
    Picture outline(12, 9, 3);
    EXPECT_EQ(stroke_from(0, 0, 5, &outline, 1, 0, 9), EMPTY);
    EXPECT_EQ(outline, Picture(12, 9, 0));
}
