#include "jni/view_image.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <vector>

#include "tests/helpers/guarded_buffer.h"
#include "tests/helpers/pixels.h"
#include "tests/helpers/sparse_memory.h"

namespace {

constexpr float INFINITE = std::numeric_limits<float>::infinity();
constexpr int LOWEST = std::numeric_limits<int>::min();

photo_pixels photo_of(const Pixels& photo) { return {photo.ints(), photo.width, photo.height}; }

struct offset {
    int x, y;
};

// An empty view after draw_image.
Pixels drawn(int width, int height, const Pixels& photo, float scale, const offset& o,
             const ze_rect& area) {
    Pixels view(width, height, '.');
    draw_image({view.ints(), width}, photo_of(photo), scale, o.x, o.y, area);
    return view;
}

// The same with the whole view redrawn.
Pixels drawn(int width, int height, const Pixels& photo, float scale, const offset& o) {
    return drawn(width, height, photo, scale, o, {0, width - 1, 0, height - 1});
}

// An empty view after draw_small_image.
Pixels drawn_small(int width, int height, const Pixels& photo, const ze_rect& area) {
    Pixels view(width, height, '.');
    draw_small_image({view.ints(), width}, photo_of(photo), area);
    return view;
}

// The points of an array with one element to spare, -77 where nothing was written.
std::vector<int32_t> points(int columns, int rows, float scale, const offset& o) {
    std::vector<int32_t> all(static_cast<size_t>(std::max(columns, 0) + std::max(rows, 0) + 1),
                             -77);
    set_image_points(columns, rows, scale, o.x, o.y, all.data());
    return all;
}

}  // namespace

// ---- draw_image

TEST(draw_image, CopiesAtScaleOneAndRepeatsTheLastColumnAndRow) {
    EXPECT_EQ(drawn(5, 4, Pixels("abc def"), 1.0f, {0, 0}), Pixels(R"(
        abccc
        defff
        defff
        defff)"));
}

TEST(draw_image, CopiesAllBitsOfAPixel) {
    Pixels photo("....");
    photo.cells = {0x00000000, 0x00FFFFFF, 0x80123456, 0xFFFFFFFF};
    Pixels view("zzzz");
    draw_image({view.ints(), 4}, photo_of(photo), 1.0f, 0, 0, {0, 3, 0, 0});
    EXPECT_EQ(view, photo);
}

TEST(draw_image, LeavesTheViewOutsideTheRectangle) {
    EXPECT_EQ(drawn(5, 4, Pixels("abcde fghij klmno pqrst"), 1.0f, {0, 0}, {1, 3, 1, 2}), Pixels(R"(
        .....
        .ghi.
        .lmn.
        .....)"));
}

TEST(draw_image, DrawsNothingInAnEmptyRectangle) {
    for (const ze_rect& area : {ze_rect{0, 2, 2, 0}, {2, 0, 0, 2}, {2, 0, 2, 0}, {0, 2, 2, 1}}) {
        EXPECT_EQ(drawn(3, 3, Pixels("abc def ghi"), 1.0f, {0, 0}, area), Pixels("... ... ..."));
    }
}

TEST(draw_image, ShowsEverySecondPhotoPixelAtScaleTwo) {
    EXPECT_EQ(drawn(3, 1, Pixels("abcdefg"), 2.0f, {1, 0}), Pixels("bdf"));
    EXPECT_EQ(drawn(1, 3, Pixels("a b c d e f g"), 2.0f, {0, 1}), Pixels("b d f"));
}

TEST(draw_image, ShowsEveryPhotoPixelTwiceAtScaleOneHalf) {
    EXPECT_EQ(drawn(4, 1, Pixels("abcd"), 0.5f, {1, 0}), Pixels("bbcc"));
    EXPECT_EQ(drawn(1, 4, Pixels("a b c d"), 0.5f, {0, 1}), Pixels("b b c c"));
}

TEST(draw_image, ShowsTheFirstColumnAndRowBeforeThePhoto) {
    EXPECT_EQ(drawn(5, 1, Pixels("abc"), 1.0f, {-2, 0}), Pixels("aaabc"));
    EXPECT_EQ(drawn(1, 5, Pixels("a b c"), 1.0f, {0, -2}), Pixels("a a a b c"));
}

// The step of 0.3 is 19660 where 19660.8 would be exact: column 10 is at 2.9998.
TEST(draw_image, AddsUpTheErrorOfTheTruncatedStep) {
    EXPECT_EQ(drawn(12, 1, Pixels("abcd"), 0.3f, {0, 0}), Pixels("aaaabbbccccd"));
    EXPECT_EQ(drawn(1, 12, Pixels("a b c d"), 0.3f, {0, 0}), Pixels("a a a a b b b c c c c d"));
}

TEST(draw_image, KeepsPhotoPositionsInAnyRectangle) {
    EXPECT_EQ(drawn(12, 1, Pixels("abcd"), 0.3f, {0, 0}, {10, 11, 0, 0}), Pixels("..........cd"));
    EXPECT_EQ(drawn(1, 12, Pixels("a b c d"), 0.3f, {0, 0}, {0, 0, 10, 11}),
              Pixels(". . . . . . . . . . c d"));
}

TEST(draw_image, MirrorsAtANegativeScale) {
    EXPECT_EQ(drawn(4, 1, Pixels("abcd"), -1.0f, {2, 0}), Pixels("cbaa"));
    // 1, 0.5, 0, -0.5
    EXPECT_EQ(drawn(4, 1, Pixels("abcd"), -0.5f, {1, 0}), Pixels("baaa"));
}

TEST(draw_image, GoesBackAcrossAPixelsEdgeAtTheSmallestNegativeScale) {
    EXPECT_EQ(drawn(3, 2, Pixels("abc def"), -1.0f / 65536, {3, 1}), Pixels("fff ccc"));
    EXPECT_EQ(drawn(3, 2, Pixels("abc def"), -1.0f / 65536, {2, 0}), Pixels("cbb cbb"));
}

TEST(draw_image, ShowsOnePhotoPixelAtScaleZeroAndNan) {
    for (const float scale : {0.0f, -0.0f, NAN, 1e-6f}) {
        EXPECT_EQ(drawn(3, 2, Pixels("abc def"), scale, {1, 1}), Pixels("eee eee")) << scale;
        EXPECT_EQ(drawn(3, 2, Pixels("abc def"), scale, {9, -9}), Pixels("ccc ccc")) << scale;
    }
}

TEST(draw_image, SaturatesAHugeScaleAndWrapsPositions) {
    // Columns 0, 32767, -1, 32767.
    for (const float scale : {INFINITE, 1e30f, 32768.0f}) {
        EXPECT_EQ(drawn(4, 1, Pixels("abc"), scale, {0, 0}), Pixels("acac")) << scale;
        EXPECT_EQ(drawn(1, 4, Pixels("a b c"), scale, {0, 0}), Pixels("a c a c")) << scale;
    }
    // Columns 1, -32767, 1.
    for (const float scale : {-INFINITE, -1e30f, -32768.0f}) {
        EXPECT_EQ(drawn(3, 1, Pixels("abc"), scale, {1, 0}), Pixels("bab")) << scale;
    }
}

TEST(draw_image, WrapsOffsets) {
    EXPECT_EQ(drawn(2, 1, Pixels("abc"), 1.0f, {65537, 0}), Pixels("bc"));
    EXPECT_EQ(drawn(2, 1, Pixels("abc"), 1.0f, {32768, 0}), Pixels("aa"));
    EXPECT_EQ(drawn(2, 1, Pixels("abc"), 1.0f, {LOWEST, LOWEST}), Pixels("ab"));
    EXPECT_EQ(drawn(1, 2, Pixels("a b c"), 1.0f, {0, 65537}), Pixels("b c"));
}

TEST(draw_image, WrapsBehindPhotoPosition32767) {
    Pixels wide(40000, 1, 'm');
    wide.cells.front() = Pixels::pixel_of('a');
    wide.cells[32767] = Pixels::pixel_of('b');
    EXPECT_EQ(drawn(3, 1, wide, 1.0f, {32766, 0}), Pixels("mba"));

    Pixels tall(1, 40000, 'm');
    tall.cells = wide.cells;
    EXPECT_EQ(drawn(1, 3, tall, 1.0f, {0, 32766}), Pixels("m b a"));
}

TEST(draw_image, ShowsElementZeroOfAPhotoWithoutPixels) {
    const Pixels one("a");
    for (const offset& size : {offset{0, 0}, {-1, -1}, {-5, 0}, {0, 7}, {-7, LOWEST}, {1, -3}}) {
        Pixels view("... ...");
        draw_image({view.ints(), 3}, {one.ints(), size.x, size.y}, 1.0f, -1, -1, {0, 2, 0, 1});
        EXPECT_EQ(view, Pixels("aaa aaa")) << size.x << " x " << size.y;
    }
    const Pixels row("abc");
    Pixels view("... ...");
    draw_image({view.ints(), 3}, {row.ints(), 3, 0}, 1.0f, 0, 0, {0, 2, 0, 1});
    EXPECT_EQ(view, Pixels("abc abc"));
}

#if UINTPTR_MAX > UINT32_MAX  // no room for it on 32-bit machines
TEST(draw_image, ReachesPixelsBeyondThirtyOneBits) {
    constexpr int WIDTH = 1 << 30;
    constexpr uint64_t PIXELS = 4 * uint64_t{WIDTH}, LAST_ROW = 3 * uint64_t{WIDTH};
    sparse_array<int32_t> photo(PIXELS), view(PIXELS);
    ASSERT_TRUE(photo.data()) << NO_ROOM;
    ASSERT_TRUE(view.data()) << NO_ROOM;
    photo[LAST_ROW + 5] = 42;

    draw_image({view.data(), WIDTH}, {photo.data(), WIDTH, 4}, 1.0f, 2, 0, {3, 3, 3, 3});

    EXPECT_EQ(view[LAST_ROW + 3], 42);
}
#endif

TEST(draw_image, TouchesNothingBeyondItsArrays) {
    struct {
        float scale;
        offset o;
        const char* view;
    } const cases[] = {
        {1.0f, {0, 0}, "abcc deff deff"},
        {1.0f, {-2, -1}, "aaab aaab ddde"},
        {1.0f, {2, 1}, "ffff ffff ffff"},
        {0.5f, {0, 0}, "aabb aabb ddee"},
        {1000.0f, {-1, -1}, "accc dfff dfff"},
        {INFINITE, {0, 0}, "acac dfdf acac"},  // rows 0, 32767, -1
    };
    for (const guard side : {guard::BEFORE, guard::BEHIND}) {
        guarded_buffer<uint32_t> photo(Pixels("abc def").cells, side);
        for (const auto& c : cases) {
            Pixels view("zzzz zzzz zzzz");
            guarded_buffer<uint32_t> guarded(view.cells, side);

            draw_image({reinterpret_cast<int32_t*>(guarded.data()), 4},
                       {reinterpret_cast<const int32_t*>(photo.data()), 3, 2}, c.scale, c.o.x,
                       c.o.y, {0, 3, 0, 2});

            view.cells = guarded.values();
            EXPECT_EQ(view, Pixels(c.view)) << "scale " << c.scale;
        }
    }
}

// ---- draw_small_image

TEST(draw_small_image, RepeatsTheLastColumnAndRowOfASmallerPhoto) {
    EXPECT_EQ(drawn_small(7, 5, Pixels("ab cd"), {1, 5, 1, 4}), Pixels(R"(
        .......
        .abbbb.
        .cdddd.
        .cdddd.
        .cdddd.)"));
}

TEST(draw_small_image, CutsOffALargerPhoto) {
    EXPECT_EQ(drawn_small(4, 3, Pixels("abcd efgh ijkl"), {2, 3, 1, 2}), Pixels(R"(
        ....
        ..ab
        ..ef)"));
}

TEST(draw_small_image, FillsTheRectangleWithAPhotoOfOnePixel) {
    EXPECT_EQ(drawn_small(4, 3, Pixels("a"), {0, 3, 0, 2}), Pixels("aaaa aaaa aaaa"));
}

TEST(draw_small_image, CopiesAllBitsOfAPixel) {
    Pixels photo("....");
    photo.cells = {0x00000000, 0x00FFFFFF, 0x80123456, 0xFFFFFFFF};
    Pixels view("zzzz");
    draw_small_image({view.ints(), 4}, photo_of(photo), {0, 3, 0, 0});
    EXPECT_EQ(view, photo);
}

TEST(draw_small_image, DrawsNothingInAnEmptyRectangle) {
    for (const ze_rect& area : {ze_rect{0, 2, 2, 0}, {2, 0, 0, 2}, {2, 0, 2, 0}, {0, 2, 2, 1}}) {
        EXPECT_EQ(drawn_small(3, 3, Pixels("abc def ghi"), area), Pixels("... ... ..."));
    }
}

TEST(draw_small_image, ShowsElementZeroOfAPhotoWithoutPixels) {
    const Pixels one("a");
    for (const offset& size : {offset{0, 0}, {-1, -1}, {-5, 0}, {0, 7}, {-7, LOWEST}, {1, -3}}) {
        Pixels view("... ...");
        draw_small_image({view.ints(), 3}, {one.ints(), size.x, size.y}, {0, 2, 0, 1});
        EXPECT_EQ(view, Pixels("aaa aaa")) << size.x << " x " << size.y;
    }
}

#if UINTPTR_MAX > UINT32_MAX  // no room for it on 32-bit machines
TEST(draw_small_image, ReachesPixelsBeyondThirtyOneBits) {
    constexpr int WIDTH = 1 << 30;
    constexpr uint64_t PIXELS = 4 * uint64_t{WIDTH}, LAST_ROW = 3 * uint64_t{WIDTH};
    sparse_array<int32_t> photo(PIXELS), view(PIXELS);
    ASSERT_TRUE(photo.data()) << NO_ROOM;
    ASSERT_TRUE(view.data()) << NO_ROOM;
    photo[LAST_ROW] = 42;

    draw_small_image({view.data(), WIDTH}, {photo.data(), WIDTH, 4}, {0, 0, 0, 3});

    EXPECT_EQ(view[LAST_ROW], 42);
}
#endif

TEST(draw_small_image, TouchesNothingBeyondItsArrays) {
    for (const guard side : {guard::BEFORE, guard::BEHIND}) {
        guarded_buffer<uint32_t> photo(Pixels("abc def").cells, side);
        Pixels view("zzzz zzzz zzzz");
        guarded_buffer<uint32_t> guarded(view.cells, side);

        draw_small_image({reinterpret_cast<int32_t*>(guarded.data()), 4},
                         {reinterpret_cast<const int32_t*>(photo.data()), 3, 2}, {0, 3, 0, 2});

        view.cells = guarded.values();
        EXPECT_EQ(view, Pixels("abcc deff deff"));
    }
}

// ---- set_image_points

TEST(set_image_points, WritesColumnsAndBehindThemRows) {
    EXPECT_EQ(points(3, 2, 2.0f, {5, 7}), (std::vector<int32_t>{5, 7, 9, 7, 9, -77}));
}

TEST(set_image_points, WritesNothingForCountsOfZero) {
    EXPECT_EQ(points(0, 0, 1.0f, {5, 7}), (std::vector<int32_t>{-77}));
    EXPECT_EQ(points(2, 0, 1.0f, {5, 7}), (std::vector<int32_t>{5, 6, -77}));
    EXPECT_EQ(points(0, 2, 1.0f, {5, 7}), (std::vector<int32_t>{7, 8, -77}));
}

TEST(set_image_points, NegativeCountsWriteNothingOfTheirKind) {
    EXPECT_EQ(points(3, -2, 1.0f, {5, 7}), (std::vector<int32_t>{5, 6, 7, -77}));
    EXPECT_EQ(points(-1, 3, 1.0f, {5, 7}), (std::vector<int32_t>{8, 9, -77, -77}));
}

TEST(set_image_points, DoesNotClampToThePhoto) {
    EXPECT_EQ(points(3, 2, 1.0f, {-2, 30000}),
              (std::vector<int32_t>{-2, -1, 0, 30000, 30001, -77}));
}

TEST(set_image_points, RoundsTowardsMinusInfinity) {
    // -1, -0.5, 0, 0.5; 0, 0.5
    EXPECT_EQ(points(4, 2, 0.5f, {-1, 0}), (std::vector<int32_t>{-1, -1, 0, 0, 0, 0, -77}));
}

TEST(set_image_points, AddsUpTheErrorOfTheTruncatedStep) {
    EXPECT_EQ(points(11, 0, 0.3f, {100, 0}),
              (std::vector<int32_t>{100, 100, 100, 100, 101, 101, 101, 102, 102, 102, 102, -77}));
    // The step of -0.3 is -19660; -19661 would put column 10 below -3.
    EXPECT_EQ(points(11, 0, -0.3f, {0, 0}),
              (std::vector<int32_t>{0, -1, -1, -1, -2, -2, -2, -3, -3, -3, -3, -77}));
}

TEST(set_image_points, SaturatesTheScaleAndWrapsPositions) {
    const std::vector<int32_t> largest = {0, 32767, -1, 32767, -77};
    for (const float scale : {INFINITE, 1e30f, 32768.0f}) {
        EXPECT_EQ(points(4, 0, scale, {0, 0}), largest) << scale;
        EXPECT_EQ(points(0, 4, scale, {0, 0}), largest) << scale;
    }
    const std::vector<int32_t> smallest = {3, -32765, 3, -77};
    for (const float scale : {-INFINITE, -1e30f, -32768.0f}) {
        EXPECT_EQ(points(3, 0, scale, {3, 3}), smallest) << scale;
    }
    EXPECT_EQ(points(1, 2, NAN, {3, 4}), (std::vector<int32_t>{3, 4, 4, -77}));
    EXPECT_EQ(points(2, 2, 1.0f, {32767, 65536}), (std::vector<int32_t>{32767, -32768, 0, 1, -77}));
}

TEST(set_image_points, NamesThePhotoPixelsThatDrawImageShows) {
    constexpr int SIDE = 24;
    Pixels photo(SIDE, SIDE, '.');
    for (uint32_t i = 0; i < SIDE * SIDE; ++i) photo.cells[i] = i;
    const auto clamped = [](int32_t p) { return p < 0 ? 0 : p >= SIDE ? SIDE - 1 : p; };
    for (const float scale : {0.1f, 0.3f, 0.7f, 1.0f, 1.37f, 2.9f, -0.6f}) {
        for (const offset& o : {offset{0, 0}, {-5, 7}, {11, -9}, {30, 2}}) {
            const std::vector<int32_t> at = points(SIDE, SIDE, scale, o);
            const Pixels view = drawn(SIDE, SIDE, photo, scale, o);
            for (size_t i = 0; i < view.cells.size(); ++i) {
                const int32_t x = clamped(at[i % SIDE]), y = clamped(at[SIDE + i / SIDE]);
                ASSERT_EQ(view.cells[i], static_cast<uint32_t>(y * SIDE + x))
                    << "scale " << scale << ", offset " << o.x << ", " << o.y;
            }
        }
    }
}

TEST(set_image_points, TouchesNothingBeyondColumnsPlusRows) {
    for (const guard side : {guard::BEFORE, guard::BEHIND}) {
        guarded_buffer<int32_t> array(std::vector<int32_t>(5, -77), side);
        set_image_points(3, 2, 1.0f, 5, 7, array.data());
        EXPECT_EQ(array.values(), (std::vector<int32_t>{5, 6, 7, 7, 8}));
        set_image_points(-3, 8, 1.0f, 0, 1, array.data());  // rows 0 to 2 lie before the array
        EXPECT_EQ(array.values(), (std::vector<int32_t>{4, 5, 6, 7, 8}));
        set_image_points(5, LOWEST, 1.0f, 2, 0, array.data());
        EXPECT_EQ(array.values(), (std::vector<int32_t>{2, 3, 4, 5, 6}));
        set_image_points(LOWEST, LOWEST, 1.0f, 0, 0, array.data());
        set_image_points(LOWEST, 9, 1.0f, 0, 0, array.data());
        set_image_points(-3, 3, 1.0f, 0, 0, array.data());
        EXPECT_EQ(array.values(), (std::vector<int32_t>{2, 3, 4, 5, 6}));
    }
}
