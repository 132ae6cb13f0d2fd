#include "selection/region_bits.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <utility>
#include <vector>

#include "selection/contour_tracer.h"
#include "selection/interior_pass.h"
#include "selection/region_shaping.h"
#include "tests/helpers/failing_allocations.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"

using ::testing::ElementsAre;
using ::testing::Pair;

namespace {

const region_values SELECTION = {value_set(1, VISITED_VALUE), value_set(VISITED_VALUE), 1};

bool is_member(const region_bits& bits, cell c) {
    return (bits.member(word_of(c)) & bit_of(c)) != 0;
}
bool is_visited(const region_bits& bits, cell c) {
    return (bits.visited(word_of(c)) & bit_of(c)) != 0;
}
bool has_marker_on_left(const region_bits& bits, cell c) {
    return (bits.marked_left(word_of(c)) & bit_of(c)) != 0;
}
bool has_marker_on_right(const region_bits& bits, cell c) {
    return (bits.marked_right(word_of(c)) & bit_of(c)) != 0;
}

std::vector<std::pair<int, int>> runs_of(bit_word bits) {
    std::vector<std::pair<int, int>> runs;
    for_each_run(bits, [&runs](int first, int count) { runs.emplace_back(first, count); });
    return runs;
}

}  // namespace

// ---- bits of a word

TEST(bits, RunsAreFoundFromTheLowestOn) {
    EXPECT_THAT(runs_of(0), ElementsAre());
    EXPECT_THAT(runs_of(0x6D), ElementsAre(Pair(0, 1), Pair(2, 2), Pair(5, 2)));
    EXPECT_THAT(runs_of(~bit_word{0}), ElementsAre(Pair(0, 64)));
    EXPECT_THAT(runs_of(bit_word{0x9} << 60), ElementsAre(Pair(60, 1), Pair(63, 1)));
}

TEST(bits, CellsBetweenTwoColumnsAreCutAtTheirWords) {
    EXPECT_EQ(bits_between(3, 5, 0), 0x38u);
    EXPECT_EQ(bits_between(60, 130, 0), bit_word{0xF} << 60);
    EXPECT_EQ(bits_between(60, 130, 1), ~bit_word{0});
    EXPECT_EQ(bits_between(60, 130, 2), 0x7u);
}

TEST(bits, TheNextOneIsLookedForUpToTheEnd) {
    const bit_word row[3] = {0x10, 0, 0x2};
    EXPECT_EQ(next_bit(row, 0, 192), 4);
    EXPECT_EQ(next_bit(row, 4, 192), 4);
    EXPECT_EQ(next_bit(row, 5, 192), 129);
    EXPECT_EQ(next_bit(row, 5, 129), 129) << "the end comes first";
    EXPECT_EQ(next_bit(row, 5, 100), 100);
    EXPECT_EQ(next_bit(row, 7, 7), 7);
}

TEST(bits, ThePreviousOneIsLookedForDownToTheStart) {
    const bit_word row[3] = {0x10, 0, 0x2};
    EXPECT_EQ(previous_bit(row, 191), 129);
    EXPECT_EQ(previous_bit(row, 129), 129);
    EXPECT_EQ(previous_bit(row, 128), 4);
    EXPECT_EQ(previous_bit(row, 4), 4);
    EXPECT_EQ(previous_bit(row, 3), -1);
}

namespace {

constexpr int ROW_WORDS = 3;
constexpr int ROW_BITS = ROW_WORDS * WORD_BITS;
constexpr int EDGES[] = {0, 1, 62, 63, 64, 65, 126, 127, 128, 129, 190, 191};

bool has_bit(const bit_word* words, int bit) { return (words[bit / 64] >> bit % 64 & 1) != 0; }

}  // namespace

TEST(bits, CellsBetweenAnyTwoColumnsAreCutAtTheirWords) {
    for (const int first : EDGES) {
        for (const int last : EDGES) {
            if (first > last) continue;
            for (int word = first / 64; word <= last / 64; ++word) {
                bit_word expected = 0;
                for (int bit = 0; bit < 64; ++bit) {
                    const int column = 64 * word + bit;
                    if (column >= first && column <= last) expected |= bit_word{1} << bit;
                }
                EXPECT_EQ(bits_between(first, last, word), expected) << first << " .. " << last;
            }
        }
    }
}

TEST(bits, AnyOnlyRunOfAWordIsFound) {
    for (int first = 0; first < 64; ++first) {
        for (int end = first + 1; end <= 64; ++end) {
            bit_word run = 0;
            for (int bit = first; bit < end; ++bit) run |= bit_word{1} << bit;
            ASSERT_THAT(runs_of(run), ElementsAre(Pair(first, end - first)));
            ASSERT_EQ(lowest_bit(run), first);
            ASSERT_EQ(highest_bit(run), end - 1);
            ASSERT_EQ(count_bits(run), end - first);
            ASSERT_EQ(count_bits(~run), 64 - (end - first));
            ASSERT_EQ(bits_from(first) & bits_up_to(end - 1), run);
        }
    }
}

TEST(bits, TheOnlyOneOfARowIsFoundFromEitherSide) {
    for (int bit = 0; bit < ROW_BITS; ++bit) {
        bit_word row[ROW_WORDS] = {};
        row[bit / 64] = bit_word{1} << bit % 64;
        for (const int from : EDGES) {
            ASSERT_EQ(previous_bit(row, from), bit <= from ? bit : -1) << bit << " from " << from;
            for (const int end : EDGES) {
                ASSERT_EQ(next_bit(row, from, end), bit >= from && bit < end ? bit : end)
                    << bit << " from " << from << " to " << end;
            }
        }
    }
}

// ---- sets of words

TEST(word_set, HoldsTheWordsPutInAndNoOthers) {
    bit_word memory[3 * ROW_WORDS] = {};
    word_set set(memory, ROW_WORDS);
    for (const int word : EDGES) {
        set.insert({1, word});
        for (int row = 0; row < 3; ++row) {
            for (int other = 0; other < ROW_BITS; ++other) {
                ASSERT_EQ(set.has({row, other}), row == 1 && other == word) << word;
            }
        }
        set.set({1, word}, true);
        EXPECT_TRUE(set.has({1, word}));
        set.erase({1, word});
        EXPECT_FALSE(set.has({1, word}));
        set.set({1, word}, false);
        EXPECT_FALSE(set.has({1, word}));
        set.set({1, word}, true);
        EXPECT_TRUE(set.has({1, word}));
        set.set({1, word}, false);
        EXPECT_FALSE(set.has({1, word}));
    }
}

TEST(word_set, TakesAndLosesWordsFromOnePlaceToBeforeAnother) {
    for (const int from : EDGES) {
        for (const int end : EDGES) {
            bit_word memory[3 * ROW_WORDS] = {};
            word_set set(memory, ROW_WORDS);
            bit_word full_memory[3 * ROW_WORDS];
            std::fill_n(full_memory, 3 * ROW_WORDS, ~bit_word{0});
            word_set full(full_memory, ROW_WORDS);
            set.insert({1, from}, end);
            full.erase({1, from}, end);
            for (int i = 0; i < 3 * ROW_BITS; ++i) {
                const bool changed = i >= ROW_BITS + from && i < ROW_BITS + end;
                ASSERT_EQ(has_bit(memory, i), changed) << from << " to " << end << ": " << i;
                ASSERT_EQ(has_bit(full_memory, i), !changed) << from << " to " << end << ": " << i;
            }
        }
    }
}

TEST(word_set, VisitsItsWordsFromOnePlaceToBeforeAnother) {
    bit_word memory[3 * ROW_WORDS] = {};
    word_set set(memory, ROW_WORDS);
    for (const int word : EDGES) set.insert({1, word});
    for (const int from : EDGES) {
        for (const int end : EDGES) {
            if (from >= end) continue;
            std::vector<int> visited, expected;
            for (const int word : EDGES) {
                if (word >= from && word < end) expected.push_back(word);
            }
            set.for_each({1, from}, end, [&](word_place at) {
                EXPECT_EQ(at.row, 1);
                visited.push_back(at.word);
            });
            EXPECT_EQ(visited, expected) << from << " to " << end;
        }
    }
}

TEST(word_set, AVisitMayChangeTheSetAhead) {
    bit_word memory[ROW_WORDS] = {};
    word_set set(memory, ROW_WORDS);
    for (const int word : {3, 63, 64, 70}) set.insert({0, word});
    std::vector<int> visited;
    set.for_each({0, 0}, ROW_BITS, [&](word_place at) {
        visited.push_back(at.word);
        set.insert({0, 2});   // behind
        set.insert({0, 65});  // ahead
        set.erase({0, 63});
        set.erase({0, 70});
    });
    EXPECT_THAT(visited, ElementsAre(3, 64, 65));
}

TEST(word_set, FindsTheNextAndThePreviousWordOfARow) {
    bit_word memory[3 * ROW_WORDS];
    std::fill_n(memory, 3 * ROW_WORDS, ~bit_word{0});
    word_set set(memory, ROW_WORDS);
    set.erase({1, 0}, ROW_BITS);
    EXPECT_EQ(set.next({1, 0}, ROW_BITS), ROW_BITS);
    EXPECT_EQ(set.previous({1, ROW_BITS - 1}), -1);
    for (const int word : EDGES) {
        set.insert({1, word});
        EXPECT_EQ(set.next({1, 0}, ROW_BITS), word);
        EXPECT_EQ(set.previous({1, ROW_BITS - 1}), word);
        set.erase({1, word});
    }
}

// ---- reading the mask

TEST(region_bits, TakesMembersAndVisitedFromTheBox) {
    Picture mask(R"(
        #####
        #2.#3
        ##5.#)");
    const region_bits bits(mask.data(), 5, 3, {1, 4, 1, 2}, SELECTION);
    ASSERT_TRUE(bits);
    Picture members(6, 4, 0), visited(6, 4, 0);
    for (int row = 0; row < 4; ++row) {
        for (int column = 0; column < 6; ++column) {
            members.at(column, row) = is_member(bits, {column, row});
            visited.at(column, row) = is_visited(bits, {column, row});
        }
    }
    EXPECT_EQ(members, Picture(R"(
        ......
        .#.#..
        .#..#.
        ......)"));
    EXPECT_EQ(visited, Picture(R"(
        ......
        .#....
        ......
        ......)"));
}

TEST(region_bits, ReplacesValuesInTheBoxAlone) {
    Picture mask(R"(
        2522
        25#2
        2222)");
    const region_bits bits(mask.data(), 4, 3, {1, 2, 0, 1},
                           {value_set(1, 2, 5), value_set(2, 5), 1});
    EXPECT_EQ(mask, Picture(R"(
        2##2
        2##2
        2222)"));
}

TEST(region_bits, ReadsRowsOfAnyLengthAlike) {
    for (int width = 1; width <= 140; ++width) {
        for (const bool full : {false, true}) {
            Picture mask(width, 1, 1);
            if (!full) mask.at(width / 2, 0) = 0;
            if (!full) mask.at(width / 3, 0) = 7;
            const region_bits bits(mask.data(), width, 1, {0, width - 1, 0, 0}, SELECTION);
            for (int x = 0; x < width; ++x) {
                ASSERT_EQ(is_member(bits, {x + 1, 1}), mask.at(x, 0) == 1) << x << " of " << width;
            }
            ASSERT_FALSE(is_member(bits, {0, 1}));
            ASSERT_FALSE(is_member(bits, {width + 1, 1}));
        }
    }
}

TEST(region_bits, WithoutRegionValuesOnesAreNoMembers) {
    Picture mask(70, 1, 1);
    const region_bits bits(mask.data(), 70, 1, {0, 69, 0, 0},
                           {value_set(3, 4), value_set(3, 4), 0});
    EXPECT_EQ(bits.member({1, 0}), 0u);
    EXPECT_EQ(bits.member({1, 1}), 0u);
}

TEST(region_bits, OfASmallBoxInALargeImageAreSmall) {
    std::vector<unsigned char> mask(4000 * 1000);
    failing_allocations counted(0);
    const region_bits bits(mask.data(), 4000, 1000, {2000, 2099, 500, 599}, SELECTION);
    EXPECT_EQ(counted.asked(), 1);
    EXPECT_LE(counted.bytes(), 100u * 100) << "a byte for each of its pixels";
}

TEST(region_bits, AreNotHadForSizesBeyondCounting) {
    unsigned char pixel = 1;
    const auto had = [&pixel](int width, int height) {
        failing_allocations counted(0);
        const bool made(
            region_bits(&pixel, width, height, {0, width - 1, 0, height - 1}, SELECTION));
        EXPECT_EQ(counted.asked(), made ? 1 : 0);
        return made;
    };
    EXPECT_FALSE(had(INT32_MAX, 1));
    EXPECT_FALSE(had(1, INT32_MAX));
    EXPECT_FALSE(had(-10, 5));
    EXPECT_TRUE(had(1, 1));
    EXPECT_TRUE(had(0, 5));
    EXPECT_TRUE(had(-10, -10)) << "as many positions as in an image of 6 x 6";
}

// ---- markers

TEST(region_bits, MarkersAreSeenFromBothSidesAcrossWords) {
    Picture mask(130, 3, 1);
    for (int x = 60; x < 70; ++x) mask.at(x, 1) = 0;
    region_bits bits(mask.data(), 130, 3, {0, 129, 0, 2}, SELECTION);
    bits.trace({71, 2}, [](cell) {});  // the gap's right end: the trace looks left at once
    EXPECT_TRUE(has_marker_on_left(bits, {71, 2}));
    EXPECT_FALSE(has_marker_on_left(bits, {72, 2}));
    EXPECT_TRUE(has_marker_on_right(bits, {69, 2}));
    bits.clear_markers();
    EXPECT_FALSE(has_marker_on_left(bits, {71, 2}));
}

// ---- the plain tracer and this one

namespace {

// Traces from every selected pixel of the drawing in turn, both ways, and compares what is left.
void expect_traced_alike(const Picture& drawing, const ze_rect& box) {
    const int width = drawing.width, height = drawing.height;
    for (int y = box.top; y <= box.bottom; ++y) {
        for (int x = box.left; x <= box.right; ++x) {
            if (drawing.at(x, y) != 1) continue;
            Picture plain_mask = drawing;
            region_mask plain(plain_mask.data(), width, height, box);
            marker_buffer plain_markers(width, height);
            trace_contour(&plain, &plain_markers, x, y, value_set(1, 2), 2);

            Picture mask = drawing;
            region_bits bits(mask.data(), width, height, box, SELECTION);
            bits.trace({x - box.left + 1, y - box.top + 1},
                       [&bits](cell c) { bits.set_visited(c); });
            for (int py = box.top; py <= box.bottom; ++py) {
                for (int px = box.left; px <= box.right; ++px) {
                    const cell c = {px - box.left + 1, py - box.top + 1};
                    ASSERT_EQ(is_visited(bits, c), plain_mask.at(px, py) == 2) << px << ", " << py;
                    ASSERT_EQ(has_marker_on_left(bits, c), plain_markers.on_left_of(px, py))
                        << px << ", " << py << " from " << x << ", " << y << "\n"
                        << drawing;
                    ASSERT_EQ(has_marker_on_right(bits, c), plain_markers.on_right_of(px, py))
                        << px << ", " << py << " from " << x << ", " << y << "\n"
                        << drawing;
                }
            }
            const ze_rect cells = bits.contours;
            if (plain.contours.left > plain.contours.right) {
                ASSERT_GT(cells.left, cells.right);
            } else {
                ASSERT_EQ((ze_rect{cells.left + box.left - 1, cells.right + box.left - 1,
                                   cells.top + box.top - 1, cells.bottom + box.top - 1}),
                          plain.contours);
            }
        }
    }
}

}  // namespace

TEST(region_bits, TraceLikeThePlainTracer) {
    const Picture shapes(R"(
        #..##...#
        ##.#.#.##
        .#.###..#
        #.....#.#
        #####.#.#
        #...#...#
        #.#.#####)");
    expect_traced_alike(shapes, {0, 8, 0, 6});
    expect_traced_alike(shapes, {1, 7, 1, 5});
    expect_traced_alike(shapes, {0, 7, 0, 6});
    expect_traced_alike(shapes, {1, 8, 2, 6});
}

TEST(region_bits, ShareMarkersAcrossTheImagesSidesInNarrowImages) {
    expect_traced_alike(Picture("#\n#\n.\n#\n#"), {0, 0, 0, 4});
    expect_traced_alike(Picture("#.\n##\n.#\n#."), {0, 1, 0, 3});
    expect_traced_alike(Picture("#.#\n###\n.#.\n#.#"), {0, 2, 0, 3});
    expect_traced_alike(Picture("#.#\n###\n.#.\n#.#"), {1, 2, 1, 2});
}

// ---- the flag within a word

TEST(flag_events, HoldFromASetToTheNextClearOne) {
    // Bits 5 and 9 set, 7 and 20 clear.
    const flag_events events = {1u << 5 | 1u << 9, 1u << 7 | 1u << 20};
    const bit_word between = 0x60u | (0xFFE00u & ~(1u << 20));
    EXPECT_EQ(events.inside(false), between);
    EXPECT_EQ(events.inside(true), between | 0x1F);
    EXPECT_FALSE(events.last());
    EXPECT_FALSE(events.none());
}

TEST(flag_events, WithoutEventsHandTheFlagOn) {
    const flag_events none = {0, 0};
    EXPECT_TRUE(none.none());
    EXPECT_EQ(none.inside(true), ~bit_word{0});
    EXPECT_EQ(none.inside(false), 0u);
}

TEST(flag_events, ReachFromOneEndOfTheWordToTheOther) {
    EXPECT_EQ((flag_events{1, 0}.inside(false)), ~bit_word{0});
    EXPECT_EQ((flag_events{bit_word{1} << 63, 0}.inside(true)), ~bit_word{0});
    EXPECT_EQ((flag_events{0, 1}.inside(true)), 0u);
    EXPECT_EQ((flag_events{0, bit_word{1} << 63}.inside(true)), bits_up_to(62));
    EXPECT_TRUE((flag_events{1, 0}.last()));
}

TEST(flag_events, HoldFromAnySetToAnyClearOne) {
    for (int set = 0; set < 64; ++set) {
        for (int cleared = 0; cleared < 64; ++cleared) {
            if (set == cleared) continue;
            const flag_events events = {bit_word{1} << set, bit_word{1} << cleared};
            for (const bool before : {false, true}) {
                bit_word expected = 0;
                bool inside = before;
                for (int bit = 0; bit < 64; ++bit) {
                    if (bit == set) inside = true;
                    if (bit == cleared) inside = false;
                    if (inside) expected |= bit_word{1} << bit;
                }
                ASSERT_EQ(events.inside(before), expected) << set << ", " << cleared;
                ASSERT_EQ(events.last(), inside);
                ASSERT_FALSE(events.none());
            }
        }
    }
}
