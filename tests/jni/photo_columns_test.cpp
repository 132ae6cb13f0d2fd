#include "jni/photo_columns.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

#include "tests/helpers/guarded_buffer.h"

namespace {

// What view column i shows, without a look at the class under test.
int shown_column(int32_t first, int32_t step, int i, int photo_width) {
    const int64_t position = first + int64_t{step} * i;
    const int64_t column = position >= 0 ? position / 65536 : (position - 65535) / 65536;
    return static_cast<int>(std::clamp<int64_t>(column, 0, std::max(photo_width - 1, 0)));
}

template <class T>
std::vector<T> shown_of(const photo_columns& columns, const std::vector<T>& row, int n) {
    guarded_buffer<T> from(row, guard::BEHIND);
    guarded_buffer<T> to(std::vector<T>(static_cast<size_t>(n), T{77}), guard::BEHIND);
    columns.show(from.data(), to.data());
    return to.values();
}

template <class T>
std::vector<T> expected_of(const std::vector<T>& row, int32_t first, int32_t step, int n,
                           int photo_width) {
    std::vector<T> expected;
    for (int i = 0; i < n; ++i) {
        expected.push_back(row[static_cast<size_t>(shown_column(first, step, i, photo_width))]);
    }
    return expected;
}

constexpr int32_t STEPS[] = {0,
                             1,
                             HALF_PIXEL - 1,
                             HALF_PIXEL,
                             HALF_PIXEL + 1,
                             ONE_PIXEL - 1,
                             ONE_PIXEL,
                             ONE_PIXEL + 1,
                             2 * ONE_PIXEL,
                             3 * ONE_PIXEL + 12345};

// Positions next to those where a step reaches another column.
constexpr int32_t FIRSTS[] = {-3 * ONE_PIXEL - 1,
                              -ONE_PIXEL,
                              -1,
                              0,
                              1,
                              HALF_PIXEL - 2,
                              HALF_PIXEL - 1,
                              HALF_PIXEL,
                              0xFFFE,
                              ONE_PIXEL,
                              7 * ONE_PIXEL + HALF_PIXEL};

}  // namespace

TEST(photo_columns, ShowColumnsBesideAndInsideThePhotoAtAnyStep) {
    for (const int photo_width : {1, 2, 3, 9, 300}) {
        std::vector<int32_t> pixels;
        std::vector<uint8_t> mask;
        for (int x = 0; x < photo_width; ++x) {
            pixels.push_back(1000 + x);
            mask.push_back(static_cast<uint8_t>(x % 251));
        }
        for (const int32_t step : STEPS) {
            for (const int32_t first : FIRSTS) {
                for (const int n : {0, 1, 2, 3, 4, 5, 8, 65, 130}) {
                    SCOPED_TRACE(testing::Message() << n << " columns from " << first << " by "
                                                    << step << " of " << photo_width);
                    const photo_columns columns(first, step, n, photo_width);
                    ASSERT_EQ(shown_of(columns, pixels, n),
                              expected_of(pixels, first, step, n, photo_width));
                    ASSERT_EQ(shown_of(columns, mask, n),
                              expected_of(mask, first, step, n, photo_width));
                    ASSERT_EQ(columns.last_of_photo(), photo_width - 1);
                    for (int i = 0; i < n; ++i) {
                        ASSERT_EQ(columns[i], whole(first + step * i));
                    }
                }
            }
        }
    }
}

// Stretches of a mask of one value are not gathered; one that only looks so has to be.
TEST(photo_columns, ShowASingleMaskValueWhereverItLies) {
    for (const int32_t step : {20000, 65535, 65536, 80000, 200000, 262144, 270000}) {
        for (const int n : {127, 128, 129, 257}) {
            const int photo_width = whole(step * n) + 1;
            const photo_columns columns(0, step, n, photo_width);
            std::vector<int> positions;  // shown ones and those between
            for (int x = 0; x < photo_width; ++x) {
                const bool at_stretch = x % whole(128 * step + 65535) < 4 || x + 4 >= photo_width;
                if (at_stretch || x % 7 == 0) positions.push_back(x);
            }
            for (const int x : positions) {
                std::vector<uint8_t> mask(static_cast<size_t>(photo_width), 1);
                mask[static_cast<size_t>(x)] = 3;
                std::vector<uint8_t> shown(static_cast<size_t>(n), 77);
                columns.show(mask.data(), shown.data());
                ASSERT_EQ(shown, expected_of(mask, 0, step, n, photo_width))
                    << n << " by " << step << ", column " << x;
            }
        }
    }
}

TEST(photo_columns, ShowAWholeTileWithANeighbourAtEachEnd) {
    constexpr int N = TILE + 2;
    const std::vector<int32_t> few = {5, 6, 7};
    std::vector<int32_t> many;
    for (int x = 0; x < 2 * N; ++x) many.push_back(x);
    for (const int32_t step : {HALF_PIXEL, ONE_PIXEL, ONE_PIXEL + HALF_PIXEL}) {
        EXPECT_EQ(shown_of(photo_columns(-ONE_PIXEL, step, N, 3), few, N),
                  expected_of(few, -ONE_PIXEL, step, N, 3));
        EXPECT_EQ(shown_of(photo_columns(-ONE_PIXEL, step, N, 2 * N), many, N),
                  expected_of(many, -ONE_PIXEL, step, N, 2 * N));
    }
}

TEST(photo_columns, OfAPhotoWithoutColumnsShowItsFirstEntry) {
    for (const int photo_width : {0, -1, -5}) {
        const photo_columns columns(-4 * ONE_PIXEL, ONE_PIXEL, 8, photo_width);
        EXPECT_EQ(columns.last_of_photo(), 0);
        EXPECT_EQ(shown_of<int32_t>(columns, {9}, 8), std::vector<int32_t>(8, 9));
        EXPECT_EQ(shown_of<uint8_t>(columns, {3}, 8), std::vector<uint8_t>(8, 3));
    }
}

TEST(photo_columns, TellWhereAPhotoColumnIsFirstShown) {
    const photo_columns columns(-ONE_PIXEL, HALF_PIXEL, 8, 3);  // -1 -1 0 0 1 1 2 2
    EXPECT_EQ(columns.first_from(-2), 0);
    EXPECT_EQ(columns.first_from(-1), 0);
    EXPECT_EQ(columns.first_from(0), 2);
    EXPECT_EQ(columns.first_from(1), 4);
    EXPECT_EQ(columns.first_from(2), 6);
    EXPECT_EQ(columns.first_from(3), 8);
}

TEST(photo_columns, UnscaledRowsRepeatTheLastColumn) {
    const std::vector<int32_t> row = {5, 6, 7};
    for (const int photo_width : {1, 2, 3}) {
        for (int64_t columns = 0; columns <= 6; ++columns) {
            guarded_buffer<int32_t> to(std::vector<int32_t>(static_cast<size_t>(columns), 77),
                                       guard::BEHIND);
            show_unscaled(row.data(), photo_width, to.data(), columns);
            for (int64_t i = 0; i < columns; ++i) {
                EXPECT_EQ(to.data()[i], row[std::min<size_t>(i, photo_width - 1)]);
            }
        }
    }
}

TEST(rises, WhereNoStepFallsOrLeavesTheRange) {
    EXPECT_TRUE(rises(0, 0, 100));
    EXPECT_TRUE(rises(0, 5, 100));
    EXPECT_FALSE(rises(0, -1, 0));
    EXPECT_TRUE(rises(INT32_MIN, 1, 1));
    EXPECT_FALSE(rises(int64_t{INT32_MIN} - 1, 1, 1));
    EXPECT_TRUE(rises(INT32_MAX - 10, 5, 2));
    EXPECT_FALSE(rises(INT32_MAX - 10, 5, 3));
    EXPECT_FALSE(rises(0, INT32_MAX, 2));
    EXPECT_FALSE(rises(INT32_MAX, INT32_MAX, int64_t{1} << 31));
}

TEST(has_rows_of_its_own, UnlessRowsOfTheViewWouldReadOrOverwriteOthers) {
    int32_t pixels[12] = {}, others[12] = {};
    const view_pixels view = {pixels, 4};
    EXPECT_TRUE(has_rows_of_its_own(view, {others, 4, 3}, {0, 3, 0, 2}));
    EXPECT_FALSE(has_rows_of_its_own(view, {pixels, 4, 3}, {0, 3, 0, 2}));
    EXPECT_TRUE(has_rows_of_its_own(view, {others, 4, 3}, {2, 2, 0, 2}));
    EXPECT_FALSE(has_rows_of_its_own(view, {others, 4, 3}, {3, 2, 0, 2}));
    EXPECT_FALSE(has_rows_of_its_own(view, {others, 4, 3}, {0, 4, 0, 2}));
    EXPECT_FALSE(has_rows_of_its_own(view, {others, 4, 3}, {INT32_MIN, INT32_MAX, 0, 2}));
}
