#include <gtest/gtest.h>

#include <climits>

#include "selection/ER_selection.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"
#include "tests/helpers/sparse_memory.h"

namespace {

struct segment {
    int x0, y0, x1, y1;
};

segment reversed(const segment& s) { return {s.x1, s.y1, s.x0, s.y0}; }

// Draws one adding segment and returns the rect that it reports.
ze_rect add(Picture* mask, const segment& s) {
    ER_selection engine;
    ze_rect drawn = {mask->width, 0, mask->height, 0};
    engine.Lasso_Add(mask->data(), mask->width, mask->height, s.x0, s.y0, s.x1, s.y1, &drawn);
    return drawn;
}

ze_rect remove(Picture* mask, const segment& s) {
    ER_selection engine;
    ze_rect drawn = {mask->width, 0, mask->height, 0};
    engine.Lasso_Del(mask->data(), mask->width, mask->height, s.x0, s.y0, s.x1, s.y1, &drawn);
    return drawn;
}

// The segment drawn from either end gives this picture and rect.
void expect_segment(const segment& s, const char* drawing, const ze_rect& drawn) {
    const Picture expected(drawing);
    for (const segment& either : {s, reversed(s)}) {
        Picture mask(expected.width, expected.height, 0);
        EXPECT_EQ(add(&mask, either), drawn);
        EXPECT_EQ(mask, expected);
    }
}

}  // namespace

TEST(Lasso_Add, StepsAShallowSegmentAlongX) {
    // A step of 21845 / 65536 rounds to 0, 0, 1, 1.
    expect_segment({2, 2, 5, 3}, R"(
        ........
        ........
        ..##....
        ....##..
        ........)",
                   {2, 5, 2, 3});
}

TEST(Lasso_Add, StepsASteepSegmentAlongY) {
    expect_segment({2, 2, 3, 5}, R"(
        .....
        .....
        ..#..
        ..#..
        ...#.
        ...#.)",
                   {2, 3, 2, 5});
}

TEST(Lasso_Add, DrawsStraightLines) {
    expect_segment({1, 2, 4, 2}, R"(
        ......
        ......
        .####.
        ......)",
                   {1, 4, 2, 2});
    expect_segment({4, 0, 4, 3}, R"(
        ....#.
        ....#.
        ....#.
        ....#.)",
                   {4, 4, 0, 3});
}

TEST(Lasso_Add, DrawsDiagonals) {
    expect_segment({1, 0, 4, 3}, R"(
        .#....
        ..#...
        ...#..
        ....#.)",
                   {1, 4, 0, 3});
    expect_segment({4, 0, 1, 3}, R"(
        ....#.
        ...#..
        ..#...
        .#....)",
                   {1, 4, 0, 3});
}

TEST(Lasso_Add, RoundsHalvesTowardsHigherCoordinates) {
    expect_segment({0, 0, 2, 1}, R"(
        #..
        .##)",
                   {0, 2, 0, 1});
    expect_segment({0, 1, 2, 0}, R"(
        ..#
        ##.)",
                   {0, 2, 0, 1});
    expect_segment({0, 0, 1, 2}, R"(
        #.
        .#
        .#)",
                   {0, 1, 0, 2});
    expect_segment({1, 0, 0, 2}, R"(
        .#
        .#
        #.)",
                   {0, 1, 0, 2});
}

TEST(Lasso_Add, DrawsOnePixelFromAPointToItself) {
    expect_segment({2, 1, 2, 1}, R"(
        ....
        ..#.
        ....)",
                   {2, 2, 1, 1});
}

TEST(Lasso_Del, DrawsTheSamePixels) {
    const segment cases[] = {{2, 2, 5, 3}, {2, 2, 3, 5}, {0, 5, 7, 0}, {7, 5, 0, 5},
                             {4, 0, 4, 5}, {6, 1, 2, 5}, {3, 3, 3, 3}};
    for (const segment& s : cases) {
        Picture added(8, 6, 0);
        Picture removed(8, 6, 1);
        EXPECT_EQ(remove(&removed, s), add(&added, s));
        for (size_t i = 0; i < added.cells.size(); ++i) {
            EXPECT_EQ(removed.cells[i], added.cells[i] == 1 ? 4 : 1);
        }
    }
}

// ---- values

TEST(Lasso_Add, MakesOneOfZeroAndFiveOfAnythingElse) {
    Picture mask(".#23456789");
    mask.at(9, 0) = 255;
    add(&mask, {0, 0, 9, 0});
    EXPECT_EQ(mask, Picture("#555555555"));
}

TEST(Lasso_Del, MakesFourOfOneAndThreeOfAnythingElse) {
    Picture mask(".#23456789");
    mask.at(9, 0) = 255;
    remove(&mask, {0, 0, 9, 0});
    EXPECT_EQ(mask, Picture("3433333333"));
}

TEST(Lasso_Add, TurnsTheJointOfTwoSegmentsIntoFive) {
    Picture mask(5, 4, 0);
    add(&mask, {1, 1, 3, 1});
    add(&mask, {3, 1, 3, 3});
    EXPECT_EQ(mask, Picture(R"(
        .....
        .##5.
        ...#.
        ...#.)"));
}

TEST(Lasso_Del, TurnsTheJointOfTwoSegmentsIntoThree) {
    Picture mask(5, 4, 1);
    remove(&mask, {1, 1, 3, 1});
    remove(&mask, {3, 1, 3, 3});
    EXPECT_EQ(mask, Picture(R"(
        #####
        #443#
        ###4#
        ###4#)"));
}

// A repeated corner is a segment from a point to itself.
TEST(Lasso_Del, DrawsARepeatedCornerOnceMore) {
    Picture mask("#####");
    EXPECT_EQ(remove(&mask, {3, 0, 3, 0}), (ze_rect{3, 3, 0, 0}));
    EXPECT_EQ(mask, Picture("###4#"));
    EXPECT_EQ(remove(&mask, {3, 0, 3, 0}), (ze_rect{3, 3, 0, 0}));
    EXPECT_EQ(mask, Picture("###3#"));
    EXPECT_EQ(remove(&mask, {3, 0, 3, 0}), (ze_rect{3, 3, 0, 0}));
    EXPECT_EQ(mask, Picture("###3#"));

    // Between the two segments that it joins it changes nothing.
    remove(&mask, {0, 0, 1, 0});
    EXPECT_EQ(mask, Picture("44#3#"));
    remove(&mask, {1, 0, 1, 0});
    EXPECT_EQ(mask, Picture("43#3#"));
    remove(&mask, {1, 0, 2, 0});
    EXPECT_EQ(mask, Picture("4343#"));
}

TEST(Lasso_Add, DrawsARepeatedCornerOnceMore) {
    Picture mask(".....");
    for (const char* expected : {"...#.", "...5.", "...5."}) {
        EXPECT_EQ(add(&mask, {3, 0, 3, 0}), (ze_rect{3, 3, 0, 0}));
        EXPECT_EQ(mask, Picture(expected));
    }
}

TEST(Lasso_Add, WidensTheRectItIsGiven) {
    ER_selection engine;
    Picture mask(8, 6, 0);
    ze_rect drawn = {4, 5, 0, 1};
    engine.Lasso_Add(mask.data(), 8, 6, 1, 4, 2, 4, &drawn);
    EXPECT_EQ(drawn, (ze_rect{1, 5, 0, 4}));
    engine.Lasso_Del(mask.data(), 8, 6, 6, 4, 7, 4, &drawn);
    EXPECT_EQ(drawn, (ze_rect{1, 7, 0, 4}));
}

// ---- ends

TEST(Lasso_Add, ReachesTheCornersOfTheImage) {
    expect_segment({0, 0, 3, 3}, "#... .#.. ..#. ...#", {0, 3, 0, 3});
    expect_segment({3, 0, 0, 3}, "...# ..#. .#.. #...", {0, 3, 0, 3});
}

TEST(Lasso_Add, DrawsNothingWithAnEndOutsideTheImage) {
    const segment cases[] = {{-1, 2, 5, 2},      {8, 2, 5, 2},       {5, -1, 5, 2},
                             {5, 6, 5, 2},       {INT_MIN, 2, 5, 2}, {INT_MAX, 2, 5, 2},
                             {5, INT_MIN, 5, 2}, {5, INT_MAX, 5, 2}};
    for (const segment& s : cases) {
        for (const segment& either : {s, reversed(s)}) {
            Picture mask(8, 6, 0);
            EXPECT_EQ(add(&mask, either), (ze_rect{8, 0, 6, 0}));
            EXPECT_EQ(remove(&mask, either), (ze_rect{8, 0, 6, 0}));
            EXPECT_EQ(mask, Picture(8, 6, 0)) << s.x0 << ' ' << s.y0;
        }
    }
}

TEST(Lasso_Add, DrawsNothingIntoAnImageWithoutPixels) {
    ER_selection engine;
    ze_rect drawn = {8, 0, 6, 0};
    engine.Lasso_Add(nullptr, 0, 6, 0, 0, 0, 0, &drawn);
    engine.Lasso_Add(nullptr, 8, 0, 0, 0, 0, 0, &drawn);
    engine.Lasso_Del(nullptr, -8, -6, -1, -1, -1, -1, &drawn);
    EXPECT_EQ(drawn, (ze_rect{8, 0, 6, 0}));
}

// ---- long segments

TEST(Lasso_Add, WorksBeyondTheRangeOfFixedNumbers) {
    Picture mask(40001, 4, 0);
    // A step of -21845 / 65536 rounds to 0, 0, -1, -1.
    EXPECT_EQ(add(&mask, {40000, 0, 39999, 3}), (ze_rect{39999, 40000, 0, 3}));
    for (int y = 0; y < 4; ++y) {
        EXPECT_EQ(mask.at(40000, y), y < 2 ? 1 : 0) << y;
        EXPECT_EQ(mask.at(39999, y), y < 2 ? 0 : 1) << y;
    }
}

TEST(Lasso_Add, MayFallShortOfTheEndOfAVeryLongSegment) {
    // 3 * 65536 / 40000 is truncated to a step of 4; 40000 such steps come to 2.44.
    Picture mask(40001, 4, 0);
    EXPECT_EQ(add(&mask, {0, 0, 40000, 3}), (ze_rect{0, 40000, 0, 2}));
    EXPECT_EQ(mask.at(40000, 2), 1);
    EXPECT_EQ(mask.at(40000, 3), 0);
}

TEST(Lasso_Add, StepsADiagonalAlongXAndClampsWhatWrapsBelowZero) {
    // 32768 wraps to -32768.0, so that the step is -1.0.
    const int side = 32769;
    sparse_array<unsigned char> mask(static_cast<unsigned long long>(side) * side);
    ASSERT_TRUE(mask.data()) << NO_ROOM;
    ER_selection engine;
    ze_rect drawn = {side, 0, side, 0};

    engine.Lasso_Add(mask.data(), side, side, 0, 0, side - 1, side - 1, &drawn);

    EXPECT_EQ(drawn, (ze_rect{0, side - 1, 0, 0}));
    for (int x = 0; x < side; ++x) ASSERT_EQ(mask[static_cast<unsigned>(x)], 1) << x;
}

TEST(Lasso_Add, ClampsAShallowSegmentToTheHeight) {
    // From the last row upwards: -40000 wraps to 25536.
    const int width = 40002;
    const int height = 40001;
    sparse_array<unsigned char> mask(static_cast<unsigned long long>(width) * height);
    ASSERT_TRUE(mask.data()) << NO_ROOM;
    ER_selection engine;
    ze_rect drawn = {width, 0, height, 0};

    engine.Lasso_Add(mask.data(), width, height, 0, height - 1, width - 1, 0, &drawn);

    EXPECT_EQ(drawn, (ze_rect{0, width - 1, height - 1, height - 1}));
    const unsigned long long last_row = static_cast<unsigned long long>(width) * (height - 1);
    for (int x = 0; x < width; ++x) ASSERT_EQ(mask[last_row + static_cast<unsigned>(x)], 1) << x;
}

TEST(Lasso_Add, ClampsASteepSegmentToTheWidth) {
    // From the last column to the left.
    const int width = 40001;
    const int height = 40002;
    sparse_array<unsigned char> mask(static_cast<unsigned long long>(width) * height);
    ASSERT_TRUE(mask.data()) << NO_ROOM;
    ER_selection engine;
    ze_rect drawn = {width, 0, height, 0};

    engine.Lasso_Add(mask.data(), width, height, width - 1, 0, 0, height - 1, &drawn);

    EXPECT_EQ(drawn, (ze_rect{width - 1, width - 1, 0, height - 1}));
    for (int y = 0; y < height; ++y) {
        ASSERT_EQ(mask[static_cast<unsigned long long>(width) * y + width - 1], 1) << y;
    }
}
