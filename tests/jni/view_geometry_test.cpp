#include "jni/view_geometry.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace {

constexpr int HIGHEST = std::numeric_limits<int>::max();
constexpr int LOWEST = std::numeric_limits<int>::min();

}  // namespace

TEST(axis_of, TruncatesTheScaleTo16Point16TowardsZero) {
    constexpr float INFINITE = std::numeric_limits<float>::infinity();
    struct {
        float scale;
        int32_t step;
    } const cases[] = {
        {1.0f, 65536},
        {2.0f, 131072},
        {0.5f, 32768},
        {0.3f, 19660},  // 19660.8
        {-0.3f, -19660},
        {0.0f, 0},
        {-0.0f, 0},
        {1.0f / 65536, 1},
        {0.99f / 65536, 0},
        {-0.99f / 65536, 0},
        {32767.5f, 0x7FFF8000},
        {32768.0f, HIGHEST},
        {1e30f, HIGHEST},
        {INFINITE, HIGHEST},
        {3e38f, HIGHEST},  // the product is infinite
        {-32768.0f, LOWEST},
        {-1e30f, LOWEST},
        {-INFINITE, LOWEST},
        {NAN, 0},
    };
    for (const auto& c : cases) EXPECT_EQ(axis_of(c.scale, 0).step, c.step) << c.scale;
}

TEST(axis_of, WrapsTheOffset) {
    struct {
        int offset;
        int32_t rounding;
        int32_t origin;
    } const cases[] = {
        {0, 0, 0},
        {3, 0, 0x30000},
        {-3, 0, -0x30000},
        {32767, 0, 0x7FFF0000},
        {32768, 0, LOWEST},
        {65536, 0, 0},
        {65539, 0, 0x30000},
        {LOWEST, 0, 0},
        {HIGHEST, 0, -0x10000},
        {3, HALF_PIXEL, 0x38000},
        {32767, HALF_PIXEL, 0x7FFF8000},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(axis_of(1.0f, c.offset, c.rounding).origin, c.origin) << c.offset;
    }
}

TEST(view_axis, WrapsPositions) {
    EXPECT_EQ((view_axis{0x10000, 0x8000}.at(3)), 0x28000);
    EXPECT_EQ((view_axis{0x10000, 0x8000}.at(-3)), -0x8000);
    EXPECT_EQ((view_axis{0x7FFF0000, 0x10000}.at(1)), LOWEST);
    EXPECT_EQ((view_axis{LOWEST, 0x10000}.at(-1)), 0x7FFF0000);
    EXPECT_EQ((view_axis{0, HIGHEST}.at(2)), -2);
    EXPECT_EQ((view_axis{5, LOWEST}.at(2)), 5);
    EXPECT_EQ((view_axis{0, 0x10000}.at(65536)), 0);
}

TEST(whole, RoundsTowardsMinusInfinity) {
    EXPECT_EQ(whole(0xFFFF), 0);
    EXPECT_EQ(whole(0x10000), 1);
    EXPECT_EQ(whole(-1), -1);
    EXPECT_EQ(whole(-0x10000), -1);
    EXPECT_EQ(whole(-0x10001), -2);
    EXPECT_EQ(whole(HIGHEST), 32767);
    EXPECT_EQ(whole(LOWEST), -32768);
}

TEST(clamp_to_photo, TheFarEndFirstAndThenZero) {
    struct {
        int64_t position;
        int size;
        int clamped;
    } const cases[] = {
        {-1, 3, 0},     {0, 3, 0},       {2, 3, 2},
        {3, 3, 2},      {32767, 3, 2},   {-32768, 3, 0},
        {0, 0, 0},      {5, 0, 0},       {-5, 0, 0},
        {0, -4, 0},     {5, -4, 0},      {-5, -4, 0},
        {5, LOWEST, 0}, {-5, LOWEST, 0}, {int64_t{HIGHEST} + 9, HIGHEST, HIGHEST - 1},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(clamp_to_photo(c.position, c.size), c.clamped) << c.position << " of " << c.size;
    }
}
