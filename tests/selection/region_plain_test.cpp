// The passes on regions against their plain definitions, on random masks.

#include "selection/region_plain.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <vector>

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

// A cell that a pass fills beside a marker ends or begins an inside in the next pass.
TEST(RegionPasses, LookAgainAtWordsWithACellFilledBesideAMarker) {
    const Picture drawn(R"(
        .....................................................2#.................
        ...............................................................#........
        ...............................................................#.....##.)");
    outcome filled = {drawn, {72, 0, 3, 0}, {0, 71, 0, 2}, 0}, plainly_filled = filled;
    run_fill(&Fill_Region, &filled);
    run_fill(&plain::Fill_Region, &plainly_filled);
    EXPECT_EQ(filled, plainly_filled);
    EXPECT_FALSE(filled.mask == drawn);
}

// Rows are a set of words too, of which the first holds rows 0 to 63: a later region widens the
// area from row 66 on, and row 16 has to be looked at again.
TEST(RegionPasses, LookAgainAtRowsInAnEarlierWordOfRows) {
    Picture drawn(65, 68, 0);
    struct pixel {
        int x, y;
    };
    for (const auto& [x, y] : {pixel{1, 15},
                               {1, 16},
                               {61, 16},
                               {62, 59},
                               {61, 60},
                               {2, 66},
                               {64, 66},
                               {2, 67},
                               {64, 67}}) {
        drawn.at(x, y) = 1;
    }
    drawn.at(63, 16) = 2;
    outcome filled = {drawn, {65, 0, 68, 0}, {0, 64, 0, 67}, 0}, plainly_filled = filled;
    run_fill(&Fill_Region, &filled);
    run_fill(&plain::Fill_Region, &plainly_filled);
    EXPECT_EQ(filled, plainly_filled);
}

// A pass that begins in the first word of a row takes the flag that an earlier pass has left at the
// end of the row above.
TEST(RegionPasses, GoOnFromTheRowAboveThatAnEarlierPassHasSeen) {
    const Picture masks[] = {Picture(R"(
        2###..
        ...##.
        .###.#)"),
                             Picture(R"(
        ##.#.
        ....#
        2#...
        .##..
        .2##.
        ..#.#)"),
                             Picture(R"(
        ..#.#.#
        #...#..
        ..#....
        #.#.##.
        .....##
        #..#.#.
        #......
        .###...
        #......)")};
    for (const Picture& mask : masks) {
        const outcome before = {
            mask, {mask.width, 0, mask.height, 0}, {0, mask.width - 1, 0, mask.height - 1}, 0};
        outcome erased = before, plainly_erased = before;
        run_erase(&Erase_Region, &erased);
        run_erase(&plain::Erase_Region, &plainly_erased);
        EXPECT_EQ(erased, plainly_erased);
    }
}

// Rows of more than 64 words, for whose sets of words one word is not enough.
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

namespace {

Picture with_values(const Picture& mask, unsigned char selected) {
    Picture other = mask;
    for (unsigned char& pixel : other.cells) {
        if (pixel == 1) pixel = selected;
    }
    return other;
}

template <class Pass, class Run>
void expect_equal_on(const Picture& mask, const ze_rect& box, Pass pass, Pass plain_pass, Run run) {
    outcome o = {mask, {mask.width, 0, mask.height, 0}, box, 0}, plain_outcome = o;
    run(pass, &o);
    run(plain_pass, &plain_outcome);
    ASSERT_EQ(o, plain_outcome) << "box " << ::testing::PrintToString(box) << ", mask " << mask;
}

// All four passes, on the whole mask and on a box that begins and ends a column and a row further
// inside.
void expect_every_pass_equal(const Picture& mask) {
    const ze_rect whole = {0, mask.width - 1, 0, mask.height - 1};
    const ze_rect part = {1, mask.width - 2, 1, mask.height - 1};
    for (const ze_rect& box : {whole, part}) {
        expect_equal_on(mask, box, &Fill_Region, &plain::Fill_Region, run_fill);
        expect_equal_on(mask, box, &Erase_Region, &plain::Erase_Region, run_erase);
        expect_equal_on(with_values(mask, 5), box, &ze_lasso_add_fill_mask,
                        &plain::ze_lasso_add_fill_mask, run_lasso);
        expect_equal_on(with_values(mask, 3), box, &ze_lasso_del_fill_mask,
                        &plain::ze_lasso_del_fill_mask, run_lasso);
    }
}

Picture turned(const Picture& mask) {
    Picture other(mask.height, mask.width, 0);
    for (int y = 0; y < mask.height; ++y) {
        for (int x = 0; x < mask.width; ++x) other.at(y, x) = mask.at(x, y);
    }
    return other;
}

constexpr int ROWS = 5;

// What may go wrong at a column: a pixel alone there, a hole, an edge of a ring, a small ring
// beside a larger block.
std::vector<Picture> masks_for_column(int x, int width) {
    Picture lone(width, ROWS, 0), hole(width, ROWS, 1), ring(width, ROWS, 0), rings(width, ROWS, 0);
    lone.at(x, 2) = 1;
    hole.at(x, 2) = 0;
    draw_rectangle(&ring, 0, 0, x + 1, ROWS, true, 1);
    draw_rectangle(&ring, x, 1, width - x, 3, true, 1);
    draw_rectangle(&rings, std::max(x - 1, 0), 1, 3, 3, true, 1);
    draw_rectangle(&rings, x < width / 2 ? width - 5 : 0, 0, 5, 4, false, 1);
    return {lone, hole, ring, rings};
}

}  // namespace

TEST(RegionPasses, WorkAtEveryColumn) {
    for (int x = 0; x < 129; ++x) {
        for (const Picture& mask : masks_for_column(x, 129)) {
            expect_every_pass_equal(mask);
            if (HasFatalFailure()) return;
        }
    }
}

TEST(RegionPasses, WorkAtTheEdgesOfWordsAndMasks) {
    for (const int size : {63, 64, 65, 127, 128, 191, 192, 193}) {
        for (int x = 0; x < size; ++x) {
            const bool edge = (x + 3) % 64 < 6 || x >= size - 3;
            if (!edge) continue;
            for (const Picture& mask : masks_for_column(x, size)) {
                expect_every_pass_equal(mask);
                expect_every_pass_equal(turned(mask));
                if (HasFatalFailure()) return;
            }
        }
    }
}

// A row's sets of words begin a second word with column 4096.
TEST(RegionPasses, WorkWhereSetsOfWordsBeginAnotherWord) {
    for (const int width : {4097, 4161}) {
        for (const int x : {3, 4031, 4094, 4095, 4096, 4159}) {
            if (x >= width) continue;
            for (const Picture& mask : masks_for_column(x, width)) {
                expect_every_pass_equal(mask);
                if (HasFatalFailure()) return;
            }
        }
    }
}

// Noise around the end of a word and mostly on the left side too: with shared markers where the
// mask ends there, and with 2s that count as visited from the start.
TEST(RegionPasses, WorkOnNoiseAtTheEdgesOfWords) {
    for (unsigned seed = 1; seed <= 4000; ++seed) {
        random_numbers random(seed);
        const int first = (random.one_in(4) ? 128 : 64) - random.between(0, 8);
        const int last = first + random.between(1, 9), share = random.between(10, 80);
        const int left_side = random.one_in(3) ? 0 : 3;
        Picture mask(last + (random.one_in(3) ? 10 : 1), random.between(2, 9), 0);
        for (int y = 0; y < mask.height; ++y) {
            for (int x = 0; x < mask.width; ++x) {
                const bool noisy = x < left_side || (x >= first && x <= last);
                const bool drawn = noisy && random.between(0, 99) < share;
                if (drawn) mask.at(x, y) = random.one_in(6) ? 2 : 1;
            }
        }
        expect_every_pass_equal(mask);
        ASSERT_FALSE(HasFatalFailure()) << "seed " << seed;
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
