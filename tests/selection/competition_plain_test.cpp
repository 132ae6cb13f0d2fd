// The competition of fronts against its plain version, and the ways in which it is carried out.

#include "selection/competition_plain.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <vector>

#include "selection/brush_cells.h"
#include "selection/front_competition.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/random_numbers.h"
#include "tests/helpers/rect_printing.h"

namespace {

// One colour, a few colours, a gradient with a little noise, or pure noise.
std::vector<int> random_photo(random_numbers& random, int width, int height) {
    std::vector<int> photo(static_cast<size_t>(width * height));
    const int kind = random.between(0, 3), colours = random.between(2, 5);
    for (size_t i = 0; i < photo.size(); ++i) {
        const int x = static_cast<int>(i) % width;
        const int grey = kind == 0   ? 90
                         : kind == 1 ? 20 * random.between(1, colours)
                         : kind == 2 ? x % 200 + random.between(0, 3)
                                     : random.between(0, 255);
        photo[i] = grey * 0x010101;
        if (kind == 3) photo[i] ^= random.between(0, 0xFFFFFF);
    }
    return photo;
}

// Two engines of one brush: the library's strokes work on one, the plain ones on the other.
struct engine_pair {
    engine_pair(int radius, int core) {
        engine.initial(radius, core);
        plain_engine.initial(radius, core);
    }

    // Makes the same stroke with both. Returns how the library carried it out.
    stroke_run stroke(bool grows, std::vector<int> photo, Picture* mask, int x, int y) {
        Picture plain_mask = *mask;
        ze_rect rect = {mask->width, 0, mask->height, 0}, plain_rect = rect;
        const auto run = grows ? run_growing : run_shrinking;
        const auto plain_run = grows ? plain::DoSelection : plain::DeSelection;
        const stroke_run carried_out =
            run(&engine, photo.data(), mask->data(), mask->width, mask->height, x, y, &rect);
        plain_run(&plain_engine, photo.data(), plain_mask.data(), mask->width, mask->height, x, y,
                  &plain_rect);
        EXPECT_EQ(*mask, plain_mask);
        EXPECT_EQ(rect, plain_rect);
        expect_equal_engines();
        return carried_out;
    }

    void expect_equal_engines() const {
        EXPECT_EQ(engine.nodes_used, plain_engine.nodes_used);
        EXPECT_EQ(engine.queue->count, plain_engine.queue->count);
        EXPECT_EQ(engine.queue->spare, plain_engine.queue->spare);
        EXPECT_EQ(engine.queue->head == nullptr, plain_engine.queue->head == nullptr);
        const ptrdiff_t cells = brush_side(engine) * brush_side(engine);
        EXPECT_TRUE(std::equal(engine.cost_h, engine.cost_h + cells, plain_engine.cost_h));
        EXPECT_TRUE(std::equal(engine.cost_v, engine.cost_v + cells, plain_engine.cost_v));
        EXPECT_EQ(std::count(engine.node_map, engine.node_map + cells, nullptr),
                  std::count(plain_engine.node_map, plain_engine.node_map + cells, nullptr));
    }

    ER_selection engine;
    ER_selection plain_engine;
};

// Ways in which strokes were carried out, by stroke_run.
using run_counts = std::vector<int>;

void expect_equal_strokes(unsigned seed, int largest_radius, run_counts* runs) {
    random_numbers random(seed);
    const int radius = random.between(1, largest_radius);
    engine_pair engines(radius, random.between(0, random.one_in(8) ? radius + 1 : 2));
    const int width = random.between(3, 3 * radius + 20), height = random.between(3, 60);
    const int foreign = random.one_in(3) ? random.between(2, 6) : 1;
    for (int strokes = random.between(1, 5); strokes > 0; --strokes) {
        Picture mask(width, height, 0);
        const int selected = random.between(0, 100);
        for (unsigned char& pixel : mask.cells) {
            pixel = random.between(0, 99) < selected;
            if (random.one_in(6)) pixel = static_cast<unsigned char>(random.between(0, foreign));
        }
        const int x = random.between(-1, width), y = random.between(-1, height);
        const bool grows = random.one_in(2);
        const std::vector<int> photo = random_photo(random, width, height);
        const stroke_run run = engines.stroke(grows, photo, &mask, x, y);
        ++(*runs)[static_cast<size_t>(run)];
        if (::testing::Test::HasFailure()) {
            FAIL() << "seed " << seed << ", radius " << radius << ", at " << x << ", " << y;
        }
    }
}

std::vector<int> flat_photo(const Picture& mask) {
    return std::vector<int>(mask.cells.size(), 0x808080);
}

}  // namespace

TEST(Competition, OfSmallBrushesIsThePlainOne) {
    run_counts runs(4);
    for (unsigned seed = 1; seed <= 3000; ++seed) {
        ASSERT_NO_FATAL_FAILURE(expect_equal_strokes(seed, 9, &runs));
    }
    for (const stroke_run run : {stroke_run::NONE, stroke_run::FIRST, stroke_run::SECOND}) {
        EXPECT_GT(runs[static_cast<size_t>(run)], 0) << static_cast<int>(run);
    }
}

// Strokes in which D_Queue's index names popped nodes where it matters. One in a thousand of those
// with tiny brushes and foreign values comes to that.
TEST(Competition, ThatBreaksTheOrderIsCarriedOutPlainly) {
    run_counts runs(4);
    for (const unsigned seed : {1343u, 1459u, 2089u, 3092u, 4711u, 6037u}) {
        ASSERT_NO_FATAL_FAILURE(expect_equal_strokes(seed, 9, &runs));
    }
    EXPECT_GT(runs[static_cast<size_t>(stroke_run::PLAIN)], 0);
}

// A stroke in which D_Queue's index asks a head for its `prev`: one that was queued alone has none,
// one among few others has itself. One in a hundred thousand comes to that.
TEST(Competition, TellsAHeadAloneFromOneAmongOthers) {
    run_counts runs(4);
    ASSERT_NO_FATAL_FAILURE(expect_equal_strokes(182617, 9, &runs));
}

TEST(Competition, OfLargeBrushesIsThePlainOne) {
    run_counts runs(4);
    for (unsigned seed = 1; seed <= 150; ++seed) {
        ASSERT_NO_FATAL_FAILURE(expect_equal_strokes(seed, 80, &runs));
    }
    EXPECT_GT(runs[static_cast<size_t>(stroke_run::FIRST)], 0);
}

// ---- what the plain version has to carry out

TEST(Competition, WithAListLeftOverIsCarriedOutPlainly) {
    engine_pair engines(3, 1);
    node left_over[2] = {};
    engines.engine.queue->push(&left_over[0]);
    engines.plain_engine.queue->push(&left_over[1]);
    Picture mask(9, 9, 0);
    EXPECT_EQ(engines.stroke(true, flat_photo(mask), &mask, 4, 4), stroke_run::PLAIN);
}

TEST(Competition, WithANodeLeftInTheMapIsCarriedOutPlainly) {
    engine_pair engines(3, 1);
    node left_over[2] = {};
    engines.engine.node_map[48] = &left_over[0];
    engines.plain_engine.node_map[48] = &left_over[1];
    Picture mask(9, 9, 0);
    EXPECT_EQ(engines.stroke(true, flat_photo(mask), &mask, 4, 4), stroke_run::PLAIN);
    EXPECT_EQ(engines.stroke(true, flat_photo(mask), &mask, 4, 4), stroke_run::FIRST);
}

// On the image's first row and column costs of an earlier stroke count, or of whoever wrote there.
TEST(Competition, WithOldCostsThatAreNoneIsCarriedOutPlainly) {
    for (const int cost : {-1, INT_MAX, 3 * 255 * 255 + 1}) {
        for (const bool horizontal : {false, true}) {
            engine_pair engines(3, 1);
            for (ER_selection* e : {&engines.engine, &engines.plain_engine}) {
                (horizontal ? e->cost_h : e->cost_v)[2 * 7 + 2] = cost;
            }
            Picture mask(9, 9, 0);
            mask.at(1, 1) = 1;
            EXPECT_EQ(engines.stroke(true, flat_photo(mask), &mask, 1, 1), stroke_run::PLAIN)
                << cost;
        }
    }
}

TEST(Competition, TakesOldCostsUpToTheDearestStep) {
    engine_pair engines(3, 1);
    for (ER_selection* e : {&engines.engine, &engines.plain_engine}) {
        std::fill(e->cost_h, e->cost_h + 49, 3 * 255 * 255);
        std::fill(e->cost_v, e->cost_v + 49, 3 * 255 * 255);
    }
    Picture mask(9, 9, 0);
    EXPECT_EQ(engines.stroke(true, flat_photo(mask), &mask, 1, 1), stroke_run::FIRST);
}

namespace {

// A corridor that winds out from the core of a large brush, through a mask that is closed to both
// fronts.
struct corridor {
    static constexpr int RADIUS = 130;
    static constexpr int CENTRE = RADIUS + 1;
    static constexpr int SIZE = 2 * RADIUS + 3;

    explicit corridor(int steps) {
        const struct { int x, y; } turns[] = {{1, 0}, {0, 1}, {-1, 0}, {0, -1}};
        int x = CENTRE, y = CENTRE;
        open(x, y);
        for (int side = 0;; ++side) {
            for (int i = 0; i < 2 * (side / 2 + 1); ++i) {
                if (static_cast<int>(path.size()) > steps) return;
                x += turns[side % 4].x;
                y += turns[side % 4].y;
                open(x, y);
            }
        }
    }

    void open(int x, int y) {
        mask.at(x, y) = 0;
        path.push_back(static_cast<size_t>(y * SIZE + x));
    }

    Picture mask{SIZE, SIZE, 5};
    std::vector<size_t> path;  // the core first
    std::vector<int> photo = std::vector<int>(mask.cells.size(), 0);
};

constexpr int64_t DEAREST_STEP = 3 * 255 * 255;  // from black to white or back

}  // namespace

TEST(Competition, WithPathsTooDearToCountIsCarriedOutPlainly) {
    const int steps = 14000;
    ASSERT_GT(steps * DEAREST_STEP, INT_MAX);
    corridor c(steps);
    for (size_t i = 0; i < c.path.size(); i += 2) c.photo[c.path[i]] = 0xFFFFFF;
    engine_pair engines(c.RADIUS, 0);
    EXPECT_EQ(engines.stroke(true, c.photo, &c.mask, c.CENTRE, c.CENTRE), stroke_run::PLAIN);
    c.mask = Picture(c.SIZE, c.SIZE, 0);
    EXPECT_EQ(engines.stroke(true, c.photo, &c.mask, c.CENTRE, c.CENTRE), stroke_run::FIRST)
        << "nothing is left of the stroke given up";
}

// The last cell of its path costs INT_MAX, for which unreached cells stand.
TEST(Competition, WithAPathThatCostsTheHighestNumberIsCarriedOutPlainly) {
    const int dearest_steps = static_cast<int>(INT_MAX / DEAREST_STEP);
    corridor c(2 + dearest_steps);
    const int red = 143, green = 131, blue = 129;  // from black to it and from it to white ...
    int64_t two_steps = 0;
    for (const int level : {red, green, blue}) {
        two_steps += level * level + (255 - level) * (255 - level);
    }
    ASSERT_EQ(two_steps + dearest_steps * DEAREST_STEP, INT_MAX);  // ... is what is left over
    c.photo[c.path[1]] = red << 16 | green << 8 | blue;
    for (size_t i = 2; i < c.path.size(); i += 2) c.photo[c.path[i]] = 0xFFFFFF;
    engine_pair engines(c.RADIUS, 0);
    EXPECT_EQ(engines.stroke(true, c.photo, &c.mask, c.CENTRE, c.CENTRE), stroke_run::PLAIN);
    EXPECT_EQ(c.mask.cells[c.path.back()], 1);
}

// ---- strokes that do nothing

TEST(Competition, DoesNothingWithoutBuffersOrAwayFromItsStart) {
    ER_selection without_buffers;
    Picture mask(5, 5, 0);
    std::vector<int> photo = flat_photo(mask);
    ze_rect rect = {5, 0, 5, 0};
    EXPECT_EQ(run_growing(&without_buffers, photo.data(), mask.data(), 5, 5, 2, 2, &rect),
              stroke_run::NONE);
    EXPECT_EQ(run_shrinking(&without_buffers, photo.data(), mask.data(), 5, 5, 2, 2, &rect),
              stroke_run::NONE);
    plain::DoSelection(&without_buffers, photo.data(), mask.data(), 5, 5, 2, 2, &rect);
    EXPECT_EQ(mask, Picture(5, 5, 0));
    engine_pair engines(1, 0);
    EXPECT_EQ(engines.stroke(true, photo, &mask, 0, 2), stroke_run::NONE);
    EXPECT_EQ(engines.stroke(false, photo, &mask, 2, 2), stroke_run::NONE) << "not selected";
}
