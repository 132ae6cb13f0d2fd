#include "selection/contour_tracer.h"

#include <gtest/gtest.h>

#include "tests/helpers/failing_allocations.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"

namespace {

constexpr unsigned char VISITED = 2;
const value_set SELECTED(1, VISITED);

bool marked(const marker_buffer& markers, int x, int y) { return markers.on_left_of(x + 1, y); }

// The markers on the pixels of an image, as a picture of 5s.
Picture marked_pixels(const marker_buffer& markers, int width, int height) {
    Picture drawn(width, height, 0);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            if (marked(markers, x, y)) drawn.at(x, y) = BACKGROUND_MARKER;
        }
    }
    return drawn;
}

// One trace in a picture of its own, from (x, y).
struct traced {
    traced(const Picture& drawing, int x, int y, const ze_rect& box, value_set region = SELECTED)
        : mask(drawing), markers(drawing.width, drawing.height) {
        region_mask view(mask.data(), mask.width, mask.height, box);
        trace_contour(&view, &markers, x, y, region, VISITED);
        contours = view.contours;
    }
    traced(const Picture& drawing, int x, int y)
        : traced(drawing, x, y, {0, drawing.width - 1, 0, drawing.height - 1}) {}

    Picture marks() const { return marked_pixels(markers, mask.width, mask.height); }

    Picture mask;
    marker_buffer markers;
    ze_rect contours;
};

}  // namespace

TEST(value_set, HoldsItsValuesAndNoOthers) {
    const value_set s(1, 5, 31);
    for (int v = 0; v < 256; ++v) {
        EXPECT_EQ(s.has(static_cast<unsigned char>(v)), v == 1 || v == 5 || v == 31) << v;
    }
    EXPECT_FALSE(value_set().has(0));
    EXPECT_TRUE(value_set(0).has(0));
    EXPECT_FALSE(value_set(0).has(32));
}

// ---- markers

TEST(marker_buffer, StartsWithoutMarkers) {
    const marker_buffer markers(4, 3);
    ASSERT_TRUE(markers);
    for (int y = -1; y <= 3; ++y) {
        for (int x = -1; x <= 4; ++x) EXPECT_FALSE(marked(markers, x, y)) << x << ", " << y;
    }
}

TEST(marker_buffer, IsSeenFromBothSides) {
    marker_buffer markers(6, 3);
    markers.set(2, 1);
    for (int x = 0; x < 6; ++x) {
        EXPECT_EQ(markers.on_left_of(x, 1), x == 3) << x;
        EXPECT_EQ(markers.on_right_of(x, 1), x == 1) << x;
        EXPECT_FALSE(markers.on_left_of(x, 2)) << x;
    }
}

TEST(marker_buffer, SharesABytePastEitherEndOfARow) {
    // Left of a row is the end of the row above ...
    marker_buffer left(4, 3);
    left.set(-1, 1);
    EXPECT_TRUE(marked(left, 3, 0));
    EXPECT_TRUE(left.on_left_of(0, 1));
    EXPECT_TRUE(left.on_right_of(2, 0));

    // ... and right of a row the start of the row below, from the row above the image on.
    marker_buffer right(4, 3);
    right.set(4, -1);
    right.set(0, 2);
    EXPECT_TRUE(marked(right, 0, 0));
    EXPECT_TRUE(right.on_right_of(3, 1));
    EXPECT_FALSE(marked(right, 0, 1));
}

TEST(marker_buffer, HasRoomOnePixelBeyondEveryEdge) {
    marker_buffer markers(2, 2);
    for (int y = -1; y <= 2; ++y) {
        for (int x = -1; x <= 2; ++x) {
            markers.set(x, y);
            EXPECT_TRUE(marked(markers, x, y)) << x << ", " << y;
        }
    }
    markers.clear();
    for (int y = -1; y <= 2; ++y) {
        for (int x = -1; x <= 2; ++x) EXPECT_FALSE(marked(markers, x, y)) << x << ", " << y;
    }
}

TEST(marker_buffer, IsFalseWithoutMemory) {
    failing_allocations out_of_memory(1);
    EXPECT_FALSE(marker_buffer(4, 3));
    EXPECT_EQ(out_of_memory.asked(), 1);
}

// ---- traces

TEST(trace_contour, VisitsTheContourAndMarksTheBackgroundStraightBesideIt) {
    const traced t(Picture(R"(
        .......
        .......
        ..###..
        ..###..
        ..###..
        .......
        .......)"),
                   2, 2);

    EXPECT_EQ(t.mask, Picture(R"(
        .......
        .......
        ..222..
        ..2#2..
        ..222..
        .......
        .......)"));
    EXPECT_EQ(t.marks(), Picture(R"(
        .......
        ..555..
        .5...5.
        .5...5.
        .5...5.
        ..555..
        .......)"));
    EXPECT_EQ(t.contours, (ze_rect{2, 4, 2, 4}));
}

TEST(trace_contour, LeavesHolesUnmarked) {
    const traced t(Picture(R"(
        ......
        .####.
        .#..#.
        .####.
        ......)"),
                   1, 1);

    EXPECT_EQ(t.marks(), Picture(R"(
        .5555.
        5....5
        5....5
        5....5
        .5555.)"));
}

TEST(trace_contour, TakesDiagonalNeighboursForConnected) {
    const traced t(Picture(R"(
        .....
        ..#..
        .#.#.
        ..#..
        .....)"),
                   2, 1);

    EXPECT_EQ(t.mask, Picture(R"(
        .....
        ..2..
        .2.2.
        ..2..
        .....)"));
    EXPECT_EQ(t.marks(), Picture(R"(
        ..5..
        .5.5.
        5...5
        .5.5.
        ..5..)"));
}

TEST(trace_contour, AddsNothingForARegionOfOnePixel) {
    const traced t(Picture(R"(
        .....
        ..#..
        .....)"),
                   2, 1);

    EXPECT_EQ(t.contours, (ze_rect{5, -1, 3, -1}));
    EXPECT_EQ(t.mask.at(2, 1), VISITED);
    EXPECT_EQ(t.marks(), Picture(R"(
        ..5..
        .5.5.
        ..5..)"));
}

TEST(trace_contour, LeavesItsStartOutOfTheContourBox) {
    const traced t(Picture(R"(
        .....
        .###.
        .....)"),
                   1, 1);
    EXPECT_EQ(t.mask, Picture("..... .222. ....."));
    EXPECT_EQ(t.contours, (ze_rect{2, 3, 1, 1}));
}

TEST(trace_contour, EndsWhenTheStartIsFirstLookedAtAgain) {
    // The right leg is walked down and up; from its top the start comes into view.
    const traced t(Picture(R"(
        .......
        ...#...
        ..#.#..
        .#...#.
        .......)"),
                   3, 1);

    EXPECT_EQ(t.mask, Picture(R"(
        .......
        ...2...
        ..#.2..
        .#...2.
        .......)"));
    EXPECT_EQ(t.contours, (ze_rect{4, 5, 2, 3}));
    EXPECT_EQ(t.marks(), Picture(R"(
        ...5...
        ..5.5..
        ...5.5.
        ....5.5
        .....5.)"));
}

TEST(trace_contour, LooksToTheLeftFirst) {
    // From the second pixel the visited first one is on the left and in view at once; nothing else
    // is looked at.
    Picture mask("..... .2##. .....");
    const traced t(mask, 2, 1);
    EXPECT_EQ(t.contours.left, 1);
    EXPECT_EQ(t.contours.right, 1);
    EXPECT_EQ(t.mask, Picture("..... .22#. ....."));
}

TEST(trace_contour, TakesEverythingBeyondTheBoxForBackground) {
    const traced t(Picture(R"(
        ######
        ######
        ######
        ######)"),
                   1, 1, {1, 3, 1, 2});

    EXPECT_EQ(t.mask, Picture(R"(
        ######
        #222##
        #222##
        ######)"));
    EXPECT_EQ(t.marks(), Picture(R"(
        .555..
        5...5.
        5...5.
        .555..)"));
}

TEST(trace_contour, MarksBeyondTheImagesEdges) {
    const traced t(Picture("## ##"), 0, 0);
    for (int i = 0; i < 2; ++i) {
        EXPECT_TRUE(marked(t.markers, i, -1)) << i;
        EXPECT_TRUE(marked(t.markers, -1, i)) << i;
        EXPECT_TRUE(marked(t.markers, 2, i)) << i;
        EXPECT_TRUE(marked(t.markers, i, 2)) << i;
    }
}

TEST(trace_contour, FollowsTheValuesOfItsRegion) {
    const traced t(Picture(R"(
        ......
        .34#5.
        ......)"),
                   1, 1, {0, 5, 0, 2}, value_set(3, 4, VISITED));
    EXPECT_EQ(t.mask, Picture(R"(
        ......
        .22#5.
        ......)"));
    EXPECT_TRUE(marked(t.markers, 3, 1));
}
