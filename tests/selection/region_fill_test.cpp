#include <gtest/gtest.h>

#include "selection/region_shaping.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/rect_printing.h"

TEST(Fill_Region, FillsARingAndReportsOnlyTheHole) {
    Picture mask(R"(
        .......
        .#####.
        .#...#.
        .#####.)");
    ze_rect changed = {7, 0, 4, 0};  // empty

    Fill_Region(mask.data(), 7, 4, 0, 6, 0, 3, &changed);

    EXPECT_EQ(mask, Picture(R"(
        .......
        .#####.
        .#####.
        .#####.)"));
    EXPECT_EQ(changed, (ze_rect{2, 4, 2, 2}));
}
