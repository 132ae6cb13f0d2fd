// The passes on regions against their plain definitions, on random masks.

#include "selection/region_plain.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>

#include "selection/region_shaping.h"
#include "tests/helpers/failing_allocations.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/random_numbers.h"
#include "tests/helpers/rect_printing.h"

namespace {

void draw_rectangle(Picture* mask, int left, int top, int width, int height, bool hollow,
                    unsigned char value) {
    for (int y = top; y < std::min(top + height, mask->height); ++y) {
        for (int x = left; x < std::min(left + width, mask->width); ++x) {
            const bool edge =
                x == left || y == top || x == left + width - 1 || y == top + height - 1;
            if (edge || !hollow) mask->at(x, y) = value;
        }
    }
}

// Noise, rectangles and rings, a diagonal that widens every box, a grid, squares in squares.
Picture random_mask(random_numbers& random) {
    // Rows of one word and of several, and images so narrow that their sides share markers.
    const int largest = random.one_in(3) ? 150 : random.one_in(2) ? 30 : 5;
    const int width = random.between(1, largest);
    const int height = random.between(1, random.one_in(2) ? largest : 12);
    Picture mask(width, height, 0);
    const int kind = random.between(0, 4), share = random.between(1, 99),
              step = random.between(2, 5);
    if (kind == 1) {
        for (int count = random.between(1, 25); count > 0; --count) {
            const int left = random.between(0, width - 1), top = random.between(0, height - 1);
            const int across = random.between(1, 1 + width / 3);
            const int down = random.between(1, 1 + height / 3);
            const bool hollow = random.one_in(3);
            draw_rectangle(&mask, left, top, across, down, hollow, !random.one_in(4));
        }
        return mask;
    }
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            const int from_centre = std::max(std::abs(x - width / 2), std::abs(y - height / 2));
            const bool drawn = kind == 0   ? random.between(0, 99) < share
                               : kind == 2 ? x * height / width == y && !random.one_in(5)
                               : kind == 3 ? x % step == 0 && (y % step == 0 || random.one_in(4))
                                           : from_centre % 3 == 0 && !random.one_in(30);
            mask.at(x, y) = drawn;
        }
    }
    return mask;
}

void sprinkle(random_numbers& random, Picture* mask, std::initializer_list<int> values) {
    for (unsigned char& pixel : mask->cells) {
        const int of = static_cast<int>(values.size());
        if (random.one_in(8))
            pixel = static_cast<unsigned char>(values.begin()[random.between(0, of - 1)]);
    }
}

ze_rect random_box(random_numbers& random, const Picture& mask) {
    if (random.one_in(2)) return {0, mask.width - 1, 0, mask.height - 1};
    return {random.between(-2, mask.width), random.between(-2, mask.width + 2),
            random.between(-2, mask.height), random.between(-2, mask.height + 2)};
}

struct outcome {
    Picture mask;
    ze_rect rect;
    ze_rect boundary;
    int result;
};

bool operator==(const outcome& a, const outcome& b) {
    return a.mask == b.mask && a.rect == b.rect && a.boundary == b.boundary && a.result == b.result;
}

std::ostream& operator<<(std::ostream& out, const outcome& o) {
    return out << o.mask << "\nrect " << ::testing::PrintToString(o.rect) << ", boundary "
               << ::testing::PrintToString(o.boundary) << ", result " << o.result;
}

// Runs `run(random mask, box)`, given both versions of a pass, on many masks.
template <class Pass, class Run>
void expect_equal(Pass pass, Pass plain_pass, std::initializer_list<int> values, Run run) {
    for (unsigned seed = 1; seed <= 1500; ++seed) {
        random_numbers random(seed);
        Picture mask = random_mask(random);
        if (random.one_in(2)) sprinkle(random, &mask, values);
        const ze_rect box = random_box(random, mask);
        const auto outcome_of = [&](Pass version) {
            outcome o = {mask, {mask.width, 0, mask.height, 0}, box, 0};
            run(version, &o);
            return o;
        };
        ASSERT_EQ(outcome_of(pass), outcome_of(plain_pass))
            << "seed " << seed << ", box " << ::testing::PrintToString(box) << ", mask " << mask;
    }
}

void run_fill(decltype(&Fill_Region) pass, outcome* o) {
    pass(o->mask.data(), o->mask.width, o->mask.height, o->boundary.left, o->boundary.right,
         o->boundary.top, o->boundary.bottom, &o->rect);
}

void run_erase(decltype(&Erase_Region) pass, outcome* o) {
    pass(o->mask.data(), o->mask.width, o->mask.height, &o->boundary, &o->rect);
}

void run_lasso(decltype(&ze_lasso_add_fill_mask) pass, outcome* o) {
    o->result = pass(o->mask.data(), o->mask.width, o->mask.height, o->boundary.left,
                     o->boundary.right, o->boundary.top, o->boundary.bottom);
}

}  // namespace

TEST(RegionPasses, FillLikeThePlainPass) {
    expect_equal(&Fill_Region, &plain::Fill_Region, {0, 1, 2, 3, 5, 200}, run_fill);
}

TEST(RegionPasses, EraseLikeThePlainPass) {
    expect_equal(&Erase_Region, &plain::Erase_Region, {0, 1, 2, 3, 5, 200}, run_erase);
}

TEST(RegionPasses, FillAnAddingLassoLikeThePlainPass) {
    expect_equal(&ze_lasso_add_fill_mask, &plain::ze_lasso_add_fill_mask, {0, 1, 2, 5, 5},
                 run_lasso);
}

TEST(RegionPasses, FillARemovingLassoLikeThePlainPass) {
    expect_equal(&ze_lasso_del_fill_mask, &plain::ze_lasso_del_fill_mask, {0, 1, 2, 3, 3, 4, 4, 3},
                 run_lasso);
}

// Rows of more than 64 words, for whose sets of words one word is not enough.
// Contours on the last column are seen beside the first, so a pixel that an earlier row left on the
// far side begins an inside once a later region widens the area to it.
TEST(RegionPasses, GoBackToEarlierRowsWhenTheAreaGetsWider) {
    const Picture drawn(R"(
        ...............................................................#
        ...............................................................#
        ..........................................................#.2...
        ...............................................................#
        ....................................................##.........#)");
    Picture mask = drawn, plain_mask = drawn;
    ze_rect rect = {64, 0, 5, 0}, plain_rect = rect;
    Fill_Region(mask.data(), 64, 5, 0, 63, 0, 4, &rect);
    plain::Fill_Region(plain_mask.data(), 64, 5, 0, 63, 0, 4, &plain_rect);
    EXPECT_EQ(mask, plain_mask);
    EXPECT_EQ(rect, plain_rect);
    EXPECT_FALSE(mask == drawn);
}

TEST(RegionPasses, WorkOnRowsOfThousandsOfPixels) {
    for (const int width : {4030, 4096, 9000}) {
        Picture mask(width, 7, 0);
        for (int x = 3; x < width; x += 97) draw_rectangle(&mask, x, 1, 60 + x % 31, 5, true, 1);
        draw_rectangle(&mask, width - 200, 0, 190, 7, true, 1);
        outcome filled = {mask, {width, 0, 7, 0}, {0, width - 1, 0, 6}, 0};
        outcome plainly_filled = filled, erased = filled, plainly_erased = filled;
        run_fill(&Fill_Region, &filled);
        run_fill(&plain::Fill_Region, &plainly_filled);
        EXPECT_TRUE(filled == plainly_filled) << width;
        run_erase(&Erase_Region, &erased);
        run_erase(&plain::Erase_Region, &plainly_erased);
        EXPECT_TRUE(erased == plainly_erased) << width;
    }
}

TEST(PlainRegionPasses, DoNothingWithoutAWorkBuffer) {
    const Picture ring("5#5 #.# 5#5");
    const outcome before = {ring, {3, 0, 3, 0}, {0, 2, 0, 2}, 7};
    outcome filled = before, erased = before, lassoed = before;
    const failing_allocations out_of_memory(1, failing_allocations::FROM_THEN_ON);
    run_fill(&plain::Fill_Region, &filled);
    EXPECT_EQ(filled, before);
    run_erase(&plain::Erase_Region, &erased);
    EXPECT_EQ(erased, (outcome{ring, {3, 0, 3, 0}, {3, 0, 3, 0}, 7}));
    run_lasso(&plain::ze_lasso_add_fill_mask, &lassoed);
    EXPECT_EQ(lassoed, (outcome{ring, {3, 0, 3, 0}, {0, 2, 0, 2}, 0}));
}

// Their buffer would have (width + 2) * (height + 2) bytes.
TEST(PlainRegionPasses, HaveNoWorkBufferForSizesOfUnlikeSign) {
    unsigned char pixel = 5;
    EXPECT_EQ(plain::ze_lasso_add_fill_mask(&pixel, -5, 4, 0, 0, 0, 0), 0);
    EXPECT_EQ(pixel, 5);
}
