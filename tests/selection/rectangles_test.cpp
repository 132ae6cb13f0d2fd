#include "selection/rectangles.h"

#include <gtest/gtest.h>

#include <climits>

#include "tests/helpers/rect_printing.h"

TEST(ze_rect, ListsLeftRightTopBottom) {
    const ze_rect r = {1, 2, 3, 4};
    EXPECT_EQ(r.left, 1);
    EXPECT_EQ(r.right, 2);
    EXPECT_EQ(r.top, 3);
    EXPECT_EQ(r.bottom, 4);
}

TEST(ze_rect, HasTwoEmptyForms) {
    EXPECT_EQ(empty_at_last_pixel(640, 480), (ze_rect{639, 0, 479, 0}));
    EXPECT_EQ(empty_beyond_image(640, 480), (ze_rect{640, 0, 480, 0}));
}

TEST(ze_rect, TakesSizesOfZeroAndBelowForItsEmptyForms) {
    EXPECT_EQ(empty_at_last_pixel(0, -3), (ze_rect{-1, 0, -4, 0}));
    EXPECT_EQ(empty_at_last_pixel(INT_MIN, 1), (ze_rect{INT_MAX, 0, 0, 0}));
    EXPECT_EQ(empty_beyond_image(0, -3), (ze_rect{0, 0, -3, 0}));
}

TEST(unite, TakesTheOuterEdgesSideBySide) {
    ze_rect r = {10, 20, 30, 40};
    unite(&r, {5, 15, 35, 45});
    EXPECT_EQ(r, (ze_rect{5, 20, 30, 45}));
    unite(&r, {6, 25, 25, 44});
    EXPECT_EQ(r, (ze_rect{5, 25, 25, 45}));
}

TEST(unite, ComparesSignedAndAsksNoOrder) {
    ze_rect r = {3, -3, 2, -2};
    unite(&r, {-1, -5, INT_MAX, INT_MIN});
    EXPECT_EQ(r, (ze_rect{-1, -3, 2, -2}));
}

TEST(unite, ReplacesAnEmptyFormByWhatComesFirst) {
    for (ze_rect r : {empty_at_last_pixel(8, 6), empty_beyond_image(8, 6)}) {
        unite(&r, {2, 5, 1, 4});
        EXPECT_EQ(r, (ze_rect{2, 5, 1, 4}));
    }
}

TEST(unite, IsLeftAloneByAnEmptyStroke) {
    ze_rect box = {8, 8, 6, 6};
    unite(&box, empty_beyond_image(8, 6));
    EXPECT_EQ(box, (ze_rect{8, 8, 6, 6}));
}

TEST(include, WidensByOnePixel) {
    ze_rect r = empty_beyond_image(8, 6);
    include(&r, 7, 2);
    EXPECT_EQ(r, (ze_rect{7, 7, 2, 2}));
    include(&r, 3, 5);
    EXPECT_EQ(r, (ze_rect{3, 7, 2, 5}));
}

TEST(clip_to_image, KeepsThePartInside) {
    EXPECT_EQ(clip_to_image({1, 6, 2, 4}, 8, 6), (ze_rect{1, 6, 2, 4}));
    EXPECT_EQ(clip_to_image({-5, 13, -5, 11}, 8, 6), (ze_rect{0, 7, 0, 5}));
    EXPECT_EQ(clip_to_image({INT_MIN, INT_MAX, INT_MIN, INT_MAX}, 8, 6), (ze_rect{0, 7, 0, 5}));
}

TEST(clip_to_image, IsEmptyWhereNothingLiesInside) {
    const auto has_pixels = [](const ze_rect& r) { return r.left <= r.right && r.top <= r.bottom; };
    EXPECT_TRUE(has_pixels(clip_to_image({7, 7, 5, 5}, 8, 6)));
    EXPECT_FALSE(has_pixels(clip_to_image({8, 9, 0, 5}, 8, 6)));
    EXPECT_FALSE(has_pixels(clip_to_image({-2, -1, 0, 5}, 8, 6)));
    EXPECT_FALSE(has_pixels(clip_to_image({0, 7, 6, 9}, 8, 6)));
    EXPECT_FALSE(has_pixels(clip_to_image({0, 7, -2, -1}, 8, 6)));
    EXPECT_FALSE(has_pixels(clip_to_image({0, 0, 0, 0}, 0, 6)));
    EXPECT_FALSE(has_pixels(clip_to_image({INT_MIN, INT_MAX, INT_MIN, INT_MAX}, INT_MIN, 6)));
}
