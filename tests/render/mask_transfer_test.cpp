#include "render/mask_transfer.h"

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <limits>
#include <numeric>
#include <string>
#include <vector>

#include "tests/helpers/guarded_buffer.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/sparse_memory.h"

namespace {

constexpr int ADD = 0;
constexpr int REMOVE = 1;

uint32_t colour(int red, int green, int blue) {
    return static_cast<uint32_t>(red) << 16 | static_cast<uint32_t>(green) << 8 |
           static_cast<uint32_t>(blue);
}

uint32_t grey(int value) { return colour(value, value, value); }

struct rectangle {
    int left, right, top, bottom;
};

struct large_photo {
    large_photo(int columns, int rows, uint32_t pixel)
        : width(columns), pixels(static_cast<size_t>(columns) * static_cast<size_t>(rows), pixel) {}

    uint32_t& at(int x, int y) { return pixels.at(static_cast<size_t>(y * width + x)); }

    int width;
    std::vector<uint32_t> pixels;
};

// The large mask after a transfer.
Picture transferred(Picture small, Picture large, large_photo photo, float ratio,
                    const rectangle& r, int flag) {
    ze_modify_mask(small.data(), large.data(), photo.pixels.data(), small.width, small.height,
                   photo.width, -1, ratio, r.left, r.right, r.top, r.bottom, flag);
    return large;
}

// What happens to the large mask under `pixel`, in a block whose reference colour is that of its
// own first pixel alone: with value 1 or 0 in the small mask, and all three neighbours different.
struct verdict {
    int added, kept_of_one, kept_of_zero;
};

verdict judge(uint32_t reference, uint32_t pixel) {
    large_photo photo(8, 8, reference ^ 0x00808080);
    photo.at(0, 0) = reference;
    photo.at(2, 1) = pixel;
    const rectangle first = {0, 0, 0, 0};
    const Picture zeros(8, 8, 0), ones(8, 8, 1);
    return {transferred(Picture("#. .."), zeros, photo, 0.25f, first, ADD).at(2, 1),
            transferred(Picture("#. .."), ones, photo, 0.25f, first, REMOVE).at(2, 1),
            transferred(Picture(".# ##"), ones, photo, 0.25f, first, REMOVE).at(2, 1)};
}

// Checks how often each photo pixel counts in the reference colour of the small mask's pixel (0,
// 0), whose block is columns and rows 0 .. 3. `samples` draws columns and rows 0 .. 4.
//
// In a grey photo one pixel after the other is made lighter; the block's inner pixels, which never
// count, show the reference colour by being exactly 59 or 60 away from it.
void expect_samples(const Picture& small, int flag, const Picture& samples) {
    const int total = std::accumulate(samples.cells.begin(), samples.cells.end(), 0);
    const int before = flag == ADD ? 0 : 1;
    const int near = flag == ADD ? 1 : small.at(0, 0);
    const int far = 1 - near;
    for (int y = 0; y < 5; ++y) {
        for (int x = 0; x < 5; ++x) {
            if (x % 4 != 0 && y % 4 != 0) continue;
            large_photo photo(8, 8, grey(70));
            photo.at(x, y) = grey(190);
            const int average = 70 + 120 * samples.at(x, y) / total;
            photo.at(1, 1) = grey(average - 60);
            photo.at(2, 1) = grey(average - 59);
            photo.at(1, 2) = grey(average + 59);
            photo.at(2, 2) = grey(average + 60);
            photo.at(3, 3) = grey(255);

            const Picture large =
                transferred(small, Picture(8, 8, static_cast<unsigned char>(before)), photo, 0.25f,
                            {0, 0, 0, 0}, flag);

            const std::string where = "photo pixel " + std::to_string(x) + ", " + std::to_string(y);
            EXPECT_EQ(large.at(1, 1), far) << where;
            EXPECT_EQ(large.at(2, 1), near) << where;
            EXPECT_EQ(large.at(1, 2), near) << where;
            EXPECT_EQ(large.at(2, 2), far) << where;
        }
    }
}

}  // namespace

// ---- Blocks that are copied

TEST(ze_modify_mask, FillsTheAreaUnderAUniformSelectionInBothModes) {
    const Picture small(5, 4, 1);
    const Picture expected(R"(
        ..........
        ..........
        ..######..
        ..######..
        ..######..
        ..######..
        ..........
        ..........)");
    for (const int flag : {ADD, REMOVE}) {
        EXPECT_EQ(
            transferred(small, Picture(10, 8, 0), large_photo(10, 8, 0), 0.5f, {1, 3, 1, 2}, flag),
            expected)
            << "flag " << flag;
    }
}

TEST(ze_modify_mask, ClearsAUniformAreaInBothModes) {
    for (const int flag : {ADD, REMOVE}) {
        EXPECT_EQ(transferred(Picture(3, 3, 0), Picture(6, 6, 1), large_photo(6, 6, 0), 0.5f,
                              {0, 1, 0, 0}, flag),
                  Picture(R"(
                      ....##
                      ....##
                      ######
                      ######
                      ######
                      ######)"))
            << "flag " << flag;
    }
}

TEST(ze_modify_mask, CopiesAUniformForeignValue) {
    for (const int flag : {ADD, REMOVE}) {
        EXPECT_EQ(transferred(Picture(2, 2, 255), Picture(2, 2, 0), large_photo(2, 2, 0), 1.0f,
                              {0, 0, 0, 0}, flag)
                      .at(0, 0),
                  255);
    }
}

TEST(ze_modify_mask, OneDifferingNeighbourMakesAnEdge) {
    for (const char* small : {"#. ##", "## .#", "## #."}) {
        // Copied, the block would be 1 as a whole; as an edge it keeps what differs from the photo.
        large_photo photo(8, 8, grey(100));
        photo.at(1, 1) = grey(250);
        const Picture large =
            transferred(Picture(small), Picture(8, 8, 0), photo, 0.25f, {0, 0, 0, 0}, ADD);
        EXPECT_EQ(large.at(1, 1), 0) << small;
        EXPECT_EQ(large.at(2, 2), 1) << small;
    }
}

TEST(ze_modify_mask, DoesNothingInAnEmptyRectangle) {
    for (const rectangle& r : {rectangle{0, 1, 1, 0}, {1, 0, 0, 1}, {1, 0, 1, 0}}) {
        EXPECT_EQ(
            transferred(Picture(3, 3, 1), Picture(6, 6, 0), large_photo(6, 6, 0), 0.5f, r, ADD),
            Picture(6, 6, 0));
    }
}

TEST(ze_modify_mask, DoesNothingUnlessTheRatioIsAboveZero) {
    // With a ratio of 0 the first block would have no end.
    const Picture before(4, 4, 7);
    for (const float ratio : {0.0f, -0.0f, -0.5f, std::numeric_limits<float>::quiet_NaN()}) {
        for (const int flag : {ADD, REMOVE}) {
            EXPECT_EQ(transferred(Picture(2, 2, 1), before, large_photo(4, 4, 0), ratio,
                                  {0, 1, 0, 1}, flag),
                      before)
                << ratio;
        }
    }
}

// ---- The small mask's last row and column

TEST(ze_modify_mask, OnTheLastRowAndColumnCopiesOnlyValuesEqualToOneMinusFlag) {
    const Picture small(R"(
        ..#
        ...
        #.#)");
    const rectangle last_column = {2, 2, 0, 2}, last_row = {0, 2, 2, 2};
    const Picture before(6, 6, 7);
    const large_photo photo(6, 6, 0);

    EXPECT_EQ(transferred(small, before, photo, 0.5f, last_column, ADD), Picture(R"(
        7777##
        7777##
        777777
        777777
        7777##
        7777##)"));
    EXPECT_EQ(transferred(small, before, photo, 0.5f, last_column, REMOVE), Picture(R"(
        777777
        777777
        7777..
        7777..
        777777
        777777)"));
    EXPECT_EQ(transferred(small, before, photo, 0.5f, last_row, ADD), Picture(R"(
        777777
        777777
        777777
        777777
        ##77##
        ##77##)"));
    EXPECT_EQ(transferred(small, before, photo, 0.5f, last_row, REMOVE), Picture(R"(
        777777
        777777
        777777
        777777
        77..77
        77..77)"));
}

TEST(ze_modify_mask, OnTheLastColumnOtherFlagsCopyOtherValues) {
    constexpr int LOWEST = std::numeric_limits<int>::min();
    struct {
        int flag, value;
        bool copied;
    } const cases[] =
        {
            {0, 2, false},     {1, 2, false},      {1, 255, false},
            {2, 0, false},     {2, 1, false},      {2, 255, false},  // 1 - 2 is no byte
            {-5, 6, true},     {-5, 1, false},     {-5, 0, false},
            {-254, 255, true},  // bytes are unsigned
            {-255, 0, false},  {LOWEST, 1, false}, {LOWEST, 0, false},
        };
    for (const auto& c : cases) {
        const Picture small(1, 1, static_cast<unsigned char>(c.value));
        const Picture large =
            transferred(small, Picture(1, 1, 7), large_photo(1, 1, 0), 1.0f, {0, 0, 0, 0}, c.flag);
        EXPECT_EQ(large.at(0, 0), c.copied ? c.value : 7)
            << "flag " << c.flag << ", value " << c.value;
    }
}

// ---- The reference colour

TEST(ze_modify_mask, AddingSamplesTheBlockAndItsSelectedNeighbours) {
    struct {
        const char* small;
        const char* samples;
    } const cases[] = {
        {"#. ..", "#.... ..... ..... ..... ....."},
        {"#. .#", "#.... ..... ..... ..... ....5"},  // 4 along the diagonal, 1 of the neighbour
        {"#. #.", "#.... #.... #.... #.... 2...."},
        {"#. ##", "#.... #.... #.... #.... 2###6"},
        {"## ..", "####2 ..... ..... ..... ....."},
        {"## .#", "####2 ....# ....# ....# ....6"},
        {"## #.", "####2 #.... #.... #.... 2...."},
        {"## #2", "####2 #...# #...# #...# 2###7"},
        {".. .#", "..... ..... ..... ..... ....#"},
        {".. #.", "..... ..... ..... ..... #...."},
        {".. ##", "..... ..... ..... ..... ####2"},
        {".# ..", "....# ..... ..... ..... ....."},
        {".# .#", "....# ....# ....# ....# ....2"},
        {".# #.", "....# ..... ..... ..... #...."},
        {".# ##", "....# ....# ....# ....# ####3"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.small);
        expect_samples(Picture(c.small), ADD, Picture(c.samples));
    }
}

TEST(ze_modify_mask, AddingTakesForeignValuesForSelected) {
    expect_samples(Picture("2. .."), ADD, Picture("#.... ..... ..... ..... ....."));
    expect_samples(Picture("23 45"), ADD, Picture("####2 #...# #...# #...# 2###7"));
    expect_samples(Picture(".7 89"), ADD, Picture("....# ....# ....# ....# ####3"));
}

TEST(ze_modify_mask, RemovingSamplesTheBlockTowardsEqualNeighbours) {
    struct {
        const char* of_one;
        const char* of_zero;
        const char* samples;
    } const cases[] = {
        {"#. ..", ".# ##", "#.... ..... ..... ..... ....."},
        {"#. .#", ".# #.", "#.... ..... ..... ..... ....4"},
        {"#. #.", ".# .#", "#.... #.... #.... #.... #...."},
        {"#. ##", ".# ..", "#.... #.... #.... #.... #...4"},
        {"## ..", ".. ##", "##### ..... ..... ..... ....."},
        {"## .#", ".. #.", "##### ..... ..... ..... ....4"},
        {"## #.", ".. .#", "##### #.... #.... #.... #...."},
    };
    for (const int flag : {1, 2, -5, std::numeric_limits<int>::min()}) {
        for (const auto& c : cases) {
            SCOPED_TRACE(std::string(c.of_one) + ", flag " + std::to_string(flag));
            expect_samples(Picture(c.of_one), flag, Picture(c.samples));
            expect_samples(Picture(c.of_zero), flag, Picture(c.samples));
        }
    }
}

TEST(ze_modify_mask, RemovingTakesForeignNeighboursForDifferent) {
    expect_samples(Picture("#2 34"), REMOVE, Picture("#.... ..... ..... ..... ....."));
    expect_samples(Picture(".2 34"), REMOVE, Picture("#.... ..... ..... ..... ....."));
}

TEST(ze_modify_mask, RemovingChangesNothingUnderAForeignValue) {
    large_photo photo(8, 8, grey(100));
    photo.at(1, 1) = grey(250);
    for (const char* small : {"2. ..", "2# #2", "22 2#"}) {
        EXPECT_EQ(transferred(Picture(small), Picture(8, 8, 7), photo, 0.25f, {0, 0, 0, 0}, REMOVE),
                  Picture(8, 8, 7))
            << small;
    }
}

TEST(ze_modify_mask, AveragesEachChannelRoundedDown) {
    // Sampled are (4, 0) and (0, 4): (251 / 2, 211 / 2, 153 / 2) is (125, 105, 76).
    large_photo photo(8, 8, 0);
    photo.at(4, 0) = 0x12000000 | colour(100, 90, 60);
    photo.at(0, 4) = 0xFE000000 | colour(151, 121, 93);
    struct {
        int x, y;
        uint32_t pixel;
        int added;
    } const probes[] = {
        {1, 1, colour(125 + 39, 105, 76), 1}, {2, 1, colour(125 + 40, 105, 76), 0},
        {3, 1, colour(125 - 39, 105, 76), 1}, {0, 1, colour(125 - 40, 105, 76), 0},
        {1, 2, colour(125, 105, 76 + 39), 1}, {2, 2, colour(125, 105, 76 + 40), 0},
        {3, 2, colour(125, 105, 76 - 39), 1}, {0, 2, colour(125, 105, 76 - 40), 0},
        {1, 3, colour(184, 164, 135), 1},     {2, 3, colour(185, 165, 136), 0},
        {3, 3, colour(66, 46, 17), 1},        {0, 3, colour(65, 45, 16), 0},
    };
    for (const auto& p : probes) photo.at(p.x, p.y) = p.pixel;

    const Picture large =
        transferred(Picture(".# #."), Picture(8, 8, 0), photo, 0.25f, {0, 0, 0, 0}, ADD);

    for (const auto& p : probes) EXPECT_EQ(large.at(p.x, p.y), p.added) << p.x << ", " << p.y;
}

TEST(ze_modify_mask, SamplesTheDiagonalPixelAsOftenAsTheShorterSideIsLong) {
    // Blocks start at 0, 2, 5 and 7. The reference colour is (60 + 2 * 120) / 3 = 100; three
    // samples of the diagonal pixel would make it 105.
    struct {
        const char* small;
        int x, y;    // the small pixel
        int bx, by;  // its block
        int next_bx, next_by;
    } const cases[] = {
        {".#. ..# ...", 1, 0, 2, 0, 5, 2},      // 3 x 2
        {"... #.. .#.", 0, 1, 0, 2, 2, 5},      // 2 x 3
        {"... ... .#. ..#", 1, 2, 2, 5, 5, 7},  // 3 x 2
        {".... ..#. ...#", 2, 1, 5, 2, 7, 5},   // 2 x 3
    };
    for (const auto& c : cases) {
        large_photo photo(8, 8, 0);
        photo.at(c.bx, c.by) = grey(60);
        photo.at(c.next_bx, c.next_by) = grey(120);
        photo.at(c.bx + 1, c.by) = grey(159);
        photo.at(c.bx, c.by + 1) = grey(160);
        photo.at(c.bx + 1, c.by + 1) = grey(41);

        const Picture large = transferred(Picture(c.small), Picture(8, 8, 1), photo, 0.4f,
                                          {c.x, c.x, c.y, c.y}, REMOVE);

        EXPECT_EQ(large.at(c.bx, c.by), 1) << c.small;
        EXPECT_EQ(large.at(c.bx + 1, c.by), 1) << c.small;
        EXPECT_EQ(large.at(c.bx, c.by + 1), 0) << c.small;
        EXPECT_EQ(large.at(c.bx + 1, c.by + 1), 1) << c.small;
    }
}

// ---- Pixels near the reference colour

TEST(ze_modify_mask, DecidesByColourDistanceAndGreenDistance) {
    const uint32_t reference = 0xFF000000 | grey(100);
    struct {
        uint32_t pixel;
        bool matches;
    } const cases[] = {
        {grey(100), true},
        {0x7F000000 | grey(100), true},  // alpha does not count
        // Red and blue, each against green.
        {colour(139, 100, 100), true},
        {colour(140, 100, 100), false},
        {colour(61, 100, 100), true},
        {colour(60, 100, 100), false},
        {colour(100, 100, 139), true},
        {colour(100, 100, 140), false},
        {colour(100, 100, 61), true},
        {colour(100, 100, 60), false},
        // Their distances add up, whatever their signs.
        {colour(120, 100, 119), true},
        {colour(120, 100, 120), false},
        {colour(80, 100, 119), true},
        {colour(80, 100, 120), false},
        {colour(81, 100, 80), true},
        {colour(80, 100, 80), false},
        // Green alone moves both.
        {colour(100, 119, 100), true},
        {colour(100, 120, 100), false},
        {colour(100, 81, 100), true},
        {colour(100, 80, 100), false},
        // The same colour, lighter or darker.
        {grey(159), true},
        {grey(160), false},
        {grey(41), true},
        {grey(40), false},
        // Both limits at once.
        {colour(159 + 39, 159, 159), true},
        {colour(159 + 40, 159, 159), false},
        {colour(160 + 39, 160, 160), false},
    };
    for (const auto& c : cases) {
        const verdict v = judge(reference, c.pixel);
        const int near = c.matches ? 1 : 0;
        EXPECT_EQ(v.added, near) << std::hex << c.pixel;
        EXPECT_EQ(v.kept_of_one, near) << std::hex << c.pixel;
        EXPECT_EQ(v.kept_of_zero, 1 - near) << std::hex << c.pixel;
    }
}

TEST(ze_modify_mask, ComparesDifferencesThatFillTheirRange) {
    // |(255 - 0) - (0 - 255)| is 510: no difference wraps in a byte.
    const verdict v = judge(colour(255, 0, 255), colour(0, 255, 0));
    EXPECT_EQ(v.added, 0);
    EXPECT_EQ(v.kept_of_one, 0);
    EXPECT_EQ(v.kept_of_zero, 1);
    EXPECT_EQ(judge(colour(255, 0, 255), colour(255, 0, 255)).added, 1);
}

TEST(ze_modify_mask, OnEdgesAddingNeverClearsAndRemovingNeverSets) {
    large_photo photo(8, 8, grey(100));
    photo.at(1, 1) = grey(250);
    for (const char* small : {"#. ..", ".# ..", ".. .#", "## #2"}) {
        EXPECT_EQ(transferred(Picture(small), Picture(8, 8, 1), photo, 0.25f, {0, 0, 0, 0}, ADD),
                  Picture(8, 8, 1))
            << small;
        EXPECT_EQ(transferred(Picture(small), Picture(8, 8, 0), photo, 0.25f, {0, 0, 0, 0}, REMOVE),
                  Picture(8, 8, 0))
            << small;
    }
}

TEST(ze_modify_mask, OnEdgesOtherEntriesKeepForeignValues) {
    large_photo photo(8, 8, grey(100));
    photo.at(1, 1) = grey(250);

    const Picture added =
        transferred(Picture("#. .."), Picture(8, 8, 7), photo, 0.25f, {0, 0, 0, 0}, ADD);
    const Picture removed =
        transferred(Picture("#. .."), Picture(8, 8, 7), photo, 0.25f, {0, 0, 0, 0}, REMOVE);

    EXPECT_EQ(added, Picture(R"(
        ####7777
        #7##7777
        ####7777
        ####7777
        77777777
        77777777
        77777777
        77777777)"));
    EXPECT_EQ(removed, Picture(R"(
        77777777
        7.777777
        77777777
        77777777
        77777777
        77777777
        77777777
        77777777)"));
}

// ---- Block positions

TEST(ze_modify_mask, DividesInSinglePrecision) {
    // 1 / 0.1f is 9.9999998..., which single precision rounds to 10.
    Picture expected(30, 30, 0);
    for (int y = 10; y < 20; ++y) {
        for (int x = 10; x < 20; ++x) expected.at(x, y) = 1;
    }
    EXPECT_EQ(transferred(Picture(3, 3, 1), Picture(30, 30, 0), large_photo(30, 30, 0), 0.1f,
                          {1, 1, 1, 1}, ADD),
              expected);
}

TEST(ze_modify_mask, TruncatesBlockPositions) {
    // Blocks start at 0, 2, 5 and 7 (0, 2.5, 5, 7.5).
    EXPECT_EQ(transferred(Picture(4, 2, 1), Picture(10, 2, 0), large_photo(10, 2, 0), 0.4f,
                          {1, 1, 0, 0}, ADD),
              Picture(R"(
                  ..###.....
                  ..###.....)"));
}

TEST(ze_modify_mask, ABlockBeyondTheRowReachesIntoTheNext) {
    // Rows of 2 under a block 4 wide and 4 high: entries 0 to 3 * 2 + 3.
    EXPECT_EQ(transferred(Picture(2, 2, 1), Picture(2, 6, 0), large_photo(2, 6, 0), 0.25f,
                          {0, 0, 0, 0}, ADD),
              Picture("## ## ## ## ## .."));
}

TEST(ze_modify_mask, ABlockWithoutPixelsChangesNothing) {
    for (const Picture& small : {Picture("#. .."), Picture("#. .#")}) {
        for (const int flag : {ADD, REMOVE}) {
            EXPECT_EQ(transferred(small, Picture(1, 1, 7), large_photo(1, 1, 0), 4.0f, {0, 0, 0, 0},
                                  flag),
                      Picture(1, 1, 7));
        }
    }
}

#if UINTPTR_MAX > UINT32_MAX  // no room for it on 32-bit machines
TEST(ze_modify_mask, ReachesPixelsBeyondThirtyOneBits) {
    constexpr int WIDTH = 1 << 30;
    constexpr uint64_t PIXELS = 4 * uint64_t{WIDTH};
    constexpr uint64_t EDGE = 2 * uint64_t{WIDTH}, LAST_ROW = 3 * uint64_t{WIDTH};
    sparse_array<unsigned char> small(PIXELS), large(PIXELS);
    sparse_array<uint32_t> photo(PIXELS);
    ASSERT_TRUE(small.data()) << NO_ROOM;
    ASSERT_TRUE(large.data()) << NO_ROOM;
    ASSERT_TRUE(photo.data()) << NO_ROOM;
    small[EDGE] = 1;
    photo[EDGE] = grey(100);
    large[LAST_ROW] = 7;

    ze_modify_mask(small.data(), large.data(), photo.data(), WIDTH, 4, WIDTH, 0, 1.0f, 0, 0, 2, 2,
                   ADD);
    EXPECT_EQ(large[EDGE], 1);
    ze_modify_mask(small.data(), large.data(), photo.data(), WIDTH, 4, WIDTH, 0, 1.0f, 0, 0, 3, 3,
                   REMOVE);
    EXPECT_EQ(large[LAST_ROW], 0);
}
#endif

// ---- Memory

// Every small mask of 3 x 3, transferred as a whole onto exact arrays. Adding to a full mask leaves
// zeros only under uniform zeros, removing from an empty one leaves ones only under uniform ones.
TEST(ze_modify_mask, TouchesNothingBeyondItsArrays) {
    std::vector<uint32_t> photo;
    for (uint32_t i = 0; i < 36; ++i) photo.push_back(i * 0x00251B0Du);
    for (const guard side : {guard::BEFORE, guard::BEHIND}) {
        guarded_buffer<uint32_t> pixels(photo, side);
        for (unsigned bits = 0; bits < 512; ++bits) {
            std::vector<unsigned char> drawn;
            for (unsigned i = 0; i < 9; ++i) drawn.push_back(bits >> i & 1);
            guarded_buffer<unsigned char> small(drawn, side);
            for (const int flag : {ADD, REMOVE}) {
                const unsigned char before = flag == ADD ? 1 : 0;
                guarded_buffer<unsigned char> large(std::vector<unsigned char>(36, before), side);

                ze_modify_mask(small.data(), large.data(), pixels.data(), 3, 3, 6, 0, 0.5f, 0, 2, 0,
                               2, flag);

                const std::vector<unsigned char> after = large.values();
                for (size_t i = 0; i < 36; ++i) {
                    const size_t s = i / 12 * 3 + i % 6 / 2;
                    const bool last = s % 3 == 2 || s / 3 == 2;
                    const bool overwritten = !last && drawn[s] != before &&
                                             drawn[s + 1] != before && drawn[s + 3] != before &&
                                             drawn[s + 4] != before;
                    ASSERT_EQ(after[i] != before, overwritten)
                        << "small mask " << bits << ", flag " << flag << ", entry " << i;
                }
            }
        }
        EXPECT_EQ(pixels.values(), photo);
    }
}
