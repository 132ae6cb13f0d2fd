#include "jni/view_outline.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <string>
#include <vector>

#include "jni/photo_columns.h"
#include "jni/view_image.h"
#include "jni/view_plain.h"
#include "tests/helpers/guarded_buffer.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/pixels.h"
#include "tests/helpers/sparse_memory.h"

namespace {

constexpr float INFINITE = std::numeric_limits<float>::infinity();
constexpr dash_colours DASHES = {static_cast<int32_t>(FIRST_DASH),
                                 static_cast<int32_t>(SECOND_DASH)};

struct offset {
    int x, y;
};

outlined_photo with_mask(const Pixels& photo, const Picture& mask) {
    return {{photo.ints(), photo.width, photo.height}, mask.cells.data()};
}

// An empty view after draw_image_with_outline, of which the plain loops make the same.
Pixels drawn(int width, int height, const outlined_photo& outlined, float scale, const offset& o,
             const ze_rect& area) {
    Pixels view(width, height, '.'), plain_view = view;
    draw_image_with_outline({view.ints(), width}, outlined, scale, o.x, o.y, DASHES, area);
    plain::draw_image_with_outline({plain_view.ints(), width}, outlined, scale, o.x, o.y, DASHES,
                                   area);
    EXPECT_EQ(plain_view, view) << "from the plain loops";
    return view;
}

Pixels drawn(int width, int height, const Pixels& photo, const Picture& mask, float scale,
             const offset& o, const ze_rect& area) {
    return drawn(width, height, with_mask(photo, mask), scale, o, area);
}

// The same with the whole view redrawn.
Pixels drawn(int width, int height, const Pixels& photo, const Picture& mask, float scale,
             const offset& o) {
    return drawn(width, height, photo, mask, scale, o, {0, width - 1, 0, height - 1});
}

// A view of the photo's size, at scale 1, without an offset.
Pixels drawn(const Pixels& photo, const Picture& mask) {
    return drawn(photo.width, photo.height, photo, mask, 1.0f, {0, 0});
}

// An empty view after draw_small_image_with_outline, of which the plain loops make the same.
Pixels drawn_small(int width, int height, const Pixels& photo, const Picture& mask,
                   const ze_rect& area) {
    Pixels view(width, height, '.'), plain_view = view;
    draw_small_image_with_outline({view.ints(), width}, with_mask(photo, mask), DASHES, area);
    plain::draw_small_image_with_outline({plain_view.ints(), width}, with_mask(photo, mask), DASHES,
                                         area);
    EXPECT_EQ(plain_view, view) << "from the plain loops";
    return view;
}

// A view of the photo's size.
Pixels drawn_small(const Pixels& photo, const Picture& mask) {
    return drawn_small(photo.width, photo.height, photo, mask,
                       {0, photo.width - 1, 0, photo.height - 1});
}

}  // namespace

// ---- dash_colours

TEST(dash_colours, TakeTurnsInCellsOfFive) {
    const struct {
        int x, y;
        bool first;
    } cases[] = {
        {0, 0, true},  {4, 4, true},   {5, 0, false},       {9, 4, false},
        {0, 5, false}, {4, 9, false},  {5, 5, true},        {9, 9, true},
        {10, 0, true}, {10, 5, false}, {1000, 1005, false}, {1005, 1005, true},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(DASHES.at(c.x, c.y), c.first ? DASHES.first : DASHES.second)
            << c.x << ", " << c.y;
    }
}

TEST(dash_colours, CountNegativeCellsTowardsZero) {
    const struct {
        int x, y;
        bool first;
    } cases[] = {
        // -4 .. 4 are one cell.
        {-1, 0, true},
        {-4, 0, true},
        {-4, -4, true},
        {0, -1, true},
        {-4, 5, false},
        {-5, 0, false},
        {-9, 0, false},
        {-10, 0, true},
        {-14, 0, true},
        {-15, 0, false},
        {0, -5, false},
        {0, -10, true},
        // Both odd, of whatever sign.
        {-5, -5, true},
        {-5, 5, true},
        {5, -9, true},
        {-15, -5, true},
        {-5, -10, false},
        // -429496729 is odd, 429496729 too.
        {std::numeric_limits<int>::min(), 0, false},
        {std::numeric_limits<int>::min(), std::numeric_limits<int>::max(), true},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(DASHES.at(c.x, c.y), c.first ? DASHES.first : DASHES.second)
            << c.x << ", " << c.y;
    }
}

// ---- draw_image_with_outline: where the photo is

TEST(draw_image_with_outline, DrawsThePhotoRoundedToTheNearestPixelWithoutASelection) {
    const Picture row(4, 1, 0), column(1, 4, 0);
    // 0.5, 1, 1.5, 2, 2.5, 3
    EXPECT_EQ(drawn(6, 1, Pixels("abcd"), row, 0.5f, {0, 0}), Pixels("abbccd"));
    EXPECT_EQ(drawn(1, 6, Pixels("a b c d"), column, 0.5f, {0, 0}), Pixels("a b b c c d"));
    // The same photo, rounded down.
    Pixels view("......");
    const Pixels photo("abcd");
    draw_image({view.ints(), 6}, {photo.ints(), 4, 1}, 0.5f, 0, 0, {0, 5, 0, 0});
    EXPECT_EQ(view, Pixels("aabbcc"));
}

TEST(draw_image_with_outline, ScalesAndOffsetsLikeTheViewWithoutOutline) {
    const Pixels photo(R"(
        abcd
        efgh
        ijkl)");
    const Picture mask(4, 3, 0);
    EXPECT_EQ(drawn(5, 4, photo, mask, 1.0f, {0, 0}), Pixels("abcdd efghh ijkll ijkll"));
    EXPECT_EQ(drawn(5, 4, photo, mask, 1.0f, {-2, -1}), Pixels("aaabc aaabc eeefg iiijk"));
    EXPECT_EQ(drawn(5, 4, photo, mask, 2.0f, {1, 0}), Pixels("bdddd jllll jllll jllll"));
    EXPECT_EQ(drawn(5, 4, photo, mask, 1.0f, {0, 0}, {1, 2, 1, 3}),
              Pixels("..... .fg.. .jk.. .jk.."));
    EXPECT_EQ(drawn(5, 4, photo, mask, 1.0f, {65537, -65535}),  // 1, 1
              Pixels("fghhh jklll jklll jklll"));
}

TEST(draw_image_with_outline, AddsUpTheErrorOfTheTruncatedStep) {
    // The step of 0.3 is 19660: column 5 is at 1.5 - 4 / 65536 and so nearer to 1.
    EXPECT_EQ(drawn(9, 1, Pixels("abcd"), Picture(4, 1, 0), 0.3f, {0, 0}), Pixels("aabbbbccc"));
    EXPECT_EQ(drawn(9, 1, Pixels("abcd"), Picture(4, 1, 0), 0.3f, {0, 0}, {5, 6, 0, 0}),
              Pixels(".....bc.."));
}

TEST(draw_image_with_outline, ShowsOnePhotoPixelAtScaleZeroAndNan) {
    // Every neighbour of an inner pixel is itself.
    for (const float scale : {0.0f, NAN, 1e-6f}) {
        EXPECT_EQ(drawn(4, 3, Pixels("abc def ghi"), Picture("... .#. ..."), scale, {1, 1}),
                  Pixels("1111 1ee1 1111"))
            << scale;
    }
}

TEST(draw_image_with_outline, SaturatesAHugeScaleAndWrapsPositions) {
    // Columns 2, -32766, 2, -32766.
    for (const float scale : {INFINITE, 1e30f, 32768.0f}) {
        EXPECT_EQ(drawn(4, 1, Pixels("abc"), Picture("..."), scale, {2, 0}), Pixels("caca"));
        EXPECT_EQ(drawn(1, 4, Pixels("a b c"), Picture(". . ."), scale, {0, 2}), Pixels("c a c a"));
    }
    // Columns 1, -32767, 1.
    for (const float scale : {-INFINITE, -1e30f, -32768.0f}) {
        EXPECT_EQ(drawn(3, 1, Pixels("abc"), Picture("..."), scale, {1, 0}), Pixels("bab"));
    }
}

TEST(draw_image_with_outline, WrapsBehindPhotoPosition32767) {
    Pixels wide(40000, 1, 'm');
    wide.cells.front() = Pixels::pixel_of('a');
    wide.cells[32767] = Pixels::pixel_of('b');
    const Picture mask(40000, 1, 0);
    EXPECT_EQ(drawn(3, 1, wide, mask, 1.0f, {32766, 0}), Pixels("mba"));
    // 32767.5, and 32768 by the half that is added for rounding.
    EXPECT_EQ(drawn(2, 1, wide, mask, 0.5f, {32767, 0}), Pixels("ba"));
}

TEST(draw_image_with_outline, ShowsElementZeroOfAPhotoWithoutPixels) {
    const Pixels photo("a");
    const Picture selected("#"), unselected(".");
    const struct {
        int width, height;
    } sizes[] = {{0, 0}, {-1, -1}, {-5, 0}, {0, 7}, {1, -3}, {-7, std::numeric_limits<int>::min()}};
    for (const auto& size : sizes) {
        Pixels view("... ... ...");
        draw_image_with_outline({view.ints(), 3},
                                {{photo.ints(), size.width, size.height}, selected.cells.data()},
                                1.0f, -1, -1, DASHES, {0, 2, 0, 2});
        EXPECT_EQ(view, Pixels("111 1a1 111")) << size.width << " x " << size.height;
        draw_image_with_outline({view.ints(), 3},
                                {{photo.ints(), size.width, size.height}, unselected.cells.data()},
                                1.0f, -1, -1, DASHES, {0, 2, 0, 2});
        EXPECT_EQ(view, Pixels("aaa aaa aaa")) << size.width << " x " << size.height;
    }
}

// ---- draw_image_with_outline: where the outline is

TEST(draw_image_with_outline, DrawsSelectedPixelsBesideOutsideOnes) {
    EXPECT_EQ(drawn(Pixels(7, 7, 'a'), Picture(R"(
                  #######
                  #######
                  #######
                  ###.###
                  #######
                  #######
                  #######)")),
              Pixels(R"(
                  1111122
                  1aaaaa2
                  1aa1aa2
                  1a1a1a2
                  1aa1aa2
                  2aaaaa1
                  2222211)"));
}

TEST(draw_image_with_outline, AWholeSelectionHasDashesOnTheRectangleButNotOnThePhotosBorder) {
    EXPECT_EQ(drawn(10, 10, Pixels(4, 4, 'a'), Picture(4, 4, 1), 1.0f, {-3, -3}), Pixels(R"(
        1111122222
        1aaaaaaaa2
        1aaaaaaaa2
        1aaaaaaaa2
        1aaaaaaaa2
        2aaaaaaaa1
        2aaaaaaaa1
        2aaaaaaaa1
        2aaaaaaaa1
        2222211111)"));
}

TEST(draw_image_with_outline, ShowsThePhotoWhereItsBorderIsSelected) {
    const Pixels photo(R"(
        abcd
        efgh
        ijkl
        mnop)");
    const Picture mask(R"(
        ####
        #..#
        #..#
        ####)");
    // The photo's first and last column and row are repeated on the rectangle's edges.
    EXPECT_EQ(drawn(6, 6, photo, mask, 1.0f, {-1, -1}), Pixels(R"(
        111112
        1abcd2
        1efgh2
        1ijkl2
        1mnop2
        222221)"));
}

TEST(draw_image_with_outline, DashesEverySelectedPixelOnTheRectanglesEdges) {
    EXPECT_EQ(drawn(8, 6, Pixels(8, 6, 'a'), Picture(8, 6, 1), 1.0f, {0, 0}, {2, 5, 1, 4}),
              Pixels(R"(
                  ........
                  ..1112..
                  ..1aa2..
                  ..1aa2..
                  ..1112..
                  ........)"));
    EXPECT_EQ(drawn(8, 6, Pixels(8, 6, 'a'), Picture(8, 6, 0), 1.0f, {0, 0}, {2, 5, 1, 4}),
              Pixels(R"(
                  ........
                  ..aaaa..
                  ..aaaa..
                  ..aaaa..
                  ..aaaa..
                  ........)"));
    // In the middle of a selection, a single row and a single column.
    EXPECT_EQ(drawn(9, 3, Pixels(9, 3, 'a'), Picture(9, 3, 1), 1.0f, {0, 0}, {2, 6, 1, 1}),
              Pixels("......... ..11122.. ........."));
    EXPECT_EQ(drawn(3, 4, Pixels(3, 4, 'a'), Picture(3, 4, 1), 1.0f, {0, 0}, {1, 1, 0, 3}),
              Pixels(".1. .1. .1. .1."));
}

TEST(draw_image_with_outline, IsOneViewPixelWideAtAnyScale) {
    // Photo columns 1, 1, 2, 2, 2, 2, 3, 3, 3, 3, 4, 4; rows likewise.
    EXPECT_EQ(drawn(12, 12, Pixels(5, 6, 'a'), Picture(R"(
                  ###..
                  ###..
                  ###..
                  ###..
                  ###..
                  ###..)"),
                    0.25f, {1, 1}),
              Pixels(R"(
                  111112aaaaaa
                  1aaaa2aaaaaa
                  1aaaa2aaaaaa
                  1aaaa2aaaaaa
                  1aaaa2aaaaaa
                  2aaaa1aaaaaa
                  2aaaa1aaaaaa
                  2aaaa1aaaaaa
                  2aaaa1aaaaaa
                  2aaaa1aaaaaa
                  1aaaa2aaaaaa
                  111112aaaaaa)"));
}

TEST(draw_image_with_outline, LooksOnlyAtTheMaskUnderNeighbouringViewPixels) {
    const Picture mask(R"(
        #.#.##
        ......
        #.#.##
        ......
        #.#.##
        #.#.##)");
    EXPECT_EQ(drawn(3, 3, Pixels(6, 6, 'a'), mask, 2.0f, {0, 0}), Pixels("111 1a1 111"));
    // At scale 1 the same photo pixel is outline.
    EXPECT_EQ(drawn(3, 3, Pixels(6, 6, 'a'), mask, 1.0f, {1, 1}), Pixels("aaa a1a aaa"));
}

TEST(draw_image_with_outline, AnyOneOfFourNeighboursMakesAnOutline) {
    const struct {
        const char* mask;
        char centre;
    } cases[] = {
        {"### ##. ###", '1'}, {"### ### #.#", '1'}, {"### .## ###", '1'}, {"#.# ### ###", '1'},
        {"### ### ###", 'e'}, {".#. ### .#.", 'e'}, {"... ... ...", 'e'},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(drawn(Pixels("abc def ghi"), Picture(c.mask)).cells[4],
                  Pixels::pixel_of(c.centre))
            << c.mask;
    }
}

TEST(draw_image_with_outline, ValuesOneAndThreeAreSelected) {
    for (int value = 0; value < 256; ++value) {
        Picture mask(3, 3, 0);
        mask.at(1, 1) = mask.at(0, 0) = static_cast<unsigned char>(value);
        const bool selected = value == 1 || value == 3;
        EXPECT_EQ(drawn(Pixels("abc def ghi"), mask),
                  Pixels(selected ? "1bc d1f ghi" : "abc def ghi"))
            << value;
    }
}

TEST(draw_image_with_outline, NeighboursOfZeroFourAndFiveAreOutside) {
    const Pixels photo("abc def ghi");
    for (int value = 0; value < 256; ++value) {
        for (const size_t neighbour : {1, 3, 5, 7}) {
            Picture mask(3, 3, 2);
            mask.at(1, 1) = 1;
            mask.cells[neighbour] = static_cast<unsigned char>(value);
            const bool outside = value == 0 || value == 4 || value == 5;
            EXPECT_EQ(drawn(photo, mask).cells[4], Pixels::pixel_of(outside ? '1' : 'e')) << value;
        }
    }
}

// ---- draw_image_with_outline: neighbours beyond the photo

TEST(draw_image_with_outline, ANeighbourBeyondTheLastColumnIsReadInTheNextRow) {
    // View pixel (1, 1) shows photo pixel (2, 2); the next column is 4, which is (0, 3).
    const Pixels photo(4, 4, 'a');
    Picture mask(4, 4, 1);
    EXPECT_EQ(drawn(3, 3, photo, mask, 2.0f, {0, 0}), Pixels("111 1a1 111"));
    mask.at(3, 2) = 0;
    EXPECT_EQ(drawn(3, 3, photo, mask, 2.0f, {0, 0}).cells[4], Pixels::pixel_of('a'));
    mask.at(0, 3) = 0;
    EXPECT_EQ(drawn(3, 3, photo, mask, 2.0f, {0, 0}).cells[4], FIRST_DASH);
}

TEST(draw_image_with_outline, ANeighbourBeforeTheFirstColumnIsReadInTheRowAbove) {
    // View pixel (1, 1) shows photo pixel (1, 1); the column before is -1, which is (3, 0).
    const Pixels photo(4, 4, 'a');
    Picture mask(4, 4, 1);
    EXPECT_EQ(drawn(3, 3, photo, mask, 2.0f, {-1, -1}), Pixels("111 1a1 111"));
    mask.at(0, 1) = 0;
    EXPECT_EQ(drawn(3, 3, photo, mask, 2.0f, {-1, -1}).cells[4], Pixels::pixel_of('a'));
    mask.at(3, 0) = 0;
    EXPECT_EQ(drawn(3, 3, photo, mask, 2.0f, {-1, -1}).cells[4], FIRST_DASH);
}

TEST(draw_image_with_outline, ANeighbourMayBeTheFirstEntryOfTheMask) {
    // View pixel (1, 1) shows photo pixel (1, 1); the column before is -4, which is (0, 0).
    const Pixels photo(4, 4, 'a');
    Picture mask(4, 4, 1);
    EXPECT_EQ(drawn(3, 3, photo, mask, 5.0f, {-4, -4}).cells[4], Pixels::pixel_of('a'));
    mask.at(0, 0) = 0;
    EXPECT_EQ(drawn(3, 3, photo, mask, 5.0f, {-4, -4}).cells[4], FIRST_DASH);
}

TEST(draw_image_with_outline, ANeighbourOutsideTheMaskMakesNoOutline) {
    // The mask lies among zeros that are not its own.
    std::vector<unsigned char> zeros(300000);
    std::fill_n(zeros.begin() + 150000, 16, 1);
    const Pixels photo(4, 4, 'a');
    const outlined_photo outlined = {{photo.ints(), 4, 4}, zeros.data() + 150000};
    for (const float scale : {2.0f, 3.0f, 6.0f, 1000.0f, 20000.0f}) {
        for (const int o : {1, 2}) {
            const int before = o - static_cast<int>(scale);
            EXPECT_EQ(drawn(3, 3, outlined, scale, {before, before}, {0, 2, 0, 2}),
                      Pixels("111 1a1 111"))
                << "scale " << scale << ", pixel " << o;
        }
    }
}

TEST(draw_image_with_outline, GoesOnWhereTilesOfTheViewMeet) {
    constexpr int WIDE = 2 * TILE + 100;
    Picture line(WIDE, 3, 0);
    std::fill_n(line.cells.begin() + WIDE, WIDE, 1);
    const Pixels view = drawn(Pixels(WIDE, 3, 'a'), line);
    for (int x = 0; x < WIDE; ++x) {
        const auto i = static_cast<size_t>(x);
        ASSERT_EQ(view.cells[i], Pixels::pixel_of('a')) << x;
        ASSERT_EQ(view.cells[WIDE + i], static_cast<uint32_t>(DASHES.at(x, 1))) << x;
        ASSERT_EQ(view.cells[2 * WIDE + i], Pixels::pixel_of('a')) << x;
    }

    for (int hole = TILE - 3; hole < TILE + 3; ++hole) {
        Picture mask(WIDE, 5, 1);
        mask.at(hole, 2) = 0;
        const Pixels beside = drawn(Pixels(WIDE, 5, 'a'), mask);
        for (int x = TILE - 5; x < TILE + 5; ++x) {
            const auto expected = x == hole - 1 || x == hole + 1
                                      ? static_cast<uint32_t>(DASHES.at(x, 2))
                                      : Pixels::pixel_of('a');
            ASSERT_EQ(beside.cells[static_cast<size_t>(2 * WIDE + x)], expected)
                << x << " beside a hole at " << hole;
        }
    }
}

TEST(draw_image_with_outline, ANeighbourBehindPosition32767Wraps) {
    // View pixel (1, 1) shows (32767, 1); the next column is -32768, entry 40000 - 32768.
    const Pixels photo(40000, 3, 'm');
    Picture mask(40000, 3, 1);
    EXPECT_EQ(drawn(3, 3, photo, mask, 1.0f, {32766, 0}), Pixels("111 1m1 111"));
    mask.cells[7232] = 0;
    EXPECT_EQ(drawn(3, 3, photo, mask, 1.0f, {32766, 0}), Pixels("111 111 111"));
}

#if UINTPTR_MAX > UINT32_MAX  // no room for it on 32-bit machines
TEST(draw_image_with_outline, ReachesPixelsBeyondThirtyOneBits) {
    constexpr int WIDTH = 1 << 30;
    constexpr uint64_t PIXELS = 4 * uint64_t{WIDTH};
    constexpr uint64_t PIXEL = 2 * uint64_t{WIDTH} + 1;
    sparse_array<int32_t> photo(PIXELS);
    sparse_array<unsigned char> mask(PIXELS);
    ASSERT_TRUE(photo.data()) << NO_ROOM;
    ASSERT_TRUE(mask.data()) << NO_ROOM;
    photo[PIXEL] = 42;
    mask[PIXEL] = mask[PIXEL - 1] = mask[PIXEL + 1] = mask[PIXEL - WIDTH] = mask[PIXEL + WIDTH] = 1;
    std::vector<int32_t> view(9);

    draw_image_with_outline({view.data(), 3}, {{photo.data(), WIDTH, 4}, mask.data()}, 1.0f, 0, 1,
                            DASHES, {0, 2, 0, 2});
    EXPECT_EQ(view[4], 42);

    mask[PIXEL + WIDTH] = 0;
    draw_image_with_outline({view.data(), 3}, {{photo.data(), WIDTH, 4}, mask.data()}, 1.0f, 0, 1,
                            DASHES, {0, 2, 0, 2});
    EXPECT_EQ(view[4], DASHES.first);
}
#endif

// ---- draw_image_with_outline: empty rectangles

TEST(draw_image_with_outline, DrawsRowsTopAndBottomWhenTopIsBelowBottom) {
    const Pixels photo(R"(
        abc
        def
        ghi
        jkl
        mno)");
    EXPECT_EQ(drawn(3, 5, photo, Picture(3, 5, 0), 1.0f, {0, 0}, {0, 1, 3, 1}), Pixels(R"(
        ...
        de.
        ...
        jk.
        ...)"));
    EXPECT_EQ(drawn(3, 5, photo, Picture(3, 5, 1), 1.0f, {0, 0}, {0, 1, 3, 1}), Pixels(R"(
        ...
        11.
        ...
        11.
        ...)"));
}

TEST(draw_image_with_outline, DrawsColumnsLeftAndRightWhenLeftIsBeyondRight) {
    const Pixels photo(R"(
        abcde
        fghij
        klmno
        pqrst)");
    EXPECT_EQ(drawn(5, 4, photo, Picture(5, 4, 0), 1.0f, {0, 0}, {3, 1, 0, 3}), Pixels(R"(
        .....
        .g.i.
        .l.n.
        .....)"));
    EXPECT_EQ(drawn(5, 4, photo, Picture(5, 4, 1), 1.0f, {0, 0}, {3, 1, 0, 3}), Pixels(R"(
        .....
        .1.1.
        .1.1.
        .....)"));
}

TEST(draw_image_with_outline, DrawsNothingWhenNeitherRowsNorColumnsAreLeft) {
    for (const ze_rect& area : {ze_rect{2, 0, 2, 0}, {2, 0, 1, 1}, {2, 0, 0, 1}}) {
        EXPECT_EQ(drawn(3, 3, Pixels("abc def ghi"), Picture(3, 3, 1), 1.0f, {0, 0}, area),
                  Pixels("... ... ..."))
            << area.top << " .. " << area.bottom;
    }
}

// ---- draw_small_image_with_outline

TEST(draw_small_image_with_outline, DrawsThePhotoWithoutASelection) {
    EXPECT_EQ(drawn_small(6, 5, Pixels("abc def"), Picture("... ..."), {1, 5, 1, 3}), Pixels(R"(
        ......
        .abccc
        .defff
        .defff
        ......)"));
    EXPECT_EQ(drawn_small(4, 3, Pixels("abcd efgh ijkl"), Picture(4, 3, 0), {2, 3, 1, 2}),
              Pixels(".... ..ab ..ef"));
}

TEST(draw_small_image_with_outline, AWholeSelectionHasDashesOnThePhotosBorder) {
    EXPECT_EQ(drawn_small(Pixels(7, 6, 'a'), Picture(7, 6, 1)), Pixels(R"(
        1111122
        1aaaaa2
        1aaaaa2
        1aaaaa2
        1aaaaa2
        2222211)"));
}

TEST(draw_small_image_with_outline, GoesOnWhereTilesOfTheViewMeet) {
    constexpr int WIDE = 2 * TILE + 100;
    Picture line(WIDE, 3, 0);
    std::fill_n(line.cells.begin() + WIDE, WIDE, 1);
    const Pixels view = drawn_small(Pixels(WIDE, 3, 'a'), line);
    for (int x = 0; x < WIDE; ++x) {
        ASSERT_EQ(view.cells[static_cast<size_t>(WIDE + x)], static_cast<uint32_t>(DASHES.at(x, 1)))
            << x;
    }
}

TEST(draw_small_image_with_outline, TheRectanglesEdgesAreNoOutline) {
    EXPECT_EQ(drawn_small(8, 6, Pixels(8, 6, 'a'), Picture(8, 6, 1), {2, 5, 1, 4}), Pixels(R"(
        ........
        ..1112..
        ..1aaa..
        ..1aaa..
        ..1aaa..
        ........)"));
}

TEST(draw_small_image_with_outline, DashesASelectedBorder) {
    EXPECT_EQ(drawn_small(Pixels("abcd efgh ijkl mnop"), Picture("#### #..# #..# ####")),
              Pixels("1111 1fg1 1jk1 1111"));
}

TEST(draw_small_image_with_outline, ASingleSelectedPixelIsOneDash) {
    EXPECT_EQ(drawn_small(Pixels(5, 5, 'a'), Picture(R"(
                  .....
                  .....
                  ..#..
                  .....
                  .....)")),
              Pixels(R"(
                  aaaaa
                  aaaaa
                  aa1aa
                  aaaaa
                  aaaaa)"));
}

TEST(draw_small_image_with_outline, TheDashPatternIsThatOfTheView) {
    const std::string even = "111112222211\n", odd = "222221111122\n";
    const std::string board =
        even + even + even + even + even + odd + odd + odd + odd + odd + even + even;
    EXPECT_EQ(drawn_small(12, 12, Pixels("a"), Picture("#"), {0, 11, 0, 11}), Pixels(board));
    EXPECT_EQ(drawn_small(7, 1, Pixels("abc"), Picture("###"), {4, 6, 0, 0}), Pixels("....122"));
}

TEST(draw_small_image_with_outline, AnyOneOfFourNeighboursMakesAnOutline) {
    const struct {
        const char* mask;
        char centre;
    } cases[] = {
        {"### ##. ###", '1'}, {"### ### #.#", '1'}, {"### .## ###", '1'}, {"#.# ### ###", '1'},
        {"### ### ###", 'e'}, {".#. ### .#.", 'e'}, {"... ... ...", 'e'},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(drawn_small(Pixels("abc def ghi"), Picture(c.mask)).cells[4],
                  Pixels::pixel_of(c.centre))
            << c.mask;
    }
}

TEST(draw_small_image_with_outline, OnlyAOneIsSelected) {
    for (int value = 0; value < 256; ++value) {
        Picture mask(3, 3, 0);
        mask.at(1, 1) = mask.at(0, 0) = static_cast<unsigned char>(value);
        EXPECT_EQ(drawn_small(Pixels("abc def ghi"), mask),
                  Pixels(value == 1 ? "1bc d1f ghi" : "abc def ghi"))
            << value;
    }
}

TEST(draw_small_image_with_outline, OnlyAZeroIsOutside) {
    const Pixels photo("abc def ghi");
    for (int value = 0; value < 256; ++value) {
        for (const size_t neighbour : {1, 3, 5, 7}) {
            Picture mask(3, 3, 2);
            mask.at(1, 1) = 1;
            mask.cells[neighbour] = static_cast<unsigned char>(value);
            EXPECT_EQ(drawn_small(photo, mask).cells[4], Pixels::pixel_of(value == 0 ? '1' : 'e'))
                << value;
        }
    }
}

TEST(draw_small_image_with_outline, DrawsNothingInAnEmptyRectangle) {
    for (const ze_rect& area : {ze_rect{0, 2, 2, 0}, {2, 0, 0, 2}, {2, 0, 2, 0}, {0, 2, 2, 1}}) {
        EXPECT_EQ(drawn_small(3, 3, Pixels("abc def ghi"), Picture(3, 3, 1), area),
                  Pixels("... ... ..."));
    }
}

TEST(draw_small_image_with_outline, ShowsElementZeroOfAPhotoWithoutPixels) {
    const Pixels photo("a");
    const Picture selected("#"), unselected(".");
    const struct {
        int width, height;
    } sizes[] = {{0, 0}, {-1, -1}, {-5, 0}, {0, 7}, {1, -3}, {-7, std::numeric_limits<int>::min()}};
    for (const auto& size : sizes) {
        Pixels view("... ...");
        draw_small_image_with_outline(
            {view.ints(), 3}, {{photo.ints(), size.width, size.height}, selected.cells.data()},
            DASHES, {0, 2, 0, 1});
        EXPECT_EQ(view, Pixels("111 111")) << size.width << " x " << size.height;
        draw_small_image_with_outline(
            {view.ints(), 3}, {{photo.ints(), size.width, size.height}, unselected.cells.data()},
            DASHES, {0, 2, 0, 1});
        EXPECT_EQ(view, Pixels("aaa aaa")) << size.width << " x " << size.height;
    }
}

#if UINTPTR_MAX > UINT32_MAX  // no room for it on 32-bit machines
TEST(draw_small_image_with_outline, ReachesPixelsBeyondThirtyOneBits) {
    constexpr int WIDTH = 1 << 30;
    constexpr uint64_t PIXELS = 5 * uint64_t{WIDTH};
    constexpr uint64_t PIXEL = 3 * uint64_t{WIDTH} + 1;
    sparse_array<int32_t> photo(PIXELS);
    sparse_array<unsigned char> mask(PIXELS);
    ASSERT_TRUE(photo.data()) << NO_ROOM;
    ASSERT_TRUE(mask.data()) << NO_ROOM;
    photo[PIXEL] = 42;
    mask[PIXEL] = mask[PIXEL - 1] = mask[PIXEL + 1] = mask[PIXEL - WIDTH] = mask[PIXEL + WIDTH] = 1;
    std::vector<int32_t> view(8);

    draw_small_image_with_outline({view.data(), 2}, {{photo.data(), WIDTH, 5}, mask.data()}, DASHES,
                                  {0, 1, 0, 3});
    EXPECT_EQ(view[7], 42);

    mask[PIXEL + WIDTH] = 0;
    draw_small_image_with_outline({view.data(), 2}, {{photo.data(), WIDTH, 5}, mask.data()}, DASHES,
                                  {0, 1, 0, 3});
    EXPECT_EQ(view[7], DASHES.first);
}
#endif

// ---- Memory: every mask of 3 x 3

namespace {

Picture mask_of_bits(unsigned bits) {
    Picture mask(3, 3, 0);
    for (unsigned i = 0; i < 9; ++i) mask.cells[i] = bits >> i & 1;
    return mask;
}

}  // namespace

TEST(draw_image_with_outline, TouchesNothingBeyondItsArrays) {
    const Pixels photo("abc def ghi");
    // Where a neighbour beyond the mask were read, its 0 would make an outline.
    constexpr size_t MIDDLE = 150000;
    std::vector<unsigned char> zeros(2 * MIDDLE);
    for (const guard side : {guard::BEFORE, guard::BEHIND}) {
        guarded_buffer<uint32_t> guarded_photo(photo.cells, side);
        guarded_buffer<uint32_t> guarded_view(std::vector<uint32_t>(20), side);
        for (unsigned bits = 0; bits < 512; ++bits) {
            const Picture mask = mask_of_bits(bits);
            guarded_buffer<unsigned char> guarded_mask(mask.cells, side);
            std::copy(mask.cells.begin(), mask.cells.end(), zeros.begin() + MIDDLE);
            for (const float scale : {-1.0f, 0.3f, 1.0f, 2.0f, 1000.0f, INFINITE}) {
                for (const offset& o : {offset{0, 0}, {-1, -1}, {1, 0}, {-999, -999}}) {
                    Pixels view(5, 4, '.');
                    draw_image_with_outline({view.ints(), 5},
                                            {{photo.ints(), 3, 3}, zeros.data() + MIDDLE}, scale,
                                            o.x, o.y, DASHES, {0, 4, 0, 3});
                    draw_image_with_outline(
                        {reinterpret_cast<int32_t*>(guarded_view.data()), 5},
                        {{reinterpret_cast<const int32_t*>(guarded_photo.data()), 3, 3},
                         guarded_mask.data()},
                        scale, o.x, o.y, DASHES, {0, 4, 0, 3});
                    ASSERT_EQ(guarded_view.values(), view.cells)
                        << mask << "\nscale " << scale << ", offset " << o.x << ", " << o.y;
                }
            }
        }
    }
}

TEST(draw_small_image_with_outline, TouchesNothingBeyondItsArrays) {
    const Pixels photo("abc def ghi");
    for (const guard side : {guard::BEFORE, guard::BEHIND}) {
        guarded_buffer<uint32_t> guarded_photo(photo.cells, side);
        guarded_buffer<uint32_t> guarded_view(std::vector<uint32_t>(9), side);
        for (unsigned bits = 0; bits < 512; ++bits) {
            const Picture mask = mask_of_bits(bits);
            guarded_buffer<unsigned char> guarded_mask(mask.cells, side);

            draw_small_image_with_outline(
                {reinterpret_cast<int32_t*>(guarded_view.data()), 3},
                {{reinterpret_cast<const int32_t*>(guarded_photo.data()), 3, 3},
                 guarded_mask.data()},
                DASHES, {0, 2, 0, 2});

            Pixels expected = photo;
            for (size_t i = 0; i < 9; ++i) {
                if (mask.cells[i] == 1) expected.cells[i] = FIRST_DASH;
            }
            const bool inside = mask.cells[1] && mask.cells[3] && mask.cells[5] && mask.cells[7];
            if (inside) expected.cells[4] = photo.cells[4];
            ASSERT_EQ(guarded_view.values(), expected.cells) << mask;
        }
    }
}
